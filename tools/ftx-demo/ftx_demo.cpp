// ftx-demo: a look at the GUI library by eye. A main window with a title, a list and a
// drawing area, and a bottom bar that runs in its own thread like the handset's soft-key
// bar. Up/Down move the list, Enter (or a tap) chooses, the left soft key chooses too and
// the right one quits.
#include <pthread.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>

#include <atomic>

#include "minigui/common.h"
#include "minigui/minigui.h"
#include "minigui/gdi.h"
#include "minigui/window.h"
#include "minigui/control.h"

namespace {

constexpr LINT kTitleId = 20;
constexpr LINT kListId = 21;
constexpr LINT kStatusId = 22;

int g_w, g_h, g_barH;
HWND g_main = HWND_INVALID;
std::atomic<HWND> g_bar{HWND_INVALID};  // made by the bar thread
PLOGFONT g_titleFont, g_listFont, g_smallFont;

struct Entry {
    const char *label;  // GB18030
    const char *status;
};
const Entry kEntries[] = {
    {"Colours of the system table", "SysPixelIndex 0..22 are drawn below the list."},
    {"Pens: 1 and 3 pixels", "Lines, frames and circles follow the pen width."},
    {"\xD6\xD0\xCE\xC4\xCE\xC4\xB1\xBE (Chinese text)", "GB18030 text through iconv and FreeType."},
    {"Touch the list to choose", "A tap chooses the item under the finger."},
    {"Quit with the right soft key", "F3 or Right-Ctrl is the right soft key."},
};

void draw_item(HWND hwnd, HSVITEM item, HDC hdc, RECT *rc) {
    bool hi = scrollview_is_item_hilight(hwnd, item);
    SetBrushColor(hdc, hi ? SysPixelIndex[22] : SysPixelIndex[18]);
    FillBox(hdc, rc->left, rc->top, RECTW(*rc), RECTH(*rc));
    SetPenColor(hdc, SysPixelIndex[20]);
    MoveTo(hdc, rc->left, rc->bottom - 1);
    LineTo(hdc, rc->right, rc->bottom - 1);
    SetBkMode(hdc, BM_TRANSPARENT);
    SetTextColor(hdc, SysPixelIndex[19]);
    RECT text = *rc;
    text.left += g_w / 24;
    const Entry *e = reinterpret_cast<const Entry *>(scrollview_get_item_adddata(item));
    DrawText(hdc, e->label, -1, &text, DT_SINGLELINE | DT_VCENTER | DT_LEFT);
}

void list_chosen(HWND hwnd, LINT, int code, DWORD add) {
    if (code != SVN_ITEMCHOSEN) return;
    const Entry *e = reinterpret_cast<const Entry *>(
        scrollview_get_item_adddata(reinterpret_cast<HSVITEM>(add)));
    SetWindowText(GetDlgItem(GetParent(hwnd), kStatusId), e->status);
}

void paint_samples(HWND hwnd, HDC hdc) {
    RECT rc;
    GetClientRect(hwnd, &rc);
    int top = rc.bottom - g_h / 4;
    int cell = RECTW(rc) / 12;
    for (int i = 0; i < FTX_NR_SYSPIXEL; i++) {
        int x = (i % 12) * cell, y = top + (i / 12) * (cell + 4);
        SetBrushColor(hdc, SysPixelIndex[i]);
        FillBox(hdc, x + 2, y, cell - 4, cell);
    }
    int y = top + 2 * (cell + 4) + cell / 2;
    SetPenColor(hdc, PIXEL_green);
    SetPenWidth(hdc, 1);
    MoveTo(hdc, cell / 2, y);
    LineTo(hdc, RECTW(rc) / 2 - cell / 2, y);
    SetPenWidth(hdc, 3);
    MoveTo(hdc, cell / 2, y + cell / 2);
    LineTo(hdc, RECTW(rc) / 2 - cell / 2, y + cell / 2);
    SetPenColor(hdc, PIXEL_yellow);
    Circle(hdc, RECTW(rc) * 5 / 8, y + cell / 4, cell / 2);
    SetBrushColor(hdc, PIXEL_red);
    int cx = RECTW(rc) * 7 / 8, cy = y + cell / 4, r = cell / 2;
    POINT sector[] = {{cx, cy}, {cx + r, cy}, {cx + r * 7 / 10, cy - r * 7 / 10}, {cx, cy - r}};
    FillPolygon(hdc, sector, 4);
    SetPenWidth(hdc, 1);
}

LRESULT main_proc(HWND hwnd, UINT msg, WPARAM wp, LPARAM lp) {
    switch (msg) {
        case MSG_CREATE: {
            int titleH = g_titleFont->size + 16;
            HWND title = CreateWindowEx(CTRL_STATIC, "FTX GUI demo  \xD1\xDD\xCA\xBE",
                                        WS_VISIBLE | SS_CENTER | SS_CENTERIMAGE, 0, kTitleId, 0, 0,
                                        g_w, titleH, hwnd, 0);
            SetWindowFont(title, g_titleFont);
            SetWindowBkColor(title, SysPixelIndex[17]);
            int itemH = g_listFont->size * 2;
            HWND list = CreateWindowEx(CTRL_SCROLLVIEW, "", WS_VISIBLE | WS_BORDER | SVS_LOOP, 0,
                                       kListId, 0, titleH + 8, g_w, itemH * 5 + 2, hwnd, 0);
            SetWindowFont(list, g_listFont);
            SendMessage(list, SVM_SETITEMDRAW, 0, reinterpret_cast<LPARAM>(draw_item));
            for (const Entry &e : kEntries) {
                SVITEMINFO info{-1, itemH, reinterpret_cast<DWORD>(&e)};
                SendMessage(list, SVM_ADDITEM, 0, reinterpret_cast<LPARAM>(&info));
            }
            SendMessage(list, SVM_SETCURSEL, 0, 1);
            SetNotificationCallback(list, list_chosen);
            SetFocusChild(list);
            HWND status = CreateWindowEx(CTRL_STATIC, "Choose an item.", WS_VISIBLE | SS_LEFT, 0,
                                         kStatusId, g_w / 24, titleH + 8 + itemH * 5 + 16,
                                         g_w - g_w / 12, g_smallFont->size * 3, hwnd, 0);
            SetWindowFont(status, g_smallFont);
            return 0;
        }
        case MSG_KEYDOWN:
            if (wp == SCANCODE_F2) {
                SendMessage(GetDlgItem(hwnd, kListId), MSG_KEYDOWN, SCANCODE_ENTER, 0);
                return 0;
            }
            if (wp == SCANCODE_F3 || wp == SCANCODE_ESCAPE) {
                PostMessage(hwnd, MSG_CLOSE, 0, 0);
                return 0;
            }
            break;
        case MSG_PAINT: {
            HDC hdc = BeginPaint(hwnd);
            SetPenColor(hdc, PIXEL_green);
            SetPenWidth(hdc, 3);
            RECT rc;
            GetClientRect(hwnd, &rc);
            MoveTo(hdc, 0, g_titleFont->size + 17);
            LineTo(hdc, RECTW(rc), g_titleFont->size + 17);
            SetPenWidth(hdc, 1);
            paint_samples(hwnd, hdc);
            EndPaint(hwnd, hdc);
            return 0;
        }
        case MSG_CLOSE:
            if (IsWindow(g_bar)) SendMessage(g_bar, MSG_CLOSE, 0, 0);
            DestroyAllControls(hwnd);
            DestroyMainWindow(hwnd);
            PostQuitMessage(hwnd);
            return 0;
        default:
            break;
    }
    return DefaultMainWinProc(hwnd, msg, wp, lp);
}

// The bottom bar: three slots; a tap on a slot acts as its key on the active window.
const char *const kSlots[3] = {"Choose", "", "Quit"};
const int kSlotKeys[3] = {SCANCODE_F2, SCANCODE_F4, SCANCODE_F3};

LRESULT bar_proc(HWND hwnd, UINT msg, WPARAM wp, LPARAM lp) {
    switch (msg) {
        case MSG_PAINT: {
            HDC hdc = BeginPaint(hwnd);
            SelectFont(hdc, g_listFont);
            SetBkMode(hdc, BM_TRANSPARENT);
            SetTextColor(hdc, SysPixelIndex[19]);
            RECT rc;
            GetClientRect(hwnd, &rc);
            int slot = RECTW(rc) / 3;
            for (int i = 0; i < 3; i++) {
                RECT r{i * slot, 0, (i + 1) * slot, RECTH(rc)};
                DrawText(hdc, kSlots[i], -1, &r, DT_CENTER | DT_VCENTER | DT_SINGLELINE);
            }
            EndPaint(hwnd, hdc);
            return 0;
        }
        case MSG_LBUTTONUP: {
            RECT rc;
            GetClientRect(hwnd, &rc);
            int slot = LOSWORD(lp) / (RECTW(rc) / 3);
            if (slot >= 0 && slot < 3 && kSlots[slot][0] != '\0') {
                HWND active = GetActiveWindow();
                if (active != HWND_DESKTOP) PostMessage(active, MSG_KEYDOWN, kSlotKeys[slot], 0);
            }
            return 0;
        }
        case MSG_CLOSE:
            DestroyMainWindow(hwnd);
            PostQuitMessage(hwnd);
            return 0;
        default:
            return DefaultMainWinProc(hwnd, msg, wp, lp);
    }
}

void *bar_thread(void *) {
    MAINWINCREATE c{};
    c.dwStyle = WS_VISIBLE;
    c.dwExStyle = WS_EX_TOOLWINDOW;
    c.spCaption = "softkeybar";
    c.hHosting = HWND_DESKTOP;
    c.MainWindowProc = bar_proc;
    c.lx = 0;
    c.ty = g_h - g_barH;
    c.rx = g_w;
    c.by = g_h;
    c.iBkColor = SysPixelIndex[17];
    HWND self = CreateMainWindow(&c);
    g_bar = self;
    if (self == HWND_INVALID) return nullptr;
    MSG msg;
    while (GetMessage(&msg, self)) {
        TranslateMessage(&msg);
        DispatchMessage(&msg);
    }
    MainWindowThreadCleanup(self);
    return nullptr;
}

}  // namespace

int main(int argc, char **argv) {
    if (InitGUI(argc, const_cast<const char **>(argv)) != 0) return 1;
    RECT scr = g_rcScr;
    g_w = RECTW(scr);
    g_h = RECTH(scr);
    g_barH = g_h / 15 + 10;
    g_titleFont =
        CreateLogFont("ttf", "song", "GB18030", 'b', 'r', 'n', 'n', 'n', 'n', g_w / 15, 0);
    g_listFont = CreateLogFont("ttf", "song", "GB18030", 'r', 'r', 'n', 'n', 'n', 'n', g_w / 22, 0);
    g_smallFont =
        CreateLogFont("ttf", "song", "GB18030", 'r', 'r', 'n', 'n', 'n', 'n', g_w / 28, 0);

    pthread_t bar;
    CreateThreadForMainWindow(&bar, nullptr, bar_thread, nullptr);

    MAINWINCREATE c{};
    c.dwStyle = WS_VISIBLE;
    c.spCaption = "ftx demo";
    c.hHosting = HWND_DESKTOP;
    c.MainWindowProc = main_proc;
    c.lx = 0;
    c.ty = 0;
    c.rx = g_w;
    c.by = g_h - g_barH;
    c.iBkColor = SysPixelIndex[18];
    g_main = CreateMainWindow(&c);
    if (g_main == HWND_INVALID) return 1;
    InitGUIIAL();
    printf("ftx-demo: %dx%d, console %s/run/console.sock\n", g_w, g_h,
           getenv("FTX_ROOT") ? getenv("FTX_ROOT") : ".");
    fflush(stdout);
    MSG msg;
    while (GetMessage(&msg, g_main)) {
        TranslateMessage(&msg);
        DispatchMessage(&msg);
    }
    MainWindowThreadCleanup(g_main);
    pthread_join(bar, nullptr);
    TerminateGUI(0);
    return 0;
}

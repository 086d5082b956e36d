// The modal dialog. Lives on the GUI thread; CloseButton may come from the PC thread.
#include "mmi_dialog.h"

#include <android/log.h>
#include <minigui/control.h>
#include <stdlib.h>
#include <string.h>
#include <tp_os.h>

#include <mutex>
#include <set>

#include "mmi_theme.h"

#define TAG "MMI_DIALOG"
#define LOGD(...) __android_log_print(ANDROID_LOG_DEBUG, TAG, __VA_ARGS__)

int g_bKeyValid = 0;

namespace {

// Records alive, and the latest one; hooks and CloseButton run off the GUI thread.
std::mutex s_lock;
std::set<MMI_DIALOG *> &s_live = *new std::set<MMI_DIALOG *>;
MMI_DIALOG *s_latest = nullptr;

bool valid(HDIALOG dlg) {
    return dlg != nullptr && dlg != HDIALOG_INVALID;
}

int font_size() {
    int w = g_ptScreenInfo.width;
    return w < 1365 ? (unsigned char)(w / 15) : 90;
}

PLOGFONT make_font(char weight) {
    return CreateLogFont("ttf", "song", "GB18030", weight, 'r', 'n', 'c', 'n', 'n', font_size(), 0);
}

void set_button_colour(MMI_DIALOG *dlg, int i, int colour) {
    if (i < 0 || i >= dlg->buttonCount || dlg->buttons[i] == HWND_INVALID) return;
    SetWindowBkColor(dlg->buttons[i], mmi_pixel(colour));
    InvalidateRect(dlg->buttons[i], nullptr, TRUE);
}

void select_button(MMI_DIALOG *dlg, int i, bool highlight) {
    if (i >= dlg->buttonCount) return;
    if (dlg->selected >= 0 && dlg->selected != i)
        set_button_colour(dlg, dlg->selected, MMI_COLOUR_CONTROL);
    dlg->selected = i;
    if (highlight) set_button_colour(dlg, i, MMI_COLOUR_HILIGHT);
}

// Puts back the hooks (s_lock held) that were in force before DoModal. The library does not hand
// back the previous hooks' contexts; the ones the program installs use none.
void restore_hooks(MMI_DIALOG *dlg) {
    if (!dlg->hooked) return;
    dlg->hooked = 0;
    RegisterKeyMsgHook(nullptr, dlg->savedKeyHook);
    RegisterMouseMsgHook(nullptr, dlg->savedMouseHook);
}

int forward_to_dialog(void *context, UINT msg, WPARAM wparam, LPARAM lparam) {
    std::lock_guard<std::mutex> lk(s_lock);
    MMI_DIALOG *dlg = static_cast<MMI_DIALOG *>(context);
    if (s_live.count(dlg) == 0 || dlg->window == HWND_INVALID) return HOOK_STOP;
    PostMessage(dlg->window, msg, wparam, lparam);
    return HOOK_STOP;
}

int hookKeyProc(void *context, HWND, UINT msg, WPARAM wparam, LPARAM lparam) {
    LOGD("1203 Dialog hookKeyProc enter,msg=%d,wparam=%d,lparam=%d,g_bKeyValid=%d.", (int)msg,
         (int)wparam, (int)lparam, g_bKeyValid);
    return forward_to_dialog(context, msg, wparam, lparam);
}

int hookMouseProc(void *context, HWND, UINT msg, WPARAM wparam, LPARAM lparam) {
    return forward_to_dialog(context, msg, wparam, lparam);
}

void close_window(MMI_DIALOG *dlg) {
    if (dlg->window == HWND_INVALID) return;
    HWND w = dlg->window;
    {
        std::lock_guard<std::mutex> lk(s_lock);
        dlg->window = HWND_INVALID;
    }
    DestroyAllControls(w);
    DestroyMainWindow(w);
    dlg->closedWindow = w;
}

// Called with s_lock held.
void report_locked(MMI_DIALOG *dlg, int button) {
    restore_hooks(dlg);
    PostMessage(dlg->notify, MSG_DIALOGBTN, (WPARAM)button, 0);
}

LRESULT DialogProc(HWND hWnd, UINT message, WPARAM wParam, LPARAM lParam) {
    LOGD("1203 Dialog DialogProc enter");
    MMI_DIALOG *dlg = reinterpret_cast<MMI_DIALOG *>(GetWindowAdditionalData(hWnd));
    if (message == 3 || (message >= 5 && message <= 15) || message == 17 || dlg == nullptr)
        return DefaultMainWinProc(hWnd, message, wParam, lParam);
    switch (message) {
        case MSG_LBUTTONDOWN: {
            int i = mmi_dialog_button_at(&dlg->layout, LOSWORD(lParam), HISWORD(lParam));
            if (i >= 0) {
                select_button(dlg, i, true);
                LOGD("1203 Dialog MSG_LBUTTONDOWN  DialogProc index = %d", i);
            }
            return 0;
        }
        case MSG_MOUSEMOVE:
            if (dlg->selected >= 0 && mmi_dialog_button_at(&dlg->layout, LOSWORD(lParam),
                                                           HISWORD(lParam)) != dlg->selected) {
                set_button_colour(dlg, dlg->selected, MMI_COLOUR_CONTROL);
                dlg->selected = -1;
            }
            return 0;
        case MSG_KEYDOWN:
            LOGD("mm_idialog.Dialog. DialogProc MSG_KEYDOWN enter.wParam=%d", (int)wParam);
            if (wParam == SCANCODE_F2) select_button(dlg, 0, true);
            if (wParam == SCANCODE_F3) select_button(dlg, 1, true);
            // A one-button dialog answers 1 (continue) on the down key, past its only button.
            if (wParam == SCANCODE_CURSORBLOCKDOWN && dlg->buttonCount == 1) dlg->selected = 1;
            return 0;
        case MSG_LBUTTONUP:
        case MSG_KEYUP:
            if (dlg->selected != -1) {
                {
                    std::lock_guard<std::mutex> lk(s_lock);
                    report_locked(dlg, dlg->selected);
                }
                SendMessage(hWnd, MSG_CLOSE, 0, 0);
            }
            return 0;
        case MSG_CLOSE:
            LOGD("1203 Dialog DialogProc MSG_CLOSE enter");
            close_window(dlg);
            return 0;
        case MSG_PAINT: {
            HDC hdc = BeginPaint(hWnd);
            const MMI_DIALOG_LAYOUT &l = dlg->layout;
            int w = RECTW(l.dialog);
            SetPenColor(hdc, mmi_pixel(MMI_COLOUR_GRAY));
            if (l.count > 0) {
                MoveTo(hdc, 0, l.buttons.top);
                LineTo(hdc, w, l.buttons.top);
            }
            for (int i = 1; i < l.count; i++) {
                MoveTo(hdc, i * l.buttonWidth - 1, l.buttons.top);
                LineTo(hdc, i * l.buttonWidth - 1, l.buttons.bottom);
            }
            SetPenColor(hdc, mmi_pixel(MMI_COLOUR_HILIGHT));
            for (int row = l.title.bottom; row < l.title.bottom + dlg->separator; row++) {
                MoveTo(hdc, 0, row);
                LineTo(hdc, w, row);
            }
            EndPaint(hWnd, hdc);
            return 0;
        }
        default:
            return DefaultMainWinProc(hWnd, message, wParam, lParam);
    }
}

HWND make_static(MMI_DIALOG *dlg, const char *text, DWORD style, LINT id, const RECT &rc,
                 PLOGFONT font) {
    HWND h = CreateWindowEx(CTRL_STATIC, text, style, WS_EX_NONE, id, rc.left, rc.top, RECTW(rc),
                            RECTH(rc), dlg->window, 0);
    if (h == HWND_INVALID) return h;
    SetWindowBkColor(h, mmi_pixel(MMI_COLOUR_CONTROL));
    if (font) SetWindowFont(h, font);
    return h;
}

void free_record(MMI_DIALOG *dlg) {
    for (PLOGFONT f : dlg->fonts)
        if (f) DestroyLogFont(f);
    free(dlg);
}

}  // namespace

void mmi_dialog_layout(int x, int y, int w, int h, int n, MMI_DIALOG_LAYOUT *out) {
    int third = h / 3;
    SetRect(&out->dialog, x, y, x + w, y + h);
    SetRect(&out->title, 0, 0, w, third - 4);
    SetRect(&out->text, 0, third, w, 2 * third);
    SetRect(&out->buttons, 0, 2 * third + 1, w, h);
    out->count = n > 0 ? n : 0;
    out->buttonWidth = n > 0 ? w / n : 0;
}

void mmi_dialog_button_rect(const MMI_DIALOG_LAYOUT *l, int i, RECT *out) {
    int left = i * l->buttonWidth;
    int width = i == l->count - 1 ? RECTW(l->dialog) - left : l->buttonWidth - 1;
    SetRect(out, left, l->buttons.top, left + width, l->buttons.bottom);
}

int mmi_dialog_button_at(const MMI_DIALOG_LAYOUT *l, int screenX, int screenY) {
    if (l->count <= 0 || l->buttonWidth <= 0) return -1;
    int x = screenX - l->dialog.left;
    int y = screenY - l->dialog.top;
    if (x < 0 || x >= RECTW(l->dialog) || y < l->buttons.top || y >= l->buttons.bottom) return -1;
    int i = x / l->buttonWidth;
    return i < l->count ? i : l->count - 1;
}

HDIALOG CreateDialog(const char *title, const char *text, int x, int y, int w, int h,
                     HWND hostWindow, HWND notifyWindow, DWORD styleArgument,
                     const char *const *buttonLabels, int n, DWORD flags) {
    LOGD("1203 Dialog CreateDialog enter");
    if (n < 0) n = 0;
    g_bKeyValid = (n == 1);
    size_t size = sizeof(MMI_DIALOG) + sizeof(HWND) * (n > 0 ? n - 1 : 0);
    MMI_DIALOG *dlg = static_cast<MMI_DIALOG *>(calloc(1, size));
    if (!dlg) return HDIALOG_INVALID;
    dlg->flags = flags;
    dlg->style = styleArgument;
    tp_os_strlcpy(dlg->title, title ? title : "", sizeof dlg->title);
    tp_os_strlcpy(dlg->text, text ? text : "", sizeof dlg->text);
    dlg->host = hostWindow;
    dlg->notify = notifyWindow;
    dlg->separator = 4;
    dlg->selected = -1;
    dlg->buttonCount = n;
    dlg->closedWindow = HWND_INVALID;
    dlg->titleCtrl = dlg->textCtrl = HWND_INVALID;
    for (int i = 0; i < n; i++)
        dlg->buttons[i] = HWND_INVALID;
    mmi_dialog_layout(x, y, w, h, n, &dlg->layout);

    MAINWINCREATE create{};
    create.dwStyle = WS_CAPTION | WS_BORDER;
    create.spCaption = "";
    create.hHosting = hostWindow;
    create.MainWindowProc = DialogProc;
    create.lx = x;
    create.ty = y;
    create.rx = x + w;
    create.by = y + h;
    create.iBkColor = mmi_pixel(MMI_COLOUR_GRAY);
    create.dwAddData = (DWORD)dlg;
    dlg->window = CreateMainWindow(&create);
    if (dlg->window == HWND_INVALID) {
        free_record(dlg);
        return HDIALOG_INVALID;
    }
    {
        std::lock_guard<std::mutex> lk(s_lock);
        s_live.insert(dlg);
        s_latest = dlg;
    }
    dlg->fonts[0] = make_font('b');
    dlg->fonts[1] = make_font('r');
    dlg->fonts[2] = make_font('r');
    const DWORD visible = WS_VISIBLE | WS_BORDER;
    dlg->titleCtrl = make_static(dlg, dlg->title, visible | SS_LEFT | SS_CENTERIMAGE, n + 1,
                                 dlg->layout.title, dlg->fonts[0]);
    dlg->textCtrl = make_static(dlg, dlg->text, visible | SS_CENTER | SS_CENTERIMAGE, n + 2,
                                dlg->layout.text, dlg->fonts[1]);
    for (int i = 0; i < n; i++) {
        RECT rc;
        mmi_dialog_button_rect(&dlg->layout, i, &rc);
        const char *label = buttonLabels && buttonLabels[i] ? buttonLabels[i] : "";
        dlg->buttons[i] =
            make_static(dlg, label, visible | SS_CENTER | SS_CENTERIMAGE | SS_NOPREFIX, i + 1, rc,
                        dlg->fonts[2]);
        if (dlg->buttons[i] == HWND_INVALID) {
            DestroyDialog(dlg);
            return HDIALOG_INVALID;
        }
    }
    LOGD("1203 Dialog CreateDialog exit");
    return dlg;
}

int DoModal(HDIALOG dlg) {
    LOGD("1203 Dialog DoModal=%d", valid(dlg) ? 1 : 0);
    if (!valid(dlg) || dlg->window == HWND_INVALID) return 0;
    ShowWindow(dlg->window, SW_SHOWNORMAL);
    dlg->savedMouseHook = RegisterMouseMsgHook(dlg, hookMouseProc);
    dlg->savedKeyHook = RegisterKeyMsgHook(dlg, hookKeyProc);
    dlg->hooked = 1;
    return 1;
}

void DestroyDialog(HDIALOG dlg) {
    if (!valid(dlg)) return;
    {
        std::lock_guard<std::mutex> lk(s_lock);
        restore_hooks(dlg);
    }
    close_window(dlg);
    {
        std::lock_guard<std::mutex> lk(s_lock);
        s_live.erase(dlg);
        if (s_latest == dlg) s_latest = nullptr;
    }
    if (dlg->closedWindow != HWND_INVALID) MainWindowThreadCleanup(dlg->closedWindow);
    free_record(dlg);
    LOGD("%s end", "DestroyDialog");
}

int CloseButton(void) {
    std::lock_guard<std::mutex> lk(s_lock);
    MMI_DIALOG *dlg = s_latest;
    if (dlg == nullptr || s_live.count(dlg) == 0) return 1;
    report_locked(dlg, MMI_DIALOG_CLOSE_BUTTON);
    return 1;
}

int AutoCloseDialog(const char *parm, int parmLen, char *reply, unsigned int replySize) {
    (void)parmLen;
    (void)reply;
    (void)replySize;
    __android_log_print(ANDROID_LOG_DEBUG, "AtThread", "%s begin,bufIn=%s", "AutoCloseDialog",
                        parm ? parm : "");
    return CloseButton() != 0 ? 1 : 0;
}

// The icon-let control. It only draws; the bar around it handles the pointer.
#include "mmi_iconlet.h"

#include <string.h>

#include <algorithm>
#include <vector>

namespace {

const ICONLET_SKIN kDefaultSkin = {22, -1};

struct IconLet {
    std::vector<ICONLET_ITEM> items;
    ICONLET_SKIN skin = kDefaultSkin;
    int pressed = -1;
    int textColour = 19;
    int align = ICONLET_ALIGN_CENTER;
    bool locked = false;
};

IconLet *data_of(HWND h) {
    return reinterpret_cast<IconLet *>(GetWindowAdditionalData2(h));
}

void repaint(HWND h, IconLet *d) {
    if (!d->locked) InvalidateRect(h, nullptr, TRUE);
}

// Where each item's text goes. A centred text wider than its slot (a long title) spreads
// into the room its neighbours' texts leave free instead of being cut at the slot's edges.
std::vector<RECT> text_boxes(HDC hdc, const IconLet *d, int width, int height) {
    size_t n = d->items.size();
    std::vector<RECT> boxes(n);
    std::vector<int> inkLeft(n), inkRight(n);
    for (size_t i = 0; i < n; i++) {
        const ICONLET_ITEM &it = d->items[i];
        boxes[i] = {it.x, 0, it.x + it.width, height};
        SIZE size = {0, 0};
        if (it.text[0] != '\0') GetTextExtent(hdc, it.text, -1, &size);
        int centre = it.x + it.width / 2;
        inkLeft[i] = size.cx > 0 ? centre - size.cx / 2 : centre;
        inkRight[i] = size.cx > 0 ? centre + (size.cx + 1) / 2 : centre;
    }
    if (d->align != ICONLET_ALIGN_CENTER) return boxes;
    for (size_t i = 0; i < n; i++) {
        const ICONLET_ITEM &it = d->items[i];
        if (inkRight[i] - inkLeft[i] <= it.width) continue;
        int left = 0, right = width;
        for (size_t j = 0; j < n; j++) {
            if (j == i || inkRight[j] == inkLeft[j]) continue;  // an empty neighbour
            if (d->items[j].x < it.x) left = std::max(left, std::min(inkRight[j], it.x));
            if (d->items[j].x > it.x)
                right = std::min(right, std::max(inkLeft[j], it.x + it.width));
        }
        boxes[i].left = std::max(left, inkLeft[i]);
        boxes[i].right = std::min(right, inkRight[i]);
    }
    return boxes;
}

void paint(HWND h, IconLet *d) {
    HDC hdc = BeginPaint(h);
    RECT rc;
    GetClientRect(h, &rc);
    SetBkMode(hdc, BM_TRANSPARENT);
    int colour = d->skin.textColour >= 0 ? d->skin.textColour : d->textColour;
    SetTextColor(hdc, SysPixelIndex[colour]);
    UINT fmt = DT_SINGLELINE | DT_VCENTER | DT_NOPREFIX;
    if (d->align == ICONLET_ALIGN_CENTER) fmt |= DT_CENTER;
    if (d->align == ICONLET_ALIGN_RIGHT) fmt |= DT_RIGHT;
    std::vector<RECT> boxes = text_boxes(hdc, d, RECTW(rc), RECTH(rc));
    for (size_t i = 0; i < d->items.size(); i++) {
        const ICONLET_ITEM &it = d->items[i];
        if (it.slot == d->pressed) {
            SetBrushColor(hdc, SysPixelIndex[d->skin.pressedBkColour]);
            FillBox(hdc, it.x, 0, it.width, RECTH(rc));
        }
        DrawText(hdc, it.text, -1, &boxes[i], fmt);
    }
    EndPaint(h, hdc);
}

LRESULT IconLetProc(HWND h, UINT msg, WPARAM wParam, LPARAM lParam) {
    IconLet *d = data_of(h);
    switch (msg) {
        case MSG_CREATE:
            SetWindowAdditionalData2(h, (DWORD) new IconLet);
            return 0;
        case MSG_DESTROY:
            delete d;
            SetWindowAdditionalData2(h, 0);
            return 0;
        case MSG_PAINT:
            if (d)
                paint(h, d);
            else {
                HDC hdc = BeginPaint(h);
                EndPaint(h, hdc);
            }
            return 0;
        case MSG_LBUTTONDOWN:
        case MSG_LBUTTONUP:
        case MSG_MOUSEMOVE:
            // The bar window sees the pointer first and decides what a tap means.
            return 0;
        default:
            break;
    }
    if (d == nullptr) return DefaultControlProc(h, msg, wParam, lParam);
    switch (msg) {
        case ILM_ADDITEM: {
            const ICONLET_ITEM *it = reinterpret_cast<const ICONLET_ITEM *>(lParam);
            if (!it) return -1;
            d->items.push_back(*it);
            d->items.back().text[ICONLET_TEXT_SIZE - 1] = '\0';
            repaint(h, d);
            return (LRESULT)d->items.size() - 1;
        }
        case ILM_RESETCONTENT:
            d->items.clear();
            d->pressed = -1;
            repaint(h, d);
            return 0;
        case ILM_SETSKIN: {
            const ICONLET_SKIN *skin = reinterpret_cast<const ICONLET_SKIN *>(lParam);
            d->skin = skin ? *skin : kDefaultSkin;
            repaint(h, d);
            return 0;
        }
        case ILM_SETPRESSED:
            d->pressed = (int)(LRESULT)wParam;
            repaint(h, d);
            return 0;
        case ILM_GETPRESSED:
            return d->pressed;
        case ILM_SETTEXTCOLOR:
            if (wParam < FTX_NR_SYSPIXEL) d->textColour = (int)wParam;
            repaint(h, d);
            return 0;
        case ILM_SETALIGN:
            d->align = (int)wParam;
            repaint(h, d);
            return 0;
        case ILM_LOCKPAINT:
            d->locked = wParam != 0;
            repaint(h, d);
            return 0;
        case ILM_GETITEMCOUNT:
            return (LRESULT)d->items.size();
        case ILM_GETITEM: {
            ICONLET_ITEM *out = reinterpret_cast<ICONLET_ITEM *>(lParam);
            if (!out || wParam >= d->items.size()) return -1;
            *out = d->items[wParam];
            return 0;
        }
        default:
            return DefaultControlProc(h, msg, wParam, lParam);
    }
}

}  // namespace

BOOL RegisterIconLetCtrl(void) {
    WNDCLASS cls{};
    cls.spClassName = CTRL_ICONLET;
    cls.dwStyle = WS_NONE;
    cls.dwExStyle = WS_EX_NONE;
    cls.iBkColor = SysPixelIndex[17];
    cls.WinProc = IconLetProc;
    if (RegisterWindowClass(&cls)) return TRUE;
    // Already registered by an earlier call.
    WNDCLASS known{};
    known.spClassName = CTRL_ICONLET;
    return GetWindowClassInfo(&known);
}

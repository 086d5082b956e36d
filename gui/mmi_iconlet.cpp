// The icon-let control. It only draws; the bar around it handles the pointer.
#include "mmi_iconlet.h"

#include <string.h>

#include <algorithm>
#include <vector>

#include "mmi_theme.h"

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

// Where an item's text is drawn: the box it is clipped to and where it starts, and how
// many of its bytes (-1: all).
struct TextPlace {
    RECT box;
    UINT fmt;
    int count;
};

// Bytes of the GB18030 character at s: 1, 2 or 4.
int char_len(const char *s) {
    unsigned char c = (unsigned char)s[0];
    if (c < 0x81 || c == 0xFF || s[1] == '\0') return 1;
    unsigned char c2 = (unsigned char)s[1];
    if (c2 >= 0x30 && c2 <= 0x39) return s[2] != '\0' && s[3] != '\0' ? 4 : 1;
    return 2;
}

// Bytes of the longest start of text, in whole characters, at most room pixels wide.
int fitting_len(HDC hdc, const char *text, int room) {
    int len = 0;
    for (int next; text[len] != '\0'; len = next) {
        next = len + char_len(text + len);
        if (GetTextExtent(hdc, text, next, nullptr) > room) break;
    }
    return len;
}

// Where each item's text goes. A text that fits its slot sits in it as aligned. A centred
// text wider than its slot (a long title) may spread into the room its neighbours leave
// free: a slot without text, or the part of a neighbour's slot beyond that neighbour's
// text; two wide texts share the free room between them. It stays centred where that room
// allows, keeps a gap to every other text, and what still does not fit is cut after the
// last whole character its room takes, its start readable. No text is drawn over, or run
// into, another.
std::vector<TextPlace> place_texts(HDC hdc, const IconLet *d, UINT fmt, int width, int height) {
    const size_t n = d->items.size();
    std::vector<TextPlace> places(n);
    std::vector<int> inkW(n, 0);
    int textH = 0;
    for (size_t i = 0; i < n; i++) {
        const ICONLET_ITEM &it = d->items[i];
        places[i] = {{it.x, 0, it.x + it.width, height}, fmt, -1};
        SIZE size = {0, 0};
        if (it.text[0] != '\0') GetTextExtent(hdc, it.text, -1, &size);
        inkW[i] = size.cx;
        textH = std::max(textH, (int)size.cy);
    }
    if (d->align != ICONLET_ALIGN_CENTER) return places;
    // About two characters: less reads as a blank inside one text.
    const int gap = std::max(4, textH);

    // What each text holds: its ink when it fits its slot, the whole slot when it does not.
    struct Claim {
        int left, right;
        bool wide;
    };
    std::vector<Claim> claims(n);
    for (size_t i = 0; i < n; i++) {
        const ICONLET_ITEM &it = d->items[i];
        bool wide = inkW[i] > it.width;
        int centre = it.x + it.width / 2;
        claims[i] = wide ? Claim{it.x, it.x + it.width, true}
                         : Claim{centre - inkW[i] / 2, centre - inkW[i] / 2 + inkW[i], false};
    }
    for (size_t i = 0; i < n; i++) {
        const ICONLET_ITEM &it = d->items[i];
        if (!claims[i].wide) continue;
        // The nearest texts on either side.
        int prev = -1, next = -1;
        for (size_t j = 0; j < n; j++) {
            if (j == i || inkW[j] == 0) continue;
            const ICONLET_ITEM &o = d->items[j];
            if (o.x < it.x && (prev < 0 || o.x > d->items[prev].x)) prev = (int)j;
            if (o.x > it.x && (next < 0 || o.x < d->items[next].x)) next = (int)j;
        }
        int left = 0, right = width;
        if (prev >= 0) {
            const Claim &p = claims[prev];
            left = p.wide ? (p.right + claims[i].left) / 2 + gap - gap / 2 : p.right + gap;
        }
        if (next >= 0) {
            const Claim &q = claims[next];
            right = q.wide ? (claims[i].right + q.left) / 2 - gap / 2 : q.left - gap;
        }
        if (right < left) right = left;
        int x = left, count = -1;
        if (inkW[i] <= right - left) {
            x = std::min(std::max(it.x + it.width / 2 - inkW[i] / 2, left), right - inkW[i]);
        } else {
            count = fitting_len(hdc, it.text, right - left);
        }
        places[i] = {{x, 0, right, height}, (fmt & ~(UINT)(DT_CENTER | DT_RIGHT)) | DT_LEFT, count};
    }
    return places;
}

void paint(HWND h, IconLet *d) {
    HDC hdc = BeginPaint(h);
    RECT rc;
    GetClientRect(h, &rc);
    SetBkMode(hdc, BM_TRANSPARENT);
    int colour = d->skin.textColour >= 0 ? d->skin.textColour : d->textColour;
    SetTextColor(hdc, mmi_pixel(colour));
    UINT fmt = DT_SINGLELINE | DT_VCENTER | DT_NOPREFIX;
    if (d->align == ICONLET_ALIGN_CENTER) fmt |= DT_CENTER;
    if (d->align == ICONLET_ALIGN_RIGHT) fmt |= DT_RIGHT;
    std::vector<TextPlace> places = place_texts(hdc, d, fmt, RECTW(rc), RECTH(rc));
    for (size_t i = 0; i < d->items.size(); i++) {
        const ICONLET_ITEM &it = d->items[i];
        if (it.slot == d->pressed) {
            SetBrushColor(hdc, mmi_pixel(d->skin.pressedBkColour));
            FillBox(hdc, it.x, 0, it.width, RECTH(rc));
        }
        // DrawText clips to the box.
        DrawText(hdc, it.text, places[i].count, &places[i].box, places[i].fmt);
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
    cls.iBkColor = mmi_pixel(MMI_COLOUR_BAR);
    cls.WinProc = IconLetProc;
    if (RegisterWindowClass(&cls)) return TRUE;
    // Already registered by an earlier call.
    WNDCLASS known{};
    known.spClassName = CTRL_ICONLET;
    return GetWindowClassInfo(&known);
}

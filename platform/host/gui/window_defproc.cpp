// The default window procedures: keys go to the focused control, the pointer to the control
// beneath it, the background is painted in the window's colour and a main window's text is
// its caption.
#include <string.h>

#include <algorithm>

#include "window_internal.h"

namespace ftxgui {

// Sends a pointer message on to the control beneath it (or to the one holding the pointer).
static bool route_mouse(Window *self, UINT msg, WPARAM wp, LPARAM lp) {
    int x = LOSWORD(lp), y = HISWORD(lp);
    Window *target = nullptr;
    int cx = 0, cy = 0;
    {
        std::lock_guard<std::mutex> lk(g_lock);
        if (g_windows.count(self) == 0) return false;
        if (self->capture != nullptr && g_windows.count(self->capture) != 0) {
            target = self->capture;
        } else {
            for (auto it = self->children.rbegin(); it != self->children.rend(); ++it) {
                Window *c = *it;
                if (!shown(c) || (c->style & WS_DISABLED) != 0) continue;
                if (!PtInRect(&c->rc, x, y) || control_mouse_transparent(c)) continue;
                target = c;
                break;
            }
        }
        if (msg == MSG_LBUTTONDOWN || msg == MSG_RBUTTONDOWN) self->capture = target;
        if (msg == MSG_LBUTTONUP || msg == MSG_RBUTTONUP) self->capture = nullptr;
        if (target != nullptr) {
            cx = x - target->rc.left - border_of(target);
            cy = y - target->rc.top - border_of(target);
        }
    }
    if (target == nullptr) return false;
    SendMessage(target, msg, wp, MAKELONG(static_cast<WORD>(cx), static_cast<WORD>(cy)));
    return true;
}

static LRESULT common_proc(HWND h, UINT msg, WPARAM wp, LPARAM lp, bool isMain) {
    switch (msg) {
        case MSG_KEYDOWN:
        case MSG_KEYUP:
        case MSG_CHAR:
        case MSG_SYSKEYDOWN:
        case MSG_SYSKEYUP:
        case MSG_SYSCHAR:
        case MSG_KEYLONGPRESS:
        case MSG_KEYALWAYSPRESS: {
            HWND focus = GetFocusChild(h);
            if (focus != nullptr) return SendMessage(focus, msg, wp, lp);
            return 0;
        }
        case MSG_LBUTTONDOWN:
        case MSG_LBUTTONUP:
        case MSG_LBUTTONDBLCLK:
        case MSG_MOUSEMOVE:
        case MSG_RBUTTONDOWN:
        case MSG_RBUTTONUP:
        case MSG_RBUTTONDBLCLK:
            route_mouse(static_cast<Window *>(h), msg, wp, lp);
            return 0;
        case MSG_PAINT: {
            HDC hdc = BeginPaint(h);
            EndPaint(h, hdc);
            return 0;
        }
        case MSG_ERASEBKGND: {
            HDC hdc = reinterpret_cast<HDC>(wp);
            bool own = hdc == nullptr;
            if (own) hdc = GetClientDC(h);
            RECT rc;
            GetClientRect(h, &rc);
            if (lp != 0) IntersectRect(&rc, &rc, reinterpret_cast<const RECT *>(lp));
            Uint32 old = SetBrushColor(hdc, GetWindowBkColor(h));
            FillBox(hdc, rc.left, rc.top, RECTW(rc), RECTH(rc));
            SetBrushColor(hdc, old);
            if (own) ReleaseDC(hdc);
            return 0;
        }
        case MSG_SETTEXT:
            if (!isMain) return 0;
            SetWindowCaption(h, reinterpret_cast<const char *>(lp));
            return 0;
        case MSG_GETTEXTLENGTH: {
            const char *c = GetWindowCaption(h);
            return c != nullptr ? static_cast<LRESULT>(strlen(c)) : 0;
        }
        case MSG_GETTEXT: {
            char *buf = reinterpret_cast<char *>(lp);
            if (buf == nullptr) return 0;
            std::string c;
            {
                std::lock_guard<std::mutex> lk(g_lock);
                Window *w = as_window_locked(h);
                if (w != nullptr) c = w->caption;
            }
            size_t n = std::min(c.size(), static_cast<size_t>(wp));
            memcpy(buf, c.data(), n);
            buf[n] = '\0';
            return static_cast<LRESULT>(n);
        }
        default:
            return 0;
    }
}

LRESULT default_main_proc(HWND h, UINT msg, WPARAM wp, LPARAM lp) {
    return common_proc(h, msg, wp, lp, true);
}
LRESULT default_control_proc(HWND h, UINT msg, WPARAM wp, LPARAM lp) {
    return common_proc(h, msg, wp, lp, false);
}

}  // namespace ftxgui

using namespace ftxgui;

extern "C" {

WNDPROC __mg_def_proc[3] = {default_main_proc, default_main_proc, default_control_proc};

}  // extern "C"

// Z-order and activation: raising, the active window, showing, hiding and moving main
// windows, and repainting what a window leaves uncovered.
#include <algorithm>

#include "window_internal.h"

namespace ftxgui {

namespace {

// Raises w to the top of its band (top-most windows stay above the others).
void raise_locked(Window *w) {
    g_zorder.erase(std::remove(g_zorder.begin(), g_zorder.end(), w), g_zorder.end());
    size_t pos = 0;
    if ((w->exStyle & WS_EX_TOPMOST) == 0) {
        while (pos < g_zorder.size() && (g_zorder[pos]->exStyle & WS_EX_TOPMOST) != 0)
            pos++;
    }
    g_zorder.insert(g_zorder.begin() + static_cast<long>(pos), w);
    g_zGen++;
}

void notify_active(Window *w, BOOL on) {
    bool mine;
    {
        std::lock_guard<std::mutex> lk(g_lock);
        if (g_windows.count(w) == 0) return;
        mine = same_thread(w->queue);
    }
    if (mine)
        SendMessage(w, MSG_ACTIVE, on, 0);
    else
        SendNotifyMessage(w, MSG_ACTIVE, on, 0);
}

}  // namespace

Window *pick_active_locked(const Window *exclude) {
    for (Window *w : g_zorder) {
        if (w != exclude && shown(w) && !is_tool(w) && (w->style & WS_DISABLED) == 0) return w;
    }
    return nullptr;
}

// Repaints what a vanished or moved window leaves behind: the windows there are
// invalidated and bare desktop is painted black.
void expose_locked(const RECT &rc, const Window *gone) {
    RECT r, scr = screen_rect();
    if (!IntersectRect(&r, &rc, &scr)) return;
    Region desk;
    desk.set(r);
    for (Window *w : g_zorder) {
        if (w == gone || !shown(w)) continue;
        RECT wr = window_screen_rect_locked(w), hit;
        if (IntersectRect(&hit, &wr, &r)) {
            RECT cr = client_screen_rect_locked(w);
            OffsetRect(&hit, -cr.left, -cr.top);
            invalidate_locked(w, &hit, true);
            w->paintPending = true;
        }
        desk.subtract(wr);
    }
    if (!desk.empty()) {
        std::lock_guard<std::mutex> fb(g_fbLock);
        for (const RECT &d : desk.rects)
            fill_screen_rect_locked_fb(desk, d, 0);
        g_fbSerial++;
    }
}

// Makes nw the active window and tells both windows; call without the lock.
void activate(Window *nw) {
    Window *old;
    {
        std::lock_guard<std::mutex> lk(g_lock);
        old = g_active;
        if (old == nw) return;
        g_active = nw;
    }
    if (old != nullptr) notify_active(old, FALSE);
    if (nw != nullptr) notify_active(nw, TRUE);
}

std::vector<Window *> zorder_snapshot_locked() {
    return g_zorder;
}
Window *active_locked() {
    return g_active;
}

}  // namespace ftxgui

using namespace ftxgui;

extern "C" {

BOOL ShowWindow(HWND h, int cmd) {
    Window *next = nullptr;
    bool changeActive = false;
    {
        std::lock_guard<std::mutex> lk(g_lock);
        Window *w = as_window_locked(h);
        if (w == nullptr) return FALSE;
        bool was = (w->style & WS_VISIBLE) != 0;
        g_zGen++;
        if (cmd == SW_HIDE) {
            if (!was) return TRUE;
            w->style &= ~static_cast<DWORD>(WS_VISIBLE);
            if (w->isMain) {
                expose_locked(w->rc, w);
                if (g_active == w) {
                    g_active = nullptr;
                    next = pick_active_locked(w);
                    changeActive = true;
                }
            } else if (w->parent != nullptr) {
                invalidate_locked(w->parent, &w->rc, true);
            }
        } else {
            w->style |= WS_VISIBLE;
            if (w->isMain) {
                // The newest shown window is on top and active; SW_SHOW only shows, so a
                // bar being shown again never takes the keys from the window in front.
                if (cmd == SW_SHOWNORMAL) raise_locked(w);
                if (!was || cmd == SW_SHOWNORMAL) invalidate_locked(w, nullptr, true);
                if (!is_tool(w) && (cmd == SW_SHOWNORMAL || g_active == nullptr)) {
                    next = w;
                    changeActive = true;
                }
            } else if (!was) {
                invalidate_locked(w, nullptr, true);
            }
        }
    }
    SendNotifyMessage(h, MSG_SHOWWINDOW, static_cast<WPARAM>(cmd), 0);
    if (changeActive) activate(next);
    return TRUE;
}

BOOL MoveWindow(HWND h, int x, int y, int w, int hgt, BOOL fPaint) {
    std::lock_guard<std::mutex> lk(g_lock);
    Window *win = as_window_locked(h);
    if (win == nullptr) return FALSE;
    RECT old = window_screen_rect_locked(win);
    RECT oldRel = win->rc;
    win->rc = RECT{x, y, x + std::max(w, 0), y + std::max(hgt, 0)};
    g_zGen++;
    if (win->isMain) {
        if (shown(win)) expose_locked(old, win);
    } else if (win->parent != nullptr) {
        invalidate_locked(win->parent, &oldRel, true);
    }
    if (fPaint || shown(win)) invalidate_locked(win, nullptr, true);
    return TRUE;
}

HWND GetActiveWindow(void) {
    std::lock_guard<std::mutex> lk(g_lock);
    return g_active != nullptr ? static_cast<HWND>(g_active) : HWND_DESKTOP;
}

HWND SetActiveWindow(HWND h) {
    Window *old;
    {
        std::lock_guard<std::mutex> lk(g_lock);
        Window *w = as_window_locked(h);
        if (w == nullptr || !w->isMain) return HWND_INVALID;
        old = g_active;
    }
    activate(static_cast<Window *>(h));
    return old != nullptr ? static_cast<HWND>(old) : HWND_DESKTOP;
}

}  // extern "C"

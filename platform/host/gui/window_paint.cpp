// Painting and invalidation: the invalid part of each window, the next window due a paint,
// what of a window is visible on screen, and painting at once on the owner's thread.
#include "window_internal.h"

namespace ftxgui {

namespace {

void paint_now(HWND h) {
    std::vector<Window *> todo;
    {
        std::lock_guard<std::mutex> lk(g_lock);
        Window *w = as_window_locked(h);
        if (w == nullptr) return;
        std::vector<Window *> stack{w};
        while (!stack.empty()) {
            Window *c = stack.back();
            stack.pop_back();
            if (!shown(c)) continue;
            if (c->paintPending) {
                c->paintPending = false;
                todo.push_back(c);
            }
            for (auto it = c->children.rbegin(); it != c->children.rend(); ++it)
                stack.push_back(*it);
        }
    }
    for (Window *c : todo)
        SendMessage(c, MSG_PAINT, 0, 0);
}

}  // namespace

Window *find_paint_locked(Window *w) {
    if (!shown(w)) return nullptr;
    if (w->paintPending) return w;
    for (Window *c : w->children) {
        Window *p = find_paint_locked(c);
        if (p != nullptr) return p;
    }
    return nullptr;
}

void visible_region_locked(const Window *w, bool client, Region &out) {
    out.clear();
    if (w == nullptr || w->destroyed) return;
    out.set(client ? client_screen_rect_locked(w) : window_screen_rect_locked(w));
    out.intersect(screen_rect());
    const Window *m = w;
    while (m->parent != nullptr) {
        if ((m->style & WS_VISIBLE) == 0) {
            out.clear();
            return;
        }
        out.intersect(client_screen_rect_locked(m->parent));
        m = m->parent;
    }
    if (!shown(m)) {
        out.clear();
        return;
    }
    for (Window *z : g_zorder) {
        if (z == m) break;
        if (shown(z)) out.subtract(z->rc);
    }
}

void invalidate_locked(Window *w, const RECT *clientRc, bool erase) {
    RECT cr = client_screen_rect_locked(w);
    RECT all{0, 0, cr.right - cr.left, cr.bottom - cr.top};
    RECT r = all;
    if (clientRc != nullptr && !IntersectRect(&r, clientRc, &all)) return;
    UnionRect(&w->inv, &w->inv, &r);
    w->paintPending = true;
    if (erase) w->erase = true;
    for (Window *c : w->children) {
        RECT hit;
        if (IntersectRect(&hit, &c->rc, &r)) invalidate_locked(c, nullptr, true);
    }
    wake_locked(w->queue);
}

}  // namespace ftxgui

using namespace ftxgui;

extern "C" {

BOOL InvalidateRect(HWND h, const RECT *prc, BOOL erase) {
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    if (w == nullptr) return FALSE;
    invalidate_locked(w, prc, erase != 0);
    return TRUE;
}

void UpdateWindow(HWND h, BOOL erase) {
    bool mine;
    {
        std::lock_guard<std::mutex> lk(g_lock);
        Window *w = as_window_locked(h);
        if (w == nullptr) return;
        invalidate_locked(w, nullptr, erase != 0);
        mine = same_thread(w->queue);
    }
    if (mine) paint_now(h);
}

}  // extern "C"

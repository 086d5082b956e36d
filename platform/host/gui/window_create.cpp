// Creating and destroying windows (always on the owner's thread) and the helpers for the
// threads that own main windows.
#include <algorithm>

#include "window_internal.h"

namespace ftxgui {

namespace {

void kill_timers_locked(Window *w) {
    for (Timer &t : timers_locked())
        if (t.used && t.wnd == w) t.used = false;
}

// Forgets a destroyed window: no longer live, memory kept until the queue goes.
void bury_locked(Window *w) {
    w->destroyed = true;
    g_zGen++;
    kill_timers_locked(w);
    g_windows.erase(w);
    g_zombies.insert(w);
    if (g_capture == w) g_capture = nullptr;
    if (w->parent != nullptr) {
        Window *p = w->parent;
        p->children.erase(std::remove(p->children.begin(), p->children.end(), w),
                          p->children.end());
        if (p->focus == w) p->focus = nullptr;
        if (p->capture == w) p->capture = nullptr;
    }
}

struct CreateArgs {
    const char *cls;
    const char *caption;
    DWORD style, exStyle;
    LINT id;
    int x, y, w, h;
    HWND parent;
    DWORD add;
};

LRESULT create_on_owner(Window *, void *arg) {
    auto *a = static_cast<CreateArgs *>(arg);
    return reinterpret_cast<LRESULT>(CreateWindowEx(a->cls, a->caption, a->style, a->exStyle, a->id,
                                                    a->x, a->y, a->w, a->h, a->parent, a->add));
}

LRESULT destroy_main_on_owner(Window *w, void *) {
    return DestroyMainWindow(w);
}
LRESULT destroy_ctrl_on_owner(Window *w, void *) {
    return DestroyWindow(w);
}

}  // namespace

}  // namespace ftxgui

using namespace ftxgui;

extern "C" {

HWND CreateMainWindowEx(PMAINWINCREATE p, const char *, const void *, const void *, const char *,
                        const char *) {
    if (p == nullptr || p->MainWindowProc == nullptr) return HWND_INVALID;
    if (g_fb == nullptr) InitGUI(0, nullptr);
    Window *w = new Window;
    {
        std::lock_guard<std::mutex> lk(g_lock);
        MsgQueue *q = nullptr;
        if (p->hHosting != nullptr && p->hHosting != HWND_DESKTOP) {
            Window *host = as_window_locked(p->hHosting);
            // A hosted window shares its host's queue, so it must be made on that thread.
            if (host == nullptr || !host->isMain || !same_thread(host->queue)) {
                delete w;
                return HWND_INVALID;
            }
            q = host->queue;
            w->host = host;
        } else if (t_queue != nullptr) {
            q = t_queue;
            w->host = q->root != nullptr && !q->root->destroyed ? q->root : nullptr;
        } else {
            q = new MsgQueue;
            q->thread = pthread_self();
            t_queue = q;
            g_queues.push_back(q);
        }
        if (t_queue == nullptr) t_queue = q;
        w->isMain = true;
        w->queue = q;
        w->proc = p->MainWindowProc;
        w->caption = p->spCaption != nullptr ? p->spCaption : "";
        w->style = p->dwStyle & ~static_cast<DWORD>(WS_VISIBLE | WS_CHILD);
        w->exStyle = p->dwExStyle;
        w->bk = p->iBkColor;
        w->rc = RECT{p->lx, p->ty, p->rx, p->by};
        w->add1 = p->dwAddData;
        w->font = g_SysLogFont[SYSLOGFONT_DEFAULT];
        q->mains.push_back(w);
        if (q->root == nullptr) q->root = w;
        g_windows.insert(w);
        g_zorder.push_back(w);
    }
    SendMessage(w, MSG_NCCREATE, 0, reinterpret_cast<LPARAM>(p));
    if (SendMessage(w, MSG_CREATE, 0, reinterpret_cast<LPARAM>(p)) != 0) {
        DestroyAllControls(w);
        std::lock_guard<std::mutex> lk(g_lock);
        g_zorder.erase(std::remove(g_zorder.begin(), g_zorder.end(), w), g_zorder.end());
        bury_locked(w);
        return HWND_INVALID;
    }
    if ((p->dwStyle & WS_VISIBLE) != 0) ShowWindow(w, SW_SHOWNORMAL);
    return w;
}

BOOL DestroyMainWindow(HWND h) {
    Window *w;
    {
        std::lock_guard<std::mutex> lk(g_lock);
        w = as_window_locked(h);
        if (w == nullptr || !w->isMain) return FALSE;
        if (!same_thread(w->queue)) w = nullptr;
    }
    if (w == nullptr)
        return static_cast<BOOL>(
            call_on_owner(static_cast<Window *>(h), destroy_main_on_owner, nullptr));
    if (SendMessage(w, MSG_DESTROY, 0, 0) != 0) return FALSE;
    std::vector<Window *> hosted;
    {
        std::lock_guard<std::mutex> lk(g_lock);
        for (Window *m : w->queue->mains)
            if (m->host == w && !m->destroyed) hosted.push_back(m);
    }
    for (Window *m : hosted)
        DestroyMainWindow(m);
    DestroyAllControls(w);
    Window *next = nullptr;
    bool changeActive = false;
    {
        std::lock_guard<std::mutex> lk(g_lock);
        if (g_windows.count(w) == 0) return TRUE;
        bool wasShown = shown(w);
        g_zorder.erase(std::remove(g_zorder.begin(), g_zorder.end(), w), g_zorder.end());
        for (Window *m : w->queue->mains)
            if (m->host == w) m->host = nullptr;
        bury_locked(w);
        if (wasShown) expose_locked(w->rc, w);
        if (g_active == w) {
            g_active = nullptr;
            next = pick_active_locked(w);
            changeActive = true;
        }
    }
    if (changeActive) activate(next);
    return TRUE;
}

int CreateThreadForMainWindow(pthread_t *thread, pthread_attr_t *attr, void *(*start)(void *),
                              void *arg) {
    return pthread_create(thread, attr, start, arg);
}

pthread_t GetMainWinThread(HWND h) {
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = any_window_locked(h);
    return w != nullptr && w->queue != nullptr ? w->queue->thread : pthread_t{};
}

int WaitMainWindowClose(HWND h, void **ret) {
    pthread_t t = GetMainWinThread(h);
    if (pthread_equal(t, pthread_t{})) return -1;
    return pthread_join(t, ret);
}

HWND CreateWindowEx(const char *cls, const char *caption, DWORD style, DWORD exStyle, LINT id,
                    int x, int y, int w, int h, HWND parentH, DWORD add) {
    if (cls == nullptr) return HWND_INVALID;
    Window *c = new Window;
    {
        std::unique_lock<std::mutex> lk(g_lock);
        const WndClass *wc = find_class_locked(cls);
        Window *parent = as_window_locked(parentH);
        if (wc == nullptr || parent == nullptr) {
            delete c;
            return HWND_INVALID;
        }
        if (!same_thread(parent->queue)) {
            lk.unlock();
            delete c;
            CreateArgs a{cls, caption, style, exStyle, id, x, y, w, h, parentH, add};
            LRESULT r = call_on_owner(parent, create_on_owner, &a);
            return r == 0 ? HWND_INVALID : reinterpret_cast<HWND>(r);
        }
        c->queue = parent->queue;
        c->parent = parent;
        c->cls = wc;
        c->proc = wc->proc;
        c->caption = caption != nullptr ? caption : "";
        c->style = (style | WS_CHILD | wc->style);
        c->exStyle = exStyle | wc->exStyle;
        c->bk = wc->parentBk ? parent->bk : wc->bk;
        c->rc = RECT{x, y, x + std::max(w, 0), y + std::max(h, 0)};
        c->id = id;
        c->add1 = add;
        c->font = parent->font;
        parent->children.push_back(c);
        g_windows.insert(c);
    }
    if (SendMessage(c, MSG_CREATE, reinterpret_cast<WPARAM>(parentH), static_cast<LPARAM>(add)) !=
        0) {
        std::lock_guard<std::mutex> lk(g_lock);
        bury_locked(c);
        return HWND_INVALID;
    }
    {
        std::lock_guard<std::mutex> lk(g_lock);
        if (g_windows.count(c) != 0 && (c->style & WS_VISIBLE) != 0)
            invalidate_locked(c, nullptr, true);
    }
    return c;
}

BOOL DestroyWindow(HWND h) {
    Window *w;
    {
        std::lock_guard<std::mutex> lk(g_lock);
        w = as_window_locked(h);
        if (w == nullptr || w->isMain) return FALSE;
        if (!same_thread(w->queue)) w = nullptr;
    }
    if (w == nullptr)
        return static_cast<BOOL>(
            call_on_owner(static_cast<Window *>(h), destroy_ctrl_on_owner, nullptr));
    if (SendMessage(w, MSG_DESTROY, 0, 0) != 0) return FALSE;
    DestroyAllControls(w);
    std::lock_guard<std::mutex> lk(g_lock);
    if (g_windows.count(w) == 0) return TRUE;
    Window *parent = w->parent;
    RECT where = w->rc;
    bool wasShown = (w->style & WS_VISIBLE) != 0;
    bury_locked(w);
    if (wasShown && parent != nullptr && g_windows.count(parent) != 0)
        invalidate_locked(parent, &where, true);
    return TRUE;
}

void DestroyAllControls(HWND h) {
    std::vector<Window *> kids;
    {
        std::lock_guard<std::mutex> lk(g_lock);
        Window *w = as_window_locked(h);
        if (w == nullptr) return;
        kids = w->children;
    }
    for (auto it = kids.rbegin(); it != kids.rend(); ++it)
        DestroyWindow(*it);
}

}  // extern "C"

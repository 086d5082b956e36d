// Windows, message queues, activation and z-order with MiniGUI-Threads semantics: every
// thread that creates a main window owns one queue, and a window's procedure only ever
// runs on that thread. One lock guards the whole window system; procedures are always
// called with it released.
#include <string.h>

#include <algorithm>
#include <unordered_set>

#include "gui_internal.h"

namespace ftxgui {

std::mutex g_lock;
std::condition_variable &g_syncCv = *new std::condition_variable;

namespace {

// Runs a function on a window's own thread (queued like a synchronous message).
constexpr UINT kCallMsg = 0xFFFF0001u;

// The window system outlives static destruction: GUI threads may still run at exit.
std::unordered_set<Window *> &g_windows = *new std::unordered_set<Window *>;  // live windows
std::unordered_set<Window *> &g_zombies =
    *new std::unordered_set<Window *>;  // destroyed, memory kept until the queue's clean-up
std::vector<Window *> &g_zorder = *new std::vector<Window *>;  // main windows, top first
std::vector<MsgQueue *> &g_queues = *new std::vector<MsgQueue *>;
Window *g_active = nullptr;
Window *g_capture = nullptr;
thread_local MsgQueue *t_queue = nullptr;

int g_desktopDummy;

bool same_thread(const MsgQueue *q) {
    return q != nullptr && pthread_equal(q->thread, pthread_self());
}

bool is_tool(const Window *w) {
    return (w->exStyle & WS_EX_TOOLWINDOW) != 0;
}
bool shown(const Window *w) {
    return !w->destroyed && (w->style & WS_VISIBLE) != 0;
}

RECT screen_rect() {
    return RECT{0, 0, g_fbW, g_fbH};
}

Window *any_window_locked(HWND h) {
    Window *w = static_cast<Window *>(h);
    if (g_windows.count(w) != 0 || g_zombies.count(w) != 0) return w;
    return nullptr;
}

Window *pick_active_locked(const Window *exclude) {
    for (Window *w : g_zorder) {
        if (w != exclude && shown(w) && !is_tool(w) && (w->style & WS_DISABLED) == 0) return w;
    }
    return nullptr;
}

// Raises w to the top of its band (top-most windows stay above the others).
void raise_locked(Window *w) {
    g_zorder.erase(std::remove(g_zorder.begin(), g_zorder.end(), w), g_zorder.end());
    size_t pos = 0;
    if ((w->exStyle & WS_EX_TOPMOST) == 0) {
        while (pos < g_zorder.size() && (g_zorder[pos]->exStyle & WS_EX_TOPMOST) != 0)
            pos++;
    }
    g_zorder.insert(g_zorder.begin() + static_cast<long>(pos), w);
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

void process_sync(SyncMsg *s, std::unique_lock<std::mutex> &lk) {
    lk.unlock();
    LRESULT r = 0;
    if (s->msg == kCallMsg) {
        auto fn = reinterpret_cast<LRESULT (*)(Window *, void *)>(s->wp);
        r = fn(s->wnd, reinterpret_cast<void *>(s->lp));
    } else {
        r = SendMessage(s->wnd, s->msg, s->wp, s->lp);
    }
    lk.lock();
    s->result = r;
    s->done = true;
    g_syncCv.notify_all();
}

Window *find_paint_locked(Window *w) {
    if (!shown(w)) return nullptr;
    if (w->paintPending) return w;
    for (Window *c : w->children) {
        Window *p = find_paint_locked(c);
        if (p != nullptr) return p;
    }
    return nullptr;
}

bool in_range(UINT m, UINT lo, UINT hi) {
    return (lo == 0 && hi == 0) || (m >= lo && m <= hi);
}

bool pop_msg(std::deque<MSG> &dq, PMSG out, UINT lo, UINT hi, bool remove) {
    for (auto it = dq.begin(); it != dq.end(); ++it) {
        if (!in_range(it->message, lo, hi)) continue;
        *out = *it;
        if (remove) dq.erase(it);
        return true;
    }
    return false;
}

// The message fetch shared by GetMessage and PeekMessage: quit, synchronous messages,
// notifications, posted messages, paints, timers, in that order.
BOOL fetch(PMSG pMsg, HWND hMain, UINT lo, UINT hi, UINT remove, bool wait) {
    MsgQueue *q = t_queue;
    if (pMsg == nullptr) return FALSE;
    memset(pMsg, 0, sizeof(*pMsg));
    if (q == nullptr) return FALSE;
    std::unique_lock<std::mutex> lk(g_lock);
    for (;;) {
        bool mainDead = hMain != nullptr && hMain != HWND_DESKTOP &&
                        g_windows.count(static_cast<Window *>(hMain)) == 0;
        if (q->quit) {
            // A quit belongs to the loop of the window that posted it; one posted by a
            // hosted window does not end its host's loop.
            if (hMain == nullptr || hMain == HWND_DESKTOP || q->quitWnd == hMain || mainDead) {
                if (remove == PM_REMOVE) q->quit = false;
                pMsg->hwnd = hMain;
                pMsg->message = MSG_QUIT;
                return FALSE;
            }
            q->quit = false;
        }
        if (mainDead && wait) {
            pMsg->message = MSG_QUIT;
            return FALSE;
        }
        if (!q->sync.empty()) {
            SyncMsg *s = q->sync.front();
            q->sync.pop_front();
            process_sync(s, lk);
            continue;
        }
        bool got = pop_msg(q->notify, pMsg, lo, hi, remove == PM_REMOVE) ||
                   pop_msg(q->posted, pMsg, lo, hi, remove == PM_REMOVE);
        if (got) {
            if (pMsg->hwnd != HWND_DESKTOP &&
                g_windows.count(static_cast<Window *>(pMsg->hwnd)) == 0) {
                if (remove != PM_REMOVE) return FALSE;
                continue;  // its window is gone
            }
            return TRUE;
        }
        if (in_range(MSG_PAINT, lo, hi)) {
            for (Window *m : q->mains) {
                Window *p = find_paint_locked(m);
                if (p == nullptr) continue;
                if (remove == PM_REMOVE) p->paintPending = false;
                pMsg->hwnd = p;
                pMsg->message = MSG_PAINT;
                return TRUE;
            }
        }
        if (in_range(MSG_TIMER, lo, hi)) {
            bool again = false;
            for (Timer &t : timers_locked()) {
                if (!t.used || !t.pending || t.queue != q) continue;
                if (remove != PM_REMOVE) {
                    pMsg->hwnd = t.wnd;
                    pMsg->message = MSG_TIMER;
                    pMsg->wParam = static_cast<WPARAM>(t.id);
                    pMsg->lParam = t.firedAt;
                    return TRUE;
                }
                t.pending = false;
                if (t.proc != nullptr) {
                    TIMERPROC proc = t.proc;
                    Window *w = t.wnd;
                    LINT id = t.id;
                    DWORD at = t.firedAt;
                    lk.unlock();
                    BOOL keep = proc(w, id, at);
                    lk.lock();
                    if (!keep) {
                        for (Timer &k : timers_locked())
                            if (k.used && k.wnd == w && k.id == id) k.used = false;
                    }
                    again = true;
                    break;
                }
                pMsg->hwnd = t.wnd;
                pMsg->message = MSG_TIMER;
                pMsg->wParam = static_cast<WPARAM>(t.id);
                pMsg->lParam = t.firedAt;
                pMsg->time = t.firedAt;
                return TRUE;
            }
            if (again) continue;
        }
        if (!wait) return FALSE;
        q->waiting = true;
        q->cv.wait(lk);
        q->waiting = false;
    }
}

void free_queue_locked(MsgQueue *q) {
    for (SyncMsg *s : q->sync) {
        s->done = true;
    }
    q->sync.clear();
    g_syncCv.notify_all();
    for (auto it = g_zombies.begin(); it != g_zombies.end();) {
        if ((*it)->queue == q) {
            delete *it;
            it = g_zombies.erase(it);
        } else {
            ++it;
        }
    }
    for (Timer &t : timers_locked())
        if (t.queue == q) t.used = false;
    g_queues.erase(std::remove(g_queues.begin(), g_queues.end(), q), g_queues.end());
    delete q;
}

void kill_timers_locked(Window *w) {
    for (Timer &t : timers_locked())
        if (t.used && t.wnd == w) t.used = false;
}

// Forgets a destroyed window: no longer live, memory kept until the queue goes.
void bury_locked(Window *w) {
    w->destroyed = true;
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

// ---- shared helpers ---------------------------------------------------------------------

bool alive_locked(HWND h) {
    return g_windows.count(static_cast<Window *>(h)) != 0;
}

Window *as_window_locked(HWND h) {
    Window *w = static_cast<Window *>(h);
    return g_windows.count(w) != 0 ? w : nullptr;
}

static int border_of(const Window *w) {
    return (w->style & WS_BORDER) != 0 ? 1 : 0;
}

RECT window_screen_rect_locked(const Window *w) {
    if (w->parent == nullptr) return w->rc;
    RECT pc = client_screen_rect_locked(w->parent);
    RECT r = w->rc;
    OffsetRect(&r, pc.left, pc.top);
    return r;
}

RECT client_screen_rect_locked(const Window *w) {
    RECT r = window_screen_rect_locked(w);
    int b = border_of(w);
    InflateRect(&r, -b, -b);
    if (r.right < r.left) r.right = r.left;
    if (r.bottom < r.top) r.bottom = r.top;
    return r;
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

void wake_locked(MsgQueue *q) {
    if (q != nullptr) q->cv.notify_all();
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

std::vector<Window *> zorder_snapshot_locked() {
    return g_zorder;
}
Window *active_locked() {
    return g_active;
}

bool queues_idle_locked() {
    for (MsgQueue *q : g_queues) {
        if (!q->waiting) return false;
        if (!q->sync.empty() || !q->notify.empty() || !q->posted.empty()) return false;
        for (Window *m : q->mains)
            if (find_paint_locked(m) != nullptr) return false;
        for (Timer &t : timers_locked())
            if (t.used && t.pending && t.queue == q) return false;
    }
    return true;
}

LRESULT call_on_owner(Window *w, LRESULT (*fn)(Window *, void *), void *arg) {
    std::unique_lock<std::mutex> lk(g_lock);
    if (g_windows.count(w) == 0) return 0;
    MsgQueue *q = w->queue;
    if (same_thread(q)) {
        lk.unlock();
        return fn(w, arg);
    }
    SyncMsg s{w, kCallMsg, reinterpret_cast<WPARAM>(fn), reinterpret_cast<LPARAM>(arg)};
    q->sync.push_back(&s);
    wake_locked(q);
    while (!s.done)
        g_syncCv.wait(lk);
    return s.result;
}

// ---- default procedures -----------------------------------------------------------------

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

HWND __mg_hwnd_desktop = &g_desktopDummy;
WNDPROC __mg_def_proc[3] = {default_main_proc, default_main_proc, default_control_proc};

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

void MainWindowThreadCleanup(HWND h) {
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = static_cast<Window *>(h);
    if (g_zombies.count(w) == 0) return;  // still alive, or already freed
    MsgQueue *q = w->queue;
    if (q != nullptr && q->root == w) {
        for (Window *m : q->mains)
            if (!m->destroyed) return;  // the queue still serves live windows
        if (t_queue == q) t_queue = nullptr;
        free_queue_locked(q);
        return;
    }
    if (q != nullptr)
        q->mains.erase(std::remove(q->mains.begin(), q->mains.end(), w), q->mains.end());
    for (auto it = g_zombies.begin(); it != g_zombies.end();) {
        if ((*it)->parent != nullptr) {
            // controls of this window
            Window *top = *it;
            while (top->parent != nullptr)
                top = top->parent;
            if (top == w) {
                delete *it;
                it = g_zombies.erase(it);
                continue;
            }
        }
        ++it;
    }
    g_zombies.erase(w);
    delete w;
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

BOOL GetMessage(PMSG pMsg, HWND hMainWnd) {
    return fetch(pMsg, hMainWnd, 0, 0, PM_REMOVE, true);
}

BOOL PeekMessage(PMSG pMsg, HWND hWnd, UINT lo, UINT hi, UINT remove) {
    MSG tmp;
    BOOL r = fetch(pMsg != nullptr ? pMsg : &tmp, hWnd, lo, hi, remove, false);
    if (!r && pMsg != nullptr && pMsg->message == MSG_QUIT) return TRUE;
    return r;
}

BOOL TranslateMessage(PMSG pMsg) {
    // Plain keys also arrive as characters, as on the handset's keypad.
    static const char kChars[] = "\0\0331234567890-=\b\tqwertyuiop[]\r\0asdfghjkl;'`\0\\zxcvbnm,./";
    if (pMsg == nullptr || pMsg->message != MSG_KEYDOWN) return FALSE;
    WPARAM sc = pMsg->wParam;
    if (sc < sizeof(kChars) - 1 && kChars[sc] != '\0') {
        PostMessage(pMsg->hwnd, MSG_CHAR, static_cast<unsigned char>(kChars[sc]), pMsg->lParam);
    } else if (sc == SCANCODE_SPACE) {
        PostMessage(pMsg->hwnd, MSG_CHAR, ' ', pMsg->lParam);
    }
    return FALSE;
}

LRESULT DispatchMessage(PMSG pMsg) {
    if (pMsg == nullptr) return -1;
    if (pMsg->hwnd == HWND_DESKTOP) return 0;
    WNDPROC proc = nullptr;
    {
        std::lock_guard<std::mutex> lk(g_lock);
        Window *w = as_window_locked(pMsg->hwnd);
        if (w != nullptr) proc = w->proc;
    }
    if (proc == nullptr) return -1;
    return proc(pMsg->hwnd, pMsg->message, pMsg->wParam, pMsg->lParam);
}

LRESULT SendMessage(HWND h, UINT msg, WPARAM wp, LPARAM lp) {
    if (h == HWND_DESKTOP) return 0;  // the desktop answers its requests with 0
    std::unique_lock<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    if (w == nullptr) return -1;
    MsgQueue *q = w->queue;
    if (same_thread(q)) {
        WNDPROC proc = w->proc;
        lk.unlock();
        return proc != nullptr ? proc(h, msg, wp, lp) : 0;
    }
    SyncMsg s{w, msg, wp, lp};
    q->sync.push_back(&s);
    wake_locked(q);
    // Serve what was already sent to us, so two threads sending at once need not block.
    MsgQueue *mine = t_queue;
    while (mine != nullptr && !mine->sync.empty()) {
        SyncMsg *other = mine->sync.front();
        mine->sync.pop_front();
        process_sync(other, lk);
    }
    while (!s.done)
        g_syncCv.wait(lk);
    return s.result;
}

LRESULT PostSyncMessage(HWND h, UINT msg, WPARAM wp, LPARAM lp) {
    {
        std::lock_guard<std::mutex> lk(g_lock);
        Window *w = as_window_locked(h);
        if (w == nullptr || same_thread(w->queue)) return -1;
    }
    return SendMessage(h, msg, wp, lp);
}

LRESULT SendAsyncMessage(HWND h, UINT msg, WPARAM wp, LPARAM lp) {
    WNDPROC proc = nullptr;
    {
        std::lock_guard<std::mutex> lk(g_lock);
        Window *w = as_window_locked(h);
        if (w != nullptr) proc = w->proc;
    }
    return proc != nullptr ? proc(h, msg, wp, lp) : -1;
}

int PostMessage(HWND h, UINT msg, WPARAM wp, LPARAM lp) {
    if (h == HWND_DESKTOP) return ERR_OK;
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    if (w == nullptr) return ERR_INV_HWND;
    MsgQueue *q = w->queue;
    if (msg == MSG_MOUSEMOVE && !q->posted.empty()) {
        MSG &last = q->posted.back();
        if (last.message == MSG_MOUSEMOVE && last.hwnd == h) {
            last.wParam = wp;
            last.lParam = lp;
            return ERR_OK;
        }
    }
    if (q->posted.size() >= kPostedSlots) return ERR_QUEUE_FULL;
    q->posted.push_back(MSG{h, msg, wp, lp, GetTickCount(), nullptr});
    wake_locked(q);
    return ERR_OK;
}

int SendNotifyMessage(HWND h, UINT msg, WPARAM wp, LPARAM lp) {
    if (h == HWND_DESKTOP) return ERR_OK;
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    if (w == nullptr) return ERR_INV_HWND;
    w->queue->notify.push_back(MSG{h, msg, wp, lp, GetTickCount(), nullptr});
    wake_locked(w->queue);
    return ERR_OK;
}

int PostQuitMessage(HWND h) {
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = any_window_locked(h);
    if (w == nullptr || w->queue == nullptr) return ERR_INV_HWND;
    if (std::find(g_queues.begin(), g_queues.end(), w->queue) == g_queues.end())
        return ERR_INV_HWND;
    w->queue->quit = true;
    w->queue->quitWnd = w->parent == nullptr ? w : w->parent;
    wake_locked(w->queue);
    return 0;
}

BOOL ShowWindow(HWND h, int cmd) {
    Window *next = nullptr;
    bool changeActive = false;
    {
        std::lock_guard<std::mutex> lk(g_lock);
        Window *w = as_window_locked(h);
        if (w == nullptr) return FALSE;
        bool was = (w->style & WS_VISIBLE) != 0;
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
    if (win->isMain) {
        if (shown(win)) expose_locked(old, win);
    } else if (win->parent != nullptr) {
        invalidate_locked(win->parent, &oldRel, true);
    }
    if (fPaint || shown(win)) invalidate_locked(win, nullptr, true);
    return TRUE;
}

BOOL EnableWindow(HWND h, BOOL enable) {
    BOOL old;
    {
        std::lock_guard<std::mutex> lk(g_lock);
        Window *w = as_window_locked(h);
        if (w == nullptr) return FALSE;
        old = (w->style & WS_DISABLED) == 0;
        if (enable)
            w->style &= ~static_cast<DWORD>(WS_DISABLED);
        else
            w->style |= WS_DISABLED;
    }
    if (old != (enable != 0)) SendMessage(h, MSG_ENABLE, enable, 0);
    return old;
}

BOOL IsWindowEnabled(HWND h) {
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    return w != nullptr && (w->style & WS_DISABLED) == 0;
}

BOOL IsWindow(HWND h) {
    std::lock_guard<std::mutex> lk(g_lock);
    return as_window_locked(h) != nullptr;
}

BOOL IsMainWindow(HWND h) {
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    return w != nullptr && w->isMain;
}

BOOL IsControl(HWND h) {
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    return w != nullptr && !w->isMain;
}

BOOL IsWindowVisible(HWND h) {
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    for (; w != nullptr; w = w->parent)
        if ((w->style & WS_VISIBLE) == 0) return FALSE;
    return as_window_locked(h) != nullptr;
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

HWND GetParent(HWND h) {
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    if (w == nullptr) return HWND_INVALID;
    if (w->parent != nullptr) return w->parent;
    return w->host != nullptr ? static_cast<HWND>(w->host) : HWND_DESKTOP;
}

HWND GetMainWindowHandle(HWND h) {
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    if (w == nullptr) return HWND_INVALID;
    while (w->parent != nullptr)
        w = w->parent;
    return w;
}

HWND GetHosting(HWND h) {
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    if (w == nullptr || !w->isMain) return HWND_INVALID;
    return w->host != nullptr ? static_cast<HWND>(w->host) : HWND_DESKTOP;
}

extern "C++" {
namespace {

// A window's rectangle as pick gives it, or the whole screen for the desktop.
template <typename Pick>
BOOL query_rect(HWND h, PRECT prc, Pick pick) {
    if (prc == nullptr) return FALSE;
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    if (w == nullptr) {
        if (h != HWND_DESKTOP) return FALSE;
        *prc = screen_rect();
        return TRUE;
    }
    *prc = pick(w);
    return TRUE;
}

}  // namespace
}  // extern "C++"

BOOL GetClientRect(HWND h, PRECT prc) {
    return query_rect(h, prc, [](Window *w) {
        RECT r = client_screen_rect_locked(w);
        RECT out;
        SetRect(&out, 0, 0, r.right - r.left, r.bottom - r.top);
        return out;
    });
}

BOOL GetWindowRect(HWND h, PRECT prc) {
    return query_rect(h, prc, [](Window *w) { return w->rc; });
}

void ClientToScreen(HWND h, int *x, int *y) {
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    if (w == nullptr) return;
    RECT r = client_screen_rect_locked(w);
    if (x != nullptr) *x += r.left;
    if (y != nullptr) *y += r.top;
}

void ScreenToClient(HWND h, int *x, int *y) {
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    if (w == nullptr) return;
    RECT r = client_screen_rect_locked(w);
    if (x != nullptr) *x -= r.left;
    if (y != nullptr) *y -= r.top;
}

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

HWND SetFocusChild(HWND h) {
    Window *old = nullptr;
    {
        std::lock_guard<std::mutex> lk(g_lock);
        Window *w = as_window_locked(h);
        if (w == nullptr || w->parent == nullptr) return HWND_INVALID;
        old = w->parent->focus;
        if (old == w) return old;
        w->parent->focus = w;
    }
    if (old != nullptr) SendMessage(old, MSG_KILLFOCUS, reinterpret_cast<WPARAM>(h), 0);
    SendMessage(h, MSG_SETFOCUS, reinterpret_cast<WPARAM>(old), 0);
    return old;
}

HWND GetFocusChild(HWND h) {
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    if (w == nullptr || w->focus == nullptr || g_windows.count(w->focus) == 0) return HWND_NULL;
    return w->focus;
}

HWND GetDlgItem(HWND h, LINT id) {
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    if (w == nullptr) return HWND_NULL;
    for (Window *c : w->children)
        if (c->id == id) return c;
    return HWND_NULL;
}

LINT GetDlgCtrlID(HWND h) {
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    return w != nullptr ? w->id : -1;
}

BOOL SetWindowText(HWND h, const char *text) {
    return SendMessage(h, MSG_SETTEXT, 0, reinterpret_cast<LPARAM>(text)) == 0;
}

int GetWindowText(HWND h, char *buf, int max) {
    if (buf == nullptr || max < 0) return 0;
    return static_cast<int>(
        SendMessage(h, MSG_GETTEXT, static_cast<WPARAM>(max), reinterpret_cast<LPARAM>(buf)));
}

int GetWindowTextLength(HWND h) {
    return static_cast<int>(SendMessage(h, MSG_GETTEXTLENGTH, 0, 0));
}

const char *GetWindowCaption(HWND h) {
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    return w != nullptr ? w->caption.c_str() : nullptr;
}

BOOL SetWindowCaption(HWND h, const char *caption) {
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    if (w == nullptr) return FALSE;
    w->caption = caption != nullptr ? caption : "";
    invalidate_locked(w, nullptr, true);
    return TRUE;
}

PLOGFONT SetWindowFont(HWND h, PLOGFONT font) {
    if (font == nullptr) font = g_SysLogFont[SYSLOGFONT_DEFAULT];
    PLOGFONT old;
    {
        std::lock_guard<std::mutex> lk(g_lock);
        Window *w = as_window_locked(h);
        if (w == nullptr) return nullptr;
        old = w->font;
    }
    if (SendMessage(h, MSG_FONTCHANGING, 0, reinterpret_cast<LPARAM>(font)) != 0) return old;
    {
        std::lock_guard<std::mutex> lk(g_lock);
        Window *w = as_window_locked(h);
        if (w == nullptr) return old;
        w->font = font;
        invalidate_locked(w, nullptr, true);
    }
    SendMessage(h, MSG_FONTCHANGED, 0, 0);
    return old;
}

PLOGFONT GetWindowFont(HWND h) {
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    return w != nullptr ? w->font : nullptr;
}

gal_pixel SetWindowBkColor(HWND h, gal_pixel c) {
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    if (w == nullptr) return 0;
    gal_pixel old = w->bk;
    w->bk = c;
    return old;
}

gal_pixel GetWindowBkColor(HWND h) {
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    return w != nullptr ? w->bk : 0;
}

DWORD GetWindowStyle(HWND h) {
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    return w != nullptr ? w->style : 0;
}

DWORD GetWindowExStyle(HWND h) {
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    return w != nullptr ? w->exStyle : 0;
}

BOOL IncludeWindowStyle(HWND h, DWORD s) {
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    if (w == nullptr) return FALSE;
    w->style |= s;
    return TRUE;
}

BOOL ExcludeWindowStyle(HWND h, DWORD s) {
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    if (w == nullptr) return FALSE;
    w->style &= ~s;
    return TRUE;
}

#define FTX_WINDOW_FIELD(getter, setter, field) \
    DWORD getter(HWND h) {                      \
        std::lock_guard<std::mutex> lk(g_lock); \
        Window *w = as_window_locked(h);        \
        return w != nullptr ? w->field : 0;     \
    }                                           \
    DWORD setter(HWND h, DWORD v) {             \
        std::lock_guard<std::mutex> lk(g_lock); \
        Window *w = as_window_locked(h);        \
        if (w == nullptr) return 0;             \
        DWORD old = w->field;                   \
        w->field = v;                           \
        return old;                             \
    }
FTX_WINDOW_FIELD(GetWindowAdditionalData, SetWindowAdditionalData, add1)
FTX_WINDOW_FIELD(GetWindowAdditionalData2, SetWindowAdditionalData2, add2)
#undef FTX_WINDOW_FIELD

WNDPROC GetWindowCallbackProc(HWND h) {
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    return w != nullptr ? w->proc : nullptr;
}

WNDPROC SetWindowCallbackProc(HWND h, WNDPROC proc) {
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    if (w == nullptr) return nullptr;
    WNDPROC old = w->proc;
    if (proc != nullptr) w->proc = proc;
    return old;
}

NOTIFPROC SetNotificationCallback(HWND h, NOTIFPROC proc) {
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    if (w == nullptr) return nullptr;
    NOTIFPROC old = w->notif;
    w->notif = proc;
    return old;
}

NOTIFPROC GetNotificationCallback(HWND h) {
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    return w != nullptr ? w->notif : nullptr;
}

void NotifyParentEx(HWND h, LINT id, int code, DWORD add) {
    NOTIFPROC proc;
    Window *parent;
    {
        std::lock_guard<std::mutex> lk(g_lock);
        Window *w = as_window_locked(h);
        if (w == nullptr) return;
        proc = w->notif;
        parent = (w->exStyle & WS_EX_NOPARENTNOTIFY) != 0 ? nullptr : w->parent;
    }
    if (proc != nullptr) {
        proc(h, id, code, add);
    } else if (parent != nullptr) {
        SendNotifyMessage(parent, MSG_COMMAND,
                          MAKELONG(static_cast<WORD>(id), static_cast<WORD>(code)),
                          reinterpret_cast<LPARAM>(h));
    }
}

HWND GetCapture(void) {
    std::lock_guard<std::mutex> lk(g_lock);
    return g_capture;
}

HWND SetCapture(HWND h) {
    std::lock_guard<std::mutex> lk(g_lock);
    Window *old = g_capture;
    g_capture = as_window_locked(h);
    return old;
}

void ReleaseCapture(void) {
    std::lock_guard<std::mutex> lk(g_lock);
    g_capture = nullptr;
}

}  // extern "C"

namespace ftxgui {
// The main window that holds the pointer captured by SetCapture, if any.
Window *capture_main_locked() {
    Window *w = g_capture;
    if (w == nullptr || g_windows.count(w) == 0) return nullptr;
    while (w->parent != nullptr)
        w = w->parent;
    return w;
}
}  // namespace ftxgui

// Message queues and message delivery: fetching (GetMessage, PeekMessage), sending and
// posting, synchronous messages between threads, quit, and the end of a thread's queue.
#include <string.h>

#include <algorithm>

#include "window_internal.h"

namespace ftxgui {

namespace {

// Runs a function on a window's own thread (queued like a synchronous message).
constexpr UINT kCallMsg = 0xFFFF0001u;

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

}  // namespace

void wake_locked(MsgQueue *q) {
    if (q != nullptr) q->cv.notify_all();
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

bool moves_pending_locked() {
    for (MsgQueue *q : g_queues)
        for (const MSG &m : q->posted)
            if (m.message == MSG_MOUSEMOVE) return true;
    return false;
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

}  // namespace ftxgui

using namespace ftxgui;

extern "C" {

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
    std::unique_lock<std::mutex> lk(g_lock);
    if (h == HWND_DESKTOP) return desktop_request_locked(msg, wp, lp);
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

}  // extern "C"

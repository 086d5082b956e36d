// Windows, message queues, activation and z-order with MiniGUI-Threads semantics: every
// thread that creates a main window owns one queue, and a window's procedure only ever
// runs on that thread. One lock guards the whole window system; procedures are always
// called with it released.
// This file holds the window system's state, the lookups and the screen geometry everyone
// shares, and the pointer capture; the rest of the window core lives in window_*.cpp.
#include "window_internal.h"

namespace ftxgui {

std::mutex g_lock;
std::condition_variable &g_syncCv = *new std::condition_variable;

// The window system outlives static destruction: GUI threads may still run at exit.
std::unordered_set<Window *> &g_windows = *new std::unordered_set<Window *>;  // live windows
std::unordered_set<Window *> &g_zombies =
    *new std::unordered_set<Window *>;  // destroyed, memory kept until the queue's clean-up
std::vector<Window *> &g_zorder = *new std::vector<Window *>;  // main windows, top first
std::atomic<unsigned> g_zGen{0};
std::vector<MsgQueue *> &g_queues = *new std::vector<MsgQueue *>;
Window *g_active = nullptr;
Window *g_capture = nullptr;
thread_local MsgQueue *t_queue = nullptr;

namespace {

int g_desktopDummy;

}  // namespace

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

bool alive_locked(HWND h) {
    return g_windows.count(static_cast<Window *>(h)) != 0;
}

Window *as_window_locked(HWND h) {
    Window *w = static_cast<Window *>(h);
    return g_windows.count(w) != 0 ? w : nullptr;
}

int border_of(const Window *w) {
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

}  // namespace ftxgui

using namespace ftxgui;

extern "C" {

HWND __mg_hwnd_desktop = &g_desktopDummy;

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

// The input layer: one thread takes key and touch events (from the display window and the
// console), offers each to the program's hook and, unless the hook swallows it, posts it:
// keys to the active main window, touches to the topmost window under the finger (which
// keeps the finger until it is lifted).
#include <chrono>
#include <thread>

#include <android/log.h>

#include "gui_internal.h"
#include "kernel_files.h"
#include "minigui/ftx_gui.h"

namespace ftxgui {

namespace {

struct InputEvent {
    int kind;
    int a, b;
};

std::mutex g_inLock;
// Never destroyed: the input thread still waits on it while the process exits.
std::condition_variable &g_inCv = *new std::condition_variable;
std::deque<InputEvent> &g_events = *new std::deque<InputEvent>;
bool g_busy = false;
std::atomic<bool> g_running{false};

MSGHOOK g_keyHook = nullptr;
void *g_keyCtx = nullptr;
MSGHOOK g_mouseHook = nullptr;
void *g_mouseCtx = nullptr;
Window *g_touchWnd = nullptr;  // the window that got the finger down
// The window a touch-tracking request named: it gets every touch until the next request.
HWND g_trackWnd = HWND_NULL;
// The desktop's touch-tracking request: wParam the window to track the finger (0: none);
// the answer is the window that tracked it before (0: none), to be given back later.
constexpr UINT kMsgTrackTouch = 0xF8;

Window *window_at_locked(int x, int y) {
    for (Window *w : zorder_snapshot_locked()) {
        if (w->destroyed || (w->style & WS_VISIBLE) == 0 || (w->style & WS_DISABLED) != 0) continue;
        if (PtInRect(&w->rc, x, y)) return w;
    }
    return nullptr;
}

// Posts an input message, waiting a little while the receiver's queue is full rather
// than losing a key.
void post_input(HWND h, UINT msg, WPARAM wp, LPARAM lp) {
    for (int i = 0; i < 1000; i++) {
        if (PostMessage(h, msg, wp, lp) != ERR_QUEUE_FULL) return;
        std::this_thread::sleep_for(std::chrono::milliseconds(2));
    }
    __android_log_print(ANDROID_LOG_WARN, "FTX_GUI", "input message 0x%x lost: queue full", msg);
}

void handle_key(const InputEvent &e) {
    UINT msg = e.kind == FTX_INPUT_KEYDOWN ? MSG_KEYDOWN : MSG_KEYUP;
    HWND dst;
    MSGHOOK hook;
    void *ctx;
    {
        std::lock_guard<std::mutex> lk(g_lock);
        Window *a = active_locked();
        dst = a != nullptr ? static_cast<HWND>(a) : HWND_DESKTOP;
        hook = g_keyHook;
        ctx = g_keyCtx;
    }
    if (hook != nullptr && hook(ctx, dst, msg, static_cast<WPARAM>(e.a), 0) == HOOK_STOP) return;
    {
        // The hook may have changed the active window (a dialog opening).
        std::lock_guard<std::mutex> lk(g_lock);
        if (!alive_locked(dst)) {
            Window *a = active_locked();
            dst = a != nullptr ? static_cast<HWND>(a) : HWND_DESKTOP;
        }
    }
    if (dst != HWND_DESKTOP) post_input(dst, msg, static_cast<WPARAM>(e.a), 0);
}

void handle_touch(const InputEvent &e) {
    UINT msg = e.kind == FTX_INPUT_TOUCHDOWN ? MSG_LBUTTONDOWN
               : e.kind == FTX_INPUT_TOUCHUP ? MSG_LBUTTONUP
                                             : MSG_MOUSEMOVE;
    Window *target;
    HWND under;
    MSGHOOK hook = nullptr;
    void *ctx = nullptr;
    int cx = 0, cy = 0;
    {
        std::lock_guard<std::mutex> lk(g_lock);
        Window *w = window_at_locked(e.a, e.b);
        under = w != nullptr ? static_cast<HWND>(w) : HWND_NULL;
        Window *captured = capture_main_locked();
        if (captured != nullptr) {
            target = captured;
        } else {
            hook = g_mouseHook;
            ctx = g_mouseCtx;
            if (msg == MSG_LBUTTONDOWN) g_touchWnd = w;
            if (g_trackWnd != HWND_NULL && alive_locked(g_trackWnd))
                target = as_window_locked(g_trackWnd);
            else
                target = g_touchWnd != nullptr && alive_locked(g_touchWnd) ? g_touchWnd : w;
        }
        if (msg == MSG_LBUTTONUP) g_touchWnd = nullptr;
        if (target != nullptr) {
            RECT cr = client_screen_rect_locked(target);
            cx = e.a - cr.left;
            cy = e.b - cr.top;
        }
    }
    DWORD flags = msg == MSG_LBUTTONUP ? 0 : KS_LEFTBUTTON;
    if (hook != nullptr &&
        hook(ctx, under, msg, flags, MAKELONG(static_cast<WORD>(e.a), static_cast<WORD>(e.b))) ==
            HOOK_STOP)
        return;
    if (target != nullptr)
        post_input(target, msg, flags, MAKELONG(static_cast<WORD>(cx), static_cast<WORD>(cy)));
}

void input_loop() {
    std::unique_lock<std::mutex> lk(g_inLock);
    for (;;) {
        while (g_events.empty())
            g_inCv.wait(lk);
        InputEvent e = g_events.front();
        g_events.pop_front();
        g_busy = true;
        lk.unlock();
        if (e.kind == FTX_INPUT_KEYDOWN || e.kind == FTX_INPUT_KEYUP)
            handle_key(e);
        else
            handle_touch(e);
        lk.lock();
        g_busy = false;
        g_inCv.notify_all();
    }
}

// The key code a PC is told for a scan code: the handset's input numbering.
struct KeyCode {
    int scancode;
    int keycode;
};
const KeyCode kKeyCodes[] = {
    {SCANCODE_ESCAPE, 116},           // power
    {SCANCODE_CURSORBLOCKUP, 115},    // volume up
    {SCANCODE_CURSORBLOCKDOWN, 114},  // volume down
    {SCANCODE_HOME, 102},             // home
    {SCANCODE_F12, 158},              // back
    {SCANCODE_MENU, 139},             // menu
    {SCANCODE_F10, 212},              // camera
    {128, 217},                       // search
    {130, 226},                       // headset hook
    {131, 528},                       // torch
    {187, 580},                       // recent applications
    {377, 377},                       // TV
};

}  // namespace

LRESULT desktop_request_locked(UINT msg, WPARAM wp, LPARAM) {
    if (msg != kMsgTrackTouch) return 0;
    HWND before = g_trackWnd != HWND_NULL && alive_locked(g_trackWnd) ? g_trackWnd : HWND_NULL;
    g_trackWnd = reinterpret_cast<HWND>(wp);
    return reinterpret_cast<LRESULT>(before);
}

bool wait_moves_taken(int timeoutMs) {
    auto until = std::chrono::steady_clock::now() + std::chrono::milliseconds(timeoutMs);
    while (std::chrono::steady_clock::now() < until) {
        bool taken = input_idle();
        if (taken) {
            std::lock_guard<std::mutex> lk(g_lock);
            taken = !moves_pending_locked();
        }
        if (taken) return true;
        std::this_thread::sleep_for(std::chrono::microseconds(200));
    }
    return false;
}

bool ial_running() {
    return g_running.load();
}

bool input_idle() {
    std::lock_guard<std::mutex> lk(g_inLock);
    return g_events.empty() && !g_busy;
}

}  // namespace ftxgui

using namespace ftxgui;

extern "C" {

int InitGUIIAL(void) {
    if (g_fb == nullptr) InitGUI(0, nullptr);
    bool expected = false;
    if (g_running.compare_exchange_strong(expected, true)) std::thread(input_loop).detach();
    return 0;
}

int ftx_gui_inject(int kind, int a, int b) {
    // A key press wakes a suspended handset (and reaches the application as well).
    if (kind == FTX_INPUT_KEYDOWN) ftxhost::resume_by_key();
    if (!g_running.load() || kind < FTX_INPUT_KEYDOWN || kind > FTX_INPUT_TOUCHUP) return -1;
    std::lock_guard<std::mutex> lk(g_inLock);
    g_events.push_back(InputEvent{kind, a, b});
    g_inCv.notify_all();
    return 0;
}

int ftx_gui_wait_idle(int timeout_ms) {
    auto until = std::chrono::steady_clock::now() + std::chrono::milliseconds(timeout_ms);
    int calm = 0;
    while (std::chrono::steady_clock::now() < until) {
        bool idle = input_idle();
        if (idle) {
            std::lock_guard<std::mutex> lk(g_lock);
            idle = queues_idle_locked();
        }
        calm = idle ? calm + 1 : 0;
        if (calm >= 3) return 0;
        std::this_thread::sleep_for(std::chrono::milliseconds(2));
    }
    return -1;
}

MSGHOOK RegisterKeyMsgHook(void *context, MSGHOOK hook) {
    std::lock_guard<std::mutex> lk(g_lock);
    MSGHOOK old = g_keyHook;
    g_keyHook = hook;
    g_keyCtx = hook != nullptr ? context : nullptr;
    return old;
}

MSGHOOK RegisterMouseMsgHook(void *context, MSGHOOK hook) {
    std::lock_guard<std::mutex> lk(g_lock);
    MSGHOOK old = g_mouseHook;
    g_mouseHook = hook;
    g_mouseCtx = hook != nullptr ? context : nullptr;
    return old;
}

int scancode_convert_keycode(int scancode) {
    if (scancode <= 0) return 0;
    for (const KeyCode &k : kKeyCodes)
        if (k.scancode == scancode) return k.keycode;
    return scancode;
}

}  // extern "C"

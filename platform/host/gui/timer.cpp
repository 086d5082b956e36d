// Timers in 10 ms ticks (FTX_TIME_SCALE shortens the tick). One thread marks timers due and
// wakes their queues; the owner thread delivers MSG_TIMER during its message fetch, so ticks
// that pile up while the owner is busy merge into one.
#include <chrono>
#include <thread>

#include "gui_internal.h"
#include "tp_os.h"

namespace ftxgui {

namespace {

constexpr size_t kTimerSlots = 64;

std::vector<Timer> &g_timers = *new std::vector<Timer>(kTimerSlots);
// Never destroyed: threads still wait on it while the process exits.
std::condition_variable &g_timerCv = *new std::condition_variable;
std::chrono::steady_clock::time_point g_start = std::chrono::steady_clock::now();
bool g_timerThread = false;

std::chrono::duration<double> tick_length() {
    double scale = tp_os_time_scale();
    if (scale <= 0) scale = 1;
    return std::chrono::duration<double>(0.010 * scale);
}

uint64_t now_ticks() {
    auto d = std::chrono::steady_clock::now() - g_start;
    return static_cast<uint64_t>(std::chrono::duration<double>(d) / tick_length());
}

void timer_loop() {
    std::unique_lock<std::mutex> lk(g_lock);
    for (;;) {
        uint64_t now = now_ticks();
        uint64_t next = UINT64_MAX;
        for (Timer &t : g_timers) {
            if (!t.used) continue;
            if (now - t.last >= t.speed) {
                t.pending = true;
                t.firedAt = static_cast<DWORD>(now);
                t.last = now;
                wake_locked(t.queue);
            }
            next = std::min<uint64_t>(next, t.last + t.speed);
        }
        if (next == UINT64_MAX) {
            g_timerCv.wait(lk);
        } else {
            auto when = g_start + std::chrono::duration_cast<std::chrono::steady_clock::duration>(
                                      tick_length() * static_cast<double>(next));
            g_timerCv.wait_until(lk, when);
        }
    }
}

Timer *find_locked(Window *w, LINT id) {
    for (Timer &t : g_timers)
        if (t.used && t.wnd == w && t.id == id) return &t;
    return nullptr;
}

}  // namespace

std::vector<Timer> &timers_locked() {
    return g_timers;
}

void timers_start() {
    std::lock_guard<std::mutex> lk(g_lock);
    if (g_timerThread) return;
    g_timerThread = true;
    std::thread(timer_loop).detach();
}

}  // namespace ftxgui

using namespace ftxgui;

extern "C" {

DWORD GetTickCount(void) {
    return static_cast<DWORD>(now_ticks());
}

BOOL SetTimerEx(HWND h, LINT id, DWORD speed, TIMERPROC proc) {
    if (id == 0) return FALSE;
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    if (w == nullptr || find_locked(w, id) != nullptr) return FALSE;
    for (Timer &t : g_timers) {
        if (t.used) continue;
        t = Timer{};
        t.used = true;
        t.wnd = w;
        t.id = id;
        t.speed = speed == 0 ? 1 : speed;
        t.proc = proc;
        t.queue = w->queue;
        t.last = now_ticks();
        g_timerCv.notify_all();
        return TRUE;
    }
    return FALSE;
}

int KillTimer(HWND h, LINT id) {
    std::lock_guard<std::mutex> lk(g_lock);
    int n = 0;
    for (Timer &t : g_timers) {
        if (t.used && t.wnd == h && (id == 0 || t.id == id)) {
            t.used = false;
            n++;
        }
    }
    return n;
}

BOOL ResetTimerEx(HWND h, LINT id, DWORD speed, TIMERPROC proc) {
    std::lock_guard<std::mutex> lk(g_lock);
    Timer *t = find_locked(static_cast<Window *>(h), id);
    if (t == nullptr) return FALSE;
    t->speed = speed == 0 ? 1 : speed;
    if (proc != reinterpret_cast<TIMERPROC>(INV_PTR)) t->proc = proc;
    t->last = now_ticks();
    t->pending = false;
    g_timerCv.notify_all();
    return TRUE;
}

BOOL IsTimerInstalled(HWND h, LINT id) {
    std::lock_guard<std::mutex> lk(g_lock);
    return find_locked(static_cast<Window *>(h), id) != nullptr;
}

BOOL HaveFreeTimer(void) {
    std::lock_guard<std::mutex> lk(g_lock);
    for (Timer &t : g_timers)
        if (!t.used) return TRUE;
    return FALSE;
}

}  // extern "C"

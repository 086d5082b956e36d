// Test harness for the GUI library: one headless GUI per test process in a private
// device root, GUI threads with a recording window procedure, and framebuffer helpers.
#pragma once

#include <pthread.h>
#include <stdlib.h>

#include <chrono>
#include <functional>
#include <mutex>
#include <thread>
#include <vector>

#include <gtest/gtest.h>

#include "minigui/common.h"
#include "minigui/minigui.h"
#include "minigui/gdi.h"
#include "minigui/window.h"
#include "minigui/control.h"
#include "minigui/ftx_gui.h"
#include "support/temp_root.h"

namespace guitest {

constexpr int kW = 480;
constexpr int kH = 800;
// Runs the std::function<void()>* in wParam on the window's thread.
constexpr UINT MSG_RUN = MSG_USER + 1;

struct Rec {
    HWND hwnd;
    UINT msg;
    WPARAM wp;
    LPARAM lp;
    pthread_t thread;
};

class Log {
  public:
    void add(const Rec &r) {
        std::lock_guard<std::mutex> lk(m_);
        recs_.push_back(r);
    }
    std::vector<Rec> all() {
        std::lock_guard<std::mutex> lk(m_);
        return recs_;
    }
    void clear() {
        std::lock_guard<std::mutex> lk(m_);
        recs_.clear();
    }
    std::vector<Rec> of(HWND h, UINT msg) {
        std::vector<Rec> out;
        for (const Rec &r : all())
            if (r.hwnd == h && r.msg == msg) out.push_back(r);
        return out;
    }

  private:
    std::mutex m_;
    std::vector<Rec> recs_;
};

inline Log &log() {
    static Log l;
    return l;
}

// Records every message; runs MSG_RUN payloads; closes like the handset's windows do.
inline LRESULT RecordingProc(HWND h, UINT msg, WPARAM wp, LPARAM lp) {
    if (msg != MSG_RUN) log().add(Rec{h, msg, wp, lp, pthread_self()});
    switch (msg) {
        case MSG_RUN:
            (*reinterpret_cast<std::function<void()> *>(wp))();
            return 0;
        case MSG_USER + 2:
            return static_cast<LRESULT>(wp * 2);
        case MSG_CLOSE:
            DestroyAllControls(h);
            DestroyMainWindow(h);
            PostQuitMessage(h);
            return 0;
        default:
            return DefaultMainWinProc(h, msg, wp, lp);
    }
}

inline MAINWINCREATE make_create(const RECT &rc, HWND host = HWND_DESKTOP,
                                 const char *caption = "test", DWORD style = WS_VISIBLE) {
    MAINWINCREATE c{};
    c.dwStyle = style;
    c.spCaption = caption;
    c.hHosting = host;
    c.MainWindowProc = RecordingProc;
    c.lx = rc.left;
    c.ty = rc.top;
    c.rx = rc.right;
    c.by = rc.bottom;
    c.iBkColor = 0x000000;
    return c;
}

// A thread with its own main window and message loop.
class GuiThread {
  public:
    explicit GuiThread(RECT rc = RECT{0, 0, kW, kH}, const char *caption = "test") {
        std::mutex m;
        std::condition_variable cv;
        bool ready = false;
        thread_ = std::thread([&, rc, caption] {
            MAINWINCREATE c = make_create(rc, HWND_DESKTOP, caption);
            HWND h = CreateMainWindow(&c);
            {
                // Notified under the lock: the constructor's cv dies as soon as it sees ready.
                std::lock_guard<std::mutex> lk(m);
                hwnd_ = h;
                tid_ = pthread_self();
                ready = true;
                cv.notify_all();
            }
            if (h == HWND_INVALID) return;
            MSG msg;
            while (GetMessage(&msg, h)) {
                TranslateMessage(&msg);
                DispatchMessage(&msg);
            }
            MainWindowThreadCleanup(h);
        });
        std::unique_lock<std::mutex> lk(m);
        cv.wait(lk, [&] { return ready; });
    }
    ~GuiThread() {
        if (IsWindow(hwnd_)) PostMessage(hwnd_, MSG_CLOSE, 0, 0);
        thread_.join();
    }
    HWND hwnd() const { return hwnd_; }
    pthread_t tid() const { return tid_; }
    // Runs fn on the GUI thread and waits for it.
    void run(std::function<void()> fn) {
        SendMessage(hwnd_, MSG_RUN, reinterpret_cast<WPARAM>(&fn), 0);
    }

  private:
    std::thread thread_;
    HWND hwnd_ = HWND_INVALID;
    pthread_t tid_{};
};

inline bool idle() {
    return ftx_gui_wait_idle(3000) == 0;
}

inline bool wait_until(const std::function<bool()> &pred, int ms = 3000) {
    auto end = std::chrono::steady_clock::now() + std::chrono::milliseconds(ms);
    while (std::chrono::steady_clock::now() < end) {
        if (pred()) return true;
        std::this_thread::sleep_for(std::chrono::milliseconds(2));
    }
    return pred();
}

inline Uint32 pixel(int x, int y) {
    int w, h;
    ftx_gui_lock_framebuffer();
    const Uint32 *fb = ftx_gui_framebuffer(&w, &h);
    Uint32 v = fb[static_cast<size_t>(y) * w + x];
    ftx_gui_unlock_framebuffer();
    return v;
}

// Number of pixels in rc (screen) that differ from px.
inline int count_not(const RECT &rc, Uint32 px) {
    int w, h, n = 0;
    ftx_gui_lock_framebuffer();
    const Uint32 *fb = ftx_gui_framebuffer(&w, &h);
    for (int y = rc.top; y < rc.bottom; y++)
        for (int x = rc.left; x < rc.right; x++)
            if (fb[static_cast<size_t>(y) * w + x] != px) n++;
    ftx_gui_unlock_framebuffer();
    return n;
}

inline void fill_screen(Uint32 px) {
    SetBrushColor(HDC_SCREEN, px);
    FillBox(HDC_SCREEN, 0, 0, kW, kH);
}

// One device root and one headless GUI for the whole test program.
class GuiEnvironment : public ::testing::Environment {
  public:
    void SetUp() override {
        setenv("FTX_DISPLAY", "headless", 1);
        setenv("FTX_SCREEN", "480x800", 1);
        root_ = new TempRoot;
        ASSERT_EQ(InitGUI(0, nullptr), 0);
        ASSERT_EQ(InitGUIIAL(), 0);
    }
    void TearDown() override {
        ftx_console_stop();
        delete root_;
    }
    static TempRoot *root_;
};

}  // namespace guitest

// Window system: creation order, activation, threads and queues, timers, hooks.
#include <atomic>

#include "gui_harness.h"

using namespace guitest;

TempRoot *GuiEnvironment::root_ = nullptr;
static ::testing::Environment *const g_env =
    ::testing::AddGlobalTestEnvironment(new GuiEnvironment);

namespace {

size_t index_of(const std::vector<Rec> &recs, HWND h, UINT msg) {
    for (size_t i = 0; i < recs.size(); i++)
        if (recs[i].hwnd == h && recs[i].msg == msg) return i;
    return SIZE_MAX;
}

std::vector<WPARAM> actives(HWND h) {
    std::vector<WPARAM> v;
    for (const Rec &r : log().of(h, MSG_ACTIVE))
        v.push_back(r.wp);
    return v;
}

}  // namespace

TEST(Windows, CreateComesBeforeTheFirstPaint) {
    log().clear();
    GuiThread gui;
    ASSERT_NE(gui.hwnd(), HWND_INVALID);
    ASSERT_TRUE(idle());
    std::vector<Rec> recs = log().all();
    size_t create = index_of(recs, gui.hwnd(), MSG_CREATE),
           paint = index_of(recs, gui.hwnd(), MSG_PAINT);
    ASSERT_NE(create, SIZE_MAX);
    ASSERT_NE(paint, SIZE_MAX);
    EXPECT_LT(create, paint);
}

TEST(Windows, ActivationFollowsTheStack) {
    log().clear();
    GuiThread gui;
    HWND a = gui.hwnd(), b = HWND_INVALID;
    ASSERT_TRUE(idle());
    EXPECT_EQ(GetActiveWindow(), a);
    EXPECT_EQ(actives(a), std::vector<WPARAM>{1});

    gui.run([&] {
        MAINWINCREATE c = make_create(RECT{0, 100, kW, 700}, a, "covering");
        b = CreateMainWindow(&c);
    });
    ASSERT_NE(b, HWND_INVALID);
    ASSERT_TRUE(idle());
    EXPECT_EQ(GetActiveWindow(), b);
    EXPECT_EQ(actives(b), std::vector<WPARAM>{1});
    EXPECT_EQ(actives(a), (std::vector<WPARAM>{1, 0}));

    SendMessage(b, MSG_CLOSE, 0, 0);
    ASSERT_TRUE(idle());
    EXPECT_FALSE(IsWindow(b));
    EXPECT_EQ(GetActiveWindow(), a);
    EXPECT_EQ(actives(a), (std::vector<WPARAM>{1, 0, 1}));
    // The host's loop goes on after a hosted window closed and posted its quit.
    EXPECT_TRUE(IsWindow(a));
    EXPECT_EQ(SendMessage(a, MSG_USER + 2, 21, 0), 42);
}

TEST(Windows, HostedWindowMustBeMadeOnTheHostsThread) {
    log().clear();
    GuiThread gui;
    HWND host = gui.hwnd();
    std::atomic<HWND> fromWorker{nullptr}, viaGui{nullptr};
    std::thread worker([&] {
        MAINWINCREATE c = make_create(RECT{0, 0, 100, 100}, host, "wrong thread");
        fromWorker = CreateMainWindow(&c);
        // The handset's way: ask the GUI thread to do it.
        std::function<void()> fn = [&] {
            MAINWINCREATE c2 = make_create(RECT{0, 0, 100, 100}, host, "right thread");
            viaGui = CreateMainWindow(&c2);
        };
        SendMessage(host, MSG_RUN, reinterpret_cast<WPARAM>(&fn), 0);
    });
    worker.join();
    EXPECT_EQ(fromWorker.load(), HWND_INVALID);
    HWND made = viaGui.load();
    ASSERT_NE(made, HWND_INVALID);
    ASSERT_TRUE(IsWindow(made));
    EXPECT_TRUE(pthread_equal(GetMainWinThread(made), gui.tid()));
    // It runs there: its messages are handled on the GUI thread.
    EXPECT_EQ(SendMessage(made, MSG_USER + 2, 5, 0), 10);
    std::vector<Rec> creates = log().of(made, MSG_CREATE);
    ASSERT_EQ(creates.size(), 1u);
    EXPECT_TRUE(pthread_equal(creates[0].thread, gui.tid()));
    // Closing the host closes what it hosts.
    SendMessage(host, MSG_CLOSE, 0, 0);
    EXPECT_FALSE(IsWindow(made));
}

TEST(Windows, SendFromAnotherThreadReturnsTheResultAndPostNeverBlocks) {
    log().clear();
    GuiThread gui;
    std::atomic<LRESULT> got{0};
    std::atomic<bool> onGui{false};
    std::thread worker([&] {
        got = SendMessage(gui.hwnd(), MSG_USER + 2, 50, 0);
        std::function<void()> fn = [&] { onGui = pthread_equal(pthread_self(), gui.tid()) != 0; };
        SendMessage(gui.hwnd(), MSG_RUN, reinterpret_cast<WPARAM>(&fn), 0);
    });
    worker.join();
    EXPECT_EQ(got.load(), 100);
    EXPECT_TRUE(onGui.load());

    // Posting to a busy window returns at once, and the queue reports when it is full.
    std::mutex gate;
    gate.lock();
    std::function<void()> block = [&] {
        gate.lock();
        gate.unlock();
    };
    PostMessage(gui.hwnd(), MSG_RUN, reinterpret_cast<WPARAM>(&block), 0);
    int full = 0;
    for (int i = 0; i < 40; i++)
        if (PostMessage(gui.hwnd(), MSG_USER + 3, static_cast<WPARAM>(i), 0) == ERR_QUEUE_FULL)
            full++;
    EXPECT_GT(full, 0);
    EXPECT_EQ(SendNotifyMessage(gui.hwnd(), MSG_USER + 4, 0, 0), ERR_OK);
    gate.unlock();
    ASSERT_TRUE(idle());
    EXPECT_EQ(log().of(gui.hwnd(), MSG_USER + 4).size(), 1u);
    EXPECT_EQ(PostMessage(reinterpret_cast<HWND>(0x1234), MSG_USER, 0, 0), ERR_INV_HWND);
}

TEST(Windows, TimerArrivesWithItsIdAtItsPeriod) {
    log().clear();
    GuiThread gui;
    BOOL set = FALSE;
    auto start = std::chrono::steady_clock::now();
    gui.run([&] { set = SetTimer(gui.hwnd(), 7, 5); });  // 50 ms
    ASSERT_TRUE(set);
    EXPECT_FALSE(SetTimer(gui.hwnd(), 7, 5)) << "a second timer with the same id";
    ASSERT_TRUE(wait_until([&] { return log().of(gui.hwnd(), MSG_TIMER).size() >= 4; }));
    auto took = std::chrono::steady_clock::now() - start;
    gui.run([&] { EXPECT_EQ(KillTimer(gui.hwnd(), 7), 1); });
    for (const Rec &r : log().of(gui.hwnd(), MSG_TIMER))
        EXPECT_EQ(r.wp, 7u);
    // Four ticks of 50 ms: no sooner than 200 ms, and not wildly late.
    EXPECT_GE(took, std::chrono::milliseconds(190));
    EXPECT_LT(took, std::chrono::milliseconds(1500));
    EXPECT_FALSE(IsTimerInstalled(gui.hwnd(), 7));
}

namespace {

std::mutex g_hookLock;
std::vector<std::pair<HWND, WPARAM>> g_hooked;

int swallow61(void *, HWND dst, UINT msg, WPARAM wp, LPARAM) {
    if (msg == MSG_KEYDOWN) {
        std::lock_guard<std::mutex> lk(g_hookLock);
        g_hooked.emplace_back(dst, wp);
    }
    return wp == SCANCODE_F3 ? HOOK_STOP : HOOK_GOON;
}

}  // namespace

TEST(Windows, KeyHookSwallowsOrPasses) {
    log().clear();
    GuiThread gui;
    ASSERT_TRUE(idle());
    MSGHOOK old = RegisterKeyMsgHook(nullptr, swallow61);
    ASSERT_EQ(ftx_gui_inject(FTX_INPUT_KEYDOWN, SCANCODE_F3, 0), 0);
    ASSERT_EQ(ftx_gui_inject(FTX_INPUT_KEYDOWN, SCANCODE_F2, 0), 0);
    ASSERT_TRUE(idle());
    EXPECT_EQ(RegisterKeyMsgHook(nullptr, old), swallow61);
    std::vector<Rec> keys = log().of(gui.hwnd(), MSG_KEYDOWN);
    ASSERT_EQ(keys.size(), 1u);
    EXPECT_EQ(keys[0].wp, static_cast<WPARAM>(SCANCODE_F2));
    std::lock_guard<std::mutex> lk(g_hookLock);
    ASSERT_EQ(g_hooked.size(), 2u);
    EXPECT_EQ(g_hooked[0].first, gui.hwnd()) << "the hook is told the active window";
    g_hooked.clear();
}

TEST(Windows, TouchGoesToTheTopmostWindowInClientCoordinates) {
    log().clear();
    GuiThread back(RECT{0, 0, kW, kH}, "back");
    GuiThread front(RECT{100, 200, 300, 400}, "front");
    ASSERT_TRUE(idle());
    ftx_gui_inject(FTX_INPUT_TOUCHDOWN, 150, 250);
    ftx_gui_inject(FTX_INPUT_TOUCHUP, 150, 250);
    ftx_gui_inject(FTX_INPUT_TOUCHDOWN, 20, 20);
    ftx_gui_inject(FTX_INPUT_TOUCHUP, 20, 20);
    ASSERT_TRUE(idle());
    std::vector<Rec> f = log().of(front.hwnd(), MSG_LBUTTONDOWN),
                     b = log().of(back.hwnd(), MSG_LBUTTONDOWN);
    ASSERT_EQ(f.size(), 1u);
    ASSERT_EQ(b.size(), 1u);
    EXPECT_EQ(LOSWORD(f[0].lp), 50);
    EXPECT_EQ(HISWORD(f[0].lp), 50);
    EXPECT_EQ(LOSWORD(b[0].lp), 20);
}

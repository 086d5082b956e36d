// Relink after a restart: with /cache/Tcp_Restart.ini the main window gets exactly one F4
// key-down about a second (scaled) after start; without it no thread is started.
#include <stdlib.h>
#include <unistd.h>

#include <filesystem>

#include "adbd_connection/AtThread.h"
#include "unit/gui/gui_harness.h"

using namespace guitest;

TempRoot *GuiEnvironment::root_ = nullptr;
static ::testing::Environment *const g_env = [] {
    setenv("FTX_TIME_SCALE", "0.05", 1);  // the one-second wait takes 50 ms
    return ::testing::AddGlobalTestEnvironment(new GuiEnvironment);
}();

namespace {

// Threads of this process.
size_t threads() {
    size_t n = 0;
    for (const auto &e : std::filesystem::directory_iterator("/proc/self/task")) {
        (void)e;
        n++;
    }
    return n;
}

TEST(Relink, OneF4KeyDownWhenTheRestartFileExists) {
    GuiThread main;
    const size_t base = threads();
    EXPECT_EQ(0, mmi_start_tcp_relink(main.hwnd()));
    EXPECT_EQ(base, threads()) << "a relink thread without the restart file";

    GuiEnvironment::root_->write("/cache/Tcp_Restart.ini", "[tcp]\n");
    EXPECT_EQ(1, mmi_start_tcp_relink(main.hwnd()));
    ASSERT_TRUE(wait_until([&] { return !log().of(main.hwnd(), MSG_KEYDOWN).empty(); }));
    // Once the thread has ended nothing more can come from it.
    ASSERT_TRUE(wait_until([&] { return threads() == base; }));
    std::vector<Rec> keys = log().of(main.hwnd(), MSG_KEYDOWN);
    ASSERT_EQ(1u, keys.size());
    EXPECT_EQ(static_cast<WPARAM>(SCANCODE_F4), keys[0].wp);
    EXPECT_EQ(0, keys[0].lp);
}

}  // namespace

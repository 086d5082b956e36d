// Relink after a restart: with /cache/Tcp_Restart.ini the main window gets exactly one F4
// key-down about a second (scaled) after start; without it no thread is started.
#include <stdlib.h>
#include <unistd.h>

#include "AtThread.h"
#include "unit/gui/gui_harness.h"

using namespace guitest;

TempRoot *GuiEnvironment::root_ = nullptr;
static ::testing::Environment *const g_env = [] {
    setenv("FTX_TIME_SCALE", "0.05", 1);  // the one-second wait takes 50 ms
    return ::testing::AddGlobalTestEnvironment(new GuiEnvironment);
}();

namespace {

TEST(Relink, OneF4KeyDownWhenTheRestartFileExists) {
    GuiThread main;
    EXPECT_EQ(0, mmi_start_tcp_relink(main.hwnd()));
    usleep(150 * 1000);
    EXPECT_TRUE(log().of(main.hwnd(), MSG_KEYDOWN).empty());

    GuiEnvironment::root_->write("/cache/Tcp_Restart.ini", "[tcp]\n");
    EXPECT_EQ(1, mmi_start_tcp_relink(main.hwnd()));
    ASSERT_TRUE(wait_until([&] { return !log().of(main.hwnd(), MSG_KEYDOWN).empty(); }));
    usleep(150 * 1000);
    std::vector<Rec> keys = log().of(main.hwnd(), MSG_KEYDOWN);
    ASSERT_EQ(1u, keys.size());
    EXPECT_EQ(static_cast<WPARAM>(SCANCODE_F4), keys[0].wp);
    EXPECT_EQ(0, keys[0].lp);
}

}  // namespace

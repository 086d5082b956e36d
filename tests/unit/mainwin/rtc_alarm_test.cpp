// The RTC alarm helper against the simulated kernel's files, and the suspend it asks for.
#include <time.h>

#include <chrono>
#include <future>
#include <string>

#include <gtest/gtest.h>

#include "core/mmi_rtc_alarm.h"
#include "minigui/ftx_gui.h"
#include "support/temp_root.h"
#include "tp_os.h"

namespace {

const char kAlarm[] = "/sys/class/rtc/rtc0/wakealarm";

long long now_s() {
    timespec ts;
    clock_gettime(CLOCK_REALTIME, &ts);
    return ts.tv_sec;
}

// A root with the files the kernel makes at boot.
struct KernelRoot : TempRoot {
    KernelRoot() {
        write(kAlarm, "");
        write("/sys/power/state", "mem\n");
    }
};

// mmi_rtc_set_wakealarm(seconds) arms the alarm `ahead` seconds from now.
void expect_armed_ahead(int seconds, long long ahead) {
    const long long before = now_s();
    ASSERT_EQ(0, mmi_rtc_set_wakealarm(seconds));
    const long long at = mmi_rtc_get_wakealarm();
    EXPECT_GE(at, before + ahead) << seconds;
    EXPECT_LE(at, now_s() + ahead) << seconds;
}

TEST(RtcAlarm, ArmsScaledSecondsRoundedUpEachReplacingTheLast) {
    // mainwin_test runs with FTX_TIME_SCALE=0.001 (power_test.cpp).
    ASSERT_DOUBLE_EQ(0.001, tp_os_time_scale());
    KernelRoot root;
    EXPECT_EQ(0, mmi_rtc_get_wakealarm());
    // The kernel takes a new alarm only after a "0": each of these replaces an armed one.
    expect_armed_ahead(1, 1);
    expect_armed_ahead(1500, 2);
    expect_armed_ahead(60000, 60);
    EXPECT_EQ(std::to_string(mmi_rtc_get_wakealarm()) + "\n", root.read(kAlarm));
    EXPECT_EQ(0, mmi_rtc_clear_wakealarm());
    EXPECT_EQ(0, mmi_rtc_get_wakealarm());
    EXPECT_EQ("", root.read(kAlarm));
    EXPECT_EQ(-1, mmi_rtc_set_wakealarm(0));
    EXPECT_EQ(-1, mmi_rtc_set_wakealarm(-5));
    EXPECT_EQ("", root.read(kAlarm));
}

TEST(RtcAlarm, AHandsetWithoutTheFilesAnswersNoAlarmAndFails) {
    TempRoot root;
    EXPECT_EQ(-1, mmi_rtc_set_wakealarm(10));
    EXPECT_EQ(-1, mmi_rtc_clear_wakealarm());
    EXPECT_EQ(0, mmi_rtc_get_wakealarm());
    EXPECT_EQ(-1, mmi_system_suspend());
    root.write(kAlarm, "garbage\n");
    EXPECT_EQ(0, mmi_rtc_get_wakealarm());
}

TEST(RtcAlarm, SuspendReturnsOnceTheAlarmFired) {
    KernelRoot root;
    ASSERT_EQ(0, mmi_rtc_set_wakealarm(1000));  // 1 s at this scale
    const long long at = mmi_rtc_get_wakealarm();
    auto suspended = std::async(std::launch::async, [] { return mmi_system_suspend(); });
    const bool returned = suspended.wait_for(std::chrono::seconds(10)) == std::future_status::ready;
    char reply[64];
    if (!returned) ftx_console_execute("wake", reply, sizeof(reply));  // never left asleep
    ASSERT_TRUE(returned);
    EXPECT_EQ(0, suspended.get());
    EXPECT_GE(now_s(), at);
    EXPECT_EQ(0, mmi_rtc_get_wakealarm());
}

}  // namespace

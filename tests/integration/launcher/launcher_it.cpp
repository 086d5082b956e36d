// The launcher (tools/run.sh, which ./ftx run starts): after a power-off with the RTC alarm
// armed it starts the application again at the alarm time; without one it ends.
#include <signal.h>
#include <time.h>

#include <string>

#include <gtest/gtest.h>

#include "support/device_under_test.h"

namespace {

const char kAlarm[] = "/sys/class/rtc/rtc0/wakealarm";
const char kStarted[] = "DVK_FTX: main begin";
const char kPowerOff[] = "PowerOffMoudle testItem close";

long long now_s() {
    timespec ts;
    clock_gettime(CLOCK_REALTIME, &ts);
    return ts.tv_sec;
}

// What the launcher said: its standard error, which the application's output shares.
std::string said(const DeviceUnderTest &dut) {
    return dut.read("/log/stdout.txt");
}

bool wait_said(const DeviceUnderTest &dut, const std::string &text, int timeoutMs = 10000) {
    return dut_wait_until([&] { return said(dut).find(text) != std::string::npos; }, timeoutMs);
}

// Started through the launcher, with the PC channel taking commands.
void start(DeviceUnderTest &dut) {
    ASSERT_TRUE(dut.startLauncher());
    ASSERT_TRUE(dut.waitConsole());
    ASSERT_TRUE(dut.waitChannel());
}

TEST(Launcher, TheRtcAlarmStartsThePoweredOffApplicationAgain) {
    DeviceUnderTest dut;
    ASSERT_NO_FATAL_FAILURE(start(dut));
    // The alarm as the application arms it: epoch seconds, already scaled.
    const long long at = now_s() + 3;
    dut.write(kAlarm, std::to_string(at) + "\n");
    ASSERT_EQ(0, dut.pc(kPowerOff).first);
    ASSERT_TRUE(wait_said(dut, "ftx run: powered off: the RTC alarm starts it again at "));
    ASSERT_TRUE(wait_said(dut, "ftx run: RTC alarm: starting again"));
    EXPECT_GE(now_s(), at);
    EXPECT_EQ("", dut.read(kAlarm));
    EXPECT_TRUE(dut.waitLogCount(kStarted, 2));

    // The launcher cleared the alarm: the next power-off ends it.
    ASSERT_TRUE(dut.waitChannel());
    ASSERT_EQ(0, dut.pc(kPowerOff).first);
    EXPECT_EQ(0, dut.wait(10000));
    EXPECT_NE(std::string::npos, said(dut).find("ftx run: powered off\n"));
    EXPECT_EQ(2u, dut.logCount(kStarted));
}

TEST(Launcher, CtrlCEndsTheWaitForTheAlarm) {
    DeviceUnderTest dut;
    ASSERT_NO_FATAL_FAILURE(start(dut));
    dut.write(kAlarm, std::to_string(now_s() + 3600) + "\n");
    ASSERT_EQ(0, dut.pc(kPowerOff).first);
    ASSERT_TRUE(wait_said(dut, "the RTC alarm starts it again at "));
    kill(dut.pid(), SIGINT);
    EXPECT_EQ(130, dut.wait(5000));
    EXPECT_NE(std::string::npos, said(dut).find("ftx run: stopped"));
    EXPECT_EQ(1u, dut.logCount(kStarted));
}

}  // namespace

// Idle, sleep, power-off and battery warning rules, with a fake clock and recorded effects.
#include <gtest/gtest.h>
#include <stdlib.h>

#include <string>
#include <vector>

#include "core/mmi_power.h"
#include "core/mmi_settings.h"
#include "support/temp_root.h"
#include "unit/config/log_capture.h"

namespace {

__attribute__((constructor)) void fast_waits() {
    setenv("FTX_TIME_SCALE", "0.001", 1);
}

struct Effects {
    long long now = 1000000000LL;
    std::vector<std::string> events;  // "write PATH=TEXT", "shell CMD", "title I A TEXT", ...
    int failWrite = -1;               // index of the write that fails
    int writes = 0;
} fx;

long long fake_clock() {
    return fx.now;
}
int fake_write(const char *path, const char *text) {
    int n = fx.writes++;
    fx.events.push_back(std::string("write ") + path + "=" + text);
    return n == fx.failWrite ? -1 : 0;
}
int fake_shell(const char *cmd) {
    fx.events.push_back(std::string("shell ") + cmd);
    return 0;
}
void fake_power_off() {
    fx.events.push_back("power off");
}
int fake_title(const char *text, int index, int abnormal) {
    fx.events.push_back("title " + std::to_string(index) + " " + std::to_string(abnormal) + " " +
                        (text ? text : "(null)"));
    return 0;
}
int fake_uninit() {
    fx.events.push_back("uninit");
    return 0;
}
int fake_vibrate(int ms) {
    fx.events.push_back("vibrate " + std::to_string(ms));
    return 0;
}
int fake_refresh(int) {
    fx.events.push_back("lcd refresh");
    return 0;
}
int fake_unregister(int kind, FTX_BatteryObserver_cb) {
    fx.events.push_back("unregister " + std::to_string(kind));
    return 0;
}

bool has_event(const std::string &e) {
    for (const auto &x : fx.events)
        if (x == e) return true;
    return false;
}

FTX_BATTERY_INFO battery(int temp = 300, int status = FTX_BATTERY_STATUS_DISCHARGING, int usb = 0) {
    FTX_BATTERY_INFO b{};
    b.batteryPresent = 1;
    b.batteryStatus = status;
    b.batteryHealth = FTX_BATTERY_HEALTH_GOOD;
    b.batteryLevel = 80;
    b.batteryTemperature = temp;
    b.chargerUsbOnline = (unsigned char)usb;
    return b;
}

class PowerTest : public ::testing::Test {
  protected:
    void SetUp() override {
        fx = Effects();
        g_powerOps = mmi_power_default_ops();
        g_powerOps.clock_us = fake_clock;
        g_powerOps.write_file = fake_write;
        g_powerOps.shell = fake_shell;
        g_powerOps.power_off = fake_power_off;
        g_powerOps.title_show = fake_title;
        g_powerOps.mode_uninit = fake_uninit;
        g_powerOps.vibrator_start = fake_vibrate;
        g_powerOps.lcd_refresh = fake_refresh;
        g_powerOps.unregister_observer = fake_unregister;
        g_bCfgOsIsCanIdle = 1;
        g_bOsIsCanIdle = 1;
        g_autoSleepTime = 90;
        g_autoTurnOffTime = 1800;
        g_powerofftemp = 600;
        mmi_power_reset();
        // A first battery record: present, discharging; it also restarts the idle count.
        FTX_BATTERY_INFO b = battery();
        batteryTemperatureobserver_cb(&b);
        fx.events.clear();
    }
    void TearDown() override { g_powerOps = mmi_power_default_ops(); }
    // A fresh start whose first battery record is b (the idle count starts with it).
    void restart(FTX_BATTERY_INFO b) {
        mmi_power_reset();
        batteryTemperatureobserver_cb(&b);
        fx.events.clear();
    }
    // One battery-service tick after secs seconds without input.
    void tick_after(long secs, FTX_BATTERY_INFO b = battery()) {
        fx.now += secs * 1000000LL;
        batteryTemperatureobserver_cb(&b);
    }
};

TEST_F(PowerTest, SleepsAtExactlyTheSleepTimeWithBacklightThenBlank) {
    tick_after(89);
    EXPECT_TRUE(fx.events.empty());
    EXPECT_EQ(g_bCurrentSleepStatus, 0);
    tick_after(1);
    std::vector<std::string> want = {
        "write /sys/class/leds/lcd-backlight/brightness=10",
        "write /sys/class/leds/lcd-backlight/brightness=0",
        "shell echo 4 > /sys/class/graphics/fb0/blank",
        "shell echo mem > /sys/power/autosleep",
    };
    EXPECT_EQ(fx.events, want);
    EXPECT_EQ(g_bCurrentSleepStatus, 1);
    // Asleep: the next tick does not sleep again.
    fx.events.clear();
    tick_after(1);
    EXPECT_TRUE(fx.events.empty());
}

TEST_F(PowerTest, PowerKeyTogglesAndWakeRefreshesThePanel) {
    ASSERT_EQ(SwitchSleepStatus(), 0);
    EXPECT_EQ(g_bCurrentSleepStatus, 1);
    fx.events.clear();
    ASSERT_EQ(SwitchSleepStatus(), 0);
    std::vector<std::string> want = {
        "shell echo off > /sys/power/autosleep",
        "shell echo 0 > /sys/class/graphics/fb0/blank",
        "lcd refresh",
        "write /sys/class/leds/lcd-backlight/brightness=100",
    };
    EXPECT_EQ(fx.events, want);
    EXPECT_EQ(g_bCurrentSleepStatus, 0);
}

TEST_F(PowerTest, FailedBacklightWriteLeavesTheScreenAwake) {
    for (int failing : {0, 1}) {
        fx.writes = 0;
        fx.failWrite = failing;
        LogCapture log;
        EXPECT_EQ(SetIdleWakeupStatus(1), -1);
        EXPECT_EQ(g_bCurrentSleepStatus, 0);
        EXPECT_TRUE(
            log.has(failing == 0 ? "set brightness = 10 fail." : "set brightness = 0 fail."));
    }
}

TEST_F(PowerTest, TurnOffTimePowersOffUnlessCharging) {
    g_autoSleepTime = 1000;  // going to sleep would restart the count as well
    g_autoTurnOffTime = 100;
    const FTX_BATTERY_INFO charging = battery(300, FTX_BATTERY_STATUS_CHARGING);
    const FTX_BATTERY_INFO fullOnCharger = battery(300, FTX_BATTERY_STATUS_FULL, 1);
    const FTX_BATTERY_INFO fullAlone = battery(300, FTX_BATTERY_STATUS_FULL, 0);
    tick_after(0, charging);  // a change of charging state restarts the count by itself
    // Charging: no power-off, and the count starts again.
    tick_after(100, charging);
    tick_after(99, charging);
    // Full on a charger counts as charging.
    tick_after(1, fullOnCharger);
    EXPECT_FALSE(has_event("power off"));
    tick_after(0, fullAlone);
    tick_after(99, fullAlone);
    EXPECT_FALSE(has_event("power off"));
    // Full without a charger powers off after a one-second buzz.
    fx.events.clear();
    tick_after(1, fullAlone);
    ASSERT_TRUE(has_event("power off"));
    std::vector<std::string> tail(fx.events.end() - 3, fx.events.end());
    EXPECT_EQ(tail, (std::vector<std::string>{"uninit", "vibrate 1000", "power off"}));
}

TEST_F(PowerTest, FullStaysOnWithAnyOneChargerOtherStatesTurnOff) {
    g_autoSleepTime = 1000;
    g_autoTurnOffTime = 100;
    struct Charger {
        const char *name;
        unsigned char FTX_BATTERY_INFO::*online;
    };
    const Charger chargers[] = {{"ac", &FTX_BATTERY_INFO::chargerAcOnline},
                                {"usb", &FTX_BATTERY_INFO::chargerUsbOnline},
                                {"wireless", &FTX_BATTERY_INFO::chargerWirelessOnline}};
    for (const Charger &c : chargers) {
        SCOPED_TRACE(c.name);
        FTX_BATTERY_INFO b = battery(300, FTX_BATTERY_STATUS_FULL);
        b.*c.online = 1;
        restart(b);
        tick_after(100, b);
        tick_after(100, b);  // the count started again at the first
        EXPECT_FALSE(has_event("power off"));
        // On the same charger only "charging" and "full" keep it on.
        for (int status : {FTX_BATTERY_STATUS_UNKNOWN, FTX_BATTERY_STATUS_DISCHARGING,
                           FTX_BATTERY_STATUS_NOT_CHARGING}) {
            SCOPED_TRACE(status);
            b.batteryStatus = status;
            restart(b);
            tick_after(100, b);
            EXPECT_TRUE(has_event("power off"));
        }
    }
    // Charging needs no charger flag at all.
    FTX_BATTERY_INFO charging = battery(300, FTX_BATTERY_STATUS_CHARGING);
    restart(charging);
    tick_after(100, charging);
    EXPECT_FALSE(has_event("power off"));
}

TEST_F(PowerTest, OsIdleOffNeverSleepsNorPowersOff) {
    g_bCfgOsIsCanIdle = 0;
    Set_OsCanIdleAllowed(1);
    EXPECT_EQ(g_bOsIsCanIdle, 0);
    tick_after(100000);
    EXPECT_EQ(AutoSleepCheck(), -1);
    EXPECT_TRUE(fx.events.empty());
    LogCapture log;
    EXPECT_EQ(SwitchSleepStatus(), -1);
    EXPECT_TRUE(log.has("E batteryObserver: SwitchSleepStatus::cannot do idle,g_bOsIsCanIdle=0"));
}

TEST_F(PowerTest, WindowPermissionBlocksIdleUntilGivenBack) {
    Set_OsCanIdleAllowed(0);
    tick_after(5000);
    EXPECT_TRUE(fx.events.empty());
    Set_OsCanIdleAllowed(1);  // restarts the idle count
    tick_after(89);
    EXPECT_EQ(g_bCurrentSleepStatus, 0);
    tick_after(1);
    EXPECT_EQ(g_bCurrentSleepStatus, 1);
}

TEST_F(PowerTest, WithoutBatteryNeverSleeps) {
    FTX_BATTERY_INFO b = battery();
    b.batteryPresent = 0;
    LogCapture log;
    tick_after(100, b);
    EXPECT_EQ(g_bCurrentSleepStatus, 0);
    EXPECT_TRUE(log.has("current cannot do idle,no battery id,present=0"));
}

TEST_F(PowerTest, TemperatureWarningAndPowerOffThresholds) {
    tick_after(0, battery(449));
    EXPECT_TRUE(fx.events.empty());
    tick_after(0, battery(450));
    EXPECT_EQ(fx.events, (std::vector<std::string>{"title 1 1 batteryTemperatureWarning"}));
    fx.events.clear();
    tick_after(0, battery(300));  // cooled down: the warning is taken back
    EXPECT_EQ(fx.events, (std::vector<std::string>{"title 1 0 (null)"}));
    fx.events.clear();
    g_powerofftemp = 520;
    tick_after(0, battery(519));
    EXPECT_FALSE(has_event("power off"));
    tick_after(0, battery(520));
    EXPECT_TRUE(has_event("power off"));
}

TEST_F(PowerTest, ChargingChangeWakesAndShowsTheState) {
    ASSERT_EQ(SetIdleWakeupStatus(1), 0);
    fx.events.clear();
    tick_after(0, battery(300, FTX_BATTERY_STATUS_CHARGING));
    EXPECT_EQ(g_bCurrentSleepStatus, 0);
    EXPECT_TRUE(has_event("title 0 0 BatteryCharging_Charging"));
    fx.events.clear();
    tick_after(0, battery(300, FTX_BATTERY_STATUS_DISCHARGING));
    EXPECT_TRUE(has_event("title 0 0 BatteryCharging_Null"));
}

TEST_F(PowerTest, VoltageWarningIsGivenOnce) {
    FTX_BATTERY_INFO b = battery();
    batteryVoltobserver_cb(&b);
    EXPECT_EQ(fx.events,
              (std::vector<std::string>{"title 1 1 batteryLevelWaring", "unregister 1"}));
}

TEST_F(PowerTest, StandbyCommandsSleepAndWake) {
    Set_OsCanIdleAllowed(0);  // a test window holds the screen
    EXPECT_EQ(mmi_AutoTest_Standby_Enable(), 1);
    EXPECT_EQ(g_bCurrentSleepStatus, 1);
    EXPECT_EQ(mmi_AutoTest_Standby_Disable(), 1);
    EXPECT_EQ(g_bCurrentSleepStatus, 0);
}

TEST(WriteFileTest, ReplacesTheValueInsideTheDeviceRoot) {
    TempRoot root;
    root.write(MMI_LCD_BRIGHTNESS_PATH, "255");
    EXPECT_EQ(write_file(MMI_LCD_BRIGHTNESS_PATH, "10"), 0);
    EXPECT_EQ(write_file(MMI_LCD_BRIGHTNESS_PATH, "0"), 0);
    EXPECT_EQ(root.read(MMI_LCD_BRIGHTNESS_PATH), "0");
    EXPECT_NE(write_file("/no/such/dir/file", "1"), 0);
}

}  // namespace

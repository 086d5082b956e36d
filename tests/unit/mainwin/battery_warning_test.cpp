// Battery warnings on the title strip: each is shown while its condition holds and leaves
// with it, the most urgent one wins, and the title comes back when none is left.
#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "core/mmi_power.h"
#include "core/mmi_settings.h"
#include "support/temp_root.h"

namespace {

std::vector<std::string> s_titles;  // "I A TEXT" per title strip change

int record_title(const char *text, int index, int abnormal) {
    s_titles.push_back(std::to_string(index) + " " + std::to_string(abnormal) + " " +
                       (text ? text : "(null)"));
    return 0;
}
long long still_clock() {
    return 5000000000LL;
}
int no_write(const char *, const char *) {
    return 0;
}
int no_shell(const char *) {
    return 0;
}
void no_power_off() {}
int no_unregister(int, FTX_BatteryObserver_cb) {
    return 0;
}

const std::string kTemp = "1 1 batteryTemperatureWarning";
const std::string kHealth = "1 1 batteryHealthWarning";
const std::string kLow = "1 1 batteryLevelWaring";
const std::string kTitleBack = "1 0 (null)";

struct Battery {
    int level = 80, temperature = 250, health = FTX_BATTERY_HEALTH_GOOD;
    int ac = 0, usb = 1, wireless = 0;
    FTX_BATTERY_INFO info() const {
        FTX_BATTERY_INFO b{};
        b.batteryPresent = 1;
        b.batteryLevel = level;
        b.batteryTemperature = temperature;
        b.batteryHealth = health;
        b.chargerAcOnline = (unsigned char)ac;
        b.chargerUsbOnline = (unsigned char)usb;
        b.chargerWirelessOnline = (unsigned char)wireless;
        b.batteryStatus =
            usb || ac || wireless ? FTX_BATTERY_STATUS_CHARGING : FTX_BATTERY_STATUS_DISCHARGING;
        return b;
    }
};

class BatteryWarning : public ::testing::Test {
  protected:
    void SetUp() override {
        g_powerOps = mmi_power_default_ops();
        g_powerOps.clock_us = still_clock;
        g_powerOps.write_file = no_write;
        g_powerOps.shell = no_shell;
        g_powerOps.power_off = no_power_off;
        g_powerOps.title_show = record_title;
        g_powerOps.unregister_observer = no_unregister;
        g_bOsIsCanIdle = 0;  // idle and sleep play no part here
        g_powerofftemp = 600;
        g_batteryWarningVolt = 30;
        mmi_power_reset();
        tick(Battery());
        s_titles.clear();
    }
    void TearDown() override { g_powerOps = mmi_power_default_ops(); }
    // One round of the battery service: the temperature observer.
    void tick(const Battery &b) {
        FTX_BATTERY_INFO i = b.info();
        batteryTemperatureobserver_cb(&i);
    }
    // The voltage observer, called by the service when the level is low.
    void low(const Battery &b) {
        FTX_BATTERY_INFO i = b.info();
        batteryVoltobserver_cb(&i);
    }
    // The warning part of what the strip was last told (charging texts left out).
    std::string lastWarning() const {
        for (auto it = s_titles.rbegin(); it != s_titles.rend(); ++it)
            if (it->rfind("1 ", 0) == 0) return *it;
        return "";
    }
    TempRoot root;
};

TEST_F(BatteryWarning, LowBatteryLeavesWhenAChargerComesOnline) {
    for (int charger = 0; charger < 3; charger++) {
        SCOPED_TRACE(charger);
        mmi_power_reset();
        s_titles.clear();
        Battery b;
        b.usb = 0;
        b.level = 12;
        low(b);
        EXPECT_EQ(kLow, lastWarning());
        tick(b);
        EXPECT_EQ(kLow, lastWarning());  // still low, still shown
        (charger == 0 ? b.ac : charger == 1 ? b.usb : b.wireless) = 1;
        tick(b);
        EXPECT_EQ(kTitleBack, lastWarning());
        s_titles.clear();
        tick(b);
        EXPECT_EQ("", lastWarning());  // the title is given back once
    }
}

TEST_F(BatteryWarning, LowBatteryLeavesOnlyAboveBothItsLevelAndTheThreshold) {
    Battery b;
    b.usb = 0;
    b.level = 12;
    low(b);
    b.level = 30;  // above the level it came at, not above the threshold of 30
    tick(b);
    EXPECT_EQ(kLow, lastWarning());
    b.level = 31;
    tick(b);
    EXPECT_EQ(kTitleBack, lastWarning());

    // A service that warns above the threshold: the warning stays until the level passes
    // the one it came at.
    mmi_power_reset();
    b.level = 40;
    low(b);
    b.level = 40;
    tick(b);
    EXPECT_EQ(kLow, lastWarning());
    b.level = 41;
    tick(b);
    EXPECT_EQ(kTitleBack, lastWarning());
}

TEST_F(BatteryWarning, HealthWarningFollowsEachHealthValue) {
    for (int health = 1; health <= 7; health++) {
        SCOPED_TRACE(health);
        s_titles.clear();
        Battery b;
        b.health = health;
        tick(b);
        bool bad = health == FTX_BATTERY_HEALTH_OVERHEAT || health == FTX_BATTERY_HEALTH_DEAD ||
                   health == FTX_BATTERY_HEALTH_OVER_VOLTAGE;
        EXPECT_EQ(bad ? kHealth : "", lastWarning());
        tick(Battery());
        EXPECT_EQ(bad ? kTitleBack : "", lastWarning());
    }
}

TEST_F(BatteryWarning, TheMostUrgentIsShownAndTheNextTakesOverWhenItLeaves) {
    Battery b;
    b.usb = 0;
    b.level = 12;
    b.health = FTX_BATTERY_HEALTH_DEAD;
    b.temperature = 450;
    low(b);
    tick(b);
    EXPECT_EQ(kTemp, lastWarning());
    b.temperature = 449;
    tick(b);
    EXPECT_EQ(kHealth, lastWarning());
    b.health = FTX_BATTERY_HEALTH_GOOD;
    tick(b);
    EXPECT_EQ(kLow, lastWarning());
    // The title comes back only when the last one leaves.
    for (const std::string &t : s_titles)
        EXPECT_NE(kTitleBack, t);
    b.usb = 1;
    tick(b);
    EXPECT_EQ(kTitleBack, lastWarning());
    // A low-battery call while hot keeps the hotter warning in front.
    s_titles.clear();
    b.temperature = 455;
    tick(b);
    b.usb = 0;
    low(b);
    EXPECT_EQ(kTemp, lastWarning());
}

}  // namespace

// The real ftx-mmi, headless: the battery test judged against the simulated battery in a
// run, and the PC's charging switch seen by the battery service and the title strip.
#include <string>

#include <gtest/gtest.h>

#include "support/handset.h"
#include "support/text.h"

using namespace handset;

namespace {

const Item kBattery = {"FTX_BATTERY", 1, 0, 1};
const char kCaption[] = "Battery Test";
const char kPassed[] = "FTX_BATTERY: every value inside for 2 refreshes: pass";

// The lines of a 720x1280 screen: the window starts at 720/15 + 10, the lines at
// (720/15) * 3 + 30 inside it, one a row twice the window font (36) high.
const int kLinesTop = 58 + 174;
const int kRowHeight = 72;
enum { LEVEL, VOLTAGE, TEMPERATURE, HEALTH, CHARGER, LINES };

template <typename Pred>
int inLine(const Png &p, int line, Pred pred) {
    const int top = kLinesTop + line * kRowHeight;
    return p.count(0, top, 720, top + kRowHeight, pred);
}

// The image's battery settings with a power-off temperature above what the tests set.
void allow_hot_battery(Handset &h) {
    h.dut.setConfig("MMI", "batteryParameter",
                    "lowvolt_threshold:30;powerofftemp:700;OSIdle:1;OS_AutoSleepTime:90;"
                    "OS_AutoTurnOffTime:1800;sys_backlight:/sys/class/leds/lcd-backlight/"
                    "brightness");
}

// Up to the device-test list with the battery set up, the service's record holding it.
void start_run(Handset &h, const std::string &battery) {
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.dut.waitChannel());
    if (!battery.empty()) {
        ASSERT_TRUE(h.dut.consoleOk("hw battery " + battery));
    }
    ASSERT_TRUE(h.dut.waitBatteryRounds(1));
    h.openDeviceList();
    h.chooseRow(0);  // the full run: the battery item first
}

}  // namespace

TEST(BatteryTest, WithinTheLimitsTheWindowPassesByItselfAndTheRunGoesOn) {
    Handset h({kBattery, kCards});
    start_run(h, "");
    ASSERT_TRUE(h.dut.waitLog(kPassed));
    ASSERT_TRUE(h.dut.waitLog(kCardsOpened));
    EXPECT_EQ(1, h.result(344));
    EXPECT_FALSE(has(h.dut.logcat(), "FTX_BATTERY: outside:"));
}

TEST(BatteryTest, AHotBatteryIsARedLineWithoutPassAndTheFailKeyEndsTheRun) {
    Handset h({kBattery, kCards});
    allow_hot_battery(h);
    start_run(h, "temperature 610");
    ASSERT_TRUE(h.waitActive(kCaption));
    ASSERT_TRUE(h.dut.waitLog("FTX_BATTERY: outside: Temperature 61.0 C above 45.0 C"));
    Png hot = h.shotWhen("battery_hot.png",
                         [](const Png &p) { return inLine(p, TEMPERATURE, red) > 50; });
    for (int line : {LEVEL, VOLTAGE, HEALTH, CHARGER}) {
        EXPECT_GT(inLine(hot, line, green), 50) << line;
        EXPECT_EQ(0, inLine(hot, line, red)) << line;
    }
    EXPECT_EQ(0, inLine(hot, TEMPERATURE, green));
    EXPECT_FALSE(pass_label(hot));
    EXPECT_TRUE(fail_label(hot));
    h.key(60);  // not offered: nothing happens
    h.key(61);
    ASSERT_TRUE(h.waitActive("Device Test"));
    EXPECT_EQ(2, h.result(344));
    // The fail ended the run before the window closed: nothing else opened.
    EXPECT_FALSE(has(h.dut.logcat(), kCardsOpened));
    EXPECT_FALSE(has(h.dut.logcat(), kPassed));
}

TEST(BatteryTest, TheItemsLimitsHoldTheWindowUntilTheVoltageComesBack) {
    Handset h({kBattery, kCards});
    h.dut.setConfig("FTX_BATTERY", "parameter", "MinVoltage:3600;MaxVoltage:4400");
    start_run(h, "voltage 3500");
    ASSERT_TRUE(h.waitActive(kCaption));
    ASSERT_TRUE(h.dut.waitLog("FTX_BATTERY: outside: Voltage 3500 mV below 3600 mV"));
    Png low =
        h.shotWhen("battery_low.png", [](const Png &p) { return inLine(p, VOLTAGE, red) > 50; });
    h.keepForDocs("battery_low.png", "battery_test.png");
    EXPECT_FALSE(pass_label(low));
    EXPECT_EQ(0, h.result(344));

    ASSERT_TRUE(h.dut.consoleOk("hw battery voltage 3900"));
    ASSERT_TRUE(h.dut.waitLog(kPassed));
    ASSERT_TRUE(h.dut.waitLog(kCardsOpened));
    EXPECT_EQ(1, h.result(344));
}

TEST(ChargePc, CloseStopsChargingUntilOpenAndTheTitleStripFollows) {
    Handset h({});
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.dut.waitChannel());
    const std::string charging = "TitleInfoShow begin,buf=Charging,index=0";
    const std::string notCharging = "TitleInfoShow begin,buf=Not charging,index=0";
    ASSERT_TRUE(h.dut.waitLog(charging));

    EXPECT_EQ(0, h.dut.pc("usbChargeMoudle testItem close").first);
    EXPECT_TRUE(has(h.dut.console("hw status"), "charging=disabled"));
    ASSERT_TRUE(h.dut.waitLog(notCharging));  // the observer's next round
    EXPECT_EQ("*0", h.dut.pc("batteryMoudle testItem charging").second);

    EXPECT_EQ(0, h.dut.pc("usbChargeMoudle testItem open").first);
    EXPECT_TRUE(has(h.dut.console("hw status"), "charging=enabled"));
    ASSERT_TRUE(h.dut.waitLogCount(charging, 2));
    EXPECT_EQ("*1", h.dut.pc("batteryMoudle testItem charging").second);

    // A switch the service refuses fails and changes nothing.
    ASSERT_TRUE(h.dut.consoleOk("hw set FTX_API_BatteryService_ChargingStatusSet -1"));
    EXPECT_EQ(2, h.dut.pc("usbChargeMoudle testItem close").first);
    EXPECT_TRUE(has(h.dut.console("hw status"), "charging=enabled"));
}

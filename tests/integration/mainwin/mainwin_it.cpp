// The real ftx-mmi, headless, in a private device root: start-up, the menu, the power key,
// dialogs, the bars and the idle rules, driven through the console and the PC port.
#include <gtest/gtest.h>
#include <unistd.h>

#include <chrono>
#include <filesystem>
#include <functional>
#include <string>

#include "support/device_under_test.h"

namespace fs = std::filesystem;

namespace {

// Makes the named library unloadable: an empty file of that name comes first on the
// library path (the build's own folder is the executable's run path, so a library
// cannot simply be left out).
void break_library(DeviceUnderTest &dut, const std::string &name) {
    std::string dir = dut.root() + "/brokenlibs";
    fs::create_directories(dir);
    dut.write("/brokenlibs/" + name, "");
    dut.setEnv("LD_LIBRARY_PATH", dir + ":" + DeviceUnderTest::buildDir() + "/lib");
}

bool in_order(const std::string &log, const std::vector<std::string> &lines) {
    size_t pos = 0;
    for (const auto &l : lines) {
        size_t p = log.find(l, pos);
        if (p == std::string::npos) {
            ADD_FAILURE() << "missing or out of order: " << l;
            return false;
        }
        pos = p + l.size();
    }
    return true;
}

// The dialog of the main window on 720x1280: 630 x 426 at (45, 427).
const char *const kDialogRect = "rect=45,427,675,853";
const char kDoModal[] = "1203 Dialog DoModal=1";
// The power key (scan code 1) going down and up, as the dialog's key hook logs it.
const char kDialogPowerDown[] = "1203 Dialog hookKeyProc enter,msg=16,wparam=1,";
const char kDialogPowerUp[] = "1203 Dialog hookKeyProc enter,msg=18,wparam=1,";

TEST(StartupTest, FullApplicationStartsInOrder) {
    for (const char *mode : {"normal", "", "unset", "ffbm-00"}) {
        SCOPED_TRACE(mode);
        DeviceUnderTest dut;
        if (std::string(mode) == "unset")
            dut.setProperty("ro.bootmode", "");  // an empty value reads as the default
        else
            dut.setProperty("ro.bootmode", mode);
        ASSERT_TRUE(dut.startToMenu());
        EXPECT_TRUE(in_order(
            dut.logcat(),
            {"DVK_FTX: main begin", "InitGUI end",
             "FTX_API_BatteryService_StartService begin =", "Start Battery Service successed",
             "mmi_CurrentWnd_ReadConfig", "g_ptScreenInfo.width= 720"}));
        EXPECT_TRUE(dut.exists("/cache/ftx/ftx.log"));
        // The PC channel answers.
        EXPECT_EQ(dut.pc("CloseDialog testItem start").first, 0);
    }
}

TEST(StartupTest, FactoryBootModeShowsOnlyTheNote) {
    for (const char *mode : {"ffbm-99", "ffbm-99x"}) {
        SCOPED_TRACE(mode);
        DeviceUnderTest dut;
        dut.setProperty("ro.bootmode", mode);
        ASSERT_TRUE(dut.start());
        ASSERT_TRUE(dut.waitConsole());
        ASSERT_TRUE(dut.waitLog("sys_language is english"));
        std::string log = dut.logcat();
        EXPECT_EQ(log.find("mmi_CurrentWnd_ReadConfig"), std::string::npos);  // no menu
        EXPECT_FALSE(dut.exists("/cache/ftx/ftx.log"));
        EXPECT_TRUE(dut.running());
    }
}

TEST(StartupTest, MissingFactoryLibraryEndsWith255BeforeAnyWindow) {
    DeviceUnderTest dut;
    break_library(dut, "lib_factory.so");
    ASSERT_TRUE(dut.start());
    EXPECT_EQ(dut.wait(10000), 255);
    std::string log = dut.logcat();
    EXPECT_NE(log.find("ftx_init_lib_factory_dll fail! main"), std::string::npos);
    EXPECT_EQ(log.find("InitGUI end"), std::string::npos);
    EXPECT_FALSE(dut.exists("/run/console.sock"));
}

TEST(StartupTest, MissingCoreDeviceLibraryEndsWith255AfterTheConfiguration) {
    DeviceUnderTest dut;
    break_library(dut, "libdvk_ncoredevice.so");
    ASSERT_TRUE(dut.start());
    EXPECT_EQ(dut.wait(10000), 255);
    std::string log = dut.logcat();
    EXPECT_TRUE(in_order(log, {"InitGUI end", "g_autoSleepTime",
                               "FATAL ERROR:ftx_init_libdvk_ncoredevice_dll fail! main"}));
    EXPECT_EQ(log.find("mmi_CurrentWnd_ReadConfig"), std::string::npos);
}

TEST(StartupTest, AgingMarkerKeepsTheChannelClosed) {
    DeviceUnderTest dut;
    dut.write("/cache/ftx/rebootAging.txt", "1\n");
    ASSERT_TRUE(dut.startToMenu());
    // The channel is started before the menu, when it is started at all.
    EXPECT_EQ(dut.logPos("AtThreadStart begin"), std::string::npos);
    EXPECT_EQ(dut.pc("CloseDialog testItem start").first, -1);
}

class RunningTest : public ::testing::Test {
  protected:
    void SetUp() override {
        dut_.setConfig("MAIN_UI", "aging", "");
        dut_.setConfig("MAIN_UI", "coupleTest", "1");
        dut_.setConfig("MAIN_UI", "signalCouple", "0");  // the coupling row opens nothing
        ASSERT_TRUE(dut_.startToMenu());
        // The first battery record has arrived (the title strip shows the charger).
        ASSERT_TRUE(dut_.waitLog("TitleInfoShow begin"));
    }
    std::string windows() { return dut_.console("windows"); }
    // Holds the power key until `until` holds (what the press must bring about), then lets
    // it go; false when that never came.
    bool holdPower(const std::function<bool()> &until) {
        if (!dut_.consoleOk("key down 1")) return false;
        bool seen = dut_wait_until(until, 10000);
        return dut_.consoleOk("key up 1") && seen;
    }
    DeviceUnderTest dut_;
};

TEST_F(RunningTest, MenuGeometryAndRows) {
    std::string w = windows();
    EXPECT_NE(w.find("rect=0,0,720,58 caption=\"batteryshow\""), std::string::npos) << w;
    EXPECT_NE(w.find("rect=0,1185,720,1280 caption=\"softkeybar\""), std::string::npos) << w;
    EXPECT_NE(w.find("rect=0,58,720,1185"), std::string::npos) << w;
    // Rows 96 high from the top of the main window: tap the middle of rows 3 and 4.
    ASSERT_TRUE(dut_.consoleOk("tap 300 " + std::to_string(58 + 96 * 3 + 48)));
    ASSERT_TRUE(dut_.waitLog("ScrollViewProc choose 3"));
    ASSERT_TRUE(dut_.consoleOk("tap 300 " + std::to_string(58 + 96 * 4 + 48)));
    ASSERT_TRUE(dut_.waitLog("ScrollViewProc choose 4"));
    EXPECT_EQ(dut_.logPos("ScrollViewProc choose 5"), std::string::npos);  // five rows only
    // Row 4 opened the aging result list; back leaves it for the menu.
    ASSERT_TRUE(dut_.waitLog("aging result list opened"));
    ASSERT_TRUE(dut_.consoleOk("key press 61"));
    ASSERT_TRUE(dut_wait_until(
        [&] {
            const std::string w = windows();
            return w.find("caption=\"Aging\"") == std::string::npos;
        },
        5000));
    // By keys: down then Enter chooses a row once more.
    ASSERT_TRUE(dut_.consoleOk("key press 108"));
    ASSERT_TRUE(dut_.consoleOk("key press 28"));
    EXPECT_TRUE(dut_.waitLogCount("ScrollViewProc choose", 3));
    std::string log = dut_.logcat();
    EXPECT_TRUE(in_order(log, {"mmi_CurrentWnd_ReadConfig,L", "g_bAgingTest=1."}));
}

TEST_F(RunningTest, ShortPowerKeyTogglesSleep) {
    // Down and up in one request: a short press however busy the machine is.
    ASSERT_TRUE(dut_.consoleOk("key press 1"));
    ASSERT_TRUE(dut_.waitLog("SetSleepStatus end"));
    EXPECT_EQ(dut_.read("/sys/class/leds/lcd-backlight/brightness"), "0");
    EXPECT_EQ(dut_.read("/sys/class/graphics/fb0/blank").substr(0, 1), "4");
    EXPECT_EQ(windows().find(kDialogRect), std::string::npos);
    ASSERT_TRUE(dut_.consoleOk("key press 1"));
    ASSERT_TRUE(dut_.waitLog("SetWakeupStatus end,ret=0"));
    EXPECT_EQ(dut_.read("/sys/class/leds/lcd-backlight/brightness"), "100");
}

TEST_F(RunningTest, LongPowerKeyAsksAndPowersOff) {
    ASSERT_TRUE(holdPower([&] { return dut_.logCount(kDoModal) == 1; }));
    EXPECT_NE(windows().find(kDialogRect), std::string::npos);
    // A second long press while the dialog is up opens nothing more: the dialog has the
    // keys. The key is held well past the long-press time, so a press that reached the
    // menu's hook would have acted by the time the dialog saw the key go up.
    auto start = std::chrono::steady_clock::now();
    ASSERT_TRUE(holdPower([&] {
        return dut_.logPos(kDialogPowerDown) != std::string::npos &&
               std::chrono::steady_clock::now() - start > std::chrono::milliseconds(1500);
    }));
    ASSERT_TRUE(dut_.waitLog(kDialogPowerUp));
    EXPECT_EQ(1u, dut_.logCount("CreateDialog enter"));
    EXPECT_EQ(0u, dut_.logCount("g_dialogcouldshow=0,thead_exit"));
    ASSERT_TRUE(dut_.consoleOk("key press 60"));
    EXPECT_EQ(dut_.wait(10000), 100);
    EXPECT_NE(dut_.logPos("mmi_PowerOffEntry begin"), std::string::npos);
}

TEST_F(RunningTest, PcClosesTheDialogAndTheSecondButtonKeepsRunning) {
    ASSERT_TRUE(holdPower([&] { return dut_.logCount(kDoModal) == 1; }));
    EXPECT_EQ(dut_.pc("CloseDialog testItem start").first, 0);
    EXPECT_TRUE(
        dut_wait_until([&] { return windows().find(kDialogRect) == std::string::npos; }, 5000));
    // Open again and answer with the second button (key 61): no power-off.
    ASSERT_TRUE(holdPower([&] { return dut_.logCount(kDoModal) == 2; }));
    EXPECT_NE(windows().find(kDialogRect), std::string::npos);
    ASSERT_TRUE(dut_.waitDialogTakesKeys());
    ASSERT_TRUE(dut_.consoleOk("key press 61"));
    EXPECT_TRUE(
        dut_wait_until([&] { return windows().find(kDialogRect) == std::string::npos; }, 5000));
    // The button's action runs on the GUI thread right after the dialog is gone.
    ASSERT_TRUE(dut_.waitLogCount("DestroyDialog end", 2));
    ASSERT_TRUE(dut_.consoleOk("idle 5000"));
    EXPECT_EQ(dut_.logPos("mmi_PowerOffEntry begin"), std::string::npos);
    EXPECT_TRUE(dut_.running());
}

TEST_F(RunningTest, BatteryTemperatureWarnsThenPowersOff) {
    ASSERT_TRUE(dut_.consoleOk("hw battery period 100"));
    ASSERT_TRUE(dut_.consoleOk("hw battery temperature 449"));
    ASSERT_TRUE(dut_.waitBatteryRounds(2));  // the application has seen 449 at least once
    EXPECT_EQ(dut_.logPos("battery Temperature Warning"), std::string::npos);
    ASSERT_TRUE(dut_.consoleOk("hw battery temperature 450"));
    EXPECT_TRUE(dut_.waitLog("battery Temperature Warning,current Temperature=450"));
    ASSERT_TRUE(dut_.consoleOk("hw battery temperature 600"));
    EXPECT_EQ(dut_.wait(10000), 100);
    EXPECT_NE(dut_.logPos("g_powerofftemp = 600"), std::string::npos);
}

// Idle rules with the times configured short and the clock scaled by FTX_TIME_SCALE 0.05:
// 20 s of idle sleep in 1 s, the power-off 30 s (1.5 s) after. The battery service calls
// once a (scaled) second, and every call runs the idle check, so 35 rounds after a fresh
// count are always past the turn-off time, however slowly the machine runs them.
const long kPastTurnOff = 35;

class IdleTest : public ::testing::Test {
  protected:
    void start(const std::string &osIdle) {
        dut_.setConfig("MMI", "batteryParameter",
                       "lowvolt_threshold:30;powerofftemp:600;OSIdle:" + osIdle +
                           ";OS_AutoSleepTime:20;OS_AutoTurnOffTime:30;sys_backlight:/sys/class/"
                           "leds/lcd-backlight/brightness");
        dut_.setEnv("FTX_TIME_SCALE", "0.05");
        ASSERT_TRUE(dut_.startToMenu());
    }
    void hw(const std::string &line) { ASSERT_TRUE(dut_.consoleOk("hw " + line)) << line; }
    DeviceUnderTest dut_;
};

TEST_F(IdleTest, SleepsThenPowersOffWhenNotCharging) {
    start("1");
    hw("charger none");
    hw("battery status 3");
    ASSERT_TRUE(dut_.waitLog("SetSleepStatus end", 15000));
    EXPECT_EQ(dut_.read("/sys/class/leds/lcd-backlight/brightness"), "0");
    EXPECT_EQ(dut_.wait(15000), 100);
    EXPECT_NE(dut_.logPos("AutoSleepCheck idle="), std::string::npos);
}

TEST_F(IdleTest, ChargingKeepsTheDeviceOnWithOrWithoutACharger) {
    start("1");
    hw("battery status 2");
    ASSERT_TRUE(dut_.waitLog("SetSleepStatus end", 15000));
    ASSERT_TRUE(dut_.waitBatteryRounds(kPastTurnOff));
    // Charging counts by itself, whatever the charger flags say.
    hw("charger none");
    ASSERT_TRUE(dut_.waitBatteryRounds(kPastTurnOff));
    EXPECT_EQ(dut_.logPos("AutoSleepCheck idle="), std::string::npos);
}

TEST_F(IdleTest, FullKeepsTheDeviceOnOnEachChargerAndTurnsOffWithoutOne) {
    start("1");
    hw("battery status 5");
    // One charger at a time; each line swaps them at once, so the charging state never
    // changes (a change would restart the idle count).
    for (const char *swap : {"ac 1 usb 0", "wireless 1 ac 0", "usb 1 wireless 0"}) {
        SCOPED_TRACE(swap);
        hw(std::string("charger ") + swap);
        ASSERT_TRUE(dut_.waitLog("SetSleepStatus end", 15000));
        ASSERT_TRUE(dut_.waitBatteryRounds(kPastTurnOff)) << "powered off";
    }
    EXPECT_EQ(dut_.logPos("AutoSleepCheck idle="), std::string::npos);
    // Full with no charger online is not charging: it turns off.
    hw("charger none");
    EXPECT_EQ(dut_.wait(15000), 100);
    EXPECT_NE(dut_.logPos("AutoSleepCheck idle="), std::string::npos);
}

TEST_F(IdleTest, OsIdleOffNeverSleeps) {
    start("0");
    hw("charger none");
    hw("battery status 3");
    ASSERT_TRUE(dut_.waitBatteryRounds(kPastTurnOff));
    EXPECT_EQ(dut_.logPos("SetSleepStatus"), std::string::npos);
    ASSERT_TRUE(dut_.consoleOk("key press 1"));
    EXPECT_TRUE(dut_.waitLog("cannot do idle,g_bOsIsCanIdle=0"));
}

}  // namespace

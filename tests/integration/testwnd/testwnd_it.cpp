// The real ftx-mmi, headless: the vibrator window from the device-test list, automatic runs
// with their summary items and restore files, the PC's vibrator, identity and battery
// commands, and screenshots checked by their pixels.
#include <stdio.h>

#include <chrono>
#include <string>

#include <gtest/gtest.h>

#include "support/handset.h"

using namespace handset;

namespace {

const Item kVibrator = {"FTX_VIBRATOR", 1, 0, 1};

// Milliseconds since midnight of the log line that holds text (logcat's "MM-DD
// HH:MM:SS.mmm" prefix), or -1.
long log_ms(const std::string &log, const std::string &text) {
    size_t p = log.find(text);
    if (p == std::string::npos) return -1;
    size_t line = log.rfind('\n', p);
    line = line == std::string::npos ? 0 : line + 1;
    int mon, day, hh, mm, ss, ms;
    if (sscanf(log.c_str() + line, "%d-%d %d:%d:%d.%d", &mon, &day, &hh, &mm, &ss, &ms) != 6)
        return -1;
    return ((hh * 60L + mm) * 60L + ss) * 1000L + ms;
}

TEST(TestWindow, PassLabelShowsOnlyAfterTheFoolProofDelay) {
    using Clock = std::chrono::steady_clock;
    const auto kDelay = std::chrono::milliseconds(3000);  // the vibrator's, at time scale 1
    Handset h({kVibrator}, 1.0);
    ASSERT_TRUE(h.start());
    h.openDeviceList();
    for (int i = 0; i < 4; i++)
        h.key(108);
    const Clock::time_point opened = Clock::now();  // the delay cannot begin before this
    h.key(28);
    ASSERT_TRUE(h.waitActive("Vibration Test"));
    ASSERT_TRUE(h.dut.waitLog("WaitForFoolProof begin"));

    // Screenshots one after the other until the pass label is there. A picture finished
    // before opened + 3 s, or before the thread logged the end of its sleep, was taken
    // inside the delay; those of its last second show what a 2 s delay would already
    // have shown.
    const char kSlept[] = "after sleep ,WaitForFoolProof";
    int inDelay = 0;
    Png last;
    bool shown = dut_wait_until(
        [&] {
            last = h.shot("vibrator.png");
            Clock::time_point done = Clock::now();
            bool slept = h.dut.logPos(kSlept) != std::string::npos;
            if (done < opened + kDelay || !slept) {
                inDelay++;
                EXPECT_FALSE(pass_label(last)) << "pass label inside the delay, shot " << inDelay;
                h.keepForDocs("vibrator.png", "vibrator_before_delay.png");
            }
            return pass_label(last);
        },
        15000);
    ASSERT_TRUE(shown) << "the pass label never came";
    ASSERT_GT(inDelay, 0);
    h.keepForDocs("vibrator.png", "vibrator_after_delay.png");
    // The thread's own log: the sleep between its first two lines is the whole delay.
    std::string log = h.dut.logcat();
    long slept = log_ms(log, kSlept) - log_ms(log, "WaitForFoolProof begin");
    if (slept < 0) slept += 24L * 3600 * 1000;  // midnight
    EXPECT_GE(slept, 2950);
    // Both labels now; the note is drawn in the window and the vibrator runs while it is open.
    EXPECT_TRUE(fail_label(last));
    EXPECT_GT(last.count(90, 100, 540, 180, light), 50);
    EXPECT_NE(std::string::npos,
              h.dut.console("hw status").find("ftx_api_Vibrator_Test_Start(ms=0) x1"));
}

TEST(TestWindow, KeysOutsideARunLeaveTheRecordAlone) {
    // Scaled so the 3 s delay lasts 12 s: both keys come long before it ends.
    Handset h({kVibrator}, 4.0);
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.fromList(4, "Vibration Test"));
    // Pass works at once, long before the 3 s delay; the delay thread is ended with it.
    h.key(60);
    ASSERT_TRUE(h.waitActive("Device Test"));
    EXPECT_EQ(1u, h.dut.logCount("mmi_testwnd_proc pass"));
    h.chooseRow(0);  // the list keeps its place on the vibrator row
    ASSERT_TRUE(h.waitActive("Vibration Test"));
    h.key(61);
    ASSERT_TRUE(h.waitActive("Device Test"));
    EXPECT_EQ(0, h.result(316));
    EXPECT_EQ(0, h.result(64));
    // Each key ended its window's delay thread before the delay was over.
    ASSERT_TRUE(h.dut.waitLogCount("WaitForFoolProof stopped", 2));
    EXPECT_EQ(0u, h.dut.logCount("after sleep ,WaitForFoolProof"));
    EXPECT_NE(std::string::npos,
              h.dut.console("hw status").find("ftx_api_Vibrator_Test_Stop() x2"));
}

TEST(Run, PassRecordsAndOpensTheNextItem) {
    Handset h({kVibrator, kCards});
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.fromList(0, "Vibration Test"));
    h.key(60);
    ASSERT_TRUE(h.dut.waitLog(kCardsOpened));
    EXPECT_EQ(1, h.result(316));
    EXPECT_EQ(0, h.result(64));  // a pass never touches the summary
}

TEST(Run, FailRecordsMarksTheSummaryAndEndsTheRun) {
    // With the pretest menu the fail also marks pretest 1's item 66 failed.
    for (const char *pretestMenu : {"0", "1"}) {
        SCOPED_TRACE(pretestMenu);
        Handset h({kVibrator, kCards});
        h.dut.setConfig("MMI", "pretest_menu_enable", pretestMenu);
        ASSERT_TRUE(h.start());
        ASSERT_TRUE(h.fromList(0, "Vibration Test"));
        h.key(61);
        // The summary item is written after the item itself, both before the window closes.
        ASSERT_TRUE(h.waitActive("Device Test"));
        EXPECT_EQ(2, h.result(316));
        EXPECT_EQ(2, h.result(64));
        EXPECT_EQ(std::string(pretestMenu) == "1" ? 2 : 0, h.result(66));
        EXPECT_EQ(0u, h.dut.logCount(kCardsOpened));
        // The run is over: the list takes choices again.
        h.chooseRow(0);
        ASSERT_TRUE(h.waitActive("Vibration Test"));
    }
}

TEST(Run, FullRunEndsWithThePreviewPassAndSwitchesTheMmiFlagOff) {
    // Three items: the vibrator runs, the SAR item is not automatic, the cards are
    // operator-judged and skipped while "mmi_flag" is 1.
    Handset h({kVibrator, {"FTX_SAR", 0, 0, 1}, {"FTX_CARDS", 1, 1, 1}});
    h.dut.setConfig("MMI", "mmi_flag", "1");
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.fromList(0, "Vibration Test"));
    h.key(60);
    ASSERT_TRUE(h.dut.waitLog("mmi_DeviceTest_Refresh open=1"));
    EXPECT_EQ(1, h.result(316));
    EXPECT_EQ(1, h.result(64));
    EXPECT_EQ(0, h.result(66));
    EXPECT_EQ(0u, h.dut.logCount(kCardsOpened));
    EXPECT_NE(std::string::npos, h.dut.read("/etc/ftx_config.ini").find("mmi_flag=0\r\n"));
    EXPECT_TRUE(h.waitActive("Device Test"));
}

TEST(Run, WithTheMmiFlagOffOperatorJudgedItemsRunToo) {
    Handset h({kVibrator, {"FTX_SAR", 0, 0, 1}, {"FTX_CARDS", 1, 1, 1}});
    h.dut.setConfig("MMI", "mmi_flag", "0");
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.fromList(0, "Vibration Test"));
    h.key(60);
    ASSERT_TRUE(h.dut.waitLog(kCardsOpened));
    EXPECT_EQ(1, h.result(316));
    EXPECT_EQ(0, h.result(64));  // the run did not reach its end
    EXPECT_NE(std::string::npos, h.dut.read("/etc/ftx_config.ini").find("mmi_flag=0\r\n"));
}

TEST(Run, PretestOneMarksSixtySixFailedUntilItsEndPretestTwoNeedsIt) {
    Handset h({kVibrator});
    ASSERT_TRUE(h.start());
    h.openDeviceList();
    // Pretest 2 first: refused, item 66 has not passed.
    h.chooseRow(3);
    ASSERT_TRUE(h.dut.waitLog("Autotest Pretest1 fails, can't run Pretest2."));
    EXPECT_EQ("Device Test", h.activeCaption());
    h.key(103);
    h.chooseRow(0);  // row 2: pretest 1
    ASSERT_TRUE(h.waitActive("Vibration Test"));
    EXPECT_EQ(2, h.result(66));
    h.key(60);
    EXPECT_TRUE(dut_wait_until([&] { return h.result(66) == 1; }, 5000));
    EXPECT_EQ(0, h.result(64));
}

TEST(Restore, RunResumesAfterTheLastPassAcrossAReboot) {
    Handset h({kVibrator, kCards});
    h.dut.setConfig("MMI", "restore_autotest", "1");
    ASSERT_TRUE(h.start());
    EXPECT_EQ("FIRST", h.dut.read("/data/pv_autotest_latest_pass"));
    ASSERT_TRUE(h.fromList(0, "Vibration Test"));
    h.key(60);
    ASSERT_TRUE(h.dut.waitLog(kCardsOpened));
    EXPECT_EQ("FTX_VIBRATOR", h.dut.read("/data/pv_autotest_latest_pass"));

    // The PC reboots the handset while the cards are due; the next start resumes there.
    EXPECT_EQ(0, h.dut.pc("RebootMoudle testItem close").first);
    EXPECT_EQ(101, h.dut.wait(5000));
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(dut_wait_until([&] { return h.dut.logCount(kCardsOpened) == 2; }, 5000));
    EXPECT_FALSE(h.dut.exists("/data/pv_autotest_restore_flag"));
    EXPECT_FALSE(h.dut.exists("/data/pv_autotest_latest_pass"));
}

TEST(Restore, AFailRemovesBothRestoreFiles) {
    Handset h({kVibrator, kCards});
    h.dut.setConfig("MMI", "restore_autotest", "1");
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.fromList(0, "Vibration Test"));
    h.dut.write("/data/pv_autotest_restore_flag", "");
    ASSERT_TRUE(h.dut.exists("/data/pv_autotest_latest_pass"));
    h.key(61);
    ASSERT_TRUE(h.waitActive("Device Test"));
    EXPECT_FALSE(h.dut.exists("/data/pv_autotest_restore_flag"));
    EXPECT_FALSE(h.dut.exists("/data/pv_autotest_latest_pass"));
}

TEST(Pc, VibratorIdentityBatteryAndDialog) {
    Handset h({kVibrator});
    ASSERT_TRUE(h.start());
    EXPECT_EQ(0, h.dut.pc("vibratorMoudle testItem open").first);
    EXPECT_NE(std::string::npos,
              h.dut.console("hw status").find("ftx_api_Vibrator_Test_Start(ms=-1) x1"));
    EXPECT_EQ(0, h.dut.pc("vibratorMoudle testItem close").first);
    EXPECT_NE(std::string::npos,
              h.dut.console("hw status").find("ftx_api_Vibrator_Test_Stop() x1"));

    EXPECT_TRUE(h.dut.consoleOk("hw battery level 57"));
    EXPECT_TRUE(dut_wait_until(
        [&] { return h.dut.pc("batteryMoudle testItem power").second == "*57"; }, 5000));
    auto imei = h.dut.pc("IMEIMoudle testItem read");
    EXPECT_EQ(0, imei.first);
    EXPECT_EQ("860000000000001", imei.second);
    EXPECT_EQ("*FTXSIM000001", h.dut.pc("barcodeMoudle testItem read").second);
    EXPECT_EQ("*FTX_SIM_V1.0.0", h.dut.pc("softwareMoudle testItem external").second);
    EXPECT_EQ(2, h.dut.pc("testinfoMoudle testItem").first);

    // A device that passed asks before a new run: the PC dismisses that question.
    h.setResult(64, 1);
    h.openDeviceList();
    h.chooseRow(0);
    ASSERT_TRUE(dut_wait_until([&] { return h.activeCaption() != "Device Test"; }, 5000));
    EXPECT_EQ(0, h.dut.pc("CloseDialog testItem start").first);
    EXPECT_TRUE(h.waitActive("Device Test"));
    // The dialog's answer is acted on by the GUI thread right after the dialog is gone.
    ASSERT_TRUE(h.dut.waitLog("DestroyDialog end"));
    ASSERT_TRUE(h.dut.consoleOk("idle 5000"));
    EXPECT_EQ(0u, h.dut.logCount("mmi_AutoTestEntry begin."));
}

TEST(Pc, StartClosesTheOpenTestWindowFirst) {
    Handset h({kVibrator});
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.fromList(4, "Vibration Test"));
    EXPECT_EQ(0, h.dut.pc("vibratorMoudle testItem open").first);
    EXPECT_TRUE(h.waitActive("Device Test"));
    std::string status = h.dut.console("hw status");
    EXPECT_NE(std::string::npos, status.find("ftx_api_Vibrator_Test_Stop() x1"));
    EXPECT_NE(std::string::npos, status.find("ftx_api_Vibrator_Test_Start(ms=-1) x2"));
}

TEST(Pc, ImeiThatDidNotComeIsAskedForAgain) {
    Handset h({kVibrator});
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.dut.consoleOk("hw testinfo off"));
    EXPECT_EQ(2, h.dut.pc("IMEIMoudle testItem read").first);  // after the 10 s wait, scaled
    ASSERT_TRUE(h.dut.consoleOk("hw testinfo on"));
    auto imei = h.dut.pc("IMEIMoudle testItem read");
    EXPECT_EQ(0, imei.first);
    EXPECT_EQ("860000000000001", imei.second);
}

TEST(DeviceList, ShowsEachItemInTheColourOfItsResultAfterARun) {
    // The SIM and SD rows hold results of other stations; the run passes the vibrator.
    Handset h({{"FTX_SIMCARD", 0, 0, 1}, {"FTX_SDCARD", 0, 0, 1}, kVibrator});
    ASSERT_TRUE(h.start());
    h.setResult(324, 2);
    h.setResult(360, 1);
    // Rows are 96 high below the 3-pixel line: 0 full run, 4 SIM, 5 SD, 6 vibrator.
    auto top = [](int r) { return 61 + 96 * r; };
    auto reds = [&](const Png &p, int r) { return p.count(0, top(r), 720, top(r + 1), red); };
    auto greens = [&](const Png &p, int r) { return p.count(0, top(r), 720, top(r + 1), green); };
    h.openDeviceList();
    Png first = h.shotWhen("device_test_list_before.png",
                           [&](const Png &p) { return reds(p, 4) > 50 && greens(p, 5) > 50; });
    EXPECT_EQ(0, greens(first, 6));  // before the run the vibrator row was untested
    EXPECT_EQ(0, greens(first, 0));
    h.chooseRow(0);
    ASSERT_TRUE(h.waitActive("Vibration Test"));
    h.key(60);
    // The end of the run refreshes the open list from the record.
    ASSERT_TRUE(h.dut.waitLog("mmi_DeviceTest_Refresh open=1"));
    ASSERT_TRUE(h.waitActive("Device Test"));
    Png list = h.shotWhen("device_test_list.png",
                          [&](const Png &p) { return greens(p, 6) > 50 && greens(p, 0) > 50; });
    EXPECT_GT(reds(list, 4), 50);
    EXPECT_EQ(0, greens(list, 4));
    EXPECT_GT(greens(list, 5), 50);
}

TEST(MonomerPreview, HardwareVersionShowsTheFirmwareAndHandsOverToTheNextItem) {
    // The preview list of the image: the hardware version, then the monomer LCD.
    Handset h({kVibrator});
    h.dut.setConfig("FTX_TPSELF", "enable", "0");
    ASSERT_TRUE(h.start());
    h.key(108);
    h.key(108);
    h.key(28);
    ASSERT_TRUE(h.waitActive("Hardware Version"));
    // The firmware text.
    h.shotWhen("monomer_hardware_version.png",
               [](const Png &p) { return p.count(90, 100, 630, 400, light) > 100; });
    h.key(60);
    EXPECT_TRUE(h.dut.waitLog("FTX_MONOMER_LCD: create_colour_window end"));
    EXPECT_EQ(0, h.result(64));  // the preview records nothing
}

TEST(InfoScreen, ShowsTheIdentityAndThePassedAndFailedItems) {
    Handset h({kVibrator});
    ASSERT_TRUE(h.start());
    h.setResult(316, 1);
    h.setResult(280, 2);
    ASSERT_TRUE(h.fromList(1, "Product Information"));
    // Lines 56 high from y 61: 5 the IMEI (value on the right), 7 item 64 failed by the
    // fail of 280, 8 item 280 (red), 9 item 316 (green), nothing after.
    auto top = [](int r) { return 61 + 56 * r; };
    // The IMEI arrives through the library's callback, after the screen opened; the screen
    // then rebuilds.
    Png info = h.shotWhen("product_information.png", [&](const Png &p) {
        return p.count(400, top(5), 700, top(6), light) > 50;
    });
    EXPECT_GT(info.count(0, top(7), 720, top(8), red), 50);
    EXPECT_GT(info.count(0, top(8), 720, top(9), red), 50);
    EXPECT_GT(info.count(0, top(9), 720, top(10), green), 50);
    EXPECT_EQ(0, info.count(0, top(10), 720, top(11), green));
    h.key(61);
    EXPECT_TRUE(h.waitActive("Device Test"));
}

}  // namespace

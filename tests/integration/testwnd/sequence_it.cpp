// The real ftx-mmi, headless: the device-test list follows the record while it is open,
// every way a run ends leaves the list taking choices, and a resume that finds nothing to
// resume records nothing.
#include <string>

#include <gtest/gtest.h>

#include "support/handset.h"

using namespace handset;

namespace {

const Item kVibrator = {"FTX_VIBRATOR", 1, 0, 1};
const char kRefused[] = "device autotest running,please exit autotest.";

// The device-test list on 720x1280: rows 96 high below the 3-pixel line; 0 the full run
// (item 64), 3 pretest 2 (item 64), 4 the vibrator (item 316).
int rowTop(int row) {
    return 61 + 96 * row;
}
int greens(const Png &p, int row) {
    return p.count(0, rowTop(row), 720, rowTop(row + 1), green);
}
int reds(const Png &p, int row) {
    return p.count(0, rowTop(row), 720, rowTop(row + 1), red);
}
bool passShown(const Png &p, int row) {
    return greens(p, row) > 50 && reds(p, row) == 0;
}
bool failShown(const Png &p, int row) {
    return reds(p, row) > 50 && greens(p, row) == 0;
}

TEST(DeviceList, RedrawsWhenTheRecordChangesWhileItIsOpen) {
    Handset h({kVibrator});
    ASSERT_TRUE(h.start());
    h.setResult(316, 1);
    h.setResult(64, 1);
    h.openDeviceList();
    h.shotWhen("list_passed.png",
               [](const Png &p) { return passShown(p, 0) && passShown(p, 3) && passShown(p, 4); });

    // A PC write while the list is in front: the fail of 316 fails the preview item too.
    h.setResult(316, 2);
    h.shotWhen("list_pc_fail.png",
               [](const Png &p) { return failShown(p, 0) && failShown(p, 3) && failShown(p, 4); });
    h.setResult(316, 1);
    h.setResult(64, 1);
    h.shotWhen("list_pc_pass.png", [](const Png &p) { return passShown(p, 0) && passShown(p, 4); });

    // A run that fails. The unit passed before, so the run asks first; the down key is the
    // one-button dialog's yes.
    h.chooseRow(0);
    ASSERT_TRUE(h.dut.waitLog("1203 Dialog DoModal=1"));
    ASSERT_TRUE(h.dut.waitDialogTakesKeys());
    h.key(108);
    ASSERT_TRUE(h.waitActive("Vibration Test"));
    h.key(61);
    ASSERT_TRUE(h.waitActive("Device Test"));
    h.shotWhen("list_after_fail.png",
               [](const Png &p) { return failShown(p, 0) && failShown(p, 4); });
    EXPECT_EQ(2, h.result(316));
    EXPECT_EQ(2, h.result(64));
}

TEST(RunEnd, AFullRunWithNothingToRunLeavesTheListTakingChoices) {
    // The only item does not take part in automatic runs.
    Handset h({{"FTX_VIBRATOR", 0, 0, 1}});
    ASSERT_TRUE(h.start());
    h.openDeviceList();
    h.chooseRow(0);
    // The entry finds nothing to open before it returns.
    ASSERT_TRUE(h.dut.waitLog(": no item to run"));
    EXPECT_EQ("Device Test", h.activeCaption());
    h.chooseRow(4);
    EXPECT_TRUE(h.waitActive("Vibration Test"));
    EXPECT_EQ(std::string::npos, h.dut.logPos(kRefused));
    EXPECT_EQ(0, h.result(64));
}

TEST(RunEnd, APcStartThatClosesTheRunsWindowEndsTheRun) {
    Handset h({kVibrator, kCards});
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.fromList(0, "Vibration Test"));
    EXPECT_EQ(0, h.dut.pc("vibratorMoudle testItem open").first);
    ASSERT_TRUE(h.waitActive("Device Test"));
    EXPECT_EQ(0, h.dut.pc("vibratorMoudle testItem close").first);
    // The list takes a choice again; the window it opens is outside any run.
    h.chooseRow(4);
    ASSERT_TRUE(h.waitActive("Vibration Test"));
    EXPECT_EQ(std::string::npos, h.dut.logPos(kRefused));
    h.key(60);
    ASSERT_TRUE(h.waitActive("Device Test"));
    // A pass in a run would record and open the next item after its window closed, on the
    // GUI thread.
    ASSERT_TRUE(h.dut.consoleOk("idle 5000"));
    EXPECT_EQ(0, h.result(316));
    EXPECT_EQ(std::string::npos, h.dut.logPos(kCardsOpened));
}

// The resume file as a power cut between truncation and write leaves it, or naming an item
// that is no longer enabled.
TEST(Restore, AResumeThatFindsNoItemRecordsNothing) {
    for (const char *left : {"", "FTX_SAR"}) {
        SCOPED_TRACE(left);
        Handset h({kVibrator, kCards});
        h.dut.setConfig("MMI", "restore_autotest", "1");
        h.dut.write("/data/pv_autotest_latest_pass", left);
        // The resume is done before the menu takes input.
        ASSERT_TRUE(h.start());
        ASSERT_NE(std::string::npos, h.dut.logPos("mmi_startNextItemTest chdomain="));
        EXPECT_EQ(0, h.result(64));
        EXPECT_EQ(0, h.result(66));
        EXPECT_FALSE(h.dut.exists("/data/pv_autotest_restore_flag"));
        EXPECT_EQ(std::string::npos, h.dut.logPos(kCardsOpened));
        // Nothing runs: the list starts a run of its own, whose pass is kept whole.
        ASSERT_TRUE(h.fromList(0, "Vibration Test"));
        h.key(60);
        ASSERT_TRUE(h.dut.waitLog(kCardsOpened));
        EXPECT_EQ("FTX_VIBRATOR", h.dut.read("/data/pv_autotest_latest_pass"));
        EXPECT_FALSE(h.dut.exists("/data/pv_autotest_latest_pass.tmp"));
    }
}

}  // namespace

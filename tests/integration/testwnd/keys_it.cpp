// The real ftx-mmi, headless: the key test as the operator runs it, as the PC and the PCBA
// run drive it, and the headset hook-key test fed by the simulated library.
#include <string>
#include <thread>

#include <gtest/gtest.h>

#include "support/handset.h"

using namespace handset;

namespace {

const Item kKeys = {"FTX_KEYS", 1, 0, 1};
const Item kHook = {"FTX_HOOKKEY", 1, 0, 1};
const char kKeysOpened[] = "FTX_KEYS: key_proc::MSG_CREATE g_currentwndCreated=1";

// The key list of a 720x1280 screen: the window starts at 720/15 + 10, the list at
// (720/15) * 3 + 30 inside it, one row twice the window font (36) high.
const int kListTop = 58 + 174;
const int kRowHeight = 72;

int redInRow(const Png &p, int row) {
    const int top = kListTop + row * kRowHeight;
    return p.count(0, top, 720, top + kRowHeight, red);
}

// No window of that caption is left.
bool closed(Handset &h, const std::string &caption) {
    return dut_wait_until(
        [&] {
            return h.dut.console("windows").find("caption=\"" + caption + "\"") ==
                   std::string::npos;
        },
        5000);
}

void press(Handset &h, const std::string &action, const std::string &key) {
    EXPECT_TRUE(h.dut.consoleOk("key " + action + " " + key));
}

}  // namespace

TEST(KeyTest, EachListedKeyPassesOnItsPressAndReleaseAndPassRecordsTheRun) {
    Handset h({kKeys, kCards});
    h.dut.setConfig("FTX_KEYS", "parameter", "VOLUME_UP:1;VOLUME_DOWN:1;POWER:1;HOME:1;BACK:0");
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.dut.waitChannel());
    h.openDeviceList();
    h.chooseRow(0);
    ASSERT_TRUE(h.waitActive("Key Test"));
    Png four = h.shotWhen("keys_four.png", [](const Png &p) { return redInRow(p, 3) > 50; });
    for (int row = 0; row < 4; row++)
        EXPECT_GT(redInRow(four, row), 50) << row;
    EXPECT_EQ(0, redInRow(four, 4));
    EXPECT_FALSE(pass_label(four));

    // Held: volume up stays listed, and volume down cannot start while it is held.
    press(h, "down", "volume-up");
    press(h, "down", "volume-down");
    ASSERT_TRUE(h.dut.waitLog("CheckKeyisDown,L610::key VOLUME_UP DownUp status fail."));
    ASSERT_TRUE(h.dut.consoleOk("idle"));
    EXPECT_GT(redInRow(h.shot("keys_held.png"), 0), 50);
    press(h, "up", "volume-up");
    Png half = h.shotWhen("keys_half.png", [](const Png &p) { return redInRow(p, 0) == 0; });
    h.keepForDocs("keys_half.png", "keys_test.png");
    EXPECT_GT(redInRow(half, 1), 50);  // its press was refused: still to do
    // The pass key does nothing while keys are left.
    h.key(60);
    press(h, "press", "volume-down");
    press(h, "press", "power");
    ASSERT_TRUE(h.dut.consoleOk("idle"));
    EXPECT_TRUE(h.waitActive("Key Test"));
    press(h, "press", "home");
    Png done = h.shotWhen("keys_done.png", pass_label);
    for (int row = 0; row < 4; row++)
        EXPECT_EQ(0, redInRow(done, row)) << row;
    h.key(60);
    ASSERT_TRUE(h.dut.waitLog(kCardsOpened));
    EXPECT_EQ(1, h.result(312));
}

TEST(KeyTest, NoConfiguredKeyOpensNothing) {
    Handset h({kKeys, kCards});
    h.dut.setConfig("FTX_KEYS", "parameter", "VOLUME_UP:0;POWER:0");
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.dut.waitChannel());
    h.openDeviceList();
    h.chooseRow(4);
    ASSERT_TRUE(h.dut.waitLog("FTX_KEYS: no test key is exist"));
    EXPECT_TRUE(h.waitActive("Device Test"));
}

TEST(KeyTest, TheFailKeyFailsTheRun) {
    Handset h({kKeys, kCards});
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.dut.waitChannel());
    h.openDeviceList();
    h.chooseRow(0);
    ASSERT_TRUE(h.waitActive("Key Test"));
    h.key(61);
    ASSERT_TRUE(h.waitActive("Device Test"));
    EXPECT_EQ(2, h.result(312));
    EXPECT_FALSE(h.dut.waitLog(kCardsOpened, 300));
}

TEST(KeyPc, CloseAnswersThePendingKeysOrThePressedOnes) {
    Handset h({kKeys});  // the image's keys: volume up, volume down, power
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.dut.waitChannel());
    auto none = h.dut.pc("keyboardMoudle testItem close");
    EXPECT_EQ(2, none.first);
    EXPECT_EQ("nothing opened", none.second);

    ASSERT_EQ(0, h.dut.pc("keyboardMoudle testItem open").first);
    press(h, "press", "volume-up");
    press(h, "press", "power");
    ASSERT_TRUE(h.dut.consoleOk("idle"));
    auto pending = h.dut.pc("keyboardMoudle testItem close");
    EXPECT_EQ(2, pending.first);
    EXPECT_EQ("114", pending.second);  // volume down's reported code
    EXPECT_EQ(0, h.result(312));       // the PC's verdict is not recorded

    ASSERT_EQ(0, h.dut.pc("keyboardMoudle testItem open").first);
    for (const char *k : {"power", "volume-down", "volume-up", "power"})
        press(h, "press", k);
    ASSERT_TRUE(h.dut.consoleOk("idle"));
    auto passed = h.dut.pc("keyboardMoudle testItem close");
    EXPECT_EQ(0, passed.first);
    EXPECT_EQ("116,114,115,116", passed.second);
    EXPECT_TRUE(closed(h, "Key Test"));
}

TEST(KeyPcba, FailsAfterItsTimeOutAndPassesOnVolumeAndPower) {
    Handset h({kKeys}, 0.1);
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.dut.waitChannel());
    EXPECT_EQ(2, h.dut.pc("KeyPCBA testItem start").first);
    ASSERT_TRUE(h.dut.waitLog("PCBAKeyTestStart::all keys done=0"));
    EXPECT_TRUE(closed(h, "Key Test"));

    std::pair<int, std::string> answer;
    std::thread pc([&] { answer = h.dut.pc("KeyPCBA testItem start"); });
    ASSERT_TRUE(h.dut.waitLogCount(kKeysOpened, 2));
    for (const char *k : {"volume-up", "volume-down", "power"})
        press(h, "press", k);
    pc.join();
    EXPECT_EQ(0, answer.first);
    EXPECT_TRUE(h.dut.waitLog("PCBAKeyTestStart::all keys done=1"));
    EXPECT_EQ(0, h.dut.pc("KeyPCBA testItem stop").first);
}

TEST(HookKey, TheLibrarysPressPassesTheTestForTheOperatorAndThePc) {
    Handset h({kHook});
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.dut.waitChannel());
    ASSERT_EQ(0, h.dut.pc("headsethookMoudle testItem open").first);
    ASSERT_TRUE(h.waitActive("Hook Key Test"));
    EXPECT_EQ(2, h.dut.pc("headsethookMoudle testItem close").first);

    ASSERT_EQ(0, h.dut.pc("headsethookMoudle testItem open").first);
    Png pending = h.shotWhen("hook_pending.png", [](const Png &p) {
        return p.count(0, kListTop, 720, kListTop + kRowHeight, red) > 50;
    });
    EXPECT_FALSE(pass_label(pending));
    ASSERT_TRUE(h.dut.consoleOk("hw hook press"));
    ASSERT_TRUE(h.dut.consoleOk("hw hook release"));
    Png pressed = h.shotWhen("hook_pressed.png", pass_label);
    EXPECT_GT(pressed.count(0, kListTop, 720, kListTop + kRowHeight, green), 50);
    auto answer = h.dut.pc("headsethookMoudle testItem close");
    EXPECT_EQ(0, answer.first);
    EXPECT_EQ("*1", answer.second);  // the library's count of presses

    // The operator's window closes on its own once the hook key was pressed.
    h.openDeviceList();
    h.chooseRow(4);
    ASSERT_TRUE(h.waitActive("Hook Key Test"));
    ASSERT_TRUE(h.dut.consoleOk("hw hook press"));
    h.shotWhen("hook_operator.png", pass_label);
    h.key(60);
    EXPECT_TRUE(h.waitActive("Device Test")) << h.dut.console("windows");
}

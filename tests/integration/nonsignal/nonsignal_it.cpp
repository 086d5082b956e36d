// The real ftx-mmi, headless: the non-signalling coupling test opened from the main menu's
// coupling row as an operator does. The RF model's record shows every enabled technology
// stepped through its bands and channels in order; a level inside the limits passes and
// one outside fails (red on screen, fail in the result record); a failing library call
// fails its steps; a missing operation opens no window; back stops the run and closes the
// test mode and the library.
#include <stdlib.h>

#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "support/handset.h"

using namespace handset;

namespace {

const char kCaption[] = "Non-signalling Coupling";
const char kFinishedPass[] = "FTX_NONSIGNAL: run finished: PASS";
const char kFinishedFail[] = "FTX_NONSIGNAL: run finished: FAIL";
const char kClosed[] = "FTX_NONSIGNAL: window closed";

// A technology's settings key, result item and the model's requests for the image's bands
// and channels.
struct Tech {
    const char *key;
    int item;
    const char *requests;
};
const Tech kImageTechs[] = {
    {"LTE", 38,
     "tech=LTE band=1 channel=300 txon=23.0 txoff band=3 channel=1575 txon=23.0 txoff band=7 "
     "channel=3100 txon=23.0 txoff"},
    {"GSM", 6,
     "tech=GSM band=900 channel=62 txon=30.0 txoff band=1800 channel=698 txon=30.0 txoff"},
    {"CDMA2000", 18, "tech=CDMA2000 band=0 channel=384 txon=24.0 txoff"},
    {"WCDMA", 26,
     "tech=WCDMA band=1 channel=10700 txon=24.0 txoff band=8 channel=3013 txon=24.0 txoff"},
    {"TDSCDMA", 30,
     "tech=TDSCDMA band=34 channel=10087 txon=24.0 txoff band=39 channel=9500 txon=24.0 txoff"},
};

// The handset with only the non-signalling test behind the coupling row; the image's
// technologies unless a test changes them.
struct NonSignal : ::testing::Test {
    Handset h{std::initializer_list<Item>{}};
    NonSignal() {
        h.dut.setConfig("MAIN_UI", "coupleTest", "1");
        h.dut.setConfig("MAIN_UI", "signalCouple", "0");
        h.dut.setConfig("FTX_NONSIGNAL", "enable", "1");
    }
    void only(const std::string &key, const std::string &parameter) {
        for (const Tech &t : kImageTechs)
            h.dut.setConfig("FTX_NONSIGNAL", t.key, key == t.key ? parameter : "enable:0");
    }
    std::string hw(const std::string &line) {
        const std::string r = h.dut.console("hw " + line);
        EXPECT_NE(std::string::npos, r.find("OK")) << line << ": " << r;
        return r;
    }
    // The main menu's third row, the coupling row.
    void openFromMenu() {
        for (int i = 0; i < 3; i++)
            h.key(108);
        h.key(28);
    }
    void start() {
        ASSERT_TRUE(h.start());
        openFromMenu();
        ASSERT_TRUE(h.waitActive(kCaption));
    }
    // The model's line of the settings requested since the test mode opened.
    std::string requested() {
        const std::string s = hw("status");
        const size_t a = s.find("rf requested:");
        if (a == std::string::npos) return "";
        const size_t e = s.find('\n', a);
        std::string line = s.substr(a + 14, e - a - 14);
        while (!line.empty() && line.back() == '\r')
            line.pop_back();
        return line;
    }
    std::string rfState() {
        const std::string s = hw("status");
        const size_t a = s.find("rf: ");
        return a == std::string::npos ? "" : s.substr(a, s.find('\n', a) - a);
    }
};

bool has(const std::string &s, const std::string &part) {
    return s.find(part) != std::string::npos;
}

// The window's lines of coloured text, top to bottom: 'g' green, 'r' red (a run of pixel
// rows holding either; the 3-pixel line along the window's top edge is left out).
std::string coloured_lines(const Png &p) {
    std::string lines;
    char last = 0;
    for (int y = 64; y < 1185; y++) {
        const int g = p.count(0, y, p.w, y + 1, green);
        const int r = p.count(0, y, p.w, y + 1, red);
        const char c = r > 0 ? 'r' : g > 0 ? 'g' : 0;
        if (c != 0 && c != last) lines += c;
        last = c;
    }
    return lines;
}

TEST_F(NonSignal, StepsThroughEveryTechnologyInOrderAndRecordsEachPass) {
    start();
    ASSERT_TRUE(h.dut.waitLog(kFinishedPass));
    std::string expected;
    for (const Tech &t : kImageTechs)
        expected += std::string(expected.empty() ? "" : " ") + t.requests;
    EXPECT_EQ(expected, requested());
    for (const Tech &t : kImageTechs)
        EXPECT_EQ(1, h.result(t.item)) << t.key;
    const std::string state = rfState();
    EXPECT_TRUE(has(state, "testmode=off tech=TDSCDMA band=39 channel=9500 tx=off")) << state;
    EXPECT_TRUE(has(state, "library=loaded")) << state;
    // The overall verdict band and every row green.
    // The verdict band and the 15 rows (5 technologies, 10 steps).
    const std::string allGreen(16, 'g');
    const Png p = h.shotWhen("nonsignal_pass.png",
                             [&](const Png &s) { return coloured_lines(s) == allGreen; });
    EXPECT_EQ(allGreen, coloured_lines(p));
}

TEST_F(NonSignal, LevelOutsideTheLimitsFailsItsStepInRedAndItsTechnology) {
    // GSM on one band only, so exactly one step fails; the tester's GSM level is too low.
    h.dut.setConfig("FTX_NONSIGNAL", "GSM",
                    "enable:1;band:900;channel:62;power:30;min:-80;max:-40");
    ASSERT_TRUE(h.start());
    hw("rf level GSM -95.5");
    hw("rf level LTE -80");  // on the limit: passes
    openFromMenu();
    ASSERT_TRUE(h.waitActive(kCaption));
    ASSERT_TRUE(h.dut.waitLog(kFinishedFail));
    EXPECT_TRUE(h.dut.waitLog("FTX_NONSIGNAL: GSM band 900 channel 62: fail level -95.5"));
    for (const Tech &t : kImageTechs)
        EXPECT_EQ(t.item == 6 ? 2 : 1, h.result(t.item)) << t.key;
    // Red: the verdict band, the GSM row and its step; green: every other row (LTE's header
    // and three steps before, then CDMA2000, WCDMA and TD-SCDMA with their steps).
    const std::string expected = "rggggrrgggggggg";
    const Png p = h.shotWhen("nonsignal_coupling.png",
                             [&](const Png &s) { return coloured_lines(s) == expected; });
    EXPECT_EQ(expected, coloured_lines(p));
}

TEST_F(NonSignal, FailingCallFailsItsStepsAndLeavesTheTransmitterOff) {
    only("LTE", "enable:1;band:1,3;channel:300/150,1575;power:22.5;min:-70;max:-50");
    ASSERT_TRUE(h.start());
    hw("rf fail txon");
    openFromMenu();
    ASSERT_TRUE(h.waitActive(kCaption));
    ASSERT_TRUE(h.dut.waitLog(kFinishedFail));
    EXPECT_EQ(
        "tech=LTE band=1 channel=300 txon=22.5(failed) channel=150 txon=22.5(failed) "
        "band=3 channel=1575 txon=22.5(failed)",
        requested());
    EXPECT_EQ(3u, h.dut.logCount("FTX_API_NonSignal_txOn ret=-1"));
    EXPECT_EQ(2, h.result(38));
    EXPECT_TRUE(has(rfState(), "testmode=off")) << rfState();
    // Once the call works again the next run passes.
    hw("rf ok txon");
    h.key(61);
    ASSERT_TRUE(h.dut.waitLog(kClosed));
    ASSERT_TRUE(dut_wait_until([&] { return h.activeCaption() != kCaption; }, 5000));
    h.key(28);  // the menu's cursor stayed on the coupling row
    ASSERT_TRUE(h.waitActive(kCaption));
    ASSERT_TRUE(h.dut.waitLog(kFinishedPass));
    EXPECT_EQ(1, h.result(38));
}

TEST_F(NonSignal, TestModeThatCannotOpenFailsEveryTechnology) {
    only("WCDMA", "enable:1;band:1;channel:10700");
    ASSERT_TRUE(h.start());
    hw("rf fail open");
    openFromMenu();
    ASSERT_TRUE(h.waitActive(kCaption));
    ASSERT_TRUE(h.dut.waitLog(kFinishedFail));
    EXPECT_EQ(2, h.result(26));
    EXPECT_EQ(0, h.result(38));  // not enabled: untouched
    EXPECT_EQ(0u, h.dut.logCount("FTX_API_NonSignal_setTech"));
}

TEST_F(NonSignal, MissingOperationOpensNoWindow) {
    const std::string lib = DeviceUnderTest::buildDir() + "/lib";
    h.dut.setEnv("LD_LIBRARY_PATH", lib + "/variants/no_nonsignal_getRxLevel:" + lib);
    ASSERT_TRUE(h.start());
    openFromMenu();
    ASSERT_TRUE(h.dut.waitLog("FATAL ERROR: could not dlsym FTX_API_NonSignal_getRxLevel"));
    EXPECT_NE(kCaption, h.activeCaption());
    EXPECT_TRUE(has(rfState(), "library=unloaded")) << rfState();
    EXPECT_EQ(0u, h.dut.logCount("FTX_NONSIGNAL: worker begin"));
}

TEST_F(NonSignal, BackDuringTheRunStopsTheWorkerAndClosesTheLibrary) {
    ASSERT_TRUE(h.start());
    hw("rf delay 2000");  // every setting takes 0.5 s
    openFromMenu();
    ASSERT_TRUE(h.waitActive(kCaption));
    ASSERT_TRUE(h.dut.waitLog("LTE: FTX_API_NonSignal_setTech ret=0"));
    h.key(61);  // "Back"
    ASSERT_TRUE(h.dut.waitLog(kClosed));
    EXPECT_TRUE(h.dut.waitLog("FTX_NONSIGNAL: run finished: stopped"));
    const std::string log = h.dut.logcat();
    EXPECT_LT(log.find("FTX_NONSIGNAL: worker stopped"), log.find("lib_dvk_nonsignal.so closed"));
    const std::string state = rfState();
    EXPECT_TRUE(has(state, "library=unloaded testmode=off")) << state;
    EXPECT_TRUE(has(state, "tx=off")) << state;
    EXPECT_FALSE(has(requested(), "tech=GSM")) << requested();
    EXPECT_EQ(0, h.result(38));  // a stopped technology records nothing
    EXPECT_NE(kCaption, h.activeCaption());
}

}  // namespace

// With both coupling tests enabled the coupling row offers a list of the two; its second
// row opens the non-signalling test.
TEST_F(NonSignal, BothEnabledTheCouplingRowListsThem) {
    h.dut.setConfig("MAIN_UI", "signalCouple", "1");
    ASSERT_TRUE(h.start());
    openFromMenu();
    ASSERT_TRUE(h.waitActive("Coupling"));
    EXPECT_TRUE(h.dut.waitLog("mmi_testwnd_Coupling_Entry::2 coupling test(s) enabled"));
    h.key(108);
    h.key(28);
    ASSERT_TRUE(h.waitActive(kCaption));
}

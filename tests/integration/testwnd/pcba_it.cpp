// The real ftx-mmi, headless: the PCBA run from the PC. Every board check answers with the
// model's built-in event and its value reply, fails on a failing event or on silence (after
// its time-out), ends the check before it when started over it, and shows its verdict.
#include <filesystem>
#include <iterator>
#include <string>

#include <gtest/gtest.h>

#include "support/handset.h"
#include "support/text.h"

using namespace handset;

namespace {

// A board check that answers through an event: its command word, its library start and
// stop, its event and the value reply of the model's default event.
struct EventCheck {
    const char *word;
    const char *op;  // without "_start" / "_stop"
    int event;
    const char *reply;
};
const EventCheck kEventChecks[] = {
    {"Cpu", "ftx_api_cpu", 110, "maxfreq=2000000"},
    {"Memory", "ftx_api_memory", 111, "MemTotal=4096 MB"},
    {"Bluetooth", "ftx_api_bluetooth", 113, ""},
    {"Battery", "ftx_api_battery", 114, ""},
    {"Wifi", "ftx_api_wifi", 115, ""},
    {"Fm", "ftx_api_fm", 116, ""},
    {"Gps", "ftx_api_gps", 117, ""},
    {"Touch", "ftx_api_touch", 122, ""},
    {"Storage", "ftx_api_storage", 119, "TotalSize=64 GB"},
    {"Sdcard", "ftx_api_sdcard", 120, "TotalSize=30436 MB"},
    {"Sim", "ftx_api_sim", 121, ""},
};

std::string start(const EventCheck &c) {
    return std::string(c.word) + "PCBA testItem start";
}
std::string stop(const char *word) {
    return std::string(word) + "PCBA testItem stop";
}

std::pair<int, std::string> answer(int result, const std::string &reply) {
    return {result, reply};
}

struct Pcba : ::testing::Test {
    Handset h{{}, 0.02};
    void SetUp() override {
        ASSERT_TRUE(h.start());
        ASSERT_TRUE(h.dut.waitChannel());
    }
    std::string status() { return h.dut.console("hw status"); }
    // The library calls of "hw status", without the counters that move on their own.
    std::string calls() {
        const std::string s = status();
        return s.substr(s.find("calls:"));
    }
    bool shows(const std::string &name) {
        return dut_wait_until([&] { return h.activeCaption() == name; }, 5000);
    }
};

TEST_F(Pcba, EveryCheckPassesOnTheBoardsOwnAnswerWithItsValueAndStopsOnItsStop) {
    for (const EventCheck &c : kEventChecks) {
        SCOPED_TRACE(c.word);
        EXPECT_EQ(answer(0, c.reply), h.dut.pc(start(c)));
        EXPECT_TRUE(has(status(), std::string(c.op) + "_start(cb="));
        EXPECT_EQ("PCBA Test", h.activeCaption());
        EXPECT_EQ(0, h.dut.pc(stop(c.word)).first);
        EXPECT_TRUE(has(status(), std::string(c.op) + "_stop()"));
        EXPECT_NE("PCBA Test", h.activeCaption());
    }
    // A stop with nothing running answers at once and calls nothing.
    const std::string before = calls();
    EXPECT_EQ(answer(0, ""), h.dut.pc("CpuPCBA testItem stop"));
    EXPECT_EQ(before, calls());
}

TEST_F(Pcba, AFailingEventFailsEveryCheckAndStillTellsItsValue) {
    for (const EventCheck &c : kEventChecks) {
        SCOPED_TRACE(c.word);
        ASSERT_TRUE(h.dut.consoleOk("hw reply " + std::string(c.op) + "_start " +
                                    std::to_string(c.event) + " 1024,0"));
        const auto r = h.dut.pc(start(c));
        EXPECT_EQ(2, r.first);
        if (c.reply[0] != '\0') {
            EXPECT_TRUE(has(r.second, "1024")) << r.second;
        }
    }
    // An unreadable report is a fail too, and the log says what came.
    ASSERT_TRUE(h.dut.consoleOk("hw reply ftx_api_cpu_start 110 fast"));
    EXPECT_EQ(answer(2, ""), h.dut.pc("CpuPCBA testItem start"));
    EXPECT_TRUE(h.dut.waitLog("unreadable report \"fast\""));
    // The event of another check does not answer this one.
    ASSERT_TRUE(h.dut.consoleOk("hw reply ftx_api_gps_start 110 5,1"));
    EXPECT_EQ(2, h.dut.pc("GpsPCBA testItem start").first);
    EXPECT_TRUE(h.dut.waitLog("event 110 ignored (test 10)"));
}

TEST_F(Pcba, ABoardThatNeverAnswersFailsEachCheckAfterItsTimeOut) {
    for (const EventCheck &c : kEventChecks)
        ASSERT_TRUE(h.dut.consoleOk("hw reply " + std::string(c.op) + "_start none"));
    for (const EventCheck &c : kEventChecks) {
        SCOPED_TRACE(c.word);
        EXPECT_EQ(answer(2, ""), h.dut.pc(start(c)));
    }
    EXPECT_EQ(std::size(kEventChecks), h.dut.logCount("no answer within"));
    // The channel is free again: the next command is served.
    EXPECT_EQ(answer(0, ""), h.dut.pc("SimPCBA testItem stop"));
    EXPECT_TRUE(has(status(), "ftx_api_sim_stop()"));
}

TEST_F(Pcba, AStartEndsTheCheckThatRuns) {
    EXPECT_EQ(0, h.dut.pc("CpuPCBA testItem start").first);
    EXPECT_FALSE(has(status(), "ftx_api_cpu_stop("));
    EXPECT_EQ(0, h.dut.pc("MemoryPCBA testItem start").first);
    EXPECT_TRUE(has(status(), "ftx_api_cpu_stop()"));
    // The Wgb check is a switch: on at its start, off when the next check starts.
    EXPECT_EQ(0, h.dut.pc("WgbPCBA testItem start").first);
    EXPECT_TRUE(has(status(), "ftx_api_memory_stop()"));
    EXPECT_TRUE(has(status(), "ftx_api_wgb_start(2,1)"));
    EXPECT_EQ(0, h.dut.pc("GpsPCBA testItem start").first);
    EXPECT_TRUE(has(status(), "ftx_api_wgb_start(2,0)"));
}

TEST_F(Pcba, CameraAndWgbChecksFollowTheirOwnAnswers) {
    // The camera checks take a picture; the text of the check decides.
    EXPECT_EQ(0, h.dut.pc("CameraBackPCBA testItem start").first);
    EXPECT_TRUE(std::filesystem::exists(h.dut.root() + "/data/ftx_camera/pcba_back.png"));
    EXPECT_EQ(0, h.dut.pc("CameraFrontPCBA testItem start").first);
    EXPECT_TRUE(std::filesystem::exists(h.dut.root() + "/data/ftx_camera/pcba_front.png"));
    ASSERT_TRUE(h.dut.consoleOk("hw camera 0 fail"));
    EXPECT_EQ(2, h.dut.pc("CameraBackPCBA testItem start").first);
    EXPECT_TRUE(h.dut.waitLog("camera check: camera 0 did not start: fail"));
    // The Wgb switch passes on any non-zero answer of its (2, 1).
    EXPECT_EQ(0, h.dut.pc("WgbPCBA testItem start").first);
    ASSERT_TRUE(h.dut.consoleOk("hw set ftx_api_wgb_start 0"));
    EXPECT_EQ(2, h.dut.pc("WgbPCBA testItem start").first);
    ASSERT_TRUE(h.dut.consoleOk("hw set ftx_api_wgb_start 7"));
    EXPECT_EQ(0, h.dut.pc("WgbPCBA testItem start").first);
    EXPECT_EQ(0, h.dut.pc("WgbPCBA testItem stop").first);
    EXPECT_TRUE(has(status(), "ftx_api_wgb_start(2,0)"));
}

TEST_F(Pcba, CameraIdCheckTakesCameraThreeOnlyWhenAsked) {
    EXPECT_EQ(0, h.dut.pc("ReadCameraID testItem start 3").first);
    EXPECT_TRUE(has(status(), "ftx_api_cameraID_test(3)"));
    EXPECT_EQ(0, h.dut.pc("ReadCameraID testItem start").first);
    EXPECT_TRUE(has(status(), "ftx_api_cameraID_test(2)"));
    ASSERT_TRUE(h.dut.consoleOk("hw camera 3 fail"));
    EXPECT_EQ(2, h.dut.pc("ReadCameraID testItem start id=13").first);
    EXPECT_EQ(0, h.dut.pc("ReadCameraID testItem start 2").first);
}

TEST_F(Pcba, RingAndVibratorReachTheModelAndAlwaysAnswerSuccess) {
    ASSERT_TRUE(h.dut.consoleOk("hw set ftx_api_Audio_RingTest_Start -1"));
    EXPECT_EQ(0, h.dut.pc("RingPCBA testItem start").first);
    EXPECT_TRUE(has(status(), "ftx_api_Audio_RingTest_Start(ring_type=2)"));
    EXPECT_EQ(0, h.dut.pc("RingPCBA testItem stop").first);
    EXPECT_TRUE(has(status(), "ftx_api_Audio_RingTest_Stop("));
    EXPECT_EQ(0, h.dut.pc("VibratorPCBA testItem start").first);
    EXPECT_TRUE(has(status(), "ftx_api_Vibrator_Test_Start("));
    EXPECT_EQ(0, h.dut.pc("VibratorPCBA testItem stop").first);
    EXPECT_TRUE(has(status(), "ftx_api_Vibrator_Test_Stop("));
}

// The window an operator sees: the check, its value and a verdict band of its colour.
TEST_F(Pcba, TheWindowShowsTheValueAndTheVerdict) {
    auto band = [](const Png &p, bool (*colour)(int, int, int)) {
        return p.count(45, 560, 675, 640, colour) > 20000;
    };
    EXPECT_EQ(0, h.dut.pc("MemoryPCBA testItem start").first);
    Png pass = h.shotWhen("pcba_pass.png", [&](const Png &p) { return band(p, green); });
    EXPECT_GT(pass.count(200, 380, 520, 450, green), 200);  // the value, in green
    ASSERT_TRUE(h.dut.consoleOk("hw reply ftx_api_memory_start 111 1024,0"));
    EXPECT_EQ(2, h.dut.pc("MemoryPCBA testItem start").first);
    Png fail = h.shotWhen("pcba_test.png", [&](const Png &p) { return band(p, red); });
    EXPECT_GT(fail.count(200, 380, 520, 450, red), 200);
    EXPECT_EQ(0, fail.count(45, 560, 675, 640, green));
}

}  // namespace

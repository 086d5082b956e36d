// The real ftx-mmi, headless: the aging (burn-in) run with short configured times and a
// fast clock. Runs that reboot are restarted on exit status 101 as the launcher does; the
// record is read from the reboot marker and the result file in the device root.
#include <signal.h>
#include <stdlib.h>

#include <filesystem>
#include <map>
#include <random>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "support/handset.h"
#include "support/http_receiver.h"

using namespace handset;

namespace {

const char kMarker[] = "/cache/ftx/rebootAging.txt";
const char kResult[] = "/cache/ftx/aging/result.ini";
const char kUploads[] = "/cache/ftx/aging/upload";

// A value of the record ("key=value" lines), -1 when missing.
long field(const std::string &record, const std::string &key) {
    const std::string k = "\n" + key + "=";
    size_t at = ("\n" + record).find(k);
    if (at == std::string::npos) return -1;
    return atol(record.c_str() + at + k.size() - 1);
}

// The pass and fail counts of an item ("item=pass,fail").
std::pair<long, long> counts(const std::string &record, const std::string &item) {
    const std::string k = "\n" + item + "=";
    size_t at = ("\n" + record).find(k);
    if (at == std::string::npos) return {-1, -1};
    const char *p = record.c_str() + at + k.size() - 1;
    char *end = nullptr;
    const long pass = strtol(p, &end, 10);
    return {pass, *end == ',' ? atol(end + 1) : -1};
}

const char *const kItems[] = {"wifi_detect", "bt_detect", "fm_detect", "video",   "light", "camera",
                              "vibrator",    "audio",     "cpu",       "standby", "reboot"};

struct Aging : ::testing::Test {
    Handset h{{}, 0.01};

    // Every item off, one cycle, no upload; tests turn on what they need.
    void SetUp() override {
        settings({{"vediotest", "enable:0;time:1"},
                  {"lighttest", "enable:0;time:1"},
                  {"cameratest", "enable:0;times:2;totalnum:2"},
                  {"reboottest", "enable:0;times:2"},
                  {"standbytest", "enable:0;times:2"},
                  {"vibratortest", "enable:0;time:1"},
                  {"audioloop", "enable:0"},
                  {"cpufullload", "enable:0;time:1"},
                  {"Parameters", "Cycles:1;TempUpLimit:550;TempUncharge:450"},
                  {"savedb", "enable:0;time:0"}});
    }
    void settings(const std::map<std::string, std::string> &keys) {
        for (const auto &k : keys)
            h.dut.setConfig("FTX_AGING", k.first, k.second);
    }
    // A run of n cycles that the handset takes over at its next start.
    void freshMarker(int cycles) {
        h.dut.write(kMarker, "[aging]\ncycle=0\ncycles=" + std::to_string(cycles) + "\n");
    }
    // From the main menu: the aging row (after the coupling row), its start row, then Yes.
    void startFromMenu() {
        for (int i = 0; i < 4; i++)
            h.key(108);
        h.key(28);
        ASSERT_TRUE(h.dut.waitLog("aging result list opened"));
        ASSERT_TRUE(h.waitActive("Aging"));
        h.key(28);
        ASSERT_TRUE(h.dut.waitDialogTakesKeys());
        h.key(60);
        ASSERT_TRUE(h.dut.waitLog("aging window created"));
    }
    std::string marker() const { return h.dut.exists(kMarker) ? h.dut.read(kMarker) : ""; }
    bool finished() const { return h.dut.exists(kResult) && !h.dut.exists(kMarker); }

    // Starts the handset and keeps it going through the reboots the run asks for until the
    // run has finished; the number of reboots, or -1 when the process ended otherwise or
    // time ran out.
    int runThroughReboots(int timeoutMs = 120000) {
        if (!h.dut.start()) return -1;
        int reboots = 0;
        bool failed = false;
        const bool done = dut_wait_until(
            [&] {
                if (!h.dut.running()) {
                    const int status = h.dut.wait(1000);
                    if (status != 101) return failed = true;
                    reboots++;
                    if (!h.dut.start()) return failed = true;
                    return false;
                }
                return finished();
            },
            timeoutMs);
        return done && !failed ? reboots : -1;
    }
};

// Both defaults of the settings, as the log tells them: a missing key against a key
// without parameters, and the server address that switches saving off when missing.
TEST_F(Aging, SettingsTakeTheirNoKeyAndInKeyDefaults) {
    h.dut.setConfig("FTX_AGING", "lighttest", "");
    h.dut.setConfig("FTX_AGING", "cameratest", "");
    h.dut.setConfig("FTX_AGING", "uploadip", "");
    settings({{"savedb", "enable:1;time:5"}});
    h.dut.write(kMarker, "[aging]\ncycles=1\ncycle=1\n");  // nothing left to run
    ASSERT_TRUE(h.dut.start());
    ASSERT_TRUE(h.dut.waitLog("mmi_AgingTest_Start_Entry end"));
    EXPECT_NE(h.dut.logPos("::lighttest::g_bAging_LightTest=0,g_iAgingLightTime=3."),
              std::string::npos);
    EXPECT_NE(h.dut.logPos("::cameratest::g_bAging_CameraTest=1,g_iAgingCameraTotalNum=100,"
                           "g_iCameraTotalNum=2."),
              std::string::npos);
    EXPECT_NE(h.dut.logPos("::savedb::g_bAging_SaveDb=1,g_iAgingSaveDbTime=5."), std::string::npos);
    EXPECT_NE(h.dut.logPos("get uploadip failed"), std::string::npos);
    ASSERT_TRUE(dut_wait_until([&] { return finished(); }, 20000));
    h.dut.stop();

    // Keys without their parameters take the in-key defaults.
    h.dut.setConfig("FTX_AGING", "lighttest", "none");
    h.dut.setConfig("FTX_AGING", "cameratest", "none");
    h.dut.setConfig("FTX_AGING", "uploadip", "127.0.0.1:9");
    h.dut.write(kMarker, "[aging]\ncycles=1\ncycle=1\n");
    ASSERT_TRUE(h.dut.start());
    ASSERT_TRUE(h.dut.waitLog("uploadip g_iport = 127.0.0.1:9"));
    EXPECT_NE(h.dut.logPos("::lighttest::g_bAging_LightTest=1,g_iAgingLightTime=10."),
              std::string::npos);
    EXPECT_NE(h.dut.logPos("::cameratest::g_bAging_CameraTest=1,g_iAgingCameraTotalNum=100,"
                           "g_iCameraTotalNum=2."),
              std::string::npos);
}

// With the marker at start the channel stays shut and the run resumes about 3 s after the
// main window (the real clock here).
TEST(AgingResume, MarkerAtStartShutsTheChannelAndResumesAfterTheMainWindow) {
    Handset h{{}, 1.0};
    for (const char *k : {"vediotest", "lighttest", "cameratest", "reboottest", "standbytest",
                          "vibratortest", "audioloop", "cpufullload"})
        h.dut.setConfig("FTX_AGING", k, "enable:0");
    h.dut.write(kMarker, "[aging]\ncycles=1\ncycle=0\n");
    ASSERT_TRUE(h.dut.start());
    ASSERT_TRUE(h.dut.waitLog("mmi_AgingTest_Start_Entry end", 20000));
    const std::string log = h.dut.logcat();
    EXPECT_EQ(log.find("AtThreadStart"), std::string::npos);
    EXPECT_EQ(h.dut.pc("VersionMoudle testItem read").first, -1);
    // Times of day of the two lines ("MM-DD HH:MM:SS.mmm").
    auto at = [&](const std::string &text) {
        size_t p = log.find(text);
        size_t line = log.rfind('\n', p);
        line = line == std::string::npos ? 0 : line + 1;
        const std::string t = log.substr(line + 6, 12);
        return ((atoi(t.c_str()) * 60 + atoi(t.c_str() + 3)) * 60 + atof(t.c_str() + 6));
    };
    const double waited = at("mmi_AgingTest_Start_Entry begin") - at("aging marker found");
    EXPECT_GE(waited, 2.9);
    EXPECT_LT(waited, 6.0);
}

// Two cycles of every item, two reboots and two standbys each: the run goes on across its
// own restarts and ends with every item passed as often as it ran.
TEST_F(Aging, TwoCyclesOfEveryItemAcrossRebootsAndStandbys) {
    settings({{"vediotest", "enable:1;time:1"},
              {"lighttest", "enable:1;time:1"},
              {"cameratest", "enable:1;times:2;totalnum:2"},
              {"reboottest", "enable:1;times:2"},
              {"standbytest", "enable:1;times:2"},
              {"vibratortest", "enable:1;time:1"},
              {"audioloop", "enable:1"},
              {"cpufullload", "enable:1;time:1"}});
    freshMarker(2);
    ASSERT_EQ(runThroughReboots(), 4);
    const std::string r = h.dut.read(kResult);
    EXPECT_EQ(field(r, "cycle"), 2);
    EXPECT_EQ(field(r, "failures"), 0) << r;
    const std::map<std::string, long> expected = {
        {"wifi_detect", 2}, {"bt_detect", 2}, {"fm_detect", 2}, {"video", 2},
        {"light", 2},       {"camera", 8},    {"vibrator", 2},  {"audio", 2},
        {"cpu", 2},         {"standby", 4},   {"reboot", 4}};
    for (const auto &e : expected)
        EXPECT_EQ(counts(r, e.first), std::make_pair(e.second, 0L)) << e.first << "\n" << r;
    EXPECT_EQ(h.dut.logCount("resume: woken by alarm"), 4u);  // the log spans the restarts
    EXPECT_TRUE(h.waitActive("Aging", 10000));                // the result list
}

// A broken camera fails its checks; the run counts them and goes on to the end.
TEST_F(Aging, BrokenCameraIsCountedAndTheRunGoesOn) {
    settings({{"cameratest", "enable:1;times:2;totalnum:2"},
              {"vibratortest", "enable:1;time:1"},
              {"Parameters", "Cycles:2;TempUpLimit:550;TempUncharge:450"}});
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.dut.consoleOk("hw camera 1 fail"));
    startFromMenu();
    ASSERT_TRUE(dut_wait_until([&] { return finished(); }, 60000));
    const std::string r = h.dut.read(kResult);
    EXPECT_EQ(counts(r, "camera"), std::make_pair(4L, 4L)) << r;
    EXPECT_EQ(counts(r, "vibrator"), std::make_pair(2L, 0L)) << r;
    EXPECT_EQ(field(r, "failures"), 4);
    EXPECT_NE(r.find("last_failure=camera 1 check returned -1"), std::string::npos) << r;
}

// The window mid-run shows the failures in red; back pressed twice stops the run after the
// step in flight and the result list opens on the stopped record.
TEST_F(Aging, WindowShowsTheRunAndBackTwiceStopsIt) {
    settings({{"cameratest", "enable:1;times:3;totalnum:3"}, {"vibratortest", "enable:1;time:60"}});
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.dut.consoleOk("hw camera 1 fail"));
    startFromMenu();
    ASSERT_TRUE(h.dut.waitLog("vibrator begins", 20000));
    h.shotWhen("aging_window.png",
               [](const Png &p) { return p.count(0, 0, 720, 1280, red) > 200; });
    h.keepForDocs("aging_window.png", "aging_window.png");
    h.key(61);
    ASSERT_TRUE(h.dut.waitLog("back pressed once"));
    EXPECT_EQ(h.dut.logPos("stopped: "), std::string::npos);
    h.key(61);
    ASSERT_TRUE(h.dut.waitLogCount("aging result list opened", 2, 15000));
    ASSERT_TRUE(finished());
    const std::string r = h.dut.read(kResult);
    EXPECT_EQ(field(r, "stopped"), 1);
    EXPECT_EQ(counts(r, "camera"), std::make_pair(6L, 3L)) << r;
    EXPECT_EQ(counts(r, "vibrator"), std::make_pair(0L, 0L)) << r;  // cut short, not counted
}

// kill -9 at random moments: each start resumes from the marker, the counters never go
// back, and the run ends with every step counted exactly once.
TEST_F(Aging, KilledAnywhereItResumesWithoutLosingSteps) {
    settings({{"vediotest", "enable:1;time:1"},
              {"cameratest", "enable:1;times:4;totalnum:2"},
              {"standbytest", "enable:1;times:2"},
              {"reboottest", "enable:1;times:1"}});
    freshMarker(3);
    std::mt19937 rng(static_cast<unsigned>(time(nullptr)));
    const unsigned seed = rng();
    SCOPED_TRACE("seed " + std::to_string(seed));
    rng.seed(seed);
    std::map<std::string, long> seen;
    auto no_step_back = [&](const std::string &rec) {
        if (rec.empty()) return;
        for (const char *item : kItems) {
            const long done = counts(rec, item).first;
            if (done < 0) continue;  // the record the test wrote, before the run's first
            EXPECT_GE(done, seen[item]) << item << " went back\n" << rec;
            seen[item] = std::max(seen[item], done);
        }
    };
    for (int round = 0; round < 6 && !finished(); round++) {
        ASSERT_TRUE(h.dut.start());
        const int ms = std::uniform_int_distribution<int>(300, 2500)(rng);
        const auto until = std::chrono::steady_clock::now() + std::chrono::milliseconds(ms);
        // Watch the record while the process runs (it may reboot by itself meanwhile).
        dut_wait_until(
            [&] {
                no_step_back(marker());
                return !h.dut.running() || std::chrono::steady_clock::now() >= until;
            },
            ms + 1000);
        if (h.dut.running()) kill(h.dut.pid(), SIGKILL);
        h.dut.wait(5000);
        no_step_back(marker());
    }
    ASSERT_GE(runThroughReboots(), 0);
    const std::string r = h.dut.read(kResult);
    no_step_back(r);
    EXPECT_EQ(field(r, "cycle"), 3);
    EXPECT_EQ(counts(r, "video"), std::make_pair(3L, 0L)) << r;
    EXPECT_EQ(counts(r, "camera"), std::make_pair(24L, 0L)) << r;
    EXPECT_EQ(counts(r, "standby"), std::make_pair(6L, 0L)) << r;
    EXPECT_EQ(counts(r, "reboot"), std::make_pair(3L, 0L)) << r;
    EXPECT_EQ(counts(r, "wifi_detect"), std::make_pair(3L, 0L)) << r;
}

// A battery above the upper limit stops charging and holds the run until it is below the
// lower one.
TEST_F(Aging, HotBatteryPausesTheRunWithChargingOff) {
    settings({{"vediotest", "enable:1;time:2"},
              {"cameratest", "enable:1;times:2;totalnum:1"},
              {"Parameters", "Cycles:1;TempUpLimit:400;TempUncharge:300"}});
    freshMarker(1);
    ASSERT_TRUE(h.dut.startToMenu());
    ASSERT_TRUE(h.dut.consoleOk("hw battery period 100"));
    ASSERT_TRUE(h.dut.waitLog("video begins", 20000));
    ASSERT_TRUE(h.dut.consoleOk("hw battery temperature 420"));
    ASSERT_TRUE(h.dut.waitLog("battery 420 above 400: charging off, paused"));
    EXPECT_NE(h.dut.console("hw status").find("charging=disabled"), std::string::npos);
    // Paused: whatever the clock does, the camera item does not begin.
    ASSERT_TRUE(h.dut.waitBatteryRounds(20));
    EXPECT_EQ(h.dut.logPos("camera begins"), std::string::npos);
    ASSERT_TRUE(h.dut.consoleOk("hw battery temperature 350"));
    ASSERT_TRUE(h.dut.waitBatteryRounds(5));
    EXPECT_EQ(h.dut.logPos("charging on, going on"), std::string::npos);
    ASSERT_TRUE(h.dut.consoleOk("hw battery temperature 290"));
    ASSERT_TRUE(h.dut.waitLog("battery 290 below 300: charging on, going on"));
    EXPECT_NE(h.dut.console("hw status").find("charging=enabled"), std::string::npos);
    ASSERT_TRUE(dut_wait_until([&] { return finished(); }, 30000));
    EXPECT_EQ(counts(h.dut.read(kResult), "camera"), std::make_pair(2L, 0L));
}

// The record goes to the factory's server as JSON; while the server is down it is kept,
// and the next try after it is up sends everything kept.
TEST_F(Aging, UploadKeepsRecordsUntilTheServerTakesThem) {
    // A port of its own, then down until the first failure has been seen.
    HttpReceiver server;
    ASSERT_TRUE(server.start());
    const int port = server.port();
    server.stop();
    settings({{"vediotest", "enable:1;time:1"},
              {"Parameters", "Cycles:4;TempUpLimit:550;TempUncharge:450"},
              {"savedb", "enable:1;time:1"},
              {"uploadip", "127.0.0.1:" + std::to_string(port)}});
    freshMarker(4);
    ASSERT_TRUE(h.dut.start());
    ASSERT_TRUE(h.dut.waitLog("record(s) kept for the next try", 30000));
    ASSERT_TRUE(server.restart());
    ASSERT_TRUE(dut_wait_until([&] { return finished(); }, 60000));
    ASSERT_TRUE(server.wait_for(2, std::chrono::seconds(15)));
    const std::vector<HttpReceiver::Request> got = server.requests();
    for (const auto &q : got) {
        EXPECT_EQ(q.method, "POST");
        EXPECT_EQ(q.path, "/aging/record");
        EXPECT_EQ(q.contentType, "application/json");
    }
    const std::string &last = got.back().body;
    EXPECT_NE(last.find("\"finished\":true"), std::string::npos) << last;
    EXPECT_NE(last.find("\"video\":{\"pass\":4,\"fail\":0}"), std::string::npos) << last;
    EXPECT_NE(last.find("\"barcode\":\""), std::string::npos) << last;
    // Everything sent: nothing is left in the outbox.
    EXPECT_TRUE(std::filesystem::is_empty(h.dut.host(kUploads)));
}

}  // namespace

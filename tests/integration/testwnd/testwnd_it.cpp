// The real ftx-mmi, headless: the vibrator window from the device-test list, automatic runs
// with their summary items and restore files, the PC's vibrator, identity and battery
// commands, and screenshots checked by their pixels.
#include <png.h>
#include <stdio.h>

#include <chrono>
#include <filesystem>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "support/device_under_test.h"

namespace {

const char *const kDomains[] = {
    "FTX_SIMCARD",
    "FTX_SDCARD",
    "FTX_BATTERY",
    "FTX_USBHOST",
    "FTX_KEYS",
    "FTX_TPSELF",
    "FTX_TOUCH",
    "FTX_SENSOR",
    "FTX_HALLSENSOR",
    "FTX_HALL_2ND",
    "FTX_FINGERPRINT",
    "FTX_NFC",
    "FTX_CAMERA_BACK",
    "FTX_AUX_CAMERA_BACK",
    "FTX_CAMERA_FRONT",
    "FTX_LCD",
    "FTX_ALLLIGHT",
    "FTX_SMARTPACAL",
    "FTX_AUDIO_LOOPBACK",
    "FTX_RINGTONE",
    "FTX_RTUP",
    "FTX_RTDOWN",
    "FTX_RECEIVER",
    "FTX_HOOKKEY",
    "FTX_HEADSET_LOOPBACK",
    "FTX_FM",
    "FTX_AUDIO_MIC_HEADSET_LOOPBACK",
    "FTX_AUDIO_AUXILIARYMIC1_HEADSET_LOOPBACK",
    "FTX_AUDIO_AUXILIARYMIC2_HEADSET_LOOPBACK",
    "FTX_HIFI",
    "FTX_AUDIO_HEADSET_RECEIVER_LOOPBACK",
    "FTX_AUDIO_HEADSET_SPEAKER_LOOPBACK",
    "FTX_VIBRATOR",
    "FTX_SAR",
    "FTX_AuxiliarySAR",
    "FTX_CARDS",
    "FTX_AUDIO_MAINMICRECORD",
    "FTX_AUXLCD_HINT",
};

// The card test has no window yet: its entry only logs, which is enough to see it opened.
const char kCardsOpened[] = "mmi_testwnd_SIMMEMTestEntry: test not available yet";

struct Item {
    const char *domain;
    int autoF, mmi, pre;
};

// Soft-key bar on 720x1280: y 1185..1280, each slot 240 wide.
struct Png {
    int w = 0, h = 0;
    std::vector<unsigned char> rgb;
    bool load(const std::string &path) {
        FILE *fp = fopen(path.c_str(), "rb");
        if (!fp) return false;
        png_structp p = png_create_read_struct(PNG_LIBPNG_VER_STRING, nullptr, nullptr, nullptr);
        png_infop info = png_create_info_struct(p);
        if (setjmp(png_jmpbuf(p))) {
            png_destroy_read_struct(&p, &info, nullptr);
            fclose(fp);
            return false;
        }
        png_init_io(p, fp);
        png_read_info(p, info);
        png_set_strip_alpha(p);
        png_set_strip_16(p);
        png_set_palette_to_rgb(p);
        png_read_update_info(p, info);
        w = (int)png_get_image_width(p, info);
        h = (int)png_get_image_height(p, info);
        rgb.assign((size_t)w * (size_t)h * 3, 0);
        std::vector<png_bytep> rows((size_t)h);
        for (int y = 0; y < h; y++)
            rows[(size_t)y] = &rgb[(size_t)y * (size_t)w * 3];
        png_read_image(p, rows.data());
        png_destroy_read_struct(&p, &info, nullptr);
        fclose(fp);
        return true;
    }
    // Pixels of the box whose colour passes pred.
    template <typename Pred>
    int count(int x0, int y0, int x1, int y1, Pred pred) const {
        int n = 0;
        for (int y = y0; y < y1 && y < h; y++)
            for (int x = x0; x < x1 && x < w; x++) {
                const unsigned char *c = &rgb[((size_t)y * (size_t)w + (size_t)x) * 3];
                if (pred(c[0], c[1], c[2])) n++;
            }
        return n;
    }
};

bool light(int r, int g, int b) {
    return r > 150 && g > 150 && b > 150;
}
bool green(int r, int g, int b) {
    return g > 150 && r < 100 && b < 100;
}
bool red(int r, int g, int b) {
    return r > 150 && g < 100 && b < 100;
}

class Handset {
  public:
    // Only the listed items are enabled; the run resumes only where a test asks for it.
    explicit Handset(std::initializer_list<Item> items, double timeScale = 0.25) {
        for (const char *d : kDomains)
            dut.setConfig(d, "enable", "0");
        for (const Item &i : items) {
            dut.setConfig(i.domain, "enable", "1");
            dut.setConfig(i.domain, "auto", std::to_string(i.autoF));
            dut.setConfig(i.domain, "mmi", std::to_string(i.mmi));
            dut.setConfig(i.domain, "pre", std::to_string(i.pre));
        }
        dut.setConfig("MMI", "restore_autotest", "0");
        dut.setEnv("FTX_TIME_SCALE", std::to_string(timeScale));
    }

    // Up to the menu with the input layer running (a key-up nobody uses tells) and the PC
    // channel open.
    bool start() {
        return dut.startToMenu() &&
               dut_wait_until([&] { return dut.consoleOk("key up 200"); }, 5000) &&
               dut.waitChannel();
    }
    void key(int code) {
        std::string r = dut.console("key press " + std::to_string(code));
        EXPECT_NE(std::string::npos, r.find("OK")) << r;
    }

    std::string activeCaption() {
        std::string w = dut.console("windows");
        size_t a = w.find("active=1");
        if (a == std::string::npos) return "";
        size_t c = w.find("caption=\"", a);
        size_t e = w.find('"', c + 9);
        return w.substr(c + 9, e - c - 9);
    }
    bool waitActive(const std::string &caption, int ms = 5000) {
        return dut_wait_until([&] { return activeCaption() == caption; }, ms);
    }
    // From the main menu: "Device test" is its second row.
    void openDeviceList() {
        key(108);
        key(28);
        ASSERT_TRUE(waitActive("Device Test"));
    }
    // Rows: 0 full run, 1 information, 2 pretest 1, 3 pretest 2, 4.. the enabled items.
    // Keys go to the active window, so the list must be in front before they are sent.
    void chooseRow(int row) {
        ASSERT_TRUE(waitActive("Device Test"));
        for (int i = 0; i < row; i++)
            key(108);
        key(28);
    }
    // Device-test list, then a row, until the window of that caption is in front.
    bool fromList(int row, const std::string &caption) {
        openDeviceList();
        chooseRow(row);
        return waitActive(caption);
    }
    int result(int item) {
        auto r = dut.pc("testinfoMoudle testItem " + std::to_string(item) + ",read");
        EXPECT_EQ(0, r.first);
        return r.second.empty() ? -1 : atoi(r.second.c_str());
    }
    void setResult(int item, int value) {
        auto r = dut.pc("testinfoMoudle testItem " + std::to_string(item) + "," +
                        std::to_string(value) + ",write");
        EXPECT_EQ(0, r.first);
    }
    size_t count(const std::string &text) { return dut.logCount(text); }
    Png shot(const std::string &name) {
        std::string path = dut.root() + "/" + name;
        EXPECT_TRUE(dut.consoleOk("screenshot " + path));
        Png png;
        EXPECT_TRUE(png.load(path));
        keepForDocs(name, name);
        return png;
    }
    // Screenshots until what the test waits for is on the screen (painting, and what a
    // library callback brings, happen after the action that caused them); the last one.
    template <typename Pred>
    Png shotWhen(const std::string &name, Pred shows, int timeoutMs = 10000) {
        Png png;
        bool seen = dut_wait_until(
            [&] {
                png = shot(name);
                return shows(png);
            },
            timeoutMs);
        EXPECT_TRUE(seen) << name << ": the screen never showed what was waited for";
        return png;
    }
    // FTX_DOCS_SHOTS collects the pictures for the documentation.
    void keepForDocs(const std::string &name, const std::string &as) {
        if (const char *dir = getenv("FTX_DOCS_SHOTS")) {
            std::filesystem::copy_file(dut.root() + "/" + name, std::string(dir) + "/" + as,
                                       std::filesystem::copy_options::overwrite_existing);
        }
    }

    DeviceUnderTest dut;
};

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

bool pass_label(const Png &p) {
    return p.count(0, 1185, 240, 1280, light) > 20;
}
bool fail_label(const Png &p) {
    return p.count(480, 1185, 720, 1280, light) > 20;
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
    EXPECT_EQ(1u, h.count("mmi_testwnd_proc pass"));
    h.chooseRow(0);  // the list keeps its place on the vibrator row
    ASSERT_TRUE(h.waitActive("Vibration Test"));
    h.key(61);
    ASSERT_TRUE(h.waitActive("Device Test"));
    EXPECT_EQ(0, h.result(316));
    EXPECT_EQ(0, h.result(64));
    // Each key ended its window's delay thread before the delay was over.
    ASSERT_TRUE(h.dut.waitLogCount("WaitForFoolProof stopped", 2));
    EXPECT_EQ(0u, h.count("after sleep ,WaitForFoolProof"));
    EXPECT_NE(std::string::npos,
              h.dut.console("hw status").find("ftx_api_Vibrator_Test_Stop() x2"));
}

// Cards after the vibrator: a run that passes the vibrator opens the cards next.
const Item kCards = {"FTX_CARDS", 1, 0, 1};

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
    Handset h({kVibrator, kCards});
    h.dut.setConfig("MMI", "pretest_menu_enable", "1");
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.fromList(0, "Vibration Test"));
    h.key(61);
    ASSERT_TRUE(dut_wait_until([&] { return h.result(66) == 2; }, 5000));
    EXPECT_EQ(2, h.result(316));
    EXPECT_EQ(2, h.result(64));
    EXPECT_EQ(0u, h.count(kCardsOpened));
    // The run is over: the list takes choices again.
    h.chooseRow(0);
    ASSERT_TRUE(h.waitActive("Vibration Test"));
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
    EXPECT_EQ(0u, h.count(kCardsOpened));
    EXPECT_NE(std::string::npos, h.dut.read("/etc/ftx_config.ini").find("mmi_flag=0\r\n"));
    EXPECT_TRUE(h.waitActive("Device Test"));
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
    ASSERT_TRUE(dut_wait_until([&] { return h.count(kCardsOpened) == 2; }, 5000));
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
    EXPECT_EQ("*FTXSIM0000000001", h.dut.pc("barcodeMoudle testItem read").second);
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
    EXPECT_EQ(0u, h.count("mmi_AutoTestEntry begin."));
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
    // The preview list of the image: the hardware version, then the monomer LCD (no window
    // yet: its entry only logs).
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
    EXPECT_TRUE(h.dut.waitLog("mmi_Monomer_LCDColorTestEntry: test not available yet"));
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

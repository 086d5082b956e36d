// The real ftx-mmi seen as an operator sees it: a configured set of test items, keys, the
// window in front, the result record through the PC, and screenshots read back as pixels.
// Integration tests of the screens share it (link PNG::PNG).
#pragma once

#include <png.h>
#include <stdio.h>
#include <stdlib.h>

#include <filesystem>
#include <algorithm>
#include <initializer_list>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "support/device_under_test.h"

namespace handset {

// Every test item domain of the image's configuration.
inline const std::vector<std::string> &all_domains() {
    static const std::vector<std::string> kDomains = {
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
    return kDomains;
}

// An enabled item, its run flags and, when given, its parameter.
struct Item {
    const char *domain;
    int autoF, mmi, pre;
    const char *parameter = nullptr;
};

// A screenshot, RGB.
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
    const unsigned char *at(int x, int y) const {
        return &rgb[((size_t)y * (size_t)w + (size_t)x) * 3];
    }
    bool same(int x0, int y0, int x1, int y1) const {
        const unsigned char *a = at(x0, y0), *b = at(x1, y1);
        return a[0] == b[0] && a[1] == b[1] && a[2] == b[2];
    }
    // Pixels of the box [x0, x1) x [y0, y1) whose colour passes pred.
    template <typename Pred>
    int count(int x0, int y0, int x1, int y1, Pred pred) const {
        int n = 0;
        for (int y = y0; y < y1 && y < h; y++)
            for (int x = x0; x < x1 && x < w; x++) {
                const unsigned char *c = at(x, y);
                if (pred(c[0], c[1], c[2])) n++;
            }
        return n;
    }
    // Per column of [0, w): 1 where some pixel of rows [y0, y1) is a text's stroke on the
    // background at (bgX, bgY): its brightest channel well above the background's. Edges
    // smoothed into the background are left out, so a text marks the same columns in any
    // of the light text colours.
    std::vector<int> inkColumns(int y0, int y1, int bgX, int bgY) const {
        auto brightest = [](const unsigned char *c) { return std::max({c[0], c[1], c[2]}); };
        const int bg = brightest(at(bgX, bgY));
        std::vector<int> ink((size_t)w, 0);
        for (int x = 0; x < w; x++)
            for (int y = y0; y < y1 && y < h; y++)
                if (brightest(at(x, y)) - bg > 100) ink[(size_t)x] = 1;
        return ink;
    }
};

// The all-cards test as the run's next item: it opens and waits (the image's slots 3 and 4
// are empty) far longer than a test runs, so the run stays on it until a key ends it.
inline constexpr Item kCards = {"FTX_CARDS", 1, 0, 1, "SimSlots:4;Timeout:3600"};
inline constexpr char kCardsOpened[] = "FTX_CARDS: test window open";

inline bool light(int r, int g, int b) {
    return r > 150 && g > 150 && b > 150;
}
// The soft-key bar of a 720x1280 screen shows its pass (left) or fail (right) label.
inline bool pass_label(const Png &p) {
    return p.count(0, 1185, 240, 1280, light) > 20;
}
inline bool fail_label(const Png &p) {
    return p.count(480, 1185, 720, 1280, light) > 20;
}
inline bool green(int r, int g, int b) {
    return g > 150 && r < 100 && b < 100;
}
inline bool red(int r, int g, int b) {
    return r > 150 && g < 100 && b < 100;
}

class Handset {
  public:
    // Only the listed items are enabled; a run resumes only where a test asks for it.
    explicit Handset(std::initializer_list<Item> items, double timeScale = 0.25) {
        for (const std::string &d : all_domains())
            dut.setConfig(d, "enable", "0");
        for (const Item &i : items) {
            dut.setConfig(i.domain, "enable", "1");
            dut.setConfig(i.domain, "auto", std::to_string(i.autoF));
            dut.setConfig(i.domain, "mmi", std::to_string(i.mmi));
            dut.setConfig(i.domain, "pre", std::to_string(i.pre));
            if (i.parameter != nullptr) dut.setConfig(i.domain, "parameter", i.parameter);
        }
        dut.setConfig("MMI", "restore_autotest", "0");
        dut.setEnv("FTX_TIME_SCALE", std::to_string(timeScale));
    }

    // The image's own configuration: every item it enables, with its parameters.
    struct ImageConfig {};
    explicit Handset(ImageConfig, double timeScale = 0.25) {
        dut.setConfig("MMI", "restore_autotest", "0");
        dut.setEnv("FTX_TIME_SCALE", std::to_string(timeScale));
    }

    // Up to the menu with the input layer running (a key-up nobody uses tells).
    bool start() {
        return dut.startToMenu() &&
               dut_wait_until([&] { return dut.consoleOk("key up 200"); }, 5000);
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
    // Rows: 0 full run, 1 information, 2 pretest 1, 3 pretest 2, 4.. the enabled items. The
    // list keeps its cursor: `row` counts from where the cursor is.
    // Keys go to the active window, so the list must be in front before they are sent.
    void chooseRow(int row) {
        ASSERT_TRUE(waitActive("Device Test"));
        for (int i = 0; i < row; i++)
            key(108);
        key(28);
    }
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
    // The main display, or with aux the auxiliary one.
    Png shot(const std::string &name, bool aux = false) {
        std::string path = dut.root() + "/" + name;
        EXPECT_TRUE(dut.consoleOk(std::string("screenshot ") + (aux ? "--aux " : "") + path));
        Png png;
        EXPECT_TRUE(png.load(path));
        keepForDocs(name, name);
        return png;
    }
    // FTX_DOCS_SHOTS collects the pictures for the documentation.
    void keepForDocs(const std::string &name, const std::string &as) {
        if (const char *dir = getenv("FTX_DOCS_SHOTS")) {
            std::error_code ec;
            std::filesystem::copy_file(dut.root() + "/" + name, std::string(dir) + "/" + as,
                                       std::filesystem::copy_options::overwrite_existing, ec);
        }
    }
    // Screenshots until pred holds (drawing follows the event that caused it); the last one
    // taken. A screenshot may catch a window half painted, so the picture must also be
    // the same twice in a row.
    template <typename Pred>
    Png shotWhen(const std::string &name, Pred pred, int timeoutMs = 10000) {
        Png png, previous;
        bool seen = dut_wait_until(
            [&] {
                previous = std::move(png);
                png = shot(name);
                return pred(png) && png.rgb == previous.rgb;
            },
            timeoutMs);
        EXPECT_TRUE(seen) << name << ": the screen never showed what was waited for";
        return png;
    }

    DeviceUnderTest dut;
};

}  // namespace handset

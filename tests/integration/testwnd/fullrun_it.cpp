// The real ftx-mmi, headless, with the image's own configuration: a full run from the first
// item to the last, the console giving each test what it waits for (a key, a finger on the
// screen, a sensor moved, a card, a headset...), and the device passed at the end.
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "support/handset.h"

using namespace handset;

namespace {

// One item of the run: what it needs from the console, and whether the operator's pass key
// ends it (else it passes by itself).
struct Step {
    const char *domain;
    std::vector<std::string> lines;  // console lines, once its window is in front
    bool passKey;
    const char *caption = nullptr;  // waited for before the lines; null: not waited for
};

// Down the left column, along the bottom row, up the right column and back along the top
// row of the 720x1280 touch frame.
const char kFrameRun[] =
    "path 120,10 120,1270 10,1270 470,1270 600,1270 600,250 600,120 710,120 250,120";

const std::vector<Step> kImageRun = {
    {"FTX_SIMCARD", {}, false},
    {"FTX_SDCARD", {}, false},
    {"FTX_BATTERY", {}, false},
    {"FTX_KEYS",
     {"key press volume-up", "key press volume-down", "key press power"},
     true,
     "Key Test"},
    {"FTX_TPSELF", {}, true, "TP Self Test"},
    {"FTX_TOUCH", {kFrameRun}, false, "Touch Test"},
    {"FTX_SENSOR",
     {"hw sensor gyro 0,2,0", "hw sensor proxi 0", "hw sensor proxi 5", "hw sensor light 1",
      "hw sensor light 500"},
     true,
     "Sensor Test"},
    {"FTX_FINGERPRINT", {"hw finger press"}, false, "Fingerprint Test"},
    {"FTX_NFC", {"hw nfc tag 04A1B2C3D4"}, false, "NFC Test"},
    {"FTX_CAMERA_BACK", {}, true, "Rear Camera Test"},
    {"FTX_CAMERA_FRONT", {}, true, "Front Camera Test"},
    {"FTX_LCD", {}, true},  // five colours touched through, then the confirmation
    {"FTX_ALLLIGHT", {}, true, "All Light Test"},  // one pass per light
    {"FTX_AUDIO_LOOPBACK", {}, true, "CAMERA WIN"},
    {"FTX_RINGTONE", {}, true, "Ringtone Test"},
    {"FTX_RECEIVER", {}, true, "Receiver Test"},
    {"FTX_HOOKKEY", {"hw hook press", "hw hook release"}, true, "Hook Key Test"},
    {"FTX_HEADSET_LOOPBACK", {"hw headset 1"}, true},
    {"FTX_FM", {}, true, "FM Test"},
    {"FTX_VIBRATOR", {}, true, "Vibration Test"},
};

std::string passed(const char *domain) {
    return std::string("mmi_startNextItemTest chdomain=") + domain;
}

// Touches through the LCD test's colours: each touch after its colour's second is over.
void lcd_colours(Handset &h) {
    for (size_t i = 1; i <= 5; i++) {
        ASSERT_TRUE(h.dut.waitLogCount("WaitForFoolProofLcd end", i, 15000));
        ASSERT_TRUE(h.dut.consoleOk("tap 360 640"));
    }
}

// Presses pass whenever the pass label shows, each time on a screen that changed since the
// last press, until the item's pass reaches the run.
void pass_through(Handset &h, const Step &s) {
    std::vector<unsigned char> pressedOn;
    ASSERT_TRUE(dut_wait_until(
        [&] {
            if (h.dut.logPos(passed(s.domain)) != std::string::npos) return true;
            Png p = h.shot("fullrun.png");
            if (pass_label(p) && p.rgb != pressedOn) {
                pressedOn = p.rgb;
                h.key(60);
            }
            return false;
        },
        30000))
        << s.domain << " never passed";
}

TEST(FullRun, TheImagesItemsPassOneAfterAnotherAndTheDevicePasses) {
    Handset h(Handset::ImageConfig{});
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.dut.waitChannel());
    h.openDeviceList();
    h.chooseRow(0);
    for (const Step &s : kImageRun) {
        SCOPED_TRACE(s.domain);
        if (s.caption != nullptr) {
            ASSERT_TRUE(h.waitActive(s.caption, 15000));
        }
        if (std::string(s.domain) == "FTX_LCD") lcd_colours(h);
        for (const std::string &line : s.lines) {
            ASSERT_TRUE(h.dut.consoleOk(line)) << line;
        }
        if (s.passKey) {
            pass_through(h, s);
        } else {
            ASSERT_TRUE(h.dut.waitLog(passed(s.domain), 30000));
        }
    }
    ASSERT_TRUE(h.waitActive("Device Test", 15000));
    EXPECT_EQ(1, h.result(64));
    for (int item : {324, 360, 344, 312, 320, 328, 336, 340, 288, 292, 280, 284, 300, 296, 298, 304,
                     308, 316}) {
        EXPECT_EQ(1, h.result(item)) << item;
    }
    // No item met a stand-in window.
    EXPECT_EQ(std::string::npos, h.dut.logPos("test not available yet"));
}

}  // namespace

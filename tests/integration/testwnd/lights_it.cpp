// The real ftx-mmi, headless: the light test stepped through in a run with each light seen
// in the simulated handset (and the LED's dot on the screen), the PC's single lights, and the
// light control with the Wi-Fi link to the PC switched off before the lights come on.
#include <iterator>
#include <string>

#include <gtest/gtest.h>

#include "support/handset.h"
#include "support/text.h"

using namespace handset;

namespace {

const Item kAllLight = {"FTX_ALLLIGHT", 1, 0, 1};
const char kCaption[] = "All Light Test";
const char kEveryLight[] =
    "BackFlashlight:1;SecondBackFlashlight:1;FrontFlashlight:1;LedRed:1;LedGreen:1;LedOrange:1;"
    "KeyBacklight:1";
const char kAllOff[] = "back=off back2=off front=off led=off keybacklight=off all=off";

std::string lights(Handset &h) {
    return h.dut.console("hw lights");
}

// The LED's dot at the right end of a 720x1280 screen's title strip (radius 12 about
// 684,29): pixels of the box around it that pass pred.
template <typename Pred>
int dot(const Png &p, Pred pred) {
    return p.count(668, 13, 701, 46, pred);
}
bool orange(int r, int g, int b) {
    return r > 200 && g > 100 && g < 160 && b < 60;
}
bool anyDot(int r, int g, int b) {
    return red(r, g, b) || green(r, g, b) || orange(r, g, b);
}
const int kDotPixels = 300;  // of the 450-odd a dot of radius 12 covers

struct Step {
    const char *name;               // in the log
    const char *state;              // in "hw lights"
    bool (*colour)(int, int, int);  // the LED's dot, when the step lights it
};
const Step kSteps[] = {
    {"back flashlight", "back=on back2=off front=off led=off keybacklight=off", nullptr},
    {"second back flashlight", "back=off back2=on front=off led=off", nullptr},
    {"front flashlight", "back=off back2=off front=on led=off", nullptr},
    {"red LED", "front=off led=red keybacklight=off", red},
    {"green LED", "front=off led=green keybacklight=off", green},
    {"orange LED", "front=off led=orange keybacklight=off", orange},
    {"key backlight", "front=off led=off keybacklight=on", nullptr},
};

std::string stepLine(int i, int of, const char *name) {
    return "FTX_ALLLIGHT: step " + std::to_string(i) + "/" + std::to_string(of) + ": " + name;
}

// Up to the full run's first item, the light test, with the item's parameter.
void start_run(Handset &h, const std::string &parameter) {
    h.dut.setConfig("FTX_ALLLIGHT", "parameter", parameter);
    ASSERT_TRUE(h.start());
    h.openDeviceList();
    h.chooseRow(0);
    ASSERT_TRUE(h.waitActive(kCaption));
}

}  // namespace

TEST(AllLightTest, EachLightIsOnOnlyDuringItsStepAndTheLastPassPassesTheRun) {
    Handset h({kAllLight, kCards});
    start_run(h, kEveryLight);
    const int n = static_cast<int>(std::size(kSteps));
    for (int i = 0; i < n; i++) {
        const Step &s = kSteps[i];
        ASSERT_TRUE(h.dut.waitLog(stepLine(i + 1, n, s.name))) << s.name;
        EXPECT_TRUE(has(lights(h), s.state)) << s.name << ": " << lights(h);
        Png p = h.shotWhen("all_light_" + std::to_string(i) + ".png", [&](const Png &shot) {
            return pass_label(shot) && (s.colour == nullptr ? dot(shot, anyDot) == 0
                                                            : dot(shot, s.colour) > kDotPixels);
        });
        EXPECT_TRUE(fail_label(p));
        if (s.colour == red) h.keepForDocs("all_light_3.png", "all_light_test.png");
        EXPECT_EQ(0, h.result(284)) << "recorded before the last step";
        h.key(60);
    }
    ASSERT_TRUE(h.dut.waitLog("FTX_ALLLIGHT: every light passed"));
    ASSERT_TRUE(h.dut.waitLog(kCardsOpened));
    EXPECT_EQ(1, h.result(284));
    EXPECT_TRUE(has(lights(h), kAllOff)) << lights(h);
}

TEST(AllLightTest, AFailAtAMiddleStepFailsTheTestEndsTheRunAndSwitchesTheLightOff) {
    Handset h({kAllLight, kCards});
    // The image's choice: no second back flashlight.
    start_run(h, "");
    ASSERT_TRUE(h.dut.waitLog(stepLine(1, 6, "back flashlight")));
    h.key(60);
    ASSERT_TRUE(h.dut.waitLog(stepLine(2, 6, "front flashlight")));
    EXPECT_TRUE(has(lights(h), "back=off back2=off front=on")) << lights(h);
    h.key(61);
    ASSERT_TRUE(h.waitActive("Device Test"));
    EXPECT_TRUE(h.dut.waitLog("FTX_ALLLIGHT: step 2/6: front flashlight failed"));
    EXPECT_EQ(2, h.result(284));
    EXPECT_TRUE(has(lights(h), kAllOff)) << lights(h);
    EXPECT_FALSE(has(h.dut.logcat(), kCardsOpened));
    EXPECT_FALSE(has(h.dut.logcat(), "step 3/6"));
}

TEST(AllLightTest, ALightTheLibraryRefusesOffersOnlyFail) {
    Handset h({kAllLight, kCards});
    h.dut.setConfig("FTX_ALLLIGHT", "parameter",
                    "BackFlashlight:0;FrontFlashlight:0;LedRed:0;LedGreen:0;LedOrange:1;"
                    "KeyBacklight:0");
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.dut.consoleOk("hw set ftx_api_LEDColorTest_Start -1"));
    h.openDeviceList();
    h.chooseRow(0);
    ASSERT_TRUE(h.dut.waitLog("FTX_ALLLIGHT: step 1/1: orange LED did not turn on"));
    const Png p = h.shotWhen("all_light_refused.png", [](const Png &shot) {
        return fail_label(shot) && shot.count(0, 300, 720, 700, red) > 200;
    });
    EXPECT_FALSE(pass_label(p));
    EXPECT_EQ(0, dot(p, anyDot));
    h.key(60);  // not offered
    h.key(61);
    ASSERT_TRUE(h.waitActive("Device Test"));
    EXPECT_EQ(2, h.result(284));
    EXPECT_FALSE(has(h.dut.logcat(), "every light passed"));
}

TEST(AllLightTest, ALibraryWithoutFlashlightsOpensNothingAndEndsTheRun) {
    Handset h({kAllLight, kCards});
    const std::string lib = DeviceUnderTest::buildDir() + "/lib";
    h.dut.setEnv("LD_LIBRARY_PATH", lib + "/variants/no_flashlight:" + lib);
    h.dut.setConfig("FTX_ALLLIGHT", "parameter", "LedRed:1");  // flashlights by default
    ASSERT_TRUE(h.start());
    h.openDeviceList();
    h.chooseRow(0);
    ASSERT_TRUE(h.dut.waitLog("FTX_ALLLIGHT: back flashlight cannot be switched, test not opened"));
    ASSERT_TRUE(h.waitActive("Device Test"));
    EXPECT_EQ(0, h.result(284));
    EXPECT_FALSE(has(h.dut.logcat(), kCardsOpened));
    EXPECT_TRUE(has(lights(h), kAllOff)) << lights(h);
    // The PC's flashlight fails too; the LED still works.
    EXPECT_EQ(2, h.dut.pc("flashlightMoudle testItem open").first);
    EXPECT_EQ(0, h.dut.pc("LEDMoudle testItem FF0000").first);
    EXPECT_TRUE(has(lights(h), "back=off back2=off front=off led=red")) << lights(h);
}

TEST(LightsPc, EachStartAndStopReachesTheLightAndTheDotFollowsTheLed) {
    Handset h({});
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.dut.waitChannel());
    struct PcLight {
        const char *open, *close, *on;
    };
    const PcLight kPc[] = {
        {"flashlightMoudle testItem open", "flashlightMoudle testItem close", "back=on"},
        {"flashlightMoudle2 testItem open", "flashlightMoudle2 testItem close", "back2=on"},
        {"flashlightMoudle testItem front open", "flashlightMoudle testItem front close",
         "front=on"},
        {"KEYbacklightMoudle testItem open", "KEYbacklightMoudle testItem close",
         "keybacklight=on"},
        {"LEDMoudle testItem FF0000", "LEDMoudle testItem close", "led=red"},
        {"LEDMoudle testItem 00FF00", "LEDMoudle testItem close", "led=green"},
        {"LEDMoudle testItem FFFF00", "LEDMoudle testItem close", "led=orange"},
    };
    for (const PcLight &l : kPc) {
        EXPECT_EQ(0, h.dut.pc(l.open).first) << l.open;
        const std::string on = lights(h);
        EXPECT_TRUE(has(on, l.on)) << l.open << ": " << on;
        EXPECT_TRUE(has(h.dut.console("hw status"), l.on)) << l.open;
        EXPECT_EQ(0, h.dut.pc(l.close).first) << l.close;
        EXPECT_TRUE(has(lights(h), kAllOff)) << l.close << ": " << lights(h);
    }
    // A second colour replaces the first; the dot shows it and goes with the stop.
    EXPECT_EQ(0, h.dut.pc("LEDMoudle testItem FF0000").first);
    EXPECT_EQ(0, h.dut.pc("LEDMoudle testItem 00FF00").first);
    h.shotWhen("led_green.png", [](const Png &p) { return dot(p, green) > kDotPixels; });
    EXPECT_EQ(0, h.dut.pc("LEDMoudle testItem close").first);
    h.shotWhen("led_off.png", [](const Png &p) { return dot(p, anyDot) == 0; });
    // A light the library refuses answers failure.
    ASSERT_TRUE(h.dut.consoleOk("hw set ftx_api_KeyBacklightTest_Start -1"));
    EXPECT_EQ(2, h.dut.pc("KEYbacklightMoudle testItem open").first);
    EXPECT_TRUE(has(lights(h), "keybacklight=off"));
}

TEST(LightsPc, LightControlDropsTheWifiLinkBeforeEveryLightComesOn) {
    Handset h({});
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.dut.waitChannel());
    EXPECT_EQ(0, h.dut.pc("WiFiConCptMoudle testItem open").first);
    ASSERT_TRUE(has(h.dut.console("hw status"), "wifilink: on"));

    EXPECT_EQ(0, h.dut.pc("LightControl testItem Open").first);
    const std::string status = h.dut.console("hw status");
    EXPECT_TRUE(has(status, "wifilink: off")) << status;
    // The lights saw the link already off when they came on.
    EXPECT_TRUE(has(status, "all=on link_at_all=off")) << status;
    h.shotWhen("light_control.png", [](const Png &p) { return dot(p, orange) > kDotPixels; });

    EXPECT_EQ(0, h.dut.pc("LightControl testItem Close").first);
    EXPECT_TRUE(has(lights(h), kAllOff)) << lights(h);
    h.shotWhen("light_control_off.png", [](const Png &p) { return dot(p, anyDot) == 0; });
    // The close leaves the link as it is.
    EXPECT_TRUE(has(h.dut.console("hw status"), "wifilink: off"));
}

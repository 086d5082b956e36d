// The real ftx-mmi, headless: the LCD colour test as the operator runs it and as the PC
// drives it, the gray level, hue and panel commands, the calibration pictures, the
// backlight, and the auxiliary display across the restart between the two LCD passes.
#include <sys/stat.h>

#include <string>

#include <gtest/gtest.h>

#include "support/handset.h"

using namespace handset;

namespace {

const Item kLcd = {"FTX_LCD", 1, 0, 1};
const char kFoolProofEnd[] = "WaitForFoolProofLcd end";
const char kTouchIgnored[] = "touched touch ignored";

struct Colour {
    int r, g, b;
};
// The five colours of the default table; the first white is one step below full white.
const Colour kFive[] = {{255, 255, 254}, {255, 0, 0}, {0, 255, 0}, {0, 0, 255}, {0, 0, 0}};

// The colour words of the PC's LCD commands, in table order.
const char *const kColourWords[] = {"FFFFFF", "FF0000", "00FF00", "0000FF", "000000"};

// Every pixel of the screen, title strip and soft-key bar included, has colour c.
bool filled(const Png &p, Colour c) {
    const int n = p.count(0, 0, p.w, p.h,
                          [c](int r, int g, int b) { return r == c.r && g == c.g && b == c.b; });
    return n == p.w * p.h;
}

// Full-screen windows in front of everything (the colour screens).
int fullScreenWindows(Handset &h) {
    const std::string w = h.dut.console("windows");
    int n = 0;
    for (size_t p = w.find("rect=0,0,720,1280"); p != std::string::npos;
         p = w.find("rect=0,0,720,1280", p + 1))
        n++;
    return n;
}

void tap(Handset &h) {
    EXPECT_TRUE(h.dut.consoleOk("tap 360 640"));
}

// Shows colours `from`.. of `colours` one touch each, each after its fool-proof second.
void touchThrough(Handset &h, const Colour *colours, int from, int to, const std::string &shot) {
    for (int i = from; i < to; i++) {
        SCOPED_TRACE(i);
        h.shotWhen(shot + std::to_string(i) + ".png",
                   [&](const Png &p) { return filled(p, colours[i]); });
        ASSERT_TRUE(h.dut.waitLogCount(kFoolProofEnd, (size_t)i + 1));
        tap(h);
    }
}

TEST(LcdColours, ARunShowsFiveColoursThenTheConfirmationAndPassOpensTheNextItem) {
    Handset h({kLcd, kCards});
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.dut.waitChannel());
    h.openDeviceList();
    h.chooseRow(0);  // the full run: the LCD test is its first item
    touchThrough(h, kFive, 0, 5, "lcd_colour_");
    h.keepForDocs("lcd_colour_1.png", "lcd_colour_red.png");
    ASSERT_TRUE(h.waitActive("LCD Color Test"));
    EXPECT_EQ(0, fullScreenWindows(h));  // the colour window went with the last touch
    Png check = h.shotWhen("lcd_confirmation.png", pass_label);
    // The note in the window, the soft-key bar back with both labels.
    EXPECT_GT(check.count(90, 100, 630, 300, light), 50);
    EXPECT_TRUE(fail_label(check));
    h.key(60);
    ASSERT_TRUE(h.dut.waitLog(kCardsOpened));
    EXPECT_EQ(1, h.result(280));
    EXPECT_EQ(0, h.result(64));
}

TEST(LcdColours, ATouchInsideTheFirstSecondIsLostAndMmiTwoShowsOneColour) {
    // Scaled so the fool-proof second lasts four: the first touch comes well inside it.
    Handset h({{"FTX_LCD", 1, 2, 1}}, 4.0);
    ASSERT_TRUE(h.start());
    h.openDeviceList();
    h.chooseRow(4);
    h.shotWhen("lcd_white.png", [](const Png &p) { return filled(p, kFive[0]); });
    tap(h);
    ASSERT_TRUE(h.dut.waitLog(kTouchIgnored));
    const size_t end = h.dut.logPos(kFoolProofEnd);
    EXPECT_TRUE(end == std::string::npos || end > h.dut.logPos(kTouchIgnored));
    // Still white after the lost touch; once the second is over one touch ends the colours.
    h.shotWhen("lcd_white_kept.png", [](const Png &p) { return filled(p, kFive[0]); });
    ASSERT_TRUE(h.dut.waitLog(kFoolProofEnd, 15000));
    tap(h);
    ASSERT_TRUE(h.waitActive("LCD Color Test"));
    h.key(61);
    ASSERT_TRUE(h.waitActive("Device Test"));
    EXPECT_EQ(0, h.result(280));  // outside a run the keys leave the record alone
}

TEST(LcdColours, SixColoursStartWithExactWhiteThenDarkGray) {
    Handset h({kLcd});
    h.dut.setConfig("FTX_LCD", "parameter", "colornum:6");
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.dut.waitChannel());
    h.openDeviceList();
    h.chooseRow(4);
    const Colour six[] = {{255, 255, 255}, {128, 128, 128}};
    touchThrough(h, six, 0, 1, "lcd_six_");
    h.shotWhen("lcd_six_1.png", [&](const Png &p) { return filled(p, six[1]); });
    EXPECT_TRUE(h.dut.waitLog("mmi_LCDColorTest_Init::LcdColorTestNum=6"));
    EXPECT_EQ(0, h.dut.pc("LCDMoudle testItem close").first);
    ASSERT_TRUE(h.waitActive("Device Test"));
}

TEST(LcdPc, EachColourRepaintsTheOneWindowAndCloseDestroysIt) {
    Handset h({kLcd});
    // The operator sees three colours; the PC reaches every colour of the table.
    h.dut.setConfig("FTX_LCD", "parameter", "colornum:3");
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.dut.waitChannel());
    for (int i = 0; i < 5; i++) {
        SCOPED_TRACE(kColourWords[i]);
        ASSERT_EQ(0, h.dut.pc(std::string("LCDMoudle testItem ") + kColourWords[i]).first);
        h.shotWhen("lcd_pc.png", [&](const Png &p) { return filled(p, kFive[i]); });
        EXPECT_EQ(1, fullScreenWindows(h));
    }
    EXPECT_EQ(1u, h.dut.logCount("FTX_LCD: create_colour_window end"));
    EXPECT_EQ(0, h.dut.pc("LCDMoudle testItem close").first);
    EXPECT_EQ(0, fullScreenWindows(h));
    // The menu is back with its soft-key bar.
    h.shotWhen("lcd_pc_closed.png", [](const Png &p) {
        const unsigned char *bar = p.at(360, 1270);
        return bar[0] == 0x1C && bar[1] == 0x22 && bar[2] == 0x2B;
    });
}

TEST(LcdPc, AGrayLevelKeepsTheWindowAgainstTouchesUntilClose) {
    Handset h({kLcd});
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.dut.waitChannel());
    EXPECT_EQ(2, h.dut.pc("GrayLevelMoudle testItem set ,,").first);
    EXPECT_EQ(0, fullScreenWindows(h));
    ASSERT_EQ(0, h.dut.pc("GrayLevelMoudle testItem set 128,128,128").first);
    EXPECT_TRUE(h.dut.waitLog("mmi_AutoTest_GrayLevel_Set RGB value: 128 128 128"));
    EXPECT_TRUE(h.dut.waitLog("RGB int value: 8421504"));
    ASSERT_TRUE(h.dut.waitLog(kFoolProofEnd));
    tap(h);
    ASSERT_TRUE(h.dut.waitLog(kTouchIgnored));
    EXPECT_EQ(1, fullScreenWindows(h));
    ASSERT_EQ(0, h.dut.pc("GrayLevelMoudle testItem set close").first);
    EXPECT_TRUE(dut_wait_until([&] { return fullScreenWindows(h) == 0; }, 5000));
}

TEST(LcdPc, HueAndHueRegistersWriteThePanelFilesAndRefuseBadRequests) {
    Handset h({kLcd});
    h.dut.write("/proc/panel_hue_dll_main_switch", "");
    h.dut.write("/proc/panel_hue_dll_main1_switch", "");
    h.dut.write("/data/panel_hue_dll_main_switch_temp", "0x12 0x34\n\n");
    h.dut.write("/data/panel_hue_dll_main1_switch_temp", "0x56\n");
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.dut.waitChannel());

    EXPECT_EQ(0, h.dut.pc("HueMoudle testItem set main,3").first);
    EXPECT_EQ("3\n", h.dut.read("/proc/panel_hue_main_switch"));
    EXPECT_EQ(2, h.dut.pc("HueMoudle testItem set main").first);
    EXPECT_EQ(2, h.dut.pc("HueMoudle testItem set ../../data/x,3").first);
    EXPECT_FALSE(h.dut.exists("/data/x_switch"));

    // An unknown panel or a missing field changes nothing.
    EXPECT_EQ(2, h.dut.pc("HueRegMoudle testItem set main,reg,lg").first);
    EXPECT_EQ(2, h.dut.pc("HueRegMoudle testItem set main,reg").first);
    EXPECT_EQ("", h.dut.read("/proc/panel_hue_dll_main_switch"));
    // The panel of one register file, and of two.
    EXPECT_EQ(0, h.dut.pc("HueRegMoudle testItem set main,reg,truly").first);
    EXPECT_EQ("0x12 0x34", h.dut.read("/proc/panel_hue_dll_main_switch"));
    EXPECT_EQ("", h.dut.read("/proc/panel_hue_dll_main1_switch"));
    EXPECT_EQ(0, h.dut.pc("HueRegMoudle testItem set main,reg,jdi").first);
    EXPECT_EQ("0x56", h.dut.read("/proc/panel_hue_dll_main1_switch"));
    EXPECT_EQ(0, h.dut.pc("HueRegMoudle testItem set main,default,jdi").first);
    EXPECT_EQ("\n", h.dut.read("/proc/panel_hue_dll_main_switch"));
    // A register the panel does not have.
    EXPECT_EQ(2, h.dut.pc("HueRegMoudle testItem set gamma,reg,truly").first);
}

TEST(LcdPc, TurnOffWakeUpAndCabcReachTheirFiles) {
    Handset h({kLcd});
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.dut.waitChannel());
    EXPECT_EQ(0, h.dut.pc("LCDTurnoffMoudle testItem").first);
    EXPECT_EQ("4\n", h.dut.read("/sys/class/graphics/fb0/blank"));
    EXPECT_EQ(0, h.dut.pc("LCDWakeupMoudle testItem").first);
    EXPECT_EQ("0\n", h.dut.read("/sys/class/graphics/fb0/blank"));
    EXPECT_NE(std::string::npos, h.dut.console("hw status").find("ftx_api_LCD_Refresh(arg=0) x1"));
    EXPECT_EQ(0, h.dut.pc("CABCMoudle testItem open").first);
    EXPECT_EQ("2\n", h.dut.read("/proc/panel_cabc_level_switch"));
    EXPECT_EQ(0, h.dut.pc("CABCMoudle testItem close").first);
    EXPECT_EQ("0\n", h.dut.read("/proc/panel_cabc_level_switch"));
}

TEST(MonomerLcd, FiveColoursWithoutDelayThenTheNextPreviewScreen) {
    // The preview's touch screen follows its colours.
    Handset h({kLcd, {"FTX_TOUCH", 1, 0, 1}});
    h.dut.setConfig("FTX_TPSELF", "enable", "0");
    h.dut.setConfig("FTX_MONOMER_HARDVERSION", "enable", "0");
    ASSERT_TRUE(h.start());
    h.key(108);
    h.key(108);
    h.key(28);  // the preview: its colours are the first screen left
    for (int i = 0; i < 5; i++) {
        SCOPED_TRACE(i);
        h.shotWhen("monomer_lcd.png", [&](const Png &p) { return filled(p, kFive[i]); });
        tap(h);
    }
    EXPECT_TRUE(h.waitActive("Touch Test"));
    EXPECT_EQ(0u, h.dut.logCount("WaitForFoolProofLcd begin"));
    EXPECT_EQ(1, fullScreenWindows(h));  // the touch test's, the colours' is gone
    EXPECT_EQ(0, h.result(280));
}

const Item kAuxHint = {"FTX_AUXLCD_HINT", 1, 0, 1};

// The LCD item of a run: five colours, then pass on the confirmation.
void passLcd(Handset &h, size_t foolProofEndsBefore) {
    for (int i = 0; i < 5; i++) {
        SCOPED_TRACE(i);
        h.shotWhen("lcd_run.png", [&](const Png &p) { return filled(p, kFive[i]); });
        ASSERT_TRUE(h.dut.waitLogCount(kFoolProofEnd, foolProofEndsBefore + (size_t)i + 1));
        tap(h);
    }
    ASSERT_TRUE(h.waitActive("LCD Color Test"));
    h.key(60);
}

TEST(AuxLcdRun, BothLcdPassesRunAcrossTheRestartBetweenThem) {
    Handset h({kLcd, kAuxHint});
    h.dut.setConfig("MMI", "aux_lcd", "1");
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.dut.waitChannel());
    h.openDeviceList();
    h.chooseRow(0);
    passLcd(h, 0);
    // The hint ends the main pass: item 64 stays failed and the process ends.
    ASSERT_TRUE(h.waitActive("Auxiliary LCD Test"));
    Png hint = h.shotWhen("aux_lcd_hint.png", [](const Png &p) {
        return p.count(90, 100, 630, 300, light) > 50 && p.count(0, 1185, 240, 1280, light) > 20;
    });
    h.key(60);
    ASSERT_EQ(0, h.dut.wait(10000));
    EXPECT_TRUE(h.dut.exists("/data/pv_aux_lcd_test_flag"));
    EXPECT_TRUE(h.dut.logPos("the main LCD pass is over") != std::string::npos);

    // The next start: the full run is the auxiliary pass, whose list holds the LCD only.
    h.dut.write("/data/fb0_black_flag", "");
    const size_t ends = h.dut.logCount(kFoolProofEnd);
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.dut.waitChannel());
    EXPECT_EQ(2, h.result(64));
    h.openDeviceList();
    h.chooseRow(0);
    ASSERT_TRUE(h.dut.waitLog("Get_AuxLCD_TestItem_Config domain=FTX_LCD,enable=1"));
    EXPECT_EQ("0\n", h.dut.read("/proc/touchscreen/ts_main_ctrl"));
    passLcd(h, ends);
    ASSERT_EQ(0, h.dut.wait(10000));
    const std::string log = h.dut.logcat();
    const size_t black = log.find("rm /data/fb0_black_flag"),
                 touch = log.find("echo 1 > /proc/touchscreen/ts_main_ctrl"),
                 flag = log.find("rm /data/pv_aux_lcd_test_flag");
    ASSERT_NE(std::string::npos, black);
    EXPECT_LT(black, touch);
    EXPECT_LT(touch, flag);
    EXPECT_NE(std::string::npos, log.find("the auxiliary LCD pass is over"));
    EXPECT_FALSE(h.dut.exists("/data/fb0_black_flag"));
    EXPECT_FALSE(h.dut.exists("/data/pv_aux_lcd_test_flag"));
    EXPECT_EQ("1\n", h.dut.read("/proc/touchscreen/ts_main_ctrl"));
    // The auxiliary pass ends like every full run, with the preview item passed.
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.dut.waitChannel());
    EXPECT_EQ(1, h.result(64));
    EXPECT_EQ(1, h.result(280));
}

TEST(LcdPc, ThePanelTypeComesFromTheImage) {
    Handset h({kLcd});
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.dut.waitChannel());
    auto r = h.dut.pc("LCDType testItem read");
    EXPECT_EQ(0, r.first);
    EXPECT_EQ("JDI", r.second);
    h.dut.stop();
    h.dut.setDeviceIni("panel", "type", "Truly");
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.dut.waitChannel());
    r = h.dut.pc("LCDType testItem read");
    EXPECT_EQ(0, r.first);
    EXPECT_EQ("Truly", r.second);
}

TEST(LcdPc, TheBacklightLevelReachesTheModelAndTheEndGivesTheBrightnessBack) {
    Handset h({kLcd});
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.dut.waitChannel());
    ASSERT_EQ(0, h.dut.pc("LCDbacklightMoudle testItem 40").first);
    EXPECT_NE(std::string::npos, h.dut.console("hw status").find("display: backlight=40 lcd=on"));
    EXPECT_EQ("40\n", h.dut.read("/sys/class/leds/lcd-backlight/brightness"));
    ASSERT_EQ(0, h.dut.pc("LCDbacklightTestMoudle testItem close").first);
    EXPECT_NE(std::string::npos, h.dut.console("hw status").find("display: backlight=end"));
    EXPECT_EQ("255\n", h.dut.read("/sys/class/leds/lcd-backlight/brightness"));
}

// The picture's own colour at the screen's left edge (the first stripe is coloured).
bool picture(const Png &p, Colour stripe) {
    const unsigned char *edge = p.at(4, 100), *middle = p.at(360, 640);
    return edge[0] == stripe.r && edge[1] == stripe.g && edge[2] == stripe.b && middle[0] == 255 &&
           middle[1] == 255 && middle[2] == 255;
}

TEST(LcdPictures, ShowImageDrawsTheNumberedPictureUntilClose) {
    Handset h({kLcd});
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.dut.waitChannel());
    EXPECT_EQ(2, h.dut.pc("commonModule testItem showImage").first);
    EXPECT_EQ(0, fullScreenWindows(h));

    ASSERT_EQ(0, h.dut.pc("commonModule testItem showImage 10").first);
    EXPECT_TRUE(h.dut.waitLog("showPictureByIndex /vendor/etc/data/ratio_25_0010.png"));
    h.shotWhen("calibration_picture.png", [](const Png &p) { return picture(p, {220, 40, 150}); });
    ASSERT_EQ(0, h.dut.pc("commonModule testItem showImage 9").first);
    EXPECT_TRUE(h.dut.waitLog("showPictureByIndex /vendor/etc/data/ratio_25_0009.png"));
    h.shotWhen("calibration_picture_9.png", [](const Png &p) {
        return picture(p, {180, 50, 210});
    });
    EXPECT_EQ(1, fullScreenWindows(h));
    // Touches leave a picture alone.
    tap(h);
    ASSERT_TRUE(h.dut.waitLog(kTouchIgnored));
    ASSERT_EQ(0, h.dut.pc("commonModule testItem close").first);
    EXPECT_EQ(0, fullScreenWindows(h));
}

TEST(AuxDisplay, ColourCommandsPaintTheSecondDisplayAndCloseEndsItsProgram) {
    Handset h({kLcd});
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.dut.waitChannel());
    EXPECT_NE(std::string::npos, h.dut.console("screen").find("aux size 240x320\naux off"));
    for (int i = 0; i < 5; i++) {
        SCOPED_TRACE(kColourWords[i]);
        ASSERT_EQ(0, h.dut.pc(std::string("LCDMoudle testItem ") + kColourWords[i] + " aux").first);
        EXPECT_TRUE(dut_wait_until(
            [&] {
                Png p = h.shot("aux_display.png", true);
                return p.w == 240 && p.h == 320 && filled(p, kFive[i]);
            },
            5000));
        if (i == 1) h.keepForDocs("aux_display.png", "aux_display_red.png");
    }
    EXPECT_NE(std::string::npos, h.dut.console("screen").find("aux on"));
    // The main display is not touched.
    EXPECT_EQ(0, fullScreenWindows(h));
    ASSERT_EQ(0, h.dut.pc("LCDMoudle testItem close aux").first);
    EXPECT_TRUE(dut_wait_until(
        [&] { return h.dut.console("screen").find("aux off") != std::string::npos; }, 5000));
    // The program took its close flag with it and is gone.
    EXPECT_TRUE(dut_wait_until([&] { return !h.dut.exists("/run/fb1.pid"); }, 5000));
    EXPECT_FALSE(h.dut.exists("/data/fb1_close_flag"));
    EXPECT_TRUE(filled(h.shot("aux_display_off.png", true), {0, 0, 0}));
    // One start of the program for each colour, in turn.
    const std::string tools = h.dut.read("/log/tools.txt");
    size_t at = 0;
    for (int i = 0; i < 5; i++) {
        at = tools.find("mmi_open_fb1 1 " + std::to_string(i) + "\n", at);
        EXPECT_NE(std::string::npos, at) << i;
    }
}

}  // namespace

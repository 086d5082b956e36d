// The display tests' pieces that do not need a window: the colour tables, the picture
// names, the gray-level value, the PC request fields and the panel's files.
#include <stdint.h>
#include <string.h>

#include <string>

#include <gtest/gtest.h>

#include "mmi_theme.h"
#include "support/temp_root.h"
#include "testwnd/display/mmi_lcd_panel.h"
#include "testwnd/display/mmi_testwnd_lcd.h"

namespace {

// The screen's palette, as the GUI fills it at start.
class LcdTable : public ::testing::Test {
  protected:
    void SetUp() override {
        for (int i = 0; i < 23; i++)
            saved_[i] = SysPixelIndex[i];
        SysPixelIndex[MMI_COLOUR_LIGHT_WHITE] = 0xFFFFFF;
        SysPixelIndex[MMI_COLOUR_DARK_GRAY] = 0x808080;
        SysPixelIndex[MMI_COLOUR_PURE_RED] = 0xFF0000;
        SysPixelIndex[MMI_COLOUR_PURE_GREEN] = 0x00FF00;
        SysPixelIndex[MMI_COLOUR_PURE_BLUE] = 0x0000FF;
        SysPixelIndex[MMI_COLOUR_BLACK] = 0x000000;
    }
    void TearDown() override {
        for (int i = 0; i < 23; i++)
            SysPixelIndex[i] = saved_[i];
    }
    gal_pixel saved_[23];
};

TEST_F(LcdTable, FiveColoursStartOneStepBelowWhiteSixWithExactWhiteAndDarkGray) {
    uint32_t t[MMI_LCD_MAX_COLOURS] = {};
    ASSERT_EQ(5, mmi_lcd_colour_table("5", 0, t));
    const uint32_t five[] = {0xFFFFFE, 0xFF0000, 0x00FF00, 0x0000FF, 0x000000};
    for (int i = 0; i < 5; i++)
        EXPECT_EQ(five[i], t[i]) << i;

    ASSERT_EQ(6, mmi_lcd_colour_table("6", 0, t));
    const uint32_t six[] = {0xFFFFFF, 0x808080, 0xFF0000, 0x00FF00, 0x0000FF, 0x000000};
    for (int i = 0; i < 6; i++)
        EXPECT_EQ(six[i], t[i]) << i;

    uint32_t preview[MMI_LCD_MAX_COLOURS] = {};
    ASSERT_EQ(5, mmi_lcd_monomer_table(preview));
    EXPECT_EQ(0, memcmp(five, preview, sizeof(five)));
}

TEST_F(LcdTable, TheCountFollowsColornumWithinTheTableAndMmiTwoShowsOne) {
    uint32_t t[MMI_LCD_MAX_COLOURS] = {};
    EXPECT_EQ(3, mmi_lcd_colour_table("3", 0, t));
    EXPECT_EQ(0xFFFFFEu, t[0]);  // any count but 6 uses the five-colour table
    EXPECT_EQ(5, mmi_lcd_colour_table("9", 0, t));
    EXPECT_EQ(1, mmi_lcd_colour_table("0", 0, t));
    EXPECT_EQ(1, mmi_lcd_colour_table("junk", 0, t));
    EXPECT_EQ(1, mmi_lcd_colour_table("6", 2, t));
    EXPECT_EQ(0xFFFFFFu, t[0]);
    EXPECT_EQ(5, mmi_lcd_colour_table("5", 1, t));
}

TEST(LcdPictures, NamesHaveFourDigitsAndGrayLevelsPackAsStored) {
    char path[MMI_LCD_PICTURE_PATH_SIZE];
    mmi_lcd_picture_path(9, path, sizeof(path));
    EXPECT_STREQ("/vendor/etc/data/ratio_25_0009.png", path);
    mmi_lcd_picture_path(10, path, sizeof(path));
    EXPECT_STREQ("/vendor/etc/data/ratio_25_0010.png", path);
    mmi_lcd_picture_path(0, path, sizeof(path));
    EXPECT_STREQ("/vendor/etc/data/ratio_25_0000.png", path);

    EXPECT_EQ(8421504L, mmi_lcd_pack_gray(128, 128, 128));
    // Green is cut to 16 bits after its shift: its high bits are lost.
    EXPECT_EQ(0xFFFFFFL, mmi_lcd_pack_gray(255, 255, 255));
    EXPECT_EQ(0x10000L, mmi_lcd_pack_gray(0, 256, 1));
}

TEST(LcdRequests, FieldsSkipEmptiesAndOnlyPlainWordsReachFilesOrTheShell) {
    mmi_lcd_fields x;
    mmi_lcd_split_fields("main,,reg,jdi,extra", 3, &x);
    ASSERT_EQ(3, x.count);
    EXPECT_STREQ("main", x.f[0]);
    EXPECT_STREQ("reg", x.f[1]);
    EXPECT_STREQ("jdi", x.f[2]);
    mmi_lcd_split_fields(",", 3, &x);
    EXPECT_EQ(0, x.count);
    mmi_lcd_split_fields(nullptr, 3, &x);
    EXPECT_EQ(0, x.count);
    const std::string longField(200, 'a');
    mmi_lcd_split_fields(longField.c_str(), 3, &x);
    EXPECT_EQ(MMI_LCD_FIELD_SIZE - 1, (int)strlen(x.f[0]));

    EXPECT_TRUE(mmi_lcd_plain_field("main_1", false));
    EXPECT_TRUE(mmi_lcd_plain_field("2.5", true));
    EXPECT_FALSE(mmi_lcd_plain_field("2.5", false));
    for (const char *bad : {"", "../x", "a b", "a;rm", "$(x)", "a/b", "a>b"})
        EXPECT_FALSE(mmi_lcd_plain_field(bad, true)) << bad;
}

TEST(LcdPanelFiles, RegisterFilesAreCopiedWithoutLineEndsAndNeverCreated) {
    TempRoot root;
    char buf[16];
    EXPECT_EQ(-1, read_regvalue_from_file("/data/none", buf, 15));
    root.write("/data/r", "0x1 0x2\n\n");
    EXPECT_EQ(7, read_regvalue_from_file("/data/r", buf, 15));
    EXPECT_STREQ("0x1 0x2", buf);
    EXPECT_EQ(3, read_regvalue_from_file("/data/r", buf, 3));  // cut at the length
    EXPECT_STREQ("0x1", buf);

    EXPECT_EQ(-1, write_regvalue_to_file("/proc/panel_hue_dll_x_switch", "1"));
    EXPECT_FALSE(root.exists("/proc/panel_hue_dll_x_switch"));
    root.write("/proc/panel_hue_dll_x_switch", "old text");
    EXPECT_EQ(3, write_regvalue_to_file("/proc/panel_hue_dll_x_switch", "new"));

    // Unknown panels and actions touch nothing.
    root.write("/data/panel_hue_dll_x_switch_temp", "9");
    for (const char *req : {"x,reg,lg", "x,apply,truly", "x,reg", "x/..,reg,truly"})
        EXPECT_EQ(0, mmi_AutoTest_Hue_Register_Set(req, 0, nullptr, 0)) << req;
    EXPECT_EQ("new", root.read("/proc/panel_hue_dll_x_switch"));
    EXPECT_EQ(1, mmi_AutoTest_Hue_Register_Set("x,reg,truly", 0, nullptr, 0));
    EXPECT_EQ("9", root.read("/proc/panel_hue_dll_x_switch"));
    // The second register file of a JDI panel is missing: the request fails.
    EXPECT_EQ(0, mmi_AutoTest_Hue_Register_Set("x,reg,jdi", 0, nullptr, 0));
}

TEST(LcdPanelFiles, ThePanelTypeComesFromItsMarker) {
    TempRoot root;
    char reply[32] = "untouched";
    EXPECT_EQ(0, mmi_AutoTest_LCDType_Read("", 0, reply, sizeof(reply)));
    root.write("/proc/msm_lcd", "panel: none\n");
    EXPECT_EQ(1, mmi_AutoTest_LCDType_Read("", 0, reply, sizeof(reply)));
    EXPECT_STREQ("untouched", reply);
    root.write("/proc/msm_lcd", "mdss_dsi_dvkTruly_hx8399\n");
    EXPECT_EQ(1, mmi_AutoTest_LCDType_Read("", 0, reply, sizeof(reply)));
    EXPECT_STREQ("Truly", reply);
    root.write("/proc/msm_lcd", "dvkJDI dvkTruly");
    EXPECT_EQ(1, mmi_AutoTest_LCDType_Read("", 0, reply, sizeof(reply)));
    EXPECT_STREQ("JDI", reply);
}

}  // namespace

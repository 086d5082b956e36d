// The display commands: the LCD's and the auxiliary display's colours, gray level, hue,
// panel type, backlight, wake-up and turn-off, CABC and the calibration pictures.
#include <stdlib.h>

#include "adbd_connection/handlers/common.h"
#include "adbd_connection/handlers/handlers.h"
#include "core/mmi_loglevel.h"
#include "testwnd/display/mmi_lcd_panel.h"
#include "testwnd/display/mmi_testwnd_lcd.h"

namespace {

// The level that ends the backlight test.
const unsigned int kBacklightEnd = 102;

// The colour commands name a position of the colour table: 0 white, 1 red, 2 green,
// 3 blue, 4 black.
enum { kWhite, kRed, kGreen, kBlue, kBlack };

int lcd_colour(const char *who, int index) {
    at_log_begin(who);
    return mmi_AutoTest_LCDColorTestEntry(index);
}

int aux_colour(const char *who, int index) {
    at_log_begin(who);
    return mmi_AutoTest_AUX_LCDColorTestEntry(index);
}

}  // namespace

#define AT_COLOUR_HANDLER(name, start, index)           \
    int name(const char *, int, char *, unsigned int) { \
        return start(__func__, index);                  \
    }
AT_COLOUR_HANDLER(AutoTest_LCD_White_Start, lcd_colour, kWhite)
AT_COLOUR_HANDLER(AutoTest_LCD_Red_Start, lcd_colour, kRed)
AT_COLOUR_HANDLER(AutoTest_LCD_Green_Start, lcd_colour, kGreen)
AT_COLOUR_HANDLER(AutoTest_LCD_Blue_Start, lcd_colour, kBlue)
AT_COLOUR_HANDLER(AutoTest_LCD_Black_Start, lcd_colour, kBlack)
AT_COLOUR_HANDLER(AutoTest_AUX_LCD_White_Start, aux_colour, kWhite)
AT_COLOUR_HANDLER(AutoTest_AUX_LCD_Red_Start, aux_colour, kRed)
AT_COLOUR_HANDLER(AutoTest_AUX_LCD_Green_Start, aux_colour, kGreen)
AT_COLOUR_HANDLER(AutoTest_AUX_LCD_Blue_Start, aux_colour, kBlue)
AT_COLOUR_HANDLER(AutoTest_AUX_LCD_Black_Start, aux_colour, kBlack)
#undef AT_COLOUR_HANDLER

int AutoTest_LCD_Stop(const char *, int, char *, unsigned int) {
    at_log_begin(__func__);
    return mmi_AutoTest_LCDColorTest_Stop_Entry();
}

int AutoTest_AUX_LCD_Stop(const char *, int, char *, unsigned int) {
    at_log_begin(__func__);
    return mmi_AutoTest_AUX_LCDColorTest_Stop_Entry();
}

int AutoTest_LCDBacklight_Start(const char *parm, int, char *, unsigned int) {
    at_log_begin(__func__);
    return mmi_AutoTest_LCDBacklightTestEntry((unsigned int)atoi(parm));
}

int AutoTest_LCDBacklight_Stop(const char *, int, char *, unsigned int) {
    at_log_begin(__func__);
    return mmi_AutoTest_LCDBacklightTestEntry(kBacklightEnd);
}

int AutoTest_LCD_Wakeup(const char *parm, int, char *, unsigned int) {
    at_run_shell(__func__, "echo 0 > /sys/class/graphics/fb0/blank");
    return mmi_AutoTest_LCDRefresh(atoi(parm));
}

int AutoTest_LCD_Turnoff(const char *, int, char *, unsigned int) {
    return at_run_shell(__func__, "echo 4 > /sys/class/graphics/fb0/blank");
}

int AutoTest_CABC_Open(const char *, int, char *, unsigned int) {
    return at_run_shell(__func__, "echo 2 > /proc/panel_cabc_level_switch");
}

int AutoTest_CABC_Close(const char *, int, char *, unsigned int) {
    return at_run_shell(__func__, "echo 0 > /proc/panel_cabc_level_switch");
}

#define AT_PASS_ON_HANDLER(name, entry)                                            \
    int name(const char *parm, int parmLen, char *reply, unsigned int replySize) { \
        at_log_begin(__func__);                                                    \
        return entry(parm, parmLen, reply, replySize);                             \
    }
AT_PASS_ON_HANDLER(AutoTest_DualLCD_Hue_Set, mmi_AutoTest_Hue_Set)
AT_PASS_ON_HANDLER(AutoTest_DualLCD_Hue_Register_Set, mmi_AutoTest_Hue_Register_Set)
AT_PASS_ON_HANDLER(AutoTest_DualLCD_GrayLevel_Set, mmi_AutoTest_GrayLevel_Set)
AT_PASS_ON_HANDLER(AutoTest_DualLCD_Switch_Display, mmi_AutoTest_Switch_Display)
AT_PASS_ON_HANDLER(AutoTest_LCDType_Read, mmi_AutoTest_LCDType_Read)
#undef AT_PASS_ON_HANDLER

int PixelWorks_Calibrate_ShowPicture(const char *parm, int parmLen, char *, unsigned int) {
    at_log_begin(__func__);
    if (parm == nullptr || parmLen < 1 || parm[0] == '\0') return 0;
    MMI_LOGD(AT_TAG, "image index %d", atoi(parm));
    return mmi_AutoTest_PW_ShowPicture(atoi(parm));
}

int PixelWorks_Calibrate_ShowPicture_Close(const char *, int, char *, unsigned int) {
    at_log_begin(__func__);
    return mmi_AutoTest_PW_ShowPicture_Close();
}

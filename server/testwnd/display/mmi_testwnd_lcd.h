// The LCD colour test: plain colours over the whole screen, one a touch, then a pass/fail
// confirmation; its PC-driven form (one colour, or a gray level, until "close"); and the
// monomer preview's colour screen, which also shows the calibration pictures.
#pragma once

#include <stddef.h>
#include <stdint.h>

#define MMI_LCD_MAX_COLOURS 6
#define MMI_LCD_PICTURE_PATH_SIZE 64

// Operator-driven test.
void *mmi_LCDColorTestEntry(void);
int mmi_LCDColorTest_Stop_Entry(void);
int mmi_LCDColorTest_Init(void);
void *mmi_CreateLcdColorTestWnd(void);
void *mmi_LCDColorTestCheckResultEntry(void);

// PC-driven: the colour at table position `index` (0 white .. 4 black), its close, and a
// gray level "R,G,B" or "close" (touches do not advance while it is shown).
int mmi_AutoTest_LCDColorTestEntry(int index);
int mmi_AutoTest_LCDColorTest_Stop_Entry(void);
int mmi_AutoTest_GrayLevel_Set(const char *parm, int parmLen, char *reply, unsigned int replySize);

// Monomer preview: five colours, then the next preview screen.
void *mmi_Monomer_LCDColorTestEntry(void);
int mmi_Monomer_LCDColorTest_Stop_Entry(void);
// Calibration pictures on the preview window, until their close.
int mmi_AutoTest_PW_ShowPicture(int index);
int mmi_AutoTest_PW_ShowPicture_Close(void);

// The colour table for a "colornum" value and the item's `mmi` flag: fills `out` (room for
// MMI_LCD_MAX_COLOURS) from the system palette, tells how many entries it filled (5 or 6)
// when `size` is given, and returns how many colours the operator is shown.
int mmi_lcd_colour_table(const char *colornum, int itemMmi, uint32_t *out, int *size = nullptr);
// The preview's five colours.
int mmi_lcd_monomer_table(uint32_t *out);
// The device path of calibration picture `index` (four digits for 0 to 99).
void mmi_lcd_picture_path(int index, char *out, size_t size);
// The packed value of a gray-level request, as it is stored and logged.
long mmi_lcd_pack_gray(int r, int g, int b);

// The display's panel and its neighbours, driven from the PC: hue and hue registers, the
// panel type, the backlight level, the refresh, the auxiliary display and the switch
// between the two displays. Each answers 1 when done, 0 when refused.
#pragma once

#include <stddef.h>

#include "testwnd/display/mmi_lcd_request.h"

// "NAME,VALUE": the value into the panel's hue switch of that name.
int mmi_AutoTest_Hue_Set(const char *parm, int parmLen, char *reply, unsigned int replySize);
// "NAME,ACTION,PANEL": ACTION "reg" copies the prepared register file(s) of NAME into the
// panel, "default" clears them; PANEL "truly" or "jdi".
int mmi_AutoTest_Hue_Register_Set(const char *parm, int parmLen, char *reply,
                                  unsigned int replySize);
// "JDI" or "Truly" into reply, from the panel's description.
int mmi_AutoTest_LCDType_Read(const char *parm, int parmLen, char *reply, unsigned int replySize);
// The backlight level; 102 ends the backlight test.
int mmi_AutoTest_LCDBacklightTestEntry(unsigned int level);
int mmi_AutoTest_LCDRefresh(int arg);
// The auxiliary display's colour (0 white .. 4 black) and its end.
int mmi_AutoTest_AUX_LCDColorTestEntry(int index);
int mmi_AutoTest_AUX_LCDColorTest_Stop_Entry(void);
// "main" or "aux": which display shows and takes touches.
int mmi_AutoTest_Switch_Display(const char *parm, int parmLen, char *reply, unsigned int replySize);

// A register file's text, up to length bytes, trailing line feeds dropped; buffer holds
// length + 1. The length left, or -1.
int read_regvalue_from_file(const char *path, char *buffer, int length);
// Writes text whole; the count written, or -1.
int write_regvalue_to_file(const char *path, const char *text);

// The light test: the item's lights one after the other, each switched on while the
// operator is asked whether it is lit (pass moves to the next, fail fails the test). Also the
// PC's single lights and the light control (every light at once).
#pragma once

void *mmi_testwnd_AllLightTestEntry(void);
int mmi_testwnd_AllLightTest_Stop_Entry(void);

// The PC's lights: 1 when the library switched the light, else 0. A start closes every open
// test window first; a light whose operations the library lacks is logged and left alone.
int mmi_AutoTest_LEDColorTestEntry(const char *colour);  // "red", "green", "orange"
int mmi_AutoTest_LEDColorTest_Stop_Entry(void);
int mmi_AutoTest_KeyBacklightTestEntry(void);
int mmi_AutoTest_KeyBacklight_Stop_Entry(void);
int mmi_AutoTest_FlashlightTestEntry(const char *parm);  // the back flashlight
int mmi_AutoTest_Flashlight_Stop_Entry(void);
int mmi_AutoTest_BackFlashlight2_TestEntry(void);
int mmi_AutoTest_BackFlashlight2_Stop_Entry(void);
int mmi_AutoTest_Front_FlashlightTestEntry(const char *parm);
int mmi_AutoTest_Front_Flashlight_Stop_Entry(void);
// Every light on at once, and off.
int mmi_AutoTest_LightControl_Open(void);
int mmi_AutoTest_LightControl_Close(void);

// The lights from the PC: the LED's colours, the key backlight, the three flashlights, and
// the light control (every light at once, with the Wi-Fi link to the PC switched off first).
#include <android/log.h>

#include "adbd_connection/handlers/common.h"
#include "adbd_connection/handlers/handlers.h"
#include "core/ftx_lib_binding.h"
#include "core/mmi_loglevel.h"
#include "testwnd/lights/mmi_testwnd_alllight.h"

#define LIGHT_HANDLER(handler, call)                       \
    int handler(const char *, int, char *, unsigned int) { \
        at_log_begin(__func__);                            \
        return call;                                       \
    }

LIGHT_HANDLER(AutoTest_LED_Red_Start, mmi_AutoTest_LEDColorTestEntry("red"))
LIGHT_HANDLER(AutoTest_LED_Green_Start, mmi_AutoTest_LEDColorTestEntry("green"))
LIGHT_HANDLER(AutoTest_LED_Orange_Start, mmi_AutoTest_LEDColorTestEntry("orange"))
LIGHT_HANDLER(AutoTest_LED_Stop, mmi_AutoTest_LEDColorTest_Stop_Entry())
LIGHT_HANDLER(AutoTest_KEYBacklight_Start, mmi_AutoTest_KeyBacklightTestEntry())
LIGHT_HANDLER(AutoTest_KEYBacklight_Stop, mmi_AutoTest_KeyBacklight_Stop_Entry())
LIGHT_HANDLER(AutoTest_flashlight_Start, mmi_AutoTest_FlashlightTestEntry("autotest"))
LIGHT_HANDLER(AutoTest_flashlight_Stop, mmi_AutoTest_Flashlight_Stop_Entry())
LIGHT_HANDLER(AutoTest_flashlight2_Start, mmi_AutoTest_BackFlashlight2_TestEntry())
LIGHT_HANDLER(AutoTest_flashlight2_Stop, mmi_AutoTest_BackFlashlight2_Stop_Entry())
LIGHT_HANDLER(AutoTest_flashlight_front_Stop, mmi_AutoTest_Front_Flashlight_Stop_Entry())
LIGHT_HANDLER(AutoTest_LightControl_Close, mmi_AutoTest_LightControl_Close())

int AutoTest_flashlight_front_Start(const char *parm, int, char *, unsigned int) {
    at_log_begin(__func__);
    return mmi_AutoTest_Front_FlashlightTestEntry(parm != nullptr ? parm : "");
}

// The lights draw on the handset's supply: the Wi-Fi link to the PC goes off before they
// come on (what the link switch answers is logged; the lights come on either way).
int AutoTest_LightControl_Open(const char *, int, char *, unsigned int) {
    at_log_begin(__func__);
    const int link =
        hw::mmi_AutoTest_WiFiConCpt_Disable ? hw::mmi_AutoTest_WiFiConCpt_Disable() : -1;
    MMI_LOGD(AT_TAG, "%s::mmi_AutoTest_WiFiConCpt_Disable ret=%d", __func__, link);
    return mmi_AutoTest_LightControl_Open();
}

// The lights' table and the library calls that switch them.
#include "testwnd/lights/mmi_lights.h"

#include <android/log.h>

#include "core/ftx_lib_binding.h"
#include "testwnd/catalogue.h"
#include "testwnd/mmi_testwnd.h"

namespace {

const char *const kTag = catalogue::AllLight.domain;

// No parameter key begins with another's name: a key answers for every key it begins.
const mmi_light kLights[MMI_LIGHTS] = {
    {"back flashlight", MMI_LIGHT_KIND_FLASH, FTX_FLASHLIGHT_BACK, nullptr, "BackFlashlight", "1",
     "info_LightBackFlashlight"},
    {"second back flashlight", MMI_LIGHT_KIND_FLASH, FTX_FLASHLIGHT_BACK2, nullptr,
     "SecondBackFlashlight", "0", "info_LightBackFlashlight2"},
    {"front flashlight", MMI_LIGHT_KIND_FLASH, FTX_FLASHLIGHT_FRONT, nullptr, "FrontFlashlight",
     "1", "info_LightFrontFlashlight"},
    {"red LED", MMI_LIGHT_KIND_LED, 0, "red", "LedRed", "1", "info_LightLedRed"},
    {"green LED", MMI_LIGHT_KIND_LED, 0, "green", "LedGreen", "1", "info_LightLedGreen"},
    {"orange LED", MMI_LIGHT_KIND_LED, 0, "orange", "LedOrange", "1", "info_LightLedOrange"},
    {"key backlight", MMI_LIGHT_KIND_KEYS, 0, nullptr, "KeyBacklight", "1",
     "info_LightKeyBacklight"},
    {"all lights", MMI_LIGHT_KIND_ALL, 0, nullptr, nullptr, nullptr, nullptr},
};

struct Binder {
    int (*fn)(void);
    const char *name;
};
// By kind.
const Binder kBinders[] = {
    {Init_lib_Flashlight_Interface, "Init_lib_Flashlight_Interface"},
    {Init_lib_LED_Interface, "Init_lib_LED_Interface"},
    {Init_lib_KeyBacklight_Interface, "Init_lib_KeyBacklight_Interface"},
    {Init_lib_Alllight_Interface, "Init_lib_Alllight_Interface"},
};

// The library's call for the light; *op names it for the log.
int call_library(const mmi_light &l, bool on, const char **op) {
    switch (l.kind) {
        case MMI_LIGHT_KIND_FLASH:
            *op = on ? "ftx_api_FlashlightTest_Start" : "ftx_api_FlashlightTest_Stop";
            if (!hw::ftx_api_FlashlightTest_Start || !hw::ftx_api_FlashlightTest_Stop) return -1;
            return on ? hw::ftx_api_FlashlightTest_Start(l.flashlight)
                      : hw::ftx_api_FlashlightTest_Stop(l.flashlight);
        case MMI_LIGHT_KIND_LED:
            *op = on ? "ftx_api_LEDColorTest_Start" : "ftx_api_LEDColorTest_Stop";
            if (!hw::ftx_api_LEDColorTest_Start || !hw::ftx_api_LEDColorTest_Stop) return -1;
            return on ? hw::ftx_api_LEDColorTest_Start(l.colour) : hw::ftx_api_LEDColorTest_Stop();
        case MMI_LIGHT_KIND_KEYS:
            *op = on ? "ftx_api_KeyBacklightTest_Start" : "ftx_api_KeyBacklightTest_Stop";
            if (!hw::ftx_api_KeyBacklightTest_Start || !hw::ftx_api_KeyBacklightTest_Stop)
                return -1;
            return on ? hw::ftx_api_KeyBacklightTest_Start() : hw::ftx_api_KeyBacklightTest_Stop();
        case MMI_LIGHT_KIND_ALL:
            *op = on ? "ftx_api_AlllightTest_Start" : "ftx_api_AlllightTest_Stop";
            if (!hw::ftx_api_AlllightTest_Start || !hw::ftx_api_AlllightTest_Stop) return -1;
            return on ? hw::ftx_api_AlllightTest_Start() : hw::ftx_api_AlllightTest_Stop();
    }
    return -1;
}

}  // namespace

const mmi_light &mmi_light_of(int id) {
    return kLights[id >= 0 && id < MMI_LIGHTS ? id : MMI_LIGHT_ALL];
}

int mmi_light_steps(const ftx_config_para *p, int n, int *ids, int max) {
    int count = 0;
    for (int id = 0; id < MMI_LIGHTS && count < max; id++) {
        const mmi_light &l = kLights[id];
        if (l.paramKey != nullptr && mmi_testwnd_param_int(p, n, l.paramKey, l.byDefault) != 0)
            ids[count++] = id;
    }
    return count;
}

int mmi_light_bind(int id) {
    const Binder &b = kBinders[mmi_light_of(id).kind];
    if (b.fn() == 0) return 0;
    __android_log_print(ANDROID_LOG_ERROR, kTag, "%s fail: no %s", b.name, mmi_light_of(id).name);
    return -1;
}

int mmi_light_switch(int id, bool on, const char *who) {
    const mmi_light &l = mmi_light_of(id);
    const char *op = "";
    const int rc = call_library(l, on, &op);
    __android_log_print(rc == 0 ? ANDROID_LOG_DEBUG : ANDROID_LOG_ERROR, kTag,
                        "%s::%s %s: %s ret=%d", who, l.name, on ? "on" : "off", op, rc);
    return rc;
}

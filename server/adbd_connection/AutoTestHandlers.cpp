// Handlers that need nothing but the result record, the core-device library and the
// device shell.
#include "adbd_connection/AutoTestHandlers.h"

#include <ctype.h>
#include <stdio.h>
#include <string.h>

#include <android/log.h>

#include "core/mmi_loglevel.h"

#include "devfs.h"
#include "core/ftx_lib_binding.h"
#include "session/mmi_testinfo.h"

namespace {

const char kTag[] = "AtThread";

void log_begin(const char *name) {
    MMI_LOGD(kTag, "%s begin", name);
}

int run_shell(const char *name, const char *line) {
    log_begin(name);
    dev_system(line);
    return 1;
}

// What may follow "iwpriv wlan0 dump": words of the driver's, never shell syntax.
bool is_plain_argument(const char *s) {
    for (; *s != '\0'; s++) {
        unsigned char c = static_cast<unsigned char>(*s);
        if (!isalnum(c) && strchr(" ._,:=-", c) == nullptr) return false;
    }
    return true;
}

}  // namespace

int AutoTest_testinfo(const char *parm, int parmLen, char *reply, unsigned int replySize) {
    if (parmLen < 1) return 0;
    if (strstr(parm, "read") != nullptr) {
        MMI_LOGD(kTag, "%s begin:bufIn=%s", "AutoTest_testinfo_Read", parm);
        return mmi_AutoTest_testinfo_Read(parm, parmLen, reply, replySize);
    }
    if (strstr(parm, "write") != nullptr) {
        MMI_LOGD(kTag, "%s begin:bufIn=%s", "AutoTest_testinfo_Write", parm);
        return mmi_AutoTest_testinfo_Write(parm, parmLen);
    }
    return 0;
}

int AutoTest_FileOpt_Read(const char *parm, int parmLen, char *, unsigned int) {
    MMI_LOGD(kTag, "%s begin,bufIn=%s", __func__, parm);
    if (hw::mmi_AutoTest_FileOpt_Read) hw::mmi_AutoTest_FileOpt_Read(parm, parmLen);
    return 1;
}

int AutoTest_FileOpt_Write(const char *parm, int parmLen, char *, unsigned int) {
    MMI_LOGD(kTag, "%s begin,bufIn=%s", __func__, parm);
    if (hw::mmi_AutoTest_FileOpt_Write) hw::mmi_AutoTest_FileOpt_Write(parm, parmLen);
    return 1;
}

int AutoTest_FileOpt_Remove(const char *parm, int parmLen, char *reply, unsigned int replySize) {
    MMI_LOGD(kTag, "%s begin,bufIn=%s", __func__, parm);
    if (hw::mmi_AutoTest_FileOpt_Remove)
        hw::mmi_AutoTest_FileOpt_Remove(parm, parmLen, reply, replySize);
    return 1;
}

int AutoTest_WiFiConCpt_Enable(const char *, int, char *, unsigned int) {
    log_begin(__func__);
    return hw::mmi_AutoTest_WiFiConCpt_Enable ? hw::mmi_AutoTest_WiFiConCpt_Enable() : 0;
}

int AutoTest_WiFiConCpt_Disable(const char *, int, char *, unsigned int) {
    log_begin(__func__);
    return hw::mmi_AutoTest_WiFiConCpt_Disable ? hw::mmi_AutoTest_WiFiConCpt_Disable() : 0;
}

int AutoTest_LCD_Turnoff(const char *, int, char *, unsigned int) {
    return run_shell(__func__, "echo 4 > /sys/class/graphics/fb0/blank");
}

int AutoTest_CABC_Open(const char *, int, char *, unsigned int) {
    return run_shell(__func__, "echo 2 > /proc/panel_cabc_level_switch");
}

int AutoTest_CABC_Close(const char *, int, char *, unsigned int) {
    return run_shell(__func__, "echo 0 > /proc/panel_cabc_level_switch");
}

int WiFiDataRate_set(const char *parm, int, char *, unsigned int) {
    MMI_LOGD(kTag, "%s begin,bufIn=%s", __func__, parm);
    // The parameter goes into a shell line: anything but plain words is refused.
    if (!is_plain_argument(parm)) {
        __android_log_print(ANDROID_LOG_ERROR, kTag, "%s::refused parameter %s", __func__, parm);
        return 1;
    }
    char line[64];
    snprintf(line, sizeof(line), "iwpriv wlan0 dump %s", parm);
    dev_system(line);
    return 1;
}

int AutoTest_EnterLowCostMode(const char *, int, char *, unsigned int) {
    log_begin(__func__);
    if (!hw::ftx_api_EnterLowCostMode) {
        __android_log_print(ANDROID_LOG_ERROR, kTag, "%s::ftx_api_EnterLostCostMode is NULL.",
                            __func__);
        return 1;
    }
    MMI_LOGD(kTag, "%s::ftx_api_EnterLostCostMode begin", __func__);
    hw::ftx_api_EnterLowCostMode();
    MMI_LOGD(kTag, "%s::ftx_api_EnterLostCostMode end", __func__);
    return 1;
}

// Standby, the MMI subset, the configuration write, power, and the core-device library's
// file operations, Wi-Fi-to-PC link switch and low-cost mode.
#include <android/log.h>

#include "adbd_connection/handlers/common.h"
#include "adbd_connection/handlers/handlers.h"
#include "core/ftx_lib_binding.h"
#include "core/mmi_autotest_config.h"
#include "core/mmi_loglevel.h"
#include "core/mmi_power.h"
#include "screens/mmi_identity.h"

#define HD_DEBUG(...) __android_log_print(ANDROID_LOG_DEBUG, AT_TAG, __VA_ARGS__)

namespace {

typedef int (*switch_fn)(void);

int call(const char *who, switch_fn fn) {
    HD_DEBUG("%s begin", who);
    return fn();
}

}  // namespace

#define SWITCH(handler, fn)                                \
    int handler(const char *, int, char *, unsigned int) { \
        return call(#handler, fn);                         \
    }

SWITCH(AutoTest_Standby_Enable, mmi_AutoTest_Standby_Enable)
SWITCH(AutoTest_Standby_Disable, mmi_AutoTest_Standby_Disable)
SWITCH(AutoTest_MMI_Enable, mmi_AutoTest_MMI_Enable)
SWITCH(AutoTest_MMI_Disable, mmi_AutoTest_MMI_Disable)

int AutoTest_Modify_ConfigFile(const char *parm, int parmLen, char *, unsigned int) {
    HD_DEBUG("%s begin,bufIn=%s", __func__, parm ? parm : "");
    if (!parm || parmLen < 1) return 0;
    return mmi_AutoTest_Modify_ConfigFile(parm);
}

int AutoTest_PowerOff(const char *parm, int parmLen, char *reply, unsigned int replySize) {
    HD_DEBUG("%s begin", __func__);
    return mmi_AutoTest_PowerOff(parm, parmLen, reply, replySize);
}

int AutoTest_Reboot(const char *parm, int parmLen, char *reply, unsigned int replySize) {
    HD_DEBUG("%s begin", __func__);
    return mmi_AutoTest_Reboot(parm, parmLen, reply, replySize);
}

// The file operations always answer success (their text says how it went); the link switch
// answers what the library answers.
int AutoTest_FileOpt_Read(const char *parm, int parmLen, char *, unsigned int) {
    MMI_LOGD(AT_TAG, "%s begin,bufIn=%s", __func__, parm);
    if (hw::mmi_AutoTest_FileOpt_Read) hw::mmi_AutoTest_FileOpt_Read(parm, parmLen);
    return 1;
}

int AutoTest_FileOpt_Write(const char *parm, int parmLen, char *, unsigned int) {
    MMI_LOGD(AT_TAG, "%s begin,bufIn=%s", __func__, parm);
    if (hw::mmi_AutoTest_FileOpt_Write) hw::mmi_AutoTest_FileOpt_Write(parm, parmLen);
    return 1;
}

int AutoTest_FileOpt_Remove(const char *parm, int parmLen, char *reply, unsigned int replySize) {
    MMI_LOGD(AT_TAG, "%s begin,bufIn=%s", __func__, parm);
    if (hw::mmi_AutoTest_FileOpt_Remove)
        hw::mmi_AutoTest_FileOpt_Remove(parm, parmLen, reply, replySize);
    return 1;
}

int AutoTest_WiFiConCpt_Enable(const char *, int, char *, unsigned int) {
    at_log_begin(__func__);
    return hw::mmi_AutoTest_WiFiConCpt_Enable ? hw::mmi_AutoTest_WiFiConCpt_Enable() : 0;
}

int AutoTest_WiFiConCpt_Disable(const char *, int, char *, unsigned int) {
    at_log_begin(__func__);
    return hw::mmi_AutoTest_WiFiConCpt_Disable ? hw::mmi_AutoTest_WiFiConCpt_Disable() : 0;
}

int AutoTest_EnterLowCostMode(const char *, int, char *, unsigned int) {
    at_log_begin(__func__);
    if (!hw::ftx_api_EnterLowCostMode) {
        __android_log_print(ANDROID_LOG_ERROR, AT_TAG, "%s::ftx_api_EnterLostCostMode is NULL.",
                            __func__);
        return 1;
    }
    MMI_LOGD(AT_TAG, "%s::ftx_api_EnterLostCostMode begin", __func__);
    hw::ftx_api_EnterLowCostMode();
    MMI_LOGD(AT_TAG, "%s::ftx_api_EnterLostCostMode end", __func__);
    return 1;
}

// Handlers that start and stop the vibrator, read the handset's identity and battery, and
// switch standby, the MMI subset, the configuration and the power.
#include "adbd_connection/autotest_handlers_device.h"

#include <android/log.h>

#include "session/mmi_autotest.h"
#include "screens/mmi_identity.h"
#include "core/mmi_power.h"
#include "testwnd/mmi_testwnd.h"

#define HD_DEBUG(...) __android_log_print(ANDROID_LOG_DEBUG, "AtThread", __VA_ARGS__)

namespace {

// The PCBA vibration ends by itself after this long.
const int kPcbaVibrationMs = 15000;

typedef int (*reader_fn)(char *reply, unsigned int replySize);
typedef int (*switch_fn)(void);

int read_into(const char *who, reader_fn reader, char *reply, unsigned int replySize) {
    HD_DEBUG("%s begin", who);
    if (!reply || replySize == 0) return 0;
    return reader(reply, replySize);
}

int call(const char *who, switch_fn fn) {
    HD_DEBUG("%s begin", who);
    return fn();
}

}  // namespace

#define READER(handler, reader)                                           \
    int handler(const char *, int, char *reply, unsigned int replySize) { \
        return read_into(#handler, reader, reply, replySize);             \
    }
#define SWITCH(handler, fn)                                \
    int handler(const char *, int, char *, unsigned int) { \
        return call(#handler, fn);                         \
    }

READER(AutoTest_battery_power_Read, mmi_AutoTest_battery_power_Read)
READER(AutoTest_battery_charging_Read, mmi_AutoTest_battery_charging_Read)
READER(AutoTest_battery_temperature_Read, mmi_AutoTest_battery_temperature_Read)
READER(AutoTest_battery_health_Read, mmi_AutoTest_battery_health_Read)
READER(AutoTest_IMEI_Read, mmi_AutoTest_IMEI_Read)
READER(AutoTest_barcode_Read, mmi_AutoTest_barcode_Read)
READER(AutoTest_internalsoftware_Read, mmi_AutoTest_internalsoftware_Read)
READER(AutoTest_externalsoftware_Read, mmi_AutoTest_externalsoftware_Read)
READER(AutoTest_haredware_Read, mmi_AutoTest_hardware_Read)
READER(AutoTest_flashtype_Read, mmi_AutoTest_flashtype_Read)
READER(AutoTest_RAM_Read, mmi_AutoTest_RAM_Status_Read)
READER(AutoTest_ROM_Read, mmi_AutoTest_ROM_Status_Read)

SWITCH(AutoTest_Vibrator_Stop, mmi_AutoTest_VibratorTest_Stop_Entry)
SWITCH(PCBAAutotestVibratorEnd, mmi_AutoTest_VibratorTest_Stop_Entry)
SWITCH(AutoTest_Standby_Enable, mmi_AutoTest_Standby_Enable)
SWITCH(AutoTest_Standby_Disable, mmi_AutoTest_Standby_Disable)
SWITCH(AutoTest_MMI_Enable, mmi_AutoTest_MMI_Enable)
SWITCH(AutoTest_MMI_Disable, mmi_AutoTest_MMI_Disable)

int AutoTest_Vibrator_Start(const char *, int, char *, unsigned int) {
    HD_DEBUG("%s begin", __func__);
    return mmi_AutoTest_VibratorTestEntry(-1);  // until stopped
}

int PCBAAutotestVibratorStart(const char *, int, char *, unsigned int) {
    HD_DEBUG("%s begin", __func__);
    return mmi_AutoTest_VibratorTestEntry(kPcbaVibrationMs);
}

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

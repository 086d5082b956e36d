// The handset's identity and battery, read into the reply.
#include <android/log.h>

#include "adbd_connection/handlers/common.h"
#include "adbd_connection/handlers/handlers.h"
#include "core/mmi_power.h"
#include "screens/mmi_identity.h"

namespace {

typedef int (*reader_fn)(char *reply, unsigned int replySize);

int read_into(const char *who, reader_fn reader, char *reply, unsigned int replySize) {
    __android_log_print(ANDROID_LOG_DEBUG, AT_TAG, "%s begin", who);
    if (!reply || replySize == 0) return 0;
    return reader(reply, replySize);
}

}  // namespace

#define READER(handler, reader)                                           \
    int handler(const char *, int, char *reply, unsigned int replySize) { \
        return read_into(#handler, reader, reply, replySize);             \
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

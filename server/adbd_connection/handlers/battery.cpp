// The battery service's charging switch from the PC: "usbChargeMoudle testItem open|close".
#include "adbd_connection/handlers/common.h"
#include "adbd_connection/handlers/handlers.h"
#include "testwnd/battery/mmi_testwnd_battery.h"

int AutoTest_BatteryCharge_Enable(const char *, int, char *, unsigned int) {
    at_log_begin(__func__);
    return mmi_AutoTest_battery_Charge_Enable();
}

int AutoTest_BatteryCharge_Disable(const char *, int, char *, unsigned int) {
    at_log_begin(__func__);
    return mmi_AutoTest_battery_Charge_Disable();
}

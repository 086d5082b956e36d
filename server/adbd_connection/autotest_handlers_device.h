// PC command handlers of the vibrator, the identity and battery readers, standby, the MMI
// switch, the configuration write and power (signature AtCmdFun; bit 0 is success).
#pragma once

#include "adbd_connection/CmdParse.h"

#define DEVICE_HANDLER(name) \
    int name(const char *parm, int parmLen, char *reply, unsigned int replySize);

#define DEVICE_HANDLERS(X)               \
    X(AutoTest_Vibrator_Start)           \
    X(AutoTest_Vibrator_Stop)            \
    X(PCBAAutotestVibratorStart)         \
    X(PCBAAutotestVibratorEnd)           \
    X(AutoTest_battery_power_Read)       \
    X(AutoTest_battery_charging_Read)    \
    X(AutoTest_battery_temperature_Read) \
    X(AutoTest_battery_health_Read)      \
    X(AutoTest_IMEI_Read)                \
    X(AutoTest_barcode_Read)             \
    X(AutoTest_internalsoftware_Read)    \
    X(AutoTest_externalsoftware_Read)    \
    X(AutoTest_haredware_Read)           \
    X(AutoTest_flashtype_Read)           \
    X(AutoTest_RAM_Read)                 \
    X(AutoTest_ROM_Read)                 \
    X(AutoTest_Standby_Enable)           \
    X(AutoTest_Standby_Disable)          \
    X(AutoTest_MMI_Enable)               \
    X(AutoTest_MMI_Disable)              \
    X(AutoTest_Modify_ConfigFile)        \
    X(AutoTest_PowerOff)                 \
    X(AutoTest_Reboot)

DEVICE_HANDLERS(DEVICE_HANDLER)
#undef DEVICE_HANDLER

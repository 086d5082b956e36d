// The handset's identity and state as the PC and the information screen read them: IMEI
// (through the test-information callback), bar code, software and hardware versions,
// flash type, RAM, ROM and the battery observer's last values. Value answers are "*"
// followed by the value, except the IMEI, which is the bare text.
#pragma once

#include <stddef.h>

#define MMI_IDENTITY_TEXT_SIZE 256

// Asks the factory library for the test information once per run; the texts arrive
// through its callback. notify (may be HWND 0) gets MSG_CALLBACK when they are in.
void mmi_testinfo_request(void *notifyWindow);
// Copies the IMEI, IMEI2 or PSN text of the test information (FTX_DATATYPE_TESTINFO_...);
// 0 when it has arrived, -1 otherwise.
int mmi_testinfo_text(int datatype, char *out, size_t size);
// Forgets the texts and the request (tests).
void mmi_identity_reset(void);

// Readers: 1 with the answer in reply, 0 on failure.
int mmi_AutoTest_IMEI_Read(char *reply, unsigned int replySize);
int mmi_AutoTest_barcode_Read(char *reply, unsigned int replySize);
int mmi_AutoTest_internalsoftware_Read(char *reply, unsigned int replySize);
int mmi_AutoTest_externalsoftware_Read(char *reply, unsigned int replySize);
int mmi_AutoTest_hardware_Read(char *reply, unsigned int replySize);
int mmi_AutoTest_flashtype_Read(char *reply, unsigned int replySize);
int mmi_AutoTest_RAM_Status_Read(char *reply, unsigned int replySize);
int mmi_AutoTest_ROM_Status_Read(char *reply, unsigned int replySize);
int mmi_AutoTest_battery_power_Read(char *reply, unsigned int replySize);
int mmi_AutoTest_battery_charging_Read(char *reply, unsigned int replySize);
int mmi_AutoTest_battery_temperature_Read(char *reply, unsigned int replySize);
int mmi_AutoTest_battery_health_Read(char *reply, unsigned int replySize);

// Identity texts for the information screen; "" when the library cannot tell.
enum mmi_identity_kind {
    MMI_ID_SOFT_INTERNAL,
    MMI_ID_SOFT_EXTERNAL,
    MMI_ID_HARDWARE,
    MMI_ID_PSN,
    MMI_ID_BOARD,
    MMI_ID_FLASH,
};
int mmi_identity_text(int kind, char *out, size_t size);

// The PC's power and MMI switches.
int mmi_AutoTest_PowerOff(const char *parm, int parmLen, char *reply, unsigned int replySize);
int mmi_AutoTest_Reboot(const char *parm, int parmLen, char *reply, unsigned int replySize);
int mmi_AutoTest_MMI_Enable(void);
int mmi_AutoTest_MMI_Disable(void);

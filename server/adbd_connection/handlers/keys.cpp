// The key and hook-key commands: the PC's open and close, whose close answers which keys
// passed, and the PCBA run's key check.
#include "adbd_connection/handlers/common.h"
#include "adbd_connection/handlers/handlers.h"
#include "testwnd/keys/mmi_testwnd_hookkey.h"
#include "testwnd/keys/mmi_testwnd_keys.h"

int AutoTest_keyboard_Start(const char *, int, char *, unsigned int) {
    at_log_begin(__func__);
    return mmi_AutoTest_KeyTestEntry();
}

int AutoTest_keyboard_Stop(const char *, int, char *reply, unsigned int replySize) {
    at_log_begin(__func__);
    return mmi_AutoTest_KeyTest_Stop_Entry(reply, replySize);
}

int AutoTest_headsethook_Start(const char *, int, char *, unsigned int) {
    at_log_begin(__func__);
    return mmi_AutoTest_HeadsetHookTestEntry();
}

int AutoTest_headsethook_Stop(const char *, int, char *reply, unsigned int replySize) {
    at_log_begin(__func__);
    return mmi_AutoTest_HeadsetHookTest_Stop_Entry(reply, replySize);
}

int PCBAAutotestKeyStart(const char *, int, char *, unsigned int) {
    at_log_begin(__func__);
    return PCBAKeyTestStart();
}

int PCBAAutotestKeyStop(const char *, int, char *, unsigned int) {
    at_log_begin(__func__);
    return PCBAKeyTestStop();
}

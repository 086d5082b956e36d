// The card and peripheral commands: the SIM and SD card reads, the NFC and fingerprint
// windows the PC opens and closes.
#include <stdlib.h>

#include <android/log.h>

#include "adbd_connection/handlers/common.h"
#include "adbd_connection/handlers/handlers.h"
#include "testwnd/cards/mmi_testwnd_cards.h"
#include "testwnd/cards/mmi_testwnd_fingerprint.h"
#include "testwnd/cards/mmi_testwnd_nfc.h"

namespace {

// The index after the command word: leading blanks skipped; "" is 0.
const char *index_text(const char *parm) {
    if (parm == nullptr) return "";
    while (*parm == ' ')
        parm++;
    return parm;
}

}  // namespace

int AutoTest_sim_Read(const char *parm, int, char *reply, unsigned int replySize) {
    at_log_begin(__func__);
    const char *text = index_text(parm);
    // Slots go up to 3: anything above "3" (a letter too) is no index.
    if (text[0] > '3') {
        __android_log_print(ANDROID_LOG_ERROR, AT_TAG, "%s::sim index %s error", __func__, text);
        return 0;
    }
    const int index = atoi(text);
    __android_log_print(ANDROID_LOG_DEBUG, AT_TAG, "%s sim index=%d", __func__, index);
    if (index >= 4) {
        __android_log_print(ANDROID_LOG_ERROR, AT_TAG, "%s::sim index=%d error", __func__, index);
        return 0;
    }
    return mmi_AutoTest_SIM_Status_Read(index, reply, replySize);
}

int AutoTest_SDCard_Read(const char *parm, int, char *reply, unsigned int replySize) {
    at_log_begin(__func__);
    const int index = atoi(index_text(parm));
    if (index != 0) {
        __android_log_print(ANDROID_LOG_ERROR, AT_TAG, "%s::sdcard index=%d error", __func__,
                            index);
        return 0;
    }
    return mmi_AutoTest_SDCARD_Status_Read(0, reply, replySize);
}

int AutoTest_NfcTest_Enable(const char *, int, char *, unsigned int) {
    at_log_begin(__func__);
    return mmi_AutoTest_NfcTestEntry();
}

int AutoTest_NfcTest_Disable(const char *, int, char *reply, unsigned int replySize) {
    at_log_begin(__func__);
    return mmi_AutoTest_NfcTest_Stop_Entry(reply, replySize);
}

int AutoTest_Fingerprint_Start(const char *, int, char *, unsigned int) {
    at_log_begin(__func__);
    return mmi_AutoTest_FingerPrintTestEntry();
}

int AutoTest_Fingerprint_Stop(const char *, int, char *reply, unsigned int replySize) {
    at_log_begin(__func__);
    return mmi_AutoTest_FingerPrintTest_Stop_Entry(reply, replySize);
}

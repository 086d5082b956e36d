// The vibrator from the PC: started until stopped, or for the PCBA run's fixed time.
#include <android/log.h>

#include "adbd_connection/handlers/common.h"
#include "adbd_connection/handlers/handlers.h"
#include "testwnd/misc/mmi_testwnd_vibrator.h"

#define HD_DEBUG(...) __android_log_print(ANDROID_LOG_DEBUG, AT_TAG, __VA_ARGS__)

namespace {

// The PCBA vibration ends by itself after this long.
const int kPcbaVibrationMs = 15000;

int stop(const char *who) {
    HD_DEBUG("%s begin", who);
    return mmi_AutoTest_VibratorTest_Stop_Entry();
}

}  // namespace

int AutoTest_Vibrator_Start(const char *, int, char *, unsigned int) {
    HD_DEBUG("%s begin", __func__);
    return mmi_AutoTest_VibratorTestEntry(-1);  // until stopped
}

int AutoTest_Vibrator_Stop(const char *, int, char *, unsigned int) {
    return stop(__func__);
}

int PCBAAutotestVibratorStart(const char *, int, char *, unsigned int) {
    HD_DEBUG("%s begin", __func__);
    return mmi_AutoTest_VibratorTestEntry(kPcbaVibrationMs);
}

int PCBAAutotestVibratorEnd(const char *, int, char *, unsigned int) {
    return stop(__func__);
}

// The vibrator test, a window of the common pattern.
#include "testwnd/misc/mmi_testwnd_vibrator.h"

#include "testwnd/mmi_testwnd.h"

namespace {

mmi_testwnd_state s_state;

const mmi_testwnd_desc kVibrator = {
    .row = &catalogue::Vibrator,
    .caption = "Vibration Test",
    .titleKey = "title_VibratorTest",
    .noteKey = "info_VibratorNote",
    .foolProofSeconds = 3,
    .start = MMI_HW_OP(ftx_api_Vibrator_Test_Start),
    .stop = MMI_HW_OP(ftx_api_Vibrator_Test_Stop),
    .stopEntrySleepMs = 500,
    .pcStopSleepMs = 200,
    .state = &s_state,
    .stopEntry = mmi_testwnd_VibratorTest_Stop_Entry,
};

}  // namespace

void *mmi_testwnd_VibratorTestEntry(void) {
    return mmi_testwnd_open(&kVibrator, 0);
}

int mmi_testwnd_VibratorTest_Stop_Entry(void) {
    return mmi_testwnd_close(&kVibrator);
}

int mmi_AutoTest_VibratorTestEntry(int mode) {
    return mmi_testwnd_pc_start(&kVibrator, mode);
}

int mmi_AutoTest_VibratorTest_Stop_Entry(void) {
    return mmi_testwnd_pc_stop(&kVibrator);
}

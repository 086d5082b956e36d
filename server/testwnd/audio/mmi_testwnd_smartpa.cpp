// The speaker calibration. The library's answer arrives on its thread and reaches the window
// as MSG_CALLBACK.
#include "testwnd/audio/mmi_testwnd_smartpa.h"

#include <stdio.h>
#include <string.h>

#include <atomic>
#include <string>

#include <android/log.h>

#include "testwnd/audio/mmi_audio_text.h"
#include "testwnd/mmi_testwnd.h"
#include "tp_os.h"

#define PA_DEBUG(...) __android_log_print(ANDROID_LOG_DEBUG, kTag, __VA_ARGS__)
#define PA_ERROR(...) __android_log_print(ANDROID_LOG_ERROR, kTag, __VA_ARGS__)

namespace {

const char *const kTag = catalogue::SmartPaCal.domain;
const int kAnswerTries = 50;  // x 100 ms

enum Result { WAITING = -1, FAILED = 0, PASSED = 1 };

mmi_testwnd_state s_state;
std::atomic<int> s_result{WAITING};
std::atomic<int> s_ohms{0};

int start(void) {
    s_result = WAITING;
    if (!hw::ftx_api_SmartPACalibrate_Start) return -1;
    PA_DEBUG("ftx_api_SmartPACalibrate_Start begin");
    return hw::ftx_api_SmartPACalibrate_Start(smartpa_cal_callback);
}

void note(char *out, unsigned int size) {
    const int result = s_result.load();
    if (result == WAITING) {
        mmi_translate("info_SmartPACal", out, size);
        return;
    }
    mmi_translate(result == PASSED ? "info_SmartPAPass" : "info_SmartPAFail", out, size);
    if (result == PASSED) {
        char ohms[32];
        snprintf(ohms, sizeof(ohms), " %d ohm", s_ohms.load());
        strncat(out, ohms, size - strlen(out) - 1);
    }
}

int hook(HWND hWnd, UINT message, WPARAM, LPARAM) {
    switch (message) {
        case MSG_CREATE:
            if (start() != 0) s_result = FAILED;
            return 0;
        case MSG_CALLBACK:
            InvalidateRect(hWnd, nullptr, TRUE);
            mmi_testwnd_show_keys(hWnd, catalogue::SmartPaCal.titleKey,
                                  s_result.load() == PASSED ? MMI_TIMER_FOOLPROOF : 0);
            return 1;
        default:
            return 0;
    }
}

// The pass label waits for a good calibration.
bool passed(void) {
    return s_result.load() == PASSED;
}

const mmi_testwnd_desc kSmartPa = {
    .row = &catalogue::SmartPaCal,
    .caption = "SmartPA Calibration",
    .noteKey = "info_SmartPACal",
    .stop = MMI_HW_OP(ftx_api_SmartPACalibrate_Stop),
    .stopEntrySleepMs = 100,
    .state = &s_state,
    .stopEntry = mmi_testwnd_SmartPACal_Stop_Entry,
    .bind = Init_lib_SmartPACAL_Interface,
    .note = note,
    .hook = hook,
    .passReady = passed,
};

}  // namespace

void smartpa_cal_callback(module_data *data) {
    if (data == nullptr || data->datatype != FTX_DATATYPE_SMARTPA) return;
    const std::string text = data->data != nullptr ? std::string(data->data, data->totallen) : "";
    int ohms = 0;
    const int result = mmi_smartpa_parse(text.c_str(), &ohms);
    PA_DEBUG("%s::%s result=%d ohms=%d", __func__, text.c_str(), result, ohms);
    s_ohms = ohms;
    s_result = result == PASSED ? PASSED : FAILED;
    HWND hWnd = s_state.hwnd.load();
    if (hWnd != HWND_INVALID) SendMessage(hWnd, MSG_CALLBACK, 1, 0);
}

void *mmi_testwnd_SmartPACalEntry(void) {
    return mmi_testwnd_open(&kSmartPa, 0);
}

int mmi_testwnd_SmartPACal_Stop_Entry(void) {
    return mmi_testwnd_close(&kSmartPa);
}

int mmi_AutoTest_SmartPACalEntry(void) {
    Check_AllTestWnd_Closed();
    if (Init_lib_SmartPACAL_Interface() != 0) return 0;
    if (start() != 0) {
        PA_ERROR("%s::ftx_api_SmartPACalibrate_Start fail", __func__);
        return 0;
    }
    return 1;
}

int mmi_AutoTest_SmartPACal_Calibrate(char *reply, unsigned int size) {
    for (int i = 0; i < kAnswerTries && s_result.load() == WAITING; i++)
        tp_os_usleep(100000);
    if (s_result.load() != PASSED) {
        PA_ERROR("%s::calibration %s", __func__, s_result.load() == WAITING ? "timeout" : "fail");
        return 0;
    }
    if (reply != nullptr && size > 0) snprintf(reply, size, "*%d", s_ohms.load());
    return 1;
}

int mmi_AutoTest_SmartPACal_Stop_Entry(void) {
    return mmi_testwnd_pc_stop(&kSmartPa);
}

// The main-microphone record test. The pass label's delay is the recording time: when it
// ends the recording is played back and only then may the operator pass.
#include "testwnd/audio/mmi_testwnd_mainmic.h"

#include <atomic>

#include <android/log.h>

#include "testwnd/mmi_testwnd.h"
#include "tp_os.h"

#define MIC_DEBUG(...) __android_log_print(ANDROID_LOG_DEBUG, kTag, __VA_ARGS__)
#define MIC_ERROR(...) __android_log_print(ANDROID_LOG_ERROR, kTag, __VA_ARGS__)

namespace {

const char *const kTag = catalogue::MainMicRecord.domain;
const int kRecordSeconds = 3;

enum Phase { PHASE_FAILED = -1, PHASE_RECORDING = 0, PHASE_PLAYING = 1 };

mmi_testwnd_state s_state;
std::atomic<int> s_phase{PHASE_RECORDING};

int record(void) {
    if (!hw::ftx_api_Audio_MainMicRecord_Start) return -1;
    MIC_DEBUG("ftx_api_Audio_MainMicRecord_Start(%d)", kRecordSeconds);
    return hw::ftx_api_Audio_MainMicRecord_Start(kRecordSeconds);
}

int play(void) {
    if (!hw::ftx_api_Audio_MainMicRecord_Play) return -1;
    const int rc = hw::ftx_api_Audio_MainMicRecord_Play();
    MIC_DEBUG("ftx_api_Audio_MainMicRecord_Play rc=%d", rc);
    return rc;
}

void note(char *out, unsigned int size) {
    const int phase = s_phase.load();
    mmi_translate(phase == PHASE_RECORDING ? "info_Recording"
                  : phase == PHASE_PLAYING ? "info_Playing"
                                           : "info_RecordFail",
                  out, size);
}

int hook(HWND hWnd, UINT message, WPARAM wParam, LPARAM) {
    switch (message) {
        case MSG_CREATE:
            s_phase = record() == 0 ? PHASE_RECORDING : PHASE_FAILED;
            if (s_phase.load() == PHASE_FAILED) MIC_ERROR("%s::record fail", __func__);
            return 0;
        case MSG_TIMER:
            if (wParam != MMI_TIMER_FOOLPROOF) return 0;
            if (s_phase.load() == PHASE_RECORDING)
                s_phase = play() == 0 ? PHASE_PLAYING : PHASE_FAILED;
            InvalidateRect(hWnd, nullptr, TRUE);
            return 0;
        default:
            return 0;
    }
}

bool playing(void) {
    return s_phase.load() == PHASE_PLAYING;
}

const mmi_testwnd_desc kMainMic = {
    .row = &catalogue::MainMicRecord,
    .caption = "MainMic Record Test",
    .foolProofSeconds = kRecordSeconds,
    .stop = MMI_HW_OP(ftx_api_Audio_MainMicRecord_Stop),
    .stopEntrySleepMs = 100,
    .state = &s_state,
    .stopEntry = mmi_test_MainMicRecordTest_Stop_Entry,
    .note = note,
    .hook = hook,
    .passReady = playing,
};

}  // namespace

void *mmi_testwnd_MainMicRecordTestEntry(void) {
    return mmi_testwnd_open(&kMainMic, 0);
}

int mmi_test_MainMicRecordTest_Stop_Entry(void) {
    return mmi_testwnd_close(&kMainMic);
}

int mmi_AutoTest_MainMicRecordTestEntry(const char *, int) {
    Check_AllTestWnd_Closed();
    if (record() != 0) {
        MIC_ERROR("%s::record fail", __func__);
        return 0;
    }
    tp_os_usleep((unsigned long)kRecordSeconds * 1000000UL);
    return play() == 0 ? 1 : 0;
}

int mmi_AutoTest_MainMicRecordTest_Stop_Entry(void) {
    return mmi_testwnd_pc_stop(&kMainMic);
}

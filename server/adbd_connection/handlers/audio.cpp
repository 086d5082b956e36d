// The audio commands. The "audioMoudle" starts remember which loop they started, so that
// one "close" stops it; the ring, FM, HiFi, calibration and earpiece rows call their test.
#include <stdlib.h>

#include <android/log.h>

#include "adbd_connection/handlers/common.h"
#include "adbd_connection/handlers/handlers.h"
#include "testwnd/audio/mmi_testwnd_fm.h"
#include "testwnd/audio/mmi_testwnd_loopback.h"
#include "testwnd/audio/mmi_testwnd_mainmic.h"
#include "testwnd/audio/mmi_testwnd_ring.h"
#include "testwnd/audio/mmi_testwnd_smartpa.h"

namespace {

struct AudioLoop {
    int (*start)(const char *parm, int parmLen);  // null: the loop starts nothing
    int (*stop)(void);
};

// By the number each start stores.
const AudioLoop kLoops[] = {
    /* 0 */ {mmi_AutoTest_Audio_Headset_Headset_LoopBackTestEntry,
             mmi_AutoTest_Audio_Headset_Headset_LoopBackTest_Stop_Entry},
    /* 1 */
    {mmi_AutoTest_Audio_Headset_Speaker_LoopBackTestEntry,
     mmi_AutoTest_Audio_Headset_Speaker_LoopBackTest_Stop_Entry},
    /* 2 */
    {mmi_AutoTest_Audio_Headset_Receiver_LoopBackTestEntry,
     mmi_AutoTest_Audio_Headset_Receiver_LoopBackTest_Stop_Entry},
    /* 3 */
    {mmi_AutoTest_Audio_MIC_Headset_LoopBackTestEntry,
     mmi_AutoTest_Audio_MIC_Headset_LoopBackTest_Stop_Entry},
    /* 4 */
    {mmi_AutoTest_Audio_AuxiliaryMIC1_Headset_LoopBackTestEntry,
     mmi_AutoTest_Audio_AuxiliaryMIC1_Headset_LoopBackTest_Stop_Entry},
    /* 5 */
    {mmi_AutoTest_Audio_AuxiliaryMIC2_Headset_LoopBackTestEntry,
     mmi_AutoTest_Audio_AuxiliaryMIC2_Headset_LoopBackTest_Stop_Entry},
    /* 6 */ {mmi_AutoTest_MainMicRecordTestEntry, mmi_AutoTest_MainMicRecordTest_Stop_Entry},
    /* 7 */ {nullptr, nullptr},
    /* 8 */
    {[](const char *, int) { return mmi_AutoTest_Audio_SpeakerRingtone_TestEntry(); },
     mmi_AutoTest_Audio_SpeakerRingtone_Test_Stop_Entry},
};
const int kLoopCount = (int)(sizeof(kLoops) / sizeof(kLoops[0]));

// The loop the last start stored; only the command thread touches it.
int s_audioLoop = -1;

int start_loop(const char *name, int loop, const char *parm, int parmLen) {
    at_log_parm(name, parm);
    s_audioLoop = loop;
    if (kLoops[loop].start == nullptr) return 0;
    return kLoops[loop].start(parm, parmLen);
}

}  // namespace

#define AUDIO_LOOP_HANDLER(handler, loop)                              \
    int handler(const char *parm, int parmLen, char *, unsigned int) { \
        return start_loop(__func__, loop, parm, parmLen);              \
    }
AUDIO_LOOP_HANDLER(AutoTest_audioloop_HeadsetHeadset_Start, 0)
AUDIO_LOOP_HANDLER(AutoTest_audioloop_HeadsetSpeaker_Start, 1)
AUDIO_LOOP_HANDLER(AutoTest_audioloop_HeadsetReceiver_Start, 2)
AUDIO_LOOP_HANDLER(AutoTest_audioloop_MicroHeadset_Start, 3)
AUDIO_LOOP_HANDLER(AutoTest_audioloop_AuxiliaryMicroHeadset1_Start, 4)
AUDIO_LOOP_HANDLER(AutoTest_audioloop_AuxiliaryMicroHeadset2_Start, 5)
AUDIO_LOOP_HANDLER(AutoTest_audioloop_MainMicRecord_Start, 6)
AUDIO_LOOP_HANDLER(AutoTest_audioloop_MainMic_Speaker_Start, 7)
AUDIO_LOOP_HANDLER(AutoTest_Audio_SpeakerRingtone_Start, 8)
#undef AUDIO_LOOP_HANDLER

int AutoTest_audioloop_Stop(const char *, int, char *, unsigned int) {
    at_log_begin(__func__);
    const int loop = s_audioLoop;
    __android_log_print(ANDROID_LOG_DEBUG, AT_TAG, "%s::audio loop=%d", __func__, loop);
    if (loop < 0 || loop >= kLoopCount || kLoops[loop].stop == nullptr) return 1;
    return kLoops[loop].stop();
}

// Starts the headset-to-upper-speaker loop, yet its close is the headset-receiver loop's.
int AutoTestMicToSpeakerStart(const char *parm, int parmLen, char *, unsigned int) {
    at_log_parm(__func__, parm);
    s_audioLoop = 2;
    return mmi_AutoTest_Audio_Headset_UpSpeaker_LoopBackTestEntry(parm, parmLen);
}

int AutoTest_FM_Start(const char *parm, int, char *, unsigned int) {
    at_log_parm(__func__, parm);
    return mmi_AutoTest_FMTest_Entry(parm != nullptr ? atoi(parm) : 0);
}

int AutoTest_FM_Stop(const char *, int, char *, unsigned int) {
    at_log_begin(__func__);
    return mmi_AutoTest_FMTest_Stop_Entry();
}

int AutoTest_hifi_Start(const char *parm, int, char *, unsigned int) {
    at_log_parm(__func__, parm);
    return mmi_AutoTest_HiFiTestEntry(parm);
}

int AutoTest_hifi_Stop(const char *, int, char *, unsigned int) {
    at_log_begin(__func__);
    return mmi_AutoTest_HiFiTest_Stop_Entry();
}

int AutoTest_Ring_Start(const char *parm, int, char *, unsigned int) {
    at_log_parm(__func__, parm);
    return mmi_auto_RingtoneTest(parm);
}

int AutoTest_Ring_Stop(const char *parm, int, char *, unsigned int) {
    at_log_begin(__func__);
    return RingSingleFreqStop(parm != nullptr ? atoi(parm) : 0);
}

// The PCBA run's tone and earpiece routes answer success whatever the library did.
#define AUDIO_ALWAYS_OK(handler, call)                     \
    int handler(const char *, int, char *, unsigned int) { \
        at_log_begin(__func__);                            \
        call;                                              \
        return 1;                                          \
    }
AUDIO_ALWAYS_OK(PCBAAutotestRingStart, RingSingleFreqStart())
AUDIO_ALWAYS_OK(PCBAAutotestRingStop, RingSingleFreqStop(0))
AUDIO_ALWAYS_OK(AutotestMic2EarpieceStart, mmi_mic2earpiece_start())
AUDIO_ALWAYS_OK(AutotestMic2EarpieceStop, mmi_mic2earpiece_stop())
AUDIO_ALWAYS_OK(AutotestAuxMic2EarpieceStart, mmi_auxmic2earpiece_start())
AUDIO_ALWAYS_OK(AutotestAuxMic2EarpieceStop, mmi_auxmic2earpiece_stop())
#undef AUDIO_ALWAYS_OK

int AutoTest_SpeakerCalibrate_Start(const char *, int, char *, unsigned int) {
    at_log_begin(__func__);
    return mmi_AutoTest_SmartPACalEntry();
}

int AutoTest_SpeakerCalibrate_Calibrate(const char *, int, char *reply, unsigned int replySize) {
    at_log_begin(__func__);
    return mmi_AutoTest_SmartPACal_Calibrate(reply, replySize);
}

int AutoTest_SpeakerCalibrate_Stop(const char *, int, char *, unsigned int) {
    at_log_begin(__func__);
    return mmi_AutoTest_SmartPACal_Stop_Entry();
}

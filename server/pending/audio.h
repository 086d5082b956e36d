// Stand-ins for the audio tests (loopbacks, ringtones, receiver, FM, headset microphones, HiFi,
// the main microphone record, PA calibration) until each window exists. An entry logs at error
// priority that its test is not available and opens nothing; a family that lands takes its lines
// out of this list.
#pragma once

#include "pending/pending.h"

#define MMI_PENDING_AUDIO(ENTRY, STOP)                                                         \
    ENTRY(mmi_testwnd_SmartPACalEntry, "FTX_SMARTPACAL")                                       \
    STOP(mmi_testwnd_SmartPACal_Stop_Entry, "FTX_SMARTPACAL")                                  \
    ENTRY(mmi_testwnd_AudioLoopBackTestEntry, "FTX_AUDIO_LOOPBACK")                            \
    ENTRY(mmi_testwnd_RingtoneTestEntry, "FTX_RINGTONE")                                       \
    STOP(mmi_test_RingtoneTest_Stop_Entry, "FTX_RINGTONE")                                     \
    ENTRY(mmi_testwnd_RingtoneUpTestEntry, "FTX_RTUP")                                         \
    ENTRY(mmi_testwnd_RingtoneDownTestEntry, "FTX_RTDOWN")                                     \
    ENTRY(mmi_testwnd_ReceiverTestEntry, "FTX_RECEIVER")                                       \
    STOP(mmi_testwnd_ReceiverTest_Stop_Entry, "FTX_RECEIVER")                                  \
    ENTRY(mmi_testwnd_HANDSET_MIC_TestEntry, "FTX_HEADSET_LOOPBACK")                           \
    STOP(mmi_testwnd_HANDSET_MIC_Stop_Entry, "FTX_HEADSET_LOOPBACK")                           \
    ENTRY(mmi_testwnd_FmTestEntry, "FTX_FM")                                                   \
    STOP(mmi_testwnd_FmTest_Stop_Entry, "FTX_FM")                                              \
    ENTRY(mmi_testwnd_Audio_MIC_Headset_LoopBackTestEntry, "FTX_AUDIO_MIC_HEADSET_LOOPBACK")   \
    STOP(mmi_testwnd_Audio_MIC_Headset_Stop_Entry, "FTX_AUDIO_MIC_HEADSET_LOOPBACK")           \
    ENTRY(mmi_testwnd_Audio_AuxiliaryMIC1_Headset_LoopBackTestEntry,                           \
          "FTX_AUDIO_AUXILIARYMIC1_HEADSET_LOOPBACK")                                          \
    STOP(mmi_testwnd_Audio_AuxiliaryMIC1_Headset_Stop_Entry,                                   \
         "FTX_AUDIO_AUXILIARYMIC1_HEADSET_LOOPBACK")                                           \
    ENTRY(mmi_testwnd_Audio_AuxiliaryMIC2_Headset_LoopBackTestEntry,                           \
          "FTX_AUDIO_AUXILIARYMIC2_HEADSET_LOOPBACK")                                          \
    STOP(mmi_testwnd_Audio_AuxiliaryMIC2_Headset_Stop_Entry,                                   \
         "FTX_AUDIO_AUXILIARYMIC2_HEADSET_LOOPBACK")                                           \
    ENTRY(mmi_testwnd_HiFiTestEntry, "FTX_HIFI")                                               \
    STOP(mmi_test_HiFiTest_Stop_Entry, "FTX_HIFI")                                             \
    ENTRY(mmi_testwnd_Audio_Headset_Receiver_LoopBackTestEntry,                                \
          "FTX_AUDIO_HEADSET_RECEIVER_LOOPBACK")                                               \
    STOP(mmi_testwnd_Audio_Headset_Receiver_Stop_Entry, "FTX_AUDIO_HEADSET_RECEIVER_LOOPBACK") \
    ENTRY(mmi_testwnd_Audio_Headset_Speaker_LoopBackTestEntry,                                 \
          "FTX_AUDIO_HEADSET_SPEAKER_LOOPBACK")                                                \
    STOP(mmi_testwnd_Audio_Headset_Speaker_Stop_Entry, "FTX_AUDIO_HEADSET_SPEAKER_LOOPBACK")   \
    ENTRY(mmi_testwnd_MainMicRecordTestEntry, "FTX_AUDIO_MAINMICRECORD")                       \
    STOP(mmi_test_MainMicRecordTest_Stop_Entry, "FTX_AUDIO_MAINMICRECORD")

MMI_PENDING_AUDIO(MMI_DECLARE_ENTRY, MMI_DECLARE_STOP)

// Stand-ins of the audio tests.
#include "pending/audio.h"

#include "pending/pending.h"

MMI_PENDING_ENTRY(mmi_testwnd_SmartPACalEntry, "FTX_SMARTPACAL")
MMI_PENDING_STOP(mmi_testwnd_SmartPACal_Stop_Entry, "FTX_SMARTPACAL")
MMI_PENDING_ENTRY(mmi_testwnd_AudioLoopBackTestEntry, "FTX_AUDIO_LOOPBACK")
MMI_PENDING_ENTRY(mmi_testwnd_RingtoneTestEntry, "FTX_RINGTONE")
MMI_PENDING_STOP(mmi_test_RingtoneTest_Stop_Entry, "FTX_RINGTONE")
MMI_PENDING_ENTRY(mmi_testwnd_RingtoneUpTestEntry, "FTX_RTUP")
MMI_PENDING_ENTRY(mmi_testwnd_RingtoneDownTestEntry, "FTX_RTDOWN")
MMI_PENDING_ENTRY(mmi_testwnd_ReceiverTestEntry, "FTX_RECEIVER")
MMI_PENDING_STOP(mmi_testwnd_ReceiverTest_Stop_Entry, "FTX_RECEIVER")
MMI_PENDING_ENTRY(mmi_testwnd_HANDSET_MIC_TestEntry, "FTX_HEADSET_LOOPBACK")
MMI_PENDING_STOP(mmi_testwnd_HANDSET_MIC_Stop_Entry, "FTX_HEADSET_LOOPBACK")
MMI_PENDING_ENTRY(mmi_testwnd_FmTestEntry, "FTX_FM")
MMI_PENDING_STOP(mmi_testwnd_FmTest_Stop_Entry, "FTX_FM")
MMI_PENDING_ENTRY(mmi_testwnd_Audio_MIC_Headset_LoopBackTestEntry, "FTX_AUDIO_MIC_HEADSET_LOOPBACK")
MMI_PENDING_STOP(mmi_testwnd_Audio_MIC_Headset_Stop_Entry, "FTX_AUDIO_MIC_HEADSET_LOOPBACK")
MMI_PENDING_ENTRY(mmi_testwnd_Audio_AuxiliaryMIC1_Headset_LoopBackTestEntry,
                  "FTX_AUDIO_AUXILIARYMIC1_HEADSET_LOOPBACK")
MMI_PENDING_STOP(mmi_testwnd_Audio_AuxiliaryMIC1_Headset_Stop_Entry,
                 "FTX_AUDIO_AUXILIARYMIC1_HEADSET_LOOPBACK")
MMI_PENDING_ENTRY(mmi_testwnd_Audio_AuxiliaryMIC2_Headset_LoopBackTestEntry,
                  "FTX_AUDIO_AUXILIARYMIC2_HEADSET_LOOPBACK")
MMI_PENDING_STOP(mmi_testwnd_Audio_AuxiliaryMIC2_Headset_Stop_Entry,
                 "FTX_AUDIO_AUXILIARYMIC2_HEADSET_LOOPBACK")
MMI_PENDING_ENTRY(mmi_testwnd_HiFiTestEntry, "FTX_HIFI")
MMI_PENDING_STOP(mmi_test_HiFiTest_Stop_Entry, "FTX_HIFI")
MMI_PENDING_ENTRY(mmi_testwnd_Audio_Headset_Receiver_LoopBackTestEntry,
                  "FTX_AUDIO_HEADSET_RECEIVER_LOOPBACK")
MMI_PENDING_STOP(mmi_testwnd_Audio_Headset_Receiver_Stop_Entry,
                 "FTX_AUDIO_HEADSET_RECEIVER_LOOPBACK")
MMI_PENDING_ENTRY(mmi_testwnd_Audio_Headset_Speaker_LoopBackTestEntry,
                  "FTX_AUDIO_HEADSET_SPEAKER_LOOPBACK")
MMI_PENDING_STOP(mmi_testwnd_Audio_Headset_Speaker_Stop_Entry, "FTX_AUDIO_HEADSET_SPEAKER_LOOPBACK")
MMI_PENDING_ENTRY(mmi_testwnd_MainMicRecordTestEntry, "FTX_AUDIO_MAINMICRECORD")
MMI_PENDING_STOP(mmi_test_MainMicRecordTest_Stop_Entry, "FTX_AUDIO_MAINMICRECORD")

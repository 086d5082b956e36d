// The audio tests: loopbacks, ringtones, receiver, FM, the headset microphones, HiFi, the main
// microphone record and the PA calibration: stand-ins until each window exists. An entry logs at
// error priority that its test is not available and opens nothing.
#pragma once

void *mmi_testwnd_SmartPACalEntry(void);  // FTX_SMARTPACAL
int mmi_testwnd_SmartPACal_Stop_Entry(void);
void *mmi_testwnd_AudioLoopBackTestEntry(void);  // FTX_AUDIO_LOOPBACK
void *mmi_testwnd_RingtoneTestEntry(void);       // FTX_RINGTONE
int mmi_test_RingtoneTest_Stop_Entry(void);
void *mmi_testwnd_RingtoneUpTestEntry(void);    // FTX_RTUP
void *mmi_testwnd_RingtoneDownTestEntry(void);  // FTX_RTDOWN
void *mmi_testwnd_ReceiverTestEntry(void);      // FTX_RECEIVER
int mmi_testwnd_ReceiverTest_Stop_Entry(void);
void *mmi_testwnd_HANDSET_MIC_TestEntry(void);  // FTX_HEADSET_LOOPBACK
int mmi_testwnd_HANDSET_MIC_Stop_Entry(void);
void *mmi_testwnd_FmTestEntry(void);  // FTX_FM
int mmi_testwnd_FmTest_Stop_Entry(void);
void *mmi_testwnd_Audio_MIC_Headset_LoopBackTestEntry(void);  // FTX_AUDIO_MIC_HEADSET_LOOPBACK
int mmi_testwnd_Audio_MIC_Headset_Stop_Entry(void);
void *mmi_testwnd_Audio_AuxiliaryMIC1_Headset_LoopBackTestEntry(
    void);  // FTX_AUDIO_AUXILIARYMIC1_HEADSET_LOOPBACK
int mmi_testwnd_Audio_AuxiliaryMIC1_Headset_Stop_Entry(void);
void *mmi_testwnd_Audio_AuxiliaryMIC2_Headset_LoopBackTestEntry(
    void);  // FTX_AUDIO_AUXILIARYMIC2_HEADSET_LOOPBACK
int mmi_testwnd_Audio_AuxiliaryMIC2_Headset_Stop_Entry(void);
void *mmi_testwnd_HiFiTestEntry(void);  // FTX_HIFI
int mmi_test_HiFiTest_Stop_Entry(void);
void *mmi_testwnd_Audio_Headset_Receiver_LoopBackTestEntry(
    void);  // FTX_AUDIO_HEADSET_RECEIVER_LOOPBACK
int mmi_testwnd_Audio_Headset_Receiver_Stop_Entry(void);
void *mmi_testwnd_Audio_Headset_Speaker_LoopBackTestEntry(
    void);  // FTX_AUDIO_HEADSET_SPEAKER_LOOPBACK
int mmi_testwnd_Audio_Headset_Speaker_Stop_Entry(void);
void *mmi_testwnd_MainMicRecordTestEntry(void);  // FTX_AUDIO_MAINMICRECORD
int mmi_test_MainMicRecordTest_Stop_Entry(void);

// Entry and stop functions of every catalogue row. Each test family defines its own;
// until its window exists the pair lives in mmi_pending_entries.cpp.
#pragma once

// Entries return the test window (HWND), stops 1 or 0 as their test defines.

void *mmi_testwnd_SIMCardTestEntry(void);  // FTX_SIMCARD
int mmi_testwnd_SIMCardTest_Stop_Entry(void);
void *mmi_testwnd_SDCardTestEntry(void);  // FTX_SDCARD
int mmi_testwnd_SDCardTest_Stop_Entry(void);
void *mmi_testwnd_BatteryTestEntry(void);  // FTX_BATTERY
int mmi_testwnd_BatteryTest_Stop_Entry(void);
void *mmi_testwnd_USBOTGTestEntry(void);  // FTX_USBHOST
int mmi_testwnd_USBOTGTest_Stop_Entry(void);
void *mmi_teswnd_KeyTestEntry(void);  // FTX_KEYS
int mmi_teswnd_KeyTest_Stop_Entry(void);
void *mmi_testwnd_TPSelfTest_Entry(void);  // FTX_TPSELF
int mmi_testwnd_TPSelfTest_Stop(void);
void *mmi_testwnd_touchTestEntry(void);  // FTX_TOUCH
int mmi_AutoTest_touchscreenTest_Stop_Entry(void);
void *mmi_testwnd_SensorsTestEntry(void);  // FTX_SENSOR
int mmi_testwnd_SensorsTest_Stop_Entry(void);
void *mmi_testwnd_HallSensorTestEntry(void);  // FTX_HALLSENSOR
int mmi_testwnd_HallSensorTest_Stop_Entry(void);
void *mmi_testwnd_HallTest_2nd_TestEntry(void);  // FTX_HALL_2ND
int mmi_testwnd_HallTest_2nd_Stop_Entry(void);
void *mmi_testwnd_FingerPrintTestEntry(void);  // FTX_FINGERPRINT
int mmi_testwnd_FingerPrintTest_Stop_Entry(void);
void *mmi_testwnd_NfcTestEntry(void);  // FTX_NFC
int mmi_testwnd_NfcTest_Stop_Entry(void);
void *mmi_testwnd_CameraBackTestEntry(void);  // FTX_CAMERA_BACK
int mmi_AutoTest_CameraBackTest_Stop_Entry(void);
void *mmi_testwnd_CameraAuxBackTestEntry(void);  // FTX_AUX_CAMERA_BACK
int mmi_AutoTest_CameraAuxBackTest_Stop_Entry(void);
void *mmi_testwnd_CameraFrontTestEntry(void);  // FTX_CAMERA_FRONT
int mmi_AutoTest_CameraFrontTest_Stop_Entry(void);
void *mmi_LCDColorTestEntry(void);  // FTX_LCD
int mmi_LCDColorTest_Stop_Entry(void);
void *mmi_testwnd_AllLightTestEntry(void);  // FTX_ALLLIGHT
int mmi_testwnd_AllLightTest_Stop_Entry(void);
void *mmi_testwnd_SmartPACalEntry(void);  // FTX_SMARTPACAL
int mmi_testwnd_SmartPACal_Stop_Entry(void);
void *mmi_testwnd_AudioLoopBackTestEntry(void);  // FTX_AUDIO_LOOPBACK
void *mmi_testwnd_RingtoneTestEntry(void);       // FTX_RINGTONE
int mmi_test_RingtoneTest_Stop_Entry(void);
void *mmi_testwnd_RingtoneUpTestEntry(void);    // FTX_RTUP
void *mmi_testwnd_RingtoneDownTestEntry(void);  // FTX_RTDOWN
void *mmi_testwnd_ReceiverTestEntry(void);      // FTX_RECEIVER
int mmi_testwnd_ReceiverTest_Stop_Entry(void);
void *mmi_teswnd_HookKeyTestEntry(void);  // FTX_HOOKKEY
int mmi_teswnd_HookKeyTest_Stop_Entry(void);
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
void *mmi_testwnd_VibratorTestEntry(void);  // FTX_VIBRATOR
int mmi_testwnd_VibratorTest_Stop_Entry(void);
void *mmi_testwnd_sar_start(void);  // FTX_SAR
int mmi_testwnd_sar_stop(void);
void *mmi_testwnd_Auxiliarysar_start(void);  // FTX_AuxiliarySAR
void *mmi_testwnd_SIMMEMTestEntry(void);     // FTX_CARDS
int mmi_testwnd_SIMMEMTest_Stop_Entry(void);
void *mmi_testwnd_MainMicRecordTestEntry(void);  // FTX_AUDIO_MAINMICRECORD
int mmi_test_MainMicRecordTest_Stop_Entry(void);
void *mmi_testwnd_AuxLCDHintTestEntry(void);  // FTX_AUXLCD_HINT
int mmi_testwnd_AuxLCDHintStop_Entry(void);
void *mmi_testwnd_Monomer_TPSelfTest_Entry(void);  // FTX_TPSELF
int mmi_testwnd_Monomer_TPSelfTest_Stop(void);
void *mmi_testwnd_Monomer_HardwareVersionEntry(void);  // FTX_MONOMER_HARDVERSION
int mmi_testwnd_Monomer_HardwareVersion_Stop(void);
void *mmi_Monomer_LCDColorTestEntry(void);  // FTX_MONOMER_LCD
int mmi_Monomer_LCDColorTest_Stop_Entry(void);
void *mmi_testwnd_Monomer_touchTestEntry(void);  // FTX_TOUCH
int mmi_testwnd_Monomer_touchscreenTest_Stop(void);

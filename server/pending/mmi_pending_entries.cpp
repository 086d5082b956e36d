// Entries of the catalogue rows whose test window does not exist yet: each logs at error
// priority that the test is not available and opens nothing. A family that lands removes
// its lines here; this file only shrinks.
#include <android/log.h>

#include "testwnd/mmi_testitem_entries.h"

#define PENDING_ENTRY(fn, tag)                                                          \
    void *fn(void) {                                                                    \
        __android_log_print(ANDROID_LOG_ERROR, tag, "%s: test not available yet", #fn); \
        return (void *)-1; /* HWND_INVALID */                                           \
    }
#define PENDING_STOP(fn, tag)                                                           \
    int fn(void) {                                                                      \
        __android_log_print(ANDROID_LOG_ERROR, tag, "%s: test not available yet", #fn); \
        return 0;                                                                       \
    }

PENDING_ENTRY(mmi_testwnd_SIMCardTestEntry, "FTX_SIMCARD")
PENDING_STOP(mmi_testwnd_SIMCardTest_Stop_Entry, "FTX_SIMCARD")
PENDING_ENTRY(mmi_testwnd_SDCardTestEntry, "FTX_SDCARD")
PENDING_STOP(mmi_testwnd_SDCardTest_Stop_Entry, "FTX_SDCARD")
PENDING_ENTRY(mmi_testwnd_BatteryTestEntry, "FTX_BATTERY")
PENDING_STOP(mmi_testwnd_BatteryTest_Stop_Entry, "FTX_BATTERY")
PENDING_ENTRY(mmi_testwnd_USBOTGTestEntry, "FTX_USBHOST")
PENDING_STOP(mmi_testwnd_USBOTGTest_Stop_Entry, "FTX_USBHOST")
PENDING_ENTRY(mmi_teswnd_KeyTestEntry, "FTX_KEYS")
PENDING_STOP(mmi_teswnd_KeyTest_Stop_Entry, "FTX_KEYS")
PENDING_ENTRY(mmi_testwnd_TPSelfTest_Entry, "FTX_TPSELF")
PENDING_STOP(mmi_testwnd_TPSelfTest_Stop, "FTX_TPSELF")
PENDING_ENTRY(mmi_testwnd_touchTestEntry, "FTX_TOUCH")
PENDING_STOP(mmi_AutoTest_touchscreenTest_Stop_Entry, "FTX_TOUCH")
PENDING_ENTRY(mmi_testwnd_SensorsTestEntry, "FTX_SENSOR")
PENDING_STOP(mmi_testwnd_SensorsTest_Stop_Entry, "FTX_SENSOR")
PENDING_ENTRY(mmi_testwnd_HallSensorTestEntry, "FTX_HALLSENSOR")
PENDING_STOP(mmi_testwnd_HallSensorTest_Stop_Entry, "FTX_HALLSENSOR")
PENDING_ENTRY(mmi_testwnd_HallTest_2nd_TestEntry, "FTX_HALL_2ND")
PENDING_STOP(mmi_testwnd_HallTest_2nd_Stop_Entry, "FTX_HALL_2ND")
PENDING_ENTRY(mmi_testwnd_FingerPrintTestEntry, "FTX_FINGERPRINT")
PENDING_STOP(mmi_testwnd_FingerPrintTest_Stop_Entry, "FTX_FINGERPRINT")
PENDING_ENTRY(mmi_testwnd_NfcTestEntry, "FTX_NFC")
PENDING_STOP(mmi_testwnd_NfcTest_Stop_Entry, "FTX_NFC")
PENDING_ENTRY(mmi_testwnd_CameraBackTestEntry, "FTX_CAMERA_BACK")
PENDING_STOP(mmi_AutoTest_CameraBackTest_Stop_Entry, "FTX_CAMERA_BACK")
PENDING_ENTRY(mmi_testwnd_CameraAuxBackTestEntry, "FTX_AUX_CAMERA_BACK")
PENDING_STOP(mmi_AutoTest_CameraAuxBackTest_Stop_Entry, "FTX_AUX_CAMERA_BACK")
PENDING_ENTRY(mmi_testwnd_CameraFrontTestEntry, "FTX_CAMERA_FRONT")
PENDING_STOP(mmi_AutoTest_CameraFrontTest_Stop_Entry, "FTX_CAMERA_FRONT")
PENDING_ENTRY(mmi_LCDColorTestEntry, "FTX_LCD")
PENDING_STOP(mmi_LCDColorTest_Stop_Entry, "FTX_LCD")
PENDING_ENTRY(mmi_testwnd_AllLightTestEntry, "FTX_ALLLIGHT")
PENDING_STOP(mmi_testwnd_AllLightTest_Stop_Entry, "FTX_ALLLIGHT")
PENDING_ENTRY(mmi_testwnd_SmartPACalEntry, "FTX_SMARTPACAL")
PENDING_STOP(mmi_testwnd_SmartPACal_Stop_Entry, "FTX_SMARTPACAL")
PENDING_ENTRY(mmi_testwnd_AudioLoopBackTestEntry, "FTX_AUDIO_LOOPBACK")
PENDING_ENTRY(mmi_testwnd_RingtoneTestEntry, "FTX_RINGTONE")
PENDING_STOP(mmi_test_RingtoneTest_Stop_Entry, "FTX_RINGTONE")
PENDING_ENTRY(mmi_testwnd_RingtoneUpTestEntry, "FTX_RTUP")
PENDING_ENTRY(mmi_testwnd_RingtoneDownTestEntry, "FTX_RTDOWN")
PENDING_ENTRY(mmi_testwnd_ReceiverTestEntry, "FTX_RECEIVER")
PENDING_STOP(mmi_testwnd_ReceiverTest_Stop_Entry, "FTX_RECEIVER")
PENDING_ENTRY(mmi_teswnd_HookKeyTestEntry, "FTX_HOOKKEY")
PENDING_STOP(mmi_teswnd_HookKeyTest_Stop_Entry, "FTX_HOOKKEY")
PENDING_ENTRY(mmi_testwnd_HANDSET_MIC_TestEntry, "FTX_HEADSET_LOOPBACK")
PENDING_STOP(mmi_testwnd_HANDSET_MIC_Stop_Entry, "FTX_HEADSET_LOOPBACK")
PENDING_ENTRY(mmi_testwnd_FmTestEntry, "FTX_FM")
PENDING_STOP(mmi_testwnd_FmTest_Stop_Entry, "FTX_FM")
PENDING_ENTRY(mmi_testwnd_Audio_MIC_Headset_LoopBackTestEntry, "FTX_AUDIO_MIC_HEADSET_LOOPBACK")
PENDING_STOP(mmi_testwnd_Audio_MIC_Headset_Stop_Entry, "FTX_AUDIO_MIC_HEADSET_LOOPBACK")
PENDING_ENTRY(mmi_testwnd_Audio_AuxiliaryMIC1_Headset_LoopBackTestEntry,
              "FTX_AUDIO_AUXILIARYMIC1_HEADSET_LOOPBACK")
PENDING_STOP(mmi_testwnd_Audio_AuxiliaryMIC1_Headset_Stop_Entry,
             "FTX_AUDIO_AUXILIARYMIC1_HEADSET_LOOPBACK")
PENDING_ENTRY(mmi_testwnd_Audio_AuxiliaryMIC2_Headset_LoopBackTestEntry,
              "FTX_AUDIO_AUXILIARYMIC2_HEADSET_LOOPBACK")
PENDING_STOP(mmi_testwnd_Audio_AuxiliaryMIC2_Headset_Stop_Entry,
             "FTX_AUDIO_AUXILIARYMIC2_HEADSET_LOOPBACK")
PENDING_ENTRY(mmi_testwnd_HiFiTestEntry, "FTX_HIFI")
PENDING_STOP(mmi_test_HiFiTest_Stop_Entry, "FTX_HIFI")
PENDING_ENTRY(mmi_testwnd_Audio_Headset_Receiver_LoopBackTestEntry,
              "FTX_AUDIO_HEADSET_RECEIVER_LOOPBACK")
PENDING_STOP(mmi_testwnd_Audio_Headset_Receiver_Stop_Entry, "FTX_AUDIO_HEADSET_RECEIVER_LOOPBACK")
PENDING_ENTRY(mmi_testwnd_Audio_Headset_Speaker_LoopBackTestEntry,
              "FTX_AUDIO_HEADSET_SPEAKER_LOOPBACK")
PENDING_STOP(mmi_testwnd_Audio_Headset_Speaker_Stop_Entry, "FTX_AUDIO_HEADSET_SPEAKER_LOOPBACK")
PENDING_ENTRY(mmi_testwnd_sar_start, "FTX_SAR")
PENDING_STOP(mmi_testwnd_sar_stop, "FTX_SAR")
PENDING_ENTRY(mmi_testwnd_Auxiliarysar_start, "FTX_AuxiliarySAR")
PENDING_ENTRY(mmi_testwnd_SIMMEMTestEntry, "FTX_CARDS")
PENDING_STOP(mmi_testwnd_SIMMEMTest_Stop_Entry, "FTX_CARDS")
PENDING_ENTRY(mmi_testwnd_MainMicRecordTestEntry, "FTX_AUDIO_MAINMICRECORD")
PENDING_STOP(mmi_test_MainMicRecordTest_Stop_Entry, "FTX_AUDIO_MAINMICRECORD")
PENDING_ENTRY(mmi_testwnd_AuxLCDHintTestEntry, "FTX_AUXLCD_HINT")
PENDING_STOP(mmi_testwnd_AuxLCDHintStop_Entry, "FTX_AUXLCD_HINT")
PENDING_ENTRY(mmi_testwnd_Monomer_TPSelfTest_Entry, "FTX_TPSELF")
PENDING_STOP(mmi_testwnd_Monomer_TPSelfTest_Stop, "FTX_TPSELF")
PENDING_ENTRY(mmi_Monomer_LCDColorTestEntry, "FTX_MONOMER_LCD")
PENDING_STOP(mmi_Monomer_LCDColorTest_Stop_Entry, "FTX_MONOMER_LCD")
PENDING_ENTRY(mmi_testwnd_Monomer_touchTestEntry, "FTX_TOUCH")
PENDING_STOP(mmi_testwnd_Monomer_touchscreenTest_Stop, "FTX_TOUCH")

// The compiled-in test catalogue. A catalogue row is the one place where a test's
// configuration domain (also its log tag), its item of the result record and its title key
// are written; the tables of the three runs and each test family's descriptor refer to it.
#pragma once

#include "session/mmi_testitem.h"

// domain, title key, item of the result record (-1: none).
struct mmi_catalogue_row {
    const char *domain;
    const char *titleKey;
    int resultIndex;
};

namespace catalogue {
// Repeated title keys (the hall rows, the ringtone rows) are the handset's own.
inline constexpr mmi_catalogue_row SimCard{"FTX_SIMCARD", "title_SimCardTest", 324};
inline constexpr mmi_catalogue_row SdCard{"FTX_SDCARD", "title_SDCardTest", 360};
inline constexpr mmi_catalogue_row Battery{"FTX_BATTERY", "title_BatteryCheck", 344};
inline constexpr mmi_catalogue_row UsbHost{"FTX_USBHOST", "menu_UsbOtgTest", -1};
inline constexpr mmi_catalogue_row Keys{"FTX_KEYS", "menu_KeyTest", 312};
inline constexpr mmi_catalogue_row TpSelf{"FTX_TPSELF", "title_TPSelfTest", -1};
inline constexpr mmi_catalogue_row Touch{"FTX_TOUCH", "menu_TouchTest", 320};
inline constexpr mmi_catalogue_row Sensor{"FTX_SENSOR", "menu_AllSensorTest", 328};
inline constexpr mmi_catalogue_row HallSensor{"FTX_HALLSENSOR", "menu_HallSensor", 352};
inline constexpr mmi_catalogue_row Hall2nd{"FTX_HALL_2ND", "menu_HallSensor", 352};
inline constexpr mmi_catalogue_row FingerPrint{"FTX_FINGERPRINT", "menu_FingerPrintTest", 336};
inline constexpr mmi_catalogue_row Nfc{"FTX_NFC", "title_NfcTest", 340};
inline constexpr mmi_catalogue_row CameraBack{"FTX_CAMERA_BACK", "title_MainCameraTest", 288};
inline constexpr mmi_catalogue_row AuxCameraBack{"FTX_AUX_CAMERA_BACK", "title_MainCamera2Test",
                                                 288};
inline constexpr mmi_catalogue_row CameraFront{"FTX_CAMERA_FRONT", "title_subCameraTest", 292};
inline constexpr mmi_catalogue_row Lcd{"FTX_LCD", "menu_LCDTest", 280};
inline constexpr mmi_catalogue_row AllLight{"FTX_ALLLIGHT", "menu_AllLightTest", 284};
inline constexpr mmi_catalogue_row SmartPaCal{"FTX_SMARTPACAL", "menu_ItemTest_SmartPACal", 300};
inline constexpr mmi_catalogue_row AudioLoopback{"FTX_AUDIO_LOOPBACK", "menu_LoopBackTest", 300};
inline constexpr mmi_catalogue_row Ringtone{"FTX_RINGTONE", "menu_RingTest", 296};
inline constexpr mmi_catalogue_row RingtoneUp{"FTX_RTUP", "menu_RingToneUp", 296};
inline constexpr mmi_catalogue_row RingtoneDown{"FTX_RTDOWN", "menu_RingToneDown", 296};
inline constexpr mmi_catalogue_row Receiver{"FTX_RECEIVER", "menu_ReceiverRingTest", 298};
inline constexpr mmi_catalogue_row HookKey{"FTX_HOOKKEY", "menu_HookKeyTest", -1};
inline constexpr mmi_catalogue_row HeadsetLoopback{"FTX_HEADSET_LOOPBACK", "menu_HeadSetTest", 304};
inline constexpr mmi_catalogue_row Fm{"FTX_FM", "menu_FMTest", 308};
inline constexpr mmi_catalogue_row AudioMicHeadsetLoopback{"FTX_AUDIO_MIC_HEADSET_LOOPBACK",
                                                           "menu_Mic_Headset", 136};
inline constexpr mmi_catalogue_row AudioAuxMic1HeadsetLoopback{
    "FTX_AUDIO_AUXILIARYMIC1_HEADSET_LOOPBACK", "menu_AuxMic1_Headset", 140};
inline constexpr mmi_catalogue_row AudioAuxMic2HeadsetLoopback{
    "FTX_AUDIO_AUXILIARYMIC2_HEADSET_LOOPBACK", "menu_AuxMic2_Headset", 142};
inline constexpr mmi_catalogue_row Hifi{"FTX_HIFI", "HIFI", 368};
inline constexpr mmi_catalogue_row AudioHeadsetReceiverLoopback{
    "FTX_AUDIO_HEADSET_RECEIVER_LOOPBACK", "menu_Headset_Receiver", 144};
inline constexpr mmi_catalogue_row AudioHeadsetSpeakerLoopback{"FTX_AUDIO_HEADSET_SPEAKER_LOOPBACK",
                                                               "menu_Headset_Speaker", 148};
inline constexpr mmi_catalogue_row Vibrator{"FTX_VIBRATOR", "menu_VibratorTest", 316};
inline constexpr mmi_catalogue_row Sar{"FTX_SAR", "menuSARtest", 376};
inline constexpr mmi_catalogue_row AuxiliarySar{"FTX_AuxiliarySAR", "AuxiSARSARtest", 376};
inline constexpr mmi_catalogue_row Cards{"FTX_CARDS", "menu_AllCardTest", 324};
inline constexpr mmi_catalogue_row MainMicRecord{"FTX_AUDIO_MAINMICRECORD", "title_MainMic_Record",
                                                 -1};
inline constexpr mmi_catalogue_row AuxLcdHint{"FTX_AUXLCD_HINT", "title_AuxLcdTest", -1};
inline constexpr mmi_catalogue_row AuxLcdRunTpSelf{"FTX_TPSELF", "title_TPSelfTest", 320};
inline constexpr mmi_catalogue_row MonomerHardVersion{"FTX_MONOMER_HARDVERSION", "menu_NfcTest",
                                                      -1};
inline constexpr mmi_catalogue_row MonomerLcd{"FTX_MONOMER_LCD", "menu_LCDTest", -1};
inline constexpr mmi_catalogue_row MonomerTouch{"FTX_TOUCH", "menu_TouchTest", -1};
}  // namespace catalogue

// The tables of the full run, the auxiliary-LCD run and the monomer preview, in the order
// they are offered; their rows are updated in place when the lists are built.
extern testitem TestItemWinMenu_TOTAL[];
extern int g_testitemnum_total;  // 38
extern testitem AuxLCD_TestItemWinMenu_TOTAL[];
extern int g_AuxLCD_testitemnum_total;  // 5
extern testitem MonomerPreview_TestItemWinMenu_TOTAL[];
extern int g_MonomerPreview_testitemnum_total;  // 4

// The three tables, as the list builders take them.
const mmi_catalogue *mmi_catalogue_tables(void);

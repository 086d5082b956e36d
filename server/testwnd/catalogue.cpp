// The tables of the three runs: each row is a catalogue row with its number in the table
// and its entry and stop.
#include "testwnd/catalogue.h"

#include <stddef.h>

#include "testwnd/audio/mmi_testwnd_fm.h"
#include "testwnd/audio/mmi_testwnd_loopback.h"
#include "testwnd/audio/mmi_testwnd_mainmic.h"
#include "testwnd/audio/mmi_testwnd_ring.h"
#include "testwnd/audio/mmi_testwnd_smartpa.h"
#include "testwnd/battery/mmi_testwnd_battery.h"
#include "testwnd/camera/mmi_testwnd_camera.h"
#include "testwnd/cards/mmi_testwnd_cards.h"
#include "testwnd/cards/mmi_testwnd_fingerprint.h"
#include "testwnd/cards/mmi_testwnd_nfc.h"
#include "testwnd/cards/mmi_testwnd_otg.h"
#include "testwnd/display/mmi_testwnd_auxlcdhint.h"
#include "testwnd/display/mmi_testwnd_lcd.h"
#include "testwnd/keys/mmi_testwnd_hookkey.h"
#include "testwnd/keys/mmi_testwnd_keys.h"
#include "testwnd/lights/mmi_testwnd_alllight.h"
#include "testwnd/misc/mmi_testwnd_hardversion.h"
#include "testwnd/misc/mmi_testwnd_vibrator.h"
#include "testwnd/sensors/mmi_testwnd_hall.h"
#include "testwnd/sensors/mmi_testwnd_sar.h"
#include "testwnd/sensors/mmi_testwnd_sensors.h"
#include "testwnd/touch/mmi_testwnd_touch.h"
#include "testwnd/touch/mmi_testwnd_tpself.h"

namespace {

constexpr void copy_text(char *dst, const char *src, size_t size) {
    size_t i = 0;
    for (; i + 1 < size && src[i] != '\0'; i++)
        dst[i] = src[i];
    for (; i < size; i++)
        dst[i] = '\0';
}

// A row as compiled in; the configuration fills the rest.
constexpr testitem testitem_row(int num, const mmi_catalogue_row &row, testitem_entry_fn entry,
                                testitem_stop_fn stop) {
    testitem t{};
    t.item_num = num;
    copy_text(t.name, row.titleKey, sizeof(t.name));
    t.entry = entry;
    t.stop = stop;
    copy_text(t.config_domain, row.domain, sizeof(t.config_domain));
    t.item_code = row.resultIndex;
    return t;
}

}  // namespace

constinit testitem TestItemWinMenu_TOTAL[] = {
    testitem_row(1, catalogue::SimCard, mmi_testwnd_SIMCardTestEntry,
                 mmi_testwnd_SIMCardTest_Stop_Entry),
    testitem_row(2, catalogue::SdCard, mmi_testwnd_SDCardTestEntry,
                 mmi_testwnd_SDCardTest_Stop_Entry),
    testitem_row(6, catalogue::Battery, mmi_testwnd_BatteryTestEntry,
                 mmi_testwnd_BatteryTest_Stop_Entry),
    testitem_row(23, catalogue::UsbHost, mmi_testwnd_USBOTGTestEntry,
                 mmi_testwnd_USBOTGTest_Stop_Entry),
    testitem_row(3, catalogue::Keys, mmi_teswnd_KeyTestEntry, mmi_teswnd_KeyTest_Stop_Entry),
    testitem_row(4, catalogue::TpSelf, mmi_testwnd_TPSelfTest_Entry, mmi_testwnd_TPSelfTest_Stop),
    testitem_row(5, catalogue::Touch, mmi_testwnd_touchTestEntry,
                 mmi_AutoTest_touchscreenTest_Stop_Entry),
    testitem_row(22, catalogue::Sensor, mmi_testwnd_SensorsTestEntry,
                 mmi_testwnd_SensorsTest_Stop_Entry),
    testitem_row(22, catalogue::HallSensor, mmi_testwnd_HallSensorTestEntry,
                 mmi_testwnd_HallSensorTest_Stop_Entry),
    testitem_row(9, catalogue::Hall2nd, mmi_testwnd_HallTest_2nd_TestEntry,
                 mmi_testwnd_HallTest_2nd_Stop_Entry),
    testitem_row(25, catalogue::FingerPrint, mmi_testwnd_FingerPrintTestEntry,
                 mmi_testwnd_FingerPrintTest_Stop_Entry),
    testitem_row(26, catalogue::Nfc, mmi_testwnd_NfcTestEntry, mmi_testwnd_NfcTest_Stop_Entry),
    testitem_row(8, catalogue::CameraBack, mmi_testwnd_CameraBackTestEntry,
                 mmi_AutoTest_CameraBackTest_Stop_Entry),
    testitem_row(9, catalogue::AuxCameraBack, mmi_testwnd_CameraAuxBackTestEntry,
                 mmi_AutoTest_CameraAuxBackTest_Stop_Entry),
    testitem_row(10, catalogue::CameraFront, mmi_testwnd_CameraFrontTestEntry,
                 mmi_AutoTest_CameraFrontTest_Stop_Entry),
    testitem_row(4, catalogue::Lcd, mmi_LCDColorTestEntry, mmi_LCDColorTest_Stop_Entry),
    testitem_row(7, catalogue::AllLight, mmi_testwnd_AllLightTestEntry,
                 mmi_testwnd_AllLightTest_Stop_Entry),
    testitem_row(30, catalogue::SmartPaCal, mmi_testwnd_SmartPACalEntry,
                 mmi_testwnd_SmartPACal_Stop_Entry),
    testitem_row(13, catalogue::AudioLoopback, mmi_testwnd_AudioLoopBackTestEntry, nullptr),
    testitem_row(11, catalogue::Ringtone, mmi_testwnd_RingtoneTestEntry,
                 mmi_test_RingtoneTest_Stop_Entry),
    testitem_row(19, catalogue::RingtoneUp, mmi_testwnd_RingtoneUpTestEntry,
                 mmi_test_RingtoneTest_Stop_Entry),
    testitem_row(30, catalogue::RingtoneDown, mmi_testwnd_RingtoneDownTestEntry,
                 mmi_test_RingtoneTest_Stop_Entry),
    testitem_row(24, catalogue::Receiver, mmi_testwnd_ReceiverTestEntry,
                 mmi_testwnd_ReceiverTest_Stop_Entry),
    testitem_row(12, catalogue::HookKey, mmi_teswnd_HookKeyTestEntry,
                 mmi_teswnd_HookKeyTest_Stop_Entry),
    testitem_row(14, catalogue::HeadsetLoopback, mmi_testwnd_HANDSET_MIC_TestEntry,
                 mmi_testwnd_HANDSET_MIC_Stop_Entry),
    testitem_row(15, catalogue::Fm, mmi_testwnd_FmTestEntry, mmi_testwnd_FmTest_Stop_Entry),
    testitem_row(16, catalogue::AudioMicHeadsetLoopback,
                 mmi_testwnd_Audio_MIC_Headset_LoopBackTestEntry,
                 mmi_testwnd_Audio_MIC_Headset_Stop_Entry),
    testitem_row(17, catalogue::AudioAuxMic1HeadsetLoopback,
                 mmi_testwnd_Audio_AuxiliaryMIC1_Headset_LoopBackTestEntry,
                 mmi_testwnd_Audio_AuxiliaryMIC1_Headset_Stop_Entry),
    testitem_row(18, catalogue::AudioAuxMic2HeadsetLoopback,
                 mmi_testwnd_Audio_AuxiliaryMIC2_Headset_LoopBackTestEntry,
                 mmi_testwnd_Audio_AuxiliaryMIC2_Headset_Stop_Entry),
    testitem_row(28, catalogue::Hifi, mmi_testwnd_HiFiTestEntry, mmi_test_HiFiTest_Stop_Entry),
    testitem_row(19, catalogue::AudioHeadsetReceiverLoopback,
                 mmi_testwnd_Audio_Headset_Receiver_LoopBackTestEntry,
                 mmi_testwnd_Audio_Headset_Receiver_Stop_Entry),
    testitem_row(20, catalogue::AudioHeadsetSpeakerLoopback,
                 mmi_testwnd_Audio_Headset_Speaker_LoopBackTestEntry,
                 mmi_testwnd_Audio_Headset_Speaker_Stop_Entry),
    testitem_row(21, catalogue::Vibrator, mmi_testwnd_VibratorTestEntry,
                 mmi_testwnd_VibratorTest_Stop_Entry),
    testitem_row(33, catalogue::Sar, mmi_testwnd_sar_start, mmi_testwnd_sar_stop),
    testitem_row(34, catalogue::AuxiliarySar, mmi_testwnd_Auxiliarysar_start, mmi_testwnd_sar_stop),
    testitem_row(27, catalogue::Cards, mmi_testwnd_SIMMEMTestEntry,
                 mmi_testwnd_SIMMEMTest_Stop_Entry),
    testitem_row(28, catalogue::MainMicRecord, mmi_testwnd_MainMicRecordTestEntry,
                 mmi_test_MainMicRecordTest_Stop_Entry),
    testitem_row(37, catalogue::AuxLcdHint, mmi_testwnd_AuxLCDHintTestEntry,
                 mmi_testwnd_AuxLCDHintStop_Entry),
};
int g_testitemnum_total = sizeof(TestItemWinMenu_TOTAL) / sizeof(TestItemWinMenu_TOTAL[0]);

constinit testitem AuxLCD_TestItemWinMenu_TOTAL[] = {
    testitem_row(0, catalogue::Touch, mmi_testwnd_touchTestEntry,
                 mmi_AutoTest_touchscreenTest_Stop_Entry),
    testitem_row(1, catalogue::Lcd, mmi_LCDColorTestEntry, mmi_LCDColorTest_Stop_Entry),
    testitem_row(2, catalogue::AllLight, mmi_testwnd_AllLightTestEntry,
                 mmi_testwnd_AllLightTest_Stop_Entry),
    testitem_row(3, catalogue::AuxLcdRunTpSelf, mmi_testwnd_TPSelfTest_Entry,
                 mmi_testwnd_TPSelfTest_Stop),
    testitem_row(4, catalogue::CameraBack, mmi_testwnd_CameraBackTestEntry,
                 mmi_AutoTest_CameraBackTest_Stop_Entry),
};
int g_AuxLCD_testitemnum_total =
    sizeof(AuxLCD_TestItemWinMenu_TOTAL) / sizeof(AuxLCD_TestItemWinMenu_TOTAL[0]);

constinit testitem MonomerPreview_TestItemWinMenu_TOTAL[] = {
    testitem_row(0, catalogue::TpSelf, mmi_testwnd_Monomer_TPSelfTest_Entry,
                 mmi_testwnd_Monomer_TPSelfTest_Stop),
    testitem_row(1, catalogue::MonomerHardVersion, mmi_testwnd_Monomer_HardwareVersionEntry,
                 mmi_testwnd_Monomer_HardwareVersion_Stop),
    testitem_row(2, catalogue::MonomerLcd, mmi_Monomer_LCDColorTestEntry,
                 mmi_Monomer_LCDColorTest_Stop_Entry),
    testitem_row(3, catalogue::MonomerTouch, mmi_testwnd_Monomer_touchTestEntry,
                 mmi_testwnd_Monomer_touchscreenTest_Stop),
};
int g_MonomerPreview_testitemnum_total =
    sizeof(MonomerPreview_TestItemWinMenu_TOTAL) / sizeof(MonomerPreview_TestItemWinMenu_TOTAL[0]);

const mmi_catalogue *mmi_catalogue_tables(void) {
    static const mmi_catalogue kTables = {
        {TestItemWinMenu_TOTAL, sizeof(TestItemWinMenu_TOTAL) / sizeof(TestItemWinMenu_TOTAL[0])},
        {AuxLCD_TestItemWinMenu_TOTAL,
         sizeof(AuxLCD_TestItemWinMenu_TOTAL) / sizeof(AuxLCD_TestItemWinMenu_TOTAL[0])},
        {MonomerPreview_TestItemWinMenu_TOTAL, sizeof(MonomerPreview_TestItemWinMenu_TOTAL) /
                                                   sizeof(MonomerPreview_TestItemWinMenu_TOTAL[0])},
    };
    return &kTables;
}

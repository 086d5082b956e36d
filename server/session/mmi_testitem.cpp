// The compiled-in test item catalogue and the lists built from it and the configuration.
#include "session/mmi_testitem.h"

#include <stdlib.h>
#include <string.h>

#include <android/log.h>

#include "core/ftx_config.h"
#include "testwnd/mmi_testitem_entries.h"
#include "tp_os.h"

#define CFG_DEBUG(...) __android_log_print(ANDROID_LOG_DEBUG, "FTX_CONFIG", __VA_ARGS__)
#define CFG_ERROR(...) __android_log_print(ANDROID_LOG_ERROR, "FTX_CONFIG", __VA_ARGS__)

// A row as compiled in; the configuration fills the rest.
#define TESTITEM_ROW(num, name, entry, stop, domain, code) \
    { num, name, entry, stop, domain, code, 0, 0, 0, 0, "", 0 }

// Repeated item numbers and names (the hall rows, the ringtone rows) are the handset's own.
testitem TestItemWinMenu_TOTAL[] = {
    TESTITEM_ROW(1, "title_SimCardTest", mmi_testwnd_SIMCardTestEntry,
                 mmi_testwnd_SIMCardTest_Stop_Entry, "FTX_SIMCARD", 324),
    TESTITEM_ROW(2, "title_SDCardTest", mmi_testwnd_SDCardTestEntry,
                 mmi_testwnd_SDCardTest_Stop_Entry, "FTX_SDCARD", 360),
    TESTITEM_ROW(6, "title_BatteryCheck", mmi_testwnd_BatteryTestEntry,
                 mmi_testwnd_BatteryTest_Stop_Entry, "FTX_BATTERY", 344),
    TESTITEM_ROW(23, "menu_UsbOtgTest", mmi_testwnd_USBOTGTestEntry,
                 mmi_testwnd_USBOTGTest_Stop_Entry, "FTX_USBHOST", -1),
    TESTITEM_ROW(3, "menu_KeyTest", mmi_teswnd_KeyTestEntry, mmi_teswnd_KeyTest_Stop_Entry,
                 "FTX_KEYS", 312),
    TESTITEM_ROW(4, "title_TPSelfTest", mmi_testwnd_TPSelfTest_Entry, mmi_testwnd_TPSelfTest_Stop,
                 "FTX_TPSELF", -1),
    TESTITEM_ROW(5, "menu_TouchTest", mmi_testwnd_touchTestEntry,
                 mmi_AutoTest_touchscreenTest_Stop_Entry, "FTX_TOUCH", 320),
    TESTITEM_ROW(22, "menu_AllSensorTest", mmi_testwnd_SensorsTestEntry,
                 mmi_testwnd_SensorsTest_Stop_Entry, "FTX_SENSOR", 328),
    TESTITEM_ROW(22, "menu_HallSensor", mmi_testwnd_HallSensorTestEntry,
                 mmi_testwnd_HallSensorTest_Stop_Entry, "FTX_HALLSENSOR", 352),
    TESTITEM_ROW(9, "menu_HallSensor", mmi_testwnd_HallTest_2nd_TestEntry,
                 mmi_testwnd_HallTest_2nd_Stop_Entry, "FTX_HALL_2ND", 352),
    TESTITEM_ROW(25, "menu_FingerPrintTest", mmi_testwnd_FingerPrintTestEntry,
                 mmi_testwnd_FingerPrintTest_Stop_Entry, "FTX_FINGERPRINT", 336),
    TESTITEM_ROW(26, "title_NfcTest", mmi_testwnd_NfcTestEntry, mmi_testwnd_NfcTest_Stop_Entry,
                 "FTX_NFC", 340),
    TESTITEM_ROW(8, "title_MainCameraTest", mmi_testwnd_CameraBackTestEntry,
                 mmi_AutoTest_CameraBackTest_Stop_Entry, "FTX_CAMERA_BACK", 288),
    TESTITEM_ROW(9, "title_MainCamera2Test", mmi_testwnd_CameraAuxBackTestEntry,
                 mmi_AutoTest_CameraAuxBackTest_Stop_Entry, "FTX_AUX_CAMERA_BACK", 288),
    TESTITEM_ROW(10, "title_subCameraTest", mmi_testwnd_CameraFrontTestEntry,
                 mmi_AutoTest_CameraFrontTest_Stop_Entry, "FTX_CAMERA_FRONT", 292),
    TESTITEM_ROW(4, "menu_LCDTest", mmi_LCDColorTestEntry, mmi_LCDColorTest_Stop_Entry, "FTX_LCD",
                 280),
    TESTITEM_ROW(7, "menu_AllLightTest", mmi_testwnd_AllLightTestEntry,
                 mmi_testwnd_AllLightTest_Stop_Entry, "FTX_ALLLIGHT", 284),
    TESTITEM_ROW(30, "menu_ItemTest_SmartPACal", mmi_testwnd_SmartPACalEntry,
                 mmi_testwnd_SmartPACal_Stop_Entry, "FTX_SMARTPACAL", 300),
    TESTITEM_ROW(13, "menu_LoopBackTest", mmi_testwnd_AudioLoopBackTestEntry, nullptr,
                 "FTX_AUDIO_LOOPBACK", 300),
    TESTITEM_ROW(11, "menu_RingTest", mmi_testwnd_RingtoneTestEntry,
                 mmi_test_RingtoneTest_Stop_Entry, "FTX_RINGTONE", 296),
    TESTITEM_ROW(19, "menu_RingToneUp", mmi_testwnd_RingtoneUpTestEntry,
                 mmi_test_RingtoneTest_Stop_Entry, "FTX_RTUP", 296),
    TESTITEM_ROW(30, "menu_RingToneDown", mmi_testwnd_RingtoneDownTestEntry,
                 mmi_test_RingtoneTest_Stop_Entry, "FTX_RTDOWN", 296),
    TESTITEM_ROW(24, "menu_ReceiverRingTest", mmi_testwnd_ReceiverTestEntry,
                 mmi_testwnd_ReceiverTest_Stop_Entry, "FTX_RECEIVER", 298),
    TESTITEM_ROW(12, "menu_HookKeyTest", mmi_teswnd_HookKeyTestEntry,
                 mmi_teswnd_HookKeyTest_Stop_Entry, "FTX_HOOKKEY", -1),
    TESTITEM_ROW(14, "menu_HeadSetTest", mmi_testwnd_HANDSET_MIC_TestEntry,
                 mmi_testwnd_HANDSET_MIC_Stop_Entry, "FTX_HEADSET_LOOPBACK", 304),
    TESTITEM_ROW(15, "menu_FMTest", mmi_testwnd_FmTestEntry, mmi_testwnd_FmTest_Stop_Entry,
                 "FTX_FM", 308),
    TESTITEM_ROW(16, "menu_Mic_Headset", mmi_testwnd_Audio_MIC_Headset_LoopBackTestEntry,
                 mmi_testwnd_Audio_MIC_Headset_Stop_Entry, "FTX_AUDIO_MIC_HEADSET_LOOPBACK", 136),
    TESTITEM_ROW(17, "menu_AuxMic1_Headset",
                 mmi_testwnd_Audio_AuxiliaryMIC1_Headset_LoopBackTestEntry,
                 mmi_testwnd_Audio_AuxiliaryMIC1_Headset_Stop_Entry,
                 "FTX_AUDIO_AUXILIARYMIC1_HEADSET_LOOPBACK", 140),
    TESTITEM_ROW(18, "menu_AuxMic2_Headset",
                 mmi_testwnd_Audio_AuxiliaryMIC2_Headset_LoopBackTestEntry,
                 mmi_testwnd_Audio_AuxiliaryMIC2_Headset_Stop_Entry,
                 "FTX_AUDIO_AUXILIARYMIC2_HEADSET_LOOPBACK", 142),
    TESTITEM_ROW(28, "HIFI", mmi_testwnd_HiFiTestEntry, mmi_test_HiFiTest_Stop_Entry, "FTX_HIFI",
                 368),
    TESTITEM_ROW(19, "menu_Headset_Receiver", mmi_testwnd_Audio_Headset_Receiver_LoopBackTestEntry,
                 mmi_testwnd_Audio_Headset_Receiver_Stop_Entry,
                 "FTX_AUDIO_HEADSET_RECEIVER_LOOPBACK", 144),
    TESTITEM_ROW(20, "menu_Headset_Speaker", mmi_testwnd_Audio_Headset_Speaker_LoopBackTestEntry,
                 mmi_testwnd_Audio_Headset_Speaker_Stop_Entry, "FTX_AUDIO_HEADSET_SPEAKER_LOOPBACK",
                 148),
    TESTITEM_ROW(21, "menu_VibratorTest", mmi_testwnd_VibratorTestEntry,
                 mmi_testwnd_VibratorTest_Stop_Entry, "FTX_VIBRATOR", 316),
    TESTITEM_ROW(33, "menuSARtest", mmi_testwnd_sar_start, mmi_testwnd_sar_stop, "FTX_SAR", 376),
    TESTITEM_ROW(34, "AuxiSARSARtest", mmi_testwnd_Auxiliarysar_start, mmi_testwnd_sar_stop,
                 "FTX_AuxiliarySAR", 376),
    TESTITEM_ROW(27, "menu_AllCardTest", mmi_testwnd_SIMMEMTestEntry,
                 mmi_testwnd_SIMMEMTest_Stop_Entry, "FTX_CARDS", 324),
    TESTITEM_ROW(28, "title_MainMic_Record", mmi_testwnd_MainMicRecordTestEntry,
                 mmi_test_MainMicRecordTest_Stop_Entry, "FTX_AUDIO_MAINMICRECORD", -1),
    TESTITEM_ROW(37, "title_AuxLcdTest", mmi_testwnd_AuxLCDHintTestEntry,
                 mmi_testwnd_AuxLCDHintStop_Entry, "FTX_AUXLCD_HINT", -1),
};
int g_testitemnum_total = sizeof(TestItemWinMenu_TOTAL) / sizeof(TestItemWinMenu_TOTAL[0]);

testitem AuxLCD_TestItemWinMenu_TOTAL[] = {
    TESTITEM_ROW(0, "menu_TouchTest", mmi_testwnd_touchTestEntry,
                 mmi_AutoTest_touchscreenTest_Stop_Entry, "FTX_TOUCH", 320),
    TESTITEM_ROW(1, "menu_LCDTest", mmi_LCDColorTestEntry, mmi_LCDColorTest_Stop_Entry, "FTX_LCD",
                 280),
    TESTITEM_ROW(2, "menu_AllLightTest", mmi_testwnd_AllLightTestEntry,
                 mmi_testwnd_AllLightTest_Stop_Entry, "FTX_ALLLIGHT", 284),
    TESTITEM_ROW(3, "title_TPSelfTest", mmi_testwnd_TPSelfTest_Entry, mmi_testwnd_TPSelfTest_Stop,
                 "FTX_TPSELF", 320),
    TESTITEM_ROW(4, "title_MainCameraTest", mmi_testwnd_CameraBackTestEntry,
                 mmi_AutoTest_CameraBackTest_Stop_Entry, "FTX_CAMERA_BACK", 288),
};
int g_AuxLCD_testitemnum_total =
    sizeof(AuxLCD_TestItemWinMenu_TOTAL) / sizeof(AuxLCD_TestItemWinMenu_TOTAL[0]);

testitem MonomerPreview_TestItemWinMenu_TOTAL[] = {
    TESTITEM_ROW(0, "title_TPSelfTest", mmi_testwnd_Monomer_TPSelfTest_Entry,
                 mmi_testwnd_Monomer_TPSelfTest_Stop, "FTX_TPSELF", -1),
    TESTITEM_ROW(1, "menu_NfcTest", mmi_testwnd_Monomer_HardwareVersionEntry,
                 mmi_testwnd_Monomer_HardwareVersion_Stop, "FTX_MONOMER_HARDVERSION", -1),
    TESTITEM_ROW(2, "menu_LCDTest", mmi_Monomer_LCDColorTestEntry,
                 mmi_Monomer_LCDColorTest_Stop_Entry, "FTX_MONOMER_LCD", -1),
    TESTITEM_ROW(3, "menu_TouchTest", mmi_testwnd_Monomer_touchTestEntry,
                 mmi_testwnd_Monomer_touchscreenTest_Stop, "FTX_TOUCH", -1),
};
int g_MonomerPreview_testitemnum_total =
    sizeof(MonomerPreview_TestItemWinMenu_TOTAL) / sizeof(MonomerPreview_TestItemWinMenu_TOTAL[0]);

testitem_node *g_pTestItemListHead;
int g_testItemListCount;
testitem_node *g_pMonomerPreviewListHead;
int g_monomerPreviewListCount;

namespace {

// How much of a row a build reads, and whether it writes the auxiliary build's lines.
enum class BuildKind { Main, AuxLCD, Monomer };

struct ItemList {
    testitem_node **head;
    int *count;
};

// One key of the row's domain into a zeroed buffer; false when the main file failed.
bool read_key(const char *domain, const char *key, char *out, const char *def) {
    memset(out, 0, FTX_CFG_TEXT_SIZE);
    return Read_MainCfgFile(domain, key, out, def) == 0;
}

// A flag whose failed lookup gives `fallback` instead of the lookup's default.
int32_t read_flag(const char *domain, const char *key, const char *def, int32_t fallback) {
    char work[FTX_CFG_TEXT_SIZE];
    return read_key(domain, key, work, def) ? atoi(work) : fallback;
}

void append_node(const ItemList &list, const testitem &row) {
    testitem_node *node = (testitem_node *)calloc(1, sizeof(testitem_node));
    if (node == nullptr) {
        CFG_ERROR("%s: out of memory for %s", __func__, row.config_domain);
        return;
    }
    *static_cast<testitem *>(node) = row;
    node->item_num = (*list.count)++;
    node->pNodeNext = nullptr;
    testitem_node **tail = list.head;
    while (*tail != nullptr)
        tail = &(*tail)->pNodeNext;
    *tail = node;
}

// Reads every row's settings in table order (the rows are updated in place, so menus see
// disabled items too) and appends the enabled rows. A failed enable or parameter lookup
// stops the build and keeps the nodes appended so far.
int build_list(testitem *table, int rows, const ItemList &list, BuildKind kind, const char *who) {
    char work[FTX_CFG_TEXT_SIZE];
    if (kind == BuildKind::AuxLCD) {
        CFG_DEBUG("%s g_testitemnum_total=%d", who, rows);
        if (rows > 0) CFG_DEBUG("%s domain=%s", who, table[0].config_domain);
    }
    for (int i = 0; i < rows; i++) {
        testitem &row = table[i];
        if (!read_key(row.config_domain, "enable", work, "0")) return -1;
        row.item_enable = atoi(work);
        if (kind == BuildKind::AuxLCD) {
            CFG_DEBUG("%s strtmp::enable=%s", who, work);
            CFG_DEBUG("%s TestItemWinMenu[%d].item_enable=%d", who, i, row.item_enable);
        }
        if (kind != BuildKind::Monomer) {
            row.item_auto = read_flag(row.config_domain, "auto", "1", 1);
            row.item_mmi = read_flag(row.config_domain, "mmi", "0", 0);
            CFG_DEBUG("mmi %d", row.item_mmi);
            // A failed read gives 0, not the default 1: the run logic relies on it.
            row.item_pre = read_flag(row.config_domain, "pre", "1", 0);
        }
        memset(row.parameter, 0, sizeof(row.parameter));
        if (Read_MainCfgFile(row.config_domain, "parameter", row.parameter, nullptr) != 0) {
            return -1;
        }
        if (row.item_enable == 0) continue;
        append_node(list, row);
        if (kind == BuildKind::AuxLCD) {
            CFG_DEBUG("%s domain=%s,enable=%d,parameter=%s", who, row.config_domain,
                      row.item_enable, row.parameter);
        }
    }
    return 0;
}

}  // namespace

int Get_TestItem_Config(int reset) {
    if (reset & 1) g_pTestItemListHead = nullptr;
    g_testItemListCount = 0;
    return build_list(TestItemWinMenu_TOTAL, g_testitemnum_total,
                      {&g_pTestItemListHead, &g_testItemListCount}, BuildKind::Main, __func__);
}

int Get_AuxLCD_TestItem_Config(int reset) {
    if (reset & 1) g_pTestItemListHead = nullptr;
    g_testItemListCount = 0;
    return build_list(AuxLCD_TestItemWinMenu_TOTAL, g_AuxLCD_testitemnum_total,
                      {&g_pTestItemListHead, &g_testItemListCount}, BuildKind::AuxLCD, __func__);
}

int Get_MonomerPreviewTestItem_Config(void) {
    g_pMonomerPreviewListHead = nullptr;
    g_monomerPreviewListCount = 0;
    return build_list(MonomerPreview_TestItemWinMenu_TOTAL, g_MonomerPreview_testitemnum_total,
                      {&g_pMonomerPreviewListHead, &g_monomerPreviewListCount}, BuildKind::Monomer,
                      __func__);
}

int ftx_config_Get_TestItem_Config_Paras(const char *domain) {
    if (domain == nullptr) return -1;
    for (int i = 0; i < g_testitemnum_total; i++) {
        const char *rowDomain = TestItemWinMenu_TOTAL[i].config_domain;
        if (strncmp(domain, rowDomain, strlen(rowDomain)) == 0) return i;
    }
    return -1;
}

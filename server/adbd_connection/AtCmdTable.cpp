// The PC command table, in the order the station PCs expect (earlier rows are tried
// first; of several prefix matches with empty actions the last wins). The module words'
// misspellings are the protocol's.
#include "adbd_connection/AtCmdTable.h"

#include <stdint.h>

#include <android/log.h>

#include "adbd_connection/handlers/handlers.h"
#include "mmi_dialog.h"

const AtCmdRow g_atcmd_table[AT_CMD_TABLE_ROWS] = {
    /*   1 */ {"vibratorMoudle testItem null", "", AutoTest_Vibrator_Start},
    /*   2 */ {"vibratorMoudle testItem open", "", AutoTest_Vibrator_Start},
    /*   3 */ {"vibratorMoudle testItem close", "", AutoTest_Vibrator_Stop},
    /*   4 */ {"LCDMoudle testItem FFFFFF", "", AutoTest_LCD_White_Start},
    /*   5 */ {"LCDMoudle testItem FF0000", "", AutoTest_LCD_Red_Start},
    /*   6 */ {"LCDMoudle testItem 00FF00", "", AutoTest_LCD_Green_Start},
    /*   7 */ {"LCDMoudle testItem 0000FF", "", AutoTest_LCD_Blue_Start},
    /*   8 */ {"LCDMoudle testItem 000000", "", AutoTest_LCD_Black_Start},
    /*   9 */ {"LCDMoudle testItem close", "", AutoTest_LCD_Stop},
    /*  10 */ {"LCDMoudle testItem FFFFFF aux", "", AutoTest_AUX_LCD_White_Start},
    /*  11 */ {"LCDMoudle testItem FF0000 aux", "", AutoTest_AUX_LCD_Red_Start},
    /*  12 */ {"LCDMoudle testItem 00FF00 aux", "", AutoTest_AUX_LCD_Green_Start},
    /*  13 */ {"LCDMoudle testItem 0000FF aux", "", AutoTest_AUX_LCD_Blue_Start},
    /*  14 */ {"LCDMoudle testItem 000000 aux", "", AutoTest_AUX_LCD_Black_Start},
    /*  15 */ {"LCDMoudle testItem close aux", "", AutoTest_AUX_LCD_Stop},
    /*  16 */ {"LEDMoudle testItem FF0000", "", AutoTest_LED_Red_Start},
    /*  17 */ {"LEDMoudle testItem 00FF00", "", AutoTest_LED_Green_Start},
    /*  18 */ {"LEDMoudle testItem FFFF00", "", AutoTest_LED_Orange_Start},
    /*  19 */ {"LEDMoudle testItem close", "", AutoTest_LED_Stop},
    /*  20 */ {"LCDbacklightMoudle testItem", "", AutoTest_LCDBacklight_Start},
    /*  21 */ {"LCDbacklightTestMoudle testItem close", " ", AutoTest_LCDBacklight_Stop},
    /*  22 */ {"LCDWakeupMoudle testItem", "", AutoTest_LCD_Wakeup},
    /*  23 */ {"LCDTurnoffMoudle testItem", " ", AutoTest_LCD_Turnoff},
    /*  24 */ {"KEYbacklightMoudle testItem open", "", AutoTest_KEYBacklight_Start},
    /*  25 */ {"KEYbacklightMoudle testItem close", "", AutoTest_KEYBacklight_Stop},
    /*  26 */ {"flashlightMoudle testItem open", "", AutoTest_flashlight_Start},
    /*  27 */ {"flashlightMoudle testItem close", "", AutoTest_flashlight_Stop},
    /*  28 */ {"flashlightMoudle2 testItem open", "", AutoTest_flashlight2_Start},
    /*  29 */ {"flashlightMoudle2 testItem close", "", AutoTest_flashlight2_Stop},
    /*  30 */
    {"flashlightMoudle testItem front open", "", AutoTest_flashlight_front_Start},
    /*  31 */
    {"flashlightMoudle testItem front close", "", AutoTest_flashlight_front_Stop},
    /*  32 */ {"keyboardMoudle testItem open", "", AutoTest_keyboard_Start},
    /*  33 */ {"keyboardMoudle testItem close", "", AutoTest_keyboard_Stop},
    /*  34 */ {"headsethookMoudle testItem open", "", AutoTest_headsethook_Start},
    /*  35 */ {"headsethookMoudle testItem close", "", AutoTest_headsethook_Stop},
    /*  36 */ {"touchMoudle testItem open", "", AutoTest_touchscreen_Start},
    /*  37 */ {"touchMoudle testItem close", "", AutoTest_touchscreen_Stop},
    /*  38 */ {"FMMoudle testItem", "", AutoTest_FM_Start},
    /*  39 */ {"FMMoudle testItem", "close", AutoTest_FM_Stop},
    /*  40 */
    {"audioMoudle testItem HeadsetHeadset", "", AutoTest_audioloop_HeadsetHeadset_Start},
    /*  41 */
    {"audioMoudle testItem HeadsetSpeaker", "", AutoTest_audioloop_HeadsetSpeaker_Start},
    /*  42 */
    {"audioMoudle testItem HeadsetReceiver", "", AutoTest_audioloop_HeadsetReceiver_Start},
    /*  43 */
    {"audioMoudle testItem MicroHeadset", "", AutoTest_audioloop_MicroHeadset_Start},
    /*  44 */
    {"audioMoudle testItem AuxiliaryMicroHeadset1", "",
     AutoTest_audioloop_AuxiliaryMicroHeadset1_Start},
    /*  45 */
    {"audioMoudle testItem AuxiliaryMicroHeadset2", "",
     AutoTest_audioloop_AuxiliaryMicroHeadset2_Start},
    /*  46 */
    {"audioMoudle testItem openMicro", "", AutoTest_audioloop_MainMicRecord_Start},
    /*  47 */
    {"audioMoudle testItem MicroSpeaker", "", AutoTest_audioloop_MainMic_Speaker_Start},
    /*  48 */
    {"audioMoudle testItem openSpeaker", "", AutoTest_Audio_SpeakerRingtone_Start},
    /*  49 */ {"audioMoudle testItem close", "", AutoTest_audioloop_Stop},
    /*  50 */ {"frontcameraMoudle testItem open", "", AutoTest_frontcamera_Start},
    /*  51 */ {"frontcameraMoudle testItem snapshot", "", AutoTest_frontcamera_Snapshot},
    /*  52 */ {"frontcameraMoudle testItem close", "", AutoTest_frontcamera_Stop},
    /*  53 */ {"backcameraMoudle testItem open", "", AutoTest_backcamera_Start},
    /*  54 */ {"backcameraMoudle testItem snapshot", "", AutoTest_backcamera_Snapshot},
    /*  55 */ {"backcameraMoudle testItem close", "", AutoTest_backcamera_Stop},
    /*  56 */ {"auxbackcameraMoudle testItem open", "", AutoTest_auxbackcamera_Start},
    /*  57 */
    {"auxbackcameraMoudle testItem snapshot", "", AutoTest_auxbackcamera_Snapshot},
    /*  58 */ {"auxbackcameraMoudle testItem close", "", AutoTest_auxbackcamera_Stop},
    /*  59 */ {"sensorMoudle testItem open", "", AutoTest_sensor_Start},
    /*  60 */ {"sensorMoudle testItem calibrate", "", AutoTest_sensor_Calibrate},
    /*  61 */ {"sensorMoudle testItem close", "", AutoTest_sensor_Stop},
    /*  62 */ {"sensorMoudle testItem readAcc", "", AutoTest_Acc_sensor_Start},
    /*  63 */ {"sensorMoudle testItem readMag", "", AutoTest_Mag_sensor_Start},
    /*  64 */ {"sensorMoudle testItem readGyro", "", AutoTest_Gyro_sensor_Start},
    /*  65 */ {"sensorMoudle testItem readPressure", "", AutoTest_Pressure_sensor_Start},
    /*  66 */ {"sensorMoudle testItem readHeartrate", "", AutoTest_Heartrate_sensor_Start},
    /*  67 */ {"sensorMoudle testItem readProxi", "", AutotestSensorProxiStart},
    /*  68 */ {"sensorMoudle testItem readLight", "", AutotestSensorLightStart},
    /*  69 */
    {"sensorMoudle testItem heartrateSelfTest", "", AutoTest_HeartrateSelfTest_sensor_Start},
    /*  70 */ {"hallsensorMoudle testItem open", "", AutoTest_hallsensor_Start},
    /*  71 */ {"hallsensorMoudle testItem close", "", AutoTest_hallsensor_Stop},
    /*  72 */ {"flashtypeMoudle testItem read", "", AutoTest_flashtype_Read},
    /*  73 */ {"RAMMoudle testItem read", "", AutoTest_RAM_Read},
    /*  74 */ {"ROMMoudle testItem read", "", AutoTest_ROM_Read},
    /*  75 */ {"simMoudle testItem", "", AutoTest_sim_Read},
    /*  76 */ {"sdCardMoudle testItem", "", AutoTest_SDCard_Read},
    /*  77 */ {"batteryMoudle testItem charging", "", AutoTest_battery_charging_Read},
    /*  78 */ {"batteryMoudle testItem chargeing", "", AutoTest_battery_charging_Read},
    /*  79 */ {"batteryMoudle testItem power", "", AutoTest_battery_power_Read},
    /*  80 */
    {"batteryMoudle testItem temperature", "", AutoTest_battery_temperature_Read},
    /*  81 */ {"batteryMoudle testItem health", "", AutoTest_battery_health_Read},
    /*  82 */ {"barcodeMoudle testItem read", "", AutoTest_barcode_Read},
    /*  83 */ {"IMEIMoudle testItem read", "", AutoTest_IMEI_Read},
    /*  84 */ {"softwareMoudle testItem internal", "", AutoTest_internalsoftware_Read},
    /*  85 */ {"softwareMoudle testItem external", "", AutoTest_externalsoftware_Read},
    /*  86 */ {"hardwareMoudle testItem read", "", AutoTest_haredware_Read},
    /*  87 */ {"testinfoMoudle testItem", "", AutoTest_testinfo},
    /*  88 */ {"usbChargeMoudle testItem open", "", AutoTest_BatteryCharge_Enable},
    /*  89 */ {"usbChargeMoudle testItem close", "", AutoTest_BatteryCharge_Disable},
    /*  90 */ {"nfcMoudle testItem open", "", AutoTest_NfcTest_Enable},
    /*  91 */ {"nfcMoudle testItem close", "", AutoTest_NfcTest_Disable},
    /*  92 */ {"fingerprintMoudle testItem open", "", AutoTest_Fingerprint_Start},
    /*  93 */ {"fingerprintMoudle testItem close", "", AutoTest_Fingerprint_Stop},
    /*  94 */ {"standbyMoudle testItem open", "", AutoTest_Standby_Enable},
    /*  95 */ {"standbyMoudle testItem close", "", AutoTest_Standby_Disable},
    /*  96 */ {"WiFiMoudle testItem open", "", AutoTest_WiFi_Enable},
    /*  97 */ {"WiFiMoudle testItem close", "", AutoTest_WiFi_Disable},
    /*  98 */ {"WiFiConCptMoudle testItem open", "", AutoTest_WiFiConCpt_Enable},
    /*  99 */ {"WiFiConCptMoudle testItem close", "", AutoTest_WiFiConCpt_Disable},
    /* 100 */ {"mmiMoudle testItem open", "", AutoTest_MMI_Enable},
    /* 101 */ {"mmiMoudle testItem close", "", AutoTest_MMI_Disable},
    /* 102 */ {"FileOptMoudle testItem read", "", AutoTest_FileOpt_Read},
    /* 103 */ {"FileOptMoudle testItem write", "", AutoTest_FileOpt_Write},
    /* 104 */ {"FileOptMoudle testItem remove", "", AutoTest_FileOpt_Remove},
    /* 105 */ {"forcetouchMoudle testItem open", "", automated_force_touch_test_start},
    /* 106 */ {"forcetouchMoudle testItem close", "", automated_force_touch_test_stop},
    /* 107 */
    {"forcetouchcalibrationMoudle testItem open", "", automated_force_touch_calibration_start},
    /* 108 */
    {"forcetouchcalibrationMoudle testItem close", "", automated_force_touch_calibration_stop},
    /* 109 */
    {"forcetouchcalibrationMoudle testItem read", "", automated_force_touch_calibration_read},
    /* 110 */
    {"forcetouchcomprehensiveMoudle testItem open", "",
     automated_force_touch_comprehensive_test_start},
    /* 111 */
    {"forcetouchcomprehensiveMoudle testItem close", "",
     automated_force_touch_comprehensive_test_stop},
    /* 112 */
    {"forcetouchcomprehensiveMoudle testItem read", "", automated_force_touch_calibration_read},
    /* 113 */ {"VibratorPCBA testItem start", "", PCBAAutotestVibratorStart},
    /* 114 */ {"VibratorPCBA testItem stop", "", PCBAAutotestVibratorEnd},
    /* 115 */ {"CpuPCBA testItem start", "", PCBAAutotestCpuStart},
    /* 116 */ {"CpuPCBA testItem stop", "", PCBAAutotestCpuStop},
    /* 117 */ {"MemoryPCBA testItem start", "", PCBAAutotestMemoryStart},
    /* 118 */ {"MemoryPCBA testItem stop", "", PCBAAutotestMemoryStop},
    /* 119 */ {"BluetoothPCBA testItem start", "", PCBAAutotestBluetoothStart},
    /* 120 */ {"BluetoothPCBA testItem stop", "", PCBAAutotestBluetoothStop},
    /* 121 */ {"CameraBackPCBA testItem start", "", PCBAAutotestCameraBackStart},
    /* 122 */ {"CameraFrontPCBA testItem start", "", PCBAAutotestCameraFrontStart},
    /* 123 */ {"BatteryPCBA testItem start", "", PCBAAutotestBatteryStart},
    /* 124 */ {"BatteryPCBA testItem stop", "", PCBAAutotestBatteryStop},
    /* 125 */ {"WifiPCBA testItem start", "", PCBAAutotestWifiStart},
    /* 126 */ {"WifiPCBA testItem stop", "", PCBAAutotestWifiStop},
    /* 127 */ {"FmPCBA testItem start", "", PCBAAutotestFmStart},
    /* 128 */ {"FmPCBA testItem stop", "", PCBAAutotestFmStop},
    /* 129 */ {"GpsPCBA testItem start", "", PCBAAutotestGpsStart},
    /* 130 */ {"GpsPCBA testItem stop", "", PCBAAutotestGpsStop},
    /* 131 */ {"TouchPCBA testItem start", "", PCBAAutotestTouchStart},
    /* 132 */ {"TouchPCBA testItem stop", "", PCBAAutotestTouchStop},
    /* 133 */ {"StoragePCBA testItem start", "", PCBAAutotestStorageStart},
    /* 134 */ {"StoragePCBA testItem stop", "", PCBAAutotestStorageStop},
    /* 135 */ {"SdcardPCBA testItem start", "", PCBAAutotestSdcardStart},
    /* 136 */ {"SdcardPCBA testItem stop", "", PCBAAutotestSdcardStop},
    /* 137 */ {"SimPCBA testItem start", "", PCBAAutotestSimStart},
    /* 138 */ {"SimPCBA testItem stop", "", PCBAAutotestSimStop},
    /* 139 */ {"KeyPCBA testItem start", "", PCBAAutotestKeyStart},
    /* 140 */ {"KeyPCBA testItem stop", "", PCBAAutotestKeyStop},
    /* 141 */ {"RingPCBA testItem start", "", PCBAAutotestRingStart},
    /* 142 */ {"RingPCBA testItem stop", "", PCBAAutotestRingStop},
    /* 143 */ {"WgbPCBA testItem start", "", PCBAAutotestWgbStart},
    /* 144 */ {"WgbPCBA testItem stop", "", PCBAAutotestWgbStop},
    /* 145 */ {"LightControl testItem Open", "", AutoTest_LightControl_Open},
    /* 146 */ {"LightControl testItem Close", "", AutoTest_LightControl_Close},
    /* 147 */ {"SwitchSSID testItem", "", AutoTest_SwitchSSID},
    /* 148 */ {"ConfigMoudle testItem write", "", AutoTest_Modify_ConfigFile},
    /* 149 */ {"RSSIMoudle testItem read", "", AutoTest_GetWiFiRSSI},
    /* 150 */ {"APInfoMoudle testItem read", "", AutoTest_GetAPInfo},
    /* 151 */ {"PowerOffMoudle testItem close", "", AutoTest_PowerOff},
    /* 152 */ {"EnterLowCostMode testItem", "", AutoTest_EnterLowCostMode},
    /* 153 */ {"RebootMoudle testItem close", "", AutoTest_Reboot},
    /* 154 */ {"audioMoudle testItem HiFi", "", AutoTest_hifi_Start},
    /* 155 */ {"hifiaudioMoudle testItem close", "", AutoTest_hifi_Stop},
    /* 156 */ {"audioMoudle testItem HeadsetRecSpeaker", "", AutoTestMicToSpeakerStart},
    /* 157 */ {"Mic2Earpiece testItem start", "", AutotestMic2EarpieceStart},
    /* 158 */ {"Mic2Earpiece testItem stop", "", AutotestMic2EarpieceStop},
    /* 159 */ {"AuxMic2Earpiece testItem start", "", AutotestAuxMic2EarpieceStart},
    /* 160 */ {"AuxMic2Earpiece testItem stop", "", AutotestAuxMic2EarpieceStop},
    /* 161 */ {"ReadCameraID testItem start", "", AutotestReadCameraIDStart},
    /* 162 */ {"CloseDialog testItem start", "", AutoCloseDialog},
    /* 163 */ {"audioRingMoudle testItem open", "", AutoTest_Ring_Start},
    /* 164 */ {"audioRingMoudle testItem close", "", AutoTest_Ring_Stop},
    /* 165 */
    {"SpeakerCalibrateMoudle testItem open", "", AutoTest_SpeakerCalibrate_Start},
    /* 166 */
    {"SpeakerCalibrateMoudle testItem calibrate", "", AutoTest_SpeakerCalibrate_Calibrate},
    /* 167 */
    {"SpeakerCalibrateMoudle testItem close", "", AutoTest_SpeakerCalibrate_Stop},
    /* 168 */ {"HueMoudle testItem set", "", AutoTest_DualLCD_Hue_Set},
    /* 169 */ {"HueRegMoudle testItem set", "", AutoTest_DualLCD_Hue_Register_Set},
    /* 170 */ {"GrayLevelMoudle testItem set", "", AutoTest_DualLCD_GrayLevel_Set},
    /* 171 */ {"DualLCDMoudle testItem Switch", "", AutoTest_DualLCD_Switch_Display},
    /* 172 */ {"CABCMoudle testItem open", "", AutoTest_CABC_Open},
    /* 173 */ {"CABCMoudle testItem close", "", AutoTest_CABC_Close},
    /* 174 */ {"LCDType testItem read", "", AutoTest_LCDType_Read},
    /* 175 */ {"WiFiUDPServ testItem open", "", WiFiUDPServ_Enable},
    /* 176 */ {"WiFiUDPServ testItem close", "", WiFiUDPServ_Disable},
    /* 177 */ {"WiFiDataRate testItem set", "", WiFiDataRate_set},
    /* 178 */ {"commonModule testItem showImage", "", PixelWorks_Calibrate_ShowPicture},
    /* 179 */ {"commonModule testItem close", "", PixelWorks_Calibrate_ShowPicture_Close},
};

int register_at_procs(void) {
    // The row counter is 8 bits wide, as on the handset: the table holds at most 255 rows.
    static_assert(AT_CMD_TABLE_ROWS <= 255, "command table too long");
    for (uint8_t i = 0; i < AT_CMD_TABLE_ROWS; i++) {
        const AtCmdRow &r = g_atcmd_table[i];
        if (registerModule(r.cmd, r.action, r.fun, 1) != REGISTER_OK) {
            __android_log_print(ANDROID_LOG_ERROR, "AtThread", "%s::register_at_procs fail",
                                "AtThreadStart");
            return -1;
        }
    }
    return 0;
}

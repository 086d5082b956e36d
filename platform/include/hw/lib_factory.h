/* The handset's factory hardware library, lib_factory.so: every ftx_api_ operation.
 * The application binds these by name with dlsym; declare the pointers with
 * decltype(&ftx_api_X). Unless said otherwise an operation returns 0 on success and a
 * non-zero value on failure. Callbacks run on the library's own worker thread. */
#ifndef FTX_HW_LIB_FACTORY_H
#define FTX_HW_LIB_FACTORY_H

#ifdef __cplusplus
extern "C" {
#endif

/* Size of the persistent result flag area. */
#define FTX_TESTINFO_FLAGS_SIZE 256
/* Size of the text ftx_api_GetFireWare fills. */
#define FTX_FIRMWARE_TEXT_SIZE 1024
/* Size of the hardware text of a touch-panel status event. */
#define FTX_TPSTATUS_TEXT_SIZE 500

/* What the library reports through a module callback. data is a NUL-terminated text of
 * totallen bytes (without the NUL), or null; it is only valid during the call. */
typedef struct module_data {
    unsigned int totallen;
    int datatype;
    char *data;
} module_data;

typedef void (*ftx_api_module_cb)(module_data *data);

/* Hook key events: status points to 1 when the hook button was pressed, 0 when released. */
typedef void (*ftx_api_hookkey_cb)(unsigned int *status);

/* datatype values and the text each one carries. */
#define FTX_DATATYPE_TESTINFO_IMEI 100  /* text: the IMEI */
#define FTX_DATATYPE_TESTINFO_IMEI2 101 /* text: the second IMEI */
#define FTX_DATATYPE_TESTINFO_PSN 102   /* text: the product serial number */
#define FTX_DATATYPE_TESTINFO_END 103   /* no text: every test-info event was sent */
#define FTX_DATATYPE_HEADSET 105        /* text: "1" headset, "2" headset without mic, "0" none */
/* PCBA events: text "<value>,<result>", result 1 pass, 0 fail; value as below. */
#define FTX_DATATYPE_PCBA_CPU 110       /* maximum frequency in kHz */
#define FTX_DATATYPE_PCBA_MEMORY 111    /* RAM size in MB */
#define FTX_DATATYPE_TPSTATUS 112       /* touch-panel status text, e.g. "...0x01..." */
#define FTX_DATATYPE_PCBA_BLUETOOTH 113 /* devices found */
#define FTX_DATATYPE_PCBA_BATTERY 114   /* level in percent */
#define FTX_DATATYPE_PCBA_WIFI 115      /* access points found */
#define FTX_DATATYPE_PCBA_FM 116        /* signal strength */
#define FTX_DATATYPE_PCBA_GPS 117       /* satellites seen */
#define FTX_DATATYPE_PCBA_STORAGE 119   /* storage size in GB */
#define FTX_DATATYPE_PCBA_SDCARD 120    /* SD card size in MB */
#define FTX_DATATYPE_PCBA_SIM 121       /* SIM cards present */
#define FTX_DATATYPE_PCBA_TOUCH 122     /* touch points seen */
/* Other tests: text "key=value;key=value..." (see docs/hardware.md). */
/* acc=X,Y,Z;mag=X,Y,Z;gyro=X,Y,Z;pressure=P;proxi=D;light=L;hr=B;hrself=1|0
 * (m/s2, uT, rad/s, hPa, cm with 0 near, lux, beats a minute; hrself: the heart-rate
 * sensor's self test passed) */
#define FTX_DATATYPE_SENSOR 130
#define FTX_DATATYPE_HALL 131        /* state=near|far */
#define FTX_DATATYPE_FINGERPRINT 132 /* result=pass|fail */
#define FTX_DATATYPE_NFC 133         /* result=pass;uid=UID | result=fail */
#define FTX_DATATYPE_SAR 134         /* value=N;aux=M (main and auxiliary SAR readings) */
#define FTX_DATATYPE_SMARTPA 135     /* result=pass|fail;value=N */
#define FTX_DATATYPE_OTG 136         /* result=pass|fail */
/* value=N (grams pressed), or result=pass|fail;value=N from a calibration or the
 * comprehensive test */
#define FTX_DATATYPE_FORCETOUCH 137
#define FTX_DATATYPE_LOOPBACK 138 /* result=pass|fail (acoustic loopback, wake-up mic) */
/* Touch self-test verdicts arrive as the datatype itself (0 pass, -1, -2, -4, or a bit set of
 * failures); a verdict with failures may carry "x,y,num,px,py,..." raw failure data. */

/* Sensor numbers of ftx_api_Sensors_Calibration. */
#define FTX_SENSOR_ACC 1
#define FTX_SENSOR_MAG 2
#define FTX_SENSOR_GYRO 3
#define FTX_SENSOR_PRESSURE 4
#define FTX_SENSOR_PROXI 5
#define FTX_SENSOR_LIGHT 6
#define FTX_SENSOR_HEARTRATE 7
/* Size of the offsets text of a calibration. */
#define FTX_SENSOR_OFFSETS_SIZE 64

/* Camera numbers. */
#define FTX_CAMERA_BACK 0
#define FTX_CAMERA_FRONT 1
#define FTX_CAMERA_AUX_BACK 2

/* Flashlight numbers. */
#define FTX_FLASHLIGHT_BACK 0
#define FTX_FLASHLIGHT_FRONT 1
#define FTX_FLASHLIGHT_BACK2 2

/* Software version kinds of ftx_api_GetSoftVersion. */
#define FTX_SOFTVERSION_INTERNAL 0
#define FTX_SOFTVERSION_EXTERNAL 1

/* ---- start-up set ---- */
int ftx_api_LCD_Get_Info(int *width, int *height, int *bpp);
int ftx_api_LCD_Off(void);
int ftx_api_LCD_Refresh(int arg);
int ftx_api_ftx_mode_init(int mode);
int ftx_api_ftx_mode_uninit(void);
/* Sends the device's test information through cb (IMEI, IMEI2, PSN, then END). */
int ftx_api_Get_TestInfo(ftx_api_module_cb cb);
int ftx_api_Get_TestInfo_Stop(void);
/* One byte of the flag area: read into *value / write value, index 0..255. */
int ftx_api_ReadFuncTestInfoFlags(int index, unsigned char *value);
int ftx_api_WriteFuncTestInfoFlags(int index, unsigned char value);
/* Identity texts, NUL-terminated, cut to size. */
int ftx_api_GetSoftVersion(int kind, char *buf, int size);
int ftx_api_GetHardVersion(char *buf, int size);
int ftx_api_GetPSN(char *buf, int size);
/* Fills flags (FTX_TESTINFO_FLAGS_SIZE bytes) with the whole flag area. */
int ftx_api_GetTestInfoFlag(unsigned char *flags);
int ftx_api_GetBoardNum(char *buf, int size);
int ftx_api_GetFlashType(char *buf, int size);
int ftx_api_camera_test_start(int camera);
/* Takes a picture into the device path path. */
int ftx_api_camera_start_capture(int camera, const char *path);
int ftx_api_camera_do_autofocus(int camera);
int ftx_api_camera_test_stop(int camera);
/* Copies the started camera's current preview frame, width x height pixels of 0x00RRGGBB row
 * after row, into argb; -1 when the camera is not started or gives no picture, or the size is
 * not 1..4096 a side. Optional: a library without it shows no preview. */
int ftx_api_camera_get_preview(int camera, unsigned int *argb, int width, int height);
/* Vibrates for ms milliseconds; -1 until stopped. */
int ftx_api_Vibrator_Test_Start(int ms);
int ftx_api_Vibrator_Test_Stop(void);
int ftx_api_AllCard_Test_Start(ftx_api_module_cb cb);
int ftx_api_AllCard_Test_Stop(void);
/* Reports every sensor through cb (FTX_DATATYPE_SENSOR) at the start, then periodically
 * and whenever a value changes, until stopped. */
int ftx_api_Sensors_Test_Start(ftx_api_module_cb cb);
int ftx_api_Sensors_Test_Stop(void);
/* Calibrates sensor (FTX_SENSOR_...): writes its new offsets, "x,y,z" or one value, into
 * offsets (size bytes, NUL-terminated); later reports carry values with the offsets
 * applied. -1 for an unknown sensor. */
int ftx_api_Sensors_Calibration(int sensor, char *offsets, int size);
int ftx_api_Audio_RingTest_Start(int ring_type);
int ftx_api_Audio_RingTest_Stop(int arg);
int ftx_api_Audio_HiFiTest_Start(void);
int ftx_api_Audio_HiFiTest_Stop(void);
int ftx_api_Audio_HiFiTest_auto_Start(const char *parm);
int ftx_api_Audio_HiFiTest_auto_Stop(void);
int ftx_api_Audio_Acoustic_Loopback_Test_Start(ftx_api_module_cb cb);
int ftx_api_Audio_Acoustic_Loopback_Test_Stop(void);
int ftx_api_Audio_wakeupMic_on_Start(ftx_api_module_cb cb);
int ftx_api_Audio_wakeupMic_Stop(void);
int ftx_api_Audio_Acoustic_Loopback_Auxiliary_MIC_Test_Start(ftx_api_module_cb cb);
int ftx_api_Audio_Acoustic_Loopback_Auxiliary_MIC_Test_Stop(void);
int ftx_api_Audio_Acoustic_Loopback_Speaker_Test_Start(ftx_api_module_cb cb);
int ftx_api_Audio_Acoustic_Loopback_Two_Speaker_Test_Start(ftx_api_module_cb cb);
int ftx_api_Audio_Acoustic_Loopback_Headset_Test_Start(ftx_api_module_cb cb);
int ftx_api_Audio_Acoustic_Loopback_Headset_Test_Stop(void);
/* 1 headset with microphone, 2 headset without microphone, 0 none. */
int ftx_api_GetHeadsetState(void);
/* Frequency as configured (units of 100 kHz, e.g. 1017 for 101.7 MHz). */
int ftx_api_FM_Test_Start(int frequency);
int ftx_api_FM_Test_Stop(void);
int ftx_api_FM_Set_Vol(int volume);
int ftx_api_FM_Get_Vol(void);
int ftx_api_Audio_Receiver_Start(int ring_type);
int ftx_api_Audio_Receiver_Stop(void);
/* Main-microphone record: Start records `seconds` of what the main microphone hears (the
 * recording is ready when the seconds have passed); Play plays the recording on the speaker;
 * Stop ends either. 0 on success; Play fails while nothing was recorded. */
int ftx_api_Audio_MainMicRecord_Start(int seconds);
int ftx_api_Audio_MainMicRecord_Play(void);
int ftx_api_Audio_MainMicRecord_Stop(void);
int ftx_api_USB_OTG_Test_START(ftx_api_module_cb cb);
int ftx_api_USB_OTG_Test_Stop(void);
int ftx_api_SetSystemIdleStatus(int idle);
/* Microphone and output codes as the audio tests use them; GetVolume returns the level. */
int ftx_api_Audio_SetVolume(int microphone, int output, int level);
int ftx_api_Audio_GetVolume(int microphone, int output);
int ftx_api_EnterLowCostMode(void);

/* ---- per-feature sets ---- */
int ftx_api_Audio_Loopback_Test_Start(int microphone, int output, const char *parm,
                                      ftx_api_module_cb cb);
int ftx_api_Audio_Loopback_Test_Stop(int microphone, int output);
int ftx_api_HookKeyTest_Start(ftx_api_hookkey_cb cb);
/* reply (may be null) gets "*<presses>" with the hook presses seen since the start. */
int ftx_api_HookKeyTest_Stop(char *reply, unsigned int size);
int ftx_api_FlashlightTest_Start(int flashlight);
int ftx_api_FlashlightTest_Stop(int flashlight);
int ftx_api_AlllightTest_Start(void);
int ftx_api_AlllightTest_Stop(void);
int ftx_api_KeyBacklightTest_Start(void);
int ftx_api_KeyBacklightTest_Stop(void);
/* color: "red", "green" or "orange". */
int ftx_api_LEDColorTest_Start(const char *color);
int ftx_api_LEDColorTest_Stop(void);
int ftx_api_Set_LCDBacklight(unsigned int level);
/* Hall and SAR starts report the state at once and then each change. */
int ftx_api_HallSensorTest_Start(ftx_api_module_cb cb);
int ftx_api_HallSensorTest_Stop(void);
int ftx_api_Hall_2nd_test_start(ftx_api_module_cb cb);
int ftx_api_Hall_2nd_test_Stop(void);
int ftx_api_Hall_2nd_calibrate(void);
/* Reports the force at once and then each change. */
int ftx_api_force_touch_sensor_test_start(ftx_api_module_cb cb);
int ftx_api_force_touch_sensor_test_stop(void);
/* Return the force value read at the press / release. */
int ftx_api_force_touch_sensor_button_down(void);
int ftx_api_force_touch_sensor_button_up(void);
/* parm: the calibration weight in grams (empty: 500). One result event follows. */
int ftx_api_force_touch_calibration_start(const char *parm, ftx_api_module_cb cb);
int ftx_api_force_touch_calibration_stop(void);
/* One result event follows. */
int ftx_api_force_touch_comprehension_start(ftx_api_module_cb cb);
int ftx_api_force_touch_comprehension_stop(void);
int ftx_api_FingerPrintTest_Start(ftx_api_module_cb cb);
int ftx_api_FingerPrintTest_Stop(void);
/* Return 1 when the card of that slot is present, 0 when absent, -1 on a bad slot. */
int ftx_api_SimCard_Test_Start(int slot);
int ftx_api_SimCard_Test_Stop(void);
int ftx_api_SDCard_Test_Start(int slot);
int ftx_api_SDCard_Test_Stop(void);
/* The SD card's size in MB: 0 when the slot is empty, -1 on a bad slot (only slot 0). */
int ftx_api_SDCard_Get_Size(int slot);
int ftx_api_NFC_Start(ftx_api_module_cb cb);
int ftx_api_NFC_Stop(void);
int ftx_api_sar_start(ftx_api_module_cb cb);
int ftx_api_sar_stop(void);
int ftx_api_SmartPACalibrate_Start(ftx_api_module_cb cb);
int ftx_api_SmartPACalibrate_Stop(void);
/* Same answer as ftx_api_GetHeadsetState. */
int ftx_api_Get_HeadSetStatus(void);
int ftx_api_tpd_SelfTest_Start(ftx_api_module_cb cb);
int ftx_api_tpd_SelfTest_Stop(void);
/* Fills buf (FTX_FIRMWARE_TEXT_SIZE bytes) with the panel firmware description. */
int ftx_api_GetFireWare(char *buf);
/* Writes "level=N;voltage=N;temperature=N;status=N;health=N" into buf. */
int ftx_api_Battery_Test(char *buf, int size);

/* ---- touch-panel status ("TPHARDWARE") ---- */
/* Remembers cb for module; a null cb forgets it. */
int ftx_api_RegisterModuleCallback(const char *module, ftx_api_module_cb cb);
/* Asks module for its status; the answer arrives through the registered callback
 * (FTX_DATATYPE_TPSTATUS with a FTX_TPSTATUS_TEXT_SIZE-byte text for "TPHARDWARE"). */
int ftx_api_GetModuleStatus(const char *module);

/* ---- aging set; the detections return 0 when the device was found ---- */
int ftx_api_BTDevDetect(void);
int ftx_api_FMDevDetect(void);
int ftx_api_WifiDevDetect(void);
/* Checks the camera with that id (2 or 3); 0 when it answers. */
int ftx_api_cameraID_test(int id);

/* ---- PCBA set: each start runs its check and reports one event through cb ---- */
int ftx_api_cpu_start(ftx_api_module_cb cb);
int ftx_api_cpu_stop(void);
int ftx_api_memory_start(ftx_api_module_cb cb);
int ftx_api_memory_stop(void);
int ftx_api_bluetooth_start(ftx_api_module_cb cb);
int ftx_api_bluetooth_stop(void);
int ftx_api_battery_start(ftx_api_module_cb cb);
int ftx_api_battery_stop(void);
int ftx_api_wifi_start(ftx_api_module_cb cb);
int ftx_api_wifi_stop(void);
int ftx_api_gps_start(ftx_api_module_cb cb);
int ftx_api_gps_stop(void);
int ftx_api_storage_start(ftx_api_module_cb cb);
int ftx_api_storage_stop(void);
int ftx_api_sdcard_start(ftx_api_module_cb cb);
int ftx_api_sdcard_stop(void);
int ftx_api_sim_start(ftx_api_module_cb cb);
int ftx_api_sim_stop(void);
int ftx_api_touch_start(ftx_api_module_cb cb);
int ftx_api_touch_stop(void);
/* Wgb switch: (2, 1) starts, (2, 0) stops; non-zero on success. */
int ftx_api_wgb_start(int group, int on);
int ftx_api_fm_start(ftx_api_module_cb cb);
int ftx_api_fm_stop(void);
int ftx_api_mic2earpiece_start(void);
int ftx_api_mic2earpiece_stop(void);
int ftx_api_auxmic2earpiece_start(void);
int ftx_api_auxmic2earpiece_stop(void);

#ifdef __cplusplus
}
#endif
#endif

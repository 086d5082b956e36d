// Binding of the handset libraries by name: one table per binder, one loop for all.
#include "core/ftx_lib_binding.h"

#include <dlfcn.h>
#include <string.h>

#include <android/log.h>

namespace hw {
#define FTX_HW_DEFINE_OP(name) ftx_hw_op<decltype(&::name)> name;
FTX_FACTORY_OPS(FTX_HW_DEFINE_OP)
FTX_COREDEVICE_OPS(FTX_HW_DEFINE_OP)
#undef FTX_HW_DEFINE_OP
}  // namespace hw

std::atomic<void *> lib_dvk_factory{nullptr};
std::atomic<void *> g_libcoredevice{nullptr};

#define FTX_HW_ENTRY(name) {#name, &hw::name},
const ftx_hw_op_entry g_ftx_hw_ops[] = {FTX_FACTORY_OPS(FTX_HW_ENTRY)
                                            FTX_COREDEVICE_OPS(FTX_HW_ENTRY){nullptr, nullptr}};
#undef FTX_HW_ENTRY

int func_temp(void) {
    return 0;
}

namespace {

const char kFactoryLib[] = "lib_factory.so";
const char kFactoryLabel[] = "lib_factory.so";
const char kCoreLib[] = "libdvk_ncoredevice.so";
const char kCoreLabel[] = "g_libcoredevice.so";
const char kStartTag[] = "DVK_FTX";

ftx_hw_slot s_handedReadFlags;
ftx_hw_slot s_handedWriteFlags;

template <typename F>
void *fn_addr(F f) {
    return reinterpret_cast<void *>(f);
}

#define REQ(name) \
    { #name, &hw::name, FTX_BIND_REQUIRED, nullptr, nullptr }
#define OPT(name) \
    { #name, &hw::name, FTX_BIND_OPTIONAL, nullptr, nullptr }
#define OPT_FB(name, fb) \
    { #name, &hw::name, FTX_BIND_OPTIONAL, fn_addr(fb), nullptr }
#define OPT_AS(name, shown) \
    { #name, &hw::name, FTX_BIND_OPTIONAL, nullptr, shown }
#define REQ_AS(name, shown) \
    { #name, &hw::name, FTX_BIND_REQUIRED, nullptr, shown }
#define OPT_HANDED(name, slot) \
    { #name, &hw::name, FTX_BIND_OPTIONAL, nullptr, nullptr, &slot }
#define ANY(name) \
    { #name, &hw::name, FTX_BIND_SILENT, nullptr, nullptr }
#define COUNT(rows) static_cast<int>(sizeof(rows) / sizeof(rows[0]))

const ftx_sym_binding kStartupSet[] = {
    REQ(ftx_api_LCD_Get_Info),
    OPT(ftx_api_LCD_Off),
    REQ(ftx_api_LCD_Refresh),
    REQ(ftx_api_ftx_mode_init),
    OPT_FB(ftx_api_ftx_mode_uninit, &func_temp),
    REQ(ftx_api_Get_TestInfo),
    REQ(ftx_api_Get_TestInfo_Stop),
    OPT_HANDED(ftx_api_ReadFuncTestInfoFlags, s_handedReadFlags),
    OPT_HANDED(ftx_api_WriteFuncTestInfoFlags, s_handedWriteFlags),
    REQ(ftx_api_GetSoftVersion),
    REQ(ftx_api_GetHardVersion),
    REQ(ftx_api_GetPSN),
    REQ(ftx_api_GetTestInfoFlag),
    REQ(ftx_api_GetBoardNum),
    REQ(ftx_api_GetFlashType),
    REQ(ftx_api_camera_test_start),
    REQ(ftx_api_camera_start_capture),
    OPT(ftx_api_camera_do_autofocus),
    REQ(ftx_api_camera_test_stop),
    REQ(ftx_api_Vibrator_Test_Start),
    REQ(ftx_api_Vibrator_Test_Stop),
    REQ(ftx_api_AllCard_Test_Start),
    REQ(ftx_api_AllCard_Test_Stop),
    REQ(ftx_api_Sensors_Test_Start),
    REQ(ftx_api_Sensors_Test_Stop),
    REQ(ftx_api_Sensors_Calibration),
    REQ(ftx_api_Audio_RingTest_Start),
    REQ(ftx_api_Audio_RingTest_Stop),
    OPT(ftx_api_Audio_HiFiTest_Start),
    OPT(ftx_api_Audio_HiFiTest_Stop),
    // The program names the plain start in this one's message.
    OPT_AS(ftx_api_Audio_HiFiTest_auto_Start, "ftx_api_Audio_HiFiTest_Start"),
    OPT(ftx_api_Audio_HiFiTest_auto_Stop),
    REQ(ftx_api_Audio_Acoustic_Loopback_Test_Start),
    REQ(ftx_api_Audio_Acoustic_Loopback_Test_Stop),
    OPT(ftx_api_Audio_wakeupMic_on_Start),
    OPT(ftx_api_Audio_wakeupMic_Stop),
    OPT(ftx_api_Audio_Acoustic_Loopback_Auxiliary_MIC_Test_Start),
    REQ(ftx_api_Audio_Acoustic_Loopback_Auxiliary_MIC_Test_Stop),
    REQ(ftx_api_Audio_Acoustic_Loopback_Speaker_Test_Start),
    OPT(ftx_api_Audio_Acoustic_Loopback_Two_Speaker_Test_Start),
    REQ(ftx_api_Audio_Acoustic_Loopback_Headset_Test_Start),
    REQ(ftx_api_Audio_Acoustic_Loopback_Headset_Test_Stop),
    REQ(ftx_api_GetHeadsetState),
    REQ(ftx_api_FM_Test_Start),
    REQ(ftx_api_FM_Test_Stop),
    REQ(ftx_api_FM_Set_Vol),
    REQ(ftx_api_FM_Get_Vol),
    OPT(ftx_api_Audio_Receiver_Start),
    OPT(ftx_api_Audio_Receiver_Stop),
    OPT(ftx_api_Audio_MainMicRecord_Start),
    OPT(ftx_api_Audio_MainMicRecord_Play),
    OPT(ftx_api_Audio_MainMicRecord_Stop),
    OPT(ftx_api_USB_OTG_Test_START),
    OPT(ftx_api_USB_OTG_Test_Stop),
    OPT(ftx_api_SetSystemIdleStatus),
    OPT(ftx_api_Audio_SetVolume),
    OPT(ftx_api_Audio_GetVolume),
    OPT(ftx_api_EnterLowCostMode),
};

const ftx_sym_binding kBatterySet[] = {
    REQ(FTX_API_BatteryService_register_Observer),
    REQ_AS(FTX_API_BatteryService_unregister_Observer,
           "FTX_API_BatteryService_unregister_Observer_lib_t"),
    REQ(FTX_API_BatteryService_StartService),
    REQ(FTX_API_BatteryService_StopService),
    REQ(FTX_API_BatteryService_ChargingStatusSet),
};

const ftx_sym_binding kChannelSet[] = {
    REQ(registerAtSocket),
    REQ(UnregisterAtSocket),
    REQ(registerCommandProcess),
    REQ(runSelectLoopMode),
    REQ(mmi_AutoTest_FileOpt_Read),
    REQ(mmi_AutoTest_FileOpt_Write),
    REQ(mmi_AutoTest_FileOpt_Remove),
    REQ(mmi_AutoTest_WiFiConCpt_Enable),
    REQ(mmi_AutoTest_WiFiConCpt_Disable),
};

// Per-feature sets.
const ftx_sym_binding kLoopbackSet[] = {REQ(ftx_api_Audio_Loopback_Test_Start),
                                        REQ(ftx_api_Audio_Loopback_Test_Stop)};
const ftx_sym_binding kHookKeySet[] = {REQ(ftx_api_HookKeyTest_Start),
                                       REQ(ftx_api_HookKeyTest_Stop)};
const ftx_sym_binding kFlashlightSet[] = {REQ(ftx_api_FlashlightTest_Start),
                                          REQ(ftx_api_FlashlightTest_Stop)};
const ftx_sym_binding kAlllightSet[] = {REQ(ftx_api_AlllightTest_Start),
                                        REQ(ftx_api_AlllightTest_Stop)};
const ftx_sym_binding kKeyBacklightSet[] = {REQ(ftx_api_KeyBacklightTest_Start),
                                            REQ(ftx_api_KeyBacklightTest_Stop)};
const ftx_sym_binding kLedSet[] = {REQ(ftx_api_LEDColorTest_Start), REQ(ftx_api_LEDColorTest_Stop)};
const ftx_sym_binding kLcdBacklightSet[] = {REQ(ftx_api_Set_LCDBacklight)};
const ftx_sym_binding kHallSet[] = {REQ(ftx_api_HallSensorTest_Start),
                                    REQ(ftx_api_HallSensorTest_Stop)};
const ftx_sym_binding kHall2ndSet[] = {REQ(ftx_api_Hall_2nd_test_start),
                                       REQ(ftx_api_Hall_2nd_test_Stop),
                                       REQ(ftx_api_Hall_2nd_calibrate)};
const ftx_sym_binding kForceTouchSet[] = {
    REQ(ftx_api_force_touch_sensor_test_start), REQ(ftx_api_force_touch_sensor_test_stop),
    REQ(ftx_api_force_touch_sensor_button_down), REQ(ftx_api_force_touch_sensor_button_up)};
const ftx_sym_binding kForceTouchCaliSet[] = {
    REQ(ftx_api_force_touch_calibration_start), REQ(ftx_api_force_touch_calibration_stop),
    REQ(ftx_api_force_touch_comprehension_start), REQ(ftx_api_force_touch_comprehension_stop)};
const ftx_sym_binding kFingerPrintSet[] = {REQ(ftx_api_FingerPrintTest_Start),
                                           REQ(ftx_api_FingerPrintTest_Stop)};
const ftx_sym_binding kSimSdSet[] = {REQ(ftx_api_SimCard_Test_Start),
                                     REQ(ftx_api_SimCard_Test_Stop), REQ(ftx_api_SDCard_Test_Start),
                                     REQ(ftx_api_SDCard_Test_Stop), OPT(ftx_api_SDCard_Get_Size)};
const ftx_sym_binding kNfcSet[] = {REQ(ftx_api_NFC_Start), REQ(ftx_api_NFC_Stop)};
const ftx_sym_binding kSarSet[] = {REQ(ftx_api_sar_start), REQ(ftx_api_sar_stop)};
const ftx_sym_binding kSmartPaSet[] = {REQ(ftx_api_SmartPACalibrate_Start),
                                       REQ(ftx_api_SmartPACalibrate_Stop)};
const ftx_sym_binding kHifiSet[] = {REQ(ftx_api_Get_HeadSetStatus)};
const ftx_sym_binding kTpSelfSet[] = {REQ(ftx_api_tpd_SelfTest_Start),
                                      REQ(ftx_api_tpd_SelfTest_Stop), REQ(ftx_api_GetFireWare)};
const ftx_sym_binding kFirmwareSet[] = {REQ(ftx_api_GetFireWare)};
const ftx_sym_binding kBatteryTestSet[] = {REQ(ftx_api_Battery_Test)};
// The preview is optional: a library without it gives the window no frames.
const ftx_sym_binding kCameraSet[] = {ANY(ftx_api_camera_get_preview)};
// The lights always; the others only where no earlier binder bound them.
#define REQ_UNSET(name) \
    { #name, &hw::name, FTX_BIND_REQUIRED_IF_UNSET, nullptr, nullptr }
const ftx_sym_binding kAgingSet[] = {
    REQ(ftx_api_AlllightTest_Start),         REQ(ftx_api_AlllightTest_Stop),
    REQ_UNSET(ftx_api_Audio_RingTest_Start), REQ_UNSET(ftx_api_Audio_RingTest_Stop),
    REQ_UNSET(ftx_api_cameraID_test),        REQ_UNSET(ftx_api_WifiDevDetect),
    REQ_UNSET(ftx_api_BTDevDetect),          REQ_UNSET(ftx_api_FMDevDetect)};
// The aging binder may have bound the camera-ID check already.
const ftx_sym_binding kPcbaSet[] = {
    ANY(ftx_api_cpu_start),
    ANY(ftx_api_cpu_stop),
    ANY(ftx_api_memory_start),
    ANY(ftx_api_memory_stop),
    ANY(ftx_api_bluetooth_start),
    ANY(ftx_api_bluetooth_stop),
    ANY(ftx_api_battery_start),
    ANY(ftx_api_battery_stop),
    ANY(ftx_api_wifi_start),
    ANY(ftx_api_wifi_stop),
    ANY(ftx_api_gps_start),
    ANY(ftx_api_gps_stop),
    ANY(ftx_api_storage_start),
    ANY(ftx_api_storage_stop),
    ANY(ftx_api_sdcard_start),
    ANY(ftx_api_sdcard_stop),
    ANY(ftx_api_sim_start),
    ANY(ftx_api_sim_stop),
    ANY(ftx_api_touch_start),
    ANY(ftx_api_touch_stop),
    ANY(ftx_api_wgb_start),
    ANY(ftx_api_fm_start),
    ANY(ftx_api_fm_stop),
    ANY(ftx_api_mic2earpiece_start),
    ANY(ftx_api_mic2earpiece_stop),
    ANY(ftx_api_auxmic2earpiece_start),
    ANY(ftx_api_auxmic2earpiece_stop),
    {"ftx_api_cameraID_test", &hw::ftx_api_cameraID_test, FTX_BIND_IF_UNSET, nullptr, nullptr},
};

// A per-feature binder: its name, its log tag, its symbols.
struct feature_binder {
    const char *name;
    const char *tag;
    const ftx_sym_binding *rows;
    int count;
    bool bareMissingLine;  // the missing library's line does not name the binder
};

#define FEATURE(name, tag, rows) \
    { name, tag, rows, COUNT(rows), false }
#define FEATURE_BARE(name, tag, rows) \
    { name, tag, rows, COUNT(rows), true }
const feature_binder kLoopback = FEATURE("load_lib_interface", "FTX_AUDIO_LOOPBACK", kLoopbackSet);
const feature_binder kHookKey = FEATURE("load_lib_interface", "FTX_HOOKKEY", kHookKeySet);
const feature_binder kFlashlight =
    FEATURE("Init_lib_Flashlight_Interface", "FTX_ALLLIGHT", kFlashlightSet);
const feature_binder kAlllight =
    FEATURE("Init_lib_Alllight_Interface", "FTX_ALLLIGHT", kAlllightSet);
const feature_binder kKeyBacklight =
    FEATURE("Init_lib_KeyBacklight_Interface", "FTX_ALLLIGHT", kKeyBacklightSet);
const feature_binder kLed = FEATURE("Init_lib_LED_Interface", "FTX_ALLLIGHT", kLedSet);
const feature_binder kLcdBacklight =
    FEATURE("Init_lib_LCDBacklight_Interface", "FTX_ALLLIGHT", kLcdBacklightSet);
const feature_binder kHall = FEATURE("Init_lib_HallSensor_Interface", "FTX_HALLSENSOR", kHallSet);
const feature_binder kHall2nd = FEATURE("Init_lib_Hall2nd_Interface", "FTX_HALL_2ND", kHall2ndSet);
const feature_binder kForceTouch =
    FEATURE("init_force_touch_sensor_test_interface", "FORCETOUCH", kForceTouchSet);
const feature_binder kForceTouchCali =
    FEATURE("init_force_touch_calibration_interface", "FORCETOUCH_CALI", kForceTouchCaliSet);
const feature_binder kFingerPrint =
    FEATURE("Init_lib_FingerPrint_Interface", "FTX_FINGERPRINT", kFingerPrintSet);
const feature_binder kSimSd = FEATURE("Init_lib_Interface", "FTX_SIMCARD", kSimSdSet);
const feature_binder kNfc = FEATURE("Init_lib_Interface", "FTX_NFC", kNfcSet);
const feature_binder kSar = FEATURE("Init_lib_sar_Interface", "FTX_SAR", kSarSet);
const feature_binder kSmartPa =
    FEATURE("Init_lib_SmartPACAL_Interface", "FTX_SMARTPACAL", kSmartPaSet);
const feature_binder kHifi = FEATURE("Init_Hifi_Interface", "FTX_HIFI", kHifiSet);
const feature_binder kTpSelf = FEATURE("Init_lib_TPSelf_Interface", "FTX_TPSELF", kTpSelfSet);
const feature_binder kHardVersion =
    FEATURE("Init_lib_HardVersion_Interface", "FTX_MONOMER_HARDVERSION", kFirmwareSet);
const feature_binder kBatteryTest =
    FEATURE("Init_lib_Battery_Interface", "FTX_BATTERY", kBatteryTestSet);
const feature_binder kCamera = FEATURE("Init_lib_Camera_Interface", "FTX_CAMERA_BACK", kCameraSet);
const feature_binder kAging = FEATURE_BARE("Init_lib_AgingTest_Interface", "AgingTest", kAgingSet);
const feature_binder kPcba = FEATURE_BARE("Init_lib_Interface_all", "FTX_CPU", kPcbaSet);

// Writes "error = <text>,<binder>" when the loader has an error text; consumes it.
void log_loader_error(const char *tag, const char *binder) {
    const char *err = dlerror();
    if (err != nullptr) __android_log_print(ANDROID_LOG_ERROR, tag, "error = %s,%s\n", err, binder);
}

int bind_feature(const feature_binder &b, const char *tag) {
    if (tag == nullptr) tag = b.tag;
    void *handle = lib_dvk_factory.load();
    if (handle == nullptr) {
        if (b.bareMissingLine)
            __android_log_print(ANDROID_LOG_ERROR, tag,
                                "FATAL ERROR: could not find lib_factory.so\n");
        else
            __android_log_print(ANDROID_LOG_ERROR, tag,
                                "FATAL ERROR: %s could not find lib_factory.so\n", b.name);
        return -1;
    }
    return ftx_bind_symbols(handle, kFactoryLabel, tag, b.name, b.rows, b.count);
}

// Opens a library once; logs the open failure under the start-up tag.
void *open_library(std::atomic<void *> &handle, const char *file, const char *label) {
    void *h = handle.load();
    if (h != nullptr) return h;
    h = dlopen(file, RTLD_NOW);
    if (h == nullptr) {
        __android_log_print(ANDROID_LOG_ERROR, kStartTag, "FATAL ERROR: could not dlopen %s: %s",
                            label, dlerror());
        return nullptr;
    }
    handle.store(h);
    return h;
}

}  // namespace

int ftx_bind_symbols(void *handle, const char *libLabel, const char *tag, const char *binder,
                     const ftx_sym_binding *rows, int count) {
    for (int i = 0; i < count; i++) {
        const ftx_sym_binding &r = rows[i];
        const bool ifUnset = r.kind == FTX_BIND_IF_UNSET || r.kind == FTX_BIND_REQUIRED_IF_UNSET;
        if (ifUnset && r.slot->get() != nullptr) continue;
        void *p = dlsym(handle, r.name);
        if (p != nullptr) {
            r.slot->set(p);
            continue;
        }
        void *standBy = r.handed != nullptr ? r.handed->get() : r.fallback;
        r.slot->set(r.kind == FTX_BIND_OPTIONAL ? standBy : nullptr);
        if (r.kind == FTX_BIND_SILENT || r.kind == FTX_BIND_IF_UNSET) {
            dlerror();
            continue;
        }
        __android_log_print(ANDROID_LOG_ERROR, tag, "FATAL ERROR: could not dlsym %s::%s\n",
                            libLabel, r.shownName != nullptr ? r.shownName : r.name);
        log_loader_error(tag, binder);
        if (r.kind == FTX_BIND_REQUIRED || r.kind == FTX_BIND_REQUIRED_IF_UNSET) return -1;
    }
    return 0;
}

int ftx_own_library_open(std::atomic<void *> *handle, const char *file, const char *tag,
                         const ftx_own_op *ops, int count) {
    void *lib = dlopen(file, RTLD_NOW);
    if (lib == nullptr) {
        __android_log_print(ANDROID_LOG_ERROR, tag, "FATAL ERROR: could not dlopen %s: %s", file,
                            dlerror());
        return -1;
    }
    handle->store(lib);
    for (int i = 0; i < count; i++) {
        void *p = dlsym(lib, ops[i].name);
        if (p == nullptr) {
            __android_log_print(ANDROID_LOG_ERROR, tag, "FATAL ERROR: could not dlsym %s\n",
                                ops[i].name);
            ftx_own_library_close(handle, ops, count);
            return -1;
        }
        ops[i].slot->set(p);
    }
    return 0;
}

void ftx_own_library_close(std::atomic<void *> *handle, const ftx_own_op *ops, int count) {
    for (int i = 0; i < count; i++)
        ops[i].slot->set(nullptr);
    void *lib = handle->exchange(nullptr);
    if (lib != nullptr) dlclose(lib);
}

void ftx_binding_set_fallbacks(const ftx_binding_fallbacks *fallbacks) {
    s_handedReadFlags.set(fallbacks ? fn_addr(fallbacks->readFuncTestInfoFlags) : nullptr);
    s_handedWriteFlags.set(fallbacks ? fn_addr(fallbacks->writeFuncTestInfoFlags) : nullptr);
}

ftx_hw_slot *ftx_hw_find(const char *name) {
    for (const ftx_hw_op_entry *e = g_ftx_hw_ops; e->name != nullptr; e++) {
        if (strcmp(e->name, name) == 0) return e->slot;
    }
    return nullptr;
}

void ftx_hw_unbind_all(void) {
    for (const ftx_hw_op_entry *e = g_ftx_hw_ops; e->name != nullptr; e++)
        e->slot->set(nullptr);
}

namespace {

// A start-up binder: opens its library and binds its set, logging as "DVK_FTX".
struct startup_binder {
    const char *name;
    std::atomic<void *> &handle;
    const char *file;
    const char *label;
    const ftx_sym_binding *rows;
    int count;
};

int bind_startup(const startup_binder &b) {
    __android_log_print(ANDROID_LOG_ERROR, kStartTag, "%s %s load lib begin\n", "appMain", b.name);
    void *h = open_library(b.handle, b.file, b.label);
    if (h == nullptr) {
        log_loader_error(kStartTag, b.name);
        return -1;
    }
    return ftx_bind_symbols(h, b.label, kStartTag, b.name, b.rows, b.count);
}

}  // namespace

int ftx_init_lib_factory_dll(void) {
    static const startup_binder b = {
        "ftx_init_lib_factory_dll", lib_dvk_factory, kFactoryLib, kFactoryLabel, kStartupSet,
        COUNT(kStartupSet)};
    return bind_startup(b);
}

int ftx_init_libdvk_ncoredevice_dll(void) {
    static const startup_binder b = {"ftx_init_libdvk_ncoredevice_dll",
                                     g_libcoredevice,
                                     kCoreLib,
                                     kCoreLabel,
                                     kBatterySet,
                                     COUNT(kBatterySet)};
    return bind_startup(b);
}

int Get_libcoredevice_Interface(void) {
    static const char kTag[] = "AtThread";
    static const char kName[] = "Get_libcoredevice_Interface";
    __android_log_print(ANDROID_LOG_ERROR, kTag, "%s::%s:load lib begin\n",
                        "adbd_connection/AtThread", kName);
    void *h = g_libcoredevice.load();
    if (h == nullptr) {
        __android_log_print(ANDROID_LOG_ERROR, kTag,
                            "FATAL ERROR: could not dlopen g_libcoredevice.so: %s", dlerror());
        log_loader_error(kTag, kName);
        return -1;
    }
    return ftx_bind_symbols(h, kCoreLabel, kTag, kName, kChannelSet, COUNT(kChannelSet));
}

int load_lib_interface_loopback(const char *tag) {
    return bind_feature(kLoopback, tag);
}
int load_lib_interface_hookkey(const char *tag) {
    return bind_feature(kHookKey, tag);
}
int Init_lib_Flashlight_Interface(void) {
    return bind_feature(kFlashlight, nullptr);
}
int Init_lib_Alllight_Interface(void) {
    return bind_feature(kAlllight, nullptr);
}
int Init_lib_KeyBacklight_Interface(void) {
    return bind_feature(kKeyBacklight, nullptr);
}
int Init_lib_LED_Interface(void) {
    return bind_feature(kLed, nullptr);
}
int Init_lib_LCDBacklight_Interface(void) {
    return bind_feature(kLcdBacklight, nullptr);
}
int Init_lib_HallSensor_Interface(void) {
    return bind_feature(kHall, nullptr);
}
int Init_lib_Hall2nd_Interface(void) {
    return bind_feature(kHall2nd, nullptr);
}
int init_force_touch_sensor_test_interface(void) {
    return bind_feature(kForceTouch, nullptr);
}
int init_force_touch_calibration_interface(void) {
    return bind_feature(kForceTouchCali, nullptr);
}
int Init_lib_FingerPrint_Interface(void) {
    return bind_feature(kFingerPrint, nullptr);
}
int Init_lib_Interface_SimSd(const char *tag) {
    return bind_feature(kSimSd, tag);
}
int Init_lib_Interface_Nfc(void) {
    return bind_feature(kNfc, nullptr);
}
int Init_lib_sar_Interface(void) {
    return bind_feature(kSar, nullptr);
}
int Init_lib_SmartPACAL_Interface(void) {
    return bind_feature(kSmartPa, nullptr);
}
int Init_Hifi_Interface(void) {
    return bind_feature(kHifi, nullptr);
}
int Init_lib_TPSelf_Interface(void) {
    return bind_feature(kTpSelf, nullptr);
}
int Init_lib_HardVersion_Interface(void) {
    return bind_feature(kHardVersion, nullptr);
}
int Init_lib_Battery_Interface(void) {
    return bind_feature(kBatteryTest, nullptr);
}
int Init_lib_Camera_Interface(void) {
    return bind_feature(kCamera, nullptr);
}
int Init_lib_AgingTest_Interface(void) {
    return bind_feature(kAging, nullptr);
}
int Init_lib_Interface_all(void) {
    return bind_feature(kPcba, nullptr);
}

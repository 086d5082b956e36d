// Run-time binding of the handset libraries: the factory library (lib_factory.so) and the
// core-device library (libdvk_ncoredevice.so). Every operation is a process-wide pointer in
// namespace hw, named after its symbol and null until bound; call it as a function
// (hw::ftx_api_Vibrator_Test_Start(-1)) and test optional ones first (if (hw::X) ...).
// The prototypes live in the hw/ headers only: the pointers take their types from them.
#pragma once

#include <atomic>

#include "hw/lib_factory.h"
#include "hw/libdvk_ncoredevice.h"

// Every factory operation the application may bind.
#define FTX_FACTORY_OPS(X)                                      \
    X(ftx_api_LCD_Get_Info)                                     \
    X(ftx_api_LCD_Off)                                          \
    X(ftx_api_LCD_Refresh)                                      \
    X(ftx_api_ftx_mode_init)                                    \
    X(ftx_api_ftx_mode_uninit)                                  \
    X(ftx_api_Get_TestInfo)                                     \
    X(ftx_api_Get_TestInfo_Stop)                                \
    X(ftx_api_ReadFuncTestInfoFlags)                            \
    X(ftx_api_WriteFuncTestInfoFlags)                           \
    X(ftx_api_GetSoftVersion)                                   \
    X(ftx_api_GetHardVersion)                                   \
    X(ftx_api_GetPSN)                                           \
    X(ftx_api_GetTestInfoFlag)                                  \
    X(ftx_api_GetBoardNum)                                      \
    X(ftx_api_GetFlashType)                                     \
    X(ftx_api_camera_test_start)                                \
    X(ftx_api_camera_start_capture)                             \
    X(ftx_api_camera_do_autofocus)                              \
    X(ftx_api_camera_test_stop)                                 \
    X(ftx_api_camera_get_preview)                               \
    X(ftx_api_Vibrator_Test_Start)                              \
    X(ftx_api_Vibrator_Test_Stop)                               \
    X(ftx_api_AllCard_Test_Start)                               \
    X(ftx_api_AllCard_Test_Stop)                                \
    X(ftx_api_Sensors_Test_Start)                               \
    X(ftx_api_Sensors_Test_Stop)                                \
    X(ftx_api_Sensors_Calibration)                              \
    X(ftx_api_Audio_RingTest_Start)                             \
    X(ftx_api_Audio_RingTest_Stop)                              \
    X(ftx_api_Audio_HiFiTest_Start)                             \
    X(ftx_api_Audio_HiFiTest_Stop)                              \
    X(ftx_api_Audio_HiFiTest_auto_Start)                        \
    X(ftx_api_Audio_HiFiTest_auto_Stop)                         \
    X(ftx_api_Audio_Acoustic_Loopback_Test_Start)               \
    X(ftx_api_Audio_Acoustic_Loopback_Test_Stop)                \
    X(ftx_api_Audio_wakeupMic_on_Start)                         \
    X(ftx_api_Audio_wakeupMic_Stop)                             \
    X(ftx_api_Audio_Acoustic_Loopback_Auxiliary_MIC_Test_Start) \
    X(ftx_api_Audio_Acoustic_Loopback_Auxiliary_MIC_Test_Stop)  \
    X(ftx_api_Audio_Acoustic_Loopback_Speaker_Test_Start)       \
    X(ftx_api_Audio_Acoustic_Loopback_Two_Speaker_Test_Start)   \
    X(ftx_api_Audio_Acoustic_Loopback_Headset_Test_Start)       \
    X(ftx_api_Audio_Acoustic_Loopback_Headset_Test_Stop)        \
    X(ftx_api_GetHeadsetState)                                  \
    X(ftx_api_FM_Test_Start)                                    \
    X(ftx_api_FM_Test_Stop)                                     \
    X(ftx_api_FM_Set_Vol)                                       \
    X(ftx_api_FM_Get_Vol)                                       \
    X(ftx_api_Audio_Receiver_Start)                             \
    X(ftx_api_Audio_Receiver_Stop)                              \
    X(ftx_api_Audio_MainMicRecord_Start)                        \
    X(ftx_api_Audio_MainMicRecord_Play)                         \
    X(ftx_api_Audio_MainMicRecord_Stop)                         \
    X(ftx_api_USB_OTG_Test_START)                               \
    X(ftx_api_USB_OTG_Test_Stop)                                \
    X(ftx_api_SetSystemIdleStatus)                              \
    X(ftx_api_Audio_SetVolume)                                  \
    X(ftx_api_Audio_GetVolume)                                  \
    X(ftx_api_EnterLowCostMode)                                 \
    X(ftx_api_Audio_Loopback_Test_Start)                        \
    X(ftx_api_Audio_Loopback_Test_Stop)                         \
    X(ftx_api_HookKeyTest_Start)                                \
    X(ftx_api_HookKeyTest_Stop)                                 \
    X(ftx_api_FlashlightTest_Start)                             \
    X(ftx_api_FlashlightTest_Stop)                              \
    X(ftx_api_AlllightTest_Start)                               \
    X(ftx_api_AlllightTest_Stop)                                \
    X(ftx_api_KeyBacklightTest_Start)                           \
    X(ftx_api_KeyBacklightTest_Stop)                            \
    X(ftx_api_LEDColorTest_Start)                               \
    X(ftx_api_LEDColorTest_Stop)                                \
    X(ftx_api_Set_LCDBacklight)                                 \
    X(ftx_api_HallSensorTest_Start)                             \
    X(ftx_api_HallSensorTest_Stop)                              \
    X(ftx_api_Hall_2nd_test_start)                              \
    X(ftx_api_Hall_2nd_test_Stop)                               \
    X(ftx_api_Hall_2nd_calibrate)                               \
    X(ftx_api_force_touch_sensor_test_start)                    \
    X(ftx_api_force_touch_sensor_test_stop)                     \
    X(ftx_api_force_touch_sensor_button_down)                   \
    X(ftx_api_force_touch_sensor_button_up)                     \
    X(ftx_api_force_touch_calibration_start)                    \
    X(ftx_api_force_touch_calibration_stop)                     \
    X(ftx_api_force_touch_comprehension_start)                  \
    X(ftx_api_force_touch_comprehension_stop)                   \
    X(ftx_api_FingerPrintTest_Start)                            \
    X(ftx_api_FingerPrintTest_Stop)                             \
    X(ftx_api_SimCard_Test_Start)                               \
    X(ftx_api_SimCard_Test_Stop)                                \
    X(ftx_api_SDCard_Test_Start)                                \
    X(ftx_api_SDCard_Test_Stop)                                 \
    X(ftx_api_SDCard_Get_Size)                                  \
    X(ftx_api_NFC_Start)                                        \
    X(ftx_api_NFC_Stop)                                         \
    X(ftx_api_sar_start)                                        \
    X(ftx_api_sar_stop)                                         \
    X(ftx_api_SmartPACalibrate_Start)                           \
    X(ftx_api_SmartPACalibrate_Stop)                            \
    X(ftx_api_Get_HeadSetStatus)                                \
    X(ftx_api_tpd_SelfTest_Start)                               \
    X(ftx_api_tpd_SelfTest_Stop)                                \
    X(ftx_api_GetFireWare)                                      \
    X(ftx_api_Battery_Test)                                     \
    X(ftx_api_RegisterModuleCallback)                           \
    X(ftx_api_GetModuleStatus)                                  \
    X(ftx_api_BTDevDetect)                                      \
    X(ftx_api_FMDevDetect)                                      \
    X(ftx_api_WifiDevDetect)                                    \
    X(ftx_api_cameraID_test)                                    \
    X(ftx_api_cpu_start)                                        \
    X(ftx_api_cpu_stop)                                         \
    X(ftx_api_memory_start)                                     \
    X(ftx_api_memory_stop)                                      \
    X(ftx_api_bluetooth_start)                                  \
    X(ftx_api_bluetooth_stop)                                   \
    X(ftx_api_battery_start)                                    \
    X(ftx_api_battery_stop)                                     \
    X(ftx_api_wifi_start)                                       \
    X(ftx_api_wifi_stop)                                        \
    X(ftx_api_gps_start)                                        \
    X(ftx_api_gps_stop)                                         \
    X(ftx_api_storage_start)                                    \
    X(ftx_api_storage_stop)                                     \
    X(ftx_api_sdcard_start)                                     \
    X(ftx_api_sdcard_stop)                                      \
    X(ftx_api_sim_start)                                        \
    X(ftx_api_sim_stop)                                         \
    X(ftx_api_touch_start)                                      \
    X(ftx_api_touch_stop)                                       \
    X(ftx_api_wgb_start)                                        \
    X(ftx_api_fm_start)                                         \
    X(ftx_api_fm_stop)                                          \
    X(ftx_api_mic2earpiece_start)                               \
    X(ftx_api_mic2earpiece_stop)                                \
    X(ftx_api_auxmic2earpiece_start)                            \
    X(ftx_api_auxmic2earpiece_stop)

// Every core-device operation: the battery service, then the command channel's nine.
#define FTX_COREDEVICE_OPS(X)                     \
    X(FTX_API_BatteryService_register_Observer)   \
    X(FTX_API_BatteryService_unregister_Observer) \
    X(FTX_API_BatteryService_StartService)        \
    X(FTX_API_BatteryService_StopService)         \
    X(FTX_API_BatteryService_ChargingStatusSet)   \
    X(registerAtSocket)                           \
    X(UnregisterAtSocket)                         \
    X(registerCommandProcess)                     \
    X(runSelectLoopMode)                          \
    X(mmi_AutoTest_FileOpt_Read)                  \
    X(mmi_AutoTest_FileOpt_Write)                 \
    X(mmi_AutoTest_FileOpt_Remove)                \
    X(mmi_AutoTest_WiFiConCpt_Enable)             \
    X(mmi_AutoTest_WiFiConCpt_Disable)

// The address a binding holds; shared by every thread, so kept atomic.
struct ftx_hw_slot {
    std::atomic<void *> addr{nullptr};
    void *get() const { return addr.load(std::memory_order_acquire); }
    void set(void *p) { addr.store(p, std::memory_order_release); }
};

// One operation pointer of type F (a pointer to function). It converts to F, so it is
// called and tested like a plain function pointer; tests may assign their own functions.
template <typename F>
struct ftx_hw_op : ftx_hw_slot {
    operator F() const { return reinterpret_cast<F>(get()); }
    ftx_hw_op &operator=(F f) {
        set(reinterpret_cast<void *>(f));
        return *this;
    }
};

namespace hw {
#define FTX_HW_DECLARE_OP(name) extern ftx_hw_op<decltype(&::name)> name;
FTX_FACTORY_OPS(FTX_HW_DECLARE_OP)
FTX_COREDEVICE_OPS(FTX_HW_DECLARE_OP)
#undef FTX_HW_DECLARE_OP
}  // namespace hw

// Library handles, opened once by the start-up binders and never closed.
extern std::atomic<void *> lib_dvk_factory;
extern std::atomic<void *> g_libcoredevice;

// How a missing symbol is treated.
enum ftx_bind_kind {
    FTX_BIND_REQUIRED,           // logged; binding stops, later symbols stay unbound, result -1
    FTX_BIND_OPTIONAL,           // logged; the fallback (or null) goes in and binding goes on
    FTX_BIND_SILENT,             // left null without a word; binding goes on
    FTX_BIND_IF_UNSET,           // as SILENT, and looked up only while its pointer is still null
    FTX_BIND_REQUIRED_IF_UNSET,  // as REQUIRED, and looked up only while still null
};

// One row of a binding table.
struct ftx_sym_binding {
    const char *name;       // symbol looked up
    ftx_hw_slot *slot;      // pointer it fills
    int kind;               // ftx_bind_kind
    void *fallback;         // stand-by of an optional symbol, or null
    const char *shownName;  // name in the failure line when the program words it otherwise
    // Where a stand-by handed in by a higher layer is kept (it wins over fallback), or null.
    const ftx_hw_slot *handed = nullptr;
};

// Stand-bys of the optional result-flag operations: the application's own copies of the
// flags, handed in by the result record before the factory library is bound.
struct ftx_binding_fallbacks {
    decltype(&::ftx_api_ReadFuncTestInfoFlags) readFuncTestInfoFlags;
    decltype(&::ftx_api_WriteFuncTestInfoFlags) writeFuncTestInfoFlags;
};
void ftx_binding_set_fallbacks(const ftx_binding_fallbacks *fallbacks);

// A library a test window opens when it opens and closes when it closes (the coupling
// tests'): its operations in look-up order.
struct ftx_own_op {
    const char *name;
    ftx_hw_slot *slot;
};
// Opens file at once (RTLD_NOW) and fills each slot in order. Logs under tag "FATAL ERROR:
// could not dlopen FILE: TEXT", or at the first missing operation "FATAL ERROR: could not
// dlsym NAME" and closes the library again. 0, or -1.
int ftx_own_library_open(std::atomic<void *> *handle, const char *file, const char *tag,
                         const ftx_own_op *ops, int count);
// Empties the slots and closes the library; nothing when it is not open.
void ftx_own_library_close(std::atomic<void *> *handle, const ftx_own_op *ops, int count);

// Looks the rows up in order in handle, logging failures under tag as
// "FATAL ERROR: could not dlsym <libLabel>::<name>" and "error = <dlerror>,<binder>".
// 0 when every required row was bound, -1 at the first missing required one.
int ftx_bind_symbols(void *handle, const char *libLabel, const char *tag, const char *binder,
                     const ftx_sym_binding *rows, int count);

// Name and pointer of every operation, for tests and diagnostics; null-terminated.
struct ftx_hw_op_entry {
    const char *name;
    ftx_hw_slot *slot;
};
extern const ftx_hw_op_entry g_ftx_hw_ops[];
// The pointer of the operation named name, or null.
ftx_hw_slot *ftx_hw_find(const char *name);
// Unbinds every operation (tests); the handles stay as they are.
void ftx_hw_unbind_all(void);

// Stand-by of ftx_api_ftx_mode_uninit: does nothing.
int func_temp(void);

// Start-up binders (main thread, before any worker): 0, or -1 when a required symbol or
// the library is missing.
int ftx_init_lib_factory_dll(void);
int ftx_init_libdvk_ncoredevice_dll(void);
// Binds the command channel's nine operations from the opened core-device library.
int Get_libcoredevice_Interface(void);

// Per-feature binders, run each time a test is entered: 0, or -1 when the factory library
// is not open or one of the feature's symbols is missing (the test is then not run).
// The loopback and hook key binders log under the calling test's tag.
int load_lib_interface_loopback(const char *tag);
int load_lib_interface_hookkey(const char *tag);
int Init_lib_Flashlight_Interface(void);
int Init_lib_Alllight_Interface(void);
int Init_lib_KeyBacklight_Interface(void);
int Init_lib_LED_Interface(void);
int Init_lib_LCDBacklight_Interface(void);
int Init_lib_HallSensor_Interface(void);
int Init_lib_Hall2nd_Interface(void);
int init_force_touch_sensor_test_interface(void);
int init_force_touch_calibration_interface(void);
int Init_lib_FingerPrint_Interface(void);
int Init_lib_Interface_SimSd(const char *tag);  // "FTX_SIMCARD" or "FTX_SDCARD"
int Init_lib_Interface_Nfc(void);
int Init_lib_sar_Interface(void);
int Init_lib_SmartPACAL_Interface(void);
int Init_Hifi_Interface(void);
int Init_lib_TPSelf_Interface(void);
int Init_lib_HardVersion_Interface(void);
int Init_lib_Battery_Interface(void);
// The camera window's preview, left unbound without a word when the library lacks it (0 then
// too; -1 only without the library).
int Init_lib_Camera_Interface(void);
int Init_lib_AgingTest_Interface(void);
// The PCBA run's set: every symbol looked up unchecked; 0 whenever the library is open.
int Init_lib_Interface_all(void);

// lib_factory.so on the host: every ftx_api_ operation backed by the hardware model.
// Each call is recorded for "hw status"; answers can be forced with "hw set"; callbacks
// reach the application from this library's worker thread.
#include <stdio.h>
#include <stdlib.h>
#include <string.h>

#include <map>
#include <mutex>
#include <string>

#include "devfs.h"
#include "factory_model.h"
#include "flag_area.h"
#include "ftx_host.h"
#include "hw/lib_factory.h"
#include "sim_core.h"
#include "tp_os.h"

using ftxsim::call;
using ftxsim::model;

namespace {

// Copies an identity value of sim/device.ini into buf.
int identity(const char *op, const char *key, const char *def, char *buf, int size) {
    int rc = call(op, 0, "%d", size);
    if (buf == nullptr || size <= 0) return -1;
    ftx_device_ini_get("identity", key, buf, static_cast<size_t>(size), def);
    return rc;
}

// A start operation that reports through a callback: remembered for "hw send", and its
// automatic reply (if any) is delivered from the worker thread.
int start_cb(const char *op, ftx_api_module_cb cb, const char *extra = "", int def = 0) {
    int rc = call(op, def, "cb=%p%s", reinterpret_cast<void *>(cb), extra);
    model().remember(op, cb);
    if (rc == 0) model().auto_reply(op);
    return rc;
}

// A start or stop of a test the sensor area reports to by itself. The model listens before
// the start's report is posted, so that no change falls between them. A forced answer of
// non-zero starts and ends nothing.
int listen(const char *op, ftx_api_module_cb cb) {
    int rc = call(op, 0, "cb=%p", reinterpret_cast<void *>(cb));
    model().remember(op, cb);
    if (rc == 0) {
        model().sensor_listen(op, cb);
        model().auto_reply(op);
    }
    return rc;
}
int unlisten(const char *op) {
    int rc = call(op, 0);
    if (rc == 0) model().sensor_listen(op, nullptr);
    return rc;
}

// An audio operation: recorded with the model's answer (unless one is forced), then, when
// it succeeds, the route it starts or ends.
int sound(const char *op, int rc, int arg = 0, int out = 0) {
    if (rc == 0) model().audio_route(op, arg, out);
    return rc;
}

}  // namespace

#define SIM_PLAIN(name)         \
    extern "C" int name(void) { \
        return call(#name, 0);  \
    }
#define SIM_CB(name)                            \
    extern "C" int name(ftx_api_module_cb cb) { \
        return start_cb(#name, cb);             \
    }
#define SIM_INT(name, arg)                      \
    extern "C" int name(int arg) {              \
        return call(#name, 0, #arg "=%d", arg); \
    }
#define SIM_LISTEN(name)                        \
    extern "C" int name(ftx_api_module_cb cb) { \
        return listen(#name, cb);               \
    }
#define SIM_UNLISTEN(name)      \
    extern "C" int name(void) { \
        return unlisten(#name); \
    }
#define SIM_AUDIO(name)                                                      \
    extern "C" int name(void) {                                              \
        return sound(#name, call(#name, model().audio_answer(#name, 0, 0))); \
    }
#define SIM_AUDIO_INT(name, arg)                                                               \
    extern "C" int name(int arg) {                                                             \
        return sound(#name, call(#name, model().audio_answer(#name, arg, 0), #arg "=%d", arg), \
                     arg);                                                                     \
    }
#define SIM_AUDIO_CB(name)                        \
    extern "C" int name(ftx_api_module_cb cb) {   \
        return sound(#name, start_cb(#name, cb)); \
    }

// ---- start-up set ----
extern "C" int ftx_api_LCD_Get_Info(int *width, int *height, int *bpp) {
    int rc = call("ftx_api_LCD_Get_Info", 0);
    tp_man_lcd_get_info_only();
    if (width != nullptr) *width = g_ptScreenInfo.width;
    if (height != nullptr) *height = g_ptScreenInfo.height;
    if (bpp != nullptr) *bpp = g_ptScreenInfo.bpp;
    return rc;
}
extern "C" int ftx_api_LCD_Off(void) {
    int rc = call("ftx_api_LCD_Off", 0);
    if (rc == 0) model().set_lcd(false);
    return rc;
}
extern "C" int ftx_api_LCD_Refresh(int arg) {
    int rc = call("ftx_api_LCD_Refresh", 0, "arg=%d", arg);
    if (rc == 0) model().set_lcd(true);
    return rc;
}
extern "C" int ftx_api_ftx_mode_init(int mode) {
    // The library starts here: a write cut short by a kill in an earlier run left its
    // temporary behind.
    ftxsim::flags_clear_stale();
    return call("ftx_api_ftx_mode_init", 0, "mode=%d", mode);
}
SIM_PLAIN(ftx_api_ftx_mode_uninit)

extern "C" int ftx_api_Get_TestInfo(ftx_api_module_cb cb) {
    int rc = call("ftx_api_Get_TestInfo", 0, "cb=%p", reinterpret_cast<void *>(cb));
    model().remember("ftx_api_Get_TestInfo", cb);
    if (rc == 0) model().send_testinfo(cb);
    return rc;
}
SIM_PLAIN(ftx_api_Get_TestInfo_Stop)

extern "C" int ftx_api_ReadFuncTestInfoFlags(int index, unsigned char *value) {
    int rc = call("ftx_api_ReadFuncTestInfoFlags", 0, "%d", index);
    if (index < 0 || index >= FTX_TESTINFO_FLAGS_SIZE || value == nullptr) return -1;
    unsigned char flags[FTX_TESTINFO_FLAGS_SIZE];
    ftxsim::flags_load(flags);
    *value = flags[index];
    return rc;
}

extern "C" int ftx_api_WriteFuncTestInfoFlags(int index, unsigned char value) {
    int rc = call("ftx_api_WriteFuncTestInfoFlags", 0, "%d,0x%02x", index, value);
    if (rc != 0) return rc;  // a forced failure stores nothing
    return ftxsim::flags_write_byte(index, value);
}

extern "C" int ftx_api_GetSoftVersion(int kind, char *buf, int size) {
    bool external = kind == FTX_SOFTVERSION_EXTERNAL;
    return identity("ftx_api_GetSoftVersion", external ? "sw_external" : "sw_internal",
                    external ? "FTX_EXT_V1.0" : "FTX_INT_V1.0", buf, size);
}
extern "C" int ftx_api_GetHardVersion(char *buf, int size) {
    return identity("ftx_api_GetHardVersion", "hw_version", "HW_V1.0", buf, size);
}
extern "C" int ftx_api_GetPSN(char *buf, int size) {
    return identity("ftx_api_GetPSN", "psn", "PSN0000000001", buf, size);
}
extern "C" int ftx_api_GetBoardNum(char *buf, int size) {
    return identity("ftx_api_GetBoardNum", "barcode", "BC0000000001", buf, size);
}
extern "C" int ftx_api_GetFlashType(char *buf, int size) {
    return identity("ftx_api_GetFlashType", "flash_type", "eMMC", buf, size);
}

extern "C" int ftx_api_GetTestInfoFlag(unsigned char *flags) {
    int rc = call("ftx_api_GetTestInfoFlag", 0);
    if (flags == nullptr) return -1;
    ftxsim::flags_load(flags);
    return rc;
}

// The cameras: a forced answer of non-zero starts, captures and stops nothing.
extern "C" int ftx_api_camera_test_start(int camera) {
    int rc = call("ftx_api_camera_test_start", model().camera_ok(camera) ? 0 : -1, "%d", camera);
    return rc == 0 ? model().camera_start(camera, true) : rc;
}
extern "C" int ftx_api_camera_start_capture(int camera, const char *path) {
    int rc = call("ftx_api_camera_start_capture", model().camera_ok(camera) ? 0 : -1, "%d,%s",
                  camera, path != nullptr ? path : "(null)");
    return rc == 0 ? model().camera_capture(camera, path) : rc;
}
extern "C" int ftx_api_camera_get_preview(int camera, unsigned int *argb, int width, int height) {
    // Not recorded: the preview asks for a frame several times a second.
    return model().camera_frame(camera, argb, width, height);
}
SIM_INT(ftx_api_camera_do_autofocus, camera)
extern "C" int ftx_api_camera_test_stop(int camera) {
    int rc = call("ftx_api_camera_test_stop", 0, "camera=%d", camera);
    return rc == 0 ? model().camera_start(camera, false) : rc;
}
SIM_INT(ftx_api_Vibrator_Test_Start, ms)
SIM_PLAIN(ftx_api_Vibrator_Test_Stop)
SIM_CB(ftx_api_AllCard_Test_Start)
SIM_PLAIN(ftx_api_AllCard_Test_Stop)
SIM_LISTEN(ftx_api_Sensors_Test_Start)
SIM_UNLISTEN(ftx_api_Sensors_Test_Stop)
extern "C" int ftx_api_Sensors_Calibration(int sensor, char *offsets, int size) {
    int rc = call("ftx_api_Sensors_Calibration", model().sensor_answer(sensor), "sensor=%d,size=%d",
                  sensor, size);
    if (rc == 0) {
        model().calibrate_sensor(sensor, offsets, size > 0 ? static_cast<size_t>(size) : 0);
    } else if (offsets != nullptr && size > 0) {
        offsets[0] = '\0';  // a failure changes no offsets
    }
    return rc;
}
SIM_AUDIO_INT(ftx_api_Audio_RingTest_Start, ring_type)
SIM_AUDIO_INT(ftx_api_Audio_RingTest_Stop, arg)
SIM_AUDIO(ftx_api_Audio_HiFiTest_Start)
SIM_AUDIO(ftx_api_Audio_HiFiTest_Stop)
extern "C" int ftx_api_Audio_HiFiTest_auto_Start(const char *parm) {
    const char *op = "ftx_api_Audio_HiFiTest_auto_Start";
    return sound(op, call(op, model().audio_answer(op, 0, 0), "%s", parm != nullptr ? parm : ""));
}
SIM_AUDIO(ftx_api_Audio_HiFiTest_auto_Stop)
SIM_AUDIO_CB(ftx_api_Audio_Acoustic_Loopback_Test_Start)
SIM_AUDIO(ftx_api_Audio_Acoustic_Loopback_Test_Stop)
SIM_AUDIO_CB(ftx_api_Audio_wakeupMic_on_Start)
SIM_AUDIO(ftx_api_Audio_wakeupMic_Stop)
SIM_AUDIO_CB(ftx_api_Audio_Acoustic_Loopback_Auxiliary_MIC_Test_Start)
SIM_AUDIO(ftx_api_Audio_Acoustic_Loopback_Auxiliary_MIC_Test_Stop)
SIM_AUDIO_CB(ftx_api_Audio_Acoustic_Loopback_Speaker_Test_Start)
SIM_AUDIO_CB(ftx_api_Audio_Acoustic_Loopback_Two_Speaker_Test_Start)
SIM_AUDIO_CB(ftx_api_Audio_Acoustic_Loopback_Headset_Test_Start)
SIM_AUDIO(ftx_api_Audio_Acoustic_Loopback_Headset_Test_Stop)
extern "C" int ftx_api_GetHeadsetState(void) {
    return call("ftx_api_GetHeadsetState", model().headset());
}
SIM_AUDIO_INT(ftx_api_FM_Test_Start, frequency)
SIM_AUDIO(ftx_api_FM_Test_Stop)
extern "C" int ftx_api_FM_Set_Vol(int volume) {
    int rc = call("ftx_api_FM_Set_Vol", 0, "%d", volume);
    if (rc == 0) ftxsim::put_value("fm.volume", volume);
    return rc;
}
extern "C" int ftx_api_FM_Get_Vol(void) {
    return call("ftx_api_FM_Get_Vol", static_cast<int>(ftxsim::get_value("fm.volume", 8)));
}
SIM_AUDIO_INT(ftx_api_Audio_Receiver_Start, ring_type)
SIM_AUDIO(ftx_api_Audio_Receiver_Stop)
SIM_AUDIO_INT(ftx_api_Audio_MainMicRecord_Start, seconds)
SIM_AUDIO(ftx_api_Audio_MainMicRecord_Play)
SIM_AUDIO(ftx_api_Audio_MainMicRecord_Stop)
SIM_CB(ftx_api_USB_OTG_Test_START)
SIM_PLAIN(ftx_api_USB_OTG_Test_Stop)
SIM_INT(ftx_api_SetSystemIdleStatus, idle)

extern "C" int ftx_api_Audio_SetVolume(int microphone, int output, int level) {
    int rc = call("ftx_api_Audio_SetVolume", 0, "%d,%d,%d", microphone, output, level);
    if (rc == 0) model().set_volume(microphone, output, level);
    return rc;
}
extern "C" int ftx_api_Audio_GetVolume(int microphone, int output) {
    return call("ftx_api_Audio_GetVolume", model().volume(microphone, output), "%d,%d", microphone,
                output);
}
SIM_PLAIN(ftx_api_EnterLowCostMode)

// ---- per-feature sets ----
extern "C" int ftx_api_Audio_Loopback_Test_Start(int microphone, int output, const char *parm,
                                                 ftx_api_module_cb cb) {
    const char *op = "ftx_api_Audio_Loopback_Test_Start";
    int rc = call(op, model().audio_answer(op, microphone, output), "%d,%d,%s,cb=%p", microphone,
                  output, parm != nullptr ? parm : "", reinterpret_cast<void *>(cb));
    model().remember(op, cb);
    if (sound(op, rc, microphone, output) == 0) model().send_headset();
    return rc;
}
extern "C" int ftx_api_Audio_Loopback_Test_Stop(int microphone, int output) {
    const char *op = "ftx_api_Audio_Loopback_Test_Stop";
    model().remember("ftx_api_Audio_Loopback_Test_Start", nullptr);
    return sound(op, call(op, 0, "%d,%d", microphone, output), microphone, output);
}
extern "C" int ftx_api_HookKeyTest_Start(ftx_api_hookkey_cb cb) {
    model().set_hook_cb(cb);
    return call("ftx_api_HookKeyTest_Start", 0, "cb=%p", reinterpret_cast<void *>(cb));
}
extern "C" int ftx_api_HookKeyTest_Stop(char *reply, unsigned int size) {
    int presses = model().set_hook_cb(nullptr);
    if (reply != nullptr && size > 0) snprintf(reply, size, "*%d", presses);
    return call("ftx_api_HookKeyTest_Stop", 0, "%u", size);
}
// The lights: a forced answer of non-zero switches nothing.
extern "C" int ftx_api_FlashlightTest_Start(int flashlight) {
    int known = flashlight >= FTX_FLASHLIGHT_BACK && flashlight <= FTX_FLASHLIGHT_BACK2 ? 0 : -1;
    int rc = call("ftx_api_FlashlightTest_Start", known, "flashlight=%d", flashlight);
    return rc == 0 ? model().set_flashlight(flashlight, true) : rc;
}
extern "C" int ftx_api_FlashlightTest_Stop(int flashlight) {
    int known = flashlight >= FTX_FLASHLIGHT_BACK && flashlight <= FTX_FLASHLIGHT_BACK2 ? 0 : -1;
    int rc = call("ftx_api_FlashlightTest_Stop", known, "flashlight=%d", flashlight);
    return rc == 0 ? model().set_flashlight(flashlight, false) : rc;
}
#define SIM_LIGHT(name, action)      \
    extern "C" int name(void) {      \
        int rc = call(#name, 0);     \
        if (rc == 0) model().action; \
        return rc;                   \
    }
SIM_LIGHT(ftx_api_AlllightTest_Start, set_all_lights(true))
SIM_LIGHT(ftx_api_AlllightTest_Stop, set_all_lights(false))
SIM_LIGHT(ftx_api_KeyBacklightTest_Start, set_key_backlight(true))
SIM_LIGHT(ftx_api_KeyBacklightTest_Stop, set_key_backlight(false))
SIM_LIGHT(ftx_api_LEDColorTest_Stop, set_led(nullptr))
extern "C" int ftx_api_LEDColorTest_Start(const char *color) {
    bool known = color != nullptr && (strcmp(color, "red") == 0 || strcmp(color, "green") == 0 ||
                                      strcmp(color, "orange") == 0);
    int rc = call("ftx_api_LEDColorTest_Start", known ? 0 : -1, "%s", color ? color : "(null)");
    return rc == 0 ? model().set_led(color) : rc;
}
extern "C" int ftx_api_Set_LCDBacklight(unsigned int level) {
    int rc = call("ftx_api_Set_LCDBacklight", 0, "%u", level);
    if (rc == 0) model().set_backlight(level);
    return rc;
}
SIM_LISTEN(ftx_api_HallSensorTest_Start)
SIM_UNLISTEN(ftx_api_HallSensorTest_Stop)
SIM_LISTEN(ftx_api_Hall_2nd_test_start)
SIM_UNLISTEN(ftx_api_Hall_2nd_test_Stop)
SIM_PLAIN(ftx_api_Hall_2nd_calibrate)
SIM_LISTEN(ftx_api_force_touch_sensor_test_start)
SIM_UNLISTEN(ftx_api_force_touch_sensor_test_stop)
extern "C" int ftx_api_force_touch_sensor_button_down(void) {
    return call("ftx_api_force_touch_sensor_button_down", model().force());
}
extern "C" int ftx_api_force_touch_sensor_button_up(void) {
    return call("ftx_api_force_touch_sensor_button_up", 0);
}
extern "C" int ftx_api_force_touch_calibration_start(const char *parm, ftx_api_module_cb cb) {
    std::string extra = std::string(",") + (parm != nullptr ? parm : "");
    return start_cb("ftx_api_force_touch_calibration_start", cb, extra.c_str(),
                    model().force_weight(parm));
}
SIM_PLAIN(ftx_api_force_touch_calibration_stop)
SIM_CB(ftx_api_force_touch_comprehension_start)
SIM_PLAIN(ftx_api_force_touch_comprehension_stop)
SIM_CB(ftx_api_FingerPrintTest_Start)
SIM_PLAIN(ftx_api_FingerPrintTest_Stop)
extern "C" int ftx_api_SimCard_Test_Start(int slot) {
    return call("ftx_api_SimCard_Test_Start", model().sim_present(slot), "%d", slot);
}
SIM_PLAIN(ftx_api_SimCard_Test_Stop)
extern "C" int ftx_api_SDCard_Test_Start(int slot) {
    return call("ftx_api_SDCard_Test_Start", model().sd_present(slot), "%d", slot);
}
SIM_PLAIN(ftx_api_SDCard_Test_Stop)
extern "C" int ftx_api_SDCard_Get_Size(int slot) {
    return call("ftx_api_SDCard_Get_Size", model().sd_size(slot), "%d", slot);
}
SIM_CB(ftx_api_NFC_Start)
SIM_PLAIN(ftx_api_NFC_Stop)
SIM_LISTEN(ftx_api_sar_start)
SIM_UNLISTEN(ftx_api_sar_stop)
SIM_CB(ftx_api_SmartPACalibrate_Start)
SIM_PLAIN(ftx_api_SmartPACalibrate_Stop)
extern "C" int ftx_api_Get_HeadSetStatus(void) {
    return call("ftx_api_Get_HeadSetStatus", model().headset());
}
extern "C" int ftx_api_tpd_SelfTest_Start(ftx_api_module_cb cb) {
    int rc = call("ftx_api_tpd_SelfTest_Start", 0, "cb=%p", reinterpret_cast<void *>(cb));
    model().remember("ftx_api_tpd_SelfTest_Start", cb);
    if (rc == 0) model().send_tp_verdict(cb);
    return rc;
}
SIM_PLAIN(ftx_api_tpd_SelfTest_Stop)
extern "C" int ftx_api_GetFireWare(char *buf) {
    int rc = call("ftx_api_GetFireWare", 0);
    if (buf == nullptr) return -1;
    model().firmware(buf, FTX_FIRMWARE_TEXT_SIZE);
    return rc;
}
extern "C" int ftx_api_Battery_Test(char *buf, int size) {
    int rc = call("ftx_api_Battery_Test", 0, "%d", size);
    if (buf == nullptr || size <= 0) return -1;
    snprintf(buf, static_cast<size_t>(size),
             "level=%ld;voltage=%ld;temperature=%ld;status=%ld;health=%ld",
             ftxsim::get_value("battery.level", 80), ftxsim::get_value("battery.voltage", 3900),
             ftxsim::get_value("battery.temperature", 250), ftxsim::get_value("battery.status", 3),
             ftxsim::get_value("battery.health", 2));
    return rc;
}

// ---- touch-panel status ----
extern "C" int ftx_api_RegisterModuleCallback(const char *module, ftx_api_module_cb cb) {
    int rc = call("ftx_api_RegisterModuleCallback", 0, "%s,cb=%p", module ? module : "(null)",
                  reinterpret_cast<void *>(cb));
    if (module == nullptr) return -1;
    model().remember((std::string("module:") + module).c_str(), cb);
    return rc;
}
extern "C" int ftx_api_GetModuleStatus(const char *module) {
    int rc = call("ftx_api_GetModuleStatus", 0, "%s", module ? module : "(null)");
    if (module == nullptr) return -1;
    if (rc == 0) model().send_module_status(module);
    return rc;
}

// ---- aging set ----
extern "C" int ftx_api_BTDevDetect(void) {
    return call("ftx_api_BTDevDetect", model().detect("bt"));
}
extern "C" int ftx_api_FMDevDetect(void) {
    return call("ftx_api_FMDevDetect", model().detect("fm"));
}
extern "C" int ftx_api_WifiDevDetect(void) {
    return call("ftx_api_WifiDevDetect", model().detect("wifi"));
}
extern "C" int ftx_api_cameraID_test(int id) {
    return call("ftx_api_cameraID_test", model().camera_ok(id) ? 0 : -1, "%d", id);
}

// ---- PCBA set ----
SIM_CB(ftx_api_cpu_start)
SIM_PLAIN(ftx_api_cpu_stop)
SIM_CB(ftx_api_memory_start)
SIM_PLAIN(ftx_api_memory_stop)
SIM_CB(ftx_api_bluetooth_start)
SIM_PLAIN(ftx_api_bluetooth_stop)
SIM_CB(ftx_api_battery_start)
SIM_PLAIN(ftx_api_battery_stop)
SIM_CB(ftx_api_wifi_start)
SIM_PLAIN(ftx_api_wifi_stop)
SIM_CB(ftx_api_gps_start)
SIM_PLAIN(ftx_api_gps_stop)
SIM_CB(ftx_api_storage_start)
SIM_PLAIN(ftx_api_storage_stop)
SIM_CB(ftx_api_sdcard_start)
SIM_PLAIN(ftx_api_sdcard_stop)
SIM_CB(ftx_api_sim_start)
SIM_PLAIN(ftx_api_sim_stop)
SIM_CB(ftx_api_touch_start)
SIM_PLAIN(ftx_api_touch_stop)
extern "C" int ftx_api_wgb_start(int group, int on) {
    return call("ftx_api_wgb_start", 1, "%d,%d", group, on);
}
SIM_CB(ftx_api_fm_start)
SIM_PLAIN(ftx_api_fm_stop)
SIM_AUDIO(ftx_api_mic2earpiece_start)
SIM_AUDIO(ftx_api_mic2earpiece_stop)
SIM_AUDIO(ftx_api_auxmic2earpiece_start)
SIM_AUDIO(ftx_api_auxmic2earpiece_stop)

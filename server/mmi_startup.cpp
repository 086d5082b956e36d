// Start-up helpers shared with the aging test, the power-off entry, and the wiring of
// power management to the bound library.
#include <android/log.h>
#include <devfs.h>
#include <stdio.h>
#include <tp_os.h>
#include <unistd.h>

#include "core/ftx_lib_binding.h"
#include "hub/mmi_mainwnd.h"
#include "core/mmi_power.h"
#include "core/mmi_settings.h"

namespace {

// The bound operations are looked up at call time: binding happens after start-up wiring.
int bound_mode_uninit(void) {
    return hw::ftx_api_ftx_mode_uninit ? hw::ftx_api_ftx_mode_uninit() : 0;
}
int bound_vibrator_start(int ms) {
    return hw::ftx_api_Vibrator_Test_Start ? hw::ftx_api_Vibrator_Test_Start(ms) : 0;
}
int bound_lcd_refresh(int arg) {
    return hw::ftx_api_LCD_Refresh ? hw::ftx_api_LCD_Refresh(arg) : 0;
}
int bound_unregister(int kind, FTX_BatteryObserver_cb cb) {
    return hw::FTX_API_BatteryService_unregister_Observer
               ? hw::FTX_API_BatteryService_unregister_Observer(kind, cb)
               : -1;
}

}  // namespace

int Check_AgingCfg_Exist(void) {
    // Joined into 256 bytes: a longer path is cut at 255 characters.
    char path[256];
    size_t n = tp_os_strlcpy(path, g_chLogPath, sizeof path);
    tp_os_strlcpy(path + n, "rebootAging.txt", sizeof path - n);
    return dev_access(path, R_OK) == 0 ? 1 : 0;
}

int mmi_PowerOffEntry(void) {
    __android_log_print(ANDROID_LOG_DEBUG, "FTX_MAIN", "%s begin", "mmi_PowerOffEntry");
    if (hw::ftx_api_ftx_mode_uninit) hw::ftx_api_ftx_mode_uninit();
    dev_sync();
    dev_reboot(LINUX_REBOOT_CMD_POWER_OFF);
    return 1;
}

void mmi_power_use_bound_library(void) {
    g_powerOps.mode_uninit = bound_mode_uninit;
    g_powerOps.vibrator_start = bound_vibrator_start;
    g_powerOps.lcd_refresh = bound_lcd_refresh;
    g_powerOps.unregister_observer = bound_unregister;
    g_powerOps.title_show = TitleInfoShow;
}

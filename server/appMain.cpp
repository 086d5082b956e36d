// The process: binds the handset libraries, reads the settings, starts the battery
// service and the PC channel, then runs the factory application or, in the factory boot
// mode, only the power-off note.
#include <android/log.h>
#include <cutils/properties.h>
#include <minigui/common.h>
#include <minigui/minigui.h>
#include <string.h>
#include <tp_os.h>
#include <unistd.h>

#include "adbd_connection/AtThread.h"
#include "core/ftx_lib_binding.h"
#include "ftx_log.h"
#include "core/mmi_autotest_config.h"
#include "mmi_iconlet.h"
#include "hub/mmi_mainwnd.h"
#include "mmi_startup.h"
#include "core/mmi_power.h"
#include "core/mmi_settings.h"

#define TAG "DVK_FTX"
#define LOGD(...) __android_log_print(ANDROID_LOG_DEBUG, TAG, __VA_ARGS__)
#define LOGE(...) __android_log_print(ANDROID_LOG_ERROR, TAG, __VA_ARGS__)

int main(int argc, char **argv) {
    tp_os_thread_init(argc, argv);
    mmi_startup_wire();
    LOGD("%s begin", "main");
    if (ftx_init_lib_factory_dll() != 0) {
        LOGE("ftx_init_lib_factory_dll fail! %s", "main");
        return -1;
    }
    if (tp_man_lcd_get_info_only() != 0) LOGE("tp_man_lcd_get_info_only fail! %s", "main");
    hw::ftx_api_ftx_mode_init(0);
    InitGUI(argc, (const char **)argv);
    LOGD("%s InitGUI end", "main");
    RegisterIconLetCtrl();
    // Nothing rewrites the configuration yet: a temporary there was cut short by a kill.
    mmi_config_clear_stale_temporary();
    mmi_initconfig();
    if (ftx_init_libdvk_ncoredevice_dll() != 0) {
        LOGE("FATAL ERROR:ftx_init_libdvk_ncoredevice_dll fail! %s", "main");
        return -1;
    }
    mmi_power_use_bound_library();
    auto startService =
        (decltype(&::FTX_API_BatteryService_StartService))hw::FTX_API_BatteryService_StartService;
    LOGD("FTX_API_BatteryService_StartService begin =%d", (int)(long)startService);
    if (startService) {
        int r = startService();
        if (r == 0)
            LOGD("Start Battery Service successed");
        else
            LOGD("Start Battery Service fail ,errno(%d)", r);
    }
    if (Check_AgingCfg_Exist() == 0) AtThreadStart();
    char bootmode[92];
    memset(bootmode, 0, sizeof bootmode);
    property_get("ro.bootmode", bootmode, "normal");
    if (strncmp(bootmode, "ffbm-99", 7) != 0) {
        ftx_initlog(g_chLogPath);
        kmt_CreateMainMenuWnd();
        tp_os_sema_get(0, TP_OS_WAIT_FOREVER);
        return 0;
    }
    kmt_CreateMainMenuWnd1();
    LOGE("MMI app can only be run in ffbm mode");
    for (;;)
        usleep(1000000000);
}

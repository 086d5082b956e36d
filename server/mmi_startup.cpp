// Start-up wiring of the layers, and of power management to the bound library.
#include "mmi_startup.h"

#include "core/ftx_lib_binding.h"
#include "core/mmi_power.h"
#include "core/mmi_settings.h"
#include "hub/mmi_titlestrip.h"
#include "screens/mmi_devicetest.h"
#include "session/mmi_autotest.h"
#include "session/mmi_monomer.h"
#include "session/mmi_testinfo.h"
#include "session/mmi_testitem.h"
#include "testwnd/catalogue.h"

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

void mmi_startup_wire(void) {
    mmi_testitem_use_catalogue(mmi_catalogue_tables());
    mmi_initconfig_set_list_builder(mmi_build_test_lists);
    mmi_testinfo_hand_binding_fallbacks();
    mmi_autotest_install_run();
    mmi_monomer_install_run();
    g_autotestOps.open_device_list = mmi_DeviceTestEntry;
    g_autotestOps.device_list_is_open = mmi_DeviceTest_IsOpen;
    g_autotestOps.refresh_device_list = mmi_DeviceTest_Refresh;
}

void mmi_power_use_bound_library(void) {
    g_powerOps.mode_uninit = bound_mode_uninit;
    g_powerOps.vibrator_start = bound_vibrator_start;
    g_powerOps.lcd_refresh = bound_lcd_refresh;
    g_powerOps.unregister_observer = bound_unregister;
    g_powerOps.title_show = TitleInfoShow;
}

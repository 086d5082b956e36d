// The binding tests' variant libraries lack exactly the symbols they are named for.
#include <dlfcn.h>
#include <stdlib.h>

#include <string>
#include <vector>

#include <gtest/gtest.h>

namespace {

struct Variant {
    const char *folder;  // under <build>/lib; "" for the full libraries
    const char *library;
    std::vector<const char *> missing;
    std::vector<const char *> present;
};

TEST(SimVariants, EachLacksOnlyItsSymbols) {
    const char *build = getenv("FTX_BUILD_DIR");
    ASSERT_NE(build, nullptr);
    const std::vector<Variant> variants = {
        {"",
         "lib_factory.so",
         {},
         {"ftx_api_camera_do_autofocus", "ftx_api_GetPSN", "ftx_sim_control"}},
        {"",
         "libdvk_ncoredevice.so",
         {},
         {"runSelectLoopMode", "FTX_API_BatteryService_unregister_Observer"}},
        {"", "lib_dvk_signalcoupling.so", {}, {"FTX_API_SignalCoupling_setModemMode"}},
        {"variants/no_autofocus/",
         "lib_factory.so",
         {"ftx_api_camera_do_autofocus"},
         {"ftx_api_camera_test_stop"}},
        {"variants/no_psn/",
         "lib_factory.so",
         {"ftx_api_GetPSN"},
         {"ftx_api_GetHardVersion", "ftx_api_GetTestInfoFlag"}},
        {"variants/no_writeflags/",
         "lib_factory.so",
         {"ftx_api_WriteFuncTestInfoFlags"},
         {"ftx_api_ReadFuncTestInfoFlags"}},
        {"variants/no_flashlight/",
         "lib_factory.so",
         {"ftx_api_FlashlightTest_Start", "ftx_api_FlashlightTest_Stop"},
         {"ftx_api_AlllightTest_Start"}},
        {"variants/no_battery_unregister/",
         "libdvk_ncoredevice.so",
         {"FTX_API_BatteryService_unregister_Observer"},
         {"FTX_API_BatteryService_register_Observer"}},
        {"variants/no_coupling_init/",
         "lib_dvk_signalcoupling.so",
         {"FTX_API_SignalCoupling_init"},
         {"FTX_API_SignalCoupling_uninit", "FTX_API_SignalCoupling_setModemMode"}},
        {"variants/no_coupling_uninit/",
         "lib_dvk_signalcoupling.so",
         {"FTX_API_SignalCoupling_uninit"},
         {"FTX_API_SignalCoupling_init", "FTX_API_SignalCoupling_setModemMode"}},
        {"variants/no_coupling_setmode/",
         "lib_dvk_signalcoupling.so",
         {"FTX_API_SignalCoupling_setModemMode"},
         {"FTX_API_SignalCoupling_init", "FTX_API_SignalCoupling_uninit"}},
        {"variants/no_nonsignal_getRxLevel/",
         "lib_dvk_nonsignal.so",
         {"FTX_API_NonSignal_getRxLevel"},
         {"FTX_API_NonSignal_open", "FTX_API_NonSignal_txOff", "ftx_sim_control"}},
        {"variants/no_nonsignal_txOff/",
         "lib_dvk_nonsignal.so",
         {"FTX_API_NonSignal_txOff"},
         {"FTX_API_NonSignal_txOn", "FTX_API_NonSignal_getRxLevel"}},
        {"variants/no_selectloop/",
         "libdvk_ncoredevice.so",
         {"runSelectLoopMode"},
         {"registerCommandProcess", "mmi_AutoTest_FileOpt_Read"}},
    };
    for (const Variant &v : variants) {
        std::string path = std::string(build) + "/lib/" + v.folder + v.library;
        void *h = dlopen(path.c_str(), RTLD_NOW | RTLD_LOCAL);
        ASSERT_NE(h, nullptr) << dlerror();
        for (const char *s : v.missing)
            EXPECT_EQ(dlsym(h, s), nullptr) << path << " " << s;
        for (const char *s : v.present)
            EXPECT_NE(dlsym(h, s), nullptr) << path << " " << s;
        // The model's own helpers stay private to the library.
        EXPECT_EQ(dlsym(h, "_ZN6ftxsim10flags_loadEPh"), nullptr) << path;
        dlclose(h);
    }
}

}  // namespace

// The binders against the simulated libraries and their variants that lack chosen
// symbols. Each case runs binding_probe in its own process, with the variant's folder
// first on the library path, since a process binds only once.
#include <stdio.h>
#include <stdlib.h>

#include <set>
#include <sstream>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "support/temp_root.h"

namespace {

struct Probe {
    std::vector<std::string> lines;
    std::set<std::string> bound, fallback;

    std::vector<std::string> with(const std::string &text) const {
        std::vector<std::string> out;
        for (const auto &l : lines)
            if (l.find(text) != std::string::npos) out.push_back(l);
        return out;
    }
    bool has(const std::string &line) const {
        for (const auto &l : lines)
            if (l == line) return true;
        return false;
    }
    std::string dump() const {
        std::string s;
        for (const auto &l : lines)
            s += l + "\n";
        return s;
    }
};

class Binding : public ::testing::Test {
  protected:
    // Runs the probe with the given variant folder ("" for the full libraries).
    Probe run(const std::string &variant, const std::string &steps) {
        std::string build = getenv("FTX_BUILD_DIR");
        std::string libs = build + "/lib";
        if (!variant.empty()) libs = build + "/lib/variants/" + variant + ":" + libs;
        std::string cmd = "LD_LIBRARY_PATH=" + libs + " FTX_PC_PORT=0 " + build +
                          "/tests/binding_probe " + steps + " 2>&1";
        Probe p;
        FILE *f = popen(cmd.c_str(), "r");
        EXPECT_NE(nullptr, f);
        if (f == nullptr) return p;
        char line[4096];
        while (fgets(line, sizeof(line), f) != nullptr) {
            std::string l(line);
            if (!l.empty() && l.back() == '\n') l.pop_back();
            p.lines.push_back(l);
            if (l.rfind("BOUND ", 0) == 0) p.bound.insert(l.substr(6));
            if (l.rfind("FALLBACK ", 0) == 0) p.fallback.insert(l.substr(9));
        }
        EXPECT_EQ(0, pclose(f)) << p.dump();
        return p;
    }
    TempRoot root;
};

const char kFactoryMiss[] = "LOG E DVK_FTX: FATAL ERROR: could not dlsym lib_factory.so::";

TEST_F(Binding, FullLibrariesBindEverything) {
    Probe p = run("", "factory core channel aging pcba");
    for (const char *step : {"factory", "core", "channel", "aging", "pcba"})
        EXPECT_TRUE(p.has(std::string("RET ") + step + " 0")) << step << "\n" << p.dump();
    EXPECT_TRUE(p.with("FATAL").empty()) << p.dump();
    EXPECT_TRUE(p.fallback.empty());
    for (const char *name :
         {"ftx_api_LCD_Get_Info", "ftx_api_EnterLowCostMode", "ftx_api_camera_do_autofocus",
          "FTX_API_BatteryService_ChargingStatusSet", "runSelectLoopMode",
          "mmi_AutoTest_WiFiConCpt_Disable", "ftx_api_wgb_start", "ftx_api_cameraID_test"})
        EXPECT_EQ(1u, p.bound.count(name)) << name;
    // Per-feature symbols wait for their test.
    EXPECT_EQ(0u, p.bound.count("ftx_api_FlashlightTest_Start"));
}

TEST_F(Binding, MissingOptionalSymbolIsOnlyLogged) {
    Probe p = run("no_autofocus", "factory");
    EXPECT_TRUE(p.has("RET factory 0")) << p.dump();
    std::vector<std::string> miss = p.with("FATAL ERROR");
    ASSERT_EQ(1u, miss.size()) << p.dump();
    EXPECT_EQ(std::string(kFactoryMiss) + "ftx_api_camera_do_autofocus", miss[0]);
    EXPECT_EQ(0u, p.bound.count("ftx_api_camera_do_autofocus"));
    EXPECT_EQ(1u, p.bound.count("ftx_api_camera_test_stop"));
    EXPECT_EQ(1u, p.bound.count("ftx_api_EnterLowCostMode"));
}

TEST_F(Binding, MissingRequiredSymbolStopsTheBinding) {
    Probe p = run("no_psn", "factory");
    EXPECT_TRUE(p.has("RET factory -1")) << p.dump();
    std::vector<std::string> miss = p.with("FATAL ERROR");
    ASSERT_EQ(1u, miss.size()) << p.dump();
    EXPECT_EQ(std::string(kFactoryMiss) + "ftx_api_GetPSN", miss[0]);
    std::vector<std::string> err = p.with("LOG E DVK_FTX: error = ");
    ASSERT_EQ(1u, err.size()) << p.dump();
    EXPECT_NE(std::string::npos, err[0].find(",ftx_init_lib_factory_dll"));
    EXPECT_EQ(1u, p.bound.count("ftx_api_GetHardVersion"));
    for (const char *later :
         {"ftx_api_GetPSN", "ftx_api_GetTestInfoFlag", "ftx_api_camera_test_start",
          "ftx_api_Vibrator_Test_Start", "ftx_api_EnterLowCostMode"})
        EXPECT_EQ(0u, p.bound.count(later)) << later;
}

TEST_F(Binding, MissingFlagWriteUsesTheStandBy) {
    Probe p = run("no_writeflags", "factory write0");
    EXPECT_TRUE(p.has("RET factory 0")) << p.dump();
    EXPECT_EQ(1u, p.fallback.count("ftx_api_WriteFuncTestInfoFlags"));
    EXPECT_EQ(1u, p.bound.count("ftx_api_ReadFuncTestInfoFlags"));
    // The stand-by reports success and stores nothing; the read-back sees it.
    EXPECT_TRUE(p.has("BYTE0 0")) << p.dump();
    EXPECT_EQ(1u, p.with("check testinfo indexbyte=0,writeval=64,readval=0").size()) << p.dump();
}

TEST_F(Binding, MissingFeatureSymbolFailsOnlyThatFeature) {
    Probe p = run("no_flashlight", "factory flashlight alllight");
    EXPECT_TRUE(p.has("RET factory 0")) << p.dump();
    EXPECT_TRUE(p.has("RET flashlight -1"));
    EXPECT_TRUE(p.has("RET alllight 0"));
    std::vector<std::string> miss = p.with("FATAL ERROR");
    ASSERT_EQ(1u, miss.size()) << p.dump();
    EXPECT_EQ(
        "LOG E FTX_ALLLIGHT: FATAL ERROR: could not dlsym lib_factory.so::"
        "ftx_api_FlashlightTest_Start",
        miss[0]);
    EXPECT_EQ(1u, p.with("LOG E FTX_ALLLIGHT: error = ").size());
    EXPECT_EQ(1u, p.bound.count("ftx_api_AlllightTest_Start"));
}

TEST_F(Binding, FeatureBindersNeedTheOpenedLibrary) {
    Probe p = run("", "flashlight pcba");
    EXPECT_TRUE(p.has("RET flashlight -1")) << p.dump();
    EXPECT_TRUE(p.has("RET pcba -1"));
    EXPECT_TRUE(
        p.has("LOG E FTX_ALLLIGHT: FATAL ERROR: Init_lib_Flashlight_Interface could not "
              "find lib_factory.so"));
    EXPECT_TRUE(p.has("LOG E FTX_CPU: FATAL ERROR: could not find lib_factory.so"));
    EXPECT_TRUE(p.bound.empty());
}

TEST_F(Binding, PcbaSetKeepsABoundCameraCheck) {
    Probe p = run("", "factory preset_camid pcba camid");
    EXPECT_TRUE(p.has("RET pcba 0")) << p.dump();
    EXPECT_TRUE(p.has("CAMID 42"));
    EXPECT_EQ(1u, p.bound.count("ftx_api_auxmic2earpiece_stop"));
}

TEST_F(Binding, BatteryBinderWordsTheUnregisterMissAsTheProgramDoes) {
    Probe p = run("no_battery_unregister", "factory core");
    EXPECT_TRUE(p.has("RET core -1")) << p.dump();
    std::vector<std::string> miss = p.with("FATAL ERROR");
    ASSERT_EQ(1u, miss.size()) << p.dump();
    EXPECT_EQ(
        "LOG E DVK_FTX: FATAL ERROR: could not dlsym g_libcoredevice.so::"
        "FTX_API_BatteryService_unregister_Observer_lib_t",
        miss[0]);
    EXPECT_EQ(1u, p.bound.count("FTX_API_BatteryService_register_Observer"));
    EXPECT_EQ(0u, p.bound.count("FTX_API_BatteryService_StartService"));
}

TEST_F(Binding, MissingChannelOperationLeavesTheChannelUnstarted) {
    Probe p = run("no_selectloop", "factory core atthread");
    EXPECT_TRUE(p.has("RET core 0")) << p.dump();
    EXPECT_TRUE(p.has("RET atthread -1"));
    std::vector<std::string> miss = p.with("could not dlsym");
    ASSERT_EQ(1u, miss.size()) << p.dump();
    EXPECT_EQ("LOG E AtThread: FATAL ERROR: could not dlsym g_libcoredevice.so::runSelectLoopMode",
              miss[0]);
    EXPECT_TRUE(p.has("LOG E AtThread: AtThreadStart::Get_libcoredevice_Interface fail"));
    EXPECT_EQ(1u, p.bound.count("registerCommandProcess"));
    for (const char *later :
         {"runSelectLoopMode", "mmi_AutoTest_FileOpt_Read", "mmi_AutoTest_FileOpt_Remove",
          "mmi_AutoTest_WiFiConCpt_Enable", "mmi_AutoTest_WiFiConCpt_Disable"})
        EXPECT_EQ(0u, p.bound.count(later)) << later;
    // No command table was registered.
    EXPECT_TRUE(p.with("registerModule::cmd is").empty());
}

}  // namespace

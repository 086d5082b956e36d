// mmi_initconfig: defaults, the order of its steps and where it stops.
#include <string.h>

#include <string>

#include <gtest/gtest.h>

#include "core/ftx_config.h"
#include "core/mmi_settings.h"
#include "support/temp_root.h"
#include "unit/config/log_capture.h"
#include "mmi_startup.h"

namespace {

// The tables and the list builder are handed in as at start-up.
[[maybe_unused]] const bool kWired = (mmi_startup_wire(), true);

const char *kLanguage =
    "[Chinese]\r\nResult_pass=\xcd\xa8\xb9\xfd\r\n"
    "[English]\r\nResult_pass=PASS\r\nResult_fail=FAIL\r\nsoftkeybar_back=Back\r\n"
    "info_Yes=Yes\r\n";

class InitConfig : public ::testing::Test {
  protected:
    // Puts every setting back to its start value, as before the first run.
    void SetUp() override {
        snprintf(g_cItemPass, MMI_TEXT_SIZE, "Result_pass");
        snprintf(g_cItemFail, MMI_TEXT_SIZE, "Result_fail");
        snprintf(g_cItemBack, MMI_TEXT_SIZE, "softkeybar_back");
        snprintf(g_ItemYes, MMI_TEXT_SIZE, "info_Yes");
        g_batteryWarningVolt = 30;
        g_powerofftemp = 600;
        g_bCfgOsIsCanIdle = 1;
        g_bOsIsCanIdle = 1;
        g_autoSleepTime = 90;
        g_autoTurnOffTime = 1800;
        g_bTPShape = 0;
        g_bRestoreAutotest = 0;
        for (char *text :
             {g_cSysBacklight, g_chLogPath, g_chAgingSettingFilePath, g_chAgingLogPath}) {
            memset(text, 0, MMI_TEXT_SIZE);
        }
    }
    void write(const std::string &mmi, const char *language = kLanguage) {
        root.write("/etc/ftx_config.ini", "[MMI]\r\n" + mmi);
        if (language != nullptr) root.write("/etc/ftx_language.ini", language);
    }
    void expect_start_values() {
        EXPECT_STREQ("Result_pass", g_cItemPass);
        EXPECT_STREQ("info_Yes", g_ItemYes);
        EXPECT_EQ(30, g_batteryWarningVolt);
        EXPECT_EQ(1, g_bOsIsCanIdle.load());
        EXPECT_EQ(0, g_bTPShape);
        EXPECT_STREQ("", g_chLogPath);
        EXPECT_STREQ("", g_chAgingLogPath);
    }
    TempRoot root;
};

TEST_F(InitConfig, DefaultsWhenTheKeysAreAbsent) {
    write("Language=English\r\n");
    LogCapture log;
    ASSERT_EQ(0, mmi_initconfig());
    EXPECT_STREQ("English", g_chLanguageName);
    EXPECT_STREQ("PASS", g_cItemPass);
    EXPECT_STREQ("FAIL", g_cItemFail);
    EXPECT_STREQ("Back", g_cItemBack);
    EXPECT_STREQ("Yes", g_ItemYes);
    EXPECT_EQ(30, g_batteryWarningVolt);
    EXPECT_EQ(600, g_powerofftemp);
    EXPECT_EQ(1, g_bCfgOsIsCanIdle);
    EXPECT_EQ(1, g_bOsIsCanIdle.load());
    EXPECT_EQ(90, g_autoSleepTime);
    EXPECT_EQ(1800, g_autoTurnOffTime);
    EXPECT_STREQ("/sys/class/leds/lcd-backlight/brightness", g_cSysBacklight);
    EXPECT_EQ(0, g_bTPShape);
    EXPECT_EQ(0, g_bRestoreAutotest);
    EXPECT_STREQ("/cache/ftx/", g_chLogPath);
    EXPECT_STREQ("/cache/ftx/agingsetting.ini", g_chAgingSettingFilePath);
    EXPECT_STREQ("/cache/ftx/aging/", g_chAgingLogPath);
    EXPECT_EQ("D FTX_CONFIG: mmi_initconfig begin", log.lines.front());
    EXPECT_EQ("D FTX_CONFIG: mmi_initconfig end", log.lines.back());
    EXPECT_TRUE(log.has("mmi_initconfig g_batteryWarningVolt=30"));
    EXPECT_TRUE(log.has("mmi_initconfig,L1016:: g_chLogPath=/cache/ftx/"));
    EXPECT_FALSE(log.has("L1019"));
}

TEST_F(InitConfig, ReadsEverySetting) {
    write(
        "Language=English\r\n"
        "batteryParameter=lowvolt_threshold:35;powerofftemp:550;OSIdle:0;"
        "OS_AutoSleepTime:60;OS_AutoTurnOffTime:900;sys_backlight:/sys/bl\r\n"
        "UEShape=1\r\nrestore_autotest=1\r\nLogPath=/data/log\r\n");
    LogCapture log;
    ASSERT_EQ(0, mmi_initconfig());
    EXPECT_EQ(35, g_batteryWarningVolt);
    EXPECT_EQ(550, g_powerofftemp);
    EXPECT_EQ(0, g_bCfgOsIsCanIdle);
    EXPECT_EQ(0, g_bOsIsCanIdle.load());
    EXPECT_EQ(60, g_autoSleepTime);
    EXPECT_EQ(900, g_autoTurnOffTime);
    EXPECT_STREQ("/sys/bl", g_cSysBacklight);
    EXPECT_EQ(1, g_bTPShape);
    EXPECT_EQ(1, g_bRestoreAutotest);
    // A missing slash is added before the aging paths are derived.
    EXPECT_STREQ("/data/log/", g_chLogPath);
    EXPECT_STREQ("/data/log/agingsetting.ini", g_chAgingSettingFilePath);
    EXPECT_STREQ("/data/log/aging/", g_chAgingLogPath);
    EXPECT_TRUE(log.has("mmi_initconfig,L1019:: g_chLogPath=/data/log/"));
}

TEST_F(InitConfig, LanguageFallsBackToChineseAndMissingTextsToTheirKeys) {
    write("UEShape=1\r\n");
    ASSERT_EQ(0, mmi_initconfig());
    EXPECT_STREQ("Chinese", g_chLanguageName);
    EXPECT_STREQ("\xcd\xa8\xb9\xfd", g_cItemPass);
    EXPECT_STREQ("Result_fail", g_cItemFail);
    write("Language=Klingon\r\n");
    SetUp();
    ASSERT_EQ(0, mmi_initconfig());
    EXPECT_EQ(0, ftx_config_lang_count());
    EXPECT_STREQ("Result_pass", g_cItemPass);
}

TEST_F(InitConfig, StopsWithoutTheMainFile) {
    root.write("/etc/ftx_language.ini", kLanguage);
    LogCapture log;
    EXPECT_EQ(-1, mmi_initconfig());
    EXPECT_TRUE(log.has("Read_MainCfgFile Get_CfgValue fail."));
    EXPECT_FALSE(log.has("mmi_initLangCfg"));
    expect_start_values();
}

TEST_F(InitConfig, StopsWithoutTheLanguageFile) {
    write("Language=English\r\nLogPath=/data/log/\r\n", nullptr);
    LogCapture log;
    EXPECT_EQ(-1, mmi_initconfig());
    EXPECT_TRUE(log.has("D FTX_CONFIG: mmi_initconfig Get_CfgValueList fail."));
    expect_start_values();
}

TEST_F(InitConfig, ALaterStopKeepsTheEarlierSettings) {
    // The malformed header lies after UEShape but before restore_autotest.
    write(
        "Language=English\r\nbatteryParameter=OSIdle:0\r\nUEShape=1\r\n[\r\n"
        "restore_autotest=1\r\nLogPath=/x/\r\n");
    EXPECT_EQ(-1, mmi_initconfig());
    EXPECT_EQ(0, g_bOsIsCanIdle.load());
    EXPECT_EQ(1, g_bTPShape);
    EXPECT_EQ(0, g_bRestoreAutotest);
    EXPECT_STREQ("", g_chLogPath);
}

}  // namespace

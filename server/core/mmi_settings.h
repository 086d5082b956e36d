// Process-wide settings read once at start-up by mmi_initconfig.
#pragma once

#include <stdint.h>

#include <atomic>

#define MMI_TEXT_SIZE 256

extern char g_chLanguageName[MMI_TEXT_SIZE];  // section of /etc/ftx_language.ini in use

// Common texts; they hold their own key until the language file supplies a text.
extern char g_cItemPass[MMI_TEXT_SIZE];
extern char g_cItemFail[MMI_TEXT_SIZE];
extern char g_cItemBack[MMI_TEXT_SIZE];
extern char g_ItemYes[MMI_TEXT_SIZE];

// MMI/batteryParameter fields.
extern int32_t g_batteryWarningVolt;
extern int32_t g_powerofftemp;
extern int32_t g_bCfgOsIsCanIdle;
extern std::atomic<int32_t> g_bOsIsCanIdle;  // changed at run time by power management
extern int32_t g_autoSleepTime;
extern int32_t g_autoTurnOffTime;
extern char g_cSysBacklight[MMI_TEXT_SIZE];

extern int32_t g_bTPShape;
extern int32_t g_bRestoreAutotest;

// Log directory, always ending in '/', and the aging files derived from it.
extern char g_chLogPath[MMI_TEXT_SIZE];
extern char g_chAgingSettingFilePath[MMI_TEXT_SIZE];
extern char g_chAgingLogPath[MMI_TEXT_SIZE];

// MMI/mmi_flag and MMI/pretest_menu_enable, read by the automatic sequence before a run
// and used by the result record from several threads.
extern std::atomic<int32_t> g_mmiPreFlag;
extern std::atomic<int32_t> g_pretestMenuEnabled;

// Builds the test lists (through the builder start-up hands in), loads the language texts
// and reads the settings above. 0 when every step ran, -1 when it stopped early.
int mmi_initconfig(void);
// What mmi_initconfig calls to build the test lists; null builds nothing.
void mmi_initconfig_set_list_builder(void (*build)(void));

// 1 when the aging restart marker (rebootAging.txt in the log folder) is readable.
int Check_AgingCfg_Exist(void);

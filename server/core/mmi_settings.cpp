// mmi_initconfig: the test lists, the language texts and the process-wide settings.
#include "core/mmi_settings.h"

#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <unistd.h>

#include <android/log.h>

#include "devfs.h"
#include "core/ftx_config.h"
#include "tp_os.h"

#define CFG_DEBUG(...) __android_log_print(ANDROID_LOG_DEBUG, "FTX_CONFIG", __VA_ARGS__)

char g_chLanguageName[MMI_TEXT_SIZE];

char g_cItemPass[MMI_TEXT_SIZE] = "Result_pass";
char g_cItemFail[MMI_TEXT_SIZE] = "Result_fail";
char g_cItemBack[MMI_TEXT_SIZE] = "softkeybar_back";
char g_ItemYes[MMI_TEXT_SIZE] = "info_Yes";

int32_t g_batteryWarningVolt = 30;
int32_t g_powerofftemp = 600;
int32_t g_bCfgOsIsCanIdle = 1;
std::atomic<int32_t> g_bOsIsCanIdle{1};
int32_t g_autoSleepTime = 90;
int32_t g_autoTurnOffTime = 1800;
char g_cSysBacklight[MMI_TEXT_SIZE];

int32_t g_bTPShape;
int32_t g_bRestoreAutotest;

char g_chLogPath[MMI_TEXT_SIZE];
char g_chAgingSettingFilePath[MMI_TEXT_SIZE];
char g_chAgingLogPath[MMI_TEXT_SIZE];

std::atomic<int32_t> g_mmiPreFlag{0};
std::atomic<int32_t> g_pretestMenuEnabled{0};

extern "C" {
extern const TP_I18N_DOMAIN language_domains[];
}

namespace {

// The platform finds the built-in text table through a weak reference, which does not
// pull its object out of the application archive: this one does.
[[maybe_unused]] __attribute__((used)) const void *s_keepLanguageDomains = language_domains;

#define BATTERY_PARA_MAX 12

// Where one batteryParameter field goes.
struct BatteryField {
    const char *name;
    const char *def;
    int32_t *target;   // numeric fields
    char *textTarget;  // the backlight path
    const char *line;
};

std::atomic<void (*)(void)> s_buildLists{nullptr};

int32_t s_osIdle;  // OSIdle lands here, then in both idle flags

const BatteryField kBatteryFields[] = {
    {"lowvolt_threshold", "30", &g_batteryWarningVolt, nullptr, "%s g_batteryWarningVolt=%d"},
    {"powerofftemp", "600", &g_powerofftemp, nullptr, "%s g_powerofftemp=%d"},
    {"OSIdle", "1", &s_osIdle, nullptr, "%s g_bCfgOsIsCanIdle=%d"},
    {"OS_AutoSleepTime", "90", &g_autoSleepTime, nullptr, "%s g_autoSleepTime=%d"},
    {"OS_AutoTurnOffTime", "1800", &g_autoTurnOffTime, nullptr, "%s g_autoTurnOffTime=%d"},
    {"sys_backlight", "/sys/class/leds/lcd-backlight/brightness", nullptr, g_cSysBacklight,
     "%s g_cSysBacklight=%s"},
};

// A path setting must name a place on the handset: absolute, without ".." parts or control
// bytes. Anything else is refused with an error and the built-in path used instead.
void check_path_setting(const char *key, char *value, const char *builtin) {
    bool ok = value[0] == '/';
    for (const char *p = value; ok && *p != '\0'; p++) {
        if (static_cast<unsigned char>(*p) < 0x20 || *p == 0x7f) ok = false;
        if (p[0] == '/' && p[1] == '.' && p[2] == '.' && (p[3] == '/' || p[3] == '\0')) ok = false;
    }
    if (ok) return;
    __android_log_print(ANDROID_LOG_ERROR, "FTX_CONFIG",
                        "%s %s %s is not an absolute path on the handset: using %s",
                        "mmi_initconfig", key, value, builtin);
    memset(value, 0, MMI_TEXT_SIZE);
    tp_os_strlcpy(value, builtin, MMI_TEXT_SIZE);
}

void read_battery_fields(const ftx_config_para *paras, int count) {
    char work[MMI_TEXT_SIZE];
    for (const BatteryField &f : kBatteryFields) {
        memset(work, 0, sizeof(work));
        ftx_config_get_para_value(paras, count, f.name, work, sizeof(work), f.def);
        if (f.textTarget != nullptr) {
            memset(f.textTarget, 0, MMI_TEXT_SIZE);
            tp_os_strlcpy(f.textTarget, work, MMI_TEXT_SIZE);
            check_path_setting(f.name, f.textTarget, f.def);
            CFG_DEBUG(f.line, "mmi_initconfig", f.textTarget);
            continue;
        }
        *f.target = atoi(work);
        if (f.target == &s_osIdle) {
            g_bOsIsCanIdle = s_osIdle;
            g_bCfgOsIsCanIdle = s_osIdle;
        }
        CFG_DEBUG(f.line, "mmi_initconfig", *f.target);
    }
}

// An MMI value read as a number; false when the main file failed.
bool read_mmi_int(const char *key, const char *def, int32_t *target, const char *line) {
    char work[MMI_TEXT_SIZE] = {0};
    if (Read_MainCfgFile("MMI", key, work, def) != 0) return false;
    *target = atoi(work);
    CFG_DEBUG(line, "mmi_initconfig", *target);
    return true;
}

// dst = prefix + suffix, cut to the buffer.
void join_path(char *dst, const char *prefix, const char *suffix) {
    size_t n = tp_os_strlcpy(dst, prefix, MMI_TEXT_SIZE);
    if (n < MMI_TEXT_SIZE - 1) tp_os_strlcpy(dst + n, suffix, MMI_TEXT_SIZE - n);
}

bool read_log_path() {
    memset(g_chLogPath, 0, sizeof(g_chLogPath));
    if (Read_MainCfgFile("MMI", "LogPath", g_chLogPath, "/cache/ftx/") != 0) return false;
    check_path_setting("LogPath", g_chLogPath, "/cache/ftx/");
    CFG_DEBUG("%s,L%d:: g_chLogPath=%s", "mmi_initconfig", 1016, g_chLogPath);
    size_t len = strlen(g_chLogPath);
    if (len > 0 && g_chLogPath[len - 1] != '/' && len < MMI_TEXT_SIZE - 1) {
        g_chLogPath[len] = '/';
        g_chLogPath[len + 1] = '\0';
        CFG_DEBUG("%s,L%d:: g_chLogPath=%s", "mmi_initconfig", 1019, g_chLogPath);
    }
    join_path(g_chAgingSettingFilePath, g_chLogPath, "agingsetting.ini");
    CFG_DEBUG("%s,L%d:: g_chAgingSettingFilePath=%s", "mmi_initconfig", 1023,
              g_chAgingSettingFilePath);
    join_path(g_chAgingLogPath, g_chLogPath, "aging/");
    CFG_DEBUG("%s,L%d:: g_chAgingLogPath=%s", "mmi_initconfig", 1025, g_chAgingLogPath);
    return true;
}

// A missing file leaves every setting at its built-in default, which looks like a working
// handset: said at error level and on the console of whoever started the program.
void report_if_missing(const char *devicePath) {
    if (dev_access(devicePath, F_OK) == 0) return;
    char host[512];
    if (dev_path(devicePath, host, sizeof(host)) != 0) snprintf(host, sizeof(host), "?");
    __android_log_print(ANDROID_LOG_ERROR, "FTX_CONFIG",
                        "%s %s is missing (%s): built-in defaults apply", "mmi_initconfig",
                        devicePath, host);
    fprintf(stderr, "ftx-mmi: %s is missing (%s): built-in defaults apply\n", devicePath, host);
}

}  // namespace

void mmi_initconfig_set_list_builder(void (*build)(void)) {
    s_buildLists = build;
}

int mmi_initconfig(void) {
    CFG_DEBUG("%s begin", __func__);
    if (void (*build)(void) = s_buildLists.load()) build();

    memset(g_chLanguageName, 0, sizeof(g_chLanguageName));
    if (Read_MainCfgFile("MMI", "Language", g_chLanguageName, "Chinese") != 0) {
        report_if_missing(FTX_MAIN_CONFIG_FILE);
        return -1;
    }
    if (Get_CfgValueList(g_chLanguageName) != 0) {
        CFG_DEBUG("%s Get_CfgValueList fail.", __func__);
        report_if_missing(FTX_LANGUAGE_FILE);
        return -1;
    }

    CFG_DEBUG("%s begin", "mmi_initLangCfg");
    Read_LangCfgFromList("Result_pass", g_cItemPass);
    Read_LangCfgFromList("Result_fail", g_cItemFail);
    Read_LangCfgFromList("softkeybar_back", g_cItemBack);
    Read_LangCfgFromList("info_Yes", g_ItemYes);
    CFG_DEBUG("%s end", "mmi_initLangCfg");

    char battery[MMI_TEXT_SIZE] = {0};
    if (Read_MainCfgFile("MMI", "batteryParameter", battery, nullptr) != 0) return -1;
    ftx_config_para paras[BATTERY_PARA_MAX];
    memset(paras, 0, sizeof(paras));
    int count = ftx_config_parse_parameter(battery, paras, BATTERY_PARA_MAX);
    read_battery_fields(paras, count);

    if (!read_mmi_int("UEShape", "0", &g_bTPShape, "%s g_bTPShape=%d")) return -1;
    if (!read_mmi_int("restore_autotest", "0", &g_bRestoreAutotest, "%s g_bRestoreAutotest=%d")) {
        return -1;
    }
    if (!read_log_path()) return -1;

    CFG_DEBUG("%s end", __func__);
    return 0;
}

int Check_AgingCfg_Exist(void) {
    // Joined into 256 bytes: a longer path is cut at 255 characters.
    char path[256];
    size_t n = tp_os_strlcpy(path, g_chLogPath, sizeof path);
    tp_os_strlcpy(path + n, "rebootAging.txt", sizeof path - n);
    return dev_access(path, R_OK) == 0 ? 1 : 0;
}

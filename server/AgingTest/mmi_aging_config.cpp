#include "AgingTest/mmi_aging_config.h"

#include <android/log.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>

#include "core/ftx_config.h"
#include "tp_os.h"

#define AGING_TAG "AgingTest"
#define LOGD(...) __android_log_print(ANDROID_LOG_DEBUG, AGING_TAG, __VA_ARGS__)
#define LOGE(...) __android_log_print(ANDROID_LOG_ERROR, AGING_TAG, __VA_ARGS__)

int g_bAging_VedioTest;
int g_iAgingVedioTestTime;
int g_bAging_LightTest;
int g_iAgingLightTime;
int g_bAging_CameraTest;
int g_iAgingCameraTotalNum;
int g_iCameraTotalNum;
int g_bAging_RebootTest;
int g_iAgingTotalRebootNum;
int g_bAging_SuspendTest;
int g_iAgingSuspendTotalNum;
int g_bAging_VibratorTest;
int g_iAgingVibratorTime;
int g_bAging_AudioLoop;
int g_iAgingCycles;
int g_iAgingTempUpLimit;
int g_iAgingTempUncharge;
int g_bAging_CpuFullLoad;
int g_cputime;
int g_bAging_SaveDb;
int g_iAgingSaveDbTime;
char g_chAgingSaveDbSsid[MMI_AGING_SSID_SIZE];
int g_bAging_ExternalBattery;
char g_iport[MMI_AGING_ENDPOINT_SIZE];

namespace {

const char kDomain[] = "FTX_AGING";
const char kFn[] = "mmi_AgingTest_ReadConfig";
// A missing key leaves the setting as it is.
const int kKeep = -0x7fffffff;

struct Param {
    const char *name;     // in the key's parameter list
    const char *setting;  // in the log line
    int *target;
    int inKey;  // the parameter is missing from a present key
    int noKey;  // the whole key is missing (kKeep: unchanged)
};

struct Group {
    const char *key;
    const char *logName;
    Param params[3];
};

// In the order they are read.
const Group kGroups[] = {
    {"vediotest",
     "vediotest",
     {{"enable", "g_bAging_VedioTest", &g_bAging_VedioTest, 1, 1},
      {"time", "g_iAgingVedioTestTime", &g_iAgingVedioTestTime, 30, 30}}},
    {"lighttest",
     "lighttest",
     {{"enable", "g_bAging_LightTest", &g_bAging_LightTest, 1, 0},
      {"time", "g_iAgingLightTime", &g_iAgingLightTime, 10, 3}}},
    {"cameratest",
     "cameratest",
     {{"enable", "g_bAging_CameraTest", &g_bAging_CameraTest, 1, 1},
      {"times", "g_iAgingCameraTotalNum", &g_iAgingCameraTotalNum, 100, 100},
      {"totalnum", "g_iCameraTotalNum", &g_iCameraTotalNum, 2, kKeep}}},
    {"reboottest",
     "RebootAging",
     {{"enable", "g_bAging_RebootTest", &g_bAging_RebootTest, 1, 1},
      {"times", "g_iAgingTotalRebootNum", &g_iAgingTotalRebootNum, 100, 100}}},
    {"standbytest",
     "SuspendAging",
     {{"enable", "g_bAging_SuspendTest", &g_bAging_SuspendTest, 1, 1},
      {"times", "g_iAgingSuspendTotalNum", &g_iAgingSuspendTotalNum, 50, 50}}},
    {"vibratortest",
     "vibratortest",
     {{"enable", "g_bAging_VibratorTest", &g_bAging_VibratorTest, 1, 1},
      {"time", "g_iAgingVibratorTime", &g_iAgingVibratorTime, 15, 15}}},
    {"audioloop", "audioloop", {{"enable", "g_bAging_AudioLoop", &g_bAging_AudioLoop, 1, 1}}},
    {"Parameters",
     "Parameters",
     {{"Cycles", "g_iAgingCycles", &g_iAgingCycles, 1, 1},
      {"TempUpLimit", "g_iAgingTempUpLimit", &g_iAgingTempUpLimit, 550, 550},
      {"TempUncharge", "g_iAgingTempUncharge", &g_iAgingTempUncharge, 450, 450}}},
    {"cpufullload",
     "cpufullload",
     {{"enable", "g_bAging_CpuFullLoad", &g_bAging_CpuFullLoad, 1, 1},
      {"time", "g_cputime", &g_cputime, 5, 5}}},
    {"savedb",
     "savedb",
     {{"enable", "g_bAging_SaveDb", &g_bAging_SaveDb, 0, 0},
      {"time", "g_iAgingSaveDbTime", &g_iAgingSaveDbTime, 0, kKeep}}},
};

const int kMaxParams = 12;

// The key's text, or false when the key is not in the domain.
bool read_key(const char *key, char *out) {
    memset(out, 0, FTX_CFG_TEXT_SIZE);
    Read_MainCfgFile(kDomain, key, out, nullptr);
    return out[0] != '\0';
}

void read_group(const Group &g) {
    char text[FTX_CFG_TEXT_SIZE];
    const bool present = read_key(g.key, text);
    ftx_config_para p[kMaxParams];
    memset(p, 0, sizeof p);
    const int n = present ? ftx_config_parse_parameter(text, p, kMaxParams) : 0;
    char line[512] = "";
    size_t used = 0;
    for (const Param &q : g.params) {
        if (q.name == nullptr) break;
        if (present) {
            char def[16], value[FTX_CFG_TEXT_SIZE] = "";
            snprintf(def, sizeof def, "%d", q.inKey);
            ftx_config_get_para_value(p, n, q.name, value, sizeof value, def);
            *q.target = atoi(value);
        } else if (q.noKey != kKeep) {
            *q.target = q.noKey;
        }
        const int w = snprintf(line + used, sizeof line - used, "%s%s=%d", used ? "," : "",
                               q.setting, *q.target);
        if (w > 0 && static_cast<size_t>(w) < sizeof line - used) used += w;
    }
    if (g.params[0].target == &g_bAging_SaveDb && present) {
        memset(g_chAgingSaveDbSsid, 0, sizeof g_chAgingSaveDbSsid);
        ftx_config_get_para_value(p, n, "SSID", g_chAgingSaveDbSsid, sizeof g_chAgingSaveDbSsid,
                                  "DVK-AGING-001");
    }
    LOGD("%s,L%d::%s::%s.", kFn, __LINE__, g.logName, line);
}

}  // namespace

void mmi_aging_config_reset(void) {
    for (const Group &g : kGroups)
        for (const Param &q : g.params)
            if (q.target != nullptr) *q.target = q.noKey == kKeep ? q.inKey : q.noKey;
    g_iAgingSaveDbTime = 0;
    tp_os_strlcpy(g_chAgingSaveDbSsid, "DVK-AGING-001", sizeof g_chAgingSaveDbSsid);
    g_bAging_ExternalBattery = 0;
    tp_os_strlcpy(g_iport, MMI_AGING_DEFAULT_ENDPOINT, sizeof g_iport);
}

void mmi_AgingTest_ReadConfig(void) {
    static const bool kInit = (mmi_aging_config_reset(), true);
    (void)kInit;
    for (const Group &g : kGroups)
        read_group(g);

    char text[FTX_CFG_TEXT_SIZE];
    memset(text, 0, sizeof text);
    g_bAging_ExternalBattery =
        Read_MainCfgFile(kDomain, "ExternBattery", text, "0") == 0 ? atoi(text) : 0;
    LOGD("%s,L%d:: g_bAging_ExternalBattery=%d.", kFn, __LINE__, g_bAging_ExternalBattery);

    if (!read_key("savedb", text)) {
        g_bAging_SaveDb = 0;
        tp_os_strlcpy(g_iport, MMI_AGING_DEFAULT_ENDPOINT, sizeof g_iport);
    }
    // A missing server address switches saving off, whatever savedb says.
    if (!read_key("uploadip", text)) {
        g_bAging_SaveDb = 0;
        tp_os_strlcpy(g_iport, MMI_AGING_DEFAULT_ENDPOINT, sizeof g_iport);
        LOGE("get uploadip failed\n");
    } else if (strlen(text) >= sizeof g_iport) {
        // Cut short it could name another server: saving stays off instead.
        g_bAging_SaveDb = 0;
        tp_os_strlcpy(g_iport, MMI_AGING_DEFAULT_ENDPOINT, sizeof g_iport);
        LOGE("uploadip longer than %d bytes: saving to the server is off\n",
             (int)sizeof g_iport - 1);
    } else {
        tp_os_strlcpy(g_iport, text, sizeof g_iport);
        LOGD("uploadip g_iport = %s\n", g_iport);
    }
}

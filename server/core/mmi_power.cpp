// Screen sleep after the idle time, automatic power-off and the battery warnings. Driven
// by the battery service's observer calls on its own thread; the power key and the PC's
// standby commands come in from the GUI and command threads.
#include "core/mmi_power.h"

#include <android/log.h>
#include <devfs.h>
#include <errno.h>
#include <fcntl.h>
#include <string.h>
#include <time.h>
#include <tp_os.h>
#include <unistd.h>

#include <mutex>

#include "core/ftx_config.h"
#include "core/ftx_lib_binding.h"
#include "core/mmi_settings.h"

#define TAG "batteryObserver"
#define LOGD(...) __android_log_print(ANDROID_LOG_DEBUG, TAG, __VA_ARGS__)
#define LOGE(...) __android_log_print(ANDROID_LOG_ERROR, TAG, __VA_ARGS__)

std::atomic<int> g_bCurrentSleepStatus{0};
std::atomic<long long> g_LastInputTime{0};

namespace {

// Lock order: battery mutex first, then the sleep mutex. The warning mutex is never held
// with the battery mutex; it is held while the title strip is set.
std::mutex s_sleepMutex;
std::mutex s_batteryMutex;
FTX_BATTERY_INFO s_battery;  // under s_batteryMutex
bool s_batteryKnown = false;
std::atomic<int> s_batteryPresent{0};  // read by the sleep path under the battery mutex
int s_lastCharging = -1;               // battery thread only

// Battery warnings of the title strip, most urgent first. Each holds while its condition
// does; the strip shows the most urgent one and gets its title back when none is left.
enum Warning { WARN_TEMPERATURE, WARN_HEALTH, WARN_LOW_BATTERY, WARN_COUNT, WARN_NONE = -1 };
const char *const kWarningKeys[WARN_COUNT] = {"batteryTemperatureWarning", "batteryHealthWarning",
                                              "batteryLevelWaring"};
std::mutex s_warnMutex;
bool s_warning[WARN_COUNT];      // under s_warnMutex
int s_warnedLevel = 0;           // level the low-battery warning came at (under s_warnMutex)
int s_shownWarning = WARN_NONE;  // under s_warnMutex

// Until start-up hands in the title strip, warnings go nowhere.
int no_title(const char *, int, int) {
    return 0;
}

int shell_run(const char *cmd) {
    return dev_system(cmd);
}

void power_off_now(void) {
    dev_sync();
    dev_reboot(LINUX_REBOOT_CMD_POWER_OFF);
}

long long start_offset_us() {
    static const long long offset = [] {
        struct timespec rt, mono;
        clock_gettime(CLOCK_REALTIME, &rt);
        clock_gettime(CLOCK_MONOTONIC, &mono);
        return (rt.tv_sec - mono.tv_sec) * 1000000LL + (rt.tv_nsec - mono.tv_nsec) / 1000;
    }();
    return offset;
}

// Takes the translation of key, or the key itself when the language file lacks it.
void translate(const char *key, char *out, size_t size) {
    char text[FTX_CFG_TEXT_SIZE];
    tp_os_strlcpy(text, key, sizeof text);
    Read_LangCfgFromList(key, text);
    tp_os_strlcpy(out, text, size);
}

int set_sleep_status() {
    LOGD("%s begin", "SetSleepStatus");
    int old = g_bCurrentSleepStatus.exchange(1);
    if (g_powerOps.write_file(MMI_LCD_BRIGHTNESS_PATH, "10") != 0) {
        LOGE("%s,L%d,set brightness = 10 fail.", "SetSleepStatus", __LINE__);
        g_bCurrentSleepStatus = old;
        return -1;
    }
    usleep(100);
    if (g_powerOps.write_file(MMI_LCD_BRIGHTNESS_PATH, "0") != 0) {
        LOGE("%s,L%d,set brightness = 0 fail.", "SetSleepStatus", __LINE__);
        g_bCurrentSleepStatus = old;
        return -1;
    }
    GetLastInputTime();
    g_powerOps.shell("echo 4 > /sys/class/graphics/fb0/blank");
    g_powerOps.shell("echo mem > /sys/power/autosleep");
    LOGD("%s end", "SetSleepStatus");
    return 0;
}

// The wake steps proper; the caller holds the sleep mutex where one is needed.
int set_wakeup_status() {
    g_powerOps.shell("echo off > /sys/power/autosleep");
    g_powerOps.shell("echo 0 > /sys/class/graphics/fb0/blank");
    tp_os_usleep(100000);
    if (g_powerOps.lcd_refresh) g_powerOps.lcd_refresh(0);
    GetLastInputTime();
    int ret = g_powerOps.write_file(MMI_LCD_BRIGHTNESS_PATH, "100");
    // Nothing else on the host marks the panel awake again.
    g_bCurrentSleepStatus = 0;
    return ret;
}

bool health_is_bad(int health) {
    return health == FTX_BATTERY_HEALTH_OVERHEAT || health == FTX_BATTERY_HEALTH_OVER_VOLTAGE ||
           health == FTX_BATTERY_HEALTH_DEAD;
}

// The battery service warns of a low level while no charger is online; the warning is over
// once one is, or once the level has climbed above both that level and the configured
// low threshold.
bool battery_low_over(const FTX_BATTERY_INFO *info, int warnedLevel) {
    if (info->chargerAcOnline || info->chargerUsbOnline || info->chargerWirelessOnline) return true;
    return info->batteryLevel > warnedLevel && info->batteryLevel > g_batteryWarningVolt;
}

// Caller holds s_warnMutex. The most urgent warning goes on the title strip; when the last
// one left, the strip's own title comes back.
void show_warnings() {
    int top = WARN_NONE;
    for (int i = WARN_COUNT - 1; i >= 0; i--)
        if (s_warning[i]) top = i;
    if (top != WARN_NONE) {
        char text[FTX_CFG_TEXT_SIZE];
        translate(kWarningKeys[top], text, sizeof text);
        g_powerOps.title_show(text, 1, 1);
    } else if (s_shownWarning != WARN_NONE) {
        g_powerOps.title_show(nullptr, 1, 0);
    }
    s_shownWarning = top;
}

void power_off_idle() {
    if (g_powerOps.mode_uninit) g_powerOps.mode_uninit();
    if (g_powerOps.vibrator_start) {
        g_powerOps.vibrator_start(1000);
        tp_os_usleep(1000000);
    }
    g_powerOps.power_off();
}

}  // namespace

mmi_power_ops mmi_power_default_ops(void) {
    return {.clock_us = mmi_power_clock_us,
            .write_file = write_file,
            .shell = shell_run,
            .power_off = power_off_now,
            .title_show = no_title};
}

mmi_power_ops g_powerOps = mmi_power_default_ops();

void mmi_power_reset(void) {
    {
        std::lock_guard<std::mutex> warn(s_warnMutex);
        for (bool &w : s_warning)
            w = false;
        s_warnedLevel = 0;
        s_shownWarning = WARN_NONE;
    }
    std::lock_guard<std::mutex> lk(s_batteryMutex);
    memset(&s_battery, 0, sizeof s_battery);
    s_battery.batteryLevel = -1;
    s_batteryKnown = false;
    s_batteryPresent = 0;
    s_lastCharging = -1;
    g_bCurrentSleepStatus = 0;
    GetLastInputTime();
}

long long mmi_power_clock_us(void) {
    struct timespec mono;
    clock_gettime(CLOCK_MONOTONIC, &mono);
    long long since = mono.tv_sec * 1000000LL + mono.tv_nsec / 1000;
    double scale = tp_os_time_scale();
    if (scale > 0 && scale != 1.0) since = (long long)(since / scale);
    return start_offset_us() + since;
}

void GetLastInputTime(void) {
    g_LastInputTime = g_powerOps.clock_us();
}

long compareTime_Minutes(void) {
    return (long)(g_powerOps.clock_us() / 1000000) - (long)(g_LastInputTime.load() / 1000000);
}

void Set_OsCanIdleAllowed(int allow) {
    if (g_bCfgOsIsCanIdle == 0) {
        g_bOsIsCanIdle = 0;
        LOGD("%s current cannot idle", "Set_OsCanIdleAllowed");
        return;
    }
    LOGD("%s,line=%d,setstatus=%d", "Set_OsCanIdleAllowed", __LINE__, allow);
    if (allow == 1) GetLastInputTime();
    g_bOsIsCanIdle = allow;
}

int SetIdleWakeupStatus(int sleep) {
    if (g_bOsIsCanIdle == 0) {
        LOGE("current cannot do idle,g_bOsIsCanIdle=%d", g_bOsIsCanIdle.load());
        return -1;
    }
    if (sleep == 1) {
        int present = s_batteryPresent;
        if (present != 1) {
            LOGE("current cannot do idle,no battery id,present=%d", present);
            return -1;
        }
        if (g_bCurrentSleepStatus == 1) {
            LOGD("%s current is sleep status", "SetIdleWakeupStatus");
            return 0;
        }
        std::lock_guard<std::mutex> lk(s_sleepMutex);
        return set_sleep_status();
    }
    if (g_bCurrentSleepStatus == 0) {
        LOGD("%s current is wakeup status", "SetIdleWakeupStatus");
        return 0;
    }
    std::lock_guard<std::mutex> lk(s_sleepMutex);
    LOGD("%s begin", "SetWakeupStatus");
    int ret = set_wakeup_status();
    LOGD("%s end,ret=%d", "SetWakeupStatus", ret);
    return ret;
}

int SwitchSleepStatus(void) {
    if (g_bOsIsCanIdle == 0) {
        LOGE("%s::cannot do idle,g_bOsIsCanIdle=%d", "SwitchSleepStatus", g_bOsIsCanIdle.load());
        return -1;
    }
    return SetIdleWakeupStatus(g_bCurrentSleepStatus == 1 ? 0 : 1);
}

int FTX_API_SetIdleStatus(void) {
    return set_wakeup_status();
}

int AutoSleepCheck(void) {
    if (g_bOsIsCanIdle != 1) return -1;
    std::lock_guard<std::mutex> lk(s_batteryMutex);
    long idle = compareTime_Minutes();
    if (idle >= g_autoSleepTime && g_bCurrentSleepStatus == 0) SetIdleWakeupStatus(1);
    if (idle >= g_autoTurnOffTime) {
        if (mmi_battery_is_charging(&s_battery)) {
            GetLastInputTime();  // on the charger the count starts again
        } else {
            LOGD("%s idle=%ld, power off", "AutoSleepCheck", idle);
            power_off_idle();
        }
    }
    return 0;
}

int mmi_AutoTest_Standby_Enable(void) {
    Set_OsCanIdleAllowed(1);
    return SetIdleWakeupStatus(1) == 0 ? 1 : 0;
}

int mmi_AutoTest_Standby_Disable(void) {
    // Waking needs the permission, so it is granted first (as the rule allows).
    Set_OsCanIdleAllowed(1);
    return SetIdleWakeupStatus(0) == 0 ? 1 : 0;
}

int write_file(const char *path, const char *text) {
    // Kernel attribute files take each write as the whole value; on the host they are
    // plain files, so the write replaces the content to keep the same meaning.
    FILE *fp = dev_fopen(path, "w+");
    if (!fp) {
        LOGE("%s fwrite errno=%s,real write len=%d", "write_file", strerror(errno), -1);
        return -1;
    }
    size_t len = strlen(text);
    size_t wrote = fwrite(text, 1, len, fp);
    fflush(fp);
    fsync(fileno(fp));
    if (wrote != len) {
        LOGE("%s fwrite errno=%s,real write len=%d", "write_file", strerror(errno), (int)wrote);
        fclose(fp);
        return -1;
    }
    char back[64];
    rewind(fp);
    size_t got = fread(back, 1, sizeof back, fp);
    fclose(fp);
    if (got != len) {
        LOGE("%s fread errno=%s,real read len=%d", "write_file", strerror(errno), (int)got);
        return -1;
    }
    return 0;
}

int mmi_battery_is_charging(const FTX_BATTERY_INFO *info) {
    if (info->batteryStatus == FTX_BATTERY_STATUS_CHARGING) return 1;
    return info->batteryStatus == FTX_BATTERY_STATUS_FULL &&
           (info->chargerAcOnline || info->chargerUsbOnline || info->chargerWirelessOnline);
}

int mmi_battery_snapshot(FTX_BATTERY_INFO *out) {
    std::lock_guard<std::mutex> lk(s_batteryMutex);
    *out = s_battery;
    if (!s_batteryKnown) out->batteryLevel = -1;
    return s_batteryKnown ? 0 : -1;
}

void batteryTemperatureobserver_cb(const FTX_BATTERY_INFO *info) {
    if (!info) return;
    {
        std::lock_guard<std::mutex> lk(s_batteryMutex);
        s_battery = *info;
        s_batteryKnown = true;
        s_batteryPresent = info->batteryPresent;
    }
    char text[FTX_CFG_TEXT_SIZE];
    int temp = info->batteryTemperature;
    if (temp >= g_powerofftemp) {
        LOGD("SendMessage MSG_CREATEDIALG BATTERYMSG:%s,temperature=%d,g_powerofftemp = %d",
             "battery temperature error!", temp, g_powerofftemp);
        g_powerOps.power_off();
        return;
    }
    if (temp >= MMI_BATTERY_TEMP_WARNING)
        LOGD("battery Temperature Warning,current Temperature=%d", temp);
    {
        std::lock_guard<std::mutex> warn(s_warnMutex);
        s_warning[WARN_TEMPERATURE] = temp >= MMI_BATTERY_TEMP_WARNING;
        s_warning[WARN_HEALTH] = health_is_bad(info->batteryHealth);
        if (s_warning[WARN_LOW_BATTERY] && battery_low_over(info, s_warnedLevel))
            s_warning[WARN_LOW_BATTERY] = false;
        show_warnings();
    }
    int charging = mmi_battery_is_charging(info);
    if (charging != s_lastCharging) {
        if (s_lastCharging != -1 && g_bCurrentSleepStatus == 1) SetIdleWakeupStatus(0);
        s_lastCharging = charging;
        translate(charging ? "BatteryCharging_Charging" : "BatteryCharging_Null", text,
                  sizeof text);
        g_powerOps.title_show(text, 0, 0);
        GetLastInputTime();
    }
    AutoSleepCheck();
}

void batteryVoltobserver_cb(const FTX_BATTERY_INFO *info) {
    char text[FTX_CFG_TEXT_SIZE];
    translate("batteryLevelWaring", text, sizeof text);
    LOGD("SendMessage MSG_CREATEDIALG BATTERYMSG:%s", text);
    FTX_BATTERY_INFO last;
    if (info) {
        last = *info;
    } else {
        mmi_battery_snapshot(&last);
    }
    {
        std::lock_guard<std::mutex> warn(s_warnMutex);
        s_warning[WARN_LOW_BATTERY] = true;
        s_warnedLevel = last.batteryLevel;
        show_warnings();
    }
    if (g_powerOps.unregister_observer) {
        LOGD("FTX_API_BatteryService_unregister_Observer batteryVoltobserver_cb start");
        g_powerOps.unregister_observer(FTX_BATTERY_OBSERVER_VOLTAGE, batteryVoltobserver_cb);
        LOGD("FTX_API_BatteryService_unregister_Observer batteryVoltobserver_cb end");
    }
}

int mmi_PowerOffEntry(void) {
    __android_log_print(ANDROID_LOG_DEBUG, "FTX_MAIN", "%s begin", "mmi_PowerOffEntry");
    if (hw::ftx_api_ftx_mode_uninit) hw::ftx_api_ftx_mode_uninit();
    dev_sync();
    dev_reboot(LINUX_REBOOT_CMD_POWER_OFF);
    return 1;
}

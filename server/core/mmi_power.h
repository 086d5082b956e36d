// Idle permission, screen sleep and wake, automatic power-off and the battery observers.
#pragma once

#include <atomic>

#include "hw/libdvk_ncoredevice.h"

// 1 while the screen is asleep.
extern std::atomic<int> g_bCurrentSleepStatus;
// Moment of the last user input, microseconds of the power clock.
extern std::atomic<long long> g_LastInputTime;

// The backlight file that sleep and wake write (the panel's own, not the configured one).
#define MMI_LCD_BRIGHTNESS_PATH "/sys/class/leds/lcd-backlight/brightness"
// Battery temperature at or above which the title strip warns (battery service unit).
#define MMI_BATTERY_TEMP_WARNING 450

// What power management reaches outside itself; tests replace it. Null hardware
// operations are skipped.
struct mmi_power_ops {
    long long (*clock_us)(void);  // the power clock
    int (*write_file)(const char *path, const char *text);
    int (*shell)(const char *cmd);
    void (*power_off)(void);  // sync and the power-off reboot; does not return on a handset
    int (*title_show)(const char *text, int index, int abnormalState);
    int (*mode_uninit)(void) = nullptr;
    int (*vibrator_start)(int ms) = nullptr;
    int (*lcd_refresh)(int arg) = nullptr;
    int (*unregister_observer)(int kind, FTX_BatteryObserver_cb cb) = nullptr;
};
// The operations in force; mmi_power_default_ops() gives the process's own.
extern mmi_power_ops g_powerOps;
mmi_power_ops mmi_power_default_ops(void);
// Forgets the battery record, the sleep state and the last seen charging state (tests).
void mmi_power_reset(void);

// The default clock: wall time at start-up plus the monotonic time since, divided by
// FTX_TIME_SCALE so that scaled runs reach the idle times sooner.
long long mmi_power_clock_us(void);

void GetLastInputTime(void);
// Seconds between now and the last input (microseconds ignored).
long compareTime_Minutes(void);

void Set_OsCanIdleAllowed(int allow);
int SetIdleWakeupStatus(int sleep);
int SwitchSleepStatus(void);
int AutoSleepCheck(void);
// The wake steps alone, without the checks and the sleep mutex (the aging run).
int FTX_API_SetIdleStatus(void);

int mmi_AutoTest_Standby_Enable(void);
int mmi_AutoTest_Standby_Disable(void);

// Appends text to path, syncs, reads back and compares; 0 on success.
int write_file(const char *path, const char *text);

void batteryTemperatureobserver_cb(const FTX_BATTERY_INFO *info);
void batteryVoltobserver_cb(const FTX_BATTERY_INFO *info);

// Copy of the last battery record; 0 when one has arrived, -1 otherwise (level then -1).
int mmi_battery_snapshot(FTX_BATTERY_INFO *out);
// 1 when the charger charges, or the battery is full while a charger is online.
int mmi_battery_is_charging(const FTX_BATTERY_INFO *info);

// The power-off dialog's first button: the device powers off.
int mmi_PowerOffEntry(void);

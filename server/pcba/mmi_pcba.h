// The PCBA run: the board-level checks a station starts from the PC on a bare board, one at
// a time. Each start ends a running check, binds the library's PCBA set and opens the PCBA
// window, whose creation runs the check: most checks answer through pcba_test_callback with
// an event that carries a value and a result flag; the camera checks take a picture; the Wgb
// check is a switch. The start waits for the answer (each check has its own time-out, scaled
// by FTX_TIME_SCALE) and the window shows the check, its progress, then the value and the
// verdict until the PC stops the check or starts another. The key check has its own run
// (PCBAKeyTestStart in the key tests).
#pragma once

#include "hw/lib_factory.h"

// Test numbers.
enum mmi_pcba_number {
    MMI_PCBA_NONE = 0,
    MMI_PCBA_CPU = 1,
    MMI_PCBA_MEMORY = 2,
    MMI_PCBA_BLUETOOTH = 4,
    MMI_PCBA_CAMERA_BACK = 5,
    MMI_PCBA_CAMERA_FRONT = 6,
    MMI_PCBA_BATTERY = 7,
    MMI_PCBA_WIFI = 8,
    MMI_PCBA_FM = 9,
    MMI_PCBA_GPS = 10,
    MMI_PCBA_TOUCH = 11,
    MMI_PCBA_STORAGE = 12,
    MMI_PCBA_SDCARD = 13,
    MMI_PCBA_SIM = 14,
    MMI_PCBA_WGB = 15,
};

// A value reply is never longer than this, whatever room the PC gives.
#define MMI_PCBA_REPLY_MAX 256

// Starts the check with that number and waits for its answer: 1 on a pass, else 0. The CPU,
// memory, storage and SD card checks write their value into reply (at most size and at most
// MMI_PCBA_REPLY_MAX bytes, the NUL included) once the board answered.
int mmi_pcba_start(int number, char *reply, unsigned int size);

// The starts by check.
int PCBACpuTestStart(char *reply, unsigned int size);
int PCBAMemoryTestStart(char *reply, unsigned int size);
int PCBABluetoothTestStart(char *reply, unsigned int size);
int PCBACameraBackTestStart(char *reply, unsigned int size);
int PCBACameraFrontTestStart(char *reply, unsigned int size);
int PCBABatteryTestStart(char *reply, unsigned int size);
int PCBAWifiTestStart(char *reply, unsigned int size);
int PCBAGpsTestStart(char *reply, unsigned int size);
int PCBATouchTestStart(char *reply, unsigned int size);
int PCBAStorageTestStart(char *reply, unsigned int size);
int PCBASdcardTestStart(char *reply, unsigned int size);
int PCBAFmTestStart(const char *parm, int len, char *reply, unsigned int size);
int PCBASimTestStart(const char *parm, int len, char *reply, unsigned int size);
int PCBAWgbTestStart(const char *parm, int len, char *reply, unsigned int size);

// Ends the running check: the library's stop of its number (the Wgb switch turned off), the
// number cleared, the window closed; 1, at once when no check runs.
int PCBATestStop(void);

// The camera-ID check of camera 3 when parm holds a "3", else of camera 2; 1 when it answers.
int ReadCameraIDTestStart(const char *parm, int len, char *reply, unsigned int size);

// The library's PCBA events (its own thread).
void pcba_test_callback(module_data *data);

// The running check's number (MMI_PCBA_NONE when none).
int mmi_pcba_current(void);

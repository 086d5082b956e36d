/* The handset's core-device library, libdvk_ncoredevice.so: the battery service, the PC
 * command channel, the channel's file operations and the Wi-Fi-to-PC link switch.
 * Unless said otherwise an operation returns 0 on success and non-zero on failure. */
#ifndef FTX_HW_LIBDVK_NCOREDEVICE_H
#define FTX_HW_LIBDVK_NCOREDEVICE_H

#ifdef __cplusplus
extern "C" {
#endif

/* ---- battery service ---- */

/* Battery status values (Android's). */
#define FTX_BATTERY_STATUS_UNKNOWN 1
#define FTX_BATTERY_STATUS_CHARGING 2
#define FTX_BATTERY_STATUS_DISCHARGING 3
#define FTX_BATTERY_STATUS_NOT_CHARGING 4
#define FTX_BATTERY_STATUS_FULL 5

/* Battery health values (Android's). */
#define FTX_BATTERY_HEALTH_UNKNOWN 1
#define FTX_BATTERY_HEALTH_GOOD 2
#define FTX_BATTERY_HEALTH_OVERHEAT 3
#define FTX_BATTERY_HEALTH_DEAD 4
#define FTX_BATTERY_HEALTH_OVER_VOLTAGE 5
#define FTX_BATTERY_HEALTH_UNSPECIFIED_FAILURE 6
#define FTX_BATTERY_HEALTH_COLD 7

/* What every observer call carries. */
typedef struct {
    unsigned char chargerAcOnline;
    unsigned char chargerUsbOnline;
    unsigned char chargerWirelessOnline;
    unsigned char batteryPresent;
    int batteryStatus;      /* FTX_BATTERY_STATUS_... */
    int batteryHealth;      /* FTX_BATTERY_HEALTH_... */
    int batteryLevel;       /* percent, 0..100 */
    int batteryVoltage;     /* millivolts */
    int batteryTemperature; /* tenths of a degree Celsius (450 is 45.0 C) */
} FTX_BATTERY_INFO;

/* Observer kinds:
 * TEMPERATURE observers are called every second (scaled by FTX_TIME_SCALE) while the
 * service runs;
 * VOLTAGE observers are called every second while the level is at or below the low-level
 * threshold and no charger is online (a low-battery warning). */
#define FTX_BATTERY_OBSERVER_TEMPERATURE 0
#define FTX_BATTERY_OBSERVER_VOLTAGE 1

/* Called on the service's own thread; info is valid during the call only. An observer may
 * unregister itself (or another) from inside the call. */
typedef void (*FTX_BatteryObserver_cb)(const FTX_BATTERY_INFO *info);

/* Registering the same (kind, cb) twice keeps one registration. */
int FTX_API_BatteryService_register_Observer(int kind, FTX_BatteryObserver_cb cb);
int FTX_API_BatteryService_unregister_Observer(int kind, FTX_BatteryObserver_cb cb);
int FTX_API_BatteryService_StartService(void);
int FTX_API_BatteryService_StopService(void);
/* 1 lets the charger charge, 0 stops charging (status becomes "not charging"). */
int FTX_API_BatteryService_ChargingStatusSet(int enable);

/* ---- PC command channel ---- */

/* Reply buffer size the channel hands to the command callback. */
#define FTX_AT_REPLY_SIZE 65536
/* Longest command line (without its line end) the channel accepts. */
#define FTX_AT_LINE_MAX 4095

/* Called for each command line (NUL-terminated, without its line end) on the thread that
 * runs runSelectLoopMode. reply starts empty (what earlier commands wrote is cleared);
 * whatever text the callback leaves in it is sent back. Returns 0, 2 or 3, sent to the PC
 * as the result. */
typedef int (*FTX_AtCommandProcess_cb)(const char *cmdString, char *reply, unsigned int replySize);

/* Opens the listening socket: TCP 127.0.0.1:$FTX_PC_PORT, else [pc] port of sim/device.ini
 * ($FTX_PC_BIND may name another bind address). */
int registerAtSocket(void);
/* Closes the socket and makes runSelectLoopMode return. */
int UnregisterAtSocket(void);
int registerCommandProcess(FTX_AtCommandProcess_cb cb);
/* Serves the socket on the calling thread until UnregisterAtSocket; returns 0 then. */
int runSelectLoopMode(void);

/* ---- file operations of the "FileOptMoudle" commands (formats: docs/hardware.md) ----
 * Read and Write answer into the reply of the command being served when called from the
 * command callback; Remove answers into reply. All return 1 on success, 0 on failure. */
int mmi_AutoTest_FileOpt_Read(const char *parm, int parmLen);
int mmi_AutoTest_FileOpt_Write(const char *parm, int parmLen);
int mmi_AutoTest_FileOpt_Remove(const char *parm, int parmLen, char *reply, unsigned int replySize);

/* Switch the Wi-Fi link to the PC; return 1 on success, 0 on failure. */
int mmi_AutoTest_WiFiConCpt_Enable(void);
int mmi_AutoTest_WiFiConCpt_Disable(void);

#ifdef __cplusplus
}
#endif
#endif

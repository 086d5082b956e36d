// The Wi-Fi link to the factory's test network: the settings, the connection thread that
// joins the network through the supplicant's control interface and shows the address as a
// QR code, the link monitor, the end of the link, and the PC's Wi-Fi commands (switching
// the network, RSSI, access-point information, the UDP echo service). Each Wi-Fi thread ends
// when it is sent SIGUSR1; the main window hears of link changes through MSG_CALLBACK (the
// link came up or changed) and MSG_TIMER 1 (the link went down: redraw the bars).
#pragma once

#include <stddef.h>

// Size of the address text and of each setting.
#define MMI_WIFI_TEXT_SIZE 256
// The UDP echo service's port and its largest datagram.
#define MMI_WIFI_UDP_PORT 3536
#define MMI_WIFI_UDP_MAX 256

// The Wi-Fi threads, for mmi_wifi_probe_thread.
#define MMI_WIFI_CON_THREAD 0
#define MMI_WIFI_UDP_THREAD 1
#define MMI_WIFI_MONITOR_THREAD 2

// Reads the settings ("MMI" / "WiFiCtrlParameter"; the SSID from
// /cache/pv_wifi_switch_ssid.cfg when it can be opened); 0.
int MMI_WiFi_GetConfigParas(void);
// Starts the connection thread in normal mode; 0, -1 when it cannot be created.
int WiFiConThreadStart(void);
// The connection procedure; arg is the quiet flag (1: longer waits, no QR code, no message).
void *WiFiConThread(void *arg);
// Ends the network and the link; mode 1 is quiet (no monitor stop, no message). 0.
int wifi_close_thread(int mode);
// Starts the link monitor; 0, -1 when it cannot be created.
int wifi_status_monitor_thread_start(void);
void *wifi_status_monitor_thread(void *arg);
// The IPv4 address of "wlan0" into text (MMI_WIFI_TEXT_SIZE bytes); 0, or -1.
int get_ipaddr(char *text);
// Reads the address again: when it changed, a new QR code, the new address kept and 0;
// else -1.
int check_ipaddr(void);
// Leaves Wi-Fi for the RF test mode (the driver reloaded in its test mode); 0.
int wifi_disconnect(void);

// The PC's commands.
int mmi_AutoTest_WiFi_Enable(void);
int mmi_AutoTest_WiFi_Disable(void);
int mmi_AutoTest_SwitchSSID(const char *parm, int len, char *reply, unsigned int size);
int mmi_AutoTest_GetWiFiRSSI(const char *parm, int len, char *reply, unsigned int size);
int mmi_AutoTest_GetAPInfo(const char *parm, int len, char *reply, unsigned int size);
int mmi_Autotest_WiFiUDPServ_Enable(const char *parm, int len, char *reply, unsigned int size);
int mmi_Autotest_WiFiUDPServ_Disable(const char *parm, int len, char *reply, unsigned int size);

// What the main window asks.
// Link state: 0 before any attempt, 1 down or failed, 2 up with an address.
int mmi_wifi_link_state(void);
// "wifi_init" of the settings.
int mmi_wifi_init_flag(void);
// Whether the main window shows the link's QR picture.
int mmi_wifi_picture_enabled(void);
// Probes a Wi-Fi thread as signal 0 would: 0 alive, ESRCH none.
int mmi_wifi_probe_thread(int which);
// The current address text ("" before the first link).
void mmi_wifi_address(char *out, size_t size);

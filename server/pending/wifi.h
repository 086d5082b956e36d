// The Wi-Fi control, as the main window reaches it; stand-ins until it lands.
#pragma once

// Link state: 0 idle, 1 down, 2 up.
int mmi_wifi_link_state(void);
int mmi_wifi_init_flag(void);  // "wifi_init" of the Wi-Fi settings
int mmi_wifi_picture_enabled(void);
int MMI_WiFi_GetConfigParas(void);
int WiFiConThreadStart(void);
int wifi_close_thread(int mode);
int wifi_status_monitor_thread_start(void);
// Probes a Wi-Fi thread with signal 0: 0 alive, ESRCH none, EINVAL a bad handle.
#define MMI_WIFI_CON_THREAD 0
#define MMI_WIFI_UDP_THREAD 1
#define MMI_WIFI_MONITOR_THREAD 2
int mmi_wifi_probe_thread(int which);

// What the main window calls in parts that are built elsewhere: the test screens, the
// aging test, the coupling screen and the Wi-Fi control. Until a part lands, its
// functions are weak stand-ins (mmi_hub_pending.cpp) that log that it is not there yet.
#pragma once

#include <atomic>

// Menu rows and dialog actions; the result is not used.
#include "screens/mmi_devicetest.h"
#include "screens/mmi_infoscreen.h"
#include "session/mmi_monomer.h"
int mmi_testwnd_Coupling_Entry(void);
int mmi_AgingTestEntry(void);
int mmi_AgingTest_Start_Entry(void);
void *mmi_AgingTest_Wnd_Thread(void *arg);

// Wi-Fi control. Link state: 0 idle, 1 down, 2 up.
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

#include "pending/wifi.h"

#include <errno.h>

#include "pending/pending.h"

MMI_PENDING(int, MMI_WiFi_GetConfigParas, (void), 0, "DVK_FTX")
MMI_PENDING(int, WiFiConThreadStart, (void), -1, "DVK_FTX")
MMI_PENDING(int, wifi_close_thread, (int), 0, "DVK_FTX")
MMI_PENDING(int, wifi_status_monitor_thread_start, (void), -1, "DVK_FTX")

// Quiet ones: the hub asks these every second.
int mmi_wifi_link_state(void) {
    return 0;
}
int mmi_wifi_init_flag(void) {
    return 0;
}
int mmi_wifi_picture_enabled(void) {
    return 0;
}
int mmi_wifi_probe_thread(int) {
    return ESRCH;
}

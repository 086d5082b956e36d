// The Wi-Fi commands: the link on and off, switching the network, RSSI and access-point
// information, the UDP echo service and the driver's data-rate dump.
#include <stdio.h>

#include <android/log.h>

#include "adbd_connection/handlers/common.h"
#include "adbd_connection/handlers/handlers.h"
#include "devfs.h"
#include "wifi/mmi_wifi.h"

int WiFiDataRate_set(const char *parm, int, char *, unsigned int) {
    at_log_parm(__func__, parm);
    // The parameter goes into a shell line: anything but plain words is refused.
    if (!at_is_plain_argument(parm)) {
        __android_log_print(ANDROID_LOG_ERROR, AT_TAG, "%s::refused parameter %s", __func__, parm);
        return 1;
    }
    char line[64];
    snprintf(line, sizeof(line), "iwpriv wlan0 dump %s", parm);
    dev_system(line);
    return 1;
}

int AutoTest_WiFi_Enable(const char *, int, char *, unsigned int) {
    at_log_begin(__func__);
    return mmi_AutoTest_WiFi_Enable();
}

int AutoTest_WiFi_Disable(const char *, int, char *, unsigned int) {
    at_log_begin(__func__);
    return mmi_AutoTest_WiFi_Disable();
}

// The workers that take all four arguments.
#define WIFI_WORKER(handler, worker)                                              \
    int handler(const char *parm, int len, char *reply, unsigned int replySize) { \
        at_log_parm(__func__, parm);                                              \
        return worker(parm, len, reply, replySize);                               \
    }
WIFI_WORKER(AutoTest_SwitchSSID, mmi_AutoTest_SwitchSSID)
WIFI_WORKER(AutoTest_GetWiFiRSSI, mmi_AutoTest_GetWiFiRSSI)
WIFI_WORKER(AutoTest_GetAPInfo, mmi_AutoTest_GetAPInfo)
WIFI_WORKER(WiFiUDPServ_Enable, mmi_Autotest_WiFiUDPServ_Enable)
WIFI_WORKER(WiFiUDPServ_Disable, mmi_Autotest_WiFiUDPServ_Disable)
#undef WIFI_WORKER

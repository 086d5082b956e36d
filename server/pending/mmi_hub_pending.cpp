// Weak stand-ins for what the main window calls in parts not built yet; each logs at
// error priority that it is not available. A part that lands defines the real function
// and this file loses its line.
#include <android/log.h>
#include <errno.h>

#include "hub/mmi_hub_links.h"

#define PENDING(ret, fn, args, value, tag)                                         \
    __attribute__((weak)) ret fn args {                                            \
        __android_log_print(ANDROID_LOG_ERROR, tag, "%s: not available yet", #fn); \
        return value;                                                              \
    }

PENDING(int, mmi_testwnd_Coupling_Entry, (void), 0, "FTX_MAIN")
PENDING(int, mmi_AgingTestEntry, (void), 0, "AgingTest")
PENDING(int, mmi_AgingTest_Start_Entry, (void), 0, "AgingTest")
PENDING(void *, mmi_AgingTest_Wnd_Thread, (void *), nullptr, "AgingTest")
PENDING(int, MMI_WiFi_GetConfigParas, (void), 0, "DVK_FTX")
PENDING(int, WiFiConThreadStart, (void), -1, "DVK_FTX")
PENDING(int, wifi_close_thread, (int), 0, "DVK_FTX")
PENDING(int, wifi_status_monitor_thread_start, (void), -1, "DVK_FTX")

// Quiet ones: the hub asks these every second.
__attribute__((weak)) int mmi_wifi_link_state(void) {
    return 0;
}
__attribute__((weak)) int mmi_wifi_init_flag(void) {
    return 0;
}
__attribute__((weak)) int mmi_wifi_picture_enabled(void) {
    return 0;
}
__attribute__((weak)) int mmi_wifi_probe_thread(int) {
    return ESRCH;
}

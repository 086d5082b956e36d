// The Wi-Fi driver's data-rate dump.
#include <stdio.h>

#include <android/log.h>

#include "adbd_connection/handlers/common.h"
#include "adbd_connection/handlers/handlers.h"
#include "core/mmi_loglevel.h"
#include "devfs.h"

int WiFiDataRate_set(const char *parm, int, char *, unsigned int) {
    MMI_LOGD(AT_TAG, "%s begin,bufIn=%s", __func__, parm);
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

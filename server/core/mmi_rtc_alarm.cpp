// The RTC alarm through its sysfs file, and the suspend through the power state file.
#include "core/mmi_rtc_alarm.h"

#include <android/log.h>
#include <devfs.h>
#include <errno.h>
#include <math.h>
#include <stdio.h>
#include <string.h>
#include <time.h>
#include <tp_os.h>

#define TAG "RTC_ALARM"
#define LOGD(...) __android_log_print(ANDROID_LOG_DEBUG, TAG, __VA_ARGS__)
#define LOGE(...) __android_log_print(ANDROID_LOG_ERROR, TAG, __VA_ARGS__)

namespace {

const char kWakealarm[] = "/sys/class/rtc/rtc0/wakealarm";
const char kPowerState[] = "/sys/power/state";

// One write of text into a kernel file: the driver sees it when the stream is closed.
int write_kernel_file(const char *path, const char *text) {
    FILE *f = dev_fopen(path, "w");
    if (f == nullptr) {
        LOGE("open %s fail,errno=%d", path, errno);
        return -1;
    }
    const bool put = fputs(text, f) >= 0;
    errno = 0;
    if (fclose(f) != 0 || !put) {
        LOGE("write \"%s\" into %s fail,errno=%d", text, path, errno);
        return -1;
    }
    return 0;
}

}  // namespace

int mmi_rtc_set_wakealarm(int seconds) {
    if (seconds < 1) {
        LOGE("%s: bad seconds %d", __func__, seconds);
        return -1;
    }
    // A scaled alarm still lies in the future: the RTC counts whole seconds. (The product's
    // rounding error, 700 * 0.01 = 7.000000000000001, must not add a second.)
    long long scaled = (long long)ceil(seconds * tp_os_time_scale() - 1e-9);
    if (scaled < 1) scaled = 1;
    // The kernel's clock, not time()'s, which may lag a few milliseconds behind it.
    struct timespec now;
    clock_gettime(CLOCK_REALTIME, &now);
    const long long at = (long long)now.tv_sec + scaled;
    // The kernel refuses a new alarm while one is armed.
    if (write_kernel_file(kWakealarm, "0") != 0) return -1;
    char text[32];
    snprintf(text, sizeof(text), "%lld", at);
    if (write_kernel_file(kWakealarm, text) != 0) return -1;
    LOGD("%s: %d s (%lld s scaled), alarm at %lld", __func__, seconds, scaled, at);
    return 0;
}

int mmi_rtc_clear_wakealarm(void) {
    if (write_kernel_file(kWakealarm, "0") != 0) return -1;
    LOGD("%s: cleared", __func__);
    return 0;
}

long long mmi_rtc_get_wakealarm(void) {
    FILE *f = dev_fopen(kWakealarm, "r");
    if (f == nullptr) return 0;
    long long at = 0;
    if (fscanf(f, "%lld", &at) != 1 || at < 0) at = 0;
    fclose(f);
    return at;
}

int mmi_system_suspend(void) {
    LOGD("%s: suspend, alarm at %lld", __func__, mmi_rtc_get_wakealarm());
    // The write returns once the handset has resumed.
    if (write_kernel_file(kPowerState, "mem") != 0) return -1;
    LOGD("%s: resumed", __func__);
    return 0;
}

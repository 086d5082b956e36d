// Whether the log keeps entries of a priority. Hot paths (the command parser logs every
// table row it looks at) test it first so that filtered debug lines cost no formatting.
#pragma once

#include <android/log.h>

// 1 when the log keeps entries of prio, else 0.
int mmi_log_enabled(int prio);

// __android_log_print at debug priority, skipped when debug entries are filtered.
#define MMI_LOGD(tag, ...)                                            \
    do {                                                              \
        if (mmi_log_enabled(ANDROID_LOG_DEBUG))                       \
            __android_log_print(ANDROID_LOG_DEBUG, tag, __VA_ARGS__); \
    } while (0)

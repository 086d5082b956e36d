// Stand-ins for the functions of parts not built yet. Each logs at error priority that its
// part is not available and returns what "nothing happened" means to its caller. A part that
// lands defines the real function, deletes the stand-in (a leftover one then fails the link)
// and moves the declaration into its own header.
#pragma once

#include <android/log.h>

#define MMI_PENDING(ret, fn, args, value, tag)                                     \
    ret fn args {                                                                  \
        __android_log_print(ANDROID_LOG_ERROR, tag, "%s: not available yet", #fn); \
        return value;                                                              \
    }

// A test entry and stop whose window does not exist yet.
#define MMI_PENDING_ENTRY(fn, tag)                                                      \
    void *fn(void) {                                                                    \
        __android_log_print(ANDROID_LOG_ERROR, tag, "%s: test not available yet", #fn); \
        return (void *)-1; /* HWND_INVALID */                                           \
    }
#define MMI_PENDING_STOP(fn, tag)                                                       \
    int fn(void) {                                                                      \
        __android_log_print(ANDROID_LOG_ERROR, tag, "%s: test not available yet", #fn); \
        return 0;                                                                       \
    }

// Their declarations, from the same per-area lists.
#define MMI_DECLARE_ENTRY(fn, tag) void *fn(void);
#define MMI_DECLARE_STOP(fn, tag) int fn(void);

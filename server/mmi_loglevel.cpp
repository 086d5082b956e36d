#include "mmi_loglevel.h"

#include <ctype.h>
#include <stdlib.h>
#include <string.h>

#include <atomic>

namespace {

std::atomic<int> g_floor{-1};

// The log's own reading of FTX_LOG_LEVEL: a number, or a priority letter (V D I W E F S).
int read_floor() {
    const char *s = getenv("FTX_LOG_LEVEL");
    if (s == nullptr || *s == '\0') return ANDROID_LOG_VERBOSE;
    if (isdigit(static_cast<unsigned char>(s[0]))) return atoi(s);
    static const char kLetters[] = "??VDIWEFS";
    const char *hit = strchr(kLetters + 2, toupper(static_cast<unsigned char>(s[0])));
    return hit != nullptr ? static_cast<int>(hit - kLetters) : ANDROID_LOG_VERBOSE;
}

}  // namespace

int mmi_log_enabled(int prio) {
    int floor = g_floor.load(std::memory_order_relaxed);
    if (floor < 0) {
        floor = read_floor();
        g_floor.store(floor, std::memory_order_relaxed);
    }
    return prio >= floor;
}

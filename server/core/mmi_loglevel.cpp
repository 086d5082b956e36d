#include "core/mmi_loglevel.h"

int mmi_log_enabled(int prio) {
    return __android_log_is_loggable(prio, "", ANDROID_LOG_VERBOSE);
}

#include "adbd_connection/handlers/common.h"

#include <ctype.h>
#include <string.h>

#include "core/mmi_loglevel.h"
#include "devfs.h"

void at_log_begin(const char *name) {
    MMI_LOGD(AT_TAG, "%s begin", name);
}

void at_log_parm(const char *name, const char *parm) {
    MMI_LOGD(AT_TAG, "%s begin,bufIn=%s", name, parm != nullptr ? parm : "");
}

int at_run_shell(const char *name, const char *line) {
    at_log_begin(name);
    dev_system(line);
    return 1;
}

bool at_is_plain_argument(const char *s) {
    for (; *s != '\0'; s++) {
        unsigned char c = static_cast<unsigned char>(*s);
        if (!isalnum(c) && strchr(" ._,:=-", c) == nullptr) return false;
    }
    return true;
}

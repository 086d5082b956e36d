// The result record: "<item>,read" or "<item>,<result>,write".
#include <string.h>

#include "adbd_connection/handlers/common.h"
#include "adbd_connection/handlers/handlers.h"
#include "core/mmi_loglevel.h"
#include "session/mmi_testinfo.h"

int AutoTest_testinfo(const char *parm, int parmLen, char *reply, unsigned int replySize) {
    if (parmLen < 1) return 0;
    if (strstr(parm, "read") != nullptr) {
        MMI_LOGD(AT_TAG, "%s begin:bufIn=%s", "AutoTest_testinfo_Read", parm);
        return mmi_AutoTest_testinfo_Read(parm, parmLen, reply, replySize);
    }
    if (strstr(parm, "write") != nullptr) {
        MMI_LOGD(AT_TAG, "%s begin:bufIn=%s", "AutoTest_testinfo_Write", parm);
        return mmi_AutoTest_testinfo_Write(parm, parmLen);
    }
    return 0;
}

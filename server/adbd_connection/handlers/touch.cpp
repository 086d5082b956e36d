// The touch screen's commands: the PC opens the frame (or the rings) and its close answers
// whether every cell was touched.
#include "adbd_connection/handlers/common.h"
#include "adbd_connection/handlers/handlers.h"
#include "testwnd/touch/mmi_testwnd_touch.h"

int AutoTest_touchscreen_Start(const char *, int, char *, unsigned int) {
    at_log_begin(__func__);
    return mmi_AutoTest_touchscreenTest_Entry();
}

int AutoTest_touchscreen_Stop(const char *, int, char *, unsigned int) {
    at_log_begin(__func__);
    return mmi_AutoTest_touchscreenTest_Stop_Entry();
}

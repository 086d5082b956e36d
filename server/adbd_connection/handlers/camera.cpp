// The camera commands: open, snapshot and close of the front, back and second back cameras.
#include "adbd_connection/handlers/common.h"
#include "adbd_connection/handlers/handlers.h"
#include "testwnd/camera/mmi_testwnd_camera.h"

#define CAMERA_HANDLERS(cam, Name)                                                           \
    int AutoTest_##cam##camera_Start(const char *, int, char *, unsigned int) {              \
        at_log_begin(__func__);                                                              \
        return mmi_AutoTest_Camera##Name##TestEntry();                                       \
    }                                                                                        \
    int AutoTest_##cam##camera_Snapshot(const char *, int, char *reply, unsigned int size) { \
        at_log_begin(__func__);                                                              \
        return mmi_AutoTest_Camera##Name##Test_Snapshot_Entry(reply, size);                  \
    }                                                                                        \
    int AutoTest_##cam##camera_Stop(const char *, int, char *, unsigned int) {               \
        at_log_begin(__func__);                                                              \
        return mmi_AutoTest_Camera##Name##Test_Stop_Entry();                                 \
    }

CAMERA_HANDLERS(front, Front)
CAMERA_HANDLERS(back, Back)
CAMERA_HANDLERS(auxback, AuxBack)

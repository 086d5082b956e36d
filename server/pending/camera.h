// Stand-ins for the camera and light tests (the back, second back and front cameras, all the
// lights) until each window exists. An entry logs at error priority that its test is not available
// and opens nothing; a family that lands takes its lines out of this list.
#pragma once

#include "pending/pending.h"

#define MMI_PENDING_CAMERA(ENTRY, STOP)                                    \
    ENTRY(mmi_testwnd_CameraBackTestEntry, "FTX_CAMERA_BACK")              \
    STOP(mmi_AutoTest_CameraBackTest_Stop_Entry, "FTX_CAMERA_BACK")        \
    ENTRY(mmi_testwnd_CameraAuxBackTestEntry, "FTX_AUX_CAMERA_BACK")       \
    STOP(mmi_AutoTest_CameraAuxBackTest_Stop_Entry, "FTX_AUX_CAMERA_BACK") \
    ENTRY(mmi_testwnd_CameraFrontTestEntry, "FTX_CAMERA_FRONT")            \
    STOP(mmi_AutoTest_CameraFrontTest_Stop_Entry, "FTX_CAMERA_FRONT")      \
    ENTRY(mmi_testwnd_AllLightTestEntry, "FTX_ALLLIGHT")                   \
    STOP(mmi_testwnd_AllLightTest_Stop_Entry, "FTX_ALLLIGHT")

MMI_PENDING_CAMERA(MMI_DECLARE_ENTRY, MMI_DECLARE_STOP)

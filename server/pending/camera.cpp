// Stand-ins of the camera tests.
#include "pending/camera.h"

#include "pending/pending.h"

MMI_PENDING_ENTRY(mmi_testwnd_CameraBackTestEntry, "FTX_CAMERA_BACK")
MMI_PENDING_STOP(mmi_AutoTest_CameraBackTest_Stop_Entry, "FTX_CAMERA_BACK")
MMI_PENDING_ENTRY(mmi_testwnd_CameraAuxBackTestEntry, "FTX_AUX_CAMERA_BACK")
MMI_PENDING_STOP(mmi_AutoTest_CameraAuxBackTest_Stop_Entry, "FTX_AUX_CAMERA_BACK")
MMI_PENDING_ENTRY(mmi_testwnd_CameraFrontTestEntry, "FTX_CAMERA_FRONT")
MMI_PENDING_STOP(mmi_AutoTest_CameraFrontTest_Stop_Entry, "FTX_CAMERA_FRONT")
MMI_PENDING_ENTRY(mmi_testwnd_AllLightTestEntry, "FTX_ALLLIGHT")
MMI_PENDING_STOP(mmi_testwnd_AllLightTest_Stop_Entry, "FTX_ALLLIGHT")

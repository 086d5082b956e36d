// The camera and light tests: the back, second back and front cameras and all the lights: stand-ins
// until each window exists. An entry logs at error priority that its test is not available and
// opens nothing.
#pragma once

void *mmi_testwnd_CameraBackTestEntry(void);  // FTX_CAMERA_BACK
int mmi_AutoTest_CameraBackTest_Stop_Entry(void);
void *mmi_testwnd_CameraAuxBackTestEntry(void);  // FTX_AUX_CAMERA_BACK
int mmi_AutoTest_CameraAuxBackTest_Stop_Entry(void);
void *mmi_testwnd_CameraFrontTestEntry(void);  // FTX_CAMERA_FRONT
int mmi_AutoTest_CameraFrontTest_Stop_Entry(void);
void *mmi_testwnd_AllLightTestEntry(void);  // FTX_ALLLIGHT
int mmi_testwnd_AllLightTest_Stop_Entry(void);

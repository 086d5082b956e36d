// The camera tests (back, second back, front): a live preview of the camera's picture that
// the operator judges, and snapshots saved under /data/ftx_camera/. One window procedure
// serves the three cameras from a table.
#pragma once

#include "mmi_msg.h"

// The menu's and the run's entries.
void *mmi_testwnd_CameraBackTestEntry(void);
void *mmi_testwnd_CameraAuxBackTestEntry(void);
void *mmi_testwnd_CameraFrontTestEntry(void);
// Stop entries, also the PC's close: the camera's window closed; 1 when its preview ran.
int mmi_AutoTest_CameraBackTest_Stop_Entry(void);
int mmi_AutoTest_CameraAuxBackTest_Stop_Entry(void);
int mmi_AutoTest_CameraFrontTest_Stop_Entry(void);
// The PC's open: the window, PC-driven (it never closes by itself); 1 when the camera started.
int mmi_AutoTest_CameraBackTestEntry(void);
int mmi_AutoTest_CameraAuxBackTestEntry(void);
int mmi_AutoTest_CameraFrontTestEntry(void);
// The PC's snapshot of the open window's camera: reply "*" and the picture's device path;
// 1 when the picture was saved.
int mmi_AutoTest_CameraBackTest_Snapshot_Entry(char *reply, unsigned int size);
int mmi_AutoTest_CameraAuxBackTest_Snapshot_Entry(char *reply, unsigned int size);
int mmi_AutoTest_CameraFrontTest_Snapshot_Entry(char *reply, unsigned int size);

// A camera's board check without a window (the PCBA run): the camera (FTX_CAMERA_...)
// started, one picture taken to /data/ftx_camera/pcba_<camera>.png, the camera stopped.
// out gets what happened, ending in "success" when every step went well; 0 then, else -1.
int mmi_camera_check(int camera, char *out, unsigned int size);

// Where the window draws, in a client area of w x h with text lines lineHeight high: the
// note line at the top, the largest upright 3:4 preview box centred below it, and the
// snapshot's status line under the box.
struct mmi_camera_layout {
    RECT note;
    RECT preview;
    RECT status;
};
void mmi_camera_layout_for(int w, int h, int lineHeight, mmi_camera_layout *out);

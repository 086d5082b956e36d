// The touch tests the finger fills: the frame of cells along the screen edge, or on a round
// screen the sectors of two rings. Run by the operator, in the monomer preview and by the PC.
#pragma once

#include "mmi_msg.h"

// Result item of every touch test.
#define MMI_TOUCH_RESULT 320

void *mmi_testwnd_touchTestEntry(void);
void *mmi_testwnd_touch_circlegrid_Entry(void);
void *mmi_testwnd_Monomer_touchTestEntry(void);
int mmi_testwnd_Monomer_touchscreenTest_Stop(void);

// PC start (the frame or the rings, as the screen's shape says) and stop: 1 when every
// cell or sector was touched.
int mmi_AutoTest_touchscreenTest_Entry(void);
int mmi_AutoTest_touchscreenTest_Stop_Entry(void);
int RectangleTouch_Start(void);
int circleTouch_Start(void);
int circleTouch_Stop(void);

// 0 for a key that may end the touch test (power, back, home, volume up and down, menu),
// else -1.
int Check_TouchTest_StopKeyVal(int key);
// Reads the item's configuration: the stop key and the cell length.
void mmi_touch_read_config(void);

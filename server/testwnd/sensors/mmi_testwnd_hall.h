// The two hall sensor tests: the window passes by itself once the magnet was seen to come
// and go. The PC drives the first one.
#pragma once

#include "hw/lib_factory.h"
#include "mmi_msg.h"

void *mmi_testwnd_HallSensorTestEntry(void);
int mmi_testwnd_HallSensorTest_Stop_Entry(void);
void *mmi_testwnd_HallTest_2nd_TestEntry(void);
int mmi_testwnd_HallTest_2nd_Stop_Entry(void);
// The library's reports (its own thread).
void hallsensor_test_callback(module_data *data);
void hall_2nd_test_callback(module_data *data);

// PC open; the close answers 1 when the magnet came and went (reply "*state=1"), -1 with no
// window open.
int mmi_AutoTest_HallSensorTestEntry(void);
int mmi_AutoTest_HallSensorTest_Stop_Entry(char *reply, unsigned int size);

// The force-touch tests, driven by the PC: the pressed force against the configured
// threshold, the calibration (its result kept on the device for the read-out) and the
// comprehensive test.
#pragma once

#include "hw/lib_factory.h"
#include "mmi_msg.h"

// Where the last good calibration's result is kept ("result=pass;value=N").
#define MMI_FORCETOUCH_CAL_FILE "/data/ftx_forcetouch_calibration"

// The library's reports (its own thread).
void force_touch_test_callback(module_data *data);
void force_touch_calibration_callback(module_data *data);
void force_touch_comprehensive_callback(module_data *data);

// Opens the force window (PC-driven); 1, 0 when it could not open.
int mmi_automated_force_touch_sensor_test_entry(void);
// Closes it: 1 when the threshold was reached, 0 when not or when none was open.
int mmi_automated_force_touch_sensor_test_stop(void);
// Opens the calibration window with the weight in grams (parm, may be empty) and waits for
// the library's result: 1 on a pass (kept in MMI_FORCETOUCH_CAL_FILE), else 0.
int mmi_force_touch_sensor_calibration_entry(const char *parm);
int mmi_force_touch_sensor_calibration_stop(void);
// "*" and the kept calibration result; 0 when none was kept.
int mmi_force_touch_sensor_calibration_read(const char *parm, int parmLen, char *reply,
                                            unsigned int size);
// The comprehensive test: opens its window and waits for the result (1 on a pass).
int mmi_force_touch_sensor_comprehensive_test_entry(const char *parm);
int mmi_force_touch_sensor_comprehensive_test_stop(const char *parm);

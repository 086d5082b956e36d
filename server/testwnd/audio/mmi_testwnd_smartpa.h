// The smart amplifier's speaker calibration: the factory library measures the speaker and
// reports its impedance; the window shows it and passes only a good calibration.
#pragma once

#include "hw/lib_factory.h"

void *mmi_testwnd_SmartPACalEntry(void);
int mmi_testwnd_SmartPACal_Stop_Entry(void);
// PC: starts the calibration (1), answers "*<ohms>" once it passed (1) or 0 when it failed
// or did not answer in 5 seconds, and stops it.
int mmi_AutoTest_SmartPACalEntry(void);
int mmi_AutoTest_SmartPACal_Calibrate(char *reply, unsigned int size);
int mmi_AutoTest_SmartPACal_Stop_Entry(void);
void smartpa_cal_callback(module_data *data);

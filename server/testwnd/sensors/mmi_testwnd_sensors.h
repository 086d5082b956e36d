// The sensor test: one window with a line per configured sensor (acceleration, magnetic
// field, gyroscope, pressure, proximity, light, heart rate), and the PC's reads of single
// sensors, their calibration and the heart-rate sensor's self test.
#pragma once

#include "hw/lib_factory.h"
#include "mmi_msg.h"

void *mmi_testwnd_SensorsTestEntry(void);
int mmi_testwnd_SensorsTest_Stop_Entry(void);
// The library's reports (its own thread).
void sensors_test_callback(module_data *data);

// PC open and close of the window; the close answers "*acc=1;gyro=0..." and 1 when every
// sensor passed.
int mmi_AutoTest_SensorsTestEntry(char *reply, unsigned int size);
int mmi_AutoTest_SensorsTest_Stop_Entry(char *reply, unsigned int size);
// Calibrates every configured sensor that can be: "*acc=dx,dy,dz;gyro=..."; 1 when all did.
int mmi_AutoTest_SensorsTest_Calibrate_Entry(char *reply, unsigned int size);
// One sensor's current value: "*x,y,z" or "*v"; 1 when the library reported it.
int mmi_AutoTest_Acc_SensorTestEntry(char *reply, unsigned int size);
int mmi_AutoTest_Mag_SensorTestEntry(char *reply, unsigned int size);
int mmi_AutoTest_Gyro_SensorTestEntry(char *reply, unsigned int size);
int mmi_AutoTest_Pressure_SensorTestEntry(char *reply, unsigned int size);
int mmi_AutoTest_Heartrate_SensorTestEntry(char *reply, unsigned int size);
int mmi_read_proximity_start(char *reply, unsigned int size);
int mmi_read_light_start(char *reply, unsigned int size);
// "*1" and 1 when the heart-rate sensor's self test passes, "*0" and 0 when not.
int mmi_AutoTest_HeartrateSelfTest_SensorTestEntry(const char *parm, int parmLen, char *reply,
                                                   unsigned int size);

// The vibrator test: the motor runs while the window is open; the operator judges it.
#pragma once

void *mmi_testwnd_VibratorTestEntry(void);
int mmi_testwnd_VibratorTest_Stop_Entry(void);
// PC start and stop: mode -1 runs until stopped, a positive mode for that many milliseconds.
int mmi_AutoTest_VibratorTestEntry(int mode);
int mmi_AutoTest_VibratorTest_Stop_Entry(void);

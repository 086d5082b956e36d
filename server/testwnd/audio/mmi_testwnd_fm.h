// The FM radio test: the configured stations, tuned one at a time; the volume keys choose.
#pragma once

void *mmi_testwnd_FmTestEntry(void);
int mmi_testwnd_FmTest_Stop_Entry(void);
// PC: tunes frequency (100 kHz units; 0 tunes the first configured station).
int mmi_AutoTest_FMTest_Entry(int frequency);
int mmi_AutoTest_FMTest_Stop_Entry(void);

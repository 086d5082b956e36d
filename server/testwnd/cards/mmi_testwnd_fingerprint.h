// The fingerprint test: passes on a good finger; a bad one asks the operator to try again.
#pragma once

void *mmi_testwnd_FingerPrintTestEntry(void);
int mmi_testwnd_FingerPrintTest_Stop_Entry(void);
// The PC's open (the window waits for the PC's close) and close: 1 when the library's report
// passed; reply "*" and its text ("*none" when none came).
int mmi_AutoTest_FingerPrintTestEntry(void);
int mmi_AutoTest_FingerPrintTest_Stop_Entry(char *reply, unsigned int size);

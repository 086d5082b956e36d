// The main-microphone record test: a few seconds recorded through the factory library, then
// played back on the speaker for the operator to judge.
#pragma once

void *mmi_testwnd_MainMicRecordTestEntry(void);
int mmi_test_MainMicRecordTest_Stop_Entry(void);
// PC: records, then plays back (1), or 0 when either step fails.
int mmi_AutoTest_MainMicRecordTestEntry(const char *parm, int parmLen);
int mmi_AutoTest_MainMicRecordTest_Stop_Entry(void);

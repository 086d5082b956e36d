// The NFC test: passes once the reader reports a tag, whose identifier it shows.
#pragma once

void *mmi_testwnd_NfcTestEntry(void);
int mmi_testwnd_NfcTest_Stop_Entry(void);
// The PC's open (the window waits for the PC's close) and close: 1 when the library's report
// passed; reply "*" and its text ("*none" when none came).
int mmi_AutoTest_NfcTestEntry(void);
int mmi_AutoTest_NfcTest_Stop_Entry(char *reply, unsigned int size);

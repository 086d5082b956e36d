// The aging (burn-in) test as the main window reaches it: the start from the menu, the
// resume after a reboot the run caused, and the result list.
#pragma once

// Prepares and starts an aging run: texts, settings, the library's operations, the window
// and the run thread. 0, or -1 when it cannot start (an operation missing, a run active).
int mmi_AgingTest_Start_Entry(void);
// Thread body of the resume: waits until the main window is up, then starts the run, which
// takes its record over from the reboot marker.
void *mmi_AgingTest_Wnd_Thread(void *arg);
// Opens the aging result list; 0, or -1 when the window cannot be made.
int mmi_AgingTestEntry(void);

// The burn-in (aging) run, as the main window reaches it; stand-ins until it lands.
#pragma once

int mmi_AgingTestEntry(void);
int mmi_AgingTest_Start_Entry(void);
void *mmi_AgingTest_Wnd_Thread(void *arg);

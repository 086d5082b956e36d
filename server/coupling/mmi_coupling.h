// The main menu's coupling row: it opens the coupling test the configuration enables, or
// a list of both when both are. MAIN_UI "signalCouple" (default 1) enables the signalling
// test, FTX_NONSIGNAL "enable" the non-signalling one.
#pragma once

// 0 when a test or the list opened, -1 otherwise (nothing enabled, or the test refused).
int mmi_testwnd_Coupling_Entry(void);

// The RF coupling screen, as the main menu reaches it; a stand-in until it lands.
#pragma once

int mmi_testwnd_Coupling_Entry(void);

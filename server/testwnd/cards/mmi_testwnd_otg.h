// The USB OTG test: passes once the library reports a device plugged into the port.
#pragma once

void *mmi_testwnd_USBOTGTestEntry(void);
int mmi_testwnd_USBOTGTest_Stop_Entry(void);

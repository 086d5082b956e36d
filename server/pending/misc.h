// The battery test: stand-ins until each window exists.
// An entry logs at error priority that its test is not available and opens nothing.
#pragma once

void *mmi_testwnd_BatteryTestEntry(void);  // FTX_BATTERY
int mmi_testwnd_BatteryTest_Stop_Entry(void);

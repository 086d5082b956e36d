// The battery test: level, voltage, temperature, health and the charger, each against the
// item's limits, refreshed from the battery service; the window passes by itself once every
// value stayed inside for two refreshes. Also the PC's charging switch.
#pragma once

void *mmi_testwnd_BatteryTestEntry(void);
int mmi_testwnd_BatteryTest_Stop_Entry(void);
// PC open: the window stays open (no pass by itself) until the PC's stop, which answers 1
// when every value lay inside at the last refresh and closes it.
int mmi_AutoTest_BatteryTestEntry(void);
int mmi_AutoTest_BatteryTest_Stop_Entry(char *reply, unsigned int size);

// The charging switch of the battery service: 1 when the service took it.
int mmi_AutoTest_battery_Charge_Enable(void);
int mmi_AutoTest_battery_Charge_Disable(void);

// The key tests: the keypad and the headset hook key: stand-ins until each window exists.
// An entry logs at error priority that its test is not available and opens nothing.
#pragma once

void *mmi_teswnd_KeyTestEntry(void);  // FTX_KEYS
int mmi_teswnd_KeyTest_Stop_Entry(void);
void *mmi_teswnd_HookKeyTestEntry(void);  // FTX_HOOKKEY
int mmi_teswnd_HookKeyTest_Stop_Entry(void);

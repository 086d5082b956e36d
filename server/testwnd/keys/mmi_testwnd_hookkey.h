// The headset hook-key test: the factory library reports the hook button; the label turns
// from red to green once it was pressed.
#pragma once

#include "mmi_msg.h"

void *mmi_teswnd_HookKeyTestEntry(void);
void *mmi_teswnd_HookKeyTest(void);
int mmi_teswnd_HookKeyTest_Stop_Entry(void);
void init_Hookkeyrect(void);
// The library's hook events (its own thread): status 1 is a press.
void hookkey_test_callback(unsigned int *status);

// PC start; PC stop answers 1 when the hook key was pressed, the library's text in reply.
int mmi_AutoTest_HeadsetHookTestEntry(void);
int mmi_AutoTest_HeadsetHookTest_Stop_Entry(char *reply, unsigned int size);

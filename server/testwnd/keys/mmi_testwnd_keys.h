// The key test: the configured keys are listed and each must be pressed and released once;
// the PC and the PCBA run drive the same window.
#pragma once

#include <stdint.h>

#include "mmi_msg.h"
#include "testwnd/mmi_key_table.h"

// The key test's table (GUI thread).
extern mmi_key_item Keytest_Item[MMI_KEY_ITEMS];

void *mmi_teswnd_KeyTestEntry(void);
void *mmi_teswnd_KeyTest(void);
int mmi_teswnd_KeyTest_Stop_Entry(void);

// Reads the item's configuration into the table's enable flags.
void Current_testwnd_GetConfigParas(void);
// Enables (or not) the first row whose config_name is a prefix of name.
void setKeytest_Item_value(const char *name, int enable);

// The key events of the key-test window.
void mmiTestMsgKeyTestProc(HWND hWnd, WPARAM key, UINT message);
void CheckKeyisDown(HWND hWnd, WPARAM key);
void CheckKeyisUp(HWND hWnd, WPARAM key);

// PC start; PC stop answers 1 with the pressed keys' codes in reply when every key passed,
// else 0 with the codes of the keys still pending.
int mmi_AutoTest_KeyTestEntry(void);
int mmi_AutoTest_KeyTest_Stop_Entry(char *reply, unsigned int size);
// The PCBA run: volume up, volume down and power within about 31 s; 1 pass, 0 fail.
int PCBAKeyTestStart(void);
int PCBAKeyTestStop(void);

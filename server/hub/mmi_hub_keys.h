// The hub's key hook: every key counts as input for the sleep timer; the power key sleeps or
// wakes on a short press and opens the power-off dialog on a long one; while the Wi-Fi link
// holds the keys, only the unlock gesture (five up/down presses within six seconds) works.
#pragma once

#include "mmi_msg.h"

// The power key held this long (milliseconds) opens the power-off dialog.
#define MMI_POWERKEY_LONG_MS 800

// 1 when a press held from pressMs to releaseMs is a short press.
int mmi_powerkey_is_short(long long pressMs, long long releaseMs);

int hookKeyProc(void *context, HWND dst, UINT msg, WPARAM wparam, LPARAM lparam);

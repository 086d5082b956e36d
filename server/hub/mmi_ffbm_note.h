// The factory-boot-mode note window: the hub's window when the handset started in the
// factory boot mode, telling how to power off.
#pragma once

#include "mmi_msg.h"

LRESULT mmi_ExampleWin_MenuWndProc1(HWND hWnd, UINT message, WPARAM wParam, LPARAM lParam);

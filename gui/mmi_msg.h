// Program messages shared by the main window, the dialogs and the test windows.
#pragma once

#include <minigui/common.h>
#include <minigui/minigui.h>
#include <minigui/gdi.h>
#include <minigui/window.h>

// The main window opens one of its modal dialogs (wParam: text for kind 2, lParam: kind).
#define MSG_CREATEDIALG 0x865
// To the active test window after the fail-and-quit dialog: record a fail and close.
#define MSG_FAILANDQUIT 0x866
// A library callback result or a Wi-Fi link change has arrived.
#define MSG_CALLBACK 0x867
// A dialog button was chosen (wParam: button number, 0 for the first).
#define MSG_DIALOGBTN 0xF60
// Runs a function on the main window's thread (wParam: mmi_gui_fn, lParam: its argument).
#define MSG_RUNONGUITHREAD 0x868
// Posted by the soft-key bar after a tap on a slot (wParam: slot number).
#define MSG_SOFTKEYTAP 7216

// The data a main window was created with (dwAddData): in MSG_CREATE from the create record,
// later from the window.
static inline DWORD mmi_window_data(HWND hWnd, UINT message, LPARAM lParam) {
    return message == MSG_CREATE ? reinterpret_cast<PMAINWINCREATE>(lParam)->dwAddData
                                 : GetWindowAdditionalData(hWnd);
}

// The main window's refresh timer of the two bars.
#define MMI_TIMER_BARS 1

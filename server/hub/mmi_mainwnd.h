// The main window: the hub of the program between the title strip and the soft-key bar.
// Its parts, one file each: the main menu (mmi_hub_menu.h), the modal dialogs other parts
// ask for (mmi_hub_dialogs.h), the key hook with the power and link keys (mmi_hub_keys.h),
// the title strip (mmi_titlestrip.h), the Wi-Fi link picture and label (mmi_wifi_link.h),
// and the factory-boot-mode note window (mmi_ffbm_note.h).
#pragma once

#include <atomic>

#include "mmi_msg.h"
#include "session/mmi_runstate.h"

extern std::atomic<HWND> g_hMainWnd;  // the hub; HWND_INVALID before it exists

// Screen geometry of the hub, from the screen size (integer division throughout).
struct mmi_hub_layout {
    RECT mainWindow;  // screen
    RECT softKeyBar;  // screen
    RECT titleStrip;  // screen
    int listHeight;
    int itemHeight;
    RECT dialog;   // screen
    int linkSide;  // s of the Wi-Fi link picture
    RECT linkSquare;
};
void mmi_hub_layout_for(int w, int h, mmi_hub_layout *out);

// The hub with the main menu; runs its message loop until it closes.
int kmt_CreateMainMenuWnd(void);
// The hub with the factory-boot-mode note instead of the menu.
int kmt_CreateMainMenuWnd1(void);
LRESULT mmi_ExampleWin_MenuWndProc(HWND hWnd, UINT message, WPARAM wParam, LPARAM lParam);

// The main window: the hub of the program between the title strip and the soft-key bar,
// with the main menu, the modal dialogs other parts ask for, the power key and the Wi-Fi
// link key. Also the factory-boot-mode note window.
#pragma once

#include <stdint.h>

#include <atomic>

#include "mmi_msg.h"

#define MMI_MENU_MAX_ROWS 5
#define MMI_MENU_LABEL_SIZE 260
// The power key held this long (milliseconds) opens the power-off dialog.
#define MMI_POWERKEY_LONG_MS 800

struct mmi_menu_row {
    int32_t index;
    char label[MMI_MENU_LABEL_SIZE];  // language key, replaced by its translation
    int (*entry)(void);
};
extern mmi_menu_row g_mainMenu[MMI_MENU_MAX_ROWS];
extern int g_mainMenuCount;  // rows added to the list

extern std::atomic<HWND> g_hMainWnd;  // the hub; HWND_INVALID before it exists
extern int g_bCoupleTest;
extern int g_bAgingTest;
extern std::atomic<int> g_deviceIsAgingTest;
extern std::atomic<int> g_dialogcouldshow;
extern std::atomic<int> g_iCreateDialog;
extern std::atomic<int> g_bWiFiConnectStatus;

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

// 1 when a press held from pressMs to releaseMs is a short press.
int mmi_powerkey_is_short(long long pressMs, long long releaseMs);

int kmt_CreateMainMenuWnd(void);
int kmt_CreateMainMenuWnd1(void);
LRESULT mmi_ExampleWin_MenuWndProc(HWND hWnd, UINT message, WPARAM wParam, LPARAM lParam);
LRESULT mmi_ExampleWin_MenuWndProc1(HWND hWnd, UINT message, WPARAM wParam, LPARAM lParam);
int hookKeyProc(void *context, HWND dst, UINT msg, WPARAM wparam, LPARAM lparam);
void ScrollViewProc(HWND hwnd, LINT id, int nc, DWORD add_data);
// Sets one item of the title strip from any thread.
int TitleInfoShow(const char *text, int index, int abnormalState);

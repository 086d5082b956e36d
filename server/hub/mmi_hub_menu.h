// The main menu of the hub: the fixed rows, the optional coupling and aging rows from the
// settings, and the list that runs the entry of the row chosen.
#pragma once

#include <stdint.h>

#include "mmi_msg.h"

#define MMI_MENU_MAX_ROWS 5
#define MMI_MENU_LABEL_SIZE 260

struct mmi_menu_row {
    int32_t index;
    char label[MMI_MENU_LABEL_SIZE];  // language key, replaced by its translation
    int (*entry)(void);
};
extern mmi_menu_row g_mainMenu[MMI_MENU_MAX_ROWS];
extern int g_mainMenuCount;  // rows added to the list

extern int g_bCoupleTest;
extern int g_bAgingTest;

void ScrollViewProc(HWND hwnd, LINT id, int nc, DWORD add_data);

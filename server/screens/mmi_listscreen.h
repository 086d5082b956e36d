// A full-screen list between the bars, hosted by the main window: the device-test list and
// the information screen are each one descriptor of it. The right soft key goes back; a
// refresh message rebuilds the rows.
#pragma once

#include <atomic>

#include "minigui/control.h"
#include "mmi_msg.h"

struct mmi_listscreen_desc {
    const char *caption;
    const char *titleKey;  // middle of the title strip
    int fontIndex;         // of the hub's fonts
    int itemHeight;        // rows of the list (pixels)
    // Rebuilds the rows' data; returns their number. Row i's item carries i.
    int (*fill)(void);
    SVITEM_DRAWFUNC draw;
    void (*choose)(int row);  // Enter or a tap on row; may be null
    UINT refreshMessage;      // rebuilds the rows when received
    std::atomic<HWND> *window;
    DWORD style = WS_CAPTION | WS_VISIBLE;  // of the window between the bars
};

// Opens the screen, or shows it again when it is open. 0, or -1 when it cannot be made.
int mmi_listscreen_open(const mmi_listscreen_desc *d);
// The row an item of the list stands for.
int mmi_listscreen_row(HSVITEM hsvi);
// Draws a row's label on the left and its value on the right in one colour, the cursor row
// on a grey band.
void mmi_listscreen_draw_row(HWND hWnd, HSVITEM hsvi, HDC hdc, const RECT *rc, const char *label,
                             const char *value, int colour);

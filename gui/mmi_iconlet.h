// "IconLetCtrl": a row of text items at given positions, one of which may be shown
// pressed. The soft-key bar and the title strip fill themselves with one.
#pragma once

#include "mmi_msg.h"

#define CTRL_ICONLET "IconLetCtrl"
#define ICONLET_TEXT_SIZE 256

struct ICONLET_ITEM {
    int x;
    int width;
    int slot;
    char text[ICONLET_TEXT_SIZE];
};

// Colours of the items (system pixel indexes).
struct ICONLET_SKIN {
    int pressedBkColour;
    int textColour;  // -1 keeps the control's text colour
};

#define ILM_ADDITEM 8600       // lParam: const ICONLET_ITEM* (copied)
#define ILM_RESETCONTENT 8601  // removes every item
#define ILM_SETSKIN 8602       // lParam: const ICONLET_SKIN*, 0 for the default skin
#define ILM_SETPRESSED 8603    // wParam: slot, or -1 for none
#define ILM_SETTEXTCOLOR 8604  // wParam: system pixel index of the text
#define ILM_SETALIGN 8605      // wParam: ICONLET_ALIGN_...
#define ILM_LOCKPAINT 8606     // wParam: 1 holds painting back, 0 repaints once
#define ILM_GETPRESSED 8607    // -> pressed slot or -1
#define ILM_GETITEMCOUNT 8608
#define ILM_GETITEM 8609  // wParam: index, lParam: ICONLET_ITEM* out -> 0, or -1

#define ICONLET_ALIGN_LEFT 0
#define ICONLET_ALIGN_RIGHT 1
#define ICONLET_ALIGN_CENTER 2

// Registers the class; TRUE when it is registered (also when it already was).
BOOL RegisterIconLetCtrl(void);

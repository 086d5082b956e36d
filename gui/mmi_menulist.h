// Drawing of the menu lists (scroll views whose items carry their label text).
#pragma once

#include "mmi_msg.h"

#include <minigui/control.h>

// Item drawing for SVM_SETITEMDRAW: the item's additional data is its label (char*).
void mmi_SVDrawItem(HWND hWnd, HSVITEM hsvi, HDC hdc, RECT *rcDraw);

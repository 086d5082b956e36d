// The board-code screen: the board's bar code as a QR code, large and centred between the
// bars, for a scanner to read from the screen. The information screen opens it when its
// board-number row is chosen; the back key or the right soft key ("Back") closes it.
#pragma once

#include "mmi_msg.h"

// Makes the board-code picture and opens the screen (shows it again when it is open).
// 0, or -1 when the window cannot be made. GUI thread.
int mmi_teswnd_QRCode(void);
LRESULT mmi_ExampleWin_QRCodeWndProc(HWND hWnd, UINT message, WPARAM wParam, LPARAM lParam);

// Where a square picture of `side` pixels goes in a client area of w x h whose top `top`
// pixels are taken: the largest whole multiple of the picture (so every module keeps one
// size) within four fifths of the room, at least the picture itself, centred in the room.
void mmi_qrscreen_layout(int w, int h, int top, int side, RECT *out);

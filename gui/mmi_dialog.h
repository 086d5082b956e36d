// The modal message box: a title line, a text line and a row of buttons. While it is up
// every key and pointer event goes to it; the chosen button is posted to the notify
// window as MSG_DIALOGBTN, which then destroys the record with DestroyDialog.
#pragma once

#include "mmi_msg.h"

#define MMI_DIALOG_TEXT_SIZE 256
// The button number CloseButton reports: no dialog of the main window has it.
#define MMI_DIALOG_CLOSE_BUTTON 3

// Positions of a dialog's parts; the dialog rectangle is in screen coordinates, the others
// relative to the dialog.
struct MMI_DIALOG_LAYOUT {
    RECT dialog;
    RECT title;
    RECT text;
    RECT buttons;
    int buttonWidth;  // w / n
    int count;
};
void mmi_dialog_layout(int x, int y, int w, int h, int n, MMI_DIALOG_LAYOUT *out);
// Rectangle of button i relative to the dialog: the last one reaches the right edge, the
// others leave a one-pixel gap for the separator.
void mmi_dialog_button_rect(const MMI_DIALOG_LAYOUT *layout, int i, RECT *out);
// Button under a screen point, or -1 outside the button row.
int mmi_dialog_button_at(const MMI_DIALOG_LAYOUT *layout, int screenX, int screenY);

struct MMI_DIALOG {
    HWND window;  // HWND_INVALID once closed
    HWND closedWindow;
    DWORD flags;  // kept, unused
    char title[MMI_DIALOG_TEXT_SIZE];
    char text[MMI_DIALOG_TEXT_SIZE];
    DWORD style;  // kept, unused
    HWND host;
    HWND notify;
    MMI_DIALOG_LAYOUT layout;
    MSGHOOK savedMouseHook;
    MSGHOOK savedKeyHook;
    int separator;
    int selected;  // -1 when none
    HWND titleCtrl;
    HWND textCtrl;
    PLOGFONT fonts[3];  // title, text, buttons
    int hooked;
    int buttonCount;
    HWND buttons[1];  // buttonCount entries
};
typedef MMI_DIALOG *HDIALOG;
#define HDIALOG_INVALID ((HDIALOG)-1)

extern int g_bKeyValid;  // 1 when the latest dialog has exactly one button

// Creates the dialog hidden, owned by hostWindow (call it on the host's thread).
HDIALOG CreateDialog(const char *title, const char *text, int x, int y, int w, int h,
                     HWND hostWindow, HWND notifyWindow, DWORD styleArgument,
                     const char *const *buttonLabels, int n, DWORD flags);
// Shows the dialog and redirects the hooks to it; 1 when shown, 0 for a bad handle.
int DoModal(HDIALOG dlg);
// Destroys what is left of the dialog and frees the record; 0 and -1 are accepted.
void DestroyDialog(HDIALOG dlg);
// Dismisses the latest dialog with button number 3; callable from any thread.
int CloseButton(void);
// "CloseDialog testItem start" from the PC.
int AutoCloseDialog(const char *parm, int parmLen, char *reply, unsigned int replySize);

// What the hub's files share among themselves and nothing else of the program uses: the log
// tag, the translation and screen helpers, and the calls one part of the hub makes into
// another. Each part keeps its own state; the others reach it only through these functions.
#pragma once

#include <android/log.h>

#include <string>

#include "mmi_msg.h"

#define TAG "FTX_MAIN"
#define LOGD(...) __android_log_print(ANDROID_LOG_DEBUG, TAG, __VA_ARGS__)
#define LOGE(...) __android_log_print(ANDROID_LOG_ERROR, TAG, __VA_ARGS__)

namespace hub {

// ---- mmi_mainwnd.cpp ----

// The translation of a language key; the key itself where there is none.
std::string tr(const char *key);
void screen_size(int *w, int *h);
// Both bars of the hub: the soft-key bar's middle label, then the title strip, drawn.
void refresh_bars(HWND hWnd);
// MSG_CLOSE of either hub window: forgets it as the hub, takes the bars and the controls
// down, destroys it and ends its loop.
LRESULT close_hub(HWND hWnd);

// ---- mmi_hub_menu.cpp ----

// Reads which optional rows (coupling, aging) the menu has.
void read_menu_config();
// The menu list, the bars and their timer in a new hub window.
void create_menu(HWND hWnd);

// ---- mmi_hub_dialogs.cpp ----

// MSG_CREATEDIALG: opens the dialog of a kind, or brings the one up to the front again.
void create_dialog(HWND hWnd, WPARAM wParam, int kind);
// MSG_DIALOGBTN: closes the dialog and runs the action of the button.
void dialog_button(HWND hWnd, int button);

// ---- mmi_hub_keys.cpp ----

// Lets the next long press open a dialog again (a dialog button was chosen).
void release_dialog_sem();
// Starts the unlock gesture over (the link came up or a key for it was pressed).
void unlock_count_reset();
// 1 once the unlock gesture has been made.
int unlocked();
int input_mouse_hook(void *context, HWND dst, UINT msg, WPARAM wparam, LPARAM lparam);

// ---- mmi_titlestrip.cpp ----

// The menu's title strip texts; drawn only when draw is true.
void refresh_title(HWND hWnd, bool draw);

// ---- mmi_wifi_link.cpp ----

// The soft-key bar's middle label from the link state.
void refresh_link_label(HWND hWnd);
// The link picture from the link state, on the bars' timer while the menu is in front.
void link_tick(HWND hWnd);
// The link key (F4) on the hub: connects, or disconnects a link that is up.
void on_link_key(HWND hWnd);
// MSG_CALLBACK: the link came up or went down.
void on_link_change(HWND hWnd);

}  // namespace hub

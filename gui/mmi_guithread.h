// Work that opens, closes or changes a window must run on the GUI thread. Callers on
// other threads (PC entries, battery observers, Wi-Fi threads) hand it over here: a
// program message to the main window whose handler runs the function there.
#pragma once

#include "mmi_msg.h"

typedef int (*mmi_gui_fn)(void *arg);

// The window whose thread runs the work (the main window); HWND_INVALID forgets it.
void mmi_guithread_set_window(HWND hWnd);
HWND mmi_guithread_window(void);
// 1 on the GUI thread (or while no main window exists: start-up and tests run inline).
int mmi_on_gui_thread(void);
// Runs fn(arg) on the GUI thread and returns its result; waits until it has run.
int mmi_RunOnGuiThread(mmi_gui_fn fn, void *arg);
// Queues fn(arg) for the GUI thread without waiting; 0 when queued (or run inline).
int mmi_PostToGuiThread(mmi_gui_fn fn, void *arg);
// For the main window's procedure: handles MSG_RUNONGUITHREAD; 1 when msg was one.
int mmi_guithread_dispatch(UINT msg, WPARAM wParam, LPARAM lParam, LRESULT *result);

// The PC command channel: binds the core-device library's channel, registers the command
// table and serves it on a thread of its own.
#pragma once

#include "minigui/common.h"

// 0 when the channel thread started, the thread creation's error, or -1 when binding or
// registration failed (no thread then).
int AtThreadStart(void);
// The channel thread's body: registers the socket and the callback, then serves.
void *start_routine(void *arg);

// Relink after a restart: arg is the main window; one second after start it gets the
// Wi-Fi toggle key (F4) so the link to the PC comes back by itself.
void *Tcp_Relink_PcServer_Thread(void *arg);
// Starts the relink thread when /cache/Tcp_Restart.ini is readable; 1 when started.
int mmi_start_tcp_relink(HWND hMainWnd);

// The signalling coupling test: it restarts the modem into its online mode (low-power mode
// first, then online), so that a call box can make the handset register and measure its
// radio, and tells the operator whether that worked. The modem's control is the vendor
// library lib_dvk_signalcoupling.so, open exactly as long as the window is. No pass or fail
// is recorded; the back key leaves.
#pragma once

#include "mmi_msg.h"

#define SIGNAL_COUPLING_TAG "SIGNAL_COUPLING"
#define SIGNAL_COUPLING_LIB "lib_dvk_signalcoupling.so"
// The window's timer: it repaints when the worker changed the modem state.
#define SIGNAL_COUPLING_TIMER 111
#define SIGNAL_COUPLING_TIMER_PERIOD 100  // ticks of 10 ms
// The pause between the switches, before FTX_TIME_SCALE.
#define SIGNAL_COUPLING_SETTLE_US 2000000

// The modem state the worker reports to the window.
enum signal_coupling_state {
    SIGNAL_COUPLING_SWITCHING = 0,
    SIGNAL_COUPLING_ONLINE = 1,
    SIGNAL_COUPLING_FAILED = 2,
};

// Opens the library and looks up its three operations: 0, or -1 (logged; nothing stays open).
int SIGNAL_COUPLING_LOAD_LIB(void);
// The main menu's way in (GUI thread): 0 when the window opened, -1 when the library, one
// of its operations or the modem's initialisation failed (logged; no window).
int mmi_SignalCouplingTestEntry(void);
LRESULT mmi_SignalCouplingTestWndProc(HWND hWnd, UINT message, WPARAM wParam, LPARAM lParam);
// The worker: low-power mode, 2 s, online mode (a modem that refuses low-power mode first is
// given one online and low-power round), holding the switching mutex; returns 0.
void *Set_Modem_online_mode(void *arg);
// Closes the window from outside (a PC start closes every test window); 1.
int mmi_SignalCouplingTest_Stop(void);

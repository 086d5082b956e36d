// The non-signalling RF coupling test: at the RF station a non-signalling tester measures
// the radio while the modem runs in its RF test mode (lib_dvk_nonsignal.so, open exactly as
// long as the window is). For each enabled technology a worker steps through the configured
// bands and channels: technology, band and channel set, transmitter on at the configured
// power, the tester's downlink level read and judged against the limits, transmitter off.
// Each technology's verdict is recorded at its coupling item (LTE 38, GSM 6, CDMA2000 18,
// WCDMA 26, TD-SCDMA 30). The settings are mmi_nonsignal_plan.h's.
#pragma once

#define NONSIGNAL_TAG "FTX_NONSIGNAL"
#define NONSIGNAL_LIB "lib_dvk_nonsignal.so"

// The main menu's way in (GUI thread): 0 when the window opened (or is open), -1 when no
// technology is enabled, or the library or one of its operations is missing (logged; no
// window).
int mmi_NonSignalTestEntry(void);
// FTX_NONSIGNAL "enable" of /etc/ftx_config.ini (default 0).
int mmi_nonsignal_enabled(void);
// Closes the window from outside (the worker stops first); 1.
int mmi_NonSignalTest_Stop(void);

// The modem's RF test mode behind lib_dvk_nonsignal.so, as a non-signalling tester sees it.
// It lives in libftxsim.so, not in the library: the application opens the library when the
// non-signalling window opens and closes it when the window closes, while the console's
// "hw rf" lines, the model's state and its record of the settings requested ("hw status")
// must outlast it and come before its first opening.
#pragma once

namespace ftxsim {

// The library's operations (lib_dvk_nonsignal.h); 0 on success. A setting (technology,
// band, channel, transmitter on or off) takes the "hw rf delay" (scaled by FTX_TIME_SCALE).
int rf_open(void);
int rf_close(void);
int rf_set_tech(int tech);
int rf_set_band(int band);
int rf_set_channel(int channel);
int rf_tx_on(int power);
int rf_tx_off(void);
int rf_get_rx_level(int *level);
// The library was loaded (true) or unloaded (false).
void rf_library_loaded(bool loaded);

}  // namespace ftxsim

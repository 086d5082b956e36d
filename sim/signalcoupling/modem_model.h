// The modem behind lib_dvk_signalcoupling.so. It lives in libftxsim.so, not in the library:
// the application opens the library when the coupling window opens and closes it when the
// window closes, while the console's "hw modem" lines, the modem's state and the record of
// the library's calls ("hw status") must outlast it and come before its first opening.
#pragma once

namespace ftxsim {

// The library's three operations; 0 on success. A mode switch takes the "hw modem delay"
// (scaled by FTX_TIME_SCALE) and fails before init and after uninit.
int modem_init(void);
int modem_uninit(void);
int modem_set_mode(int mode);

}  // namespace ftxsim

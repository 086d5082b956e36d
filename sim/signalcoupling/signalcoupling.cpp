// lib_dvk_signalcoupling.so: the handset library's operations, handed to the modem model of
// libftxsim.so (modem_model.h), so that closing the library loses nothing of the model.
#include <stddef.h>

#include "hw/lib_dvk_signalcoupling.h"
#include "modem_model.h"
#include "sim_core.h"

extern "C" int FTX_API_SignalCoupling_init(void) {
    return ftxsim::modem_init();
}

extern "C" int FTX_API_SignalCoupling_uninit(void) {
    return ftxsim::modem_uninit();
}

extern "C" int FTX_API_SignalCoupling_setModemMode(int mode) {
    return ftxsim::modem_set_mode(mode);
}

extern "C" int ftx_sim_control(const char *line, char *reply, size_t size) {
    return ftxsim::control(line, reply, size);
}

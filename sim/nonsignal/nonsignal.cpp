// lib_dvk_nonsignal.so: the handset library's operations, handed to the RF model of
// libftxsim.so (rf_model.h), so that closing the library loses nothing of the model. The
// model is told when the library is loaded and unloaded ("hw status": library=...).
#include <stddef.h>

#include "hw/lib_dvk_nonsignal.h"
#include "rf_model.h"
#include "sim_core.h"

namespace {

struct Loaded {
    Loaded() { ftxsim::rf_library_loaded(true); }
    ~Loaded() { ftxsim::rf_library_loaded(false); }
} s_loaded;

}  // namespace

extern "C" int FTX_API_NonSignal_open(void) {
    return ftxsim::rf_open();
}
extern "C" int FTX_API_NonSignal_close(void) {
    return ftxsim::rf_close();
}
extern "C" int FTX_API_NonSignal_setTech(int tech) {
    return ftxsim::rf_set_tech(tech);
}
extern "C" int FTX_API_NonSignal_setBand(int band) {
    return ftxsim::rf_set_band(band);
}
extern "C" int FTX_API_NonSignal_setChannel(int channel) {
    return ftxsim::rf_set_channel(channel);
}
extern "C" int FTX_API_NonSignal_txOn(int power) {
    return ftxsim::rf_tx_on(power);
}
extern "C" int FTX_API_NonSignal_txOff(void) {
    return ftxsim::rf_tx_off();
}
extern "C" int FTX_API_NonSignal_getRxLevel(int *level) {
    return ftxsim::rf_get_rx_level(level);
}

extern "C" int ftx_sim_control(const char *line, char *reply, size_t size) {
    return ftxsim::control(line, reply, size);
}

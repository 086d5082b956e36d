// Pieces of libdvk_ncoredevice.so that its control words reach.
#pragma once

#include "sim_core.h"

namespace ftxsim {

void battery_state(Reply &r);
int battery_word(const Args &a, Reply &r);
int charger_word(const Args &a, Reply &r);
void channel_state(Reply &r);

}  // namespace ftxsim

// The modal dialogs the hub opens for the other parts (power off, battery check, fail and
// quit, touch-panel error, aging, the automatic test runs), by kind.
#pragma once

#include <atomic>

#include "hw/lib_factory.h"

extern std::atomic<int> g_dialogcouldshow;
extern std::atomic<int> g_iCreateDialog;

// Registered for "TPHARDWARE" when the touch-panel alert is confirmed in state 3.
void Get_tpstatus_callback(module_data *data);

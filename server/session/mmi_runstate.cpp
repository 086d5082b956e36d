#include "session/mmi_runstate.h"

std::atomic<int> g_bAutoTestRunning{0};

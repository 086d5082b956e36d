// Run state of the automatic test sequence, shared by the GUI, command and aging threads.
#pragma once

#include <atomic>

// 1 while an automatic run is active; results are recorded and chained only then.
extern std::atomic<int> g_bAutoTestRunning;

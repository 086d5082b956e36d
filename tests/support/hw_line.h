// A console "hw" line sent straight to the simulated libraries loaded in the test, for the
// unit tests of the hardware model.
#pragma once

#include <string>

#include "ftx_host.h"

// The line's reply; its status in *rc when asked.
inline std::string hw(const std::string &line, int *rc = nullptr) {
    char reply[8192];
    const int r = ftx_host_hw_dispatch(line.c_str(), reply, sizeof(reply));
    if (rc != nullptr) *rc = r;
    return reply;
}

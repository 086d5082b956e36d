// Shared set-up of the configuration fuzz targets: a private device root, a quiet log, and
// the input split into leading lines and the rest.
#pragma once

#include <stddef.h>
#include <stdint.h>
#include <stdlib.h>

#include <string>

inline void fuzz_quiet_root() {
    static char root[] = "/tmp/ftx-fuzz-config-XXXXXX";
    if (getenv("FTX_ROOT") == nullptr && mkdtemp(root) != nullptr) setenv("FTX_ROOT", root, 1);
    setenv("FTX_LOG_LEVEL", "F", 1);  // the capture-free log writer then drops every line
}

// Takes the next line (without its LF) off the front of rest.
inline std::string fuzz_take_line(std::string &rest, size_t max) {
    size_t lf = rest.find('\n');
    std::string line = rest.substr(0, lf);
    rest = lf == std::string::npos ? "" : rest.substr(lf + 1);
    if (line.size() > max) line.resize(max);
    return line;
}

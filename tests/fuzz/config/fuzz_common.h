// Shared set-up of the configuration fuzz targets: a private device root, a quiet log, and
// the input split into leading lines and the rest.
#pragma once

#include <stddef.h>
#include <stdint.h>
#include <stdlib.h>

#include <string>

// Included by exactly one file per target.
extern "C" int LLVMFuzzerInitialize(int *, char ***) {
    static char root[] = "/tmp/ftx-fuzz-config-XXXXXX";
    if (getenv("FTX_ROOT") == nullptr && mkdtemp(root) != nullptr) setenv("FTX_ROOT", root, 1);
    setenv("FTX_LOG_LEVEL", "F", 1);  // only fatal lines reach the log file
    return 0;
}

// Takes the next line (without its LF) off the front of rest.
inline std::string fuzz_take_line(std::string &rest, size_t max) {
    size_t lf = rest.find('\n');
    std::string line = rest.substr(0, lf);
    rest = lf == std::string::npos ? "" : rest.substr(lf + 1);
    if (line.size() > max) line.resize(max);
    return line;
}

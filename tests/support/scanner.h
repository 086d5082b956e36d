// A QR code scanner for the tests: Debian's zbarimg (package zbar-tools) reads a picture on
// the host. Tests skip what needs it when it is not installed.
#pragma once

#include <stdio.h>
#include <stdlib.h>

#include <string>

namespace scanner {

inline bool available() {
    return system("command -v zbarimg >/dev/null 2>&1") == 0;
}

// The text of the QR code in the picture at hostPath (PNG or BMP), "" when none is found.
inline std::string read(const std::string &hostPath) {
    std::string cmd =
        "zbarimg --quiet --raw -Sdisable -Sqrcode.enable '" + hostPath + "' 2>/dev/null";
    FILE *p = popen(cmd.c_str(), "r");
    if (p == nullptr) return "";
    std::string out;
    char buf[256];
    size_t n;
    while ((n = fread(buf, 1, sizeof buf, p)) > 0)
        out.append(buf, n);
    pclose(p);
    while (!out.empty() && out.back() == '\n')
        out.pop_back();
    return out;
}

}  // namespace scanner

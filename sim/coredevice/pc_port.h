// The PC channel's TCP port as the handset and the PC tools both read it: FTX_PC_PORT when
// set, else [pc] port of the device root's sim/device.ini, else 20051. A value that is not
// a plain decimal number of 0..65535 is refused, never taken modulo or as 0.
#pragma once

#include <stdio.h>
#include <stdlib.h>

#include "ftx_host.h"

namespace ftxsim {

const int kPcDefaultPort = 20051;

// Parses a whole decimal port number (0..65535, blanks around it allowed); false otherwise.
inline bool pc_port_parse(const char *text, int *port) {
    if (text == nullptr) return false;
    while (*text == ' ' || *text == '\t')
        ++text;
    long value = 0;
    int digits = 0;
    for (; *text >= '0' && *text <= '9'; ++text) {
        value = value * 10 + (*text - '0');
        if (++digits > 5) return false;
    }
    while (*text == ' ' || *text == '\t' || *text == '\r' || *text == '\n')
        ++text;
    if (digits == 0 || *text != '\0' || value > 65535) return false;
    *port = static_cast<int>(value);
    return true;
}

struct PcPortSetting {
    int port;  // valid when ok
    bool ok;
    const char *source;  // "FTX_PC_PORT", "sim/device.ini [pc] port" or "default"
    char text[256];      // the value as written, for messages
};

// Reads the configured port (the root is $FTX_ROOT).
inline PcPortSetting pc_port_setting() {
    PcPortSetting s{kPcDefaultPort, true, "default", ""};
    char ini[256];
    const char *value = getenv("FTX_PC_PORT");
    if (value != nullptr && *value != '\0') {
        s.source = "FTX_PC_PORT";
    } else if (ftx_device_ini_get("pc", "port", ini, sizeof(ini), nullptr) == 0) {
        s.source = "sim/device.ini [pc] port";
        value = ini;
    } else {
        return s;
    }
    snprintf(s.text, sizeof(s.text), "%s", value);
    s.ok = pc_port_parse(value, &s.port);
    return s;
}

}  // namespace ftxsim

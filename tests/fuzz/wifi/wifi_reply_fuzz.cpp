// The supplicant's answers as the application reads them: any bytes as a STATUS reply, an
// ADD_NETWORK reply and a wpa_cli line; the readers stay inside them (no terminator here).
#include <stddef.h>
#include <stdint.h>
#include <string.h>

#include <vector>

#include "wifi/mmi_wifi_reply.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t *data, size_t size) {
    std::vector<char> text(data, data + size);
    mmi_wifi_parse_status(text.data(), text.size());
    if (mmi_wifi_parse_network_id(text.data(), text.size()) < -1) __builtin_trap();
    char out[33];
    for (size_t skip : {0, 5, 6}) {
        mmi_wifi_line_field(text.data(), text.size(), skip, 32, out);
        if (strlen(out) > 32) __builtin_trap();
    }
    return 0;
}

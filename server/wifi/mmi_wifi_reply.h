// Reading what the supplicant answers: a STATUS reply (its state and whether it holds a
// link-local address), the id ADD_NETWORK gives, and a field of a wpa_cli output line.
// Every reader stays inside the bytes it is given, terminated or not.
#pragma once

#include <stddef.h>

struct mmi_wifi_status {
    bool completed = false;  // "wpa_state=COMPLETED"
    bool linkLocal = false;  // "169.254" somewhere: DHCP has not answered yet
};

// The reply of len bytes; NUL bytes before it begin are skipped, one after that ends it.
mmi_wifi_status mmi_wifi_parse_status(const char *reply, size_t len);
// The network id at the start of an ADD_NETWORK reply; -1 when it holds none.
int mmi_wifi_parse_network_id(const char *reply, size_t len);
// n bytes of the line (size bytes, up to its NUL) after its first skip bytes, into out
// (n + 1 bytes, always terminated); what the line lacks stays empty.
void mmi_wifi_line_field(const char *line, size_t size, size_t skip, size_t n, char *out);

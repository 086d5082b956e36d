#include "wifi/mmi_wifi_reply.h"

#include <string.h>

namespace {

// Whether the bytes [p, end) hold word.
bool holds(const char *p, const char *end, const char *word) {
    const size_t n = strlen(word);
    for (; static_cast<size_t>(end - p) >= n; p++)
        if (memcmp(p, word, n) == 0) return true;
    return false;
}

}  // namespace

mmi_wifi_status mmi_wifi_parse_status(const char *reply, size_t len) {
    mmi_wifi_status st;
    if (reply == nullptr) return st;
    const char *p = reply, *end = reply + len;
    while (p < end && *p == '\0')
        p++;
    const char *stop = static_cast<const char *>(memchr(p, '\0', static_cast<size_t>(end - p)));
    if (stop != nullptr) end = stop;
    st.completed = holds(p, end, "wpa_state=COMPLETED");
    st.linkLocal = holds(p, end, "169.254");
    return st;
}

int mmi_wifi_parse_network_id(const char *reply, size_t len) {
    if (reply == nullptr) return -1;
    long id = 0;
    size_t i = 0;
    for (; i < len && reply[i] >= '0' && reply[i] <= '9'; i++) {
        id = id * 10 + (reply[i] - '0');
        if (id > 0x7fffffffL) return -1;
    }
    return i == 0 ? -1 : static_cast<int>(id);
}

void mmi_wifi_line_field(const char *line, size_t size, size_t skip, size_t n, char *out) {
    out[0] = '\0';
    if (line == nullptr) return;
    const size_t len = strnlen(line, size);
    if (len <= skip) return;
    const size_t take = len - skip < n ? len - skip : n;
    memcpy(out, line + skip, take);
    out[take] = '\0';
}

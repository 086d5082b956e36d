// The peripheral tests' library reports.
#include "testwnd/cards/mmi_card_report.h"

#include <string.h>

namespace {

bool field_is(const char *f, size_t n, const char *key) {
    const size_t k = strlen(key);
    return n > k && memcmp(f, key, k) == 0 && f[k] == '=';
}

void read_field(const char *f, size_t n, mmi_card_report *out) {
    if (field_is(f, n, "result")) {
        const char *v = f + 7;
        const size_t vn = n - 7;
        if (vn == 4 && memcmp(v, "pass", 4) == 0) {
            out->result = MMI_CARD_PASS;
        } else if (vn == 4 && memcmp(v, "fail", 4) == 0) {
            out->result = MMI_CARD_FAIL;
        }
    } else if (field_is(f, n, "uid")) {
        size_t used = 0;
        for (size_t i = 4; i < n && used + 1 < MMI_CARD_UID_SIZE; i++) {
            const unsigned char c = (unsigned char)f[i];
            if (c > ' ' && c < 0x7f) out->uid[used++] = (char)c;
        }
        out->uid[used] = 0;
    }
}

}  // namespace

int mmi_card_parse_report(const char *text, size_t len, mmi_card_report *out) {
    *out = mmi_card_report{};
    if (text == nullptr) return out->result;
    const size_t end = strnlen(text, len);
    size_t from = 0;
    while (from < end) {
        const char *semi = static_cast<const char *>(memchr(text + from, ';', end - from));
        const size_t to = semi != nullptr ? (size_t)(semi - text) : end;
        read_field(text + from, to - from, out);
        from = to + 1;
    }
    return out->result;
}

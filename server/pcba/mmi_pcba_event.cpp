#include "pcba/mmi_pcba_event.h"

namespace {

struct Cursor {
    const char *p;
    const char *end;
    void blanks() {
        while (p < end && (*p == ' ' || *p == '\t'))
            p++;
    }
    // A decimal number of at most 20 digits, kept within max; false when there is none or
    // it is larger.
    bool number(unsigned long long max, unsigned long long *out) {
        blanks();
        unsigned long long v = 0;
        const char *start = p;
        while (p < end && *p >= '0' && *p <= '9') {
            const unsigned d = static_cast<unsigned>(*p - '0');
            if (v > (max - d) / 10) return false;
            v = v * 10 + d;
            p++;
        }
        if (p == start) return false;
        *out = v;
        blanks();
        return true;
    }
};

}  // namespace

int mmi_pcba_parse_event(const char *text, size_t len, mmi_pcba_event *out) {
    if (text == nullptr || out == nullptr) return -1;
    Cursor c{text, text + len};
    // A NUL ends the text early.
    for (const char *q = text; q < c.end; q++)
        if (*q == '\0') {
            c.end = q;
            break;
        }
    unsigned long long value = 0, result = 0;
    if (!c.number(~0ULL, &value)) return -1;
    if (c.p == c.end || *c.p != ',') return -1;
    c.p++;
    c.blanks();
    const bool negative = c.p < c.end && *c.p == '-';
    if (negative) c.p++;
    if (!c.number(0x7fffffffULL, &result) || c.p != c.end) return -1;
    out->value = value;
    out->result = negative ? -static_cast<int>(result) : static_cast<int>(result);
    return 0;
}

// The factory library's battery text: a reading is whole or refused (the values before stay
// as they were), and every line made of it is ended inside its buffer, whatever the values.
#include <stddef.h>
#include <stdint.h>
#include <stdio.h>
#include <string.h>

#include <string>

#include "testwnd/battery/mmi_battery_lines.h"

namespace {

void same(const char *key, char *out, size_t size) {
    snprintf(out, size, "%s", key);
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t *data, size_t size) {
    std::string text(reinterpret_cast<const char *>(data), size);
    text = text.substr(0, text.find('\0'));
    mmi_battery_values v;
    memset(&v, 0x5a, sizeof v);
    const mmi_battery_values before = v;
    const int rc = mmi_battery_parse(text.c_str(), &v);
    if (rc != 0 && rc != -1) __builtin_trap();
    if (rc == -1 && memcmp(&before, &v, sizeof v) != 0) __builtin_trap();
    if (rc == 0 && v.chargersKnown != 0) __builtin_trap();
    // Limits from the same bytes, so that both sides of every range are reached.
    mmi_battery_limits lim;
    mmi_battery_read_limits(nullptr, nullptr, &lim);
    if (size >= 8) {
        memcpy(&lim.min[MMI_BATTERY_TEMPERATURE], data, 4);
        memcpy(&lim.max[MMI_BATTERY_VOLTAGE], data + 4, 4);
    }
    for (size_t bufSize : {size_t{1}, size_t{9}, size_t{256}}) {
        char out[256];
        memset(out, 'x', sizeof out);
        for (int line = -1; line <= MMI_BATTERY_LINES; line++) {
            const int inside =
                mmi_battery_line(line, rc == 0 ? &v : nullptr, &lim, same, out, bufSize);
            if (inside != 0 && inside != 1) __builtin_trap();
            if (memchr(out, '\0', bufSize) == nullptr) __builtin_trap();
        }
    }
    return 0;
}

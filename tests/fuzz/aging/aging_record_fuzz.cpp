// The reboot marker after a power cut or a bad flash: whatever it holds, the reader stays in
// its bytes and gives a record within range, which formats and reads back the same.
#include <stddef.h>
#include <stdint.h>
#include <string.h>

#include "AgingTest/mmi_aging_record.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t *data, size_t size) {
    mmi_aging_record r;
    if (mmi_aging_record_parse(&r, reinterpret_cast<const char *>(data), size) != 0) return 0;
    if (r.cycles < 1 || r.cycle < 0 || r.cycle > r.cycles || r.item < 0 ||
        r.item >= AGING_ITEM_COUNT || r.step < 0)
        __builtin_trap();
    static char text[8192];
    const int n = mmi_aging_record_format(&r, text, sizeof text);
    if (n < 0) __builtin_trap();
    mmi_aging_record back;
    if (mmi_aging_record_parse(&back, text, static_cast<size_t>(n)) != 0) __builtin_trap();
    if (back.cycle != r.cycle || back.cycles != r.cycles || back.item != r.item ||
        back.step != r.step || memcmp(back.counts, r.counts, sizeof r.counts) != 0)
        __builtin_trap();
    return 0;
}

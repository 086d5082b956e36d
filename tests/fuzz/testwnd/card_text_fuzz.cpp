// The peripheral tests' library reports: the reader stays inside the text it was given (the
// buffer here has no terminator), answers one of its three results and keeps the
// identifier terminated and printable.
#include <stddef.h>
#include <stdint.h>
#include <string.h>

#include <vector>

#include "testwnd/cards/mmi_card_report.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t *data, size_t size) {
    std::vector<char> text(data, data + size);  // not terminated: the reader must not need it
    mmi_card_report r;
    const int result = mmi_card_parse_report(text.data(), text.size(), &r);
    if (result != r.result) __builtin_trap();
    if (result != MMI_CARD_NONE && result != MMI_CARD_PASS && result != MMI_CARD_FAIL)
        __builtin_trap();
    const size_t n = strnlen(r.uid, sizeof(r.uid));
    if (n == sizeof(r.uid)) __builtin_trap();
    for (size_t i = 0; i < n; i++)
        if (r.uid[i] <= ' ' || r.uid[i] >= 0x7f) __builtin_trap();
    return 0;
}

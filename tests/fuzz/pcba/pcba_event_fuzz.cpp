// The PCBA events' text from the library: the reader stays inside the bytes it was given
// (no terminator here) and only a text it read fills the event.
#include <stddef.h>
#include <stdint.h>

#include <vector>

#include "pcba/mmi_pcba_event.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t *data, size_t size) {
    std::vector<char> text(data, data + size);
    mmi_pcba_event ev;
    ev.value = 12345;
    ev.result = 99;
    const int rc = mmi_pcba_parse_event(text.data(), text.size(), &ev);
    if (rc != 0 && rc != -1) __builtin_trap();
    if (rc == -1 && (ev.value != 12345 || ev.result != 99)) __builtin_trap();
    if (rc == 0 && size == 0) __builtin_trap();
    return 0;
}

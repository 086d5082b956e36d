// The panel self test's failure text from the factory library: the parse never reads past
// its points, and every point it keeps lands inside the screen or is left out.
#include <stddef.h>
#include <stdint.h>

#include <string>

#include "testwnd/touch/mmi_tp_rawdata.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t *data, size_t size) {
    if (size < 2) return 0;
    const int w = 1 + data[0] * 8, h = 1 + data[1] * 8;
    std::string text(reinterpret_cast<const char *>(data) + 2, size - 2);
    text = text.substr(0, text.find('\0'));
    mmi_tp_raw raw{};
    if (mmi_tp_raw_parse(text.c_str(), &raw, "fuzz") != 0) {
        if (raw.p != nullptr) __builtin_trap();
        return 0;
    }
    if (raw.num < 0 || raw.num > MMI_TP_RAW_MAX_POINTS) __builtin_trap();
    if (raw.filled < 0 || raw.filled > 2 * raw.num) __builtin_trap();
    int box[4];
    for (int i = 0; 2 * i + 1 < raw.filled; i++) {
        if (mmi_tp_raw_cell(&raw, i, w, h, box) != 0) continue;
        if (box[0] < 0 || box[1] < 0 || box[0] >= w || box[1] >= h) __builtin_trap();
        if (box[0] + box[2] > w || box[1] + box[3] > h) __builtin_trap();
    }
    mmi_tp_raw_free(&raw);
    return 0;
}

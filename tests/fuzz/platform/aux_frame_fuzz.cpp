// The auxiliary display's frame file: a frame is taken whole or not at all, and a frame
// taken formats back to bytes that parse to the same frame.
#include <stddef.h>
#include <stdint.h>

#include <string>

#include "aux_fb.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t *data, size_t size) {
    const std::string bytes(reinterpret_cast<const char *>(data), size);
    ftxhost::AuxFrame f;
    if (ftxhost::aux_fb_parse(bytes, &f) != 0) return 0;
    if (f.width <= 0 || f.height <= 0 || f.width > ftxhost::kAuxFbMaxSide ||
        f.height > ftxhost::kAuxFbMaxSide ||
        f.pixels.size() != static_cast<size_t>(f.width) * static_cast<size_t>(f.height))
        __builtin_trap();
    ftxhost::AuxFrame again;
    if (ftxhost::aux_fb_parse(ftxhost::aux_fb_format(f), &again) != 0 || again.pixels != f.pixels ||
        again.on != f.on)
        __builtin_trap();
    return 0;
}

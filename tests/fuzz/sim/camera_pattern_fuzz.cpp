// The cameras' frame request (camera, time, size as the application asks for them): any
// request is drawn inside its buffer, every pixel of an accepted one, or refused untouched.
#include <stdint.h>
#include <stdlib.h>
#include <string.h>

#include <vector>

#include "camera_pattern.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t *data, size_t size) {
    int32_t id = 0;
    int64_t ms = 0;
    int16_t w = 0, h = 0;
    if (size < sizeof id + sizeof ms + sizeof w + sizeof h) return 0;
    memcpy(&id, data, sizeof id);
    memcpy(&ms, data + 4, sizeof ms);
    memcpy(&w, data + 12, sizeof w);
    memcpy(&h, data + 14, sizeof h);
    // Large accepted sizes cost time only: keep them to a few hundred pixels a side.
    if (w > 300 && w <= SIM_CAMERA_MAX_SIDE) w = static_cast<int16_t>(w % 300 + 1);
    if (h > 300 && h <= SIM_CAMERA_MAX_SIDE) h = static_cast<int16_t>(h % 300 + 1);
    const size_t n = w > 0 && h > 0 && w <= SIM_CAMERA_MAX_SIDE && h <= SIM_CAMERA_MAX_SIDE
                         ? static_cast<size_t>(w) * static_cast<size_t>(h)
                         : 1;
    std::vector<unsigned> frame(n, 0xFFFFFFFFu);  // no pattern colour has a top byte
    const int rc = ftxsim::camera_pattern(id, ms, frame.data(), w, h);
    for (unsigned px : frame)
        if ((rc == 0) != (px <= 0xFFFFFFu)) abort();
    return 0;
}

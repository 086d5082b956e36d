// Any bytes given as a picture either fail to load or give a bitmap whose pixels and
// alpha mask can be read in full.
#include <stdint.h>
#include <stdlib.h>
#include <string.h>
#include <zlib.h>

#include <vector>

#include "minigui/common.h"
#include "minigui/gdi.h"
#include "minigui/minigui.h"

namespace {

uint32_t be32(const uint8_t *p) {
    return (static_cast<uint32_t>(p[0]) << 24) | (p[1] << 16) | (p[2] << 8) | p[3];
}

// Mutations nearly always break a PNG chunk's CRC, and the decoder then stops at the
// first chunk; mending the CRCs lets the fuzzer reach the header and data checks.
void mend_png_crcs(std::vector<uint8_t> &d) {
    static const uint8_t sig[8] = {0x89, 'P', 'N', 'G', '\r', '\n', 0x1A, '\n'};
    if (d.size() < 8 || memcmp(d.data(), sig, 8) != 0) return;
    size_t at = 8;
    while (at + 12 <= d.size()) {
        uint32_t len = be32(&d[at]);
        if (len > d.size() - at - 12) break;
        uint32_t crc = static_cast<uint32_t>(crc32(0, &d[at + 4], len + 4));
        uint8_t *c = &d[at + 8 + len];
        c[0] = static_cast<uint8_t>(crc >> 24);
        c[1] = static_cast<uint8_t>(crc >> 16);
        c[2] = static_cast<uint8_t>(crc >> 8);
        c[3] = static_cast<uint8_t>(crc);
        at += 12 + len;
    }
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t *data, size_t size) {
    if (size > (1u << 20)) return 0;
    std::vector<uint8_t> in(data, data + size);
    mend_png_crcs(in);
    BITMAP bmp{};
    int rc = LoadBitmapFromMem(HDC_SCREEN, &bmp, in.data(), static_cast<int>(in.size()), "bmp");
    if (rc != ERR_BMP_OK) {
        if (bmp.bmBits != nullptr || bmp.bmAlphaMask != nullptr) abort();
        return 0;
    }
    if (bmp.bmBits == nullptr || bmp.bmWidth == 0 || bmp.bmHeight == 0 ||
        bmp.bmPitch < bmp.bmWidth * bmp.bmBytesPerPixel)
        abort();
    // Touch the last byte of every row so a short allocation shows up under ASan.
    volatile Uint8 sink = 0;
    for (Uint32 y = 0; y < bmp.bmHeight; y++) {
        sink = sink ^ bmp.bmBits[static_cast<size_t>(y) * bmp.bmPitch +
                                 bmp.bmWidth * bmp.bmBytesPerPixel - 1];
        if (bmp.bmAlphaMask != nullptr)
            sink =
                sink ^ bmp.bmAlphaMask[static_cast<size_t>(y) * bmp.bmAlphaPitch + bmp.bmWidth - 1];
    }
    (void)sink;
    UnloadBitmap(&bmp);
    return 0;
}

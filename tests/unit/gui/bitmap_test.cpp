// Pictures from memory: sizes a small file may claim, and what a refused load leaves.
#include <string.h>
#include <zlib.h>

#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "minigui/common.h"
#include "minigui/gdi.h"
#include "minigui/minigui.h"

namespace {

void put_be32(std::string &d, uint32_t v) {
    for (int i = 3; i >= 0; i--)
        d += static_cast<char>(v >> (8 * i));
}

void put_chunk(std::string &d, const char *type, const std::string &body) {
    put_be32(d, static_cast<uint32_t>(body.size()));
    std::string tb = std::string(type, 4) + body;
    d += tb;
    put_be32(
        d, static_cast<uint32_t>(crc32(0, reinterpret_cast<const Bytef *>(tb.data()), tb.size())));
}

// A black 1-bit grey PNG, w x h: all-zero rows compress to almost nothing.
std::string mono_png(uint32_t w, uint32_t h) {
    std::string d("\x89PNG\r\n\x1a\n", 8), ihdr;
    put_be32(ihdr, w);
    put_be32(ihdr, h);
    ihdr += std::string("\x01\x00\x00\x00\x00", 5);  // depth 1, grey
    put_chunk(d, "IHDR", ihdr);
    std::vector<Bytef> raw(static_cast<size_t>(h) * (1 + (w + 7) / 8), 0);
    uLongf packed = compressBound(raw.size());
    std::string z(packed, '\0');
    EXPECT_EQ(compress2(reinterpret_cast<Bytef *>(z.data()), &packed, raw.data(), raw.size(), 9),
              Z_OK);
    z.resize(packed);
    put_chunk(d, "IDAT", z);
    put_chunk(d, "IEND", "");
    return d;
}

// A 1-bit BMP, w x h, with a two-colour palette.
std::string mono_bmp(uint32_t w, uint32_t h) {
    size_t stride = ((w + 31) / 32) * 4;
    std::string d(62 + stride * h, '\0');
    auto put32 = [&](size_t off, uint32_t v) {
        for (int i = 0; i < 4; i++)
            d[off + i] = static_cast<char>(v >> (8 * i));
    };
    d[0] = 'B';
    d[1] = 'M';
    put32(2, static_cast<uint32_t>(d.size()));
    put32(10, 62);
    put32(14, 40);
    put32(18, w);
    put32(22, h);
    d[26] = 1;
    d[28] = 1;
    put32(58, 0xFFFFFF);
    return d;
}

int load(const std::string &d, BITMAP *bmp) {
    memset(bmp, 0x5A, sizeof(*bmp));
    return LoadBitmapFromMem(HDC_SCREEN, bmp, d.data(), static_cast<int>(d.size()), "");
}

}  // namespace

TEST(BitmapLimits, SmallFilesClaimingHugePicturesAreRefused) {
    // 8192 x 4096 pixels would take 128 MB of screen pixels (256 MB while a PNG decodes)
    // from a few kilobytes of PNG or 4 MB of BMP.
    for (const std::string &d : {mono_png(8192, 4096), mono_bmp(8192, 4096)}) {
        BITMAP bmp;
        EXPECT_EQ(load(d, &bmp), ERR_BMP_LOAD) << d.substr(0, 4);
        EXPECT_EQ(bmp.bmBits, nullptr);
        EXPECT_EQ(bmp.bmAlphaMask, nullptr);
    }
}

TEST(BitmapLimits, LongStripsWithinThePixelBudgetLoad) {
    struct Case {
        std::string data;
        Uint32 w, h;
    } cases[] = {{mono_png(16384, 4), 16384, 4},
                 {mono_bmp(4, 16384), 4, 16384},
                 {mono_png(2048, 2048), 2048, 2048}};
    for (const Case &c : cases) {
        BITMAP bmp;
        ASSERT_EQ(load(c.data, &bmp), ERR_BMP_OK) << c.w << "x" << c.h;
        EXPECT_EQ(bmp.bmWidth, c.w);
        EXPECT_EQ(bmp.bmHeight, c.h);
        EXPECT_EQ(reinterpret_cast<Uint32 *>(bmp.bmBits)[0] & 0xFFFFFF, 0u);
        UnloadBitmap(&bmp);
    }
}

// Bitmaps: uncompressed BMP (1, 4, 8, 16, 24 and 32 bits) and PNG, decoded to screen
// pixels with an alpha mask when the picture has transparency; drawn stretched.
#include <png.h>
#include <stdlib.h>
#include <string.h>
#include <strings.h>

#include <algorithm>

#include "devfs.h"
#include "gui_internal.h"

using namespace ftxgui;

namespace {

constexpr Uint32 kMaxSide = 16384;
constexpr long kMaxFile = 64L << 20;
// A few kilobytes of compressed PNG or 1-bit BMP can claim gigabytes of pixels: pictures
// are refused above 64 MB of screen pixels, before anything is decoded.
constexpr uint64_t kMaxPixels = 4096u * 4096u;

bool too_big(Uint32 w, Uint32 h) {
    return w == 0 || h == 0 || w > kMaxSide || h > kMaxSide ||
           static_cast<uint64_t>(w) * h > kMaxPixels;
}

Uint32 rd16(const Uint8 *p) {
    return p[0] | (p[1] << 8);
}
Uint32 rd32(const Uint8 *p) {
    return p[0] | (p[1] << 8) | (p[2] << 16) | (static_cast<Uint32>(p[3]) << 24);
}

int alloc_bitmap(PBITMAP bmp, Uint32 w, Uint32 h, bool alpha) {
    memset(bmp, 0, sizeof(*bmp));
    bmp->bmBitsPerPixel = 32;
    bmp->bmBytesPerPixel = 4;
    bmp->bmWidth = w;
    bmp->bmHeight = h;
    bmp->bmPitch = w * 4;
    bmp->bmAlpha = 255;
    bmp->bmBits = static_cast<Uint8 *>(malloc(static_cast<size_t>(w) * h * 4));
    if (bmp->bmBits == nullptr) return ERR_BMP_MEM;
    if (alpha) {
        bmp->bmAlphaMask = static_cast<Uint8 *>(malloc(static_cast<size_t>(w) * h));
        if (bmp->bmAlphaMask == nullptr) {
            free(bmp->bmBits);
            bmp->bmBits = nullptr;
            return ERR_BMP_MEM;
        }
        bmp->bmAlphaPitch = w;
        bmp->bmType |= BMP_TYPE_ALPHA_MASK;
    }
    return ERR_BMP_OK;
}

// Bit position and width of a channel mask (BI_BITFIELDS).
void mask_shift(Uint32 mask, int &shift, int &bits) {
    shift = 0;
    bits = 0;
    if (mask == 0) return;
    while ((mask & 1) == 0) {
        mask >>= 1;
        shift++;
    }
    while ((mask & 1) != 0) {
        mask >>= 1;
        bits++;
    }
}

int channel(Uint32 v, Uint32 mask, int shift, int bits) {
    if (bits == 0) return 0;
    Uint32 c = (v & mask) >> shift;
    return static_cast<int>(bits >= 8 ? c >> (bits - 8) : (c * 255) / ((1u << bits) - 1));
}

int load_bmp(PBITMAP bmp, const Uint8 *d, size_t size) {
    if (size < 54 || d[0] != 'B' || d[1] != 'M') return ERR_BMP_UNKNOWN_TYPE;
    Uint32 dataOff = rd32(d + 10), hdr = rd32(d + 14);
    if (hdr < 40 || 14 + static_cast<size_t>(hdr) > size) return ERR_BMP_LOAD;
    int32_t w = static_cast<int32_t>(rd32(d + 18)), h = static_cast<int32_t>(rd32(d + 22));
    Uint32 bpp = rd16(d + 28), comp = rd32(d + 30), colors = rd32(d + 46);
    bool topDown = h < 0;
    Uint32 W = static_cast<Uint32>(w),
           H = topDown ? 0u - static_cast<Uint32>(h) : static_cast<Uint32>(h);
    if (w <= 0 || too_big(W, H)) return ERR_BMP_LOAD;
    if (comp != 0 && !(comp == 3 && (bpp == 16 || bpp == 32))) return ERR_BMP_NOT_SUPPORTED;
    if (bpp != 1 && bpp != 4 && bpp != 8 && bpp != 16 && bpp != 24 && bpp != 32)
        return ERR_BMP_NOT_SUPPORTED;
    Uint32 rm = 0x7C00, gm = 0x3E0, bmask = 0x1F;
    if (bpp == 32) {
        rm = 0xFF0000;
        gm = 0xFF00;
        bmask = 0xFF;
    }
    if (comp == 3) {
        if (14 + 40 + 12 > size) return ERR_BMP_LOAD;
        rm = rd32(d + 54);
        gm = rd32(d + 58);
        bmask = rd32(d + 62);
    }
    Uint32 palette[256] = {};
    if (bpp <= 8) {
        Uint32 n = colors != 0 ? colors : (1u << bpp);
        if (n > 256) return ERR_BMP_LOAD;
        size_t palOff = 14 + static_cast<size_t>(hdr);
        if (palOff + n * 4 > size) return ERR_BMP_LOAD;
        for (Uint32 i = 0; i < n; i++) {
            const Uint8 *p = d + palOff + i * 4;
            palette[i] = rgb_pixel(p[2], p[1], p[0]);
        }
    }
    size_t stride = ((static_cast<size_t>(W) * bpp + 31) / 32) * 4;
    if (dataOff > size || stride * H > size - dataOff) return ERR_BMP_LOAD;
    int rs, rb, gs, gb, bs, bb;
    mask_shift(rm, rs, rb);
    mask_shift(gm, gs, gb);
    mask_shift(bmask, bs, bb);
    int rc = alloc_bitmap(bmp, W, H, false);
    if (rc != ERR_BMP_OK) return rc;
    Uint32 *out = reinterpret_cast<Uint32 *>(bmp->bmBits);
    for (Uint32 y = 0; y < H; y++) {
        const Uint8 *row = d + dataOff + stride * (topDown ? y : H - 1 - y);
        Uint32 *o = out + static_cast<size_t>(y) * W;
        for (Uint32 x = 0; x < W; x++) {
            switch (bpp) {
                case 1:
                    o[x] = palette[(row[x / 8] >> (7 - x % 8)) & 1];
                    break;
                case 4:
                    o[x] = palette[(row[x / 2] >> (x % 2 == 0 ? 4 : 0)) & 0xF];
                    break;
                case 8:
                    o[x] = palette[row[x]];
                    break;
                case 16: {
                    Uint32 v = rd16(row + x * 2);
                    o[x] = rgb_pixel(channel(v, rm, rs, rb), channel(v, gm, gs, gb),
                                     channel(v, bmask, bs, bb));
                    break;
                }
                case 24:
                    o[x] = rgb_pixel(row[x * 3 + 2], row[x * 3 + 1], row[x * 3]);
                    break;
                default: {
                    Uint32 v = rd32(row + x * 4);
                    o[x] = rgb_pixel(channel(v, rm, rs, rb), channel(v, gm, gs, gb),
                                     channel(v, bmask, bs, bb));
                    break;
                }
            }
        }
    }
    return ERR_BMP_OK;
}

int load_png(PBITMAP bmp, const Uint8 *d, size_t size) {
    png_image img;
    memset(&img, 0, sizeof(img));
    img.version = PNG_IMAGE_VERSION;
    if (png_image_begin_read_from_memory(&img, d, size) == 0) return ERR_BMP_LOAD;
    if (too_big(img.width, img.height)) {
        png_image_free(&img);
        return ERR_BMP_LOAD;
    }
    img.format = PNG_FORMAT_RGBA;
    std::vector<Uint8> rgba(PNG_IMAGE_SIZE(img));
    if (png_image_finish_read(&img, nullptr, rgba.data(), 0, nullptr) == 0) {
        png_image_free(&img);
        return ERR_BMP_LOAD;
    }
    bool alpha = false;
    for (size_t i = 3; i < rgba.size(); i += 4)
        if (rgba[i] != 0xFF) alpha = true;
    int rc = alloc_bitmap(bmp, img.width, img.height, alpha);
    if (rc != ERR_BMP_OK) return rc;
    Uint32 *out = reinterpret_cast<Uint32 *>(bmp->bmBits);
    size_t n = static_cast<size_t>(img.width) * img.height;
    for (size_t i = 0; i < n; i++) {
        out[i] = rgb_pixel(rgba[i * 4], rgba[i * 4 + 1], rgba[i * 4 + 2]);
        if (alpha) bmp->bmAlphaMask[i] = rgba[i * 4 + 3];
    }
    return ERR_BMP_OK;
}

}  // namespace

extern "C" {

int LoadBitmapFromMem(HDC, PBITMAP bmp, const void *mem, int size, const char *ext) {
    if (bmp == nullptr || mem == nullptr || size <= 0) return ERR_BMP_ERROR_SOURCE;
    memset(bmp, 0, sizeof(*bmp));
    const Uint8 *d = static_cast<const Uint8 *>(mem);
    size_t n = static_cast<size_t>(size);
    bool png = n >= 8 && png_sig_cmp(d, 0, 8) == 0;
    bool bmpMagic = n >= 2 && d[0] == 'B' && d[1] == 'M';
    if (!png && !bmpMagic) {
        (void)ext;
        return ERR_BMP_UNKNOWN_TYPE;
    }
    return png ? load_png(bmp, d, n) : load_bmp(bmp, d, n);
}

int LoadBitmapFromFile(HDC hdc, PBITMAP bmp, const char *file) {
    if (bmp == nullptr || file == nullptr) return ERR_BMP_ERROR_SOURCE;
    memset(bmp, 0, sizeof(*bmp));
    FILE *f = dev_fopen(file, "rb");
    if (f == nullptr) return ERR_BMP_FILEIO;
    std::vector<Uint8> data;
    Uint8 buf[65536];
    size_t got;
    while ((got = fread(buf, 1, sizeof(buf), f)) > 0) {
        data.insert(data.end(), buf, buf + got);
        if (static_cast<long>(data.size()) > kMaxFile) {
            fclose(f);
            return ERR_BMP_LOAD;
        }
    }
    fclose(f);
    if (data.empty()) return ERR_BMP_CANT_READ;
    const char *dot = strrchr(file, '.');
    return LoadBitmapFromMem(hdc, bmp, data.data(), static_cast<int>(data.size()),
                             dot != nullptr ? dot + 1 : "");
}

void UnloadBitmap(PBITMAP bmp) {
    if (bmp == nullptr) return;
    free(bmp->bmBits);
    free(bmp->bmAlphaMask);
    bmp->bmBits = nullptr;
    bmp->bmAlphaMask = nullptr;
}

int SetBitmapKeyColor(HDC, PBITMAP bmp, Uint8 r, Uint8 g, Uint8 b) {
    if (bmp == nullptr) return -1;
    bmp->bmType |= BMP_TYPE_COLORKEY;
    bmp->bmColorKey = rgb_pixel(r, g, b);
    return 0;
}

BOOL FillBoxWithBitmap(HDC hdc, int x, int y, int w, int h, const BITMAP *bmp) {
    DC *dc = as_dc(hdc);
    if (dc == nullptr || bmp == nullptr || bmp->bmBits == nullptr || bmp->bmWidth == 0 ||
        bmp->bmHeight == 0 || bmp->bmBytesPerPixel != 4)
        return FALSE;
    if (w <= 0) w = static_cast<int>(bmp->bmWidth);
    if (h <= 0) h = static_cast<int>(bmp->bmHeight);
    RECT dst{x + dc->ox, y + dc->oy, x + dc->ox + w, y + dc->oy + h};
    bool key = (bmp->bmType & BMP_TYPE_COLORKEY) != 0;
    bool mask = (bmp->bmType & BMP_TYPE_ALPHA_MASK) != 0 && bmp->bmAlphaMask != nullptr;
    int global = (bmp->bmType & BMP_TYPE_ALPHACHANNEL) != 0 ? bmp->bmAlpha : 255;
    DcDraw fb(dc);
    for (const RECT &c : dc->clip.rects) {
        RECT r;
        if (!IntersectRect(&r, &c, &dst)) continue;
        for (int py = r.top; py < r.bottom; py++) {
            Uint32 sy =
                static_cast<Uint32>((static_cast<int64_t>(py - dst.top) * bmp->bmHeight) / h);
            const Uint32 *src = reinterpret_cast<const Uint32 *>(
                bmp->bmBits + static_cast<size_t>(sy) * bmp->bmPitch);
            const Uint8 *am =
                mask ? bmp->bmAlphaMask + static_cast<size_t>(sy) * bmp->bmAlphaPitch : nullptr;
            Uint32 *out = g_fb + static_cast<size_t>(py) * g_fbW;
            for (int px = r.left; px < r.right; px++) {
                Uint32 sx =
                    static_cast<Uint32>((static_cast<int64_t>(px - dst.left) * bmp->bmWidth) / w);
                Uint32 s = src[sx] & 0xFFFFFF;
                if (key && s == (bmp->bmColorKey & 0xFFFFFF)) continue;
                int a = am != nullptr ? am[sx] * global / 255 : global;
                if (a >= 255)
                    out[px] = s;
                else
                    px_blend(dc, px, py, s, a);
            }
        }
    }
    return TRUE;
}

}  // extern "C"

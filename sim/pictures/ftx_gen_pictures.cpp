// ftx-gen-pictures OUTDIR: the calibration pictures of the handset image,
// OUTDIR/ratio_25_0000.png .. ratio_25_0011.png. Picture N is a field of stripes whose
// coloured share grows with N, in a colour of its own, with its four-digit number written
// large in a white box in the middle, so each one is told apart at a glance.
#include <png.h>
#include <stdio.h>
#include <string.h>

#include <string>
#include <vector>

namespace {

const int kWidth = 360, kHeight = 640, kCount = 12, kPeriod = 40;

// 5x7 digits, one row a byte, the top bit of 5 on the left.
const unsigned char kDigits[10][7] = {
    {0x0E, 0x11, 0x13, 0x15, 0x19, 0x11, 0x0E}, {0x04, 0x0C, 0x04, 0x04, 0x04, 0x04, 0x0E},
    {0x0E, 0x11, 0x01, 0x02, 0x04, 0x08, 0x1F}, {0x1F, 0x02, 0x04, 0x02, 0x01, 0x11, 0x0E},
    {0x02, 0x06, 0x0A, 0x12, 0x1F, 0x02, 0x02}, {0x1F, 0x10, 0x1E, 0x01, 0x01, 0x11, 0x0E},
    {0x06, 0x08, 0x10, 0x1E, 0x11, 0x11, 0x0E}, {0x1F, 0x01, 0x02, 0x04, 0x08, 0x08, 0x08},
    {0x0E, 0x11, 0x11, 0x0E, 0x11, 0x11, 0x0E}, {0x0E, 0x11, 0x11, 0x0F, 0x01, 0x02, 0x0C},
};

// Twelve colours around the colour wheel.
const unsigned char kHues[kCount][3] = {
    {230, 40, 40},  {230, 130, 30}, {220, 210, 30}, {130, 210, 40}, {40, 190, 60},  {30, 190, 150},
    {30, 170, 220}, {40, 90, 220},  {110, 60, 220}, {180, 50, 210}, {220, 40, 150}, {140, 140, 140},
};

struct Image {
    std::vector<unsigned char> rgb = std::vector<unsigned char>((size_t)kWidth * kHeight * 3, 0);
    void set(int x, int y, const unsigned char *c) {
        if (x < 0 || y < 0 || x >= kWidth || y >= kHeight) return;
        memcpy(&rgb[((size_t)y * kWidth + (size_t)x) * 3], c, 3);
    }
    void box(int x0, int y0, int x1, int y1, const unsigned char *c) {
        for (int y = y0; y < y1; y++)
            for (int x = x0; x < x1; x++)
                set(x, y, c);
    }
};

void draw_number(Image &img, int n) {
    const unsigned char white[3] = {255, 255, 255}, black[3] = {0, 0, 0};
    char text[8];
    snprintf(text, sizeof(text), "%04d", n);
    const int scale = 12, glyphW = 5 * scale, gap = scale * 2;
    const int textW = 4 * glyphW + 3 * gap, textH = 7 * scale;
    const int x0 = (kWidth - textW) / 2, y0 = (kHeight - textH) / 2;
    img.box(x0 - gap, y0 - gap, x0 + textW + gap, y0 + textH + gap, white);
    for (int i = 0; i < 4; i++) {
        const unsigned char *glyph = kDigits[text[i] - '0'];
        for (int row = 0; row < 7; row++)
            for (int col = 0; col < 5; col++)
                if (glyph[row] & (0x10 >> col)) {
                    const int x = x0 + i * (glyphW + gap) + col * scale, y = y0 + row * scale;
                    img.box(x, y, x + scale, y + scale, black);
                }
    }
}

Image picture(int n) {
    Image img;
    const unsigned char dark[3] = {20, 20, 20};
    // The coloured share of each stripe period: (n + 1) / (kCount + 1).
    const int lit = kPeriod * (n + 1) / (kCount + 1);
    for (int y = 0; y < kHeight; y++)
        for (int x = 0; x < kWidth; x++)
            img.set(x, y, (x % kPeriod) < lit ? kHues[n] : dark);
    draw_number(img, n);
    return img;
}

int write_png(const std::string &path, const Image &img) {
    png_image p;
    memset(&p, 0, sizeof(p));
    p.version = PNG_IMAGE_VERSION;
    p.width = kWidth;
    p.height = kHeight;
    p.format = PNG_FORMAT_RGB;
    if (png_image_write_to_file(&p, path.c_str(), 0, img.rgb.data(), 0, nullptr) == 0) {
        fprintf(stderr, "ftx-gen-pictures: %s: %s\n", path.c_str(), p.message);
        return -1;
    }
    return 0;
}

}  // namespace

int main(int argc, char **argv) {
    if (argc != 2) {
        fprintf(stderr, "usage: ftx-gen-pictures OUTDIR\n");
        return 2;
    }
    for (int n = 0; n < kCount; n++) {
        char name[64];
        snprintf(name, sizeof(name), "/ratio_25_%04d.png", n);
        if (write_png(std::string(argv[1]) + name, picture(n)) != 0) return 1;
    }
    return 0;
}

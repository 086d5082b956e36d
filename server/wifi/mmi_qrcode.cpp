// QR code pictures: libqrencode encodes, libpng writes the PNG and reads it back, and the BMP
// copy is written here. Every file goes through the device file system.
#include "wifi/mmi_qrcode.h"

#include <errno.h>
#include <png.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>

#include <mutex>

#include <android/log.h>

#include "core/mmi_file.h"
#include "devfs.h"
#include "screens/mmi_identity.h"

#define QR_TAG "FTX_BARCODE"
#define QR_DEBUG(...) __android_log_print(ANDROID_LOG_DEBUG, QR_TAG, __VA_ARGS__)
#define QR_ERROR(...) __android_log_print(ANDROID_LOG_ERROR, QR_TAG, __VA_ARGS__)

namespace {

// The writer is created for this libpng version; any 1.6 library takes it.
const char kPngWriterVersion[] = "1.6.25";
// Larger pictures are refused on reading (a symbol of the largest version is 555 pixels).
const png_uint_32 kMaxReadSide = 4096;
const size_t kPathSize = 512;

// The Wi-Fi thread and the GUI thread may both make pictures; one at a time.
std::mutex s_lock;

[[noreturn]] void fail(const char *message) {
    fputs(message, stderr);
    exit(1);
}

void put16(unsigned char *p, unsigned v) {
    p[0] = static_cast<unsigned char>(v);
    p[1] = static_cast<unsigned char>(v >> 8);
}

void put32(unsigned char *p, unsigned long v) {
    put16(p, static_cast<unsigned>(v & 0xFFFF));
    put16(p + 2, static_cast<unsigned>(v >> 16));
}

// One channel laid over white.
unsigned char over_white(unsigned c, unsigned a) {
    return static_cast<unsigned char>((c * a + 255 * (255 - a)) / 255);
}

}  // namespace

int writePNG(const QRcode *symbol, const char *path, int type) {
    if (symbol == nullptr || path == nullptr || type != MMI_QR_PNG_RGBA) return -1;
    const int side = (symbol->width + 2 * MMI_QR_QUIET_MODULES) * MMI_QR_MODULE_PIXELS;
    unsigned char *row = static_cast<unsigned char *>(malloc(static_cast<size_t>(side) * 4));
    if (row == nullptr) fail("Failed to allocate memory.\n");
    FILE *fp = dev_fopen(path, "wb");
    if (fp == nullptr) {
        fprintf(stderr, "Failed to create file: %s\n", path);
        exit(1);
    }
    png_structp png = png_create_write_struct(kPngWriterVersion, nullptr, nullptr, nullptr);
    if (png == nullptr) fail("Failed to initialize PNG writer.\n");
    png_infop info = png_create_info_struct(png);
    if (info == nullptr) fail("Failed to initialize PNG write.\n");
    if (setjmp(png_jmpbuf(png))) {
        png_destroy_write_struct(&png, &info);
        fclose(fp);
        fail("Failed to write PNG image.\n");
    }
    png_init_io(png, fp);
    png_set_IHDR(png, info, static_cast<png_uint_32>(side), static_cast<png_uint_32>(side), 8,
                 PNG_COLOR_TYPE_RGB_ALPHA, PNG_INTERLACE_NONE, PNG_COMPRESSION_TYPE_DEFAULT,
                 PNG_FILTER_TYPE_DEFAULT);
    png_set_pHYs(png, info, MMI_QR_PIXELS_PER_METRE, MMI_QR_PIXELS_PER_METRE, PNG_RESOLUTION_METER);
    png_write_info(png, info);

    // The quiet zone above and below: white rows.
    memset(row, 0xFF, static_cast<size_t>(side) * 4);
    const int quietRows = MMI_QR_QUIET_MODULES * MMI_QR_MODULE_PIXELS;
    for (int y = 0; y < quietRows; y++)
        png_write_row(png, row);
    for (int my = 0; my < symbol->width; my++) {
        const unsigned char *modules = symbol->data + static_cast<size_t>(my) * symbol->width;
        unsigned char *px = row + static_cast<size_t>(quietRows) * 4;
        for (int mx = 0; mx < symbol->width; mx++) {
            // Bit 0 of a module is dark.
            unsigned char v = (modules[mx] & 1) != 0 ? 0x00 : 0xFF;
            for (int k = 0; k < MMI_QR_MODULE_PIXELS; k++, px += 4) {
                px[0] = px[1] = px[2] = v;
                px[3] = 0xFF;
            }
        }
        for (int k = 0; k < MMI_QR_MODULE_PIXELS; k++)
            png_write_row(png, row);
    }
    memset(row, 0xFF, static_cast<size_t>(side) * 4);
    for (int y = 0; y < quietRows; y++)
        png_write_row(png, row);
    png_write_end(png, info);
    png_destroy_write_struct(&png, &info);
    fclose(fp);
    free(row);
    return 0;
}

int read_png(const char *path, mmi_qr_image *image) {
    if (path == nullptr || image == nullptr) return -1;
    FILE *fp = dev_fopen(path, "rb");
    if (fp == nullptr) return -1;
    png_image img;
    memset(&img, 0, sizeof img);
    img.version = PNG_IMAGE_VERSION;
    int rc = -1;
    if (png_image_begin_read_from_stdio(&img, fp) != 0 && img.width > 0 && img.height > 0 &&
        img.width <= kMaxReadSide && img.height <= kMaxReadSide) {
        img.format = PNG_FORMAT_RGBA;
        std::vector<unsigned char> pixels(PNG_IMAGE_SIZE(img));
        if (png_image_finish_read(&img, nullptr, pixels.data(), 0, nullptr) != 0) {
            image->width = static_cast<int>(img.width);
            image->height = static_cast<int>(img.height);
            image->rgba = std::move(pixels);
            rc = 0;
        }
    }
    png_image_free(&img);
    fclose(fp);
    return rc;
}

int write_bmp(const char *path, const mmi_qr_image *image) {
    if (path == nullptr || image == nullptr || image->width <= 0 || image->height <= 0 ||
        image->rgba.size() != static_cast<size_t>(image->width) * image->height * 4)
        return -1;
    const size_t w = static_cast<size_t>(image->width), h = static_cast<size_t>(image->height);
    const size_t stride = (w * 3 + 3) & ~static_cast<size_t>(3);
    const size_t headerSize = 54;
    std::vector<unsigned char> file(headerSize + stride * h, 0);
    unsigned char *d = file.data();
    d[0] = 'B';
    d[1] = 'M';
    put32(d + 2, file.size());
    put32(d + 10, headerSize);
    put32(d + 14, 40);  // the information header
    put32(d + 18, w);
    put32(d + 22, h);  // positive: the bottom row first
    put16(d + 26, 1);  // planes
    put16(d + 28, 24);
    put32(d + 30, 0);  // uncompressed
    put32(d + 34, stride * h);
    put32(d + 38, MMI_QR_PIXELS_PER_METRE);
    put32(d + 42, MMI_QR_PIXELS_PER_METRE);
    for (size_t y = 0; y < h; y++) {
        const unsigned char *src = image->rgba.data() + (h - 1 - y) * w * 4;
        unsigned char *out = d + headerSize + y * stride;
        for (size_t x = 0; x < w; x++, src += 4, out += 3) {
            out[0] = over_white(src[2], src[3]);
            out[1] = over_white(src[1], src[3]);
            out[2] = over_white(src[0], src[3]);
        }
    }
    // The main menu may be reading the picture: it sees the old one or the new one.
    if (mmi_file_replace(path, file.data(), file.size()) != 0) {
        QR_ERROR("%s: cannot write %s", __func__, path);
        return -1;
    }
    return 0;
}

int Generate_QrencodePicture(const char *text, int length, const char *png_path) {
    // The encoder cannot encode an empty text, and its failure would end the process.
    if (text == nullptr || png_path == nullptr || text[0] == '\0') {
        QR_ERROR("%s,L%d::fail,intext=%p,outfile=%p.", __func__, __LINE__, text, png_path);
        return -1;
    }
    int datalen = static_cast<int>(strlen(text));
    if (datalen != length) {
        QR_ERROR("%s,L%d::length fail,length=%d,datalen=%d.", __func__, __LINE__, length, datalen);
        return -1;
    }
    std::lock_guard<std::mutex> lk(s_lock);
    QRcode *symbol = QRcode_encodeString(text, 0, QR_ECLEVEL_L, QR_MODE_8, 1);
    if (symbol == nullptr) {
        if (errno == ERANGE) fail("Failed to encode the input data: Input data too large\n");
        perror("Failed to encode the input data");
        exit(1);
    }
    writePNG(symbol, png_path, MMI_QR_PNG_RGBA);
    mmi_qr_image image;
    if (read_png(png_path, &image) == 0) {
        // "X.png" -> "X.bmp": the path without its last four characters.
        int keep = static_cast<int>(strlen(png_path));
        keep = keep > 4 ? keep - 4 : 0;
        char bmp[kPathSize];
        if (snprintf(bmp, sizeof bmp, "%.*s.bmp", keep, png_path) < static_cast<int>(sizeof bmp))
            write_bmp(bmp, &image);
        else
            QR_ERROR("%s: path too long: %s", __func__, png_path);
    } else {
        QR_ERROR("%s: cannot read back %s", __func__, png_path);
    }
    QRcode_free(symbol);
    return 0;
}

void create_barcode_qrcode(void) {
    QR_DEBUG("create_barcode_qrcode begin.\n");
    char code[MMI_IDENTITY_TEXT_SIZE];
    if (mmi_identity_text(MMI_ID_BOARD, code, sizeof code) != 0)
        snprintf(code, sizeof code, "%s", MMI_QR_BOARD_CODE_NONE);
    size_t n = strlen(code);
    if (n == 0 || n > MMI_QR_BOARD_CODE_MAX) {
        QR_ERROR("barcode info error.\n");
        snprintf(code, sizeof code, "%s", MMI_QR_BOARD_CODE_NONE);
        n = strlen(code);
    }
    Generate_QrencodePicture(code, static_cast<int>(n), MMI_QR_BOARD_PNG);
    QR_DEBUG("create_barcode_qrcode end.\n");
}

// QR code pictures: a text encoded as a QR code symbol, written as a PNG picture and copied
// beside it as a BMP picture, which the GUI library loads. The Wi-Fi address
// ("/data/mmi_ip.png") and the board's bar code ("/data/board_id.png") are made this way.
#pragma once

#include <qrencode.h>

#include <vector>

// Picture types of writePNG.
#define MMI_QR_PNG_RGBA 1  // 8 bits per channel, red, green, blue and alpha

// Pixels of one module of the symbol, and modules of white around it.
#define MMI_QR_MODULE_PIXELS 3
#define MMI_QR_QUIET_MODULES 4
// Pixel density written into the PNG (pixels per metre, both ways).
#define MMI_QR_PIXELS_PER_METRE 2834

// The bar code encoded when the board has none, or one that does not fit.
#define MMI_QR_BOARD_CODE_NONE "000000000000"
#define MMI_QR_BOARD_CODE_MAX 12
#define MMI_QR_BOARD_PNG "/data/board_id.png"
#define MMI_QR_BOARD_BMP "/data/board_id.bmp"

// A picture read back from a PNG: 8-bit RGBA, rows top first, no padding.
struct mmi_qr_image {
    int width = 0;
    int height = 0;
    std::vector<unsigned char> rgba;
};

// Encodes text (length must be strlen(text)) into png_path (a device path) and its BMP copy
// ("X.png" -> "X.bmp"). 0, or -1 on a bad argument (nothing is written). A failing encoder or
// PNG writer ends the process with status 1 after its message on the standard error stream.
int Generate_QrencodePicture(const char *text, int length, const char *png_path);

// The board's bar code (the product information's board number) into MMI_QR_BOARD_PNG and
// MMI_QR_BOARD_BMP; a missing one, an empty one or one longer than 12 characters becomes
// MMI_QR_BOARD_CODE_NONE.
void create_barcode_qrcode(void);

// Writes symbol as a PNG picture of the given type (MMI_QR_PNG_RGBA) to a device path: black
// modules of 3 x 3 pixels on white, with the quiet zone. 0, or -1 for another type; the
// failures of the writer end the process.
int writePNG(const QRcode *symbol, const char *path, int type);
// Reads a PNG picture at a device path into image. 0, or -1 when it cannot be read.
int read_png(const char *path, mmi_qr_image *image);
// Writes image as an uncompressed 24-bit BMP picture to a device path (written beside it and
// renamed over it, so a reader sees the old picture or the new one). Alpha is laid over
// white. 0, or -1.
int write_bmp(const char *path, const mmi_qr_image *image);

// QR code pictures: what a bad argument leaves, the PNG's form, the BMP copy as the GUI
// library loads it, what a scanner reads from both, the board's bar code, and where the
// board-code screen puts the picture.
#include <png.h>
#include <stdio.h>

#include <algorithm>
#include <cstdlib>
#include <filesystem>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "core/ftx_lib_binding.h"
#include "minigui/common.h"
#include "minigui/gdi.h"
#include "minigui/minigui.h"
#include "screens/mmi_qrscreen.h"
#include "support/scanner.h"
#include "support/temp_root.h"
#include "unit/config/log_capture.h"
#include "wifi/mmi_qrcode.h"

namespace {

namespace fs = std::filesystem;

// A text for a scanner: mixed case and punctuation, which the 8-bit mode keeps as they are.
const char kText[] = "Board ftx-42/Ab.C?x=1";

int generate(const std::string &text, const char *path) {
    return Generate_QrencodePicture(text.c_str(), static_cast<int>(text.size()), path);
}

std::vector<std::string> files(const TempRoot &root, const char *folder) {
    std::vector<std::string> out;
    std::error_code ec;
    for (const auto &e : fs::directory_iterator(root.host(folder), ec))
        out.push_back(e.path().filename().string());
    return out;
}

// The RGB pixels LoadBitmap gives for a device path; empty when it refuses the file.
std::vector<Uint32> loaded(const char *path, int *w = nullptr) {
    BITMAP bmp{};
    if (LoadBitmap(HDC_SCREEN, &bmp, path) != 0) return {};
    std::vector<Uint32> px;
    for (Uint32 y = 0; y < bmp.bmHeight; y++)
        for (Uint32 x = 0; x < bmp.bmWidth; x++)
            px.push_back(reinterpret_cast<const Uint32 *>(bmp.bmBits + y * bmp.bmPitch)[x] &
                         0xFFFFFF);
    if (w != nullptr) *w = static_cast<int>(bmp.bmWidth);
    UnloadBitmap(&bmp);
    return px;
}

class QrPicture : public ::testing::Test {
  protected:
    void SetUp() override { fs::create_directories(root.host("/data")); }
    TempRoot root;
    LogCapture log;
};

TEST_F(QrPicture, BadArgumentsWriteNothing) {
    EXPECT_EQ(-1, Generate_QrencodePicture(nullptr, 3, "/data/a.png"));
    EXPECT_TRUE(log.has("E FTX_BARCODE: Generate_QrencodePicture,L"));
    EXPECT_TRUE(log.has("::fail,intext=(nil),outfile="));
    EXPECT_EQ(-1, Generate_QrencodePicture("abc", 3, nullptr));
    EXPECT_EQ(-1, Generate_QrencodePicture("", 0, "/data/a.png"));
    EXPECT_EQ(-1, Generate_QrencodePicture("abc", 4, "/data/a.png"));
    EXPECT_TRUE(log.has("::length fail,length=4,datalen=3."));
    EXPECT_EQ(-1, Generate_QrencodePicture("abc", 2, "/data/a.png"));
    EXPECT_TRUE(files(root, "/data").empty());
}

TEST_F(QrPicture, PngIsRgbaWithModulesOfThreePixelsAndAQuietZone) {
    ASSERT_EQ(0, generate("000000000000", "/data/mmi_ip.png"));
    FILE *fp = fopen(root.host("/data/mmi_ip.png").c_str(), "rb");
    ASSERT_NE(nullptr, fp);
    png_structp p = png_create_read_struct(PNG_LIBPNG_VER_STRING, nullptr, nullptr, nullptr);
    png_infop info = png_create_info_struct(p);
    ASSERT_EQ(0, setjmp(png_jmpbuf(p)));
    png_init_io(p, fp);
    png_read_info(p, info);
    // Twelve digits fit the smallest symbol: 21 modules, 4 more on each side, 3 pixels each.
    const int side = (21 + 8) * 3;
    EXPECT_EQ(side, static_cast<int>(png_get_image_width(p, info)));
    EXPECT_EQ(side, static_cast<int>(png_get_image_height(p, info)));
    EXPECT_EQ(PNG_COLOR_TYPE_RGB_ALPHA, png_get_color_type(p, info));
    EXPECT_EQ(8, png_get_bit_depth(p, info));
    png_uint_32 xres = 0, yres = 0;
    int unit = -1;
    ASSERT_NE(0u, png_get_pHYs(p, info, &xres, &yres, &unit));
    EXPECT_EQ(std::vector<png_uint_32>({2834, 2834, PNG_RESOLUTION_METER}),
              std::vector<png_uint_32>({xres, yres, static_cast<png_uint_32>(unit)}));
    png_destroy_read_struct(&p, &info, nullptr);
    fclose(fp);
    mmi_qr_image image;
    ASSERT_EQ(0, read_png("/data/mmi_ip.png", &image));
    auto rgba = [&](int x, int y) {
        const unsigned char *c = &image.rgba[(static_cast<size_t>(y) * side + x) * 4];
        return std::vector<int>{c[0], c[1], c[2], c[3]};
    };
    const std::vector<int> white{255, 255, 255, 255}, black{0, 0, 0, 255};
    // The quiet zone is white; the finder pattern's corner module (4, 4) is black, all 3 x 3
    // of its pixels, and its ring's inner module (5, 5) white.
    for (int i = 0; i < 12; i++) {
        EXPECT_EQ(white, rgba(i, 40));
        EXPECT_EQ(white, rgba(40, side - 1 - i));
    }
    for (int k = 0; k < 9; k++)
        EXPECT_EQ(black, rgba(12 + k % 3, 12 + k / 3));
    EXPECT_EQ(white, rgba(16, 16));
}

TEST_F(QrPicture, BmpBesideThePngLoadsAsTheSamePicture) {
    ASSERT_EQ(0, generate(kText, "/data/mmi_ip.png"));
    EXPECT_TRUE(root.exists("/data/mmi_ip.bmp"));
    int w = 0;
    std::vector<Uint32> png = loaded("/data/mmi_ip.png", &w);
    std::vector<Uint32> bmp = loaded("/data/mmi_ip.bmp");
    ASSERT_FALSE(png.empty());
    EXPECT_EQ(static_cast<size_t>(w) * w, png.size());
    EXPECT_TRUE(png == bmp) << "the BMP differs from the PNG";
    // Written beside and renamed over: nothing else is left in the folder.
    auto names = files(root, "/data");
    std::sort(names.begin(), names.end());
    EXPECT_EQ((std::vector<std::string>{"mmi_ip.bmp", "mmi_ip.png"}), names);
}

TEST_F(QrPicture, AScannerReadsTheTextFromThePngAndTheBmp) {
    if (!scanner::available()) GTEST_SKIP() << "zbarimg (zbar-tools) is not installed";
    const std::string longer = std::string(kText) + " " + std::string(120, 'z') + "END";
    for (const std::string &text : {std::string(kText), longer}) {
        ASSERT_EQ(0, generate(text, "/data/code.png"));
        EXPECT_EQ(text, scanner::read(root.host("/data/code.png")));
        EXPECT_EQ(text, scanner::read(root.host("/data/code.bmp")));
    }
}

TEST_F(QrPicture, BmpLaysAlphaOverWhiteAndUnreadablePngsAreRefused) {
    // 2 x 1: opaque red, fully transparent blue.
    mmi_qr_image image;
    image.width = 2;
    image.height = 1;
    image.rgba = {255, 0, 0, 255, 0, 0, 255, 0};
    ASSERT_EQ(0, write_bmp("/data/two.bmp", &image));
    EXPECT_EQ((std::vector<Uint32>{0xFF0000, 0xFFFFFF}), loaded("/data/two.bmp"));
    image.rgba.pop_back();  // one byte short of the size
    EXPECT_EQ(-1, write_bmp("/data/two.bmp", &image));

    root.write("/data/not.png", "not a picture");
    mmi_qr_image back;
    EXPECT_EQ(-1, read_png("/data/not.png", &back));
    EXPECT_EQ(-1, read_png("/data/missing.png", &back));
    EXPECT_EQ(-1, writePNG(nullptr, "/data/x.png", MMI_QR_PNG_RGBA));
}

using QrPictureDeathTest = QrPicture;

TEST_F(QrPictureDeathTest, EncoderAndWriterFailuresEndTheProcess) {
    GTEST_FLAG_SET(death_test_style, "threadsafe");
    EXPECT_EXIT(generate("abc", "/no/such/folder/a.png"), ::testing::ExitedWithCode(1),
                "Failed to create file: /no/such/folder/a.png");
    // Far more than the largest symbol holds.
    EXPECT_EXIT(generate(std::string(8000, 'x'), "/data/big.png"), ::testing::ExitedWithCode(1),
                "Failed to encode the input data: Input data too large");
}

// The board's bar code as the factory library answers it.
std::string s_board;
int s_boardRc = 0;
int fake_board(char *buf, int size) {
    snprintf(buf, static_cast<size_t>(size), "%s", s_board.c_str());
    return s_boardRc;
}

class BoardCode : public QrPicture {
  protected:
    void TearDown() override { ftx_hw_unbind_all(); }
    // The board picture is the picture of `expected`.
    void expectBoardPicture(const std::string &expected) {
        ASSERT_EQ(0, generate(expected, "/data/expected.png"));
        EXPECT_EQ(root.read("/data/expected.png"), root.read(MMI_QR_BOARD_PNG));
        EXPECT_EQ(root.read("/data/expected.bmp"), root.read(MMI_QR_BOARD_BMP));
        EXPECT_TRUE(log.has("create_barcode_qrcode begin."));
        EXPECT_TRUE(log.has("create_barcode_qrcode end."));
    }
};

TEST_F(BoardCode, TwelveCharactersAreEncodedAsTheyAre) {
    hw::ftx_api_GetBoardNum = fake_board;
    s_board = "FTXBOARD0042";
    create_barcode_qrcode();
    expectBoardPicture("FTXBOARD0042");
    EXPECT_FALSE(log.has("barcode info error."));
    if (scanner::available()) {
        EXPECT_EQ("FTXBOARD0042", scanner::read(root.host(MMI_QR_BOARD_BMP)));
    }
}

TEST_F(BoardCode, ThirteenCharactersOrAnEmptyCodeBecomeZeros) {
    hw::ftx_api_GetBoardNum = fake_board;
    for (const char *code : {"FTXBOARD00420", ""}) {
        log.lines.clear();
        s_board = code;
        create_barcode_qrcode();
        expectBoardPicture("000000000000");
        EXPECT_TRUE(log.has("E FTX_BARCODE: barcode info error.")) << code;
    }
}

TEST_F(BoardCode, NoCodeFromTheLibraryBecomesZeros) {
    hw::ftx_api_GetBoardNum = fake_board;
    s_board = "FTXBOARD0042";
    s_boardRc = -1;  // the library could not read it
    create_barcode_qrcode();
    s_boardRc = 0;
    expectBoardPicture("000000000000");
    EXPECT_FALSE(log.has("barcode info error."));

    ftx_hw_unbind_all();  // no library at all
    fs::remove(root.host(MMI_QR_BOARD_PNG));
    fs::remove(root.host(MMI_QR_BOARD_BMP));
    create_barcode_qrcode();
    expectBoardPicture("000000000000");
}

TEST(BoardCodeScreen, PictureIsAWholeMultipleCentredInTheRoom) {
    struct Case {
        int w, h, top, side;
    } cases[] = {{720, 1127, 3, 87}, {480, 700, 3, 87}, {720, 1127, 3, 99}, {100, 60, 3, 87}};
    for (const Case &c : cases) {
        RECT r;
        mmi_qrscreen_layout(c.w, c.h, c.top, c.side, &r);
        const int s = RECTW(r), room = std::min(c.w, c.h - c.top);
        EXPECT_EQ(s, RECTH(r));
        EXPECT_EQ(0, s % c.side) << c.w << "x" << c.h;
        EXPECT_GE(s, c.side);
        if (c.side <= room * 4 / 5) {
            EXPECT_LE(s, room * 4 / 5);
            EXPECT_GT(s + c.side, room * 4 / 5);  // no larger multiple fits
        }
        EXPECT_LE(std::abs(r.left - (c.w - r.right)), 1);
        EXPECT_LE(std::abs((r.top - c.top) - (c.h - r.bottom)), 1);
    }
}

}  // namespace

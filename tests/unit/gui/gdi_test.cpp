// Drawing: boxes, pens, text layout, Chinese text, bitmaps; clipping to windows.
#include <png.h>
#include <string.h>

#include <fstream>

#include "gui_harness.h"

using namespace guitest;

namespace {

constexpr Uint32 kBlack = 0x000000;
constexpr Uint32 kRed = 0xFF0000;

// A full-screen black window on its own thread to draw in; what is drawn stays while
// the canvas lives.
class Canvas {
  public:
    Canvas() { EXPECT_TRUE(idle()); }
    void draw(const std::function<void(HWND, HDC)> &fn) {
        gui_.run([&] {
            HDC hdc = GetClientDC(gui_.hwnd());
            fn(gui_.hwnd(), hdc);
            ReleaseDC(hdc);
        });
    }

  private:
    GuiThread gui_;
};

}  // namespace

TEST(Gdi, FillBoxColoursExactlyItsBox) {
    Canvas canvas;
    canvas.draw([](HWND, HDC hdc) {
        SetBrushColor(hdc, kRed);
        FillBox(hdc, 10, 20, 30, 40);
    });
    EXPECT_EQ(count_not(RECT{10, 20, 40, 60}, kRed), 0);
    EXPECT_EQ(pixel(9, 20), kBlack);
    EXPECT_EQ(pixel(40, 20), kBlack);
    EXPECT_EQ(pixel(10, 60), kBlack);
}

TEST(Gdi, DrawingIsClippedToTheWindowAndItsCoveringWindows) {
    GuiThread back;
    GuiThread front(RECT{100, 100, 200, 200});
    ASSERT_TRUE(idle());
    fill_screen(kBlack);
    back.run([&] {
        HDC hdc = GetClientDC(back.hwnd());
        SetBrushColor(hdc, kRed);
        FillBox(hdc, 0, 0, kW, kH);
        ReleaseDC(hdc);
    });
    EXPECT_EQ(count_not(RECT{100, 100, 200, 200}, kBlack), 0)
        << "the covering window stays untouched";
    EXPECT_EQ(pixel(99, 150), kRed);
    front.run([&] {
        HDC hdc = GetClientDC(front.hwnd());
        SetBrushColor(hdc, 0x00FF00);
        FillBox(hdc, -50, -50, 400, 400);
        ReleaseDC(hdc);
    });
    EXPECT_EQ(count_not(RECT{100, 100, 200, 200}, 0x00FF00), 0);
    EXPECT_EQ(pixel(200, 150), kRed);
}

TEST(Gdi, PenWidthAppliesToLinesAndFrames) {
    Canvas canvas;
    canvas.draw([](HWND, HDC hdc) {
        SetPenColor(hdc, kRed);
        SetPenWidth(hdc, 3);
        MoveTo(hdc, 10, 50);
        LineTo(hdc, 100, 50);
        Rectangle(hdc, 200, 200, 260, 240);
        MoveTo(hdc, 300, 300);
        LineTo(hdc, 350, 350);
    });
    for (int y = 49; y <= 51; y++)
        EXPECT_EQ(count_not(RECT{10, y, 101, y + 1}, kRed), 0) << "row " << y;
    EXPECT_EQ(count_not(RECT{10, 48, 101, 49}, kBlack), 0);
    EXPECT_EQ(count_not(RECT{10, 52, 101, 53}, kBlack), 0);
    // Frame sides are three pixels wide too, centred on the outline.
    EXPECT_EQ(pixel(199, 220), kRed);
    EXPECT_EQ(pixel(201, 220), kRed);
    EXPECT_EQ(pixel(202, 220), kBlack);
    EXPECT_EQ(pixel(230, 220), kBlack);
    // A diagonal line is thick as well.
    EXPECT_EQ(pixel(325, 325), kRed);
    EXPECT_EQ(pixel(326, 325), kRed);
    EXPECT_EQ(pixel(324, 325), kRed);
}

TEST(Gdi, CircleAndPolygonFill) {
    Canvas canvas;
    canvas.draw([](HWND, HDC hdc) {
        SetBrushColor(hdc, kRed);
        FillCircle(hdc, 100, 100, 20);
        POINT tri[] = {{200, 200}, {300, 200}, {200, 300}};
        FillPolygon(hdc, tri, 3);
    });
    EXPECT_EQ(pixel(100, 100), kRed);
    EXPECT_EQ(pixel(100, 81), kRed);
    EXPECT_EQ(pixel(100, 78), kBlack);
    EXPECT_EQ(pixel(87, 87), kRed);
    EXPECT_EQ(pixel(84, 84), kBlack);
    EXPECT_EQ(pixel(210, 210), kRed);
    EXPECT_EQ(pixel(290, 290), kBlack) << "beyond the hypotenuse";
}

TEST(Gdi, DrawTextWrapsAndCentresInsideItsRectangle) {
    const RECT box{60, 100, 260, 400};
    int height = 0, fontH = 0;
    const char *text = "the quick brown fox jumps over the lazy dog and keeps on running far away";
    Canvas canvas;
    canvas.draw([&](HWND, HDC hdc) {
        SetTextColor(hdc, kRed);
        SetBkMode(hdc, BM_TRANSPARENT);
        RECT rc = box;
        fontH = GetFontHeight(hdc);
        height = DrawText(hdc, text, -1, &rc, DT_CENTER | DT_WORDBREAK);
    });
    ASSERT_GT(fontH, 0);
    EXPECT_GE(height, 3 * fontH) << "a long text takes several lines";
    EXPECT_GT(count_not(box, kBlack), 200);
    EXPECT_EQ(count_not(RECT{0, 0, kW, box.top}, kBlack), 0);
    EXPECT_EQ(count_not(RECT{0, box.top, box.left, kH}, kBlack), 0);
    EXPECT_EQ(count_not(RECT{box.right, box.top, kW, kH}, kBlack), 0);
    EXPECT_EQ(count_not(RECT{box.left, box.top + height, box.right, kH}, kBlack), 0);

    // One short word sits in the middle of its line.
    GuiThread gui;
    ASSERT_TRUE(idle());
    fill_screen(kBlack);
    gui.run([&] {
        HDC hdc = GetClientDC(gui.hwnd());
        SetTextColor(hdc, kRed);
        SetBkMode(hdc, BM_TRANSPARENT);
        RECT rc = box;
        DrawText(hdc, "II", -1, &rc, DT_CENTER | DT_SINGLELINE);
        ReleaseDC(hdc);
    });
    int left = kW, right = -1;
    for (int y = box.top; y < box.top + fontH; y++)
        for (int x = box.left; x < box.right; x++)
            if (pixel(x, y) != kBlack) {
                left = std::min(left, x);
                right = std::max(right, x);
            }
    ASSERT_GE(right, left);
    int margin = (left - box.left) - (box.right - 1 - right);
    EXPECT_LE(abs(margin), fontH / 2);
}

TEST(Gdi, Gb18030ChineseRendersFullWidthGlyphs) {
    // "中文测试" in GB18030.
    const char text[] = "\xD6\xD0\xCE\xC4\xB2\xE2\xCA\xD4";
    PLOGFONT font = CreateLogFont("ttf", "song", "GB18030", 'r', 'r', 'n', 'n', 'n', 'n', 32, 0);
    PLOGFONT bold = CreateLogFont("ttf", "song", "GB18030", 'b', 'r', 'n', 'n', 'n', 'n', 32, 0);
    ASSERT_NE(font, nullptr);
    ASSERT_NE(bold, nullptr);
    EXPECT_EQ(font->size, 32);
    SIZE sz{}, szb{};
    int regular = 0, heavy = 0;
    Canvas canvas;
    canvas.draw([&](HWND, HDC hdc) {
        SelectFont(hdc, font);
        GetTextExtent(hdc, text, -1, &sz);
        SetTextColor(hdc, kRed);
        SetBkMode(hdc, BM_TRANSPARENT);
        TextOut(hdc, 10, 10, text);
        SelectFont(hdc, bold);
        GetTextExtent(hdc, text, -1, &szb);
        TextOut(hdc, 10, 100, text);
    });
    regular = count_not(RECT{0, 0, kW, 90}, kBlack);
    heavy = count_not(RECT{0, 90, kW, 190}, kBlack);
    EXPECT_GE(sz.cx, 4 * 28) << "four wide characters";
    EXPECT_LE(sz.cx, 4 * 36);
    EXPECT_EQ(sz.cy, 32);
    EXPECT_GT(regular, 150) << "glyphs were drawn, not blanks";
    EXPECT_GT(heavy, regular) << "bold is heavier";
    EXPECT_EQ(CreateLogFont("ttf", "song", "GB18030", 'x', 'r', 'n', 'n', 'n', 'n', 32, 0),
              nullptr);
    DestroyLogFont(font);
    DestroyLogFont(bold);
}

namespace {

// A 24-bit BMP, w x h, left half colour a and right half colour b (bottom-up rows).
std::string make_bmp(int w, int h, Uint32 a, Uint32 b) {
    int stride = (w * 3 + 3) & ~3;
    std::string d(54 + static_cast<size_t>(stride) * h, '\0');
    auto put32 = [&](size_t off, Uint32 v) {
        for (int i = 0; i < 4; i++)
            d[off + i] = static_cast<char>(v >> (8 * i));
    };
    d[0] = 'B';
    d[1] = 'M';
    put32(2, static_cast<Uint32>(d.size()));
    put32(10, 54);
    put32(14, 40);
    put32(18, static_cast<Uint32>(w));
    put32(22, static_cast<Uint32>(h));
    d[26] = 1;
    d[28] = 24;
    for (int y = 0; y < h; y++)
        for (int x = 0; x < w; x++) {
            Uint32 c = x < w / 2 ? a : b;
            size_t o = 54 + static_cast<size_t>(y) * stride + x * 3;
            d[o] = static_cast<char>(c);
            d[o + 1] = static_cast<char>(c >> 8);
            d[o + 2] = static_cast<char>(c >> 16);
        }
    return d;
}

// A PNG, w x h, top half colour a and bottom half transparent.
void write_png(const std::string &path, int w, int h, Uint32 a) {
    std::vector<png_byte> rgba(static_cast<size_t>(w) * h * 4, 0);
    for (int y = 0; y < h / 2; y++)
        for (int x = 0; x < w; x++) {
            png_byte *p = &rgba[(static_cast<size_t>(y) * w + x) * 4];
            p[0] = static_cast<png_byte>(a >> 16);
            p[1] = static_cast<png_byte>(a >> 8);
            p[2] = static_cast<png_byte>(a);
            p[3] = 0xFF;
        }
    png_image img{};
    img.version = PNG_IMAGE_VERSION;
    img.width = static_cast<png_uint_32>(w);
    img.height = static_cast<png_uint_32>(h);
    img.format = PNG_FORMAT_RGBA;
    ASSERT_NE(png_image_write_to_file(&img, path.c_str(), 0, rgba.data(), 0, nullptr), 0);
}

}  // namespace

TEST(Gdi, BmpAndPngAreDrawnStretchedWhereAsked) {
    TempRoot &root = *GuiEnvironment::root_;
    root.write("/data/two.bmp", make_bmp(4, 2, 0x0000FF, 0x00FF00));
    std::filesystem::create_directories(root.host("/vendor/etc/data"));
    write_png(root.host("/vendor/etc/data/half.png"), 8, 8, 0xFFFF00);
    int bmpRc = -99, pngRc = -99;
    Canvas canvas;
    canvas.draw([&](HWND, HDC hdc) {
        BITMAP bmp, png;
        bmpRc = LoadBitmap(hdc, &bmp, "/data/two.bmp");
        pngRc = LoadBitmap(hdc, &png, "/vendor/etc/data/half.png");
        if (bmpRc == 0) FillBoxWithBitmap(hdc, 100, 100, 80, 40, &bmp);
        if (pngRc == 0) FillBoxWithBitmap(hdc, 300, 300, 60, 60, &png);
        UnloadBitmap(&bmp);
        UnloadBitmap(&png);
        BITMAP none;
        EXPECT_LT(LoadBitmap(hdc, &none, "/data/missing.bmp"), 0);
    });
    ASSERT_EQ(bmpRc, 0);
    ASSERT_EQ(pngRc, 0);
    EXPECT_EQ(count_not(RECT{100, 100, 140, 140}, 0x0000FF), 0);
    EXPECT_EQ(count_not(RECT{140, 100, 180, 140}, 0x00FF00), 0);
    EXPECT_EQ(pixel(99, 100), kBlack);
    EXPECT_EQ(pixel(180, 139), kBlack);
    EXPECT_EQ(pixel(100, 140), kBlack);
    EXPECT_EQ(count_not(RECT{300, 300, 360, 330}, 0xFFFF00), 0);
    EXPECT_EQ(count_not(RECT{300, 330, 360, 360}, kBlack), 0)
        << "transparent half lets the background show";
}

TEST(Gdi, TruncatedOrForeignPictureIsRefused) {
    std::string bmp = make_bmp(4, 2, 0, 0);
    BITMAP b;
    EXPECT_EQ(LoadBitmapFromMem(HDC_SCREEN, &b, bmp.data(), static_cast<int>(bmp.size()), "bmp"),
              0);
    UnloadBitmap(&b);
    EXPECT_LT(
        LoadBitmapFromMem(HDC_SCREEN, &b, bmp.data(), static_cast<int>(bmp.size()) - 3, "bmp"), 0);
    EXPECT_LT(LoadBitmapFromMem(HDC_SCREEN, &b, "GIF89a", 6, "gif"), 0);
}

TEST(Gdi, ADeviceContextKeepsOffAWindowThatCameUpOverItsWindowAfterItWasTaken) {
    // A bar's paint that began before a window came up over the bar ends after that window
    // painted: shapes, text and pictures drawn then stay off it, and still reach the part
    // of the bar it leaves uncovered.
    GuiThread bar(RECT{0, 0, kW, 60}, "bar");
    ASSERT_TRUE(idle());
    HDC hdc = HDC_INVALID;
    bar.run([&] { hdc = GetClientDC(bar.hwnd()); });
    GuiThread front(RECT{0, 0, kW / 2, kH}, "front");
    ASSERT_TRUE(idle());
    ASSERT_EQ(count_not(RECT{0, 0, kW / 2, kH}, kBlack), 0);
    const std::string bmp = make_bmp(4, 2, kRed, kRed);
    bar.run([&] {
        SetBrushColor(hdc, kRed);
        FillBox(hdc, 0, 0, kW, 20);
        SetBkMode(hdc, BM_OPAQUE);
        SetBkColor(hdc, kRed);
        SetTextColor(hdc, kRed);
        TextOut(hdc, 0, 20, std::string(80, 'W').c_str());
        BITMAP b;
        if (LoadBitmapFromMem(hdc, &b, bmp.data(), static_cast<int>(bmp.size()), "bmp") == 0) {
            FillBoxWithBitmap(hdc, 0, 40, kW, 20, &b);
            UnloadBitmap(&b);
        }
        ReleaseDC(hdc);
    });
    EXPECT_EQ(count_not(RECT{0, 0, kW / 2, kH}, kBlack), 0) << "the window in front is untouched";
    EXPECT_EQ(count_not(RECT{kW / 2, 0, kW, 20}, kRed), 0) << "the box";
    EXPECT_LT(count_not(RECT{kW / 2, 20, kW, 40}, kRed), (kW / 2) * 20) << "the text";
    EXPECT_EQ(count_not(RECT{kW / 2, 40, kW, 60}, kRed), 0) << "the picture";
}

// The board-code screen on the real program: an operator opens it from the product
// information's board-number row, a scanner reads the bar code off the screen, and the back
// key or the right soft key goes back.
#include <algorithm>
#include <cstdlib>
#include <string>

#include <gtest/gtest.h>

#include "support/handset.h"
#include "support/scanner.h"

namespace {

using handset::Handset;
using handset::Png;

const handset::Item kVibrator = {"FTX_VIBRATOR", 1, 0, 1};
const char kBoardCode[] = "Board Code";

// From the menu to the board-code screen as an operator goes: device test, information,
// down to the board number (row 4), OK.
void openBoardCode(Handset &h) {
    ASSERT_TRUE(h.fromList(1, "Product Information"));
    for (int i = 0; i < 4; i++)
        h.key(108);
    h.key(28);
    ASSERT_TRUE(h.waitActive(kBoardCode));
}

bool nearWhite(int r, int g, int b) {
    return r > 240 && g > 240 && b > 240;
}

// The screen once the code is drawn: a white square in the middle of the 720 x 1280 screen
// (the picture's quiet zone), steady over two screenshots.
Png codeShown(Handset &h, const std::string &name) {
    return h.shotWhen(name,
                      [](const Png &p) { return p.count(160, 400, 560, 800, nearWhite) > 40000; });
}

TEST(BoardCodeScreen, ShowsTheBoardsBarCodeForAScannerAndTheBackKeyCloses) {
    Handset h({kVibrator});
    h.dut.setDeviceIni("identity", "barcode", "FTX000000042");
    ASSERT_TRUE(h.start());
    openBoardCode(h);
    Png shot = codeShown(h, "board_code.png");
    // The picture's white edge, between the title strip (to y 58) and the soft-key bar (from
    // y 1185): 29 modules of 18 pixels, centred.
    int x0 = 720, x1 = -1, y0 = 1280, y1 = -1;
    for (int y = 60; y < 1185; y++)
        for (int x = 0; x < 720; x++) {
            const unsigned char *c = shot.at(x, y);
            if (!nearWhite(c[0], c[1], c[2])) continue;
            x0 = std::min(x0, x), x1 = std::max(x1, x), y0 = std::min(y0, y), y1 = std::max(y1, y);
        }
    EXPECT_EQ(29 * 18, x1 + 1 - x0);
    EXPECT_EQ(29 * 18, y1 + 1 - y0);
    EXPECT_LE(std::abs(x0 - (720 - 1 - x1)), 1) << x0 << ".." << x1;
    EXPECT_LE(std::abs((y0 - 58) - (1185 - 1 - y1)), 4) << y0 << ".." << y1;
    if (scanner::available()) {
        EXPECT_EQ("FTX000000042", scanner::read(h.dut.root() + "/board_code.png"));
    } else {
        ADD_FAILURE() << "zbarimg (zbar-tools) is not installed: the code was not read";
    }
    EXPECT_EQ(std::string::npos, h.dut.logPos("barcode info error."));
    // The screen kept the handset awake; going back lets it idle again.
    const size_t idle = h.dut.logCount("Set_OsCanIdleAllowed");
    h.key(88);  // back
    EXPECT_TRUE(h.waitActive("Product Information"));
    EXPECT_TRUE(h.dut.waitLogCount("Set_OsCanIdleAllowed", idle + 1));
}

TEST(BoardCodeScreen, ABarCodeTooLongShowsZerosAndTheRightSoftKeyCloses) {
    Handset h({kVibrator});
    h.dut.setDeviceIni("identity", "barcode", "FTX0000000042");  // 13 characters
    ASSERT_TRUE(h.start());
    openBoardCode(h);
    codeShown(h, "board_code_zeros.png");
    EXPECT_TRUE(h.dut.waitLog("barcode info error."));
    if (scanner::available()) {
        EXPECT_EQ("000000000000", scanner::read(h.dut.root() + "/board_code_zeros.png"));
    }
    h.key(61);
    EXPECT_TRUE(h.waitActive("Product Information"));
    // Opened again, it shows again.
    h.key(28);
    EXPECT_TRUE(h.waitActive(kBoardCode));
    EXPECT_TRUE(h.dut.waitLogCount("mmi_teswnd_QRCode() end.", 2));
}

}  // namespace

// The real ftx-mmi, headless: the touch frame filled by a finger run around the screen edge,
// the rings of a round screen, and the panel self test's verdict screens and failure map.
#include <math.h>

#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "support/handset.h"

using namespace handset;

namespace {

const Item kTouch = {"FTX_TOUCH", 1, 0, 1};
const Item kTpSelf = {"FTX_TPSELF", 1, 0, 1};

// The frame of a w x h screen as the operator's guide describes it: a cell length that
// divides the width, strips a third of the width thick, and one more cell where over half
// a cell is left.
struct Frame {
    int len, thick, rowCells, columnCells, rowRest, columnRest;
};

Frame frameOf(int w, int h) {
    Frame f{};
    const int hi = w < 720 ? 20 : 40, lo = w < 720 ? 11 : 21;
    f.len = w < 720 ? 10 : 20;
    for (int len = lo; len <= hi; len++)
        if (w % len == 0) f.len = len;
    f.thick = (w / 3) / f.len * f.len;
    const int middle = (w - 2 * f.thick) / f.len;
    f.rowRest = w - (2 * f.thick + middle * f.len);
    f.rowCells = f.thick / f.len + middle + (2 * f.rowRest > f.len ? 1 : 0);
    f.columnRest = (h - f.thick) % f.len;
    f.columnCells = (h - f.thick) / f.len + (2 * f.columnRest > f.len ? 1 : 0);
    return f;
}

// A point inside every cell of the 720x1280 frame, off the finger's trail.
std::vector<std::pair<int, int>> cellPoints(const Frame &f) {
    std::vector<std::pair<int, int>> pts;
    const int half = f.len / 2, mid = f.thick / 2 + 7;
    const int columnEnd = f.columnCells * f.len, rowEnd = f.rowCells * f.len;
    for (int i = 0; i < f.columnCells; i++) {
        pts.push_back({mid, i * f.len + half});                             // left column
        pts.push_back({rowEnd + 1 + mid, f.thick + 1 + i * f.len + half});  // right column
    }
    for (int i = 0; i < f.rowCells; i++) {
        pts.push_back({i * f.len + half, columnEnd + 1 + mid});  // bottom row
        pts.push_back({f.thick + 1 + i * f.len + half, mid});    // top row
    }
    return pts;
}

// Down the left column, along the bottom row, up the right column and back along the top
// row of a 720x1280 frame (strips 240 thick, cells 40 long).
const char kFrameRun[] =
    "path 120,10 120,1270 10,1270 470,1270 600,1270 600,250 600,120 710,120 250,120";

bool green_at(const Png &p, int x, int y) {
    const unsigned char *c = p.at(x, y);
    return green(c[0], c[1], c[2]);
}

// A finger run once around a circle of radius r about (c, c), from angle `from` to `to`
// degrees counter-clockwise.
std::string ringRun(int c, int r, double from, double to, double step) {
    std::string line = "path";
    for (double a = from; a <= to + 1e-9; a += step) {
        const double rad = a * M_PI / 180.0;
        line += " " + std::to_string((int)lround(c + r * cos(rad))) + "," +
                std::to_string((int)lround(c - r * sin(rad)));
    }
    return line;
}

}  // namespace

TEST(TouchFrame, CellsFollowTheScreenWidthAndHeight) {
    for (auto size : {std::pair<int, int>{720, 1280}, std::pair<int, int>{480, 854}}) {
        SCOPED_TRACE(size.first);
        Handset h({kTouch});
        h.dut.setScreen(size.first, size.second);
        ASSERT_TRUE(h.start());
        ASSERT_TRUE(h.dut.waitChannel());
        ASSERT_EQ(0, h.dut.pc("touchMoudle testItem open").first);
        const Frame f = frameOf(size.first, size.second);
        EXPECT_TRUE(h.dut.waitLog("initCells::1111 cells->cellHeight=" + std::to_string(f.len)));
        EXPECT_TRUE(h.dut.waitLog("initCells::temp1 2222=" + std::to_string(f.rowRest) +
                                  ",CELLCOUNT2 2222=" + std::to_string(f.rowCells)));
        EXPECT_TRUE(h.dut.waitLog("initCells::temp1 2222=" + std::to_string(f.columnRest) +
                                  ",cells->cellCount[0] 2222=" + std::to_string(f.columnCells)));
        EXPECT_TRUE(h.dut.waitLog("TESTWND_HEIGHT = " + std::to_string(size.second) +
                                  ",cells->cellWidth=" + std::to_string(f.thick) +
                                  ",cells->cellHeight=" + std::to_string(f.len)));
        EXPECT_EQ(2, h.dut.pc("touchMoudle testItem close").first);
    }
}

TEST(TouchFrame, ARunAroundTheEdgeFillsEveryCellAndOnlyThenThePcStopPasses) {
    Handset h({kTouch});
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.dut.waitChannel());
    ASSERT_EQ(0, h.dut.pc("touchMoudle testItem open").first);
    ASSERT_TRUE(h.waitActive("Touch Test"));
    // Half the way: the left column and the bottom row.
    ASSERT_TRUE(h.dut.consoleOk("path 120,10 120,1270 10,1270 470,1270"));
    const Frame f = frameOf(720, 1280);
    Png half = h.shotWhen("touch_half.png", [&](const Png &p) { return green_at(p, 127, 20); });
    h.keepForDocs("touch_half.png", "touch_edge_half.png");
    EXPECT_TRUE(green_at(half, 127, 1020));
    EXPECT_FALSE(green_at(half, 607, 260));  // the right column is still to do
    // The trail follows the finger: yellow on the left column's middle.
    const unsigned char *trail = half.at(120, 600);
    EXPECT_TRUE(trail[0] > 200 && trail[1] > 200 && trail[2] < 100);
    EXPECT_EQ(2, h.dut.pc("touchMoudle testItem close").first);

    ASSERT_EQ(0, h.dut.pc("touchMoudle testItem open").first);
    ASSERT_TRUE(h.waitActive("Touch Test"));
    ASSERT_TRUE(h.dut.consoleOk(kFrameRun));
    Png full = h.shotWhen("touch_full.png", [&](const Png &p) { return green_at(p, 257, 127); });
    int missing = 0;
    for (auto pt : cellPoints(f))
        if (!green_at(full, pt.first, pt.second)) missing++;
    EXPECT_EQ(0, missing);
    EXPECT_EQ(0, h.dut.pc("touchMoudle testItem close").first);
    EXPECT_EQ(0, h.result(320));  // the PC's verdict is its own
}

TEST(TouchFrame, InARunTheLastCellPassesAndTheStopKeyFailsWithCellsLeft) {
    Handset h({kTouch, kCards});
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.dut.waitChannel());
    h.openDeviceList();
    h.chooseRow(0);
    ASSERT_TRUE(h.waitActive("Touch Test"));
    ASSERT_TRUE(h.dut.consoleOk(kFrameRun));
    ASSERT_TRUE(h.dut.waitLog(kCardsOpened));
    EXPECT_EQ(1, h.result(320));

    ASSERT_TRUE(h.waitActive("Cards Test"));
    h.key(61);  // the cards fail: the run ends without passing the device

    h.setResult(320, 0);
    ASSERT_TRUE(h.waitActive("Device Test"));
    h.chooseRow(0);
    ASSERT_TRUE(h.waitActive("Touch Test"));
    ASSERT_TRUE(h.dut.consoleOk("tap 120 20"));
    h.key(88);  // back is no stop key here: nothing happens
    h.key(102);
    ASSERT_TRUE(h.dut.waitLog("key_up::cells.drawCount=1,cells.totalCount=76"));
    ASSERT_TRUE(h.waitActive("Device Test"));
    EXPECT_EQ(2, h.result(320));
}

TEST(TouchRing, BothRingsFilledPassAndOneMissingSectorFails) {
    Handset h({kTouch});
    h.dut.setConfig("MMI", "UEShape", "1");
    h.dut.setScreen(720, 720);
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.dut.waitChannel());
    // The outer ring lies between radius 185 and 342 of the centre (360, 360), the inner
    // one within 180.
    ASSERT_EQ(0, h.dut.pc("touchMoudle testItem open").first);
    ASSERT_TRUE(h.waitActive("Touch Test"));
    ASSERT_TRUE(h.dut.consoleOk(ringRun(360, 265, 10, 358, 4)));  // misses (0, 9] degrees
    ASSERT_TRUE(h.dut.consoleOk(ringRun(360, 90, 0, 360, 6)));
    Png ring = h.shotWhen("touch_ring.png", [](const Png &p) {
        const unsigned char *c = p.at(370, 120);  // the top of the outer ring
        return green(c[0], c[1], c[2]);
    });
    h.keepForDocs("touch_ring.png", "touch_ring.png");
    const unsigned char *gap = ring.at(360 + 300, 360 - 20);  // 3.8 degrees: not touched
    EXPECT_FALSE(green(gap[0], gap[1], gap[2]));
    EXPECT_EQ(2, h.dut.pc("touchMoudle testItem close").first);
    EXPECT_TRUE(
        h.dut.waitLog("g_inner_circles[0].iClickedNum=20,g_inner_circles[0].divided_num=20"));

    ASSERT_EQ(0, h.dut.pc("touchMoudle testItem open").first);
    ASSERT_TRUE(h.dut.consoleOk(ringRun(360, 265, 0, 360, 4)));
    ASSERT_TRUE(h.dut.consoleOk(ringRun(360, 90, 0, 360, 6)));
    EXPECT_EQ(0, h.dut.pc("touchMoudle testItem close").first);
}

namespace {

// The self-test window of a 720x1280 screen: its status line and its detail text.
const int kStatusTop = 58 + 6 * 58, kDetailTop = 58 + 48 * 7 + 70;

int detailPixels(const Png &p, bool (*colour)(int, int, int)) {
    return p.count(0, kDetailTop, 720, kDetailTop + 200, colour);
}

}  // namespace

TEST(TpSelfTest, EachVerdictShowsItsScreenAndTheFailureMapMarksTheFailingPoints) {
    Handset h({kTpSelf});
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.dut.waitChannel());
    h.openDeviceList();
    int row = 4;  // the list keeps its cursor on the self test after the first time
    for (int verdict : {0, -1, -2, -4}) {
        SCOPED_TRACE(verdict);
        ASSERT_TRUE(h.dut.consoleOk("hw tp verdict " + std::to_string(verdict)));
        h.chooseRow(row);
        row = 0;
        ASSERT_TRUE(h.waitActive("TP Self Test"));
        Png p = h.shotWhen("tpself_pass.png", pass_label);
        EXPECT_GT(detailPixels(p, green), 50);
        EXPECT_EQ(0, detailPixels(p, red));
        h.key(61);
        ASSERT_TRUE(h.waitActive("Device Test"));
    }
    // Above the upper limit (bit 0) and an open circuit (bit 9), at two points of a 4x8 grid.
    ASSERT_TRUE(h.dut.consoleOk("hw tp verdict 513 4,8,2,1,2,3,5"));
    h.chooseRow(0);
    ASSERT_TRUE(h.waitActive("TP Self Test"));
    Png failed = h.shotWhen("tpself_fail.png", [](const Png &p) {
        return fail_label(p) && p.count(240, 1185, 480, 1280, light) > 20;  // "Detail"
    });
    h.keepForDocs("tpself_fail.png", "tpself_fail.png");
    EXPECT_FALSE(pass_label(failed));
    EXPECT_GT(detailPixels(failed, red), 50);
    EXPECT_GT(failed.count(0, kStatusTop, 720, kStatusTop + 58, red), 20);
    // Two lines of detail: ink in the first and the second text line.
    EXPECT_GT(failed.count(0, kDetailTop, 720, kDetailTop + 40, red), 20);
    EXPECT_GT(failed.count(0, kDetailTop + 45, 720, kDetailTop + 85, red), 20);

    h.key(62);
    ASSERT_TRUE(h.waitActive(" "));
    // Cells of 180x160: the failing points (1,2) and (3,5) are red, the rest is not.
    Png map = h.shotWhen("tpself_map.png", [](const Png &p) {
        const unsigned char *c = p.at(270, 400);
        return red(c[0], c[1], c[2]);
    });
    h.keepForDocs("tpself_map.png", "tpself_failure_map.png");
    EXPECT_EQ(180 * 160, map.count(180, 320, 360, 480, red));
    EXPECT_EQ(180 * 160, map.count(540, 800, 720, 960, red));
    EXPECT_EQ(2 * 180 * 160, map.count(0, 0, 720, 1280, red));
    h.key(88);
    ASSERT_TRUE(h.waitActive("TP Self Test"));
    h.key(61);
    ASSERT_TRUE(h.waitActive("Device Test"));
}

// The touch tests' pieces without a window: the cell frame, where a touch lands in it and
// in the rings, the self test's failure text and verdict lines, the stop keys.
#include <math.h>
#include <string.h>

#include <string>

#include <gtest/gtest.h>

#include "testwnd/mmi_key_table.h"
#include "testwnd/touch/mmi_testwnd_touch.h"
#include "testwnd/touch/mmi_testwnd_tpself.h"
#include "testwnd/touch/mmi_touch_geometry.h"
#include "testwnd/touch/mmi_tp_rawdata.h"

namespace {

const char kTag[] = "FTX_TOUCH";

struct Cells {
    Cells(int w, int h, int rectWidth = 0) { ok = initCells(&c, w, h, rectWidth, kTag) == 0; }
    ~Cells() { mmi_cells_free(&c); }
    mmi_cells c{};
    bool ok;
};

}  // namespace

TEST(TouchCells, TheCellLengthDividesTheWidthWhenItCan) {
    EXPECT_EQ(40, mmi_cells_length(1080, 0));  // 1080 = 27 x 40
    EXPECT_EQ(20, mmi_cells_length(700, 0));   // nothing of 21..40 divides 700
    EXPECT_EQ(20, mmi_cells_length(480, 0));
    EXPECT_EQ(10, mmi_cells_length(509, 0));   // a prime: nothing of 11..20 divides it
    EXPECT_EQ(36, mmi_cells_length(720, 36));  // configured
    EXPECT_EQ(10, mmi_cells_length(720, 3));   // never under 10
}

TEST(TouchCells, A1080ScreenHasStripsAThirdWide) {
    Cells f(1080, 1920);
    ASSERT_TRUE(f.ok);
    EXPECT_EQ(40, f.c.cellHeight);
    EXPECT_EQ(360, f.c.cellWidth);  // 9 cells of 40
    EXPECT_EQ(18u, f.c.cellCount[MMI_STRIP_TOP]);
    EXPECT_EQ(39u, f.c.cellCount[MMI_STRIP_LEFT]);  // (1920 - 360) / 40
    EXPECT_EQ(2 * (18 + 39), f.c.totalCount);
}

TEST(TouchCells, AnOddRestOverHalfACellMakesOneMoreCell) {
    // 854 - 160 = 694 = 34 x 20 + 14, and 14 is over half of 20.
    Cells f(480, 854);
    ASSERT_TRUE(f.ok);
    EXPECT_EQ(35u, f.c.cellCount[MMI_STRIP_LEFT]);
    // 850 - 160 = 690 leaves 10: exactly half is not over half.
    Cells g(480, 850);
    EXPECT_EQ(34u, g.c.cellCount[MMI_STRIP_LEFT]);
}

TEST(TouchCells, TouchesLandInTheirStripAndCountOnce) {
    Cells f(720, 1280);
    ASSERT_TRUE(f.ok);
    const int c = 26, k = 12;
    int strip = -1;
    EXPECT_EQ(0, mmi_cells_index(&f.c, 120, 1, &strip));
    EXPECT_EQ(MMI_STRIP_LEFT, strip);
    EXPECT_EQ(25, mmi_cells_index(&f.c, 120, 1039, nullptr));
    EXPECT_EQ(-1, mmi_cells_index(&f.c, 120, 1040, nullptr));  // on the edge: no strip
    EXPECT_EQ(c + 11, mmi_cells_index(&f.c, 479, 1200, &strip));
    EXPECT_EQ(MMI_STRIP_BOTTOM, strip);
    EXPECT_EQ(c + k, mmi_cells_index(&f.c, 242, 100, &strip));
    EXPECT_EQ(MMI_STRIP_TOP, strip);
    EXPECT_EQ(c + 2 * k + 25, mmi_cells_index(&f.c, 600, 1279, &strip));
    EXPECT_EQ(MMI_STRIP_RIGHT, strip);
    EXPECT_EQ(-1, mmi_cells_index(&f.c, 360, 640, nullptr));  // the middle

    int index = -1;
    EXPECT_TRUE(mmi_cells_mark(&f.c, 120, 30, &index));
    EXPECT_FALSE(mmi_cells_mark(&f.c, 130, 10, &index));  // the same cell
    EXPECT_EQ(1, f.c.drawCount);
    int box[4];
    mmi_cells_box(&f.c, c + 2 * k + 25, box);
    EXPECT_EQ((std::vector<int>{482, 242 + 25 * 40, 720, 240 + 26 * 40}),
              (std::vector<int>{box[0], box[1], box[2], box[3]}));
    for (int y = 1; y < 1280; y += 10)
        for (int x = 1; x < 720; x += 10)
            mmi_cells_mark(&f.c, x, y, nullptr);
    EXPECT_EQ(f.c.totalCount, f.c.drawCount);
}

TEST(TouchRings, SectorsCountCounterClockwiseFromTheRight) {
    mmi_ring outer, inner;
    mmi_rings_init(&outer, &inner, 720, true);
    EXPECT_EQ(342, outer.outer.radius);  // 360 - 18
    EXPECT_EQ(185, outer.inner.radius);
    EXPECT_EQ(180, inner.outer.radius);
    EXPECT_EQ(360 + 342, outer.outer.point[0].x);   // angle 0: to the right
    EXPECT_EQ(360 - 342, outer.outer.point[10].y);  // a quarter turn: straight up
    auto at = [](double deg, int r) {
        const double a = deg * M_PI / 180;
        return std::pair<int, int>{(int)lround(360 + r * cos(a)), (int)lround(360 - r * sin(a))};
    };
    auto sector = [&](const mmi_ring &ring, double deg, int r) {
        auto p = at(deg, r);
        return mmi_ring_sector(&ring, p.first, p.second, kTag);
    };
    EXPECT_EQ(1, sector(outer, 4.5, 260));
    EXPECT_EQ(10, sector(outer, 85, 260));
    EXPECT_EQ(21, sector(outer, 185, 260));  // below the x axis on the left
    EXPECT_EQ(40, sector(outer, 355, 260));
    EXPECT_EQ(-1, sector(outer, 45, 100));  // inside the outer ring's hole
    EXPECT_EQ(-1, sector(outer, 45, 350));  // outside the screen's circle
    EXPECT_EQ(5, sector(inner, 80, 50));    // 18 degrees a sector
    EXPECT_TRUE(mmi_ring_mark(&outer, 40));
    EXPECT_FALSE(mmi_ring_mark(&outer, 40));
    EXPECT_FALSE(mmi_ring_full(&outer));
    for (int j = 1; j <= 40; j++)
        mmi_ring_mark(&outer, j);
    EXPECT_TRUE(mmi_ring_full(&outer));
    inner.enabled = false;
    EXPECT_TRUE(mmi_ring_full(&inner));  // a ring not used is never waited for
}

TEST(TpRawData, TheTextGivesTheGridAndThePointsSkippingEmptyFields) {
    mmi_tp_raw raw{};
    ASSERT_EQ(0, mmi_tp_raw_parse("4,8,2,1,,2,3,5,9,9", &raw, kTag));
    EXPECT_EQ(4, raw.x);
    EXPECT_EQ(8, raw.y);
    ASSERT_EQ(2, raw.num);
    EXPECT_EQ(4, raw.filled);  // no more than 2 x num values
    EXPECT_EQ((std::vector<uint32_t>{1, 2, 3, 5}), std::vector<uint32_t>(raw.p, raw.p + 4));
    // Fewer points than announced: only those read.
    ASSERT_EQ(0, mmi_tp_raw_parse("4,8,3,1,2", &raw, kTag));
    EXPECT_EQ(2, raw.filled);
    // x, y and num are needed; a negative count holds nothing.
    EXPECT_EQ(-1, mmi_tp_raw_parse("4,8", &raw, kTag));
    EXPECT_EQ(nullptr, raw.p);
    EXPECT_EQ(-1, mmi_tp_raw_parse(",,", &raw, kTag));
    ASSERT_EQ(0, mmi_tp_raw_parse("4,8,-5,1,2", &raw, kTag));
    EXPECT_EQ(0, raw.num);
    EXPECT_EQ(nullptr, raw.p);
    // A huge count is capped rather than allocated.
    ASSERT_EQ(0, mmi_tp_raw_parse("4,8,2000000000", &raw, kTag));
    EXPECT_EQ(MMI_TP_RAW_MAX_POINTS, raw.num);
    mmi_tp_raw_free(&raw);
}

TEST(TpRawData, AFailingPointIsItsGridCellOnTheScreenAndPointsOffTheGridAreLeftOut) {
    mmi_tp_raw raw{};
    ASSERT_EQ(0, mmi_tp_raw_parse("4,8,3,3,7,4,0,4000000000,1", &raw, kTag));
    int box[4];
    ASSERT_EQ(0, mmi_tp_raw_cell(&raw, 0, 720, 1280, box));
    EXPECT_EQ((std::vector<int>{540, 1120, 180, 160}), std::vector<int>(box, box + 4));
    EXPECT_EQ(-1, mmi_tp_raw_cell(&raw, 1, 720, 1280, box));  // column 4 of 0..3
    EXPECT_EQ(-1, mmi_tp_raw_cell(&raw, 2, 720, 1280, box));
    EXPECT_EQ(-1, mmi_tp_raw_cell(&raw, 3, 720, 1280, box));  // never announced
    ASSERT_EQ(0, mmi_tp_raw_parse("0,8,1,0,0", &raw, kTag));
    EXPECT_EQ(-1, mmi_tp_raw_cell(&raw, 0, 720, 1280, box));
    mmi_tp_raw_free(&raw);
}

TEST(TpVerdict, EachVerdictHasItsLinesAndOnlyFourPass) {
    char out[512];
    EXPECT_EQ(1, mmi_tp_verdict_detail(0, out, sizeof(out), false));
    EXPECT_STREQ("info_rawdata", out);
    EXPECT_EQ(1, mmi_tp_verdict_detail(-4, out, sizeof(out), false));
    EXPECT_STREQ("info_NotSupportManufacturerModule", out);
    EXPECT_EQ(0, mmi_tp_verdict_detail(-3, out, sizeof(out), false));
    EXPECT_STREQ("info_LoadDllFail", out);
    EXPECT_EQ(0, mmi_tp_verdict_detail(0x201, out, sizeof(out), false));
    EXPECT_STREQ("info_beyond_max_limit\ninfo_GT_OPEN", out);
    EXPECT_EQ(0, mmi_tp_verdict_detail(0x60, out, sizeof(out), false));
    EXPECT_STREQ("info_key_beyond_max_limit\ninfo_key_beyond_max_limit", out);
    char tiny[8];
    mmi_tp_verdict_detail(0x201, tiny, sizeof(tiny), false);
    EXPECT_STREQ("info_be", tiny);
}

TEST(TouchStopKey, OnlyTheListedKeysMayEndTheTest) {
    for (int key : {1, 88, 102, 103, 108, 127})
        EXPECT_EQ(0, Check_TouchTest_StopKeyVal(key)) << key;
    for (int key : {0, 60, 61, 68, 130})
        EXPECT_EQ(-1, Check_TouchTest_StopKeyVal(key)) << key;
    EXPECT_EQ(68u, Get_Keytest_item_key_value("CAMERA"));  // configurable, then refused
}

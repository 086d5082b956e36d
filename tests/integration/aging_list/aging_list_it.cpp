// The real ftx-mmi, headless: the aging result list opened from the main menu's aging row,
// first with no record at all, then with a finished run's result file in the log folder.
#include <string>

#include <gtest/gtest.h>

#include "AgingTest/mmi_aging_record.h"
#include "support/handset.h"

using namespace handset;

namespace {

const char kResult[] = "/cache/ftx/aging/result.ini";

// A stopped run of 10 cycles after 4: the FM detection failed once in five, three items
// passed every time, the others never ran.
std::string a_result() {
    mmi_aging_record r;
    mmi_aging_record_init(&r, 10, 1700000000);
    r.cycle = 4;
    r.finished = 1;
    r.stopped = 1;
    r.elapsed = 2 * 3600 + 5;
    r.counts[AGING_ITEM_WIFI_DETECT] = {5, 0};
    r.counts[AGING_ITEM_BT_DETECT] = {5, 0};
    r.counts[AGING_ITEM_FM_DETECT] = {4, 1};
    r.counts[AGING_ITEM_VIDEO] = {4, 0};
    r.failures = 1;
    snprintf(r.lastFailure, sizeof r.lastFailure, "ftx_api_FMDevDetect returned -1");
    char text[4096];
    EXPECT_GT(mmi_aging_record_format(&r, text, sizeof text), 0);
    return text;
}

// The list's rows on a 720x1280 screen: 60 pixels high from y 62 (the window's top at 58,
// its border and the list's 3-pixel line); row 0 starts a run, item i is row i + 1.
constexpr int kRowTop = 62, kRowHeight = 60;
int row_top(int row) {
    return kRowTop + row * kRowHeight;
}
// Pixels of a colour in the right half of a row, where its value is.
int value_pixels(const Png &p, int row, bool (*colour)(int, int, int)) {
    return p.count(360, row_top(row) + 4, 715, row_top(row + 1) - 4, colour);
}

struct AgingList : ::testing::Test {
    Handset h{{}, 0.25};
    // The aging row is the menu's fifth (after the coupling row the image enables); the
    // menu keeps its cursor, so `down` counts from where it is.
    void openFromMenu(int down) {
        for (int i = 0; i < down; i++)
            h.key(108);
        h.key(28);
        ASSERT_TRUE(h.waitActive("Aging"));
    }
};

TEST_F(AgingList, ShowsEachItemsCountsInTheColourOfItsResult) {
    ASSERT_TRUE(h.start());
    // No run yet: the start row and the word that there is no result.
    openFromMenu(4);
    EXPECT_TRUE(h.dut.waitLog("aging result list opened (2 rows)"));
    h.key(61);  // back
    ASSERT_TRUE(dut_wait_until([&] { return h.activeCaption() != "Aging"; }, 5000));

    // The list reads the result file at each open.
    h.dut.write(kResult, a_result());
    openFromMenu(0);
    EXPECT_TRUE(h.dut.waitLog("aging result list opened (17 rows)"));
    const Png p = h.shotWhen("aging_result.png", [&](const Png &s) {
        return value_pixels(s, 1 + AGING_ITEM_FM_DETECT, red) > 50;
    });
    for (int item : {AGING_ITEM_WIFI_DETECT, AGING_ITEM_BT_DETECT, AGING_ITEM_VIDEO}) {
        SCOPED_TRACE(item);
        EXPECT_GT(value_pixels(p, 1 + item, green), 50);
        EXPECT_EQ(0, value_pixels(p, 1 + item, red));
    }
    EXPECT_EQ(0, value_pixels(p, 1 + AGING_ITEM_FM_DETECT, green));
    // An item that never ran shows its dashes in neither colour.
    EXPECT_EQ(0, value_pixels(p, 1 + AGING_ITEM_CAMERA, green));
    EXPECT_EQ(0, value_pixels(p, 1 + AGING_ITEM_CAMERA, red));
    EXPECT_GT(value_pixels(p, 1 + AGING_ITEM_CAMERA, light), 10);
}

}  // namespace

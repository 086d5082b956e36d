// The camera window's layout: the preview box keeps its upright 3:4 shape in any client area
// and leaves room for the note and status lines.
#include <gtest/gtest.h>

#include "testwnd/camera/mmi_testwnd_camera.h"

namespace {

void expect_fits(const mmi_camera_layout &l, int w, int h) {
    EXPECT_GE(l.preview.left, 0);
    EXPECT_LE(l.preview.right, w);
    EXPECT_GE(l.preview.top, l.note.bottom);
    EXPECT_LE(l.preview.bottom, l.status.top);
    EXPECT_LE(l.status.bottom, h);
    // Upright 3:4 within a pixel of rounding, centred.
    const int bw = RECTW(l.preview), bh = RECTH(l.preview);
    EXPECT_LE(abs(bw * 4 - bh * 3), 4) << bw << "x" << bh;
    EXPECT_LE(abs(l.preview.left - (w - l.preview.right)), 1);
}

}  // namespace

TEST(CameraLayout, APortraitScreenGivesTheFullWidthBox) {
    mmi_camera_layout l;
    mmi_camera_layout_for(720, 1164, 54, &l);
    EXPECT_EQ(0, l.preview.left);
    EXPECT_EQ(720, l.preview.right);
    EXPECT_EQ(80, l.preview.top);
    EXPECT_EQ(1040, l.preview.bottom);
    expect_fits(l, 720, 1164);
}

TEST(CameraLayout, AShortAreaNarrowsTheBoxAndNothingGoesNegative) {
    for (auto [w, h] : {std::pair{1280, 620}, {480, 700}, {720, 400}, {240, 300}}) {
        SCOPED_TRACE(std::to_string(w) + "x" + std::to_string(h));
        mmi_camera_layout l;
        mmi_camera_layout_for(w, h, 54, &l);
        EXPECT_LT(RECTW(l.preview), w + 1);
        expect_fits(l, w, h);
    }
    // No room at all: an empty box, never a negative one.
    mmi_camera_layout l;
    mmi_camera_layout_for(720, 100, 54, &l);
    EXPECT_EQ(0, RECTH(l.preview));
    EXPECT_EQ(0, RECTW(l.preview));
}

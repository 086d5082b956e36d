// Geometry, fonts and the power key's threshold of the main window, from the screen size.
#include <gtest/gtest.h>

#include "hub/mmi_hub_keys.h"
#include "hub/mmi_mainwnd.h"
#include "mmi_theme.h"

namespace {

TEST(HubLayoutTest, Portrait720x1280) {
    mmi_hub_layout l;
    mmi_hub_layout_for(720, 1280, &l);
    EXPECT_EQ(RECTH(l.titleStrip), 58);
    EXPECT_EQ(l.softKeyBar.top, 1185);
    EXPECT_EQ(l.softKeyBar.bottom, 1280);
    EXPECT_EQ(l.mainWindow.top, 58);
    EXPECT_EQ(l.mainWindow.bottom, 1185);
    EXPECT_EQ(l.listHeight, 528);
    EXPECT_EQ(l.itemHeight, 96);
    EXPECT_EQ(RECTW(l.linkSquare), 174);
    EXPECT_EQ(l.linkSquare.left, 273);
    EXPECT_EQ(l.linkSquare.top, 553);
    // The dialog: 7/8 of the width, a third of the height, centred.
    EXPECT_EQ(l.dialog.left, 45);
    EXPECT_EQ(RECTW(l.dialog), 630);
    EXPECT_EQ(l.dialog.top, 427);
    EXPECT_EQ(RECTH(l.dialog), 426);
}

TEST(HubLayoutTest, TopBandFollowsTheWidthAndTheBottomBandTheHeight) {
    mmi_hub_layout l;
    mmi_hub_layout_for(1080, 1920, &l);
    EXPECT_EQ(l.mainWindow.top, 1080 / 15 + 10);
    EXPECT_EQ(l.softKeyBar.top, 1920 - (1920 / 15 + 10));
    EXPECT_EQ(l.linkSide, 87 * 2);      // the larger picture above 720 wide
    mmi_hub_layout_for(1280, 720, &l);  // landscape: the bands differ
    EXPECT_EQ(RECTH(l.titleStrip), 1280 / 15 + 10);
    EXPECT_EQ(RECTH(l.softKeyBar), 720 / 15 + 10);
}

TEST(HubLayoutTest, FontSizes) {
    EXPECT_EQ(mmi_logfont_size(1, 720), 48);
    EXPECT_EQ(mmi_logfont_size(2, 1364), 90);
    EXPECT_EQ(mmi_logfont_size(2, 1365), 90);
    EXPECT_EQ(mmi_logfont_size(3, 720), 36);  // 720 / 18.75 = 38.4, down to a multiple of 4
    EXPECT_EQ(mmi_logfont_size(4, 720), 24);  // 720 / 26.25 = 27.4
    EXPECT_EQ(mmi_logfont_size(3, 1725), 90);
    EXPECT_EQ(mmi_logfont_size(4, 2414) % 4, 0);
    EXPECT_EQ(mmi_logfont_size(5, 720), 250);
    EXPECT_EQ(mmi_logfont_size(6, 720), 25);
}

TEST(HubLayoutTest, PowerKeyShortBelow800Ms) {
    EXPECT_EQ(mmi_powerkey_is_short(1000, 1799), 1);
    EXPECT_EQ(mmi_powerkey_is_short(1000, 1800), 0);
}

}  // namespace

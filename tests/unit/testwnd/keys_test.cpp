// The key table without a window: the press and release rules, the layout and the lookups
// the touch tests use for their stop key.
#include <string.h>

#include <gtest/gtest.h>

#include "testwnd/mmi_key_table.h"
#include "testwnd/keys/mmi_testwnd_keys.h"

namespace {

const char kTag[] = "FTX_KEYS";

class KeyRules : public ::testing::Test {
  protected:
    void SetUp() override {
        mmi_key_table_init(t);
        enable("VOLUME_UP");
        enable("VOLUME_DOWN");
        enable("POWER");
    }
    void enable(const char *name) { t[mmi_key_table_find_name(t, name)].test_enable = 1; }
    bool done(const char *name) { return t[mmi_key_table_find_name(t, name)].done != 0; }
    mmi_key_item t[MMI_KEY_ITEMS];
};

}  // namespace

TEST_F(KeyRules, AKeyPassesOnItsFirstPressAndReleaseOnly) {
    EXPECT_TRUE(mmi_key_press(t, 103, kTag));
    EXPECT_FALSE(done("VOLUME_UP"));
    EXPECT_TRUE(mmi_key_release(t, 103, kTag));
    EXPECT_TRUE(done("VOLUME_UP"));
    // A second press and release change nothing.
    EXPECT_FALSE(mmi_key_press(t, 103, kTag));
    EXPECT_FALSE(mmi_key_release(t, 103, kTag));
    // A release without its press, and keys not tested, are ignored.
    EXPECT_FALSE(mmi_key_release(t, 108, kTag));
    EXPECT_FALSE(done("VOLUME_DOWN"));
    EXPECT_FALSE(mmi_key_press(t, 102, kTag));
    EXPECT_FALSE(mmi_key_all_done(t));
    mmi_key_press(t, 108, kTag);
    mmi_key_release(t, 108, kTag);
    mmi_key_press(t, 1, kTag);
    mmi_key_release(t, 1, kTag);
    EXPECT_TRUE(mmi_key_all_done(t));
}

TEST_F(KeyRules, AHeldKeyBlocksOthersUntilItIsReleased) {
    mmi_key_press(t, 103, kTag);
    EXPECT_FALSE(mmi_key_press(t, 108, kTag));  // refused: volume up is held
    EXPECT_FALSE(mmi_key_release(t, 108, kTag));
    EXPECT_EQ(0, t[1].down);
    EXPECT_TRUE(mmi_key_release(t, 103, kTag));  // releasing the held key passes it
    EXPECT_TRUE(mmi_key_press(t, 108, kTag));
    EXPECT_TRUE(mmi_key_release(t, 108, kTag));
}

TEST_F(KeyRules, PendingCodesAreTheReportedCodesInTableOrder) {
    char out[64];
    mmi_key_pending_codes(t, out, sizeof(out));
    // The platform reports volume up, volume down and power as 115, 114 and 116.
    EXPECT_STREQ("115,114,116,", out);
    mmi_key_press(t, 108, kTag);
    mmi_key_release(t, 108, kTag);
    mmi_key_pending_codes(t, out, sizeof(out));
    EXPECT_STREQ("115,116,", out);
    char tiny[5];
    mmi_key_pending_codes(t, tiny, sizeof(tiny));
    EXPECT_STREQ("115,", tiny);
}

TEST_F(KeyRules, EnabledRowsStackFromTheListTopAndOthersKeepTheirRectangles) {
    mmi_key_table_layout(t, 720, 72);
    const int top = (720 / 15) * 3 + 30;
    EXPECT_EQ(top, t[0].top);
    EXPECT_EQ(top + 72, t[0].bottom);
    EXPECT_EQ(top + 72, t[1].top);
    EXPECT_EQ(top + 144, t[5].top);  // power follows volume down: home to menu are off
    EXPECT_EQ(720, t[5].right);
    EXPECT_EQ(0, t[2].bottom);
}

TEST(KeyLookup, ConfigNamesMatchAsPrefixesAndUnknownStopKeysAreHome) {
    EXPECT_EQ(103u, Get_Keytest_item_key_value("VOLUME_UP"));
    EXPECT_EQ(1u, Get_Keytest_item_key_value("POWER_KEY"));  // "POWER" is its prefix
    EXPECT_EQ(127u, Get_Keytest_item_key_value("MENU"));
    EXPECT_EQ(102u, Get_Keytest_item_key_value("VOLUME"));
    EXPECT_EQ(102u, Get_Keytest_item_key_value(""));
}

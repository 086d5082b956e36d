// The real ftx-mmi, headless: the title strip's battery warnings come and go with their
// conditions, and long texts on the strip keep clear of their neighbours.
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "support/handset.h"

using namespace handset;

namespace {

// The title strip on 720x1280: 58 high, three slots 240 wide.
const int kStripH = 58;
const int kSlot = 240;

// The strip's pixels, row by row.
std::vector<unsigned char> strip(const Png &p) {
    return std::vector<unsigned char>(p.rgb.begin(), p.rgb.begin() + (size_t)p.w * kStripH * 3);
}
// Columns of the strip holding text; the strip's far right corner is background.
std::vector<int> ink(const Png &p) {
    return p.inkColumns(2, kStripH - 2, p.w - 1, 1);
}
std::string runs(const Png &p) {
    std::vector<int> in = ink(p);
    std::string out;
    for (int x = 0; x < p.w; x++)
        if (in[(size_t)x] && (x == 0 || !in[(size_t)x - 1]))
            out += " " + std::to_string(x);
        else if (!in[(size_t)x] && x > 0 && in[(size_t)x - 1])
            out += "-" + std::to_string(x);
    return out;
}
int redIn(const Png &p, int x0, int x1) {
    return p.count(x0, 0, x1, kStripH, red);
}
// The menu's strip at rest: charger, title and level, none of them red.
bool atRest(const Png &p) {
    for (int s = 0; s < 3; s++)
        if (p.count(s * kSlot, 0, (s + 1) * kSlot, kStripH, light) < 20) return false;
    return redIn(p, 0, p.w) == 0;
}

class TitleStrip : public ::testing::Test {
  protected:
    void SetUp() override {
        ASSERT_TRUE(h.start());
        ASSERT_TRUE(h.dut.waitLog("TitleInfoShow begin"));  // the first battery record
        rest = h.shotWhen("strip_rest.png", atRest);
    }
    void hw(const std::vector<std::string> &lines) {
        for (const std::string &l : lines)
            ASSERT_TRUE(h.dut.consoleOk("hw " + l)) << l;
    }
    Handset h{{{"FTX_VIBRATOR", 1, 0, 1}}, 1.0};
    Png rest;
};

TEST_F(TitleStrip, EachWarningLeavesWhenItsConditionDoes) {
    struct Case {
        std::vector<std::string> on, off;
    };
    const Case kCases[] = {
        {{"battery temperature 455"}, {"battery temperature 250"}},
        {{"battery health 3"}, {"battery health 2"}},  // overheat
        {{"battery health 4"}, {"battery health 2"}},  // dead
        {{"battery health 5"}, {"battery health 2"}},  // over voltage
        // The battery service warns once a run of a low level without a charger.
        {{"charger none", "battery level 12"}, {"charger usb 1", "battery level 80"}},
    };
    const auto restStrip = strip(rest);
    for (const Case &c : kCases) {
        SCOPED_TRACE(c.on.back());
        hw(c.on);
        h.shotWhen("strip_warned.png",
                   [](const Png &p) { return redIn(p, kSlot, 2 * kSlot) > 50; });
        hw(c.off);
        // Charger, title and level exactly as before the warning, in their own colour.
        h.shotWhen("strip_back.png", [&](const Png &p) { return strip(p) == restStrip; });
    }
}

TEST_F(TitleStrip, LongTextsKeepClearOfTheirNeighbours) {
    const std::vector<int> restInk = ink(rest);
    int leftEnd = 0, rightStart = rest.w;
    for (int x = 0; x < kSlot; x++)
        if (restInk[(size_t)x]) leftEnd = x;
    for (int x = rest.w - 1; x >= 2 * kSlot; x--)
        if (restInk[(size_t)x]) rightStart = x;

    // A warning far wider than its slot between two short texts: the short texts stay as
    // they were, with nothing else within 10 columns of them, and the warning takes the
    // room they leave.
    hw({"battery temperature 455"});
    Png hot =
        h.shotWhen("strip_hot.png", [](const Png &p) { return redIn(p, kSlot, 2 * kSlot) > 50; });
    const std::vector<int> hotInk = ink(hot);
    for (int x = 0; x <= leftEnd + 10; x++)
        ASSERT_EQ(restInk[(size_t)x], hotInk[(size_t)x]) << "column " << x;
    for (int x = rightStart - 10; x < hot.w; x++)
        ASSERT_EQ(restInk[(size_t)x], hotInk[(size_t)x]) << "column " << x;
    int spread = 0;
    for (int x = leftEnd + 11; x < kSlot; x++)
        spread += hotInk[(size_t)x];
    EXPECT_GT(spread, 0);

    // "Not charging" nearly fills its slot and the low-battery warning is as wide: a gap
    // stays between them, on the menu and over a test window, where the level stays as
    // current as on the menu.
    hw({"battery temperature 250", "charger none", "battery level 12"});
    auto lowShown = [&](const Png &p) {
        std::vector<int> in = ink(p);
        bool leftWide = false;  // "Not charging" starts further left than "Charging"
        for (int x = 0; x < 20; x++)
            leftWide = leftWide || in[(size_t)x];
        bool newLevel = false;  // "12%", no longer "80%"
        for (int x = rightStart - 10; x < p.w; x++)
            newLevel = newLevel || in[(size_t)x] != restInk[(size_t)x];
        return leftWide && newLevel && redIn(p, kSlot, 2 * kSlot) > 50;
    };
    auto gapAtTheSlotEdge = [](const Png &p) {
        std::vector<int> in = ink(p);
        for (int x = kSlot - 8; x < kSlot + 20; x++)
            if (in[(size_t)x]) return x;
        return -1;
    };
    Png low = h.shotWhen("strip_low.png", lowShown);
    EXPECT_EQ(-1, gapAtTheSlotEdge(low));
    h.openDeviceList();
    h.chooseRow(4);
    ASSERT_TRUE(h.waitActive("Vibration Test"));
    // The next battery round puts the warning over the test window.
    Png inWindow = h.shotWhen("strip_low_window.png", lowShown);
    EXPECT_EQ(-1, gapAtTheSlotEdge(inWindow));
    EXPECT_EQ(ink(low), ink(inWindow)) << runs(low) << " / " << runs(inWindow);
    // The level changes while the test window is in front: the strip over it follows.
    hw({"battery level 11"});
    const std::vector<int> twelve = ink(inWindow);
    h.shotWhen("strip_low_window_11.png", [&](const Png &p) {
        std::vector<int> in = ink(p);
        for (int x = rightStart - 10; x < p.w; x++)
            if (in[(size_t)x] != twelve[(size_t)x]) return lowShown(p);
        return false;
    });
    // When the warning leaves, the test window gets its own strip back: its title alone,
    // not the menu's charger and level.
    hw({"charger usb 1"});
    h.shotWhen("strip_window_back.png", [](const Png &p) {
        std::vector<int> in = ink(p);
        int sides = 0, middle = 0;
        for (int x = 0; x < p.w; x++)
            (x >= kSlot - 20 && x < 2 * kSlot + 20 ? middle : sides) += in[(size_t)x];
        return redIn(p, 0, p.w) == 0 && sides == 0 && middle > 0;
    });
}

}  // namespace

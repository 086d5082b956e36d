// The dialog and the bars on a headless GUI: geometry, key and pointer rules, registry.
#include <string>

#include "mmi_bars.h"
#include "mmi_dialog.h"
#include "mmi_iconlet.h"
#include "unit/config/log_capture.h"
#include "unit/gui/gui_harness.h"

using namespace guitest;

TempRoot *GuiEnvironment::root_ = nullptr;

namespace {

const testing::Environment *const kEnv = ::testing::AddGlobalTestEnvironment(new GuiEnvironment);

TEST(DialogLayoutTest, ButtonsShareTheWidthAndTheLastTakesTheRest) {
    MMI_DIALOG_LAYOUT l;
    mmi_dialog_layout(45, 427, 630, 426, 2, &l);
    RECT b0, b1;
    mmi_dialog_button_rect(&l, 0, &b0);
    mmi_dialog_button_rect(&l, 1, &b1);
    EXPECT_EQ(b0.left, 0);
    EXPECT_EQ(RECTW(b0), 314);
    EXPECT_EQ(b1.left, 315);
    EXPECT_EQ(RECTW(b1), 315);
    // Rows: title to a third minus the separator, text the second third, buttons below.
    EXPECT_EQ(l.title.bottom, 138);
    EXPECT_EQ(l.text.top, 142);
    EXPECT_EQ(l.text.bottom, 284);
    EXPECT_EQ(l.buttons.top, 285);
    EXPECT_EQ(l.buttons.bottom, 426);

    mmi_dialog_layout(0, 0, 630, 426, 3, &l);
    int widths[3];
    for (int i = 0; i < 3; i++) {
        RECT rc;
        mmi_dialog_button_rect(&l, i, &rc);
        widths[i] = RECTW(rc);
        EXPECT_EQ(rc.left, 210 * i);
    }
    EXPECT_EQ(widths[0], 209);
    EXPECT_EQ(widths[1], 209);
    EXPECT_EQ(widths[2], 210);
}

TEST(DialogLayoutTest, PointerFindsTheButtonOnlyInTheButtonRow) {
    MMI_DIALOG_LAYOUT l;
    mmi_dialog_layout(100, 200, 631, 300, 3, &l);
    EXPECT_EQ(mmi_dialog_button_at(&l, 100, 200 + 201), 0);
    EXPECT_EQ(mmi_dialog_button_at(&l, 100 + 210, 200 + 299), 1);
    EXPECT_EQ(mmi_dialog_button_at(&l, 100 + 630, 200 + 250), 2);  // the wider last button
    EXPECT_EQ(mmi_dialog_button_at(&l, 100 + 631, 200 + 250), -1);
    EXPECT_EQ(mmi_dialog_button_at(&l, 150, 200 + 200), -1);  // the row starts a pixel lower
    mmi_dialog_layout(0, 0, 300, 300, 0, &l);
    EXPECT_EQ(mmi_dialog_button_at(&l, 10, 250), -1);
}

// A dialog over a recording window; the window is its host and notify window.
class DialogTest : public ::testing::Test {
  protected:
    void open(int buttons) {
        static const char *const labels[] = {"Yes", "No", "Maybe"};
        gui_.run([&] {
            dlg_ = CreateDialog("Title", "Text", 30, 200, 420, 300, gui_.hwnd(), gui_.hwnd(), 0,
                                labels, buttons, 0);
            ASSERT_NE(dlg_, HDIALOG_INVALID);
            EXPECT_EQ(DoModal(dlg_), 1);
        });
        ASSERT_TRUE(idle());
        log().clear();
    }
    void TearDown() override {
        gui_.run([&] { DestroyDialog(dlg_); });
        idle();
    }
    void key(int code) {
        ftx_gui_inject(FTX_INPUT_KEYDOWN, code, 0);
        ftx_gui_inject(FTX_INPUT_KEYUP, code, 0);
        ASSERT_TRUE(idle());
    }
    std::vector<int> reports() {
        std::vector<int> out;
        for (const Rec &r : log().of(gui_.hwnd(), MSG_DIALOGBTN))
            out.push_back((int)r.wp);
        return out;
    }
    GuiThread gui_;
    HDIALOG dlg_ = HDIALOG_INVALID;
};

TEST_F(DialogTest, SoftKeysReportTheirButtonAndCloseTheDialog) {
    for (int code : {SCANCODE_F2, SCANCODE_F3}) {
        open(2);
        key(code);
        EXPECT_EQ(reports(), std::vector<int>{code == SCANCODE_F2 ? 0 : 1});
        EXPECT_EQ(dlg_->window, HWND_INVALID);
        // The hooks are back: keys reach the window again, nothing more is reported.
        log().clear();
        key(SCANCODE_F2);
        EXPECT_TRUE(reports().empty());
        EXPECT_EQ(log().of(gui_.hwnd(), MSG_KEYDOWN).size(), 1u);
        gui_.run([&] { DestroyDialog(dlg_); });
        dlg_ = HDIALOG_INVALID;
    }
}

TEST_F(DialogTest, DownKeyAnswersOneOnlyInAOneButtonDialog) {
    open(2);
    key(SCANCODE_CURSORBLOCKDOWN);
    EXPECT_TRUE(reports().empty());
    EXPECT_NE(dlg_->window, HWND_INVALID);
    // Keys do not reach other windows while the dialog is up.
    EXPECT_TRUE(log().of(gui_.hwnd(), MSG_KEYDOWN).empty());
    gui_.run([&] { DestroyDialog(dlg_); });
    open(1);
    key(SCANCODE_CURSORBLOCKDOWN);
    EXPECT_EQ(reports(), std::vector<int>{1});
}

TEST_F(DialogTest, APressMovedOffItsButtonReportsNothing) {
    open(2);
    // Button row of the dialog at (30, 200), 420 x 300: from y = 200 + 201.
    ftx_gui_inject(FTX_INPUT_TOUCHDOWN, 60, 450);
    ftx_gui_inject(FTX_INPUT_TOUCHMOVE, 300, 450);
    ftx_gui_inject(FTX_INPUT_TOUCHUP, 300, 450);
    ASSERT_TRUE(idle());
    EXPECT_TRUE(reports().empty());
    ftx_gui_inject(FTX_INPUT_TOUCHDOWN, 300, 450);
    ftx_gui_inject(FTX_INPUT_TOUCHUP, 300, 450);
    ASSERT_TRUE(idle());
    EXPECT_EQ(reports(), std::vector<int>{1});
}

TEST_F(DialogTest, CloseButtonDismissesWithNumberThreeFromAnotherThread) {
    open(2);
    std::thread([] { EXPECT_EQ(AutoCloseDialog("start", 5, nullptr, 0), 1); }).join();
    ASSERT_TRUE(idle());
    EXPECT_EQ(reports(), std::vector<int>{3});
    // The notify window destroys the record, as the main window does on MSG_DIALOGBTN.
    gui_.run([&] { DestroyDialog(dlg_); });
    dlg_ = HDIALOG_INVALID;
    key(SCANCODE_F2);  // hooks restored
    EXPECT_EQ(log().of(gui_.hwnd(), MSG_KEYDOWN).size(), 1u);
}

// ---- bars ----

std::vector<ICONLET_ITEM> items_of(HWND ctrl) {
    std::vector<ICONLET_ITEM> out;
    int n = (int)SendMessage(ctrl, ILM_GETITEMCOUNT, 0, 0);
    for (int i = 0; i < n; i++) {
        ICONLET_ITEM it{};
        SendMessage(ctrl, ILM_GETITEM, (WPARAM)i, (LPARAM)&it);
        out.push_back(it);
    }
    return out;
}

TEST(BarTest, EverySetterAnswersZeroBeforeTheBarExists) {
    HWND owner = (HWND)0x1234;
    EXPECT_EQ(tp_skb_set_text_items(owner, "a", "b", "c"), 0);
    EXPECT_EQ(tp_skb_update(owner), 0);
    EXPECT_EQ(tp_skb_set_text_col(12), 0);
    EXPECT_EQ(tp_batteryshow_set_text_items_byIndex(owner, "x", 1), 0);
    EXPECT_EQ(tp_batteryshow_update(owner), 0);
    EXPECT_EQ(tp_skb_show(1), 0);
}

TEST(BarTest, TapOnASoftKeyActsAsTheKey) {
    ASSERT_TRUE(RegisterIconLetCtrl());
    GuiThread gui(RECT{0, 40, kW, kH - 63});
    RECT bar = {0, kH - 63, kW, kH};
    ASSERT_EQ(svr_create_softkeybar(gui.hwnd(), &bar, 1), 1);
    ASSERT_EQ(tp_skb_set_text_items(gui.hwnd(), "Pass", "", "Fail"), 1);
    ASSERT_EQ(tp_skb_set_text_items(gui.hwnd(), "Pass", nullptr, "Fail"), 1);
    EXPECT_EQ(tp_skb_record_count(), 1);  // the second set replaced the first
    ASSERT_EQ(tp_skb_update(gui.hwnd()), 1);
    auto items = items_of(tp_skb_control());
    ASSERT_EQ(items.size(), 3u);
    EXPECT_EQ(items[1].x, kW / 3);
    EXPECT_EQ(items[2].width, kW / 3);
    EXPECT_STREQ(items[2].text, "Fail");
    ASSERT_TRUE(idle());

    auto tap = [](int x0, int x1) {
        ftx_gui_inject(FTX_INPUT_TOUCHDOWN, x0, kH - 30);
        if (x1 != x0) ftx_gui_inject(FTX_INPUT_TOUCHMOVE, x1, kH - 30);
        ftx_gui_inject(FTX_INPUT_TOUCHUP, x1, kH - 30);
        ASSERT_TRUE(idle());
    };
    log().clear();
    tap(kW - 10, kW - 10);
    auto keys = log().of(gui.hwnd(), MSG_KEYDOWN);
    ASSERT_EQ(keys.size(), 1u);
    EXPECT_EQ(keys[0].wp, (WPARAM)SCANCODE_F3);
    auto taps = log().of(gui.hwnd(), MSG_SOFTKEYTAP);
    ASSERT_EQ(taps.size(), 1u);
    EXPECT_EQ(taps[0].wp, 2u);

    log().clear();
    tap(10, kW / 3 + 10);  // ends on another slot
    tap(kW / 2, kW / 2);   // the empty middle text
    EXPECT_TRUE(log().of(gui.hwnd(), MSG_KEYDOWN).empty());
    tap(10, 10);
    keys = log().of(gui.hwnd(), MSG_KEYDOWN);
    ASSERT_EQ(keys.size(), 1u);
    EXPECT_EQ(keys[0].wp, (WPARAM)SCANCODE_F2);

    EXPECT_EQ(tp_skb_del_items(), 1);
    EXPECT_EQ(tp_skb_record_count(), 0);
    EXPECT_EQ(svr_destroy_softkeybar(), 1);
    EXPECT_EQ(tp_skb_window(), HWND_NULL);
}

TEST(BarTest, TitleStripByIndexSettersCheckIndexAndOwner) {
    ASSERT_TRUE(RegisterIconLetCtrl());
    GuiThread gui(RECT{0, 40, kW, kH - 63});
    RECT strip = {0, 0, kW, 42};
    ASSERT_EQ(svr_create_batteryshow(gui.hwnd(), &strip, 1), 1);
    LogCapture log;
    EXPECT_EQ(tp_batteryshow_set_text_items_byIndex(gui.hwnd(), "x", 1), 0);
    EXPECT_TRUE(log.has("tp_batteryshow_set_text_items_byIndex pNode is NULL"));
    EXPECT_EQ(tp_batteryshow_has_items(gui.hwnd()), 0);
    ASSERT_EQ(tp_batteryshow_set_text_items(gui.hwnd(), "L", "M", "R"), 1);
    EXPECT_EQ(tp_batteryshow_has_items(gui.hwnd()), 1);
    EXPECT_EQ(tp_batteryshow_set_text_items_byIndex(gui.hwnd(), "x", 3), 0);
    EXPECT_TRUE(log.has("tp_batteryshow_set_text_items_byIndex index error = 3"));
    ASSERT_EQ(tp_batteryshow_set_text_items_byIndex(gui.hwnd(), "Hot", 1), 1);
    ASSERT_EQ(tp_batteryshow_update(gui.hwnd()), 1);
    auto items = items_of(tp_batteryshow_control());
    ASSERT_EQ(items.size(), 3u);
    EXPECT_STREQ(items[0].text, "L");
    EXPECT_STREQ(items[1].text, "Hot");
    // Drawn: the strip is no longer plain bar background.
    ASSERT_TRUE(idle());
    EXPECT_GT(count_not(strip, pixel(1, 1)), 0);
    EXPECT_EQ(tp_batteryshow_destroy(), 1);
}

TEST(BarTest, ALongTitleSpreadsIntoFreeRoomInsteadOfBeingCut) {
    ASSERT_TRUE(RegisterIconLetCtrl());
    GuiThread gui(RECT{0, 40, kW, kH - 63});
    RECT strip = {0, 0, kW, 42};
    ASSERT_EQ(svr_create_batteryshow(gui.hwnd(), &strip, 1), 1);
    const char *title = "Product information of the handset";
    ASSERT_EQ(tp_batteryshow_set_text_items(gui.hwnd(), "", title, ""), 1);
    ASSERT_EQ(tp_batteryshow_update(gui.hwnd()), 1);
    ASSERT_TRUE(idle());
    RECT leftThird = {0, 0, kW / 3, 42};
    EXPECT_GT(count_not(leftThird, pixel(0, 1)), 0);  // the title reaches past its slot

    // A right text keeps its room: it looks the same beside a long title as beside a short one.
    auto rightThird = [&] {
        EXPECT_EQ(tp_batteryshow_update(gui.hwnd()), 1);
        EXPECT_TRUE(idle());
        std::vector<Uint32> px;
        for (int y = 0; y < 42; y++)
            for (int x = kW - kW / 6 - 10; x < kW; x++)
                px.push_back(pixel(x, y));
        return px;
    };
    ASSERT_EQ(tp_batteryshow_set_text_items(gui.hwnd(), "", "T", "88%"), 1);
    auto beside_short = rightThird();
    ASSERT_EQ(tp_batteryshow_set_text_items(gui.hwnd(), "", title, "88%"), 1);
    EXPECT_EQ(beside_short, rightThird());
    EXPECT_EQ(tp_batteryshow_destroy(), 1);
}

// Texts without blanks: a gap of several background columns in the strip can only be the
// room between two items.
TEST(BarTest, TextsWiderThanTheirSlotKeepClearOfTheirNeighbours) {
    ASSERT_TRUE(RegisterIconLetCtrl());
    GuiThread gui(RECT{0, 40, kW, kH - 63});
    RECT strip = {0, 0, kW, 42};
    ASSERT_EQ(svr_create_batteryshow(gui.hwnd(), &strip, 1), 1);
    // The strip's columns holding text, as runs [first, last + 1) split at 8 or more
    // background columns.
    auto runs = [&](const char *left, const char *middle, const char *right) {
        EXPECT_EQ(tp_batteryshow_set_text_items(gui.hwnd(), left, middle, right), 1);
        EXPECT_EQ(tp_batteryshow_update(gui.hwnd()), 1);
        EXPECT_TRUE(idle());
        const Uint32 bg = pixel(kW - 1, 1);
        std::vector<std::pair<int, int>> out;
        int blank = 1000;
        for (int x = 0; x < kW; x++) {
            if (count_not(RECT{x, 2, x + 1, 38}, bg) == 0) {
                blank++;
                continue;
            }
            if (out.empty() || blank >= 8)
                out.push_back({x, x + 1});
            else
                out.back().second = x + 1;
            blank = 0;
        }
        return out;
    };
    const int third = kW / 3;
    // Two texts too wide for their slots beside each other, and a short one.
    auto r = runs("NOTCHARGINGATALL", "BATTERYLOWPLEASECHARGENOW", "12%");
    ASSERT_EQ(r.size(), 3u);
    EXPECT_LE(r[0].second, third);  // the left text is cut at its own slot
    EXPECT_GE(r[1].first, third);
    EXPECT_GE(r[2].first, 2 * third);
    // The same two apart: both use the free middle slot and share it.
    r = runs("NOTCHARGINGATALL", "", "BATTERYLOWPLEASE");
    ASSERT_EQ(r.size(), 2u);
    EXPECT_GT(r[0].second, third);
    EXPECT_LT(r[1].first, 2 * third);
    // A short neighbour keeps its room and a long title stays clear of it on both sides.
    r = runs("AB", "BATTERYTEMPERATURETOOHIGHNOW", "88%");
    ASSERT_EQ(r.size(), 3u);
    EXPECT_GT(r[1].second, 2 * third);  // the title uses the room the short texts leave
    EXPECT_EQ(tp_batteryshow_destroy(), 1);
}

TEST(BarTest, SlotsAreThirdsOfTheWidth) {
    EXPECT_EQ(tp_bar_slot_at(0, 720), 0);
    EXPECT_EQ(tp_bar_slot_at(239, 720), 0);
    EXPECT_EQ(tp_bar_slot_at(240, 720), 1);
    EXPECT_EQ(tp_bar_slot_at(719, 720), 2);
    EXPECT_EQ(tp_bar_slot_at(721, 721), -1);  // past the third slot of 240
    EXPECT_EQ(tp_bar_slot_at(-1, 720), -1);
}

}  // namespace

// Controls: the scroll view's selection and choice reports, the static control's text.
#include "gui_harness.h"

using namespace guitest;

namespace {

std::mutex g_notesLock;
std::vector<std::pair<int, DWORD>> g_notes;

void note(HWND, LINT, int nc, DWORD add) {
    std::lock_guard<std::mutex> lk(g_notesLock);
    g_notes.emplace_back(nc, add);
}

std::vector<std::pair<int, DWORD>> chosen() {
    std::lock_guard<std::mutex> lk(g_notesLock);
    std::vector<std::pair<int, DWORD>> out;
    for (auto &n : g_notes)
        if (n.first == SVN_ITEMCHOSEN) out.push_back(n);
    return out;
}

void draw_item(HWND hwnd, HSVITEM item, HDC hdc, RECT *rc) {
    SetBrushColor(hdc, scrollview_is_item_hilight(hwnd, item) ? 0xFFFFFF : 0x202020);
    FillBox(hdc, rc->left, rc->top, RECTW(*rc), RECTH(*rc));
}

}  // namespace

TEST(Controls, ScrollViewSelectsWithArrowsAndReportsChoices) {
    GuiThread gui;
    HWND list = HWND_INVALID;
    HSVITEM items[3] = {};
    gui.run([&] {
        list = CreateWindowEx(CTRL_SCROLLVIEW, "", WS_CHILD | WS_VISIBLE | SVS_LOOP, 0, 21, 0, 100,
                              kW, 300, gui.hwnd(), 0);
        SendMessage(list, SVM_SETITEMDRAW, 0, reinterpret_cast<LPARAM>(draw_item));
        for (int i = 0; i < 3; i++) {
            SVITEMINFO info{-1, 80, static_cast<DWORD>(100 + i)};
            EXPECT_EQ(SendMessage(list, SVM_ADDITEM, reinterpret_cast<WPARAM>(&items[i]),
                                  reinterpret_cast<LPARAM>(&info)),
                      i);
        }
        SendMessage(list, SVM_SETCURSEL, 0, 1);
        SetNotificationCallback(list, note);
        SetFocusChild(list);
    });
    ASSERT_NE(list, HWND_INVALID);
    ASSERT_TRUE(idle());
    EXPECT_EQ(GetDlgItem(gui.hwnd(), 21), list);
    EXPECT_EQ(pixel(10, 110), 0xFFFFFFu) << "the first item is highlighted";
    EXPECT_EQ(pixel(10, 190), 0x202020u);

    // Keys reach the list through the main window (the focus child).
    ftx_gui_inject(FTX_INPUT_KEYDOWN, SCANCODE_CURSORBLOCKDOWN, 0);
    ftx_gui_inject(FTX_INPUT_KEYDOWN, SCANCODE_CURSORBLOCKDOWN, 0);
    ASSERT_TRUE(idle());
    EXPECT_EQ(SendMessage(list, SVM_GETCURSEL, 0, 0), 2);
    EXPECT_EQ(pixel(10, 270), 0xFFFFFFu);
    ftx_gui_inject(FTX_INPUT_KEYDOWN, SCANCODE_CURSORBLOCKDOWN, 0);  // wraps with SVS_LOOP
    ftx_gui_inject(FTX_INPUT_KEYDOWN, SCANCODE_CURSORBLOCKUP, 0);
    ftx_gui_inject(FTX_INPUT_KEYDOWN, SCANCODE_CURSORBLOCKUP, 0);
    ASSERT_TRUE(idle());
    EXPECT_EQ(SendMessage(list, SVM_GETCURSEL, 0, 0), 1);
    EXPECT_TRUE(chosen().empty()) << "moving is not choosing";

    ftx_gui_inject(FTX_INPUT_KEYDOWN, SCANCODE_ENTER, 0);
    ASSERT_TRUE(idle());
    ASSERT_EQ(chosen().size(), 1u);
    EXPECT_EQ(chosen()[0].second, reinterpret_cast<DWORD>(items[1]));
    EXPECT_EQ(scrollview_get_item_adddata(items[1]), 101u);

    // A tap on the third item (screen y 100 + 2 * 80 + 10) chooses it.
    ftx_gui_inject(FTX_INPUT_TOUCHDOWN, 50, 270);
    ftx_gui_inject(FTX_INPUT_TOUCHUP, 50, 270);
    ASSERT_TRUE(idle());
    ASSERT_EQ(chosen().size(), 2u);
    EXPECT_EQ(chosen()[1].second, reinterpret_cast<DWORD>(items[2]));
    EXPECT_EQ(SendMessage(list, SVM_GETCURSEL, 0, 0), 2);
    EXPECT_EQ(scrollview_get_item_index(list, items[2]), 2);

    // A press that slides off its item before lifting chooses nothing.
    ftx_gui_inject(FTX_INPUT_TOUCHDOWN, 50, 110);
    ftx_gui_inject(FTX_INPUT_TOUCHMOVE, 50, 190);
    ftx_gui_inject(FTX_INPUT_TOUCHUP, 50, 190);
    ASSERT_TRUE(idle());
    EXPECT_EQ(chosen().size(), 2u);
    std::lock_guard<std::mutex> lk(g_notesLock);
    g_notes.clear();
}

TEST(Controls, StaticTextFollowsSetWindowText) {
    GuiThread gui;
    HWND label = HWND_INVALID;
    gui.run([&] {
        label = CreateWindowEx(CTRL_STATIC, "", WS_VISIBLE | SS_CENTER, 0, 20, 40, 40, 200, 60,
                               gui.hwnd(), 0);
    });
    ASSERT_TRUE(idle());
    EXPECT_EQ(count_not(RECT{40, 40, 240, 100}, 0), 0) << "no text yet";
    EXPECT_TRUE(SetWindowText(label, "Vibration"));
    ASSERT_TRUE(idle());
    char buf[32];
    EXPECT_EQ(GetWindowText(label, buf, 4), 4);
    EXPECT_STREQ(buf, "Vibr");
    EXPECT_GT(count_not(RECT{40, 40, 240, 100}, 0), 50);
    EXPECT_EQ(count_not(RECT{0, 100, kW, kH}, 0), 0);
}

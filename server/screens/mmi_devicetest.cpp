// The device-test list window.
#include "screens/mmi_devicetest.h"

#include <string.h>

#include <atomic>

#include <android/log.h>

#include "core/ftx_lib_binding.h"
#include "session/mmi_autotest.h"
#include "mmi_guithread.h"
#include "screens/mmi_infoscreen.h"
#include "screens/mmi_listscreen.h"
#include "session/mmi_runstate.h"
#include "session/mmi_testinfo.h"
#include "testwnd/mmi_testwnd.h"
#include "tp_os.h"
#include "mmi_theme.h"

#define DT_TAG "FTX_MAIN"
#define DT_DEBUG(...) __android_log_print(ANDROID_LOG_DEBUG, DT_TAG, __VA_ARGS__)

namespace {

// GUI thread only, apart from the handle and the pending flag.
std::atomic<HWND> s_window{HWND_INVALID};
mmi_devicetest_row s_rows[MMI_DEVICETEST_MAX_ROWS];
int s_rowCount;
int s_results[MMI_DEVICETEST_MAX_ROWS];
// A refresh is queued and has not reread the record yet: a burst of writes queues one.
std::atomic<bool> s_refreshPending{false};

int result_of(const unsigned char *flags, int item) {
    if (item < 0 || item >= MMI_TESTINFO_ITEMS) return 0;
    return (flags[item / 4] >> ((3 - item % 4) * 2)) & 3;
}

// A run rebuilds the item list; the rows follow it and reread the record.
int fill_rows(void) {
    s_refreshPending = false;  // a write from here on queues another refresh
    s_rowCount = mmi_devicetest_build_rows(g_pTestItemListHead, s_rows, MMI_DEVICETEST_MAX_ROWS);
    unsigned char flags[MMI_TESTINFO_FLAGS_SIZE] = {0};
    if (hw::ftx_api_GetTestInfoFlag) hw::ftx_api_GetTestInfoFlag(flags);
    GetTestItemsResult(flags);
    for (int i = 0; i < s_rowCount; i++) {
        int idx = s_rows[i].resultIndex;
        s_results[i] = idx >= 0 && idx < MMI_TESTINFO_ITEMS ? (int)g_testinfo[idx].test_result : 0;
    }
    return s_rowCount;
}

void draw_row(HWND hWnd, HSVITEM hsvi, HDC hdc, RECT *rc) {
    int i = mmi_listscreen_row(hsvi);
    if (i < 0 || i >= s_rowCount) return;
    char label[MMI_TESTWND_TEXT_SIZE], word[MMI_TESTWND_TEXT_SIZE] = "";
    mmi_translate(s_rows[i].labelKey, label, sizeof(label));
    if (s_results[i] == MMI_RESULT_PASS) mmi_translate("Result_pass", word, sizeof(word));
    if (s_results[i] == MMI_RESULT_FAIL) mmi_translate("Result_fail", word, sizeof(word));
    mmi_listscreen_draw_row(hWnd, hsvi, hdc, rc, label, word,
                            mmi_devicetest_result_colour(s_results[i]));
}

void open_row(const mmi_devicetest_row *row) {
    switch (row->kind) {
        case DEVICETEST_ROW_FULL_RUN:
            mmi_AutoTestEntry();
            break;
        case DEVICETEST_ROW_SUMMARY:
            mmi_TestInfoEntry();
            break;
        case DEVICETEST_ROW_PRETEST1:
            mmi_AutoTestEntry_Ex();
            break;
        case DEVICETEST_ROW_PRETEST2:
            mmi_AutoTestEntry_Ex2();
            break;
        default:
            if (row->item && row->item->entry) row->item->entry();
            break;
    }
}

void choose_row(int i) {
    if (i < 0 || i >= s_rowCount) return;
    unsigned char flags[MMI_TESTINFO_FLAGS_SIZE] = {0};
    if (hw::ftx_api_GetTestInfoFlag) hw::ftx_api_GetTestInfoFlag(flags);
    int choice = mmi_devicetest_choice(&s_rows[i], flags, g_bAutoTestRunning.load());
    if (choice < 0) {
        DT_DEBUG("%s device autotest running,please exit autotest.", "on_choose");
        return;
    }
    if (choice > 0) {
        PostMessage(mmi_guithread_window(), MSG_CREATEDIALG, 0, (LPARAM)choice);
        return;
    }
    open_row(&s_rows[i]);
}

const mmi_listscreen_desc kList = {"Device Test", "menu_DeviceTest", 2,         0,        fill_rows,
                                   draw_row,      choose_row,        MSG_TIMER, &s_window};

}  // namespace

int mmi_devicetest_result_colour(int result) {
    if (result == MMI_RESULT_PASS) return MMI_COLOUR_PASS;
    if (result == MMI_RESULT_FAIL) return MMI_COLOUR_FAIL;
    return MMI_COLOUR_TEXT;
}

int mmi_devicetest_build_rows(const testitem_node *head, mmi_devicetest_row *rows, int max) {
    static const mmi_devicetest_row kFixed[] = {
        {DEVICETEST_ROW_FULL_RUN, "menu_AutoTest", nullptr, MMI_ITEM_CAC_PREVIEW},
        {DEVICETEST_ROW_SUMMARY, "menu_ProduceInfo", nullptr, -1},
        {DEVICETEST_ROW_PRETEST1, "menu_AutoTest_EX", nullptr, MMI_ITEM_CAC_PREVIEW_TEMP},
        {DEVICETEST_ROW_PRETEST2, "menu_AutoTest_EX2", nullptr, MMI_ITEM_CAC_PREVIEW},
    };
    int n = 0;
    for (const auto &r : kFixed) {
        if (n < max) rows[n++] = r;
    }
    for (const testitem_node *p = head; p && n < max; p = p->pNodeNext) {
        rows[n++] = {DEVICETEST_ROW_ITEM, p->name, p, p->item_code};
    }
    return n;
}

int mmi_devicetest_choice(const mmi_devicetest_row *row, const unsigned char *flags,
                          int autoTestRunning) {
    if (autoTestRunning == 1) return -1;
    const bool passed64 = result_of(flags, MMI_ITEM_CAC_PREVIEW) == MMI_RESULT_PASS;
    const bool passed66 = result_of(flags, MMI_ITEM_CAC_PREVIEW_TEMP) == MMI_RESULT_PASS;
    // A device that passed before asks before it runs again.
    switch (row->kind) {
        case DEVICETEST_ROW_FULL_RUN:
            return passed64 || passed66 ? 7 : 0;
        case DEVICETEST_ROW_PRETEST1:
            return passed64 || passed66 ? 8 : 0;
        case DEVICETEST_ROW_PRETEST2:
            return passed64 ? 9 : 0;
        default:
            return 0;
    }
}

int mmi_DeviceTestEntry(void) {
    // Rows as high as the main menu's.
    static mmi_listscreen_desc list = kList;
    list.itemHeight = (g_ptScreenInfo.width / 15) * 2;
    g_testinfoChanged = mmi_DeviceTest_RecordChanged;
    return mmi_listscreen_open(&list);
}

int mmi_DeviceTest_IsOpen(void) {
    return s_window != HWND_INVALID;
}

HWND mmi_DeviceTest_Window(void) {
    return s_window;
}

void mmi_DeviceTest_Refresh(void) {
    HWND open = s_window.load();
    DT_DEBUG("%s open=%d", __func__, open != HWND_INVALID);
    if (open != HWND_INVALID) SendMessage(open, MSG_TIMER, MMI_DEVICETEST_TIMER_REFRESH, 0);
}

void mmi_DeviceTest_RecordChanged(void) {
    // Any thread, with no lock of the record held: queue the refresh, never wait for it.
    HWND open = s_window.load();
    if (open == HWND_INVALID || s_refreshPending.exchange(true)) return;
    if (PostMessage(open, MSG_TIMER, MMI_DEVICETEST_TIMER_REFRESH, 0) != ERR_OK)
        s_refreshPending = false;
}

// The device-test list window.
#include "mmi_devicetest.h"

#include <string.h>

#include <atomic>

#include <android/log.h>

#include "ftx_config.h"
#include "ftx_lib_binding.h"
#include "minigui/control.h"
#include "mmi_autotest.h"
#include "mmi_bars.h"
#include "mmi_guithread.h"
#include "mmi_mainwnd.h"
#include "mmi_infoscreen.h"
#include "mmi_runstate.h"
#include "mmi_settings.h"
#include "mmi_testinfo.h"
#include "mmi_testwnd.h"
#include "tp_os.h"

#define DT_TAG "FTX_MAIN"
#define DT_DEBUG(...) __android_log_print(ANDROID_LOG_DEBUG, DT_TAG, __VA_ARGS__)

namespace {

const int kListId = 21;
const int kColourText = 19;
const int kColourPass = 10;
const int kColourFail = 12;
const int kColourWindow = 18;

// GUI thread only.
std::atomic<HWND> s_window{HWND_INVALID};
mmi_devicetest_row s_rows[MMI_DEVICETEST_MAX_ROWS];
int s_rowCount;
int s_results[MMI_DEVICETEST_MAX_ROWS];

int result_of(const unsigned char *flags, int item) {
    if (item < 0 || item >= MMI_TESTINFO_ITEMS) return 0;
    return (flags[item / 4] >> ((3 - item % 4) * 2)) & 3;
}

void read_results(void) {
    unsigned char flags[MMI_TESTINFO_FLAGS_SIZE] = {0};
    if (hw::ftx_api_GetTestInfoFlag) hw::ftx_api_GetTestInfoFlag(flags);
    GetTestItemsResult(flags);
    for (int i = 0; i < s_rowCount; i++) {
        int idx = s_rows[i].resultIndex;
        s_results[i] = idx >= 0 && idx < MMI_TESTINFO_ITEMS ? (int)g_testinfo[idx].test_result : 0;
    }
}

void translate(const char *key, char *out, size_t size) {
    tp_os_strlcpy(out, key, size);
    Read_LangCfgFromList(key, out);
}

void draw_row(HWND hWnd, HSVITEM hsvi, HDC hdc, RECT *rc) {
    int i = (int)scrollview_get_item_adddata(hsvi);
    if (i < 0 || i >= s_rowCount) return;
    if (scrollview_is_item_hilight(hWnd, hsvi)) {
        SetBrushColor(hdc, SysPixelIndex[7]);
        FillBox(hdc, rc->left, rc->top, RECTWP(rc), RECTHP(rc));
    }
    char label[256], word[256] = "";
    translate(s_rows[i].labelKey, label, sizeof(label));
    int colour = mmi_devicetest_result_colour(s_results[i]);
    if (s_results[i] == MMI_RESULT_PASS) translate("Result_pass", word, sizeof(word));
    if (s_results[i] == MMI_RESULT_FAIL) translate("Result_fail", word, sizeof(word));
    SetBkMode(hdc, BM_TRANSPARENT);
    SetTextColor(hdc, SysPixelIndex[colour]);
    RECT text = *rc;
    text.left += RECTWP(rc) / 20;
    text.right -= RECTWP(rc) / 20;
    DrawText(hdc, label, -1, &text, DT_LEFT | DT_VCENTER | DT_SINGLELINE);
    if (word[0]) DrawText(hdc, word, -1, &text, DT_RIGHT | DT_VCENTER | DT_SINGLELINE);
    SetPenColor(hdc, SysPixelIndex[20]);
    MoveTo(hdc, rc->left, rc->bottom - 1);
    LineTo(hdc, rc->right, rc->bottom - 1);
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

void on_choose(HWND hwnd, LINT id, int nc, DWORD add) {
    (void)hwnd;
    (void)id;
    if (nc != SVN_ITEMCHOSEN) return;
    int i = (int)scrollview_get_item_adddata((HSVITEM)add);
    if (i < 0 || i >= s_rowCount) return;
    unsigned char flags[MMI_TESTINFO_FLAGS_SIZE] = {0};
    if (hw::ftx_api_GetTestInfoFlag) hw::ftx_api_GetTestInfoFlag(flags);
    int choice = mmi_devicetest_choice(&s_rows[i], flags, g_bAutoTestRunning.load());
    if (choice < 0) {
        DT_DEBUG("%s device autotest running,please exit autotest.", __func__);
        return;
    }
    if (choice > 0) {
        PostMessage(mmi_guithread_window(), MSG_CREATEDIALG, 0, (LPARAM)choice);
        return;
    }
    open_row(&s_rows[i]);
}

void show_bars(HWND hWnd) {
    char title[256];
    translate("menu_DeviceTest", title, sizeof(title));
    tp_skb_set_text_col(kColourText);
    tp_skb_set_text_items(hWnd, "", "", g_cItemBack);
    tp_skb_update(hWnd);
    tp_batteryshow_set_text_items(hWnd, "", title, "");
    tp_batteryshow_update(hWnd);
}

void fill_list(HWND list) {
    int cur = (int)SendMessage(list, SVM_GETCURSEL, 0, 0);
    SendMessage(list, SVM_RESETCONTENT, 0, 0);
    s_rowCount = mmi_devicetest_build_rows(g_pTestItemListHead, s_rows, MMI_DEVICETEST_MAX_ROWS);
    read_results();
    const int w = g_ptScreenInfo.width;
    for (int i = 0; i < s_rowCount; i++) {
        SVITEMINFO info;
        info.nItem = i;
        info.nItemHeight = (w / 15) * 2;
        info.addData = (DWORD)i;
        SendMessage(list, SVM_ADDITEM, 0, (LPARAM)&info);
    }
    SendMessage(list, SVM_SETCURSEL, cur > 0 && cur < s_rowCount ? cur : 0, 1);
}

LRESULT devicetest_proc(HWND hWnd, UINT message, WPARAM wParam, LPARAM lParam) {
    switch (message) {
        case MSG_CREATE: {
            RECT rc;
            GetClientRect(hWnd, &rc);
            HWND list =
                CreateWindowEx(CTRL_SCROLLVIEW, "", WS_VISIBLE | WS_BORDER | SVS_LOOP, WS_EX_NONE,
                               kListId, 0, 3, RECTW(rc), RECTH(rc) - 3, hWnd, 0);
            if (g_mmiLogFont[2]) SetWindowFont(list, g_mmiLogFont[2]);
            SendMessage(list, SVM_SETITEMDRAW, 0, (LPARAM)draw_row);
            SetNotificationCallback(list, on_choose);
            fill_list(list);
            SetFocusChild(list);
            show_bars(hWnd);
            break;
        }
        case MSG_ACTIVE:
            if (wParam) show_bars(hWnd);
            break;
        case MSG_TIMER:
            if (wParam == MMI_DEVICETEST_TIMER_REFRESH) {
                DT_DEBUG("%s refresh", __func__);
                // A run rebuilds the item list; the rows follow it.
                fill_list(GetDlgItem(hWnd, kListId));
                InvalidateRect(GetDlgItem(hWnd, kListId), nullptr, TRUE);
                show_bars(hWnd);
            }
            break;
        case MSG_KEYDOWN:
            if (wParam == MMI_KEY_FAIL) {
                SendMessage(hWnd, MSG_CLOSE, 0, 0);
                return 0;
            }
            break;
        case MSG_PAINT: {
            HDC hdc = BeginPaint(hWnd);
            SetPenColor(hdc, SysPixelIndex[kColourPass]);
            SetPenWidth(hdc, 3);
            MoveTo(hdc, 0, 0);
            LineTo(hdc, g_ptScreenInfo.width, 0);
            EndPaint(hWnd, hdc);
            return 0;
        }
        case MSG_CLOSE:
            s_window = HWND_INVALID;
            DestroyAllControls(hWnd);
            DestroyMainWindow(hWnd);
            return 0;
        default:
            break;
    }
    return DefaultMainWinProc(hWnd, message, wParam, lParam);
}

}  // namespace

int mmi_devicetest_result_colour(int result) {
    if (result == MMI_RESULT_PASS) return kColourPass;
    if (result == MMI_RESULT_FAIL) return kColourFail;
    return kColourText;
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
    HWND open = s_window.load();
    if (open != HWND_INVALID) {
        ShowWindow(open, SW_SHOWNORMAL);
        return 0;
    }
    RECT rc;
    mmi_testwnd_rect(g_ptScreenInfo.width, g_ptScreenInfo.height, &rc);
    MAINWINCREATE create;
    memset(&create, 0, sizeof(create));
    create.dwStyle = WS_CAPTION | WS_VISIBLE;
    create.dwExStyle = WS_EX_NONE;
    create.spCaption = "Device Test";
    create.hHosting = mmi_guithread_window();
    create.MainWindowProc = devicetest_proc;
    create.lx = rc.left;
    create.ty = rc.top;
    create.rx = rc.right;
    create.by = rc.bottom;
    create.iBkColor = SysPixelIndex[kColourWindow];
    HWND hWnd = CreateMainWindow(&create);
    if (hWnd == HWND_INVALID) {
        __android_log_print(ANDROID_LOG_ERROR, DT_TAG, "%s CreateMainWindow fail", __func__);
        return -1;
    }
    s_window = hWnd;
    ShowWindow(hWnd, SW_SHOWNORMAL);
    return 0;
}

int mmi_DeviceTest_IsOpen(void) {
    return s_window != HWND_INVALID;
}

HWND mmi_DeviceTest_Window(void) {
    return s_window;
}

void mmi_DeviceTest_Refresh(void) {
    HWND open = s_window.load();
    if (open != HWND_INVALID) SendMessage(open, MSG_TIMER, MMI_DEVICETEST_TIMER_REFRESH, 0);
}

// The test and product information screen.
#include "mmi_infoscreen.h"

#include <string.h>

#include <atomic>

#include <android/log.h>

#include "ftx_config.h"
#include "ftx_lib_binding.h"
#include "minigui/control.h"
#include "mmi_bars.h"
#include "mmi_guithread.h"
#include "mmi_mainwnd.h"
#include "mmi_identity.h"
#include "mmi_testinfo.h"
#include "mmi_settings.h"
#include "mmi_testwnd.h"
#include "tp_os.h"

#define INFO_TAG "FTX_MAIN"

namespace {

const int kListId = 22;
const int kColourText = 19;
const int kColourPass = 10;
const int kColourFail = 12;
const int kColourWindow = 18;

// GUI thread only, apart from the handle.
std::atomic<HWND> s_window{HWND_INVALID};
mmi_info_line s_lines[MMI_INFO_MAX_LINES];
int s_lineCount;

// A text key with the words to show when the language file lacks it.
void translate(const char *key, const char *fallback, char *out, size_t size) {
    tp_os_strlcpy(out, fallback, size);
    Read_LangCfgFromList(key, out);
}

struct IdentityRow {
    const char *key;
    const char *fallback;
    int kind;  // mmi_identity_kind, or -1 for the IMEI
};
const IdentityRow kIdentity[] = {
    {"info_SoftwareInternal", "Internal software", MMI_ID_SOFT_INTERNAL},
    {"info_SoftwareExternal", "External software", MMI_ID_SOFT_EXTERNAL},
    {"info_HardwareVersion", "Hardware version", MMI_ID_HARDWARE},
    {"info_PSN", "PSN", MMI_ID_PSN},
    {"info_BoardNum", "Board number", MMI_ID_BOARD},
    {"info_IMEI", "IMEI", -1},
    {"info_FlashType", "Flash type", MMI_ID_FLASH},
};

void build_lines(void) {
    s_lineCount = 0;
    for (const auto &row : kIdentity) {
        mmi_info_line &l = s_lines[s_lineCount++];
        translate(row.key, row.fallback, l.label, sizeof(l.label));
        memset(l.value, 0, sizeof(l.value));
        if (row.kind < 0) {
            mmi_testinfo_text(FTX_DATATYPE_TESTINFO_IMEI, l.value, sizeof(l.value));
        } else {
            mmi_identity_text(row.kind, l.value, sizeof(l.value));
        }
        l.colour = kColourText;
    }
    unsigned char flags[MMI_TESTINFO_FLAGS_SIZE] = {0};
    if (hw::ftx_api_GetTestInfoFlag) hw::ftx_api_GetTestInfoFlag(flags);
    s_lineCount +=
        mmi_info_record_lines(flags, s_lines + s_lineCount, MMI_INFO_MAX_LINES - s_lineCount);
}

void draw_line(HWND hWnd, HSVITEM hsvi, HDC hdc, RECT *rc) {
    int i = (int)scrollview_get_item_adddata(hsvi);
    if (i < 0 || i >= s_lineCount) return;
    if (scrollview_is_item_hilight(hWnd, hsvi)) {
        SetBrushColor(hdc, SysPixelIndex[7]);
        FillBox(hdc, rc->left, rc->top, RECTWP(rc), RECTHP(rc));
    }
    SetBkMode(hdc, BM_TRANSPARENT);
    SetTextColor(hdc, SysPixelIndex[s_lines[i].colour]);
    RECT text = *rc;
    text.left += RECTWP(rc) / 30;
    text.right -= RECTWP(rc) / 30;
    DrawText(hdc, s_lines[i].label, -1, &text, DT_LEFT | DT_VCENTER | DT_SINGLELINE);
    DrawText(hdc, s_lines[i].value, -1, &text, DT_RIGHT | DT_VCENTER | DT_SINGLELINE);
}

void fill_list(HWND list) {
    SendMessage(list, SVM_RESETCONTENT, 0, 0);
    build_lines();
    for (int i = 0; i < s_lineCount; i++) {
        SVITEMINFO info;
        info.nItem = i;
        info.nItemHeight = g_ptScreenInfo.width / 15 + 8;
        info.addData = (DWORD)i;
        SendMessage(list, SVM_ADDITEM, 0, (LPARAM)&info);
    }
    SendMessage(list, SVM_SETCURSEL, 0, 1);
}

void show_bars(HWND hWnd) {
    char title[256];
    translate("menu_ProduceInfo", "menu_ProduceInfo", title, sizeof(title));
    tp_skb_set_text_col(kColourText);
    tp_skb_set_text_items(hWnd, "", "", g_cItemBack);
    tp_skb_update(hWnd);
    tp_batteryshow_set_text_items(hWnd, "", title, "");
    tp_batteryshow_update(hWnd);
}

LRESULT info_proc(HWND hWnd, UINT message, WPARAM wParam, LPARAM lParam) {
    switch (message) {
        case MSG_CREATE: {
            RECT rc;
            GetClientRect(hWnd, &rc);
            HWND list = CreateWindowEx(CTRL_SCROLLVIEW, "", WS_VISIBLE | WS_BORDER, WS_EX_NONE,
                                       kListId, 0, 3, RECTW(rc), RECTH(rc) - 3, hWnd, 0);
            if (g_mmiLogFont[3]) SetWindowFont(list, g_mmiLogFont[3]);
            SendMessage(list, SVM_SETITEMDRAW, 0, (LPARAM)draw_line);
            fill_list(list);
            SetFocusChild(list);
            show_bars(hWnd);
            break;
        }
        case MSG_CALLBACK:
            // The test information (IMEI) has arrived.
            fill_list(GetDlgItem(hWnd, kListId));
            return 0;
        case MSG_ACTIVE:
            if (wParam) show_bars(hWnd);
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

int mmi_info_record_lines(const unsigned char *flags, mmi_info_line *lines, int max) {
    GetTestItemsResult(flags);
    char pass[MMI_INFO_LINE_SIZE], fail[MMI_INFO_LINE_SIZE];
    translate("Result_pass", "Result_pass", pass, sizeof(pass));
    translate("Result_fail", "Result_fail", fail, sizeof(fail));
    int n = 0;
    for (int i = 0; i < MMI_TESTINFO_ITEMS && n < max; i++) {
        unsigned r = g_testinfo[i].test_result;
        if (r != MMI_RESULT_PASS && r != MMI_RESULT_FAIL) continue;
        mmi_info_line &l = lines[n++];
        snprintf(l.label, sizeof(l.label), "%d %s", g_testinfo[i].index, g_testinfo[i].context);
        tp_os_strlcpy(l.value, r == MMI_RESULT_PASS ? pass : fail, sizeof(l.value));
        l.colour = r == MMI_RESULT_PASS ? kColourPass : kColourFail;
    }
    return n;
}

int mmi_TestInfoEntry(void) {
    if (s_window.load() != HWND_INVALID) return 0;
    RECT rc;
    mmi_testwnd_rect(g_ptScreenInfo.width, g_ptScreenInfo.height, &rc);
    MAINWINCREATE create;
    memset(&create, 0, sizeof(create));
    create.dwStyle = WS_CAPTION | WS_VISIBLE;
    create.dwExStyle = WS_EX_NONE;
    create.spCaption = "Product Information";
    create.hHosting = mmi_guithread_window();
    create.MainWindowProc = info_proc;
    create.lx = rc.left;
    create.ty = rc.top;
    create.rx = rc.right;
    create.by = rc.bottom;
    create.iBkColor = SysPixelIndex[kColourWindow];
    HWND hWnd = CreateMainWindow(&create);
    if (hWnd == HWND_INVALID) {
        __android_log_print(ANDROID_LOG_ERROR, INFO_TAG, "%s CreateMainWindow fail", __func__);
        return -1;
    }
    s_window = hWnd;
    // The IMEI comes through the library's callback; the screen redraws when it is in.
    mmi_testinfo_request(hWnd);
    ShowWindow(hWnd, SW_SHOWNORMAL);
    return 0;
}

HWND mmi_TestInfo_Window(void) {
    return s_window.load();
}

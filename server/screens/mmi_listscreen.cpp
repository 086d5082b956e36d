// The shared list screen.
#include "screens/mmi_listscreen.h"

#include <string.h>

#include <android/log.h>

#include "core/ftx_config.h"
#include "mmi_bars.h"
#include "mmi_guithread.h"
#include "core/mmi_settings.h"
#include "testwnd/mmi_testwnd.h"
#include "tp_os.h"
#include "mmi_theme.h"

namespace {

const int kListId = 21;

const mmi_listscreen_desc *desc_of(HWND hWnd) {
    return reinterpret_cast<const mmi_listscreen_desc *>(GetWindowAdditionalData(hWnd));
}

void show_bars(HWND hWnd, const mmi_listscreen_desc *d) {
    char title[MMI_TESTWND_TEXT_SIZE];
    tp_os_strlcpy(title, d->titleKey, sizeof(title));
    Read_LangCfgFromList(d->titleKey, title);
    tp_skb_set_text_col(MMI_COLOUR_TEXT);
    tp_skb_set_text_items(hWnd, "", "", g_cItemBack);
    tp_skb_update(hWnd);
    tp_batteryshow_set_text_items(hWnd, "", title, "");
    tp_batteryshow_update(hWnd);
}

void fill(HWND list, const mmi_listscreen_desc *d) {
    int cur = (int)SendMessage(list, SVM_GETCURSEL, 0, 0);
    SendMessage(list, SVM_RESETCONTENT, 0, 0);
    int n = d->fill();
    for (int i = 0; i < n; i++) {
        SVITEMINFO info;
        info.nItem = i;
        info.nItemHeight = d->itemHeight;
        info.addData = (DWORD)i;
        SendMessage(list, SVM_ADDITEM, 0, (LPARAM)&info);
    }
    SendMessage(list, SVM_SETCURSEL, cur > 0 && cur < n ? cur : 0, 1);
}

void on_notify(HWND list, LINT, int nc, DWORD add) {
    if (nc != SVN_ITEMCHOSEN) return;
    const mmi_listscreen_desc *d = desc_of(GetParent(list));
    if (d && d->choose) d->choose(mmi_listscreen_row((HSVITEM)add));
}

LRESULT list_proc(HWND hWnd, UINT message, WPARAM wParam, LPARAM lParam) {
    const mmi_listscreen_desc *d = desc_of(hWnd);
    if (message == MSG_CREATE) {
        d = reinterpret_cast<const mmi_listscreen_desc *>(
            reinterpret_cast<PMAINWINCREATE>(lParam)->dwAddData);
        RECT rc;
        GetClientRect(hWnd, &rc);
        // Below the 3-pixel line of the window's top edge.
        HWND list = CreateWindowEx(CTRL_SCROLLVIEW, "", WS_VISIBLE | WS_BORDER | SVS_LOOP,
                                   WS_EX_NONE, kListId, 0, 3, RECTW(rc), RECTH(rc) - 3, hWnd, 0);
        PLOGFONT font = g_mmiLogFont[d->fontIndex];
        if (font) SetWindowFont(list, font);
        SendMessage(list, SVM_SETITEMDRAW, 0, (LPARAM)d->draw);
        SetNotificationCallback(list, on_notify);
        fill(list, d);
        SetFocusChild(list);
        return DefaultMainWinProc(hWnd, message, wParam, lParam);
    }
    if (d && message == d->refreshMessage && (message != MSG_TIMER || wParam == 1)) {
        fill(GetDlgItem(hWnd, kListId), d);
        InvalidateRect(GetDlgItem(hWnd, kListId), nullptr, TRUE);
        if (GetActiveWindow() == hWnd) show_bars(hWnd, d);
        return 0;
    }
    switch (message) {
        case MSG_ACTIVE:
            if (wParam) show_bars(hWnd, d);
            break;
        case MSG_KEYDOWN:
            if (wParam == MMI_KEY_FAIL) {
                SendMessage(hWnd, MSG_CLOSE, 0, 0);
                return 0;
            }
            break;
        case MSG_PAINT: {
            HDC hdc = BeginPaint(hWnd);
            mmi_testwnd_draw_top_line(hdc);
            EndPaint(hWnd, hdc);
            return 0;
        }
        case MSG_CLOSE:
            *d->window = HWND_INVALID;
            DestroyAllControls(hWnd);
            DestroyMainWindow(hWnd);
            return 0;
        default:
            break;
    }
    return DefaultMainWinProc(hWnd, message, wParam, lParam);
}

}  // namespace

int mmi_listscreen_row(HSVITEM hsvi) {
    return (int)scrollview_get_item_adddata(hsvi);
}

void mmi_listscreen_draw_row(HWND hWnd, HSVITEM hsvi, HDC hdc, const RECT *rc, const char *label,
                             const char *value, int colour) {
    if (scrollview_is_item_hilight(hWnd, hsvi)) {
        SetBrushColor(hdc, mmi_pixel(MMI_COLOUR_GRAY));
        FillBox(hdc, rc->left, rc->top, RECTWP(rc), RECTHP(rc));
    }
    SetBkMode(hdc, BM_TRANSPARENT);
    SetTextColor(hdc, mmi_pixel(colour));
    RECT text = *rc;
    text.left += RECTWP(rc) / 20;
    text.right -= RECTWP(rc) / 20;
    DrawText(hdc, label, -1, &text, DT_LEFT | DT_VCENTER | DT_SINGLELINE);
    if (value && value[0]) DrawText(hdc, value, -1, &text, DT_RIGHT | DT_VCENTER | DT_SINGLELINE);
    SetPenColor(hdc, mmi_pixel(MMI_COLOUR_FRAME));
    MoveTo(hdc, rc->left, rc->bottom - 1);
    LineTo(hdc, rc->right, rc->bottom - 1);
}

int mmi_listscreen_open(const mmi_listscreen_desc *d) {
    HWND open = d->window->load();
    if (open != HWND_INVALID) {
        ShowWindow(open, SW_SHOWNORMAL);
        return 0;
    }
    HWND hWnd = mmi_testwnd_create(d->caption, list_proc, reinterpret_cast<DWORD>(d), d->style);
    if (hWnd == HWND_INVALID) return -1;
    *d->window = hWnd;
    ShowWindow(hWnd, SW_SHOWNORMAL);
    return 0;
}

// The factory-boot-mode note window: the bars, the factory title and the lines that tell
// how to power off, in the handset's language.
#include "hub/mmi_ffbm_note.h"

#include <cutils/properties.h>
#include <minigui/control.h>
#include <stdio.h>
#include <string.h>

#include <string>

#include "core/mmi_power.h"
#include "hub/hub_internal.h"
#include "hub/mmi_mainwnd.h"
#include "mmi_bars.h"
#include "mmi_guithread.h"
#include "mmi_theme.h"

namespace {

using hub::screen_size;
using hub::tr;

const int kNoteId = 20;

}  // namespace

LRESULT mmi_ExampleWin_MenuWndProc1(HWND hWnd, UINT message, WPARAM wParam, LPARAM lParam) {
    LRESULT result = 0;
    if (mmi_guithread_dispatch(message, wParam, lParam, &result)) return result;
    int w, h;
    screen_size(&w, &h);
    switch (message) {
        case MSG_CREATE: {
            g_hMainWnd = hWnd;
            mmi_guithread_set_window(hWnd);
            mmi_hub_layout l;
            mmi_hub_layout_for(w, h, &l);
            HWND note =
                CreateWindowEx(CTRL_STATIC, "", WS_VISIBLE | SS_CENTER | SS_NOPREFIX, WS_EX_NONE,
                               kNoteId, 0, 0, w, RECTH(l.mainWindow) / 4, hWnd, 0);
            if (note != HWND_INVALID && g_mmiLogFont[1]) SetWindowFont(note, g_mmiLogFont[1]);
            if (g_mmiLogFont[4]) SetWindowFont(hWnd, g_mmiLogFont[4]);
            svr_create_softkeybar(hWnd, &l.softKeyBar, 1);
            svr_create_batteryshow(hWnd, &l.titleStrip, 1);
            SetTimer(hWnd, MMI_TIMER_BARS, 100);
            return 0;
        }
        case MSG_TIMER: {
            if (wParam != MMI_TIMER_BARS) return 0;
            tp_skb_set_text_items(hWnd, " ", " ", " ");
            tp_skb_set_text_col(MMI_COLOUR_TEXT);
            tp_skb_update(hWnd);
            FTX_BATTERY_INFO b;
            char level[32] = "";
            if (mmi_battery_snapshot(&b) == 0 && b.batteryLevel != -1)
                snprintf(level, sizeof level, "%d%%", b.batteryLevel);
            tp_batteryshow_set_text_items(hWnd, "", "", level);
            tp_batteryshow_update(hWnd);
            if (GetDlgItem(hWnd, kNoteId + 1) == 0) {
                std::string title = tr("title_ftm");
                int fh = g_mmiLogFont[2] ? g_mmiLogFont[2]->size : w / 15;
                HWND t =
                    CreateWindowEx(CTRL_STATIC, title.c_str(), WS_VISIBLE | SS_CENTER | SS_NOPREFIX,
                                   WS_EX_NONE, kNoteId + 1, 0, 150, w, fh + 1, hWnd, 0);
                if (t != HWND_INVALID && g_mmiLogFont[2]) SetWindowFont(t, g_mmiLogFont[2]);
            }
            return 0;
        }
        case MSG_PAINT: {
            char locale[PROPERTY_VALUE_MAX] = {0};
            property_get("ro.product.locale", locale, "en-US");
            static const char *const kChinese[] = {"info_FTMPowerOffNote1", "info_FTMPowerOffNote3",
                                                   "info_FTMPowerOffNote5"};
            static const char *const kEnglish[] = {"info_FTMPowerOffNote", "info_FTMPowerOffNote2",
                                                   "info_FTMPowerOffNote4"};
            bool chinese = strncmp(locale, "zh-CN", 5) == 0;
            LOGD(chinese ? "sys_language is chinese\n" : "sys_language is english\n");
            const char *const *keys = chinese ? kChinese : kEnglish;
            HDC hdc = BeginPaint(hWnd);
            if (g_mmiLogFont[4]) SelectFont(hdc, g_mmiLogFont[4]);
            SetBkMode(hdc, BM_TRANSPARENT);
            SetTextColor(hdc, mmi_pixel(MMI_COLOUR_TEXT));
            int fh = GetFontHeight(hdc);
            // Positions are screen rows; the client area starts below the title strip.
            int top = w / 15 + h / 4 + 10 - (w / 15 + 10);
            for (int i = 0; i < 3; i++) {
                std::string line = tr(keys[i]);
                RECT rc = {w / 60, top + i * fh, w / 60 + (w / 4) * 30 + w / 60,
                           top + (i + 1) * fh};
                rc.right = w - w / 60;
                DrawText(hdc, line.c_str(), -1, &rc, DT_LEFT | DT_SINGLELINE | DT_NOPREFIX);
            }
            EndPaint(hWnd, hdc);
            return 0;
        }
        case MSG_CLOSE:
            return hub::close_hub(hWnd);
        default:
            return DefaultMainWinProc(hWnd, message, wParam, lParam);
    }
}

// The board-code screen.
#include "screens/mmi_qrscreen.h"

#include <atomic>

#include <android/log.h>

#include "core/mmi_power.h"
#include "core/mmi_settings.h"
#include "mmi_bars.h"
#include "mmi_theme.h"
#include "testwnd/mmi_key_table.h"
#include "testwnd/mmi_testwnd.h"
#include "wifi/mmi_qrcode.h"

#define QS_TAG "FTX_BARCODE"
#define QS_DEBUG(...) __android_log_print(ANDROID_LOG_DEBUG, QS_TAG, __VA_ARGS__)
#define QS_ERROR(...) __android_log_print(ANDROID_LOG_ERROR, QS_TAG, __VA_ARGS__)

namespace {

const char kCaption[] = "Board Code";
const char kTitleKey[] = "title_barcode_qrcode";
// The 3-pixel line along the window's top edge.
const int kTopLine = 3;

std::atomic<HWND> s_window{HWND_INVALID};

void draw_code(HWND hWnd, HDC hdc) {
    BITMAP bmp{};
    if (LoadBitmap(hdc, &bmp, MMI_QR_BOARD_BMP) != 0) {
        QS_ERROR("%s: cannot load %s", __func__, MMI_QR_BOARD_BMP);
        return;
    }
    RECT client, box;
    GetClientRect(hWnd, &client);
    mmi_qrscreen_layout(RECTW(client), RECTH(client), kTopLine, static_cast<int>(bmp.bmWidth),
                        &box);
    FillBoxWithBitmap(hdc, box.left, box.top, RECTW(box), RECTH(box), &bmp);
    UnloadBitmap(&bmp);
}

void show_bars(HWND hWnd) {
    char title[MMI_TESTWND_TEXT_SIZE];
    mmi_translate(kTitleKey, title, sizeof title);
    tp_skb_set_text_col(MMI_COLOUR_TEXT);
    tp_skb_set_text_items(hWnd, "", "", g_cItemBack);
    tp_batteryshow_set_text_items(hWnd, "", title, "");
    tp_skb_update(hWnd);
    tp_batteryshow_update(hWnd);
}

bool is_back(WPARAM key) {
    return key == MMI_KEY_FAIL || key == Get_Keytest_item_key_value("BACK");
}

}  // namespace

void mmi_qrscreen_layout(int w, int h, int top, int side, RECT *out) {
    const int roomH = h - top;
    const int room = w < roomH ? w : roomH;
    int scale = side > 0 ? room * 4 / 5 / side : 1;
    if (scale < 1) scale = 1;
    const int s = side * scale;
    out->left = (w - s) / 2;
    out->top = top + (roomH - s) / 2;
    out->right = out->left + s;
    out->bottom = out->top + s;
}

LRESULT mmi_ExampleWin_QRCodeWndProc(HWND hWnd, UINT message, WPARAM wParam, LPARAM lParam) {
    switch (message) {
        case MSG_CREATE:
            QS_DEBUG("mmi_ExampleWin_QRCodeWndProc() MSG_CREATE.\n");
            mmi_testwnd_create_title(hWnd, kTitleKey);
            // A scanner may take its time: the screen stays on while the code shows.
            Set_OsCanIdleAllowed(0);
            break;
        case MSG_ACTIVE:
            if (wParam) {
                show_bars(hWnd);
                HDC hdc = GetClientDC(hWnd);
                draw_code(hWnd, hdc);
                ReleaseDC(hdc);
            }
            break;
        case MSG_PAINT: {
            HDC hdc = BeginPaint(hWnd);
            mmi_testwnd_draw_top_line(hdc);
            draw_code(hWnd, hdc);
            EndPaint(hWnd, hdc);
            return 0;
        }
        case MSG_KEYDOWN:
            QS_DEBUG("%s message= MSG_KEYDOWN", __func__);
            if (is_back(wParam)) {
                SendMessage(hWnd, MSG_CLOSE, 0, 0);
                return 0;
            }
            break;
        case MSG_CLOSE:
            Set_OsCanIdleAllowed(1);
            s_window = HWND_INVALID;
            DestroyAllControls(hWnd);
            DestroyMainWindow(hWnd);
            return 0;
        default:
            break;
    }
    return DefaultMainWinProc(hWnd, message, wParam, lParam);
}

int mmi_teswnd_QRCode(void) {
    QS_DEBUG("mmi_teswnd_QRCode() begin.\n");
    create_barcode_qrcode();
    HWND open = s_window.load();
    if (open == HWND_INVALID) {
        open = mmi_testwnd_create(kCaption, mmi_ExampleWin_QRCodeWndProc, 0);
        if (open == HWND_INVALID) return -1;
        s_window = open;
    } else {
        InvalidateRect(open, nullptr, TRUE);  // the picture was made again
    }
    ShowWindow(open, SW_SHOWNORMAL);
    QS_DEBUG("mmi_teswnd_QRCode() end.\n");
    return 0;
}

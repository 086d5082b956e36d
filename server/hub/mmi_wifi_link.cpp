// The hub's Wi-Fi link: the link picture in the middle of the menu, the soft-key middle label
// that follows the link state (connect, connecting, disconnect) and the link key.
#include "hub/mmi_wifi_link.h"

#include <errno.h>

#include <string>

#include "hub/hub_internal.h"
#include "hub/mmi_mainwnd.h"
#include "mmi_bars.h"
#include "mmi_theme.h"
#include "wifi/mmi_wifi.h"

std::atomic<int> g_bWiFiConnectStatus{0};

namespace {

using hub::screen_size;
using hub::tr;

const char *const kLinkPicture = "/data/mmi_ip.bmp";

std::atomic<int> s_wifiConnecting{0};

void draw_link_picture(HWND hWnd, bool up) {
    int w, h;
    screen_size(&w, &h);
    mmi_hub_layout l;
    mmi_hub_layout_for(w, h, &l);
    HDC hdc = GetClientDC(hWnd);
    // The square is placed on the screen; the client starts below the title strip.
    int dy = -l.mainWindow.top;
    SetBrushColor(hdc, mmi_pixel(up ? MMI_COLOUR_WHITE : MMI_COLOUR_WINDOW));
    FillBox(hdc, l.linkSquare.left, l.linkSquare.top + dy, RECTW(l.linkSquare),
            RECTH(l.linkSquare));
    if (up) {
        BITMAP bmp{};
        // The GUI library takes device paths, as on the handset.
        if (LoadBitmap(hdc, &bmp, kLinkPicture) == 0) {
            int s = l.linkSide;
            FillBoxWithBitmap(hdc, w / 2 - s / 2, h / 2 - s + dy, s, s, &bmp);
            UnloadBitmap(&bmp);
        }
    }
    ReleaseDC(hdc);
}

void show_middle(HWND hWnd, const char *key, int colour) {
    std::string text = tr(key);
    tp_skb_set_text_items(hWnd, " ", text.c_str(), " ");
    tp_skb_set_text_col(colour);
    tp_skb_update(hWnd);
}

void probe_log(int which, const char *sendFail, const char *none, const char *exists) {
    int r = mmi_wifi_probe_thread(which);
    LOGD("%s", r == EINVAL ? sendFail : r == ESRCH ? none : exists);
}

}  // namespace

namespace hub {

void refresh_link_label(HWND hWnd) {
    int state = mmi_wifi_link_state();
    const char *middleKey = nullptr;
    int middleColour = MMI_COLOUR_FAIL;
    if (state == 1 || (state == 0 && mmi_wifi_init_flag())) {
        middleKey = "softkeybar_connect";
    } else if (state == 2) {
        middleKey = "softkeybar_disconnect";
        middleColour = MMI_COLOUR_GRAY;
    }
    std::string middle = middleKey ? tr(middleKey) : " ";
    tp_skb_set_text_items(hWnd, " ", middle.c_str(), " ");
    tp_skb_set_text_col(middleColour);
    tp_skb_update(hWnd);
}

void link_tick(HWND hWnd) {
    if (!mmi_wifi_picture_enabled()) return;
    int state = mmi_wifi_link_state();
    if (state == 2) {
        draw_link_picture(hWnd, true);
        if (!unlocked()) {
            unlock_count_reset();
            g_bWiFiConnectStatus = 1;
        }
    } else if (state == 1) {
        draw_link_picture(hWnd, false);
        s_wifiConnecting = 0;
        g_bWiFiConnectStatus = 0;
    }
}

void on_link_key(HWND hWnd) {
    g_bWiFiConnectStatus = 1;
    unlock_count_reset();
    if (mmi_wifi_link_state() < 2) {
        if (s_wifiConnecting) return;
        show_middle(hWnd, "softkeybar_connecting", MMI_COLOUR_BLUE);
        int r = mmi_wifi_probe_thread(MMI_WIFI_CON_THREAD);
        if (r == EINVAL) {
            LOGD("Send siganl fail.");
        } else if (r == ESRCH) {
            LOGD("WiFiConThread is not exist.");
        } else {
            LOGD("WiFiConThread exists. kill it first.");
            wifi_close_thread(0);
        }
        WiFiConThreadStart();
        probe_log(MMI_WIFI_UDP_THREAD, "Info_M_PV:UDP connect Send siganl fail.",
                  "Info_M_PV:UDP connect is not exist.", "Info_M_PV:UDP connect . kill it first.");
        s_wifiConnecting = 1;
    }
    if (mmi_wifi_link_state() == 2) {
        show_middle(hWnd, "softkeybar_disconnect", MMI_COLOUR_BLUE);
        wifi_close_thread(0);
        s_wifiConnecting = 0;
    }
}

void on_link_change(HWND hWnd) {
    LOGD("%s MSG_CALLBACK  begin.", "mmi_ExampleWin_MenuWndProc");
    if (mmi_wifi_link_state() == 2) {
        int r = mmi_wifi_probe_thread(MMI_WIFI_MONITOR_THREAD);
        if (r == ESRCH) {
            LOGD("wifi_status_monitor_thread_start not exist.");
            wifi_status_monitor_thread_start();
        } else if (r == EINVAL) {
            LOGD("Send siganl fail.");
        } else {
            LOGD("wifi_status_monitor_thread_start exists.do nothing.");
        }
        draw_link_picture(hWnd, true);
        show_middle(hWnd, "softkeybar_disconnect", MMI_COLOUR_GRAY);
        g_bWiFiConnectStatus = 1;
        unlock_count_reset();
    } else {
        s_wifiConnecting = 0;
        draw_link_picture(hWnd, false);
        show_middle(hWnd, "softkeybar_connect", MMI_COLOUR_FAIL);
        g_bWiFiConnectStatus = 0;
    }
}

}  // namespace hub

// The hub window, its procedure and message loop, its layout, and the two ways of starting
// it: with the main menu, or with the factory-boot-mode note.
#include "hub/mmi_mainwnd.h"

#include <devfs.h>
#include <stdio.h>
#include <string.h>
#include <tp_os.h>
#include <unistd.h>

#include "core/ftx_config.h"
#include "core/ftx_lib_binding.h"
#include "core/mmi_power.h"
#include "core/mmi_settings.h"
#include "adbd_connection/AtThread.h"
#include "hub/hub_internal.h"
#include "hub/mmi_ffbm_note.h"
#include "hub/mmi_hub_keys.h"
#include "mmi_bars.h"
#include "mmi_guithread.h"
#include "mmi_theme.h"
#include "AgingTest/mmi_aging.h"
#include "session/mmi_autotest.h"
#include "session/mmi_testitem.h"

std::atomic<HWND> g_hMainWnd{HWND_INVALID};

namespace hub {

std::string tr(const char *key) {
    char text[FTX_CFG_TEXT_SIZE];
    tp_os_strlcpy(text, key, sizeof text);
    Read_LangCfgFromList(key, text);
    return text;
}

void screen_size(int *w, int *h) {
    *w = g_ptScreenInfo.width;
    *h = g_ptScreenInfo.height;
}

void refresh_bars(HWND hWnd) {
    refresh_link_label(hWnd);
    refresh_title(hWnd, true);
}

LRESULT close_hub(HWND hWnd) {
    g_hMainWnd = HWND_INVALID;
    mmi_guithread_set_window(HWND_INVALID);
    svr_destroy_softkeybar();
    DestroyAllControls(hWnd);
    DestroyMainWindow(hWnd);
    PostQuitMessage(hWnd);
    return 0;
}

}  // namespace hub

namespace {

using hub::screen_size;

void on_timer(HWND hWnd) {
    // The bars show the texts of the window in front; only refresh while that is the menu.
    if (GetActiveWindow() != hWnd) {
        hub::refresh_title(hWnd, false);
        return;
    }
    hub::refresh_bars(hWnd);
    hub::link_tick(hWnd);
}

void restore_autotest() {
    if (!g_bRestoreAutotest) return;
    if (dev_access(AUTOTEST_LATEST_PASS_FILE, F_OK) != 0) {
        mmi_autotest_write_latest_pass("FIRST");
        return;
    }
    Get_TestItem_Config(1);
    FILE *fp = dev_fopen(AUTOTEST_LATEST_PASS_FILE, "r");
    if (!fp) {
        LOGD("%s open %s fail.", "mmi_Restore_Autotest", AUTOTEST_LATEST_PASS_FILE);
        return;
    }
    char domain[65] = {0};
    size_t len = fread(domain, 1, 64, fp);
    fclose(fp);
    LOGD("%s fread chdomain %s len=%d", "mmi_Restore_Autotest", domain, (int)len);
    dev_system("touch /data/pv_autotest_restore_flag");
    dev_system("rm /data/pv_autotest_latest_pass");
    if (strcmp(domain, "FIRST") == 0) {
        dev_system("rm /data/pv_autotest_restore_flag");
        mmi_AutoTestEntry();
    } else {
        mmi_startNextItemTest(domain);
    }
}

int run_loop(HWND hWnd) {
    MSG msg;
    while (GetMessage(&msg, hWnd)) {
        TranslateMessage(&msg);
        DispatchMessage(&msg);
    }
    MainWindowThreadCleanup(hWnd);
    return 0;
}

HWND create_hub_window(WNDPROC proc) {
    int w, h;
    screen_size(&w, &h);
    mmi_hub_layout l;
    mmi_hub_layout_for(w, h, &l);
    MAINWINCREATE create{};
    create.dwStyle = WS_CAPTION | WS_VISIBLE | WS_BORDER;
    create.spCaption = "";
    create.hHosting = HWND_DESKTOP;
    create.MainWindowProc = proc;
    create.lx = l.mainWindow.left;
    create.ty = l.mainWindow.top;
    create.rx = l.mainWindow.right;
    create.by = l.mainWindow.bottom;
    create.iBkColor = mmi_pixel(MMI_COLOUR_WINDOW);
    return CreateMainWindow(&create);
}

// One way of starting the hub: its procedure and what it adds to the common start.
struct HubStart {
    const char *who;  // named when the window cannot be made
    WNDPROC proc;
    MSGHOOK mouseHook = nullptr;            // none: the mouse hook is left as it is
    void (*shown)(void) = nullptr;          // after the window is shown
    int (*ready)(HWND hMainWnd) = nullptr;  // after the input engine is up, before the loop
};

int start_hub(const HubStart &s) {
    mmi_testwnd_InitLogFont();
    HWND hWnd = create_hub_window(s.proc);
    if (hWnd == HWND_INVALID) {
        LOGE("%s create main window fail", s.who);
        return -1;
    }
    RegisterKeyMsgHook(nullptr, hookKeyProc);
    if (s.mouseHook) RegisterMouseMsgHook(nullptr, s.mouseHook);
    ShowWindow(hWnd, SW_SHOWNORMAL);
    if (s.shown) s.shown();
    int rc = InitGUIIAL();
    if (rc != 0) return rc;
    if (s.ready) s.ready(hWnd);
    return run_loop(hWnd);
}

// The menu's services once it is shown: the battery observers, an aging run to resume and
// an automatic test run to restore.
void start_menu_services() {
    if (hw::FTX_API_BatteryService_register_Observer) {
        hw::FTX_API_BatteryService_register_Observer(FTX_BATTERY_OBSERVER_TEMPERATURE,
                                                     batteryTemperatureobserver_cb);
        hw::FTX_API_BatteryService_register_Observer(FTX_BATTERY_OBSERVER_VOLTAGE,
                                                     batteryVoltobserver_cb);
    }
    if (Check_AgingCfg_Exist()) {
        LOGD("%s aging marker found: the aging test resumes", "kmt_CreateMainMenuWnd");
        g_deviceIsAgingTest = 1;
        tp_os_thread_create("AGING_RESUME", 0, 0, mmi_AgingTest_Wnd_Thread, nullptr);
    }
    restore_autotest();
}

}  // namespace

void mmi_hub_layout_for(int w, int h, mmi_hub_layout *out) {
    int titleH = w / 15 + 10;
    int barH = h / 15 + 10;
    SetRect(&out->mainWindow, 0, titleH, w, h - barH);
    SetRect(&out->softKeyBar, 0, h - barH, w, h);
    SetRect(&out->titleStrip, 0, 0, w, titleH);
    out->itemHeight = (w / 15) * 2;
    out->listHeight = (int)((w / 15) * 2 * 5.5);
    int dw = 7 * (w / 8);
    int dh = h / 3;
    SetRect(&out->dialog, (w - dw) / 2, (h - dh) / 2, (w - dw) / 2 + dw, (h - dh) / 2 + dh);
    out->linkSide = w <= 720 ? 87 : 174;
    int s = out->linkSide;
    SetRect(&out->linkSquare, w / 2 - s, h / 2 - s, w / 2 + s, h / 2 + s);
}

LRESULT mmi_ExampleWin_MenuWndProc(HWND hWnd, UINT message, WPARAM wParam, LPARAM lParam) {
    LRESULT result = 0;
    if (mmi_guithread_dispatch(message, wParam, lParam, &result)) return result;
    switch (message) {
        case MSG_CREATE:
            g_hMainWnd = hWnd;
            mmi_guithread_set_window(hWnd);
            hub::create_menu(hWnd);
            return 0;
        case MSG_TIMER:
            if (wParam == MMI_TIMER_BARS) on_timer(hWnd);
            return 0;
        case MSG_KEYDOWN:
            if (wParam == SCANCODE_F4) {
                hub::on_link_key(hWnd);
                return 0;
            }
            break;
        case MSG_CALLBACK:
            hub::on_link_change(hWnd);
            tp_skb_update(hWnd);
            return 0;
        case MSG_PAINT: {
            HDC hdc = BeginPaint(hWnd);
            SetPenColor(hdc, mmi_pixel(MMI_COLOUR_PASS));
            SetPenWidth(hdc, 3);
            MoveTo(hdc, 0, 0);
            LineTo(hdc, g_ptScreenInfo.width, 0);
            EndPaint(hWnd, hdc);
            return 0;
        }
        case MSG_CREATEDIALG:
            hub::create_dialog(hWnd, wParam, (int)lParam);
            return 0;
        case MSG_DIALOGBTN:
            hub::dialog_button(hWnd, (int)wParam);
            return 0;
        case MSG_CLOSE:
            return hub::close_hub(hWnd);
        default:
            break;
    }
    return DefaultMainWinProc(hWnd, message, wParam, lParam);
}

int kmt_CreateMainMenuWnd(void) {
    hub::read_menu_config();
    // The relink runs only when /cache/Tcp_Restart.ini is readable.
    return start_hub({.who = "kmt_CreateMainMenuWnd",
                      .proc = mmi_ExampleWin_MenuWndProc,
                      .mouseHook = hub::input_mouse_hook,
                      .shown = start_menu_services,
                      .ready = mmi_start_tcp_relink});
}

int kmt_CreateMainMenuWnd1(void) {
    return start_hub({.who = "kmt_CreateMainMenuWnd1", .proc = mmi_ExampleWin_MenuWndProc1});
}

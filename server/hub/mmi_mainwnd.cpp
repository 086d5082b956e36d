// The hub window and its procedure, the key hook with the power and link keys, the
// dialogs of the other parts and the title strip's shared setter.
#include "hub/mmi_mainwnd.h"

#include <android/log.h>
#include <cutils/properties.h>
#include <devfs.h>
#include <errno.h>
#include <minigui/control.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <sys/time.h>
#include <tp_os.h>
#include <unistd.h>

#include <mutex>
#include <semaphore>
#include <string>

#include "core/ftx_config.h"
#include "core/ftx_lib_binding.h"
#include "session/mmi_autotest.h"
#include "mmi_bars.h"
#include "mmi_dialog.h"
#include "mmi_guithread.h"
#include "adbd_connection/AtThread.h"
#include "mmi_menulist.h"
#include "core/mmi_power.h"
#include "core/mmi_settings.h"
#include "pending/aging.h"
#include "pending/coupling.h"
#include "pending/wifi.h"
#include "screens/mmi_devicetest.h"
#include "screens/mmi_infoscreen.h"
#include "session/mmi_monomer.h"
#include "session/mmi_testitem.h"
#include "mmi_theme.h"

// Registered for "TPHARDWARE" when the touch-panel alert is confirmed in state 3.
void Get_tpstatus_callback(module_data *data);

#define TAG "FTX_MAIN"
#define LOGD(...) __android_log_print(ANDROID_LOG_DEBUG, TAG, __VA_ARGS__)
#define LOGE(...) __android_log_print(ANDROID_LOG_ERROR, TAG, __VA_ARGS__)

mmi_menu_row g_mainMenu[MMI_MENU_MAX_ROWS] = {
    {0, "menu_ProduceInfo", mmi_TestInfoEntry},
    {1, "menu_DeviceTest", mmi_DeviceTestEntry},
    {2, "menu_TPPreviewTest", mmi_testwnd_MonomerPreview_Entry},
    {3, "", nullptr},
    {4, "", nullptr},
};
int g_mainMenuCount = 0;

std::atomic<HWND> g_hMainWnd{HWND_INVALID};
int g_bCoupleTest = 0;
int g_bAgingTest = 1;
std::atomic<int> g_deviceIsAgingTest{0};
std::atomic<int> g_dialogcouldshow{1};
std::atomic<int> g_iCreateDialog{0};
std::atomic<int> g_bWiFiConnectStatus{0};

namespace {

const int kListId = 21;
const int kNoteId = 20;
const char *const kLinkPicture = "/data/mmi_ip.bmp";

// Dialog state (GUI thread).
HDIALOG s_dialog = HDIALOG_INVALID;
int s_dialogKind = 0;
int s_savedIdle = 1;
bool s_tpAlertShown = false;

// Wi-Fi key state.
std::atomic<int> s_wifiConnecting{0};
std::atomic<int> s_unlockFlag{0};
std::atomic<int> s_unlockCount{0};  // counted on the input thread, reset by the GUI thread
std::atomic<long long> s_unlockFirstMs{0};

// Power key (input thread and its long-press thread).
std::atomic<long long> s_powerDownMs{0};
std::atomic<int> s_shortPress{0};
std::binary_semaphore s_dialogSem{1};  // held from a long press until a dialog button
std::atomic<bool> s_dialogSemHeld{false};

// Title strip: one mutex for every writer; a warning set at index 1 stays over the
// periodic refresh until it is taken back.
std::mutex s_titleMutex;
std::string s_titleWarning;  // under s_titleMutex

long long now_ms() {
    struct timeval tv;
    gettimeofday(&tv, nullptr);
    return tv.tv_sec * 1000LL + tv.tv_usec / 1000;
}

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

// ---- dialogs ----

struct DialogKind {
    int kind;
    const char *title;
    const char *text;
    const char *buttons[2];
    int count;
    int (*action)(int button);
};

int power_off_action(int button) {
    return button == 0 ? mmi_PowerOffEntry() : 0;
}
int fail_and_quit_action(int button) {
    if (button == 0) {
        HWND active = GetActiveWindow();
        if (active && active != HWND_INVALID) SendNotifyMessage(active, MSG_FAILANDQUIT, 0, 0);
    }
    return 0;
}
int aging_action(int button) {
    return button == 0 ? mmi_AgingTest_Start_Entry() : 0;
}
int autotest_action(int button) {
    return button == 1 ? mmi_AutoTestEntry() : 0;
}
int autotest_ex_action(int button) {
    return button == 1 ? mmi_AutoTestEntry_Ex() : 0;
}
int autotest_ex2_action(int button) {
    return button == 1 ? mmi_AutoTestEntry_Ex2() : 0;
}

const DialogKind kDialogs[] = {
    {1, "title_PowerOff", "info_PowerOffNote", {"info_Yes", "info_No"}, 2, power_off_action},
    {2, "title_BatteryCheck", nullptr, {"info_Yes", nullptr}, 1, nullptr},
    {3, "info_Quit", "info_FailAndQuit", {"info_Yes", "info_No"}, 2, fail_and_quit_action},
    {5, "TP ERROR", nullptr, {"info_Yes", nullptr}, 1, nullptr},
    {6, "title_AgingTest", "menu_StartTest", {"info_Yes", "info_No"}, 2, aging_action},
    {7, "menu_AutoTest", "info_continuetest", {"info_No", nullptr}, 1, autotest_action},
    {8, "menu_AutoTest_EX", "info_continuetest", {"info_No", nullptr}, 1, autotest_ex_action},
    {9, "menu_AutoTest_EX2", "info_continuetest", {"info_No", nullptr}, 1, autotest_ex2_action},
};

const DialogKind *dialog_kind(int kind) {
    for (const DialogKind &k : kDialogs)
        if (k.kind == kind) return &k;
    return nullptr;
}

int tp_state(void);

std::string tp_text() {
    switch (tp_state()) {
        case 3:
            return tr("title_TPFState");
        case 1:
            return tr("title_TPUState");
        case 0:
            return tr("title_TPOState");
        default:
            return tr("title_factory");
    }
}

bool dialog_open() {
    return s_dialog != HDIALOG_INVALID && s_dialog != nullptr;
}

void create_dialog(HWND hWnd, WPARAM wParam, int kind) {
    s_savedIdle = g_bOsIsCanIdle;
    SetIdleWakeupStatus(0);
    Set_OsCanIdleAllowed(0);
    LOGD("1203 mmiExmMainWnd MSG_CREATEDIALG");
    const DialogKind *k = dialog_kind(kind);
    if (kind == 5 && s_tpAlertShown) k = nullptr;
    if (!k || dialog_open()) {
        // Nothing new: the dialog that is up (if any) comes to the front again.
        if (dialog_open() && s_dialog->window != HWND_INVALID)
            ShowWindow(s_dialog->window, SW_SHOWNORMAL);
        Set_OsCanIdleAllowed(s_savedIdle);
        return;
    }
    if (kind == 2) LOGD("create power alert dialog");
    if (kind == 5) LOGD("create tpstatusuptate alert dialog");
    std::string title = tr(k->title);
    std::string text;
    if (kind == 2)
        text = wParam ? reinterpret_cast<const char *>(wParam) : "";
    else if (kind == 5)
        text = tp_text();
    else
        text = tr(k->text);
    std::string labels[2];
    const char *labelPtrs[2] = {nullptr, nullptr};
    for (int i = 0; i < k->count; i++) {
        labels[i] = tr(k->buttons[i]);
        labelPtrs[i] = labels[i].c_str();
    }
    mmi_hub_layout l;
    int w, h;
    screen_size(&w, &h);
    mmi_hub_layout_for(w, h, &l);
    s_dialogKind = kind;
    s_dialog =
        CreateDialog(title.c_str(), text.c_str(), l.dialog.left, l.dialog.top, RECTW(l.dialog),
                     RECTH(l.dialog), hWnd, hWnd, 0, labelPtrs, k->count, 0);
    if (!dialog_open()) return;
    DoModal(s_dialog);
    g_dialogcouldshow = 0;
    g_iCreateDialog = 1;
}

void release_dialog_sem() {
    if (s_dialogSemHeld.exchange(false)) s_dialogSem.release();
}

void dialog_button(HWND hWnd, int button) {
    if (dialog_open()) {
        DestroyDialog(s_dialog);
        s_dialog = HDIALOG_INVALID;
        release_dialog_sem();
        Set_OsCanIdleAllowed(s_savedIdle);
        g_dialogcouldshow = 1;
        g_iCreateDialog = 0;
    }
    if (s_dialogKind == 5) {
        if (tp_state() != 3) {
            s_tpAlertShown = true;
            if (hw::ftx_api_GetModuleStatus) hw::ftx_api_GetModuleStatus("TPHARDWARE");
        } else {
            if (hw::ftx_api_RegisterModuleCallback)
                hw::ftx_api_RegisterModuleCallback("TPHARDWARE", Get_tpstatus_callback);
            SendNotifyMessage(hWnd, MSG_CREATEDIALG, 0, 5);
            if (hw::ftx_api_GetModuleStatus) hw::ftx_api_GetModuleStatus("TPHARDWARE");
        }
        return;
    }
    const DialogKind *k = dialog_kind(s_dialogKind);
    if (k && k->action) k->action(button);
}

// ---- bars ----

// The menu's title strip texts: charger, title (or the warning in force) and level. Drawn
// only while the menu is in front; otherwise only its record is kept current, which a
// battery warning shows over other windows.
void refresh_title(HWND hWnd, bool draw) {
    FTX_BATTERY_INFO b;
    bool known = mmi_battery_snapshot(&b) == 0 && b.batteryLevel != -1;
    char level[32] = "";
    if (known) snprintf(level, sizeof level, "%d%%", b.batteryLevel);
    int colour =
        known && b.batteryLevel <= g_batteryWarningVolt ? MMI_COLOUR_FAIL : MMI_COLOUR_TEXT;
    std::string charging = tr(known && mmi_battery_is_charging(&b) ? "BatteryCharging_Charging"
                                                                   : "BatteryCharging_Null");
    std::lock_guard<std::mutex> lk(s_titleMutex);
    std::string title = s_titleWarning.empty() ? tr("title_factory") : s_titleWarning;
    if (!s_titleWarning.empty()) colour = 12;
    tp_batteryshow_set_text_items(hWnd, charging.c_str(), title.c_str(), level);
    if (!draw) return;
    tp_batteryshow_set_text_col(colour);
    tp_batteryshow_update(hWnd);
}

void refresh_bars(HWND hWnd) {
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
    refresh_title(hWnd, true);
}

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
        char path[512];
        BITMAP bmp{};
        if (dev_path(kLinkPicture, path, sizeof path) == 0 && LoadBitmap(hdc, &bmp, path) == 0) {
            int s = l.linkSide;
            FillBoxWithBitmap(hdc, w / 2 - s / 2, h / 2 - s + dy, s, s, &bmp);
            UnloadBitmap(&bmp);
        }
    }
    ReleaseDC(hdc);
}

void on_timer(HWND hWnd) {
    // The bars show the texts of the window in front; only refresh while that is the menu.
    if (GetActiveWindow() != hWnd) {
        refresh_title(hWnd, false);
        return;
    }
    refresh_bars(hWnd);
    if (!mmi_wifi_picture_enabled()) return;
    int state = mmi_wifi_link_state();
    if (state == 2) {
        draw_link_picture(hWnd, true);
        if (!s_unlockFlag) {
            s_unlockCount = 0;
            g_bWiFiConnectStatus = 1;
        }
    } else if (state == 1) {
        draw_link_picture(hWnd, false);
        s_wifiConnecting = 0;
        g_bWiFiConnectStatus = 0;
    }
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

void on_link_key(HWND hWnd) {
    g_bWiFiConnectStatus = 1;
    s_unlockCount = 0;
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
        s_unlockCount = 0;
    } else {
        s_wifiConnecting = 0;
        draw_link_picture(hWnd, false);
        show_middle(hWnd, "softkeybar_connect", MMI_COLOUR_FAIL);
        g_bWiFiConnectStatus = 0;
    }
}

// ---- menu ----

void add_row(HWND list, mmi_menu_row *row, int itemHeight) {
    Read_LangCfgFromList(row->label, row->label);
    SVITEMINFO info{};
    info.nItem = row->index;
    info.nItemHeight = itemHeight;
    info.addData = (DWORD)row->label;
    SendMessage(list, SVM_ADDITEM, 0, (LPARAM)&info);
    g_mainMenuCount++;
}

void append_row(HWND list, int *count, const char *key, int (*entry)(void), int itemHeight) {
    // The table holds five rows; a sixth is refused here instead of overrunning it.
    if (*count >= MMI_MENU_MAX_ROWS) {
        (*count)++;
        return;
    }
    mmi_menu_row *row = &g_mainMenu[*count];
    tp_os_strlcpy(row->label, key, sizeof row->label);
    row->index = *count;
    row->entry = entry;
    add_row(list, row, itemHeight);
    (*count)++;
}

void create_menu(HWND hWnd) {
    int w, h;
    screen_size(&w, &h);
    mmi_hub_layout l;
    mmi_hub_layout_for(w, h, &l);
    MMI_WiFi_GetConfigParas();
    LOGD("main_wifi_init_flag = %d", mmi_wifi_init_flag());
    LOGD("g_ptScreenInfo.width= %d", w);
    LOGD("g_ptScreenInfo.height = %d", h);
    HWND list = CreateWindowEx(CTRL_SCROLLVIEW, "", WS_CHILD | WS_VISIBLE | WS_BORDER | SVS_LOOP,
                               WS_EX_NONE, kListId, 0, 0, w, l.listHeight, hWnd, 0);
    if (list == HWND_INVALID) {
        LOGE("%s create list fail", "mmi_ExampleWin_MenuWndProc");
        return;
    }
    if (g_mmiLogFont[2]) SetWindowFont(list, g_mmiLogFont[2]);
    SetWindowBkColor(list, mmi_pixel(MMI_COLOUR_WINDOW));
    SendMessage(list, SVM_SETITEMDRAW, 0, (LPARAM)mmi_SVDrawItem);
    g_mainMenuCount = 0;
    int count = 0;
    while (count < MMI_MENU_MAX_ROWS && g_mainMenu[count].entry) {
        add_row(list, &g_mainMenu[count], l.itemHeight);
        count++;
    }
    if (g_bCoupleTest)
        append_row(list, &count, "menu_CoupleTest", mmi_testwnd_Coupling_Entry, l.itemHeight);
    if (g_bAgingTest) append_row(list, &count, "title_AgingTest", mmi_AgingTestEntry, l.itemHeight);
    if (count < 6) {
        SendMessage(list, SVM_SETCURSEL, 0, 1);
        SetNotificationCallback(list, ScrollViewProc);
        SetFocusChild(list);
        svr_create_softkeybar(hWnd, &l.softKeyBar, 1);
        svr_create_batteryshow(hWnd, &l.titleStrip, 1);
        SetTimer(hWnd, MMI_TIMER_BARS, 100);
        refresh_bars(hWnd);
    } else {
        LOGD("item num:%d,max:%d.", count, MMI_MENU_MAX_ROWS);
    }
}

// ---- power key ----

void *long_press_thread(void *) {
    long long start = s_powerDownMs;
    while (!s_shortPress) {
        if (now_ms() - start >= MMI_POWERKEY_LONG_MS) break;
        usleep(100);
    }
    if (s_shortPress) return nullptr;
    if (g_dialogcouldshow == 0) {
        LOGD("%s,L%d:: tempval=%d,g_dialogcouldshow=%d,thead_exit.", "hookKeyProc", __LINE__,
             (int)(now_ms() - start), g_dialogcouldshow.load());
        s_shortPress = 1;
        return nullptr;
    }
    if (g_bCurrentSleepStatus == 1) SetIdleWakeupStatus(0);
    s_dialogSem.acquire();
    s_dialogSemHeld = true;
    HWND hub = g_hMainWnd;
    if (hub != HWND_INVALID) SendMessage(hub, MSG_CREATEDIALG, 0, 1);
    s_shortPress = 1;
    return nullptr;
}

// Counts the unlock gesture; true when the key is to be swallowed.
bool key_lock(HWND dst, UINT msg, WPARAM key) {
    if (g_bWiFiConnectStatus != 1 || dst != g_hMainWnd) return false;
    bool upDown = key == SCANCODE_CURSORBLOCKUP || key == SCANCODE_CURSORBLOCKDOWN;
    if (msg == MSG_KEYDOWN) return upDown;
    if (msg != MSG_KEYUP) return false;
    if (!upDown) return true;
    if (s_unlockCount == 0) s_unlockFirstMs = now_ms();
    if (++s_unlockCount >= 5) {
        long long t = now_ms() - s_unlockFirstMs;
        LOGD("time = %d\n", (int)t);
        if (t <= 6000) {
            LOGD("time correct! unlock tp!\n");
            s_unlockFlag = 1;
            g_bWiFiConnectStatus = 0;
        } else {
            LOGD("time out, try again!\n");
        }
        s_unlockCount = 0;
    }
    return true;
}

int input_mouse_hook(void *, HWND, UINT, WPARAM, LPARAM) {
    GetLastInputTime();
    return HOOK_GOON;
}

LRESULT close_hub(HWND hWnd) {
    svr_destroy_softkeybar();
    DestroyAllControls(hWnd);
    DestroyMainWindow(hWnd);
    PostQuitMessage(hWnd);
    return 0;
}

void read_menu_config() {
    char value[FTX_CFG_TEXT_SIZE] = {0};
    Read_MainCfgFile("MAIN_UI", "coupleTest", value, "0");
    g_bCoupleTest = atoi(value);
    memset(value, 0, sizeof value);
    g_bAgingTest = Read_MainCfgFile("MAIN_UI", "aging", value, "1") == 0 ? atoi(value) : 1;
    LOGD("%s,L%d::g_bCoupleTest=%d.", "mmi_CurrentWnd_ReadConfig", __LINE__, g_bCoupleTest);
    LOGD("%s,L%d::g_bAgingTest=%d.", "mmi_CurrentWnd_ReadConfig", __LINE__, g_bAgingTest);
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

// Touch-panel state of the last "TPHARDWARE" answer (-1 before one).
std::atomic<int> s_tpState{-1};
int tp_state(void) {
    return s_tpState;
}

}  // namespace

// The touch-panel status answer: "0x0N" in the text gives the state.
void Get_tpstatus_callback(module_data *data) {
    if (!data) return;
    const char *p = strstr((const char *)data->data, "0x0");
    if (p) s_tpState = p[3] - '0';
}

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

int mmi_powerkey_is_short(long long pressMs, long long releaseMs) {
    return releaseMs - pressMs < MMI_POWERKEY_LONG_MS ? 1 : 0;
}

int TitleInfoShow(const char *text, int index, int abnormalState) {
    if (index == 1 && g_deviceIsAgingTest == 1) return 0;
    LOGD("%s begin,buf=%s,index=%d,abnomal_state=%d ", "TitleInfoShow", text ? text : "(null)",
         index, abnormalState);
    HWND hub = g_hMainWnd;
    std::lock_guard<std::mutex> lk(s_titleMutex);
    if (index == 1) {
        if (abnormalState == 1 && text) s_titleWarning = text;
        if (abnormalState == 0) s_titleWarning.clear();
    }
    if (abnormalState == 0) tp_batteryshow_set_text_col(MMI_COLOUR_TEXT);
    if (abnormalState == 1) tp_batteryshow_set_text_col(MMI_COLOUR_FAIL);
    std::string restore;
    if (!text && index == 1 && abnormalState == 0) {
        restore = tr("title_factory");
        text = restore.c_str();
    }
    if (text) tp_batteryshow_set_text_items_byIndex(hub, text, index);
    // A warning in force is shown over whatever window is in front. Otherwise the window in
    // front keeps its own strip (a list's or a test's title), given back to it when a
    // warning leaves; the menu's texts wait in its record until it is in front again.
    HWND front = GetActiveWindow();
    if (s_titleWarning.empty() && front != hub && front != HWND_INVALID && front != HWND_NULL &&
        tp_batteryshow_has_items(front))
        return tp_batteryshow_update(front);
    return tp_batteryshow_update(hub);
}

void ScrollViewProc(HWND hwnd, LINT id, int nc, DWORD add_data) {
    (void)id;
    if (nc != SVN_ITEMCHOSEN) return;
    int index = scrollview_get_item_index(hwnd, (HSVITEM)add_data);
    if (index < 0 || index >= MMI_MENU_MAX_ROWS || !g_mainMenu[index].entry) return;
    LOGD("%s choose %d %s", "ScrollViewProc", index, g_mainMenu[index].label);
    g_mainMenu[index].entry();
}

int hookKeyProc(void *context, HWND dst, UINT msg, WPARAM wparam, LPARAM lparam) {
    (void)context;
    (void)lparam;
    GetLastInputTime();
    if (wparam == SCANCODE_ESCAPE && msg == MSG_KEYDOWN) {
        s_powerDownMs = now_ms();
        s_shortPress = 0;
        LOGD("1127 hookKeyProc MSG_KEYDOWN KEY_POWER");
        if (!tp_os_thread_create("POWER_KEY_LONG_PRESS", 0, 0, long_press_thread, nullptr))
            LOGE("%s long press thread fail", "hookKeyProc");
    } else if (wparam == SCANCODE_ESCAPE && msg == MSG_KEYUP) {
        if (mmi_powerkey_is_short(s_powerDownMs, now_ms())) {
            s_shortPress = 1;
            SwitchSleepStatus();
        }
    }
    return key_lock(dst, msg, wparam) ? HOOK_STOP : HOOK_GOON;
}

LRESULT mmi_ExampleWin_MenuWndProc(HWND hWnd, UINT message, WPARAM wParam, LPARAM lParam) {
    LRESULT result = 0;
    if (mmi_guithread_dispatch(message, wParam, lParam, &result)) return result;
    switch (message) {
        case MSG_CREATE:
            g_hMainWnd = hWnd;
            mmi_guithread_set_window(hWnd);
            create_menu(hWnd);
            return 0;
        case MSG_TIMER:
            if (wParam == MMI_TIMER_BARS) on_timer(hWnd);
            return 0;
        case MSG_KEYDOWN:
            if (wParam == SCANCODE_F4) {
                on_link_key(hWnd);
                return 0;
            }
            break;
        case MSG_CALLBACK:
            on_link_change(hWnd);
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
            create_dialog(hWnd, wParam, (int)lParam);
            return 0;
        case MSG_DIALOGBTN:
            dialog_button(hWnd, (int)wParam);
            return 0;
        case MSG_CLOSE:
            g_hMainWnd = HWND_INVALID;
            mmi_guithread_set_window(HWND_INVALID);
            return close_hub(hWnd);
        default:
            break;
    }
    return DefaultMainWinProc(hWnd, message, wParam, lParam);
}

int kmt_CreateMainMenuWnd(void) {
    read_menu_config();
    mmi_testwnd_InitLogFont();
    HWND hWnd = create_hub_window(mmi_ExampleWin_MenuWndProc);
    if (hWnd == HWND_INVALID) {
        LOGE("%s create main window fail", "kmt_CreateMainMenuWnd");
        return -1;
    }
    RegisterKeyMsgHook(nullptr, hookKeyProc);
    RegisterMouseMsgHook(nullptr, input_mouse_hook);
    ShowWindow(hWnd, SW_SHOWNORMAL);
    if (hw::FTX_API_BatteryService_register_Observer) {
        hw::FTX_API_BatteryService_register_Observer(FTX_BATTERY_OBSERVER_TEMPERATURE,
                                                     batteryTemperatureobserver_cb);
        hw::FTX_API_BatteryService_register_Observer(FTX_BATTERY_OBSERVER_VOLTAGE,
                                                     batteryVoltobserver_cb);
    }
    if (Check_AgingCfg_Exist()) {
        g_deviceIsAgingTest = 1;
        tp_os_thread_create("AGING_RESUME", 0, 0, mmi_AgingTest_Wnd_Thread, nullptr);
    }
    restore_autotest();
    int rc = InitGUIIAL();
    if (rc != 0) return rc;
    mmi_start_tcp_relink(hWnd);  // only when /cache/Tcp_Restart.ini is readable
    return run_loop(hWnd);
}

// ---- the factory-boot-mode note window ----

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
            g_hMainWnd = HWND_INVALID;
            mmi_guithread_set_window(HWND_INVALID);
            return close_hub(hWnd);
        default:
            return DefaultMainWinProc(hWnd, message, wParam, lParam);
    }
}

int kmt_CreateMainMenuWnd1(void) {
    mmi_testwnd_InitLogFont();
    HWND hWnd = create_hub_window(mmi_ExampleWin_MenuWndProc1);
    if (hWnd == HWND_INVALID) {
        LOGE("%s create main window fail", "kmt_CreateMainMenuWnd1");
        return -1;
    }
    RegisterKeyMsgHook(nullptr, hookKeyProc);
    ShowWindow(hWnd, SW_SHOWNORMAL);
    int rc = InitGUIIAL();
    if (rc != 0) return rc;
    return run_loop(hWnd);
}

// The key test window. Its procedure runs on the GUI thread; the PC and the PCBA run reach
// it through the GUI thread and poll its flags.
#include "testwnd/keys/mmi_testwnd_keys.h"

#include <stdio.h>
#include <stdlib.h>
#include <string.h>

#include <atomic>

#include <android/log.h>
#include <cutils/properties.h>
#include <minigui/minigui.h>

#include "core/mmi_power.h"
#include "mmi_bars.h"
#include "mmi_guithread.h"
#include "mmi_theme.h"
#include "testwnd/mmi_testwnd.h"
#include "tp_os.h"

#define KEY_DEBUG(...) __android_log_print(ANDROID_LOG_DEBUG, kTag, __VA_ARGS__)
#define KEY_ERROR(...) __android_log_print(ANDROID_LOG_ERROR, kTag, __VA_ARGS__)

mmi_key_item Keytest_Item[MMI_KEY_ITEMS];

namespace {

const char *const kTag = catalogue::Keys.domain;
const int kMaxParams = 12;
// The keys of the item's configuration, in table order; UI_KEYS follows them.
const char *const kConfigKeys[] = {"VOLUME_UP",  "VOLUME_DOWN", "HOME",   "BACK",
                                   "MENU",       "POWER",       "CAMERA", "SEARCH",
                                   "APP_SWITCH", "TORCH",       "TV"};
// The keys of the PCBA run.
const char *const kPcbaKeys[] = {"VOLUME_UP", "VOLUME_DOWN", "POWER"};
// The keys the panel status adds when UI_KEYS asks for them.
const char *const kUiKeys[] = {"HOME", "BACK", "APP_SWITCH"};

const bool s_tableReady = (mmi_key_table_init(Keytest_Item), true);

mmi_ownwnd_state s_wnd;
std::atomic<int> s_pcba{0};
std::atomic<int> s_allDone{0};
// The converted codes of the keys released, each followed by ',' (GUI thread).
char g_keys_buf[256];

int open_on_gui(void *) {
    mmi_teswnd_KeyTest();
    return 1;
}

void close_key_window(HWND hWnd) {
    SendMessage(hWnd, MSG_CLOSE, 0, 0);
}

void fail_and_close(HWND hWnd) {
    mmi_testwnd_record_fail(catalogue::Keys.resultIndex);
    close_key_window(hWnd);
}

void show_soft_keys(HWND hWnd, const char *titleKey) {
    char pass[MMI_TESTWND_TEXT_SIZE], fail[MMI_TESTWND_TEXT_SIZE];
    mmi_translate("Result_pass", pass, sizeof(pass));
    mmi_translate("Result_fail", fail, sizeof(fail));
    if (s_allDone.load()) {
        mmi_testwnd_set_bars(hWnd, titleKey, pass, "", fail);
    } else {
        mmi_testwnd_set_bars(hWnd, titleKey, " ", " ", fail);
    }
}

void paint(HWND hWnd) {
    HDC hdc = BeginPaint(hWnd);
    const int w = g_ptScreenInfo.width;
    SetPenColor(hdc, mmi_pixel(MMI_COLOUR_PASS));
    SetPenWidth(hdc, 1);
    MoveTo(hdc, 0, 0);
    LineTo(hdc, w, 0);
    SetBkMode(hdc, BM_TRANSPARENT);
    SetTextColor(hdc, mmi_pixel(MMI_COLOUR_FAIL));
    SetBrushColor(hdc, mmi_pixel(MMI_COLOUR_WINDOW));
    for (mmi_key_item &k : Keytest_Item) {
        RECT rc = {(int)k.left, (int)k.top, (int)k.right, (int)k.bottom};
        if (k.test_enable && !k.done) {
            mmi_translate(k.text, k.text, sizeof(k.text));
            DrawText(hdc, k.text, -1, &rc, DT_CENTER | DT_VCENTER | DT_SINGLELINE);
        } else {
            FillBox(hdc, rc.left, rc.top, rc.right - rc.left, rc.bottom - rc.top);
        }
    }
    EndPaint(hWnd, hdc);
}

void append_key(WPARAM key) {
    const int code = scancode_convert_keycode((int)key);
    if (code == 0) return;
    const size_t used = strlen(g_keys_buf);
    snprintf(g_keys_buf + used, sizeof(g_keys_buf) - used, "%d,", code);
    KEY_DEBUG("%s::g_keys_buf=%s", "mmiTestMsgKeyTestProc", g_keys_buf);
}

LRESULT key_proc(HWND hWnd, UINT message, WPARAM wParam, LPARAM lParam) {
    switch (message) {
        case MSG_CREATE:
            mmi_testwnd_create_title(hWnd, "title_KeyTest");
            for (mmi_key_item &k : Keytest_Item)
                k.done = 0;
            s_allDone = 0;
            memset(g_keys_buf, 0, sizeof(g_keys_buf));
            mmi_set_current_test(kTag);
            s_wnd.created = 1;
            KEY_DEBUG("%s::MSG_CREATE g_currentwndCreated=1", __func__);
            Set_OsCanIdleAllowed(0);
            break;
        case MSG_ACTIVE:
            if (mmi_ownwnd_refuses(&s_wnd, message, kTag)) return 0;
            if (wParam == 1) show_soft_keys(hWnd, "title_KeyTest");
            break;
        case MSG_PAINT:
            if (mmi_ownwnd_refuses(&s_wnd, message, kTag)) return 0;
            paint(hWnd);
            return 0;
        case MSG_KEYDOWN:
        case MSG_KEYUP:
            KEY_DEBUG("%s message= %s", __func__,
                      message == MSG_KEYDOWN ? "MSG_KEYDOWN" : "MSG_KEYUP");
            mmiTestMsgKeyTestProc(hWnd, wParam, message);
            return 0;
        case MSG_FAILANDQUIT:
            tp_os_print("mmi_testwnd_key test fail");
            fail_and_close(hWnd);
            return 0;
        case MSG_CLOSE:
            if (!s_wnd.pcDriven.load()) Set_OsCanIdleAllowed(1);
            memset(g_keys_buf, 0, sizeof(g_keys_buf));
            mmi_ownwnd_destroy(&s_wnd, hWnd);
            return 0;
        default:
            break;
    }
    return DefaultMainWinProc(hWnd, message, wParam, lParam);
}

// The PC's verdict, on the GUI thread where the table lives.
int key_verdict(char *reply, unsigned int size) {
    const size_t n = strlen(g_keys_buf);
    if (n > 0 && g_keys_buf[n - 1] == ',') g_keys_buf[n - 1] = '\0';
    char pending[MMI_KEY_TEXT_SIZE];
    mmi_key_pending_codes(Keytest_Item, pending, sizeof(pending));
    if (pending[0] == '\0') {
        KEY_DEBUG("%s::success keys=%s", "mmi_AutoTest_KeyTest_Stop_Entry", g_keys_buf);
        tp_os_strlcpy(reply, g_keys_buf, size);
        return 1;
    }
    pending[strlen(pending) - 1] = '\0';
    KEY_ERROR("%s::fail keys=%s", "mmi_AutoTest_KeyTest_Stop_Entry", pending);
    tp_os_strlcpy(reply, pending, size);
    return 0;
}

}  // namespace

// ---- configuration ----

void setKeytest_Item_value(const char *name, int enable) {
    KEY_DEBUG("%s::name=%s,test_enable_value=%d", __func__, name, enable);
    for (int i = 0; i < MMI_KEY_ITEMS; i++) {
        mmi_key_item &k = Keytest_Item[i];
        KEY_DEBUG("%s::Keytest_Item[%d].config_name=%s", __func__, i, k.config_name);
        if (strncmp(k.config_name, name, strlen(k.config_name)) != 0) continue;
        k.test_enable = enable;
        k.down = 0;
        KEY_DEBUG("%s::Keytest_Item[%d].test_enable=%d", __func__, i, k.test_enable);
        return;
    }
}

void Current_testwnd_GetConfigParas(void) {
    ftx_config_para paras[kMaxParams];
    const int n = mmi_testwnd_params(kTag, paras, kMaxParams);
    for (const char *key : kConfigKeys) {
        char value[FTX_CFG_TEXT_SIZE] = {0};
        ftx_config_get_para_value(paras, n, key, value, sizeof(value), "0");
        const int v = atoi(value);
        KEY_DEBUG("%s::CONFIG_%s=%s,tempval=%d", __func__, key, value, v);
        setKeytest_Item_value(key, v);
    }
    const int ui = mmi_testwnd_param_int(paras, n, "UI_KEYS", "0");
    KEY_DEBUG("%s::bEnableUIKeyTest=%d", __func__, ui);
    char status[PROPERTY_VALUE_MAX] = {0};
    property_get("ftmd.TPstatus", status, "0");
    if (ui != 0 && atoi(status) != 0) {
        for (const char *key : kUiKeys)
            setKeytest_Item_value(key, 1);
        KEY_DEBUG("%s::bEnableUIKeys=%d", __func__, 1);
    }
}

// ---- the window ----

void *mmi_teswnd_KeyTest(void) {
    (void)s_tableReady;
    if (s_pcba.load()) {
        for (mmi_key_item &k : Keytest_Item)
            k.test_enable = 0;
        for (const char *key : kPcbaKeys)
            setKeytest_Item_value(key, 1);
    } else {
        Current_testwnd_GetConfigParas();
    }
    if (!mmi_key_any_enabled(Keytest_Item)) {
        KEY_DEBUG("no test key is exist");
        return HWND_INVALID;
    }
    const int w = g_ptScreenInfo.width;
    mmi_key_table_layout(Keytest_Item, w, 2 * mmi_logfont_size(3, w));
    for (mmi_key_item &k : Keytest_Item) {
        k.down = 0;
        k.up = 0;
    }
    s_allDone = 0;
    HWND hWnd = mmi_testwnd_create("Key Test", key_proc, 0);
    s_wnd.created = 1;  // also after a failure: a PC stop then answers from the table
    return mmi_ownwnd_opened(&s_wnd, hWnd, mmi_teswnd_KeyTest_Stop_Entry);
}

void *mmi_teswnd_KeyTestEntry(void) {
    s_wnd.pcDriven = 0;
    return mmi_teswnd_KeyTest();
}

int mmi_teswnd_KeyTest_Stop_Entry(void) {
    return mmi_ownwnd_stop(&s_wnd);
}

// ---- key events ----

void CheckKeyisDown(HWND hWnd, WPARAM key) {
    if (mmi_key_press(Keytest_Item, (uint32_t)key, kTag)) InvalidateRect(hWnd, nullptr, TRUE);
}

void CheckKeyisUp(HWND hWnd, WPARAM key) {
    if (mmi_key_release(Keytest_Item, (uint32_t)key, kTag)) InvalidateRect(hWnd, nullptr, TRUE);
}

void mmiTestMsgKeyTestProc(HWND hWnd, WPARAM key, UINT message) {
    tp_os_print("mmiTestMsgKeyDownProc wParam=%d\n", (int)key);
    const bool release = message == MSG_KEYUP;
    if (key == MMI_KEY_FAIL) {
        const int i = mmi_key_table_find_enabled(Keytest_Item, MMI_KEY_FAIL);
        // A tested key that shares the fail key's code is a test key until it passes.
        if (i >= 0 && !Keytest_Item[i].done) {
            release ? CheckKeyisUp(hWnd, key) : CheckKeyisDown(hWnd, key);
            return;
        }
        if (!release) fail_and_close(hWnd);
        return;
    }
    if (key == MMI_KEY_PASS && !release && s_allDone.load()) {
        close_key_window(hWnd);
        mmi_testwnd_record_pass(catalogue::Keys.resultIndex, kTag);
        return;
    }
    if (!release) {
        CheckKeyisDown(hWnd, key);
        return;
    }
    CheckKeyisUp(hWnd, key);
    if (mmi_key_all_done(Keytest_Item) && !s_allDone.load()) {
        s_allDone = 1;
        show_soft_keys(hWnd, nullptr);
    }
    append_key(key);
}

// ---- PC and PCBA ----

int mmi_AutoTest_KeyTestEntry(void) {
    return mmi_ownwnd_pc_open(&s_wnd, mmi_teswnd_KeyTest);
}

int mmi_AutoTest_KeyTest_Stop_Entry(char *reply, unsigned int size) {
    const int verdict = mmi_ownwnd_pc_stop(&s_wnd, key_verdict, reply, size);
    if (verdict < 0) {
        KEY_ERROR("%s::currentwnd is not created", __func__);
        tp_os_strlcpy(reply, "nothing opened", size);
        return 0;
    }
    return verdict;
}

int PCBAKeyTestStart(void) {
    Check_AllTestWnd_Closed();
    s_pcba = 1;
    s_wnd.pcDriven = 1;
    mmi_RunOnGuiThread(open_on_gui, nullptr);
    for (int i = 0; i < 62 && !s_allDone.load(); i++)
        tp_os_usleep(500000);
    const int done = s_allDone.load();
    KEY_DEBUG("%s::all keys done=%d", __func__, done);
    mmi_ownwnd_stop(&s_wnd);
    s_pcba = 0;
    return done;
}

int PCBAKeyTestStop(void) {
    return 1;
}

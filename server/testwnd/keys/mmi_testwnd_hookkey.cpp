// The hook-key test window. The library's callback runs on its own thread and reaches the
// window only through a message; the table is the GUI thread's.
#include "testwnd/keys/mmi_testwnd_hookkey.h"

#include <string.h>

#include <atomic>

#include <android/log.h>

#include "mmi_guithread.h"
#include "mmi_theme.h"
#include "testwnd/mmi_key_table.h"
#include "testwnd/mmi_testwnd.h"
#include "tp_os.h"

#define HOOK_DEBUG(...) __android_log_print(ANDROID_LOG_DEBUG, kTag, __VA_ARGS__)
#define HOOK_ERROR(...) __android_log_print(ANDROID_LOG_ERROR, kTag, __VA_ARGS__)

namespace {

const char *const kTag = catalogue::HookKey.domain;
const char kTitle[] = "menu_HookKeyTest";
// A second hook code some headsets send.
const WPARAM kHookAlt = 132;

mmi_key_item s_items[MMI_KEY_ITEMS];
const bool s_tableReady = (mmi_key_table_init(s_items), true);
mmi_ownwnd_state s_wnd;
std::atomic<int> s_hookPressed{0};

int hook_row(void) {
    for (int i = 0; i < MMI_KEY_ITEMS; i++)
        if (s_items[i].key == MMI_KEY_HOOK) return i;
    return -1;
}

bool hook_done(void) {
    const int i = hook_row();
    return i >= 0 && s_items[i].done;
}

// Marks the hook row passed; true when it was not yet.
bool mark_hook(void) {
    const int i = hook_row();
    if (i < 0 || s_items[i].done) return false;
    s_items[i].done = 1;
    HOOK_DEBUG("%s::Keytest_Item[%d].config_name=%s OK", "CheckKeyisTest", i,
               s_items[i].config_name);
    return true;
}

void lib_stop(char *reply, unsigned int size) {
    if (hw::ftx_api_HookKeyTest_Stop) hw::ftx_api_HookKeyTest_Stop(reply, size);
}

void soft_keys(HWND hWnd, bool pass, const char *titleKey) {
    char passText[MMI_TESTWND_TEXT_SIZE], fail[MMI_TESTWND_TEXT_SIZE];
    mmi_translate("Result_pass", passText, sizeof(passText));
    mmi_translate("Result_fail", fail, sizeof(fail));
    mmi_testwnd_set_bars(hWnd, titleKey, pass ? passText : " ", pass ? "" : " ", fail);
}

void pass_and_close(HWND hWnd) {
    mmi_testwnd_pass_and_close(hWnd, catalogue::Keys.resultIndex, kTag);
}

void fail_and_close(HWND hWnd) {
    mmi_testwnd_fail_and_close(hWnd, catalogue::Keys.resultIndex);
}

void paint(HWND hWnd) {
    HDC hdc = BeginPaint(hWnd);
    const int w = g_ptScreenInfo.width;
    const int listTop = mmi_key_list_top(w);
    char note[MMI_TESTWND_TEXT_SIZE];
    mmi_translate("info_KeyNote", note, sizeof(note));
    SetBkMode(hdc, BM_TRANSPARENT);
    SetTextColor(hdc, mmi_pixel(MMI_COLOUR_TEXT));
    RECT rc = {w / 8, w / 15 + 10, (w / 4) * 3 + w / 8, listTop};
    DrawText(hdc, note, -1, &rc, DT_WORDBREAK);
    SetPenColor(hdc, mmi_pixel(MMI_COLOUR_PASS));
    SetPenWidth(hdc, 1);
    MoveTo(hdc, 0, 0);
    LineTo(hdc, w, 0);
    MoveTo(hdc, 0, listTop);
    LineTo(hdc, w, listTop);
    for (mmi_key_item &k : s_items) {
        if (k.right <= k.left || k.bottom <= k.top) continue;
        const bool pending = k.key == MMI_KEY_HOOK && !k.done;
        SetTextColor(hdc, mmi_pixel(pending ? MMI_COLOUR_FAIL : MMI_COLOUR_PASS));
        mmi_translate(k.text, k.text, sizeof(k.text));
        RECT row = {(int)k.left, (int)k.top, (int)k.right, (int)k.bottom};
        DrawText(hdc, k.text, -1, &row, DT_CENTER | DT_VCENTER | DT_SINGLELINE);
    }
    EndPaint(hWnd, hdc);
}

void key_down(HWND hWnd, WPARAM key) {
    HOOK_DEBUG("%s message= MSG_KEYDOWN", __func__);
    HOOK_DEBUG("%s::wParam=%d", __func__, (int)key);
    if ((key == MMI_KEY_HOOK || key == kHookAlt) && mark_hook())
        InvalidateRect(hWnd, nullptr, TRUE);
    if (hook_done()) {
        s_hookPressed = 1;
        if (!s_wnd.pcDriven.load()) {
            pass_and_close(hWnd);
            return;
        }
        soft_keys(hWnd, true, nullptr);
    }
    if (key == MMI_KEY_FAIL) {
        lib_stop(nullptr, 0);
        fail_and_close(hWnd);
    } else if (key == MMI_KEY_PASS && s_hookPressed.load()) {
        lib_stop(nullptr, 0);
        pass_and_close(hWnd);
    }
}

LRESULT hook_proc(HWND hWnd, UINT message, WPARAM wParam, LPARAM lParam) {
    switch (message) {
        case MSG_CREATE:
            if (g_mmiLogFont[3]) SetWindowFont(hWnd, g_mmiLogFont[3]);
            for (mmi_key_item &k : s_items)
                k.done = 0;
            s_hookPressed = 0;
            mmi_set_current_test(kTag);
            // The library may call back as soon as it starts: the window is known by then.
            s_wnd.hwnd = hWnd;
            s_wnd.created = 1;
            if (hw::ftx_api_HookKeyTest_Start) hw::ftx_api_HookKeyTest_Start(hookkey_test_callback);
            break;
        case MSG_ACTIVE:
            if (mmi_ownwnd_refuses(&s_wnd, message, kTag)) return 0;
            if (wParam == 1) soft_keys(hWnd, hook_done(), kTitle);
            break;
        case MSG_PAINT:
            if (mmi_ownwnd_refuses(&s_wnd, message, kTag)) return 0;
            paint(hWnd);
            return 0;
        case MSG_KEYDOWN:
            key_down(hWnd, wParam);
            return 0;
        case MSG_CALLBACK:
            if (wParam == 1) {
                mark_hook();
                InvalidateRect(hWnd, nullptr, TRUE);
            }
            soft_keys(hWnd, wParam == 1, nullptr);
            return 0;
        case MSG_FAILANDQUIT:
            fail_and_close(hWnd);
            return 0;
        case MSG_CLOSE:
            mmi_ownwnd_destroy(&s_wnd, hWnd);
            return 0;
        default:
            break;
    }
    return DefaultMainWinProc(hWnd, message, wParam, lParam);
}

// The PC's verdict, on the GUI thread: the library's stop text, and whether the key passed.
int hook_verdict(char *reply, unsigned int size) {
    s_wnd.pcDriven = 0;
    lib_stop(reply, size);
    return hook_done() ? 1 : 0;
}

}  // namespace

void init_Hookkeyrect(void) {
    (void)s_tableReady;
    const int i = hook_row();
    if (i < 0) return;
    const int w = g_ptScreenInfo.width;
    mmi_key_item &k = s_items[i];
    k.left = 0;
    k.top = mmi_key_list_top(w);
    k.right = w;
    k.bottom = k.top + 2 * mmi_logfont_size(3, w);
    HOOK_DEBUG("config_name=%s,left=%d,top=%d,right=%d,bottom=%d", k.config_name, (int)k.left,
               (int)k.top, (int)k.right, (int)k.bottom);
}

void *mmi_teswnd_HookKeyTest(void) {
    init_Hookkeyrect();
    // Without the library's calls the operator's key still passes the test.
    load_lib_interface_hookkey(kTag);
    return mmi_ownwnd_opened(&s_wnd, mmi_testwnd_create("Hook Key Test", hook_proc, 0),
                             mmi_teswnd_HookKeyTest_Stop_Entry);
}

void *mmi_teswnd_HookKeyTestEntry(void) {
    s_wnd.pcDriven = 0;
    return mmi_teswnd_HookKeyTest();
}

int mmi_teswnd_HookKeyTest_Stop_Entry(void) {
    return mmi_ownwnd_stop(&s_wnd);
}

void hookkey_test_callback(unsigned int *status) {
    const unsigned int s = status != nullptr ? *status : 0;
    HWND hWnd = s_wnd.hwnd.load();
    HOOK_DEBUG("hook key callback begin: status=%u window=%s", s,
               hWnd == HWND_INVALID ? "none" : "open");
    if (s != 1 || hWnd == HWND_INVALID) return;
    SendMessage(hWnd, MSG_CALLBACK, 1, 0);
    s_hookPressed = 1;
}

int mmi_AutoTest_HeadsetHookTestEntry(void) {
    HOOK_DEBUG("%s::L%d,g_currentwndCreated=%d", __func__, 463, s_wnd.created.load());
    return mmi_ownwnd_pc_open(&s_wnd, mmi_teswnd_HookKeyTest);
}

int mmi_AutoTest_HeadsetHookTest_Stop_Entry(char *reply, unsigned int size) {
    const int verdict = mmi_ownwnd_pc_stop(&s_wnd, hook_verdict, reply, size);
    if (verdict < 0) {
        HOOK_ERROR("%s::currentwnd is not created", __func__);
        return 0;
    }
    return verdict;
}

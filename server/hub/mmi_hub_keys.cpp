// The hub's input hooks: the power key (a short press sleeps or wakes, a long one opens the
// power-off dialog from its own thread) and the unlock gesture while the Wi-Fi link holds
// the keys.
#include "hub/mmi_hub_keys.h"

#include <sys/time.h>
#include <tp_os.h>
#include <unistd.h>

#include <semaphore>

#include "core/mmi_power.h"
#include "hub/hub_internal.h"
#include "hub/mmi_hub_dialogs.h"
#include "hub/mmi_mainwnd.h"
#include "hub/mmi_wifi_link.h"

namespace {

// Wi-Fi unlock gesture.
std::atomic<int> s_unlockFlag{0};
std::atomic<int> s_unlockCount{0};  // counted on the input thread, reset by the GUI thread
std::atomic<long long> s_unlockFirstMs{0};

// Power key (input thread and its long-press thread).
std::atomic<long long> s_powerDownMs{0};
std::atomic<int> s_shortPress{0};
std::binary_semaphore s_dialogSem{1};  // held from a long press until a dialog button
std::atomic<bool> s_dialogSemHeld{false};

long long now_ms() {
    struct timeval tv;
    gettimeofday(&tv, nullptr);
    return tv.tv_sec * 1000LL + tv.tv_usec / 1000;
}

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

}  // namespace

namespace hub {

void release_dialog_sem() {
    if (s_dialogSemHeld.exchange(false)) s_dialogSem.release();
}

void unlock_count_reset() {
    s_unlockCount = 0;
}

int unlocked() {
    return s_unlockFlag;
}

int input_mouse_hook(void *, HWND, UINT, WPARAM, LPARAM) {
    GetLastInputTime();
    return HOOK_GOON;
}

}  // namespace hub

int mmi_powerkey_is_short(long long pressMs, long long releaseMs) {
    return releaseMs - pressMs < MMI_POWERKEY_LONG_MS ? 1 : 0;
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

// The signalling coupling window: the vendor library opened and initialised on entry, a
// worker that walks the modem through low-power mode into online mode, a timer that repaints
// the window when the worker's state changes, and a close that waits for the worker before
// the library is uninitialised and closed.
#include "coupling/mmi_signal_coupling.h"

#include <pthread.h>

#include <android/log.h>

#include <atomic>
#include <mutex>

#include "core/ftx_lib_binding.h"
#include "core/mmi_power.h"
#include "hw/lib_dvk_signalcoupling.h"
#include "minigui/control.h"
#include "mmi_guithread.h"
#include "mmi_theme.h"
#include "testwnd/mmi_testwnd.h"
#include "tp_os.h"

#define LOGD(...) __android_log_print(ANDROID_LOG_DEBUG, SIGNAL_COUPLING_TAG, __VA_ARGS__)
#define LOGE(...) __android_log_print(ANDROID_LOG_ERROR, SIGNAL_COUPLING_TAG, __VA_ARGS__)

namespace {

// The library and its operations, looked up in this order.
std::atomic<void *> s_lib{nullptr};
ftx_hw_op<decltype(&::FTX_API_SignalCoupling_init)> s_init;
ftx_hw_op<decltype(&::FTX_API_SignalCoupling_uninit)> s_uninit;
ftx_hw_op<decltype(&::FTX_API_SignalCoupling_setModemMode)> s_setModemMode;
const ftx_own_op kOperations[] = {
    {"FTX_API_SignalCoupling_init", &s_init},
    {"FTX_API_SignalCoupling_uninit", &s_uninit},
    {"FTX_API_SignalCoupling_setModemMode", &s_setModemMode},
};

// The modem state the worker writes, and the state the window last drew (GUI thread).
std::atomic<int> s_modemState{SIGNAL_COUPLING_SWITCHING};
int s_drawnState = SIGNAL_COUPLING_SWITCHING;
// Held by the worker for a whole switching sequence.
std::mutex s_switching;
// The worker (GUI thread only: started in MSG_CREATE, joined in MSG_CLOSE).
pthread_t s_worker;
bool s_workerStarted = false;

mmi_ownwnd_state s_wnd;

// The text of each state: a language key, or for a failure the fixed text in GBK.
const char *const kStateKeys[] = {"singalCoupleNote1", "singalCoupleNote2", nullptr};
// 设置modem为online模式失败!
const char kFailedText[] = "\311\350\326\303modem\316\252online\304\243\312\275\312\247\260\334!";
// The window font, in which the texts are drawn.
const int kFont = 3;

const int kOperationCount = sizeof kOperations / sizeof kOperations[0];

void close_library(void) {
    ftx_own_library_close(&s_lib, kOperations, kOperationCount);
}

// One mode switch, logged.
int switch_mode(int mode) {
    const int rc = s_setModemMode(mode);
    LOGD("%s::FTX_API_SignalCoupling_setModemMode(%d) ret=%d", "Set_Modem_online_mode", mode, rc);
    return rc;
}

void paint(HWND hWnd) {
    const int w = g_ptScreenInfo.width;
    const int h = g_ptScreenInfo.height;
    const int state = s_drawnState;
    LOGD("%s::MSG_PAINT modem state %d", "mmi_SignalCouplingTestWndProc", state);
    char text[MMI_TESTWND_NOTE_SIZE];
    if (state >= 0 && state < SIGNAL_COUPLING_FAILED)
        mmi_translate(kStateKeys[state], text, sizeof text);
    else
        tp_os_strlcpy(text, kFailedText, sizeof text);
    HDC hdc = BeginPaint(hWnd);
    mmi_testwnd_draw_top_line(hdc);
    SetBkMode(hdc, BM_TRANSPARENT);
    // The text's lines centred in the box, across and down.
    RECT box = {w / 8, 0, w / 8 + 3 * (w / 4), h - (h / 15 + 10)};
    const UINT format = DT_CENTER | DT_WORDBREAK;
    if (g_mmiLogFont[kFont]) SelectFont(hdc, g_mmiLogFont[kFont]);
    RECT need = box;
    DrawText(hdc, text, -1, &need, format | DT_CALCRECT);
    const int spare = RECTH(box) - RECTH(need);
    if (spare > 0) box.top += spare / 2;
    mmi_testwnd_text_at(hdc, kFont, MMI_COLOUR_TEXT, text, box, format);
    EndPaint(hWnd, hdc);
}

void on_create(HWND hWnd) {
    HWND strip =
        CreateWindowEx(CTRL_STATIC, "", WS_VISIBLE | WS_BORDER | SS_CENTER | SS_NOPREFIX,
                       WS_EX_NONE, MMI_TESTWND_TITLE_ID, 0, 0, g_ptScreenInfo.width, 20, hWnd, 0);
    if (g_mmiLogFont[1] && strip != HWND_INVALID) SetWindowFont(strip, g_mmiLogFont[1]);
    if (g_mmiLogFont[kFont]) SetWindowFont(hWnd, g_mmiLogFont[kFont]);
    s_modemState = SIGNAL_COUPLING_SWITCHING;
    s_drawnState = SIGNAL_COUPLING_SWITCHING;
    s_workerStarted = pthread_create(&s_worker, nullptr, Set_Modem_online_mode, nullptr) == 0;
    if (!s_workerStarted) {
        LOGE("%s::MSG_CREATE the worker did not start", "mmi_SignalCouplingTestWndProc");
        s_modemState = SIGNAL_COUPLING_FAILED;
    }
    SetTimer(hWnd, SIGNAL_COUPLING_TIMER, SIGNAL_COUPLING_TIMER_PERIOD);
}

void on_close(HWND hWnd) {
    KillTimer(hWnd, SIGNAL_COUPLING_TIMER);
    LOGD("%s::MSG_CLOSE waiting for the modem switch", "mmi_SignalCouplingTestWndProc");
    if (s_workerStarted) pthread_join(s_worker, nullptr);
    s_workerStarted = false;
    { std::lock_guard<std::mutex> done(s_switching); }
    if (s_uninit) s_uninit();
    close_library();
    LOGD("%s::MSG_CLOSE uninit done, %s closed", "mmi_SignalCouplingTestWndProc",
         SIGNAL_COUPLING_LIB);
    mmi_ownwnd_destroy(&s_wnd, hWnd);
}

int open_window(void *) {
    HWND hWnd = mmi_testwnd_create("", mmi_SignalCouplingTestWndProc, 0,
                                   WS_CAPTION | WS_BORDER | WS_VISIBLE);
    return mmi_ownwnd_opened(&s_wnd, hWnd, mmi_SignalCouplingTest_Stop) != HWND_INVALID ? 0 : -1;
}

}  // namespace

int SIGNAL_COUPLING_LOAD_LIB(void) {
    return ftx_own_library_open(&s_lib, SIGNAL_COUPLING_LIB, SIGNAL_COUPLING_TAG, kOperations,
                                kOperationCount);
}

int mmi_SignalCouplingTestEntry(void) {
    LOGD("%s begin", __func__);
    if (s_wnd.hwnd.load() != HWND_INVALID) {
        LOGD("%s the window is open already", __func__);
        return 0;
    }
    if (SIGNAL_COUPLING_LOAD_LIB() != 0) {
        LOGE("%s::SIGNAL_COUPLING_LOAD_LIB Fail.", __func__);
        return -1;
    }
    const int rc = s_init();
    if (rc != 0) {
        LOGE("%s::FTX_API_SignalCoupling_init Fail, ret=%d.", __func__, rc);
        close_library();
        return -1;
    }
    if (mmi_RunOnGuiThread(open_window, nullptr) != 0) {
        LOGE("%s create the window fail", __func__);
        s_uninit();
        close_library();
        return -1;
    }
    // The title strip's battery indicator keeps following the voltage in this window.
    if (hw::FTX_API_BatteryService_register_Observer)
        hw::FTX_API_BatteryService_register_Observer(FTX_BATTERY_OBSERVER_VOLTAGE,
                                                     batteryVoltobserver_cb);
    LOGD("%s the window is open", __func__);
    return 0;
}

LRESULT mmi_SignalCouplingTestWndProc(HWND hWnd, UINT message, WPARAM wParam, LPARAM lParam) {
    switch (message) {
        case MSG_CREATE:
            on_create(hWnd);
            break;
        case MSG_TIMER:
            if (wParam != SIGNAL_COUPLING_TIMER) break;
            if (s_modemState.load() != s_drawnState) {
                s_drawnState = s_modemState.load();
                LOGD("%s::MSG_TIMER modem state %d", __func__, s_drawnState);
                InvalidateRect(hWnd, nullptr, TRUE);
            }
            return 0;
        case MSG_PAINT:
            paint(hWnd);
            return 0;
        case MSG_ACTIVE:
            if (wParam == 1) {
                char back[MMI_TESTWND_TEXT_SIZE];
                mmi_translate("softkeybar_back", back, sizeof back);
                mmi_testwnd_set_bars(hWnd, "title_SingalCouple", "", "", back);
            }
            break;
        case MSG_KEYDOWN:
            if (wParam == SCANCODE_F3) {
                SendMessage(hWnd, MSG_CLOSE, 0, 0);
                return 0;
            }
            break;
        case MSG_CLOSE:
            on_close(hWnd);
            return 0;
        default:
            break;
    }
    return DefaultMainWinProc(hWnd, message, wParam, lParam);
}

void *Set_Modem_online_mode(void *) {
    std::lock_guard<std::mutex> sequence(s_switching);
    s_modemState = SIGNAL_COUPLING_SWITCHING;
    if (switch_mode(FTX_MODEM_MODE_LOW_POWER) != 0) {
        // One online and low-power round to recover.
        if (switch_mode(FTX_MODEM_MODE_ONLINE) != 0 || switch_mode(FTX_MODEM_MODE_LOW_POWER) != 0) {
            s_modemState = SIGNAL_COUPLING_FAILED;
            LOGE("%s modem state %d", __func__, SIGNAL_COUPLING_FAILED);
            return nullptr;
        }
        tp_os_usleep(SIGNAL_COUPLING_SETTLE_US);
    }
    tp_os_usleep(SIGNAL_COUPLING_SETTLE_US);
    const int state =
        switch_mode(FTX_MODEM_MODE_ONLINE) == 0 ? SIGNAL_COUPLING_ONLINE : SIGNAL_COUPLING_FAILED;
    s_modemState = state;
    LOGD("%s modem state %d", __func__, state);
    return nullptr;
}

int mmi_SignalCouplingTest_Stop(void) {
    return mmi_ownwnd_stop(&s_wnd);
}

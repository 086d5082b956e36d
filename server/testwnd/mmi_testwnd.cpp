// The test-window framework and the table of tests that follow its pattern.
#include "testwnd/mmi_testwnd.h"

#include <errno.h>
#include <signal.h>
#include <stdint.h>
#include <string.h>
#include <time.h>

#include <vector>

#include <android/log.h>

#include "core/ftx_config.h"
#include "session/mmi_autotest.h"
#include "mmi_bars.h"
#include "minigui/control.h"
#include "mmi_guithread.h"
#include "hub/mmi_mainwnd.h"
#include "session/mmi_monomer.h"
#include "session/mmi_runstate.h"
#include "session/mmi_testinfo.h"
#include "tp_os.h"

#define TW_DEBUG(tag, ...) __android_log_print(ANDROID_LOG_DEBUG, tag, __VA_ARGS__)
#define TW_ERROR(tag, ...) __android_log_print(ANDROID_LOG_ERROR, tag, __VA_ARGS__)

namespace {

mmi_testwnd_state s_vibrator;
mmi_testwnd_state s_hardVersion;

// The panel firmware as the library describes it.
void firmware_note(char *out, unsigned int size) {
    char buf[FTX_FIRMWARE_TEXT_SIZE] = {0};
    if (!hw::ftx_api_GetFireWare || hw::ftx_api_GetFireWare(buf) != 0) {
        TW_ERROR("FTX_MONOMER_HARDVERSION", "%s ftx_api_GetFireWare fail", __func__);
    }
    buf[sizeof(buf) - 1] = '\0';
    tp_os_strlcpy(out, buf, size);
}

// Colours of the system pixel table.
const int kColourPassLine = 10;
const int kColourText = 19;
const int kColourWindow = 18;

std::mutex s_currentLock;
char s_currentTest[MMI_TESTWND_TEXT_SIZE];

struct OpenWindow {
    HWND hwnd;
    int (*stop)(void);
};
std::mutex s_openLock;
std::vector<OpenWindow> s_open;

// SIGUSR1, only ever sent with pthread_kill, asks the sleeping thread to end: it wakes from
// its sleep and returns, so nothing is unwound inside the handler.
thread_local volatile sig_atomic_t t_stopRequested;

void signalHandler(int) {
    t_stopRequested = 1;
}

void install_stop_handler() {
    struct sigaction sa;
    memset(&sa, 0, sizeof(sa));
    sa.sa_handler = signalHandler;
    sigemptyset(&sa.sa_mask);
    sigaction(SIGUSR1, &sa, nullptr);
}

// The platform's scaled sleep, cut short by SIGUSR1; false when it was.
bool sleep_unless_stopped(unsigned long us) {
    if (t_stopRequested) return false;  // asked before the sleep began
    double scaled = (double)us * tp_os_time_scale();
    struct timespec ts;
    ts.tv_sec = (time_t)(scaled / 1e6);
    ts.tv_nsec = (long)((scaled - (double)ts.tv_sec * 1e6) * 1000.0);
    while (nanosleep(&ts, &ts) != 0) {
        if (errno != EINTR || t_stopRequested) break;
    }
    return !t_stopRequested;
}

const mmi_testwnd_desc *desc_of(HWND hWnd) {
    return reinterpret_cast<const mmi_testwnd_desc *>(GetWindowAdditionalData(hWnd));
}

int close_window(void *hWnd) {
    return (int)SendMessage((HWND)hWnd, MSG_CLOSE, 0, 0);
}

void hw_stop(const mmi_testwnd_desc *d) {
    if (d->stop && *d->stop) (*d->stop)();
}

}  // namespace

// ---- the table ----

const mmi_testwnd_desc g_testwndTable[] = {
    {"Vibration Test", "title_VibratorTest", "info_VibratorNote", 316, "FTX_VIBRATOR", 3,
     &hw::ftx_api_Vibrator_Test_Start, &hw::ftx_api_Vibrator_Test_Stop,
     "ftx_api_Vibrator_Test_Start", "ftx_api_Vibrator_Test_Stop", 500, 200, &s_vibrator,
     mmi_testwnd_VibratorTest_Stop_Entry, MMI_TESTWND_RUN_AUTO, nullptr, nullptr},
    {"Hardware Version", "menu_NfcTest", "", -1, "FTX_MONOMER_HARDVERSION", 1, nullptr, nullptr, "",
     "", 0, 0, &s_hardVersion, mmi_testwnd_Monomer_HardwareVersion_Stop, MMI_TESTWND_RUN_MONOMER,
     Init_lib_HardVersion_Interface, firmware_note},
};
const int g_testwndCount = sizeof(g_testwndTable) / sizeof(g_testwndTable[0]);

const mmi_testwnd_desc *mmi_testwnd_find(const char *domain) {
    for (int i = 0; i < g_testwndCount; i++) {
        if (strcmp(g_testwndTable[i].domain, domain) == 0) return &g_testwndTable[i];
    }
    return nullptr;
}

// ---- shared state ----

void mmi_set_current_test(const char *domain) {
    std::lock_guard<std::mutex> lk(s_currentLock);
    memset(s_currentTest, 0, sizeof(s_currentTest));
    if (domain) tp_os_strlcpy(s_currentTest, domain, sizeof(s_currentTest));
}

void mmi_get_current_test(char *out, size_t size) {
    std::lock_guard<std::mutex> lk(s_currentLock);
    tp_os_strlcpy(out, s_currentTest, size);
}

void mmi_testwnd_register_open(HWND hWnd, int (*stop)(void)) {
    std::lock_guard<std::mutex> lk(s_openLock);
    s_open.push_back({hWnd, stop});
}

void mmi_testwnd_unregister(HWND hWnd) {
    std::lock_guard<std::mutex> lk(s_openLock);
    for (size_t i = 0; i < s_open.size(); i++) {
        if (s_open[i].hwnd == hWnd) {
            s_open.erase(s_open.begin() + (long)i);
            return;
        }
    }
}

int Check_AllTestWnd_Closed(void) {
    int closed = 0;
    for (;;) {
        OpenWindow w;
        {
            std::lock_guard<std::mutex> lk(s_openLock);
            if (s_open.empty()) break;
            w = s_open.back();
            s_open.pop_back();
        }
        TW_DEBUG("FTX_MAIN", "%s close hwnd=%p", __func__, w.hwnd);
        if (w.stop) w.stop();
        closed++;
    }
    // A run waits for a key in its window; with the window gone no pass or fail can come.
    if (closed > 0 && g_bAutoTestRunning == 1) mmi_autotest_end_run("test window closed");
    if (closed > 0) g_bMonomerPreviewRunning = 0;  // the same for a preview
    return closed;
}

// ---- helpers ----

void mmi_translate(const char *key, char *out, size_t size) {
    tp_os_strlcpy(out, key, size);
    Read_LangCfgFromList(key, out);
}

HWND mmi_testwnd_create(const char *caption, WNDPROC proc, DWORD addData) {
    RECT rc;
    mmi_testwnd_rect(g_ptScreenInfo.width, g_ptScreenInfo.height, &rc);
    MAINWINCREATE create;
    memset(&create, 0, sizeof(create));
    create.dwStyle = WS_CAPTION | WS_VISIBLE;
    create.dwExStyle = WS_EX_NONE;
    create.spCaption = caption;
    create.hHosting = mmi_guithread_window();
    create.MainWindowProc = proc;
    create.lx = rc.left;
    create.ty = rc.top;
    create.rx = rc.right;
    create.by = rc.bottom;
    create.iBkColor = SysPixelIndex[kColourWindow];
    create.dwAddData = addData;
    HWND hWnd = CreateMainWindow(&create);
    if (hWnd == HWND_INVALID)
        TW_ERROR("FTX_MAIN", "%s CreateMainWindow %s fail", __func__, caption);
    return hWnd;
}

void mmi_testwnd_draw_top_line(HDC hdc) {
    SetPenColor(hdc, SysPixelIndex[kColourPassLine]);
    SetPenWidth(hdc, 3);
    MoveTo(hdc, 0, 0);
    LineTo(hdc, g_ptScreenInfo.width, 0);
}

void mmi_testwnd_rect(int w, int h, RECT *out) {
    out->left = 0;
    out->top = w / 15 + 10;
    out->right = w;
    out->bottom = h - (h / 15 + 10);
}

void mmi_testwnd_show_keys(HWND hWnd, const char *titleKey, WPARAM wParam) {
    char pass[MMI_TESTWND_TEXT_SIZE], fail[MMI_TESTWND_TEXT_SIZE], title[MMI_TESTWND_TEXT_SIZE];
    mmi_translate("Result_pass", pass, sizeof(pass));
    mmi_translate("Result_fail", fail, sizeof(fail));
    mmi_translate(titleKey, title, sizeof(title));
    tp_skb_set_text_col(kColourText);
    if (wParam == MMI_TIMER_FOOLPROOF) {
        tp_skb_set_text_items(hWnd, pass, "", fail);
    } else {
        tp_skb_set_text_items(hWnd, "", "", fail);
    }
    tp_skb_update(hWnd);
    tp_batteryshow_set_text_items_byIndex(hWnd, title, 1);
    tp_batteryshow_update(hWnd);
}

void *WaitForFoolProof(void *arg) {
    mmi_testwnd_state *st = static_cast<mmi_testwnd_state *>(arg);
    const unsigned generation = st->generation.load();
    const char *tag = st->tag.load();
    install_stop_handler();
    TW_DEBUG(tag, "WaitForFoolProof begin.hwnd = %d", (int)(intptr_t)st->hwnd.load());
    // SIGUSR1 reaches the thread only while it sleeps: never while it holds a lock (another
    // part's handler in force may end the thread outright).
    sigset_t usr1;
    sigemptyset(&usr1);
    sigaddset(&usr1, SIGUSR1);
    pthread_sigmask(SIG_UNBLOCK, &usr1, nullptr);
    bool slept = sleep_unless_stopped((unsigned long)st->foolProofSeconds.load() * 1000000UL);
    pthread_sigmask(SIG_BLOCK, &usr1, nullptr);
    if (!slept) {
        TW_DEBUG(tag, "WaitForFoolProof stopped");
        return nullptr;
    }

    HWND target = HWND_INVALID;
    {
        std::lock_guard<std::mutex> lk(st->lock);
        if (st->generation == generation) {
            st->sleeping = false;
            target = st->hwnd.load();
        }
    }
    TW_DEBUG(tag, "after sleep ,WaitForFoolProof hwnd = %d", (int)(intptr_t)target);
    if (target != HWND_INVALID) SendMessage(target, MSG_TIMER, MMI_TIMER_FOOLPROOF, 0);
    TW_DEBUG(tag, "WaitForFoolProof end");
    return nullptr;
}

int mmi_testwnd_start_foolproof(mmi_testwnd_state *st, int seconds, const char *tag) {
    install_stop_handler();
    std::lock_guard<std::mutex> lk(st->lock);
    st->foolProofSeconds = seconds;
    st->tag = tag;
    st->generation++;
    // The thread starts with SIGUSR1 blocked and opens it only for its sleep.
    sigset_t usr1, old;
    sigemptyset(&usr1);
    sigaddset(&usr1, SIGUSR1);
    pthread_sigmask(SIG_BLOCK, &usr1, &old);
    pthread_t t;
    int rc = pthread_create(&t, nullptr, WaitForFoolProof, st);
    pthread_sigmask(SIG_SETMASK, &old, nullptr);
    if (rc != 0) {
        TW_ERROR(tag, "%s pthread_create fail", __func__);
        return -1;
    }
    pthread_detach(t);
    st->thread = t;
    st->sleeping = true;
    return 0;
}

void mmi_testwnd_stop_foolproof(mmi_testwnd_state *st) {
    std::lock_guard<std::mutex> lk(st->lock);
    if (st->sleeping) pthread_kill(st->thread, SIGUSR1);
    st->sleeping = false;
    st->generation++;
}

void mmi_testwnd_record_pass(int resultIndex, const char *domain) {
    if (g_bAutoTestRunning != 1) return;
    mmi_write_testinfo_single_byte(resultIndex, 1);
    mmi_startNextItemTest(domain);
}

void mmi_testwnd_record_fail(int resultIndex) {
    if (g_bAutoTestRunning == 1) mmi_write_testinfo_single_byte(resultIndex, 2);
    mmi_autotest_end_run("fail");
}

void mmi_testwnd_pass(const mmi_testwnd_desc *d) {
    if (d->run == MMI_TESTWND_RUN_MONOMER) {
        if (g_bMonomerPreviewRunning == 1) mmi_startNextMonomerPreviewItemTest(d->domain);
        return;
    }
    mmi_testwnd_record_pass(d->resultIndex, d->domain);
}

void mmi_testwnd_fail(const mmi_testwnd_desc *d) {
    if (d->run == MMI_TESTWND_RUN_MONOMER) {
        g_bMonomerPreviewRunning = 0;
        return;
    }
    mmi_testwnd_record_fail(d->resultIndex);
}

// ---- the generic window ----

LRESULT mmi_testwnd_proc(HWND hWnd, UINT message, WPARAM wParam, LPARAM lParam) {
    const mmi_testwnd_desc *d = desc_of(hWnd);
    const int w = g_ptScreenInfo.width, h = g_ptScreenInfo.height;
    switch (message) {
        case MSG_CREATE: {
            d = reinterpret_cast<const mmi_testwnd_desc *>(
                reinterpret_cast<PMAINWINCREATE>(lParam)->dwAddData);
            char title[MMI_TESTWND_TEXT_SIZE];
            mmi_translate(d->titleKey, title, sizeof(title));
            HWND ctrl =
                CreateWindowEx(CTRL_STATIC, title, WS_VISIBLE | WS_BORDER | SS_CENTER | SS_NOPREFIX,
                               WS_EX_NONE, MMI_TESTWND_TITLE_ID, 0, 0, w, 0, hWnd, 0);
            if (g_mmiLogFont[1] && ctrl != HWND_INVALID) SetWindowFont(ctrl, g_mmiLogFont[1]);
            if (g_mmiLogFont[3]) SetWindowFont(hWnd, g_mmiLogFont[3]);
            d->state->hwnd = hWnd;
            if (d->start && *d->start) (*d->start)(d->state->mode.load());
            mmi_set_current_test(d->domain);
            mmi_testwnd_start_foolproof(d->state, d->foolProofSeconds, d->domain);
            break;
        }
        case MSG_TIMER:
            mmi_testwnd_show_keys(hWnd, d->titleKey, wParam);
            break;
        case MSG_KEYDOWN:
            if (wParam == MMI_KEY_PASS) {
                TW_DEBUG(d->domain, "%s pass", __func__);
                hw_stop(d);
                tp_os_usleep(100000);
                SendMessage(hWnd, MSG_CLOSE, 0, 0);
                mmi_testwnd_pass(d);
                return 0;
            }
            if (wParam == MMI_KEY_FAIL) {
                hw_stop(d);
                tp_os_usleep(100000);
                mmi_testwnd_fail(d);
                SendMessage(hWnd, MSG_CLOSE, 0, 0);
                return 0;
            }
            break;
        case MSG_FAILANDQUIT:
            hw_stop(d);
            tp_os_usleep(500000);
            mmi_testwnd_fail(d);
            SendMessage(hWnd, MSG_CLOSE, 0, 0);
            return 0;
        case MSG_PAINT: {
            HDC hdc = BeginPaint(hWnd);
            mmi_testwnd_draw_top_line(hdc);
            char note[MMI_TESTWND_NOTE_SIZE] = {0};
            if (d->note) {
                d->note(note, sizeof(note));
            } else {
                mmi_translate(d->noteKey, note, sizeof(note));
            }
            SetTextColor(hdc, SysPixelIndex[kColourText]);
            SetBkMode(hdc, BM_TRANSPARENT);
            RECT rc = {w / 8, w / 15 + 10, (w / 4) * 3 + w / 8, h - (h / 15 + 10)};
            DrawText(hdc, note, -1, &rc, DT_WORDBREAK);
            EndPaint(hWnd, hdc);
            return 0;
        }
        case MSG_CLOSE:
            mmi_set_current_test("");
            mmi_testwnd_stop_foolproof(d->state);
            mmi_testwnd_unregister(hWnd);
            d->state->hwnd = HWND_INVALID;
            DestroyAllControls(hWnd);
            DestroyMainWindow(hWnd);
            return 0;
        default:
            break;
    }
    return DefaultMainWinProc(hWnd, message, wParam, lParam);
}

HWND mmi_testwnd_open(const mmi_testwnd_desc *d, int mode) {
    if (d->bind && d->bind() != 0) {
        TW_ERROR(d->domain, "%s::bind fail, test not opened", __func__);
        return HWND_INVALID;
    }
    d->state->mode = mode;
    HWND hWnd = mmi_testwnd_create(d->caption, mmi_testwnd_proc, reinterpret_cast<DWORD>(d));
    if (hWnd == HWND_INVALID) return hWnd;
    d->state->hwnd = hWnd;
    mmi_testwnd_register_open(hWnd, d->stopEntry);
    ShowWindow(hWnd, SW_SHOWNORMAL);
    // The bars keep a record per shown window: this one's starts with the fail label only.
    tp_skb_set_text_items(hWnd, "", "", "");
    tp_batteryshow_set_text_items(hWnd, "", "", "");
    mmi_testwnd_show_keys(hWnd, d->titleKey, 0);
    return hWnd;
}

int mmi_testwnd_close(const mmi_testwnd_desc *d) {
    d->state->mode = 0;
    HWND hWnd = d->state->hwnd.load();
    // The PC thread closes windows too: the close itself runs on the GUI thread.
    if (hWnd != HWND_INVALID) mmi_RunOnGuiThread(close_window, hWnd);
    hw_stop(d);
    tp_os_usleep((unsigned long)d->stopEntrySleepMs * 1000UL);
    return 1;
}

int mmi_testwnd_pc_start(const mmi_testwnd_desc *d, int mode) {
    Check_AllTestWnd_Closed();
    d->state->mode = mode;
    if (!d->start || !*d->start) return 1;
    TW_DEBUG(d->domain, "%s::%s(%d) begin", __func__, d->startName, mode);
    if ((*d->start)(mode) != 0) {
        TW_DEBUG(d->domain, "%s::%s fail", __func__, d->startName);
        return 0;
    }
    TW_DEBUG(d->domain, "%s::%s end", __func__, d->startName);
    return 1;
}

int mmi_testwnd_pc_stop(const mmi_testwnd_desc *d) {
    if (d->stop && *d->stop) {
        TW_DEBUG(d->domain, "%s::%s begin", __func__, d->stopName);
        if ((*d->stop)() != 0) {
            TW_DEBUG(d->domain, "%s::%s fail", __func__, d->stopName);
            return 0;
        }
        TW_DEBUG(d->domain, "%s::%s end", __func__, d->stopName);
    }
    tp_os_usleep((unsigned long)d->pcStopSleepMs * 1000UL);
    return 1;
}

// ---- the vibrator ----

void *mmi_testwnd_VibratorTestEntry(void) {
    return mmi_testwnd_open(&g_testwndTable[0], 0);
}

int mmi_testwnd_VibratorTest_Stop_Entry(void) {
    return mmi_testwnd_close(&g_testwndTable[0]);
}

int mmi_AutoTest_VibratorTestEntry(int mode) {
    return mmi_testwnd_pc_start(&g_testwndTable[0], mode);
}

int mmi_AutoTest_VibratorTest_Stop_Entry(void) {
    return mmi_testwnd_pc_stop(&g_testwndTable[0]);
}

// ---- the monomer preview's hardware version ----

void *mmi_testwnd_Monomer_HardwareVersionEntry(void) {
    return mmi_testwnd_open(&g_testwndTable[1], 0);
}

int mmi_testwnd_Monomer_HardwareVersion_Stop(void) {
    return mmi_testwnd_close(&g_testwndTable[1]);
}

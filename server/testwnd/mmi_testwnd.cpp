// The test-window framework: the generic window and the helpers every test window uses.
#include "testwnd/mmi_testwnd.h"

#include <errno.h>
#include <signal.h>
#include <stdint.h>
#include <stdlib.h>
#include <string.h>
#include <time.h>

#include <algorithm>
#include <iterator>
#include <vector>

#include <android/log.h>

#include "core/ftx_config.h"
#include "core/mmi_thread_stop.h"
#include "session/mmi_testitem.h"
#include "mmi_bars.h"
#include "minigui/control.h"
#include "mmi_guithread.h"
#include "tp_os.h"
#include "mmi_theme.h"

#define TW_DEBUG(tag, ...) __android_log_print(ANDROID_LOG_DEBUG, tag, __VA_ARGS__)
#define TW_ERROR(tag, ...) __android_log_print(ANDROID_LOG_ERROR, tag, __VA_ARGS__)

namespace {

// Colours of the system pixel table.

std::mutex s_currentLock;
char s_currentTest[MMI_TESTWND_TEXT_SIZE];

struct OpenWindow {
    HWND hwnd;
    int (*stop)(void);
};
std::mutex s_openLock;
std::vector<OpenWindow> s_open;

const mmi_testwnd_desc *desc_of(HWND hWnd) {
    return reinterpret_cast<const mmi_testwnd_desc *>(GetWindowAdditionalData(hWnd));
}

int close_window(void *hWnd) {
    return (int)SendMessage((HWND)hWnd, MSG_CLOSE, 0, 0);
}

void hw_stop(const mmi_testwnd_desc *d) {
    if (d->stop.bound()) (*d->stop.op)();
    if (d->stopWithMode.bound()) (*d->stopWithMode.op)(d->state->mode.load());
}

const char *domain_of(const mmi_testwnd_desc *d) {
    return d->row->domain;
}

const char *title_of(const mmi_testwnd_desc *d) {
    return d->titleKey != nullptr ? d->titleKey : d->row->titleKey;
}

}  // namespace

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
    return mmi_testwnd_close_others(HWND_INVALID);
}

int mmi_testwnd_close_others(HWND keep) {
    int closed = 0;
    for (;;) {
        OpenWindow w;
        {
            std::lock_guard<std::mutex> lk(s_openLock);
            auto it = std::find_if(s_open.rbegin(), s_open.rend(),
                                   [keep](const OpenWindow &o) { return o.hwnd != keep; });
            if (it == s_open.rend()) break;
            w = *it;
            s_open.erase(std::next(it).base());
        }
        TW_DEBUG("FTX_MAIN", "%s close hwnd=%p", "Check_AllTestWnd_Closed", w.hwnd);
        if (w.stop) w.stop();
        closed++;
    }
    // A run waits for a key in its window; with the window gone no pass or fail can come.
    if (closed > 0) mmi_run_windows_closed();
    return closed;
}

// ---- helpers ----

void mmi_testwnd_text_at(HDC hdc, int font, int colour, const char *text, RECT box, UINT format) {
    if (font >= 0 && font < 7 && g_mmiLogFont[font]) SelectFont(hdc, g_mmiLogFont[font]);
    SetTextColor(hdc, mmi_pixel(colour));
    DrawText(hdc, text, -1, &box, format);
}

void mmi_testwnd_key_at(HDC hdc, int font, int colour, const char *key, RECT box, UINT format) {
    char text[MMI_TESTWND_TEXT_SIZE];
    mmi_translate(key, text, sizeof text);
    mmi_testwnd_text_at(hdc, font, colour, text, box, format);
}

void mmi_translate(const char *key, char *out, size_t size) {
    tp_os_strlcpy(out, key, size);
    Read_LangCfgFromList(key, out);
}

namespace {

// A main window hosted by the main window, in rc, on the window background.
HWND create_main(const char *caption, WNDPROC proc, DWORD addData, DWORD style, DWORD exStyle,
                 const RECT &rc) {
    MAINWINCREATE create;
    memset(&create, 0, sizeof(create));
    create.dwStyle = style;
    create.dwExStyle = exStyle;
    create.spCaption = caption;
    create.hHosting = mmi_guithread_window();
    create.MainWindowProc = proc;
    create.lx = rc.left;
    create.ty = rc.top;
    create.rx = rc.right;
    create.by = rc.bottom;
    create.iBkColor = mmi_pixel(MMI_COLOUR_WINDOW);
    create.dwAddData = addData;
    HWND hWnd = CreateMainWindow(&create);
    if (hWnd == HWND_INVALID)
        TW_ERROR("FTX_MAIN", "%s CreateMainWindow %s fail", __func__, caption);
    return hWnd;
}

}  // namespace

HWND mmi_testwnd_create(const char *caption, WNDPROC proc, DWORD addData, DWORD style) {
    RECT rc;
    mmi_testwnd_rect(g_ptScreenInfo.width, g_ptScreenInfo.height, &rc);
    return create_main(caption, proc, addData, style, WS_EX_NONE, rc);
}

HWND mmi_testwnd_create_full(const char *caption, WNDPROC proc, DWORD addData) {
    const RECT screen = {0, 0, g_ptScreenInfo.width, g_ptScreenInfo.height};
    HWND hWnd = create_main(caption, proc, addData, WS_VISIBLE, WS_EX_TOPMOST, screen);
    if (hWnd != HWND_INVALID) ShowWindow(hWnd, SW_SHOWNORMAL);
    return hWnd;
}

void mmi_testwnd_create_title(HWND hWnd, const char *titleKey) {
    char title[MMI_TESTWND_TEXT_SIZE];
    mmi_translate(titleKey, title, sizeof(title));
    HWND ctrl =
        CreateWindowEx(CTRL_STATIC, title, WS_VISIBLE | WS_BORDER | SS_CENTER | SS_NOPREFIX,
                       WS_EX_NONE, MMI_TESTWND_TITLE_ID, 0, 0, g_ptScreenInfo.width, 0, hWnd, 0);
    if (g_mmiLogFont[1] && ctrl != HWND_INVALID) SetWindowFont(ctrl, g_mmiLogFont[1]);
    if (g_mmiLogFont[3]) SetWindowFont(hWnd, g_mmiLogFont[3]);
}

void mmi_testwnd_draw_top_line(HDC hdc) {
    SetPenColor(hdc, mmi_pixel(MMI_COLOUR_PASS));
    SetPenWidth(hdc, 3);
    MoveTo(hdc, 0, 0);
    LineTo(hdc, g_ptScreenInfo.width, 0);
}

int mmi_testwnd_draw_note(HDC hdc, const char *noteKey) {
    const int w = g_ptScreenInfo.width;
    char text[MMI_TESTWND_NOTE_SIZE];
    mmi_translate(noteKey, text, sizeof(text));
    SetTextColor(hdc, mmi_pixel(MMI_COLOUR_TEXT));
    const int top = w / 15 + 10;
    RECT note = {w / 16, top, w - w / 16, top};
    DrawText(hdc, text, -1, &note, DT_WORDBREAK | DT_CALCRECT);  // as many lines as it takes
    note.right = w - w / 16;
    DrawText(hdc, text, -1, &note, DT_WORDBREAK);
    return note.bottom;
}

void mmi_testwnd_draw_rule(HDC hdc, int y) {
    SetPenColor(hdc, mmi_pixel(MMI_COLOUR_FRAME));
    SetPenWidth(hdc, 1);
    MoveTo(hdc, 0, y);
    LineTo(hdc, g_ptScreenInfo.width, y);
}

void mmi_testwnd_draw_row(HDC hdc, int top, int height, const char *label, const char *value,
                          bool passed, int valueRight) {
    const int w = g_ptScreenInfo.width;
    mmi_testwnd_draw_rule(hdc, top);
    SetTextColor(hdc, mmi_pixel(passed ? MMI_COLOUR_PASS : MMI_COLOUR_FAIL));
    RECT l = {w / 16, top, w * 3 / 8, top + height};
    DrawText(hdc, label, -1, &l, DT_LEFT | DT_VCENTER | DT_SINGLELINE);
    RECT v = {w * 3 / 8 + w / 48, top, valueRight, top + height};
    DrawText(hdc, value, -1, &v, DT_LEFT | DT_VCENTER | DT_SINGLELINE);
}

void mmi_testwnd_rect(int w, int h, RECT *out) {
    out->left = 0;
    out->top = w / 15 + 10;
    out->right = w;
    out->bottom = h - (h / 15 + 10);
}

void mmi_testwnd_set_bars(HWND hWnd, const char *titleKey, const char *left, const char *middle,
                          const char *right) {
    tp_skb_set_text_col(MMI_COLOUR_TEXT);
    tp_skb_set_text_items(hWnd, left, middle, right);
    tp_skb_update(hWnd);
    if (titleKey == nullptr) return;
    // The strip keeps a record per window: this one's is made first.
    if (!tp_batteryshow_has_items(hWnd)) tp_batteryshow_set_text_items(hWnd, "", "", "");
    char title[MMI_TESTWND_TEXT_SIZE];
    mmi_translate(titleKey, title, sizeof(title));
    tp_batteryshow_set_text_items_byIndex(hWnd, title, 1);
    tp_batteryshow_update(hWnd);
}

void mmi_testwnd_show_keys(HWND hWnd, const char *titleKey, WPARAM wParam) {
    char pass[MMI_TESTWND_TEXT_SIZE], fail[MMI_TESTWND_TEXT_SIZE];
    mmi_translate("Result_pass", pass, sizeof(pass));
    mmi_translate("Result_fail", fail, sizeof(fail));
    mmi_testwnd_set_bars(hWnd, titleKey, wParam == MMI_TIMER_FOOLPROOF ? pass : "", "", fail);
}

int mmi_testwnd_params(const char *domain, ftx_config_para *out, int max) {
    memset(out, 0, sizeof(ftx_config_para) * (size_t)max);
    const testitem *row = mmi_testitem_main_row(domain);
    if (row == nullptr) return 0;
    char parameter[TESTITEM_TEXT_SIZE] = {0};
    tp_os_strlcpy(parameter, row->parameter, sizeof(parameter));
    return ftx_config_parse_parameter(parameter, out, max);
}

int mmi_testwnd_param_int(const ftx_config_para *p, int n, const char *key, const char *def) {
    char value[FTX_CFG_TEXT_SIZE] = {0};
    ftx_config_get_para_value(p, n, key, value, sizeof(value), def);
    return atoi(value);
}

// ---- windows with their own procedure ----

namespace {

int close_own(void *arg) {
    HWND hWnd = static_cast<mmi_ownwnd_state *>(arg)->hwnd.load();
    if (hWnd != HWND_INVALID) SendMessage(hWnd, MSG_CLOSE, 0, 0);
    return 1;
}

struct OwnOpen {
    void (*open)(const void *ctx);
    const void *ctx;
};

int open_own(void *arg) {
    const OwnOpen *o = static_cast<const OwnOpen *>(arg);
    o->open(o->ctx);
    return 1;
}

// The forms without a context: the plain function travels as the context.
void open_plain(const void *ctx) {
    reinterpret_cast<void *(*)(void)>(const_cast<void *>(ctx))();
}

int verdict_plain(const void *ctx, char *reply, unsigned int size) {
    return reinterpret_cast<int (*)(char *, unsigned int)>(const_cast<void *>(ctx))(reply, size);
}

struct OwnStop {
    mmi_ownwnd_state *st;
    int (*verdict)(const void *, char *, unsigned int);
    const void *ctx;
    char *reply;
    unsigned int size;
};

int stop_own(void *arg) {
    OwnStop *o = static_cast<OwnStop *>(arg);
    HWND hWnd = o->st->hwnd.load();
    if (hWnd == HWND_INVALID) return -1;
    const int verdict = o->verdict(o->ctx, o->reply, o->size);
    SendMessage(hWnd, MSG_CLOSE, 0, 0);
    return verdict;
}

}  // namespace

int mmi_ownwnd_pc_open(mmi_ownwnd_state *st, void *(*open)(void)) {
    return mmi_ownwnd_pc_open(st, open_plain, reinterpret_cast<const void *>(open));
}

int mmi_ownwnd_pc_open(mmi_ownwnd_state *st, void (*open)(const void *ctx), const void *ctx) {
    Check_AllTestWnd_Closed();
    st->pcDriven = 0;
    if (st->hwnd.load() == HWND_INVALID) {
        OwnOpen o{open, ctx};
        mmi_RunOnGuiThread(open_own, &o);
        for (int i = 0; !st->created.load(); i++) {
            if (i == 30) return 1;
            tp_os_usleep(100000);
        }
    }
    st->pcDriven = 1;
    HWND hWnd = st->hwnd.load();
    if (hWnd == HWND_INVALID) return 1;
    if (!st->activated.load()) {
        SendMessage(hWnd, MSG_ACTIVE, 1, 0);
        tp_os_usleep(10000);
    }
    if (!st->painted.load()) {
        SendMessage(hWnd, MSG_PAINT, 0, 0);
        tp_os_usleep(10000);
    }
    return 1;
}

int mmi_ownwnd_pc_stop(mmi_ownwnd_state *st, int (*verdict)(char *reply, unsigned int size),
                       char *reply, unsigned int size) {
    return mmi_ownwnd_pc_stop(st, verdict_plain, reinterpret_cast<const void *>(verdict), reply,
                              size);
}

int mmi_ownwnd_pc_stop(mmi_ownwnd_state *st,
                       int (*verdict)(const void *ctx, char *reply, unsigned int size),
                       const void *ctx, char *reply, unsigned int size) {
    OwnStop o{st, verdict, ctx, reply, size};
    const int answer = mmi_RunOnGuiThread(stop_own, &o);
    if (answer >= 0) tp_os_usleep(100000);
    return answer;
}

void mmi_ownwnd_created(mmi_ownwnd_state *st, HWND hWnd, const char *tag) {
    mmi_set_current_test(tag);
    st->hwnd = hWnd;
    st->created = 1;
}

void mmi_ownwnd_destroy(mmi_ownwnd_state *st, HWND hWnd) {
    mmi_set_current_test("");
    st->created = 0;
    st->pcDriven = 0;
    st->activated = 0;
    st->painted = 0;
    mmi_testwnd_unregister(hWnd);
    st->hwnd = HWND_INVALID;
    DestroyAllControls(hWnd);
    DestroyMainWindow(hWnd);
}

bool mmi_ownwnd_refuses(mmi_ownwnd_state *st, UINT message, const char *tag) {
    std::atomic<int> &seen = message == MSG_ACTIVE ? st->activated : st->painted;
    if (st->pcDriven.load() && !st->created.load()) {
        seen = 0;
        TW_DEBUG(tag, "%s::%s g_currentwndCreated=0", __func__,
                 message == MSG_ACTIVE ? "MSG_ACTIVE" : "MSG_PAINT");
        return true;
    }
    seen = 1;
    return false;
}

void mmi_ownwnd_close(mmi_ownwnd_state *st) {
    mmi_RunOnGuiThread(close_own, st);
}

HWND mmi_ownwnd_opened(mmi_ownwnd_state *st, HWND hWnd, int (*stop)(void)) {
    if (hWnd == HWND_INVALID) return hWnd;
    st->hwnd = hWnd;
    mmi_testwnd_register_open(hWnd, stop);
    ShowWindow(hWnd, SW_SHOWNORMAL);
    return hWnd;
}

int mmi_ownwnd_stop(mmi_ownwnd_state *st) {
    mmi_ownwnd_close(st);
    tp_os_usleep(100000);
    return 1;
}

void *WaitForFoolProof(void *arg) {
    mmi_testwnd_state *st = static_cast<mmi_testwnd_state *>(arg);
    const unsigned generation = st->generation.load();
    const char *tag = st->tag.load();
    mmi_thread_stop_install();
    TW_DEBUG(tag, "WaitForFoolProof begin.hwnd = %d", (int)(intptr_t)st->hwnd.load());
    // SIGUSR1 reaches the thread only while it sleeps: never while it holds a lock (another
    // part's handler in force may end the thread outright).
    sigset_t usr1;
    sigemptyset(&usr1);
    sigaddset(&usr1, SIGUSR1);
    pthread_sigmask(SIG_UNBLOCK, &usr1, nullptr);
    bool slept = mmi_sleep_unless_stopped((unsigned long)st->foolProofSeconds.load() * 1000000UL);
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
    mmi_thread_stop_install();
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
    mmi_run_pass(MMI_RUN_AUTO, resultIndex, domain);
}

void mmi_testwnd_record_fail(int resultIndex) {
    mmi_run_fail(MMI_RUN_AUTO, resultIndex);
}

void mmi_testwnd_pass_and_close(HWND hWnd, int resultIndex, const char *domain) {
    SendMessage(hWnd, MSG_CLOSE, 0, 0);
    mmi_testwnd_record_pass(resultIndex, domain);
}

void mmi_testwnd_fail_and_close(HWND hWnd, int resultIndex) {
    mmi_testwnd_record_fail(resultIndex);
    SendMessage(hWnd, MSG_CLOSE, 0, 0);
}

void mmi_testwnd_pass(const mmi_testwnd_desc *d) {
    mmi_run_pass(d->run, d->row->resultIndex, domain_of(d));
}

void mmi_testwnd_fail(const mmi_testwnd_desc *d) {
    mmi_run_fail(d->run, d->row->resultIndex);
}

// ---- the generic window ----

LRESULT mmi_testwnd_proc(HWND hWnd, UINT message, WPARAM wParam, LPARAM lParam) {
    const mmi_testwnd_desc *d = desc_of(hWnd);
    const int w = g_ptScreenInfo.width, h = g_ptScreenInfo.height;
    if (d != nullptr && d->hook && message != MSG_CREATE && d->hook(hWnd, message, wParam, lParam))
        return 0;
    switch (message) {
        case MSG_CREATE: {
            d = reinterpret_cast<const mmi_testwnd_desc *>(
                reinterpret_cast<PMAINWINCREATE>(lParam)->dwAddData);
            mmi_testwnd_create_title(hWnd, title_of(d));
            d->state->hwnd = hWnd;
            if (d->start.bound()) (*d->start.op)(d->state->mode.load());
            mmi_set_current_test(domain_of(d));
            if (d->hook) d->hook(hWnd, message, wParam, lParam);
            break;
        }
        case MSG_TIMER:
            mmi_testwnd_show_keys(hWnd, title_of(d), d->passReady && !d->passReady() ? 0 : wParam);
            break;
        case MSG_KEYDOWN:
            if (wParam == MMI_KEY_PASS && d->passReady && !d->passReady()) return 0;
            if (wParam == MMI_KEY_PASS) {
                TW_DEBUG(domain_of(d), "%s pass", __func__);
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
            SetTextColor(hdc, mmi_pixel(MMI_COLOUR_TEXT));
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
        TW_ERROR(domain_of(d), "%s::bind fail, test not opened", __func__);
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
    mmi_testwnd_show_keys(hWnd, title_of(d), 0);
    // The delay starts once the fail label is up, so the pass label can only come after it
    // (a short delay's message could otherwise be handled first and then be overwritten).
    mmi_testwnd_start_foolproof(d->state, d->foolProofSeconds, domain_of(d));
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
    if (!d->start.bound()) return 1;
    TW_DEBUG(domain_of(d), "%s::%s(%d) begin", __func__, d->start.name, mode);
    if ((*d->start.op)(mode) != 0) {
        TW_DEBUG(domain_of(d), "%s::%s fail", __func__, d->start.name);
        return 0;
    }
    TW_DEBUG(domain_of(d), "%s::%s end", __func__, d->start.name);
    return 1;
}

int mmi_testwnd_pc_stop(const mmi_testwnd_desc *d) {
    if (d->stop.bound()) {
        TW_DEBUG(domain_of(d), "%s::%s begin", __func__, d->stop.name);
        if ((*d->stop.op)() != 0) {
            TW_DEBUG(domain_of(d), "%s::%s fail", __func__, d->stop.name);
            return 0;
        }
        TW_DEBUG(domain_of(d), "%s::%s end", __func__, d->stop.name);
    }
    tp_os_usleep((unsigned long)d->pcStopSleepMs * 1000UL);
    return 1;
}

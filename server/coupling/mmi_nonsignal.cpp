// The non-signalling window: the library opened and bound on entry, a worker that steps the
// modem's RF test mode through every enabled technology's bands and channels, the window
// that draws the worker's progress as it goes, and a close that stops the worker (it turns
// the transmitter off and leaves the test mode) before the library is closed.
#include "coupling/mmi_nonsignal.h"

#include <pthread.h>
#include <signal.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>

#include <android/log.h>

#include <atomic>
#include <mutex>

#include "core/ftx_config.h"
#include "core/ftx_lib_binding.h"
#include "core/mmi_thread_stop.h"
#include "coupling/mmi_nonsignal_plan.h"
#include "hw/lib_dvk_nonsignal.h"
#include "mmi_guithread.h"
#include "mmi_theme.h"
#include "session/mmi_testinfo.h"
#include "testwnd/mmi_key_table.h"
#include "testwnd/mmi_testwnd.h"
#include "tp_os.h"

#define NS_DEBUG(...) __android_log_print(ANDROID_LOG_DEBUG, NONSIGNAL_TAG, __VA_ARGS__)
#define NS_ERROR(...) __android_log_print(ANDROID_LOG_ERROR, NONSIGNAL_TAG, __VA_ARGS__)

namespace {

// ---- the library ----

std::atomic<void *> s_lib{nullptr};
ftx_hw_op<decltype(&::FTX_API_NonSignal_open)> s_open;
ftx_hw_op<decltype(&::FTX_API_NonSignal_close)> s_close;
ftx_hw_op<decltype(&::FTX_API_NonSignal_setTech)> s_setTech;
ftx_hw_op<decltype(&::FTX_API_NonSignal_setBand)> s_setBand;
ftx_hw_op<decltype(&::FTX_API_NonSignal_setChannel)> s_setChannel;
ftx_hw_op<decltype(&::FTX_API_NonSignal_txOn)> s_txOn;
ftx_hw_op<decltype(&::FTX_API_NonSignal_txOff)> s_txOff;
ftx_hw_op<decltype(&::FTX_API_NonSignal_getRxLevel)> s_getRxLevel;

// The operations in the order they are looked up.
enum Op { OP_OPEN, OP_CLOSE, OP_TECH, OP_BAND, OP_CHANNEL, OP_TXON, OP_TXOFF, OP_LEVEL, OPS };
const ftx_own_op kOps[OPS] = {
    {"FTX_API_NonSignal_open", &s_open},
    {"FTX_API_NonSignal_close", &s_close},
    {"FTX_API_NonSignal_setTech", &s_setTech},
    {"FTX_API_NonSignal_setBand", &s_setBand},
    {"FTX_API_NonSignal_setChannel", &s_setChannel},
    {"FTX_API_NonSignal_txOn", &s_txOn},
    {"FTX_API_NonSignal_txOff", &s_txOff},
    {"FTX_API_NonSignal_getRxLevel", &s_getRxLevel},
};
// How a failing operation is shown: its name without the common prefix.
const char *short_name(int op) {
    return kOps[op].name + sizeof "FTX_API_NonSignal_" - 1;
}

void close_library(void) {
    if (s_lib.load() == nullptr) return;
    ftx_own_library_close(&s_lib, kOps, OPS);
    NS_DEBUG("%s closed", NONSIGNAL_LIB);
}

int open_library(void) {
    return ftx_own_library_open(&s_lib, NONSIGNAL_LIB, NONSIGNAL_TAG, kOps, OPS);
}

// ---- the run's state: written by the worker under s_lock, drawn by the window ----

enum State { WAITING, RUNNING, PASSED, FAILED, STOPPED };

// Why a step or a technology failed.
enum Reason { R_NONE, R_BELOW, R_ABOVE, R_CALL, R_SETTINGS, R_TESTMODE };

struct StepResult {
    State state = WAITING;
    Reason reason = R_NONE;
    bool hasLevel = false;
    int level = 0;
    int op = 0, rc = 0;  // the failing call
};

struct TechResult {
    State state = WAITING;
    Reason reason = R_NONE;
    int op = 0, rc = 0;
    StepResult steps[MMI_NS_MAX_STEPS];
};

struct Progress {
    int tech = -1, step = -1;  // in progress, -1 for none
    bool hasLevel = false;     // the step in progress has read its level
    int level = 0;
    bool finished = false;
    State overall = WAITING;
    TechResult techs[MMI_NS_TECHS];
};

// The settings: written on the GUI thread before the worker starts, only read after.
mmi_ns_plan s_plans[MMI_NS_TECHS];
std::mutex s_lock;
Progress s_progress;
std::atomic<bool> s_stop{false};
// The worker (GUI thread only: started in MSG_CREATE, joined in MSG_CLOSE).
pthread_t s_worker;
bool s_workerStarted = false;
mmi_ownwnd_state s_wnd;

void changed(void) {
    const HWND hWnd = s_wnd.hwnd.load();
    if (hWnd != HWND_INVALID) PostMessage(hWnd, MSG_CALLBACK, 0, 0);
}

template <typename F>
void update(F f) {
    {
        std::lock_guard<std::mutex> lk(s_lock);
        f(s_progress);
    }
    changed();
}

bool stopping(void) {
    return s_stop.load() || mmi_thread_stop_requested();
}

// A library call, logged with its step.
int logged(int op, int rc, const char *tech, const mmi_ns_step *s) {
    if (s != nullptr)
        NS_DEBUG("%s band %d channel %d: %s ret=%d", tech, s->band, s->channel, kOps[op].name, rc);
    else
        NS_DEBUG("%s: %s ret=%d", tech, kOps[op].name, rc);
    return rc;
}

// One step: band (when it changed), channel, transmitter on, the settle time, the reading,
// transmitter off. Returns the step's state.
State run_step(int t, int i, int *bandSet) {
    const mmi_ns_tech &tech = kMmiNsTechs[t];
    const mmi_ns_plan &plan = s_plans[t];
    const mmi_ns_step &s = plan.steps[i];
    StepResult r;
    r.state = FAILED;
    r.reason = R_CALL;
    // Each call unless a stop came first; a stop leaves the step unjudged.
    auto call = [&](int op, auto fn) {
        if (stopping()) {
            r.state = STOPPED;
            return false;
        }
        r.op = op;
        r.rc = logged(op, fn(), tech.name, &s);
        return r.rc == 0;
    };
    bool ok = true;
    if (*bandSet != s.band) {
        ok = call(OP_BAND, [&] { return s_setBand(s.band); });
        *bandSet = ok ? s.band : -1;
    }
    ok = ok && call(OP_CHANNEL, [&] { return s_setChannel(s.channel); }) &&
         call(OP_TXON, [&] { return s_txOn(plan.power); });
    if (ok) {
        // SIGUSR1 cuts the settle time short; it stays blocked everywhere else.
        sigset_t usr1;
        sigemptyset(&usr1);
        sigaddset(&usr1, SIGUSR1);
        pthread_sigmask(SIG_UNBLOCK, &usr1, nullptr);
        mmi_sleep_unless_stopped((unsigned long)plan.settleMs * 1000UL);
        pthread_sigmask(SIG_BLOCK, &usr1, nullptr);
        int level = 0;
        const bool read = call(OP_LEVEL, [&] { return s_getRxLevel(&level); });
        if (read)
            update([&](Progress &p) {
                p.hasLevel = true;
                p.level = level;
            });
        // The transmitter goes off whatever happened, a stop included.
        const int offRc = logged(OP_TXOFF, s_txOff(), tech.name, &s);
        if (read) {
            r.hasLevel = true;
            r.level = level;
            const bool passes = mmi_ns_level_passes(plan, level);
            r.state = passes ? PASSED : FAILED;
            r.reason = passes ? R_NONE : level < plan.min ? R_BELOW : R_ABOVE;
            if (passes && offRc != 0) {
                r.state = FAILED;
                r.reason = R_CALL;
                r.op = OP_TXOFF;
                r.rc = offRc;
            }
        }
    }
    char level[16];
    mmi_ns_format_dbm(r.level, level, sizeof level);
    NS_DEBUG("%s band %d channel %d: %s%s%s", tech.name, s.band, s.channel,
             r.state == PASSED    ? "pass"
             : r.state == STOPPED ? "stopped"
                                  : "fail",
             r.hasLevel ? " level " : "", r.hasLevel ? level : "");
    update([&](Progress &p) { p.techs[t].steps[i] = r; });
    return r.state;
}

// A technology's verdict; a failure of the whole technology (its settings, the test mode,
// the technology's own setting) also fails each of its steps with the same reason.
void set_verdict(TechResult &r, const mmi_ns_plan &plan, State state, Reason reason, int op,
                 int rc) {
    r.state = state;
    r.reason = reason;
    r.op = op;
    r.rc = rc;
    if (reason != R_CALL && reason != R_TESTMODE) return;
    for (int i = 0; i < plan.stepCount; i++) {
        StepResult &s = r.steps[i];
        s.state = FAILED;
        s.reason = reason;
        s.op = op;
        s.rc = rc;
    }
}

// One technology: its settings, the technology set, its steps; the verdict recorded.
void run_tech(int t) {
    const mmi_ns_tech &tech = kMmiNsTechs[t];
    const mmi_ns_plan &plan = s_plans[t];
    update([&](Progress &p) {
        p.tech = t;
        p.step = -1;
        p.techs[t].state = RUNNING;
    });
    TechResult verdict;
    verdict.state = PASSED;
    if (!plan.valid) {
        NS_ERROR("%s: settings not usable: %s", tech.name, plan.reason);
        verdict.state = FAILED;
        verdict.reason = R_SETTINGS;
    } else if (const int rc = logged(OP_TECH, s_setTech(tech.libTech), tech.name, nullptr)) {
        verdict.state = FAILED;
        verdict.reason = R_CALL;
        verdict.op = OP_TECH;
        verdict.rc = rc;
    } else {
        int bandSet = -1;  // none yet
        for (int i = 0; i < plan.stepCount; i++) {
            if (stopping()) {
                verdict.state = STOPPED;
                break;
            }
            update([&](Progress &p) {
                p.step = i;
                p.hasLevel = false;
                p.techs[t].steps[i].state = RUNNING;
            });
            const State s = run_step(t, i, &bandSet);
            if (s == STOPPED) verdict.state = STOPPED;
            if (s == FAILED && verdict.state == PASSED) verdict.state = FAILED;
            if (s == STOPPED) break;
        }
    }
    update([&](Progress &p) {
        set_verdict(p.techs[t], plan, verdict.state, verdict.reason, verdict.op, verdict.rc);
        p.step = -1;
    });
    if (verdict.state == STOPPED) return;
    const int result = verdict.state == PASSED ? 1 : 2;
    NS_DEBUG("%s: %s, item %d (%s) = %d", tech.name, result == 1 ? "PASS" : "FAIL", tech.resultItem,
             tech.resultLabel, result);
    mmi_write_testinfo_single_byte(tech.resultItem, result);
}

void *worker(void *) {
    NS_DEBUG("worker begin");
    const int rc = logged(OP_OPEN, s_open(), "test mode", nullptr);
    bool stopped = false;
    for (int t = 0; t < MMI_NS_TECHS; t++) {
        if (!s_plans[t].enabled) continue;
        if (stopping()) {
            stopped = true;
            break;
        }
        if (rc == 0) {
            run_tech(t);
            continue;
        }
        // Without the test mode nothing can be measured: every technology fails.
        update([&](Progress &p) {
            set_verdict(p.techs[t], s_plans[t], FAILED, R_TESTMODE, OP_OPEN, rc);
        });
        mmi_write_testinfo_single_byte(kMmiNsTechs[t].resultItem, 2);
    }
    if (rc == 0) logged(OP_CLOSE, s_close(), "test mode", nullptr);
    State overall = PASSED;
    update([&](Progress &p) {
        for (int t = 0; t < MMI_NS_TECHS; t++) {
            if (!s_plans[t].enabled) continue;
            const State s = p.techs[t].state;
            if (s == FAILED) overall = FAILED;
            if ((s == STOPPED || s == WAITING) && overall == PASSED) overall = STOPPED;
        }
        if (stopped && overall == PASSED) overall = STOPPED;
        p.overall = overall;
        p.tech = -1;
        p.finished = true;
    });
    NS_DEBUG("run finished: %s", overall == PASSED   ? "PASS"
                                 : overall == FAILED ? "FAIL"
                                                     : "stopped");
    return nullptr;
}

void start_worker(void) {
    s_stop = false;
    mmi_thread_stop_install();
    // The worker starts with SIGUSR1 blocked and opens it only for its settle times.
    sigset_t usr1, old;
    sigemptyset(&usr1);
    sigaddset(&usr1, SIGUSR1);
    pthread_sigmask(SIG_BLOCK, &usr1, &old);
    s_workerStarted = pthread_create(&s_worker, nullptr, worker, nullptr) == 0;
    pthread_sigmask(SIG_SETMASK, &old, nullptr);
    if (!s_workerStarted) NS_ERROR("pthread_create fail");
}

void stop_worker(void) {
    if (!s_workerStarted) return;
    s_stop = true;
    pthread_kill(s_worker, SIGUSR1);
    pthread_join(s_worker, nullptr);
    s_workerStarted = false;
    NS_DEBUG("worker stopped");
}

// ---- the window ----

constexpr int kFont = 3;

struct Layout {
    int line;       // one row
    RECT current;   // the step in progress, or the overall verdict
    int listTop;    // the first row of the list
    int valueLeft;  // where a row's value begins
};

Layout layout_for(int w) {
    Layout l;
    l.line = mmi_logfont_size(kFont, w) * 3 / 2;
    const int margin = w / 24;
    l.current = {margin, l.line / 2, w - margin, l.line / 2 + l.line * 2};
    l.listTop = l.current.bottom + l.line / 2;
    l.valueLeft = w * 15 / 32;
    return l;
}

const char *tr(const char *key, char *out, size_t size) {
    mmi_translate(key, out, size);
    return out;
}

// The text of a failure: a call with its answer, the settings' reason, a level off limits.
void reason_text(Reason reason, int op, int rc, int level, const mmi_ns_plan &plan, char *out,
                 size_t size) {
    char word[MMI_TESTWND_TEXT_SIZE], a[16], b[16];
    switch (reason) {
        case R_BELOW:
        case R_ABOVE:
            mmi_ns_format_dbm(level, a, sizeof a);
            mmi_ns_format_dbm(reason == R_BELOW ? plan.min : plan.max, b, sizeof b);
            snprintf(out, size, "%s dBm %s %s", a, reason == R_BELOW ? "<" : ">", b);
            return;
        case R_CALL:
            snprintf(out, size, "%s %s %d", short_name(op), tr("ns_CallFailed", word, sizeof word),
                     rc);
            return;
        case R_SETTINGS:
            snprintf(out, size, "%s %s", tr("ns_BadSettings", word, sizeof word), plan.reason);
            return;
        case R_TESTMODE:
            snprintf(out, size, "%s (%d)", tr("ns_NoTestMode", word, sizeof word), rc);
            return;
        case R_NONE:
            break;
    }
    out[0] = '\0';
}

int state_colour(State s) {
    return s == PASSED ? MMI_COLOUR_PASS : s == FAILED ? MMI_COLOUR_FAIL : MMI_COLOUR_TEXT;
}

// A limit as short as it reads: whole dBm without the tenths (the row's room is narrow).
void compact_dbm(int tenths, char *out, size_t size) {
    if (tenths % 10 == 0)
        snprintf(out, size, "%d", tenths / 10);
    else
        mmi_ns_format_dbm(tenths, out, size);
}

const char *const kStateKeys[] = {"ns_Waiting", "ns_Testing", "ns_Pass", "ns_Fail", "ns_Stopped"};

void draw_row(HDC hdc, const Layout &l, int top, int indent, const char *label, const char *value,
              int colour) {
    const int w = g_ptScreenInfo.width;
    mmi_testwnd_draw_rule(hdc, top);
    const UINT f = DT_LEFT | DT_VCENTER | DT_SINGLELINE;
    mmi_testwnd_text_at(hdc, kFont, colour, label,
                        {w / 24 + indent, top, l.valueLeft, top + l.line}, f);
    mmi_testwnd_text_at(hdc, kFont, colour, value, {l.valueLeft, top, w - w / 48, top + l.line}, f);
}

// The step in progress, or the overall verdict on a band of its colour once the run ended.
void draw_current(HDC hdc, const Layout &l, const Progress &p) {
    char text[MMI_TESTWND_TEXT_SIZE * 4], word[MMI_TESTWND_TEXT_SIZE];
    const UINT centred = DT_CENTER | DT_VCENTER | DT_SINGLELINE;
    if (p.finished) {
        const int colour = p.overall == PASSED   ? MMI_COLOUR_PASS
                           : p.overall == FAILED ? MMI_COLOUR_FAIL
                                                 : MMI_COLOUR_GRAY;
        SetBrushColor(hdc, mmi_pixel(colour));
        FillBox(hdc, l.current.left, l.current.top, RECTW(l.current), RECTH(l.current));
        mmi_testwnd_key_at(hdc, 1, MMI_COLOUR_WINDOW, kStateKeys[p.overall], l.current, centred);
        return;
    }
    if (p.tech < 0 || p.step < 0) {
        mmi_testwnd_key_at(hdc, kFont, MMI_COLOUR_TEXT, "ns_Testing", l.current, centred);
        return;
    }
    const mmi_ns_plan &plan = s_plans[p.tech];
    const mmi_ns_step &s = plan.steps[p.step];
    char band[MMI_TESTWND_TEXT_SIZE], channel[MMI_TESTWND_TEXT_SIZE], power[16];
    mmi_ns_format_dbm(plan.power, power, sizeof power);
    tr("ns_Band", band, sizeof band);
    tr("ns_Channel", channel, sizeof channel);
    tr("ns_Tx", word, sizeof word);
    // Two lines that fit the narrowest screen: where, then what is sent and what comes back.
    snprintf(text, sizeof text, "%s  %s %d  %s %d", kMmiNsTechs[p.tech].name, band, s.band, channel,
             s.channel);
    RECT top = l.current, bottom = l.current;
    top.bottom = top.top + l.line;
    bottom.top = top.bottom;
    mmi_testwnd_text_at(hdc, kFont, MMI_COLOUR_TEXT, text, top, centred);
    char rx[MMI_TESTWND_TEXT_SIZE], level[MMI_TESTWND_TEXT_SIZE];
    if (p.hasLevel) {
        char dbm[16];
        mmi_ns_format_dbm(p.level, dbm, sizeof dbm);
        snprintf(level, sizeof level, "%s dBm", dbm);
    } else {
        tr("ns_Measuring", level, sizeof level);
    }
    snprintf(text, sizeof text, "%s %s dBm  %s %s", word, power, tr("ns_Rx", rx, sizeof rx), level);
    mmi_testwnd_text_at(hdc, kFont, MMI_COLOUR_TEXT, text, bottom, centred);
}

void paint(HWND hWnd) {
    Progress p;
    {
        std::lock_guard<std::mutex> lk(s_lock);
        p = s_progress;
    }
    const Layout l = layout_for(g_ptScreenInfo.width);
    HDC hdc = BeginPaint(hWnd);
    SetBkMode(hdc, BM_TRANSPARENT);
    mmi_testwnd_draw_top_line(hdc);
    draw_current(hdc, l, p);
    char label[MMI_TESTWND_TEXT_SIZE * 3], value[MMI_TESTWND_TEXT_SIZE * 2],
        word[MMI_TESTWND_TEXT_SIZE];
    int top = l.listTop;
    for (int t = 0; t < MMI_NS_TECHS; t++) {
        const mmi_ns_plan &plan = s_plans[t];
        if (!plan.enabled) continue;
        const TechResult &tr_ = p.techs[t];
        char limits[64], lo[16], hi[16];
        compact_dbm(plan.min, lo, sizeof lo);
        compact_dbm(plan.max, hi, sizeof hi);
        snprintf(limits, sizeof limits, "%s..%s", lo, hi);
        if (tr_.reason != R_NONE)
            reason_text(tr_.reason, tr_.op, tr_.rc, 0, plan, value, sizeof value);
        else
            snprintf(value, sizeof value, "%s %s", tr(kStateKeys[tr_.state], word, sizeof word),
                     plan.valid ? limits : "");
        draw_row(hdc, l, top, 0, kMmiNsTechs[t].name, value, state_colour(tr_.state));
        top += l.line;
        for (int i = 0; i < plan.stepCount && plan.valid; i++) {
            const StepResult &r = tr_.steps[i];
            char band[MMI_TESTWND_TEXT_SIZE];
            tr("ns_Band", band, sizeof band);
            snprintf(label, sizeof label, "%s %d / %d", band, plan.steps[i].band,
                     plan.steps[i].channel);
            if (r.state == FAILED) {
                reason_text(r.reason, r.op, r.rc, r.level, plan, value, sizeof value);
            } else if (r.hasLevel) {
                char dbm[16];
                mmi_ns_format_dbm(r.level, dbm, sizeof dbm);
                snprintf(value, sizeof value, "%s dBm", dbm);
            } else {
                tr(kStateKeys[r.state], value, sizeof value);
            }
            draw_row(hdc, l, top, l.line / 2, label, value, state_colour(r.state));
            top += l.line;
        }
    }
    mmi_testwnd_draw_rule(hdc, top);
    EndPaint(hWnd, hdc);
}

bool is_back(WPARAM key) {
    return key == MMI_KEY_FAIL || key == Get_Keytest_item_key_value("BACK");
}

LRESULT nonsignal_proc(HWND hWnd, UINT message, WPARAM wParam, LPARAM lParam) {
    switch (message) {
        case MSG_CREATE:
            if (g_mmiLogFont[kFont]) SetWindowFont(hWnd, g_mmiLogFont[kFont]);
            mmi_ownwnd_created(&s_wnd, hWnd, NONSIGNAL_TAG);
            s_wnd.hwnd = hWnd;
            start_worker();
            break;
        case MSG_ACTIVE:
            if (wParam == 1) {
                char back[MMI_TESTWND_TEXT_SIZE];
                mmi_translate("softkeybar_back", back, sizeof back);
                mmi_testwnd_set_bars(hWnd, "title_NonSignal", "", "", back);
            }
            break;
        case MSG_PAINT:
            paint(hWnd);
            return 0;
        case MSG_CALLBACK:
            InvalidateRect(hWnd, nullptr, TRUE);
            return 0;
        case MSG_KEYDOWN:
            if (is_back(wParam)) {
                NS_DEBUG("back key: leaving");
                SendMessage(hWnd, MSG_CLOSE, 0, 0);
            }
            return 0;
        case MSG_CLOSE:
            stop_worker();
            close_library();
            mmi_ownwnd_destroy(&s_wnd, hWnd);
            NS_DEBUG("window closed");
            return 0;
        default:
            break;
    }
    return DefaultMainWinProc(hWnd, message, wParam, lParam);
}

// The settings of every technology; the number enabled.
int read_plans(void) {
    int enabled = 0;
    for (int t = 0; t < MMI_NS_TECHS; t++) {
        char value[FTX_CFG_TEXT_SIZE] = "";
        Read_MainCfgFile(NONSIGNAL_TAG, kMmiNsTechs[t].key, value, "");
        mmi_ns_parse_plan(kMmiNsTechs[t], value, &s_plans[t]);
        if (!s_plans[t].enabled) continue;
        enabled++;
        NS_DEBUG("%s: %d step(s), power %d, limits %d..%d (tenths of a dBm), settle %d ms%s%s",
                 kMmiNsTechs[t].name, s_plans[t].stepCount, s_plans[t].power, s_plans[t].min,
                 s_plans[t].max, s_plans[t].settleMs,
                 s_plans[t].valid ? "" : ", unusable: ", s_plans[t].reason);
    }
    return enabled;
}

int open_window(void *) {
    HWND hWnd = mmi_testwnd_create("Non-signalling Coupling", nonsignal_proc, 0);
    return mmi_ownwnd_opened(&s_wnd, hWnd, mmi_NonSignalTest_Stop) != HWND_INVALID ? 0 : -1;
}

}  // namespace

int mmi_nonsignal_enabled(void) {
    char value[FTX_CFG_TEXT_SIZE] = "";
    Read_MainCfgFile(NONSIGNAL_TAG, "enable", value, "0");
    return atoi(value) == 1 ? 1 : 0;
}

int mmi_NonSignalTestEntry(void) {
    NS_DEBUG("%s begin", __func__);
    if (s_wnd.hwnd.load() != HWND_INVALID) {
        NS_DEBUG("%s the window is open already", __func__);
        return 0;
    }
    if (read_plans() == 0) {
        NS_ERROR("%s no technology is enabled, test not opened", __func__);
        return -1;
    }
    if (open_library() != 0) return -1;
    {
        std::lock_guard<std::mutex> lk(s_lock);
        s_progress = Progress{};
    }
    if (mmi_RunOnGuiThread(open_window, nullptr) != 0) {
        NS_ERROR("%s create the window fail", __func__);
        close_library();
        return -1;
    }
    NS_DEBUG("%s the window is open", __func__);
    return 0;
}

int mmi_NonSignalTest_Stop(void) {
    return mmi_ownwnd_stop(&s_wnd);
}

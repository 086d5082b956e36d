// The aging window: a full-screen view of what the run publishes, repainted part by part
// once a second, a moving test pattern over the whole screen while the video item runs, and
// the back key pressed twice to stop the run.
#include "AgingTest/mmi_aging_window.h"

#include <stdio.h>
#include <string.h>

#include <atomic>
#include <chrono>

#include <android/log.h>

#include "core/mmi_power.h"
#include "mmi_guithread.h"
#include "mmi_theme.h"
#include "session/mmi_runstate.h"
#include "testwnd/mmi_testwnd.h"
#include "tp_os.h"

#define AGING_TAG "AgingTest"
#define AGING_LOG(...) __android_log_print(ANDROID_LOG_INFO, AGING_TAG, __VA_ARGS__)
#define AGING_ERROR(...) __android_log_print(ANDROID_LOG_ERROR, AGING_TAG, __VA_ARGS__)

namespace {

constexpr int kViewTimer = 1;  // takes the run's view
// Timer periods in 10 ms ticks (scaled like every wait).
constexpr int kViewPeriod = 100;
constexpr int kVideoPeriod = 10;
// The operator's time for the second back press: real seconds, whatever the clock's scale.
constexpr std::chrono::seconds kStopWindow{3};

std::atomic<HWND> s_window{HWND_INVALID};
// Set when the run ended: the close then opens the result list.
std::atomic<int> s_result{0};

// GUI thread only.
mmi_aging_view s_shown;    // what the window shows
bool s_stopArmed = false;  // the back key was pressed once, at s_stopArmedAt
std::chrono::steady_clock::time_point s_stopArmedAt;
bool s_closing = false;
long long s_frame = 0;  // of the test pattern

// ---- layout ----

// Where the window draws for a screen w x h: the heading band, the item in large type and
// the phase under it, a form of label-and-value lines, the last failure, the table of every
// item's counts, and the footer band.
enum Line { CYCLE, STEP, LEFT, ELAPSED, BATTERY, FAILURES, LINES };
const char *const kLineKeys[LINES] = {"aging_Cycle",   "aging_Step",    "aging_TimeLeft",
                                      "aging_Elapsed", "aging_Battery", "aging_Failures"};
constexpr int kTableRows = (AGING_ITEM_COUNT + 1) / 2;  // two items a row

struct Layout {
    int margin;
    RECT header, item, phase, line[LINES], failure, table, footer;
    int tableLine;
};

Layout layout_for(int w, int h) {
    Layout l;
    const int line = mmi_logfont_size(3, w) * 3 / 2;
    const int small = mmi_logfont_size(4, w) * 3 / 2;
    const int big = mmi_logfont_size(1, w) * 3 / 2;
    const int band = line * 3 / 2;
    l.margin = w / 16;
    const int left = l.margin, right = w - l.margin;
    l.header = {0, 0, w, band};
    l.footer = {0, h - band, w, h};
    int y = band + line / 2;
    l.item = {left, y, right, y + big};
    y += big;
    l.phase = {left, y, right, y + line};
    y += line + line / 2;
    for (RECT &r : l.line) {
        r = {left, y, right, y + line};
        y += line;
    }
    l.failure = {left, y, right, y + 2 * small};
    y += 2 * small + line / 2;
    l.tableLine = line;
    l.table = {left, y, right, y + line * (kTableRows + 1)};
    return l;
}

Layout layout_now() {
    return layout_for(g_ptScreenInfo.width, g_ptScreenInfo.height);
}

// ---- painting ----

constexpr auto &text_at = mmi_testwnd_text_at;
constexpr auto &key_at = mmi_testwnd_key_at;

constexpr UINT kCentred = DT_CENTER | DT_VCENTER | DT_SINGLELINE;
constexpr UINT kLeft = DT_LEFT | DT_VCENTER | DT_SINGLELINE;
constexpr UINT kRight = DT_RIGHT | DT_VCENTER | DT_SINGLELINE;

// The value of a form line, and its colour.
int line_value(const mmi_aging_view &v, int line, char *out, size_t size) {
    const mmi_aging_record &r = v.record;
    switch (line) {
        case CYCLE:
            snprintf(out, size, "%d / %d", mmi_aging_shown_cycle(&r), r.cycles);
            break;
        case STEP:
            if (v.itemSteps > 0)
                snprintf(out, size, "%d / %d", r.step, v.itemSteps);
            else
                tp_os_strlcpy(out, "--", size);
            break;
        case LEFT:
            if (v.itemLeft >= 0)
                mmi_aging_format_elapsed(v.itemLeft, out, size);
            else
                tp_os_strlcpy(out, "--", size);
            break;
        case ELAPSED:
            mmi_aging_format_elapsed(r.elapsed, out, size);
            break;
        case BATTERY:
            mmi_aging_format_battery(v.batteryLevel, v.batteryTemp, out, size);
            return v.phase == AGING_PHASE_HOT ? MMI_COLOUR_FAIL : MMI_COLOUR_TEXT;
        default:
            snprintf(out, size, "%d", r.failures);
            return r.failures > 0 ? MMI_COLOUR_FAIL : MMI_COLOUR_TEXT;
    }
    return MMI_COLOUR_TEXT;
}

int count_colour(int n, int colour) {
    return n > 0 ? colour : MMI_COLOUR_TEXT;
}

// Two items a row: each half holds the label, the passes and the fails, under a heading of
// the result words.
void paint_table(HDC hdc, const mmi_aging_view &v, const Layout &l) {
    const int half = RECTW(l.table) / 2;
    for (int col = 0; col < 2; col++) {
        const int x = l.table.left + col * half;
        const int passLeft = x + half * 6 / 10, failLeft = x + half * 8 / 10;
        for (int row = 0; row <= kTableRows; row++) {
            const int y = l.table.top + row * l.tableLine;
            const RECT label = {x, y, passLeft, y + l.tableLine};
            const RECT pass = {passLeft, y, failLeft, y + l.tableLine};
            const RECT fail = {failLeft, y, x + half, y + l.tableLine};
            if (row == 0) {
                key_at(hdc, 4, MMI_COLOUR_TEXT, "Result_pass", pass, kCentred);
                key_at(hdc, 4, MMI_COLOUR_TEXT, "Result_fail", fail, kCentred);
                continue;
            }
            const int item = col * kTableRows + row - 1;
            if (item >= AGING_ITEM_COUNT) break;
            const mmi_aging_count &c = v.record.counts[item];
            const int current = item == v.record.item && v.phase != AGING_PHASE_DONE;
            key_at(hdc, 4, current ? MMI_COLOUR_HILIGHT_TEXT : MMI_COLOUR_TEXT,
                   mmi_aging_item_label(item), label, kLeft);
            char n[16];
            snprintf(n, sizeof n, "%d", c.pass);
            text_at(hdc, 4, count_colour(c.pass, MMI_COLOUR_PASS), n, pass, kCentred);
            snprintf(n, sizeof n, "%d", c.fail);
            text_at(hdc, 4, count_colour(c.fail, MMI_COLOUR_FAIL), n, fail, kCentred);
        }
    }
    SetPenColor(hdc, mmi_pixel(MMI_COLOUR_FRAME));
    SetPenWidth(hdc, 1);
    MoveTo(hdc, l.table.left, l.table.top + l.tableLine - 1);
    LineTo(hdc, l.table.right, l.table.top + l.tableLine - 1);
}

void paint_footer(HDC hdc, const Layout &l) {
    SetBrushColor(hdc, mmi_pixel(MMI_COLOUR_BAR));
    FillBox(hdc, l.footer.left, l.footer.top, RECTW(l.footer), RECTH(l.footer));
    if (s_stopArmed)
        key_at(hdc, 3, MMI_COLOUR_FAIL, "aging_StopAgain", l.footer, kCentred);
    else
        key_at(hdc, 4, MMI_COLOUR_TEXT, "aging_StopHint", l.footer, kCentred);
}

// Colour bars sliding right over two thirds of the screen, grey steps sliding left under
// them: a few boxes a frame, every pixel of the panel changing within a few seconds.
void paint_pattern(HDC hdc, const Layout &l) {
    static const unsigned char kBars[8][3] = {{255, 255, 255}, {255, 255, 0}, {0, 255, 255},
                                              {0, 255, 0},     {255, 0, 255}, {255, 0, 0},
                                              {0, 0, 255},     {0, 0, 0}};
    constexpr int kSteps = 16;
    const int w = g_ptScreenInfo.width, h = g_ptScreenInfo.height;
    const int split = h * 2 / 3;
    const int shift = w / 48 > 0 ? w / 48 : 1;
    const int offset = static_cast<int>((s_frame * shift) % w);
    // One band of width bw whose left edge is at x (mod w), wrapped round the screen.
    auto band = [&](int x, int bw, int top, int height) {
        x = ((x % w) + w) % w;
        const int first = bw < w - x ? bw : w - x;
        FillBox(hdc, x, top, first, height);
        if (first < bw) FillBox(hdc, 0, top, bw - first, height);
    };
    const int bw = (w + 7) / 8;
    for (int i = 0; i < 8; i++) {
        SetBrushColor(hdc, RGB2Pixel(hdc, kBars[i][0], kBars[i][1], kBars[i][2]));
        band(i * bw + offset, bw, 0, split);
    }
    const int sw = (w + kSteps - 1) / kSteps;
    for (int i = 0; i < kSteps; i++) {
        const int grey = i * 255 / (kSteps - 1);
        SetBrushColor(hdc, RGB2Pixel(hdc, grey, grey, grey));
        band(i * sw - offset, sw, split, h - split);
    }
    if (s_stopArmed) paint_footer(hdc, l);
}

void paint(HWND hWnd) {
    const Layout l = layout_now();
    const mmi_aging_view &v = s_shown;
    HDC hdc = BeginPaint(hWnd);
    SetBkMode(hdc, BM_TRANSPARENT);
    if (v.video) {
        paint_pattern(hdc, l);
        EndPaint(hWnd, hdc);
        return;
    }
    const int w = g_ptScreenInfo.width;
    SetBrushColor(hdc, mmi_pixel(MMI_COLOUR_BAR));
    FillBox(hdc, l.header.left, l.header.top, RECTW(l.header), RECTH(l.header));
    SetPenColor(hdc, mmi_pixel(MMI_COLOUR_PASS));
    SetPenWidth(hdc, 3);
    MoveTo(hdc, 0, l.header.bottom);
    LineTo(hdc, w, l.header.bottom);
    key_at(hdc, 3, MMI_COLOUR_TEXT, "aging_Title", l.header, kCentred);
    paint_footer(hdc, l);

    const bool working = v.phase != AGING_PHASE_STARTING && v.phase != AGING_PHASE_DONE;
    key_at(hdc, 1, MMI_COLOUR_TEXT, working ? mmi_aging_item_label(v.record.item) : "aging_Title",
           l.item, kCentred);
    key_at(hdc, 3, v.phase == AGING_PHASE_HOT ? MMI_COLOUR_FAIL : MMI_COLOUR_TEXT,
           mmi_aging_phase_key(v.phase), l.phase, kCentred);
    for (int i = 0; i < LINES; i++) {
        char value[MMI_TESTWND_TEXT_SIZE];
        const int colour = line_value(v, i, value, sizeof value);
        key_at(hdc, 3, MMI_COLOUR_TEXT, kLineKeys[i], l.line[i], kLeft);
        text_at(hdc, 3, colour, value, l.line[i], kRight);
    }
    if (v.record.lastFailure[0] != '\0')
        text_at(hdc, 4, MMI_COLOUR_FAIL, v.record.lastFailure, l.failure,
                DT_LEFT | DT_TOP | DT_WORDBREAK);
    paint_table(hdc, v, l);
    EndPaint(hWnd, hdc);
}

// ---- the view, once a second (ten times a second under the video item) ----

void invalidate(HWND hWnd, const RECT &r) {
    InvalidateRect(hWnd, &r, TRUE);
}

// Repaints the parts whose content differs between what is shown and v.
void repaint_changes(HWND hWnd, const mmi_aging_view &was, const mmi_aging_view &v) {
    const Layout l = layout_now();
    const mmi_aging_record &a = was.record, &b = v.record;
    if (a.item != b.item || was.phase != v.phase) {
        invalidate(hWnd, l.item);
        invalidate(hWnd, l.phase);
    }
    const bool changed[LINES] = {
        a.cycle != b.cycle || a.cycles != b.cycles || a.finished != b.finished,
        a.step != b.step || was.itemSteps != v.itemSteps,
        was.itemLeft != v.itemLeft,
        a.elapsed != b.elapsed,
        was.batteryLevel != v.batteryLevel || was.batteryTemp != v.batteryTemp ||
            (was.phase == AGING_PHASE_HOT) != (v.phase == AGING_PHASE_HOT),
        a.failures != b.failures,
    };
    for (int i = 0; i < LINES; i++)
        if (changed[i]) invalidate(hWnd, l.line[i]);
    if (strcmp(a.lastFailure, b.lastFailure) != 0) invalidate(hWnd, l.failure);
    if (memcmp(a.counts, b.counts, sizeof a.counts) != 0 || a.item != b.item ||
        (was.phase == AGING_PHASE_DONE) != (v.phase == AGING_PHASE_DONE))
        invalidate(hWnd, l.table);
}

void take_view(HWND hWnd) {
    mmi_aging_view v;
    mmi_aging_view_get(&v);
    if (v.video != s_shown.video) {
        ResetTimer(hWnd, kViewTimer, v.video ? kVideoPeriod : kViewPeriod);
        s_shown = v;
        InvalidateRect(hWnd, nullptr, v.video ? FALSE : TRUE);
        return;
    }
    if (v.video) {
        s_frame++;
        s_shown = v;
        InvalidateRect(hWnd, nullptr, FALSE);
        return;
    }
    repaint_changes(hWnd, s_shown, v);
    s_shown = v;
    // A run that ended without word (its thread is gone) ends the window as well.
    if (v.phase == AGING_PHASE_DONE && !mmi_aging_run_active()) mmi_aging_window_finished();
}

// ---- the back key ----

void back_pressed(HWND hWnd) {
    if (s_stopArmed && std::chrono::steady_clock::now() - s_stopArmedAt < kStopWindow) {
        AGING_LOG("back pressed again: the operator stops the run");
        SendMessage(hWnd, MSG_CLOSE, 0, 0);
        return;
    }
    AGING_LOG("back pressed once: press it again within 3 s to stop");
    s_stopArmed = true;
    s_stopArmedAt = std::chrono::steady_clock::now();
    const Layout l = layout_now();
    InvalidateRect(hWnd, &l.footer, !s_shown.video);
}

// The first press's note goes once its time has passed (looked at on every tick).
void stop_expiry(HWND hWnd) {
    if (!s_stopArmed || std::chrono::steady_clock::now() - s_stopArmedAt < kStopWindow) return;
    s_stopArmed = false;
    // Under the pattern the note sits on top of it: the whole frame is drawn again.
    const Layout l = layout_now();
    if (s_shown.video)
        InvalidateRect(hWnd, nullptr, FALSE);
    else
        InvalidateRect(hWnd, &l.footer, TRUE);
}

void close_window(HWND hWnd) {
    if (s_closing) return;
    s_closing = true;
    KillTimer(hWnd, kViewTimer);
    s_window = HWND_INVALID;
    // Returns at once when the run has ended; a run this close stops ends here too, its
    // record kept as the result.
    if (mmi_aging_run_stop() == 0) s_result = 1;
    g_deviceIsAgingTest = 0;
    Set_OsCanIdleAllowed(1);
    const int result = s_result.exchange(0);
    AGING_LOG("aging window closed%s", result ? ", the result list opens" : "");
    DestroyMainWindow(hWnd);
    if (result) mmi_AgingTestEntry();
}

LRESULT aging_proc(HWND hWnd, UINT message, WPARAM wParam, LPARAM lParam) {
    switch (message) {
        case MSG_CREATE:
            s_closing = false;
            s_stopArmed = false;
            s_frame = 0;
            mmi_aging_view_get(&s_shown);
            SetTimer(hWnd, kViewTimer, s_shown.video ? kVideoPeriod : kViewPeriod);
            break;
        case MSG_PAINT:
            paint(hWnd);
            return 0;
        case MSG_TIMER:
            if (wParam != kViewTimer) return 0;
            take_view(hWnd);
            stop_expiry(hWnd);
            return 0;
        case MSG_KEYDOWN:
            // Only the back key counts, and a held key's repeats do not: nothing else that
            // brushes the handset in its rack may stop the run.
            if (wParam == SCANCODE_F3 && (lParam & KS_REPEATED) == 0) back_pressed(hWnd);
            return 0;
        case MSG_KEYUP:
            return 0;
        case MSG_CLOSE:
            close_window(hWnd);
            return 0;
        default:
            break;
    }
    return DefaultMainWinProc(hWnd, message, wParam, lParam);
}

int create_on_gui(void *) {
    if (s_window.load() != HWND_INVALID) return 0;
    s_result = 0;
    HWND hWnd = mmi_testwnd_create_full("Aging", aging_proc, 0);
    if (hWnd == HWND_INVALID) {
        AGING_ERROR("the aging window could not be made");
        return -1;
    }
    s_window = hWnd;
    AGING_LOG("aging window created");
    return 0;
}

}  // namespace

HWND mmi_CreateAgingTestWnd(void) {
    mmi_RunOnGuiThread(create_on_gui, nullptr);
    return s_window.load();
}

void mmi_aging_window_finished(void) {
    s_result = 1;
    HWND hWnd = s_window.load();
    if (hWnd != HWND_INVALID) PostMessage(hWnd, MSG_CLOSE, 0, 0);
}

void mmi_aging_window_reset(void) {
    s_result = 0;
}

void mmi_aging_format_elapsed(long long seconds, char *out, size_t size) {
    if (seconds < 0) seconds = 0;
    snprintf(out, size, "%lld:%02lld:%02lld", seconds / 3600, seconds / 60 % 60, seconds % 60);
}

void mmi_aging_format_battery(int level, int tenths, char *out, size_t size) {
    if (level < 0) {
        tp_os_strlcpy(out, "--", size);
        return;
    }
    const int whole = (tenths < 0 ? -tenths : tenths) / 10;
    const int tenth = (tenths < 0 ? -tenths : tenths) % 10;
    snprintf(out, size, "%d %%  %s%d.%d C", level, tenths < 0 ? "-" : "", whole, tenth);
}

const char *mmi_aging_phase_key(int phase) {
    static const char *const kKeys[] = {
        "aging_PhaseStarting", "aging_PhaseItem",   "aging_PhaseBetween", "aging_PhaseHot",
        "aging_PhaseStandby",  "aging_PhaseReboot", "aging_PhaseDone",
    };
    return phase >= 0 && phase < static_cast<int>(sizeof kKeys / sizeof kKeys[0]) ? kKeys[phase]
                                                                                  : kKeys[0];
}

int mmi_aging_shown_cycle(const mmi_aging_record *r) {
    if (r->finished) return r->cycle;
    return r->cycle < r->cycles ? r->cycle + 1 : r->cycles;
}

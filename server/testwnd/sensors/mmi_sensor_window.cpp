// The shared sensor window.
#include "testwnd/sensors/mmi_sensor_window.h"

#include <stdio.h>
#include <stdlib.h>
#include <string.h>

#include <android/log.h>

#include "core/ftx_config.h"
#include "mmi_theme.h"
#include "tp_os.h"

#define SW_DEBUG(d, ...) __android_log_print(ANDROID_LOG_DEBUG, (d)->row->domain, __VA_ARGS__)
#define SW_ERROR(d, ...) __android_log_print(ANDROID_LOG_ERROR, (d)->row->domain, __VA_ARGS__)

namespace {

double param_double(const ftx_config_para *p, int n, const char *key, double def) {
    if (key == nullptr) return def;
    char value[FTX_CFG_TEXT_SIZE] = {0};
    ftx_config_get_para_value(p, n, key, value, sizeof(value), "");
    char *end = nullptr;
    const double v = strtod(value, &end);
    return end != value ? v : def;
}

// The configured lines, with their limits; how many.
int setup_lines(const mmi_sensorwnd_desc *d) {
    ftx_config_para p[MMI_SENSOR_PARAMS_MAX];
    const int n = mmi_sensorwnd_params(d, p);
    mmi_sensorwnd_state *st = d->state;
    st->lineCount = 0;
    for (int i = 0; i < d->lineCount && st->lineCount < MMI_SENSOR_LINES_MAX; i++) {
        const mmi_sensor_line_spec *s = &d->lines[i];
        if (!mmi_sensorwnd_line_on(p, n, s)) continue;
        const double lo = param_double(p, n, s->loParam, s->loDef);
        const double hi = param_double(p, n, s->hiParam, s->hiDef);
        mmi_sensor_line_reset(&st->lines[st->lineCount++], s, lo, hi);
        SW_DEBUG(d, "%s::%s lo=%g hi=%g", __func__, s->key, lo, hi);
    }
    st->passOffered = 0;
    return st->lineCount;
}

void lib_start(const mmi_sensorwnd_desc *d) {
    {
        std::lock_guard<std::mutex> lk(d->state->lock);
        d->state->taken = d->state->reports;  // the lines start from the library's start
    }
    const int rc = d->start ? d->start(d->callback) : -1;
    SW_DEBUG(d, "%s rc=%d", __func__, rc);
    if (rc == 0) d->state->running = 1;
}

void lib_stop(const mmi_sensorwnd_desc *d) {
    if (!d->state->running.exchange(0)) return;
    if (d->stop) d->stop();
    SW_DEBUG(d, "%s", __func__);
}

void soft_keys(HWND hWnd, const mmi_sensorwnd_desc *d, const char *titleKey) {
    mmi_testwnd_show_keys(hWnd, titleKey, d->state->passOffered ? MMI_TIMER_FOOLPROOF : 0);
}

void pass_and_close(HWND hWnd, const mmi_sensorwnd_desc *d) {
    SW_DEBUG(d, "%s", __func__);
    lib_stop(d);
    mmi_testwnd_pass_and_close(hWnd, d->row->resultIndex, d->row->domain);
}

void fail_and_close(HWND hWnd, const mmi_sensorwnd_desc *d) {
    SW_DEBUG(d, "%s", __func__);
    lib_stop(d);
    mmi_testwnd_fail_and_close(hWnd, d->row->resultIndex);
}

// The last report, parsed; call with the lock held and at least one report.
void parse_last(mmi_sensorwnd_state *st, mmi_sensor_report *out) {
    const char *text = st->queue[(st->reports - 1) % MMI_SENSOR_QUEUE];
    mmi_sensor_parse(text, MMI_SENSOR_REPORT_SIZE, out);
}

// Every report not yet taken through the lines (the oldest ones are lost when more came
// than the queue holds); every line passed offers pass (or passes).
void take_reports(HWND hWnd, const mmi_sensorwnd_desc *d) {
    mmi_sensorwnd_state *st = d->state;
    mmi_sensor_report r[MMI_SENSOR_QUEUE];
    int n = 0;
    {
        std::lock_guard<std::mutex> lk(st->lock);
        unsigned from = st->taken;
        if (st->reports - from > MMI_SENSOR_QUEUE) from = st->reports - MMI_SENSOR_QUEUE;
        for (unsigned i = from; i != st->reports; i++)
            mmi_sensor_parse(st->queue[i % MMI_SENSOR_QUEUE], MMI_SENSOR_REPORT_SIZE, &r[n++]);
        st->taken = st->reports;
    }
    for (int k = 0; k < n; k++) {
        for (int i = 0; i < st->lineCount; i++) {
            const int was = st->lines[i].done;
            if (mmi_sensor_line_update(&st->lines[i], &r[k]) && !was)
                SW_DEBUG(d, "sensor %s passed", st->lines[i].spec->key);
        }
    }
    if (n == 0) return;
    InvalidateRect(hWnd, nullptr, TRUE);
    if (st->passOffered || !mmi_sensor_lines_done(st->lines, st->lineCount)) return;
    st->passOffered = 1;
    SW_DEBUG(d, "every sensor passed");
    if (d->autoPass && !st->wnd.pcDriven.load()) {
        pass_and_close(hWnd, d);
        return;
    }
    soft_keys(hWnd, d, nullptr);
}

bool has_sides(const mmi_sensor_line_spec *s) {
    return (s->kind == MMI_SENSOR_BOTH_SIDES || s->kind == MMI_SENSOR_COME_GO) &&
           s->lowWordKey != nullptr;
}

// A line's side words ("near", "far"), each green once seen.
void draw_sides(HDC hdc, const mmi_sensor_line &l, int x, int top, int bottom, int right) {
    const mmi_sensor_line_spec *s = l.spec;
    if (!has_sides(s)) return;
    const char *keys[2] = {s->lowWordKey, s->highWordKey};
    const int seen[2] = {l.low, l.high};
    const int half = (right - x) / 2;
    for (int k = 0; k < 2; k++) {
        char word[MMI_TESTWND_TEXT_SIZE];
        mmi_translate(keys[k], word, sizeof(word));
        SetTextColor(hdc, mmi_pixel(seen[k] ? MMI_COLOUR_PASS : MMI_COLOUR_GRAY));
        RECT rc = {x + k * half, top, x + (k + 1) * half, bottom};
        DrawText(hdc, word, -1, &rc, DT_CENTER | DT_VCENTER | DT_SINGLELINE);
    }
}

// The value a RESULT line shows: its pass or fail word and its extra value.
void result_text(const mmi_sensor_line &l, char *out, size_t size) {
    char word[MMI_TESTWND_TEXT_SIZE] = "";
    const char *key = l.v[0] == 1 ? l.spec->highWordKey : l.spec->lowWordKey;
    if (key != nullptr) mmi_translate(key, word, sizeof(word));
    if (l.hasExtra) {
        snprintf(out, size, "%s  %.*f %s", word, l.spec->decimals, l.extra, l.spec->unit);
    } else {
        snprintf(out, size, "%s", word);
    }
}

// The value a line shows: its numbers, its word or its result.
void value_text(const mmi_sensor_line &l, char *out, size_t size) {
    if (l.spec->kind == MMI_SENSOR_RESULT) {
        if (l.seen)
            result_text(l, out, size);
        else
            out[0] = 0;
    } else if (l.word[0] != 0) {
        char key[MMI_SENSOR_WORD_SIZE + 8];
        snprintf(key, sizeof(key), "sensor_%s", l.word);
        mmi_translate(key, out, size);
    } else {
        mmi_sensor_line_value(&l, out, size);
    }
}

void paint(HWND hWnd, const mmi_sensorwnd_desc *d) {
    mmi_sensorwnd_state *st = d->state;
    const int w = g_ptScreenInfo.width;
    const int font = mmi_logfont_size(3, w);
    HDC hdc = BeginPaint(hWnd);
    mmi_testwnd_draw_top_line(hdc);
    SetBkMode(hdc, BM_TRANSPARENT);
    const int rowH = font * 2;
    int top = mmi_testwnd_draw_note(hdc, d->noteKey) + font / 2;
    for (int i = 0; i < st->lineCount; i++, top += rowH) {
        const mmi_sensor_line &l = st->lines[i];
        char label[MMI_TESTWND_TEXT_SIZE], value[MMI_TESTWND_TEXT_SIZE];
        mmi_translate(l.spec->labelKey, label, sizeof(label));
        value_text(l, value, sizeof(value));
        mmi_testwnd_draw_row(hdc, top, rowH, label, value, l.done,
                             has_sides(l.spec) ? w * 11 / 16 : w - w / 32);
        // The side words in the smaller font: two share what is left of the line.
        PLOGFONT lineFont = GetCurFont(hdc);
        if (g_mmiLogFont[4]) SelectFont(hdc, g_mmiLogFont[4]);
        draw_sides(hdc, l, w * 11 / 16, top, top + rowH, w - w / 32);
        if (lineFont) SelectFont(hdc, lineFont);
    }
    mmi_testwnd_draw_rule(hdc, top);
    EndPaint(hWnd, hdc);
}

LRESULT sensor_proc(HWND hWnd, UINT message, WPARAM wParam, LPARAM lParam) {
    const auto *d =
        reinterpret_cast<const mmi_sensorwnd_desc *>(mmi_window_data(hWnd, message, lParam));
    if (d == nullptr) return DefaultMainWinProc(hWnd, message, wParam, lParam);
    mmi_sensorwnd_state *st = d->state;
    const char *tag = d->row->domain;
    if (mmi_ownwnd_verdict(
            message, wParam, st->passOffered, [&] { pass_and_close(hWnd, d); },
            [&] { fail_and_close(hWnd, d); }))
        return 0;
    switch (message) {
        case MSG_CREATE:
            mmi_testwnd_create_title(hWnd, d->row->titleKey);
            // The library may report as soon as it starts: the window is known by then.
            mmi_ownwnd_created(&st->wnd, hWnd, tag);
            lib_start(d);
            break;
        case MSG_ACTIVE:
            if (mmi_ownwnd_refuses(&st->wnd, message, tag)) return 0;
            if (wParam == 1) soft_keys(hWnd, d, d->row->titleKey);
            break;
        case MSG_PAINT:
            if (mmi_ownwnd_refuses(&st->wnd, message, tag)) return 0;
            paint(hWnd, d);
            return 0;
        case MSG_CALLBACK:
            take_reports(hWnd, d);
            return 0;
        case MSG_KEYDOWN:
            return 0;
        case MSG_CLOSE:
            lib_stop(d);
            mmi_ownwnd_destroy(&st->wnd, hWnd);
            return 0;
        default:
            break;
    }
    return DefaultMainWinProc(hWnd, message, wParam, lParam);
}

// The PC's verdict, on the GUI thread: "*" and each line's key=0|1; 1 when all passed.
int pc_verdict(const void *ctx, char *reply, unsigned int size) {
    const mmi_sensorwnd_desc *d = static_cast<const mmi_sensorwnd_desc *>(ctx);
    mmi_sensorwnd_state *st = d->state;
    if (reply != nullptr && size > 0) {
        size_t used = (size_t)snprintf(reply, size, "*");
        for (int i = 0; i < st->lineCount && used < size; i++) {
            const int n = snprintf(reply + used, size - used, "%s%s=%d", i ? ";" : "",
                                   st->lines[i].spec->key, st->lines[i].done);
            if (n < 0) break;
            used += (size_t)n;
        }
    }
    st->wnd.pcDriven = 0;
    return mmi_sensor_lines_done(st->lines, st->lineCount);
}

void pc_open_on_gui(const void *ctx) {
    mmi_sensorwnd_open(static_cast<const mmi_sensorwnd_desc *>(ctx));
}

}  // namespace

int mmi_sensorwnd_params(const mmi_sensorwnd_desc *d, ftx_config_para *p) {
    int n = mmi_testwnd_params(d->row->domain, p, MMI_SENSOR_PARAMS_MAX);
    if (n > 0) return n;
    // A family the catalogue does not list keeps its parameter in its domain only.
    char text[FTX_CFG_TEXT_SIZE] = {0};
    if (Read_MainCfgFile(d->row->domain, "parameter", text, "") != 0) return 0;
    return ftx_config_parse_parameter(text, p, MMI_SENSOR_PARAMS_MAX);
}

bool mmi_sensorwnd_line_on(const ftx_config_para *p, int n, const mmi_sensor_line_spec *s) {
    return s->enableParam == nullptr ||
           param_double(p, n, s->enableParam, s->offByDefault ? 0 : 1) != 0;
}

void mmi_sensorwnd_report(const mmi_sensorwnd_desc *d, const module_data *data) {
    mmi_sensorwnd_state *st = d->state;
    {
        std::lock_guard<std::mutex> lk(st->lock);
        char *slot = st->queue[st->reports % MMI_SENSOR_QUEUE];
        slot[0] = 0;
        if (data != nullptr && data->data != nullptr) {
            const size_t n = data->totallen < MMI_SENSOR_REPORT_SIZE - 1
                                 ? data->totallen
                                 : MMI_SENSOR_REPORT_SIZE - 1;
            memcpy(slot, data->data, n);
            slot[n] = 0;
        }
        st->reports++;
    }
    HWND hWnd = st->wnd.hwnd.load();
    if (hWnd != HWND_INVALID && st->wnd.created.load()) PostMessage(hWnd, MSG_CALLBACK, 0, 0);
}

HWND mmi_sensorwnd_open(const mmi_sensorwnd_desc *d) {
    if (d->bind && d->bind() != 0) {
        SW_ERROR(d, "%s::bind fail, test not opened", __func__);
        return HWND_INVALID;
    }
    if (setup_lines(d) == 0) {
        SW_ERROR(d, "%s::no sensor is configured, test not opened", __func__);
        return HWND_INVALID;
    }
    HWND hWnd = mmi_testwnd_create(d->caption, sensor_proc, reinterpret_cast<DWORD>(d));
    return mmi_ownwnd_opened(&d->state->wnd, hWnd, d->stopEntry);
}

int mmi_sensorwnd_close(const mmi_sensorwnd_desc *d) {
    return mmi_ownwnd_stop(&d->state->wnd);
}

int mmi_sensorwnd_pc_open(const mmi_sensorwnd_desc *d) {
    mmi_ownwnd_pc_open(&d->state->wnd, pc_open_on_gui, d);
    return d->state->wnd.hwnd.load() != HWND_INVALID ? 1 : 0;
}

int mmi_sensorwnd_pc_close(const mmi_sensorwnd_desc *d, char *reply, unsigned int size) {
    return mmi_ownwnd_pc_stop(&d->state->wnd, pc_verdict, d, reply, size);
}

unsigned mmi_sensorwnd_reports(const mmi_sensorwnd_desc *d) {
    std::lock_guard<std::mutex> lk(d->state->lock);
    return d->state->reports;
}

int mmi_sensorwnd_wait(const mmi_sensorwnd_desc *d, unsigned before, int tries,
                       mmi_sensor_report *out) {
    mmi_sensorwnd_state *st = d->state;
    for (int i = 0; i < tries; i++) {
        {
            std::lock_guard<std::mutex> lk(st->lock);
            if (st->reports != before) {
                parse_last(st, out);
                return 0;
            }
        }
        tp_os_usleep(100000);
    }
    SW_ERROR(d, "%s::no report from the library", __func__);
    return -1;
}

int mmi_sensorwnd_fresh_report(const mmi_sensorwnd_desc *d, mmi_sensor_report *out, int tries) {
    mmi_sensorwnd_state *st = d->state;
    if (d->bind && d->bind() != 0) return -1;
    const unsigned before = mmi_sensorwnd_reports(d);
    const bool ours = !st->running.load();
    if (ours) {
        if (d->start == nullptr || d->start(d->callback) != 0) {
            SW_ERROR(d, "%s::library start fail", __func__);
            return -1;
        }
        st->running = 1;
    }
    const int rc = mmi_sensorwnd_wait(d, before, tries, out);
    // A window opened meanwhile keeps the library running.
    if (ours && st->wnd.hwnd.load() == HWND_INVALID) lib_stop(d);
    return rc;
}

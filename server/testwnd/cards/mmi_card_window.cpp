// The shared card and peripheral window.
#include "testwnd/cards/mmi_card_window.h"

#include <stdio.h>
#include <string.h>

#include <android/log.h>

#include "core/ftx_config.h"
#include "mmi_theme.h"
#include "tp_os.h"

#define CW_DEBUG(d, ...) __android_log_print(ANDROID_LOG_DEBUG, (d)->row->domain, __VA_ARGS__)
#define CW_ERROR(d, ...) __android_log_print(ANDROID_LOG_ERROR, (d)->row->domain, __VA_ARGS__)

namespace {

constexpr int kParamsMax = 8;
constexpr int kTimerId = 131;
constexpr int kTimerPeriod = 100;  // 10 ms units (scaled like every wait): one second
constexpr int kSimSlotsDefault = 2;

int clamp(int v, int lo, int hi) {
    return v < lo ? lo : v > hi ? hi : v;
}

// The lines and the time-out from the item's parameter; how many lines.
int setup(const mmi_cardwnd_desc *d) {
    ftx_config_para p[kParamsMax];
    const int n = mmi_testwnd_params(d->row->domain, p, kParamsMax);
    mmi_cardwnd_state *st = d->state;
    st->lineCount = 0;
    if (d->sim) {
        char def[8];
        snprintf(def, sizeof def, "%d", kSimSlotsDefault);
        const int slots =
            clamp(mmi_testwnd_param_int(p, n, "SimSlots", def), 0, MMI_CARD_SIM_SLOTS);
        for (int i = 0; i < slots; i++)
            st->lines[st->lineCount++] = {.kind = MMI_CARD_SIM, .slot = i};
    }
    if (d->sd) st->lines[st->lineCount++] = {.kind = MMI_CARD_SD, .slot = 0};
    if (d->start) st->lines[st->lineCount++] = {.kind = MMI_CARD_EVENT, .present = 0};
    char def[8];
    snprintf(def, sizeof def, "%d", MMI_CARD_TIMEOUT_DEFAULT);
    st->timeout = clamp(mmi_testwnd_param_int(p, n, "Timeout", def), 1, 3600);
    st->left = st->timeout;
    st->failsShown = 0;
    st->uid[0] = 0;
    st->passOffered = 0;
    {
        std::lock_guard<std::mutex> lk(st->lock);
        st->last = mmi_card_report{};
        st->passSeen = 0;
        st->failsSeen = 0;
        st->lastText[0] = 0;
    }
    CW_DEBUG(d, "%s::lines=%d timeout=%d s", __func__, st->lineCount, st->timeout);
    return st->lineCount;
}

void lib_start(const mmi_cardwnd_desc *d) {
    if (d->start == nullptr) return;
    const int rc = d->start(d->callback);
    CW_DEBUG(d, "%s rc=%d", __func__, rc);
    if (rc == 0) d->state->running = 1;
}

void lib_stop(const mmi_cardwnd_desc *d) {
    if (d->start == nullptr) {
        // The card checks end their library session.
        if (d->sim && hw::ftx_api_SimCard_Test_Stop) hw::ftx_api_SimCard_Test_Stop();
        if (d->sd && hw::ftx_api_SDCard_Test_Stop) hw::ftx_api_SDCard_Test_Stop();
        return;
    }
    if (!d->state->running.exchange(0)) return;
    if (d->stop) d->stop();
    CW_DEBUG(d, "%s", __func__);
}

bool pc_driven(const mmi_cardwnd_state *st) {
    return st->byPc.load() || st->wnd.pcDriven.load();
}

// Every line green.
bool all_present(const mmi_cardwnd_state *st) {
    for (int i = 0; i < st->lineCount; i++)
        if (st->lines[i].present != 1) return false;
    return st->lineCount > 0;
}

// The card lines asked again, the report taken; true when a line changed.
bool refresh(const mmi_cardwnd_desc *d) {
    mmi_cardwnd_state *st = d->state;
    bool changed = false;
    for (int i = 0; i < st->lineCount; i++) {
        mmi_cardwnd_line &l = st->lines[i];
        const mmi_cardwnd_line was = l;
        if (l.kind == MMI_CARD_EVENT) {
            std::lock_guard<std::mutex> lk(st->lock);
            l.present = st->passSeen ? 1 : 0;
            if (st->passSeen) snprintf(st->uid, sizeof st->uid, "%s", st->last.uid);
            if (st->failsSeen != st->failsShown) {
                st->failsShown = st->failsSeen;
                changed = true;
            }
        } else {
            l.present = mmi_card_check(l.kind, l.slot, &l.sizeMb);
        }
        if (l.present != was.present || l.sizeMb != was.sizeMb) {
            changed = true;
            if (l.kind == MMI_CARD_SIM)
                CW_DEBUG(d, "sim slot %d present=%d", l.slot, l.present);
            else if (l.kind == MMI_CARD_SD)
                CW_DEBUG(d, "sd card present=%d size=%d MB", l.present, l.sizeMb);
            else if (l.present == 1)
                CW_DEBUG(d, "report passed%s%s", st->uid[0] ? ", uid=" : "", st->uid);
        }
    }
    return changed;
}

void pass_and_close(HWND hWnd, const mmi_cardwnd_desc *d) {
    CW_DEBUG(d, "%s", __func__);
    KillTimer(hWnd, kTimerId);
    lib_stop(d);
    mmi_testwnd_pass_and_close(hWnd, d->row->resultIndex, d->row->domain);
}

void fail_and_close(HWND hWnd, const mmi_cardwnd_desc *d) {
    CW_DEBUG(d, "%s", __func__);
    KillTimer(hWnd, kTimerId);
    lib_stop(d);
    mmi_testwnd_fail_and_close(hWnd, d->row->resultIndex);
}

// After a refresh: every line green offers pass, or passes a window the PC did not open.
// true when the window closed.
bool judge(HWND hWnd, const mmi_cardwnd_desc *d) {
    mmi_cardwnd_state *st = d->state;
    const int ready = all_present(st) ? 1 : 0;
    if (ready && !pc_driven(st)) {
        pass_and_close(hWnd, d);
        return true;
    }
    if (ready != st->passOffered) {
        st->passOffered = ready;
        mmi_testwnd_show_keys(hWnd, nullptr, ready ? MMI_TIMER_FOOLPROOF : 0);
    }
    return false;
}

// A line's label and its state, and whether it is green.
bool line_text(const mmi_cardwnd_desc *d, const mmi_cardwnd_line &l, char *label, char *value,
               size_t size) {
    // Half a line: a word, a number and a unit still fit the line's buffers.
    char word[MMI_TESTWND_TEXT_SIZE / 2];
    const mmi_cardwnd_state *st = d->state;
    switch (l.kind) {
        case MMI_CARD_SIM:
            mmi_translate("card_SimSlot", word, sizeof word);
            snprintf(label, size, "%s %d", word, l.slot + 1);
            break;
        case MMI_CARD_SD:
            mmi_translate("card_SdCard", label, size);
            break;
        default:
            mmi_translate(d->labelKey, label, size);
            break;
    }
    if (l.kind == MMI_CARD_EVENT) {
        if (l.present == 1) {
            mmi_translate("card_Detected", value, size);  // a tag's identifier: its own row
        } else {
            mmi_translate(st->failsShown > 0 && d->failKey ? d->failKey : "card_Waiting", value,
                          size);
        }
        return l.present == 1;
    }
    const char *key = l.present == 1   ? "card_Present"
                      : l.present == 0 ? "card_Absent"
                                       : "card_Error";
    mmi_translate(key, word, sizeof word);
    if (l.present == 1 && l.sizeMb > 0)
        snprintf(value, size, "%s, %d MB", word, l.sizeMb);
    else
        snprintf(value, size, "%s", word);
    return l.present == 1;
}

void paint(HWND hWnd, const mmi_cardwnd_desc *d) {
    mmi_cardwnd_state *st = d->state;
    const int w = g_ptScreenInfo.width;
    const int font = mmi_logfont_size(3, w);
    HDC hdc = BeginPaint(hWnd);
    mmi_testwnd_draw_top_line(hdc);
    SetBkMode(hdc, BM_TRANSPARENT);
    char text[MMI_TESTWND_NOTE_SIZE];
    const int rowH = font * 2;
    int top = mmi_testwnd_draw_note(hdc, d->noteKey) + font / 2;
    for (int i = 0; i < st->lineCount; i++, top += rowH) {
        char label[MMI_TESTWND_TEXT_SIZE], value[MMI_TESTWND_TEXT_SIZE];
        const bool green = line_text(d, st->lines[i], label, value, sizeof label);
        mmi_testwnd_draw_row(hdc, top, rowH, label, value, green, w - w / 32);
    }
    if (st->uid[0]) {
        SetTextColor(hdc, mmi_pixel(MMI_COLOUR_PASS));
        snprintf(text, sizeof text, "UID %s", st->uid);
        RECT ru = {w / 16, top, w - w / 32, top + rowH};
        DrawText(hdc, text, -1, &ru, DT_LEFT | DT_VCENTER | DT_SINGLELINE);
        top += rowH;
    }
    mmi_testwnd_draw_rule(hdc, top);
    if (!pc_driven(st)) {
        char word[MMI_TESTWND_TEXT_SIZE];
        mmi_translate("card_TimeLeft", word, sizeof word);
        snprintf(text, sizeof text, "%s %d s", word, st->left);
        SetTextColor(hdc, mmi_pixel(MMI_COLOUR_TEXT));
        RECT rt = {w / 16, top + font / 2, w - w / 16, top + font / 2 + rowH};
        DrawText(hdc, text, -1, &rt, DT_LEFT | DT_VCENTER | DT_SINGLELINE);
    }
    EndPaint(hWnd, hdc);
}

// One second gone: the lines asked again, a pass, or the time-out's fail.
void tick(HWND hWnd, const mmi_cardwnd_desc *d) {
    mmi_cardwnd_state *st = d->state;
    refresh(d);
    if (judge(hWnd, d)) return;
    if (pc_driven(st)) return;
    if (st->left > 0) st->left--;
    InvalidateRect(hWnd, nullptr, TRUE);
    if (st->left > 0) return;
    CW_ERROR(d, "%s::no pass within %d s, fail", __func__, st->timeout);
    fail_and_close(hWnd, d);
}

LRESULT card_proc(HWND hWnd, UINT message, WPARAM wParam, LPARAM lParam) {
    const auto *d =
        reinterpret_cast<const mmi_cardwnd_desc *>(mmi_window_data(hWnd, message, lParam));
    if (d == nullptr) return DefaultMainWinProc(hWnd, message, wParam, lParam);
    mmi_cardwnd_state *st = d->state;
    const char *tag = d->row->domain;
    if (mmi_ownwnd_verdict(
            message, wParam, st->passOffered, [&] { pass_and_close(hWnd, d); },
            [&] { fail_and_close(hWnd, d); }))
        return 0;
    switch (message) {
        case MSG_CREATE:
            mmi_testwnd_create_title(hWnd, d->row->titleKey);
            mmi_ownwnd_created(&st->wnd, hWnd, tag);
            lib_start(d);
            refresh(d);  // shown at once; a pass waits for the first second
            SetTimer(hWnd, kTimerId, kTimerPeriod);
            break;
        case MSG_ACTIVE:
            if (mmi_ownwnd_refuses(&st->wnd, message, tag)) return 0;
            if (wParam == 1)
                mmi_testwnd_show_keys(hWnd, d->row->titleKey,
                                      st->passOffered ? MMI_TIMER_FOOLPROOF : 0);
            break;
        case MSG_PAINT:
            if (mmi_ownwnd_refuses(&st->wnd, message, tag)) return 0;
            paint(hWnd, d);
            return 0;
        case MSG_TIMER:
            if (wParam == kTimerId) tick(hWnd, d);
            return 0;
        case MSG_CALLBACK:
            if (refresh(d)) InvalidateRect(hWnd, nullptr, TRUE);
            judge(hWnd, d);
            return 0;
        case MSG_KEYDOWN:
            return 0;
        case MSG_CLOSE:
            KillTimer(hWnd, kTimerId);
            lib_stop(d);
            mmi_ownwnd_destroy(&st->wnd, hWnd);
            return 0;
        default:
            break;
    }
    return DefaultMainWinProc(hWnd, message, wParam, lParam);
}

// The PC's verdict, on the GUI thread: "*" and the last report; 1 when every line passed.
int pc_verdict(const void *ctx, char *reply, unsigned int size) {
    const mmi_cardwnd_desc *d = static_cast<const mmi_cardwnd_desc *>(ctx);
    mmi_cardwnd_state *st = d->state;
    refresh(d);
    if (reply != nullptr && size > 0) {
        std::lock_guard<std::mutex> lk(st->lock);
        snprintf(reply, size, "*%s", st->lastText[0] ? st->lastText : "none");
    }
    const int answer = all_present(st) ? 1 : 0;
    CW_DEBUG(d, "%s::verdict=%d", __func__, answer);
    st->wnd.pcDriven = 0;
    st->byPc = 0;
    return answer;
}

HWND open_window(const mmi_cardwnd_desc *d);
void pc_open_on_gui(const void *ctx) {
    open_window(static_cast<const mmi_cardwnd_desc *>(ctx));
}

}  // namespace

int mmi_card_check(int kind, int slot, int *sizeMb) {
    *sizeMb = 0;
    if (kind == MMI_CARD_SIM)
        return hw::ftx_api_SimCard_Test_Start ? hw::ftx_api_SimCard_Test_Start(slot) : -1;
    if (!hw::ftx_api_SDCard_Test_Start) return -1;
    const int present = hw::ftx_api_SDCard_Test_Start(slot);
    if (present == 1 && hw::ftx_api_SDCard_Get_Size) {
        const int mb = hw::ftx_api_SDCard_Get_Size(slot);
        *sizeMb = mb > 0 ? mb : 0;
    }
    return present;
}

void mmi_cardwnd_report(const mmi_cardwnd_desc *d, const module_data *data) {
    mmi_cardwnd_state *st = d->state;
    mmi_card_report r;
    const char *text = data != nullptr ? data->data : nullptr;
    const size_t len = text != nullptr ? data->totallen : 0;
    mmi_card_parse_report(text, len, &r);
    CW_DEBUG(d, "%s::result=%d uid=%s", __func__, r.result, r.uid);
    {
        std::lock_guard<std::mutex> lk(st->lock);
        if (r.result == MMI_CARD_NONE) return;
        st->last = r;
        if (r.result == MMI_CARD_PASS) st->passSeen = 1;
        if (r.result == MMI_CARD_FAIL) st->failsSeen++;
        const size_t n = len < sizeof st->lastText - 1 ? len : sizeof st->lastText - 1;
        size_t used = 0;
        for (size_t i = 0; i < n && text[i] != 0; i++)
            if ((unsigned char)text[i] >= ' ' && (unsigned char)text[i] < 0x7f)
                st->lastText[used++] = text[i];
        st->lastText[used] = 0;
    }
    HWND hWnd = st->wnd.hwnd.load();
    if (hWnd != HWND_INVALID && st->wnd.created.load()) PostMessage(hWnd, MSG_CALLBACK, 0, 0);
}

namespace {

HWND open_window(const mmi_cardwnd_desc *d) {
    if (d->bind && d->bind() != 0) {
        CW_ERROR(d, "%s::bind fail, test not opened", __func__);
        return HWND_INVALID;
    }
    if (setup(d) == 0) {
        CW_ERROR(d, "%s::no card is configured, test not opened", __func__);
        return HWND_INVALID;
    }
    CW_DEBUG(d, "%s: test window open", d->row->domain);
    HWND hWnd = mmi_testwnd_create(d->caption, card_proc, reinterpret_cast<DWORD>(d));
    return mmi_ownwnd_opened(&d->state->wnd, hWnd, d->stopEntry);
}

}  // namespace

HWND mmi_cardwnd_open(const mmi_cardwnd_desc *d) {
    d->state->byPc = 0;
    return open_window(d);
}

int mmi_cardwnd_close(const mmi_cardwnd_desc *d) {
    return mmi_ownwnd_stop(&d->state->wnd);
}

int mmi_cardwnd_pc_open(const mmi_cardwnd_desc *d) {
    d->state->byPc = 1;
    mmi_ownwnd_pc_open(&d->state->wnd, pc_open_on_gui, d);
    if (d->state->wnd.hwnd.load() == HWND_INVALID) d->state->byPc = 0;
    return d->state->wnd.hwnd.load() != HWND_INVALID ? 1 : 0;
}

int mmi_cardwnd_pc_close(const mmi_cardwnd_desc *d, char *reply, unsigned int size) {
    return mmi_ownwnd_pc_stop(&d->state->wnd, pc_verdict, d, reply, size);
}

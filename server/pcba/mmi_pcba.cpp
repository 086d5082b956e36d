// The PCBA run: one table of checks, the run's state shared by the command thread (start,
// wait, stop), the library's thread (the events) and the GUI thread (the window), and the
// window itself.
#include "pcba/mmi_pcba.h"

#include <stdio.h>
#include <string.h>

#include <chrono>
#include <condition_variable>
#include <mutex>

#include <android/log.h>

#include "core/ftx_lib_binding.h"
#include "mmi_guithread.h"
#include "mmi_theme.h"
#include "pcba/mmi_pcba_event.h"
#include "testwnd/camera/mmi_testwnd_camera.h"
#include "testwnd/mmi_testwnd.h"
#include "tp_os.h"

#define PCBA_TAG "FTX_PCBA"
#define PCBA_DEBUG(...) __android_log_print(ANDROID_LOG_DEBUG, PCBA_TAG, __VA_ARGS__)
#define PCBA_ERROR(...) __android_log_print(ANDROID_LOG_ERROR, PCBA_TAG, __VA_ARGS__)

namespace {

using Clock = std::chrono::steady_clock;

enum class Kind {
    Event,   // the library's start, answered by an event through pcba_test_callback
    Camera,  // a picture taken; passes when the check's output says "success"
    Wgb,     // the Wgb switch (2, 1); passes when it answers non-zero
};

typedef mmi_hw_named_op<int (*)(ftx_api_module_cb)> event_start_op;

struct Check {
    int number;
    const char *name;      // in the log
    const char *titleKey;  // the window's heading
    Kind kind;
    int event;  // the event that answers it
    event_start_op start;
    mmi_hw_stop_op stop;
    const char *valueKey;     // the value's label in the window
    const char *unit;         // after the value
    const char *replyFormat;  // the PC's value reply, or null
    bool intReply;            // the reply's number is an int
    int waitSeconds;          // for the event, before the check fails (scaled)
    int camera;
};

#define EVENT_OPS(start, stop) MMI_HW_OP(start), MMI_HW_OP(stop)
const Check kChecks[] = {
    {MMI_PCBA_CPU, "cpu", "pcba_Cpu", Kind::Event, FTX_DATATYPE_PCBA_CPU,
     EVENT_OPS(ftx_api_cpu_start, ftx_api_cpu_stop), "pcba_MaxFreq", "kHz", "maxfreq=%llu", false,
     10, 0},
    {MMI_PCBA_MEMORY, "memory", "pcba_Memory", Kind::Event, FTX_DATATYPE_PCBA_MEMORY,
     EVENT_OPS(ftx_api_memory_start, ftx_api_memory_stop), "pcba_MemTotal", "MB",
     "MemTotal=%llu MB", false, 10, 0},
    {MMI_PCBA_BLUETOOTH, "bluetooth", "pcba_Bluetooth", Kind::Event, FTX_DATATYPE_PCBA_BLUETOOTH,
     EVENT_OPS(ftx_api_bluetooth_start, ftx_api_bluetooth_stop), "pcba_Devices", "", nullptr, false,
     30, 0},
    {MMI_PCBA_CAMERA_BACK,
     "back camera",
     "pcba_CameraBack",
     Kind::Camera,
     0,
     {},
     {},
     "pcba_Camera",
     "",
     nullptr,
     false,
     0,
     FTX_CAMERA_BACK},
    {MMI_PCBA_CAMERA_FRONT,
     "front camera",
     "pcba_CameraFront",
     Kind::Camera,
     0,
     {},
     {},
     "pcba_Camera",
     "",
     nullptr,
     false,
     0,
     FTX_CAMERA_FRONT},
    {MMI_PCBA_BATTERY, "battery", "pcba_Battery", Kind::Event, FTX_DATATYPE_PCBA_BATTERY,
     EVENT_OPS(ftx_api_battery_start, ftx_api_battery_stop), "pcba_Level", "%", nullptr, false, 10,
     0},
    {MMI_PCBA_WIFI, "wifi", "pcba_Wifi", Kind::Event, FTX_DATATYPE_PCBA_WIFI,
     EVENT_OPS(ftx_api_wifi_start, ftx_api_wifi_stop), "pcba_AccessPoints", "", nullptr, false, 30,
     0},
    {MMI_PCBA_FM, "fm", "pcba_Fm", Kind::Event, FTX_DATATYPE_PCBA_FM,
     EVENT_OPS(ftx_api_fm_start, ftx_api_fm_stop), "pcba_Signal", "", nullptr, false, 20, 0},
    {MMI_PCBA_GPS, "gps", "pcba_Gps", Kind::Event, FTX_DATATYPE_PCBA_GPS,
     EVENT_OPS(ftx_api_gps_start, ftx_api_gps_stop), "pcba_Satellites", "", nullptr, false, 60, 0},
    {MMI_PCBA_TOUCH, "touch", "pcba_Touch", Kind::Event, FTX_DATATYPE_PCBA_TOUCH,
     EVENT_OPS(ftx_api_touch_start, ftx_api_touch_stop), "pcba_TouchPoints", "", nullptr, false, 30,
     0},
    {MMI_PCBA_STORAGE, "storage", "pcba_Storage", Kind::Event, FTX_DATATYPE_PCBA_STORAGE,
     EVENT_OPS(ftx_api_storage_start, ftx_api_storage_stop), "pcba_StorageSize", "GB",
     "TotalSize=%llu GB", false, 10, 0},
    {MMI_PCBA_SDCARD, "sdcard", "pcba_Sdcard", Kind::Event, FTX_DATATYPE_PCBA_SDCARD,
     EVENT_OPS(ftx_api_sdcard_start, ftx_api_sdcard_stop), "pcba_SdSize", "MB", "TotalSize=%d MB",
     true, 10, 0},
    {MMI_PCBA_SIM, "sim", "pcba_Sim", Kind::Event, FTX_DATATYPE_PCBA_SIM,
     EVENT_OPS(ftx_api_sim_start, ftx_api_sim_stop), "pcba_SimCards", "", nullptr, false, 10, 0},
    {MMI_PCBA_WGB,
     "wgb",
     "pcba_Wgb",
     Kind::Wgb,
     0,
     {},
     {},
     "pcba_Switch",
     "",
     nullptr,
     false,
     0,
     0},
};
#undef EVENT_OPS

const Check *find_check(int number) {
    for (const Check &c : kChecks)
        if (c.number == number) return &c;
    return nullptr;
}

// Why a check failed.
enum Reason {
    REASON_NONE,
    REASON_BOARD,      // the board answered with a failure
    REASON_TIMEOUT,    // no answer within the check's time
    REASON_UNBOUND,    // the library lacks the operation
    REASON_REFUSED,    // the library's start failed
    REASON_BADREPORT,  // the event's text could not be read
    REASON_NOWINDOW,   // the window could not be made, so the check never ran
};
const char *const kReasonKeys[] = {"",
                                   "pcba_BoardFail",
                                   "pcba_NoAnswer",
                                   "pcba_Unbound",
                                   "pcba_Refused",
                                   "pcba_BadReport",
                                   "pcba_NoWindow"};

enum Verdict { PENDING, PASSED, FAILED };

constexpr int kTextSize = 160;

// The running check. Written under `lock`; the window paints a copy.
struct Run {
    int number = MMI_PCBA_NONE;
    Verdict verdict = PENDING;
    Reason reason = REASON_NONE;
    bool hasValue = false;
    unsigned long long value = 0;
    int rc = 0;              // the library's start or switch answer
    char text[kTextSize]{};  // the camera check's output, or an unreadable report
    Clock::time_point started{};
    long waitMs = 0;  // scaled
};

std::mutex s_lock;
std::condition_variable s_decided;
Run s_run;
mmi_ownwnd_state s_wnd;

constexpr int kProgressTimer = 140;
constexpr int kProgressPeriod = 20;  // 10 ms units

// Copies the printable bytes of text (at most len) into out.
void printable(const char *text, size_t len, char *out, size_t size) {
    size_t used = 0;
    for (size_t i = 0; i < len && text[i] != '\0' && used + 1 < size; i++)
        out[used++] = static_cast<unsigned char>(text[i]) >= ' ' && text[i] != 0x7f ? text[i] : '?';
    out[used] = '\0';
}

// Wakes the waiting start and repaints the window; under s_lock.
void decided_locked() {
    s_decided.notify_all();
    HWND hWnd = s_wnd.hwnd.load();
    if (hWnd != HWND_INVALID) PostMessage(hWnd, MSG_CALLBACK, 0, 0);
}

// The verdict of check `number`, unless it has one or another check runs meanwhile.
void decide(int number, Verdict v, Reason why, int rc = 0) {
    std::lock_guard<std::mutex> lk(s_lock);
    if (s_run.number != number || s_run.verdict != PENDING) return;
    s_run.verdict = v;
    s_run.reason = v == PASSED ? REASON_NONE : why;
    s_run.rc = rc;
    decided_locked();
}

// Runs the check (GUI thread, the window's creation).
void run_check(const Check &c) {
    switch (c.kind) {
        case Kind::Event: {
            if (!c.start.bound()) {
                PCBA_ERROR("%s::%s is not in the library", c.name, c.start.name);
                decide(c.number, FAILED, REASON_UNBOUND);
                return;
            }
            const int rc = (*c.start.op)(pcba_test_callback);
            PCBA_DEBUG("%s::%s ret=%d", c.name, c.start.name, rc);
            if (rc != 0) decide(c.number, FAILED, REASON_REFUSED, rc);
            return;
        }
        case Kind::Camera: {
            char out[kTextSize];
            mmi_camera_check(c.camera, out, sizeof out);
            PCBA_DEBUG("%s::camera check: %s", c.name, out);
            const bool ok = strstr(out, "success") != nullptr;
            {
                std::lock_guard<std::mutex> lk(s_lock);
                if (s_run.number == c.number) tp_os_strlcpy(s_run.text, out, sizeof s_run.text);
            }
            decide(c.number, ok ? PASSED : FAILED, REASON_NONE);  // the output says why
            return;
        }
        case Kind::Wgb: {
            if (!hw::ftx_api_wgb_start) {
                PCBA_ERROR("%s::ftx_api_wgb_start is not in the library", c.name);
                decide(c.number, FAILED, REASON_UNBOUND);
                return;
            }
            const int rc = hw::ftx_api_wgb_start(2, 1);
            PCBA_DEBUG("%s::ftx_api_wgb_start(2,1) ret=%d", c.name, rc);
            decide(c.number, rc != 0 ? PASSED : FAILED, REASON_BOARD, rc);
            return;
        }
    }
}

// The library's stop of the check (command or GUI thread).
void stop_check(const Check &c) {
    if (c.kind == Kind::Wgb) {
        if (hw::ftx_api_wgb_start) {
            const int rc = hw::ftx_api_wgb_start(2, 0);
            PCBA_DEBUG("%s::ftx_api_wgb_start(2,0) ret=%d", c.name, rc);
        }
        return;
    }
    if (c.stop.bound()) {
        const int rc = (*c.stop.op)();
        PCBA_DEBUG("%s::%s ret=%d", c.name, c.stop.name, rc);
    }
}

// ---- the window ----

constexpr auto &text_at = mmi_testwnd_text_at;
constexpr auto &key_at = mmi_testwnd_key_at;

// Where the window draws, for a screen w x h: the heading band, the check's name, then
// either the progress (a status line over a bar) or the value (its label over it), the
// verdict band and the reason of a fail; the footer band at the bottom.
struct Layout {
    int line;  // the body font's line
    RECT header, name, status, progress, value, verdict, reason, footer;
};

Layout layout_for(int w, int h) {
    Layout l;
    l.line = mmi_logfont_size(3, w) * 3 / 2;
    const int band = l.line * 3 / 2;
    const int margin = w / 16;
    const int big = mmi_logfont_size(1, w) * 3 / 2;
    l.header = {0, 0, w, band};
    l.footer = {0, h - band, w, h};
    int y = band + l.line;
    l.name = {margin, y, w - margin, y + big};
    y = l.name.bottom + l.line;
    l.status = {margin, y, w - margin, y + l.line};
    y = l.status.bottom + l.line / 2;
    l.progress = {margin, y, w - margin, y + l.line * 2 / 3};
    l.value = {margin, y, w - margin, y + big * 2};  // wraps when it is a camera's output
    y = l.value.bottom + l.line;
    l.verdict = {margin, y, w - margin, y + big * 3 / 2};
    y = l.verdict.bottom + l.line / 2;
    l.reason = {margin, y, w - margin, y + 3 * l.line};
    return l;
}

// The value's text: the number and its unit, the camera's output or the switch's answer.
void value_text(const Check &c, const Run &r, char *out, size_t size) {
    if (c.kind == Kind::Camera) {
        tp_os_strlcpy(out, r.text, size);
    } else if (c.kind == Kind::Wgb) {
        mmi_translate(r.verdict == PASSED ? "pcba_SwitchedOn" : "pcba_NotSwitched", out, size);
    } else {
        snprintf(out, size, "%llu%s%s", r.value, c.unit[0] != '\0' && c.unit[0] != '%' ? " " : "",
                 c.unit);
    }
}

void paint_progress(HDC hdc, const Check &c, const Run &r, const Layout &l) {
    const long elapsed = static_cast<long>(
        std::chrono::duration_cast<std::chrono::milliseconds>(Clock::now() - r.started).count());
    const long wait = r.waitMs > 0 ? r.waitMs : 1;
    const long done = elapsed < wait ? elapsed : wait;
    char word[MMI_TESTWND_TEXT_SIZE], text[MMI_TESTWND_TEXT_SIZE * 2 + 32];
    mmi_translate("pcba_Checking", word, sizeof word);
    if (c.waitSeconds > 0) {
        char left[MMI_TESTWND_TEXT_SIZE];
        mmi_translate("card_TimeLeft", left, sizeof left);
        const long seconds = (c.waitSeconds * (wait - done) + wait - 1) / wait;
        snprintf(text, sizeof text, "%s    %s %ld s", word, left, seconds);
    } else {
        tp_os_strlcpy(text, word, sizeof text);
    }
    text_at(hdc, 3, MMI_COLOUR_TEXT, text, l.status, DT_LEFT | DT_VCENTER | DT_SINGLELINE);
    const RECT &p = l.progress;
    SetPenColor(hdc, mmi_pixel(MMI_COLOUR_FRAME));
    SetPenWidth(hdc, 1);
    Rectangle(hdc, p.left, p.top, p.right - 1, p.bottom - 1);
    const int fill = static_cast<int>((p.right - p.left - 4) * done / wait);
    SetBrushColor(hdc, mmi_pixel(MMI_COLOUR_BLUE));
    FillBox(hdc, p.left + 2, p.top + 2, fill, p.bottom - p.top - 4);
}

void paint(HWND hWnd, const Check &c) {
    Run r;
    {
        std::lock_guard<std::mutex> lk(s_lock);
        r = s_run;
    }
    const int w = g_ptScreenInfo.width;
    const Layout l = layout_for(w, g_ptScreenInfo.height);
    HDC hdc = BeginPaint(hWnd);
    SetBkMode(hdc, BM_TRANSPARENT);
    SetBrushColor(hdc, mmi_pixel(MMI_COLOUR_BAR));
    FillBox(hdc, l.header.left, l.header.top, RECTW(l.header), RECTH(l.header));
    FillBox(hdc, l.footer.left, l.footer.top, RECTW(l.footer), RECTH(l.footer));
    SetPenColor(hdc, mmi_pixel(MMI_COLOUR_PASS));
    SetPenWidth(hdc, 3);
    MoveTo(hdc, 0, l.header.bottom);
    LineTo(hdc, w, l.header.bottom);
    const UINT centred = DT_CENTER | DT_VCENTER | DT_SINGLELINE;
    key_at(hdc, 3, MMI_COLOUR_TEXT, "pcba_Title", l.header, centred);
    key_at(hdc, 4, MMI_COLOUR_TEXT, "pcba_ByPc", l.footer, centred);
    key_at(hdc, 1, MMI_COLOUR_TEXT, c.titleKey, l.name, centred);
    if (r.verdict == PENDING) {
        paint_progress(hdc, c, r, l);
        EndPaint(hWnd, hdc);
        return;
    }
    const bool passed = r.verdict == PASSED;
    const int colour = passed ? MMI_COLOUR_PASS : MMI_COLOUR_FAIL;
    if (r.hasValue || c.kind != Kind::Event) {
        char value[MMI_TESTWND_TEXT_SIZE];
        value_text(c, r, value, sizeof value);
        key_at(hdc, 3, MMI_COLOUR_TEXT, c.valueKey, l.status, centred);
        if (c.kind == Kind::Camera)
            text_at(hdc, 4, colour, value, l.value, DT_CENTER | DT_WORDBREAK);
        else
            text_at(hdc, 1, colour, value, l.value, centred);
    }
    // The verdict on a band of its colour, to be seen from across the bench.
    SetBrushColor(hdc, mmi_pixel(colour));
    FillBox(hdc, l.verdict.left, l.verdict.top, RECTW(l.verdict), RECTH(l.verdict));
    key_at(hdc, 1, MMI_COLOUR_WINDOW, passed ? "pcba_Pass" : "pcba_Fail", l.verdict, centred);
    if (!passed && r.reason != REASON_NONE) {
        char why[MMI_TESTWND_TEXT_SIZE], text[MMI_TESTWND_TEXT_SIZE * 2];
        mmi_translate(kReasonKeys[r.reason], why, sizeof why);
        if (r.reason == REASON_TIMEOUT)
            snprintf(text, sizeof text, "%s %d s", why, c.waitSeconds);
        else if (r.reason == REASON_REFUSED)
            snprintf(text, sizeof text, "%s (%d)", why, r.rc);
        else if (r.reason == REASON_BADREPORT)
            snprintf(text, sizeof text, "%s \"%s\"", why, r.text);
        else
            tp_os_strlcpy(text, why, sizeof text);
        text_at(hdc, 4, MMI_COLOUR_FAIL, text, l.reason, DT_CENTER | DT_WORDBREAK);
    }
    EndPaint(hWnd, hdc);
}

Verdict verdict_now() {
    std::lock_guard<std::mutex> lk(s_lock);
    return s_run.verdict;
}

LRESULT pcba_proc(HWND hWnd, UINT message, WPARAM wParam, LPARAM lParam) {
    const auto *c = reinterpret_cast<const Check *>(mmi_window_data(hWnd, message, lParam));
    if (c == nullptr) return DefaultMainWinProc(hWnd, message, wParam, lParam);
    switch (message) {
        case MSG_CREATE:
            mmi_set_current_test(PCBA_TAG);
            s_wnd.hwnd = hWnd;
            s_wnd.created = 1;
            SetTimer(hWnd, kProgressTimer, kProgressPeriod);
            run_check(*c);
            break;
        case MSG_PAINT:
            paint(hWnd, *c);
            return 0;
        case MSG_TIMER:
            if (wParam != kProgressTimer) return 0;
            if (verdict_now() != PENDING) {
                KillTimer(hWnd, kProgressTimer);
                InvalidateRect(hWnd, nullptr, TRUE);
            } else {
                const Layout l = layout_for(g_ptScreenInfo.width, g_ptScreenInfo.height);
                RECT both = {l.status.left, l.status.top, l.progress.right, l.progress.bottom};
                InvalidateRect(hWnd, &both, TRUE);
            }
            return 0;
        case MSG_CALLBACK:
            KillTimer(hWnd, kProgressTimer);
            InvalidateRect(hWnd, nullptr, TRUE);
            return 0;
        case MSG_CLOSE:
            KillTimer(hWnd, kProgressTimer);
            mmi_ownwnd_destroy(&s_wnd, hWnd);
            return 0;
        default:
            break;
    }
    return DefaultMainWinProc(hWnd, message, wParam, lParam);
}

int open_on_gui(void *arg) {
    const Check *c = static_cast<const Check *>(arg);
    HWND hWnd = mmi_testwnd_create_full("PCBA Test", pcba_proc, reinterpret_cast<DWORD>(c));
    return mmi_ownwnd_opened(&s_wnd, hWnd, PCBATestStop) != HWND_INVALID ? 1 : 0;
}

// The value reply of a check that has one.
void write_reply(const Check &c, const Run &r, char *reply, unsigned int size) {
    if (c.replyFormat == nullptr || !r.hasValue || reply == nullptr || size == 0) return;
    const size_t room = size < MMI_PCBA_REPLY_MAX ? size : MMI_PCBA_REPLY_MAX;
    if (c.intReply)
        snprintf(reply, room, c.replyFormat, static_cast<int>(r.value));
    else
        snprintf(reply, room, c.replyFormat, r.value);
}

}  // namespace

int mmi_pcba_current(void) {
    std::lock_guard<std::mutex> lk(s_lock);
    return s_run.number;
}

void pcba_test_callback(module_data *data) {
    if (data == nullptr) return;
    const char *text = data->data != nullptr ? data->data : "";
    const size_t len = data->data != nullptr ? data->totallen : 0;
    mmi_pcba_event ev;
    const int parsed = mmi_pcba_parse_event(text, len, &ev);
    std::lock_guard<std::mutex> lk(s_lock);
    const Check *c = find_check(s_run.number);
    if (c == nullptr || c->kind != Kind::Event || c->event != data->datatype ||
        s_run.verdict != PENDING) {
        PCBA_DEBUG("%s::event %d ignored (test %d)", __func__, data->datatype, s_run.number);
        return;
    }
    if (parsed != 0) {
        printable(text, len, s_run.text, sizeof s_run.text);
        PCBA_ERROR("%s::%s: unreadable report \"%s\"", __func__, c->name, s_run.text);
        s_run.verdict = FAILED;
        s_run.reason = REASON_BADREPORT;
    } else {
        s_run.hasValue = true;
        s_run.value = ev.value;
        s_run.verdict = ev.result == 1 ? PASSED : FAILED;
        s_run.reason = ev.result == 1 ? REASON_NONE : REASON_BOARD;
        PCBA_DEBUG("%s::%s value=%llu result=%d", __func__, c->name, ev.value, ev.result);
    }
    decided_locked();
}

int mmi_pcba_start(int number, char *reply, unsigned int size) {
    const Check *c = find_check(number);
    if (c == nullptr) return 0;
    PCBATestStop();
    {
        std::lock_guard<std::mutex> lk(s_lock);
        s_run = Run{};
        s_run.number = number;
        s_run.started = Clock::now();
        const double ms = c->waitSeconds * 1000.0 * tp_os_time_scale();
        s_run.waitMs = ms < 1.0 ? 1 : static_cast<long>(ms);
    }
    PCBA_DEBUG("%s::test %d (%s)", __func__, number, c->name);
    Init_lib_Interface_all();
    if (mmi_RunOnGuiThread(open_on_gui, const_cast<Check *>(c)) != 1) {
        PCBA_ERROR("%s::%s: no window, the check did not run", __func__, c->name);
        decide(number, FAILED, REASON_NOWINDOW);
    }
    Run r;
    {
        std::unique_lock<std::mutex> lk(s_lock);
        const bool answered = s_decided.wait_for(
            lk, std::chrono::milliseconds(s_run.waitMs),
            [number] { return s_run.number != number || s_run.verdict != PENDING; });
        if (!answered && s_run.number == number) {
            PCBA_ERROR("%s::%s: no answer within %d s", __func__, c->name, c->waitSeconds);
            s_run.verdict = FAILED;
            s_run.reason = REASON_TIMEOUT;
            decided_locked();
        }
        r = s_run;
    }
    write_reply(*c, r, reply, size);
    PCBA_DEBUG("%s::%s verdict=%s", __func__, c->name, r.verdict == PASSED ? "pass" : "fail");
    return r.number == number && r.verdict == PASSED ? 1 : 0;
}

int PCBATestStop(void) {
    int number;
    {
        std::lock_guard<std::mutex> lk(s_lock);
        number = s_run.number;
    }
    if (number == MMI_PCBA_NONE) return 1;
    PCBA_DEBUG("%s::test %d", __func__, number);
    const Check *c = find_check(number);
    if (c != nullptr) stop_check(*c);
    {
        std::lock_guard<std::mutex> lk(s_lock);
        if (s_run.number == number) s_run.number = MMI_PCBA_NONE;
        s_decided.notify_all();
    }
    mmi_ownwnd_close(&s_wnd);
    tp_os_usleep(100000);
    return 1;
}

int ReadCameraIDTestStart(const char *parm, int, char *, unsigned int) {
    const int id = parm != nullptr && strchr(parm, '3') != nullptr ? 3 : 2;
    Init_lib_Interface_all();
    if (!hw::ftx_api_cameraID_test) {
        PCBA_ERROR("%s::ftx_api_cameraID_test is not in the library", __func__);
        return 0;
    }
    const int rc = hw::ftx_api_cameraID_test(id);
    PCBA_DEBUG("%s::ftx_api_cameraID_test(%d) ret=%d", __func__, id, rc);
    return rc == 0 ? 1 : 0;
}

#define PCBA_START(Name, number)                                \
    int PCBA##Name##TestStart(char *reply, unsigned int size) { \
        return mmi_pcba_start(number, reply, size);             \
    }
PCBA_START(Cpu, MMI_PCBA_CPU)
PCBA_START(Memory, MMI_PCBA_MEMORY)
PCBA_START(Bluetooth, MMI_PCBA_BLUETOOTH)
PCBA_START(CameraBack, MMI_PCBA_CAMERA_BACK)
PCBA_START(CameraFront, MMI_PCBA_CAMERA_FRONT)
PCBA_START(Battery, MMI_PCBA_BATTERY)
PCBA_START(Wifi, MMI_PCBA_WIFI)
PCBA_START(Gps, MMI_PCBA_GPS)
PCBA_START(Touch, MMI_PCBA_TOUCH)
PCBA_START(Storage, MMI_PCBA_STORAGE)
PCBA_START(Sdcard, MMI_PCBA_SDCARD)
#undef PCBA_START

#define PCBA_START_PARM(Name, number)                                              \
    int PCBA##Name##TestStart(const char *, int, char *reply, unsigned int size) { \
        return mmi_pcba_start(number, reply, size);                                \
    }
PCBA_START_PARM(Fm, MMI_PCBA_FM)
PCBA_START_PARM(Sim, MMI_PCBA_SIM)
PCBA_START_PARM(Wgb, MMI_PCBA_WGB)
#undef PCBA_START_PARM

// The battery test window. Its timer reads the battery observer's last record (the factory
// library's battery text until the first record arrives) on the GUI thread, judges each line
// against the item's limits and repaints what changed; the window's state is the GUI
// thread's.
#include "testwnd/battery/mmi_testwnd_battery.h"

#include <stdio.h>
#include <string.h>

#include <atomic>

#include <android/log.h>

#include "core/mmi_power.h"
#include "mmi_theme.h"
#include "testwnd/battery/mmi_battery_lines.h"
#include "testwnd/mmi_testwnd.h"
#include "tp_os.h"

#define BAT_DEBUG(...) __android_log_print(ANDROID_LOG_DEBUG, kTag, __VA_ARGS__)
#define BAT_ERROR(...) __android_log_print(ANDROID_LOG_ERROR, kTag, __VA_ARGS__)

namespace {

const char *const kTag = catalogue::Battery.domain;
const char kCaption[] = "Battery Test";
const char kNoteKey[] = "info_BatteryNote";
const int kTimerId = 121;
const int kTimerPeriod = 50;   // 10 ms units: twice each battery service round
const int kPassRefreshes = 2;  // refreshes in a row with every value inside
const int kParamsMax = 12;

mmi_ownwnd_state s_wnd;
// 1 while the PC opened the window: it then waits for the PC's verdict.
std::atomic<int> s_byPc{0};
mmi_battery_limits s_limits;  // read at each open, before the window exists

// GUI thread only: what the window shows.
struct Screen {
    char text[MMI_BATTERY_LINES][MMI_TESTWND_TEXT_SIZE];
    int inside[MMI_BATTERY_LINES];
    char logged[MMI_BATTERY_LINES][MMI_TESTWND_TEXT_SIZE];  // last outside text logged
    int streak;      // refreshes in a row with every value inside
    bool allInside;  // at the last refresh
    bool passOffered;
    bool fallbackLogged;
};
Screen s;

struct Params {
    ftx_config_para p[kParamsMax];
    int n;
};

int param_of(const char *key, int def, void *ctx) {
    const Params *params = static_cast<const Params *>(ctx);
    char text[16];
    snprintf(text, sizeof text, "%d", def);
    return mmi_testwnd_param_int(params->p, params->n, key, text);
}

void read_limits(void) {
    Params params;
    params.n = mmi_testwnd_params(kTag, params.p, kParamsMax);
    mmi_battery_read_limits(param_of, &params, &s_limits);
    BAT_DEBUG("%s::level %d..%d voltage %d..%d temperature %d..%d", __func__,
              s_limits.min[MMI_BATTERY_LEVEL], s_limits.max[MMI_BATTERY_LEVEL],
              s_limits.min[MMI_BATTERY_VOLTAGE], s_limits.max[MMI_BATTERY_VOLTAGE],
              s_limits.min[MMI_BATTERY_TEMPERATURE], s_limits.max[MMI_BATTERY_TEMPERATURE]);
}

// The observer's last record, else the library's own reading; false when neither is there.
bool read_values(mmi_battery_values *v) {
    FTX_BATTERY_INFO info;
    if (mmi_battery_snapshot(&info) == 0) {
        *v = {.level = info.batteryLevel,
              .voltage = info.batteryVoltage,
              .temperature = info.batteryTemperature,
              .status = info.batteryStatus,
              .health = info.batteryHealth,
              .chargersKnown = 1,
              .ac = info.chargerAcOnline,
              .usb = info.chargerUsbOnline,
              .wireless = info.chargerWirelessOnline};
        return true;
    }
    char text[MMI_TESTWND_TEXT_SIZE] = {0};
    const int rc = hw::ftx_api_Battery_Test ? hw::ftx_api_Battery_Test(text, sizeof text) : -1;
    text[sizeof text - 1] = '\0';
    const bool ok = rc == 0 && mmi_battery_parse(text, v) == 0;
    if (!s.fallbackLogged) {
        BAT_DEBUG("%s::no battery record yet, ftx_api_Battery_Test ret=%d text=%s%s", __func__, rc,
                  text, ok ? "" : " (not read)");
        s.fallbackLogged = true;
    }
    return ok;
}

void offer_pass(HWND hWnd, bool offer) {
    s.passOffered = offer;
    mmi_testwnd_show_keys(hWnd, catalogue::Battery.titleKey, offer ? MMI_TIMER_FOOLPROOF : 0);
}

void pass_and_close(HWND hWnd) {
    mmi_testwnd_pass_and_close(hWnd, catalogue::Battery.resultIndex, kTag);
}

void fail_and_close(HWND hWnd) {
    mmi_testwnd_fail_and_close(hWnd, catalogue::Battery.resultIndex);
}

// Reads and judges every line; true when the window is to pass now.
bool refresh(HWND hWnd) {
    mmi_battery_values v;
    const bool known = read_values(&v);
    bool all = known, changed = false;
    for (int i = 0; i < MMI_BATTERY_LINES; i++) {
        char text[MMI_TESTWND_TEXT_SIZE];
        const int inside =
            mmi_battery_line(i, known ? &v : nullptr, &s_limits, mmi_translate, text, sizeof text);
        if (!inside && strcmp(text, s.logged[i]) != 0) {
            BAT_DEBUG("outside: %s", text);
            snprintf(s.logged[i], sizeof s.logged[i], "%s", text);
        }
        if (inside) s.logged[i][0] = '\0';
        changed |= inside != s.inside[i] || strcmp(text, s.text[i]) != 0;
        s.inside[i] = inside;
        snprintf(s.text[i], sizeof s.text[i], "%s", text);
        all = all && inside;
    }
    s.allInside = all;
    s.streak = all ? s.streak + 1 : 0;
    if (changed) InvalidateRect(hWnd, nullptr, TRUE);
    if (all != s.passOffered) offer_pass(hWnd, all);
    return s.streak >= kPassRefreshes && !s_byPc.load();
}

void paint(HWND hWnd) {
    HDC hdc = BeginPaint(hWnd);
    const int w = g_ptScreenInfo.width;
    // The note above the lines, the lines one below the other at twice the font's height.
    const int listTop = (w / 15) * 3 + 30;
    const int rowHeight = 2 * mmi_logfont_size(3, w);
    const int margin = w / 16;
    mmi_testwnd_draw_top_line(hdc);
    SetBkMode(hdc, BM_TRANSPARENT);
    char note[MMI_TESTWND_TEXT_SIZE];
    mmi_translate(kNoteKey, note, sizeof note);
    SetTextColor(hdc, mmi_pixel(MMI_COLOUR_TEXT));
    RECT rc = {w / 8, w / 15 + 10, w - w / 8, listTop};
    DrawText(hdc, note, -1, &rc, DT_WORDBREAK);
    for (int i = 0; i < MMI_BATTERY_LINES; i++) {
        SetTextColor(hdc, mmi_pixel(s.inside[i] ? MMI_COLOUR_PASS : MMI_COLOUR_FAIL));
        RECT row = {margin, listTop + i * rowHeight, w - margin, listTop + (i + 1) * rowHeight};
        DrawText(hdc, s.text[i], -1, &row, DT_LEFT | DT_VCENTER | DT_SINGLELINE);
    }
    EndPaint(hWnd, hdc);
}

LRESULT battery_proc(HWND hWnd, UINT message, WPARAM wParam, LPARAM lParam) {
    if (mmi_ownwnd_verdict(
            message, wParam, s.passOffered, [&] { pass_and_close(hWnd); },
            [&] {
                if (message == MSG_KEYDOWN) BAT_DEBUG("%s fail key", __func__);
                fail_and_close(hWnd);
            }))
        return 0;
    switch (message) {
        case MSG_CREATE:
            if (g_mmiLogFont[3]) SetWindowFont(hWnd, g_mmiLogFont[3]);
            memset(&s, 0, sizeof s);
            mmi_ownwnd_created(&s_wnd, hWnd, kTag);
            refresh(hWnd);  // one refresh of two: the window cannot pass before it shows
            SetTimer(hWnd, kTimerId, kTimerPeriod);
            break;
        case MSG_ACTIVE:
            if (mmi_ownwnd_refuses(&s_wnd, message, kTag)) return 0;
            if (wParam == 1) offer_pass(hWnd, s.passOffered);
            break;
        case MSG_PAINT:
            if (mmi_ownwnd_refuses(&s_wnd, message, kTag)) return 0;
            paint(hWnd);
            return 0;
        case MSG_TIMER:
            if (wParam != kTimerId) return 0;
            if (refresh(hWnd)) {
                BAT_DEBUG("every value inside for %d refreshes: pass", kPassRefreshes);
                pass_and_close(hWnd);
            }
            return 0;
        case MSG_KEYDOWN:
            return 0;
        case MSG_CLOSE:
            KillTimer(hWnd, kTimerId);
            mmi_ownwnd_destroy(&s_wnd, hWnd);
            return 0;
        default:
            break;
    }
    return DefaultMainWinProc(hWnd, message, wParam, lParam);
}

void *open_window(void) {
    if (Init_lib_Battery_Interface() != 0) {
        BAT_ERROR("%s::Init_lib_Battery_Interface fail, test not opened", __func__);
        return HWND_INVALID;
    }
    read_limits();
    return mmi_ownwnd_opened(&s_wnd, mmi_testwnd_create(kCaption, battery_proc, 0),
                             mmi_testwnd_BatteryTest_Stop_Entry);
}

// The PC's verdict, on the GUI thread.
int battery_verdict(char *, unsigned int) {
    BAT_DEBUG("%s::all inside=%d", __func__, s.allInside ? 1 : 0);
    return s.allInside ? 1 : 0;
}

int charging_set(const char *who, int enable) {
    if (!hw::FTX_API_BatteryService_ChargingStatusSet) {
        BAT_ERROR("%s::FTX_API_BatteryService_ChargingStatusSet not bound", who);
        return 0;
    }
    const int rc = hw::FTX_API_BatteryService_ChargingStatusSet(enable);
    BAT_DEBUG("%s::FTX_API_BatteryService_ChargingStatusSet(%d) ret=%d", who, enable, rc);
    return rc == 0 ? 1 : 0;
}

}  // namespace

void *mmi_testwnd_BatteryTestEntry(void) {
    s_byPc = 0;
    return open_window();
}

int mmi_testwnd_BatteryTest_Stop_Entry(void) {
    return mmi_ownwnd_stop(&s_wnd);
}

int mmi_AutoTest_BatteryTestEntry(void) {
    if (Init_lib_Battery_Interface() != 0) return 0;
    s_byPc = 1;
    return mmi_ownwnd_pc_open(&s_wnd, open_window);
}

int mmi_AutoTest_BatteryTest_Stop_Entry(char *reply, unsigned int size) {
    const int verdict = mmi_ownwnd_pc_stop(&s_wnd, battery_verdict, reply, size);
    if (verdict < 0) BAT_ERROR("%s::no battery window open", __func__);
    return verdict > 0 ? 1 : 0;
}

int mmi_AutoTest_battery_Charge_Enable(void) {
    return charging_set(__func__, 1);
}

int mmi_AutoTest_battery_Charge_Disable(void) {
    return charging_set(__func__, 0);
}

// The panel self-test window and the failure map. The library's verdict arrives on its own
// thread: it leaves the verdict and the failure data (under a lock) for the GUI thread's
// 200 ms timer to pick up.
#include "testwnd/touch/mmi_testwnd_tpself.h"

#include <stdio.h>
#include <string.h>

#include <atomic>
#include <mutex>

#include <android/log.h>

#include "mmi_bars.h"
#include "mmi_guithread.h"
#include "mmi_theme.h"
#include "session/mmi_autotest.h"
#include "testwnd/mmi_testwnd.h"
#include "testwnd/touch/mmi_testwnd_touch.h"
#include "testwnd/touch/mmi_tp_rawdata.h"
#include "tp_os.h"

#define TP_DEBUG(...) __android_log_print(ANDROID_LOG_DEBUG, kTag, __VA_ARGS__)
#define TP_ERROR(...) __android_log_print(ANDROID_LOG_ERROR, kTag, __VA_ARGS__)

namespace {

const char *const kTag = catalogue::TpSelf.domain;
const char kMapTag[] = "FTX_TPRAWDATA";
const int kTimerId = 120;
const int kTimerPeriod = 20;  // 10 ms units
const int kTimeOutTicks = 61;
const int kFirmwareWaitUs = 500000;
const WPARAM kKeyMiddle = 62;
const WPARAM kKeyUp = 103;
const WPARAM kKeyBack = 88;
const int kTextSize = 1024;

// Verdicts that mean the panel is fine (or cannot be judged here).
enum {
    kRawNormal = 0,
    kRawReadFail = -1,
    kTypeUnsupported = -2,
    kLoadFail = -3,
    kMakerUnsupported = -4,
};

// The verdicts with a text of their own; the others are failure bits.
struct VerdictText {
    int verdict;
    const char *key;
    bool pass;
};
const VerdictText kVerdicts[] = {
    {kRawNormal, "info_rawdata", true},
    {kMakerUnsupported, "info_NotSupportManufacturerModule", true},
    {kTypeUnsupported, "info_NotSupportCurrentModuleType", true},
    {kRawReadFail, "info_GetRawDataFail", true},
    {kLoadFail, "info_LoadDllFail", false},
};

struct BitText {
    int bit;
    const char *key;
};
const BitText kBits[] = {
    {0, "info_beyond_max_limit"},
    {1, "info_beyond_min_limit"},
    {2, "info_beyond_accord_limit"},
    {5, "info_key_beyond_max_limit"},
    {6, "info_key_beyond_max_limit"},
    {7, "info_module_type_error"},
    {8, "info_version_error"},
    {9, "info_GT_OPEN"},
    {10, "info_GT_SHORT"},
};

mmi_ownwnd_state s_wnd;
std::atomic<int> s_preview{0};
// The verdict, written by the library's thread.
std::atomic<int> gTpdTestResult{0};
std::atomic<int> s_arrived{0};
std::mutex s_rawLock;
mmi_tp_raw g_TPSelfRawFailData;

// GUI thread only: what the window shows.
struct Screen {
    char title[MMI_TESTWND_TEXT_SIZE];
    char firmwareTitle[MMI_TESTWND_TEXT_SIZE];
    char noTouch[MMI_TESTWND_TEXT_SIZE];
    char detailKey[MMI_TESTWND_TEXT_SIZE];
    char firmware[FTX_FIRMWARE_TEXT_SIZE];
    char status[MMI_TESTWND_TEXT_SIZE];
    int statusColour;
    char detail[kTextSize];
    int detailColour;
    int ticks;
    bool started;
    bool passShown;
};
Screen s;

// The failure map.
mmi_ownwnd_state s_map;
WPARAM s_mapLastKey = 0;

void append_line(char *out, unsigned int size, const char *text) {
    const size_t used = strlen(out);
    snprintf(out + used, size - used, "%s%s", used > 0 ? "\n" : "", text);
}

void add_text(char *out, unsigned int size, const char *key, bool translate) {
    char text[MMI_TESTWND_TEXT_SIZE];
    if (translate)
        mmi_translate(key, text, sizeof(text));
    else
        tp_os_strlcpy(text, key, sizeof(text));
    append_line(out, size, text);
}

void draw_area(HDC hdc, int top, int height, int background, const char *text, int colour,
               UINT format) {
    const int w = g_ptScreenInfo.width;
    SetBrushColor(hdc, mmi_pixel(background));
    FillBox(hdc, 0, top, w, height);
    SetTextColor(hdc, mmi_pixel(colour));
    // A margin on both sides: a long text wraps rather than touching the screen's edge.
    const int margin = w / 40;
    RECT rc = {margin, top, w - margin, top + height};
    DrawText(hdc, text, -1, &rc, format);
}

void paint(HWND hWnd) {
    HDC hdc = BeginPaint(hWnd);
    const int w = g_ptScreenInfo.width, h = g_ptScreenInfo.height;
    const int row = w / 15 + 10;
    SetBkMode(hdc, BM_TRANSPARENT);
    const UINT line = DT_CENTER | DT_VCENTER | DT_SINGLELINE;
    draw_area(hdc, 0, row, MMI_COLOUR_DARK_GRAY, s.firmwareTitle, MMI_COLOUR_TEXT, line);
    draw_area(hdc, row, 5 * row, MMI_COLOUR_WINDOW, s.firmware, MMI_COLOUR_TEXT, DT_WORDBREAK);
    draw_area(hdc, 6 * row, row, MMI_COLOUR_DARK_GRAY, s.status, s.statusColour, line);
    const int detailTop = (w / 15) * 7 + 70;
    const int detailBottom = h - (h / 15 + 10);
    draw_area(hdc, detailTop, detailBottom - detailTop, MMI_COLOUR_WINDOW, s.detail, s.detailColour,
              DT_CENTER | DT_WORDBREAK);
    mmi_testwnd_draw_top_line(hdc);
    EndPaint(hWnd, hdc);
}

void set_status(HWND hWnd, const char *text, int colour) {
    tp_os_strlcpy(s.status, text, sizeof(s.status));
    s.statusColour = colour;
    InvalidateRect(hWnd, nullptr, TRUE);
}

void show_result(HWND hWnd, bool pass) {
    char word[MMI_TESTWND_TEXT_SIZE], status[MMI_TESTWND_TEXT_SIZE * 2];
    char fail[MMI_TESTWND_TEXT_SIZE];
    mmi_translate(pass ? "Result_pass" : "Result_fail", word, sizeof(word));
    mmi_translate("Result_fail", fail, sizeof(fail));
    snprintf(status, sizeof(status), "%s:%s", s.title, word);
    const int colour = pass ? MMI_COLOUR_PASS : MMI_COLOUR_FAIL;
    s.detailColour = colour;
    set_status(hWnd, status, colour);
    s.passShown = pass;
    if (pass)
        mmi_testwnd_set_bars(hWnd, nullptr, word, "", fail);
    else
        mmi_testwnd_set_bars(hWnd, nullptr, "", s.detailKey, fail);
}

void close_window(HWND hWnd) {
    SendMessage(hWnd, MSG_CLOSE, 0, 0);
}

void judge(HWND hWnd) {
    const int verdict = gTpdTestResult.load();
    const bool pass = mmi_tp_verdict_detail(verdict, s.detail, sizeof(s.detail), true) == 1;
    show_result(hWnd, pass);
    // Panels the test cannot judge pass a run without a result.
    if ((verdict == kTypeUnsupported || verdict == kRawReadFail) && g_bAutoTestRunning == 1) {
        close_window(hWnd);
        mmi_startNextItemTest(kTag);
    }
}

void tick(HWND hWnd) {
    s.ticks++;
    if (!s_arrived.load()) {
        if (s.ticks >= kTimeOutTicks) {
            TP_DEBUG("%s timer trigger %d times.", __func__, s.ticks);
            KillTimer(hWnd, kTimerId);
            tp_os_strlcpy(s.detail, "TimeOut", sizeof(s.detail));
            show_result(hWnd, false);
            char fail[MMI_TESTWND_TEXT_SIZE];
            mmi_translate("Result_fail", fail, sizeof(fail));
            mmi_testwnd_set_bars(hWnd, nullptr, "", "", fail);
        } else if (s.ticks >= 2) {
            static const char *const kDots[] = {".    ", ". .  ", ". . ."};
            char status[MMI_TESTWND_TEXT_SIZE * 3];
            snprintf(status, sizeof(status), "%s : %s %s", s.title, s.noTouch, kDots[s.ticks % 3]);
            set_status(hWnd, status, MMI_COLOUR_HILIGHT_TEXT);
        }
        return;
    }
    KillTimer(hWnd, kTimerId);
    TP_DEBUG("%s timer trigger %d times.", __func__, s.ticks);
    judge(hWnd);
}

// The first paint starts the library's test.
void start(HWND hWnd) {
    s.started = true;
    if (s.firmware[0] == '\0') tp_os_usleep(kFirmwareWaitUs);
    char status[MMI_TESTWND_TEXT_SIZE * 3];
    snprintf(status, sizeof(status), "%s: %s", s.title, s.noTouch);
    set_status(hWnd, status, MMI_COLOUR_FAIL);
    if (hw::ftx_api_tpd_SelfTest_Start) hw::ftx_api_tpd_SelfTest_Start(tpd_auto_test_callback);
    SetTimer(hWnd, kTimerId, kTimerPeriod);
}

LRESULT mmi_TPSelfTestWndProc(HWND hWnd, UINT message, WPARAM wParam, LPARAM lParam) {
    switch (message) {
        case MSG_CREATE:
            if (g_mmiLogFont[3]) SetWindowFont(hWnd, g_mmiLogFont[3]);
            memset(s.firmware, 0, sizeof(s.firmware));
            if (hw::ftx_api_GetFireWare) hw::ftx_api_GetFireWare(s.firmware);
            s.firmware[sizeof(s.firmware) - 1] = '\0';
            s.started = false;
            s.passShown = false;
            s.ticks = 0;
            s.status[0] = '\0';
            s.detail[0] = '\0';
            s_arrived = 0;
            mmi_set_current_test(kTag);
            break;
        case MSG_ACTIVE:
            if (wParam == 1 && !s.started) {
                char fail[MMI_TESTWND_TEXT_SIZE];
                mmi_translate("Result_fail", fail, sizeof(fail));
                mmi_testwnd_set_bars(hWnd, "TP TEST", "", "", fail);
            }
            break;
        case MSG_PAINT:
            if (!s.started) start(hWnd);
            paint(hWnd);
            return 0;
        case MSG_TIMER:
            if (wParam == kTimerId) tick(hWnd);
            return 0;
        case MSG_KEYDOWN:
            if (wParam == kKeyMiddle) {
                mmi_TP_RawDataDetail_Entry();
            } else if (wParam == MMI_KEY_FAIL) {
                close_window(hWnd);
                mmi_testwnd_record_fail(MMI_TOUCH_RESULT);
            } else if (wParam == MMI_KEY_PASS && s.passShown) {
                // The pass key counts only once the verdict offered it.
                const bool preview = s_preview.load();
                close_window(hWnd);
                if (preview)
                    mmi_run_pass(MMI_RUN_MONOMER, -1, kTag);
                else
                    mmi_testwnd_record_pass(MMI_TOUCH_RESULT, kTag);
            }
            return 0;
        case MSG_FAILANDQUIT:
            close_window(hWnd);
            mmi_testwnd_record_fail(MMI_TOUCH_RESULT);
            return 0;
        case MSG_CLOSE: {
            KillTimer(hWnd, kTimerId);
            {
                std::lock_guard<std::mutex> lk(s_rawLock);
                mmi_tp_raw_free(&g_TPSelfRawFailData);
            }
            s.ticks = 0;
            s_preview = 0;
            s_arrived = 0;
            if (hw::ftx_api_tpd_SelfTest_Stop) hw::ftx_api_tpd_SelfTest_Stop();
            mmi_ownwnd_destroy(&s_wnd, hWnd);
            return 0;
        }
        default:
            break;
    }
    return DefaultMainWinProc(hWnd, message, wParam, lParam);
}

// The library's three operations, each named in the log when it is missing.
bool bound(void) {
    Init_lib_TPSelf_Interface();
    struct Need {
        bool ok;
        const char *name;
        int line;
    };
    const Need needs[] = {
        {hw::ftx_api_GetFireWare != nullptr, "ftx_api_GetFireWare", 559},
        {hw::ftx_api_tpd_SelfTest_Start != nullptr, "ftx_api_tpd_SelfTest_Start", 565},
        {hw::ftx_api_tpd_SelfTest_Stop != nullptr, "ftx_api_tpd_SelfTest_Stop", 572},
    };
    bool all = true;
    for (const Need &n : needs) {
        if (n.ok) continue;
        TP_ERROR("%s,L%d: could not dlsym %s: %s", "mmi_testwnd_TPSelfTest_Entry", n.line, n.name,
                 "symbol not bound");
        all = false;
    }
    return all;
}

// ---- the failure map ----

void paint_map(HWND hWnd) {
    HDC hdc = BeginPaint(hWnd);
    const int w = g_ptScreenInfo.width, h = g_ptScreenInfo.height;
    std::lock_guard<std::mutex> lk(s_rawLock);
    const mmi_tp_raw &raw = g_TPSelfRawFailData;
    if (raw.x > 0 && raw.y > 0 && raw.num > 0 && raw.p != nullptr) {
        SetBrushColor(hdc, mmi_pixel(MMI_COLOUR_FAIL));
        int box[4];
        for (int i = 0; 2 * i + 1 < raw.filled; i++)
            if (mmi_tp_raw_cell(&raw, i, w, h, box) == 0)
                FillBox(hdc, box[0], box[1], box[2], box[3]);
    } else {
        SetBkMode(hdc, BM_TRANSPARENT);
        SetTextColor(hdc, mmi_pixel(MMI_COLOUR_TEXT));
        RECT rc = {0, 0, w, h};
        DrawText(hdc, "No Data!Press KeyBack or KeyUp to Exit!", -1, &rc,
                 DT_CENTER | DT_VCENTER | DT_SINGLELINE);
    }
    EndPaint(hWnd, hdc);
}

LRESULT map_proc(HWND hWnd, UINT message, WPARAM wParam, LPARAM lParam) {
    switch (message) {
        case MSG_PAINT:
            paint_map(hWnd);
            return 0;
        case MSG_KEYDOWN:
            s_mapLastKey = wParam;
            if (wParam == MMI_KEY_PASS || wParam == MMI_KEY_FAIL) close_window(hWnd);
            return 0;
        case MSG_KEYUP:
            if ((wParam == kKeyUp || wParam == kKeyBack) && wParam == s_mapLastKey)
                close_window(hWnd);
            s_mapLastKey = 0;
            return 0;
        case MSG_FAILANDQUIT:
            close_window(hWnd);
            return 0;
        case MSG_CLOSE:
            __android_log_print(ANDROID_LOG_DEBUG, kMapTag, "%s close", __func__);
            s_mapLastKey = 0;
            s_map.hwnd = HWND_INVALID;
            tp_skb_show(1);
            DestroyMainWindow(hWnd);
            return 0;
        default:
            break;
    }
    return DefaultMainWinProc(hWnd, message, wParam, lParam);
}

}  // namespace

int mmi_tp_verdict_detail(int verdict, char *out, unsigned int size, bool translate) {
    out[0] = '\0';
    for (const VerdictText &v : kVerdicts) {
        if (v.verdict != verdict) continue;
        add_text(out, size, v.key, translate);
        return v.pass ? 1 : 0;
    }
    for (const BitText &b : kBits)
        if (((unsigned)verdict >> b.bit) & 1u) add_text(out, size, b.key, translate);
    return 0;
}

void tpd_auto_test_callback(module_data *data) {
    TP_DEBUG("tpd_auto_test_callback begin");
    if (data == nullptr) return;
    if (data->data == nullptr) {
        gTpdTestResult = data->datatype;
        s_arrived = 1;
        return;
    }
    TP_DEBUG("%s::totallen=%d", __func__, (int)data->totallen);
    TP_DEBUG("%s::len=%d", __func__, (int)strlen(data->data));
    gTpdTestResult = data->datatype;
    if (data->datatype == kTypeUnsupported || data->datatype == kRawReadFail) {
        s_arrived = 1;
        TP_DEBUG("%s::gTpdTestResult=%d", __func__, data->datatype);
        return;
    }
    std::lock_guard<std::mutex> lk(s_rawLock);
    if (mmi_tp_raw_parse(data->data, &g_TPSelfRawFailData, kTag) == 0) s_arrived = 1;
}

void *mmi_testwnd_TPSelfTest_Entry(void) {
    if (!bound()) return HWND_INVALID;
    mmi_translate("title_TPFirmwareInfo", s.firmwareTitle, sizeof(s.firmwareTitle));
    mmi_translate("title_TPSelfTest", s.title, sizeof(s.title));
    mmi_translate("info_NoTouch", s.noTouch, sizeof(s.noTouch));
    mmi_translate("info_Detail", s.detailKey, sizeof(s.detailKey));
    return mmi_ownwnd_opened(&s_wnd, mmi_testwnd_create("TP Self Test", mmi_TPSelfTestWndProc, 0),
                             mmi_testwnd_TPSelfTest_Stop);
}

int mmi_testwnd_TPSelfTest_Stop(void) {
    mmi_ownwnd_close(&s_map);
    return mmi_ownwnd_stop(&s_wnd);
}

void *mmi_testwnd_Monomer_TPSelfTest_Entry(void) {
    s_preview = 1;
    return mmi_testwnd_TPSelfTest_Entry();
}

int mmi_testwnd_Monomer_TPSelfTest_Stop(void) {
    s_preview = 0;
    return mmi_testwnd_TPSelfTest_Stop();
}

void *mmi_TP_RawDataDetail_Entry(void) {
    __android_log_print(ANDROID_LOG_DEBUG, kMapTag, "%s begin", __func__);
    tp_skb_show(0);
    HWND hWnd = mmi_testwnd_create_full(" ", map_proc, 0);
    if (hWnd == HWND_INVALID) return hWnd;
    s_map.hwnd = hWnd;
    return hWnd;
}

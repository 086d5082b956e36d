// The touch tests' full-screen window. The frame and the rings share the window's
// behaviour (the finger's trail, the stop key, pass on the last cell) and differ in what
// they draw and where a touch lands: one procedure each over the same handlers.
#include "testwnd/touch/mmi_testwnd_touch.h"

#include <math.h>
#include <stdlib.h>
#include <string.h>

#include <atomic>

#include <android/log.h>

#include "core/mmi_power.h"
#include "core/mmi_settings.h"
#include "mmi_bars.h"
#include "mmi_guithread.h"
#include "mmi_theme.h"
#include "session/mmi_testinfo.h"
#include "testwnd/mmi_key_table.h"
#include "testwnd/mmi_testwnd.h"
#include "testwnd/touch/mmi_touch_geometry.h"
#include "tp_os.h"

#define TOUCH_DEBUG(...) __android_log_print(ANDROID_LOG_DEBUG, kTag, __VA_ARGS__)
#define TOUCH_ERROR(...) __android_log_print(ANDROID_LOG_ERROR, kTag, __VA_ARGS__)

namespace {

const char *const kTag = catalogue::Touch.domain;
const int kMaxParams = 12;
// A finger that jumps further than this (in x or y) draws no trail segment.
const int kTrailJump = 50;
// The touch-tracking request the desktop answers (the test window gets every touch).
const UINT kMsgDesktopTrackTouch = 248;
// The stop key when the configured one may not end the test.
const int kFallbackStopKey = 127;
// Sub-steps of a sector's arcs when it is filled.
const int kArcSteps = 6;

mmi_ownwnd_state s_wnd;
std::atomic<int> s_preview{0};
std::atomic<int> g_StopTouchTestKeyVal{102};
std::atomic<int> g_RectWidth{0};

// GUI thread only.
mmi_cells cells;
mmi_ring g_outer_circles;
mmi_ring g_inner_circles;
bool s_round = false;  // the open window is the ring test
WPARAM s_lastKey = 0;
bool s_trailOn = false;
POINT s_last = {0, 0};
LRESULT s_trackValue = 0;

bool all_touched(void) {
    if (s_round) return mmi_ring_full(&g_outer_circles) && mmi_ring_full(&g_inner_circles);
    return cells.touched != nullptr && cells.drawCount >= cells.totalCount;
}

// ---- drawing ----

void fill_cell(HDC hdc, int index) {
    int b[4];
    mmi_cells_box(&cells, index, b);
    SetBrushColor(hdc, cells.fillColour);
    FillBox(hdc, b[0], b[1], b[2] - b[0], b[3] - b[1]);
}

void line(HDC hdc, int x0, int y0, int x1, int y1) {
    MoveTo(hdc, x0, y0);
    LineTo(hdc, x1, y1);
}

void paint_cells(HDC hdc) {
    SetPenColor(hdc, cells.lineColour);
    SetPenWidth(hdc, 1);
    const int len = cells.cellHeight;
    for (int s = 0; s < MMI_STRIPS; s++) {
        const mmi_strip &r = cells.strip[s];
        const int l = (int)r.left, t = (int)r.top, rt = (int)r.right, b = (int)r.bottom;
        line(hdc, l, t, rt, t);
        line(hdc, rt, t, rt, b);
        line(hdc, rt, b, l, b);
        line(hdc, l, b, l, t);
        // The dividers: one line at every cell length from the strip's start.
        for (uint32_t i = 0; i <= cells.cellCount[s]; i++) {
            const int d = (int)i * len;
            if (s == MMI_STRIP_LEFT || s == MMI_STRIP_RIGHT)
                line(hdc, l, t + d, rt, t + d);
            else
                line(hdc, l + d, t, l + d, b);
        }
    }
    for (int i = 0; i < cells.totalCount && cells.touched != nullptr; i++)
        if (cells.touched[i]) fill_cell(hdc, i);
}

void fill_sector(HDC hdc, const mmi_ring &ring, int sector) {
    const mmi_circle &o = ring.outer;
    const double from = o.point[sector - 1].angle, to = o.point[sector].angle;
    POINT pts[2 * (kArcSteps + 1)];
    for (int i = 0; i <= kArcSteps; i++) {
        const double a = from + (to - from) * i / kArcSteps;
        pts[i] = {(int)(o.cx + o.radius * cos(a)), (int)(o.cy - o.radius * sin(a))};
        const double b = to - (to - from) * i / kArcSteps;
        pts[kArcSteps + 1 + i] = {(int)(o.cx + ring.inner.radius * cos(b)),
                                  (int)(o.cy - ring.inner.radius * sin(b))};
    }
    SetBrushColor(hdc, mmi_pixel(MMI_COLOUR_PASS));
    FillPolygon(hdc, pts, 2 * (kArcSteps + 1));
}

// The ring's edges and its radial dividers.
void init_Test_Circles(HDC hdc, const mmi_ring *ring) {
    if (ring == nullptr) {
        TOUCH_ERROR("%s error circles=NULL", __func__);
        return;
    }
    for (int j = 1; j <= ring->outer.divided_num; j++)
        if (ring->clicked[j]) fill_sector(hdc, *ring, j);
    SetPenColor(hdc, mmi_pixel(MMI_COLOUR_BLUE));
    SetPenWidth(hdc, 1);
    Circle(hdc, ring->outer.cx, ring->outer.cy, ring->outer.radius);
    Circle(hdc, ring->inner.cx, ring->inner.cy, ring->inner.radius);
    for (int j = 0; j < ring->outer.divided_num; j++)
        line(hdc, ring->outer.point[j].x, ring->outer.point[j].y, ring->inner.point[j].x,
             ring->inner.point[j].y);
}

void paint(HWND hWnd) {
    TOUCH_DEBUG("%s MSG_PAINT begin", __func__);
    HDC hdc = BeginPaint(hWnd);
    if (s_round) {
        init_Test_Circles(hdc, &g_outer_circles);
        if (g_inner_circles.enabled) init_Test_Circles(hdc, &g_inner_circles);
    } else {
        paint_cells(hdc);
    }
    EndPaint(hWnd, hdc);
}

// ---- touches ----

void UpdateOneRect(HDC hdc, int x, int y) {
    int strip = -1;
    if (mmi_cells_index(&cells, x, y, &strip) < 0) return;
    TOUCH_DEBUG("UpdateOneRect %d", strip);
    int index;
    if (mmi_cells_mark(&cells, x, y, &index)) fill_cell(hdc, index);
}

void Circle_Test_Start(HDC hdc, int x, int y) {
    TOUCH_DEBUG("20150605 %s point x=%d,y=%d", __func__, x, y);
    const int cx = g_outer_circles.outer.cx, cy = g_outer_circles.outer.cy;
    const int xtmp = x - cx, ytmp = cy - y;
    static const char *const kQuarter[] = {"1th", "2th", "3th", "4th"};
    const int q = ytmp >= 0 ? (xtmp >= 0 ? 0 : 1) : (xtmp < 0 ? 2 : 3);
    TOUCH_DEBUG("20150607 %s %s section", __func__, kQuarter[q]);
    double distance;
    const double radian = mmi_ring_angle(cx, cy, x, y, &distance);
    TOUCH_DEBUG("20150607 %s press x=%d,y=%d,xtmp=%d,ytmp=%d,ztmp=%f,radian_tmp=%f", __func__, x, y,
                xtmp, ytmp, distance, radian);
    for (mmi_ring *ring : {&g_inner_circles, &g_outer_circles}) {
        if (!ring->enabled) continue;
        const int sector = mmi_ring_sector(ring, x, y, kTag);
        if (sector < 0) continue;
        if (!mmi_ring_mark(ring, sector)) {
            TOUCH_DEBUG("20150609 current is clicked.");
            return;
        }
        fill_sector(hdc, *ring, sector);
        // The divider lines stay on top of the filled sector.
        init_Test_Circles(hdc, ring);
        return;
    }
}

void touch_at(HWND hWnd, int x, int y) {
    HDC hdc = GetClientDC(hWnd);
    if (s_round)
        Circle_Test_Start(hdc, x, y);
    else
        UpdateOneRect(hdc, x, y);
    ReleaseDC(hdc);
}

void trail_to(HWND hWnd, int x, int y) {
    if (!s_trailOn) return;
    if (abs(x - s_last.x) > kTrailJump || abs(y - s_last.y) > kTrailJump) return;
    HDC hdc = GetClientDC(hWnd);
    SetPenColor(hdc, mmi_pixel(MMI_COLOUR_HILIGHT_TEXT));
    SetPenWidth(hdc, 3);
    line(hdc, s_last.x, s_last.y, x, y);
    ReleaseDC(hdc);
    s_last = {x, y};
}

// ---- results ----

void close_window(HWND hWnd) {
    SendMessage(hWnd, MSG_CLOSE, 0, 0);
}

// Every cell touched: the preview moves on, a run records and moves on. `always` writes
// the pass even outside a run.
void passed(HWND hWnd, bool always) {
    if (s_preview.load()) {
        close_window(hWnd);
        mmi_run_pass(MMI_RUN_MONOMER, catalogue::MonomerTouch.resultIndex, kTag);
        return;
    }
    if (always && g_bAutoTestRunning != 1) mmi_write_testinfo_single_byte(MMI_TOUCH_RESULT, 1);
    close_window(hWnd);
    mmi_testwnd_record_pass(MMI_TOUCH_RESULT, kTag);
}

void failed(HWND hWnd) {
    mmi_testwnd_record_fail(MMI_TOUCH_RESULT);
    close_window(hWnd);
}

int stop_key(void) {
    const int key = g_StopTouchTestKeyVal.load();
    return Check_TouchTest_StopKeyVal(key) == 0 ? key : kFallbackStopKey;
}

void key_up(HWND hWnd, WPARAM key) {
    if ((int)key == stop_key() && key == s_lastKey) {
        TOUCH_DEBUG("%s::%s::key_value=%d", "mmi_touchadusting_LineWin", __func__, (int)key);
        TOUCH_DEBUG("%s::cells.drawCount=%d,cells.totalCount=%d", __func__, cells.drawCount,
                    cells.totalCount);
        s_lastKey = 0;
        if (all_touched())
            passed(hWnd, true);
        else
            failed(hWnd);
        return;
    }
    s_lastKey = 0;
    if (key == MMI_KEY_PASS || key == MMI_KEY_FAIL) close_window(hWnd);
}

LRESULT touch_proc(HWND hWnd, UINT message, WPARAM wParam, LPARAM lParam) {
    const int x = LOSWORD(lParam), y = HISWORD(lParam);
    switch (message) {
        case MSG_CREATE:
            mmi_set_current_test(kTag);
            s_wnd.created = 1;
            if (g_StopTouchTestKeyVal.load() == 1) Set_OsCanIdleAllowed(0);
            break;
        case MSG_ACTIVE:
            tp_skb_show(0);
            if (mmi_ownwnd_refuses(&s_wnd, message, kTag)) return 0;
            break;
        case MSG_PAINT:
            if (mmi_ownwnd_refuses(&s_wnd, message, kTag)) return 0;
            paint(hWnd);
            return 0;
        case MSG_LBUTTONDOWN:
            touch_at(hWnd, x, y);
            s_trackValue = SendMessage(HWND_DESKTOP, kMsgDesktopTrackTouch, (WPARAM)hWnd, 0);
            s_trailOn = true;
            s_last = {x, y};
            return 0;
        case MSG_MOUSEMOVE:
            if (all_touched()) return 0;
            touch_at(hWnd, x, y);
            trail_to(hWnd, x, y);
            return 0;
        case MSG_LBUTTONUP:
            if (!all_touched()) {
                trail_to(hWnd, x, y);
                s_trailOn = false;
                SendMessage(HWND_DESKTOP, kMsgDesktopTrackTouch, (WPARAM)s_trackValue, 0);
                return 0;
            }
            s_trailOn = false;
            if (!s_wnd.pcDriven.load()) passed(hWnd, false);
            return 0;
        case MSG_KEYDOWN:
            TOUCH_DEBUG("%s,L%d::Downkey_value=%d", __func__, 652, (int)wParam);
            s_lastKey = wParam;
            return 0;
        case MSG_KEYUP:
            key_up(hWnd, wParam);
            return 0;
        case MSG_FAILANDQUIT:
            failed(hWnd);
            return 0;
        case MSG_CLOSE:
            s_lastKey = 0;
            s_preview = 0;
            if (g_StopTouchTestKeyVal.load() == 1 && !s_wnd.pcDriven.load())
                Set_OsCanIdleAllowed(1);
            s_trailOn = false;
            mmi_cells_free(&cells);
            tp_skb_show(1);
            mmi_ownwnd_destroy(&s_wnd, hWnd);
            return 0;
        default:
            break;
    }
    return DefaultMainWinProc(hWnd, message, wParam, lParam);
}

// The edge test's and the ring test's procedures: the same behaviour over their shapes.
LRESULT mmi_TouchAdjusting_LineWinProc(HWND hWnd, UINT message, WPARAM wParam, LPARAM lParam) {
    return touch_proc(hWnd, message, wParam, lParam);
}
LRESULT mmi_TouchAdjusting_CircleGridProc(HWND hWnd, UINT message, WPARAM wParam, LPARAM lParam) {
    return touch_proc(hWnd, message, wParam, lParam);
}

// The full-screen window, shown; HWND_INVALID on failure.
HWND create_window(WNDPROC proc) {
    HWND hWnd = mmi_testwnd_create_full("Touch Test", proc, 0);
    return mmi_ownwnd_opened(&s_wnd, hWnd, mmi_AutoTest_touchscreenTest_Stop_Entry);
}

HWND open_edge_test(void) {
    s_round = false;
    if (initCells(&cells, g_ptScreenInfo.width, g_ptScreenInfo.height, g_RectWidth.load(), kTag) !=
        0)
        return HWND_INVALID;
    cells.lineColour = mmi_pixel(MMI_COLOUR_BLUE);
    cells.fillColour = mmi_pixel(MMI_COLOUR_PASS);
    return create_window(mmi_TouchAdjusting_LineWinProc);
}

// The window the screen's shape asks for (GUI thread).
void *open_by_shape(void) {
    return g_bTPShape == 1 ? mmi_testwnd_touch_circlegrid_Entry() : open_edge_test();
}

// The PC's verdict (GUI thread): every cell, or every sector of both rings, touched.
int touch_verdict(char *, unsigned int) {
    if (s_round)
        TOUCH_DEBUG("0607_2 %s g_inner_circles[0].iClickedNum=%d,g_inner_circles[0].divided_num=%d",
                    "circleTouch_Stop", g_inner_circles.iClickedNum,
                    g_inner_circles.outer.divided_num);
    return all_touched() ? 1 : 0;
}

int pc_open(void) {
    return mmi_ownwnd_pc_open(&s_wnd, open_by_shape);
}

int pc_stop(void) {
    const int verdict = mmi_ownwnd_pc_stop(&s_wnd, touch_verdict, nullptr, 0);
    if (verdict < 0)
        TOUCH_ERROR("%s: no touch test open", "mmi_AutoTest_touchscreenTest_Stop_Entry");
    return verdict > 0 ? 1 : 0;
}

}  // namespace

int Check_TouchTest_StopKeyVal(int key) {
    switch (key) {
        case 1:
        case 88:
        case 102:
        case 103:
        case 108:
        case 127:
            return 0;
        default:
            return -1;
    }
}

void mmi_touch_read_config(void) {
    ftx_config_para paras[kMaxParams];
    const int n = mmi_testwnd_params(kTag, paras, kMaxParams);
    char value[FTX_CFG_TEXT_SIZE] = {0};
    ftx_config_get_para_value(paras, n, "StopTestKey", value, sizeof(value), "HOME");
    g_StopTouchTestKeyVal = (int)Get_Keytest_item_key_value(value);
    TOUCH_DEBUG("%s::CONFIG_STOPTESTKEY=%s,g_StopTouchTestKeyVal=%d", __func__, value,
                g_StopTouchTestKeyVal.load());
    memset(value, 0, sizeof(value));
    ftx_config_get_para_value(paras, n, "RectWidth", value, sizeof(value), "0");
    int width = atoi(value);
    if (width < 0 || width > g_ptScreenInfo.width) {
        TOUCH_ERROR("Fatal error::%s::RectWidth=%s,g_RectWidth=%d", __func__, value, width);
        width = 0;
    }
    g_RectWidth = width;
    TOUCH_DEBUG("%s::RectWidth=%s,g_RectWidth=%d", __func__, value, width);
}

void *mmi_testwnd_touchTestEntry(void) {
    s_wnd.pcDriven = 0;
    mmi_touch_read_config();
    return open_by_shape();
}

void *mmi_testwnd_touch_circlegrid_Entry(void) {
    s_round = true;
    mmi_rings_init(&g_outer_circles, &g_inner_circles, g_ptScreenInfo.width, true);
    return create_window(mmi_TouchAdjusting_CircleGridProc);
}

void *mmi_testwnd_Monomer_touchTestEntry(void) {
    s_preview = 1;
    return mmi_testwnd_touchTestEntry();
}

int mmi_testwnd_Monomer_touchscreenTest_Stop(void) {
    s_preview = 0;
    return mmi_ownwnd_stop(&s_wnd);
}

int RectangleTouch_Start(void) {
    return pc_open();
}

int circleTouch_Start(void) {
    return pc_open();
}

int circleTouch_Stop(void) {
    return pc_stop();
}

int mmi_AutoTest_touchscreenTest_Entry(void) {
    mmi_touch_read_config();
    if (g_bTPShape == 1)
        circleTouch_Start();
    else
        RectangleTouch_Start();
    return 1;
}

int mmi_AutoTest_touchscreenTest_Stop_Entry(void) {
    return pc_stop();
}

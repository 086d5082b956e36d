// The light test window and the PC's lights. The window steps through the lights the item's
// parameter names (mmi_light_steps); each step's light is on while its question shows and
// goes off when the step ends or the window closes. The window's state is the GUI thread's.
#include "testwnd/lights/mmi_testwnd_alllight.h"

#include <stdio.h>
#include <string.h>

#include <android/log.h>

#include "mmi_theme.h"
#include "testwnd/lights/mmi_lights.h"
#include "testwnd/mmi_testwnd.h"
#include "tp_os.h"

#define LIGHT_DEBUG(...) __android_log_print(ANDROID_LOG_DEBUG, kTag, __VA_ARGS__)
#define LIGHT_ERROR(...) __android_log_print(ANDROID_LOG_ERROR, kTag, __VA_ARGS__)

namespace {

const char *const kTag = catalogue::AllLight.domain;
const char kCaption[] = "All Light Test";
const int kParamsMax = 16;

mmi_ownwnd_state s_wnd;

// GUI thread only.
struct Steps {
    int ids[MMI_LIGHTS];
    int count;
    int current;
    bool lit;  // the library switched the current step's light on
};
Steps s;

void offer_keys(HWND hWnd) {
    mmi_testwnd_show_keys(hWnd, catalogue::AllLight.titleKey, s.lit ? MMI_TIMER_FOOLPROOF : 0);
}

void light_off(void) {
    if (s.current < s.count && s.lit) mmi_light_switch(s.ids[s.current], false, __func__);
    s.lit = false;
}

void start_step(HWND hWnd) {
    const int id = s.ids[s.current];
    s.lit = mmi_light_switch(id, true, __func__) == 0;
    LIGHT_DEBUG("step %d/%d: %s%s", s.current + 1, s.count, mmi_light_of(id).name,
                s.lit ? "" : " did not turn on");
    InvalidateRect(hWnd, nullptr, TRUE);
    offer_keys(hWnd);
}

// The pass key: the current light passed; the next step starts, or the test passes.
void pass_step(HWND hWnd) {
    LIGHT_DEBUG("step %d/%d: %s passed", s.current + 1, s.count,
                mmi_light_of(s.ids[s.current]).name);
    light_off();
    if (s.current + 1 < s.count) {
        s.current++;
        start_step(hWnd);
        return;
    }
    LIGHT_DEBUG("every light passed");
    mmi_testwnd_pass_and_close(hWnd, catalogue::AllLight.resultIndex, kTag);
}

void fail(HWND hWnd) {
    if (s.current < s.count)
        LIGHT_DEBUG("step %d/%d: %s failed", s.current + 1, s.count,
                    mmi_light_of(s.ids[s.current]).name);
    mmi_testwnd_fail_and_close(hWnd, catalogue::AllLight.resultIndex);
}

void paint(HWND hWnd) {
    HDC hdc = BeginPaint(hWnd);
    const int w = g_ptScreenInfo.width;
    const int margin = w / 10;
    mmi_testwnd_draw_top_line(hdc);
    SetBkMode(hdc, BM_TRANSPARENT);
    char text[MMI_TESTWND_TEXT_SIZE], word[64];
    // The note, the step's number, then its question (or why its light is off) larger.
    mmi_translate("info_LightNote", text, sizeof text);
    SetTextColor(hdc, mmi_pixel(MMI_COLOUR_TEXT));
    RECT note = {margin, w / 15 + 10, w - margin, w / 15 + 10 + 3 * mmi_logfont_size(3, w)};
    DrawText(hdc, text, -1, &note, DT_WORDBREAK);
    mmi_translate("info_LightStep", word, sizeof word);
    snprintf(text, sizeof text, "%s %d / %d", word, s.current + 1, s.count);
    RECT step = {margin, w / 3, w - margin, w / 3 + 2 * mmi_logfont_size(3, w)};
    DrawText(hdc, text, -1, &step, DT_LEFT | DT_VCENTER | DT_SINGLELINE);
    if (s.current < s.count) {
        const mmi_light &l = mmi_light_of(s.ids[s.current]);
        mmi_translate(s.lit ? l.questionKey : "info_LightNotOn", text, sizeof text);
        if (g_mmiLogFont[1]) SelectFont(hdc, g_mmiLogFont[1]);
        SetTextColor(hdc, mmi_pixel(s.lit ? MMI_COLOUR_TEXT : MMI_COLOUR_FAIL));
        RECT question = {margin, w / 3 + 3 * mmi_logfont_size(3, w), w - margin, w + w / 3};
        DrawText(hdc, text, -1, &question, DT_WORDBREAK);
    }
    EndPaint(hWnd, hdc);
}

LRESULT alllight_proc(HWND hWnd, UINT message, WPARAM wParam, LPARAM lParam) {
    if (mmi_ownwnd_verdict(
            message, wParam, s.lit, [&] { pass_step(hWnd); }, [&] { fail(hWnd); }))
        return 0;
    switch (message) {
        case MSG_CREATE:
            if (g_mmiLogFont[3]) SetWindowFont(hWnd, g_mmiLogFont[3]);
            mmi_ownwnd_created(&s_wnd, hWnd, kTag);
            start_step(hWnd);
            break;
        case MSG_ACTIVE:
            if (mmi_ownwnd_refuses(&s_wnd, message, kTag)) return 0;
            if (wParam == 1) offer_keys(hWnd);
            break;
        case MSG_PAINT:
            if (mmi_ownwnd_refuses(&s_wnd, message, kTag)) return 0;
            paint(hWnd);
            return 0;
        case MSG_KEYDOWN:
            return 0;
        case MSG_CLOSE:
            light_off();
            mmi_ownwnd_destroy(&s_wnd, hWnd);
            return 0;
        default:
            break;
    }
    return DefaultMainWinProc(hWnd, message, wParam, lParam);
}

// The item's steps into s, each light's operations bound; false (logged) when the test
// cannot run.
bool prepare_steps(void) {
    ftx_config_para p[kParamsMax];
    const int n = mmi_testwnd_params(kTag, p, kParamsMax);
    memset(&s, 0, sizeof s);
    s.count = mmi_light_steps(p, n, s.ids, MMI_LIGHTS);
    if (s.count == 0) {
        LIGHT_ERROR("no light is configured, test not opened");
        return false;
    }
    for (int i = 0; i < s.count; i++) {
        if (mmi_light_bind(s.ids[i]) != 0) {
            LIGHT_ERROR("%s cannot be switched, test not opened", mmi_light_of(s.ids[i]).name);
            return false;
        }
    }
    return true;
}

// A PC light: a start closes the open test windows first; 1 when the library switched it.
int pc_light(int id, bool on, const char *who) {
    if (on) Check_AllTestWnd_Closed();
    if (mmi_light_bind(id) != 0) return 0;
    return mmi_light_switch(id, on, who) == 0 ? 1 : 0;
}

}  // namespace

void *mmi_testwnd_AllLightTestEntry(void) {
    if (!prepare_steps()) return HWND_INVALID;
    return mmi_ownwnd_opened(&s_wnd, mmi_testwnd_create(kCaption, alllight_proc, 0),
                             mmi_testwnd_AllLightTest_Stop_Entry);
}

int mmi_testwnd_AllLightTest_Stop_Entry(void) {
    return mmi_ownwnd_stop(&s_wnd);
}

int mmi_AutoTest_LEDColorTestEntry(const char *colour) {
    for (int id = 0; id < MMI_LIGHTS; id++) {
        const mmi_light &l = mmi_light_of(id);
        if (l.kind == MMI_LIGHT_KIND_LED && colour != nullptr && strcmp(l.colour, colour) == 0)
            return pc_light(id, true, __func__);
    }
    LIGHT_ERROR("%s::no LED colour %s", __func__, colour != nullptr ? colour : "(null)");
    return 0;
}

// The LED's stop is the same for every colour.
int mmi_AutoTest_LEDColorTest_Stop_Entry(void) {
    return pc_light(MMI_LIGHT_LED_RED, false, __func__);
}

int mmi_AutoTest_KeyBacklightTestEntry(void) {
    return pc_light(MMI_LIGHT_KEY_BACKLIGHT, true, __func__);
}

int mmi_AutoTest_KeyBacklight_Stop_Entry(void) {
    return pc_light(MMI_LIGHT_KEY_BACKLIGHT, false, __func__);
}

int mmi_AutoTest_FlashlightTestEntry(const char *parm) {
    LIGHT_DEBUG("%s::parm=%s", __func__, parm != nullptr ? parm : "");
    return pc_light(MMI_LIGHT_BACK, true, __func__);
}

int mmi_AutoTest_Flashlight_Stop_Entry(void) {
    return pc_light(MMI_LIGHT_BACK, false, __func__);
}

int mmi_AutoTest_BackFlashlight2_TestEntry(void) {
    return pc_light(MMI_LIGHT_BACK2, true, __func__);
}

int mmi_AutoTest_BackFlashlight2_Stop_Entry(void) {
    return pc_light(MMI_LIGHT_BACK2, false, __func__);
}

int mmi_AutoTest_Front_FlashlightTestEntry(const char *parm) {
    LIGHT_DEBUG("%s::parm=%s", __func__, parm != nullptr ? parm : "");
    return pc_light(MMI_LIGHT_FRONT, true, __func__);
}

int mmi_AutoTest_Front_Flashlight_Stop_Entry(void) {
    return pc_light(MMI_LIGHT_FRONT, false, __func__);
}

int mmi_AutoTest_LightControl_Open(void) {
    return pc_light(MMI_LIGHT_ALL, true, __func__);
}

int mmi_AutoTest_LightControl_Close(void) {
    return pc_light(MMI_LIGHT_ALL, false, __func__);
}

// The test-window framework: one window procedure serves every test that follows the
// common pattern (title, note, delayed pass label, pass and fail keys, and the report of the
// result to the run that opened the window), driven by the family's descriptor. Tests with
// their own procedure reuse the helpers below.
#pragma once

#include <pthread.h>

#include <atomic>
#include <mutex>

#include "core/ftx_config.h"
#include "core/ftx_lib_binding.h"
#include "mmi_msg.h"
#include "session/mmi_runstate.h"
#include "testwnd/catalogue.h"

#define MMI_TESTWND_TEXT_SIZE 256

// Soft keys.
#define MMI_KEY_PASS 60
#define MMI_KEY_FAIL 61
// MSG_TIMER wParam the fool-proof thread sends when the pass label may show.
#define MMI_TIMER_FOOLPROOF 5
// Identifier of a test window's title control.
#define MMI_TESTWND_TITLE_ID 20

// A bound operation and its name in the log; written MMI_HW_OP(ftx_api_...), so the name
// is never a second string.
template <typename F>
struct mmi_hw_named_op {
    ftx_hw_op<F> *op;
    const char *name;
    bool bound() const { return op != nullptr && *op != nullptr; }
};
#define MMI_HW_OP(slot) \
    { &hw::slot, #slot }
typedef mmi_hw_named_op<int (*)(int)> mmi_hw_start_op;
typedef mmi_hw_named_op<int (*)(void)> mmi_hw_stop_op;

// Run-time state of one test's window.
struct mmi_testwnd_state {
    std::atomic<HWND> hwnd{HWND_INVALID};
    std::atomic<int> mode{0};
    // The fool-proof thread: its delay and log tag, the generation of the window it serves,
    // and whether it still sleeps (only then may SIGUSR1 end it).
    std::atomic<int> foolProofSeconds{0};
    std::atomic<const char *> tag{"FTX_MAIN"};
    std::mutex lock;
    pthread_t thread{};
    bool sleeping = false;
    std::atomic<unsigned> generation{0};
};

// A test family that follows the common pattern, written with designated initializers.
struct mmi_testwnd_desc {
    const mmi_catalogue_row *row;    // domain (also the log tag), result item, title key
    const char *caption;             // window caption
    const char *titleKey = nullptr;  // title strip and title control, when not the row's
    const char *noteKey = "";        // body text
    int foolProofSeconds = 0;        // before the pass label shows
    mmi_hw_start_op start = {};      // hardware start, given the mode variable
    mmi_hw_stop_op stop = {};
    mmi_hw_start_op stopWithMode = {};  // a stop that is given the mode (instead of stop)
    int stopEntrySleepMs = 0;           // after the stop entry closed the window
    int pcStopSleepMs = 0;              // after the PC stop entry
    mmi_testwnd_state *state = nullptr;
    int (*stopEntry)(void) = nullptr;                      // closes the window from outside
    int run = MMI_RUN_AUTO;                                // the run a pass or fail is reported to
    int (*bind)(void) = nullptr;                           // per-feature binder, null when none
    void (*note)(char *out, unsigned int size) = nullptr;  // body text instead of noteKey
    // Sees every message first (after MSG_CREATE's own work, before MSG_CLOSE's); non-zero
    // when it handled the message, which the common procedure then leaves alone.
    int (*hook)(HWND hWnd, UINT message, WPARAM wParam, LPARAM lParam) = nullptr;
    // When set, the pass label and the pass key wait for it to answer true as well as for
    // the fool-proof delay (a test that must hear from the hardware first).
    bool (*passReady)(void) = nullptr;
};

#define MMI_TESTWND_NOTE_SIZE 1024

// The generic pattern.
HWND mmi_testwnd_open(const mmi_testwnd_desc *d, int mode);
int mmi_testwnd_close(const mmi_testwnd_desc *d);
int mmi_testwnd_pc_start(const mmi_testwnd_desc *d, int mode);
int mmi_testwnd_pc_stop(const mmi_testwnd_desc *d);
LRESULT mmi_testwnd_proc(HWND hWnd, UINT message, WPARAM wParam, LPARAM lParam);

// Helpers for every test window, generic or not.
// The outer rectangle of a test window: between the title strip and the soft-key bar.
void mmi_testwnd_rect(int w, int h, RECT *out);
// Creates (not shows) a window in that rectangle, hosted by the main window, on the GUI
// thread; addData reaches MSG_CREATE. HWND_INVALID on failure (logged).
HWND mmi_testwnd_create(const char *caption, WNDPROC proc, DWORD addData,
                        DWORD style = WS_CAPTION | WS_VISIBLE);
// The same over the whole screen, title strip and soft-key bar included (topmost), shown.
HWND mmi_testwnd_create_full(const char *caption, WNDPROC proc, DWORD addData);
// The title control (titleKey translated) and the window fonts, in MSG_CREATE.
void mmi_testwnd_create_title(HWND hWnd, const char *titleKey);
// The 3-pixel green line along the window's top edge.
void mmi_testwnd_draw_top_line(HDC hdc);
// The operator's note (noteKey translated) under the title strip, in as many lines as it
// takes; the y below it.
int mmi_testwnd_draw_note(HDC hdc, const char *noteKey);
// A thin rule across the window at y.
void mmi_testwnd_draw_rule(HDC hdc, int y);
// One row of a window's list, under a rule at top: its label and its value, green when it
// passed and red when not; the value ends at valueRight.
void mmi_testwnd_draw_row(HDC hdc, int top, int height, const char *label, const char *value,
                          bool passed, int valueRight);
// The text of a language key, or the key itself when the language file lacks it.
void mmi_translate(const char *key, char *out, size_t size);
// Text in a box, in one of the hub's fonts (an index of g_mmiLogFont) and a palette colour;
// the key form translates a language key first.
void mmi_testwnd_text_at(HDC hdc, int font, int colour, const char *text, RECT box, UINT format);
void mmi_testwnd_key_at(HDC hdc, int font, int colour, const char *key, RECT box, UINT format);
// Shows the pass label (wParam 5) or only the fail label, and the title in the strip.
void mmi_testwnd_show_keys(HWND hWnd, const char *titleKey, WPARAM wParam);
// Starts the fool-proof thread that sends MSG_TIMER 5 to st->hwnd after `seconds`.
int mmi_testwnd_start_foolproof(mmi_testwnd_state *st, int seconds, const char *tag);
// Ends a fool-proof thread that still sleeps (SIGUSR1) and forgets its window.
void mmi_testwnd_stop_foolproof(mmi_testwnd_state *st);
// Pass or fail of a test in the automatic run (recorded and chained only while it runs).
void mmi_testwnd_record_pass(int resultIndex, const char *domain);
void mmi_testwnd_record_fail(int resultIndex);
// A window's end with its verdict: a pass closes the window first (the run's next item
// then opens in front of what was under it), a fail is recorded first.
void mmi_testwnd_pass_and_close(HWND hWnd, int resultIndex, const char *domain);
void mmi_testwnd_fail_and_close(HWND hWnd, int resultIndex);
// The same for a window of either run kind.
void mmi_testwnd_pass(const mmi_testwnd_desc *d);
void mmi_testwnd_fail(const mmi_testwnd_desc *d);

// The fool-proof thread body; arg is the window's mmi_testwnd_state.
void *WaitForFoolProof(void *arg);

// The domain of the open test window ("" when none), shared with the PC thread.
void mmi_set_current_test(const char *domain);
void mmi_get_current_test(char *out, size_t size);

// A window with its own procedure that the PC can open and drive: its handle and the flags
// its messages and the PC share.
struct mmi_ownwnd_state {
    std::atomic<HWND> hwnd{HWND_INVALID};
    std::atomic<int> created{0};
    std::atomic<int> pcDriven{0};
    std::atomic<int> activated{0};
    std::atomic<int> painted{0};
};
// The PC's open of such a window: every other test window closes, `open` runs on the GUI
// thread unless the window exists, the created flag is polled (100 ms, at most 30 times; a
// window that never comes still answers 1), then the window becomes PC-driven and is sent
// MSG_ACTIVE (1) and MSG_PAINT unless it has seen them.
int mmi_ownwnd_pc_open(mmi_ownwnd_state *st, void *(*open)(void));
// The same for windows of a family that share one procedure: open is given ctx.
int mmi_ownwnd_pc_open(mmi_ownwnd_state *st, void (*open)(const void *ctx), const void *ctx);
// The PC's close: on the GUI thread, verdict(reply, size) judges the open window, which is
// then closed; its answer after 100 ms, or -1 when no window was open.
int mmi_ownwnd_pc_stop(mmi_ownwnd_state *st, int (*verdict)(char *reply, unsigned int size),
                       char *reply, unsigned int size);
// The same with ctx handed to verdict.
int mmi_ownwnd_pc_stop(mmi_ownwnd_state *st,
                       int (*verdict)(const void *ctx, char *reply, unsigned int size),
                       const void *ctx, char *reply, unsigned int size);
// MSG_CREATE's common start: the window becomes the current test (tag) and is known as
// created, so that the library's reports and the PC can reach it from then on.
void mmi_ownwnd_created(mmi_ownwnd_state *st, HWND hWnd, const char *tag);
// The verdict keys and the run's fail-and-quit: the fail key or MSG_FAILANDQUIT calls fail(),
// the pass key calls pass() while a pass is offered; true when the message did either.
template <typename Pass, typename Fail>
bool mmi_ownwnd_verdict(UINT message, WPARAM wParam, bool passOffered, Pass pass, Fail fail) {
    if (message == MSG_FAILANDQUIT || (message == MSG_KEYDOWN && wParam == MMI_KEY_FAIL))
        fail();
    else if (message == MSG_KEYDOWN && wParam == MMI_KEY_PASS && passOffered)
        pass();
    else
        return false;
    return true;
}
// MSG_CLOSE's common end: no current test, the flags cleared, the window unregistered and
// destroyed with its controls.
void mmi_ownwnd_destroy(mmi_ownwnd_state *st, HWND hWnd);
// A PC-driven window that has not been created refuses to activate or paint: true then (the
// seen flag of `message` is cleared and the refusal logged under tag).
bool mmi_ownwnd_refuses(mmi_ownwnd_state *st, UINT message, const char *tag);
// Sends MSG_CLOSE to the window, when there is one, on the GUI thread.
void mmi_ownwnd_close(mmi_ownwnd_state *st);
// The end of such a window's open: the handle kept, the stop entry registered, the window
// shown. Returns hWnd (HWND_INVALID passes through untouched).
HWND mmi_ownwnd_opened(mmi_ownwnd_state *st, HWND hWnd, int (*stop)(void));
// The stop entry's common form: the window closed, 100 ms for it to go; answers 1.
int mmi_ownwnd_stop(mmi_ownwnd_state *st);

// The soft keys (palette text colour) and, unless titleKey is null, the title strip.
void mmi_testwnd_set_bars(HWND hWnd, const char *titleKey, const char *left, const char *middle,
                          const char *right);
// The item's parameter records (at most max) from the main table's row of domain.
int mmi_testwnd_params(const char *domain, ftx_config_para *out, int max);
// The integer of an item parameter (its text through atoi; def when it is missing).
int mmi_testwnd_param_int(const ftx_config_para *p, int n, const char *key, const char *def);

// Open test windows register their stop entry, so that a PC command can close them all.
void mmi_testwnd_register_open(HWND hWnd, int (*stop)(void));
void mmi_testwnd_unregister(HWND hWnd);
int Check_AllTestWnd_Closed(void);
// The same, leaving `keep` open (a window the PC repaints instead of opening anew).
int mmi_testwnd_close_others(HWND keep);

// The test-window framework: one window procedure serves every test that follows the
// common pattern (title, note, delayed pass label, pass and fail keys, result recording and
// the next item of a run), driven by a row of the descriptor table. Tests with their own
// procedure reuse the helpers below.
#pragma once

#include <pthread.h>

#include <atomic>
#include <mutex>

#include "core/ftx_lib_binding.h"
#include "mmi_msg.h"

#define MMI_TESTWND_TEXT_SIZE 256

// Soft keys.
#define MMI_KEY_PASS 60
#define MMI_KEY_FAIL 61
// MSG_TIMER wParam the fool-proof thread sends when the pass label may show.
#define MMI_TIMER_FOOLPROOF 5
// Identifier of a test window's title control.
#define MMI_TESTWND_TITLE_ID 20

typedef ftx_hw_op<int (*)(int)> mmi_hw_start_op;
typedef ftx_hw_op<int (*)(void)> mmi_hw_stop_op;

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

struct mmi_testwnd_desc {
    const char *caption;     // window caption
    const char *titleKey;    // title strip item 1 and the title control
    const char *noteKey;     // body text
    int resultIndex;         // item of the result record
    const char *domain;      // configuration domain, also the log tag
    int foolProofSeconds;    // before the pass label shows
    mmi_hw_start_op *start;  // hardware start, given the mode variable
    mmi_hw_stop_op *stop;
    const char *startName;  // the operations' names in the log
    const char *stopName;
    int stopEntrySleepMs;  // after the stop entry closed the window
    int pcStopSleepMs;     // after the PC stop entry
    mmi_testwnd_state *state;
    int (*stopEntry)(void);  // closes the window from outside
    // Which run a pass hands over to: the automatic sequence or the monomer preview.
    int run;
    int (*bind)(void);                           // per-feature binder, null when none
    void (*note)(char *out, unsigned int size);  // body text instead of noteKey, or null
};

#define MMI_TESTWND_RUN_AUTO 0
#define MMI_TESTWND_RUN_MONOMER 1
#define MMI_TESTWND_NOTE_SIZE 1024

// Every generic test window, in one table.
extern const mmi_testwnd_desc g_testwndTable[];
extern const int g_testwndCount;
const mmi_testwnd_desc *mmi_testwnd_find(const char *domain);

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
HWND mmi_testwnd_create(const char *caption, WNDPROC proc, DWORD addData);
// The 3-pixel green line along the window's top edge.
void mmi_testwnd_draw_top_line(HDC hdc);
// The text of a language key, or the key itself when the language file lacks it.
void mmi_translate(const char *key, char *out, size_t size);
// Shows the pass label (wParam 5) or only the fail label, and the title in the strip.
void mmi_testwnd_show_keys(HWND hWnd, const char *titleKey, WPARAM wParam);
// Starts the fool-proof thread that sends MSG_TIMER 5 to st->hwnd after `seconds`.
int mmi_testwnd_start_foolproof(mmi_testwnd_state *st, int seconds, const char *tag);
// Ends a fool-proof thread that still sleeps (SIGUSR1) and forgets its window.
void mmi_testwnd_stop_foolproof(mmi_testwnd_state *st);
// Pass or fail of a test: recorded and chained only while a run is active.
void mmi_testwnd_record_pass(int resultIndex, const char *domain);
void mmi_testwnd_record_fail(int resultIndex);
// The same for a window of either run kind.
void mmi_testwnd_pass(const mmi_testwnd_desc *d);
void mmi_testwnd_fail(const mmi_testwnd_desc *d);

// The fool-proof thread body; arg is the window's mmi_testwnd_state.
void *WaitForFoolProof(void *arg);

// The domain of the open test window ("" when none), shared with the PC thread.
void mmi_set_current_test(const char *domain);
void mmi_get_current_test(char *out, size_t size);

// Open test windows register their stop entry, so that a PC command can close them all.
void mmi_testwnd_register_open(HWND hWnd, int (*stop)(void));
void mmi_testwnd_unregister(HWND hWnd);
int Check_AllTestWnd_Closed(void);

// The vibrator, the first user of the table.
void *mmi_testwnd_VibratorTestEntry(void);
int mmi_testwnd_VibratorTest_Stop_Entry(void);
int mmi_AutoTest_VibratorTestEntry(int mode);
int mmi_AutoTest_VibratorTest_Stop_Entry(void);

// The monomer preview's hardware version screen: the panel firmware, judged by the operator.
void *mmi_testwnd_Monomer_HardwareVersionEntry(void);
int mmi_testwnd_Monomer_HardwareVersion_Stop(void);

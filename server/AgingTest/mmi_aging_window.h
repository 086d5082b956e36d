// The aging window (what the run publishes, for an operator looking at a handset in a
// burn-in rack; a moving test pattern while the video item runs) and the aging result list
// (the last run's record, or the record of the run in progress).
#pragma once

#include <stddef.h>

#include "AgingTest/mmi_aging_run.h"
#include "mmi_msg.h"

// Makes the full-screen aging window on the GUI thread (any thread may call it) and
// returns it; the window already up is returned as it is. HWND_INVALID when it cannot be
// made (logged).
HWND mmi_CreateAgingTestWnd(void);
// The run has ended (finished or stopped; the run thread calls it): the window closes and
// then opens the result list. Any thread.
void mmi_aging_window_finished(void);
// Forgets that a run ended (a resumed run's window starts afresh). Any thread.
void mmi_aging_window_reset(void);
// The result list (GUI thread): 0, or -1 when its window cannot be made.
int mmi_AgingTestEntry(void);

// ---- the texts both screens show, without the screen (unit tested) ----

// Seconds as "H:MM:SS" (hours as many as it takes; a negative count shows 0:00:00).
void mmi_aging_format_elapsed(long long seconds, char *out, size_t size);
// The battery as "85 %  31.5 C" (temperature in tenths of a degree), "--" when the level is
// unknown (negative).
void mmi_aging_format_battery(int level, int tenths, char *out, size_t size);
// The language key of a phase (mmi_aging_phase); an unknown phase is "starting".
const char *mmi_aging_phase_key(int phase);
// The cycle an operator is told about: the one running (completed + 1, at most the cycles
// asked for), or the last one once the run finished.
int mmi_aging_shown_cycle(const mmi_aging_record *r);

#define MMI_AGING_ROW_TEXT 160

// One row of the result list: its label (a language key, or the text itself when labelKey
// is null), its value (valueKey translated when set, else value) and the colour of both.
struct mmi_aging_list_row {
    bool startsRun;  // choosing it asks whether to start a run
    const char *labelKey;
    char text[MMI_AGING_ROW_TEXT];
    const char *valueKey;
    char value[MMI_AGING_ROW_TEXT];
    int colour;  // mmi_colour
};

// Where the listed record came from.
enum mmi_aging_list_source {
    AGING_LIST_NONE,    // neither file: one row "aging_NoResult"
    AGING_LIST_MARKER,  // the reboot marker: a run is in progress
    AGING_LIST_RESULT,  // the last run's result file
};

// Row limit: the start of a run, every item, the state, the cycles, the elapsed time, the
// last failure's label and its text.
#define MMI_AGING_LIST_ROWS (AGING_ITEM_COUNT + 6)

// The rows of the list for record r from source, the start of a run first; pass and fail are the
// result words
// ("PASS", "FAIL"). Returns their number (at most max).
int mmi_aging_list_build(const mmi_aging_record *r, int source, const char *pass, const char *fail,
                         mmi_aging_list_row *rows, int max);

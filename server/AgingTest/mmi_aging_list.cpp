// The aging result list: one descriptor of the shared list screen, its rows built from the
// record of the run in progress (the reboot marker) or of the last run (the result file),
// under a first row that starts a run (through the main window's aging dialog).
#include <stdio.h>
#include <string.h>

#include <atomic>

#include <android/log.h>

#include "AgingTest/mmi_aging_window.h"
#include "mmi_guithread.h"
#include "mmi_theme.h"
#include "screens/mmi_devicetest.h"
#include "screens/mmi_listscreen.h"
#include "session/mmi_runstate.h"
#include "session/mmi_testinfo.h"
#include "testwnd/mmi_testwnd.h"
#include "tp_os.h"

#define AGING_TAG "AgingTest"

namespace {

// GUI thread only, apart from the handle.
std::atomic<HWND> s_window{HWND_INVALID};
mmi_aging_list_row s_rows[MMI_AGING_LIST_ROWS];
int s_rowCount;
// The main window's dialog that asks whether to start an aging run.
constexpr int kStartDialog = 6;

mmi_aging_list_row *next_row(mmi_aging_list_row *rows, int *n, int max, const char *labelKey) {
    if (*n >= max) return nullptr;
    mmi_aging_list_row *row = &rows[(*n)++];
    memset(row, 0, sizeof *row);
    row->labelKey = labelKey;
    row->colour = MMI_COLOUR_TEXT;
    return row;
}

// Rereads the record: the marker while a run is in progress, else the result file.
int load(mmi_aging_record *r) {
    char path[MMI_TESTWND_TEXT_SIZE];
    mmi_aging_marker_path(path, sizeof path);
    if (mmi_aging_record_load(r, path) == 0) return AGING_LIST_MARKER;
    mmi_aging_result_path(path, sizeof path);
    if (mmi_aging_record_load(r, path) == 0) return AGING_LIST_RESULT;
    return AGING_LIST_NONE;
}

int fill_rows(void) {
    char pass[MMI_TESTWND_TEXT_SIZE], fail[MMI_TESTWND_TEXT_SIZE];
    mmi_translate("Result_pass", pass, sizeof pass);
    mmi_translate("Result_fail", fail, sizeof fail);
    mmi_aging_record r;
    const int source = load(&r);
    s_rowCount = mmi_aging_list_build(&r, source, pass, fail, s_rows, MMI_AGING_LIST_ROWS);
    return s_rowCount;
}

void draw_row(HWND hWnd, HSVITEM hsvi, HDC hdc, RECT *rc) {
    const int i = mmi_listscreen_row(hsvi);
    if (i < 0 || i >= s_rowCount) return;
    const mmi_aging_list_row &row = s_rows[i];
    char label[MMI_TESTWND_TEXT_SIZE], value[MMI_TESTWND_TEXT_SIZE];
    if (row.labelKey)
        mmi_translate(row.labelKey, label, sizeof label);
    else
        tp_os_strlcpy(label, row.text, sizeof label);
    if (row.valueKey)
        mmi_translate(row.valueKey, value, sizeof value);
    else
        tp_os_strlcpy(value, row.value, sizeof value);
    mmi_listscreen_draw_row(hWnd, hsvi, hdc, rc, label, value, row.colour);
}

// The start row asks the main window for the aging dialog, unless a run is on.
void choose_row(int i) {
    if (i < 0 || i >= s_rowCount || !s_rows[i].startsRun) return;
    if (g_deviceIsAgingTest.load() == 1 || g_bAutoTestRunning.load() == 1) {
        __android_log_print(ANDROID_LOG_INFO, AGING_TAG, "a run is active: no aging start");
        return;
    }
    PostMessage(mmi_guithread_window(), MSG_CREATEDIALG, 0, (LPARAM)kStartDialog);
}

// Every row fits one screen between the bars (the height is set at each open).
mmi_listscreen_desc s_list = {
    .caption = "Aging",
    .titleKey = "title_AgingTest",
    .fontIndex = 3,
    .itemHeight = 0,
    .fill = fill_rows,
    .draw = draw_row,
    .choose = choose_row,
    .refreshMessage = MSG_TIMER,
    .window = &s_window,
    .style = WS_CAPTION | WS_BORDER | WS_VISIBLE,
};

}  // namespace

int mmi_aging_list_build(const mmi_aging_record *r, int source, const char *pass, const char *fail,
                         mmi_aging_list_row *rows, int max) {
    int n = 0;
    mmi_aging_list_row *row = next_row(rows, &n, max, "menu_StartTest");
    if (row == nullptr) return n;
    row->startsRun = true;
    if (source == AGING_LIST_NONE || r == nullptr) {
        next_row(rows, &n, max, "aging_NoResult");
        return n;
    }
    for (int i = 0; i < AGING_ITEM_COUNT; i++) {
        if ((row = next_row(rows, &n, max, mmi_aging_item_label(i))) == nullptr) return n;
        const mmi_aging_count &c = r->counts[i];
        if (c.fail > 0) {
            snprintf(row->value, sizeof row->value, "%s %d/%d", fail, c.fail, c.pass + c.fail);
            row->colour = mmi_devicetest_result_colour(MMI_RESULT_FAIL);
        } else if (c.pass > 0) {
            snprintf(row->value, sizeof row->value, "%s %d", pass, c.pass);
            row->colour = mmi_devicetest_result_colour(MMI_RESULT_PASS);
        } else {
            tp_os_strlcpy(row->value, "--", sizeof row->value);
        }
    }
    if ((row = next_row(rows, &n, max, "aging_State")) == nullptr) return n;
    row->valueKey = source == AGING_LIST_MARKER ? "aging_InProgress"
                    : r->stopped                ? "aging_Stopped"
                                                : "aging_Finished";
    if ((row = next_row(rows, &n, max, "aging_Cycles")) == nullptr) return n;
    snprintf(row->value, sizeof row->value, "%d / %d", r->cycle, r->cycles);
    if ((row = next_row(rows, &n, max, "aging_Elapsed")) == nullptr) return n;
    mmi_aging_format_elapsed(r->elapsed, row->value, sizeof row->value);
    if ((row = next_row(rows, &n, max, "aging_LastFailure")) == nullptr) return n;
    if (r->lastFailure[0] == '\0') {
        tp_os_strlcpy(row->value, "--", sizeof row->value);
        return n;
    }
    // The failure on a row of its own, as long as the row is wide.
    row->colour = MMI_COLOUR_FAIL;
    if ((row = next_row(rows, &n, max, nullptr)) == nullptr) return n;
    row->colour = MMI_COLOUR_FAIL;
    tp_os_strlcpy(row->text, r->lastFailure, sizeof row->text);
    return n;
}

int mmi_AgingTestEntry(void) {
    s_list.itemHeight = g_ptScreenInfo.width / 12;
    const int rc = mmi_listscreen_open(&s_list);
    __android_log_print(rc == 0 ? ANDROID_LOG_INFO : ANDROID_LOG_ERROR, AGING_TAG,
                        "aging result list %s (%d rows)", rc == 0 ? "opened" : "not opened",
                        s_rowCount);
    return rc;
}

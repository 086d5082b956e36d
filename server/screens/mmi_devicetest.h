// The device-test list: the three run starts, the record's summary, and one row per
// configured item with its result in colour. MSG_TIMER with wParam 1 refreshes it.
#pragma once

#include "mmi_msg.h"
#include "session/mmi_testitem.h"

#define MMI_DEVICETEST_TIMER_REFRESH 1

enum mmi_devicetest_row_kind {
    DEVICETEST_ROW_FULL_RUN,  // row 0
    DEVICETEST_ROW_SUMMARY,   // row 1: the record's summary, opens the information screen
    DEVICETEST_ROW_PRETEST1,  // row 2
    DEVICETEST_ROW_PRETEST2,  // row 3
    DEVICETEST_ROW_ITEM,      // one per configured item
};

struct mmi_devicetest_row {
    int kind;
    const char *labelKey;
    const testitem_node *item;  // DEVICETEST_ROW_ITEM only
    int resultIndex;            // item of the result record shown in colour, -1 for none
};

#define MMI_DEVICETEST_MAX_ROWS 64

// Fills rows from the item list; returns the count (at most max).
int mmi_devicetest_build_rows(const testitem_node *head, mmi_devicetest_row *rows, int max);
// What choosing a row does: the dialog kind (7, 8, 9) to ask the main window for, 0 to
// open the row's own entry, -1 when refused because a run is active. flags is the flag area.
int mmi_devicetest_choice(const mmi_devicetest_row *row, const unsigned char *flags,
                          int autoTestRunning);
// System pixel index a result is drawn in: 10 pass, 12 fail, 19 otherwise.
int mmi_devicetest_result_colour(int result);

int mmi_DeviceTestEntry(void);  // 0, or -1 when the window cannot be made
int mmi_DeviceTest_IsOpen(void);
HWND mmi_DeviceTest_Window(void);
// Asks the open list to reread the record and redraw (MSG_TIMER, wParam 1).
void mmi_DeviceTest_Refresh(void);
// The record changed (any thread): queues one such refresh of the open list.
void mmi_DeviceTest_RecordChanged(void);

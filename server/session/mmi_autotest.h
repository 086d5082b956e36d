// The automatic test sequence: the full run, the two pretest runs, the next-item rule and
// the restore files that let a run cut short by a reboot resume after its last pass.
#pragma once

#include <atomic>

#include "session/mmi_testitem.h"

// g_autoTestMode values.
#define AUTOTEST_MODE_FULL 0
#define AUTOTEST_MODE_PRETEST1 1
#define AUTOTEST_MODE_PRETEST2 3

// Summary items of the result record.
#define AUTOTEST_ITEM_CAC_PREVIEW 64
#define AUTOTEST_ITEM_CAC_PREVIEW_TEMP 66

#define AUTOTEST_LATEST_PASS_FILE "/data/pv_autotest_latest_pass"
#define AUTOTEST_RESTORE_FLAG_FILE "/data/pv_autotest_restore_flag"
#define AUTOTEST_AUX_LCD_FLAG_FILE "/data/pv_aux_lcd_test_flag"
#define AUTOTEST_FB0_BLACK_FLAG_FILE "/data/fb0_black_flag"
#define AUTOTEST_TS_MAIN_CTRL_FILE "/proc/touchscreen/ts_main_ctrl"

extern std::atomic<int> g_autoTestMode;

// What an item's entry returns when its window could not be made (HWND_INVALID).
#define AUTOTEST_ENTRY_FAILED ((void *)-1)

// What the sequence reaches outside itself; tests replace it.
struct mmi_autotest_ops {
    int (*write_result)(int item, int result);  // the result record
    int (*read_flags)(unsigned char *flags);    // whole flag area; -1 when unbound
    int (*read_config)(const char *domain, const char *key, char *out, const char *def);
    int (*modify_config)(const char *parm);  // "DOMAIN,key,value"
    int (*build_list)(int reset);
    int (*build_aux_list)(int reset);
    int (*open_device_list)(void);
    int (*device_list_is_open)(void);
    void (*refresh_device_list)(void);
    int (*lcd_off)(void);
    void (*exit_process)(int status);
    void (*sleep_us)(unsigned long us);
};
extern mmi_autotest_ops g_autotestOps;
mmi_autotest_ops mmi_autotest_default_ops(void);

// The selection rules over a list, without side effects.
// First item a run of `mode` opens; null when none.
const testitem_node *mmi_autotest_first_item(const testitem_node *head, int mode, int mmiPreFlag);
// The node whose config_domain is a prefix of domain; null when none.
const testitem_node *mmi_autotest_find_item(const testitem_node *head, const char *domain);
// The item after current that a run of `mode` opens next; null at the end of the list.
const testitem_node *mmi_autotest_next_item(const testitem_node *current, int mode, int mmiPreFlag);

// Ends the run where it is (an item that cannot open, a window closed from outside,
// nothing to run or to resume): running cleared, mode back to the full run, no summary.
void mmi_autotest_end_run(const char *why);
// Writes the resume file atomically (a neighbour renamed over it). 0 on success.
int mmi_autotest_write_latest_pass(const char *text);

int mmi_AutoTestEntry(void);
int mmi_AutoTestEntry_Ex(void);
int mmi_AutoTestEntry_Ex2(void);
// Called after a pass in a run, with the window's own domain.
int mmi_startNextItemTest(const char *domain);
// Makes the sequence the receiver of what the automatic run's test windows report.
void mmi_autotest_install_run(void);

// The automatic test sequence and its restore files.
#include "session/mmi_autotest.h"

#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <unistd.h>

#include <android/log.h>

#include "core/mmi_file.h"
#include "devfs.h"
#include "core/ftx_config.h"
#include "core/ftx_lib_binding.h"
#include "core/mmi_autotest_config.h"
#include "session/mmi_runstate.h"
#include "core/mmi_settings.h"
#include "session/mmi_testinfo.h"
#include "tp_os.h"

#define AT_DEBUG(...) __android_log_print(ANDROID_LOG_DEBUG, "FTX_AUTOTEST", __VA_ARGS__)
#define AT_ERROR(...) __android_log_print(ANDROID_LOG_ERROR, "FTX_AUTOTEST", __VA_ARGS__)

std::atomic<int> g_autoTestMode{AUTOTEST_MODE_FULL};

namespace {

int read_flags_default(unsigned char *flags) {
    if (!hw::ftx_api_GetTestInfoFlag) return -1;
    return hw::ftx_api_GetTestInfoFlag(flags);
}

int lcd_off_default(void) {
    return hw::ftx_api_LCD_Off ? hw::ftx_api_LCD_Off() : -1;
}

// Until start-up hands in the device-test list there is none to open.
int no_device_list(void) {
    return 0;
}
void no_refresh(void) {}

// The process ends at once, as a handset that is switched off: the other threads (the PC
// channel, the battery observer, fool-proof timers) are still running, so the globals they
// use must not be destroyed under them.
void exit_default(int status) {
    fflush(nullptr);
    dev_sync();
    _exit(status);
}

}  // namespace

mmi_autotest_ops mmi_autotest_default_ops(void) {
    return {.write_result = mmi_write_testinfo_single_byte,
            .read_flags = read_flags_default,
            .read_config = Read_MainCfgFile,
            .modify_config = mmi_AutoTest_Modify_ConfigFile,
            .build_list = Get_TestItem_Config,
            .build_aux_list = Get_AuxLCD_TestItem_Config,
            .open_device_list = no_device_list,
            .device_list_is_open = no_device_list,
            .refresh_device_list = no_refresh,
            .lcd_off = lcd_off_default,
            .exit_process = exit_default,
            .sleep_us = tp_os_usleep};
}

mmi_autotest_ops g_autotestOps = mmi_autotest_default_ops();

namespace {

// Restore files are plain files of the device root; a missing one is not an error.
void remove_file(const char *path) {
    AT_DEBUG("rm %s", path);
    dev_unlink(path);
}

void touch_file(const char *path) {
    FILE *fp = dev_fopen(path, "a");
    if (fp) fclose(fp);
}

// The file holds exactly the text, without a line end (the resume reads it back whole).
void write_text_file(const char *path, const char *text) {
    FILE *fp = dev_fopen(path, "w");
    if (!fp) {
        AT_ERROR("open %s fail.", path);
        return;
    }
    fputs(text, fp);
    fclose(fp);
}

bool file_exists(const char *path) {
    return dev_access(path, F_OK) == 0;
}

bool first_pick_ok(const testitem &t, int mode, int mmiPreFlag) {
    switch (mode) {
        case AUTOTEST_MODE_PRETEST1:
            return t.item_pre != 0;
        case AUTOTEST_MODE_PRETEST2:
            // Unlike the next-item rule, the first pick of pretest 2 ignores `auto`.
            return t.item_pre != 1;
        default:
            return !(mmiPreFlag && t.item_mmi) && t.item_auto != 0;
    }
}

typedef bool (*accept_fn)(const testitem &t);

bool accept_pretest1(const testitem &t) {
    return t.item_pre && t.item_auto;
}
bool accept_pretest2(const testitem &t) {
    return t.item_pre != 1 && t.item_auto;
}
bool accept_mmi(const testitem &t) {
    return t.item_mmi != 1 && t.item_auto;
}
bool accept_auto(const testitem &t) {
    return t.item_auto != 0;
}

// One pass of the next-item rule: moves p forward while its next item is not acceptable.
const testitem_node *skip_pass(const testitem_node *p, accept_fn ok, bool autoLog) {
    while (p->pNodeNext && !ok(*p->pNodeNext)) {
        if (autoLog) {
            AT_DEBUG("pTestItemTmp->pNodeNext->testitem.item_auto = %d", p->pNodeNext->item_auto);
        } else {
            AT_DEBUG("pTestItemTmp->pNodeNext->testitem.item_mmi = %d", p->pNodeNext->item_mmi);
        }
        p = p->pNodeNext;
    }
    return p;
}

void common_start(const char *who) {
    AT_DEBUG("%s begin.", who);
    AT_DEBUG("%s begin", "get_mmi_pre_flag");
    char buf[MMI_TEXT_SIZE] = {0};
    if (g_autotestOps.read_config("MMI", "mmi_flag", buf, "0") == 0) {
        g_mmiPreFlag = atoi(buf);
        memset(buf, 0, sizeof(buf));
        if (g_autotestOps.read_config("MMI", "pretest_menu_enable", buf, "0") == 0) {
            g_pretestMenuEnabled = atoi(buf);
        }
    }
    g_autotestOps.build_list(1);
}

// An item whose window cannot be opened ends the run where it is, as a fail would (without
// a record): the list stays usable instead of waiting for a pass that cannot come.
void open_item(const testitem_node *item) {
    void *w = item->entry ? item->entry() : AUTOTEST_ENTRY_FAILED;
    if (w != AUTOTEST_ENTRY_FAILED) return;
    AT_ERROR("%s %s could not be opened", __func__, item->config_domain);
    mmi_autotest_end_run("an item could not be opened");
}

int start_first(int mode) {
    const testitem_node *first =
        mmi_autotest_first_item(g_pTestItemListHead, mode, g_mmiPreFlag.load());
    if (!first) {
        // Nothing takes part in this run: it is over before it began.
        mmi_autotest_end_run("no item to run");
        return -1;
    }
    open_item(first);
    return 0;
}

// The run reached the end of its list: summary items, then back to the device-test list
// (or, with an auxiliary LCD, the end of this LCD pass).
void finish_run(void) {
    const int mode = g_autoTestMode.load();
    if (mode == AUTOTEST_MODE_PRETEST1 || g_pretestMenuEnabled == 1) {
        g_autotestOps.write_result(AUTOTEST_ITEM_CAC_PREVIEW_TEMP, 1);
    }
    if (mode == AUTOTEST_MODE_PRETEST2) g_autotestOps.write_result(AUTOTEST_ITEM_CAC_PREVIEW, 1);
    if (g_bAutoTestRunning == 1 && mode == AUTOTEST_MODE_FULL) {
        g_autotestOps.write_result(AUTOTEST_ITEM_CAC_PREVIEW, 1);
    }
    if (g_mmiPreFlag == 1) g_autotestOps.modify_config("MMI,mmi_flag,0");

    char auxLcd[MMI_TEXT_SIZE] = {0};
    g_autotestOps.read_config("MMI", "aux_lcd", auxLcd, "0");
    const bool hasAuxLcd = atoi(auxLcd) != 0;

    if (g_bRestoreAutotest) {
        remove_file(AUTOTEST_RESTORE_FLAG_FILE);
        remove_file(AUTOTEST_LATEST_PASS_FILE);
        if (!hasAuxLcd && !g_autotestOps.device_list_is_open()) {
            g_autotestOps.open_device_list();
            g_bAutoTestRunning = 0;
            g_autotestOps.refresh_device_list();
            g_autoTestMode = AUTOTEST_MODE_FULL;
            return;
        }
    }
    if (!hasAuxLcd) {
        g_bAutoTestRunning = 0;
        g_autotestOps.refresh_device_list();
        g_autoTestMode = AUTOTEST_MODE_FULL;
        return;
    }
    // Item 64 stays failed between the two LCD passes; the next start runs the auxiliary one.
    const bool mainPass = !file_exists(AUTOTEST_AUX_LCD_FLAG_FILE);
    if (mainPass) {
        g_autotestOps.write_result(AUTOTEST_ITEM_CAC_PREVIEW, 2);
        AT_DEBUG("touch %s", AUTOTEST_AUX_LCD_FLAG_FILE);
        touch_file(AUTOTEST_AUX_LCD_FLAG_FILE);
    } else {
        remove_file(AUTOTEST_FB0_BLACK_FLAG_FILE);
        AT_DEBUG("echo 1 > %s", AUTOTEST_TS_MAIN_CTRL_FILE);
        write_text_file(AUTOTEST_TS_MAIN_CTRL_FILE, "1\n");
        remove_file(AUTOTEST_AUX_LCD_FLAG_FILE);
    }
    AT_DEBUG("%s: the %s LCD pass is over: LCD off, the process ends", __func__,
             mainPass ? "main" : "auxiliary");
    g_autotestOps.lcd_off();
    g_autotestOps.exit_process(0);
}

}  // namespace

const testitem_node *mmi_autotest_first_item(const testitem_node *head, int mode, int mmiPreFlag) {
    for (const testitem_node *p = head; p; p = p->pNodeNext) {
        if (first_pick_ok(*p, mode, mmiPreFlag)) return p;
    }
    return nullptr;
}

const testitem_node *mmi_autotest_find_item(const testitem_node *head, const char *domain) {
    for (const testitem_node *p = head; p; p = p->pNodeNext) {
        AT_DEBUG("%s current_testitem.config_domain=%s", "mmi_startNextItemTest", p->config_domain);
        if (strncmp(p->config_domain, domain, strlen(p->config_domain)) == 0) return p;
    }
    return nullptr;
}

const testitem_node *mmi_autotest_next_item(const testitem_node *current, int mode,
                                            int mmiPreFlag) {
    const testitem_node *p = current;
    if (mode == AUTOTEST_MODE_PRETEST1) p = skip_pass(p, accept_pretest1, false);
    if (mode == AUTOTEST_MODE_PRETEST2) p = skip_pass(p, accept_pretest2, false);
    if (mmiPreFlag == 1) p = skip_pass(p, accept_mmi, false);
    if (mmiPreFlag == 0 && mode == AUTOTEST_MODE_FULL) p = skip_pass(p, accept_auto, true);
    return p->pNodeNext;
}

int mmi_AutoTestEntry(void) {
    common_start(__func__);
    if (file_exists(AUTOTEST_AUX_LCD_FLAG_FILE)) {
        write_text_file(AUTOTEST_TS_MAIN_CTRL_FILE, "0\n");
        g_autotestOps.build_aux_list(1);
    }
    g_bAutoTestRunning = 1;
    g_autoTestMode = AUTOTEST_MODE_FULL;
    return start_first(AUTOTEST_MODE_FULL);
}

int mmi_AutoTestEntry_Ex(void) {
    common_start(__func__);
    g_bAutoTestRunning = 1;
    g_autoTestMode = AUTOTEST_MODE_PRETEST1;
    // Marked failed first, so that a pretest cut short stays failed.
    g_autotestOps.write_result(AUTOTEST_ITEM_CAC_PREVIEW_TEMP, 2);
    int ret = start_first(AUTOTEST_MODE_PRETEST1);
    AT_DEBUG("%s end.", __func__);
    return ret;
}

int mmi_AutoTestEntry_Ex2(void) {
    common_start(__func__);
    unsigned char flags[256] = {0};
    g_autotestOps.read_flags(flags);
    // Item 66 is the third slot (bits 3-2) of byte 16.
    if (((flags[AUTOTEST_ITEM_CAC_PREVIEW_TEMP / 4] >> 2) & 3) != 1) {
        AT_DEBUG("mmi_AutoTestEntry_Ex2: Autotest Pretest1 fails, can't run Pretest2.");
        return -1;
    }
    g_bAutoTestRunning = 1;
    g_autoTestMode = AUTOTEST_MODE_PRETEST2;
    int ret = start_first(AUTOTEST_MODE_PRETEST2);
    AT_DEBUG("%s end.", __func__);
    return ret;
}

int mmi_startNextItemTest(const char *domain) {
    if (!domain) domain = "";
    AT_DEBUG("%s begin.chdomain = %s", __func__, domain);
    if (g_bRestoreAutotest) {
        if (!file_exists(AUTOTEST_RESTORE_FLAG_FILE)) {
            AT_DEBUG("echo latest pass chdomain %s", domain);
            mmi_autotest_write_latest_pass(domain);
        } else {
            // First pass after a resume.
            remove_file(AUTOTEST_RESTORE_FLAG_FILE);
            g_bAutoTestRunning = 1;
        }
    }
    g_autotestOps.sleep_us(5000);
    AT_DEBUG("%s chdomain=%s", __func__, domain);
    if (!g_pTestItemListHead) {
        AT_ERROR("%s error: pTestItemTmp is NULL", __func__);
        mmi_autotest_end_run("empty item list");
        return -1;
    }
    const testitem_node *current = mmi_autotest_find_item(g_pTestItemListHead, domain);
    if (!current) {
        // An empty or stale resume file, or an item no longer enabled: nothing says the run
        // got to its end, so it stops here without the summary pass.
        AT_ERROR("%s no item for chdomain=%s", __func__, domain);
        mmi_autotest_end_run("current item not in the list");
        return -1;
    }
    const testitem_node *next =
        mmi_autotest_next_item(current, g_autoTestMode.load(), g_mmiPreFlag.load());
    if (next) {
        open_item(next);
        return 0;
    }
    finish_run();
    return 0;
}

void mmi_autotest_end_run(const char *why) {
    AT_DEBUG("%s running=%d mode=%d: %s", __func__, g_bAutoTestRunning.load(),
             g_autoTestMode.load(), why ? why : "");
    g_bAutoTestRunning = 0;
    g_autoTestMode = AUTOTEST_MODE_FULL;
}

int mmi_autotest_write_latest_pass(const char *text) {
    // A power cut must leave the old content or the new one, never a truncated file.
    if (mmi_file_replace(AUTOTEST_LATEST_PASS_FILE, text, strlen(text)) != 0) {
        AT_ERROR("write %s fail.", AUTOTEST_LATEST_PASS_FILE);
        return -1;
    }
    return 0;
}

namespace {

void run_pass(int resultIndex, const char *domain) {
    if (g_bAutoTestRunning != 1) return;
    mmi_write_testinfo_single_byte(resultIndex, 1);
    mmi_startNextItemTest(domain);
}

void run_fail(int resultIndex) {
    if (g_bAutoTestRunning == 1) mmi_write_testinfo_single_byte(resultIndex, 2);
    mmi_autotest_end_run("fail");
}

void run_windows_closed(void) {
    if (g_bAutoTestRunning == 1) mmi_autotest_end_run("test window closed");
}

const mmi_run_ops kRun = {run_pass, run_fail, run_windows_closed};

}  // namespace

void mmi_autotest_install_run(void) {
    mmi_run_install(MMI_RUN_AUTO, &kRun);
}

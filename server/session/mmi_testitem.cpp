// The test item lists of the runs, built from the catalogue and the configuration.
#include "session/mmi_testitem.h"

#include <stdlib.h>
#include <string.h>

#include <atomic>

#include <android/log.h>

#include "core/ftx_config.h"
#include "tp_os.h"

#define CFG_DEBUG(...) __android_log_print(ANDROID_LOG_DEBUG, "FTX_CONFIG", __VA_ARGS__)
#define CFG_ERROR(...) __android_log_print(ANDROID_LOG_ERROR, "FTX_CONFIG", __VA_ARGS__)

namespace {
const mmi_catalogue kNoCatalogue = {};
std::atomic<const mmi_catalogue *> s_catalogue{&kNoCatalogue};
}  // namespace

void mmi_testitem_use_catalogue(const mmi_catalogue *catalogue) {
    s_catalogue = catalogue != nullptr ? catalogue : &kNoCatalogue;
}

testitem_node *g_pTestItemListHead;
int g_testItemListCount;
testitem_node *g_pMonomerPreviewListHead;
int g_monomerPreviewListCount;

namespace {

// How much of a row a build reads, and whether it writes the auxiliary build's lines.
enum class BuildKind { Main, AuxLCD, Monomer };

struct ItemList {
    testitem_node **head;
    int *count;
};

// One key of the row's domain into a zeroed buffer; false when the main file failed.
bool read_key(const char *domain, const char *key, char *out, const char *def) {
    memset(out, 0, FTX_CFG_TEXT_SIZE);
    return Read_MainCfgFile(domain, key, out, def) == 0;
}

// A flag whose failed lookup gives `fallback` instead of the lookup's default.
int32_t read_flag(const char *domain, const char *key, const char *def, int32_t fallback) {
    char work[FTX_CFG_TEXT_SIZE];
    return read_key(domain, key, work, def) ? atoi(work) : fallback;
}

void append_node(const ItemList &list, const testitem &row) {
    testitem_node *node = (testitem_node *)calloc(1, sizeof(testitem_node));
    if (node == nullptr) {
        CFG_ERROR("%s: out of memory for %s", __func__, row.config_domain);
        return;
    }
    *static_cast<testitem *>(node) = row;
    node->item_num = (*list.count)++;
    node->pNodeNext = nullptr;
    testitem_node **tail = list.head;
    while (*tail != nullptr)
        tail = &(*tail)->pNodeNext;
    *tail = node;
}

// Reads every row's settings in table order (the rows are updated in place, so menus see
// disabled items too) and appends the enabled rows. A failed enable or parameter lookup
// stops the build and keeps the nodes appended so far.
int build_list(testitem *table, int rows, const ItemList &list, BuildKind kind, const char *who) {
    char work[FTX_CFG_TEXT_SIZE];
    if (kind == BuildKind::AuxLCD) {
        CFG_DEBUG("%s g_testitemnum_total=%d", who, rows);
        if (rows > 0) CFG_DEBUG("%s domain=%s", who, table[0].config_domain);
    }
    for (int i = 0; i < rows; i++) {
        testitem &row = table[i];
        if (!read_key(row.config_domain, "enable", work, "0")) return -1;
        row.item_enable = atoi(work);
        if (kind == BuildKind::AuxLCD) {
            CFG_DEBUG("%s strtmp::enable=%s", who, work);
            CFG_DEBUG("%s TestItemWinMenu[%d].item_enable=%d", who, i, row.item_enable);
        }
        if (kind != BuildKind::Monomer) {
            row.item_auto = read_flag(row.config_domain, "auto", "1", 1);
            row.item_mmi = read_flag(row.config_domain, "mmi", "0", 0);
            CFG_DEBUG("mmi %d", row.item_mmi);
            // A failed read gives 0, not the default 1: the run logic relies on it.
            row.item_pre = read_flag(row.config_domain, "pre", "1", 0);
        }
        memset(row.parameter, 0, sizeof(row.parameter));
        if (Read_MainCfgFile(row.config_domain, "parameter", row.parameter, nullptr) != 0) {
            return -1;
        }
        if (row.item_enable == 0) continue;
        append_node(list, row);
        if (kind == BuildKind::AuxLCD) {
            CFG_DEBUG("%s domain=%s,enable=%d,parameter=%s", who, row.config_domain,
                      row.item_enable, row.parameter);
        }
    }
    return 0;
}

// The main and the auxiliary-LCD builds share one list.
int build_run_list(int reset, const testitem_table &t, BuildKind kind, const char *who) {
    if (reset & 1) g_pTestItemListHead = nullptr;
    g_testItemListCount = 0;
    return build_list(t.rows, t.count, {&g_pTestItemListHead, &g_testItemListCount}, kind, who);
}

}  // namespace

int Get_TestItem_Config(int reset) {
    return build_run_list(reset, s_catalogue.load()->main, BuildKind::Main, __func__);
}

int Get_AuxLCD_TestItem_Config(int reset) {
    return build_run_list(reset, s_catalogue.load()->auxLcd, BuildKind::AuxLCD, __func__);
}

int Get_MonomerPreviewTestItem_Config(void) {
    g_pMonomerPreviewListHead = nullptr;
    g_monomerPreviewListCount = 0;
    const testitem_table &t = s_catalogue.load()->monomer;
    return build_list(t.rows, t.count, {&g_pMonomerPreviewListHead, &g_monomerPreviewListCount},
                      BuildKind::Monomer, __func__);
}

int ftx_config_Get_TestItem_Config_Paras(const char *domain) {
    if (domain == nullptr) return -1;
    const testitem_table &t = s_catalogue.load()->main;
    for (int i = 0; i < t.count; i++) {
        const char *rowDomain = t.rows[i].config_domain;
        if (strncmp(domain, rowDomain, strlen(rowDomain)) == 0) return i;
    }
    return -1;
}

const testitem *mmi_testitem_main_row(const char *domain) {
    const int i = ftx_config_Get_TestItem_Config_Paras(domain);
    return i < 0 ? nullptr : &s_catalogue.load()->main.rows[i];
}

void mmi_build_test_lists(void) {
    Get_MonomerPreviewTestItem_Config();
    Get_TestItem_Config(0);
}

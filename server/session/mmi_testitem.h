// The test item lists of the runs, built from the catalogue and the configuration.
#pragma once

#include <stdint.h>

#define TESTITEM_TEXT_SIZE 256

// A test window's entry returns the window (HWND) or HWND_INVALID; stop closes it.
typedef void *(*testitem_entry_fn)(void);
typedef int (*testitem_stop_fn)(void);

struct testitem {
    int32_t item_num;               // compiled-in number; in a list node its position in the list
    char name[TESTITEM_TEXT_SIZE];  // language key of the title
    testitem_entry_fn entry;
    testitem_stop_fn stop;  // may be null
    char config_domain[TESTITEM_TEXT_SIZE];
    int32_t item_code;
    int32_t item_enable;
    int32_t item_auto;
    int32_t item_mmi;
    int32_t item_pre;
    char parameter[TESTITEM_TEXT_SIZE];
    int32_t spare;
};

struct testitem_node : testitem {
    testitem_node *pNodeNext;
};

// The catalogue's tables the lists are built from (the full run, the auxiliary-LCD run and
// the monomer preview); their rows are updated in place by the builders.
struct testitem_table {
    testitem *rows;
    int count;
};
struct mmi_catalogue {
    testitem_table main;
    testitem_table auxLcd;
    testitem_table monomer;
};
// Start-up hands the catalogue in before any list is built; until then the lists are empty.
void mmi_testitem_use_catalogue(const mmi_catalogue *catalogue);

// The test item list (main and auxiliary-LCD builds) and the monomer preview list.
extern testitem_node *g_pTestItemListHead;
extern int g_testItemListCount;
extern testitem_node *g_pMonomerPreviewListHead;
extern int g_monomerPreviewListCount;

// Bit 0 of reset forgets the old list (nodes are never freed); without it new nodes are
// appended behind the old ones. The count always restarts at 0. 0, or -1 when a lookup
// failed and the build stopped.
int Get_TestItem_Config(int reset);
int Get_AuxLCD_TestItem_Config(int reset);
int Get_MonomerPreviewTestItem_Config(void);

// The lists every start builds: the monomer preview's, then the main one (reset 0).
void mmi_build_test_lists(void);

// Main-table row whose config_domain is a prefix of domain, or -1.
int ftx_config_Get_TestItem_Config_Paras(const char *domain);
// That row itself (its configured flags and parameter string), or null.
const testitem *mmi_testitem_main_row(const char *domain);

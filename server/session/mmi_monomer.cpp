// The monomer preview sequence.
#include "session/mmi_monomer.h"

#include <android/log.h>

#include "session/mmi_autotest.h"
#include "session/mmi_runstate.h"
#include "session/mmi_testitem.h"

#define MP_DEBUG(...) __android_log_print(ANDROID_LOG_DEBUG, "FTX_MAIN", __VA_ARGS__)

std::atomic<int> g_bMonomerPreviewRunning{0};

int mmi_testwnd_MonomerPreview_Entry(void) {
    MP_DEBUG("%s begin.", __func__);
    Get_MonomerPreviewTestItem_Config();
    const testitem_node *first = g_pMonomerPreviewListHead;
    if (!first) {
        MP_DEBUG("%s error: no preview item enabled", __func__);
        return -1;
    }
    g_bMonomerPreviewRunning = 1;
    if (first->entry) first->entry();
    return 0;
}

int mmi_startNextMonomerPreviewItemTest(const char *domain) {
    MP_DEBUG("%s begin.chdomain = %s", __func__, domain ? domain : "");
    if (g_bMonomerPreviewRunning != 1 || !domain) return 1;
    const testitem_node *current = mmi_autotest_find_item(g_pMonomerPreviewListHead, domain);
    // Every enabled item of the preview list takes part.
    const testitem_node *next = current ? current->pNodeNext : nullptr;
    if (next) {
        if (next->entry) next->entry();
        return 0;
    }
    MP_DEBUG("%s preview done", __func__);
    g_bMonomerPreviewRunning = 0;
    return 1;
}

namespace {

void run_pass(int, const char *domain) {
    if (g_bMonomerPreviewRunning == 1) mmi_startNextMonomerPreviewItemTest(domain);
}

void run_stop(int) {
    g_bMonomerPreviewRunning = 0;
}

void run_windows_closed(void) {
    g_bMonomerPreviewRunning = 0;
}

const mmi_run_ops kRun = {run_pass, run_stop, run_windows_closed};

}  // namespace

void mmi_monomer_install_run(void) {
    mmi_run_install(MMI_RUN_MONOMER, &kRun);
}

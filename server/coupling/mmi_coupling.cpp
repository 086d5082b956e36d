#include "coupling/mmi_coupling.h"

#include <android/log.h>
#include <stdlib.h>

#include <atomic>

#include "core/ftx_config.h"
#include "mmi_theme.h"
#include "coupling/mmi_nonsignal.h"
#include "coupling/mmi_signal_coupling.h"
#include "screens/mmi_listscreen.h"
#include "testwnd/mmi_testwnd.h"
#include "tp_os.h"

#define COUPLING_TAG "FTX_COUPLING"

namespace {

struct Test {
    const char *labelKey;
    int (*enabled)(void);
    int (*entry)(void);
};

int signal_enabled(void) {
    char value[FTX_CFG_TEXT_SIZE] = "";
    Read_MainCfgFile("MAIN_UI", "signalCouple", value, "1");
    return value[0] != '\0' ? atoi(value) : 1;
}

const Test kTests[] = {
    {"title_SingalCouple", signal_enabled, mmi_SignalCouplingTestEntry},
    {"title_NonSignal", mmi_nonsignal_enabled, mmi_NonSignalTestEntry},
};
const int kTestCount = sizeof kTests / sizeof kTests[0];

// The enabled tests, in the table's order (GUI thread).
const Test *s_rows[kTestCount];
int s_rowCount;
std::atomic<HWND> s_window{HWND_INVALID};

int fill_rows(void) {
    s_rowCount = 0;
    for (const Test &t : kTests)
        if (t.enabled()) s_rows[s_rowCount++] = &t;
    return s_rowCount;
}

void draw_row(HWND hWnd, HSVITEM hsvi, HDC hdc, RECT *rc) {
    const int i = mmi_listscreen_row(hsvi);
    if (i < 0 || i >= s_rowCount) return;
    char label[MMI_TESTWND_TEXT_SIZE];
    mmi_translate(s_rows[i]->labelKey, label, sizeof label);
    mmi_listscreen_draw_row(hWnd, hsvi, hdc, rc, label, "", MMI_COLOUR_TEXT);
}

void choose_row(int i) {
    if (i >= 0 && i < s_rowCount) s_rows[i]->entry();
}

mmi_listscreen_desc s_list = {
    .caption = "Coupling",
    .titleKey = "menu_CoupleTest",
    .fontIndex = 3,
    .itemHeight = 0,
    .fill = fill_rows,
    .draw = draw_row,
    .choose = choose_row,
    .refreshMessage = MSG_TIMER,
    .window = &s_window,
};

}  // namespace

int mmi_testwnd_Coupling_Entry(void) {
    const int n = fill_rows();
    __android_log_print(ANDROID_LOG_DEBUG, COUPLING_TAG, "%s::%d coupling test(s) enabled",
                        __func__, n);
    if (n == 0) return -1;
    if (n == 1) return s_rows[0]->entry();
    s_list.itemHeight = (g_ptScreenInfo.width / 15) * 2;
    return mmi_listscreen_open(&s_list);
}

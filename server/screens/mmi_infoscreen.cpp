// The test and product information screen.
#include "screens/mmi_infoscreen.h"

#include <string.h>

#include <atomic>

#include <android/log.h>

#include "core/ftx_config.h"
#include "core/ftx_lib_binding.h"
#include "screens/mmi_identity.h"
#include "screens/mmi_listscreen.h"
#include "screens/mmi_qrscreen.h"
#include "session/mmi_testinfo.h"
#include "tp_os.h"
#include "mmi_theme.h"

#define INFO_TAG "FTX_MAIN"

namespace {

// GUI thread only, apart from the handle.
std::atomic<HWND> s_window{HWND_INVALID};
mmi_info_line s_lines[MMI_INFO_MAX_LINES];
int s_lineCount;

// A text key with the words to show when the language file lacks it.
void translate(const char *key, const char *fallback, char *out, size_t size) {
    tp_os_strlcpy(out, fallback, size);
    Read_LangCfgFromList(key, out);
}

struct IdentityRow {
    const char *key;
    const char *fallback;
    int kind;  // mmi_identity_kind, or -1 for the IMEI
};
const IdentityRow kIdentity[] = {
    {"info_SoftwareInternal", "Internal software", MMI_ID_SOFT_INTERNAL},
    {"info_SoftwareExternal", "External software", MMI_ID_SOFT_EXTERNAL},
    {"info_HardwareVersion", "Hardware version", MMI_ID_HARDWARE},
    {"info_PSN", "PSN", MMI_ID_PSN},
    {"info_BoardNum", "Board number", MMI_ID_BOARD},
    {"info_IMEI", "IMEI", -1},
    {"info_FlashType", "Flash type", MMI_ID_FLASH},
};

int build_lines(void) {
    s_lineCount = 0;
    for (const auto &row : kIdentity) {
        mmi_info_line &l = s_lines[s_lineCount++];
        translate(row.key, row.fallback, l.label, sizeof(l.label));
        memset(l.value, 0, sizeof(l.value));
        if (row.kind < 0) {
            mmi_testinfo_text(FTX_DATATYPE_TESTINFO_IMEI, l.value, sizeof(l.value));
        } else {
            mmi_identity_text(row.kind, l.value, sizeof(l.value));
        }
        l.colour = MMI_COLOUR_TEXT;
    }
    unsigned char flags[MMI_TESTINFO_FLAGS_SIZE] = {0};
    if (hw::ftx_api_GetTestInfoFlag) hw::ftx_api_GetTestInfoFlag(flags);
    s_lineCount +=
        mmi_info_record_lines(flags, s_lines + s_lineCount, MMI_INFO_MAX_LINES - s_lineCount);
    return s_lineCount;
}

void draw_line(HWND hWnd, HSVITEM hsvi, HDC hdc, RECT *rc) {
    int i = mmi_listscreen_row(hsvi);
    if (i < 0 || i >= s_lineCount) return;
    mmi_listscreen_draw_row(hWnd, hsvi, hdc, rc, s_lines[i].label, s_lines[i].value,
                            s_lines[i].colour);
}

// Choosing the board-number row shows the board's bar code as a QR code.
void choose(int row) {
    if (row >= 0 && row < static_cast<int>(sizeof kIdentity / sizeof kIdentity[0]) &&
        kIdentity[row].kind == MMI_ID_BOARD)
        mmi_teswnd_QRCode();
}

// MSG_CALLBACK: the test information (IMEI) has arrived.
const mmi_listscreen_desc kInfo = {
    "Product Information", "menu_ProduceInfo", 4, 0, build_lines, draw_line, choose,
    MSG_CALLBACK,          &s_window};

}  // namespace

int mmi_info_record_lines(const unsigned char *flags, mmi_info_line *lines, int max) {
    GetTestItemsResult(flags);
    char pass[MMI_INFO_LINE_SIZE], fail[MMI_INFO_LINE_SIZE];
    translate("Result_pass", "Result_pass", pass, sizeof(pass));
    translate("Result_fail", "Result_fail", fail, sizeof(fail));
    int n = 0;
    for (int i = 0; i < MMI_TESTINFO_ITEMS && n < max; i++) {
        unsigned r = g_testinfo[i].test_result;
        if (r != MMI_RESULT_PASS && r != MMI_RESULT_FAIL) continue;
        mmi_info_line &l = lines[n++];
        snprintf(l.label, sizeof(l.label), "%d %s", g_testinfo[i].index, g_testinfo[i].context);
        tp_os_strlcpy(l.value, r == MMI_RESULT_PASS ? pass : fail, sizeof(l.value));
        l.colour = r == MMI_RESULT_PASS ? MMI_COLOUR_PASS : MMI_COLOUR_FAIL;
    }
    return n;
}

int mmi_TestInfoEntry(void) {
    static mmi_listscreen_desc info = kInfo;
    info.itemHeight = g_ptScreenInfo.width / 15 + 8;
    int rc = mmi_listscreen_open(&info);
    // The IMEI comes through the library's callback; the screen rebuilds when it is in.
    if (rc == 0) mmi_testinfo_request(s_window.load());
    return rc;
}

HWND mmi_TestInfo_Window(void) {
    return s_window.load();
}

// The main menu: its rows, the list that shows them and the choice of a row.
#include "hub/mmi_hub_menu.h"

#include <stdlib.h>
#include <string.h>
#include <tp_os.h>

#include "core/ftx_config.h"
#include "hub/hub_internal.h"
#include "hub/mmi_mainwnd.h"
#include "mmi_bars.h"
#include "mmi_menulist.h"
#include "mmi_theme.h"
#include "AgingTest/mmi_aging.h"
#include "coupling/mmi_coupling.h"
#include "wifi/mmi_wifi.h"
#include "screens/mmi_devicetest.h"
#include "screens/mmi_infoscreen.h"
#include "session/mmi_monomer.h"

mmi_menu_row g_mainMenu[MMI_MENU_MAX_ROWS] = {
    {0, "menu_ProduceInfo", mmi_TestInfoEntry},
    {1, "menu_DeviceTest", mmi_DeviceTestEntry},
    {2, "menu_TPPreviewTest", mmi_testwnd_MonomerPreview_Entry},
    {3, "", nullptr},
    {4, "", nullptr},
};
int g_mainMenuCount = 0;

int g_bCoupleTest = 0;
int g_bAgingTest = 1;

namespace {

const int kListId = 21;

void add_row(HWND list, mmi_menu_row *row, int itemHeight) {
    Read_LangCfgFromList(row->label, row->label);
    SVITEMINFO info{};
    info.nItem = row->index;
    info.nItemHeight = itemHeight;
    info.addData = (DWORD)row->label;
    SendMessage(list, SVM_ADDITEM, 0, (LPARAM)&info);
    g_mainMenuCount++;
}

void append_row(HWND list, int *count, const char *key, int (*entry)(void), int itemHeight) {
    // The table holds five rows; a sixth is refused here instead of overrunning it.
    if (*count >= MMI_MENU_MAX_ROWS) {
        (*count)++;
        return;
    }
    mmi_menu_row *row = &g_mainMenu[*count];
    tp_os_strlcpy(row->label, key, sizeof row->label);
    row->index = *count;
    row->entry = entry;
    add_row(list, row, itemHeight);
    (*count)++;
}

}  // namespace

namespace hub {

void read_menu_config() {
    char value[FTX_CFG_TEXT_SIZE] = {0};
    Read_MainCfgFile("MAIN_UI", "coupleTest", value, "0");
    g_bCoupleTest = atoi(value);
    memset(value, 0, sizeof value);
    g_bAgingTest = Read_MainCfgFile("MAIN_UI", "aging", value, "1") == 0 ? atoi(value) : 1;
    LOGD("%s,L%d::g_bCoupleTest=%d.", "mmi_CurrentWnd_ReadConfig", __LINE__, g_bCoupleTest);
    LOGD("%s,L%d::g_bAgingTest=%d.", "mmi_CurrentWnd_ReadConfig", __LINE__, g_bAgingTest);
}

void create_menu(HWND hWnd) {
    int w, h;
    screen_size(&w, &h);
    mmi_hub_layout l;
    mmi_hub_layout_for(w, h, &l);
    MMI_WiFi_GetConfigParas();
    LOGD("main_wifi_init_flag = %d", mmi_wifi_init_flag());
    LOGD("g_ptScreenInfo.width= %d", w);
    LOGD("g_ptScreenInfo.height = %d", h);
    HWND list = CreateWindowEx(CTRL_SCROLLVIEW, "", WS_CHILD | WS_VISIBLE | WS_BORDER | SVS_LOOP,
                               WS_EX_NONE, kListId, 0, 0, w, l.listHeight, hWnd, 0);
    if (list == HWND_INVALID) {
        LOGE("%s create list fail", "mmi_ExampleWin_MenuWndProc");
        return;
    }
    if (g_mmiLogFont[2]) SetWindowFont(list, g_mmiLogFont[2]);
    SetWindowBkColor(list, mmi_pixel(MMI_COLOUR_WINDOW));
    SendMessage(list, SVM_SETITEMDRAW, 0, (LPARAM)mmi_SVDrawItem);
    g_mainMenuCount = 0;
    int count = 0;
    while (count < MMI_MENU_MAX_ROWS && g_mainMenu[count].entry) {
        add_row(list, &g_mainMenu[count], l.itemHeight);
        count++;
    }
    if (g_bCoupleTest)
        append_row(list, &count, "menu_CoupleTest", mmi_testwnd_Coupling_Entry, l.itemHeight);
    if (g_bAgingTest) append_row(list, &count, "title_AgingTest", mmi_AgingTestEntry, l.itemHeight);
    if (count < 6) {
        SendMessage(list, SVM_SETCURSEL, 0, 1);
        SetNotificationCallback(list, ScrollViewProc);
        SetFocusChild(list);
        svr_create_softkeybar(hWnd, &l.softKeyBar, 1);
        svr_create_batteryshow(hWnd, &l.titleStrip, 1);
        SetTimer(hWnd, MMI_TIMER_BARS, 100);
        refresh_bars(hWnd);
    } else {
        LOGD("item num:%d,max:%d.", count, MMI_MENU_MAX_ROWS);
    }
}

}  // namespace hub

void ScrollViewProc(HWND hwnd, LINT id, int nc, DWORD add_data) {
    (void)id;
    if (nc != SVN_ITEMCHOSEN) return;
    int index = scrollview_get_item_index(hwnd, (HSVITEM)add_data);
    if (index < 0 || index >= MMI_MENU_MAX_ROWS || !g_mainMenu[index].entry) return;
    LOGD("%s choose %d %s", "ScrollViewProc", index, g_mainMenu[index].label);
    g_mainMenu[index].entry();
}

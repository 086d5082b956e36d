// The hub's title strip: the periodic refresh of the menu's texts and the setter other parts
// call from any thread. One mutex for every writer; a warning set at index 1 stays over the
// periodic refresh until it is taken back.
#include "hub/mmi_titlestrip.h"

#include <stdio.h>

#include <mutex>
#include <string>

#include "core/mmi_power.h"
#include "core/mmi_settings.h"
#include "hub/hub_internal.h"
#include "hub/mmi_mainwnd.h"
#include "mmi_bars.h"
#include "mmi_theme.h"

namespace {

using hub::tr;

std::mutex s_titleMutex;
std::string s_titleWarning;  // under s_titleMutex

}  // namespace

namespace hub {

// The menu's title strip texts: charger, title (or the warning in force) and level. Drawn
// only while the menu is in front; otherwise only its record is kept current, which a
// battery warning shows over other windows.
void refresh_title(HWND hWnd, bool draw) {
    FTX_BATTERY_INFO b;
    bool known = mmi_battery_snapshot(&b) == 0 && b.batteryLevel != -1;
    char level[32] = "";
    if (known) snprintf(level, sizeof level, "%d%%", b.batteryLevel);
    int colour =
        known && b.batteryLevel <= g_batteryWarningVolt ? MMI_COLOUR_FAIL : MMI_COLOUR_TEXT;
    std::string charging = tr(known && mmi_battery_is_charging(&b) ? "BatteryCharging_Charging"
                                                                   : "BatteryCharging_Null");
    std::lock_guard<std::mutex> lk(s_titleMutex);
    std::string title = s_titleWarning.empty() ? tr("title_factory") : s_titleWarning;
    if (!s_titleWarning.empty()) colour = 12;
    tp_batteryshow_set_text_items(hWnd, charging.c_str(), title.c_str(), level);
    if (!draw) return;
    tp_batteryshow_set_text_col(colour);
    tp_batteryshow_update(hWnd);
}

}  // namespace hub

int TitleInfoShow(const char *text, int index, int abnormalState) {
    if (index == 1 && g_deviceIsAgingTest == 1) return 0;
    LOGD("%s begin,buf=%s,index=%d,abnomal_state=%d ", "TitleInfoShow", text ? text : "(null)",
         index, abnormalState);
    HWND hub = g_hMainWnd;
    std::lock_guard<std::mutex> lk(s_titleMutex);
    if (index == 1) {
        if (abnormalState == 1 && text) s_titleWarning = text;
        if (abnormalState == 0) s_titleWarning.clear();
    }
    if (abnormalState == 0) tp_batteryshow_set_text_col(MMI_COLOUR_TEXT);
    if (abnormalState == 1) tp_batteryshow_set_text_col(MMI_COLOUR_FAIL);
    std::string restore;
    if (!text && index == 1 && abnormalState == 0) {
        restore = tr("title_factory");
        text = restore.c_str();
    }
    if (text) tp_batteryshow_set_text_items_byIndex(hub, text, index);
    // A warning in force is shown over whatever window is in front. Otherwise the window in
    // front keeps its own strip (a list's or a test's title), given back to it when a
    // warning leaves; the menu's texts wait in its record until it is in front again.
    HWND front = GetActiveWindow();
    if (s_titleWarning.empty() && front != hub && front != HWND_INVALID && front != HWND_NULL &&
        tp_batteryshow_has_items(front))
        return tp_batteryshow_update(front);
    return tp_batteryshow_update(hub);
}

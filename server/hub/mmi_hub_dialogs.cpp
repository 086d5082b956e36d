// The hub's modal dialogs: the table of kinds with their texts, buttons and actions, and
// opening and answering them on the GUI thread.
#include "hub/mmi_hub_dialogs.h"

#include <string.h>

#include <string>

#include "core/ftx_lib_binding.h"
#include "core/mmi_power.h"
#include "core/mmi_settings.h"
#include "hub/hub_internal.h"
#include "hub/mmi_mainwnd.h"
#include "mmi_dialog.h"
#include "AgingTest/mmi_aging.h"
#include "session/mmi_autotest.h"

std::atomic<int> g_dialogcouldshow{1};
std::atomic<int> g_iCreateDialog{0};

namespace {

using hub::tr;

// Dialog state (GUI thread).
HDIALOG s_dialog = HDIALOG_INVALID;
int s_dialogKind = 0;
int s_savedIdle = 1;
bool s_tpAlertShown = false;

// Touch-panel state of the last "TPHARDWARE" answer (-1 before one).
std::atomic<int> s_tpState{-1};

struct DialogKind {
    int kind;
    const char *title;
    const char *text;
    const char *buttons[2];
    int count;
    int (*action)(int button);
};

int power_off_action(int button) {
    return button == 0 ? mmi_PowerOffEntry() : 0;
}
int fail_and_quit_action(int button) {
    if (button == 0) {
        HWND active = GetActiveWindow();
        if (active && active != HWND_INVALID) SendNotifyMessage(active, MSG_FAILANDQUIT, 0, 0);
    }
    return 0;
}
int aging_action(int button) {
    return button == 0 ? mmi_AgingTest_Start_Entry() : 0;
}
int autotest_action(int button) {
    return button == 1 ? mmi_AutoTestEntry() : 0;
}
int autotest_ex_action(int button) {
    return button == 1 ? mmi_AutoTestEntry_Ex() : 0;
}
int autotest_ex2_action(int button) {
    return button == 1 ? mmi_AutoTestEntry_Ex2() : 0;
}

const DialogKind kDialogs[] = {
    {1, "title_PowerOff", "info_PowerOffNote", {"info_Yes", "info_No"}, 2, power_off_action},
    {2, "title_BatteryCheck", nullptr, {"info_Yes", nullptr}, 1, nullptr},
    {3, "info_Quit", "info_FailAndQuit", {"info_Yes", "info_No"}, 2, fail_and_quit_action},
    {5, "TP ERROR", nullptr, {"info_Yes", nullptr}, 1, nullptr},
    {6, "title_AgingTest", "menu_StartTest", {"info_Yes", "info_No"}, 2, aging_action},
    {7, "menu_AutoTest", "info_continuetest", {"info_No", nullptr}, 1, autotest_action},
    {8, "menu_AutoTest_EX", "info_continuetest", {"info_No", nullptr}, 1, autotest_ex_action},
    {9, "menu_AutoTest_EX2", "info_continuetest", {"info_No", nullptr}, 1, autotest_ex2_action},
};

const DialogKind *dialog_kind(int kind) {
    for (const DialogKind &k : kDialogs)
        if (k.kind == kind) return &k;
    return nullptr;
}

int tp_state(void) {
    return s_tpState;
}

std::string tp_text() {
    switch (tp_state()) {
        case 3:
            return tr("title_TPFState");
        case 1:
            return tr("title_TPUState");
        case 0:
            return tr("title_TPOState");
        default:
            return tr("title_factory");
    }
}

bool dialog_open() {
    return s_dialog != HDIALOG_INVALID && s_dialog != nullptr;
}

}  // namespace

namespace hub {

void create_dialog(HWND hWnd, WPARAM wParam, int kind) {
    s_savedIdle = g_bOsIsCanIdle;
    SetIdleWakeupStatus(0);
    Set_OsCanIdleAllowed(0);
    LOGD("1203 mmiExmMainWnd MSG_CREATEDIALG");
    const DialogKind *k = dialog_kind(kind);
    if (kind == 5 && s_tpAlertShown) k = nullptr;
    if (!k || dialog_open()) {
        // Nothing new: the dialog that is up (if any) comes to the front again.
        if (dialog_open() && s_dialog->window != HWND_INVALID)
            ShowWindow(s_dialog->window, SW_SHOWNORMAL);
        Set_OsCanIdleAllowed(s_savedIdle);
        return;
    }
    if (kind == 2) LOGD("create power alert dialog");
    if (kind == 5) LOGD("create tpstatusuptate alert dialog");
    std::string title = tr(k->title);
    std::string text;
    if (kind == 2)
        text = wParam ? reinterpret_cast<const char *>(wParam) : "";
    else if (kind == 5)
        text = tp_text();
    else
        text = tr(k->text);
    std::string labels[2];
    const char *labelPtrs[2] = {nullptr, nullptr};
    for (int i = 0; i < k->count; i++) {
        labels[i] = tr(k->buttons[i]);
        labelPtrs[i] = labels[i].c_str();
    }
    mmi_hub_layout l;
    int w, h;
    screen_size(&w, &h);
    mmi_hub_layout_for(w, h, &l);
    s_dialogKind = kind;
    s_dialog =
        CreateDialog(title.c_str(), text.c_str(), l.dialog.left, l.dialog.top, RECTW(l.dialog),
                     RECTH(l.dialog), hWnd, hWnd, 0, labelPtrs, k->count, 0);
    if (!dialog_open()) return;
    DoModal(s_dialog);
    g_dialogcouldshow = 0;
    g_iCreateDialog = 1;
}

void dialog_button(HWND hWnd, int button) {
    if (dialog_open()) {
        DestroyDialog(s_dialog);
        s_dialog = HDIALOG_INVALID;
        release_dialog_sem();
        Set_OsCanIdleAllowed(s_savedIdle);
        g_dialogcouldshow = 1;
        g_iCreateDialog = 0;
    }
    if (s_dialogKind == 5) {
        if (tp_state() != 3) {
            s_tpAlertShown = true;
            if (hw::ftx_api_GetModuleStatus) hw::ftx_api_GetModuleStatus("TPHARDWARE");
        } else {
            if (hw::ftx_api_RegisterModuleCallback)
                hw::ftx_api_RegisterModuleCallback("TPHARDWARE", Get_tpstatus_callback);
            SendNotifyMessage(hWnd, MSG_CREATEDIALG, 0, 5);
            if (hw::ftx_api_GetModuleStatus) hw::ftx_api_GetModuleStatus("TPHARDWARE");
        }
        return;
    }
    const DialogKind *k = dialog_kind(s_dialogKind);
    if (k && k->action) k->action(button);
}

}  // namespace hub

// The touch-panel status answer: "0x0N" in the text gives the state.
void Get_tpstatus_callback(module_data *data) {
    if (!data) return;
    const char *p = strstr((const char *)data->data, "0x0");
    if (p) s_tpState = p[3] - '0';
}

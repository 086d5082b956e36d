#include "AgingTest/mmi_aging.h"

#include <android/log.h>

#include "AgingTest/mmi_aging_config.h"
#include "AgingTest/mmi_aging_run.h"
#include "AgingTest/mmi_aging_window.h"
#include "core/ftx_config.h"
#include "core/ftx_lib_binding.h"
#include "core/mmi_power.h"
#include "session/mmi_runstate.h"
#include "tp_os.h"

#define AGING_TAG "AgingTest"
#define LOGD(...) __android_log_print(ANDROID_LOG_DEBUG, AGING_TAG, __VA_ARGS__)
#define LOGE(...) __android_log_print(ANDROID_LOG_ERROR, AGING_TAG, __VA_ARGS__)

namespace {

// The texts the aging screens use, loaded at each start.
char s_textPass[FTX_CFG_TEXT_SIZE] = "Result_pass";
char s_textFail[FTX_CFG_TEXT_SIZE] = "Result_fail";
char s_textBack[FTX_CFG_TEXT_SIZE] = "softkeybar_back";
char s_textYes[FTX_CFG_TEXT_SIZE] = "info_Yes";

void load_texts() {
    Read_LangCfgFromList("Result_pass", s_textPass);
    Read_LangCfgFromList("Result_fail", s_textFail);
    Read_LangCfgFromList("softkeybar_back", s_textBack);
    Read_LangCfgFromList("info_Yes", s_textYes);
}

}  // namespace

int mmi_AgingTest_Start_Entry(void) {
    load_texts();
    mmi_AgingTest_ReadConfig();
    if (Init_lib_AgingTest_Interface() != 0) {
        LOGE("%s::Init_lib_AgingTest_Interface failed: the aging test is not started", __func__);
        return -1;
    }
    if (mmi_aging_run_begin() != 0) {
        LOGE("%s::an aging run is active already", __func__);
        return -1;
    }
    g_deviceIsAgingTest = 1;
    Set_OsCanIdleAllowed(0);
    LOGD("%s begin", __func__);
    mmi_CreateAgingTestWnd();
    if (tp_os_thread_create("AGING_RUN", 0, 0, mmi_AgingTest_Thread, nullptr) == 0) {
        LOGE("%s::the run thread could not be started", __func__);
        mmi_aging_run_abandon();
        mmi_aging_window_finished();
        return -1;
    }
    LOGD("%s end", __func__);
    return 0;
}

void *mmi_AgingTest_Wnd_Thread(void *) {
    mmi_aging_window_reset();
    tp_os_usleep(3000000);  // the main window is up by then
    mmi_AgingTest_Start_Entry();
    return nullptr;
}

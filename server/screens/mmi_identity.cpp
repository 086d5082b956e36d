// Identity and state readers for the PC and the information screen.
#include "screens/mmi_identity.h"

#include <stdio.h>
#include <stdlib.h>
#include <string.h>

#include <atomic>
#include <mutex>

#include <android/log.h>

#include "devfs.h"
#include "core/ftx_lib_binding.h"
#include "core/mmi_autotest_config.h"
#include "session/mmi_autotest.h"
#include "mmi_msg.h"
#include "core/mmi_power.h"
#include "core/mmi_settings.h"
#include "tp_os.h"

#define ID_TAG "AtThread"
#define ID_DEBUG(...) __android_log_print(ANDROID_LOG_DEBUG, ID_TAG, __VA_ARGS__)
#define ID_ERROR(...) __android_log_print(ANDROID_LOG_ERROR, ID_TAG, __VA_ARGS__)

namespace {

// The IMEI waits 100 steps of 100 ms; the PCBA memory and storage checks answer sooner.
const int kWaitSteps = 100;
const unsigned long kWaitStepUs = 100000;

std::mutex s_lock;
char s_imei[MMI_IDENTITY_TEXT_SIZE];
char s_imei2[MMI_IDENTITY_TEXT_SIZE];
char s_psn[MMI_IDENTITY_TEXT_SIZE];
std::atomic<bool> s_requested{false};
std::atomic<HWND> s_notify{HWND_INVALID};

char *slot_of(int datatype) {
    switch (datatype) {
        case FTX_DATATYPE_TESTINFO_IMEI:
            return s_imei;
        case FTX_DATATYPE_TESTINFO_IMEI2:
            return s_imei2;
        case FTX_DATATYPE_TESTINFO_PSN:
            return s_psn;
        default:
            return nullptr;
    }
}

// Runs on the factory library's thread: store and tell, nothing more.
void testinfo_cb(module_data *data) {
    if (!data) return;
    if (data->datatype == FTX_DATATYPE_TESTINFO_END) {
        HWND w = s_notify.load();
        if (w != HWND_INVALID && w != nullptr) PostMessage(w, MSG_CALLBACK, 0, 0);
        return;
    }
    std::lock_guard<std::mutex> lk(s_lock);
    char *slot = slot_of(data->datatype);
    if (slot && data->data) {
        size_t n = data->totallen < MMI_IDENTITY_TEXT_SIZE - 1 ? data->totallen
                                                               : MMI_IDENTITY_TEXT_SIZE - 1;
        memcpy(slot, data->data, n);
        slot[n] = '\0';
    }
}

// "*" and the value, cut to the reply.
int value_reply(char *reply, unsigned int size, const char *value) {
    if (!reply || size == 0) return 0;
    memset(reply, 0, size);
    snprintf(reply, size, "*%s", value);
    return 1;
}

int int_reply(char *reply, unsigned int size, long long value) {
    char buf[32];
    snprintf(buf, sizeof(buf), "%lld", value);
    return value_reply(reply, size, buf);
}

// One PCBA check whose callback carries "<value>,<result>".
std::atomic<long long> s_pcbaValue{-1};
std::atomic<int> s_pcbaType{0};

void pcba_cb(module_data *data) {
    if (!data || data->datatype != s_pcbaType.load() || !data->data) return;
    s_pcbaValue = atoll(data->data);
}

long long run_pcba_check(int type, ftx_hw_op<int (*)(ftx_api_module_cb)> &start,
                         ftx_hw_op<int (*)(void)> &stop) {
    Init_lib_Interface_all();
    if (!start) return -1;
    s_pcbaType = type;
    s_pcbaValue = -1;
    if (start(pcba_cb) != 0) return -1;
    for (int i = 0; i < kWaitSteps && s_pcbaValue.load() < 0; i++)
        tp_os_usleep(kWaitStepUs);
    if (stop) stop();
    return s_pcbaValue.load();
}

typedef int (*text_op)(char *buf, int size);

int text_reader(const char *who, int kind, char *reply, unsigned int size) {
    ID_DEBUG("%s begin,maxoutlen=%u", who, size);
    char buf[MMI_IDENTITY_TEXT_SIZE] = {0};
    if (mmi_identity_text(kind, buf, sizeof(buf)) != 0 || buf[0] == '\0') {
        ID_ERROR("%s::read fail", who);
        return 0;
    }
    return value_reply(reply, size, buf);
}

void *reboot_later(void *arg) {
    // The PC gets its answer before the device goes down.
    tp_os_usleep(300000);
    dev_sync();
    dev_reboot((int)(intptr_t)arg);
    return nullptr;
}

int reboot_async(int cmd) {
    pthread_t t;
    if (pthread_create(&t, nullptr, reboot_later, (void *)(intptr_t)cmd) != 0) return 0;
    pthread_detach(t);
    return 1;
}

}  // namespace

void mmi_testinfo_request(void *notifyWindow) {
    if (notifyWindow) s_notify = static_cast<HWND>(notifyWindow);
    if (s_requested.exchange(true)) return;
    if (!hw::ftx_api_Get_TestInfo || hw::ftx_api_Get_TestInfo(testinfo_cb) != 0) {
        ID_ERROR("%s ftx_api_Get_TestInfo fail", __func__);
        s_requested = false;
    }
}

int mmi_testinfo_text(int datatype, char *out, size_t size) {
    std::lock_guard<std::mutex> lk(s_lock);
    const char *slot = slot_of(datatype);
    if (!slot || slot[0] == '\0') return -1;
    tp_os_strlcpy(out, slot, size);
    return 0;
}

void mmi_identity_reset(void) {
    std::lock_guard<std::mutex> lk(s_lock);
    s_imei[0] = s_imei2[0] = s_psn[0] = '\0';
    s_requested = false;
    s_notify = HWND_INVALID;
}

int mmi_identity_text(int kind, char *out, size_t size) {
    memset(out, 0, size);
    int n = (int)size;
    switch (kind) {
        case MMI_ID_SOFT_INTERNAL:
            if (!hw::ftx_api_GetSoftVersion) return -1;
            return hw::ftx_api_GetSoftVersion(FTX_SOFTVERSION_INTERNAL, out, n);
        case MMI_ID_SOFT_EXTERNAL:
            if (!hw::ftx_api_GetSoftVersion) return -1;
            return hw::ftx_api_GetSoftVersion(FTX_SOFTVERSION_EXTERNAL, out, n);
        case MMI_ID_HARDWARE:
            return hw::ftx_api_GetHardVersion ? hw::ftx_api_GetHardVersion(out, n) : -1;
        case MMI_ID_PSN:
            return hw::ftx_api_GetPSN ? hw::ftx_api_GetPSN(out, n) : -1;
        case MMI_ID_BOARD:
            return hw::ftx_api_GetBoardNum ? hw::ftx_api_GetBoardNum(out, n) : -1;
        case MMI_ID_FLASH:
            return hw::ftx_api_GetFlashType ? hw::ftx_api_GetFlashType(out, n) : -1;
        default:
            return -1;
    }
}

int mmi_AutoTest_IMEI_Read(char *reply, unsigned int replySize) {
    ID_DEBUG("%s begin", __func__);
    mmi_testinfo_request(nullptr);
    char imei[MMI_IDENTITY_TEXT_SIZE];
    for (int i = 0; i < kWaitSteps; i++) {
        if (mmi_testinfo_text(FTX_DATATYPE_TESTINFO_IMEI, imei, sizeof(imei)) == 0) {
            memset(reply, 0, replySize);
            tp_os_strlcpy(reply, imei, replySize);
            return 1;
        }
        tp_os_usleep(kWaitStepUs);
    }
    // Nothing came: the next read asks the library again.
    s_requested = false;
    ID_ERROR("%s::no IMEI", __func__);
    return 0;
}

int mmi_AutoTest_barcode_Read(char *reply, unsigned int replySize) {
    return text_reader(__func__, MMI_ID_BOARD, reply, replySize);
}
int mmi_AutoTest_internalsoftware_Read(char *reply, unsigned int replySize) {
    return text_reader(__func__, MMI_ID_SOFT_INTERNAL, reply, replySize);
}
int mmi_AutoTest_externalsoftware_Read(char *reply, unsigned int replySize) {
    return text_reader(__func__, MMI_ID_SOFT_EXTERNAL, reply, replySize);
}
int mmi_AutoTest_hardware_Read(char *reply, unsigned int replySize) {
    return text_reader(__func__, MMI_ID_HARDWARE, reply, replySize);
}
int mmi_AutoTest_flashtype_Read(char *reply, unsigned int replySize) {
    return text_reader(__func__, MMI_ID_FLASH, reply, replySize);
}

int mmi_AutoTest_RAM_Status_Read(char *reply, unsigned int replySize) {
    long long mb =
        run_pcba_check(FTX_DATATYPE_PCBA_MEMORY, hw::ftx_api_memory_start, hw::ftx_api_memory_stop);
    if (mb < 0) {
        ID_ERROR("%s::no memory size", __func__);
        return 0;
    }
    return int_reply(reply, replySize, mb);
}

int mmi_AutoTest_ROM_Status_Read(char *reply, unsigned int replySize) {
    long long gb = run_pcba_check(FTX_DATATYPE_PCBA_STORAGE, hw::ftx_api_storage_start,
                                  hw::ftx_api_storage_stop);
    if (gb < 0) {
        ID_ERROR("%s::no storage size", __func__);
        return 0;
    }
    return int_reply(reply, replySize, gb);
}

int mmi_AutoTest_battery_power_Read(char *reply, unsigned int replySize) {
    FTX_BATTERY_INFO info;
    if (mmi_battery_snapshot(&info) != 0 || info.batteryLevel < 0) {
        ID_DEBUG("%s::not get BatteryLevel", __func__);
        return 0;
    }
    return int_reply(reply, replySize, info.batteryLevel);
}

int mmi_AutoTest_battery_charging_Read(char *reply, unsigned int replySize) {
    FTX_BATTERY_INFO info;
    if (mmi_battery_snapshot(&info) != 0) {
        ID_DEBUG("%s::not get BatteryStatus", __func__);
        return 0;
    }
    return int_reply(reply, replySize, mmi_battery_is_charging(&info));
}

int mmi_AutoTest_battery_temperature_Read(char *reply, unsigned int replySize) {
    FTX_BATTERY_INFO info;
    if (mmi_battery_snapshot(&info) != 0) {
        ID_DEBUG("%s::not get BatteryTemperature", __func__);
        return 0;
    }
    return int_reply(reply, replySize, info.batteryTemperature);
}

int mmi_AutoTest_battery_health_Read(char *reply, unsigned int replySize) {
    FTX_BATTERY_INFO info;
    if (mmi_battery_snapshot(&info) != 0) {
        ID_DEBUG("%s::not get BatteryHealth", __func__);
        return 0;
    }
    return int_reply(reply, replySize, info.batteryHealth);
}

int mmi_AutoTest_PowerOff(const char *, int, char *, unsigned int) {
    ID_DEBUG("%s begin", __func__);
    return reboot_async(LINUX_REBOOT_CMD_POWER_OFF);
}

int mmi_AutoTest_Reboot(const char *, int, char *, unsigned int) {
    ID_DEBUG("%s begin", __func__);
    return reboot_async(LINUX_REBOOT_CMD_RESTART);
}

// The PC switches the operator-judged subset of the next runs on and off.
int mmi_AutoTest_MMI_Enable(void) {
    g_mmiPreFlag = 1;
    return mmi_AutoTest_Modify_ConfigFile("MMI,mmi_flag,1");
}

int mmi_AutoTest_MMI_Disable(void) {
    g_mmiPreFlag = 0;
    return mmi_AutoTest_Modify_ConfigFile("MMI,mmi_flag,0");
}

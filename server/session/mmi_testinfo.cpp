// The pass/fail record: packing, the single-item write with its read-back and roll-up,
// and the PC read and write back ends.
#include "session/mmi_testinfo.h"

#include <stdio.h>
#include <stdlib.h>
#include <string.h>

#include <mutex>

#include <android/log.h>

#include "core/mmi_loglevel.h"

#include "devfs.h"
#include "core/ftx_lib_binding.h"
#include "session/mmi_runstate.h"
#include "core/mmi_settings.h"

namespace {

const char kTag[] = "CHECKTESTINFO";
const char kWriteName[] = "mmi_write_testinfo_single_byte";
const int kLastByte = (MMI_TESTINFO_ITEMS - 1) / 4;
const int kLastSlot = (MMI_TESTINFO_ITEMS - 1) % 4;
const int kCacByte = MMI_ITEM_CAC_PREVIEW / 4;

// Byte index and slot of the last single-item encode or decode; the read-back checks
// compare the byte they name, quirks included.
std::atomic<int> s_byteIndex{kLastByte};
std::atomic<int> s_slot{kLastSlot};

// Results of several threads go through one read-modify-write of the flag area at a time.
std::mutex s_writeLock;

int high_bit(int slot) {
    return (3 - slot) * 2 + 1;
}

void decode_all(const unsigned char *flags) {
    for (int i = 0; i < MMI_TESTINFO_ITEMS; i++) {
        int shift = (3 - i % 4) * 2;
        g_testinfo[i].test_result.store((flags[i / 4] >> shift) & 3u, std::memory_order_relaxed);
    }
    s_byteIndex = kLastByte;
    s_slot = kLastSlot;
}

void read_area(unsigned char *buf) {
    if (hw::ftx_api_GetTestInfoFlag) hw::ftx_api_GetTestInfoFlag(buf);
}

void write_byte(int index, unsigned char value) {
    if (hw::ftx_api_WriteFuncTestInfoFlags) hw::ftx_api_WriteFuncTestInfoFlags(index, value);
}

// Compares the current byte of the working buffer with the library's; on a difference
// writes it once more when a result was written. No second check. The caller is told
// "done" either way, so a byte that did not land is an error in the log.
void check_written(const unsigned char *work, bool writes) {
    unsigned char back[MMI_TESTINFO_FLAGS_SIZE];
    memset(back, 0, sizeof(back));
    read_area(back);
    int b = s_byteIndex;
    if (work[b] == back[b]) return;
    __android_log_print(ANDROID_LOG_ERROR, kTag,
                        "%s::check testinfo indexbyte=%d,writeval=%d,readval=%d", kWriteName, b,
                        work[b], back[b]);
    if (writes) write_byte(b, work[b]);
}

}  // namespace

int GetSign(const unsigned char *flags, int item) {
    if (flags == nullptr || item < 0 || item >= MMI_TESTINFO_FLAGS_SIZE * 4) return 0;
    s_byteIndex = item / 4;
    s_slot = item % 4;
    return (flags[item / 4] >> (high_bit(item % 4) - 1)) & 3;
}

int SetSignInOneByte(unsigned char *byte, int slot, int value) {
    int high = high_bit(slot);
    MMI_LOGD(kTag, "%s::m_highPower=%d,m_lowPower=%d", "SetPowerValue", high, high - 1);
    if (value < 0 || value > 2 || slot < 0 || slot > 3 || byte == nullptr) return 0;
    *byte =
        static_cast<unsigned char>((*byte & ~(3u << (high - 1))) | (unsigned)value << (high - 1));
    return 1;
}

void GetTestItemsResult(const unsigned char *flags) {
    if (flags == nullptr) return;
    std::lock_guard<std::mutex> lock(s_writeLock);
    decode_all(flags);
}

void mmi_testinfo_current(int *byteIndex, int *slot) {
    if (byteIndex != nullptr) *byteIndex = s_byteIndex;
    if (slot != nullptr) *slot = s_slot;
}

std::atomic<void (*)(void)> g_testinfoChanged{nullptr};

int mmi_write_testinfo_single_byte(int item, int result) {
    // Declared before the lock, so it runs after the lock is released.
    struct Notify {
        ~Notify() {
            if (void (*changed)(void) = g_testinfoChanged.load()) changed();
        }
    } notify;
    std::lock_guard<std::mutex> lock(s_writeLock);
    MMI_LOGD(kTag, "%s,itemindex=%d,testresult=%d", kWriteName, item, result);
    if (item < 0 || item >= MMI_TESTINFO_ITEMS) {
        __android_log_print(ANDROID_LOG_ERROR, kTag, "%s::item %d out of range", kWriteName, item);
        return 0;
    }
    if (result == MMI_RESULT_FAIL && g_bRestoreAutotest != 0) {
        // A failed run has nothing left to resume.
        dev_system("rm /data/pv_autotest_restore_flag");
        dev_system("rm /data/pv_autotest_latest_pass");
    }
    unsigned char work[MMI_TESTINFO_FLAGS_SIZE];
    memset(work, 0, sizeof(work));
    read_area(work);

    const bool writes = result == MMI_RESULT_PASS || result == MMI_RESULT_FAIL;
    if (writes) {
        s_byteIndex = item / 4;
        s_slot = item % 4;
        SetSignInOneByte(&work[item / 4], item % 4, result);
    }
    MMI_LOGD(kTag, "%s::ftx_api_WriteFuncTestInfoFlags begin", kWriteName);
    if (writes) write_byte(item / 4, work[item / 4]);
    MMI_LOGD(kTag, "%s::ftx_api_WriteFuncTestInfoFlags end", kWriteName);

    check_written(work, writes);
    decode_all(work);
    if (item == MMI_ITEM_CAC_PREVIEW) return 0;

    // A failed station item fails the CAC preview too and ends the automatic run.
    if (result == MMI_RESULT_FAIL && (item > 279 || (item >= 124 && item <= 159))) {
        s_byteIndex = kCacByte;
        s_slot = MMI_ITEM_CAC_PREVIEW % 4;
        SetSignInOneByte(&work[kCacByte], MMI_ITEM_CAC_PREVIEW % 4, MMI_RESULT_FAIL);
        MMI_LOGD(kTag, "%s::g_pretestMenuEnabled=%d", kWriteName, g_pretestMenuEnabled.load());
        if (g_pretestMenuEnabled == 1)
            SetSignInOneByte(&work[kCacByte], MMI_ITEM_CAC_PREVIEW_TEMP % 4, MMI_RESULT_FAIL);
        MMI_LOGD(kTag, "%s::write cac_preview testresult=%d begin", kWriteName, MMI_RESULT_FAIL);
        write_byte(kCacByte, work[kCacByte]);
        MMI_LOGD(kTag, "%s::write cac_preview end", kWriteName);
        g_bAutoTestRunning = 0;
    }
    // Without the roll-up this compares byte 99, left by the decode above; kept so.
    check_written(work, writes);
    decode_all(work);
    return 0;
}

int mmi_AutoTest_testinfo_Read(const char *command, int length, char *reply,
                               unsigned int replySize) {
    static const char kName[] = "mmi_AutoTest_testinfo_Read";
    if (command == nullptr || length < 1 || strstr(command, "read") == nullptr) return 0;
    const char *comma = strchr(command, ',');
    if (comma == nullptr) {
        __android_log_print(ANDROID_LOG_ERROR, "TESTINFO", "%s::not found testinfo index", kName);
        return 0;
    }
    char index[256];
    memset(index, 0, sizeof(index));
    size_t n = static_cast<size_t>(comma - command);
    if (n > sizeof(index) - 1) n = sizeof(index) - 1;
    memcpy(index, command, n);
    MMI_LOGD("TESTINFO", "%s::buf_In=%s;index=%s", kName, command, index);
    if (!hw::ftx_api_GetTestInfoFlag) return 0;
    int item = atoi(index);
    if (item < 0 || item >= MMI_TESTINFO_ITEMS) {
        __android_log_print(ANDROID_LOG_ERROR, "TESTINFO", "%s::index %d out of range", kName,
                            item);
        return 0;
    }
    unsigned char flags[MMI_TESTINFO_FLAGS_SIZE];
    memset(flags, 0, sizeof(flags));
    hw::ftx_api_GetTestInfoFlag(flags);
    int value;
    {
        // GetSign moves the current byte, which a write in progress checks against.
        std::lock_guard<std::mutex> lock(s_writeLock);
        value = GetSign(flags, item);
    }
    if (reply != nullptr && replySize > 0) snprintf(reply, replySize, "%d", value);
    return 1;
}

int mmi_AutoTest_testinfo_Write(const char *command, int length) {
    if (command == nullptr || length < 1) return 0;
    char buf[256];
    memset(buf, 0, sizeof(buf));
    size_t n = strnlen(command, length < 255 ? static_cast<size_t>(length) : 255);
    memcpy(buf, command, n);
    char *end = strstr(buf, ",write");
    if (end == nullptr) return 0;
    *end = '\0';
    char *comma = strchr(buf, ',');
    if (comma == nullptr) return 0;
    *comma = '\0';
    if (comma[1] == '\0') return 0;
    // A result other than 1 or 2 is accepted and writes nothing.
    mmi_write_testinfo_single_byte(atoi(buf), atoi(comma + 1));
    return 1;
}

int CheckParaResult(const char *spec, int value, int isMax) {
    static const char kName[] = "CheckParaResult";
    const char *colon = spec != nullptr ? strchr(spec, ':') : nullptr;
    if (colon == nullptr) {
        MMI_LOGD("", "%s input para error: %s", kName, spec != nullptr ? spec : "");
        return 0;
    }
    int limit = atoi(colon + 1);
    int max = isMax & 1;
    MMI_LOGD("", "%s begin para list: strpara=%d,ival=%d,bmax=%d", kName, limit, value, max);
    // A value equal to the limit fails either way.
    int ok = max ? value < limit : value > limit;
    if (!ok) MMI_LOGD("", "%s end", kName);
    return ok;
}

int mmi_WriteFuncTestInfoFlags(int, unsigned char) {
    return 0;
}
int mmi_ReadFuncTestInfoFlags(int, unsigned char *) {
    return 0;
}

void mmi_testinfo_hand_binding_fallbacks(void) {
    static const ftx_binding_fallbacks kFallbacks = {mmi_ReadFuncTestInfoFlags,
                                                     mmi_WriteFuncTestInfoFlags};
    ftx_binding_set_fallbacks(&kFallbacks);
}

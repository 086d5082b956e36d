// The test-window helpers, the device-test list's choices, the information screen's record
// lines and the PC readers, with the factory library replaced by fakes.
#include <stdlib.h>
#include <string.h>

#include <atomic>
#include <mutex>
#include <vector>
#include <chrono>
#include <string>
#include <thread>

#include <gtest/gtest.h>

#include "adbd_connection/handlers/handlers.h"
#include "ftx_host.h"
#include "core/ftx_lib_binding.h"
#include "screens/mmi_devicetest.h"
#include "screens/mmi_identity.h"
#include "screens/mmi_infoscreen.h"
#include "session/mmi_testinfo.h"
#include "testwnd/misc/mmi_testwnd_vibrator.h"
#include "testwnd/mmi_testwnd.h"

namespace {

// Waits of the readers and the fool-proof thread run 1000 times faster here.
__attribute__((constructor)) void fast_clock() {
    setenv("FTX_TIME_SCALE", "0.001", 1);
}

// The log as other threads write it.
class LogCapture {
  public:
    LogCapture() { ftx_log_set_capture(&LogCapture::add, this); }
    ~LogCapture() { ftx_log_set_capture(nullptr, nullptr); }
    bool has(const std::string &text) {
        std::lock_guard<std::mutex> lk(lock_);
        for (const auto &l : lines_)
            if (l.find(text) != std::string::npos) return true;
        return false;
    }

  private:
    static void add(int, const char *tag, const char *msg, void *ctx) {
        auto *self = static_cast<LogCapture *>(ctx);
        std::lock_guard<std::mutex> lk(self->lock_);
        self->lines_.push_back(std::string(tag) + ": " + msg);
    }
    std::mutex lock_;
    std::vector<std::string> lines_;
};

void settle() {
    std::this_thread::sleep_for(std::chrono::milliseconds(50));
}

TEST(FoolProof, ThreadEndedWhileItSleepsNeverReachesTheWindow) {
    LogCapture log;
    mmi_testwnd_state st;
    st.hwnd = HWND_INVALID;
    // 100 s, scaled to 100 ms: long enough to be ended in its sleep.
    ASSERT_EQ(0, mmi_testwnd_start_foolproof(&st, 100, "FTX_TEST"));
    settle();
    mmi_testwnd_stop_foolproof(&st);
    std::this_thread::sleep_for(std::chrono::milliseconds(200));
    EXPECT_TRUE(log.has("WaitForFoolProof begin"));
    EXPECT_TRUE(log.has("WaitForFoolProof stopped"));
    EXPECT_FALSE(log.has("after sleep ,WaitForFoolProof"));
}

TEST(FoolProof, StopRightAfterTheStartEndsTheThreadAtOnce) {
    LogCapture log;
    mmi_testwnd_state st;
    // 10000 s, scaled to 10 s: only the stop can end it within the second waited here.
    ASSERT_EQ(0, mmi_testwnd_start_foolproof(&st, 10000, "FTX_TEST"));
    mmi_testwnd_stop_foolproof(&st);
    bool stopped = false;
    for (int i = 0; i < 20 && !stopped; i++) {
        settle();
        stopped = log.has("WaitForFoolProof stopped");
    }
    EXPECT_TRUE(stopped);
}

TEST(FoolProof, ThreadWithoutAWindowWakesAndEnds) {
    LogCapture log;
    mmi_testwnd_state st;
    ASSERT_EQ(0, mmi_testwnd_start_foolproof(&st, 0, "FTX_TEST"));
    ASSERT_TRUE([&] {
        for (int i = 0; i < 100 && !log.has("WaitForFoolProof end"); i++)
            settle();
        return log.has("WaitForFoolProof end");
    }());
    EXPECT_TRUE(log.has("after sleep ,WaitForFoolProof hwnd = -1"));
    mmi_testwnd_stop_foolproof(&st);  // nothing left to end
}

// ---- the vibrator's PC entries over a fake library ----

std::atomic<int> g_startMs{0}, g_starts{0}, g_stops{0};
int g_startResult = 0, g_stopResult = 0;
int fake_start(int ms) {
    g_startMs = ms;
    g_starts++;
    return g_startResult;
}
int fake_stop(void) {
    g_stops++;
    return g_stopResult;
}

class VibratorPc : public ::testing::Test {
  protected:
    void SetUp() override {
        hw::ftx_api_Vibrator_Test_Start = fake_start;
        hw::ftx_api_Vibrator_Test_Stop = fake_stop;
        g_starts = g_stops = 0;
        g_startResult = g_stopResult = 0;
    }
    void TearDown() override { ftx_hw_unbind_all(); }
    char reply[64] = {0};
};

TEST_F(VibratorPc, OpenRunsUntilStoppedPcbaForFifteenSeconds) {
    LogCapture log;
    EXPECT_EQ(1, AutoTest_Vibrator_Start("", 0, reply, sizeof(reply)) & 1);
    EXPECT_EQ(-1, g_startMs.load());
    EXPECT_TRUE(
        log.has("FTX_VIBRATOR: mmi_testwnd_pc_start::ftx_api_Vibrator_Test_Start(-1) begin"));
    EXPECT_EQ(1, PCBAAutotestVibratorStart("", 0, reply, sizeof(reply)) & 1);
    EXPECT_EQ(15000, g_startMs.load());
    EXPECT_EQ(1, AutoTest_Vibrator_Stop("", 0, reply, sizeof(reply)) & 1);
    EXPECT_EQ(1, PCBAAutotestVibratorEnd("", 0, reply, sizeof(reply)) & 1);
    EXPECT_EQ(2, g_stops.load());
}

TEST_F(VibratorPc, LibraryFailuresAreReportedAnAbsentLibraryIsNot) {
    LogCapture log;
    g_startResult = 5;
    EXPECT_EQ(0, AutoTest_Vibrator_Start("", 0, reply, sizeof(reply)) & 1);
    EXPECT_TRUE(log.has("ftx_api_Vibrator_Test_Start fail"));
    g_stopResult = 1;
    EXPECT_EQ(0, AutoTest_Vibrator_Stop("", 0, reply, sizeof(reply)) & 1);
    ftx_hw_unbind_all();
    EXPECT_EQ(1, AutoTest_Vibrator_Start("", 0, reply, sizeof(reply)) & 1);
    EXPECT_EQ(1, AutoTest_Vibrator_Stop("", 0, reply, sizeof(reply)) & 1);
}

// ---- readers ----

int fake_board(char *buf, int size) {
    snprintf(buf, (size_t)size, "%s", "BC123");
    return 0;
}
int fake_soft(int kind, char *buf, int size) {
    snprintf(buf, (size_t)size, "%s", kind == FTX_SOFTVERSION_INTERNAL ? "INT" : "EXT");
    return 0;
}
int failing_text(char *, int) {
    return -1;
}

std::atomic<int> g_testinfoCalls{0};
std::atomic<bool> g_sendImei{true};
int fake_get_testinfo(ftx_api_module_cb cb) {
    g_testinfoCalls++;
    // The answer comes later, from the library's own thread.
    std::thread([cb] {
        char imei[] = "860000000000099";
        module_data d{(unsigned)strlen(imei), FTX_DATATYPE_TESTINFO_IMEI, imei};
        if (g_sendImei) cb(&d);
        module_data end{0, FTX_DATATYPE_TESTINFO_END, nullptr};
        cb(&end);
    }).detach();
    return 0;
}

class Readers : public ::testing::Test {
  protected:
    void SetUp() override { mmi_identity_reset(); }
    void TearDown() override {
        settle();
        ftx_hw_unbind_all();
        mmi_identity_reset();
    }
    char reply[64] = {0};
};

TEST_F(Readers, ValueAnswersBeginWithAStarAndFitTheReply) {
    hw::ftx_api_GetBoardNum = fake_board;
    hw::ftx_api_GetSoftVersion = fake_soft;
    EXPECT_EQ(1, AutoTest_barcode_Read("", 0, reply, sizeof(reply)));
    EXPECT_STREQ("*BC123", reply);
    EXPECT_EQ(1, AutoTest_internalsoftware_Read("", 0, reply, sizeof(reply)));
    EXPECT_STREQ("*INT", reply);
    EXPECT_EQ(1, AutoTest_externalsoftware_Read("", 0, reply, 4));
    EXPECT_STREQ("*EX", reply);
    hw::ftx_api_GetBoardNum = failing_text;
    EXPECT_EQ(0, AutoTest_barcode_Read("", 0, reply, sizeof(reply)));
    EXPECT_EQ(0, AutoTest_haredware_Read("", 0, reply, sizeof(reply)));  // not bound
}

TEST_F(Readers, ImeiArrivesThroughTheCallbackAndIsAskedForOnce) {
    g_sendImei = true;
    g_testinfoCalls = 0;
    hw::ftx_api_Get_TestInfo = fake_get_testinfo;
    EXPECT_EQ(1, AutoTest_IMEI_Read("", 0, reply, sizeof(reply)));
    EXPECT_STREQ("860000000000099", reply);
    EXPECT_EQ(1, AutoTest_IMEI_Read("", 0, reply, sizeof(reply)));
    EXPECT_EQ(1, g_testinfoCalls.load());
}

TEST_F(Readers, ImeiThatNeverComesFailsAfterTheWait) {
    g_sendImei = false;
    hw::ftx_api_Get_TestInfo = fake_get_testinfo;
    EXPECT_EQ(0, AutoTest_IMEI_Read("", 0, reply, sizeof(reply)));
    g_sendImei = true;
}

TEST_F(Readers, ConfigWriteNeedsAParameter) {
    EXPECT_EQ(0, AutoTest_Modify_ConfigFile("", 0, reply, sizeof(reply)));
    EXPECT_EQ(0, AutoTest_Modify_ConfigFile(nullptr, 0, reply, sizeof(reply)));
}

// ---- the device-test list and the information screen ----

TEST(DeviceTestList, RowsAndWhatChoosingThemDoes) {
    testitem_node items[2];
    memset(static_cast<void *>(items), 0, sizeof(items));
    snprintf(items[0].name, sizeof(items[0].name), "menu_VibratorTest");
    items[0].item_code = 316;
    items[0].pNodeNext = &items[1];
    items[1].item_code = -1;
    mmi_devicetest_row rows[MMI_DEVICETEST_MAX_ROWS];
    ASSERT_EQ(6, mmi_devicetest_build_rows(items, rows, MMI_DEVICETEST_MAX_ROWS));
    EXPECT_EQ(DEVICETEST_ROW_FULL_RUN, rows[0].kind);
    EXPECT_EQ(DEVICETEST_ROW_PRETEST1, rows[2].kind);
    EXPECT_EQ(DEVICETEST_ROW_PRETEST2, rows[3].kind);
    EXPECT_EQ(316, rows[4].resultIndex);
    EXPECT_EQ(&items[1], rows[5].item);
    EXPECT_EQ(3, mmi_devicetest_build_rows(items, rows, 3));

    unsigned char flags[256] = {0};
    // Nothing passed yet: every row opens its own entry.
    for (int r = 0; r < 6; r++)
        EXPECT_EQ(0, mmi_devicetest_choice(&rows[r], flags, 0)) << r;
    // A run is active: every choice is refused.
    for (int r = 0; r < 6; r++)
        EXPECT_EQ(-1, mmi_devicetest_choice(&rows[r], flags, 1)) << r;
    flags[16] = 0x04;  // item 66 passed: the full run and pretest 1 ask first
    EXPECT_EQ(7, mmi_devicetest_choice(&rows[0], flags, 0));
    EXPECT_EQ(8, mmi_devicetest_choice(&rows[2], flags, 0));
    EXPECT_EQ(0, mmi_devicetest_choice(&rows[3], flags, 0));
    flags[16] = 0x40;  // item 64 passed: pretest 2 asks too
    EXPECT_EQ(7, mmi_devicetest_choice(&rows[0], flags, 0));
    EXPECT_EQ(9, mmi_devicetest_choice(&rows[3], flags, 0));
    EXPECT_EQ(0, mmi_devicetest_choice(&rows[4], flags, 0));
    flags[16] = 0x80;  // item 64 failed asks nothing
    EXPECT_EQ(0, mmi_devicetest_choice(&rows[0], flags, 0));
}

TEST(InfoScreen, RecordListsPassedAndFailedItemsOnly) {
    unsigned char flags[256] = {0};
    flags[79] = 0x40;  // item 316 pass
    flags[70] = 0x80;  // item 280 fail
    flags[1] = 0x30;   // item 5 = 3, never written by this program: left out
    flags[16] = 0x40;  // item 64 pass
    mmi_info_line lines[8];
    ASSERT_EQ(3, mmi_info_record_lines(flags, lines, 8));
    EXPECT_STREQ("64 S_CAC_PREVIEW", lines[0].label);
    EXPECT_EQ(10, lines[0].colour);
    EXPECT_EQ(0, strncmp(lines[1].label, "280 ", 4));
    EXPECT_EQ(12, lines[1].colour);
    EXPECT_EQ(0, strncmp(lines[2].label, "316 ", 4));
    EXPECT_EQ(1, mmi_info_record_lines(flags, lines, 1));
    const unsigned char none[256] = {0};
    GetTestItemsResult(none);  // nothing kept for the next test
}

}  // namespace

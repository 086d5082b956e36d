// The result record against an in-memory flag area: packing, read-back, the CAC preview
// roll-up, restore files, the PC read and write commands and the limit check.
#include <iconv.h>
#include <string.h>

#include <mutex>
#include <string>
#include <thread>
#include <vector>

#include <gtest/gtest.h>

#include "core/ftx_lib_binding.h"
#include "session/mmi_runstate.h"
#include "core/mmi_settings.h"
#include "session/mmi_testinfo.h"
#include "support/temp_root.h"
#include "unit/config/log_capture.h"

namespace {

// The library's flag area as the fakes below see it.
std::mutex g_areaLock;
unsigned char g_area[MMI_TESTINFO_FLAGS_SIZE];
std::vector<std::pair<int, int>> g_writes;  // (byte index, value) in call order
bool g_storeWrites = true;

int fake_get(unsigned char *flags) {
    std::lock_guard<std::mutex> lock(g_areaLock);
    memcpy(flags, g_area, sizeof(g_area));
    return 0;
}

int fake_write(int index, unsigned char value) {
    std::lock_guard<std::mutex> lock(g_areaLock);
    g_writes.emplace_back(index, value);
    if (g_storeWrites) g_area[index] = value;
    return 0;
}

class TestInfo : public ::testing::Test {
  protected:
    void SetUp() override {
        memset(g_area, 0, sizeof(g_area));
        g_writes.clear();
        g_storeWrites = true;
        hw::ftx_api_GetTestInfoFlag = fake_get;
        hw::ftx_api_WriteFuncTestInfoFlags = fake_write;
        g_bRestoreAutotest = 0;
        g_pretestMenuEnabled = 0;
        g_bAutoTestRunning = 0;
    }
    void TearDown() override { ftx_hw_unbind_all(); }

    TempRoot root;  // the log and the restore files

    std::string read_item(int item) {
        char reply[64] = "untouched";
        std::string cmd = std::to_string(item) + ",read";
        if (mmi_AutoTest_testinfo_Read(cmd.c_str(), static_cast<int>(cmd.size()), reply,
                                       sizeof(reply)) != 1)
            return "failed";
        return reply;
    }
    int write_cmd(const std::string &cmd) {
        return mmi_AutoTest_testinfo_Write(cmd.c_str(), static_cast<int>(cmd.size()));
    }
    // Byte indexes written, in order.
    std::vector<int> written_bytes() const {
        std::vector<int> out;
        for (auto &w : g_writes)
            out.push_back(w.first);
        return out;
    }
};

TEST_F(TestInfo, PacksTwoBitsPerItemHighBitFirst) {
    mmi_write_testinfo_single_byte(0, 1);
    EXPECT_EQ(0x40, g_area[0]);
    mmi_write_testinfo_single_byte(0, 2);
    EXPECT_EQ(0x80, g_area[0]);
    memset(g_area, 0, sizeof(g_area));
    mmi_write_testinfo_single_byte(3, 1);
    EXPECT_EQ(0x01, g_area[0]);
    mmi_write_testinfo_single_byte(3, 2);
    EXPECT_EQ(0x02, g_area[0]);
    // Byte 16 holds items 64..67.
    memset(g_area, 0, sizeof(g_area));
    mmi_write_testinfo_single_byte(65, 1);
    EXPECT_EQ(0x10, g_area[16]);
    EXPECT_EQ(1u, g_testinfo[65].test_result.load());
}

TEST_F(TestInfo, PassOverFailClearsTheFailBitAndKeepsNeighbours) {
    g_area[1] = 0xFF;  // items 4..7 all 3
    mmi_write_testinfo_single_byte(5, 2);
    EXPECT_EQ(0xEF, g_area[1]);
    mmi_write_testinfo_single_byte(5, 1);
    EXPECT_EQ(0xDF, g_area[1]);
    EXPECT_EQ(3u, g_testinfo[4].test_result.load());
    EXPECT_EQ(1u, g_testinfo[5].test_result.load());
    EXPECT_EQ(3u, g_testinfo[6].test_result.load());
}

TEST_F(TestInfo, SignHelpers) {
    unsigned char byte = 0xFF;
    EXPECT_EQ(0, SetSignInOneByte(&byte, 1, 3));
    EXPECT_EQ(0xFF, byte);
    EXPECT_EQ(1, SetSignInOneByte(&byte, 2, 0));
    EXPECT_EQ(0xF3, byte);

    unsigned char flags[MMI_TESTINFO_FLAGS_SIZE] = {};
    flags[99] = 0x1B;  // items 396..399: 0, 1, 2, 3
    EXPECT_EQ(2, GetSign(flags, 398));
    int b = -1, s = -1;
    mmi_testinfo_current(&b, &s);
    EXPECT_EQ(99, b);
    EXPECT_EQ(2, s);
    GetSign(flags, 5);
    GetTestItemsResult(flags);
    mmi_testinfo_current(&b, &s);
    EXPECT_EQ(99, b);
    EXPECT_EQ(3, s);
    EXPECT_EQ(3u, g_testinfo[399].test_result.load());
    EXPECT_EQ(1u, g_testinfo[397].test_result.load());
}

TEST_F(TestInfo, OtherResultsWriteNothing) {
    g_area[1] = 0x10;
    mmi_write_testinfo_single_byte(5, 0);
    mmi_write_testinfo_single_byte(5, 3);
    EXPECT_TRUE(g_writes.empty());
    EXPECT_EQ(0x10, g_area[1]);
}

TEST_F(TestInfo, ReadBackRetriesOnceAndGivesUp) {
    {
        LogCapture stored;
        mmi_write_testinfo_single_byte(8, 1);
        for (const std::string &l : stored.lines)
            EXPECT_NE('E', l[0]) << "a stored result is no error: " << l;
    }
    memset(g_area, 0, sizeof(g_area));
    g_writes.clear();
    g_storeWrites = false;  // the library drops every write
    LogCapture log;
    mmi_write_testinfo_single_byte(8, 1);
    // The write, its one retry; the second check compares byte 99 (untouched), no write.
    EXPECT_EQ((std::vector<int>{2, 2}), written_bytes());
    // The caller hears "done" either way: the lost result is an error in the log.
    EXPECT_TRUE(
        log.has("E CHECKTESTINFO: mmi_write_testinfo_single_byte::check testinfo "
                "indexbyte=2,writeval=64,readval=0"));
    EXPECT_EQ(1, write_cmd("9,2,write"));
    EXPECT_EQ("0", read_item(9));
    EXPECT_TRUE(log.has("indexbyte=2,writeval=32,readval=0"));

    g_writes.clear();
    mmi_write_testinfo_single_byte(280, 2);
    // Item byte, its retry, the CAC byte and its retry.
    EXPECT_EQ((std::vector<int>{70, 70, 16, 16}), written_bytes());
}

TEST_F(TestInfo, UnboundReadStartsFromZero) {
    hw::ftx_api_GetTestInfoFlag = nullptr;
    g_area[0] = 0x3F;
    mmi_write_testinfo_single_byte(0, 1);
    // Nothing could be read, so the other items of the byte are written as untested.
    EXPECT_EQ(0x40, g_area[0]);
}

TEST_F(TestInfo, CacPreviewRollUp) {
    struct Case {
        int item, result, pretest;
        unsigned char byte16;
    };
    const Case cases[] = {
        {280, 2, 0, 0x80}, {130, 2, 0, 0x80}, {300, 2, 0, 0x80}, {124, 2, 0, 0x80},
        {159, 2, 0, 0x80}, {399, 2, 0, 0x80}, {200, 2, 0, 0x00}, {160, 2, 0, 0x00},
        {123, 2, 0, 0x00}, {279, 2, 0, 0x00}, {280, 1, 0, 0x00}, {130, 1, 1, 0x00},
        {280, 2, 1, 0x88}, {200, 2, 1, 0x00},
    };
    for (const Case &c : cases) {
        SCOPED_TRACE(testing::Message()
                     << "item " << c.item << " result " << c.result << " pretest " << c.pretest);
        memset(g_area, 0, sizeof(g_area));
        g_writes.clear();
        g_pretestMenuEnabled = c.pretest;
        g_bAutoTestRunning = 1;
        mmi_write_testinfo_single_byte(c.item, c.result);
        EXPECT_EQ(c.byte16, g_area[16]);
        // A roll-up ends the automatic run; anything else leaves it alone.
        EXPECT_EQ(c.byte16 != 0 ? 0 : 1, g_bAutoTestRunning.load());
    }
}

TEST_F(TestInfo, FailOfThePreviewItemItselfWritesOnlyIt) {
    g_pretestMenuEnabled = 1;
    g_area[16] = 0x01;  // item 67 passed
    mmi_write_testinfo_single_byte(64, 2);
    EXPECT_EQ(0x81, g_area[16]);
    EXPECT_EQ((std::vector<int>{16}), written_bytes());
}

TEST_F(TestInfo, RestoreFilesRemovedOnlyByAFailWithRestoreOn) {
    const char *files[] = {"/data/pv_autotest_restore_flag", "/data/pv_autotest_latest_pass"};
    auto make = [&] {
        for (const char *f : files)
            root.write(f, "FTX_LCD");
    };
    make();
    mmi_write_testinfo_single_byte(10, 2);  // restore off
    for (const char *f : files)
        EXPECT_TRUE(root.exists(f)) << f;
    g_bRestoreAutotest = 1;
    mmi_write_testinfo_single_byte(10, 1);  // a pass
    for (const char *f : files)
        EXPECT_TRUE(root.exists(f)) << f;
    mmi_write_testinfo_single_byte(10, 2);
    for (const char *f : files)
        EXPECT_FALSE(root.exists(f)) << f;
    // Already gone: the fail is still recorded.
    mmi_write_testinfo_single_byte(11, 2);
    EXPECT_EQ(0x08 | 0x02, g_area[2]);
}

TEST_F(TestInfo, ReadCommand) {
    g_area[1] = 0x10;
    EXPECT_EQ("1", read_item(5));
    EXPECT_EQ("0", read_item(4));
    g_area[99] = 0x03;
    EXPECT_EQ("3", read_item(399));

    char reply[16] = "";
    LogCapture log;
    EXPECT_EQ(0, mmi_AutoTest_testinfo_Read("5 read", 6, reply, sizeof(reply)));
    EXPECT_TRUE(log.has("E TESTINFO: mmi_AutoTest_testinfo_Read::not found testinfo index"));
    EXPECT_EQ(0, mmi_AutoTest_testinfo_Read("5,rd", 4, reply, sizeof(reply)));
    hw::ftx_api_GetTestInfoFlag = nullptr;
    EXPECT_EQ("failed", read_item(5));
}

TEST_F(TestInfo, WriteCommand) {
    EXPECT_EQ(1, write_cmd("5,2,write"));
    EXPECT_EQ("2", read_item(5));
    EXPECT_EQ(0, write_cmd("5,,write"));
    EXPECT_EQ(0, write_cmd("5,write"));
    EXPECT_EQ(0, write_cmd("5,1"));
    g_writes.clear();
    EXPECT_EQ(1, write_cmd("5,7,write"));
    EXPECT_TRUE(g_writes.empty());
    EXPECT_EQ("2", read_item(5));
    // Only the first 255 characters count: a ",write" beyond them is not seen.
    std::string longCmd = "6,1" + std::string(300, ' ') + ",write";
    EXPECT_EQ(0, write_cmd(longCmd));
    EXPECT_EQ(1, write_cmd("6,1,write"));
    EXPECT_EQ("1", read_item(6));
}

TEST_F(TestInfo, ConcurrentWritesToOneByteLoseNothing) {
    std::vector<std::thread> threads;
    for (int item = 0; item < 4; item++) {
        threads.emplace_back([item] {
            for (int i = 0; i < 200; i++)
                mmi_write_testinfo_single_byte(item, 1 + (i + item) % 2);
        });
    }
    for (auto &t : threads)
        t.join();
    // Each thread's last write (i = 199) decides its item.
    unsigned char expect = 0;
    for (int item = 0; item < 4; item++) {
        int value = 1 + (199 + item) % 2;
        expect |= static_cast<unsigned char>(value << ((3 - item) * 2));
    }
    EXPECT_EQ(expect, g_area[0]);
}

TEST(CheckParaResult, StrictLimits) {
    EXPECT_EQ(0, CheckParaResult("cur:100", 100, 1));
    EXPECT_EQ(0, CheckParaResult("cur:100", 100, 0));
    EXPECT_EQ(1, CheckParaResult("cur:100", 99, 1));
    EXPECT_EQ(0, CheckParaResult("cur:100", 99, 0));
    EXPECT_EQ(1, CheckParaResult("cur:100", 101, 0));
    EXPECT_EQ(1, CheckParaResult("cur:100", 99, 3));  // only bit 0 counts
    EXPECT_EQ(0, CheckParaResult("cur:100", 99, 2));
    EXPECT_EQ(1, CheckParaResult("cur:-5", -6, 1));
    LogCapture log;
    EXPECT_EQ(0, CheckParaResult("cur100", 0, 1));
    EXPECT_TRUE(log.has("CheckParaResult input para error: cur100"));
    EXPECT_EQ(0, CheckParaResult("", 0, 0));
    EXPECT_EQ(0, CheckParaResult(nullptr, 0, 0));
}

std::string to_gbk(const std::string &utf8) {
    iconv_t cd = iconv_open("GBK", "UTF-8");
    std::string in = utf8;
    char out[64] = {};
    char *ip = in.data(), *op = out;
    size_t il = in.size(), ol = sizeof(out) - 1;
    iconv(cd, &ip, &il, &op, &ol);
    iconv_close(cd);
    return out;
}

TEST(TestInfoTable, LabelsAndIndexes) {
    EXPECT_STREQ("S_BOARDTEST_CURRENT", g_testinfo[0].context);
    EXPECT_STREQ(" S_EDGE_CAL", g_testinfo[12].context);
    EXPECT_STREQ("S_CAC_PREVIEW_TEMP", g_testinfo[66].context);
    EXPECT_STREQ("S_WCDMA_2_DIV_CPT", g_testinfo[99].context);
    EXPECT_STREQ("S_LTE_2_DIV_CPT", g_testinfo[115].context);
    EXPECT_STREQ("useless", g_testinfo[150].context);
    EXPECT_STREQ("S_STAND_BACKUP", g_testinfo[277].context);
    const std::pair<int, const char *> chinese[] = {
        {3, "保留"},           {275, "保留"},         {280, "LCD预检"},      {287, "灯类包装2"},
        {288, "后camera预检"}, {299, "受话器终检"},   {320, "触摸屏预检"},   {321, "TOUCH终检"},
        {339, "指纹包装2"},    {356, "激光对焦校准"}, {357, "激光对焦综测"}, {361, "SD卡终检"},
    };
    for (auto &c : chinese)
        EXPECT_EQ(to_gbk(c.second), g_testinfo[c.first].context) << c.first;
    for (int i = 0; i < MMI_TESTINFO_ITEMS; i++) {
        int expect = i == 339 ? 338 : i == 358 ? 354 : i == 359 ? 355 : i;
        EXPECT_EQ(expect, g_testinfo[i].index) << i;
        EXPECT_EQ(i >= 362, g_testinfo[i].context[0] == '\0') << i;
    }
}

}  // namespace

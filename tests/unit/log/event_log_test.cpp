// Event log files: opening with the directory path, the two entry formats, refusals.
#include <stdlib.h>
#include <string.h>
#include <sys/stat.h>
#include <time.h>

#include <string>

#include <gtest/gtest.h>

#include "ftx_log.h"
#include "core/mmi_settings.h"
#include "support/temp_root.h"
#include "unit/config/log_capture.h"

namespace {

// 15 November 2023, 17:29:07 local time (the tests run in UTC).
time_t fixed_clock() {
    struct tm t = {};
    t.tm_year = 123;
    t.tm_mon = 10;
    t.tm_mday = 15;
    t.tm_hour = 17;
    t.tm_min = 29;
    t.tm_sec = 7;
    return mktime(&t);
}

class EventLog : public ::testing::Test {
  protected:
    void SetUp() override {
        setenv("TZ", "UTC", 1);
        tzset();
        ftx_log_set_clock(fixed_clock);
    }
    void TearDown() override {
        ftx_log_set_clock(nullptr);
        for (FILE *fp : opened)
            uninit_ftxlog(fp);
    }
    FILE *open(const char *dir, const char *name) {
        FILE *fp = nullptr;
        EXPECT_EQ(0, init_ftx_log(&fp, dir, name));
        opened.push_back(fp);
        return fp;
    }
    TempRoot root;
    std::vector<FILE *> opened;
};

TEST_F(EventLog, MainLogCreatesItsDirectoriesAndAppends) {
    snprintf(g_chLogPath, MMI_TEXT_SIZE, "/cache/ftx/");
    root.write("/cache/keep", "");
    ASSERT_EQ(0, ftx_initlog(g_chLogPath));
    ASSERT_NE(nullptr, s_logFp);
    EXPECT_EQ(0, writeftxlog(s_logFp, "Label", "text %d", 1));
    uninit_ftxlog(s_logFp);
    s_logFp = nullptr;
    struct stat st;
    ASSERT_EQ(0, stat(root.host("/cache/ftx").c_str(), &st));
    EXPECT_TRUE(S_ISDIR(st.st_mode));
    // An existing log grows.
    ASSERT_EQ(0, ftx_initlog(g_chLogPath));
    EXPECT_EQ(0, writeftxlog_NoTime(s_logFp, "Label", "%s", "text"));
    uninit_ftxlog(s_logFp);
    s_logFp = nullptr;
    EXPECT_EQ("11/15-17:29:07 [Label] text 1\n[Label]\ntext\n", root.read("/cache/ftx/ftx.log"));
}

TEST_F(EventLog, DirectoryWithoutSlashGetsOne) {
    LogCapture log;
    FILE *fp = open("/data/aging", "run.log");
    ASSERT_NE(nullptr, fp);
    EXPECT_TRUE(root.exists("/data/aging/run.log"));
    EXPECT_TRUE(log.has("init_ftx_log:L187:path laster byte must /."));
    EXPECT_TRUE(log.has("init_ftx_log:/data/aging not exist."));
}

TEST_F(EventLog, OpenFailureLeavesNoStream) {
    root.write("/data/file", "x");  // a file where a directory is wanted
    FILE *fp = (FILE *)&fp;
    LogCapture log;
    EXPECT_EQ(-1, init_ftx_log(&fp, "/data/file/sub/", "a.log"));
    EXPECT_EQ(nullptr, fp);
    EXPECT_TRUE(log.has("make dirctory fail"));
    snprintf(g_chLogPath, MMI_TEXT_SIZE, "/data/file/sub/");
    EXPECT_EQ(-1, ftx_initlog(g_chLogPath));
    EXPECT_TRUE(log.has("E FTXLOG: ftx_initlog:L357:init_ftx_log(ftx.log) fail."));
}

TEST_F(EventLog, NullStreamIsRefused) {
    LogCapture log;
    EXPECT_EQ(-1, writeftxlog(nullptr, "L", "x"));
    EXPECT_EQ(-1, writeftxlog_NoTime(nullptr, "L", "x"));
    EXPECT_TRUE(log.has("D FTXLOG: writeftxlog:s_logFp is NULL."));
    EXPECT_EQ(0, uninit_ftxlog(nullptr));
}

TEST_F(EventLog, LongMessagesAreCutAt1023) {
    FILE *fp = open("/cache/ftx/", "long.log");
    std::string msg(1500, 'm');
    ASSERT_EQ(0, writeftxlog_NoTime(fp, "L", "%s", msg.c_str()));
    EXPECT_EQ("[L]\n" + std::string(1023, 'm') + "\n", root.read("/cache/ftx/long.log"));
}

TEST(MkdirMain, CreatesEveryMissingLevel) {
    TempRoot root;
    EXPECT_EQ(0, mkdir_main("/a/b//c/"));
    EXPECT_TRUE(root.exists("/a/b/c"));
    EXPECT_EQ(0, mkdir_main("/a/b/c"));  // all there already
    root.write("/f", "");
    EXPECT_NE(0, mkdir_main("/f/g"));
}

TEST(ConverTime, AsctimeTextInUtc) {
    TempRoot root;
    char out[64];
    memset(out, 'x', sizeof(out));
    LogCapture log;
    EXPECT_EQ(0, Conver_time2ASC(1700069347, 5, out, sizeof(out)));
    EXPECT_STREQ("Wed Nov 15 17:29:07 2023\n", out);
    EXPECT_TRUE(log.has("D ALARM: time L60 -> 1700069347.000000005"));
    // Only out_size bytes are written.
    memset(out, 'x', sizeof(out));
    Conver_time2ASC(0, 0, out, 3);
    EXPECT_EQ("Thuxx", std::string(out, 5));
}

}  // namespace

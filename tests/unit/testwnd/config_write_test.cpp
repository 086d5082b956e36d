// The configuration writer: what the reader sees after a rewrite, and what the PC cannot do.
#include <string.h>

#include <thread>
#include <vector>

#include <gtest/gtest.h>

#include "core/ftx_config.h"
#include "session/mmi_autotest.h"
#include "core/mmi_autotest_config.h"
#include "support/temp_root.h"
#include "unit/config/log_capture.h"

namespace {

const char kImage[] =
    "# comment\r\n"
    "[MMI]\r\n"
    "restore_autotest=1\r\n"
    "mmi_flag=1\r\n"
    "aux_lcd=0\r\n"
    "\r\n"
    "[MMI_EXTRA]\r\n"
    "mmi_flag=7\r\n"
    "[FTX_VIBRATOR]\r\n"
    "enable=1\r\n";

std::string set(const std::string &in, const char *d, const char *k, const char *v) {
    std::string out;
    EXPECT_EQ(0, mmi_config_set_value(in, d, k, v, &out));
    return out;
}

std::string read_back(const TempRoot &root, const char *domain, const char *key) {
    (void)root;
    char out[256] = {0};
    Read_MainCfgFile(domain, key, out, "none");
    return out;
}

TEST(ConfigWrite, ReplacesOnlyTheKeyOfTheExactDomainKeepingCrLf) {
    std::string out = set(kImage, "MMI", "mmi_flag", "0");
    std::string want = kImage;
    want.replace(want.find("mmi_flag=1"), 10, "mmi_flag=0");
    EXPECT_EQ(want, out);
    // The domain that merely begins with the name is not touched.
    EXPECT_NE(std::string::npos, out.find("[MMI_EXTRA]\r\nmmi_flag=7\r\n"));
}

TEST(ConfigWrite, MissingKeyGoesToTheEndOfItsDomainAndMissingDomainToTheEnd) {
    std::string out = set(kImage, "MMI", "Language", "English");
    EXPECT_NE(std::string::npos, out.find("aux_lcd=0\r\n\r\nLanguage=English\r\n[MMI_EXTRA]"));
    out = set(kImage, "FTX_VIBRATOR", "auto", "0");
    EXPECT_EQ(std::string(kImage) + "auto=0\r\n", out);
    out = set("[A]\nx=1", "B", "y", "2");
    EXPECT_EQ("[A]\nx=1\n[B]\ny=2\n", out);
}

TEST(ConfigWrite, ParameterSplitRefusesWhatWouldBreakTheFile) {
    char d[256], k[256], v[256];
    ASSERT_EQ(0, mmi_config_split_parm("MMI,mmi_flag,0", d, k, v));
    EXPECT_STREQ("MMI", d);
    EXPECT_STREQ("mmi_flag", k);
    EXPECT_STREQ("0", v);
    ASSERT_EQ(0, mmi_config_split_parm("MMI,LogPath,/cache/a,b\r\n", d, k, v));
    EXPECT_STREQ("/cache/a,b", v);
    EXPECT_EQ(-1, mmi_config_split_parm("MMI,mmi_flag", d, k, v));
    EXPECT_EQ(-1, mmi_config_split_parm(",mmi_flag,0", d, k, v));
    EXPECT_EQ(-1, mmi_config_split_parm("MMI],x,0", d, k, v));
    EXPECT_EQ(-1, mmi_config_split_parm("MMI,a=b,0", d, k, v));
    EXPECT_EQ(-1, mmi_config_split_parm("MMI,x,0\r\n[EVIL]", d, k, v));
    std::string longKey(300, 'k');
    EXPECT_EQ(-1, mmi_config_split_parm(("MMI," + longKey + ",1").c_str(), d, k, v));
}

TEST(ConfigWrite, ModifyConfigFileIsSeenByTheReader) {
    TempRoot root;
    root.write(FTX_MAIN_CONFIG_FILE, kImage);
    EXPECT_EQ("1", read_back(root, "MMI", "mmi_flag"));
    EXPECT_EQ(1, mmi_AutoTest_Modify_ConfigFile("MMI,mmi_flag,0"));
    EXPECT_EQ("0", read_back(root, "MMI", "mmi_flag"));
    EXPECT_NE(std::string::npos, root.read(FTX_MAIN_CONFIG_FILE).find("[MMI_EXTRA]\r\nmmi_flag=7"));
    EXPECT_FALSE(root.exists(FTX_MAIN_CONFIG_FILE ".tmp"));
    EXPECT_EQ(0, mmi_AutoTest_Modify_ConfigFile("MMI,mmi_flag"));
    EXPECT_EQ("0", read_back(root, "MMI", "mmi_flag"));
}

TEST(ConfigWrite, ModifyFailsWithoutAFile) {
    TempRoot root;
    EXPECT_EQ(0, mmi_AutoTest_Modify_ConfigFile("MMI,mmi_flag,0"));
    EXPECT_FALSE(root.exists(FTX_MAIN_CONFIG_FILE));
}

TEST(ConfigWrite, LargeFilesAreRewrittenWholeOrRefusedUntouched) {
    TempRoot root;
    // Comment lines of 100 bytes around the domain, so a cut would fall inside a line.
    std::string filler;
    for (int i = 0; filler.size() < (3u << 19); i++)
        filler += "# " + std::string(95, 'a' + i % 26) + "\r\n";
    const std::string big = filler + kImage + filler + "[LAST]\r\nkey=end\r\n";
    ASSERT_GT(big.size(), 2u << 20);
    root.write(FTX_MAIN_CONFIG_FILE, big);
    EXPECT_EQ(1, mmi_AutoTest_Modify_ConfigFile("MMI,mmi_flag,0"));
    std::string want = big;
    want.replace(want.find("mmi_flag=1"), 10, "mmi_flag=0");
    EXPECT_TRUE(want == root.read(FTX_MAIN_CONFIG_FILE)) << "the rewrite changed more than a key";
    EXPECT_EQ("end", read_back(root, "LAST", "key"));

    // Over the 16 MB the writer holds in memory: refused, the file left as it was.
    std::string huge = want;
    while (huge.size() <= (16u << 20))
        huge += filler;
    root.write(FTX_MAIN_CONFIG_FILE, huge);
    LogCapture log;
    EXPECT_EQ(0, mmi_AutoTest_Modify_ConfigFile("MMI,mmi_flag,1"));
    EXPECT_TRUE(
        log.has("E FTX_CONFIG: mmi_AutoTest_Modify_ConfigFile /etc/ftx_config.ini is over"));
    EXPECT_TRUE(huge == root.read(FTX_MAIN_CONFIG_FILE));
    EXPECT_FALSE(root.exists(FTX_MAIN_CONFIG_FILE ".tmp"));
}

TEST(ConfigWrite, ConcurrentRewritesKeepEveryKey) {
    TempRoot root;
    root.write(FTX_MAIN_CONFIG_FILE, kImage);
    // Two writers of different keys (the end of a run and the PC): each one's last value
    // must be in the file.
    std::vector<std::thread> writers;
    for (const char *key : {"alpha", "beta"}) {
        writers.emplace_back([key] {
            for (int i = 0; i <= 30; i++) {
                std::string parm = std::string("MMI,") + key + "," + std::to_string(i);
                EXPECT_EQ(1, mmi_AutoTest_Modify_ConfigFile(parm.c_str()));
            }
        });
    }
    for (auto &t : writers)
        t.join();
    EXPECT_EQ("30", read_back(root, "MMI", "alpha"));
    EXPECT_EQ("30", read_back(root, "MMI", "beta"));
    EXPECT_EQ("1", read_back(root, "MMI", "mmi_flag"));
}

TEST(ConfigWrite, AStaleTemporaryIsClearedAtStart) {
    TempRoot root;
    root.write(FTX_MAIN_CONFIG_FILE, kImage);
    EXPECT_EQ(0, mmi_config_clear_stale_temporary());
    root.write(FTX_MAIN_CONFIG_FILE ".tmp", "[MMI]\r\nmmi_fl");  // a kill mid-write
    LogCapture log;
    EXPECT_EQ(1, mmi_config_clear_stale_temporary());
    EXPECT_FALSE(root.exists(FTX_MAIN_CONFIG_FILE ".tmp"));
    EXPECT_TRUE(log.has("W FTX_CONFIG: mmi_config_clear_stale_temporary removed"));
    EXPECT_EQ(kImage, root.read(FTX_MAIN_CONFIG_FILE));
}

}  // namespace

// The configuration writer: what the reader sees after a rewrite, and what the PC cannot do.
#include <string.h>

#include <gtest/gtest.h>

#include "ftx_config.h"
#include "mmi_autotest.h"
#include "mmi_autotest_config.h"
#include "support/temp_root.h"

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

}  // namespace

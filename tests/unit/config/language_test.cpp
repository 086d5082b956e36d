// The language list: one section loaded at start-up, looked up by exact key.
#include <stdio.h>
#include <string.h>
#include <unistd.h>

#include <string>

#include <gtest/gtest.h>

#include "core/ftx_config.h"
#include "support/temp_root.h"
#include "unit/config/log_capture.h"

namespace {

class LangList : public ::testing::Test {
  protected:
    int load(const std::string &content, const char *language) {
        root.write(FTX_LANGUAGE_FILE, content);
        return Get_CfgValueList(language);
    }
    // The text of key, or "<fallback>" when the lookup failed and left the buffer alone.
    std::string text(const char *key) {
        char buf[FTX_CFG_TEXT_SIZE] = "<fallback>";
        Read_LangCfgFromList(key, buf);
        return buf;
    }
    TempRoot root;
};

TEST_F(LangList, LoadsOnlyTheConfiguredSection) {
    ASSERT_EQ(0, load("[Chinese]\r\nmenu_StartTest=zh\r\n"
                      "[English]\r\nmenu_StartTest=Start\r\nmenu_Start=Go\r\n"
                      "menu_StartTest=Again\r\nempty=\n",
                      "English"));
    EXPECT_EQ(3, ftx_config_lang_count());
    EXPECT_EQ("Start", text("menu_StartTest"));  // first of duplicates, exact key
    EXPECT_EQ("Go", text("menu_Start"));
    EXPECT_EQ("<fallback>", text("menu_Star"));
    EXPECT_EQ("<fallback>", text("empty"));
}

TEST_F(LangList, KeyAndOutputMayShareTheBuffer) {
    ASSERT_EQ(0, load("[English]\r\ninfo_Yes=Yes\r\n", "English"));
    char buf[FTX_CFG_TEXT_SIZE] = "info_Yes";
    EXPECT_EQ(0, Read_LangCfgFromList(buf, buf));
    EXPECT_STREQ("Yes", buf);
}

TEST_F(LangList, HoldsAtMost1999Texts) {
    std::string file = "[English]\r\n";
    for (int i = 1; i <= 2001; i++)
        file += "k" + std::to_string(i) + "=t" + std::to_string(i) + "\r\n";
    ASSERT_EQ(0, load(file, "English"));
    EXPECT_EQ(1999, ftx_config_lang_count());
    EXPECT_EQ("t1999", text("k1999"));
    EXPECT_EQ("<fallback>", text("k2000"));
    EXPECT_EQ("<fallback>", text("k2001"));
}

TEST_F(LangList, FailuresLeaveAnEmptyOrPartialList) {
    ASSERT_EQ(0, load("[English]\r\na=1x\r\n", "English"));
    EXPECT_EQ(0, load("[English]\r\na=1x\r\n", "French"));
    EXPECT_EQ(0, ftx_config_lang_count());
    EXPECT_EQ("<fallback>", text("a"));
    {
        LogCapture log;
        EXPECT_EQ(-1, load("[English]\r\na=1x\r\n[\r\nb=2x\r\n", "English"));
        EXPECT_TRUE(log.has("Get_CfgValueList mmi_parse_domain fail."));
    }
    EXPECT_EQ("1x", text("a"));
    EXPECT_EQ("<fallback>", text("b"));
    ASSERT_EQ(0, unlink(root.host(FTX_LANGUAGE_FILE).c_str()));
    EXPECT_EQ(-1, Get_CfgValueList("English"));
    EXPECT_EQ(0, ftx_config_lang_count());
    char buf[8] = "x";
    EXPECT_EQ(-1, Read_LangCfgFromList(nullptr, buf));
}

}  // namespace

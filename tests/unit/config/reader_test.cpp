// The single-value lookup of the sectioned format, quirks included.
#include <string.h>

#include <string>

#include <gtest/gtest.h>

#include "core/ftx_config.h"
#include "support/temp_root.h"
#include "unit/config/log_capture.h"

namespace {

const char *kFile = "/etc/test.ini";

class CfgLookup : public ::testing::Test {
  protected:
    // Writes the file and looks domain/key up into a fresh zeroed buffer.
    int lookup(const std::string &content, const char *domain, const char *key,
               const char *def = nullptr) {
        root.write(kFile, content);
        memset(out, 0, sizeof(out));
        return Get_CfgValue(kFile, domain, key, out, def);
    }
    TempRoot root;
    char out[FTX_CFG_TEXT_SIZE] = {};
};

TEST_F(CfgLookup, LastCharacterOfTheValueIsDropped) {
    EXPECT_EQ(0, lookup("[MMI]\r\nLanguage=English\r\n", "MMI", "Language"));
    EXPECT_STREQ("English", out);
    // With bare LF ends the real last character goes.
    EXPECT_EQ(0, lookup("[MMI]\nLanguage=English\n", "MMI", "Language"));
    EXPECT_STREQ("Englis", out);
    // A one-character value becomes empty, so the default shows.
    EXPECT_EQ(0, lookup("[MMI]\nUEShape=1\n", "MMI", "UEShape", "0"));
    EXPECT_STREQ("0", out);
}

TEST_F(CfgLookup, PrefixesMatchAndTheFirstMatchWins) {
    const std::string file =
        "[MMI]\r\nLang=French\r\nLanguage=English\r\nOS=7\r\n"
        "[MMIX]\r\nLanguage=German\r\n";
    EXPECT_EQ(0, lookup(file, "MMI", "Language"));
    EXPECT_STREQ("French", out);
    // A file key is a prefix of the wanted key, a file domain of the wanted domain.
    EXPECT_EQ(0, lookup(file, "MMI", "OSIdle"));
    EXPECT_STREQ("7", out);
    EXPECT_EQ(0, lookup(file, "MMI_OTHER", "Lang"));
    EXPECT_STREQ("French", out);
    // ...but never the other way round.
    EXPECT_EQ(0, lookup(file, "MM", "Lang", "none"));
    EXPECT_STREQ("none", out);
}

TEST_F(CfgLookup, EmptyValuesAndLinesOutsideDomainsAreSkipped) {
    const std::string file =
        "Key=9\r\n"
        "[D]\r\nKey=\n  Key \t=  12\r\n";
    EXPECT_EQ(0, lookup(file, "D", "Key"));
    EXPECT_STREQ("12", out);
    EXPECT_EQ(0, lookup("Key=9\r\n[D]\r\n", "D", "Key", "d"));
    EXPECT_STREQ("d", out);
}

TEST_F(CfgLookup, OnlyColumnOneStartsAComment) {
    const std::string file = "[D]\r\n#Key=1\r\n  #Key=2\r\n";
    EXPECT_EQ(0, lookup(file, "D", "#Key"));
    EXPECT_STREQ("2", out);
}

TEST_F(CfgLookup, MalformedHeaderBeforeTheEntryFailsTheLookup) {
    for (const char *bad : {"[]\r\n", "[MMI\r\n", "[\r\n"}) {
        SCOPED_TRACE(bad);
        snprintf(out, sizeof(out), "kept");
        root.write(kFile, std::string("[A]\r\nx=1\r\n") + bad + "[D]\r\nKey=5\r\n");
        LogCapture log;
        EXPECT_EQ(-1, Get_CfgValue(kFile, "D", "Key", out, "def"));
        EXPECT_STREQ("kept", out);
        EXPECT_TRUE(log.has("Get_CfgValue mmi_parse_domain fail."));
    }
    // After the match the search has stopped.
    EXPECT_EQ(0, lookup("[D]\r\nKey=5\r\n[]\r\n", "D", "Key"));
    EXPECT_STREQ("5", out);
    // Blanks inside the brackets belong to the name.
    EXPECT_EQ(0, lookup("[ D ]\r\nKey=5\r\n", "D", "Key", "no"));
    EXPECT_STREQ("no", out);
}

TEST_F(CfgLookup, MissingDomainKeepsDefaultOrPriorValue) {
    EXPECT_EQ(0, lookup("[A]\r\nKey=1\r\n", "B", "Key", "dflt"));
    EXPECT_STREQ("dflt", out);
    snprintf(out, sizeof(out), "prior");
    EXPECT_EQ(0, Get_CfgValue(kFile, "B", "Key", out, nullptr));
    EXPECT_STREQ("prior", out);
    // A found value replaces a longer prior one completely.
    snprintf(out, sizeof(out), "a much longer prior value");
    EXPECT_EQ(0, Get_CfgValue(kFile, "A", "Key", out, "x"));
    EXPECT_STREQ("1", out);
    EXPECT_EQ(std::string(24, '\0'), std::string(out + 1, 24));
}

TEST_F(CfgLookup, MissingFileAndNullArgumentsFail) {
    snprintf(out, sizeof(out), "kept");
    LogCapture log;
    EXPECT_EQ(-1, Get_CfgValue("/etc/none.ini", "D", "K", out, "def"));
    EXPECT_STREQ("kept", out);
    EXPECT_TRUE(log.has("D FTX_CONFIG: Get_CfgValue open /etc/none.ini fail."));
    EXPECT_EQ(-1, Get_CfgValue(kFile, nullptr, "K", out, "def"));
    EXPECT_EQ(-1, Get_CfgValue(kFile, "D", "K", nullptr, "def"));
    EXPECT_TRUE(log.has("E FTX_CONFIG: Get_CfgValue,L279::cfg_file domain name value NULL"));
}

TEST_F(CfgLookup, LinesAreReadIn2048ByteBites) {
    // 2047 bytes fill one read; the entry behind them starts a line of its own.
    EXPECT_EQ(0, lookup("[D]\r\n" + std::string(2047, 'x') + "Key=7\r\n", "D", "Key"));
    EXPECT_STREQ("7", out);
    // One byte less and the next piece starts inside the key.
    EXPECT_EQ(0, lookup("[D]\r\n" + std::string(2046, 'x') + "Key=7\r\n", "D", "Key", "-"));
    EXPECT_STREQ("-", out);
}

TEST_F(CfgLookup, FieldLimits) {
    // '=' at offset 255 is usable, at 256 not.
    const std::string k255(255, 'k'), k256(256, 'k');
    EXPECT_EQ(0, lookup("[D]\r\n" + k255 + "=1\r\n", "D", k255.c_str()));
    EXPECT_STREQ("1", out);
    EXPECT_EQ(0, lookup("[D]\r\n" + k256 + "=1\r\n", "D", k256.c_str(), "-"));
    EXPECT_STREQ("-", out);
    // Values are cut to 255 characters, then lose their last one.
    EXPECT_EQ(0, lookup("[D]\r\nKey=" + std::string(300, 'v') + "\r\n", "D", "Key"));
    EXPECT_EQ(254u, strlen(out));
    // A 255-character domain name is fine, 256 is malformed.
    const std::string d255(255, 'd'), d256(256, 'd');
    EXPECT_EQ(0, lookup("[" + d255 + "]\r\nKey=1\r\n", d255.c_str(), "Key"));
    EXPECT_STREQ("1", out);
    EXPECT_EQ(-1, lookup("[" + d256 + "]\r\nKey=1\r\n", d256.c_str(), "Key"));
}

TEST_F(CfgLookup, AnUnterminatedBufferIsClearedOnlyOverItsSize) {
    root.write(kFile, "[D]\r\nKey=12\r\n");
    memset(out, 'x', sizeof(out));
    EXPECT_EQ(0, Get_CfgValue(kFile, "D", "Key", out, nullptr));
    EXPECT_STREQ("12", out);
}

TEST_F(CfgLookup, MainFileWrapperBracketsTheLookup) {
    root.write("/etc/ftx_config.ini", "[MMI]\r\nLogPath=/data/x/\r\n");
    LogCapture log;
    EXPECT_EQ(0, Read_MainCfgFile("MMI", "LogPath", out, nullptr));
    EXPECT_STREQ("/data/x/", out);
    ASSERT_GE(log.lines.size(), 2u);
    EXPECT_EQ("D FTX_CONFIG: Read_MainCfgFile begin", log.lines.front());
    EXPECT_EQ("D FTX_CONFIG: Read_MainCfgFile end", log.lines.back());
    root.write("/etc/ftx_config.ini", "[]\r\n");
    EXPECT_EQ(-1, Read_MainCfgFile("MMI", "LogPath", out, nullptr));
    EXPECT_EQ("D FTX_CONFIG: Read_MainCfgFile Get_CfgValue fail.", log.lines.back());
}

TEST(CfgParseHelpers, DomainAndEqualSplit) {
    char name[FTX_CFG_TEXT_SIZE] = "old";
    EXPECT_EQ(0, mmi_parse_domain("[MMI] trailing ] text\r\n", name));
    EXPECT_STREQ("MMI", name);
    EXPECT_EQ(-1, mmi_parse_domain("[]", name));
    EXPECT_STREQ("MMI", name);
    char key[FTX_CFG_TEXT_SIZE] = "k", value[FTX_CFG_TEXT_SIZE] = "v";
    mmi_parse_equal("no equal sign\r\n", key, value);
    EXPECT_STREQ("k", key);
    EXPECT_STREQ("v", value);
    mmi_parse_equal(" a = b=c\r\n", key, value);
    EXPECT_STREQ(" a ", key);
    EXPECT_STREQ(" b=c\r\n", value);
}

}  // namespace

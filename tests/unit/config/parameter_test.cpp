// Parameter strings: "key:value" pairs separated by ';'.
#include <string.h>

#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "core/ftx_config.h"
#include "support/temp_root.h"
#include "unit/config/log_capture.h"

namespace {

// Parses str as callers do: out of a zero-filled 256-byte value buffer.
std::vector<std::pair<std::string, std::string>> parse(const char *str, int max = 12) {
    char value[FTX_CFG_TEXT_SIZE] = {0};
    snprintf(value, sizeof(value), "%s", str);
    std::vector<ftx_config_para> recs(max + 1);
    memset(recs.data(), 0, recs.size() * sizeof(ftx_config_para));
    int n = ftx_config_parse_parameter(value, recs.data(), max);
    std::vector<std::pair<std::string, std::string>> out;
    for (int i = 0; i < n; i++)
        out.emplace_back(recs[i].key, recs[i].value);
    EXPECT_EQ('\0', recs[max].key[0]) << "wrote past max";
    return out;
}

using Pairs = std::vector<std::pair<std::string, std::string>>;

TEST(ParameterString, PairsAndTheirLimits) {
    TempRoot root;
    EXPECT_EQ((Pairs{{"lowvolt_threshold", "30"}, {"powerofftemp", "600"}}),
              parse("lowvolt_threshold:30;powerofftemp:600"));
    LogCapture log;
    EXPECT_EQ((Pairs{{"lowvolt_threshold", "30"}}),
              parse("lowvolt_threshold:30;powerofftemp:600", 1));
    EXPECT_TRUE(log.has("E FTX_CONFIG: ftx_config paras_index=1,max_paras_index=1"));
}

TEST(ParameterString, SkipsEmptyKeysAndStopsAtAPieceWithoutColon) {
    TempRoot root;
    EXPECT_EQ((Pairs{{"a", "1"}}), parse(":5;a:1"));
    EXPECT_EQ((Pairs{{"a", "1"}}), parse("a:1;b;c:3"));
    EXPECT_EQ((Pairs{{"a", "1"}}), parse("a:1;"));
    // The skip looks at the untrimmed key: blanks before ':' give an empty key.
    EXPECT_EQ((Pairs{{"a", "1"}, {"", "2"}}), parse("a:1; :2"));
    EXPECT_EQ(Pairs{}, parse("a:"));  // shorter than 3
}

TEST(ParameterString, OnlyTrailingBlanksAreTrimmed) {
    TempRoot root;
    EXPECT_EQ((Pairs{{"a", "1"}, {" b", " 2"}, {"url", "http://x:80"}}),
              parse("a \t:1 \n; b: 2 ;url:http://x:80"));
}

TEST(ParameterString, ValueLookupByNamePrefix) {
    ftx_config_para recs[3];
    memset(recs, 0, sizeof(recs));
    snprintf(recs[0].key, sizeof(recs[0].key), "lowvolt_threshold2");
    snprintf(recs[0].value, sizeof(recs[0].value), "25");
    snprintf(recs[1].key, sizeof(recs[1].key), "lowvolt_threshold");
    snprintf(recs[1].value, sizeof(recs[1].value), "30");
    char out[8] = {0};
    EXPECT_EQ(2, ftx_config_get_para_value(recs, 2, "lowvolt_threshold", out, sizeof(out), "9"));
    EXPECT_STREQ("25", out);
    // Records beyond count are not looked at; the default then applies.
    memset(out, 0, sizeof(out));
    snprintf(recs[2].key, sizeof(recs[2].key), "late");
    EXPECT_EQ(3, ftx_config_get_para_value(recs, 2, "late", out, sizeof(out), "def"));
    EXPECT_STREQ("def", out);
    // The copy stays inside out.
    snprintf(recs[1].value, sizeof(recs[1].value), "0123456789");
    memset(out, 0, sizeof(out));
    EXPECT_EQ(7, ftx_config_get_para_value(&recs[1], 1, "lowvolt", out, sizeof(out), nullptr));
    EXPECT_STREQ("0123456", out);
}

}  // namespace

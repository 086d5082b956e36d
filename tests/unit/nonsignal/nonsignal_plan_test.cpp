// The non-signalling settings as the configuration writes them, and the judging of a level.
#include <string.h>

#include <gtest/gtest.h>

#include "coupling/mmi_nonsignal_plan.h"

namespace {

const mmi_ns_tech &kLte = kMmiNsTechs[0];
const mmi_ns_tech &kGsm = kMmiNsTechs[1];

mmi_ns_plan parsed(const char *text, const mmi_ns_tech &tech = kLte) {
    mmi_ns_plan p;
    mmi_ns_parse_plan(tech, text, &p);
    return p;
}

TEST(NonSignalPlan, TechnologyTableMatchesTheResultRecord) {
    const struct {
        const char *key;
        int item;
        const char *label;
    } kExpected[] = {{"LTE", 38, "S_LTE_CPT"},
                     {"GSM", 6, "S_GSM_CPT"},
                     {"CDMA2000", 18, "S_CDMA_CPT"},
                     {"WCDMA", 26, "S_WCDMA_CPT"},
                     {"TDSCDMA", 30, "S_TD_CPT"}};
    for (int i = 0; i < MMI_NS_TECHS; i++) {
        EXPECT_STREQ(kExpected[i].key, kMmiNsTechs[i].key);
        EXPECT_EQ(kExpected[i].item, kMmiNsTechs[i].resultItem);
        EXPECT_STREQ(kExpected[i].label, kMmiNsTechs[i].resultLabel);
        EXPECT_EQ(i + 1, kMmiNsTechs[i].libTech);
    }
}

TEST(NonSignalPlan, BandsWithOneChannelOrAGroupEachBecomeStepsInOrder) {
    mmi_ns_plan p = parsed(
        "enable:1;band:1,3,7;channel:300/50,1575,3100/3050/2750;power:22.5;"
        "min:-75.5;max:-45;settle:30");
    ASSERT_TRUE(p.enabled);
    ASSERT_TRUE(p.valid) << p.reason;
    const mmi_ns_step kSteps[] = {{1, 300}, {1, 50}, {3, 1575}, {7, 3100}, {7, 3050}, {7, 2750}};
    ASSERT_EQ(6, p.stepCount);
    for (int i = 0; i < 6; i++) {
        EXPECT_EQ(kSteps[i].band, p.steps[i].band) << i;
        EXPECT_EQ(kSteps[i].channel, p.steps[i].channel) << i;
    }
    EXPECT_EQ(225, p.power);
    EXPECT_EQ(-755, p.min);
    EXPECT_EQ(-450, p.max);
    EXPECT_EQ(30, p.settleMs);
}

TEST(NonSignalPlan, DefaultsAndZeroNumberedBandsAndChannels) {
    // CDMA's band class 0 and GSM's ARFCN 0 are real numbers.
    mmi_ns_plan p = parsed("enable:1;band:0;channel:0", kGsm);
    ASSERT_TRUE(p.valid) << p.reason;
    ASSERT_EQ(1, p.stepCount);
    EXPECT_EQ(0, p.steps[0].band);
    EXPECT_EQ(0, p.steps[0].channel);
    EXPECT_EQ(kGsm.defaultPower, p.power);
    EXPECT_EQ(-800, p.min);
    EXPECT_EQ(-400, p.max);
    EXPECT_EQ(0, p.settleMs);
}

TEST(NonSignalPlan, NotEnabledIsValidAndEmpty) {
    for (const char *text : {"", "enable:0;band:1;channel:300", "band:1;channel:300", "enable:2"}) {
        mmi_ns_plan p;
        EXPECT_EQ(0, mmi_ns_parse_plan(kLte, text, &p)) << text;
        EXPECT_FALSE(p.enabled) << text;
        EXPECT_EQ(0, p.stepCount) << text;
    }
}

TEST(NonSignalPlan, UnreadableSettingsAreRefusedWithAReason) {
    const struct {
        const char *text;
        const char *reason;
    } kBad[] = {
        {"enable:1;channel:300", "no band"},
        {"enable:1;band:1", "no channel"},
        {"enable:1;band:1,3;channel:300", "fewer channel groups"},
        {"enable:1;band:1;channel:300,1575", "more channel groups"},
        {"enable:1;band:1,,3;channel:300,1,2", "bad band"},
        {"enable:1;band:x;channel:300", "bad band"},
        {"enable:1;band:1;channel:300/", "bad channel"},
        {"enable:1;band:1;channel:300//5", "bad channel"},
        {"enable:1;band:1;channel:-3", "bad channel"},
        {"enable:1;band:1;channel:9999999", "bad channel"},
        {"enable:1;band:1;channel:1/2/3/4/5/6/7/8/9/10/11/12/13/14/15/16/17", "too many"},
        {"enable:1;band:1;channel:300;power:23.55", "bad power"},
        {"enable:1;band:1;channel:300;power:high", "bad power"},
        {"enable:1;band:1;channel:300;min:-40;max:-80", "min above max"},
        {"enable:1;band:1;channel:300;min:-250", "bad min"},
        {"enable:1;band:1;channel:300;settle:20000", "bad settle"},
    };
    for (const auto &b : kBad) {
        mmi_ns_plan p;
        EXPECT_EQ(-1, mmi_ns_parse_plan(kLte, b.text, &p)) << b.text;
        EXPECT_TRUE(p.enabled) << b.text;
        EXPECT_FALSE(p.valid) << b.text;
        EXPECT_NE(nullptr, strstr(p.reason, b.reason)) << b.text << " -> " << p.reason;
    }
}

TEST(NonSignalPlan, DbmTextAndLimitsAreInclusive) {
    int v = 0;
    EXPECT_EQ(0, mmi_ns_parse_dbm("-60.5", &v));
    EXPECT_EQ(-605, v);
    EXPECT_EQ(0, mmi_ns_parse_dbm("+23", &v));
    EXPECT_EQ(230, v);
    for (const char *bad : {"", "-", "1.", ".5", "1.25", "60.1", "-200.1", "1e3", " 5"})
        EXPECT_EQ(-1, mmi_ns_parse_dbm(bad, &v)) << bad;
    char text[16];
    mmi_ns_format_dbm(-5, text, sizeof text);
    EXPECT_STREQ("-0.5", text);
    mmi_ns_format_dbm(230, text, sizeof text);
    EXPECT_STREQ("23.0", text);

    mmi_ns_plan p = parsed("enable:1;band:1;channel:300;min:-80;max:-40");
    EXPECT_TRUE(mmi_ns_level_passes(p, -800));
    EXPECT_TRUE(mmi_ns_level_passes(p, -400));
    EXPECT_FALSE(mmi_ns_level_passes(p, -801));
    EXPECT_FALSE(mmi_ns_level_passes(p, -399));
}

}  // namespace

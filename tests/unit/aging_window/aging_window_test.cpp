// The texts of the aging window and of the aging result list, without a screen.
#include <stdlib.h>
#include <string.h>

#include <filesystem>
#include <fstream>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "AgingTest/mmi_aging_window.h"
#include "core/ftx_config.h"
#include "mmi_theme.h"
#include "support/temp_root.h"

namespace {

std::string elapsed(long long seconds, size_t size = 32) {
    char out[32];
    mmi_aging_format_elapsed(seconds, out, size);
    return out;
}

std::string battery(int level, int tenths) {
    char out[32];
    mmi_aging_format_battery(level, tenths, out, sizeof out);
    return out;
}

TEST(AgingTexts, ElapsedTimeIsHoursMinutesSeconds) {
    EXPECT_EQ("0:00:00", elapsed(0));
    EXPECT_EQ("0:00:59", elapsed(59));
    EXPECT_EQ("0:01:00", elapsed(60));
    EXPECT_EQ("1:01:01", elapsed(3661));
    EXPECT_EQ("100:00:00", elapsed(360000));  // a long burn-in keeps counting hours
    EXPECT_EQ("0:00:00", elapsed(-5));        // a clock set back shows no negative time
    EXPECT_EQ("1:0", elapsed(3661, 4));       // bounded by the buffer, terminated
}

TEST(AgingTexts, BatteryShowsLevelAndTenthsOfADegreeOrDashesWhenUnknown) {
    EXPECT_EQ("85 %  31.5 C", battery(85, 315));
    EXPECT_EQ("100 %  45.0 C", battery(100, 450));
    EXPECT_EQ("3 %  -0.5 C", battery(3, -5));
    EXPECT_EQ("3 %  -12.3 C", battery(3, -123));
    EXPECT_EQ("--", battery(-1, 315));
}

TEST(AgingTexts, ShownCycleIsTheOneRunningAndTheLastOnceFinished) {
    mmi_aging_record r{};
    r.cycles = 3;
    EXPECT_EQ(1, mmi_aging_shown_cycle(&r));
    r.cycle = 2;
    EXPECT_EQ(3, mmi_aging_shown_cycle(&r));
    r.cycle = 3;  // every cycle done, the end not yet written
    EXPECT_EQ(3, mmi_aging_shown_cycle(&r));
    r.cycle = 1;
    r.finished = 1;  // stopped by the operator after the first cycle
    EXPECT_EQ(1, mmi_aging_shown_cycle(&r));
}

TEST(AgingTexts, EveryPhaseHasItsOwnTextAndAnUnknownOneReadsAsStarting) {
    std::vector<std::string> keys;
    for (int p = AGING_PHASE_STARTING; p <= AGING_PHASE_DONE; p++) {
        for (const std::string &k : keys)
            EXPECT_NE(k, mmi_aging_phase_key(p)) << p;
        keys.push_back(mmi_aging_phase_key(p));
    }
    EXPECT_STREQ(mmi_aging_phase_key(AGING_PHASE_STARTING), mmi_aging_phase_key(-1));
    EXPECT_STREQ(mmi_aging_phase_key(AGING_PHASE_STARTING), mmi_aging_phase_key(99));
}

// ---- the result list ----

struct Rows {
    mmi_aging_list_row row[MMI_AGING_LIST_ROWS];
    int n = 0;
    int build(const mmi_aging_record *r, int source, int max = MMI_AGING_LIST_ROWS) {
        n = mmi_aging_list_build(r, source, "PASS", "FAIL", row, max);
        return n;
    }
    // The row of item i (after the start row).
    const mmi_aging_list_row &item(int i) const { return row[i + 1]; }
    // The row whose label key is key, or null.
    const mmi_aging_list_row *find(const char *key) const {
        for (int i = 0; i < n; i++)
            if (row[i].labelKey && strcmp(row[i].labelKey, key) == 0) return &row[i];
        return nullptr;
    }
};

mmi_aging_record a_record() {
    mmi_aging_record r{};
    r.cycles = 10;
    r.cycle = 4;
    r.finished = 1;
    r.elapsed = 3 * 3600 + 25 * 60 + 7;
    r.counts[AGING_ITEM_VIDEO] = {4, 0};
    r.counts[AGING_ITEM_CAMERA] = {3, 1};
    r.counts[AGING_ITEM_REBOOT] = {0, 2};
    return r;
}

TEST(AgingList, EachItemShowsItsCountsInTheColourOfItsResult) {
    mmi_aging_record r = a_record();
    Rows rows;
    rows.build(&r, AGING_LIST_RESULT);
    for (int i = 0; i < AGING_ITEM_COUNT; i++) {
        EXPECT_STREQ(mmi_aging_item_label(i), rows.item(i).labelKey) << i;
        EXPECT_FALSE(rows.item(i).startsRun) << i;
    }
    EXPECT_STREQ("PASS 4", rows.item(AGING_ITEM_VIDEO).value);
    EXPECT_EQ(MMI_COLOUR_PASS, rows.item(AGING_ITEM_VIDEO).colour);
    EXPECT_STREQ("FAIL 1/4", rows.item(AGING_ITEM_CAMERA).value);  // one of four failed
    EXPECT_EQ(MMI_COLOUR_FAIL, rows.item(AGING_ITEM_CAMERA).colour);
    EXPECT_STREQ("FAIL 2/2", rows.item(AGING_ITEM_REBOOT).value);
    EXPECT_STREQ("--", rows.item(AGING_ITEM_CPU).value);  // never ran
    EXPECT_EQ(MMI_COLOUR_TEXT, rows.item(AGING_ITEM_CPU).colour);
}

TEST(AgingList, TheRunsRowsTellItsStateCyclesTimeAndLastFailure) {
    mmi_aging_record r = a_record();
    Rows rows;
    EXPECT_EQ(AGING_ITEM_COUNT + 5, rows.build(&r, AGING_LIST_RESULT));
    EXPECT_STREQ("aging_Finished", rows.find("aging_State")->valueKey);
    EXPECT_STREQ("4 / 10", rows.find("aging_Cycles")->value);
    EXPECT_STREQ("3:25:07", rows.find("aging_Elapsed")->value);
    EXPECT_STREQ("--", rows.find("aging_LastFailure")->value);
    EXPECT_EQ(MMI_COLOUR_TEXT, rows.find("aging_LastFailure")->colour);

    r.stopped = 1;
    strcpy(r.lastFailure, "camera 0: no picture");
    EXPECT_EQ(AGING_ITEM_COUNT + 6, rows.build(&r, AGING_LIST_RESULT));
    EXPECT_STREQ("aging_Stopped", rows.find("aging_State")->valueKey);
    EXPECT_EQ(MMI_COLOUR_FAIL, rows.find("aging_LastFailure")->colour);
    const mmi_aging_list_row &text = rows.row[rows.n - 1];  // the failure on a row of its own
    EXPECT_EQ(nullptr, text.labelKey);
    EXPECT_STREQ("camera 0: no picture", text.text);
    EXPECT_EQ(MMI_COLOUR_FAIL, text.colour);

    // The marker's record is a run still in progress, whatever its flags say.
    rows.build(&r, AGING_LIST_MARKER);
    EXPECT_STREQ("aging_InProgress", rows.find("aging_State")->valueKey);
}

TEST(AgingList, TheStartRowComesFirstAndTheRowsStayWithinTheirRoom) {
    Rows rows;
    ASSERT_EQ(2, rows.build(nullptr, AGING_LIST_NONE));
    EXPECT_TRUE(rows.row[0].startsRun);
    EXPECT_STREQ("menu_StartTest", rows.row[0].labelKey);
    EXPECT_FALSE(rows.row[1].startsRun);
    EXPECT_STREQ("aging_NoResult", rows.row[1].labelKey);
    EXPECT_STREQ("", rows.row[1].value);

    mmi_aging_record r = a_record();
    strcpy(r.lastFailure, "x");
    rows.row[3].colour = -7;  // a row past the room keeps what it had
    EXPECT_EQ(3, rows.build(&r, AGING_LIST_RESULT, 3));
    EXPECT_EQ(-7, rows.row[3].colour);
    EXPECT_EQ(0, rows.build(&r, AGING_LIST_RESULT, 0));
    EXPECT_EQ(0, rows.build(nullptr, AGING_LIST_NONE, 0));
    // A failure text as long as the record holds is cut to the row, terminated.
    memset(r.lastFailure, 'f', sizeof r.lastFailure - 1);
    r.lastFailure[sizeof r.lastFailure - 1] = '\0';
    rows.build(&r, AGING_LIST_RESULT);
    EXPECT_EQ(strlen(r.lastFailure), strlen(rows.row[rows.n - 1].text));
}

// Every text the two screens ask for is in both languages of the image.
TEST(AgingTexts, EveryKeyIsInBothLanguagesOfTheImage) {
    std::vector<std::string> keys = {"aging_Title",   "aging_StopHint", "aging_StopAgain",
                                     "aging_Cycle",   "aging_Step",     "aging_TimeLeft",
                                     "aging_Elapsed", "aging_Battery",  "aging_Failures",
                                     "Result_pass",   "Result_fail",    "title_AgingTest"};
    for (int p = AGING_PHASE_STARTING; p <= AGING_PHASE_DONE; p++)
        keys.push_back(mmi_aging_phase_key(p));
    Rows rows;
    rows.build(nullptr, AGING_LIST_NONE);
    keys.push_back(rows.row[0].labelKey);
    keys.push_back(rows.row[1].labelKey);
    mmi_aging_record r = a_record();
    strcpy(r.lastFailure, "x");
    for (int source : {AGING_LIST_MARKER, AGING_LIST_RESULT}) {
        for (int stopped : {0, 1}) {
            r.stopped = stopped;
            rows.build(&r, source);
            for (int i = 0; i < rows.n; i++) {
                if (rows.row[i].labelKey) keys.push_back(rows.row[i].labelKey);
                if (rows.row[i].valueKey) keys.push_back(rows.row[i].valueKey);
            }
        }
    }
    TempRoot root;
    const char *src = getenv("FTX_SOURCE_DIR");
    std::ifstream in(std::string(src ? src : ".") + "/sim/image" FTX_LANGUAGE_FILE,
                     std::ios::binary);
    root.write(FTX_LANGUAGE_FILE,
               std::string((std::istreambuf_iterator<char>(in)), std::istreambuf_iterator<char>()));
    for (const char *language : {"English", "Chinese"}) {
        ASSERT_EQ(0, Get_CfgValueList(language));
        for (const std::string &k : keys) {
            char text[FTX_CFG_TEXT_SIZE];
            EXPECT_EQ(0, Read_LangCfgFromList(k.c_str(), text)) << language << ": " << k;
        }
    }
}

}  // namespace

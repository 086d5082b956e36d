// The aging record as the reboot marker keeps it, its JSON for the server, and the settings
// reader's two kinds of default.
#include <string.h>

#include <string>

#include <gtest/gtest.h>

#include "AgingTest/mmi_aging_config.h"
#include "AgingTest/mmi_aging_record.h"
#include "support/temp_root.h"

namespace {

mmi_aging_record sample() {
    mmi_aging_record r;
    mmi_aging_record_init(&r, 3, 1790000000);
    r.cycle = 1;
    r.item = AGING_ITEM_STANDBY;
    r.step = 7;
    r.rebootPending = 1;
    r.elapsed = 4321;
    mmi_aging_record_count(&r, AGING_ITEM_CAMERA, 1, nullptr);
    mmi_aging_record_count(&r, AGING_ITEM_CAMERA, 0, "camera 1 check\nreturned -1");
    mmi_aging_record_count(&r, AGING_ITEM_REBOOT, 1, nullptr);
    return r;
}

TEST(AgingRecord, SavedRecordReadsBackWhole) {
    TempRoot root;
    const mmi_aging_record r = sample();
    ASSERT_EQ(mmi_aging_record_save(&r, "/cache/ftx/rebootAging.txt"), -1);  // no folder yet
    root.write("/cache/ftx/.keep", "");
    ASSERT_EQ(mmi_aging_record_save(&r, "/cache/ftx/rebootAging.txt"), 0);
    EXPECT_FALSE(root.exists("/cache/ftx/rebootAging.txt.tmp"));

    mmi_aging_record back;
    ASSERT_EQ(mmi_aging_record_load(&back, "/cache/ftx/rebootAging.txt"), 0);
    EXPECT_EQ(back.cycles, 3);
    EXPECT_EQ(back.cycle, 1);
    EXPECT_EQ(back.item, AGING_ITEM_STANDBY);
    EXPECT_EQ(back.step, 7);
    EXPECT_EQ(back.rebootPending, 1);
    EXPECT_EQ(back.startedAt, 1790000000);
    EXPECT_EQ(back.elapsed, 4321);
    EXPECT_EQ(back.failures, 1);
    EXPECT_EQ(back.counts[AGING_ITEM_CAMERA].pass, 1);
    EXPECT_EQ(back.counts[AGING_ITEM_CAMERA].fail, 1);
    EXPECT_EQ(back.counts[AGING_ITEM_REBOOT].pass, 1);
    // A line end in the failure text would have begun a new entry.
    EXPECT_STREQ(back.lastFailure, "camera 1 check returned -1");
    EXPECT_EQ(mmi_aging_record_load(&back, "/cache/ftx/none.txt"), -1);
}

TEST(AgingRecord, DamagedRecordIsClampedNotTrusted) {
    mmi_aging_record r;
    const char bad[] =
        "[aging]\ncycles=-5\ncycle=99\nitem=bogus\nstep=-3\n"
        "reboot_pending=7\n[counts]\ncamera=-4,x\nvideo=2,3\n";
    ASSERT_EQ(mmi_aging_record_parse(&r, bad, strlen(bad)), 0);
    EXPECT_EQ(r.cycles, 1);
    EXPECT_EQ(r.cycle, 1);  // never past the cycles asked for
    EXPECT_EQ(r.item, 0);
    EXPECT_EQ(r.step, 0);
    EXPECT_EQ(r.rebootPending, 1);
    EXPECT_EQ(r.counts[AGING_ITEM_CAMERA].pass, 0);
    EXPECT_EQ(r.counts[AGING_ITEM_CAMERA].fail, 0);
    EXPECT_EQ(r.counts[AGING_ITEM_VIDEO].fail, 3);
    // Without its cycles it is not a record at all.
    const char other[] = "[aging]\ncycle=1\n";
    EXPECT_EQ(mmi_aging_record_parse(&r, other, strlen(other)), -1);
}

TEST(AgingRecord, JsonEscapesTextsAndListsEveryItem) {
    mmi_aging_record r = sample();
    strcpy(r.lastFailure, "say \"no\"\\\t");
    char json[4096];
    ASSERT_GT(mmi_aging_record_json(&r, "FTX\"1", "v1.0", json, sizeof json), 0);
    const std::string j = json;
    EXPECT_NE(j.find("\"barcode\":\"FTX\\\"1\""), std::string::npos) << j;
    EXPECT_NE(j.find("\"last_failure\":\"say \\\"no\\\"\\\\\\u0009\""), std::string::npos) << j;
    EXPECT_NE(j.find("\"camera\":{\"pass\":1,\"fail\":1}"), std::string::npos) << j;
    EXPECT_NE(j.find("\"reboot\":{\"pass\":1,\"fail\":0}}}"), std::string::npos) << j;
    char small[64];
    EXPECT_EQ(mmi_aging_record_json(&r, "x", "y", small, sizeof small), -1);
}

struct AgingSettings : ::testing::Test {
    TempRoot root;
    void config(const std::string &body) {
        root.write("/etc/ftx_config.ini", "[FTX_AGING]\r\n" + body);
        mmi_AgingTest_ReadConfig();
    }
};

// The camera count survives a read without the key; the others take their no-key values.
TEST_F(AgingSettings, MissingKeysTakeNoKeyValuesAndTheCameraCountStays) {
    config(
        "cameratest=enable:1;times:7;totalnum:3\r\nlighttest=enable:1;time:20\r\n"
        "savedb=enable:1;time:9;SSID:LINE-7\r\nuploadip=10.0.0.2:8080\r\n");
    EXPECT_EQ(g_iCameraTotalNum, 3);
    EXPECT_EQ(g_iAgingLightTime, 20);
    EXPECT_EQ(g_bAging_SaveDb, 1);
    EXPECT_STREQ(g_chAgingSaveDbSsid, "LINE-7");
    EXPECT_STREQ(g_iport, "10.0.0.2:8080");

    config("uploadip=10.0.0.3:1\r\n");
    EXPECT_EQ(g_iCameraTotalNum, 3);
    EXPECT_EQ(g_iAgingCameraTotalNum, 100);
    EXPECT_EQ(g_bAging_LightTest, 0);
    EXPECT_EQ(g_iAgingLightTime, 3);
    EXPECT_EQ(g_bAging_SaveDb, 0);
    EXPECT_EQ(g_iAgingSaveDbTime, 9);  // kept with its network
    EXPECT_STREQ(g_chAgingSaveDbSsid, "LINE-7");
    EXPECT_STREQ(g_iport, "10.0.0.3:1");
    EXPECT_EQ(g_iAgingCycles, 1);
    EXPECT_EQ(g_iAgingTempUpLimit, 550);
    EXPECT_EQ(g_bAging_AudioLoop, 1);

    // An address too long to keep whole is not cut into another one.
    config("savedb=enable:1\r\nuploadip=" + std::string(140, 'a') + ":80\r\n");
    EXPECT_EQ(g_bAging_SaveDb, 0);
    EXPECT_STREQ(g_iport, MMI_AGING_DEFAULT_ENDPOINT);
}

}  // namespace

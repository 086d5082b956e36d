// The catalogue tables and the lists built from them and the configuration.
#include <string.h>

#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "session/mmi_testitem.h"
#include "support/temp_root.h"
#include "unit/config/log_capture.h"
#include "mmi_startup.h"
#include "testwnd/audio/mmi_testwnd_ring.h"
#include "testwnd/display/mmi_testwnd_auxlcdhint.h"
#include "testwnd/display/mmi_testwnd_lcd.h"
#include "testwnd/sensors/mmi_testwnd_sar.h"
#include "testwnd/catalogue.h"

namespace {

// The tables and the list builder are handed in as at start-up.
[[maybe_unused]] const bool kWired = (mmi_startup_wire(), true);

std::vector<std::string> domains(const testitem_node *head) {
    std::vector<std::string> out;
    for (const testitem_node *n = head; n != nullptr; n = n->pNodeNext) {
        out.push_back(n->config_domain);
    }
    return out;
}

const testitem &row(const char *domain) {
    int i = ftx_config_Get_TestItem_Config_Paras(domain);
    EXPECT_GE(i, 0) << domain;
    return TestItemWinMenu_TOTAL[i < 0 ? 0 : i];
}

class Catalogue : public ::testing::Test {
  protected:
    void config(const std::string &content) { root.write("/etc/ftx_config.ini", content); }
    TempRoot root;
};

TEST(CatalogueTables, RowsAsCompiledIn) {
    ASSERT_EQ(38, g_testitemnum_total);
    ASSERT_EQ(5, g_AuxLCD_testitemnum_total);
    ASSERT_EQ(4, g_MonomerPreview_testitemnum_total);
    const testitem &first = TestItemWinMenu_TOTAL[0];
    EXPECT_EQ(1, first.item_num);
    EXPECT_STREQ("title_SimCardTest", first.name);
    EXPECT_STREQ("FTX_SIMCARD", first.config_domain);
    EXPECT_EQ(324, first.item_code);
    const testitem &last = TestItemWinMenu_TOTAL[37];
    EXPECT_STREQ("FTX_AUXLCD_HINT", last.config_domain);
    EXPECT_EQ(&mmi_testwnd_AuxLCDHintTestEntry, last.entry);
    EXPECT_EQ(-1, last.item_code);
    // The loopback row has no stop; the three ringtone rows share one.
    EXPECT_EQ(nullptr, row("FTX_AUDIO_LOOPBACK").stop);
    EXPECT_EQ(&mmi_test_RingtoneTest_Stop_Entry, row("FTX_RTUP").stop);
    EXPECT_EQ(&mmi_test_RingtoneTest_Stop_Entry, row("FTX_RTDOWN").stop);
    EXPECT_EQ(&mmi_testwnd_sar_stop, row("FTX_AuxiliarySAR").stop);
    EXPECT_EQ(376, row("FTX_AuxiliarySAR").item_code);
    EXPECT_STREQ("FTX_TOUCH", AuxLCD_TestItemWinMenu_TOTAL[0].config_domain);
    EXPECT_EQ(320, AuxLCD_TestItemWinMenu_TOTAL[3].item_code);
    EXPECT_STREQ("FTX_MONOMER_HARDVERSION", MonomerPreview_TestItemWinMenu_TOTAL[1].config_domain);
    for (int i = 0; i < g_testitemnum_total; i++) {
        EXPECT_NE(nullptr, TestItemWinMenu_TOTAL[i].entry) << i;
    }
}

TEST(CatalogueTables, RowLookupByDomainPrefix) {
    EXPECT_EQ(32, ftx_config_Get_TestItem_Config_Paras("FTX_VIBRATOR"));
    EXPECT_EQ(8, ftx_config_Get_TestItem_Config_Paras("FTX_HALLSENSOR"));
    EXPECT_EQ(33, ftx_config_Get_TestItem_Config_Paras("FTX_SAR_EXTRA"));
    EXPECT_EQ(-1, ftx_config_Get_TestItem_Config_Paras("FTX_UNKNOWN"));
    EXPECT_EQ(-1, ftx_config_Get_TestItem_Config_Paras("FTX"));
}

TEST_F(Catalogue, ListFollowsTableOrderNotFileOrder) {
    config(
        "[FTX_VIBRATOR]\r\nenable=1\r\nparameter=mode:1\r\n"
        "[FTX_LCD]\r\nenable=1\r\nauto=0\r\nmmi=1\r\npre=0\r\n"
        "[FTX_SIMCARD]\r\nenable=2\r\n"
        "[FTX_KEYS]\r\nauto=1\r\n");
    ASSERT_EQ(0, Get_TestItem_Config(1));
    EXPECT_EQ((std::vector<std::string>{"FTX_SIMCARD", "FTX_LCD", "FTX_VIBRATOR"}),
              domains(g_pTestItemListHead));
    EXPECT_EQ(3, g_testItemListCount);
    const testitem_node *lcd = g_pTestItemListHead->pNodeNext;
    EXPECT_EQ(1, lcd->item_num);  // position in the list, not the compiled-in 4
    EXPECT_EQ(0, lcd->item_auto);
    EXPECT_EQ(1, lcd->item_mmi);
    EXPECT_EQ(0, lcd->item_pre);
    EXPECT_EQ(&mmi_LCDColorTestEntry, lcd->entry);
    EXPECT_STREQ("mode:1", lcd->pNodeNext->parameter);
    // Disabled rows are updated in place too: no enable means disabled, defaults apply.
    EXPECT_EQ(0, row("FTX_KEYS").item_enable);
    EXPECT_EQ(1, row("FTX_KEYS").item_auto);
    EXPECT_EQ(1, row("FTX_KEYS").item_pre);
    EXPECT_EQ(4, row("FTX_LCD").item_num);
}

TEST_F(Catalogue, OnlyTheLcdEnabled) {
    config("[FTX_LCD]\r\nenable=1\r\n");
    ASSERT_EQ(0, Get_TestItem_Config(1));
    EXPECT_EQ((std::vector<std::string>{"FTX_LCD"}), domains(g_pTestItemListHead));
    EXPECT_EQ(0, g_pTestItemListHead->item_num);
}

TEST_F(Catalogue, FileDomainsServeRowsTheyArePrefixesOf) {
    config(
        "[FTX_SAR]\r\nenable=1\r\n[FTX_AuxiliarySAR]\r\nenable=0\r\n"
        "[FTX_HALL]\r\nenable=1\r\n");
    ASSERT_EQ(0, Get_TestItem_Config(1));
    EXPECT_EQ((std::vector<std::string>{"FTX_HALLSENSOR", "FTX_HALL_2ND", "FTX_SAR"}),
              domains(g_pTestItemListHead));
}

TEST_F(Catalogue, FailedPreLookupGivesZeroButFailedAutoGivesOne) {
    // The malformed header breaks every lookup that has not matched before it.
    config("[FTX_SIMCARD]\r\nenable=1\r\n[]\r\nauto=0\r\npre=1\r\n");
    LogCapture log;
    EXPECT_EQ(-1, Get_TestItem_Config(1));
    const testitem &sim = TestItemWinMenu_TOTAL[0];
    EXPECT_EQ(1, sim.item_enable);
    EXPECT_EQ(1, sim.item_auto);
    EXPECT_EQ(0, sim.item_mmi);
    EXPECT_EQ(0, sim.item_pre);
    // The parameter lookup failed too: the build stopped before appending.
    EXPECT_EQ(nullptr, g_pTestItemListHead);
    EXPECT_TRUE(log.has("Read_MainCfgFile Get_CfgValue fail."));
}

TEST_F(Catalogue, ResetForgetsWhileNoResetAppends) {
    config("[FTX_LCD]\r\nenable=1\r\n[FTX_FM]\r\nenable=1\r\n");
    ASSERT_EQ(0, Get_TestItem_Config(1));
    ASSERT_EQ(0, Get_TestItem_Config(0));
    EXPECT_EQ((std::vector<std::string>{"FTX_LCD", "FTX_FM", "FTX_LCD", "FTX_FM"}),
              domains(g_pTestItemListHead));
    EXPECT_EQ(2, g_testItemListCount);
    EXPECT_EQ(0, g_pTestItemListHead->pNodeNext->pNodeNext->item_num);
    ASSERT_EQ(0, Get_TestItem_Config(1));
    EXPECT_EQ((std::vector<std::string>{"FTX_LCD", "FTX_FM"}), domains(g_pTestItemListHead));
}

TEST_F(Catalogue, MissingConfigurationGivesAnEmptyList) {
    EXPECT_EQ(-1, Get_TestItem_Config(1));
    EXPECT_EQ(nullptr, g_pTestItemListHead);
    EXPECT_EQ(0, g_testItemListCount);
}

TEST_F(Catalogue, AuxiliaryAndMonomerBuilds) {
    config(
        "[FTX_TPSELF]\r\nenable=1\r\nmmi=1\r\n[FTX_CAMERA_BACK]\r\nenable=1\r\n"
        "[FTX_MONOMER_LCD]\r\nenable=1\r\nparameter=a:1\r\n");
    LogCapture log;
    ASSERT_EQ(0, Get_AuxLCD_TestItem_Config(1));
    EXPECT_EQ((std::vector<std::string>{"FTX_TPSELF", "FTX_CAMERA_BACK"}),
              domains(g_pTestItemListHead));
    EXPECT_TRUE(log.has("Get_AuxLCD_TestItem_Config domain=FTX_TOUCH"));
    EXPECT_TRUE(log.has("Get_AuxLCD_TestItem_Config TestItemWinMenu[3].item_enable=1"));
    EXPECT_TRUE(log.has("Get_AuxLCD_TestItem_Config domain=FTX_CAMERA_BACK,enable=1,parameter="));
    ASSERT_EQ(0, Get_MonomerPreviewTestItem_Config());
    EXPECT_EQ((std::vector<std::string>{"FTX_TPSELF", "FTX_MONOMER_LCD"}),
              domains(g_pMonomerPreviewListHead));
    EXPECT_EQ(2, g_monomerPreviewListCount);
    // The monomer build reads enable and parameter only.
    EXPECT_EQ(1, AuxLCD_TestItemWinMenu_TOTAL[3].item_mmi);
    EXPECT_EQ(0, MonomerPreview_TestItemWinMenu_TOTAL[0].item_mmi);
    EXPECT_STREQ("a:1", MonomerPreview_TestItemWinMenu_TOTAL[2].parameter);
}

}  // namespace

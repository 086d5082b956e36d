// Handlers reached through the real table: shell lines, the core-device pass-throughs,
// the low-cost mode and the result record command.
#include <string.h>

#include <fstream>
#include <string>

#include <gtest/gtest.h>

#include "adbd_connection/AtCmdTable.h"
#include "adbd_connection/CmdParse.h"
#include "core/ftx_lib_binding.h"
#include "support/temp_root.h"
#include "unit/config/log_capture.h"

namespace {

std::string g_fileParm;
int g_fileLen = -1;
int g_wifiAnswer = 1;
int g_lowCostCalls = 0;
unsigned char g_area[256];

int fake_read(const char *parm, int len) {
    g_fileParm = std::string("read:") + parm;
    g_fileLen = len;
    return 0;
}
int fake_remove(const char *parm, int len, char *reply, unsigned int size) {
    g_fileParm = std::string("remove:") + parm;
    g_fileLen = len;
    snprintf(reply, size, "ERROR no such file");
    return 0;
}
int fake_wifi(void) {
    return g_wifiAnswer;
}
int fake_lowcost(void) {
    return ++g_lowCostCalls;
}
int fake_get(unsigned char *flags) {
    memcpy(flags, g_area, sizeof(g_area));
    return 0;
}
int fake_write(int index, unsigned char value) {
    g_area[index] = value;
    return 0;
}

class Handlers : public ::testing::Test {
  protected:
    void SetUp() override {
        mmi_cmd_registry_clear();
        ASSERT_EQ(0, register_at_procs());
        memset(g_area, 0, sizeof(g_area));
    }
    void TearDown() override {
        mmi_cmd_registry_clear();
        ftx_hw_unbind_all();
    }
    int run(const std::string &line) {
        reply_[0] = '\0';
        return AtCommandProcess(line.c_str(), reply_, sizeof(reply_));
    }
    std::string shell_record() { return root.read("/log/shell.txt"); }

    TempRoot root;
    char reply_[256];
};

TEST_F(Handlers, ShellLinesAnswerSuccessWhateverHappens) {
    root.write("/sys/class/graphics/fb0/blank", "0\n");
    EXPECT_EQ(0, run("LCDTurnoffMoudle testItem"));
    EXPECT_EQ("4", root.read("/sys/class/graphics/fb0/blank").substr(0, 1));
    // /proc/panel_cabc_level_switch does not exist on this handset: still success.
    EXPECT_EQ(0, run("CABCMoudle testItem open"));
    EXPECT_EQ(0, run("CABCMoudle testItem close"));
    std::string shell = shell_record();
    EXPECT_NE(std::string::npos, shell.find("echo 2 > /proc/panel_cabc_level_switch")) << shell;
    EXPECT_NE(std::string::npos, shell.find("echo 0 > /proc/panel_cabc_level_switch")) << shell;
}

TEST_F(Handlers, DataRateParameterNeverReachesTheShellAsCode) {
    EXPECT_EQ(0, run("WiFiDataRate testItem set 11n"));
    EXPECT_NE(std::string::npos, shell_record().find("iwpriv wlan0 dump 11n"));
    for (const char *bad : {"1;touch /data/owned", "$(touch /data/owned)", "`id`", "a|b", "a>b"}) {
        EXPECT_EQ(0, run(std::string("WiFiDataRate testItem set ") + bad)) << bad;
    }
    EXPECT_FALSE(root.exists("/data/owned"));
    EXPECT_EQ(std::string::npos, shell_record().find("owned"));
}

TEST_F(Handlers, CoreDeviceOperationsPassThrough) {
    hw::mmi_AutoTest_FileOpt_Read = fake_read;
    hw::mmi_AutoTest_FileOpt_Remove = fake_remove;
    hw::mmi_AutoTest_WiFiConCpt_Enable = fake_wifi;
    hw::mmi_AutoTest_WiFiConCpt_Disable = fake_wifi;
    EXPECT_EQ(0, run("FileOptMoudle testItem read /data/a.txt,2"));
    EXPECT_EQ("read:/data/a.txt,2", g_fileParm);
    EXPECT_EQ(13, g_fileLen);
    // The file operations answer success even when they failed; the text tells.
    EXPECT_EQ(0, run("FileOptMoudle testItem remove /data/none"));
    EXPECT_EQ("remove:/data/none", g_fileParm);
    EXPECT_STREQ("ERROR no such file", reply_);
    g_wifiAnswer = 1;
    EXPECT_EQ(0, run("WiFiConCptMoudle testItem open"));
    g_wifiAnswer = 0;
    EXPECT_EQ(2, run("WiFiConCptMoudle testItem close"));
}

TEST_F(Handlers, LowCostModeAnswersSuccessBoundOrNot) {
    LogCapture log;
    EXPECT_EQ(0, run("EnterLowCostMode testItem"));
    EXPECT_TRUE(
        log.has("E AtThread: AutoTest_EnterLowCostMode::ftx_api_EnterLostCostMode is NULL."));
    hw::ftx_api_EnterLowCostMode = fake_lowcost;
    EXPECT_EQ(0, run("EnterLowCostMode testItem"));
    EXPECT_EQ(1, g_lowCostCalls);
}

TEST_F(Handlers, TestInfoCommand) {
    hw::ftx_api_GetTestInfoFlag = fake_get;
    hw::ftx_api_WriteFuncTestInfoFlags = fake_write;
    EXPECT_EQ(0, run("testinfoMoudle testItem 5,2,write"));
    EXPECT_EQ(0, run("testinfoMoudle testItem 5,read"));
    EXPECT_STREQ("2", reply_);
    EXPECT_EQ(2, run("testinfoMoudle testItem"));
    EXPECT_EQ(2, run("testinfoMoudle testItem 5,2"));
    // "read" is looked for first.
    EXPECT_EQ(0, run("testinfoMoudle testItem 5,1,write,read"));
    EXPECT_STREQ("2", reply_);
}

}  // namespace

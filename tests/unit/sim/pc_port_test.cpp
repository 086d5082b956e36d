// The PC channel's port setting, shared by the handset's channel and ftx-pc: where it comes
// from, and that only a plain number of 0..65535 is taken.
#include <stdlib.h>

#include <string>

#include <gtest/gtest.h>

#include "ftx_host.h"
#include "pc_port.h"
#include "support/temp_root.h"

namespace {

using ftxsim::pc_port_parse;
using ftxsim::pc_port_setting;

TEST(PcPort, OnlyWholeNumbersInRangeAreTaken) {
    int port = -7;
    for (const char *good :
         {"0", "1", "20051", "65535", " 20051", "20051 ", "20051\r\n", "00080"}) {
        EXPECT_TRUE(pc_port_parse(good, &port)) << '"' << good << '"';
    }
    EXPECT_TRUE(pc_port_parse("00080", &port));
    EXPECT_EQ(port, 80);
    port = -7;
    for (const char *bad : {"100231", "65536", "99999999999", "-1", "+1", "abc", "20051x", "0x50",
                            "2 0051", "", " ", "1e3", "800000"}) {
        EXPECT_FALSE(pc_port_parse(bad, &port)) << '"' << bad << '"';
    }
    EXPECT_EQ(port, -7) << "a refused value leaves the port alone";
    EXPECT_FALSE(pc_port_parse(nullptr, &port));
}

class PcPortSetting : public ::testing::Test {
  protected:
    void SetUp() override { unsetenv("FTX_PC_PORT"); }
    void TearDown() override { unsetenv("FTX_PC_PORT"); }
    void ini(const std::string &pcSection) {
        root_.write("/sim/device.ini", "[screen]\nwidth=720\n" + pcSection);
        ftx_host_reset();
    }
    TempRoot root_;
};

TEST_F(PcPortSetting, EnvironmentFirstThenDeviceIniThenDefault) {
    ini("[pc]\nport=20777\n");
    setenv("FTX_PC_PORT", "31000", 1);
    ftxsim::PcPortSetting s = pc_port_setting();
    EXPECT_TRUE(s.ok);
    EXPECT_EQ(s.port, 31000);
    EXPECT_STREQ(s.source, "FTX_PC_PORT");

    setenv("FTX_PC_PORT", "", 1);  // set but empty counts as unset
    s = pc_port_setting();
    EXPECT_TRUE(s.ok);
    EXPECT_EQ(s.port, 20777);
    EXPECT_STREQ(s.source, "sim/device.ini [pc] port");

    unsetenv("FTX_PC_PORT");
    ini("[network]\nwlan0=lo\n");
    s = pc_port_setting();
    EXPECT_TRUE(s.ok);
    EXPECT_EQ(s.port, ftxsim::kPcDefaultPort);
    EXPECT_STREQ(s.source, "default");
}

TEST_F(PcPortSetting, ABadValueIsRefusedWithItsSourceAndText) {
    ini("[pc]\nport=20777\n");
    setenv("FTX_PC_PORT", "100231", 1);
    ftxsim::PcPortSetting s = pc_port_setting();
    EXPECT_FALSE(s.ok) << "never taken modulo 65536 (34695)";
    EXPECT_STREQ(s.source, "FTX_PC_PORT");
    EXPECT_STREQ(s.text, "100231");

    unsetenv("FTX_PC_PORT");
    for (const char *bad : {"port=abc\n", "port=\n", "port=70000\n"}) {
        ini(std::string("[pc]\n") + bad);
        s = pc_port_setting();
        EXPECT_FALSE(s.ok) << bad;
        EXPECT_STREQ(s.source, "sim/device.ini [pc] port") << bad;
    }
}

}  // namespace

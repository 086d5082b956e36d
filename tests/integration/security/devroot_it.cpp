// The device root holds data only: what a PC client writes into it never runs on the host,
// and no setting or command sends the application's files outside it.
#include <gtest/gtest.h>

#include <filesystem>
#include <string>

#include "support/device_under_test.h"

namespace fs = std::filesystem;

namespace {

TEST(DeviceRoot, AToolRewrittenByThePcNeverRunsOnTheHost) {
    DeviceUnderTest dut;
    ASSERT_TRUE(dut.startToMenu());
    const std::string marker = dut.root() + ".pwned";
    const std::string script = "/system/bin/iwpriv,#!/bin/sh\\ntouch " + marker + "\\n";

    // The system partition is read-only, as on a handset.
    auto w = dut.pc("FileOptMoudle testItem write " + script);
    EXPECT_EQ(0, w.first);
    EXPECT_EQ("ERROR read-only file system", w.second);

    // A configuration write remounts it writable; the file changes, but stays data.
    ASSERT_EQ(0, dut.pc("ConfigMoudle testItem write MMI,StationNote,1").first);
    w = dut.pc("FileOptMoudle testItem write " + script);
    EXPECT_EQ('*', w.second[0]) << w.second;
    EXPECT_EQ("#!/bin/sh\ntouch " + marker + "\n", dut.read("/system/bin/iwpriv"));

    // The next line that names the tool runs the build's own iwpriv.
    EXPECT_EQ(0, dut.pc("WiFiDataRate testItem set 0").first);
    EXPECT_NE(std::string::npos, dut.read("/log/tools.txt").find("iwpriv wlan0 dump 0\n"));
    EXPECT_FALSE(fs::exists(marker));
    fs::remove(marker);
}

TEST(DeviceRoot, APathSettingThatLeavesTheRootIsRefusedWhenRead) {
    for (const char *logPath : {"../escaped/", "/cache/../../escaped/", "cache/ftx"}) {
        SCOPED_TRACE(logPath);
        DeviceUnderTest dut;
        dut.setConfig("MMI", "LogPath", logPath);
        ASSERT_TRUE(dut.startToMenu());
        ASSERT_TRUE(dut.waitLog(std::string("LogPath ") + logPath));
        EXPECT_TRUE(dut.exists("/cache/ftx/ftx.log")) << "the built-in folder is used";
        EXPECT_FALSE(fs::exists(fs::path(dut.root()).parent_path() / "escaped"));
        EXPECT_FALSE(dut.exists("/escaped"));
    }
}

}  // namespace

#include <regex>
#include <string>
#include <vector>

#include <android/log.h>
#include <cutils/properties.h>
#include <gtest/gtest.h>

#include "ftx_host.h"
#include "support/temp_root.h"
#include "tp_os.h"

namespace {

std::vector<std::string> lines_of(const std::string &s) {
    std::vector<std::string> out;
    size_t start = 0;
    while (start < s.size()) {
        size_t nl = s.find('\n', start);
        out.push_back(s.substr(start, nl - start));
        start = nl + 1;
    }
    return out;
}

TEST(AndroidLog, ThreadtimeLinesWithContinuations) {
    TempRoot root;
    __android_log_print(ANDROID_LOG_DEBUG, "DVK_FTX", "%s begin\n", "main");
    __android_log_print(ANDROID_LOG_ERROR, "FTX_CONFIG", "two\nlines");
    auto lines = lines_of(root.read("/log/logcat.txt"));
    ASSERT_EQ(3u, lines.size());
    std::regex threadtime(R"(\d\d-\d\d \d\d:\d\d:\d\d\.\d{3} +\d+ +\d+ D DVK_FTX: main begin)");
    EXPECT_TRUE(std::regex_match(lines[0], threadtime)) << lines[0];
    EXPECT_NE(std::string::npos, lines[1].find(" E FTX_CONFIG: two"));
    EXPECT_NE(std::string::npos, lines[2].find(" E FTX_CONFIG: lines"));
    // The continuation carries the same prefix as its first line.
    EXPECT_EQ(lines[1].substr(0, lines[1].find(" E ")), lines[2].substr(0, lines[2].find(" E ")));
}

TEST(AndroidLog, LevelFloorKeepsTheCaptureComplete) {
    TempRoot root;
    setenv("FTX_LOG_LEVEL", "E", 1);
    ftx_host_reset();
    std::vector<std::string> seen;
    ftx_log_set_capture(
        [](int prio, const char *tag, const char *msg, void *ctx) {
            static_cast<std::vector<std::string> *>(ctx)->push_back(std::to_string(prio) + tag +
                                                                    ":" + msg);
        },
        &seen);
    EXPECT_EQ(0, __android_log_is_loggable(ANDROID_LOG_DEBUG, "T", ANDROID_LOG_VERBOSE));
    EXPECT_EQ(1, __android_log_is_loggable(ANDROID_LOG_ERROR, "T", ANDROID_LOG_VERBOSE));
    __android_log_print(ANDROID_LOG_DEBUG, "T", "quiet");
    __android_log_print(ANDROID_LOG_ERROR, "T", "loud\n");
    ftx_log_set_capture(nullptr, nullptr);
    unsetenv("FTX_LOG_LEVEL");
    EXPECT_EQ((std::vector<std::string>{"3T:quiet", "6T:loud"}), seen);
    auto lines = lines_of(root.read("/log/logcat.txt"));
    ASSERT_EQ(1u, lines.size());
    EXPECT_NE(std::string::npos, lines[0].find("E T: loud"));
}

TEST(Properties, ReadFromTheImageAndSetInMemory) {
    TempRoot root;
    root.write("/sim/properties", "# boot\nro.bootmode=ffbm-99\r\nro.product.locale = zh-CN\n");
    char v[PROPERTY_VALUE_MAX];
    EXPECT_EQ(7, property_get("ro.bootmode", v, "normal"));
    EXPECT_STREQ("ffbm-99", v);
    property_get("missing", v, "normal");
    EXPECT_STREQ("normal", v);
    EXPECT_EQ(0, property_get("missing", v, nullptr));
    EXPECT_STREQ("", v);
    EXPECT_EQ(0, property_set("ftmd.TPstatus", "3"));
    property_get("ftmd.TPstatus", v, "");
    EXPECT_STREQ("3", v);
    EXPECT_EQ(-1, property_set("x", std::string(PROPERTY_VALUE_MAX, 'a').c_str()));
}

TEST(DeviceIni, SectionsKeysAndDefaults) {
    TempRoot root;
    root.write("/sim/device.ini", "[identity]\r\nimei = 8612\r\n[screen]\nwidth=480\nheight=800\n");
    char buf[16];
    EXPECT_EQ(0, ftx_device_ini_get("identity", "imei", buf, sizeof(buf), "x"));
    EXPECT_STREQ("8612", buf);
    EXPECT_EQ(-1, ftx_device_ini_get("identity", "psn", buf, sizeof(buf), "none"));
    EXPECT_STREQ("none", buf);
    EXPECT_EQ(480, ftx_device_ini_get_int("screen", "width", 1));
    EXPECT_EQ(7, ftx_device_ini_get_int("screen", "depth", 7));

    EXPECT_EQ(0, tp_man_lcd_get_info_only());
    EXPECT_EQ(480, g_ptScreenInfo.width);
    EXPECT_EQ(800, g_ptScreenInfo.height);
    setenv("FTX_SCREEN", "320x640", 1);
    EXPECT_EQ(0, tp_man_lcd_get_info_only());
    EXPECT_EQ(320, g_ptScreenInfo.width);
    setenv("FTX_SCREEN", "wide", 1);
    EXPECT_NE(0, tp_man_lcd_get_info_only());
    EXPECT_EQ(480, g_ptScreenInfo.width);
    unsetenv("FTX_SCREEN");
}

TEST(HwRegistry, LinesGoToTheLibraryThatClaimsThem) {
    char reply[64];
    EXPECT_EQ(-1, ftx_host_hw_dispatch("battery level 50", reply, sizeof(reply)));
    EXPECT_STREQ("no hardware", reply);
    ftx_host_register_hw("battery", [](const char *line, char *r, size_t n) {
        if (strncmp(line, "battery", 7) != 0) return -1;
        snprintf(r, n, "level set");
        return 0;
    });
    ftx_host_register_hw("modem", [](const char *line, char *r, size_t n) {
        if (strncmp(line, "modem", 5) != 0) return -1;
        snprintf(r, n, "modem refuses");
        return 1;
    });
    EXPECT_EQ(0, ftx_host_hw_dispatch("battery level 50", reply, sizeof(reply)));
    EXPECT_STREQ("level set", reply);
    EXPECT_EQ(1, ftx_host_hw_dispatch("modem online", reply, sizeof(reply)));
    EXPECT_STREQ("modem refuses", reply);
    EXPECT_EQ(-1, ftx_host_hw_dispatch("camera", reply, sizeof(reply)));
}

}  // namespace

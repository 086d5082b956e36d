#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

#include <filesystem>
#include <map>
#include <regex>
#include <string>
#include <vector>

#include <android/log.h>
#include <cutils/properties.h>
#include <gtest/gtest.h>

#include "ftx_host.h"
#include "support/temp_root.h"
#include "tp_os.h"

namespace ftxhost {
int root_writable(char *why, size_t size);
}

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

// The log folder's ring: logcat.txt.N ... logcat.txt.1 then logcat.txt, with each file's
// size; unset env values are left unset.
class LogRing : public ::testing::Test {
  protected:
    void configure(const char *kb, const char *count) {
        set_or_unset("FTX_LOG_ROTATE_KB", kb);
        set_or_unset("FTX_LOG_ROTATE_COUNT", count);
        ftx_host_reset();
    }
    void TearDown() override { configure(nullptr, nullptr); }

    std::vector<std::string> files() const {
        std::vector<std::string> out;
        for (int i = 99; i >= 1; i--) {
            if (root.exists("/log/logcat.txt." + std::to_string(i)))
                out.push_back("/log/logcat.txt." + std::to_string(i));
        }
        if (root.exists("/log/logcat.txt")) out.push_back("/log/logcat.txt");
        return out;
    }
    std::string all() const {
        std::string out;
        for (const std::string &f : files())
            out += root.read(f);
        return out;
    }
    size_t size_of(const std::string &devicePath) const {
        struct stat st;
        return stat(root.host(devicePath).c_str(), &st) == 0 ? static_cast<size_t>(st.st_size) : 0;
    }
    // The numbers after "line " of every entry, in file order; whole lines only.
    std::vector<int> numbers(const std::string &tag) const {
        std::vector<int> out;
        std::regex entry(R"(\d\d-\d\d [0-9:.]+ +\d+ +\d+ I )" + tag + R"(: line (\d+) x+)");
        for (const std::string &l : lines_of(all())) {
            std::smatch m;
            if (std::regex_match(l, m, entry)) {
                out.push_back(std::stoi(m[1]));
            } else {
                EXPECT_EQ(std::string::npos, l.find(tag + ":")) << "cut entry: " << l;
            }
        }
        return out;
    }
    static void set_or_unset(const char *name, const char *value) {
        if (value != nullptr) {
            setenv(name, value, 1);
        } else {
            unsetenv(name);
        }
    }
    static void log_lines(const char *tag, int from, int to, size_t width) {
        std::string pad(width, 'x');
        for (int i = from; i < to; i++)
            __android_log_print(ANDROID_LOG_INFO, tag, "line %d %s", i, pad.c_str());
    }

    TempRoot root;
};

TEST_F(LogRing, RotatesAtTheSizeAndKeepsTheNewestFiles) {
    configure("1", "2");
    log_lines("RING", 0, 200, 40);  // some 80 bytes an entry, 16 KB in all
    std::vector<std::string> want = {"/log/logcat.txt.2", "/log/logcat.txt.1", "/log/logcat.txt"};
    ASSERT_EQ(want, files());
    for (const std::string &f : files()) {
        EXPECT_LE(size_of(f), 1024u) << f;
        EXPECT_GT(size_of(f), 0u) << f;
    }
    EXPECT_GT(size_of("/log/logcat.txt.1"), 1024u - 100) << "a rotated file is filled first";
    // What is kept is the newest entries, whole and in order, up to the last one.
    std::vector<int> kept = numbers("RING");
    ASSERT_FALSE(kept.empty());
    EXPECT_EQ(199, kept.back());
    for (size_t i = 1; i < kept.size(); i++)
        EXPECT_EQ(kept[i - 1] + 1, kept[i]);
}

TEST_F(LogRing, NoRotatedFilesRestartsTheOneFile) {
    configure("1", "0");
    log_lines("RING", 0, 50, 40);
    ASSERT_EQ(std::vector<std::string>{"/log/logcat.txt"}, files());
    EXPECT_LE(size_of("/log/logcat.txt"), 1024u);
    EXPECT_EQ(49, numbers("RING").back());
}

TEST_F(LogRing, DefaultsAreFourFilesOfFourMegabytes) {
    // Values that are not whole numbers in range count as unset.
    for (auto values : {std::pair<const char *, const char *>{nullptr, nullptr},
                        std::pair<const char *, const char *>{"4k", "-1"},
                        std::pair<const char *, const char *>{"0", "100"}}) {
        SCOPED_TRACE(values.first != nullptr ? values.first : "unset");
        TempRoot fresh;
        configure(values.first, values.second);
        // Entries of some 4 KB: the first rotation comes after about a thousand of them.
        int n = 0;
        while (!fresh.exists("/log/logcat.txt.1") && n < 2000)
            log_lines("RING", n, n + 1, 4000), n++;
        EXPECT_GT(n, 1000);
        EXPECT_LT(n, 1050);
        log_lines("RING", n, n + 4 * 1050, 4000);
        for (int i = 1; i <= 4; i++) {
            std::string f = "/log/logcat.txt." + std::to_string(i);
            struct stat st;
            ASSERT_EQ(0, stat(fresh.host(f).c_str(), &st)) << f;
            EXPECT_LE(st.st_size, 4 << 20);
            EXPECT_GT(st.st_size, (4 << 20) - 4100);
        }
        EXPECT_FALSE(fresh.exists("/log/logcat.txt.5"));
    }
}

TEST_F(LogRing, TwoProcessesWritingOneLogLoseNothingWhileRotating) {
    configure("1", "99");  // room for everything: any missing line was lost by a rotation
    pid_t child = fork();
    if (child == 0) {
        log_lines("CHILD", 0, 150, 30);
        _exit(0);
    }
    log_lines("PARENT", 0, 150, 30);
    int status = 0;
    ASSERT_EQ(child, waitpid(child, &status, 0));
    for (const char *tag : {"PARENT", "CHILD"}) {
        std::map<int, int> seen;
        for (int n : numbers(tag))
            seen[n]++;
        EXPECT_EQ(150u, seen.size()) << tag;
        for (auto &kv : seen)
            EXPECT_EQ(1, kv.second) << tag << " line " << kv.first;
    }
    EXPECT_FALSE(root.exists("/log/logcat.txt.99"));
}

TEST(RootCheck, AWritableRootPassesAndOneThatIsNoFolderFails) {
    TempRoot root;
    root.write("/sim/device.ini", "[pc]\n");
    char why[512] = "";
    EXPECT_EQ(0, ftxhost::root_writable(why, sizeof(why)));
    // The probes leave nothing behind.
    for (const char *dir : {"", "/sim"}) {
        for (const auto &e : std::filesystem::directory_iterator(root.host(dir)))
            EXPECT_EQ(std::string::npos, e.path().string().find("probe")) << e.path();
    }

    // A root that is missing is made, as the log would make it.
    std::string missing = root.path() + "/inner";
    setenv("FTX_ROOT", missing.c_str(), 1);
    ftx_host_reset();
    EXPECT_EQ(0, ftxhost::root_writable(why, sizeof(why)));
    EXPECT_TRUE(std::filesystem::is_directory(missing));

    // A file where the root should be takes no files; the reason names it.
    std::string file = root.path() + "/plain";
    root.write("/plain", "x");
    setenv("FTX_ROOT", file.c_str(), 1);
    ftx_host_reset();
    EXPECT_EQ(-1, ftxhost::root_writable(why, sizeof(why)));
    EXPECT_NE(std::string::npos, std::string(why).find(file)) << why;
    setenv("FTX_ROOT", root.path().c_str(), 1);
    ftx_host_reset();
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

// The application reaches the device only through the platform: no code outside the host
// platform runs shell lines, reboots or opens a device path by itself.
#include <filesystem>
#include <fstream>
#include <regex>
#include <string>
#include <vector>

#include <gtest/gtest.h>

namespace fs = std::filesystem;

namespace {

// Removes comments and the contents of string and character literals, line by line.
std::string code_only(const std::string &line, bool &inBlock) {
    std::string out;
    for (size_t i = 0; i < line.size(); i++) {
        if (inBlock) {
            if (line.compare(i, 2, "*/") == 0) {
                inBlock = false;
                i++;
            }
            continue;
        }
        if (line.compare(i, 2, "//") == 0) break;
        if (line.compare(i, 2, "/*") == 0) {
            inBlock = true;
            i++;
            continue;
        }
        char c = line[i];
        if (c == '"' || c == '\'') {
            out += c;
            for (i++; i < line.size() && line[i] != c; i++) {
                if (line[i] == '\\') i++;
            }
            out += c;
            continue;
        }
        out += c;
    }
    return out;
}

struct Rule {
    std::vector<std::string> folders;
    std::regex pattern;
    const char *what;
};

std::vector<std::string> violations(const fs::path &top, const Rule &rule) {
    std::vector<std::string> found;
    for (const std::string &folder : rule.folders) {
        if (!fs::exists(top / folder)) continue;
        for (const auto &entry : fs::recursive_directory_iterator(top / folder)) {
            std::string ext = entry.path().extension();
            if (ext != ".c" && ext != ".cpp" && ext != ".h" && ext != ".hpp") continue;
            std::ifstream in(entry.path());
            std::string line;
            bool inBlock = false;
            int n = 0;
            while (std::getline(in, line)) {
                n++;
                std::string code = code_only(line, inBlock);
                if (std::regex_search(code, rule.pattern)) {
                    found.push_back(fs::relative(entry.path(), top).string() + ":" +
                                    std::to_string(n) + ": " + rule.what + ": " + line);
                }
            }
        }
    }
    return found;
}

fs::path source_top() {
    const char *dir = getenv("FTX_SOURCE_DIR");
    return dir != nullptr ? fs::path(dir) : fs::path(FTX_SOURCE_DIR_FALLBACK);
}

TEST(PlatformBoundary, NoShellRebootOrDirectDeviceAccessOutsideTheHostPlatform) {
    const fs::path top = source_top();
    ASSERT_TRUE(fs::exists(top / "platform/host")) << top;
    const std::vector<Rule> rules = {
        {{"server", "gui", "log", "sim", "tools", "bench", "platform/include"},
         std::regex(R"((^|[^\w.>:])(::)?(system|popen|reboot)\s*\()"),
         "runs a shell or reboots (use dev_system / dev_reboot)"},
        // The application opens every file by its device path through the platform.
        {{"server", "gui", "log"},
         std::regex(
             R"((^|[^\w.>])(::)?(fopen|open|opendir|access|stat|lstat|mkdir|unlink|remove|rename|truncate|chmod)\s*\()"),
         "opens a path directly (use dev_fopen, dev_open, ...)"},
        {{"server", "gui", "log", "sim", "tools"},
         std::regex(R"((fopen|open|opendir|access|stat|mkdir|unlink)\s*\(\s*"/)"),
         "opens an absolute device path"},
    };
    std::vector<std::string> all;
    for (const Rule &rule : rules) {
        auto v = violations(top, rule);
        all.insert(all.end(), v.begin(), v.end());
    }
    std::string report;
    for (const std::string &s : all)
        report += s + "\n";
    EXPECT_TRUE(all.empty()) << report;
}

TEST(PlatformBoundary, TheCheckSeesWhatItMustForbid) {
    bool inBlock = false;
    std::regex shell(R"((^|[^\w.>:])(::)?(system|popen|reboot)\s*\()");
    EXPECT_TRUE(std::regex_search(code_only("  system(\"reboot\");", inBlock), shell));
    EXPECT_TRUE(std::regex_search(code_only("x = ::popen(cmd, \"r\");", inBlock), shell));
    EXPECT_FALSE(std::regex_search(code_only("dev_system(cmd); // system(x)", inBlock), shell));
    EXPECT_FALSE(std::regex_search(code_only("log(\"system(%s)\");", inBlock), shell));
    EXPECT_FALSE(
        std::regex_search(code_only("dev_reboot(LINUX_REBOOT_CMD_POWER_OFF);", inBlock), shell));
    EXPECT_FALSE(std::regex_search(code_only("/* system( */ x();", inBlock), shell));
}

}  // namespace

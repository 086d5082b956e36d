// The include rules hold on the real tree, and the check finds each kind of broken rule in
// a small tree made for the purpose.
#include "layer_rules.h"

#include <stdlib.h>

#include <fstream>
#include <string>
#include <vector>

#include <gtest/gtest.h>

namespace fs = std::filesystem;

namespace {

class Tree {
  public:
    Tree() {
        char tmpl[] = "/tmp/ftx-layers-XXXXXX";
        top_ = mkdtemp(tmpl);
    }
    ~Tree() {
        std::error_code ec;
        fs::remove_all(top_, ec);
    }
    void file(const std::string &rel, const std::string &text = "") const {
        fs::create_directories((top_ / rel).parent_path());
        std::ofstream(top_ / rel) << text;
    }
    std::vector<std::string> check() const { return layers::violations(top_); }

  private:
    fs::path top_;
};

std::string joined(const std::vector<std::string> &v) {
    std::string s;
    for (const std::string &line : v)
        s += line + "\n";
    return s;
}

// The headers every case can include.
void base(const Tree &t) {
    t.file("gui/mmi_bars.h");
    t.file("log/ftx_log.h");
    t.file("server/core/ftx_config.h");
    t.file("server/session/mmi_autotest.h");
    t.file("server/session/mmi_runstate.h");
    t.file("server/testwnd/mmi_testwnd.h");
    t.file("server/testwnd/misc/mmi_testwnd_vibrator.h");
    t.file("server/testwnd/audio/mmi_testwnd_ring.h");
    t.file("server/hub/mmi_mainwnd.h");
}

TEST(IncludeRules, HoldOnTheApplication) {
    const char *dir = getenv("FTX_SOURCE_DIR");
    fs::path top = dir != nullptr ? fs::path(dir) : fs::path(FTX_TEST_SOURCE_DIR);
    ASSERT_TRUE(fs::exists(top / "server/core"));
    std::vector<std::string> found = layers::violations(top);
    EXPECT_TRUE(found.empty()) << joined(found);
}

TEST(IncludeRules, IncludesDownwardAndWithinTheirAreaPass) {
    Tree t;
    base(t);
    t.file("server/appMain.cpp", "#include \"hub/mmi_mainwnd.h\"\n#include <stdio.h>\n");
    t.file("server/hub/mmi_mainwnd.cpp",
           "#include \"hub/mmi_mainwnd.h\"\n#include \"mmi_bars.h\"\n#include \"ftx_log.h\"\n");
    t.file("server/testwnd/mmi_testwnd.cpp",
           "#include \"session/mmi_runstate.h\"\n#include \"core/ftx_config.h\"\n");
    t.file("server/testwnd/misc/mmi_testwnd_vibrator.cpp",
           "#include \"mmi_testwnd_vibrator.h\"\n#include \"testwnd/mmi_testwnd.h\"\n");
    t.file("server/testwnd/catalogue.cpp",
           "#include \"testwnd/audio/mmi_testwnd_ring.h\"\n"
           "#include \"testwnd/misc/mmi_testwnd_vibrator.h\"\n");
    t.file(
        "server/adbd_connection/handlers/misc.cpp",
        "#include \"testwnd/misc/mmi_testwnd_vibrator.h\"\n#include \"session/mmi_autotest.h\"\n");
    EXPECT_TRUE(t.check().empty()) << joined(t.check());
}

TEST(IncludeRules, EachBrokenRuleIsReportedWithItsPlace) {
    struct Case {
        const char *file;
        const char *text;
        const char *expected;
    } cases[] = {
        {"server/core/mmi_power.cpp", "// title\n#include \"hub/mmi_mainwnd.h\"\n",
         "server/core/mmi_power.cpp:2: includes a higher layer"},
        {"gui/mmi_dialog.cpp", "#include \"core/ftx_config.h\"\n",
         "gui/mmi_dialog.cpp:1: includes a higher layer"},
        {"log/ftx_log.cpp", "  #  include \"session/mmi_runstate.h\"\n",
         "log/ftx_log.cpp:1: includes a higher layer"},
        {"server/testwnd/mmi_testwnd.cpp", "#include \"session/mmi_autotest.h\"\n",
         "server/testwnd/mmi_testwnd.cpp:1: the framework reports a result through the run "
         "interface"},
        {"server/testwnd/misc/mmi_testwnd_vibrator.cpp",
         "#include \"testwnd/audio/mmi_testwnd_ring.h\"\n",
         "includes another test area than its own"},
        {"server/adbd_connection/handlers/audio.cpp",
         "#include \"testwnd/misc/mmi_testwnd_vibrator.h\"\n",
         "includes another test area than its own"},
        {"server/station/mmi_station.cpp", "", "the folder is in no layer"},
    };
    for (const Case &c : cases) {
        Tree t;
        base(t);
        t.file(c.file, c.text);
        std::string report = joined(t.check());
        EXPECT_NE(report.find(c.expected), std::string::npos) << c.file << "\n" << report;
    }
}

}  // namespace

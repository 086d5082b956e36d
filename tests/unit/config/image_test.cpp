// The device image's configuration and language files, read as the handset reads them.
#include <iconv.h>
#include <stdlib.h>
#include <string.h>

#include <filesystem>
#include <fstream>
#include <set>
#include <string>

#include <gtest/gtest.h>

#include "core/ftx_config.h"
#include "core/mmi_settings.h"
#include "session/mmi_testitem.h"
#include "support/temp_root.h"
#include "tp_os.h"
#include "mmi_startup.h"
#include "testwnd/catalogue.h"

extern "C" const TP_I18N_DOMAIN language_domains[];

namespace {

// The tables and the list builder are handed in as at start-up.
[[maybe_unused]] const bool kWired = (mmi_startup_wire(), true);

std::string image_dir() {
    const char *src = getenv("FTX_SOURCE_DIR");
    return std::string(src != nullptr ? src : ".") + "/sim/image";
}

std::string slurp(const std::string &path) {
    std::ifstream in(path, std::ios::binary);
    return std::string((std::istreambuf_iterator<char>(in)), std::istreambuf_iterator<char>());
}

// The key=value lines of one section of a CR LF file, keys only.
std::set<std::string> section_keys(const std::string &file, const std::string &section) {
    std::set<std::string> keys;
    bool inside = false;
    size_t pos = 0;
    while (pos < file.size()) {
        size_t end = file.find("\r\n", pos);
        std::string line = file.substr(pos, end - pos);
        pos = end == std::string::npos ? file.size() : end + 2;
        if (!line.empty() && line[0] == '[') {
            inside = line == "[" + section + "]";
        } else if (inside && line.find('=') != std::string::npos && line[0] != '#') {
            keys.insert(line.substr(0, line.find('=')));
        }
    }
    return keys;
}

class Image : public ::testing::Test {
  protected:
    void SetUp() override {
        for (const char *f : {"/etc/ftx_config.ini", "/etc/ftx_language.ini"}) {
            root.write(f, slurp(image_dir() + f));
        }
    }
    TempRoot root;
};

TEST_F(Image, EveryLineEndsInCrLf) {
    for (const char *f : {"/etc/ftx_config.ini", "/etc/ftx_language.ini"}) {
        std::string text = root.read(f);
        ASSERT_FALSE(text.empty()) << f;
        EXPECT_EQ("\r\n", text.substr(text.size() - 2)) << f;
        for (size_t i = 0; i < text.size(); i++) {
            if (text[i] != '\n') continue;
            ASSERT_EQ('\r', text[i - 1]) << f << " byte " << i;
        }
    }
}

TEST_F(Image, ChineseTextsAreGb18030AndBothLanguagesHaveEveryKey) {
    std::string text = root.read("/etc/ftx_language.ini");
    iconv_t cd = iconv_open("UTF-8", "GB18030");
    ASSERT_NE((iconv_t)-1, cd);
    std::string utf8(text.size() * 2, '\0');
    char *in = text.data(), *out = utf8.data();
    size_t inLeft = text.size(), outLeft = utf8.size();
    EXPECT_NE((size_t)-1, iconv(cd, &in, &inLeft, &out, &outLeft));
    iconv_close(cd);
    EXPECT_NE(std::string::npos, utf8.find("Result_pass=\xe9\x80\x9a\xe8\xbf\x87"));  // 通过
    std::set<std::string> en = section_keys(text, "English"), zh = section_keys(text, "Chinese");
    EXPECT_GT(en.size(), 100u);
    EXPECT_EQ(en, zh);
}

TEST_F(Image, StartUpReadsTheImageAndFindsEveryCatalogueText) {
    ASSERT_EQ(0, mmi_initconfig());
    EXPECT_STREQ("English", g_chLanguageName);
    EXPECT_STREQ("PASS", g_cItemPass);
    EXPECT_STREQ("/cache/ftx/", g_chLogPath);
    EXPECT_STREQ("/sys/class/leds/lcd-backlight/brightness", g_cSysBacklight);
    EXPECT_GT(g_testItemListCount, 10);
    EXPECT_GT(g_monomerPreviewListCount, 0);
    const struct {
        testitem *rows;
        int count;
    } tables[] = {{TestItemWinMenu_TOTAL, g_testitemnum_total},
                  {AuxLCD_TestItemWinMenu_TOTAL, g_AuxLCD_testitemnum_total},
                  {MonomerPreview_TestItemWinMenu_TOTAL, g_MonomerPreview_testitemnum_total}};
    std::string config = root.read("/etc/ftx_config.ini");
    for (const auto &t : tables) {
        for (int i = 0; i < t.count; i++) {
            const testitem &row = t.rows[i];
            char text[FTX_CFG_TEXT_SIZE] = {0};
            EXPECT_EQ(0, Read_LangCfgFromList(row.name, text)) << row.name;
            // Each domain is written out with its enable key.
            EXPECT_TRUE(section_keys(config, row.config_domain).count("enable"))
                << row.config_domain;
        }
    }
}

// The soft-key bar's and battery indicator's built-in texts reach the platform lookup, and
// each language has every key.
TEST(BuiltInTexts, BothDomainsServeTheSameKeys) {
    EXPECT_STREQ("Pass", tp_i18n_get_text("en", "softkeybar_pass"));
    EXPECT_STREQ("\xcd\xa8\xb9\xfd", tp_i18n_get_text("zh", "softkeybar_pass"));
    std::set<std::string> keys[2];
    for (int d = 0; d < 2; d++) {
        ASSERT_NE(nullptr, language_domains[d].name);
        for (const TP_I18N_TEXT *t = language_domains[d].texts; t->key != nullptr; t++) {
            keys[d].insert(t->key);
        }
    }
    EXPECT_EQ(nullptr, language_domains[2].name);
    EXPECT_EQ(keys[0], keys[1]);
}

}  // namespace

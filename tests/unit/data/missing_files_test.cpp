// A configuration or language file that is not there: the settings fall back to their
// defaults, so the start says so at error level and on standard error.
#include <string>

#include <gtest/gtest.h>

#include "core/ftx_config.h"
#include "core/mmi_settings.h"
#include "support/temp_root.h"
#include "unit/config/log_capture.h"

namespace {

const char kConfig[] = "[MMI]\r\nLanguage=English\r\n";
const char kLanguage[] = "[English]\r\nResult_pass=PASS\r\n";

struct Case {
    bool config, language;
    const char *missing;  // the file reported, or null
};

TEST(MissingFiles, EachMissingFileIsReportedOnceAtErrorLevelAndOnStandardError) {
    const Case cases[] = {
        {false, true, FTX_MAIN_CONFIG_FILE},
        {false, false, FTX_MAIN_CONFIG_FILE},  // the start stops at the first
        {true, false, FTX_LANGUAGE_FILE},
        {true, true, nullptr},
    };
    for (const Case &c : cases) {
        SCOPED_TRACE(testing::Message() << "config " << c.config << " language " << c.language);
        TempRoot root;
        if (c.config) root.write(FTX_MAIN_CONFIG_FILE, kConfig);
        if (c.language) root.write(FTX_LANGUAGE_FILE, kLanguage);
        LogCapture log;
        testing::internal::CaptureStderr();
        int rc = mmi_initconfig();
        std::string err = testing::internal::GetCapturedStderr();
        EXPECT_EQ(c.missing == nullptr ? 0 : -1, rc);
        size_t errors = 0;
        for (const std::string &l : log.lines)
            errors += l.rfind("E FTX_CONFIG: mmi_initconfig ", 0) == 0 ? 1 : 0;
        if (c.missing == nullptr) {
            EXPECT_EQ(0u, errors);
            EXPECT_EQ("", err);
            continue;
        }
        std::string host = root.host(c.missing);
        EXPECT_EQ(1u, errors);
        EXPECT_TRUE(log.has(std::string("E FTX_CONFIG: mmi_initconfig ") + c.missing +
                            " is missing (" + host + "): built-in defaults apply"));
        EXPECT_EQ(std::string("ftx-mmi: ") + c.missing + " is missing (" + host +
                      "): built-in defaults apply\n",
                  err);
    }
}

}  // namespace

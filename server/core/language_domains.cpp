// Built-in texts of the soft-key bar and the battery indicator, looked up by the platform's
// tp_i18n_get_text. Everything else on screen comes from /etc/ftx_language.ini. The
// Chinese texts are GB18030 bytes, as the fonts expect.
#include "tp_os.h"

namespace {

const TP_I18N_TEXT kEnglish[] = {
    {"softkeybar_pass", "Pass"},      {"softkeybar_fail", "Fail"},
    {"softkeybar_back", "Back"},      {"softkeybar_ok", "OK"},
    {"softkeybar_cancel", "Cancel"},  {"softkeybar_select", "Select"},
    {"softkeybar_wifi", "WiFi"},      {"battery_charging", "Charging"},
    {"battery_full", "Full"},         {"battery_low", "Low battery"},
    {"battery_absent", "No battery"}, {nullptr, nullptr},
};

// Pass, Fail, Back, OK, Cancel, Select, WiFi, Charging, Full, Low battery, No battery.
const TP_I18N_TEXT kChinese[] = {
    {"softkeybar_pass", "\xcd\xa8\xb9\xfd"},
    {"softkeybar_fail", "\xca\xa7\xb0\xdc"},
    {"softkeybar_back", "\xb7\xb5\xbb\xd8"},
    {"softkeybar_ok", "\xc8\xb7\xb6\xa8"},
    {"softkeybar_cancel", "\xc8\xa1\xcf\xfb"},
    {"softkeybar_select", "\xd1\xa1\xd4\xf1"},
    {"softkeybar_wifi", "WiFi"},
    {"battery_charging", "\xb3\xe4\xb5\xe7\xd6\xd0"},
    {"battery_full", "\xd2\xd1\xb3\xe4\xc2\xfa"},
    {"battery_low", "\xb5\xe7\xc1\xbf\xb5\xcd"},
    {"battery_absent", "\xce\xde\xb5\xe7\xb3\xd8"},
    {nullptr, nullptr},
};

}  // namespace

extern "C" {
extern const TP_I18N_DOMAIN language_domains[];
const TP_I18N_DOMAIN language_domains[] = {
    {"en", kEnglish},
    {"zh", kChinese},
    {nullptr, nullptr},
};
}

// The battery test's pure parts: the factory library's battery text, the item's limits and
// each line's verdict and text.
#include <stddef.h>
#include <string.h>

#include <map>
#include <string>

#include <gtest/gtest.h>

#include "hw/libdvk_ncoredevice.h"
#include "testwnd/battery/mmi_battery_lines.h"

namespace {

// A few words of English, else the key without its prefix ("info_ChargerUSB" is "USB").
void english(const char *key, char *out, size_t size) {
    static const std::map<std::string, std::string> kWords = {
        {"info_BatteryAbove", "above"},      {"info_BatteryBelow", "below"},
        {"info_BatteryNotGood", "not good"}, {"info_BatteryNotCharging", "not charging"},
        {"info_BatteryHealthGood", "good"},  {"info_BatteryHealthDead", "dead"},
    };
    auto it = kWords.find(key);
    std::string text = it != kWords.end() ? it->second : key;
    for (const char *prefix : {"info_Battery", "info_Charger"})
        if (text.rfind(prefix, 0) == 0) text = text.substr(strlen(prefix));
    snprintf(out, size, "%s", text.c_str());
}

const mmi_battery_values kGood = {.level = 80,
                                  .voltage = 3900,
                                  .temperature = 250,
                                  .status = FTX_BATTERY_STATUS_CHARGING,
                                  .health = FTX_BATTERY_HEALTH_GOOD,
                                  .chargersKnown = 1,
                                  .ac = 0,
                                  .usb = 1,
                                  .wireless = 0};

// The good battery with one value changed.
mmi_battery_values with(int mmi_battery_values::*field, int value) {
    mmi_battery_values v = kGood;
    v.*field = value;
    return v;
}

mmi_battery_limits defaults() {
    mmi_battery_limits lim;
    mmi_battery_read_limits(nullptr, nullptr, &lim);
    return lim;
}

// "1 Temperature 25.0 C": the verdict, then the text.
std::string line(int id, const mmi_battery_values &v, const mmi_battery_limits &lim = defaults()) {
    char text[128];
    const int inside = mmi_battery_line(id, &v, &lim, english, text, sizeof text);
    return std::to_string(inside) + " " + text;
}

}  // namespace

TEST(BatteryText, ReadsTheFiveFieldsInAnyOrderAndSkipsOthers) {
    mmi_battery_values v{};
    ASSERT_EQ(0, mmi_battery_parse("level=80;voltage=3900;temperature=250;status=2;health=2", &v));
    EXPECT_EQ(0, memcmp(&v, &kGood, offsetof(mmi_battery_values, chargersKnown)));
    EXPECT_EQ(0, v.chargersKnown);  // the library's text does not name the chargers

    ASSERT_EQ(
        0, mmi_battery_parse(
               "health=3; temperature = -55 ;present=1;;status=4;level=+5;voltage=3300\r\n", &v));
    EXPECT_EQ(-55, v.temperature);
    EXPECT_EQ(5, v.level);
    EXPECT_EQ(3300, v.voltage);
}

TEST(BatteryText, AnythingButFiveWholeNumbersLeavesTheReadingAlone) {
    for (const char *bad : {
             "",
             "level=80;voltage=3900;temperature=250;status=2",  // no health
             "level=80;voltage=3900;temperature=250;status=2;health=",
             "level=8x;voltage=3900;temperature=250;status=2;health=2",
             "level=80;voltage=39 00;temperature=250;status=2;health=2",
             "level=80;voltage=12345678;temperature=250;status=2;health=2",  // eight digits
             "Level=80;voltage=3900;temperature=250;status=2;health=2",      // keys are exact
         }) {
        mmi_battery_values v = kGood;
        EXPECT_EQ(-1, mmi_battery_parse(bad, &v)) << bad;
        EXPECT_EQ(0, memcmp(&kGood, &v, sizeof v)) << bad;
    }
    mmi_battery_values v{};
    EXPECT_EQ(-1, mmi_battery_parse(nullptr, &v));
}

TEST(BatteryLimits, DefaultsUnlessTheItemNamesThem) {
    const mmi_battery_limits d = defaults();
    EXPECT_EQ(0, d.min[MMI_BATTERY_LEVEL]);
    EXPECT_EQ(100, d.max[MMI_BATTERY_LEVEL]);
    EXPECT_EQ(3400, d.min[MMI_BATTERY_VOLTAGE]);
    EXPECT_EQ(4500, d.max[MMI_BATTERY_VOLTAGE]);
    EXPECT_EQ(0, d.min[MMI_BATTERY_TEMPERATURE]);
    EXPECT_EQ(450, d.max[MMI_BATTERY_TEMPERATURE]);

    mmi_battery_limits lim;
    mmi_battery_read_limits(
        [](const char *key, int def, void *) {
            if (strcmp(key, "MinVoltage") == 0) return 3600;
            return strcmp(key, "MaxTemperature") == 0 ? 400 : def;
        },
        nullptr, &lim);
    EXPECT_EQ(3600, lim.min[MMI_BATTERY_VOLTAGE]);
    EXPECT_EQ(4500, lim.max[MMI_BATTERY_VOLTAGE]);
    EXPECT_EQ("0 Temperature 40.1 C above 40.0 C",
              line(MMI_BATTERY_TEMPERATURE, with(&mmi_battery_values::temperature, 401), lim));
}

TEST(BatteryLines, RangesAreInclusiveAndOutsideSaysWhichLimit) {
    const int T = MMI_BATTERY_TEMPERATURE, V = MMI_BATTERY_VOLTAGE;
    EXPECT_EQ("1 Level 80 %", line(MMI_BATTERY_LEVEL, kGood));
    EXPECT_EQ("1 Voltage 3900 mV", line(V, kGood));
    EXPECT_EQ("1 Temperature 45.0 C", line(T, with(&mmi_battery_values::temperature, 450)));
    EXPECT_EQ("0 Temperature 61.0 C above 45.0 C",
              line(T, with(&mmi_battery_values::temperature, 610)));
    EXPECT_EQ("0 Temperature -0.5 C below 0.0 C",
              line(T, with(&mmi_battery_values::temperature, -5)));
    EXPECT_EQ("1 Voltage 3400 mV", line(V, with(&mmi_battery_values::voltage, 3400)));
    EXPECT_EQ("0 Voltage 3399 mV below 3400 mV", line(V, with(&mmi_battery_values::voltage, 3399)));
}

TEST(BatteryLines, HealthMustBeGoodAndTheChargerLineOnlyTells) {
    mmi_battery_values v = kGood;
    EXPECT_EQ("1 Health good", line(MMI_BATTERY_HEALTH, v));
    v.health = FTX_BATTERY_HEALTH_DEAD;
    EXPECT_EQ("0 Health dead (not good)", line(MMI_BATTERY_HEALTH, v));
    v.health = 42;
    EXPECT_EQ("0 Health Unknown (not good)", line(MMI_BATTERY_HEALTH, v));

    EXPECT_EQ("1 Charger USB, Charging", line(MMI_BATTERY_CHARGER, v));
    v.ac = 1;
    v.status = FTX_BATTERY_STATUS_FULL;
    EXPECT_EQ("1 Charger AC+USB, Full", line(MMI_BATTERY_CHARGER, v));
    v.ac = v.usb = 0;
    v.status = FTX_BATTERY_STATUS_NOT_CHARGING;
    EXPECT_EQ("1 Charger None, not charging", line(MMI_BATTERY_CHARGER, v));
    v.chargersKnown = 0;  // the library's own reading: the state alone
    EXPECT_EQ("1 Charger not charging", line(MMI_BATTERY_CHARGER, v));
}

TEST(BatteryLines, NoReadingBadLinesAndShortBuffers) {
    const mmi_battery_limits lim = defaults();
    char text[12];
    EXPECT_EQ(0, mmi_battery_line(MMI_BATTERY_LEVEL, nullptr, &lim, english, text, sizeof text));
    EXPECT_STREQ("Level -", text);
    EXPECT_EQ(0, mmi_battery_line(MMI_BATTERY_LINES, &kGood, &lim, english, text, sizeof text));
    EXPECT_STREQ("", text);
    mmi_battery_values hot = kGood;
    hot.temperature = 610;
    EXPECT_EQ(0, mmi_battery_line(MMI_BATTERY_TEMPERATURE, &hot, &lim, english, text, sizeof text));
    EXPECT_STREQ("Temperature", text);  // cut, and still ended
}

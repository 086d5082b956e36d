// The sensor report reader and the line judges of the sensor windows.
#include <string.h>

#include <string>

#include <gtest/gtest.h>

#include "testwnd/sensors/mmi_sensor_lines.h"

namespace {

mmi_sensor_report parse(const std::string &text) {
    mmi_sensor_report r;
    mmi_sensor_parse(text.c_str(), text.size() + 1, &r);
    return r;
}

// A line of `kind` on the field "x" with the limits lo, hi, fed the reports in turn; its
// done flag after each.
std::string judge(mmi_sensor_kind kind, double lo, double hi,
                  std::initializer_list<const char *> reports, int highIsNear = 0) {
    const mmi_sensor_line_spec spec = {
        .key = "x", .kind = kind, .unit = "", .decimals = 1, .highIsNear = highIsNear};
    mmi_sensor_line l;
    mmi_sensor_line_reset(&l, &spec, lo, hi);
    std::string out;
    for (const char *text : reports) {
        mmi_sensor_report r = parse(text);
        out += std::to_string(mmi_sensor_line_update(&l, &r));
    }
    return out;
}

TEST(SensorReport, ReadsVectorsScalarsAndWords) {
    mmi_sensor_report r = parse("acc=0.10,-0.20,9.80;proxi=5;state=near;result=pass");
    ASSERT_EQ(4, r.count);
    const mmi_sensor_field *acc = mmi_sensor_find(&r, "acc");
    ASSERT_NE(nullptr, acc);
    EXPECT_EQ(3, acc->count);
    EXPECT_DOUBLE_EQ(-0.2, acc->v[1]);
    EXPECT_DOUBLE_EQ(5, mmi_sensor_find(&r, "proxi")->v[0]);
    EXPECT_STREQ("near", mmi_sensor_find(&r, "state")->word);
    EXPECT_DOUBLE_EQ(0, mmi_sensor_find(&r, "state")->v[0]);
    EXPECT_DOUBLE_EQ(1, mmi_sensor_find(&r, "result")->v[0]);
    EXPECT_EQ(nullptr, mmi_sensor_find(&r, "light"));
}

TEST(SensorReport, BadFieldsAreSkippedOrEmpty) {
    // No '=', an empty key, a key too long, a value that is no number, four values.
    mmi_sensor_report r =
        parse("junk;=3;averyveryverylongkeyname=1;light=bright;gyro=1,2,3,4;;pressure=nan");
    EXPECT_EQ(nullptr, mmi_sensor_find(&r, "junk"));
    ASSERT_NE(nullptr, mmi_sensor_find(&r, "light"));
    EXPECT_EQ(0, mmi_sensor_find(&r, "light")->count);
    EXPECT_EQ(3, mmi_sensor_find(&r, "gyro")->count);
    EXPECT_EQ(0, mmi_sensor_find(&r, "pressure")->count);
    // The reader stops at len even without a terminator.
    const char cut[] = {'p', 'r', 'o', 'x', 'i', '=', '7', '9'};
    mmi_sensor_parse(cut, 7, &r);
    EXPECT_DOUBLE_EQ(7, mmi_sensor_find(&r, "proxi")->v[0]);
    EXPECT_EQ(0, mmi_sensor_parse(nullptr, 10, &r));
}

TEST(SensorReport, KeepsAtMostItsFields) {
    std::string many;
    for (int i = 0; i < 20; i++)
        many += "k" + std::to_string(i) + "=" + std::to_string(i) + ";";
    EXPECT_EQ(MMI_SENSOR_FIELDS_MAX, parse(many).count);
}

TEST(SensorLines, EachKindPassesOnlyOnWhatItAsksFor) {
    // At rest on any axis, either way up, within the tolerance.
    EXPECT_EQ("001", judge(MMI_SENSOR_AXIS_G, 0.5, 0, {"x=0,0,0", "x=3,3,3", "x=0,-9.5,0.2"}));
    EXPECT_EQ("0", judge(MMI_SENSOR_AXIS_G, 0.5, 0, {"x=0,0,10.31"}));
    // A vector's length in range; once in range it stays passed.
    EXPECT_EQ("011", judge(MMI_SENSOR_RANGE, 10, 100, {"x=3,4,0", "x=30,40,0", "x=0,0,500"}));
    EXPECT_EQ("01", judge(MMI_SENSOR_ABOVE, 0.5, 0, {"x=0.1,0.1,0.1", "x=0,0.6,0"}));
    // Both sides must be seen, in either order; a value stuck on one side never passes.
    EXPECT_EQ("001", judge(MMI_SENSOR_BOTH_SIDES, 10, 100, {"x=120", "x=50", "x=3"}));
    EXPECT_EQ("000", judge(MMI_SENSOR_BOTH_SIDES, 10, 100, {"x=120", "x=500", "x=120"}));
    EXPECT_EQ("01", judge(MMI_SENSOR_BOTH_SIDES, 0, 1, {"x=far", "x=near"}));
    EXPECT_EQ("01", judge(MMI_SENSOR_RESULT, 0, 0, {"x=fail", "x=pass"}));
    // A magnet must come and then go: far at the start does not count.
    EXPECT_EQ("0001", judge(MMI_SENSOR_COME_GO, 0, 1, {"x=far", "x=near", "x=near", "x=far"}));
    EXPECT_EQ("00", judge(MMI_SENSOR_COME_GO, 0, 1, {"x=far", "x=near"}));
    // A body near a SAR sensor reads high: it must reach Near and fall back to Far.
    EXPECT_EQ("0001", judge(MMI_SENSOR_COME_GO, 100, 500, {"x=0", "x=600", "x=300", "x=90"}, 1));
    EXPECT_EQ("000", judge(MMI_SENSOR_COME_GO, 100, 500, {"x=0", "x=300", "x=0"}, 1));
    // Reports without the line's field leave it as it was.
    EXPECT_EQ("00", judge(MMI_SENSOR_RANGE, 0, 100, {"y=5", "x=bright"}));
}

TEST(SensorLines, ValueTextAndAllDone) {
    const mmi_sensor_line_spec spec = {
        .key = "acc", .kind = MMI_SENSOR_AXIS_G, .unit = "m/s2", .decimals = 2};
    mmi_sensor_line lines[2];
    mmi_sensor_line_reset(&lines[0], &spec, 0.5, 0);
    mmi_sensor_line_reset(&lines[1], &spec, 0.5, 0);
    char text[64];
    mmi_sensor_line_value(&lines[0], text, sizeof(text));
    EXPECT_STREQ("", text);
    mmi_sensor_report r = parse("acc=0.1,-0.2,9.8");
    mmi_sensor_line_update(&lines[0], &r);
    mmi_sensor_line_value(&lines[0], text, sizeof(text));
    EXPECT_STREQ("0.10 -0.20 9.80 m/s2", text);
    char small[8];
    mmi_sensor_line_value(&lines[0], small, sizeof(small));
    EXPECT_STREQ("0.10 -0", small);
    EXPECT_EQ(0, mmi_sensor_lines_done(lines, 2));
    mmi_sensor_line_update(&lines[1], &r);
    EXPECT_EQ(1, mmi_sensor_lines_done(lines, 2));
    EXPECT_EQ(0, mmi_sensor_lines_done(lines, 0));
    // A value that came as a word shows as that word.
    r = parse("acc=near");
    mmi_sensor_line_update(&lines[0], &r);
    mmi_sensor_line_value(&lines[0], text, sizeof(text));
    EXPECT_STREQ("near", text);
}

}  // namespace

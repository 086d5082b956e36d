// The factory library's sensor area: the sensor, Hall, SAR and force-touch tests' reports,
// driven by the library's operations and "hw" lines.
#include <math.h>
#include <stdio.h>
#include <stdlib.h>

#include <chrono>
#include <condition_variable>
#include <deque>
#include <map>
#include <mutex>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "ftx_host.h"
#include "hw/lib_factory.h"
#include "support/temp_root.h"
#include "support/text.h"
#include "support/hw_line.h"

namespace {

const bool kFastTime = setenv("FTX_TIME_SCALE", "0.01", 1) == 0;
constexpr auto kWait = std::chrono::seconds(5);
// Long enough for 25 sensor reports (200 ms each, scaled): what a test watches for silence.
constexpr auto kQuiet = std::chrono::milliseconds(50);

const char kDefaults[] =
    "acc=0.00,0.00,9.80;mag=20.00,-5.00,40.00;gyro=0.00,0.00,0.00;pressure=1013;proxi=5;"
    "light=120;hr=72;hrself=1";

// The sensor area's line of "hw status".
std::string status_line() {
    const std::string s = hw("status");
    const size_t at = s.find("sensors:");
    return at == std::string::npos ? "" : s.substr(at, s.find('\n', at) - at);
}

// The callbacks, each with its own tag.
enum Tag { SENSORS_A, SENSORS_B, HALL1, HALL2, SAR, FORCE, RESULT, MARK };

struct Got {
    int datatype;
    std::string text;
};

struct Events {
    std::mutex lock;
    std::condition_variable cv;
    std::map<int, std::deque<Got>> got;
};
Events g_events;

template <int T>
void collect(module_data *d) {
    std::lock_guard<std::mutex> lk(g_events.lock);
    g_events.got[T].push_back(
        {d->datatype, d->data != nullptr ? std::string(d->data, d->totallen) : ""});
    g_events.cv.notify_all();
}

// The next event of tag, or datatype -1 after kWait.
Got next(int tag) {
    std::unique_lock<std::mutex> lk(g_events.lock);
    std::deque<Got> &q = g_events.got[tag];
    if (!g_events.cv.wait_for(lk, kWait, [&] { return !q.empty(); })) return {-1, ""};
    Got g = q.front();
    q.pop_front();
    return g;
}

// Takes tag's events until one has text holding part; false after kWait.
bool until(int tag, const std::string &part) {
    for (;;) {
        Got g = next(tag);
        if (g.datatype < 0) return false;
        if (has(g.text, part)) return true;
    }
}

// True when tag gets no event for kQuiet.
bool quiet(int tag) {
    std::unique_lock<std::mutex> lk(g_events.lock);
    std::deque<Got> &q = g_events.got[tag];
    return !g_events.cv.wait_for(lk, kQuiet, [&] { return !q.empty(); });
}

void forget(int tag) {
    std::lock_guard<std::mutex> lk(g_events.lock);
    g_events.got[tag].clear();
}

// Returns once the worker has run every job posted before: they come before the marker.
void drain() {
    ASSERT_EQ(ftx_api_FingerPrintTest_Start(collect<MARK>), 0);  // sends nothing by itself
    ASSERT_TRUE(has(hw("finger press"), "sent"));
    ASSERT_EQ(next(MARK).datatype, FTX_DATATYPE_FINGERPRINT);
}

// A sensor report's fields, each value read by strtod to its end; empty when a field is
// missing, out of order or not a number.
std::map<std::string, std::vector<double>> fields(const std::string &text) {
    static const char *const kNames[] = {"acc",   "mag",   "gyro", "pressure",
                                         "proxi", "light", "hr",   "hrself"};
    std::map<std::string, std::vector<double>> out;
    size_t at = 0;
    for (const char *name : kNames) {
        const std::string key = std::string(name) + "=";
        if (text.compare(at, key.size(), key) != 0) return {};
        at += key.size();
        const size_t end = std::min(text.find(';', at), text.size());
        std::string values = text.substr(at, end - at) + ",";
        for (size_t p = 0, comma; (comma = values.find(',', p)) != std::string::npos;
             p = comma + 1) {
            const std::string v = values.substr(p, comma - p);
            char *stop = nullptr;
            const double d = strtod(v.c_str(), &stop);
            if (v.empty() || *stop != '\0') return {};
            out[name].push_back(d);
        }
        at = end + 1;
    }
    return at == text.size() + 1 ? out : std::map<std::string, std::vector<double>>{};
}

// A value of the next sensor report of tag; NAN after kWait.
double next_value(int tag, const char *name, size_t i = 0) {
    Got g = next(tag);
    auto f = fields(g.text);
    return f.count(name) && f[name].size() > i ? f[name][i] : NAN;
}

class SimSensors : public ::testing::Test {
  protected:
    void SetUp() override {
        ASSERT_TRUE(kFastTime);
        stop_all();
        int rc;
        hw("sensor reset", &rc);
        ASSERT_EQ(rc, 0);
        hw("force result pass");
        hw("set ftx_api_Sensors_Calibration default");
        drain();
        std::lock_guard<std::mutex> lk(g_events.lock);
        g_events.got.clear();
    }
    void TearDown() override { stop_all(); }
    static void stop_all() {
        ftx_api_Sensors_Test_Stop();
        ftx_api_HallSensorTest_Stop();
        ftx_api_Hall_2nd_test_Stop();
        ftx_api_sar_stop();
        ftx_api_force_touch_sensor_test_stop();
    }
    TempRoot root_;
};

TEST_F(SimSensors, StartReportsEveryDefaultInItsFormatThenPeriodically) {
    EXPECT_TRUE(has(status_line(),
                    "sensors: acc=0.00,0.00,9.80 mag=20.00,-5.00,40.00 "
                    "gyro=0.00,0.00,0.00 pressure=1013 proxi=5 light=120 hr=72 "
                    "hrself=1 wave=none running=0 hall=far hall2=far "
                    "sar=0 aux=0 force=0 "))
        << status_line();
    EXPECT_EQ(hw("sensor"), status_line() + "\n") << "the same line";
    ASSERT_EQ(ftx_api_Sensors_Test_Start(collect<SENSORS_A>), 0);
    Got first = next(SENSORS_A);
    EXPECT_EQ(first.datatype, FTX_DATATYPE_SENSOR);
    EXPECT_EQ(first.text, kDefaults);
    EXPECT_EQ(fields(first.text)["mag"], (std::vector<double>{20, -5, 40}));
    EXPECT_TRUE(has(status_line(), " running=1 "));
    // Nothing changes, and the reports keep coming.
    for (int i = 0; i < 5; ++i)
        EXPECT_EQ(next(SENSORS_A).text, kDefaults) << i;
}

TEST_F(SimSensors, SetsReachTheCallbackInEitherFormUntilTheStop) {
    ASSERT_EQ(ftx_api_Sensors_Test_Start(collect<SENSORS_A>), 0);
    int rc;
    EXPECT_EQ(hw("sensor acc 1.5,-2,3.25", &rc), "sensor acc 1.50,-2.00,3.25\n");
    EXPECT_EQ(rc, 0);
    EXPECT_TRUE(until(SENSORS_A, "acc=1.50,-2.00,3.25;"));
    hw("sensor mag -0.001 7 1e2", &rc);
    EXPECT_EQ(rc, 0);
    EXPECT_TRUE(until(SENSORS_A, ";mag=0.00,7.00,100.00;")) << "never \"-0.00\"";
    hw("sensor proxi 0");
    hw("sensor pressure 1000.5");
    hw("sensor hrself 0");
    EXPECT_TRUE(until(SENSORS_A, ";pressure=1000.5;proxi=0;light=120;hr=72;hrself=0"));

    ASSERT_EQ(ftx_api_Sensors_Test_Stop(), 0);
    EXPECT_TRUE(has(status_line(), " running=0 "));
    drain();
    forget(SENSORS_A);
    hw("sensor light 5");
    EXPECT_TRUE(quiet(SENSORS_A)) << "neither a periodic report nor a change after the stop";

    // A new start reports to its own callback only; a forced failure starts nothing.
    ASSERT_EQ(ftx_api_Sensors_Test_Start(collect<SENSORS_B>), 0);
    EXPECT_TRUE(until(SENSORS_B, ";light=5;"));
    EXPECT_TRUE(quiet(SENSORS_A));
    ASSERT_EQ(ftx_api_Sensors_Test_Stop(), 0);
    hw("set ftx_api_Sensors_Test_Start -1");
    EXPECT_EQ(ftx_api_Sensors_Test_Start(collect<SENSORS_A>), -1);
    hw("set ftx_api_Sensors_Test_Start default");
    EXPECT_TRUE(quiet(SENSORS_A));
    EXPECT_TRUE(has(status_line(), " running=0 "));
}

TEST_F(SimSensors, AWaveMovesBetweenItsEndsUntilTheNextSet) {
    ASSERT_EQ(ftx_api_Sensors_Test_Start(collect<SENSORS_A>), 0);
    int rc;
    hw("sensor light wave 100 200 4000", &rc);  // 40 ms at this time scale: ~20 reports a wave
    ASSERT_EQ(rc, 0);
    EXPECT_TRUE(has(status_line(), " wave=light "));
    double low = 1e9, high = -1e9;
    bool rose = false, fell = false;
    double last = next_value(SENSORS_A, "light");
    for (int i = 0; i < 2000 && !(low <= 110 && high >= 190 && rose && fell); ++i) {
        const double v = next_value(SENSORS_A, "light");
        ASSERT_GE(v, 100);
        ASSERT_LE(v, 200);
        low = std::min(low, v);
        high = std::max(high, v);
        rose = rose || v > last;
        fell = fell || v < last;
        last = v;
    }
    EXPECT_LE(low, 110);
    EXPECT_GE(high, 190);
    EXPECT_TRUE(rose && fell);

    // A vector's values move together.
    hw("sensor gyro wave 0,0,0 10 -20 30 1000", &rc);
    ASSERT_EQ(rc, 0);
    for (int i = 0; i < 10; ++i) {
        auto f = fields(next(SENSORS_A).text);
        ASSERT_EQ(f["gyro"].size(), 3u);
        EXPECT_NEAR(f["gyro"][1], -2 * f["gyro"][0], 0.03);
        EXPECT_NEAR(f["gyro"][2], 3 * f["gyro"][0], 0.03);
    }
    hw("sensor light 150");
    hw("sensor gyro 1,2,3");
    drain();
    forget(SENSORS_A);
    for (int i = 0; i < 5; ++i)
        EXPECT_TRUE(
            has(next(SENSORS_A).text, "gyro=1.00,2.00,3.00;pressure=1013;proxi=5;light=150;"));
    EXPECT_TRUE(has(status_line(), " wave=none "));
}

TEST_F(SimSensors, CalibrationOffsetsApplyToLaterReports) {
    hw("sensor acc 0.1,-0.2,9.75");
    hw("sensor gyro 0.01 -0.02 0.03");
    char offsets[FTX_SENSOR_OFFSETS_SIZE];
    ASSERT_EQ(ftx_api_Sensors_Calibration(FTX_SENSOR_ACC, offsets, sizeof(offsets)), 0);
    EXPECT_STREQ(offsets, "-0.10,0.20,0.05");
    ASSERT_EQ(ftx_api_Sensors_Calibration(FTX_SENSOR_GYRO, offsets, sizeof(offsets)), 0);
    EXPECT_STREQ(offsets, "-0.01,0.02,-0.03");
    ASSERT_EQ(ftx_api_Sensors_Calibration(FTX_SENSOR_MAG, offsets, sizeof(offsets)), 0);
    EXPECT_STREQ(offsets, "0,0,0");
    for (int sensor :
         {FTX_SENSOR_PRESSURE, FTX_SENSOR_PROXI, FTX_SENSOR_LIGHT, FTX_SENSOR_HEARTRATE}) {
        ASSERT_EQ(ftx_api_Sensors_Calibration(sensor, offsets, sizeof(offsets)), 0) << sensor;
        EXPECT_STREQ(offsets, "0") << sensor;
    }
    EXPECT_TRUE(has(status_line(), " acc=0.10,-0.20,9.75 acc.offset=-0.10,0.20,0.05 mag="))
        << "status shows the raw reading and the offsets";
    EXPECT_TRUE(has(status_line(), " gyro.offset=-0.01,0.02,-0.03 "));

    ASSERT_EQ(ftx_api_Sensors_Test_Start(collect<SENSORS_A>), 0);
    EXPECT_TRUE(
        has(next(SENSORS_A).text, "acc=0.00,0.00,9.80;mag=20.00,-5.00,40.00;gyro=0.00,0.00,0.00;"));
    hw("sensor acc 1,1,1");
    EXPECT_TRUE(until(SENSORS_A, "acc=0.90,1.20,1.05;")) << "raw + offsets";

    // Unknown sensors and a forced failure leave the offsets as they are.
    for (int sensor : {0, 8, -1}) {
        snprintf(offsets, sizeof(offsets), "untouched");
        EXPECT_EQ(ftx_api_Sensors_Calibration(sensor, offsets, sizeof(offsets)), -1) << sensor;
        EXPECT_STREQ(offsets, "") << sensor;
    }
    hw("set ftx_api_Sensors_Calibration -1");
    EXPECT_EQ(ftx_api_Sensors_Calibration(FTX_SENSOR_ACC, offsets, sizeof(offsets)), -1);
    EXPECT_STREQ(offsets, "");
    hw("set ftx_api_Sensors_Calibration default");
    hw("sensor acc 2,2,2");
    EXPECT_TRUE(until(SENSORS_A, "acc=1.90,2.20,2.05;"));
    EXPECT_EQ(ftx_api_Sensors_Calibration(FTX_SENSOR_ACC, nullptr, 0), 0) << "no text asked";
    EXPECT_TRUE(until(SENSORS_A, "acc=0.00,0.00,9.80;"));

    hw("sensor reset");
    EXPECT_TRUE(until(SENSORS_A, kDefaults)) << "the reset ends the offsets";
    EXPECT_FALSE(has(status_line(), ".offset="));
}

TEST_F(SimSensors, HallReportsGoToTheTestOfTheChangedSensor) {
    ASSERT_EQ(ftx_api_HallSensorTest_Start(collect<HALL1>), 0);
    ASSERT_EQ(ftx_api_Hall_2nd_test_start(collect<HALL2>), 0);
    Got first = next(HALL1);
    EXPECT_EQ(first.datatype, FTX_DATATYPE_HALL);
    EXPECT_EQ(first.text, "state=far");
    EXPECT_EQ(next(HALL2).text, "state=far");
    int rc;
    hw("hall near", &rc);
    EXPECT_EQ(rc, 0);
    EXPECT_EQ(next(HALL1).text, "state=near");
    hw("hall 2nd near");
    EXPECT_EQ(next(HALL2).text, "state=near");
    hw("hall 2nd near");  // no change, no report
    hw("hall far");
    EXPECT_EQ(next(HALL1).text, "state=far");
    drain();
    EXPECT_TRUE(quiet(HALL2));
    EXPECT_TRUE(has(status_line(), " hall=far hall2=near "));

    ASSERT_EQ(ftx_api_HallSensorTest_Stop(), 0);
    hw("hall near");
    drain();
    EXPECT_TRUE(quiet(HALL1));
    EXPECT_EQ(ftx_api_HallSensorTest_Start(collect<HALL1>), 0);
    EXPECT_EQ(next(HALL1).text, "state=near") << "a new start reports the state of now";

    EXPECT_EQ(ftx_api_Hall_2nd_calibrate(), 0);
    hw("set ftx_api_Hall_2nd_calibrate -1");
    EXPECT_EQ(ftx_api_Hall_2nd_calibrate(), -1);
    hw("set ftx_api_Hall_2nd_calibrate default");
}

TEST_F(SimSensors, SarAndForceReportTheirValues) {
    ASSERT_EQ(ftx_api_sar_start(collect<SAR>), 0);
    Got first = next(SAR);
    EXPECT_EQ(first.datatype, FTX_DATATYPE_SAR);
    EXPECT_EQ(first.text, "value=0;aux=0");
    hw("sar 12");
    EXPECT_EQ(next(SAR).text, "value=12;aux=0");
    hw("sar aux 7");
    EXPECT_EQ(next(SAR).text, "value=12;aux=7");
    ASSERT_EQ(ftx_api_sar_stop(), 0);
    hw("sar 13");
    drain();
    EXPECT_TRUE(quiet(SAR));

    ASSERT_EQ(ftx_api_force_touch_sensor_test_start(collect<FORCE>), 0);
    first = next(FORCE);
    EXPECT_EQ(first.datatype, FTX_DATATYPE_FORCETOUCH);
    EXPECT_EQ(first.text, "value=0");
    hw("force 350");
    EXPECT_EQ(next(FORCE).text, "value=350");
    EXPECT_EQ(ftx_api_force_touch_sensor_button_down(), 350);
    EXPECT_EQ(ftx_api_force_touch_sensor_button_up(), 0);
    EXPECT_TRUE(has(status_line(), " sar=13 aux=7 force=350 force.result=pass "));
}

TEST_F(SimSensors, ForceResultsFollowTheForceAndTheConsole) {
    hw("force 480");
    ASSERT_EQ(ftx_api_force_touch_calibration_start("", collect<RESULT>), 0);
    Got g = next(RESULT);
    EXPECT_EQ(g.datatype, FTX_DATATYPE_FORCETOUCH);
    EXPECT_EQ(g.text, "result=pass;value=480");
    EXPECT_TRUE(has(status_line(), " force.weight=500")) << "the default weight";
    ASSERT_EQ(ftx_api_force_touch_calibration_start("200", collect<RESULT>), 0);
    EXPECT_EQ(next(RESULT).text, "result=pass;value=480");
    EXPECT_TRUE(has(status_line(), " force.weight=200"));
    for (const char *bad : {"abc", "-5", "0", "12g"}) {
        EXPECT_EQ(ftx_api_force_touch_calibration_start(bad, collect<RESULT>), -1) << bad;
    }
    drain();
    EXPECT_TRUE(quiet(RESULT)) << "a refused weight sends nothing";

    hw("force result fail");
    ASSERT_EQ(ftx_api_force_touch_calibration_start(nullptr, collect<RESULT>), 0);
    EXPECT_EQ(next(RESULT).text, "result=fail;value=480");
    ASSERT_EQ(ftx_api_force_touch_comprehension_start(collect<RESULT>), 0);
    EXPECT_EQ(next(RESULT).text, "result=fail;value=480") << "sticky until changed";
    hw("force result pass");
    ASSERT_EQ(ftx_api_force_touch_comprehension_start(collect<RESULT>), 0);
    EXPECT_EQ(next(RESULT).text, "result=pass;value=480");
    hw("force 0");
    ASSERT_EQ(ftx_api_force_touch_comprehension_start(collect<RESULT>), 0);
    EXPECT_EQ(next(RESULT).text, "result=fail;value=0") << "nothing pressed";
}

TEST_F(SimSensors, BadConsoleLinesChangeNothing) {
    hw("sensor light wave 10 20 1000");
    hw("hall 2nd near");
    hw("sar 4");
    const std::string before = status_line();
    const char *const kBad[] = {
        "sensor foo 1",
        "sensor acc 1,2",
        "sensor acc 1,2,3,4",
        "sensor acc 1,x,3",
        "sensor acc 1,,3",
        "sensor acc 1 2 3,",
        "sensor pressure",
        "sensor pressure abc",
        "sensor light -1",
        "sensor light nan",
        "sensor light inf",
        "sensor light 0x10",
        "sensor light 1e300",
        "sensor hrself 2",
        "sensor hrself 0.5",
        "sensor hrself wave 0 1 100",
        "sensor light wave 1 2 9",
        "sensor light wave 1 2 100.5",
        "sensor light wave 1 2",
        "sensor acc wave 1,2,3 4,5 100",
        "sensor reset now",
        "hall middle",
        "hall 2nd",
        "hall 3rd near",
        "sar -1",
        "sar aux x",
        "sar 1 2",
        "force -5",
        "force result maybe",
        "force 99999999999",
    };
    for (const char *line : kBad) {
        int rc;
        const std::string reply = hw(line, &rc);
        EXPECT_EQ(rc, 1) << line;
        EXPECT_FALSE(reply.empty()) << line << ": a reason or the usage";
    }
    EXPECT_TRUE(has(hw("sensor acc 1,2"), "acc takes 3 values, not 2"));
    EXPECT_TRUE(has(hw("sensor foo 1"), "no sensor \"foo\""));
    // The wave's sample moves between the two reads: compare without it.
    auto without_light = [](std::string s) {
        const size_t at = s.find(" light=");
        return s.erase(at, s.find(' ', at + 1) - at);
    };
    EXPECT_EQ(without_light(status_line()), without_light(before));
    EXPECT_TRUE(has(status_line(), " wave=light "));

    const std::string help = hw("help");
    for (const char *word : {"\nsensor ", "\nhall ", "\nsar ", "\nforce "})
        EXPECT_TRUE(has(help, word)) << word;
}

}  // namespace

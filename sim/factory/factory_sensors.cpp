// Sensor area of the factory model: the sensors (acceleration, magnetic field, gyroscope,
// pressure, proximity, light, heart rate), the two Hall sensors, the SAR readings and the
// force-touch sensor, set from the console, and the reports their tests get from the worker
// thread: at the start, at each change and, for the sensor test, every 200 ms (scaled) until
// the stop. A sensor may follow a triangle wave, sampled at each report; a calibration adds
// offsets to its later reports.
#include <stdio.h>
#include <string.h>

#include <chrono>
#include <condition_variable>
#include <mutex>
#include <string>
#include <thread>

#include "factory_area.h"
#include "sensor_values.h"
#include "tp_os.h"

namespace ftxsim {
namespace {

using Clock = std::chrono::steady_clock;

constexpr int kReportPeriodMs = 200;      // of the sensor test
constexpr int kForceResultDelayMs = 300;  // a force-touch calibration or comprehensive test
constexpr int kDefaultWeight = 500;       // grams, of a calibration given none

// The tests that report by themselves until their stop.
enum StreamId { SENSOR_TEST, HALL1, HALL2, SAR, FORCE_TEST, kStreamCount };
struct StreamKind {
    const char *start;
    const char *stop;
    int datatype;
    const char *name;  // in "hw status"
};
constexpr StreamKind kStreams[kStreamCount] = {
    {"ftx_api_Sensors_Test_Start", "ftx_api_Sensors_Test_Stop", FTX_DATATYPE_SENSOR, "sensors"},
    {"ftx_api_HallSensorTest_Start", "ftx_api_HallSensorTest_Stop", FTX_DATATYPE_HALL, "hall"},
    {"ftx_api_Hall_2nd_test_start", "ftx_api_Hall_2nd_test_Stop", FTX_DATATYPE_HALL, "hall2"},
    {"ftx_api_sar_start", "ftx_api_sar_stop", FTX_DATATYPE_SAR, "sar"},
    {"ftx_api_force_touch_sensor_test_start", "ftx_api_force_touch_sensor_test_stop",
     FTX_DATATYPE_FORCETOUCH, "force"},
};

// The single-event tests of the force-touch sensor.
constexpr const char *kForceResultOps[] = {"ftx_api_force_touch_calibration_start",
                                           "ftx_api_force_touch_comprehension_start"};

struct Reading {
    double raw[kMaxSensorWidth] = {};
    bool waving = false;
    double a[kMaxSensorWidth] = {}, b[kMaxSensorWidth] = {};
    long periodMs = 0;
    Clock::time_point since;
    bool calibrated = false;
    double offset[kMaxSensorWidth] = {};
};

struct Stream {
    ftx_api_module_cb cb = nullptr;  // null: not reporting
    unsigned generation = 0;         // a start or a stop ends what the previous one posted
};

struct Values {
    Reading readings[kSensorCount];
    bool near[2] = {false, false};  // the Hall sensors
    long sar = 0, aux = 0;
    long force = 0;
    bool forceFails = false;
    long weight = kDefaultWeight;  // of the last calibration

    Values() {
        for (int s = 0; s < kSensorCount; ++s)
            for (int i = 0; i < kSensors[s].width; ++i)
                readings[s].raw[i] = kSensors[s].defaults[i];
    }
};

struct Sensors : Values {
    Stream streams[kStreamCount];
    std::condition_variable stopped;  // wakes the sensor test's ticker at a stop
};

Sensors &sensors() {
    return model_part<Sensors>();
}

double scale() {
    return tp_os_time_scale();
}

// ---- the readings (the callers hold model_lock()) ----

// What sensor s reads now, without its offsets.
void raw_now(int s, double *out) {
    const Reading &r = sensors().readings[s];
    const int width = kSensors[s].width;
    if (!r.waving) {
        for (int i = 0; i < width; ++i)
            out[i] = r.raw[i];
        return;
    }
    const double elapsedMs =
        std::chrono::duration<double, std::milli>(Clock::now() - r.since).count() / scale();
    wave_sample(r.a, r.b, width, elapsedMs, r.periodMs, out);
}

std::string sensor_report() {
    std::string text;
    for (int s = 0; s < kSensorCount; ++s) {
        double v[kMaxSensorWidth];
        raw_now(s, v);
        for (int i = 0; i < kSensors[s].width; ++i)
            v[i] += sensors().readings[s].offset[i];
        text += std::string(s > 0 ? ";" : "") + kSensors[s].name + "=" + sensor_text(s, v);
    }
    return text;
}

std::string report(StreamId id) {
    const Sensors &s = sensors();
    switch (id) {
        case SENSOR_TEST:
            return sensor_report();
        case HALL1:
        case HALL2:
            return std::string("state=") + (s.near[id == HALL2] ? "near" : "far");
        case SAR:
            return "value=" + std::to_string(s.sar) + ";aux=" + std::to_string(s.aux);
        default:
            return "value=" + std::to_string(s.force);
    }
}

// Reports stream id's text of now to its callback from the worker, unless a start or a stop
// came in between.
void post_report(StreamId id) {
    const Stream &st = sensors().streams[id];
    if (st.cb == nullptr) return;
    const unsigned generation = st.generation;
    worker().post([id, generation, text = report(id)] {
        ftx_api_module_cb cb;
        {
            std::lock_guard<std::mutex> lock(model_lock());
            const Stream &now = sensors().streams[id];
            if (now.generation != generation || now.cb == nullptr) return;
            cb = now.cb;
        }
        call_back(cb, kStreams[id].datatype, text, true);
    });
}

// The sensor test's periodic reports, until the start or stop after generation.
void ticker(unsigned generation) {
    const auto period = std::chrono::duration_cast<Clock::duration>(
        std::chrono::duration<double, std::milli>(kReportPeriodMs * scale()));
    Sensors &s = sensors();
    std::unique_lock<std::mutex> lk(model_lock());
    auto next = Clock::now() + period;
    auto ended = [&] { return s.streams[SENSOR_TEST].generation != generation; };
    while (!s.stopped.wait_until(lk, next, ended)) {
        post_report(SENSOR_TEST);
        next += period;
        if (next < Clock::now()) next = Clock::now() + period;  // fell behind: no burst
    }
}

void reset_values() {
    static_cast<Values &>(sensors()) = Values{};
}

// This area's part of "hw status".
void state(Reply &r) {
    const Sensors &s = sensors();
    for (int i = 0; i < kSensorCount; ++i) {
        double v[kMaxSensorWidth];
        raw_now(i, v);
        r.add(" %s=%s", kSensors[i].name, sensor_text(i, v).c_str());
        const Reading &reading = s.readings[i];
        if (reading.calibrated)
            r.add(" %s.offset=%s", kSensors[i].name, sensor_text(i, reading.offset).c_str());
    }
    const char *sep = " wave=";
    for (int i = 0; i < kSensorCount; ++i) {
        if (!s.readings[i].waving) continue;
        r.add("%s%s", sep, kSensors[i].name);
        sep = ",";
    }
    if (*sep != ',') r.add(" wave=none");
    r.add(
        " running=%d hall=%s hall2=%s sar=%ld aux=%ld force=%ld force.result=%s "
        "force.weight=%ld",
        s.streams[SENSOR_TEST].cb != nullptr, s.near[0] ? "near" : "far",
        s.near[1] ? "near" : "far", s.sar, s.aux, s.force, s.forceFails ? "fail" : "pass",
        s.weight);
    sep = " reporting=";
    for (int i = 0; i < kStreamCount; ++i) {
        if (s.streams[i].cb == nullptr) continue;
        r.add("%s%s", sep, kStreams[i].name);
        sep = ",";
    }
    if (*sep != ',') r.add(" reporting=none");
}

Event reply(const std::string &op) {
    for (int i = 0; i < kStreamCount; ++i) {
        if (op != kStreams[i].start) continue;
        std::lock_guard<std::mutex> lock(model_lock());
        return {kStreams[i].datatype, report(static_cast<StreamId>(i)), false, 0};
    }
    for (const char *name : kForceResultOps) {
        if (op != name) continue;
        std::lock_guard<std::mutex> lock(model_lock());
        const Sensors &s = sensors();
        const bool pass = !s.forceFails && s.force > 0;
        return {
            FTX_DATATYPE_FORCETOUCH,
            std::string("result=") + (pass ? "pass" : "fail") + ";value=" + std::to_string(s.force),
            false, kForceResultDelayMs};
    }
    return no_event();
}

}  // namespace

void FactoryModel::sensor_listen(const char *op, ftx_api_module_cb cb) {
    std::lock_guard<std::mutex> lock(model_lock());
    Sensors &s = sensors();
    for (int i = 0; i < kStreamCount; ++i) {
        const bool start = strcmp(op, kStreams[i].start) == 0;
        if (!start && strcmp(op, kStreams[i].stop) != 0) continue;
        Stream &st = s.streams[i];
        const unsigned generation = ++st.generation;
        st.cb = start ? cb : nullptr;
        if (i != SENSOR_TEST) return;
        s.stopped.notify_all();
        if (st.cb != nullptr) std::thread(ticker, generation).detach();
        return;
    }
}

int FactoryModel::sensor_answer(int sensor) {
    return sensor_of_number(sensor) >= 0 ? 0 : -1;
}

void FactoryModel::calibrate_sensor(int sensor, char *offsets, size_t size) {
    std::string text;
    const int id = sensor_of_number(sensor);
    if (id >= 0) {
        std::lock_guard<std::mutex> lock(model_lock());
        const SensorKind &k = kSensors[id];
        Reading &r = sensors().readings[id];
        double raw[kMaxSensorWidth];
        raw_now(id, raw);
        for (int i = 0; i < k.width; ++i)
            r.offset[i] = k.calibrates ? k.target[i] - raw[i] : 0;
        r.calibrated = true;
        // A sensor without a calibration target writes its zero offsets as plain zeros.
        text = k.calibrates ? sensor_text(id, r.offset) : k.width == 1 ? "0" : "0,0,0";
    }
    if (offsets != nullptr && size > 0) snprintf(offsets, size, "%s", text.c_str());
}

int FactoryModel::force() {
    std::lock_guard<std::mutex> lock(model_lock());
    return static_cast<int>(sensors().force);
}

int FactoryModel::force_weight(const char *parm) {
    long weight = kDefaultWeight;
    if (parm != nullptr && *parm != '\0' && (!to_int(parm, &weight) || weight <= 0)) return -1;
    std::lock_guard<std::mutex> lock(model_lock());
    sensors().weight = weight;
    return 0;
}

// ---- control words ----
namespace {

// Reports the streams whose values changed from before to the tests that run.
void report_changes(const Values &before) {
    const Sensors &s = sensors();
    for (int i = 0; i < 2; ++i)
        if (before.near[i] != s.near[i]) post_report(i == 0 ? HALL1 : HALL2);
    if (before.sar != s.sar || before.aux != s.aux) post_report(SAR);
    if (before.force != s.force) post_report(FORCE_TEST);
}

int w_sensor(const Args &a, Reply &r) {
    SensorLine line;
    std::string why;
    if (parse_sensor_line(Args(a.begin() + 1, a.end()), &line, &why) != 0) {
        r.add("%s", why.c_str());
        return 1;
    }
    std::lock_guard<std::mutex> lock(model_lock());
    Sensors &s = sensors();
    if (line.what == SensorLine::SHOW) {
        r.add("sensors:");
        state(r);
        return r.done("\n");
    }
    if (line.what == SensorLine::RESET) {
        const Values before = s;
        reset_values();
        report_changes(before);
        post_report(SENSOR_TEST);
        return r.done("sensors reset\n");
    }
    const SensorKind &k = kSensors[line.sensor];
    Reading &reading = s.readings[line.sensor];
    reading.waving = line.what == SensorLine::WAVE;
    for (int i = 0; i < k.width; ++i) {
        reading.raw[i] = line.a[i];
        reading.a[i] = line.a[i];
        reading.b[i] = line.b[i];
    }
    reading.periodMs = line.periodMs;
    reading.since = Clock::now();
    post_report(SENSOR_TEST);
    if (reading.waving) {
        return r.done("sensor %s wave %s to %s in %ld ms\n", k.name,
                      sensor_text(line.sensor, line.a).c_str(),
                      sensor_text(line.sensor, line.b).c_str(), line.periodMs);
    }
    return r.done("sensor %s %s\n", k.name, sensor_text(line.sensor, line.a).c_str());
}

bool near_far(const std::string &w, bool *near) {
    if (w != "near" && w != "far") return false;
    *near = w == "near";
    return true;
}

int w_hall(const Args &a, Reply &r) {
    const bool second = a.size() == 3 && a[1] == "2nd";
    bool near;
    if (a.size() != (second ? 3u : 2u) || !near_far(a.back(), &near)) return 1;
    std::lock_guard<std::mutex> lock(model_lock());
    const Values before = sensors();
    sensors().near[second] = near;
    report_changes(before);
    return r.done("hall%s %s\n", second ? " 2nd" : "", a.back().c_str());
}

// A whole number 0..INT_MAX.
bool count(const std::string &w, long *v) {
    return to_int(w, v) && *v >= 0 && *v <= 0x7fffffff;
}

int w_sar(const Args &a, Reply &r) {
    const bool aux = a.size() == 3 && a[1] == "aux";
    long v;
    if (a.size() != (aux ? 3u : 2u) || !count(a.back(), &v)) return 1;
    std::lock_guard<std::mutex> lock(model_lock());
    const Values before = sensors();
    (aux ? sensors().aux : sensors().sar) = v;
    report_changes(before);
    return r.done("sar%s %ld\n", aux ? " aux" : "", v);
}

int w_force(const Args &a, Reply &r) {
    long v = 0;
    const bool result = a.size() == 3 && a[1] == "result";
    if (result ? (a[2] != "pass" && a[2] != "fail") : (a.size() != 2 || !count(a[1], &v))) return 1;
    std::lock_guard<std::mutex> lock(model_lock());
    if (result) {
        sensors().forceFails = a[2] == "fail";
        return r.done("force results %s\n", a[2].c_str());
    }
    const Values before = sensors();
    sensors().force = v;
    report_changes(before);
    return r.done("force %ld\n", v);
}

}  // namespace

constinit const Area kSensorsArea = {
    .words =
        {
            {"sensor",
             "[NAME V[,V,V] | NAME wave A B PERIOD_MS | reset]  (NAME: acc, mag, gyro, "
             "pressure, proxi, light, hr, hrself; a vector's values separated by commas or "
             "blanks; wave: from A to B and back in PERIOD_MS, until the next set; reset: "
             "every default, hall, SAR and force included, no wave, no offsets)",
             w_sensor},
            {"hall", "[2nd] near|far  (the first or second Hall sensor, default far)", w_hall},
            {"sar", "[aux] N  (the main or auxiliary SAR reading, default 0)", w_sar},
            {"force",
             "GRAMS | result pass|fail  (the force pressed, default 0; the result of the next "
             "calibrations and comprehensive tests, which fail at force 0 too)",
             w_force},
        },
    .reply = reply,
    .state = state,
};

}  // namespace ftxsim

// The words of "hw sensor" as the console gives them: any line is parsed without a crash, a
// refusal has its reason, an accepted line holds values the sensor takes, its wave stays
// between its ends, and the report's text of those values reads back by strtod.
#include <math.h>
#include <stddef.h>
#include <stdint.h>
#include <stdlib.h>

#include <string>
#include <vector>

#include "sensor_values.h"

namespace {

using ftxsim::kSensors;

// Every number of a report's "X,Y,Z" or "V" text reads whole, within rounding of v.
void check_text(int sensor, const double *v) {
    const std::string text = ftxsim::sensor_text(sensor, v);
    size_t at = 0;
    for (int i = 0; i < kSensors[sensor].width; ++i) {
        const size_t comma = text.find(',', at);
        const std::string piece = text.substr(at, comma - at);
        char *end = nullptr;
        const double d = strtod(piece.c_str(), &end);
        if (piece.empty() || *end != '\0' || fabs(d - v[i]) > 0.006) __builtin_trap();
        if (piece.compare(0, 2, "-0") == 0 && d == 0) __builtin_trap();
        at = comma == std::string::npos ? text.size() : comma + 1;
    }
    if (at != text.size()) __builtin_trap();
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t *data, size_t size) {
    std::vector<std::string> words;
    std::string word;
    for (size_t i = 0; i <= size; ++i) {
        const char c = i < size ? static_cast<char>(data[i]) : ' ';
        if (c == ' ' || c == '\t' || c == '\n' || c == '\r') {
            if (!word.empty()) words.push_back(word);
            word.clear();
        } else {
            word += c;
        }
    }
    ftxsim::SensorLine line;
    std::string why;
    if (ftxsim::parse_sensor_line(words, &line, &why) != 0) {
        if (why.empty()) __builtin_trap();
        return 0;
    }
    if (line.what == ftxsim::SensorLine::SHOW || line.what == ftxsim::SensorLine::RESET) {
        if (words.size() > 1) __builtin_trap();
        return 0;
    }
    if (line.sensor < 0 || line.sensor >= ftxsim::kSensorCount) __builtin_trap();
    const ftxsim::SensorKind &k = kSensors[line.sensor];
    const bool wave = line.what == ftxsim::SensorLine::WAVE;
    for (int i = 0; i < k.width; ++i) {
        for (double v : {line.a[i], wave ? line.b[i] : line.a[i]}) {
            if (!(v >= k.low && v <= k.high)) __builtin_trap();
            if (k.flag && v != 0 && v != 1) __builtin_trap();
        }
    }
    check_text(line.sensor, line.a);
    if (!wave) return 0;
    if (k.flag || line.periodMs < ftxsim::kMinWavePeriodMs ||
        line.periodMs > ftxsim::kMaxWavePeriodMs) {
        __builtin_trap();
    }
    const double p = static_cast<double>(line.periodMs);
    for (double t : {0.0, p / 4, p / 2, p * 0.75, p, p * 1e6 + 1, -1.0, nan("")}) {
        double v[ftxsim::kMaxSensorWidth];
        ftxsim::wave_sample(line.a, line.b, k.width, t, line.periodMs, v);
        for (int i = 0; i < k.width; ++i) {
            const double lo = fmin(line.a[i], line.b[i]), hi = fmax(line.a[i], line.b[i]);
            if (!(v[i] >= lo - 1e-9 * (1 + fabs(lo)) && v[i] <= hi + 1e-9 * (1 + fabs(hi))))
                __builtin_trap();
        }
        check_text(line.sensor, v);
    }
    return 0;
}

#include "sensor_values.h"

#include <math.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>

#include "hw/lib_factory.h"

namespace ftxsim {

namespace {
constexpr double kBig = 1e6;  // the largest magnitude a value is set to
}  // namespace

const SensorKind kSensors[kSensorCount] = {
    {"acc", FTX_SENSOR_ACC, 3, {0, 0, 9.8}, -kBig, kBig, false, true, {0, 0, 9.8}},
    {"mag", FTX_SENSOR_MAG, 3, {20, -5, 40}, -kBig, kBig, false, false, {}},
    {"gyro", FTX_SENSOR_GYRO, 3, {0, 0, 0}, -kBig, kBig, false, true, {0, 0, 0}},
    {"pressure", FTX_SENSOR_PRESSURE, 1, {1013}, 0, kBig, false, false, {}},
    {"proxi", FTX_SENSOR_PROXI, 1, {5}, 0, kBig, false, false, {}},
    {"light", FTX_SENSOR_LIGHT, 1, {120}, 0, kBig, false, false, {}},
    {"hr", FTX_SENSOR_HEARTRATE, 1, {72}, 0, kBig, false, false, {}},
    {"hrself", 0, 1, {1}, 0, 1, true, false, {}},
};

int sensor_of_number(int number) {
    for (int s = 0; s < kSensorCount; ++s)
        if (number != 0 && kSensors[s].number == number) return s;
    return -1;
}

namespace {

// A whole plain decimal number: digits, sign, point, exponent; finite.
bool number(const std::string &text, double *v) {
    if (text.empty() || text.find_first_not_of("0123456789+-.eE") != std::string::npos)
        return false;
    char *end = nullptr;
    const double d = strtod(text.c_str(), &end);
    if (end == nullptr || *end != '\0' || !std::isfinite(d)) return false;
    *v = d;
    return true;
}

// The numbers of words[from, to), each word split at commas.
bool numbers(const std::vector<std::string> &words, size_t from, size_t to,
             std::vector<double> *out, std::string *why) {
    for (size_t i = from; i < to; ++i) {
        size_t start = 0;
        for (;;) {
            const size_t comma = words[i].find(',', start);
            const std::string piece = words[i].substr(start, comma - start);
            double v;
            if (!number(piece, &v)) {
                *why = "not a number: \"" + piece + "\"";
                return false;
            }
            out->push_back(v);
            if (comma == std::string::npos) break;
            start = comma + 1;
        }
    }
    return true;
}

// Checks that vs holds count values for sensor s, in its range, and copies them to a and b.
bool take(int s, const std::vector<double> &vs, int count, SensorLine *out, std::string *why) {
    const SensorKind &k = kSensors[s];
    if (vs.size() != static_cast<size_t>(count * k.width)) {
        char text[96];
        snprintf(text, sizeof(text), "%s takes %d value%s, not %zu", k.name, count * k.width,
                 count * k.width > 1 ? "s" : "", vs.size());
        *why = text;
        return false;
    }
    for (size_t i = 0; i < vs.size(); ++i) {
        if (vs[i] < k.low || vs[i] > k.high || (k.flag && vs[i] != 0 && vs[i] != 1)) {
            char text[96];
            if (k.flag) {
                snprintf(text, sizeof(text), "%s is 0 or 1", k.name);
            } else {
                snprintf(text, sizeof(text), "%s values are %s to %s", k.name,
                         sensor_number(k.low, true).c_str(), sensor_number(k.high, true).c_str());
            }
            *why = text;
            return false;
        }
        // The first width values start the wave (or are the values set), the next turn it.
        // Kept as two plain stores: GCC's UBSan instrumentation lost the store through a
        // conditional array expression.
        if (i < static_cast<size_t>(k.width)) {
            out->a[i] = vs[i];
        } else {
            out->b[i - static_cast<size_t>(k.width)] = vs[i];
        }
    }
    return true;
}

}  // namespace

int parse_sensor_line(const std::vector<std::string> &words, SensorLine *out, std::string *why) {
    SensorLine line;
    if (words.empty()) {
        *out = line;
        return 0;
    }
    if (words[0] == "reset") {
        if (words.size() != 1) return *why = "reset takes nothing more", -1;
        line.what = SensorLine::RESET;
        *out = line;
        return 0;
    }
    for (int s = 0; s < kSensorCount; ++s)
        if (words[0] == kSensors[s].name) line.sensor = s;
    if (line.sensor < 0) {
        *why = "no sensor \"" + words[0] + "\" (";
        for (int s = 0; s < kSensorCount; ++s)
            *why += std::string(s > 0 ? ", " : "") + kSensors[s].name;
        *why += ")";
        return -1;
    }
    const SensorKind &k = kSensors[line.sensor];
    std::vector<double> vs;
    if (words.size() >= 2 && words[1] == "wave") {
        if (k.flag) return *why = std::string(k.name) + " takes no wave", -1;
        if (words.size() < 5) return *why = "wave A B PERIOD_MS", -1;
        const std::string &p = words.back();
        char *end = nullptr;
        const long period = strtol(p.c_str(), &end, 10);
        if (p.empty() || p.find_first_not_of("0123456789") != std::string::npos || *end != '\0' ||
            period < kMinWavePeriodMs || period > kMaxWavePeriodMs) {
            char text[96];
            snprintf(text, sizeof(text), "the period is %ld to %ld ms", kMinWavePeriodMs,
                     kMaxWavePeriodMs);
            *why = text;
            return -1;
        }
        if (!numbers(words, 2, words.size() - 1, &vs, why) || !take(line.sensor, vs, 2, &line, why))
            return -1;
        line.what = SensorLine::WAVE;
        line.periodMs = period;
    } else {
        if (!numbers(words, 1, words.size(), &vs, why) || !take(line.sensor, vs, 1, &line, why))
            return -1;
        line.what = SensorLine::SET;
    }
    *out = line;
    return 0;
}

void wave_sample(const double *a, const double *b, int width, double elapsedMs, long periodMs,
                 double *out) {
    double phase = periodMs > 0 ? fmod(elapsedMs, static_cast<double>(periodMs)) / periodMs : 0;
    if (!(phase >= 0 && phase < 1)) phase = 0;  // before the start, or not a number
    const double f = phase < 0.5 ? 2 * phase : 2 - 2 * phase;
    for (int i = 0; i < width; ++i)
        out[i] = a[i] + (b[i] - a[i]) * f;
}

std::string sensor_number(double v, bool trimmed) {
    if (!std::isfinite(v)) v = 0;
    if (fabs(v) < 0.005) v = 0;  // would print as "-0.00"
    char text[400];              // every finite double fits with two decimals
    snprintf(text, sizeof(text), "%.2f", v);
    std::string s = text;
    if (trimmed) {
        while (s.back() == '0')
            s.pop_back();
        if (s.back() == '.') s.pop_back();
    }
    return s;
}

std::string sensor_text(int sensor, const double *v) {
    const SensorKind &k = kSensors[sensor];
    if (k.flag) return v[0] != 0 ? "1" : "0";
    if (k.width == 1) return sensor_number(v[0], true);
    std::string s;
    for (int i = 0; i < k.width; ++i)
        s += (i > 0 ? "," : "") + sensor_number(v[i], false);
    return s;
}

}  // namespace ftxsim

// The simulated sensors' values without the model's state: the table of sensors, the words of
// "hw sensor" that set them, their waves and the numbers of their reports.
#pragma once

#include <stddef.h>

#include <string>
#include <vector>

namespace ftxsim {

constexpr int kMaxSensorWidth = 3;

// The sensors in the order of the report's fields.
enum SensorId { ACC, MAG, GYRO, PRESSURE, PROXI, LIGHT, HR, HRSELF, kSensorCount };

struct SensorKind {
    const char *name;  // its word and its field of the report
    int number;        // FTX_SENSOR_... of its calibration; 0: none
    int width;         // 1 or 3 values
    double defaults[kMaxSensorWidth];
    double low, high;  // the values it takes
    bool flag;         // 0 or 1 only, and never a wave
    bool calibrates;   // a calibration brings the reading to target; else its offsets stay 0
    double target[kMaxSensorWidth];
};

extern const SensorKind kSensors[kSensorCount];

// The sensor of a calibration number, or -1.
int sensor_of_number(int number);

// A "hw sensor" line, parsed.
struct SensorLine {
    enum What { SHOW, SET, WAVE, RESET } what = SHOW;
    int sensor = -1;                 // SET, WAVE
    double a[kMaxSensorWidth] = {};  // the values set, or where the wave starts
    double b[kMaxSensorWidth] = {};  // where the wave turns
    long periodMs = 0;               // WAVE: from a to b and back
};

constexpr long kMinWavePeriodMs = 10;
constexpr long kMaxWavePeriodMs = 3600L * 1000;

// Parses the words after "sensor": none (show), "reset", "NAME V..." or
// "NAME wave A... B... PERIOD_MS". V, A and B are as many numbers as the sensor has values,
// separated by blanks or commas. Returns 0, or -1 with the reason in why.
int parse_sensor_line(const std::vector<std::string> &words, SensorLine *out, std::string *why);

// The triangle wave from a to b and back, period periodMs, elapsedMs after it started.
void wave_sample(const double *a, const double *b, int width, double elapsedMs, long periodMs,
                 double *out);

// A plain decimal number with two decimals ("-0.05"); trimmed, without the trailing zeros
// ("1013", "9.8"). Never "-0".
std::string sensor_number(double v, bool trimmed);

// A sensor's values as its report shows them: "X,Y,Z" with two decimals, one value trimmed,
// the flag 0 or 1.
std::string sensor_text(int sensor, const double *v);

}  // namespace ftxsim

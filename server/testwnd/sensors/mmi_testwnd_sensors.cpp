// The sensor test family.
#include "testwnd/sensors/mmi_testwnd_sensors.h"

#include <stdio.h>
#include <string.h>

#include <android/log.h>

#include "testwnd/sensors/mmi_sensor_window.h"

#define SENSOR_DEBUG(...) __android_log_print(ANDROID_LOG_DEBUG, kTag, __VA_ARGS__)
#define SENSOR_ERROR(...) __android_log_print(ANDROID_LOG_ERROR, kTag, __VA_ARGS__)

namespace {

const char *const kTag = catalogue::Sensor.domain;
// How long a PC read waits for the library's report: 30 x 100 ms.
const int kReadTries = 30;

// The item's parameter turns each sensor on (Acc:1) and may move its limits (DarkLight:10).
// A parameter key answers for every key it begins, so no limit's name begins with a
// sensor's.
const mmi_sensor_line_spec kLines[] = {
    {.key = "acc",
     .labelKey = "sensor_Acc",
     .kind = MMI_SENSOR_AXIS_G,
     .enableParam = "Acc",
     .loParam = "GTolerance",
     .loDef = 0.5,
     .unit = "m/s2",
     .decimals = 2,
     .calibrate = FTX_SENSOR_ACC},
    {.key = "mag",
     .labelKey = "sensor_Mag",
     .kind = MMI_SENSOR_RANGE,
     .enableParam = "Mag",
     .loParam = "MinMag",
     .loDef = 10,
     .hiParam = "MaxMag",
     .hiDef = 100,
     .unit = "uT",
     .decimals = 1},
    {.key = "gyro",
     .labelKey = "sensor_Gyro",
     .kind = MMI_SENSOR_ABOVE,
     .enableParam = "Gyro",
     .loParam = "MinGyro",
     .loDef = 0.5,
     .unit = "rad/s",
     .decimals = 1,
     .calibrate = FTX_SENSOR_GYRO},
    {.key = "pressure",
     .labelKey = "sensor_Pressure",
     .kind = MMI_SENSOR_RANGE,
     .enableParam = "Pressure",
     .loParam = "MinPressure",
     .loDef = 300,
     .hiParam = "MaxPressure",
     .hiDef = 1100,
     .unit = "hPa",
     .decimals = 1},
    {.key = "proxi",
     .labelKey = "sensor_Proxi",
     .kind = MMI_SENSOR_BOTH_SIDES,
     .enableParam = "Proxi",
     .loParam = "NearProxi",
     .loDef = 0,
     .hiParam = "FarProxi",
     .hiDef = 3,
     .unit = "cm",
     .decimals = 1,
     .lowWordKey = "sensor_near",
     .highWordKey = "sensor_far"},
    {.key = "light",
     .labelKey = "sensor_Light",
     .kind = MMI_SENSOR_BOTH_SIDES,
     .enableParam = "Light",
     .loParam = "DarkLight",
     .loDef = 10,
     .hiParam = "BrightLight",
     .hiDef = 100,
     .unit = "lux",
     .decimals = 0,
     .lowWordKey = "sensor_dark",
     .highWordKey = "sensor_bright"},
    {.key = "hr",
     .labelKey = "sensor_HeartRate",
     .kind = MMI_SENSOR_RANGE,
     .enableParam = "HeartRate",
     .loParam = "MinHeartRate",
     .loDef = 40,
     .hiParam = "MaxHeartRate",
     .hiDef = 200,
     .unit = "bpm",
     .decimals = 0,
     .offByDefault = 1},
};

mmi_sensorwnd_state s_state;

int start(ftx_api_module_cb cb) {
    return hw::ftx_api_Sensors_Test_Start ? hw::ftx_api_Sensors_Test_Start(cb) : -1;
}

int stop(void) {
    return hw::ftx_api_Sensors_Test_Stop ? hw::ftx_api_Sensors_Test_Stop() : -1;
}

const mmi_sensorwnd_desc kSensors = {
    .row = &catalogue::Sensor,
    .caption = "Sensor Test",
    .noteKey = "info_SensorNote",
    .lines = kLines,
    .lineCount = (int)(sizeof(kLines) / sizeof(kLines[0])),
    .start = start,
    .stop = stop,
    .callback = sensors_test_callback,
    .state = &s_state,
    .stopEntry = mmi_testwnd_SensorsTest_Stop_Entry,
};

// "*" and the values of one field of a fresh report.
int read_field(const char *key, char *reply, unsigned int size) {
    if (reply != nullptr && size > 0) reply[0] = 0;
    mmi_sensor_report r;
    if (mmi_sensorwnd_fresh_report(&kSensors, &r, kReadTries) != 0) return 0;
    const mmi_sensor_field *f = mmi_sensor_find(&r, key);
    if (f == nullptr || f->count == 0) {
        SENSOR_ERROR("%s::the library reports no %s", __func__, key);
        return 0;
    }
    size_t used = 0;
    if (reply == nullptr || size == 0) return 1;
    used = (size_t)snprintf(reply, size, "*");
    for (int i = 0; i < f->count && used < size; i++) {
        const int n = snprintf(reply + used, size - used, "%s%g", i ? "," : "", f->v[i]);
        if (n < 0) break;
        used += (size_t)n;
    }
    SENSOR_DEBUG("%s::%s %s", __func__, key, reply);
    return 1;
}

}  // namespace

void sensors_test_callback(module_data *data) {
    mmi_sensorwnd_report(&kSensors, data);
}

void *mmi_testwnd_SensorsTestEntry(void) {
    s_state.wnd.pcDriven = 0;
    return mmi_sensorwnd_open(&kSensors);
}

int mmi_testwnd_SensorsTest_Stop_Entry(void) {
    return mmi_sensorwnd_close(&kSensors);
}

int mmi_AutoTest_SensorsTestEntry(char *reply, unsigned int size) {
    if (reply != nullptr && size > 0) reply[0] = 0;
    return mmi_sensorwnd_pc_open(&kSensors);
}

int mmi_AutoTest_SensorsTest_Stop_Entry(char *reply, unsigned int size) {
    const int answer = mmi_sensorwnd_pc_close(&kSensors, reply, size);
    if (answer < 0) {
        SENSOR_ERROR("%s::currentwnd is not created", __func__);
        return 0;
    }
    return answer;
}

int mmi_AutoTest_SensorsTest_Calibrate_Entry(char *reply, unsigned int size) {
    if (reply == nullptr || size == 0) return 0;
    size_t used = (size_t)snprintf(reply, size, "*");
    int all = 1, any = 0;
    ftx_config_para p[MMI_SENSOR_PARAMS_MAX];
    const int n = mmi_sensorwnd_params(&kSensors, p);
    for (const mmi_sensor_line_spec &s : kLines) {
        if (s.calibrate == 0 || !mmi_sensorwnd_line_on(p, n, &s)) continue;
        char offsets[FTX_SENSOR_OFFSETS_SIZE] = {0};
        const int rc = hw::ftx_api_Sensors_Calibration
                           ? hw::ftx_api_Sensors_Calibration(s.calibrate, offsets, sizeof(offsets))
                           : -1;
        SENSOR_DEBUG("%s::%s rc=%d offsets=%s", __func__, s.key, rc, offsets);
        any = 1;
        if (rc != 0) {
            all = 0;
            continue;
        }
        const int n =
            snprintf(reply + used, size - used, "%s%s=%s", used > 1 ? ";" : "", s.key, offsets);
        if (n > 0) used += (size_t)n;
        if (used >= size) break;
    }
    return any && all ? 1 : 0;
}

int mmi_AutoTest_Acc_SensorTestEntry(char *reply, unsigned int size) {
    return read_field("acc", reply, size);
}

int mmi_AutoTest_Mag_SensorTestEntry(char *reply, unsigned int size) {
    return read_field("mag", reply, size);
}

int mmi_AutoTest_Gyro_SensorTestEntry(char *reply, unsigned int size) {
    return read_field("gyro", reply, size);
}

int mmi_AutoTest_Pressure_SensorTestEntry(char *reply, unsigned int size) {
    return read_field("pressure", reply, size);
}

int mmi_AutoTest_Heartrate_SensorTestEntry(char *reply, unsigned int size) {
    return read_field("hr", reply, size);
}

int mmi_read_proximity_start(char *reply, unsigned int size) {
    return read_field("proxi", reply, size);
}

int mmi_read_light_start(char *reply, unsigned int size) {
    return read_field("light", reply, size);
}

int mmi_AutoTest_HeartrateSelfTest_SensorTestEntry(const char *, int, char *reply,
                                                   unsigned int size) {
    if (!read_field("hrself", reply, size)) return 0;
    return reply != nullptr && strcmp(reply, "*1") == 0 ? 1 : 0;
}

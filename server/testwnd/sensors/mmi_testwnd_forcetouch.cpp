// The force-touch family: three windows of the shared sensor window, none of them in the
// catalogue (the station PC runs them).
#include "testwnd/sensors/mmi_testwnd_forcetouch.h"

#include <stdio.h>
#include <string.h>

#include <android/log.h>

#include "devfs.h"
#include "testwnd/sensors/mmi_sensor_window.h"
#include "tp_os.h"

#define FT_DEBUG(...) __android_log_print(ANDROID_LOG_DEBUG, kCalRow.domain, __VA_ARGS__)
#define FT_ERROR(...) __android_log_print(ANDROID_LOG_ERROR, kCalRow.domain, __VA_ARGS__)

namespace {

constexpr mmi_catalogue_row kForceRow{"FORCETOUCH", "title_ForceTouch", -1};
constexpr mmi_catalogue_row kCalRow{"FORCETOUCH_CALI", "title_ForceTouchCalibration", -1};
constexpr mmi_catalogue_row kComprehensiveRow{"FORCETOUCH_CALI", "title_ForceTouchComprehensive",
                                              -1};
// How long the PC waits for a calibration or comprehensive result: 50 x 100 ms.
const int kResultTries = 50;
const char kCalTemp[] = MMI_FORCETOUCH_CAL_FILE ".tmp";

const mmi_sensor_line_spec kForce[] = {
    {.key = "value",
     .labelKey = "sensor_Force",
     .kind = MMI_SENSOR_ABOVE,
     .loParam = "Threshold",
     .loDef = 200,
     .unit = "g",
     .decimals = 0},
};
const mmi_sensor_line_spec kResult[] = {
    {.key = "result",
     .labelKey = "sensor_ForceResult",
     .kind = MMI_SENSOR_RESULT,
     .unit = "g",
     .decimals = 0,
     .lowWordKey = "Result_fail",
     .highWordKey = "Result_pass",
     .extraKey = "value"},
};

mmi_sensorwnd_state s_force, s_cal, s_comprehensive;
// The calibration weight the PC gave, for the window's start (command thread, then GUI).
std::mutex s_weightLock;
char s_weight[64];

int force_start(ftx_api_module_cb cb) {
    return hw::ftx_api_force_touch_sensor_test_start ? hw::ftx_api_force_touch_sensor_test_start(cb)
                                                     : -1;
}
int force_stop(void) {
    return hw::ftx_api_force_touch_sensor_test_stop ? hw::ftx_api_force_touch_sensor_test_stop()
                                                    : -1;
}
int cal_start(ftx_api_module_cb cb) {
    if (!hw::ftx_api_force_touch_calibration_start) return -1;
    char weight[sizeof(s_weight)];
    {
        std::lock_guard<std::mutex> lk(s_weightLock);
        memcpy(weight, s_weight, sizeof(weight));
    }
    return hw::ftx_api_force_touch_calibration_start(weight, cb);
}
int cal_stop(void) {
    return hw::ftx_api_force_touch_calibration_stop ? hw::ftx_api_force_touch_calibration_stop()
                                                    : -1;
}
int comprehensive_start(ftx_api_module_cb cb) {
    return hw::ftx_api_force_touch_comprehension_start
               ? hw::ftx_api_force_touch_comprehension_start(cb)
               : -1;
}
int comprehensive_stop(void) {
    return hw::ftx_api_force_touch_comprehension_stop ? hw::ftx_api_force_touch_comprehension_stop()
                                                      : -1;
}

int close_force(void);
int close_cal(void);
int close_comprehensive(void);

const mmi_sensorwnd_desc kForceTest = {
    .row = &kForceRow,
    .caption = "Force Touch Test",
    .noteKey = "info_ForceTouchNote",
    .lines = kForce,
    .lineCount = 1,
    .bind = init_force_touch_sensor_test_interface,
    .start = force_start,
    .stop = force_stop,
    .callback = force_touch_test_callback,
    .state = &s_force,
    .stopEntry = close_force,
};
const mmi_sensorwnd_desc kCalibration = {
    .row = &kCalRow,
    .caption = "Force Touch Calibration",
    .noteKey = "info_ForceTouchCalNote",
    .lines = kResult,
    .lineCount = 1,
    .bind = init_force_touch_calibration_interface,
    .start = cal_start,
    .stop = cal_stop,
    .callback = force_touch_calibration_callback,
    .state = &s_cal,
    .stopEntry = close_cal,
};
const mmi_sensorwnd_desc kComprehensive = {
    .row = &kComprehensiveRow,
    .caption = "Force Touch Comprehensive Test",
    .noteKey = "info_ForceTouchNote",
    .lines = kResult,
    .lineCount = 1,
    .bind = init_force_touch_calibration_interface,
    .start = comprehensive_start,
    .stop = comprehensive_stop,
    .callback = force_touch_comprehensive_callback,
    .state = &s_comprehensive,
    .stopEntry = close_comprehensive,
};

int close_force(void) {
    return mmi_sensorwnd_close(&kForceTest);
}
int close_cal(void) {
    return mmi_sensorwnd_close(&kCalibration);
}
int close_comprehensive(void) {
    return mmi_sensorwnd_close(&kComprehensive);
}

// Keeps a good calibration's text: written beside the file and renamed over it, so a power
// cut leaves the old result or the new one.
void keep_calibration(const module_data *data) {
    if (data == nullptr || data->data == nullptr) return;
    char text[MMI_SENSOR_REPORT_SIZE];
    const size_t n = data->totallen < sizeof(text) - 1 ? data->totallen : sizeof(text) - 1;
    memcpy(text, data->data, n);
    text[n] = 0;
    mmi_sensor_report r;
    mmi_sensor_parse(text, sizeof(text), &r);
    const mmi_sensor_field *result = mmi_sensor_find(&r, "result");
    if (result == nullptr || strcmp(result->word, "pass") != 0) {
        FT_ERROR("%s::calibration failed: %s", __func__, text);
        return;
    }
    FILE *f = dev_fopen(kCalTemp, "w");
    if (f == nullptr) {
        FT_ERROR("%s::cannot write %s", __func__, kCalTemp);
        return;
    }
    const bool written = fprintf(f, "%s\n", text) > 0;
    const bool closed = fclose(f) == 0;
    if (!written || !closed || dev_rename(kCalTemp, MMI_FORCETOUCH_CAL_FILE) != 0) {
        FT_ERROR("%s::cannot keep the calibration", __func__);
        dev_unlink(kCalTemp);
        return;
    }
    FT_DEBUG("%s::%s", __func__, text);
}

// The PC's open of a result window and its wait for the result: 1 on a pass.
int open_and_wait(const mmi_sensorwnd_desc *d) {
    const unsigned before = mmi_sensorwnd_reports(d);
    if (!mmi_sensorwnd_pc_open(d)) return 0;
    mmi_sensor_report r;
    if (mmi_sensorwnd_wait(d, before, kResultTries, &r) != 0) return 0;
    const mmi_sensor_field *result = mmi_sensor_find(&r, "result");
    return result != nullptr && strcmp(result->word, "pass") == 0 ? 1 : 0;
}

}  // namespace

void force_touch_test_callback(module_data *data) {
    mmi_sensorwnd_report(&kForceTest, data);
}

void force_touch_calibration_callback(module_data *data) {
    keep_calibration(data);
    mmi_sensorwnd_report(&kCalibration, data);
}

void force_touch_comprehensive_callback(module_data *data) {
    mmi_sensorwnd_report(&kComprehensive, data);
}

int mmi_automated_force_touch_sensor_test_entry(void) {
    return mmi_sensorwnd_pc_open(&kForceTest);
}

int mmi_automated_force_touch_sensor_test_stop(void) {
    return mmi_sensorwnd_pc_close(&kForceTest, nullptr, 0) == 1 ? 1 : 0;
}

int mmi_force_touch_sensor_calibration_entry(const char *parm) {
    {
        std::lock_guard<std::mutex> lk(s_weightLock);
        tp_os_strlcpy(s_weight, parm != nullptr ? parm : "", sizeof(s_weight));
    }
    return open_and_wait(&kCalibration);
}

int mmi_force_touch_sensor_calibration_stop(void) {
    mmi_sensorwnd_pc_close(&kCalibration, nullptr, 0);
    return 1;
}

int mmi_force_touch_sensor_calibration_read(const char *, int, char *reply, unsigned int size) {
    if (reply == nullptr || size == 0) return 0;
    reply[0] = 0;
    FILE *f = dev_fopen(MMI_FORCETOUCH_CAL_FILE, "r");
    if (f == nullptr) {
        FT_ERROR("%s::no calibration kept", __func__);
        return 0;
    }
    char line[MMI_SENSOR_REPORT_SIZE] = {0};
    const bool read = fgets(line, sizeof(line), f) != nullptr;
    fclose(f);
    line[strcspn(line, "\r\n")] = 0;
    if (!read || line[0] == 0) return 0;
    snprintf(reply, size, "*%s", line);
    return 1;
}

int mmi_force_touch_sensor_comprehensive_test_entry(const char *) {
    return open_and_wait(&kComprehensive);
}

int mmi_force_touch_sensor_comprehensive_test_stop(const char *) {
    mmi_sensorwnd_pc_close(&kComprehensive, nullptr, 0);
    return 1;
}

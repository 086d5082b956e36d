// The hall sensor test family: the first sensor and the second one, which is calibrated as
// its test starts.
#include "testwnd/sensors/mmi_testwnd_hall.h"

#include <android/log.h>

#include "testwnd/sensors/mmi_sensor_window.h"

namespace {

// The library reports state=near (a magnet) or far.
const mmi_sensor_line_spec kMagnet[] = {
    {.key = "state",
     .labelKey = "sensor_Magnet",
     .kind = MMI_SENSOR_COME_GO,
     .loDef = 0,
     .hiDef = 1,
     .unit = "",
     .decimals = 0,
     .lowWordKey = "sensor_near",
     .highWordKey = "sensor_far"},
};
const int kMagnetLines = 1;

mmi_sensorwnd_state s_first, s_second;

int first_start(ftx_api_module_cb cb) {
    return hw::ftx_api_HallSensorTest_Start ? hw::ftx_api_HallSensorTest_Start(cb) : -1;
}
int first_stop(void) {
    return hw::ftx_api_HallSensorTest_Stop ? hw::ftx_api_HallSensorTest_Stop() : -1;
}

int second_start(ftx_api_module_cb cb) {
    if (!hw::ftx_api_Hall_2nd_test_start) return -1;
    const int rc = hw::ftx_api_Hall_2nd_calibrate ? hw::ftx_api_Hall_2nd_calibrate() : -1;
    __android_log_print(ANDROID_LOG_DEBUG, catalogue::Hall2nd.domain,
                        "ftx_api_Hall_2nd_calibrate rc=%d", rc);
    return hw::ftx_api_Hall_2nd_test_start(cb);
}
int second_stop(void) {
    return hw::ftx_api_Hall_2nd_test_Stop ? hw::ftx_api_Hall_2nd_test_Stop() : -1;
}

const mmi_sensorwnd_desc kFirst = {
    .row = &catalogue::HallSensor,
    .caption = "Hall Sensor Test",
    .noteKey = "info_HallNote",
    .lines = kMagnet,
    .lineCount = kMagnetLines,
    .bind = Init_lib_HallSensor_Interface,
    .start = first_start,
    .stop = first_stop,
    .callback = hallsensor_test_callback,
    .autoPass = 1,
    .state = &s_first,
    .stopEntry = mmi_testwnd_HallSensorTest_Stop_Entry,
};

const mmi_sensorwnd_desc kSecond = {
    .row = &catalogue::Hall2nd,
    .caption = "Hall Sensor 2 Test",
    .noteKey = "info_HallNote",
    .lines = kMagnet,
    .lineCount = kMagnetLines,
    .bind = Init_lib_Hall2nd_Interface,
    .start = second_start,
    .stop = second_stop,
    .callback = hall_2nd_test_callback,
    .autoPass = 1,
    .state = &s_second,
    .stopEntry = mmi_testwnd_HallTest_2nd_Stop_Entry,
};

}  // namespace

void hallsensor_test_callback(module_data *data) {
    mmi_sensorwnd_report(&kFirst, data);
}

void hall_2nd_test_callback(module_data *data) {
    mmi_sensorwnd_report(&kSecond, data);
}

void *mmi_testwnd_HallSensorTestEntry(void) {
    s_first.wnd.pcDriven = 0;
    return mmi_sensorwnd_open(&kFirst);
}

int mmi_testwnd_HallSensorTest_Stop_Entry(void) {
    return mmi_sensorwnd_close(&kFirst);
}

void *mmi_testwnd_HallTest_2nd_TestEntry(void) {
    s_second.wnd.pcDriven = 0;
    return mmi_sensorwnd_open(&kSecond);
}

int mmi_testwnd_HallTest_2nd_Stop_Entry(void) {
    return mmi_sensorwnd_close(&kSecond);
}

int mmi_AutoTest_HallSensorTestEntry(void) {
    return mmi_sensorwnd_pc_open(&kFirst);
}

int mmi_AutoTest_HallSensorTest_Stop_Entry(char *reply, unsigned int size) {
    return mmi_sensorwnd_pc_close(&kFirst, reply, size);
}

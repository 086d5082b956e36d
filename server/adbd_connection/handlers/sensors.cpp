// The sensor, hall and force-touch commands: the sensor window and its single reads and
// calibration, the hall window, and the force-touch windows with the kept calibration.
#include "adbd_connection/handlers/common.h"
#include "adbd_connection/handlers/handlers.h"
#include "testwnd/sensors/mmi_testwnd_forcetouch.h"
#include "testwnd/sensors/mmi_testwnd_hall.h"
#include "testwnd/sensors/mmi_testwnd_sensors.h"

namespace {

// The parameter without its leading blanks.
const char *trimmed(const char *parm) {
    if (parm == nullptr) return "";
    while (*parm == ' ')
        parm++;
    return parm;
}

}  // namespace

#define SENSOR_READER(handler, entry)                                     \
    int handler(const char *, int, char *reply, unsigned int replySize) { \
        at_log_begin(__func__);                                           \
        return entry(reply, replySize);                                   \
    }

SENSOR_READER(AutoTest_sensor_Start, mmi_AutoTest_SensorsTestEntry)
SENSOR_READER(AutoTest_sensor_Calibrate, mmi_AutoTest_SensorsTest_Calibrate_Entry)
SENSOR_READER(AutoTest_sensor_Stop, mmi_AutoTest_SensorsTest_Stop_Entry)
SENSOR_READER(AutoTest_Acc_sensor_Start, mmi_AutoTest_Acc_SensorTestEntry)
SENSOR_READER(AutoTest_Mag_sensor_Start, mmi_AutoTest_Mag_SensorTestEntry)
SENSOR_READER(AutoTest_Gyro_sensor_Start, mmi_AutoTest_Gyro_SensorTestEntry)
SENSOR_READER(AutoTest_Pressure_sensor_Start, mmi_AutoTest_Pressure_SensorTestEntry)
SENSOR_READER(AutoTest_Heartrate_sensor_Start, mmi_AutoTest_Heartrate_SensorTestEntry)
SENSOR_READER(AutotestSensorProxiStart, mmi_read_proximity_start)
SENSOR_READER(AutotestSensorLightStart, mmi_read_light_start)
SENSOR_READER(AutoTest_hallsensor_Stop, mmi_AutoTest_HallSensorTest_Stop_Entry)

int AutoTest_HeartrateSelfTest_sensor_Start(const char *parm, int parmLen, char *reply,
                                            unsigned int replySize) {
    at_log_begin(__func__);
    return mmi_AutoTest_HeartrateSelfTest_SensorTestEntry(parm, parmLen, reply, replySize);
}

int AutoTest_hallsensor_Start(const char *, int, char *, unsigned int) {
    at_log_begin(__func__);
    return mmi_AutoTest_HallSensorTestEntry();
}

int automated_force_touch_test_start(const char *, int, char *, unsigned int) {
    at_log_begin(__func__);
    return mmi_automated_force_touch_sensor_test_entry();
}

int automated_force_touch_test_stop(const char *, int, char *, unsigned int) {
    at_log_begin(__func__);
    return mmi_automated_force_touch_sensor_test_stop();
}

int automated_force_touch_calibration_start(const char *parm, int, char *, unsigned int) {
    at_log_begin(__func__);
    return mmi_force_touch_sensor_calibration_entry(trimmed(parm));
}

int automated_force_touch_calibration_stop(const char *, int, char *, unsigned int) {
    at_log_begin(__func__);
    return mmi_force_touch_sensor_calibration_stop();
}

int automated_force_touch_calibration_read(const char *parm, int parmLen, char *reply,
                                           unsigned int replySize) {
    at_log_begin(__func__);
    return mmi_force_touch_sensor_calibration_read(parm, parmLen, reply, replySize);
}

int automated_force_touch_comprehensive_test_start(const char *parm, int, char *, unsigned int) {
    at_log_begin(__func__);
    return mmi_force_touch_sensor_comprehensive_test_entry(trimmed(parm));
}

int automated_force_touch_comprehensive_test_stop(const char *parm, int, char *, unsigned int) {
    at_log_begin(__func__);
    return mmi_force_touch_sensor_comprehensive_test_stop(trimmed(parm));
}

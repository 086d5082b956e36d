// Sensor area of the factory model: the events the sensor, Hall, fingerprint, SAR and force
// touch tests send when started.
#include <string>

#include "factory_area.h"

namespace ftxsim {
namespace {

Event reply(const std::string &op) {
    if (op == "ftx_api_Sensors_Test_Start") {
        return {
            FTX_DATATYPE_SENSOR,
            "acc=0.0,0.0,9.8;mag=20.0,-5.0,40.0;gyro=0.0,0.0,0.0;pressure=1013;proxi=0;light=120"};
    }
    if (op == "ftx_api_HallSensorTest_Start" || op == "ftx_api_Hall_2nd_test_start") {
        return {FTX_DATATYPE_HALL, "state=near"};
    }
    if (op == "ftx_api_FingerPrintTest_Start") return {FTX_DATATYPE_FINGERPRINT, "result=pass"};
    if (op == "ftx_api_sar_start") return {FTX_DATATYPE_SAR, "value=1"};
    if (op.rfind("ftx_api_force_touch_", 0) == 0) return {FTX_DATATYPE_FORCETOUCH, "value=300"};
    return no_event();
}

}  // namespace

constinit const Area kSensorsArea = {.reply = reply};

}  // namespace ftxsim

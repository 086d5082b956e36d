// PCBA area of the factory model: the events the board tests (CPU, memory, storage, radios,
// battery, cards, touch) send when started.
#include <stdlib.h>

#include <string>

#include "factory_area.h"
#include "ftx_host.h"

namespace ftxsim {
namespace {

// "4GB", "4096MB", "4096" (MB) as megabytes.
long megabytes(const char *text) {
    char *end = nullptr;
    long v = strtol(text, &end, 10);
    if (end != nullptr && (*end == 'G' || *end == 'g')) v *= 1024;
    return v;
}

long identity_mb(const char *key, const char *def) {
    char buf[64];
    ftx_device_ini_get("identity", key, buf, sizeof(buf), def);
    return megabytes(buf);
}

Event reply(const std::string &op) {
    if (op == "ftx_api_cpu_start") return {FTX_DATATYPE_PCBA_CPU, "2000000,1"};
    if (op == "ftx_api_memory_start") {
        return {FTX_DATATYPE_PCBA_MEMORY, std::to_string(identity_mb("ram", "4GB")) + ",1"};
    }
    if (op == "ftx_api_storage_start") {
        return {FTX_DATATYPE_PCBA_STORAGE,
                std::to_string(identity_mb("rom", "64GB") / 1024) + ",1"};
    }
    if (op == "ftx_api_bluetooth_start") return {FTX_DATATYPE_PCBA_BLUETOOTH, "3,1"};
    if (op == "ftx_api_battery_start") {
        return {FTX_DATATYPE_PCBA_BATTERY, std::to_string(get_value("battery.level", 80)) + ",1"};
    }
    if (op == "ftx_api_wifi_start") return {FTX_DATATYPE_PCBA_WIFI, "5,1"};
    if (op == "ftx_api_fm_start") return {FTX_DATATYPE_PCBA_FM, "40,1"};
    if (op == "ftx_api_gps_start") return {FTX_DATATYPE_PCBA_GPS, "8,1"};
    if (op == "ftx_api_sdcard_start") return {FTX_DATATYPE_PCBA_SDCARD, "30436,1"};
    if (op == "ftx_api_sim_start") return {FTX_DATATYPE_PCBA_SIM, "1,1"};
    if (op == "ftx_api_touch_start") return {FTX_DATATYPE_PCBA_TOUCH, "5,1"};
    return no_event();
}

}  // namespace

constinit const Area kPcbaArea = {.reply = reply};

}  // namespace ftxsim

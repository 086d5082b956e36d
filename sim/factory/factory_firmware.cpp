// Firmware area of the factory model: the panel's firmware description the library reports.
#include <stdio.h>

#include <mutex>
#include <string>

#include "factory_area.h"

namespace ftxsim {
namespace {

struct Firmware {
    std::string firmware = "TP IC FT8719, firmware 0x0A, vendor 0x51";
};

Firmware &panel_firmware() {
    return model_part<Firmware>();
}

}  // namespace

void FactoryModel::firmware(char *buf, size_t size) {
    std::lock_guard<std::mutex> lock(model_lock());
    snprintf(buf, size, "%s", panel_firmware().firmware.c_str());
}

// ---- control words ----
namespace {

int w_firmware(const Args &a, Reply &r) {
    if (a.size() < 2) return 1;
    std::lock_guard<std::mutex> lock(model_lock());
    panel_firmware().firmware = rest(a, 1);
    return r.done("firmware set\n");
}

}  // namespace

constinit const Area kFirmwareArea = {
    .words = {{"firmware", "TEXT", w_firmware}},
};

}  // namespace ftxsim

// Light area of the factory model: the three flashlights, the notification LED, the key
// backlight and the all-light switch. The LED shows on the simulated screen as a dot in the
// title strip (the platform draws it into what is shown and into screenshots) in its colour;
// the all-light switch lights it orange, both of its chips, unless a colour was chosen.
#include <string.h>

#include <mutex>
#include <string>

#include "factory_area.h"
#include "ftx_host.h"

namespace ftxsim {
namespace {

struct LedColour {
    const char *name;
    unsigned rgb;
};
const LedColour kLedColours[] = {
    {"red", 0xFF0000},
    {"green", 0x00FF00},
    {"orange", 0xFF8000},
};
const int kOrange = 2;

// Flashlight numbers FTX_FLASHLIGHT_BACK, _FRONT, _BACK2, as "hw lights" names them.
const char *const kFlashNames[] = {"back", "front", "back2"};
const int kFlashlights = 3;

struct Lights {
    bool flash[kFlashlights] = {};
    int led = -1;  // index into kLedColours, -1 off
    bool keyBacklight = false;
    bool all = false;
    int linkAtAll = -1;  // the Wi-Fi-to-PC link when the all-light switch went on; -1 unknown
};

Lights &lights() {
    return model_part<Lights>();
}

// The dot follows the LED (under model_lock()).
void show_led() {
    const Lights &l = lights();
    int colour = l.led >= 0 ? l.led : (l.all ? kOrange : -1);
    ftx_host_set_indicator(colour >= 0 ? 1 : 0, colour >= 0 ? kLedColours[colour].rgb : 0);
}

const char *on_off_word(bool on) {
    return on ? "on" : "off";
}

// This area's part of "hw status", also the answer of "hw lights".
void state(Reply &r) {
    const Lights &l = lights();
    r.add(" back=%s back2=%s front=%s led=%s keybacklight=%s all=%s",
          on_off_word(l.flash[FTX_FLASHLIGHT_BACK]), on_off_word(l.flash[FTX_FLASHLIGHT_BACK2]),
          on_off_word(l.flash[FTX_FLASHLIGHT_FRONT]), l.led >= 0 ? kLedColours[l.led].name : "off",
          on_off_word(l.keyBacklight), on_off_word(l.all));
    if (l.all) r.add(" link_at_all=%s", l.linkAtAll < 0 ? "-" : on_off_word(l.linkAtAll != 0));
}

int w_lights(const Args &a, Reply &r) {
    std::lock_guard<std::mutex> lock(model_lock());
    if (a.size() == 2 && a[1] == "reset") {
        lights() = Lights{};
        show_led();
    } else if (a.size() != 1) {
        return 1;
    }
    r.add("lights:");
    state(r);
    return r.done("\n");
}

}  // namespace

int FactoryModel::set_flashlight(int flashlight, bool on) {
    if (flashlight < 0 || flashlight >= kFlashlights) return -1;
    std::lock_guard<std::mutex> lock(model_lock());
    lights().flash[flashlight] = on;
    return 0;
}

int FactoryModel::set_led(const char *colour) {
    std::lock_guard<std::mutex> lock(model_lock());
    int found = -1;
    for (int i = 0; colour != nullptr && i < static_cast<int>(std::size(kLedColours)); i++)
        if (strcmp(colour, kLedColours[i].name) == 0) found = i;
    if (colour != nullptr && found < 0) return -1;
    lights().led = found;
    show_led();
    return 0;
}

void FactoryModel::set_key_backlight(bool on) {
    std::lock_guard<std::mutex> lock(model_lock());
    lights().keyBacklight = on;
}

void FactoryModel::set_all_lights(bool on) {
    // The core-device library publishes its link state; read before the lock (its own).
    const long link = get_value("wifilink.on", -1);
    std::lock_guard<std::mutex> lock(model_lock());
    Lights &l = lights();
    l.all = on;
    l.linkAtAll = on ? static_cast<int>(link) : -1;
    show_led();
}

constinit const Area kLightsArea = {
    .words = {{"lights", "[reset]  (the lights' state; reset: every light off)", w_lights}},
    .state = state,
};

}  // namespace ftxsim

// Display area of the factory model: the panel's backlight level and whether the LCD is on.
// A level reaches the screen through the backlight file of the device root, which the
// display dims by; level 102 ends the backlight test and gives the screen back the
// brightness it had before the test's first level.
#include <stdio.h>

#include <mutex>
#include <string>

#include "devfs.h"
#include "factory_area.h"

namespace ftxsim {
namespace {

const char kBrightness[] = "/sys/class/leds/lcd-backlight/brightness";
const unsigned kBacklightEnd = 102;

struct Display {
    long level = -1;  // -1: never set
    bool ended = false;
    long before = -1;  // the brightness before the test's first level
    bool lcdOn = true;
};

Display &display() {
    return model_part<Display>();
}

long read_brightness() {
    FILE *f = dev_fopen(kBrightness, "r");
    long v = 255;
    if (f == nullptr) return v;
    if (fscanf(f, "%ld", &v) != 1) v = 255;
    fclose(f);
    return v;
}

void write_brightness(long v) {
    FILE *f = dev_fopen(kBrightness, "w");
    if (f == nullptr) return;
    fprintf(f, "%ld\n", v);
    fclose(f);
}

// This area's part of "hw status".
void state(Reply &r) {
    const Display &d = display();
    if (d.ended) {
        r.add(" backlight=end");
    } else if (d.level < 0) {
        r.add(" backlight=-");
    } else {
        r.add(" backlight=%ld", d.level);
    }
    r.add(" lcd=%s", d.lcdOn ? "on" : "off");
}

}  // namespace

void FactoryModel::set_backlight(unsigned level) {
    std::lock_guard<std::mutex> lock(model_lock());
    Display &d = display();
    if (level == kBacklightEnd) {
        d.ended = true;
        if (d.before >= 0) write_brightness(d.before);
        d.before = -1;
        return;
    }
    if (d.before < 0) d.before = read_brightness();
    d.level = level;
    d.ended = false;
    write_brightness(level);
}

void FactoryModel::set_lcd(bool on) {
    std::lock_guard<std::mutex> lock(model_lock());
    display().lcdOn = on;
}

constinit const Area kDisplayArea = {
    .state = state,
};

}  // namespace ftxsim

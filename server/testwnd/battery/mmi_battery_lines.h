// The battery test's readings and the lines its window shows: the factory library's text
// ("level=80;voltage=3900;temperature=250;status=2;health=2"), the item's limits and each
// line's text and verdict. No window and no language file here: the caller hands in the
// translation of the language keys.
#pragma once

#include <stddef.h>

// One reading, in the battery service's units.
struct mmi_battery_values {
    int level;          // percent
    int voltage;        // millivolts
    int temperature;    // tenths of a degree Celsius
    int status;         // FTX_BATTERY_STATUS_...
    int health;         // FTX_BATTERY_HEALTH_...
    int chargersKnown;  // 0 when the flags below were not reported (the library's text)
    int ac, usb, wireless;
};

// The window's lines, top to bottom.
enum mmi_battery_line_id {
    MMI_BATTERY_LEVEL,
    MMI_BATTERY_VOLTAGE,
    MMI_BATTERY_TEMPERATURE,
    MMI_BATTERY_HEALTH,
    MMI_BATTERY_CHARGER,
    MMI_BATTERY_LINES
};

// Inclusive limits of each line; only the lines with limit keys use them.
struct mmi_battery_limits {
    int min[MMI_BATTERY_LINES];
    int max[MMI_BATTERY_LINES];
};

// The item parameter's value of key, def when the item does not set it.
typedef int (*mmi_battery_param_fn)(const char *key, int def, void *ctx);
// The limits of the item's parameter (MinLevel, MaxLevel, MinVoltage, MaxVoltage,
// MinTemperature, MaxTemperature), each missing one at its default (0..100 %,
// 3400..4500 mV, 0..450 tenths of a degree). A null param gives the defaults.
void mmi_battery_read_limits(mmi_battery_param_fn param, void *ctx, mmi_battery_limits *out);

// The text of a language key, the key itself when there is none.
typedef void (*mmi_battery_translate_fn)(const char *key, char *out, size_t size);

// The text of line for v against lim, cut to size: "Temperature 25.0 C", when outside with
// its reason "Temperature 61.0 C above 45.0 C" or "Health dead (not good)". 1 when the
// value lies inside (health good; the charger line always), 0 when it does not. A null v
// (no reading) gives the label and "-", outside.
int mmi_battery_line(int line, const mmi_battery_values *v, const mmi_battery_limits *lim,
                     mmi_battery_translate_fn tr, char *out, size_t size);

// The factory library's text: ';'-separated key=value fields in any order, unknown fields
// skipped, each of level, voltage, temperature, status and health a whole number of at most
// seven digits. 0 with *out filled (no charger flags), -1 with *out untouched otherwise.
int mmi_battery_parse(const char *text, mmi_battery_values *out);

// The handset's lights as one table: the three flashlights, the LED in each of its colours,
// the key backlight and the all-light switch, each with the library operations that switch
// it, the binder that provides them, its item parameter and its question on the screen.
#pragma once

#include "core/ftx_config.h"

enum mmi_light_id {
    MMI_LIGHT_BACK,
    MMI_LIGHT_BACK2,
    MMI_LIGHT_FRONT,
    MMI_LIGHT_LED_RED,
    MMI_LIGHT_LED_GREEN,
    MMI_LIGHT_LED_ORANGE,
    MMI_LIGHT_KEY_BACKLIGHT,
    MMI_LIGHT_ALL,  // every light at once: never a step of the light test
    MMI_LIGHTS
};

enum mmi_light_kind {
    MMI_LIGHT_KIND_FLASH,
    MMI_LIGHT_KIND_LED,
    MMI_LIGHT_KIND_KEYS,
    MMI_LIGHT_KIND_ALL
};

struct mmi_light {
    const char *name;  // in the log: "front flashlight"
    mmi_light_kind kind;
    int flashlight;           // FTX_FLASHLIGHT_... of a flashlight
    const char *colour;       // the LED's colour for the library
    const char *paramKey;     // the item parameter that makes it a step (null: never one)
    const char *byDefault;    // that parameter's value when the item leaves it out
    const char *questionKey;  // what the operator is asked while it is on
};

const mmi_light &mmi_light_of(int id);

// The light test's steps, in table order: the ids whose parameter is non-zero. Returns
// their number (at most max).
int mmi_light_steps(const ftx_config_para *p, int n, int *ids, int max);

// Binds the light's library operations (the per-feature binder of its kind): 0 when bound.
int mmi_light_bind(int id);
// Switches the light on or off through the library: the library's answer, -1 when its
// operations are not bound. Logged under the light test's tag as `who`.
int mmi_light_switch(int id, bool on, const char *who);

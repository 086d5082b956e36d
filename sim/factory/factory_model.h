// The factory library's hardware model: callbacks it was given, the state the console sets,
// and the events it sends back from its worker thread. The members are defined with the area
// they model (factory_audio.cpp, factory_touch.cpp...) or, for the callbacks, in the core.
#pragma once

#include <stddef.h>

#include "hw/lib_factory.h"

namespace ftxsim {

class FactoryModel {
  public:
    // Remembers the callback an operation was given (null forgets it).
    void remember(const char *op, ftx_api_module_cb cb);
    // Sends op's automatic reply (the default, or what "hw reply" set) to its callback.
    void auto_reply(const char *op);
    void send_testinfo(ftx_api_module_cb cb);
    void send_headset();
    void send_tp_verdict(ftx_api_module_cb cb);
    void send_module_status(const char *module);

    int headset();
    // The audio routes. audio_answer is the model's answer to an audio operation before it
    // runs: -1 for HiFi without a headset, a record of other than 1..10 seconds, a play with
    // nothing recorded, a loopback of unknown codes; else 0. audio_route starts or ends what op
    // plays; arg is its number (ring type, frequency, seconds, a loopback's microphone code),
    // out a loopback's output code.
    int audio_answer(const char *op, int arg, int out);
    void audio_route(const char *op, int arg, int out);
    // A route's volume level: 0..15 (a level out of range is clamped), 5 until set.
    void set_volume(int microphone, int output, int level);
    int volume(int microphone, int output);
    // Sets the hook callback; returns the presses counted since the previous set.
    int set_hook_cb(ftx_api_hookkey_cb cb);
    bool camera_ok(int id);
    // A camera's preview: started by its test start (-1 for a broken camera or an id outside
    // 0..31), ended by its stop. camera_frame draws the started camera's moving test pattern;
    // camera_capture saves it as a PNG picture at a device path. 0, or -1 when the camera is not
    // started, is broken or the size or path is refused.
    int camera_start(int id, bool on);
    int camera_frame(int id, unsigned *argb, int w, int h);
    int camera_capture(int id, const char *path);
    int sim_present(int slot);
    int sd_present(int slot);
    int sd_size(int slot);  // MB; 0 when empty, -1 on a bad slot
    // 0 when the device answers, -1 when the console made it fail.
    int detect(const char *name);
    void firmware(char *buf, size_t size);
    // The backlight level the library was given (102 ends the backlight test) and the LCD's
    // power.
    void set_backlight(unsigned level);
    void set_lcd(bool on);
    // The lights: a flashlight (FTX_FLASHLIGHT_...; -1 for another number), the LED's
    // colour ("red", "green", "orange"; null turns it off; -1 for another colour), the key
    // backlight, and every light at once.
    int set_flashlight(int flashlight, bool on);
    int set_led(const char *colour);
    void set_key_backlight(bool on);
    void set_all_lights(bool on);
    // The sensor area's reports: a start of the sensor, Hall, SAR or force-touch test makes
    // the model report to cb (the sensor test also every 200 ms, scaled) until its stop; any
    // other op changes nothing.
    void sensor_listen(const char *op, ftx_api_module_cb cb);
    // The model's answer to a sensor calibration: 0 for a sensor number FTX_SENSOR_..., else -1.
    int sensor_answer(int sensor);
    // Calibrates sensor and writes its new offsets ("x,y,z" or one value) into offsets.
    void calibrate_sensor(int sensor, char *offsets, size_t size);
    // The force pressed on the force-touch sensor, in grams.
    int force();
    // A force-touch calibration's weight parameter (grams; null or empty: 500): 0 for a
    // positive whole number, which becomes the weight, else -1.
    int force_weight(const char *parm);
};

FactoryModel &model();

}  // namespace ftxsim

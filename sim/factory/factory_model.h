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
    // Sets the hook callback; returns the presses counted since the previous set.
    int set_hook_cb(ftx_api_hookkey_cb cb);
    bool camera_ok(int id);
    int sim_present(int slot);
    int sd_present(int slot);
    // 0 when the device answers, -1 when the console made it fail.
    int detect(const char *name);
    void firmware(char *buf, size_t size);
    // The backlight level the library was given (102 ends the backlight test) and the LCD's
    // power.
    void set_backlight(unsigned level);
    void set_lcd(bool on);
};

FactoryModel &model();

}  // namespace ftxsim

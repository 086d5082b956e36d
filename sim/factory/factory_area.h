// What the areas of the factory model (audio, touch panel, cards...) share with its core.
// Each area keeps its own part of the state, guarded by the one model lock, and its own
// table of "hw" words; the core gathers the areas listed at the end of this file.
#pragma once

#include <stddef.h>

#include <initializer_list>
#include <mutex>
#include <string>

#include "factory_model.h"
#include "hw/lib_factory.h"
#include "sim_core.h"

namespace ftxsim {

struct Event {
    int datatype;
    std::string text;
    bool none = false;  // send nothing
    int delayMs = 100;  // after the start, scaled by FTX_TIME_SCALE
};

// The event that sends nothing.
Event no_event();

// Guards every area's state and the callbacks the library was given.
std::mutex &model_lock();

// The area's part of the model's state, made on first use. Never destroyed: the worker may
// still run at exit. Read and written under model_lock().
template <class Part>
Part &model_part() {
    static Part *p = new Part;
    return *p;
}

// The library's callback thread.
Worker &worker();

// Calls cb with one event now (the worker's part of deliver()).
void call_back(ftx_api_module_cb cb, int datatype, const std::string &text, bool withText);

// Delivers one event to cb on the worker thread.
void deliver(ftx_api_module_cb cb, int datatype, const std::string &text, bool withText,
             int delay_ms = 0);

// The callback op was last given, or null.
ftx_api_module_cb callback_of(const std::string &op);

// Rest of the words from index i, joined by blanks.
std::string rest(const Args &a, size_t i);

// "on", "ok", "1" or "off", "fail", "0"; false for any other word.
bool on_off(const std::string &w, bool *value);

// One area of the model: its "hw" words and the events its operations send by themselves.
struct Area {
    // Its "hw" words, in the order "hw help" lists them.
    std::initializer_list<Word> words = {};
    // The event op sends when started; no_event() when op is none of the area's.
    Event (*reply)(const std::string &op) = nullptr;
    // Adds the area's part of "hw status" (" name=value..."), under model_lock().
    void (*state)(Reply &r) = nullptr;
};

// The areas, one a file; the core's list of them orders "hw help" and the replies.
extern const Area kAudioArea;
extern const Area kTouchArea;
extern const Area kInfoArea;
extern const Area kCameraArea;
extern const Area kCardsArea;
extern const Area kRadioArea;
extern const Area kFirmwareArea;
extern const Area kPcbaArea;
extern const Area kSensorsArea;
extern const Area kDisplayArea;
extern const Area kLightsArea;

}  // namespace ftxsim

// The core of the factory model: the callbacks the library was given, the replies the
// console set, the worker, the generic words (set, reply, send, flags) and the gathering of
// the areas' words and automatic replies.
#include "factory_model.h"

#include <stdio.h>
#include <string.h>

#include <map>
#include <mutex>
#include <string>
#include <vector>

#include "factory_area.h"
#include "flag_area.h"
#include "ftx_host.h"
#include "sim_core.h"

namespace ftxsim {
namespace {

struct State {
    std::mutex lock;
    std::map<std::string, ftx_api_module_cb> callbacks;
    std::map<std::string, Event> replies;  // set by "hw reply"
};

State &st() {
    static State *s = new State;  // never destroyed: the worker may still run at exit
    return *s;
}

int w_set(const Args &a, Reply &r) {
    long v = 0;
    if (a.size() != 3) return 1;
    if (a[2] == "default") {
        force_answer(a[1].c_str(), false, 0);
    } else if (to_int(a[2], &v)) {
        force_answer(a[1].c_str(), true, static_cast<int>(v));
    } else {
        return 1;
    }
    return r.done("%s answers %s\n", a[1].c_str(), a[2].c_str());
}

int w_reply(const Args &a, Reply &r) {
    if (a.size() < 3) return 1;
    std::lock_guard<std::mutex> lock(st().lock);
    if (a[2] == "default") {
        st().replies.erase(a[1]);
    } else if (a[2] == "none") {
        st().replies[a[1]] = no_event();
    } else {
        long dt;
        if (!to_int(a[2], &dt)) return 1;
        st().replies[a[1]] = Event{static_cast<int>(dt), rest(a, 3)};
    }
    return r.done("%s replies %s\n", a[1].c_str(), a[2].c_str());
}

int w_send(const Args &a, Reply &r) {
    long dt;
    if (a.size() < 3 || !to_int(a[2], &dt)) return 1;
    ftx_api_module_cb cb = callback_of(a[1]);
    if (cb == nullptr) {
        r.add("%s holds no callback", a[1].c_str());
        return 1;
    }
    deliver(cb, static_cast<int>(dt), rest(a, 3), a.size() > 3);
    return r.done("sent %ld to %s\n", dt, a[1].c_str());
}

int w_flags(const Args &a, Reply &r) {
    unsigned char f[FTX_TESTINFO_FLAGS_SIZE];
    long i, v;
    if (a.size() == 1) {
        flags_load(f);
        for (int row = 0; row < FTX_TESTINFO_FLAGS_SIZE; row += 16) {
            r.add("%03d:", row);
            for (int k = 0; k < 16; ++k)
                r.add(" %02x", f[row + k]);
            r.add("\n");
        }
        return 0;
    }
    if (a.size() == 2 && a[1] == "clear") {
        memset(f, 0, sizeof(f));
        if (flags_store(f) != 0) return r.add("cannot write the flag area"), 1;
        return r.done("flags cleared\n");
    }
    if (a.size() == 4 && a[1] == "set" && to_int(a[2], &i) && to_int(a[3], &v) && i >= 0 &&
        i < FTX_TESTINFO_FLAGS_SIZE && v >= 0 && v <= 255) {
        if (flags_write_byte(static_cast<int>(i), static_cast<unsigned char>(v)) != 0) {
            return r.add("cannot write the flag area"), 1;
        }
        return r.done("byte %ld = 0x%02lx\n", i, v);
    }
    if ((a.size() == 3 || a.size() == 4) && a[1] == "item" && to_int(a[2], &i) && i >= 0 &&
        i < 400) {
        int shift = (3 - static_cast<int>(i % 4)) * 2;
        if (a.size() == 4) {
            if (!to_int(a[3], &v) || v < 0 || v > 3) return 1;
            // Under the area's lock: the item's neighbours may be written at the same time.
            if (flags_update(static_cast<int>(i / 4), static_cast<unsigned char>(3 << shift),
                             static_cast<unsigned char>(v << shift)) != 0) {
                return r.add("cannot write the flag area"), 1;
            }
        }
        flags_load(f);
        return r.done("item %ld = %d\n", i, (f[i / 4] >> shift) & 3);
    }
    return 1;
}

constinit const Area kCoreArea = {
    .words =
        {
            {"set", "OPERATION VALUE|default  (force an operation's return value)", w_set},
            {"reply", "OPERATION DATATYPE [TEXT] | OPERATION none|default", w_reply},
            {"send", "OPERATION DATATYPE [TEXT]  (event to the callback it was given)", w_send},
            {"flags", "[clear | set BYTE VALUE | item N [VALUE]]", w_flags},
        },
};

// Every area, in the order "hw help" lists their words. An operation's automatic reply is
// the first an area gives, in the same order: the sensor area stands first so that the
// force-touch names are matched before any name holding "Loopback".
const Area *const kAreas[] = {
    &kSensorsArea, &kPcbaArea,  &kAudioArea, &kTouchArea,    &kInfoArea,    &kCameraArea,
    &kCardsArea,   &kRadioArea, &kCoreArea,  &kFirmwareArea, &kDisplayArea, &kLightsArea,
};

// Events an operation sends by itself when started.
Event default_reply(const std::string &op) {
    for (const Area *area : kAreas) {
        if (area->reply == nullptr) continue;
        Event e = area->reply(op);
        if (!e.none) return e;
    }
    return no_event();
}

void print_state(Reply &r) {
    std::lock_guard<std::mutex> lock(st().lock);
    r.add("factory:");
    kAudioArea.state(r);
    kTouchArea.state(r);
    kInfoArea.state(r);
    r.add("\nfactory:");
    kCardsArea.state(r);
    kCameraArea.state(r);
    r.add("\ndisplay:");
    kDisplayArea.state(r);
    r.add("\nlights:");
    kLightsArea.state(r);
    r.add("\nsensors:");
    kSensorsArea.state(r);
    r.add("\n");
}

int control_fn(const char *line, char *reply, size_t size) {
    return control(line, reply, size);
}

// One table of every area's words, kept for the library's life (the core keeps its address).
// Plain static storage: nothing to destroy while the worker may still run at exit, and
// nothing left on the heap when a test unloads the library.
constexpr size_t kMaxWords = 128;
Word g_words[kMaxWords];

__attribute__((constructor)) void register_factory() {
    size_t n = 0;
    for (const Area *area : kAreas)
        for (const Word &w : area->words)
            if (n < kMaxWords) {
                g_words[n++] = w;
            } else {
                // A word left out would answer "unknown" with no hint why: say so at load.
                fprintf(stderr, "lib_factory: no room for the hw word \"%s\"\n", w.word);
            }
    add_words(g_words, n, print_state);
    ftx_host_register_hw("factory", control_fn);
}

}  // namespace

Event no_event() {
    Event none{0, ""};
    none.none = true;
    return none;
}

std::mutex &model_lock() {
    return st().lock;
}

Worker &worker() {
    static Worker *w = new Worker("factory");
    return *w;
}

void deliver(ftx_api_module_cb cb, int datatype, const std::string &text, bool withText,
             int delay_ms) {
    if (cb == nullptr) return;
    worker().post([cb, datatype, text, withText] { call_back(cb, datatype, text, withText); },
                  delay_ms);
}

void call_back(ftx_api_module_cb cb, int datatype, const std::string &text, bool withText) {
    std::string copy = text;
    module_data d;
    d.totallen = withText ? static_cast<unsigned int>(copy.size()) : 0;
    d.datatype = datatype;
    d.data = withText ? copy.data() : nullptr;
    cb(&d);
}

ftx_api_module_cb callback_of(const std::string &op) {
    std::lock_guard<std::mutex> lock(st().lock);
    auto it = st().callbacks.find(op);
    return it != st().callbacks.end() ? it->second : nullptr;
}

std::string rest(const Args &a, size_t i) {
    std::string out;
    for (; i < a.size(); ++i) {
        if (!out.empty()) out += ' ';
        out += a[i];
    }
    return out;
}

bool on_off(const std::string &w, bool *value) {
    if (w == "on" || w == "ok" || w == "1") {
        *value = true;
    } else if (w == "off" || w == "fail" || w == "0") {
        *value = false;
    } else {
        return false;
    }
    return true;
}

void FactoryModel::remember(const char *op, ftx_api_module_cb cb) {
    std::lock_guard<std::mutex> lock(st().lock);
    if (cb == nullptr) {
        st().callbacks.erase(op);
    } else {
        st().callbacks[op] = cb;
    }
}

void FactoryModel::auto_reply(const char *op) {
    Event e;
    bool overridden;
    {
        std::lock_guard<std::mutex> lock(st().lock);
        auto it = st().replies.find(op);
        overridden = it != st().replies.end();
        if (overridden) e = it->second;
    }
    if (!overridden) e = default_reply(op);  // outside the lock: it reads device.ini
    if (e.none) return;
    deliver(callback_of(op), e.datatype, e.text, !e.text.empty(), e.delayMs);
}

FactoryModel &model() {
    static FactoryModel m;
    return m;
}

}  // namespace ftxsim

extern "C" int ftx_sim_control(const char *line, char *reply, size_t size) {
    return ftxsim::control(line, reply, size);
}

// Audio area of the factory model: the headset plugged in, the hook key, and the events of
// the loopback and amplifier tests.
#include <mutex>
#include <string>

#include "factory_area.h"

namespace ftxsim {
namespace {

struct Audio {
    ftx_api_hookkey_cb hook = nullptr;
    int hookPresses = 0;
    int headset = 1;
};

Audio &audio() {
    return model_part<Audio>();
}

// This area's part of "hw status".
void state(Reply &r) {
    const Audio &s = audio();
    r.add(" headset=%d hook=%s presses=%d", s.headset, s.hook ? "running" : "idle", s.hookPresses);
}

Event reply(const std::string &op) {
    if (op == "ftx_api_SmartPACalibrate_Start")
        return {FTX_DATATYPE_SMARTPA, "result=pass;value=8"};
    if (op.find("Loopback") != std::string::npos || op == "ftx_api_Audio_wakeupMic_on_Start") {
        return {FTX_DATATYPE_LOOPBACK, "result=pass"};
    }
    return no_event();
}

}  // namespace

void FactoryModel::send_headset() {
    int h = headset();
    deliver(callback_of("ftx_api_Audio_Loopback_Test_Start"), FTX_DATATYPE_HEADSET,
            std::to_string(h), true);
}

int FactoryModel::headset() {
    std::lock_guard<std::mutex> lock(model_lock());
    return audio().headset;
}

int FactoryModel::set_hook_cb(ftx_api_hookkey_cb cb) {
    std::lock_guard<std::mutex> lock(model_lock());
    int presses = audio().hookPresses;
    audio().hook = cb;
    audio().hookPresses = 0;
    return presses;
}

// ---- control words ----
namespace {

int w_headset(const Args &a, Reply &r) {
    long v;
    if (a.size() != 2 || !to_int(a[1], &v) || v < 0 || v > 2) return 1;
    {
        std::lock_guard<std::mutex> lock(model_lock());
        audio().headset = static_cast<int>(v);
    }
    model().send_headset();
    return r.done("headset %ld\n", v);
}

int w_hook(const Args &a, Reply &r) {
    if (a.size() != 2 || (a[1] != "press" && a[1] != "release")) return 1;
    unsigned int status = a[1] == "press" ? 1 : 0;
    ftx_api_hookkey_cb cb;
    {
        std::lock_guard<std::mutex> lock(model_lock());
        cb = audio().hook;
        if (status == 1) ++audio().hookPresses;
    }
    if (cb == nullptr) {
        r.add("hook test not running");
        return 1;
    }
    worker().post([cb, status] {
        unsigned int s = status;
        cb(&s);
    });
    return r.done("hook %s\n", a[1].c_str());
}

}  // namespace

constinit const Area kAudioArea = {
    .words =
        {
            {"headset", "0|1|2  (none, with microphone, without microphone)", w_headset},
            {"hook", "press|release", w_hook},
        },
    .reply = reply,
    .state = state,
};

}  // namespace ftxsim

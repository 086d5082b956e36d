// Touch-panel area of the factory model: the self-test verdict and the module status the
// console sets.
#include <stdio.h>

#include <mutex>
#include <string>

#include "factory_area.h"

namespace ftxsim {
namespace {

struct Touch {
    int tpVerdict = 0;
    std::string tpRaw;
    int tpStatus = 0;
    int tpDelayMs = 500;
};

Touch &touch() {
    return model_part<Touch>();
}

// This area's part of "hw status".
void state(Reply &r) {
    r.add(" tp.verdict=%d tp.status=%d", touch().tpVerdict, touch().tpStatus);
}

}  // namespace

void FactoryModel::send_tp_verdict(ftx_api_module_cb cb) {
    int verdict, delay;
    std::string raw;
    {
        std::lock_guard<std::mutex> lock(model_lock());
        verdict = touch().tpVerdict;
        raw = touch().tpRaw;
        delay = touch().tpDelayMs;
    }
    deliver(cb, verdict, raw, !raw.empty(), delay);
}

void FactoryModel::send_module_status(const char *module) {
    int status;
    {
        std::lock_guard<std::mutex> lock(model_lock());
        status = touch().tpStatus;
    }
    char text[FTX_TPSTATUS_TEXT_SIZE];
    snprintf(text, sizeof(text), "module=%s;status=0x%02x", module, status);
    deliver(callback_of(std::string("module:") + module), FTX_DATATYPE_TPSTATUS, text, true);
}

// ---- control words ----
namespace {

int w_tp(const Args &a, Reply &r) {
    long v;
    if (a.size() < 3 || !to_int(a[2], &v)) return 1;
    std::lock_guard<std::mutex> lock(model_lock());
    if (a[1] == "verdict") {
        touch().tpVerdict = static_cast<int>(v);
        touch().tpRaw = a.size() > 3 ? rest(a, 3) : "";
    } else if (a[1] == "status" && v >= 0 && v <= 3 && a.size() == 3) {
        touch().tpStatus = static_cast<int>(v);
    } else if (a[1] == "delay" && v >= 0 && a.size() == 3) {
        touch().tpDelayMs = static_cast<int>(v);
    } else {
        return 1;
    }
    return r.done("tp %s %ld\n", a[1].c_str(), v);
}

}  // namespace

constinit const Area kTouchArea = {
    .words = {{"tp", "verdict N [x,y,num,px,py,...] | status 0..3 | delay MS", w_tp}},
    .state = state,
};

}  // namespace ftxsim

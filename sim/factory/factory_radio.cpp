// Radio area of the factory model: whether the Bluetooth, FM and Wi-Fi devices answer.
#include <map>
#include <mutex>
#include <string>

#include "factory_area.h"

namespace ftxsim {
namespace {

struct Radio {
    std::map<std::string, int> detect;  // "bt", "fm", "wifi": 0 ok, -1 fail
};

Radio &radio() {
    return model_part<Radio>();
}

}  // namespace

int FactoryModel::detect(const char *name) {
    std::lock_guard<std::mutex> lock(model_lock());
    auto it = radio().detect.find(name);
    return it != radio().detect.end() ? it->second : 0;
}

// ---- control words ----
namespace {

int w_detect(const Args &a, Reply &r) {
    bool ok;
    if (a.size() != 3 || (a[1] != "bt" && a[1] != "fm" && a[1] != "wifi") || !on_off(a[2], &ok)) {
        return 1;
    }
    std::lock_guard<std::mutex> lock(model_lock());
    radio().detect[a[1]] = ok ? 0 : -1;
    return r.done("detect %s %s\n", a[1].c_str(), ok ? "ok" : "fail");
}

}  // namespace

constinit const Area kRadioArea = {
    .words = {{"detect", "bt|fm|wifi ok|fail", w_detect}},
};

}  // namespace ftxsim

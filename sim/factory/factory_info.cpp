// Test-information area of the factory model: the IMEIs and PSN the library reports, and
// whether they arrive at all.
#include <mutex>

#include "factory_area.h"
#include "ftx_host.h"

namespace ftxsim {
namespace {

struct Info {
    bool testinfo = true;
};

Info &info() {
    return model_part<Info>();
}

// This area's part of "hw status".
void state(Reply &r) {
    r.add(" testinfo=%s", info().testinfo ? "on" : "off");
}

}  // namespace

void FactoryModel::send_testinfo(ftx_api_module_cb cb) {
    {
        std::lock_guard<std::mutex> lock(model_lock());
        if (!info().testinfo) return;
    }
    static const struct {
        int datatype;
        const char *key;
        const char *def;
    } kInfo[] = {{FTX_DATATYPE_TESTINFO_IMEI, "imei", "860000000000001"},
                 {FTX_DATATYPE_TESTINFO_IMEI2, "imei2", "860000000000019"},
                 {FTX_DATATYPE_TESTINFO_PSN, "psn", "PSN0000000001"}};
    for (const auto &i : kInfo) {
        char buf[128];
        ftx_device_ini_get("identity", i.key, buf, sizeof(buf), i.def);
        deliver(cb, i.datatype, buf, true, 50);
    }
    deliver(cb, FTX_DATATYPE_TESTINFO_END, "", false);
}

// ---- control words ----
namespace {

int w_testinfo(const Args &a, Reply &r) {
    bool on;
    if (a.size() != 2 || !on_off(a[1], &on)) return 1;
    std::lock_guard<std::mutex> lock(model_lock());
    info().testinfo = on;
    return r.done("testinfo %s\n", on ? "on" : "off");
}

}  // namespace

constinit const Area kInfoArea = {
    .words = {{"testinfo", "on|off  (off: the test information never arrives)", w_testinfo}},
    .state = state,
};

}  // namespace ftxsim

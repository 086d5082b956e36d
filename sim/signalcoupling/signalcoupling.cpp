// lib_dvk_signalcoupling.so: a modem model. Switching modes takes a moment (scaled by
// FTX_TIME_SCALE) and either switch can be made to fail from the console.
#include <mutex>

#include "ftx_host.h"
#include "hw/lib_dvk_signalcoupling.h"
#include "sim_core.h"
#include "tp_os.h"

namespace ftxsim {
namespace {

struct Modem {
    std::mutex lock;
    bool initialised = false;
    int mode = FTX_MODEM_MODE_ONLINE;
    bool failLowPower = false;
    bool failOnline = false;
    bool failInit = false;
    int switchMs = 200;
};

Modem &modem() {
    static Modem *m = new Modem;
    return *m;
}

const char *mode_name(int mode) {
    return mode == FTX_MODEM_MODE_ONLINE      ? "online"
           : mode == FTX_MODEM_MODE_LOW_POWER ? "lowpower"
                                              : "other";
}

int modem_word(const Args &a, Reply &r) {
    Modem &m = modem();
    std::lock_guard<std::mutex> lock(m.lock);
    long v;
    if (a.size() == 3 && (a[2] == "ok" || a[2] == "fail")) {
        bool fail = a[2] == "fail";
        if (a[1] == "lowpower") {
            m.failLowPower = fail;
        } else if (a[1] == "online") {
            m.failOnline = fail;
        } else if (a[1] == "init") {
            m.failInit = fail;
        } else {
            return 1;
        }
    } else if (a.size() == 3 && a[1] == "delay" && to_int(a[2], &v) && v >= 0) {
        m.switchMs = static_cast<int>(v);
    } else {
        return 1;
    }
    return r.done("modem %s %s\n", a[1].c_str(), a[2].c_str());
}

void state(Reply &r) {
    Modem &m = modem();
    std::lock_guard<std::mutex> lock(m.lock);
    r.add("modem: %s mode=%s%s%s%s\n", m.initialised ? "initialised" : "closed", mode_name(m.mode),
          m.failInit ? " init-fails" : "", m.failLowPower ? " lowpower-fails" : "",
          m.failOnline ? " online-fails" : "");
}

const Word kWords[] = {
    {"modem", "lowpower|online|init ok|fail | delay MS", modem_word},
};

int control_fn(const char *line, char *reply, size_t size) {
    return control(line, reply, size);
}

__attribute__((constructor)) void register_signalcoupling() {
    add_words(kWords, sizeof(kWords) / sizeof(kWords[0]), state);
    ftx_host_register_hw("signalcoupling", control_fn);
}

}  // namespace
}  // namespace ftxsim

using namespace ftxsim;

extern "C" int FTX_API_SignalCoupling_init(void) {
    Modem &m = modem();
    std::lock_guard<std::mutex> lock(m.lock);
    int rc = call("FTX_API_SignalCoupling_init", m.failInit ? -1 : 0);
    if (rc == 0) m.initialised = true;
    return rc;
}

extern "C" int FTX_API_SignalCoupling_uninit(void) {
    Modem &m = modem();
    std::lock_guard<std::mutex> lock(m.lock);
    m.initialised = false;
    return call("FTX_API_SignalCoupling_uninit", 0);
}

extern "C" int FTX_API_SignalCoupling_setModemMode(int mode) {
    Modem &m = modem();
    int delay;
    bool fails;
    {
        std::lock_guard<std::mutex> lock(m.lock);
        bool known = mode == FTX_MODEM_MODE_ONLINE || mode == FTX_MODEM_MODE_LOW_POWER;
        fails = !m.initialised || !known ||
                (mode == FTX_MODEM_MODE_ONLINE ? m.failOnline : m.failLowPower);
        delay = m.switchMs;
    }
    int rc = call("FTX_API_SignalCoupling_setModemMode", fails ? -1 : 0, "%d", mode);
    tp_os_usleep(static_cast<unsigned long>(delay) * 1000);
    if (rc == 0) {
        std::lock_guard<std::mutex> lock(m.lock);
        m.mode = mode;
    }
    return rc;
}

extern "C" int ftx_sim_control(const char *line, char *reply, size_t size) {
    return ftxsim::control(line, reply, size);
}

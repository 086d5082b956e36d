// The modem model: its mode, the switches and initialisation the console makes fail (for
// good or for the next few calls), and how long a switch takes. A switch in progress ends
// when the delay in force has passed since it began, so a new "hw modem delay" also
// shortens or lengthens the switch the application is waiting for.
#include "modem_model.h"

#include <chrono>
#include <condition_variable>
#include <mutex>

#include "ftx_host.h"
#include "hw/lib_dvk_signalcoupling.h"
#include "sim_core.h"
#include "tp_os.h"

namespace ftxsim {
namespace {

// A failure the console asked for: none, for good, or for the next `left` calls.
struct Failure {
    bool always = false;
    int left = 0;
    bool active() const { return always || left > 0; }
    // Whether this call fails; a counted failure is used up by it.
    bool take() {
        if (always) return true;
        if (left <= 0) return false;
        --left;
        return true;
    }
};

struct Modem {
    std::mutex lock;
    std::condition_variable changed;  // the delay changed
    bool initialised = false;
    int mode = FTX_MODEM_MODE_ONLINE;
    int switchingTo = 0;  // the mode a switch in progress goes to, 0 when none
    Failure init, lowPower, online;
    int switchMs = 200;
};

Modem &modem() {
    static Modem *m = new Modem;  // never freed: library threads may outlive statics
    return *m;
}

const char *mode_name(int mode) {
    return mode == FTX_MODEM_MODE_ONLINE      ? "online"
           : mode == FTX_MODEM_MODE_LOW_POWER ? "lowpower"
                                              : "other";
}

struct FailureWord {
    const char *name;
    Failure Modem::*failure;
};
const FailureWord kFailures[] = {
    {"lowpower", &Modem::lowPower},
    {"online", &Modem::online},
    {"init", &Modem::init},
};

int modem_word(const Args &a, Reply &r) {
    Modem &m = modem();
    std::lock_guard<std::mutex> lock(m.lock);
    long v = 0;
    if (a.size() == 3 && a[1] == "delay") {
        if (!to_int(a[2], &v) || v < 0 || v > 3600000) return 1;
        m.switchMs = static_cast<int>(v);
        m.changed.notify_all();
        return r.done("modem delay %ld\n", v);
    }
    const bool counted = a.size() == 4 && a[2] == "fail";
    if ((a.size() != 3 && !counted) || (a[2] != "ok" && a[2] != "fail")) return 1;
    if (counted && (!to_int(a[3], &v) || v < 1 || v > 1000000)) return 1;
    for (const FailureWord &f : kFailures) {
        if (a[1] != f.name) continue;
        Failure &failure = m.*f.failure;
        failure.always = a[2] == "fail" && !counted;
        failure.left = static_cast<int>(v);
        return counted ? r.done("modem %s fail %ld\n", f.name, v)
                       : r.done("modem %s %s\n", f.name, a[2].c_str());
    }
    return 1;
}

void failure_state(Reply &r, const char *name, const Failure &f) {
    if (f.always)
        r.add(" %s-fails", name);
    else if (f.left > 0)
        r.add(" %s-fails=%d", name, f.left);
}

void state(Reply &r) {
    Modem &m = modem();
    std::lock_guard<std::mutex> lock(m.lock);
    r.add("modem: %s mode=%s", m.initialised ? "initialised" : "closed", mode_name(m.mode));
    if (m.switchingTo != 0) r.add(" switching=%s", mode_name(m.switchingTo));
    for (const FailureWord &f : kFailures)
        failure_state(r, f.name, m.*f.failure);
    r.add(" delay=%d\n", m.switchMs);
}

const Word kWords[] = {
    {"modem", "lowpower|online|init ok|fail [N] | delay MS", modem_word},
};

// Registered with the console when libftxsim.so loads (after sim_core.cpp's own state,
// which comes first in the library).
struct Registration {
    Registration() {
        add_words(kWords, sizeof(kWords) / sizeof(kWords[0]), state);
        ftx_host_register_hw("signalcoupling", control);
    }
} s_registration;

}  // namespace

int modem_init(void) {
    Modem &m = modem();
    std::lock_guard<std::mutex> lock(m.lock);
    int rc = call("FTX_API_SignalCoupling_init", m.init.take() ? -1 : 0);
    if (rc == 0) m.initialised = true;
    return rc;
}

int modem_uninit(void) {
    Modem &m = modem();
    std::lock_guard<std::mutex> lock(m.lock);
    m.initialised = false;
    return call("FTX_API_SignalCoupling_uninit", 0);
}

int modem_set_mode(int mode) {
    Modem &m = modem();
    std::unique_lock<std::mutex> lock(m.lock);
    const bool known = mode == FTX_MODEM_MODE_ONLINE || mode == FTX_MODEM_MODE_LOW_POWER;
    bool fails = !m.initialised || !known;
    if (known && m.initialised)
        fails = (mode == FTX_MODEM_MODE_ONLINE ? m.online : m.lowPower).take();
    int rc = call("FTX_API_SignalCoupling_setModemMode", fails ? -1 : 0, "%d", mode);
    m.switchingTo = known ? mode : 0;
    const auto begun = std::chrono::steady_clock::now();
    const auto due = [&] {
        return begun +
               std::chrono::duration_cast<std::chrono::steady_clock::duration>(
                   std::chrono::duration<double, std::milli>(m.switchMs * tp_os_time_scale()));
    };
    while (std::chrono::steady_clock::now() < due())
        m.changed.wait_until(lock, due());
    m.switchingTo = 0;
    if (rc == 0) m.mode = mode;
    return rc;
}

}  // namespace ftxsim

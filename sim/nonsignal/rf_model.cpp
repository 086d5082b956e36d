// The RF test mode: whether it is on, the technology, band and channel set, the transmitter
// and its power, the level the tester's downlink reaches the handset at (one per
// technology), the operations the console makes fail, how long a setting takes, and the
// settings requested since the test mode was last opened, in order.
#include "rf_model.h"

#include <stdio.h>
#include <stdlib.h>
#include <string.h>

#include <chrono>
#include <condition_variable>
#include <mutex>
#include <string>
#include <vector>

#include "ftx_host.h"
#include "hw/lib_dvk_nonsignal.h"
#include "sim_core.h"
#include "tp_os.h"

namespace ftxsim {
namespace {

constexpr int kTechs = 5;
const char *const kTechNames[kTechs] = {"LTE", "GSM", "CDMA2000", "WCDMA", "TDSCDMA"};

// The operations the console can make fail, by their "hw rf fail" names.
enum Op { OPEN, CLOSE, TECH, BAND, CHANNEL, TXON, TXOFF, LEVEL, OPS };
const char *const kOpNames[OPS] = {"open",    "close", "tech",  "band",
                                   "channel", "txon",  "txoff", "level"};

constexpr size_t kMaxRequested = 128;

struct Rf {
    std::mutex lock;
    std::condition_variable changed;  // the delay changed
    int loaded = 0;                   // times the library is loaded now
    bool testMode = false;
    int tech = 0, band = -1, channel = -1;  // 0, -1: not set
    bool tx = false;
    int power = 0;
    int level[kTechs] = {-600, -600, -600, -600, -600};
    bool fails[OPS] = {};
    int delayMs = 100;
    std::vector<std::string> requested;  // since the last open
    bool requestedCut = false;
};

Rf &rf() {
    static Rf *m = new Rf;  // never freed: library threads may outlive statics
    return *m;
}

const char *tech_name(int tech) {
    return tech >= 1 && tech <= kTechs ? kTechNames[tech - 1] : "-";
}

// "-60.5" from -605.
std::string tenths(int v) {
    char text[32];
    snprintf(text, sizeof text, "%s%d.%d", v < 0 ? "-" : "", abs(v) / 10, abs(v) % 10);
    return text;
}

// "-60", "-60.5", "23" into tenths; false when text is not such a number.
bool parse_tenths(const std::string &text, int *out) {
    const char *s = text.c_str();
    const bool negative = *s == '-';
    if (negative) s++;
    long whole = 0, tenth = 0;
    int digits = 0;
    for (; *s >= '0' && *s <= '9'; s++, digits++) {
        whole = whole * 10 + (*s - '0');
        if (whole > 100000) return false;
    }
    if (digits == 0) return false;
    if (*s == '.') {
        s++;
        if (*s < '0' || *s > '9') return false;
        tenth = *s++ - '0';
    }
    if (*s != '\0') return false;
    const long v = whole * 10 + tenth;
    *out = static_cast<int>(negative ? -v : v);
    return true;
}

// Records a request; under the lock.
void request(Rf &m, const std::string &what, bool ok) {
    if (m.requested.size() >= kMaxRequested) {
        m.requestedCut = true;
        return;
    }
    m.requested.push_back(ok ? what : what + "(failed)");
}

// Waits the delay in force (a new "hw rf delay" shortens or lengthens a wait in progress).
void take_delay(Rf &m, std::unique_lock<std::mutex> &lock) {
    const auto begun = std::chrono::steady_clock::now();
    const auto due = [&] {
        return begun +
               std::chrono::duration_cast<std::chrono::steady_clock::duration>(
                   std::chrono::duration<double, std::milli>(m.delayMs * tp_os_time_scale()));
    };
    while (std::chrono::steady_clock::now() < due())
        m.changed.wait_until(lock, due());
}

// One setting: recorded, delayed, applied when it succeeds.
// `allowed` tells, under the lock, whether the model's state lets it happen.
template <typename Allowed, typename Apply>
int setting(Op op, const char *symbol, const std::string &what, int arg, Allowed allowed,
            Apply apply) {
    Rf &m = rf();
    std::unique_lock<std::mutex> lock(m.lock);
    const int rc = call(symbol, allowed(m) && !m.fails[op] ? 0 : -1, "%d", arg);
    request(m, what, rc == 0);
    take_delay(m, lock);
    if (rc == 0) apply(m);
    return rc;
}

void state(Reply &r) {
    Rf &m = rf();
    std::lock_guard<std::mutex> lock(m.lock);
    r.add("rf: library=%s testmode=%s tech=%s band=%d channel=%d tx=%s power=%s delay=%d level=",
          m.loaded > 0 ? "loaded" : "unloaded", m.testMode ? "on" : "off", tech_name(m.tech),
          m.band, m.channel, m.tx ? "on" : "off", tenths(m.power).c_str(), m.delayMs);
    for (int i = 0; i < kTechs; i++)
        r.add("%s%s:%s", i > 0 ? "," : "", kTechNames[i], tenths(m.level[i]).c_str());
    r.add(" fails=");
    bool any = false;
    for (int i = 0; i < OPS; i++) {
        if (!m.fails[i]) continue;
        r.add("%s%s", any ? "," : "", kOpNames[i]);
        any = true;
    }
    r.add("%s\nrf requested:", any ? "" : "-");
    for (const std::string &s : m.requested)
        r.add(" %s", s.c_str());
    r.add("%s\n", m.requestedCut ? " ..." : "");
}

int rf_word(const Args &a, Reply &r) {
    Rf &m = rf();
    if (a.size() == 1) {
        state(r);
        return 0;
    }
    std::lock_guard<std::mutex> lock(m.lock);
    long v = 0;
    if (a.size() == 3 && a[1] == "delay") {
        if (!to_int(a[2], &v) || v < 0 || v > 3600000) return 1;
        m.delayMs = static_cast<int>(v);
        m.changed.notify_all();
        return r.done("rf delay %ld\n", v);
    }
    if (a.size() == 3 && (a[1] == "fail" || a[1] == "ok")) {
        for (int i = 0; i < OPS; i++) {
            if (a[2] != kOpNames[i]) continue;
            m.fails[i] = a[1] == "fail";
            return r.done("rf %s %s\n", a[1].c_str(), kOpNames[i]);
        }
        return 1;
    }
    int level = 0;
    if (a.size() == 4 && a[1] == "level" && parse_tenths(a[3], &level) && level >= -2000 &&
        level <= 500) {
        for (int i = 0; i < kTechs; i++) {
            if (a[2] != kTechNames[i]) continue;
            m.level[i] = level;
            return r.done("rf level %s %s\n", kTechNames[i], tenths(level).c_str());
        }
    }
    return 1;
}

const Word kWords[] = {
    {"rf",
     "[level LTE|GSM|CDMA2000|WCDMA|TDSCDMA DBM | fail|ok "
     "open|close|tech|band|channel|txon|txoff|level | delay MS]",
     rf_word},
};

// Registered with the console when libftxsim.so loads.
struct Registration {
    Registration() {
        add_words(kWords, sizeof(kWords) / sizeof(kWords[0]), state);
        ftx_host_register_hw("nonsignal", control);
    }
} s_registration;

}  // namespace

int rf_open(void) {
    Rf &m = rf();
    std::lock_guard<std::mutex> lock(m.lock);
    const int rc = call("FTX_API_NonSignal_open", m.fails[OPEN] ? -1 : 0);
    if (rc != 0) return rc;
    if (!m.testMode) {
        m.requested.clear();
        m.requestedCut = false;
        m.tech = 0;
        m.band = m.channel = -1;
        m.tx = false;
    }
    m.testMode = true;
    return 0;
}

int rf_close(void) {
    Rf &m = rf();
    std::lock_guard<std::mutex> lock(m.lock);
    const int rc = call("FTX_API_NonSignal_close", m.fails[CLOSE] ? -1 : 0);
    if (rc != 0) return rc;
    m.testMode = false;
    m.tx = false;
    return 0;
}

int rf_set_tech(int tech) {
    const bool known = tech >= 1 && tech <= kTechs;
    return setting(
        TECH, "FTX_API_NonSignal_setTech", std::string("tech=") + tech_name(tech), tech,
        [known](Rf &m) { return known && m.testMode; },
        [tech](Rf &m) {
            m.tech = tech;
            m.band = m.channel = -1;
            m.tx = false;
        });
}

int rf_set_band(int band) {
    return setting(
        BAND, "FTX_API_NonSignal_setBand", "band=" + std::to_string(band), band,
        [band](Rf &m) { return m.testMode && m.tech != 0 && band >= 0; },
        [band](Rf &m) {
            m.band = band;
            m.channel = -1;
            m.tx = false;
        });
}

int rf_set_channel(int channel) {
    return setting(
        CHANNEL, "FTX_API_NonSignal_setChannel", "channel=" + std::to_string(channel), channel,
        [channel](Rf &m) { return m.testMode && m.band >= 0 && channel >= 0; },
        [channel](Rf &m) { m.channel = channel; });
}

int rf_tx_on(int power) {
    return setting(
        TXON, "FTX_API_NonSignal_txOn", "txon=" + tenths(power), power,
        [](Rf &m) { return m.testMode && m.channel >= 0; },
        [power](Rf &m) {
            m.tx = true;
            m.power = power;
        });
}

int rf_tx_off(void) {
    return setting(
        TXOFF, "FTX_API_NonSignal_txOff", "txoff", 0, [](Rf &m) { return m.testMode; },
        [](Rf &m) { m.tx = false; });
}

int rf_get_rx_level(int *level) {
    Rf &m = rf();
    std::lock_guard<std::mutex> lock(m.lock);
    const bool ok = level != nullptr && m.testMode && m.channel >= 0 && !m.fails[LEVEL];
    const int rc = call("FTX_API_NonSignal_getRxLevel", ok ? 0 : -1);
    if (rc == 0 && level != nullptr) *level = m.level[m.tech - 1];
    return rc;
}

void rf_library_loaded(bool loaded) {
    Rf &m = rf();
    std::lock_guard<std::mutex> lock(m.lock);
    m.loaded += loaded ? 1 : -1;
}

}  // namespace ftxsim

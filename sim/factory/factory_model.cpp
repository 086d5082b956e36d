#include "factory_model.h"

#include <stdio.h>
#include <stdlib.h>
#include <string.h>

#include <map>
#include <mutex>
#include <string>

#include "flag_area.h"
#include "ftx_host.h"
#include "sim_core.h"

namespace ftxsim {
namespace {

struct Event {
    int datatype;
    std::string text;
    bool none = false;  // send nothing
};

struct State {
    std::mutex lock;
    std::map<std::string, ftx_api_module_cb> callbacks;
    std::map<std::string, Event> replies;  // set by "hw reply"
    ftx_api_hookkey_cb hook = nullptr;
    int hookPresses = 0;
    int headset = 1;
    int tpVerdict = 0;
    std::string tpRaw;
    int tpStatus = 0;
    int tpDelayMs = 500;
    bool testinfo = true;
    unsigned cameraFail = 0;  // bit per camera id
    int sim[4] = {1, 1, 0, 0};
    int sd = 1;
    std::map<std::string, int> detect;  // "bt", "fm", "wifi": 0 ok, -1 fail
    std::string firmware = "TP IC FT8719, firmware 0x0A, vendor 0x51";
};

State &st() {
    static State *s = new State;  // never destroyed: the worker may still run at exit
    return *s;
}

Worker &worker() {
    static Worker *w = new Worker("factory");
    return *w;
}

// "4GB", "4096MB", "4096" (MB) as megabytes.
long megabytes(const char *text) {
    char *end = nullptr;
    long v = strtol(text, &end, 10);
    if (end != nullptr && (*end == 'G' || *end == 'g')) v *= 1024;
    return v;
}

long identity_mb(const char *key, const char *def) {
    char buf[64];
    ftx_device_ini_get("identity", key, buf, sizeof(buf), def);
    return megabytes(buf);
}

// Events an operation sends by itself when started.
Event default_reply(const std::string &op) {
    if (op == "ftx_api_cpu_start") return {FTX_DATATYPE_PCBA_CPU, "2000000,1"};
    if (op == "ftx_api_memory_start") {
        return {FTX_DATATYPE_PCBA_MEMORY, std::to_string(identity_mb("ram", "4GB")) + ",1"};
    }
    if (op == "ftx_api_storage_start") {
        return {FTX_DATATYPE_PCBA_STORAGE,
                std::to_string(identity_mb("rom", "64GB") / 1024) + ",1"};
    }
    if (op == "ftx_api_bluetooth_start") return {FTX_DATATYPE_PCBA_BLUETOOTH, "3,1"};
    if (op == "ftx_api_battery_start") {
        return {FTX_DATATYPE_PCBA_BATTERY, std::to_string(get_value("battery.level", 80)) + ",1"};
    }
    if (op == "ftx_api_wifi_start") return {FTX_DATATYPE_PCBA_WIFI, "5,1"};
    if (op == "ftx_api_fm_start") return {FTX_DATATYPE_PCBA_FM, "40,1"};
    if (op == "ftx_api_gps_start") return {FTX_DATATYPE_PCBA_GPS, "8,1"};
    if (op == "ftx_api_sdcard_start") return {FTX_DATATYPE_PCBA_SDCARD, "30436,1"};
    if (op == "ftx_api_sim_start") return {FTX_DATATYPE_PCBA_SIM, "1,1"};
    if (op == "ftx_api_touch_start") return {FTX_DATATYPE_PCBA_TOUCH, "5,1"};
    if (op == "ftx_api_Sensors_Test_Start") {
        return {
            FTX_DATATYPE_SENSOR,
            "acc=0.0,0.0,9.8;mag=20.0,-5.0,40.0;gyro=0.0,0.0,0.0;pressure=1013;proxi=0;light=120"};
    }
    if (op == "ftx_api_HallSensorTest_Start" || op == "ftx_api_Hall_2nd_test_start") {
        return {FTX_DATATYPE_HALL, "state=near"};
    }
    if (op == "ftx_api_FingerPrintTest_Start") return {FTX_DATATYPE_FINGERPRINT, "result=pass"};
    if (op == "ftx_api_NFC_Start") return {FTX_DATATYPE_NFC, "result=pass"};
    if (op == "ftx_api_sar_start") return {FTX_DATATYPE_SAR, "value=1"};
    if (op == "ftx_api_SmartPACalibrate_Start")
        return {FTX_DATATYPE_SMARTPA, "result=pass;value=8"};
    if (op == "ftx_api_USB_OTG_Test_START") return {FTX_DATATYPE_OTG, "result=pass"};
    if (op.rfind("ftx_api_force_touch_", 0) == 0) return {FTX_DATATYPE_FORCETOUCH, "value=300"};
    if (op.find("Loopback") != std::string::npos || op == "ftx_api_Audio_wakeupMic_on_Start") {
        return {FTX_DATATYPE_LOOPBACK, "result=pass"};
    }
    Event none{0, ""};
    none.none = true;
    return none;
}

// Delivers one event to cb on the worker thread.
void deliver(ftx_api_module_cb cb, int datatype, const std::string &text, bool withText,
             int delay_ms = 0) {
    if (cb == nullptr) return;
    worker().post(
        [cb, datatype, text, withText] {
            std::string copy = text;
            module_data d;
            d.totallen = withText ? static_cast<unsigned int>(copy.size()) : 0;
            d.datatype = datatype;
            d.data = withText ? copy.data() : nullptr;
            cb(&d);
        },
        delay_ms);
}

ftx_api_module_cb callback_of(const std::string &op) {
    std::lock_guard<std::mutex> lock(st().lock);
    auto it = st().callbacks.find(op);
    return it != st().callbacks.end() ? it->second : nullptr;
}

// Rest of the words from index i, joined by blanks.
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

// ---- control words ----

int w_headset(const Args &a, Reply &r) {
    long v;
    if (a.size() != 2 || !to_int(a[1], &v) || v < 0 || v > 2) return 1;
    {
        std::lock_guard<std::mutex> lock(st().lock);
        st().headset = static_cast<int>(v);
    }
    model().send_headset();
    r.add("headset %ld\n", v);
    return 0;
}

int w_hook(const Args &a, Reply &r) {
    if (a.size() != 2 || (a[1] != "press" && a[1] != "release")) return 1;
    unsigned int status = a[1] == "press" ? 1 : 0;
    ftx_api_hookkey_cb cb;
    {
        std::lock_guard<std::mutex> lock(st().lock);
        cb = st().hook;
        if (status == 1) ++st().hookPresses;
    }
    if (cb == nullptr) {
        r.add("hook test not running");
        return 1;
    }
    worker().post([cb, status] {
        unsigned int s = status;
        cb(&s);
    });
    r.add("hook %s\n", a[1].c_str());
    return 0;
}

int w_tp(const Args &a, Reply &r) {
    long v;
    if (a.size() < 3 || !to_int(a[2], &v)) return 1;
    std::lock_guard<std::mutex> lock(st().lock);
    if (a[1] == "verdict") {
        st().tpVerdict = static_cast<int>(v);
        st().tpRaw = a.size() > 3 ? rest(a, 3) : "";
    } else if (a[1] == "status" && v >= 0 && v <= 3 && a.size() == 3) {
        st().tpStatus = static_cast<int>(v);
    } else if (a[1] == "delay" && v >= 0 && a.size() == 3) {
        st().tpDelayMs = static_cast<int>(v);
    } else {
        return 1;
    }
    r.add("tp %s %ld\n", a[1].c_str(), v);
    return 0;
}

int w_testinfo(const Args &a, Reply &r) {
    bool on;
    if (a.size() != 2 || !on_off(a[1], &on)) return 1;
    std::lock_guard<std::mutex> lock(st().lock);
    st().testinfo = on;
    r.add("testinfo %s\n", on ? "on" : "off");
    return 0;
}

int w_camera(const Args &a, Reply &r) {
    long id;
    bool ok;
    if (a.size() != 3 || !to_int(a[1], &id) || id < 0 || id > 31 || !on_off(a[2], &ok)) return 1;
    std::lock_guard<std::mutex> lock(st().lock);
    if (ok) {
        st().cameraFail &= ~(1u << id);
    } else {
        st().cameraFail |= 1u << id;
    }
    r.add("camera %ld %s\n", id, ok ? "ok" : "fail");
    return 0;
}

int w_card(const Args &a, Reply &r) {
    long slot, present;
    if (a.size() != 4 || !to_int(a[2], &slot) || !to_int(a[3], &present)) return 1;
    std::lock_guard<std::mutex> lock(st().lock);
    if (a[1] == "sim" && slot >= 0 && slot < 4) {
        st().sim[slot] = present != 0;
    } else if (a[1] == "sd" && slot == 0) {
        st().sd = present != 0;
    } else {
        return 1;
    }
    r.add("card %s %ld %ld\n", a[1].c_str(), slot, present);
    return 0;
}

int w_detect(const Args &a, Reply &r) {
    bool ok;
    if (a.size() != 3 || (a[1] != "bt" && a[1] != "fm" && a[1] != "wifi") || !on_off(a[2], &ok)) {
        return 1;
    }
    std::lock_guard<std::mutex> lock(st().lock);
    st().detect[a[1]] = ok ? 0 : -1;
    r.add("detect %s %s\n", a[1].c_str(), ok ? "ok" : "fail");
    return 0;
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
    r.add("%s answers %s\n", a[1].c_str(), a[2].c_str());
    return 0;
}

int w_reply(const Args &a, Reply &r) {
    if (a.size() < 3) return 1;
    std::lock_guard<std::mutex> lock(st().lock);
    if (a[2] == "default") {
        st().replies.erase(a[1]);
    } else if (a[2] == "none") {
        Event e{0, ""};
        e.none = true;
        st().replies[a[1]] = e;
    } else {
        long dt;
        if (!to_int(a[2], &dt)) return 1;
        st().replies[a[1]] = Event{static_cast<int>(dt), rest(a, 3)};
    }
    r.add("%s replies %s\n", a[1].c_str(), a[2].c_str());
    return 0;
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
    r.add("sent %ld to %s\n", dt, a[1].c_str());
    return 0;
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
        r.add("flags cleared\n");
        return 0;
    }
    if (a.size() == 4 && a[1] == "set" && to_int(a[2], &i) && to_int(a[3], &v) && i >= 0 &&
        i < FTX_TESTINFO_FLAGS_SIZE && v >= 0 && v <= 255) {
        if (flags_write_byte(static_cast<int>(i), static_cast<unsigned char>(v)) != 0) {
            return r.add("cannot write the flag area"), 1;
        }
        r.add("byte %ld = 0x%02lx\n", i, v);
        return 0;
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
        r.add("item %ld = %d\n", i, (f[i / 4] >> shift) & 3);
        return 0;
    }
    return 1;
}

int w_firmware(const Args &a, Reply &r) {
    if (a.size() < 2) return 1;
    std::lock_guard<std::mutex> lock(st().lock);
    st().firmware = rest(a, 1);
    r.add("firmware set\n");
    return 0;
}

const Word kWords[] = {
    {"headset", "0|1|2  (none, with microphone, without microphone)", w_headset},
    {"hook", "press|release", w_hook},
    {"tp", "verdict N [x,y,num,px,py,...] | status 0..3 | delay MS", w_tp},
    {"testinfo", "on|off  (off: the test information never arrives)", w_testinfo},
    {"camera", "ID ok|fail", w_camera},
    {"card", "sim SLOT 0|1 | sd 0 0|1", w_card},
    {"detect", "bt|fm|wifi ok|fail", w_detect},
    {"set", "OPERATION VALUE|default  (force an operation's return value)", w_set},
    {"reply", "OPERATION DATATYPE [TEXT] | OPERATION none|default", w_reply},
    {"send", "OPERATION DATATYPE [TEXT]  (event to the callback it was given)", w_send},
    {"flags", "[clear | set BYTE VALUE | item N [VALUE]]", w_flags},
    {"firmware", "TEXT", w_firmware},
};

void print_state(Reply &r) {
    std::lock_guard<std::mutex> lock(st().lock);
    State &s = st();
    r.add("factory: headset=%d hook=%s presses=%d tp.verdict=%d tp.status=%d testinfo=%s\n",
          s.headset, s.hook ? "running" : "idle", s.hookPresses, s.tpVerdict, s.tpStatus,
          s.testinfo ? "on" : "off");
    r.add("factory: sim=%d,%d,%d,%d sd=%d camera.fail=0x%x\n", s.sim[0], s.sim[1], s.sim[2],
          s.sim[3], s.sd, s.cameraFail);
}

int control_fn(const char *line, char *reply, size_t size) {
    return control(line, reply, size);
}

__attribute__((constructor)) void register_factory() {
    add_words(kWords, sizeof(kWords) / sizeof(kWords[0]), print_state);
    ftx_host_register_hw("factory", control_fn);
}

}  // namespace

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
    deliver(callback_of(op), e.datatype, e.text, !e.text.empty(), 100);
}

void FactoryModel::send_testinfo(ftx_api_module_cb cb) {
    {
        std::lock_guard<std::mutex> lock(st().lock);
        if (!st().testinfo) return;
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

void FactoryModel::send_headset() {
    int h = headset();
    deliver(callback_of("ftx_api_Audio_Loopback_Test_Start"), FTX_DATATYPE_HEADSET,
            std::to_string(h), true);
}

void FactoryModel::send_tp_verdict(ftx_api_module_cb cb) {
    int verdict, delay;
    std::string raw;
    {
        std::lock_guard<std::mutex> lock(st().lock);
        verdict = st().tpVerdict;
        raw = st().tpRaw;
        delay = st().tpDelayMs;
    }
    deliver(cb, verdict, raw, !raw.empty(), delay);
}

void FactoryModel::send_module_status(const char *module) {
    int status;
    {
        std::lock_guard<std::mutex> lock(st().lock);
        status = st().tpStatus;
    }
    char text[FTX_TPSTATUS_TEXT_SIZE];
    snprintf(text, sizeof(text), "module=%s;status=0x%02x", module, status);
    deliver(callback_of(std::string("module:") + module), FTX_DATATYPE_TPSTATUS, text, true);
}

int FactoryModel::headset() {
    std::lock_guard<std::mutex> lock(st().lock);
    return st().headset;
}

int FactoryModel::set_hook_cb(ftx_api_hookkey_cb cb) {
    std::lock_guard<std::mutex> lock(st().lock);
    int presses = st().hookPresses;
    st().hook = cb;
    st().hookPresses = 0;
    return presses;
}

bool FactoryModel::camera_ok(int id) {
    std::lock_guard<std::mutex> lock(st().lock);
    return id < 0 || id > 31 || (st().cameraFail & (1u << id)) == 0;
}

int FactoryModel::sim_present(int slot) {
    std::lock_guard<std::mutex> lock(st().lock);
    return slot >= 0 && slot < 4 ? st().sim[slot] : -1;
}

int FactoryModel::sd_present(int slot) {
    std::lock_guard<std::mutex> lock(st().lock);
    return slot == 0 ? st().sd : -1;
}

int FactoryModel::detect(const char *name) {
    std::lock_guard<std::mutex> lock(st().lock);
    auto it = st().detect.find(name);
    return it != st().detect.end() ? it->second : 0;
}

void FactoryModel::firmware(char *buf, size_t size) {
    std::lock_guard<std::mutex> lock(st().lock);
    snprintf(buf, size, "%s", st().firmware.c_str());
}

FactoryModel &model() {
    static FactoryModel m;
    return m;
}

}  // namespace ftxsim

extern "C" int ftx_sim_control(const char *line, char *reply, size_t size) {
    return ftxsim::control(line, reply, size);
}

// The battery service: observers called from the service's own thread every second with
// the battery model, which "hw battery" and "hw charger" change.
#include <string.h>

#include <algorithm>
#include <chrono>
#include <condition_variable>
#include <mutex>
#include <thread>
#include <vector>

#include "coredevice.h"
#include "hw/libdvk_ncoredevice.h"
#include "sim_core.h"
#include "tp_os.h"

namespace ftxsim {
namespace {

struct Observer {
    int kind;
    FTX_BatteryObserver_cb cb;
};

struct Battery {
    std::mutex lock;
    std::condition_variable cv;
    std::vector<Observer> observers;
    bool running = false;
    unsigned generation = 0;  // a restart makes the previous thread end
    FTX_BATTERY_INFO info{};
    bool chargingEnabled = true;
    int forcedStatus = 0;  // 0: derived from the chargers and the level
    int lowLevel = 15;
    int periodMs = 1000;
    unsigned long rounds = 0;  // rounds whose callbacks have all returned: tests wait on it
};

Battery &bat() {
    static Battery *b = [] {
        Battery *n = new Battery;  // never destroyed: its thread may outlive exit
        n->info.chargerUsbOnline = 1;
        n->info.batteryPresent = 1;
        n->info.batteryHealth = FTX_BATTERY_HEALTH_GOOD;
        n->info.batteryLevel = 80;
        n->info.batteryVoltage = 3900;
        n->info.batteryTemperature = 250;
        return n;
    }();
    return *b;
}

// The status the model shows; call with the lock held.
int derived_status(const Battery &b) {
    if (b.forcedStatus != 0) return b.forcedStatus;
    const FTX_BATTERY_INFO &i = b.info;
    bool charger = i.chargerAcOnline || i.chargerUsbOnline || i.chargerWirelessOnline;
    if (!i.batteryPresent) return FTX_BATTERY_STATUS_UNKNOWN;
    if (!charger) return FTX_BATTERY_STATUS_DISCHARGING;
    if (i.batteryLevel >= 100) return FTX_BATTERY_STATUS_FULL;
    return b.chargingEnabled ? FTX_BATTERY_STATUS_CHARGING : FTX_BATTERY_STATUS_NOT_CHARGING;
}

void publish(const FTX_BATTERY_INFO &i) {
    put_value("battery.level", i.batteryLevel);
    put_value("battery.voltage", i.batteryVoltage);
    put_value("battery.temperature", i.batteryTemperature);
    put_value("battery.status", i.batteryStatus);
    put_value("battery.health", i.batteryHealth);
}

void service_loop(unsigned generation) {
    Battery &b = bat();
    std::unique_lock<std::mutex> lk(b.lock);
    while (b.running && b.generation == generation) {
        FTX_BATTERY_INFO info = b.info;
        info.batteryStatus = derived_status(b);
        bool charger = info.chargerAcOnline || info.chargerUsbOnline || info.chargerWirelessOnline;
        bool low = info.batteryLevel <= b.lowLevel && !charger;
        std::vector<Observer> obs = b.observers;
        auto period =
            std::chrono::microseconds(static_cast<long>(b.periodMs * 1000.0 * tp_os_time_scale()));
        lk.unlock();
        publish(info);
        for (const Observer &o : obs) {
            if (o.kind == FTX_BATTERY_OBSERVER_TEMPERATURE || low) {
                // Skip observers removed by an earlier callback of this round.
                {
                    std::lock_guard<std::mutex> g(b.lock);
                    auto same = [&](const Observer &x) { return x.kind == o.kind && x.cb == o.cb; };
                    if (std::none_of(b.observers.begin(), b.observers.end(), same)) continue;
                }
                o.cb(&info);
            }
        }
        lk.lock();
        ++b.rounds;
        b.cv.wait_for(lk, period, [&] { return !b.running || b.generation != generation; });
    }
}

bool valid_kind(int kind) {
    return kind == FTX_BATTERY_OBSERVER_TEMPERATURE || kind == FTX_BATTERY_OBSERVER_VOLTAGE;
}

}  // namespace

void battery_state(Reply &r) {
    Battery &b = bat();
    std::lock_guard<std::mutex> lock(b.lock);
    const FTX_BATTERY_INFO &i = b.info;
    r.add(
        "battery: service=%s observers=%zu level=%d voltage=%d temperature=%d status=%d "
        "health=%d present=%d charging=%s low=%d rounds=%lu\n",
        b.running ? "running" : "stopped", b.observers.size(), i.batteryLevel, i.batteryVoltage,
        i.batteryTemperature, derived_status(b), i.batteryHealth, i.batteryPresent,
        b.chargingEnabled ? "enabled" : "disabled", b.lowLevel, b.rounds);
    r.add("charger: ac=%d usb=%d wireless=%d\n", i.chargerAcOnline, i.chargerUsbOnline,
          i.chargerWirelessOnline);
}

int battery_word(const Args &a, Reply &r) {
    long v;
    if (a.size() != 3) return 1;
    Battery &b = bat();
    std::lock_guard<std::mutex> lock(b.lock);
    FTX_BATTERY_INFO &i = b.info;
    if (a[1] == "status" && a[2] == "auto") {
        b.forcedStatus = 0;
    } else if (!to_int(a[2], &v)) {
        return 1;
    } else if (a[1] == "level" && v >= 0 && v <= 100) {
        i.batteryLevel = static_cast<int>(v);
    } else if (a[1] == "temperature") {
        i.batteryTemperature = static_cast<int>(v);
    } else if (a[1] == "voltage" && v >= 0) {
        i.batteryVoltage = static_cast<int>(v);
    } else if (a[1] == "health" && v >= 1 && v <= 7) {
        i.batteryHealth = static_cast<int>(v);
    } else if (a[1] == "present" && (v == 0 || v == 1)) {
        i.batteryPresent = static_cast<unsigned char>(v);
    } else if (a[1] == "status" && v >= 1 && v <= 5) {
        b.forcedStatus = static_cast<int>(v);
    } else if (a[1] == "low" && v >= 0 && v <= 100) {
        b.lowLevel = static_cast<int>(v);
    } else if (a[1] == "period" && v >= 10) {
        b.periodMs = static_cast<int>(v);
    } else {
        return 1;
    }
    return r.done("battery %s %s\n", a[1].c_str(), a[2].c_str());
}

int charger_word(const Args &a, Reply &r) {
    Battery &b = bat();
    std::lock_guard<std::mutex> lock(b.lock);
    FTX_BATTERY_INFO &i = b.info;
    if (a.size() == 2 && a[1] == "none") {
        i.chargerAcOnline = i.chargerUsbOnline = i.chargerWirelessOnline = 0;
    } else if (a.size() >= 3 && a.size() % 2 == 1) {
        // Several pairs change at once, so one line can swap chargers without a round
        // seeing none (or both) online in between.
        FTX_BATTERY_INFO next = i;
        for (size_t k = 1; k < a.size(); k += 2) {
            long v;
            unsigned char *flag = a[k] == "ac"         ? &next.chargerAcOnline
                                  : a[k] == "usb"      ? &next.chargerUsbOnline
                                  : a[k] == "wireless" ? &next.chargerWirelessOnline
                                                       : nullptr;
            if (flag == nullptr || !to_int(a[k + 1], &v) || (v != 0 && v != 1)) return 1;
            *flag = static_cast<unsigned char>(v);
        }
        i = next;
    } else {
        return 1;
    }
    b.cv.notify_all();
    return r.done("charger: ac=%d usb=%d wireless=%d\n", i.chargerAcOnline, i.chargerUsbOnline,
                  i.chargerWirelessOnline);
}

}  // namespace ftxsim

using namespace ftxsim;

extern "C" int FTX_API_BatteryService_register_Observer(int kind, FTX_BatteryObserver_cb cb) {
    int rc = call("FTX_API_BatteryService_register_Observer", 0, "%d,cb=%p", kind,
                  reinterpret_cast<void *>(cb));
    if (rc != 0) return rc;
    if (cb == nullptr || !valid_kind(kind)) return -1;
    Battery &b = bat();
    std::lock_guard<std::mutex> lock(b.lock);
    for (const Observer &o : b.observers) {
        if (o.kind == kind && o.cb == cb) return 0;
    }
    b.observers.push_back({kind, cb});
    return 0;
}

extern "C" int FTX_API_BatteryService_unregister_Observer(int kind, FTX_BatteryObserver_cb cb) {
    int rc = call("FTX_API_BatteryService_unregister_Observer", 0, "%d,cb=%p", kind,
                  reinterpret_cast<void *>(cb));
    Battery &b = bat();
    std::lock_guard<std::mutex> lock(b.lock);
    auto it = std::remove_if(b.observers.begin(), b.observers.end(),
                             [&](const Observer &o) { return o.kind == kind && o.cb == cb; });
    if (it == b.observers.end()) return -1;
    b.observers.erase(it, b.observers.end());
    return rc;
}

extern "C" int FTX_API_BatteryService_StartService(void) {
    int rc = call("FTX_API_BatteryService_StartService", 0);
    if (rc != 0) return rc;
    Battery &b = bat();
    std::lock_guard<std::mutex> lock(b.lock);
    if (b.running) return 0;
    b.running = true;
    unsigned gen = ++b.generation;
    std::thread(service_loop, gen).detach();
    return 0;
}

extern "C" int FTX_API_BatteryService_StopService(void) {
    int rc = call("FTX_API_BatteryService_StopService", 0);
    Battery &b = bat();
    std::lock_guard<std::mutex> lock(b.lock);
    b.running = false;
    b.cv.notify_all();
    return rc;
}

extern "C" int FTX_API_BatteryService_ChargingStatusSet(int enable) {
    int rc = call("FTX_API_BatteryService_ChargingStatusSet", 0, "%d", enable);
    if (rc != 0) return rc;
    Battery &b = bat();
    std::lock_guard<std::mutex> lock(b.lock);
    b.chargingEnabled = enable != 0;
    return 0;
}

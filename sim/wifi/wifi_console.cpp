// "hw wifi ..." console lines: the simulated Wi-Fi network as the console changes it. Each
// line rewrites the root's run/wifi/console, which the supplicant (a process of its own)
// takes up within a few milliseconds; so the lines work whether or not it runs. Built into
// libdvk_ncoredevice.so, which the application always loads.
#include <stdlib.h>
#include <time.h>

#include <string>

#include "devfs.h"
#include "sim_core.h"
#include "wifi_link.h"
#include "wifi_model.h"

namespace ftxwifi {
namespace {

using ftxsim::Args;
using ftxsim::Reply;

const char kUsage[] =
    "[status] | ap SSID on|off | rssi SSID DBM | key SSID KEY|default | stuck SSID on|off | "
    "linklocal ROUNDS | fail REQUEST [off] | reset";

void show(Reply &r) {
    const std::string root = dev_root();
    const NetworkModel model = load_model();
    const ConsoleState console = read_console(root);
    auto link = ftxhost::wifi_read_link(root);
    const bool running = ftxhost::wifi_supplicant_running(root);
    int left = console.linklocal;
    if (link["linklocal.serial"] == std::to_string(console.linklocalSerial))
        left -= atoi(link["linklocal.used"].c_str());
    std::string fails;
    for (const std::string &f : console.fails)
        fails += (fails.empty() ? "" : ",") + f;
    r.add("wifi: supplicant=%s state=%s ssid=%s ip=%s failures=%s linklocal=%d fail=%s\n",
          running ? "running" : "stopped", running ? link["wpa_state"].c_str() : "-",
          running && !link["ssid"].empty() ? link["ssid"].c_str() : "-",
          running && !link["ip"].empty() ? link["ip"].c_str() : "-",
          link["failures"].empty() ? "0" : link["failures"].c_str(), left > 0 ? left : 0,
          fails.empty() ? "-" : fails.c_str());
    r.add("wifi: mac=%s dhcp=%s\n", model.mac.c_str(),
          model.address.empty() ? "-" : model.address.c_str());
    const auto aps = effective_aps(model, console);
    for (size_t i = 0; i < aps.size(); i++) {
        const AccessPoint &ap = aps[i];
        r.add("wifi ap %zu: %s %s key=%s bssid=%s freq=%d rssi=%d %s%s\n", i, ap.ssid.c_str(),
              ap.keyMgmt.c_str(), ap.key.empty() ? "-" : ap.key.c_str(), ap.bssid.c_str(), ap.freq,
              ap.rssi, ap.on ? "on" : "off", ap.stuck ? " stuck" : "");
    }
}

int on_off(const std::string &word, bool *on) {
    if (word != "on" && word != "off") return -1;
    *on = word == "on";
    return 0;
}

int wifi_word(const Args &a, Reply &r) {
    if (a.size() == 1 || (a.size() == 2 && a[1] == "status")) {
        show(r);
        return 0;
    }
    const std::string root = dev_root();
    const NetworkModel model = load_model();
    ConsoleState c = read_console(root);
    const std::string &what = a[1];
    if (what == "reset" && a.size() == 2) {
        c = ConsoleState{};
    } else if (what == "linklocal" && a.size() == 3) {
        long rounds = 0;
        if (!ftxsim::to_int(a[2], &rounds) || rounds < 0 || rounds > 1000000) return 1;
        struct timespec ts;
        clock_gettime(CLOCK_REALTIME, &ts);
        c.linklocal = static_cast<int>(rounds);
        c.linklocalSerial = ts.tv_sec * 1000000000LL + ts.tv_nsec;
    } else if (what == "fail" && (a.size() == 3 || (a.size() == 4 && a[3] == "off"))) {
        if (a.size() == 4) {
            c.fails.erase(a[2]);
        } else {
            c.fails.insert(a[2]);
        }
    } else if (a.size() == 4 &&
               (what == "ap" || what == "rssi" || what == "key" || what == "stuck")) {
        const int index = find_ap(model, a[2]);
        if (index < 0) return r.done("no access point %s\n", a[2].c_str()) + 1;
        ConsoleState::Ap &ap = c.aps[index];
        bool on = false;
        long dbm = 0;
        if (what == "ap" && on_off(a[3], &on) == 0) {
            ap.on = on;
        } else if (what == "stuck" && on_off(a[3], &on) == 0) {
            ap.stuck = on;
        } else if (what == "rssi" && ftxsim::to_int(a[3], &dbm) && dbm >= -120 && dbm <= 0) {
            ap.rssi = static_cast<int>(dbm);
        } else if (what == "key") {
            ap.key = a[3];
            if (a[3] == "default") ap.key.reset();
        } else {
            return 1;
        }
    } else {
        return 1;
    }
    if (write_console(root, c) != 0)
        return r.done("cannot write %s\n", ftxhost::kWifiConsoleFile) + 1;
    show(r);
    return 0;
}

const ftxsim::Word kWords[] = {
    {"wifi", kUsage, wifi_word},
};

__attribute__((constructor)) void register_wifi() {
    ftxsim::add_words(kWords, sizeof(kWords) / sizeof(kWords[0]), show);
}

}  // namespace
}  // namespace ftxwifi

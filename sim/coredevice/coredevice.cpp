// libdvk_ncoredevice.so: control words, the Wi-Fi-to-PC link switch and registration.
#include <atomic>

#include "coredevice.h"
#include "ftx_host.h"
#include "hw/libdvk_ncoredevice.h"

namespace ftxsim {
namespace {

std::atomic<bool> g_linkOn{false};
std::atomic<bool> g_linkFails{false};

int wifilink_word(const Args &a, Reply &r) {
    if (a.size() != 2 || (a[1] != "ok" && a[1] != "fail")) return 1;
    g_linkFails.store(a[1] == "fail");
    return r.done("wifilink switch %s\n", a[1].c_str());
}

void state(Reply &r) {
    battery_state(r);
    channel_state(r);
    r.add("wifilink: %s%s\n", g_linkOn.load() ? "on" : "off",
          g_linkFails.load() ? " (switch fails)" : "");
}

const Word kWords[] = {
    {"battery",
     "level 0..100 | temperature TENTHS_C | voltage MV | health 1..7 | present 0|1 | "
     "status 1..5|auto | low LEVEL | period MS",
     battery_word},
    {"charger", "ac|usb|wireless 0|1 [...] | none", charger_word},
    {"wifilink", "ok|fail  (whether the Wi-Fi-to-PC link switch works)", wifilink_word},
};

int control_fn(const char *line, char *reply, size_t size) {
    return control(line, reply, size);
}

__attribute__((constructor)) void register_coredevice() {
    add_words(kWords, sizeof(kWords) / sizeof(kWords[0]), state);
    ftx_host_register_hw("coredevice", control_fn);
}

int switch_link(const char *op, bool on) {
    int ok = call(op, g_linkFails.load() ? 0 : 1);
    if (ok & 1) {
        g_linkOn.store(on);
        put_value("wifilink.on", on ? 1 : 0);  // the factory's lights tell what they saw
    }
    return ok;
}

}  // namespace
}  // namespace ftxsim

extern "C" int mmi_AutoTest_WiFiConCpt_Enable(void) {
    return ftxsim::switch_link("mmi_AutoTest_WiFiConCpt_Enable", true);
}

extern "C" int mmi_AutoTest_WiFiConCpt_Disable(void) {
    return ftxsim::switch_link("mmi_AutoTest_WiFiConCpt_Disable", false);
}

extern "C" int ftx_sim_control(const char *line, char *reply, size_t size) {
    return ftxsim::control(line, reply, size);
}

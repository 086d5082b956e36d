// Routes "hw ..." control lines to the simulated libraries that registered for them.
#include <stdio.h>
#include <string.h>

#include <mutex>
#include <string>
#include <vector>

#include "ftx_host.h"

namespace {

struct HwEntry {
    std::string name;
    ftx_sim_control_fn fn;
};

std::mutex g_hwLock;
std::vector<HwEntry> g_hw;

}  // namespace

extern "C" void ftx_host_register_hw(const char *name, ftx_sim_control_fn fn) {
    if (name == nullptr || fn == nullptr) return;
    std::lock_guard<std::mutex> lock(g_hwLock);
    for (HwEntry &e : g_hw) {
        if (e.name == name) {
            e.fn = fn;
            return;
        }
    }
    g_hw.push_back({name, fn});
}

extern "C" int ftx_host_hw_dispatch(const char *line, char *reply, size_t size) {
    std::vector<HwEntry> entries;
    {
        std::lock_guard<std::mutex> lock(g_hwLock);
        entries = g_hw;
    }
    if (reply != nullptr && size > 0) reply[0] = '\0';
    for (const HwEntry &e : entries) {
        int rc = e.fn(line != nullptr ? line : "", reply, size);
        if (rc >= 0) return rc;
    }
    if (reply != nullptr && size > 0) snprintf(reply, size, "no hardware");
    return -1;
}

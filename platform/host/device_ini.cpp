// The simulated handset's settings: $FTX_ROOT/sim/device.ini.
#include <stdio.h>
#include <stdlib.h>
#include <string.h>

#include <map>
#include <mutex>
#include <string>

#include "devfs.h"
#include "ftx_host.h"
#include "host_internal.h"
#include "kv_file.h"

namespace {

std::mutex g_iniLock;
std::map<std::string, std::string> g_ini;
bool g_loaded = false;

}  // namespace

namespace ftxhost {
void device_ini_reset() {
    std::lock_guard<std::mutex> lock(g_iniLock);
    g_ini.clear();
    g_loaded = false;
}
}  // namespace ftxhost

extern "C" int ftx_device_ini_get(const char *section, const char *key, char *out, size_t size,
                                  const char *default_value) {
    std::string v;
    bool found = false;
    {
        std::lock_guard<std::mutex> lock(g_iniLock);
        if (!g_loaded) {
            char path[4096];
            if (dev_path("/sim/device.ini", path, sizeof(path)) == 0) {
                g_ini = ftxhost::read_kv_file(path, true);
            }
            g_loaded = true;
        }
        std::string k = std::string(section != nullptr ? section : "") + "." + (key ? key : "");
        auto it = g_ini.find(k);
        if (it != g_ini.end()) {
            v = it->second;
            found = true;
        }
    }
    if (!found && default_value != nullptr) v = default_value;
    if (out != nullptr && size > 0) snprintf(out, size, "%s", v.c_str());
    return found ? 0 : -1;
}

extern "C" int ftx_device_ini_get_int(const char *section, const char *key, int default_value) {
    char buf[64];
    if (ftx_device_ini_get(section, key, buf, sizeof(buf), nullptr) != 0 || buf[0] == '\0') {
        return default_value;
    }
    return atoi(buf);
}

extern "C" void ftx_host_reset(void) {
    ftxhost::root_reset();
    ftxhost::mounts_reset();
    ftxhost::properties_reset();
    ftxhost::device_ini_reset();
    ftxhost::log_reset();
}

// Android properties on the host: $FTX_ROOT/sim/properties, kept in memory.
#include <string.h>

#include <map>
#include <mutex>
#include <string>

#include <cutils/properties.h>

#include "devfs.h"
#include "host_internal.h"
#include "kv_file.h"

namespace {

std::mutex g_propLock;
std::map<std::string, std::string> g_props;
bool g_loaded = false;

void load_locked() {
    if (g_loaded) return;
    char path[4096];
    if (dev_path("/sim/properties", path, sizeof(path)) == 0) {
        g_props = ftxhost::read_kv_file(path, false);
    }
    g_loaded = true;
}

}  // namespace

namespace ftxhost {
void properties_reset() {
    std::lock_guard<std::mutex> lock(g_propLock);
    g_props.clear();
    g_loaded = false;
}
}  // namespace ftxhost

extern "C" int property_get(const char *key, char *value, const char *default_value) {
    if (value == nullptr) return 0;
    std::string v;
    {
        std::lock_guard<std::mutex> lock(g_propLock);
        load_locked();
        auto it = key != nullptr ? g_props.find(key) : g_props.end();
        if (it != g_props.end()) {
            v = it->second;
        } else if (default_value != nullptr) {
            v = default_value;
        }
    }
    size_t n = v.size() < PROPERTY_VALUE_MAX - 1 ? v.size() : PROPERTY_VALUE_MAX - 1;
    memcpy(value, v.data(), n);
    value[n] = '\0';
    return static_cast<int>(n);
}

extern "C" int property_set(const char *key, const char *value) {
    if (key == nullptr || value == nullptr || strlen(value) >= PROPERTY_VALUE_MAX) return -1;
    std::lock_guard<std::mutex> lock(g_propLock);
    load_locked();
    g_props[key] = value;
    return 0;
}

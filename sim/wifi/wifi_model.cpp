#include "wifi_model.h"

#include <arpa/inet.h>
#include <netinet/in.h>
#include <stdio.h>
#include <stdlib.h>
#include <sys/stat.h>

#include "devfs.h"
#include "ftx_host.h"
#include "kv_file.h"
#include "wifi_link.h"

namespace ftxwifi {
namespace {

std::string setting(const std::string &key, const char *fallback) {
    char buf[256];
    ftx_device_ini_get("wifi", key.c_str(), buf, sizeof(buf), fallback);
    return buf;
}

long number(const std::string &text, long lo, long hi, long fallback) {
    char *end = nullptr;
    long v = strtol(text.c_str(), &end, 10);
    if (text.empty() || end == nullptr || *end != '\0' || v < lo || v > hi) return fallback;
    return v;
}

// The first access point's keys have no prefix; the others are "apN.".
std::string prefix(int index) {
    return index == 0 ? "" : "ap" + std::to_string(index + 1) + ".";
}

}  // namespace

NetworkModel load_model() {
    NetworkModel m;
    for (int i = 0; i < kMaxAccessPoints; i++) {
        const std::string p = prefix(i);
        AccessPoint ap;
        ap.ssid = setting(p + "ssid", "");
        if (ap.ssid.empty() || ap.ssid.size() > 32) continue;
        ap.key = setting(p + "key", "");
        ap.keyMgmt = setting(p + "key_mgmt", ap.key.empty() ? "NONE" : "WPA-PSK");
        if (ap.keyMgmt != "NONE") ap.keyMgmt = "WPA-PSK";
        char bssid[32];
        snprintf(bssid, sizeof(bssid), "02:00:00:00:01:%02x", i + 1);
        ap.bssid = setting(p + "bssid", bssid);
        ap.freq = static_cast<int>(number(setting(p + "freq", ""), 2400, 7125, 2437));
        ap.rssi = static_cast<int>(number(setting(p + "rssi", ""), -120, 0, -55));
        m.aps.push_back(ap);
    }
    unsigned char mac[6] = {0};
    dev_if_hwaddr("wlan0", mac);
    char text[32];
    snprintf(text, sizeof(text), "%02x:%02x:%02x:%02x:%02x:%02x", mac[0], mac[1], mac[2], mac[3],
             mac[4], mac[5]);
    m.mac = text;
    m.address = setting("address", "");
    struct sockaddr_in host;
    char dotted[INET_ADDRSTRLEN];
    if (m.address.empty() && dev_service_addr("wlan0", 0, &host) == 0 &&
        inet_ntop(AF_INET, &host.sin_addr, dotted, sizeof(dotted)) != nullptr)
        m.address = dotted;
    m.joinMs = number(setting("join_ms", ""), 0, 600000, 600);
    return m;
}

ConsoleState read_console(const std::string &root) {
    ConsoleState c;
    const auto kv = ftxhost::read_kv_file((root + ftxhost::kWifiConsoleFile).c_str(), false);
    for (const auto &[key, value] : kv) {
        if (key == "linklocal") {
            c.linklocal = static_cast<int>(number(value, 0, 1000000, 0));
        } else if (key == "linklocal.serial") {
            c.linklocalSerial = strtoll(value.c_str(), nullptr, 10);
        } else if (key == "fail") {
            size_t i = 0;
            while (i < value.size()) {
                size_t comma = value.find(',', i);
                if (comma == std::string::npos) comma = value.size();
                if (comma > i) c.fails.insert(value.substr(i, comma - i));
                i = comma + 1;
            }
        } else if (key.rfind("ap.", 0) == 0) {
            size_t dot = key.find('.', 3);
            if (dot == std::string::npos) continue;
            long index = number(key.substr(3, dot - 3), 0, kMaxAccessPoints - 1, -1);
            if (index < 0) continue;
            const std::string field = key.substr(dot + 1);
            ConsoleState::Ap &ap = c.aps[static_cast<int>(index)];
            if (field == "on") ap.on = value == "1";
            if (field == "stuck") ap.stuck = value == "1";
            if (field == "rssi") ap.rssi = static_cast<int>(number(value, -120, 0, -55));
            if (field == "key") ap.key = ftxhost::wifi_unescape(value);
        }
    }
    return c;
}

int write_console(const std::string &root, const ConsoleState &state) {
    std::map<std::string, std::string> kv;
    for (const auto &[index, ap] : state.aps) {
        const std::string p = "ap." + std::to_string(index) + ".";
        if (ap.on) kv[p + "on"] = *ap.on ? "1" : "0";
        if (ap.stuck) kv[p + "stuck"] = *ap.stuck ? "1" : "0";
        if (ap.rssi) kv[p + "rssi"] = std::to_string(*ap.rssi);
        if (ap.key) kv[p + "key"] = ftxhost::wifi_escape(*ap.key);
    }
    if (state.linklocal > 0) {
        kv["linklocal"] = std::to_string(state.linklocal);
        kv["linklocal.serial"] = std::to_string(state.linklocalSerial);
    }
    std::string fails;
    for (const std::string &f : state.fails)
        fails += (fails.empty() ? "" : ",") + f;
    if (!fails.empty()) kv["fail"] = fails;
    mkdir((root + "/run").c_str(), 0755);
    mkdir((root + ftxhost::kWifiRunDir).c_str(), 0755);
    return ftxhost::wifi_write_file(root + ftxhost::kWifiConsoleFile, kv);
}

std::vector<AccessPoint> effective_aps(const NetworkModel &model, const ConsoleState &console) {
    std::vector<AccessPoint> aps = model.aps;
    for (const auto &[index, change] : console.aps) {
        if (index < 0 || static_cast<size_t>(index) >= aps.size()) continue;
        AccessPoint &ap = aps[static_cast<size_t>(index)];
        ap.on = change.on.value_or(ap.on);
        ap.stuck = change.stuck.value_or(ap.stuck);
        ap.rssi = change.rssi.value_or(ap.rssi);
        ap.key = change.key.value_or(ap.key);
    }
    return aps;
}

int find_ap(const NetworkModel &model, const std::string &ssid) {
    for (size_t i = 0; i < model.aps.size(); i++) {
        if (model.aps[i].ssid == ssid) return static_cast<int>(i);
    }
    return -1;
}

}  // namespace ftxwifi

// The simulated Wi-Fi network: the access points and the handset's interface as
// sim/device.ini [wifi] describes them, and what the console changed in them since
// ("hw wifi ..."), kept in the root's run/wifi/console so that the supplicant, a separate
// process, sees it.
#pragma once

#include <map>
#include <optional>
#include <set>
#include <string>
#include <vector>

namespace ftxwifi {

struct AccessPoint {
    std::string ssid;
    std::string keyMgmt = "WPA-PSK";  // or "NONE"
    std::string key;                  // the WPA passphrase
    std::string bssid;
    int freq = 2437;  // MHz
    int rssi = -55;   // dBm
    bool on = true;
    bool stuck = false;  // takes a handset's association and never completes it
};

// At most this many access points: [wifi] ssid=..., then ap2.ssid=... up to ap8.
inline constexpr int kMaxAccessPoints = 8;

struct NetworkModel {
    std::vector<AccessPoint> aps;
    std::string mac;      // the handset's wlan0, "02:00:00:00:00:01"
    std::string address;  // what DHCP hands out; empty: DHCP finds no server
    long joinMs = 600;    // scanning, associating and the key handshake together, unscaled
};

// Reads the model from the device settings through the platform.
NetworkModel load_model();

// What the console changed; each field left empty keeps the device settings' value.
struct ConsoleState {
    struct Ap {
        std::optional<bool> on, stuck;
        std::optional<int> rssi;
        std::optional<std::string> key;
    };
    std::map<int, Ap> aps;          // by index into NetworkModel::aps
    int linklocal = 0;              // DHCP rounds that hand out a link-local address
    long long linklocalSerial = 0;  // tells one "hw wifi linklocal" line from the next
    std::set<std::string> fails;    // request words answered "FAIL"
};

ConsoleState read_console(const std::string &root);
int write_console(const std::string &root, const ConsoleState &state);

// The access points with the console's changes applied.
std::vector<AccessPoint> effective_aps(const NetworkModel &model, const ConsoleState &console);

// The index of the access point named ssid, or -1.
int find_ap(const NetworkModel &model, const std::string &ssid);

}  // namespace ftxwifi

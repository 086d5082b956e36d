// The simulated Wi-Fi network's files in the device root, shared by the supplicant
// (sim/wifi), the handset's tools, the console's "hw wifi" lines and the platform's
// interface calls. Each file is written whole (a neighbour file renamed over it), so a reader
// always sees an old or a new version, never half of one.
#pragma once

#include <sys/types.h>

#include <map>
#include <string>

namespace ftxhost {

// Device paths.
inline constexpr char kWifiSocketDir[] = "/data/misc/wifi/sockets";
inline constexpr char kWifiSocket[] = "/data/misc/wifi/sockets/wlan0";
inline constexpr char kWifiRunDir[] = "/run/wifi";
// The supplicant's pid; the supplicant holds a write lock (fcntl) on it while it runs.
inline constexpr char kWifiPidFile[] = "/run/wifi/supplicant.pid";
// What the supplicant publishes: the link, the address it handed out, its counters.
inline constexpr char kWifiLinkFile[] = "/run/wifi/link";
// What the console changed in the network ("hw wifi ..."); absent: the device settings.
inline constexpr char kWifiConsoleFile[] = "/run/wifi/console";

// The pid of the supplicant that runs for the root (host folder), or 0.
pid_t wifi_supplicant_pid(const std::string &root);
bool wifi_supplicant_running(const std::string &root);

// The supplicant's published state ("key=value" lines), empty when it never ran.
std::map<std::string, std::string> wifi_read_link(const std::string &root);

// Writes "key=value" lines to hostPath whole: a neighbour file, fsync, rename. 0 or -1.
int wifi_write_file(const std::string &hostPath, const std::map<std::string, std::string> &kv);

// A text as one value of such a file: bytes outside '!'..'~' and '%' become %XX.
std::string wifi_escape(const std::string &text);
std::string wifi_unescape(const std::string &value);

}  // namespace ftxhost

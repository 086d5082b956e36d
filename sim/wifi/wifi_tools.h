// The handset's Wi-Fi tools, run by the handset tool program (sim/handset) under their names:
//   pv_wifi_init.sh     starts the root's supplicant (detached; nothing when one runs) and
//                       returns once it serves
//   pv_wifi_close.sh    stops it: its link and the address DHCP handed out end with it
//   dhcptool, dhcpcd    ask the supplicant for an address for wlan0
//   wpa_cli             the host's wpa_cli, on the root's control sockets only
// and "ifconfig wlan0 up|down" (toybox's applet), which takes the interface up or down.
#pragma once

#include <functional>
#include <string>

namespace ftxwifi {

// Runs the tool name (of the list above) for the device root (host folder); insideRoot tells
// whether a host path stays inside the root, links followed. Returns the exit status (may not
// return: wpa_cli).
int run_wifi_tool(const std::string &name, const std::string &root,
                  const std::function<bool(const std::string &)> &insideRoot, int argc,
                  char **argv);

// toybox ifconfig: "wlan0 down" and "wlan0 up" reach the supplicant; always 0.
int wifi_ifconfig(const std::string &root, int argc, char **argv);

// One request to the supplicant's control socket; 0 with its reply, -1 when nothing answered
// within timeoutMs.
int ctrl_request(const std::string &socketPath, const std::string &request, std::string *reply,
                 int timeoutMs);

}  // namespace ftxwifi

// The simulated supplicant's state: the networks its clients configured, the join of one of
// them to an access point of the model (scanning, associating, the key handshake, completed),
// the address DHCP handed out, and the replies to the control interface's requests. Plain
// logic over a clock the caller passes in; ftx_wpa_supplicant.cpp gives it a socket.
#pragma once

#include <limits.h>

#include <map>
#include <string>
#include <string_view>
#include <vector>

#include "wifi_model.h"
#include "wpa_request.h"

namespace ftxwifi {

// How long each step of a join takes (ms).
struct Timing {
    long long scanMs = 200, assocMs = 200, handshakeMs = 200;
    long long retryMs = 1000;  // after a failed handshake, before scanning again
};
// A join of joinMs split in three steps, scaled (FTX_TIME_SCALE).
Timing scaled_timing(long joinMs, double scale);

class Supplicant {
  public:
    Supplicant(NetworkModel model, Timing timing);

    // The console's changes to the network, taken at once.
    void set_console(const ConsoleState &console);
    // Link-local rounds already handed out for the console line with that serial.
    void restore_linklocal(long long serial, int used);

    // Answers one request at nowMs; *terminate is set when the request ends the supplicant.
    std::string handle(std::string_view request, long long nowMs, bool *terminate = nullptr);
    // Moves the join on to nowMs.
    void tick(long long nowMs);
    // When tick next has something to do (LLONG_MAX: not until a request or a change).
    long long next_event(long long nowMs) const;

    // The state as wpa_state names it ("COMPLETED", "SCANNING", ...).
    const char *state() const;
    // What the supplicant publishes for the other processes (run/wifi/link).
    std::map<std::string, std::string> published() const;

  private:
    enum class Phase { Disabled, Idle, Scanning, Associating, Handshake, Completed, Lost };
    struct Network {
        std::string ssid;
        bool hasSsid = false;
        std::string keyMgmt = "WPA-PSK WPA-EAP";
        std::string psk;
        bool hasPsk = false;
        bool enabled = false;
    };

    std::string set_network(const WpaRequest &r);
    std::string get_network(const WpaRequest &r) const;
    std::string list_networks() const;
    std::string status() const;
    std::string signal_poll() const;
    std::string dhcp();
    // Enables, disables or removes the addressed networks; FAIL for an unknown id.
    std::string change_networks(const WpaRequest &r, long long nowMs);

    bool matches(const Network &n, const AccessPoint &ap) const;
    bool still_joined() const;  // the network and access point of the join still fit
    void start_scan(long long nowMs);
    void drop_link(Phase next, long long nowMs);
    void enter(Phase p, long long until);
    int linklocal_left() const;

    NetworkModel model_;
    Timing timing_;
    ConsoleState console_;
    std::vector<AccessPoint> aps_;
    std::map<int, Network> networks_;
    Phase phase_ = Phase::Idle;
    long long phaseEnd_ = 0;
    int current_ = -1;  // the network being joined or joined
    int bss_ = -1;      // its access point, an index into aps_
    bool ifUp_ = true;
    bool disconnected_ = false;  // DISCONNECT: no join until RECONNECT or a selection
    std::string lease_;          // the address DHCP handed out, for network leaseNet_
    int leaseNet_ = -1;
    long failures_ = 0;  // key handshakes that failed
    long long linklocalSerial_ = 0;
    int linklocalUsed_ = 0;
};

}  // namespace ftxwifi

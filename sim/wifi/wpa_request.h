// The requests of the supplicant's control interface, read from one datagram: the request's
// word, a network id and, for SET_NETWORK and GET_NETWORK, a field and its value. The
// parser only reads; what a request does is the supplicant's (supplicant.h).
#pragma once

#include <string>
#include <string_view>

namespace ftxwifi {

enum class Verb {
    Unknown,
    Ping,
    AddNetwork,
    SetNetwork,
    GetNetwork,
    SelectNetwork,
    EnableNetwork,
    DisableNetwork,
    RemoveNetwork,
    ListNetworks,
    Reconnect,
    Reassociate,
    Disconnect,
    Status,
    SignalPoll,
    Attach,
    Detach,
    Terminate,
    // The simulation's own requests, from the handset's tools: an address from DHCP, the
    // interface taken down or brought up.
    SimDhcp,
    SimIfDown,
    SimIfUp,
};

struct WpaRequest {
    Verb verb = Verb::Unknown;
    std::string word;  // the request's first word as sent ("STATUS"); what "hw wifi fail" names
    bool wellFormed = false;  // the arguments the verb needs are there and valid
    int id = -1;              // the network id; -1 with all set for "all" / "any"
    bool all = false;
    std::string field;  // SET_NETWORK / GET_NETWORK
    std::string value;  // SET_NETWORK: the rest of the request, as sent
};

// Largest request and reply the control interface carries.
inline constexpr size_t kMaxMessage = 4096;

// Reads one request. An optional "IFNAME=wlan0 " prefix and one trailing newline are
// skipped; words are case-sensitive, as the supplicant reads them.
WpaRequest parse_request(std::string_view text);

// A network's "ssid" value: a quoted text ("\"name\"") or hex digits, 1..32 bytes.
bool decode_ssid(const std::string &value, std::string *ssid);
// A "psk" value: a quoted passphrase of 8..63 printable characters, or 64 hex digits.
bool decode_psk(const std::string &value, std::string *psk);
// A "key_mgmt" value: blank-separated known names; true with them in *names (one blank
// between names).
bool decode_key_mgmt(const std::string &value, std::string *names);

}  // namespace ftxwifi

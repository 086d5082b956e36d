#include "supplicant.h"

#include <stdio.h>

#include "wifi_link.h"

namespace ftxwifi {
namespace {

const char kOk[] = "OK\n";
const char kFail[] = "FAIL\n";

bool has_word(const std::string &list, const char *word) {
    const std::string w = word;
    size_t i = 0;
    while (i <= list.size()) {
        size_t end = list.find(' ', i);
        if (end == std::string::npos) end = list.size();
        if (list.compare(i, end - i, w) == 0 && end - i == w.size()) return true;
        i = end + 1;
    }
    return false;
}

// An SSID as the supplicant prints it: printable bytes as they are, '"' and '\' escaped,
// others as \xHH.
std::string ssid_text(const std::string &ssid) {
    std::string out;
    for (unsigned char c : ssid) {
        if (c == '"' || c == '\\') {
            out += '\\';
            out += static_cast<char>(c);
        } else if (c >= ' ' && c <= '~') {
            out += static_cast<char>(c);
        } else {
            char hex[8];
            snprintf(hex, sizeof(hex), "\\x%02x", c);
            out += hex;
        }
    }
    return out;
}

int link_speed(int rssi) {
    if (rssi >= -60) return 72;
    if (rssi >= -70) return 65;
    if (rssi >= -80) return 26;
    return 6;
}

}  // namespace

Timing scaled_timing(long joinMs, double scale) {
    auto scaled = [scale](double ms) { return static_cast<long long>(ms * scale + 0.5); };
    Timing t;
    t.scanMs = t.assocMs = t.handshakeMs = scaled(joinMs / 3.0);
    t.retryMs = scaled(joinMs * 5.0 / 3.0);
    return t;
}

Supplicant::Supplicant(NetworkModel model, Timing timing)
    : model_(std::move(model)), timing_(timing), aps_(model_.aps) {}

void Supplicant::set_console(const ConsoleState &console) {
    console_ = console;
    aps_ = effective_aps(model_, console_);
}

void Supplicant::restore_linklocal(long long serial, int used) {
    linklocalSerial_ = serial;
    linklocalUsed_ = used;
}

void Supplicant::enter(Phase p, long long until) {
    phase_ = p;
    phaseEnd_ = until;
}

bool Supplicant::matches(const Network &n, const AccessPoint &ap) const {
    if (!n.enabled || !n.hasSsid || n.ssid != ap.ssid || !ap.on) return false;
    return has_word(n.keyMgmt, ap.keyMgmt == "NONE" ? "NONE" : "WPA-PSK");
}

bool Supplicant::still_joined() const {
    auto it = networks_.find(current_);
    if (it == networks_.end() || bss_ < 0 || static_cast<size_t>(bss_) >= aps_.size()) return false;
    return matches(it->second, aps_[static_cast<size_t>(bss_)]);
}

void Supplicant::start_scan(long long nowMs) {
    current_ = bss_ = -1;
    enter(Phase::Scanning, nowMs + timing_.scanMs);
}

void Supplicant::drop_link(Phase next, long long nowMs) {
    lease_.clear();
    leaseNet_ = current_ = bss_ = -1;
    enter(next, nowMs);
}

void Supplicant::tick(long long nowMs) {
    // A late tick may owe several steps; each step either moves on or waits.
    for (int step = 0; step < 8; step++) {
        const Phase before = phase_;
        const long long endBefore = phaseEnd_;
        if (!ifUp_) {
            if (phase_ != Phase::Disabled) drop_link(Phase::Disabled, nowMs);
            return;
        }
        if (phase_ == Phase::Disabled) enter(Phase::Idle, nowMs);
        if (disconnected_) return;
        bool anyEnabled = false;
        for (const auto &[id, n] : networks_)
            anyEnabled = anyEnabled || n.enabled;
        const AccessPoint *ap =
            bss_ >= 0 && static_cast<size_t>(bss_) < aps_.size() ? &aps_[bss_] : nullptr;
        switch (phase_) {
            case Phase::Disabled:
                break;
            case Phase::Idle:
                if (anyEnabled) start_scan(nowMs);
                break;
            case Phase::Scanning: {
                if (nowMs < phaseEnd_) break;
                if (!anyEnabled) {
                    enter(Phase::Idle, nowMs);
                    break;
                }
                for (const auto &[id, n] : networks_) {
                    for (size_t i = 0; i < aps_.size() && current_ < 0; i++) {
                        if (!matches(n, aps_[i])) continue;
                        current_ = id;
                        bss_ = static_cast<int>(i);
                    }
                }
                if (current_ < 0) {
                    phaseEnd_ = nowMs + timing_.scanMs;  // scan again
                    return;
                }
                if (leaseNet_ != current_) {
                    lease_.clear();
                    leaseNet_ = -1;
                }
                enter(Phase::Associating, nowMs + timing_.assocMs);
                break;
            }
            case Phase::Associating:
                if (!still_joined()) {
                    start_scan(nowMs);
                } else if (!ap->stuck && nowMs >= phaseEnd_) {
                    if (ap->keyMgmt == "NONE") {
                        enter(Phase::Completed, nowMs);
                    } else {
                        enter(Phase::Handshake, nowMs + timing_.handshakeMs);
                    }
                }
                break;
            case Phase::Handshake: {
                if (!still_joined()) {
                    start_scan(nowMs);
                    break;
                }
                if (nowMs < phaseEnd_) break;
                const Network &n = networks_.find(current_)->second;
                if (n.hasPsk && n.psk == ap->key) {
                    enter(Phase::Completed, nowMs);
                } else {
                    failures_++;
                    enter(Phase::Lost, nowMs + timing_.retryMs);
                }
                break;
            }
            case Phase::Completed:
                // A vanished access point, or one whose key changed, drops the link.
                if (!still_joined() ||
                    (ap->keyMgmt != "NONE" && networks_.find(current_)->second.psk != ap->key))
                    enter(Phase::Lost, nowMs + timing_.scanMs);
                break;
            case Phase::Lost:
                if (nowMs >= phaseEnd_) start_scan(nowMs);
                break;
        }
        if (phase_ == before && phaseEnd_ == endBefore) return;
    }
}

long long Supplicant::next_event(long long nowMs) const {
    switch (phase_) {
        case Phase::Idle: {
            for (const auto &[id, n] : networks_) {
                if (n.enabled && !disconnected_) return nowMs;
            }
            return LLONG_MAX;
        }
        case Phase::Scanning:
        case Phase::Handshake:
        case Phase::Lost:
            return phaseEnd_;
        case Phase::Associating:
            return bss_ >= 0 && static_cast<size_t>(bss_) < aps_.size() && aps_[bss_].stuck
                       ? LLONG_MAX
                       : phaseEnd_;
        default:
            return LLONG_MAX;
    }
}

const char *Supplicant::state() const {
    switch (phase_) {
        case Phase::Disabled:
            return "INTERFACE_DISABLED";
        case Phase::Scanning:
            return "SCANNING";
        case Phase::Associating:
            return "ASSOCIATING";
        case Phase::Handshake:
            return "4WAY_HANDSHAKE";
        case Phase::Completed:
            return "COMPLETED";
        default:
            return "DISCONNECTED";
    }
}

std::string Supplicant::handle(std::string_view request, long long nowMs, bool *terminate) {
    if (terminate != nullptr) *terminate = false;
    const WpaRequest r = parse_request(request);
    if (!r.word.empty() && console_.fails.count(r.word) != 0) return kFail;
    if (r.verb == Verb::Unknown) return "UNKNOWN COMMAND\n";
    if (!r.wellFormed) return kFail;
    tick(nowMs);
    std::string reply = kOk;
    switch (r.verb) {
        case Verb::Ping:
            return "PONG\n";
        case Verb::AddNetwork: {
            const int id = networks_.empty() ? 0 : networks_.rbegin()->first + 1;
            networks_[id] = Network{};
            return std::to_string(id) + "\n";
        }
        case Verb::SetNetwork:
            return set_network(r);
        case Verb::GetNetwork:
            return get_network(r);
        case Verb::ListNetworks:
            return list_networks();
        case Verb::SelectNetwork: {
            if (!r.all && networks_.count(r.id) == 0) return kFail;
            for (auto &[id, n] : networks_)
                n.enabled = r.all || id == r.id;
            disconnected_ = false;
            if (phase_ == Phase::Disabled) break;
            if (phase_ == Phase::Completed && still_joined()) break;  // already there
            if (current_ >= 0 && !still_joined()) drop_link(Phase::Idle, nowMs);
            start_scan(nowMs);
            break;
        }
        case Verb::EnableNetwork:
        case Verb::DisableNetwork:
        case Verb::RemoveNetwork:
            reply = change_networks(r, nowMs);
            break;
        case Verb::Reconnect:
            if (phase_ == Phase::Disabled) return kFail;
            if (disconnected_ || phase_ == Phase::Lost) {
                disconnected_ = false;
                start_scan(nowMs);
            }
            break;
        case Verb::Reassociate:
            if (phase_ == Phase::Disabled) return kFail;
            disconnected_ = false;
            start_scan(nowMs);
            break;
        case Verb::Disconnect:
            disconnected_ = true;
            drop_link(Phase::Idle, nowMs);
            break;
        case Verb::Status:
            return status();
        case Verb::SignalPoll:
            return signal_poll();
        case Verb::Attach:
        case Verb::Detach:
            break;
        case Verb::Terminate:
            if (terminate != nullptr) *terminate = true;
            break;
        case Verb::SimDhcp:
            return dhcp();
        case Verb::SimIfDown:
            ifUp_ = false;
            drop_link(Phase::Disabled, nowMs);
            break;
        case Verb::SimIfUp:
            if (!ifUp_) {
                ifUp_ = true;
                enter(Phase::Idle, nowMs);
            }
            break;
        case Verb::Unknown:
            break;
    }
    tick(nowMs);
    return reply;
}

std::string Supplicant::set_network(const WpaRequest &r) {
    auto it = networks_.find(r.id);
    if (it == networks_.end()) return kFail;
    Network &n = it->second;
    if (r.field == "ssid") {
        if (!decode_ssid(r.value, &n.ssid)) return kFail;
        n.hasSsid = true;
    } else if (r.field == "key_mgmt") {
        if (!decode_key_mgmt(r.value, &n.keyMgmt)) return kFail;
    } else if (r.field == "psk") {
        if (!decode_psk(r.value, &n.psk)) return kFail;
        n.hasPsk = true;
    } else if (r.field == "scan_ssid" || r.field == "priority") {
        if (r.value.empty() || r.value.size() > 9 ||
            r.value.find_first_not_of("0123456789") != std::string::npos)
            return kFail;
    } else {
        return kFail;
    }
    return kOk;
}

// As the supplicant answers it: the value alone, without a line end.
std::string Supplicant::get_network(const WpaRequest &r) const {
    auto it = networks_.find(r.id);
    if (it == networks_.end()) return kFail;
    const Network &n = it->second;
    if (r.field == "ssid" && n.hasSsid) return "\"" + n.ssid + "\"";
    if (r.field == "key_mgmt") return n.keyMgmt;
    if (r.field == "psk" && n.hasPsk) return "*";
    return kFail;
}

std::string Supplicant::list_networks() const {
    std::string out = "network id / ssid / bssid / flags\n";
    for (const auto &[id, n] : networks_) {
        std::string flags;
        if (id == current_ && phase_ == Phase::Completed) flags = "[CURRENT]";
        if (!n.enabled) flags = "[DISABLED]";
        out += std::to_string(id) + "\t" + ssid_text(n.ssid) + "\tany\t" + flags + "\n";
    }
    return out;
}

std::string Supplicant::change_networks(const WpaRequest &r, long long nowMs) {
    if (!r.all && networks_.count(r.id) == 0) return kFail;
    std::vector<int> ids;
    for (const auto &[id, n] : networks_) {
        if (r.all || id == r.id) ids.push_back(id);
    }
    for (int id : ids) {
        if (r.verb == Verb::RemoveNetwork) {
            networks_.erase(id);
        } else {
            networks_[id].enabled = r.verb == Verb::EnableNetwork;
        }
        if (id == leaseNet_ && r.verb != Verb::EnableNetwork) {
            lease_.clear();
            leaseNet_ = -1;
        }
    }
    auto current = networks_.find(current_);
    if (current_ >= 0 && (current == networks_.end() || !current->second.enabled))
        drop_link(Phase::Idle, nowMs);
    return kOk;
}

std::string Supplicant::status() const {
    std::string s;
    auto net = networks_.find(current_);
    const bool joined = (phase_ == Phase::Associating || phase_ == Phase::Handshake ||
                         phase_ == Phase::Completed) &&
                        bss_ >= 0 && net != networks_.end();
    if (joined) {
        const AccessPoint &ap = aps_[static_cast<size_t>(bss_)];
        s += "bssid=" + ap.bssid + "\nfreq=" + std::to_string(ap.freq) +
             "\nssid=" + ssid_text(net->second.ssid) + "\nid=" + std::to_string(current_) +
             "\nmode=station\n";
        if (phase_ == Phase::Completed) {
            const bool psk = ap.keyMgmt != "NONE";
            s += std::string("pairwise_cipher=") + (psk ? "CCMP" : "NONE") +
                 "\ngroup_cipher=" + (psk ? "CCMP" : "NONE") +
                 "\nkey_mgmt=" + (psk ? "WPA2-PSK" : "NONE") + "\n";
        }
    }
    s += std::string("wpa_state=") + state() + "\n";
    if (phase_ == Phase::Completed && !lease_.empty()) s += "ip_address=" + lease_ + "\n";
    s += "address=" + model_.mac + "\n";
    return s;
}

std::string Supplicant::signal_poll() const {
    if (phase_ != Phase::Completed) return kFail;
    const AccessPoint &ap = aps_[static_cast<size_t>(bss_)];
    return "RSSI=" + std::to_string(ap.rssi) +
           "\nLINKSPEED=" + std::to_string(link_speed(ap.rssi)) +
           "\nNOISE=-92\nFREQUENCY=" + std::to_string(ap.freq) + "\n";
}

int Supplicant::linklocal_left() const {
    if (console_.linklocal <= 0) return 0;
    const int used = linklocalSerial_ == console_.linklocalSerial ? linklocalUsed_ : 0;
    return used >= console_.linklocal ? 0 : console_.linklocal - used;
}

std::string Supplicant::dhcp() {
    if (phase_ != Phase::Completed) return kFail;
    if (linklocal_left() > 0) {
        if (linklocalSerial_ != console_.linklocalSerial) {
            linklocalSerial_ = console_.linklocalSerial;
            linklocalUsed_ = 0;
        }
        unsigned int mac[6] = {0};
        sscanf(model_.mac.c_str(), "%x:%x:%x:%x:%x:%x", &mac[0], &mac[1], &mac[2], &mac[3], &mac[4],
               &mac[5]);
        // 169.254.0.x and 169.254.255.x are reserved; each round gets another address.
        lease_ = "169.254." + std::to_string(1 + mac[4] % 254) + "." +
                 std::to_string(1 + (mac[5] + static_cast<unsigned>(linklocalUsed_)) % 254);
        linklocalUsed_++;
    } else if (!model_.address.empty()) {
        lease_ = model_.address;
    } else {
        return kFail;
    }
    leaseNet_ = current_;
    return lease_ + "\n";
}

std::map<std::string, std::string> Supplicant::published() const {
    std::map<std::string, std::string> kv;
    kv["wpa_state"] = state();
    auto net = networks_.find(current_);
    if (bss_ >= 0 && net != networks_.end()) {
        const AccessPoint &ap = aps_[static_cast<size_t>(bss_)];
        kv["ssid"] = ftxhost::wifi_escape(net->second.ssid);
        kv["bssid"] = ap.bssid;
        kv["freq"] = std::to_string(ap.freq);
    }
    if (phase_ == Phase::Completed && !lease_.empty()) kv["ip"] = lease_;
    kv["if_up"] = ifUp_ ? "1" : "0";
    kv["failures"] = std::to_string(failures_);
    kv["linklocal.serial"] = std::to_string(linklocalSerial_);
    kv["linklocal.used"] = std::to_string(linklocalUsed_);
    kv["linklocal.left"] = std::to_string(linklocal_left());
    kv["networks"] = std::to_string(networks_.size());
    return kv;
}

}  // namespace ftxwifi

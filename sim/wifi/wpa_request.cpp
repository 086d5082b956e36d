#include "wpa_request.h"

namespace ftxwifi {
namespace {

struct VerbName {
    const char *word;
    Verb verb;
    bool takesArguments;  // "WORD args"; the others are the whole request
};

const VerbName kVerbs[] = {
    {"PING", Verb::Ping, false},
    {"ADD_NETWORK", Verb::AddNetwork, false},
    {"SET_NETWORK", Verb::SetNetwork, true},
    {"GET_NETWORK", Verb::GetNetwork, true},
    {"SELECT_NETWORK", Verb::SelectNetwork, true},
    {"ENABLE_NETWORK", Verb::EnableNetwork, true},
    {"DISABLE_NETWORK", Verb::DisableNetwork, true},
    {"REMOVE_NETWORK", Verb::RemoveNetwork, true},
    {"LIST_NETWORKS", Verb::ListNetworks, false},
    {"RECONNECT", Verb::Reconnect, false},
    {"REASSOCIATE", Verb::Reassociate, false},
    {"DISCONNECT", Verb::Disconnect, false},
    {"STATUS", Verb::Status, false},
    {"SIGNAL_POLL", Verb::SignalPoll, false},
    {"ATTACH", Verb::Attach, false},
    {"DETACH", Verb::Detach, false},
    {"TERMINATE", Verb::Terminate, false},
    {"SIM_DHCP", Verb::SimDhcp, false},
    {"SIM_IFDOWN", Verb::SimIfDown, false},
    {"SIM_IFUP", Verb::SimIfUp, false},
};

const char *const kKeyMgmtNames[] = {
    "NONE",   "WPA-PSK", "WPA-EAP",        "IEEE8021X",      "SAE",
    "FT-PSK", "FT-EAP",  "WPA-PSK-SHA256", "WPA-EAP-SHA256", "OWE"};

bool parse_id(std::string_view text, int *id) {
    if (text.empty() || text.size() > 9) return false;
    int v = 0;
    for (char c : text) {
        if (c < '0' || c > '9') return false;
        v = v * 10 + (c - '0');
    }
    *id = v;
    return true;
}

// "ID" or the word that names every network.
bool parse_target(std::string_view text, const char *allWord, WpaRequest *r) {
    if (text == allWord) {
        r->all = true;
        return true;
    }
    return parse_id(text, &r->id);
}

int hex_value(char c) {
    if (c >= '0' && c <= '9') return c - '0';
    if (c >= 'a' && c <= 'f') return c - 'a' + 10;
    if (c >= 'A' && c <= 'F') return c - 'A' + 10;
    return -1;
}

bool decode_hex(const std::string &text, std::string *out) {
    if (text.empty() || text.size() % 2 != 0) return false;
    std::string bytes;
    for (size_t i = 0; i < text.size(); i += 2) {
        int hi = hex_value(text[i]), lo = hex_value(text[i + 1]);
        if (hi < 0 || lo < 0) return false;
        bytes += static_cast<char>(hi * 16 + lo);
    }
    *out = bytes;
    return true;
}

bool quoted(const std::string &value) {
    return value.size() >= 2 && value.front() == '"' && value.back() == '"';
}

}  // namespace

WpaRequest parse_request(std::string_view text) {
    WpaRequest r;
    // The request is a C string to the supplicant: it ends at the first NUL.
    size_t nul = text.find('\0');
    if (nul != std::string_view::npos) text = text.substr(0, nul);
    if (!text.empty() && text.back() == '\n') text.remove_suffix(1);
    if (text.substr(0, 7) == "IFNAME=") {
        size_t space = text.find(' ');
        text = space == std::string_view::npos ? std::string_view() : text.substr(space + 1);
    }
    size_t space = text.find(' ');
    std::string_view word = text.substr(0, space);
    r.word = std::string(word);
    for (const VerbName &v : kVerbs) {
        if (word != v.word) continue;
        if (v.takesArguments != (space != std::string_view::npos)) return r;  // unknown
        r.verb = v.verb;
        break;
    }
    if (r.verb == Verb::Unknown) return r;
    std::string_view args =
        space == std::string_view::npos ? std::string_view() : text.substr(space + 1);
    switch (r.verb) {
        case Verb::SetNetwork:
        case Verb::GetNetwork: {
            size_t a = args.find(' ');
            if (a == std::string_view::npos || !parse_id(args.substr(0, a), &r.id)) return r;
            std::string_view rest = args.substr(a + 1);
            size_t b = rest.find(' ');
            r.field = std::string(rest.substr(0, b));
            if (r.verb == Verb::SetNetwork) {
                if (b == std::string_view::npos) return r;
                r.value = std::string(rest.substr(b + 1));
            } else if (b != std::string_view::npos) {
                return r;
            }
            r.wellFormed = !r.field.empty();
            return r;
        }
        case Verb::SelectNetwork:
            r.wellFormed = parse_target(args, "any", &r);
            return r;
        case Verb::EnableNetwork:
        case Verb::DisableNetwork:
        case Verb::RemoveNetwork:
            r.wellFormed = parse_target(args, "all", &r);
            return r;
        default:
            r.wellFormed = true;
            return r;
    }
}

bool decode_ssid(const std::string &value, std::string *ssid) {
    std::string bytes;
    if (quoted(value)) {
        bytes = value.substr(1, value.size() - 2);
    } else if (!decode_hex(value, &bytes)) {
        return false;
    }
    if (bytes.empty() || bytes.size() > 32) return false;
    *ssid = bytes;
    return true;
}

bool decode_psk(const std::string &value, std::string *psk) {
    if (quoted(value)) {
        std::string pass = value.substr(1, value.size() - 2);
        if (pass.size() < 8 || pass.size() > 63) return false;
        for (char c : pass) {
            if (c < ' ' || c > '~') return false;
        }
        *psk = pass;
        return true;
    }
    std::string bytes;
    if (value.size() != 64 || !decode_hex(value, &bytes)) return false;
    *psk = value;
    return true;
}

bool decode_key_mgmt(const std::string &value, std::string *names) {
    std::string out;
    size_t i = 0;
    while (i < value.size()) {
        if (value[i] == ' ') {
            i++;
            continue;
        }
        size_t end = value.find(' ', i);
        std::string name = value.substr(i, end == std::string::npos ? end : end - i);
        bool known = false;
        for (const char *k : kKeyMgmtNames)
            known = known || name == k;
        if (!known) return false;
        out += (out.empty() ? "" : " ") + name;
        i = end == std::string::npos ? value.size() : end;
    }
    if (out.empty()) return false;
    *names = out;
    return true;
}

}  // namespace ftxwifi

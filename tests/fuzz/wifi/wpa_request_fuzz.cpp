// Any requests, one per line, with the clock moved between them: the parser and the
// supplicant never crash, every reply is a whole answer within the interface's size, and the
// published state agrees with the state the replies give.
#include <stdint.h>
#include <stdio.h>
#include <stdlib.h>

#include <string>
#include <string_view>

#include "supplicant.h"
#include "wpa_request.h"

namespace {

[[noreturn]] void finding(const char *what, const std::string &request, const std::string &reply) {
    fprintf(stderr, "%s\nrequest: %s\nreply:   %s\n", what, request.c_str(), reply.c_str());
    abort();
}

ftxwifi::NetworkModel model() {
    ftxwifi::NetworkModel m;
    ftxwifi::AccessPoint lab;
    lab.ssid = "LAB";
    lab.key = "secret123";
    lab.bssid = "02:00:00:00:01:01";
    ftxwifi::AccessPoint open = lab;
    open.ssid = "OPEN";
    open.keyMgmt = "NONE";
    open.key.clear();
    m.aps = {lab, open};
    m.mac = "02:00:00:00:00:01";
    m.address = "10.0.0.2";
    return m;
}

void check_values(const ftxwifi::WpaRequest &r) {
    std::string v;
    if (ftxwifi::decode_ssid(r.value, &v) && (v.empty() || v.size() > 32))
        finding("ssid of a bad length", r.value, v);
    if (ftxwifi::decode_psk(r.value, &v) && !(v.size() >= 8 && v.size() <= 64))
        finding("psk of a bad length", r.value, v);
    if (ftxwifi::decode_key_mgmt(r.value, &v) && (v.empty() || v.find("  ") != std::string::npos))
        finding("key_mgmt badly joined", r.value, v);
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t *data, size_t size) {
    ftxwifi::Supplicant s(model(), ftxwifi::Timing{3, 3, 3, 7});
    ftxwifi::ConsoleState console;
    long long now = 0;
    std::string_view in(reinterpret_cast<const char *>(data), size);
    for (int n = 0; n < 64 && !in.empty(); n++) {
        size_t end = in.find('\n');
        std::string_view line = in.substr(0, end);
        in = end == std::string_view::npos ? std::string_view() : in.substr(end + 1);
        // A leading byte below 0x20 changes the console or moves the clock instead.
        if (!line.empty() && static_cast<unsigned char>(line[0]) < 0x20) {
            const unsigned char c = static_cast<unsigned char>(line[0]);
            if (c % 4 == 0) console.aps[c / 4 % 2].on = !console.aps[c / 4 % 2].on.value_or(true);
            if (c % 4 == 1) console.linklocal = c;
            if (c % 4 == 2) console.aps[0].key = std::string(line.substr(1));
            s.set_console(console);
            now += c;
            s.tick(now);
            continue;
        }
        const std::string request(line);
        const ftxwifi::WpaRequest r = ftxwifi::parse_request(request);
        check_values(r);
        bool terminate = false;
        const std::string reply = s.handle(request, now, &terminate);
        if (reply.empty() || reply.size() > ftxwifi::kMaxMessage)
            finding("reply empty or too long", request, reply);
        if (r.verb != ftxwifi::Verb::GetNetwork && reply.back() != '\n')
            finding("reply without its line end", request, reply);
        if (terminate != (r.verb == ftxwifi::Verb::Terminate && reply == "OK\n"))
            finding("terminate without TERMINATE", request, reply);
        auto published = s.published();
        if (published.count("ip") != 0 && published["wpa_state"] != "COMPLETED")
            finding("an address without a completed link", request, reply);
        if (r.verb == ftxwifi::Verb::Status && reply != "FAIL\n" &&
            reply.find(std::string("wpa_state=") + s.state() + "\n") == std::string::npos)
            finding("STATUS disagrees with the state", request, reply);
        now += 1 + static_cast<long long>(request.size() % 5);
    }
    return 0;
}

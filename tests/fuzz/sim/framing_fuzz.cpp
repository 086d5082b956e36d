// Feeds arbitrary bytes in arbitrary chunks to the channel's line framer, stopping after
// arbitrary lines and feeding the rest again as the channel does when a client's answers
// are over their bound, and checks every line against a plain split of the whole input.
// Also checks the port setting's parser against a plain reading of the same bytes.
#include <stddef.h>
#include <stdint.h>
#include <stdlib.h>

#include <string>
#include <utility>
#include <vector>

#include "line_framer.h"
#include "pc_port.h"

namespace {

const size_t kMax = 64;  // small, so overlong lines are common

std::vector<std::pair<std::string, bool>> reference(const std::string &in) {
    std::vector<std::pair<std::string, bool>> out;
    size_t start = 0, lf;
    while ((lf = in.find('\n', start)) != std::string::npos) {
        std::string line = in.substr(start, lf - start);
        if (!line.empty() && line.back() == '\r') line.pop_back();
        bool overlong = line.size() > kMax;
        out.emplace_back(overlong ? "" : line, overlong);
        start = lf + 1;
    }
    return out;
}

// A port is blanks, 1 to 5 digits of value at most 65535, then blanks or line ends.
bool port_reference(const std::string &text, int *port) {
    size_t i = text.find_first_not_of(" \t");
    if (i == std::string::npos) return false;
    size_t end = text.find_first_not_of("0123456789", i);
    if (end == std::string::npos) end = text.size();
    if (end == i || end - i > 5) return false;
    if (text.find_first_not_of(" \t\r\n", end) != std::string::npos) return false;
    long v = strtol(text.substr(i, end - i).c_str(), nullptr, 10);
    if (v > 65535) return false;
    *port = static_cast<int>(v);
    return true;
}

void check_port(const std::string &in) {
    std::string text = in.substr(0, in.find('\0'));
    int got = -1, want = -1;
    bool ok = ftxsim::pc_port_parse(text.c_str(), &got);
    if (ok != port_reference(text, &want) || (ok && got != want)) abort();
    if (!ok && got != -1) abort();
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t *data, size_t size) {
    if (size < 2) return 0;
    // The first byte picks the chunk sizes the bytes arrive in, the second the lines after
    // which the feeding stops.
    unsigned seed = data[0];
    unsigned stops = data[1];
    std::string in(reinterpret_cast<const char *>(data + 2), size - 2);
    check_port(in);
    ftxsim::LineFramer f(kMax);
    std::vector<std::pair<std::string, bool>> got;
    std::string held;
    size_t i = 0;
    unsigned lines = 0;
    while (i < in.size() || !held.empty()) {
        if (i < in.size()) {
            seed = seed * 1103515245u + 12345u;
            size_t chunk = 1 + (seed >> 16) % 17;
            if (chunk > in.size() - i) chunk = in.size() - i;
            held.append(in, i, chunk);
            i += chunk;
        }
        size_t used = f.feed(held.data(), held.size(), [&](const std::string &line, bool overlong) {
            if (line.size() > kMax) abort();
            got.emplace_back(line, overlong);
            return ((stops >> (++lines % 8)) & 1) == 0;
        });
        if (used > held.size()) abort();
        held.erase(0, used);
        if (f.pending() > kMax + 1) abort();
    }
    if (got != reference(in)) abort();
    return 0;
}

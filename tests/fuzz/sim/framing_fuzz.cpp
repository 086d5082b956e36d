// Feeds arbitrary bytes in arbitrary chunks to the channel's line framer and checks every
// line against a plain split of the whole input.
#include <stddef.h>
#include <stdint.h>
#include <stdlib.h>

#include <string>
#include <utility>
#include <vector>

#include "line_framer.h"

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

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t *data, size_t size) {
    if (size < 1) return 0;
    // The first byte picks the chunk sizes the bytes arrive in.
    unsigned seed = data[0];
    std::string in(reinterpret_cast<const char *>(data + 1), size - 1);
    ftxsim::LineFramer f(kMax);
    std::vector<std::pair<std::string, bool>> got;
    size_t i = 0;
    while (i < in.size()) {
        seed = seed * 1103515245u + 12345u;
        size_t chunk = 1 + (seed >> 16) % 17;
        if (chunk > in.size() - i) chunk = in.size() - i;
        f.feed(in.data() + i, chunk, [&](const std::string &line, bool overlong) {
            if (line.size() > kMax) abort();
            got.emplace_back(line, overlong);
        });
        i += chunk;
        if (f.pending() > kMax + 1) abort();
    }
    if (got != reference(in)) abort();
    return 0;
}

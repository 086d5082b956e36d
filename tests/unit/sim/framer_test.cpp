// Line framing of the PC channel.
#include <string>
#include <utility>
#include <vector>

#include <gtest/gtest.h>

#include "line_framer.h"

namespace {

using Lines = std::vector<std::pair<std::string, bool>>;

Lines frame(const std::string &bytes, size_t chunk, size_t max = 8) {
    ftxsim::LineFramer f(max);
    Lines out;
    for (size_t i = 0; i < bytes.size(); i += chunk) {
        f.feed(bytes.data() + i, std::min(chunk, bytes.size() - i),
               [&](const std::string &l, bool overlong) { out.emplace_back(l, overlong); });
    }
    return out;
}

TEST(LineFramer, LinesAreCutAtLfWhateverTheChunks) {
    const std::string input = "a\r\nbb\n\n12345678\n123456789\nc\r\r\n12345678\r\nrest";
    const Lines expected = {{"a", false}, {"bb", false},  {"", false},        {"12345678", false},
                            {"", true},   {"c\r", false}, {"12345678", false}};
    for (size_t chunk : {1u, 2u, 3u, 7u, 100u})
        EXPECT_EQ(frame(input, chunk), expected) << chunk;
}

TEST(LineFramer, OverlongLinesKeepNoBytes) {
    ftxsim::LineFramer f(4095);
    std::string big(1 << 20, 'x');
    int lines = 0;
    f.feed(big.data(), big.size(), [&](const std::string &, bool) { ++lines; });
    EXPECT_EQ(lines, 0);
    EXPECT_EQ(f.pending(), 0u);
    bool overlong = false;
    f.feed("\n", 1, [&](const std::string &l, bool o) { overlong = o && l.empty(); });
    EXPECT_TRUE(overlong);
    std::string exact(4095, 'y');
    exact += "\r\n";
    std::string got;
    f.feed(exact.data(), exact.size(),
           [&](const std::string &l, bool o) { got = o ? "overlong" : l; });
    EXPECT_EQ(got.size(), 4095u);
}

}  // namespace

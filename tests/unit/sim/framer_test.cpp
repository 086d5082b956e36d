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

// The channel stops after a line when a client's answers are over their bound and feeds the
// rest later: every stop point must give the same lines as one pass.
TEST(LineFramer, StoppingAfterAnyLineAndResumingLosesAndRepeatsNothing) {
    const std::string input = "a\r\nbb\n\n12345678\r\n123456789\nc\r\r\n12345678\r\nrest";
    const Lines whole = frame(input, input.size());
    for (size_t stopEvery = 1; stopEvery <= 4; ++stopEvery) {
        for (size_t chunk : {1u, 3u, 100u}) {
            ftxsim::LineFramer f(8);
            Lines got;
            std::string held;  // bytes handed back by a stop
            size_t calls = 0;
            auto on_line = [&](const std::string &l, bool overlong) {
                got.emplace_back(l, overlong);
                return ++calls % stopEvery != 0;
            };
            for (size_t i = 0; i < input.size(); i += chunk) {
                held += input.substr(i, chunk);
                size_t used;
                while (!held.empty() && (used = f.feed(held.data(), held.size(), on_line)) > 0) {
                    ASSERT_LE(used, held.size());
                    held.erase(0, used);
                }
            }
            EXPECT_EQ(got, whole) << "stop every " << stopEvery << " lines, chunk " << chunk;
            EXPECT_EQ(f.pending(), 4u) << "\"rest\" waits for its line end";
        }
    }
}

TEST(LineFramer, ConsumedCountEndsRightAfterTheStoppingLine) {
    ftxsim::LineFramer f(8);
    const std::string in = "one\ntwo\nthree";
    EXPECT_EQ(f.feed(in.data(), in.size(), [](const std::string &, bool) { return false; }), 4u);
    EXPECT_EQ(f.feed(in.data() + 4, in.size() - 4, [](const std::string &, bool) { return true; }),
              in.size() - 4)
        << "without a stop every byte is taken, an unfinished line included";
    EXPECT_EQ(f.pending(), 5u);
}

}  // namespace

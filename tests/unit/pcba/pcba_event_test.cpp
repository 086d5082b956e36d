// The PCBA events' text: "VALUE,RESULT" from the library's thread.
#include <string>

#include <gtest/gtest.h>

#include "pcba/mmi_pcba_event.h"

namespace {

// The parse's status, and the event it read.
int parse(const std::string &text, mmi_pcba_event *ev, size_t len = std::string::npos) {
    return mmi_pcba_parse_event(text.data(), len == std::string::npos ? text.size() : len, ev);
}

TEST(PcbaEvent, ValueAndResult) {
    mmi_pcba_event ev;
    ASSERT_EQ(0, parse("2000000,1", &ev));
    EXPECT_EQ(2000000ULL, ev.value);
    EXPECT_EQ(1, ev.result);
    ASSERT_EQ(0, parse(" 30436 , 0 ", &ev));
    EXPECT_EQ(30436ULL, ev.value);
    EXPECT_EQ(0, ev.result);
    ASSERT_EQ(0, parse("5,-1", &ev));
    EXPECT_EQ(-1, ev.result);
    // The largest value a board could give.
    ASSERT_EQ(0, parse("18446744073709551615,1", &ev));
    EXPECT_EQ(~0ULL, ev.value);
}

TEST(PcbaEvent, AnythingElseIsRefusedAndLeavesTheEventAlone) {
    for (const char *text : {"", "1", ",1", "1,", "x,1", "1,x", "1,1,1", "1;1", "-5,1",
                             "18446744073709551616,1", "1,2147483648", "1 2,1", "0x10,1"}) {
        mmi_pcba_event ev;
        ev.value = 7;
        ev.result = 7;
        EXPECT_EQ(-1, parse(text, &ev)) << text;
        EXPECT_EQ(7ULL, ev.value) << text;
        EXPECT_EQ(7, ev.result) << text;
    }
}

TEST(PcbaEvent, TheTextEndsAtItsLengthOrAtAZeroByte) {
    mmi_pcba_event ev;
    ASSERT_EQ(0, parse("64,1junk", &ev, 4));
    EXPECT_EQ(64ULL, ev.value);
    ASSERT_EQ(0, parse(std::string("64,1\0junk", 9), &ev));
    EXPECT_EQ(1, ev.result);
    EXPECT_EQ(-1, parse("64,1", &ev, 3));
    EXPECT_EQ(-1, mmi_pcba_parse_event(nullptr, 4, &ev));
}

}  // namespace

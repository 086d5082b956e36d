// Profile files: exact lookups and in-place rewrites.
#include <string.h>

#include <string>

#include <gtest/gtest.h>

#include "ftx_profile.h"
#include "support/temp_root.h"

namespace {

const char *kPath = "/cache/ftx/agingsetting.ini";

class Profile : public ::testing::Test {
  protected:
    std::string after_write(const std::string &before, const char *section, const char *key,
                            const char *value) {
        root.write(kPath, before);
        EXPECT_EQ(0, write_profile_string(section, key, value, kPath));
        return root.read(kPath);
    }
    std::string read(const char *section, const char *key, const char *def = "<def>") {
        char out[64] = {0};
        read_profile_string(section, key, out, sizeof(out), def, kPath);
        return out;
    }
    TempRoot root;
};

TEST_F(Profile, WritesCreateAndPlaceEntries) {
    root.write("/cache/ftx/keep", "");
    ASSERT_EQ(0, write_profile_int("Aging", "count", 3, kPath));
    EXPECT_EQ("[Aging]\ncount=3\n", root.read(kPath));
    // A new key becomes the first line of its section.
    EXPECT_EQ("[A]\nnew=1\nold=0\n[B]\nx=1\n",
              after_write("[A]\nold=0\n[B]\nx=1\n", "A", "new", "1"));
    // With CR LF ends it lands between the header's CR and LF.
    EXPECT_EQ("[A]\rnew=1\n\nold=0\r\n", after_write("[A]\r\nold=0\r\n", "A", "new", "1"));
    // A new section follows a blank line; an empty file gets just the section.
    EXPECT_EQ("[A]\nold=0\n\n[B]\nk=v\n", after_write("[A]\nold=0\n", "B", "k", "v"));
    EXPECT_EQ("[B]\nk=v\n", after_write("", "B", "k", "v"));
}

TEST_F(Profile, ReplacingKeepsTheBlanksAroundTheValue) {
    root.write(kPath, "[A]\nkey =  old value \t\nnext=1\n");
    EXPECT_EQ("old value", read("A", "key"));
    EXPECT_EQ(0, write_profile_string("A", "key", "new", kPath));
    EXPECT_EQ("[A]\nkey =  new \t\nnext=1\n", root.read(kPath));
    EXPECT_EQ("[A]\nkey=5\n", after_write("[A]\nkey=\n", "A", "key", "5"));
}

TEST_F(Profile, MatchingIsExact) {
    root.write(kPath,
               "[ A ]\n;hidden=1\n=odd\nab=2\n\nx=1 [B]\ny=3\n[a]\nab=9\n[B]\nz=4\xff\n[C]\nc=1\n");
    EXPECT_EQ("2", read("A", "ab"));
    EXPECT_EQ("<def>", read("A", "a"));
    EXPECT_EQ("<def>", read("A", "hidden"));  // commented
    EXPECT_EQ("3", read("A", "y"));           // "[B]" mid-line is no header
    EXPECT_EQ("9", read("a", "ab"));
    EXPECT_EQ("4", read("B", "z"));
    EXPECT_EQ("<def>", read("C", "c"));  // the 0xFF byte ended the file
    EXPECT_EQ("<def>", read("B", "y"));
}

TEST_F(Profile, ReadDefaultsAndNumbers) {
    root.write(kPath, "[A]\nn=42\ns=abc\n");
    EXPECT_EQ(42, read_profile_int("A", "n", 7, kPath));
    EXPECT_EQ(7, read_profile_int("A", "missing", 7, kPath));
    EXPECT_EQ(0, read_profile_int("A", "s", 7, kPath));
    EXPECT_EQ(7, read_profile_int("A", "n", 7, "/cache/none.ini"));
    // Values are cut to the buffer; a long default fills it without a terminator.
    char out[4];
    EXPECT_EQ(0, read_profile_string("A", "s", out, 3, nullptr, kPath));
    EXPECT_STREQ("ab", out);
    memset(out, 'z', sizeof(out));
    EXPECT_EQ(-1, read_profile_string("A", "none", out, 3, "defgh", kPath));
    EXPECT_EQ("defz", std::string(out, 4));
}

TEST(ProfileParse, PositionsOfSectionKeyAndValue) {
    const char *buf = "[S]\n k = v1 \n";
    int ss, se, ks, ke, vs, ve;
    ASSERT_EQ(1, parse_file("S", "k", buf, &ss, &se, &ks, &ke, &vs, &ve));
    EXPECT_EQ(1, ss);
    EXPECT_EQ(2, se);
    EXPECT_EQ(5, ks);
    EXPECT_EQ(5, ke);
    EXPECT_EQ(9, vs);
    EXPECT_EQ(10, ve);
    EXPECT_EQ(0, parse_file("S", "x", buf, &ss, &se, &ks, &ke, &vs, &ve));
    EXPECT_EQ(2, se);
    EXPECT_EQ(-1, ks);
    EXPECT_EQ(0, parse_file("T", "k", buf, &ss, &se, &ks, &ke, &vs, &ve));
    EXPECT_EQ(-1, ss);
}

}  // namespace

// The peripheral tests' report reader: what the OTG, NFC and fingerprint libraries send.
#include <string>

#include <gtest/gtest.h>

#include "testwnd/cards/mmi_card_report.h"

namespace {

mmi_card_report parse(const std::string &text, size_t len = std::string::npos) {
    mmi_card_report r;
    mmi_card_parse_report(text.data(), len == std::string::npos ? text.size() : len, &r);
    return r;
}

TEST(CardReport, ResultAndTagInEitherOrder) {
    EXPECT_EQ(MMI_CARD_PASS, parse("result=pass").result);
    EXPECT_EQ(MMI_CARD_FAIL, parse("result=fail").result);
    mmi_card_report r = parse("uid=04:A2:B3;result=pass");
    EXPECT_EQ(MMI_CARD_PASS, r.result);
    EXPECT_STREQ("04:A2:B3", r.uid);
    // The last result field counts; an empty field or an unknown key changes nothing.
    EXPECT_EQ(MMI_CARD_FAIL, parse("result=pass;;x=1;result=fail").result);
}

TEST(CardReport, AnythingButAnExactResultSaysNothing) {
    for (const char *text : {"", "result=", "result=passed", "result=Pass", "results=pass",
                             "result pass", "=pass", "uid=04"})
        EXPECT_EQ(MMI_CARD_NONE, parse(text).result) << text;
}

TEST(CardReport, TheTextEndsAtItsLengthOrAtAZeroByte) {
    EXPECT_EQ(MMI_CARD_NONE, parse("result=pass", 10).result);  // "result=pas"
    EXPECT_EQ(MMI_CARD_NONE, parse(std::string("result=\0pass", 12)).result);
    EXPECT_EQ(MMI_CARD_PASS, parse(std::string("result=pass\0;result=fail", 24)).result);
    EXPECT_EQ(MMI_CARD_NONE, parse("result=pass", 0).result);
    mmi_card_report r;
    EXPECT_EQ(MMI_CARD_NONE, mmi_card_parse_report(nullptr, 5, &r));
}

TEST(CardReport, TheTagKeepsItsPrintableCharactersUpTo32) {
    EXPECT_STREQ("04A2", parse("result=pass;uid=0 4\t\x01"
                               "A2\x7f")
                             .uid);
    const std::string longUid(40, 'F');
    EXPECT_EQ(std::string(32, 'F'), parse("result=pass;uid=" + longUid).uid);
    // A later report without a tag forgets the earlier one's.
    EXPECT_STREQ("", parse("result=fail").uid);
}

}  // namespace

// Reading the supplicant's answers: the STATUS reply, the new network's id and the fields of
// wpa_cli's lines that the RSSI and access-point commands pass on.
#include <string>

#include <gtest/gtest.h>

#include "wifi/mmi_wifi_reply.h"

namespace {

mmi_wifi_status status(const std::string &reply) {
    return mmi_wifi_parse_status(reply.data(), reply.size());
}

TEST(WifiReply, StatusTellsACompletedLinkAndALinkLocalAddress) {
    const std::string up =
        "bssid=02:00:00:00:01:01\nfreq=2437\nssid=DFX_WIFI_TEST\n"
        "wpa_state=COMPLETED\nip_address=127.0.0.1\naddress=02:00:00:00:00:01\n";
    EXPECT_TRUE(status(up).completed);
    EXPECT_FALSE(status(up).linkLocal);
    EXPECT_TRUE(status("wpa_state=COMPLETED\nip_address=169.254.3.7\n").linkLocal);
    EXPECT_FALSE(status("wpa_state=SCANNING\naddress=02:00:00:00:00:01\n").completed);
    EXPECT_FALSE(status("wpa_state=COMPLETE").completed);  // cut short
    // Leading NUL bytes are skipped; one after the text ends it.
    EXPECT_TRUE(status(std::string("\0\0wpa_state=COMPLETED\n", 22)).completed);
    EXPECT_FALSE(status(std::string("wpa_state=SCANNING\0wpa_state=COMPLETED", 38)).completed);
    EXPECT_FALSE(mmi_wifi_parse_status(nullptr, 10).completed);
}

TEST(WifiReply, NetworkIdIsTheLeadingNumber) {
    EXPECT_EQ(0, mmi_wifi_parse_network_id("0\n", 2));
    EXPECT_EQ(12, mmi_wifi_parse_network_id("12\n", 3));
    EXPECT_EQ(-1, mmi_wifi_parse_network_id("FAIL\n", 5));
    EXPECT_EQ(-1, mmi_wifi_parse_network_id("99999999999\n", 12));
    EXPECT_EQ(1, mmi_wifi_parse_network_id("12", 1));  // only the bytes it is given
}

TEST(WifiReply, LineFieldsKeepTheirLineEndAndNeverReadPastTheLine) {
    char out[33];
    mmi_wifi_line_field("RSSI=-55\n", 10, 5, 16, out);
    EXPECT_STREQ("-55\n", out);
    mmi_wifi_line_field("bssid=02:00:00:00:01:01\n", 25, 6, 32, out);
    EXPECT_STREQ("02:00:00:00:01:01\n", out);
    mmi_wifi_line_field("freq=2437000000000000000000\n", 29, 5, 16, out);
    EXPECT_STREQ("2437000000000000", out);
    mmi_wifi_line_field("RSS", 4, 5, 16, out);
    EXPECT_STREQ("", out);
    const char unterminated[6] = {'R', 'S', 'S', 'I', '=', '7'};
    mmi_wifi_line_field(unterminated, sizeof unterminated, 5, 16, out);
    EXPECT_STREQ("7", out);
}

}  // namespace

// The control interface's request parser and its value decoders.
#include <gtest/gtest.h>

#include "wpa_request.h"

namespace {

using ftxwifi::parse_request;
using ftxwifi::Verb;

TEST(SimWpaRequest, WordsAreCaseSensitiveAndTakeArgumentsOnlyWhereTheyShould) {
    EXPECT_EQ(Verb::Ping, parse_request("PING").verb);
    EXPECT_EQ(Verb::Status, parse_request("STATUS\n").verb);
    EXPECT_EQ(Verb::Status, parse_request("IFNAME=wlan0 STATUS").verb);
    EXPECT_EQ(Verb::Unknown, parse_request("status").verb);
    EXPECT_EQ(Verb::Unknown, parse_request("STATUS verbose").verb);
    EXPECT_EQ(Verb::Unknown, parse_request("SET_NETWORK").verb);
    EXPECT_EQ(Verb::Unknown, parse_request("").verb);
    EXPECT_EQ("STATUS-VERBOSE", parse_request("STATUS-VERBOSE").word);
    // A request is a C string: nothing after a NUL counts.
    EXPECT_EQ(Verb::Ping, parse_request(std::string_view("PING\0 x", 7)).verb);
}

TEST(SimWpaRequest, NetworkRequestsCarryTheirIdFieldAndValue) {
    auto r = parse_request("SET_NETWORK 12 ssid \"two words\"");
    EXPECT_EQ(Verb::SetNetwork, r.verb);
    EXPECT_TRUE(r.wellFormed);
    EXPECT_EQ(12, r.id);
    EXPECT_EQ("ssid", r.field);
    EXPECT_EQ("\"two words\"", r.value);

    r = parse_request("SET_NETWORK 0 key_mgmt WPA-PSK WPA-EAP");
    EXPECT_EQ("WPA-PSK WPA-EAP", r.value);
    EXPECT_FALSE(parse_request("SET_NETWORK 0 ssid").wellFormed);
    EXPECT_FALSE(parse_request("SET_NETWORK x ssid \"a\"").wellFormed);
    EXPECT_FALSE(parse_request("SET_NETWORK -1 ssid \"a\"").wellFormed);
    EXPECT_FALSE(parse_request("SET_NETWORK 9999999999 ssid \"a\"").wellFormed);
    EXPECT_TRUE(parse_request("GET_NETWORK 3 psk").wellFormed);
    EXPECT_FALSE(parse_request("GET_NETWORK 3 psk x").wellFormed);

    r = parse_request("SELECT_NETWORK any");
    EXPECT_TRUE(r.wellFormed && r.all);
    EXPECT_FALSE(parse_request("SELECT_NETWORK all").wellFormed);
    r = parse_request("REMOVE_NETWORK all");
    EXPECT_TRUE(r.wellFormed && r.all);
    r = parse_request("DISABLE_NETWORK 4");
    EXPECT_TRUE(r.wellFormed && !r.all);
    EXPECT_EQ(4, r.id);
    EXPECT_FALSE(parse_request("ENABLE_NETWORK ").wellFormed);
}

TEST(SimWpaRequest, ValuesAreDecodedAsTheSupplicantTakesThem) {
    std::string v;
    EXPECT_TRUE(ftxwifi::decode_ssid("\"DFX_WIFI_TEST\"", &v));
    EXPECT_EQ("DFX_WIFI_TEST", v);
    EXPECT_TRUE(ftxwifi::decode_ssid("414243", &v));
    EXPECT_EQ("ABC", v);
    EXPECT_FALSE(ftxwifi::decode_ssid("\"\"", &v));
    EXPECT_FALSE(ftxwifi::decode_ssid("\"" + std::string(33, 'a') + "\"", &v));
    EXPECT_FALSE(ftxwifi::decode_ssid("DFX", &v));  // neither quoted nor hex
    EXPECT_FALSE(ftxwifi::decode_ssid("4", &v));

    EXPECT_TRUE(ftxwifi::decode_psk("\"kqmtrel459\"", &v));
    EXPECT_EQ("kqmtrel459", v);
    EXPECT_FALSE(ftxwifi::decode_psk("\"short\"", &v));
    EXPECT_FALSE(ftxwifi::decode_psk("\"" + std::string(64, 'a') + "\"", &v));
    EXPECT_FALSE(ftxwifi::decode_psk("\"tab\there12\"", &v));
    EXPECT_TRUE(ftxwifi::decode_psk(std::string(64, 'f'), &v));
    EXPECT_FALSE(ftxwifi::decode_psk(std::string(63, 'f'), &v));

    EXPECT_TRUE(ftxwifi::decode_key_mgmt("WPA-PSK  WPA-EAP", &v));
    EXPECT_EQ("WPA-PSK WPA-EAP", v);
    EXPECT_TRUE(ftxwifi::decode_key_mgmt("NONE", &v));
    EXPECT_FALSE(ftxwifi::decode_key_mgmt("WPA-PSK BOGUS", &v));
    EXPECT_FALSE(ftxwifi::decode_key_mgmt(" ", &v));
}

}  // namespace

// The simulated supplicant's state on a clock the test moves: joins, keys, DHCP rounds, the
// console's changes and the replies' formats.
#include <gtest/gtest.h>

#include <string>

#include "supplicant.h"

namespace {

using ftxwifi::AccessPoint;
using ftxwifi::ConsoleState;
using ftxwifi::Supplicant;

ftxwifi::NetworkModel lab_model() {
    ftxwifi::NetworkModel m;
    AccessPoint lab;
    lab.ssid = "LAB";
    lab.key = "secret123";
    lab.bssid = "02:00:00:00:01:01";
    lab.freq = 2437;
    lab.rssi = -55;
    AccessPoint open;
    open.ssid = "OPEN";
    open.keyMgmt = "NONE";
    open.bssid = "02:00:00:00:01:02";
    open.freq = 5180;
    open.rssi = -75;
    m.aps = {lab, open};
    m.mac = "02:00:00:00:00:01";
    m.address = "10.1.2.3";
    return m;
}

// Each join step takes 10 ms, a retry after a wrong key 50 ms.
const ftxwifi::Timing kTiming{10, 10, 10, 50};

class SimSupplicant : public ::testing::Test {
  protected:
    Supplicant s{lab_model(), kTiming};
    long long now = 1000;

    std::string ask(const std::string &request) { return s.handle(request, now); }
    // Adds and selects a network the way the application does; its id.
    std::string join(const std::string &ssid, const std::string &keyMgmt, const std::string &psk) {
        std::string id = ask("ADD_NETWORK");
        id.pop_back();
        EXPECT_EQ("OK\n", ask("SET_NETWORK " + id + " ssid \"" + ssid + "\""));
        EXPECT_EQ("OK\n", ask("SET_NETWORK " + id + " key_mgmt " + keyMgmt));
        if (!psk.empty()) {
            EXPECT_EQ("OK\n", ask("SET_NETWORK " + id + " psk \"" + psk + "\""));
        }
        EXPECT_EQ("OK\n", ask("SELECT_NETWORK " + id));
        EXPECT_EQ("OK\n", ask("RECONNECT"));
        return id;
    }
    void pass(long long ms) {
        for (long long i = 0; i < ms; i++)
            s.tick(++now);
    }
    void console(const ConsoleState &c) {
        s.set_console(c);
        s.tick(now);
    }
};

TEST_F(SimSupplicant, JoinsStepByStepAndAnswersAsTheSupplicantDoes) {
    EXPECT_EQ("PONG\n", ask("PING"));
    EXPECT_EQ("UNKNOWN COMMAND\n", ask("BOGUS"));
    EXPECT_EQ("wpa_state=DISCONNECTED\naddress=02:00:00:00:00:01\n", ask("STATUS"));
    EXPECT_EQ("FAIL\n", ask("SIGNAL_POLL"));
    EXPECT_EQ("0", join("LAB", "WPA-PSK", "secret123"));
    EXPECT_STREQ("SCANNING", s.state());
    pass(10);
    EXPECT_STREQ("ASSOCIATING", s.state());
    EXPECT_EQ(
        "bssid=02:00:00:00:01:01\nfreq=2437\nssid=LAB\nid=0\nmode=station\n"
        "wpa_state=ASSOCIATING\naddress=02:00:00:00:00:01\n",
        ask("STATUS"));
    pass(10);
    EXPECT_STREQ("4WAY_HANDSHAKE", s.state());
    pass(10);
    EXPECT_EQ(
        "bssid=02:00:00:00:01:01\nfreq=2437\nssid=LAB\nid=0\nmode=station\n"
        "pairwise_cipher=CCMP\ngroup_cipher=CCMP\nkey_mgmt=WPA2-PSK\nwpa_state=COMPLETED\n"
        "address=02:00:00:00:00:01\n",
        ask("STATUS"));
    EXPECT_EQ("RSSI=-55\nLINKSPEED=72\nNOISE=-92\nFREQUENCY=2437\n", ask("SIGNAL_POLL"));
    EXPECT_EQ("10.1.2.3\n", ask("SIM_DHCP"));
    EXPECT_NE(std::string::npos, ask("STATUS").find("wpa_state=COMPLETED\nip_address=10.1.2.3\n"));
    EXPECT_EQ("10.1.2.3", s.published()["ip"]);
    // Selecting the network it is on, or asking to reconnect, keeps the link.
    EXPECT_EQ("OK\n", ask("SELECT_NETWORK 0"));
    EXPECT_EQ("OK\n", ask("RECONNECT"));
    EXPECT_STREQ("COMPLETED", s.state());
}

TEST_F(SimSupplicant, AnOpenNetworkNeedsKeyMgmtNoneAndSkipsTheHandshake) {
    join("OPEN", "WPA-PSK", "");
    pass(100);
    EXPECT_STREQ("SCANNING", s.state()) << "a WPA network does not match an open access point";
    EXPECT_EQ("OK\n", ask("SET_NETWORK 0 key_mgmt NONE"));
    EXPECT_EQ("OK\n", ask("REASSOCIATE"));
    pass(20);
    EXPECT_STREQ("COMPLETED", s.state());
    const std::string status = ask("STATUS");
    EXPECT_NE(std::string::npos, status.find("freq=5180\n"));
    EXPECT_NE(std::string::npos,
              status.find("pairwise_cipher=NONE\ngroup_cipher=NONE\nkey_mgmt=NONE\n"));
    EXPECT_EQ("RSSI=-75\nLINKSPEED=26\nNOISE=-92\nFREQUENCY=5180\n", ask("SIGNAL_POLL"));
}

TEST_F(SimSupplicant, AWrongKeyNeverCompletesAndAnUnknownSsidKeepsScanning) {
    join("LAB", "WPA-PSK", "not-the-key");
    std::string seen;
    for (int i = 0; i < 300; i++) {
        pass(1);
        if (seen.find(s.state()) == std::string::npos) seen += std::string(s.state()) + " ";
    }
    EXPECT_EQ("SCANNING ASSOCIATING 4WAY_HANDSHAKE DISCONNECTED ", seen);
    EXPECT_GE(std::stol(s.published()["failures"]), 3) << "it keeps trying";
    EXPECT_EQ("FAIL\n", ask("SIM_DHCP"));

    // The access point takes the handset's key: the next try completes.
    ConsoleState c;
    c.aps[0].key = "not-the-key";
    console(c);
    pass(100);
    EXPECT_STREQ("COMPLETED", s.state());

    ASSERT_EQ("OK\n", ask("REMOVE_NETWORK all"));
    join("NOWHERE", "WPA-PSK", "secret123");
    pass(500);
    EXPECT_STREQ("SCANNING", s.state());
}

TEST_F(SimSupplicant, DhcpHandsOutTheConsolesLinkLocalRoundsThenTheModelsAddress) {
    join("LAB", "WPA-PSK", "secret123");
    EXPECT_EQ("FAIL\n", ask("SIM_DHCP")) << "no address before the link completes";
    pass(30);
    ConsoleState c;
    c.linklocal = 2;
    c.linklocalSerial = 7;
    console(c);
    const std::string first = ask("SIM_DHCP"), second = ask("SIM_DHCP");
    EXPECT_EQ(0u, first.rfind("169.254.", 0)) << first;
    EXPECT_EQ(0u, second.rfind("169.254.", 0)) << second;
    EXPECT_NE(first, second);
    EXPECT_NE(std::string::npos, ask("STATUS").find("ip_address=" + second));
    EXPECT_EQ("10.1.2.3\n", ask("SIM_DHCP"));
    EXPECT_EQ("0", s.published()["linklocal.left"]);

    // A new supplicant goes on counting the same console line; a new line counts afresh.
    Supplicant next(lab_model(), kTiming);
    next.restore_linklocal(7, 2);
    next.set_console(c);
    EXPECT_EQ("0", next.published()["linklocal.left"]);
    c.linklocalSerial = 8;
    next.set_console(c);
    EXPECT_EQ("2", next.published()["linklocal.left"]);
}

TEST_F(SimSupplicant, AVanishingAccessPointDropsTheLinkUntilItReturns) {
    join("LAB", "WPA-PSK", "secret123");
    pass(30);
    ASSERT_EQ("10.1.2.3\n", ask("SIM_DHCP"));
    ConsoleState c;
    c.aps[0].on = false;
    console(c);
    EXPECT_STREQ("DISCONNECTED", s.state());
    EXPECT_EQ(0u, s.published().count("ip"));
    EXPECT_EQ(std::string::npos, ask("STATUS").find("ip_address"));
    pass(200);
    EXPECT_STREQ("SCANNING", s.state());
    c.aps[0].on = true;
    console(c);
    pass(40);
    EXPECT_STREQ("COMPLETED", s.state());
    EXPECT_EQ("10.1.2.3", s.published()["ip"]) << "the lease of the same network holds";

    // A key changed on the access point drops the link and fails the next handshake.
    c.aps[0].key = "changed-key";
    console(c);
    EXPECT_STREQ("DISCONNECTED", s.state());
    pass(45);
    EXPECT_EQ("1", s.published()["failures"]);
}

TEST_F(SimSupplicant, TheConsoleFailsRequestsAndHoldsAStuckAccessPoint) {
    ConsoleState c;
    c.fails = {"STATUS", "SET_NETWORK"};
    c.aps[0].stuck = true;
    console(c);
    EXPECT_EQ("FAIL\n", ask("STATUS"));
    EXPECT_EQ("0\n", ask("ADD_NETWORK"));
    EXPECT_EQ("FAIL\n", ask("SET_NETWORK 0 ssid \"LAB\""));
    c.fails.clear();
    console(c);
    join("LAB", "WPA-PSK", "secret123");
    pass(5000);
    EXPECT_STREQ("ASSOCIATING", s.state());
    EXPECT_EQ(LLONG_MAX, s.next_event(now));
    c.aps[0].stuck = false;
    console(c);
    pass(30);
    EXPECT_STREQ("COMPLETED", s.state());
}

TEST_F(SimSupplicant, TheInterfaceGoingDownDropsLinkAndAddress) {
    join("LAB", "WPA-PSK", "secret123");
    pass(30);
    ASSERT_EQ("10.1.2.3\n", ask("SIM_DHCP"));
    EXPECT_EQ("OK\n", ask("SIM_IFDOWN"));
    EXPECT_STREQ("INTERFACE_DISABLED", s.state());
    EXPECT_EQ("FAIL\n", ask("RECONNECT"));
    EXPECT_EQ("0", s.published()["if_up"]);
    EXPECT_EQ("OK\n", ask("SIM_IFUP"));
    pass(30);
    EXPECT_STREQ("COMPLETED", s.state());
    EXPECT_EQ(0u, s.published().count("ip")) << "a new DHCP round is needed";
}

TEST_F(SimSupplicant, NetworksAreConfiguredListedAndTakenAway) {
    EXPECT_EQ("FAIL\n", ask("SET_NETWORK 0 ssid \"LAB\""));
    EXPECT_EQ("FAIL\n", ask("SELECT_NETWORK 0"));
    join("LAB", "WPA-PSK", "secret123");
    EXPECT_EQ("1\n", ask("ADD_NETWORK"));
    EXPECT_EQ("FAIL\n", ask("SET_NETWORK 1 psk \"short\""));
    EXPECT_EQ("FAIL\n", ask("SET_NETWORK 1 key_mgmt WEP"));
    EXPECT_EQ("FAIL\n", ask("SET_NETWORK 1 bogus 1"));
    EXPECT_EQ("OK\n", ask("SET_NETWORK 1 scan_ssid 1"));
    EXPECT_EQ("\"LAB\"", ask("GET_NETWORK 0 ssid"));
    EXPECT_EQ("*", ask("GET_NETWORK 0 psk"));
    EXPECT_EQ("FAIL\n", ask("GET_NETWORK 1 ssid"));
    pass(30);
    ASSERT_EQ("10.1.2.3\n", ask("SIM_DHCP"));
    EXPECT_EQ("network id / ssid / bssid / flags\n0\tLAB\tany\t[CURRENT]\n1\t\tany\t[DISABLED]\n",
              ask("LIST_NETWORKS"));
    EXPECT_EQ("OK\n", ask("DISABLE_NETWORK 0"));
    EXPECT_STREQ("DISCONNECTED", s.state());
    EXPECT_EQ("OK\n", ask("ENABLE_NETWORK 0"));
    pass(30);
    EXPECT_STREQ("COMPLETED", s.state());
    EXPECT_EQ(0u, s.published().count("ip")) << "the lease went with the disabled network";
    EXPECT_EQ("OK\n", ask("DISCONNECT"));
    pass(100);
    EXPECT_STREQ("DISCONNECTED", s.state());
    EXPECT_EQ("OK\n", ask("REMOVE_NETWORK 0"));
    EXPECT_EQ("FAIL\n", ask("REMOVE_NETWORK 0"));
    EXPECT_EQ("2\n", ask("ADD_NETWORK")) << "ids go on after the highest left";
    bool terminate = false;
    EXPECT_EQ("OK\n", s.handle("TERMINATE", now, &terminate));
    EXPECT_TRUE(terminate);
}

TEST(SimSupplicantTiming, AJoinIsSplitInThreeStepsAndScaled) {
    ftxwifi::Timing t = ftxwifi::scaled_timing(600, 0.5);
    EXPECT_EQ(100, t.scanMs);
    EXPECT_EQ(100, t.assocMs);
    EXPECT_EQ(100, t.handshakeMs);
    EXPECT_EQ(500, t.retryMs);
}

}  // namespace

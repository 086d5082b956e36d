// The real ftx-mmi, headless, against the simulated supplicant: joining the test network from
// the main menu's link key and from the PC, the QR code of the address (decoded by a real
// scanner), every way the network can fail, the link monitor, and the PC's Wi-Fi commands.
#include <arpa/inet.h>
#include <netinet/in.h>
#include <sys/socket.h>
#include <sys/time.h>
#include <unistd.h>

#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>

#include <gtest/gtest.h>

#include "support/handset.h"
#include "support/scanner.h"
#include "support/text.h"

using namespace handset;

namespace {

const char kLinkUp[] = "WiFiLinkState 0 -> 2";

std::pair<int, std::string> answer(int result, const std::string &reply) {
    return {result, reply};
}

// A UDP port nobody uses now, for a handset's echo service.
int free_udp_port() {
    const int s = socket(AF_INET, SOCK_DGRAM, 0);
    sockaddr_in a{};
    a.sin_family = AF_INET;
    a.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
    socklen_t len = sizeof a;
    bind(s, reinterpret_cast<sockaddr *>(&a), sizeof a);
    getsockname(s, reinterpret_cast<sockaddr *>(&a), &len);
    close(s);
    return ntohs(a.sin_port);
}

// One datagram to the echo service and its answer ("" when none came within a second).
std::string echo(int port, const std::string &data) {
    const int s = socket(AF_INET, SOCK_DGRAM, 0);
    timeval tv{1, 0};
    setsockopt(s, SOL_SOCKET, SO_RCVTIMEO, &tv, sizeof tv);
    sockaddr_in a{};
    a.sin_family = AF_INET;
    a.sin_port = htons(static_cast<uint16_t>(port));
    a.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
    sendto(s, data.data(), data.size(), 0, reinterpret_cast<sockaddr *>(&a), sizeof a);
    char buf[2048];
    const ssize_t n = recv(s, buf, sizeof buf, 0);
    close(s);
    return n > 0 ? std::string(buf, static_cast<size_t>(n)) : "";
}

// Whether the port is free again (the service closed its socket).
bool port_free(int port) {
    const int s = socket(AF_INET, SOCK_DGRAM, 0);
    sockaddr_in a{};
    a.sin_family = AF_INET;
    a.sin_port = htons(static_cast<uint16_t>(port));
    a.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
    const bool ok = bind(s, reinterpret_cast<sockaddr *>(&a), sizeof a) == 0;
    close(s);
    return ok;
}

struct Wifi : ::testing::Test {
    Handset h{{}, 0.05};
    void SetUp() override {
        if (!scanner::available()) GTEST_SKIP() << "zbarimg is not installed";
    }
    void start() {
        ASSERT_TRUE(h.start());
        ASSERT_TRUE(h.dut.waitChannel());
    }
    // The main menu's link key.
    void linkKey() { h.key(62); }
    // What the supplicant was asked, in order.
    std::string requests() {
        std::ifstream in(h.dut.root() + "/log/wpa_supplicant.txt");
        return std::string(std::istreambuf_iterator<char>(in), {});
    }
    bool exists(const std::string &devicePath) { return h.dut.exists(devicePath); }
    // The QR code of the main window's link picture, from a screenshot.
    std::string screenCode() {
        std::string code;
        dut_wait_until(
            [&] {
                h.shot("wifi_menu.png");
                code = scanner::read(h.dut.root() + "/wifi_menu.png");
                return !code.empty();
            },
            5000);
        return code;
    }
};

TEST_F(Wifi, TheLinkKeyJoinsTheNetworkAndTheMenuShowsTheAddressAsAQrCode) {
    start();
    linkKey();
    ASSERT_TRUE(h.dut.waitLog(kLinkUp));
    // The requests in order, the SSID and the key quoted.
    const std::string asked = requests();
    const size_t add = asked.find("ADD_NETWORK");
    const size_t ssid = asked.find("SET_NETWORK 0 ssid \"DFX_WIFI_TEST\"");
    const size_t mgmt = asked.find("SET_NETWORK 0 key_mgmt WPA-PSK");
    const size_t psk = asked.find("SET_NETWORK 0 psk \"kqmtrel459\"");
    const size_t select = asked.find("SELECT_NETWORK 0");
    const size_t reconnect = asked.find("RECONNECT");
    const size_t status = asked.find("STATUS");
    ASSERT_NE(std::string::npos, status) << asked;
    EXPECT_LT(add, ssid);
    EXPECT_LT(ssid, mgmt);
    EXPECT_LT(mgmt, psk);
    EXPECT_LT(psk, select);
    EXPECT_LT(select, reconnect);
    EXPECT_LT(reconnect, status);
    EXPECT_TRUE(h.dut.waitLog("MSG_CALLBACK  begin."));
    EXPECT_EQ("127.0.0.1", scanner::read(h.dut.root() + "/data/mmi_ip.png"));
    EXPECT_TRUE(exists("/data/mmi_ip.bmp"));
    EXPECT_EQ("127.0.0.1", screenCode());
    h.keepForDocs("wifi_menu.png", "main_menu_qr.png");
    // The monitor runs once the link is up.
    EXPECT_TRUE(h.dut.waitLog("wifi_status_monitor_thread_start not exist."));
    // The key again ends the link.
    linkKey();
    EXPECT_TRUE(h.dut.waitLog("WiFiLinkState 2 -> 1"));
    EXPECT_TRUE(dut_wait_until(
        [&] { return has(h.dut.read("/log/tools.txt"), "pv_wifi_close.sh"); }, 5000));
    EXPECT_TRUE(has(requests(), "REMOVE_NETWORK 0"));
}

TEST_F(Wifi, AnOpenNetworkIsJoinedWithoutAKey) {
    h.dut.setConfig("MMI", "WiFiCtrlParameter", "def_ssid:OPEN_NET;key_mgmt:NONE;wifi_init:1");
    h.dut.setDeviceIni("wifi", "ap2.ssid", "OPEN_NET");
    h.dut.setDeviceIni("wifi", "ap2.key_mgmt", "NONE");
    start();
    EXPECT_EQ(answer(0, ""), h.dut.pc("WiFiMoudle testItem open"));
    ASSERT_TRUE(h.dut.waitLog(kLinkUp));
    EXPECT_TRUE(has(requests(), "SET_NETWORK 0 key_mgmt NONE"));
    EXPECT_FALSE(has(requests(), "psk"));
}

TEST_F(Wifi, EachFailingRequestEndsTheAttemptWithItsOwnLogLine) {
    start();
    const std::pair<const char *, const char *> kFailures[] = {
        {"ADD_NETWORK", "mmi_WiFiConnect::add_network fails."},
        {"SET_NETWORK", "set_network ssid fail"},
        {"SELECT_NETWORK", "select_network fail"},
        {"RECONNECT", "mmi_WiFiConnect::reconnect fails."},
        {"STATUS", "wifi_setip_func::status fails."},
    };
    for (const auto &f : kFailures) {
        SCOPED_TRACE(f.first);
        ASSERT_TRUE(h.dut.consoleOk(std::string("hw wifi fail ") + f.first));
        EXPECT_EQ(answer(0, ""), h.dut.pc("WiFiMoudle testItem open"));
        EXPECT_TRUE(h.dut.waitLog(f.second));
        ASSERT_TRUE(h.dut.consoleOk(std::string("hw wifi fail ") + f.first + " off"));
    }
    EXPECT_EQ(0u, h.dut.logCount("WiFiLinkState 0 -> 2"));
}

TEST_F(Wifi, ANetworkThatIsNotThereOrNeverCompletesLeavesTheLinkDown) {
    // No supplicant at all: the image lacks its start script.
    h.dut.remove("/system/bin/pv_wifi_init.sh");
    start();
    EXPECT_EQ(answer(0, ""), h.dut.pc("WiFiMoudle testItem open"));
    EXPECT_TRUE(h.dut.waitLog("mmi_WiFiConnect::wpa_ctrl_open fails."));
    EXPECT_EQ(0, h.dut.logCount("WiFiLinkState"));
}

TEST_F(Wifi, AnAccessPointThatNeverCompletesFailsTheLink) {
    start();
    ASSERT_TRUE(h.dut.consoleOk("hw wifi stuck DFX_WIFI_TEST on"));
    linkKey();
    EXPECT_TRUE(
        h.dut.waitLog("WiFiConThread::wpa_state=COMPLETED not found. Fail to connect to router."));
    EXPECT_TRUE(h.dut.waitLog("WiFiLinkState 0 -> 1"));
    EXPECT_FALSE(exists("/data/mmi_ip.png"));
}

TEST_F(Wifi, LinkLocalAddressesAreAskedAgainUntilTheNetworkAnswers) {
    start();
    ASSERT_TRUE(h.dut.consoleOk("hw wifi linklocal 3"));
    linkKey();
    ASSERT_TRUE(h.dut.waitLog(kLinkUp));
    EXPECT_EQ(4u, h.dut.logCount("WiFiConThread::dhcp cmd:/system/bin/dhcptool wlan0."));
    EXPECT_EQ("127.0.0.1", scanner::read(h.dut.root() + "/data/mmi_ip.png"));
}

TEST_F(Wifi, TheMonitorFollowsAnAccessPointThatGoesAndComesBack) {
    start();
    linkKey();
    ASSERT_TRUE(h.dut.waitLog(kLinkUp));
    ASSERT_TRUE(h.dut.consoleOk("hw wifi ap DFX_WIFI_TEST off"));
    EXPECT_TRUE(h.dut.waitLog("WiFiLinkState 2 -> 1"));
    ASSERT_TRUE(h.dut.consoleOk("hw wifi ap DFX_WIFI_TEST on"));
    EXPECT_TRUE(h.dut.waitLog("WiFiLinkState 1 -> 2"));
    EXPECT_EQ("127.0.0.1", screenCode());
}

TEST_F(Wifi, SwitchingTheNetworkIsKeptAcrossARestartUntilTheDefaultIsAskedFor) {
    start();
    EXPECT_EQ(answer(0, ""), h.dut.pc("SwitchSSID testItem LAB_NET"));
    EXPECT_EQ("LAB_NET", h.dut.read("/cache/pv_wifi_switch_ssid.cfg"));
    EXPECT_TRUE(dut_wait_until([&] { return has(requests(), "ssid \"LAB_NET\""); }, 5000));
    h.dut.stop();
    ASSERT_TRUE(h.start());
    EXPECT_TRUE(h.dut.waitLog("MMI_WiFi_GetConfigParas ssid=LAB_NET"));
    ASSERT_TRUE(h.dut.waitChannel());
    EXPECT_EQ(answer(0, ""), h.dut.pc("SwitchSSID testItem DFX_WIFI_TEST"));
    EXPECT_FALSE(exists("/cache/pv_wifi_switch_ssid.cfg"));
    EXPECT_TRUE(h.dut.waitLog(kLinkUp));
}

TEST_F(Wifi, RssiAndAccessPointInformationComeThroughTheRealClient) {
    start();
    linkKey();
    ASSERT_TRUE(h.dut.waitLog(kLinkUp));
    ASSERT_TRUE(h.dut.consoleOk("hw wifi rssi DFX_WIFI_TEST -61"));
    EXPECT_EQ(answer(0, "-61\n"), h.dut.pc("RSSIMoudle testItem read"));
    EXPECT_EQ(answer(0, "02:00:00:00:01:01\n,2437\n,127.0.0.1,02:00:00:00:00:01"),
              h.dut.pc("APInfoMoudle testItem read"));
    EXPECT_TRUE(
        has(h.dut.read("/log/tools.txt"), "wpa_cli -i wlan0 -p /data/misc/wifi/sockets status"));
}

TEST_F(Wifi, TheUdpEchoAnswersWholeDatagramsUpTo256BytesUntilDisabled) {
    const int port = free_udp_port();
    h.dut.setDeviceIni("ports", "udp_3536", std::to_string(port));
    start();
    EXPECT_EQ(answer(0, ""), h.dut.pc("WiFiUDPServ testItem open"));
    ASSERT_TRUE(
        h.dut.waitLog("wificpt_udpserver_thread: echo on 127.0.0.1:" + std::to_string(port)));
    const std::string full(256, 'a');
    EXPECT_EQ(full, echo(port, full));
    std::string longer(300, 'b');
    EXPECT_EQ(longer.substr(0, 256), echo(port, longer));
    EXPECT_TRUE(has(h.dut.read("/log/tools.txt"), "iwpriv wlan0 setPower 0"));
    EXPECT_EQ(answer(0, ""), h.dut.pc("WiFiUDPServ testItem close"));
    EXPECT_TRUE(dut_wait_until([&] { return port_free(port); }, 5000));
    EXPECT_TRUE(has(h.dut.read("/log/tools.txt"), "iwpriv wlan0 setPower 9"));
}

TEST_F(Wifi, AfterARestartForThePcTheLinkComesBackByItself) {
    h.dut.write("/cache/Tcp_Restart.ini", "[tcp]\n");
    start();
    EXPECT_TRUE(h.dut.waitLog(kLinkUp));
    EXPECT_EQ("127.0.0.1", screenCode());
}

}  // namespace

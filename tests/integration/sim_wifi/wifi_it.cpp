// The simulated Wi-Fi network end to end: the supplicant started and stopped by the handset's
// scripts through dev_system, driven with the real wpa_ctrl client library and the host's
// wpa_cli, DHCP through dhcptool, the console's "hw wifi" lines, and the platform's
// interface calls. Every wait is on a condition.
#include <signal.h>
#include <stdio.h>
#include <string.h>
#include <sys/wait.h>
#include <unistd.h>

#include <chrono>
#include <filesystem>
#include <functional>
#include <string>
#include <thread>
#include <vector>

#include <gtest/gtest.h>
#include <wpa_ctrl.h>

#include "devfs.h"
#include "ftx_host.h"
#include "support/temp_root.h"
#include "wifi_link.h"

// The "hw" lines of libdvk_ncoredevice.so, where the console's wifi words live.
extern "C" int ftx_sim_control(const char *line, char *reply, size_t size);

namespace {

const char *const kPlaceholders[] = {"pv_wifi_init.sh", "pv_wifi_close.sh", "dhcptool", "wpa_cli"};
const std::string kTools = FTX_TEST_BUILD_DIR "/handset/bin";

bool until(const std::function<bool()> &pred, int ms = 5000) {
    auto end = std::chrono::steady_clock::now() + std::chrono::milliseconds(ms);
    while (std::chrono::steady_clock::now() < end) {
        if (pred()) return true;
        std::this_thread::sleep_for(std::chrono::milliseconds(5));
    }
    return pred();
}

bool has(const std::string &text, const std::string &part) {
    return text.find(part) != std::string::npos;
}

std::string first_line(const std::string &text, int n = 0) {
    size_t at = 0;
    for (int i = 0; i < n && at != std::string::npos; i++) {
        at = text.find('\n', at);
        if (at != std::string::npos) at++;
    }
    if (at == std::string::npos) return "";
    return text.substr(at, text.find('\n', at) - at);
}

// Alive and not yet ended (a supplicant's parent is gone, so nobody may reap it).
bool alive(pid_t pid) {
    FILE *f = fopen(("/proc/" + std::to_string(pid) + "/stat").c_str(), "r");
    if (f == nullptr) return false;
    char buf[512] = "";
    size_t n = fread(buf, 1, sizeof(buf) - 1, f);
    fclose(f);
    const char *close = strrchr(buf, ')');
    return n > 0 && close != nullptr && close[1] == ' ' && close[2] != 'Z' && close[2] != 'X';
}

int exit_status(int status) {
    return WIFEXITED(status) ? WEXITSTATUS(status) : -1;
}

void make_handset(const TempRoot &root, const std::string &extraWifi = "") {
    root.write("/sim/device.ini",
               "[network]\nwlan0=lo\n[wifi]\nssid=DFX_WIFI_TEST\nkey=kqmtrel459\n" + extraWifi);
    for (const char *t : kPlaceholders)
        root.write(std::string("/system/bin/") + t, "data only");
}

class SimWifi : public ::testing::Test {
  protected:
    TempRoot root;
    struct wpa_ctrl *ctrl = nullptr;

    void SetUp() override {
        setenv("FTX_TIME_SCALE", "0.05", 1);
        make_handset(root);
        ASSERT_EQ(0, exit_status(dev_system("/system/bin/pv_wifi_init.sh")));
        char path[512];
        ASSERT_EQ(0, dev_path("/data/misc/wifi/sockets/wlan0", path, sizeof(path)));
        ctrl = wpa_ctrl_open(path);
        ASSERT_NE(nullptr, ctrl);
    }
    void TearDown() override {
        if (ctrl != nullptr) wpa_ctrl_close(ctrl);
        dev_system("/system/bin/pv_wifi_close.sh");
    }

    std::string request(const std::string &cmd) {
        char reply[2048];
        size_t len = sizeof(reply) - 1;
        if (wpa_ctrl_request(ctrl, cmd.c_str(), cmd.size(), reply, &len, nullptr) != 0)
            return "(no reply)";
        return std::string(reply, len);
    }
    std::string hw(const std::string &line) {
        char reply[4096];
        int rc = ftx_sim_control(line.c_str(), reply, sizeof(reply));
        return std::string(rc == 0 ? "" : "KO ") + reply;
    }
    // A device shell line's output, as the application reads wpa_cli's.
    std::string shell(const std::string &line) {
        FILE *fp = dev_popen(line.c_str(), "r");
        if (fp == nullptr) return "(refused)";
        std::string out;
        char buf[512];
        size_t n;
        while ((n = fread(buf, 1, sizeof(buf), fp)) > 0)
            out.append(buf, n);
        dev_pclose(fp);
        return out;
    }
    std::string wpa_cli(const std::string &command) {
        return shell("wpa_cli -i wlan0 -p /data/misc/wifi/sockets " + command);
    }
    std::string ipv4() {
        char ip[64];
        return dev_if_ipv4("wlan0", ip, sizeof(ip)) == 0 ? ip : "-";
    }
    // What the application sends to join the test network.
    void join(const std::string &psk = "kqmtrel459") {
        ASSERT_EQ("0\n", request("ADD_NETWORK"));
        ASSERT_EQ("OK\n", request("SET_NETWORK 0 ssid \"DFX_WIFI_TEST\""));
        ASSERT_EQ("OK\n", request("SET_NETWORK 0 key_mgmt WPA-PSK"));
        ASSERT_EQ("OK\n", request("SET_NETWORK 0 psk \"" + psk + "\""));
        ASSERT_EQ("OK\n", request("SELECT_NETWORK 0"));
        ASSERT_EQ("OK\n", request("RECONNECT"));
    }
    bool completed() { return has(request("STATUS"), "wpa_state=COMPLETED\n"); }
    int dhcp() { return exit_status(dev_system("/system/bin/dhcptool wlan0")); }
};

TEST_F(SimWifi, JoinsTakesAnAddressAndEndsWithTheCloseScript) {
    EXPECT_EQ("PONG\n", request("PING"));
    const pid_t pid = ftxhost::wifi_supplicant_pid(root.path());
    ASSERT_GT(pid, 0);
    EXPECT_EQ(0, exit_status(dev_system("/system/bin/pv_wifi_init.sh")));
    EXPECT_EQ(pid, ftxhost::wifi_supplicant_pid(root.path())) << "one supplicant per root";

    join();
    ASSERT_TRUE(until([&] { return completed(); }));
    EXPECT_EQ("-", ipv4()) << "no address before DHCP";
    ASSERT_EQ(0, dhcp());
    EXPECT_TRUE(has(request("STATUS"), "wpa_state=COMPLETED\nip_address=127.0.0.1\n"));
    EXPECT_TRUE(until([&] { return ipv4() == "127.0.0.1"; }));
    unsigned char mac[6];
    ASSERT_EQ(0, dev_if_hwaddr("wlan0", mac));
    EXPECT_TRUE(has(request("STATUS"), "address=02:00:00:00:00:01\n"));

    // The host's wpa_cli, as the application runs it for the AP information and the RSSI.
    const std::string status = wpa_cli("status");
    EXPECT_EQ("bssid=02:00:00:00:01:01", first_line(status)) << status;
    EXPECT_EQ("freq=2437", first_line(status, 1)) << status;
    EXPECT_EQ("RSSI=-55", first_line(wpa_cli("signal_poll")));
    EXPECT_TRUE(
        has(root.read("/log/wpa_supplicant.txt"), " SET_NETWORK 0 psk \"kqmtrel459\" -> OK\n"));
    const std::string tools = root.read("/log/tools.txt");
    EXPECT_TRUE(has(tools, "dhcptool wlan0\n")) << tools;
    EXPECT_TRUE(has(tools, "wpa_cli -i wlan0 -p /data/misc/wifi/sockets signal_poll\n")) << tools;

    // The interface taken down loses the address; the close script ends the supplicant.
    EXPECT_EQ(0, exit_status(dev_system("toybox ifconfig wlan0 down")));
    EXPECT_TRUE(until([&] { return ipv4() == "-"; }));
    EXPECT_TRUE(has(request("STATUS"), "wpa_state=INTERFACE_DISABLED\n"));
    EXPECT_EQ(0, exit_status(dev_system("/system/bin/pv_wifi_init.sh")));
    ASSERT_TRUE(until([&] { return completed(); })) << "init brings the interface back up";
    ASSERT_EQ(0, dhcp());
    EXPECT_TRUE(until([&] { return ipv4() == "127.0.0.1"; }));
    EXPECT_EQ(0, exit_status(dev_system("pv_wifi_close.sh")));
    EXPECT_EQ(0, ftxhost::wifi_supplicant_pid(root.path()));
    EXPECT_EQ("-", ipv4());
    EXPECT_FALSE(root.exists("/data/misc/wifi/sockets/wlan0"));
    EXPECT_EQ("(no reply)", request("PING"));
    EXPECT_NE(0, dhcp());
    EXPECT_TRUE(has(wpa_cli("status 2>&1"), "Failed to connect"));
}

TEST_F(SimWifi, LinkLocalRoundsAndFailingRequestsComeFromTheConsole) {
    join();
    ASSERT_TRUE(until([&] { return completed(); }));
    EXPECT_TRUE(has(hw("wifi linklocal 2"), "linklocal=2"));
    for (int round = 0; round < 2; round++) {
        ASSERT_EQ(0, dhcp());
        const std::string status = request("STATUS");
        EXPECT_TRUE(has(status, "ip_address=169.254.")) << round << "\n" << status;
        EXPECT_TRUE(until([&] { return ipv4().rfind("169.254.", 0) == 0; }));
    }
    ASSERT_EQ(0, dhcp());
    EXPECT_TRUE(has(request("STATUS"), "ip_address=127.0.0.1\n"));
    EXPECT_TRUE(has(hw("wifi"), "linklocal=0"));

    EXPECT_TRUE(has(hw("wifi fail STATUS"), "fail=STATUS"));
    EXPECT_EQ("FAIL\n", request("STATUS"));
    EXPECT_EQ("FAIL", first_line(wpa_cli("status")));
    EXPECT_EQ("PONG\n", request("PING"));
    hw("wifi fail STATUS off");
    EXPECT_TRUE(until([&] { return completed(); }));
}

TEST_F(SimWifi, AVanishingAccessPointAndAChangedKeyDropTheLink) {
    join();
    ASSERT_TRUE(until([&] { return completed(); }));
    ASSERT_EQ(0, dhcp());
    ASSERT_TRUE(until([&] { return ipv4() == "127.0.0.1"; }));

    EXPECT_TRUE(has(hw("wifi ap DFX_WIFI_TEST off"), " off\n"));
    EXPECT_TRUE(until([&] { return !completed() && ipv4() == "-"; }));
    EXPECT_EQ("FAIL", first_line(wpa_cli("signal_poll")));
    hw("wifi ap DFX_WIFI_TEST on");
    EXPECT_TRUE(until([&] { return completed() && ipv4() == "127.0.0.1"; }));

    hw("wifi rssi DFX_WIFI_TEST -71");
    EXPECT_TRUE(until([&] { return first_line(request("SIGNAL_POLL")) == "RSSI=-71"; }));

    // The access point's key changes: the handset's is wrong now and never completes.
    hw("wifi key DFX_WIFI_TEST another-key");
    EXPECT_TRUE(until([&] { return has(hw("wifi"), "failures=2"); }));
    EXPECT_FALSE(completed());
    EXPECT_EQ("-", ipv4());
    hw("wifi reset");
    EXPECT_TRUE(until([&] { return completed(); }));
}

TEST_F(SimWifi, TheConsoleWorksWithoutASupplicantAndShowsInHwStatus) {
    dev_system("/system/bin/pv_wifi_close.sh");
    const std::string shown = hw("wifi stuck DFX_WIFI_TEST on");
    EXPECT_TRUE(has(shown, "wifi: supplicant=stopped state=-")) << shown;
    EXPECT_TRUE(has(shown,
                    "wifi ap 0: DFX_WIFI_TEST WPA-PSK key=kqmtrel459 "
                    "bssid=02:00:00:00:01:01 freq=2437 rssi=-55 on stuck\n"))
        << shown;
    EXPECT_TRUE(has(hw("status"), "wifi ap 0: DFX_WIFI_TEST")) << hw("status");
    EXPECT_EQ("KO no access point NOWHERE\n", hw("wifi ap NOWHERE off"));
    EXPECT_TRUE(has(hw("wifi linklocal x"), "KO usage: wifi"));

    // The next supplicant starts with the console's changes: the stuck access point holds
    // the association.
    ASSERT_EQ(0, exit_status(dev_system("/system/bin/pv_wifi_init.sh")));
    wpa_ctrl_close(ctrl);
    char path[512];
    dev_path("/data/misc/wifi/sockets/wlan0", path, sizeof(path));
    ctrl = wpa_ctrl_open(path);
    ASSERT_NE(nullptr, ctrl);
    join();
    EXPECT_TRUE(until([&] { return has(request("STATUS"), "wpa_state=ASSOCIATING\n"); }));
    hw("wifi stuck DFX_WIFI_TEST off");
    EXPECT_TRUE(until([&] { return completed(); }));
}

// Two handsets side by side: each root has its own supplicant, and the clients of one never
// see the other's.
TEST(SimWifiRoots, SeveralRootsServeAtOnceAndASupplicantEndsWithItsRoot) {
    setenv("FTX_TIME_SCALE", "0.05", 1);
    TempRoot a;
    make_handset(a);
    std::string b = a.path() + "-b";
    std::filesystem::create_directories(b);
    auto write_b = [&](const std::string &p, const std::string &text) {
        std::filesystem::create_directories(std::filesystem::path(b + p).parent_path());
        FILE *f = fopen((b + p).c_str(), "w");
        fputs(text.c_str(), f);
        fclose(f);
    };
    write_b("/sim/device.ini",
            "[network]\nwlan0=lo\n[wifi]\nssid=DFX_WIFI_TEST\nkey=kqmtrel459\n"
            "mac=02:00:00:00:00:02\n");
    auto tool = [&](const std::string &rootPath, const std::string &line) {
        const std::string cmd =
            "FTX_ROOT='" + rootPath + "' FTX_APP_PID=" + std::to_string(getpid()) + " " + line;
        FILE *fp = popen(cmd.c_str(), "r");
        std::string out;
        char buf[512];
        size_t n;
        while ((n = fread(buf, 1, sizeof(buf), fp)) > 0)
            out.append(buf, n);
        pclose(fp);
        return out;
    };
    tool(a.path(), kTools + "/pv_wifi_init.sh");
    tool(b, kTools + "/pv_wifi_init.sh");
    const pid_t pidA = ftxhost::wifi_supplicant_pid(a.path()),
                pidB = ftxhost::wifi_supplicant_pid(b);
    ASSERT_GT(pidA, 0);
    ASSERT_GT(pidB, 0);
    EXPECT_NE(pidA, pidB);

    // Many wpa_cli clients on both roots at once.
    std::vector<std::thread> clients;
    std::vector<std::string> answers(8);
    for (int i = 0; i < 8; i++) {
        clients.emplace_back([&, i] {
            answers[i] = tool(i % 2 == 0 ? a.path() : b, kTools + "/wpa_cli -i wlan0 status");
        });
    }
    for (std::thread &t : clients)
        t.join();
    for (int i = 0; i < 8; i++) {
        EXPECT_TRUE(has(answers[i],
                        i % 2 == 0 ? "address=02:00:00:00:00:01\n" : "address=02:00:00:00:00:02\n"))
            << i << ": " << answers[i];
    }
    // A wpa_cli pointed outside the root is refused.
    EXPECT_TRUE(has(tool(a.path(), kTools + "/wpa_cli -p /var/run/wpa_supplicant status 2>&1"),
                    "outside the device"));

    std::filesystem::remove_all(b);
    EXPECT_TRUE(until([&] { return !alive(pidB); })) << "the supplicant of a removed root";
    tool(a.path(), kTools + "/pv_wifi_close.sh");
    EXPECT_EQ(0, ftxhost::wifi_supplicant_pid(a.path()));
}

}  // namespace

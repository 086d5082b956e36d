// The real ftx-mmi's PC channel under hostile clients: a port that is no port, a crowd of
// silent connections, a client that never reads, an idle one; and the PC tools and the
// launcher finding a root's port and console.
#include <dirent.h>
#include <stdio.h>
#include <sys/wait.h>
#include <unistd.h>

#include <fstream>
#include <set>
#include <sstream>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "channel.h"
#include "channel_probe.h"
#include "support/host_io.h"
#include "support/device_under_test.h"

namespace {

using chantest::closed_by_peer;
using chantest::parse_channel_figures;
using chantest::raw_connect;

const char kImei[] = "IMEIMoudle testItem read";
const char kImeiReply[] = "860000000000001";

std::map<std::string, long> figures(const DeviceUnderTest &dut) {
    return parse_channel_figures(dut.console("hw status"));
}

std::vector<std::string> fd_links(pid_t pid) {
    std::vector<std::string> links;
    std::string dir = "/proc/" + std::to_string(pid) + "/fd";
    DIR *d = opendir(dir.c_str());
    if (d == nullptr) return links;
    while (dirent *e = readdir(d)) {
        char target[256];
        ssize_t n = readlink((dir + "/" + e->d_name).c_str(), target, sizeof(target) - 1);
        if (n > 0) links.emplace_back(target, static_cast<size_t>(n));
    }
    closedir(d);
    return links;
}

// TCP sockets of the process that listen (from /proc/net/tcp and tcp6: state 0A).
int listening_sockets(pid_t pid) {
    std::set<std::string> inodes;
    for (const std::string &l : fd_links(pid)) {
        if (l.rfind("socket:[", 0) == 0) inodes.insert(l.substr(8, l.size() - 9));
    }
    int n = 0;
    for (const char *table : {"/proc/net/tcp", "/proc/net/tcp6"}) {
        std::ifstream in(table);
        std::string line;
        std::getline(in, line);  // heading
        while (std::getline(in, line)) {
            std::istringstream w(line);
            std::string sl, local, remote, state, queues, timer, retr, uid, timeout, inode;
            w >> sl >> local >> remote >> state >> queues >> timer >> retr >> uid >> timeout >>
                inode;
            n += state == "0A" && inodes.count(inode) > 0;
        }
    }
    return n;
}

// Reads exactly n bytes (less when the connection ends or nothing comes for 30 s).
std::string recv_exactly(int fd, size_t n) {
    std::string got;
    std::vector<char> buf(1 << 16);
    while (got.size() < n) {
        pollfd p{fd, POLLIN, 0};
        if (poll(&p, 1, 30000) <= 0) break;
        ssize_t r = recv(fd, buf.data(), std::min(buf.size(), n - got.size()), 0);
        if (r <= 0) break;
        got.append(buf.data(), static_cast<size_t>(r));
    }
    return got;
}

TEST(ChannelOnTheHandset, APortThatIsNoPortIsAStartErrorAndNothingListens) {
    DeviceUnderTest dut;
    dut.setEnv("FTX_PC_PORT", "100231");
    ASSERT_TRUE(dut.start());
    ASSERT_TRUE(dut.waitConsole());
    const std::string said = "PC channel not opened: FTX_PC_PORT \"100231\" is not a port number";
    EXPECT_TRUE(dut.waitLog("E DVK_CHANNEL: " + said));
    EXPECT_TRUE(dut_wait_until(
        [&] { return dut.read("/log/stdout.txt").find("ftx: " + said) != std::string::npos; },
        10000))
        << dut.read("/log/stdout.txt");
    EXPECT_EQ(figures(dut)["open"], 0);
    EXPECT_FALSE(dut.exists("/run/pc_port"));
    EXPECT_EQ(listening_sockets(dut.pid()), 0) << "not on 34695 (100231 modulo 65536) either";
    EXPECT_TRUE(dut.consoleOk("windows")) << "the application goes on without its channel";
}

// Hundreds of silent connections: the channel holds its cap of them, closes the rest at
// once (so the process keeps its descriptors), and serves again when they leave.
TEST(ChannelOnTheHandset, ASilentCrowdIsCappedAndTheChannelServesWhenItLeaves) {
    DeviceUnderTest dut;
    ASSERT_TRUE(dut.startToMenu());
    ASSERT_TRUE(dut_wait_until([&] { return dut.pc(kImei).first == 0; }, 10000));
    size_t fdsBefore = fd_links(dut.pid()).size();
    const long kCap = static_cast<long>(ftxsim::kChannelMaxClients);
    const long kCrowd = 300;
    std::vector<int> crowd;
    for (long i = 0; i < kCrowd; ++i) {
        int fd = raw_connect(dut.port());
        ASSERT_GE(fd, 0) << i;
        crowd.push_back(fd);
    }
    ASSERT_TRUE(dut_wait_until(
        [&] {
            auto f = figures(dut);
            return f["clients"] == kCap && f["refused"] == kCrowd - kCap;
        },
        20000))
        << dut.console("hw status");
    EXPECT_LE(fd_links(dut.pid()).size(), fdsBefore + kCap + 4);
    int closed = 0;
    for (int fd : crowd) {
        pollfd p{fd, POLLIN, 0};
        closed += poll(&p, 1, 0) == 1;
    }
    EXPECT_EQ(closed, kCrowd - kCap) << "every connection past the cap sees its end at once";
    EXPECT_EQ(dut.pc(kImei).first, -1) << "no room while the crowd holds every slot";
    EXPECT_TRUE(
        dut.waitLog("W DVK_CHANNEL: 64 PC clients connected: further connections are "
                    "closed until one leaves"));

    for (int fd : crowd)
        close(fd);
    ASSERT_TRUE(dut_wait_until([&] { return figures(dut)["clients"] == 0; }, 10000));
    auto answer = dut.pc(kImei);
    EXPECT_EQ(answer.first, 0);
    EXPECT_EQ(answer.second, kImeiReply);
}

// A station that sends file reads and never reads the answers: the channel holds about a
// megabyte for it, serves the others, and hands over every answer once it reads.
TEST(ChannelOnTheHandset, AClientThatNeverReadsIsHeldAtItsBound) {
    DeviceUnderTest dut;
    dut.setEnv("FTX_LOG_LEVEL", "I");  // the parser's debug lines would only slow this down
    std::string content(60000, 'b');
    for (size_t i = 0; i < content.size(); i += 97)
        content[i] = static_cast<char>('a' + i % 26);
    dut.write("/data/big", content);
    ASSERT_TRUE(dut.startToMenu());
    const int kReads = 200;  // 12 MB of answers: far past the bound and the socket buffers
    std::string burst;
    for (int i = 0; i < kReads; ++i)
        burst += "FileOptMoudle testItem read /data/big\n";
    int rude = raw_connect(dut.port());
    ASSERT_GE(rude, 0);
    ASSERT_TRUE(send_all(rude, burst));
    ASSERT_TRUE(dut_wait_until([&] { return figures(dut)["waiting"] == 1; }, 20000));
    auto f = figures(dut);
    EXPECT_GE(static_cast<size_t>(f["unsent"]), ftxsim::kChannelClientOutMax);
    EXPECT_LE(static_cast<size_t>(f["unsent"]), ftxsim::kChannelClientOutMax + content.size() + 32);
    auto answer = dut.pc(kImei);
    EXPECT_EQ(answer.first, 0) << "other clients are served meanwhile";
    EXPECT_EQ(answer.second, kImeiReply);

    std::string one = "0 " + std::to_string(content.size() + 1) + "\n*" + content + "\n";
    std::string all = recv_exactly(rude, one.size() * kReads);
    ASSERT_EQ(all.size(), one.size() * kReads);
    for (int i = 0; i < kReads; ++i)
        ASSERT_EQ(all.compare(one.size() * static_cast<size_t>(i), one.size(), one), 0) << i;
    close(rude);
    EXPECT_TRUE(dut_wait_until([&] { return figures(dut)["unsent"] == 0; }, 10000));
}

// With every wait scaled by 0.01 the idle time is 3 s: a silent connection is closed then.
TEST(ChannelOnTheHandset, ASilentConnectionIsClosedAfterTheIdleTime) {
    DeviceUnderTest dut;
    dut.setEnv("FTX_TIME_SCALE", "0.01");
    ASSERT_TRUE(dut.startToMenu());
    ASSERT_TRUE(dut.waitLog("PC channel listening on port"));
    int silent = raw_connect(dut.port());
    ASSERT_GE(silent, 0);
    EXPECT_TRUE(closed_by_peer(silent, 30000));
    close(silent);
    EXPECT_TRUE(dut.waitLog("I DVK_CHANNEL: PC client"));
    EXPECT_TRUE(dut.waitLog("closed: no traffic for 3.0 s"));
    EXPECT_EQ(dut.pc(kImei).first, 0);
}

// ./ftx pc and ./ftx console take --root DIR: the port from DIR/sim/device.ini (unless
// FTX_PC_PORT is set) and the console at DIR/run/console.sock, from any folder.
TEST(ChannelOnTheHandset, TheLauncherToolsFindTheRootTheyAreGiven) {
    DeviceUnderTest dut;
    std::string ini = dut.read("/sim/device.ini");
    size_t at = ini.find("port=20051");
    ASSERT_NE(at, std::string::npos);
    ini.replace(at, 10, "port=" + std::to_string(dut.port()));
    dut.write("/sim/device.ini", ini);
    ASSERT_TRUE(dut.startToMenu());
    std::string ftx = "cd / && env -u FTX_PC_PORT -u FTX_ROOT -u FTX_CONSOLE FTX_BUILD_DIR=" +
                      DeviceUnderTest::buildDir() + " " + DeviceUnderTest::sourceDir() + "/ftx ";
    int status;
    EXPECT_EQ(run(ftx + "pc --root " + dut.root() + " " + kImei, &status),
              std::string(kImeiReply) + "\n");
    EXPECT_EQ(status, 0);
    std::string windows = run(ftx + "console --root " + dut.root() + " windows", &status);
    EXPECT_EQ(status, 0);
    EXPECT_NE(windows.find("softkeybar"), std::string::npos) << windows;
    EXPECT_EQ(windows.substr(windows.size() - 3), "OK\n");

    for (const char *tool : {"pc", "console"}) {
        std::string help = run(ftx + tool + " --help", &status);
        EXPECT_EQ(status, 0) << tool;
        EXPECT_EQ(help.rfind(std::string("usage: ftx-") + tool + " ", 0), 0u) << help;
        EXPECT_NE(help.find("--root DIR"), std::string::npos) << help;
        EXPECT_EQ(help.back(), '\n');
    }
}

}  // namespace

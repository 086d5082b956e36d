// The command channel end to end: a separate process binds the simulated libraries and
// starts the channel with AtThreadStart; the test talks TCP to it as the station PC does.
#include <signal.h>
#include <stdlib.h>
#include <sys/wait.h>
#include <unistd.h>

#include <chrono>
#include <string>
#include <thread>
#include <vector>

#include <gtest/gtest.h>

#include "adbd_connection/AtCmdTable.h"
#include "pc_client.h"
#include "support/temp_root.h"

namespace {

class Channel : public ::testing::Test {
  protected:
    void SetUp() override { start(); }
    void TearDown() override { stop(SIGTERM); }

    void start() {
        unlink(root_.host("/run/pc_port").c_str());
        int in[2];
        ASSERT_EQ(0, pipe(in));
        pid_ = fork();
        ASSERT_GE(pid_, 0);
        if (pid_ == 0) {
            dup2(in[0], 0);
            close(in[1]);
            std::string build = getenv("FTX_BUILD_DIR");
            std::string app = build + "/tests/channel_app";
            setenv("FTX_PC_PORT", "0", 1);
            // The libraries are found by bare name, also under sanitizers, whose dlopen
            // does not see the program's own search path.
            setenv("LD_LIBRARY_PATH", (build + "/lib").c_str(), 1);
            execl(app.c_str(), app.c_str(), static_cast<char *>(nullptr));
            _exit(127);
        }
        close(in[0]);
        stdin_ = in[1];
        // The library writes its port once the channel thread has opened the socket (polled:
        // a slow start under a sanitizer or a loaded machine only takes longer).
        auto until = std::chrono::steady_clock::now() + std::chrono::seconds(30);
        while (port_ <= 0 && std::chrono::steady_clock::now() < until) {
            std::this_thread::sleep_for(std::chrono::milliseconds(10));
            port_ = atoi(root_.read("/run/pc_port").c_str());
        }
        ASSERT_GT(port_, 0) << "channel did not start";
    }
    void stop(int sig) {
        if (pid_ <= 0) return;
        kill(pid_, sig);
        close(stdin_);
        int status = 0;
        waitpid(pid_, &status, 0);
        pid_ = -1;
        port_ = 0;
    }
    void connect(ftxpc::PcClient &c) { ASSERT_EQ(0, c.connect_to("127.0.0.1", port_)); }
    int command(const std::string &line, std::string *reply) {
        ftxpc::PcClient c;
        if (c.connect_to("127.0.0.1", port_) != 0) return -1;
        return c.command(line, reply);
    }

    TempRoot root_;
    pid_t pid_ = -1;
    int stdin_ = -1;
    int port_ = 0;
};

TEST_F(Channel, ResultSurvivesAProcessRestart) {
    std::string reply;
    EXPECT_EQ(0, command("testinfoMoudle testItem 5,2,write", &reply));
    EXPECT_EQ(0, command("testinfoMoudle testItem 5,read", &reply));
    EXPECT_EQ("2", reply);
    stop(SIGKILL);
    start();
    EXPECT_EQ(0, command("testinfoMoudle testItem 5,read", &reply));
    EXPECT_EQ("2", reply);
}

TEST_F(Channel, ResultCodes) {
    std::string reply;
    EXPECT_EQ(2, command("no such command", &reply));
    EXPECT_EQ(2, command("testinfoMoudle testItem", &reply));  // the handler fails
    for (const AtCmdRow &r : g_atcmd_table) {
        if (r.fun != nullptr || r.action[0] != '\0') continue;
        EXPECT_EQ(3, command(r.cmd, &reply)) << r.cmd;  // no handler yet
        break;
    }
    EXPECT_EQ(0, command("FileOptMoudle testItem write /data/station.txt,hello", &reply));
    EXPECT_EQ("*5", reply);
    EXPECT_EQ(0, command("FileOptMoudle testItem read /data/station.txt", &reply));
    EXPECT_EQ("*hello", reply);
}

TEST_F(Channel, SeveralClientsAtOnce) {
    std::vector<std::thread> clients;
    std::vector<int> errors(4, 0);
    for (int t = 0; t < 4; t++) {
        clients.emplace_back([this, t, &errors] {
            ftxpc::PcClient c;
            if (c.connect_to("127.0.0.1", port_) != 0) {
                errors[t] = 100;
                return;
            }
            std::string item = std::to_string(20 + t), value = std::to_string(1 + t % 2), reply;
            if (c.command("testinfoMoudle testItem " + item + "," + value + ",write", &reply) != 0)
                errors[t]++;
            for (int i = 0; i < 25; i++) {
                if (c.command("testinfoMoudle testItem " + item + ",read", &reply) != 0 ||
                    reply != value)
                    errors[t]++;
            }
        });
    }
    for (auto &c : clients)
        c.join();
    for (int t = 0; t < 4; t++)
        EXPECT_EQ(0, errors[t]) << "client " << t;
}

TEST_F(Channel, HostileInputLeavesTheChannelServing) {
    ftxpc::PcClient c;
    connect(c);
    std::string reply;
    EXPECT_EQ(2, c.command(std::string(1 << 20, 'A'), &reply));
    EXPECT_EQ("", reply);
    std::string binary;
    for (int i = 0; i < 4096; i++)
        binary += static_cast<char>((i * 7919) & 0xFF);
    for (char &ch : binary)
        if (ch == '\n') ch = 'x';
    int rc = c.command(binary, &reply);
    EXPECT_TRUE(rc == 0 || rc == 2 || rc == 3) << rc;
    rc = c.command(std::string("testinfoMoudle testItem 7,1,write") + '\0' + "junk", &reply);
    EXPECT_EQ(0, rc);
    EXPECT_EQ(0, c.command("testinfoMoudle testItem 7,read", &reply));
    EXPECT_EQ("1", reply);

    // A client that leaves in the middle of a line.
    {
        ftxpc::PcClient gone;
        connect(gone);
        gone.send_raw("testinfoMoudle testItem 7,2,wri");
    }
    EXPECT_EQ(0, command("testinfoMoudle testItem 7,read", &reply));
    EXPECT_EQ("1", reply);
}

}  // namespace

// A test process registers its own command callback with the core-device library, serves
// the channel on a thread as the application does, and talks TCP to it.
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <sys/wait.h>
#include <unistd.h>

#include <atomic>
#include <chrono>
#include <fstream>
#include <mutex>
#include <string>
#include <thread>
#include <vector>

#include <gtest/gtest.h>

#include "hw/libdvk_ncoredevice.h"
#include "pc_client.h"
#include "support/temp_root.h"

namespace {

std::mutex g_seenLock;
std::vector<std::string> g_seen;

int command_cb(const char *line, char *reply, unsigned int size) {
    {
        std::lock_guard<std::mutex> lock(g_seenLock);
        g_seen.push_back(line);
    }
    if (strncmp(line, "echo ", 5) == 0) {
        snprintf(reply, size, "%s", line + 5);
        return 0;
    }
    if (strncmp(line, "read ", 5) == 0) {
        mmi_AutoTest_FileOpt_Read(line + 5, static_cast<int>(strlen(line + 5)));
        return 0;
    }
    if (strcmp(line, "none") == 0) return 3;
    snprintf(reply, size, "unknown");
    return 2;
}

size_t seen_count() {
    std::lock_guard<std::mutex> lock(g_seenLock);
    return g_seen.size();
}

class Channel : public ::testing::Test {
  protected:
    void SetUp() override {
        setenv("FTX_PC_PORT", "0", 1);  // any free port; the library writes it to /run/pc_port
        ASSERT_EQ(registerAtSocket(), 0);
        ASSERT_EQ(registerCommandProcess(command_cb), 0);
        loop_ = std::thread([this] { loopResult_ = runSelectLoopMode(); });
        port_ = atoi(root_.read("/run/pc_port").c_str());
        ASSERT_GT(port_, 0);
        std::lock_guard<std::mutex> lock(g_seenLock);
        g_seen.clear();
    }
    void TearDown() override {
        UnregisterAtSocket();
        loop_.join();
        EXPECT_EQ(loopResult_, 0);
    }
    void connect(ftxpc::PcClient &c) { ASSERT_EQ(c.connect_to("127.0.0.1", port_), 0); }

    TempRoot root_;
    std::thread loop_;
    std::atomic<int> loopResult_{-1};
    int port_ = 0;
};

TEST_F(Channel, AnswersCarryResultAndReply) {
    ftxpc::PcClient c;
    connect(c);
    std::string reply;
    EXPECT_EQ(c.command("echo hello world", &reply), 0);
    EXPECT_EQ(reply, "hello world");
    EXPECT_EQ(c.command("echo crlf\r", &reply), 0);
    EXPECT_EQ(reply, "crlf") << "a trailing CR is dropped";
    EXPECT_EQ(c.command("what", &reply), 2);
    EXPECT_EQ(reply, "unknown");
    EXPECT_EQ(c.command("none", &reply), 3);
    EXPECT_EQ(reply, "") << "the reply buffer is cleared before each command";
    // The exact bytes on the wire.
    ASSERT_EQ(c.send_raw("echo ab\n"), 0);
    std::string raw;
    ASSERT_EQ(c.read_answer(&raw), 0);
    EXPECT_EQ(raw, "ab");
}

TEST_F(Channel, SeveralClientsEachGetTheirOwnAnswersInOrder) {
    const int kClients = 4, kCommands = 50;
    std::vector<std::thread> threads;
    std::atomic<int> good{0};
    for (int k = 0; k < kClients; ++k) {
        threads.emplace_back([&, k] {
            ftxpc::PcClient c;
            if (c.connect_to("127.0.0.1", port_) != 0) return;
            std::string burst;
            for (int i = 0; i < kCommands; ++i)
                burst += "echo " + std::to_string(k) + ":" + std::to_string(i) + "\n";
            if (c.send_raw(burst) != 0) return;  // pipelined: all sent before any answer
            for (int i = 0; i < kCommands; ++i) {
                std::string reply;
                if (c.read_answer(&reply) != 0 ||
                    reply != std::to_string(k) + ":" + std::to_string(i))
                    return;
            }
            ++good;
        });
    }
    for (auto &t : threads)
        t.join();
    EXPECT_EQ(good, kClients);
    EXPECT_EQ(seen_count(), static_cast<size_t>(kClients * kCommands));
}

TEST_F(Channel, HugeLinesAndBinaryBytesLeaveTheChannelServing) {
    ftxpc::PcClient c;
    connect(c);
    std::string reply;
    EXPECT_EQ(c.command(std::string(1 << 20, 'x'), &reply), 2) << "a 1 MB line";
    EXPECT_EQ(reply, "");
    EXPECT_EQ(c.command(std::string(4096, 'y'), &reply), 2) << "one byte over the limit";
    EXPECT_EQ(seen_count(), 0u) << "no command ran for a line over the limit";
    EXPECT_EQ(c.command("echo " + std::string(4090, 'z'), &reply), 0) << "4095 bytes are fine";
    EXPECT_EQ(reply.size(), 4090u);

    std::string binary;
    for (int b = 0; b < 256; ++b) {
        if (b != '\n') binary.push_back(static_cast<char>(b));
    }
    EXPECT_EQ(c.command(binary, &reply), 2);
    EXPECT_EQ(c.command("echo still here", &reply), 0);
    EXPECT_EQ(reply, "still here");
}

TEST_F(Channel, AClientVanishingMidLineCostsNothing) {
    {
        ftxpc::PcClient gone;
        connect(gone);
        ASSERT_EQ(gone.send_raw("echo half a comm"), 0);
    }
    ftxpc::PcClient c;
    connect(c);
    std::string reply;
    EXPECT_EQ(c.command("echo next", &reply), 0);
    EXPECT_EQ(reply, "next");
    EXPECT_EQ(seen_count(), 1u) << "the unfinished line never ran";

    // A client that sends and leaves without reading its answer.
    {
        ftxpc::PcClient rude;
        connect(rude);
        ASSERT_EQ(rude.send_raw("echo 1\necho 2\n"), 0);
    }
    EXPECT_EQ(c.command("echo after", &reply), 0);
    EXPECT_EQ(reply, "after");
}

TEST_F(Channel, FileReadsAnswerWithTheFilesBytes) {
    root_.write("/data/blob", std::string("a\0b\nc", 5));
    ftxpc::PcClient c;
    connect(c);
    std::string reply;
    EXPECT_EQ(c.command("read /data/blob", &reply), 0);
    EXPECT_EQ(reply, std::string("*a\0b\nc", 6));
    EXPECT_EQ(c.command("read /data/../../etc/passwd", &reply), 0);
    EXPECT_EQ(reply, "ERROR \"..\" is not allowed");
}

std::string run(const std::string &cmd, int *status) {
    FILE *p = popen(cmd.c_str(), "r");
    std::string out;
    char buf[4096];
    size_t n;
    while ((n = fread(buf, 1, sizeof(buf), p)) > 0)
        out.append(buf, n);
    int st = pclose(p);
    *status = WIFEXITED(st) ? WEXITSTATUS(st) : -1;
    return out;
}

TEST_F(Channel, PcToolExitStatusIsTheResult) {
    const char *build = getenv("FTX_BUILD_DIR");
    ASSERT_NE(build, nullptr);
    std::string tool = std::string(build) + "/bin/ftx-pc -p " + std::to_string(port_);
    int status;
    EXPECT_EQ(run(tool + " echo hi there", &status), "hi there\n");
    EXPECT_EQ(status, 0);
    run(tool + " nothing", &status);
    EXPECT_EQ(status, 2);
    run(tool + " none", &status);
    EXPECT_EQ(status, 3);
    run(std::string(build) + "/bin/ftx-pc -p 1 echo x 2>/dev/null", &status);
    EXPECT_EQ(status, 1);

    std::string home = root_.path() + "/home";
    std::string out =
        run("printf 'echo a\\n!!\\nhistory\\n!9\\n' | HOME=" + home + " " + tool, &status);
    EXPECT_EQ(status, 0);
    EXPECT_NE(out.find("[0] a\necho a\n[0] a\n"), std::string::npos) << out;
    EXPECT_NE(out.find("   2  echo a"), std::string::npos) << out;
    EXPECT_NE(out.find("no such history entry"), std::string::npos) << out;
}

}  // namespace

// The channel of libdvk_ncoredevice.so over real TCP in this process (see channel_fixture.h):
// framing, several clients, the limits that keep hostile clients from taking it down, a
// bad port, and the ftx-pc tool against it.
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <sys/resource.h>
#include <sys/wait.h>
#include <unistd.h>

#include <atomic>
#include <filesystem>
#include <memory>
#include <string>
#include <thread>
#include <vector>

#include <gtest/gtest.h>

#include "channel.h"
#include "channel_fixture.h"
#include "support/host_io.h"

namespace {

using namespace chantest;
using ftxsim::kChannelClientOutMax;
using ftxsim::kChannelMaxClients;
using ftxsim::kChannelTotalOutMax;

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

    // Help, and ports that are no port: a clear refusal, never another port.
    std::string pc = std::string(build) + "/bin/ftx-pc";
    std::string help = run(pc + " --help", &status);
    EXPECT_EQ(status, 0);
    EXPECT_EQ(help.rfind("usage: ftx-pc ", 0), 0u) << help;
    EXPECT_EQ(help.back(), '\n');
    EXPECT_EQ(run(pc + " -h", &status), help);
    std::string bogus = run(pc + " --bogus 2>&1", &status);
    EXPECT_EQ(status, 1);
    EXPECT_NE(bogus.find("usage: ftx-pc "), std::string::npos) << bogus;
    for (const char *bad : {"100231", "abc", "0", "-5"}) {
        std::string err = run(pc + " -p " + bad + " echo x 2>&1", &status);
        EXPECT_EQ(status, 1) << bad;
        EXPECT_NE(err.find("the port is a number 1..65535"), std::string::npos) << err;
    }

    std::string home = root_.path() + "/home";
    std::string out =
        run("printf 'echo a\\n!!\\nhistory\\n!9\\n' | HOME=" + home + " " + tool, &status);
    EXPECT_EQ(status, 0);
    EXPECT_NE(out.find("[0] a\necho a\n[0] a\n"), std::string::npos) << out;
    EXPECT_NE(out.find("   2  echo a"), std::string::npos) << out;
    EXPECT_NE(out.find("no such history entry"), std::string::npos) << out;
}

// --root DIR takes the port its handset runs on, else DIR/sim/device.ini's, unless
// FTX_PC_PORT is set.
TEST_F(Channel, PcToolFindsThePortOfTheRootItIsGiven) {
    std::string other = root_.path() + "/other";
    std::filesystem::create_directories(other + "/sim");
    FILE *ini = fopen((other + "/sim/device.ini").c_str(), "w");
    ASSERT_NE(ini, nullptr);
    fprintf(ini, "[pc]\nport=%d\n", port_);
    fclose(ini);
    std::string pc = std::string(getenv("FTX_BUILD_DIR")) + "/bin/ftx-pc";
    int status;
    // The fixture's own FTX_PC_PORT=0 would win: leave it out.
    EXPECT_EQ(run("env -u FTX_PC_PORT FTX_ROOT=/nonexistent " + pc + " --root " + other +
                      " echo via root",
                  &status),
              "via root\n");
    EXPECT_EQ(status, 0);
    EXPECT_EQ(
        run("FTX_PC_PORT=" + std::to_string(port_) + " " + pc + " --root /nonexistent echo env",
            &status),
        "env\n")
        << "FTX_PC_PORT wins over the root";
    std::string err = run("env -u FTX_PC_PORT " + pc + " --root /nonexistent echo x 2>&1", &status);
    EXPECT_EQ(status, 1);
    EXPECT_NE(err.find("no [pc] port in /nonexistent/sim/device.ini"), std::string::npos) << err;
    // A handset started on another port than its root's setting says which in run/pc_port.
    std::string running = root_.path() + "/running";
    std::filesystem::create_directories(running + "/sim");
    std::filesystem::create_directories(running + "/run");
    ini = fopen((running + "/sim/device.ini").c_str(), "w");
    ASSERT_NE(ini, nullptr);
    fprintf(ini, "[pc]\nport=1\n");
    fclose(ini);
    FILE *now = fopen((running + "/run/pc_port").c_str(), "w");
    ASSERT_NE(now, nullptr);
    fprintf(now, "%d\n", port_);
    fclose(now);
    EXPECT_EQ(run("env -u FTX_PC_PORT " + pc + " --root " + running + " echo running", &status),
              "running\n");
    EXPECT_EQ(status, 0);
    err = run("FTX_PC_PORT=100231 " + pc + " echo x 2>&1", &status);
    EXPECT_EQ(status, 1);
    EXPECT_NE(err.find("FTX_PC_PORT \"100231\" is not a port number"), std::string::npos) << err;
}

// Silent connections past the cap are closed at once, so they cannot use up the process's
// descriptors, and the clients already connected keep being served.
TEST_F(Channel, ConnectionsPastTheCapAreClosedAtOnceAndAFreedSlotIsTaken) {
    long refusedBefore = figures()["refused"];
    std::vector<std::unique_ptr<ftxpc::PcClient>> held;
    for (size_t i = 0; i < kChannelMaxClients; ++i) {
        held.push_back(std::make_unique<ftxpc::PcClient>());
        connect(*held.back());
        std::string reply;
        ASSERT_EQ(held.back()->command("echo " + std::to_string(i), &reply), 0) << i;
    }
    EXPECT_EQ(figures()["clients"], static_cast<long>(kChannelMaxClients));
    const int kCrowd = 300;
    for (int i = 0; i < kCrowd; ++i) {
        int fd = raw_connect(port_);
        ASSERT_GE(fd, 0);
        bool closed = closed_by_peer(fd);
        close(fd);
        ASSERT_TRUE(closed) << "connection " << i << " past the cap";
    }
    auto f = figures();
    EXPECT_EQ(f["refused"] - refusedBefore, kCrowd);
    EXPECT_EQ(f["clients"], static_cast<long>(kChannelMaxClients));
    EXPECT_EQ(log_.count("further connections are closed until one leaves", ANDROID_LOG_WARN), 1u)
        << "one warning for the whole stretch at the cap";
    std::string reply;
    EXPECT_EQ(held.front()->command("echo first", &reply), 0);
    EXPECT_EQ(held.back()->command("echo last", &reply), 0);
    EXPECT_EQ(reply, "last");

    held.erase(held.begin() + 5);
    ASSERT_TRUE(wait_until([] { return figures()["clients"] == kChannelMaxClients - 1; }));
    ftxpc::PcClient next;
    connect(next);
    EXPECT_EQ(next.command("echo in the freed slot", &reply), 0);
    EXPECT_EQ(reply, "in the freed slot");
}

// Raises the descriptor limit back and frees the fillers however the test ends.
struct DescriptorFill {
    rlimit saved{};
    std::vector<int> fillers;
    ~DescriptorFill() {
        release();
        setrlimit(RLIMIT_NOFILE, &saved);
    }
    void release() {
        for (int fd : fillers)
            close(fd);
        fillers.clear();
    }
};

// With no descriptor left, a pending connection keeps the listener readable: the loop must
// not spin on it, must go on serving its clients, and must take the connection once a
// descriptor frees.
TEST_F(Channel, OutOfDescriptorsTheListenerRestsAndTakesTheClientOnceOneFrees) {
    ftxpc::PcClient a;
    connect(a);
    std::string reply;
    ASSERT_EQ(a.command("echo before", &reply), 0);
    int b = socket(AF_INET, SOCK_STREAM | SOCK_CLOEXEC, 0);  // made while descriptors last
    ASSERT_GE(b, 0);
    DescriptorFill fill;
    ASSERT_EQ(getrlimit(RLIMIT_NOFILE, &fill.saved), 0);
    int highest = 0;
    for (const auto &e : std::filesystem::directory_iterator("/proc/self/fd"))
        highest = std::max(highest, atoi(e.path().filename().c_str()));
    rlimit low = fill.saved;
    low.rlim_cur = static_cast<rlim_t>(highest) + 16;  // filling up to this is quick
    ASSERT_EQ(setrlimit(RLIMIT_NOFILE, &low), 0);
    for (int fd; (fd = dup(b)) >= 0;)
        fill.fillers.push_back(fd);
    ASSERT_EQ(errno, EMFILE);

    sockaddr_in addr{};
    addr.sin_family = AF_INET;
    addr.sin_port = htons(static_cast<uint16_t>(port_));
    addr.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
    ASSERT_EQ(::connect(b, reinterpret_cast<sockaddr *>(&addr), sizeof(addr)), 0);
    ASSERT_TRUE(
        wait_until([&] { return log_.count("cannot accept a PC client", ANDROID_LOG_ERROR) > 0; }));
    long before = figures()["wakeups"];
    for (int i = 0; i < 20; ++i) {
        ASSERT_EQ(a.command("echo during " + std::to_string(i), &reply), 0);
        EXPECT_EQ(reply, "during " + std::to_string(i));
    }
    long woke = figures()["wakeups"] - before;
    // Twenty commands and a few listener retries; a loop polling the readable listener
    // wakes thousands of times meanwhile.
    EXPECT_LT(woke, 100) << "the loop spins on a listener it cannot accept from";

    fill.release();
    ASSERT_EQ(send(b, "echo taken\n", 11, MSG_NOSIGNAL), 11);
    pollfd p{b, POLLIN, 0};
    ASSERT_EQ(poll(&p, 1, 10000), 1) << "the waiting client is served once a descriptor frees";
    char buf[64] = {};
    ASSERT_GT(recv(b, buf, sizeof(buf) - 1, 0), 0);
    EXPECT_STREQ(buf, "0 5\ntaken\n");
    close(b);
    EXPECT_EQ(log_.count("cannot accept a PC client", ANDROID_LOG_ERROR), 1u)
        << "logged once per stretch";
    EXPECT_EQ(log_.count("PC clients are accepted again"), 1u);
}

std::string fills(int commands, int bytes) {
    std::string burst;
    for (int i = 0; i < commands; ++i)
        burst += "fill " + std::to_string(bytes) + "\n";
    return burst;
}

// Reads n answers of `bytes` 'f's; how many were whole and in order.
int take_fills(ftxpc::PcClient &c, int n, int bytes) {
    std::string reply;
    for (int i = 0; i < n; ++i) {
        if (c.read_answer(&reply) != 0 || reply != std::string(static_cast<size_t>(bytes), 'f'))
            return i;
    }
    return n;
}

const int kFill = 65000;          // about one reply buffer
const int kFillsPerClient = 200;  // some 13 MB: far past the bound and any socket buffers
const size_t kOneAnswer = kFill + 16;

// A client that sends commands and never reads is held at its bound (its further lines
// wait in the kernel), the others are served meanwhile, and when it reads at last it gets
// every answer.
TEST_F(Channel, AClientThatDoesNotReadIsHeldAtItsBoundAndLosesNoAnswer) {
    long servedBefore = figures()["served"];
    ftxpc::PcClient rude;
    connect(rude);
    ASSERT_EQ(rude.send_raw(fills(kFillsPerClient, kFill)), 0);
    ASSERT_TRUE(wait_until([] { return figures()["waiting"] == 1; }));
    auto f = figures();
    EXPECT_GE(static_cast<size_t>(f["unsent"]), kChannelClientOutMax);
    EXPECT_LE(static_cast<size_t>(f["unsent"]), kChannelClientOutMax + kOneAnswer);
    EXPECT_LT(f["served"] - servedBefore, kFillsPerClient) << "its further lines wait";
    EXPECT_EQ(log_.count("lines wait until it reads"), 1u);

    ftxpc::PcClient polite;
    connect(polite);
    std::string reply;
    EXPECT_EQ(polite.command("echo meanwhile", &reply), 0);
    EXPECT_EQ(reply, "meanwhile");

    ASSERT_EQ(take_fills(rude, kFillsPerClient, kFill), kFillsPerClient);
    EXPECT_EQ(rude.command("echo done", &reply), 0);
    EXPECT_EQ(reply, "done");
    EXPECT_TRUE(wait_until([] {
        auto f = figures();
        return f["unsent"] == 0 && f["waiting"] == 0;
    }));
}

// Many such clients together are held at the total bound, below the sum of their own.
TEST_F(Channel, ClientsThatDoNotReadAreHeldAtTheTotalBoundTogether) {
    const size_t kRude = kChannelTotalOutMax / kChannelClientOutMax + 4;
    std::vector<std::unique_ptr<ftxpc::PcClient>> rude;
    for (size_t i = 0; i < kRude; ++i) {
        rude.push_back(std::make_unique<ftxpc::PcClient>());
        connect(*rude.back());
        ASSERT_EQ(rude.back()->send_raw(fills(kFillsPerClient, kFill)), 0);
    }
    ASSERT_TRUE(wait_until([&] { return figures()["waiting"] == static_cast<long>(kRude); }));
    auto f = figures();
    EXPECT_GE(static_cast<size_t>(f["unsent"]), kChannelTotalOutMax);
    EXPECT_LE(static_cast<size_t>(f["unsent"]), kChannelTotalOutMax + kRude * kOneAnswer);

    ftxpc::PcClient polite;
    connect(polite);
    std::string reply;
    EXPECT_EQ(polite.command("echo meanwhile", &reply), 0) << "a client with nothing unsent runs";
    for (size_t i = 0; i < kRude; ++i)
        ASSERT_EQ(take_fills(*rude[i], kFillsPerClient, kFill), kFillsPerClient) << i;
    EXPECT_TRUE(wait_until([] { return figures()["unsent"] == 0; }));
}

// A client that sends its commands and closes its sending side (as a shell pipe does)
// still gets every answer, held ones included, and is closed after the last.
TEST_F(Channel, AClientThatClosesItsSendingSideGetsEveryAnswer) {
    ftxpc::PcClient c;
    connect(c);
    ASSERT_EQ(c.send_raw(fills(kFillsPerClient, kFill) + "echo last\nunfinished"), 0);
    ASSERT_EQ(c.finish_sending(), 0);
    ASSERT_TRUE(wait_until([] { return figures()["waiting"] == 1; }));
    ASSERT_EQ(take_fills(c, kFillsPerClient, kFill), kFillsPerClient);
    std::string reply;
    EXPECT_EQ(c.read_answer(&reply), 0);
    EXPECT_EQ(reply, "last");
    EXPECT_EQ(c.read_answer(&reply, 10000), -1) << "closed after the last answer";
    EXPECT_TRUE(wait_until([] { return figures()["clients"] == 0; }));
    EXPECT_EQ(seen_count(), static_cast<size_t>(kFillsPerClient + 1))
        << "the unfinished line never ran";
}

// Writes what the code under test prints on standard error into a string.
class StderrCapture {
  public:
    StderrCapture() {
        fflush(stderr);
        saved_ = dup(2);
        file_ = tmpfile();
        dup2(fileno(file_), 2);
    }
    ~StderrCapture() { text(); }
    std::string text() {
        if (saved_ >= 0) {
            fflush(stderr);
            dup2(saved_, 2);
            close(saved_);
            saved_ = -1;
            rewind(file_);
            char buf[4096];
            size_t n;
            while ((n = fread(buf, 1, sizeof(buf), file_)) > 0)
                text_.append(buf, n);
            fclose(file_);
        }
        return text_;
    }

  private:
    int saved_ = -1;
    FILE *file_ = nullptr;
    std::string text_;
};

// A port that is no port is a start-up error on the log and on standard error, and the
// channel listens nowhere (never on the number taken modulo 65536).
TEST(ChannelStart, APortThatIsNoPortIsAStartErrorAndNothingListens) {
    TempRoot root;
    ChannelLog log;
    struct Case {
        const char *env;  // FTX_PC_PORT, or null for the device settings' value
        const char *ini;
        const char *expect;
    };
    const Case cases[] = {
        {"100231", "20051", "FTX_PC_PORT \"100231\" is not a port number (0..65535)"},
        {"65536", "20051", "FTX_PC_PORT \"65536\""},
        {"-1", "20051", "FTX_PC_PORT \"-1\""},
        {"20051x", "20051", "FTX_PC_PORT \"20051x\""},
        {"abc", "20051", "FTX_PC_PORT \"abc\""},
        {nullptr, "abc", "sim/device.ini [pc] port \"abc\" is not a port number"},
        {nullptr, "100231", "sim/device.ini [pc] port \"100231\""},
    };
    for (const Case &c : cases) {
        SCOPED_TRACE(c.expect);
        if (c.env != nullptr) {
            setenv("FTX_PC_PORT", c.env, 1);
        } else {
            unsetenv("FTX_PC_PORT");
        }
        root.write("/sim/device.ini", std::string("[pc]\nport=") + c.ini + "\n");
        root.write("/run/pc_port", "20051\n");  // left by an earlier run
        ftx_host_reset();
        StderrCapture err;
        EXPECT_EQ(registerAtSocket(), -1);
        std::string said = err.text();
        EXPECT_NE(said.find(std::string("PC channel not opened: ") + c.expect), std::string::npos)
            << said;
        EXPECT_EQ(log.count(c.expect, ANDROID_LOG_ERROR), 1u);
        EXPECT_FALSE(root.exists("/run/pc_port")) << "no port file points at a closed channel";
        EXPECT_EQ(figures()["open"], 0);
        EXPECT_EQ(runSelectLoopMode(), -1) << "the loop does not run without a socket";
    }
    unsetenv("FTX_PC_PORT");
}

}  // namespace

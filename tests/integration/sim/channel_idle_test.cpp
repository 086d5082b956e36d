// The channel's idle time-out: every platform wait is scaled by 0.005 here, so the idle
// time is 1.5 s instead of 300 s.
#include <stdlib.h>

#include <chrono>
#include <string>

#include <gtest/gtest.h>

#include "channel.h"
#include "channel_fixture.h"
#include "tp_os.h"

namespace {

using namespace chantest;

// Before anything reads the scale (it is read once per process).
const bool kScaled = setenv("FTX_TIME_SCALE", "0.005", 1) == 0;

long idle_ms() {
    return static_cast<long>(ftxsim::kChannelIdleSeconds * 1000 * tp_os_time_scale());
}

TEST_F(Channel, ASilentClientIsClosedAfterTheIdleTimeWhileABusyOneStays) {
    ASSERT_TRUE(kScaled);
    ASSERT_EQ(idle_ms(), 1500);
    long closedBefore = figures()["idle_closed"];
    ftxpc::PcClient silent, busy;
    connect(silent);
    auto start = std::chrono::steady_clock::now();
    connect(busy);
    std::string reply;
    int commands = 0;
    // The busy client keeps talking until the silent one is gone.
    ASSERT_TRUE(wait_until([&] {
        EXPECT_EQ(busy.command("echo busy", &reply), 0);
        ++commands;
        return figures()["idle_closed"] == closedBefore + 1;
    }));
    auto took = std::chrono::duration_cast<std::chrono::milliseconds>(
                    std::chrono::steady_clock::now() - start)
                    .count();
    EXPECT_GE(took, idle_ms() - 10) << "closed before its idle time";
    EXPECT_GT(commands, 1);
    EXPECT_EQ(silent.command("echo too late", &reply), -1);
    EXPECT_EQ(busy.command("echo still", &reply), 0);
    EXPECT_EQ(reply, "still");
    EXPECT_EQ(log_.count("closed: no traffic for 1.5 s"), 1u);
}

// A client held for not reading its answers is closed when it stays silent, and what it
// left unsent is given back.
TEST_F(Channel, AClientHeldForNotReadingIsClosedWhenSilentAndItsOutputFreed) {
    long closedBefore = figures()["idle_closed"];
    ftxpc::PcClient rude;
    connect(rude);
    std::string burst;
    for (int i = 0; i < 200; ++i)
        burst += "fill 65000\n";
    ASSERT_EQ(rude.send_raw(burst), 0);
    ASSERT_TRUE(wait_until([] { return figures()["waiting"] == 1; }));
    EXPECT_GT(figures()["unsent"], 0);
    EXPECT_TRUE(wait_until([&] {
        auto f = figures();
        return f["idle_closed"] == closedBefore + 1 && f["clients"] == 0 && f["unsent"] == 0 &&
               f["waiting"] == 0;
    })) << "closed, and nothing kept for it";
}

// A command that runs longer than the idle time costs neither its client nor one whose
// line arrived meanwhile the connection: their bytes came while the loop was busy.
TEST_F(Channel, ACommandLongerThanTheIdleTimeClosesNoClient) {
    long closedBefore = figures()["idle_closed"];
    ftxpc::PcClient slow, queued;
    connect(slow);
    connect(queued);
    ASSERT_EQ(slow.send_raw("sleep " + std::to_string(idle_ms() + 500) + "\n"), 0);
    ASSERT_TRUE(wait_until([] { return seen_count() == 1; }));
    ASSERT_EQ(queued.send_raw("echo queued\n"), 0);
    std::string reply;
    EXPECT_EQ(slow.read_answer(&reply), 0);
    EXPECT_EQ(reply, "slept");
    EXPECT_EQ(queued.read_answer(&reply), 0);
    EXPECT_EQ(reply, "queued");
    EXPECT_EQ(slow.command("echo after", &reply), 0);
    EXPECT_EQ(queued.command("echo after", &reply), 0);
    EXPECT_EQ(figures()["idle_closed"], closedBefore);
}

// The interactive ftx-pc opens its connection again when the handset closed it for idleness:
// the operator sees the answer, not a lost connection.
TEST_F(Channel, ThePcPromptReconnectsAfterAnIdleClose) {
    long closedBefore = figures()["idle_closed"];
    std::string out = root_.path() + "/prompt.txt";
    std::string cmd = std::string(getenv("FTX_BUILD_DIR")) + "/bin/ftx-pc -p " +
                      std::to_string(port_) + " > " + out + " 2>&1";
    FILE *prompt = popen(("HOME=" + root_.path() + " " + cmd).c_str(), "w");
    ASSERT_NE(prompt, nullptr);
    fputs("echo before\n", prompt);
    fflush(prompt);
    EXPECT_TRUE(wait_until(
        [&] { return root_.read("/prompt.txt").find("[0] before") != std::string::npos; }));
    EXPECT_TRUE(wait_until([&] { return figures()["idle_closed"] == closedBefore + 1; }));
    fputs("echo after\n", prompt);
    EXPECT_EQ(pclose(prompt), 0);
    std::string said = root_.read("/prompt.txt");
    EXPECT_NE(said.find("[0] after"), std::string::npos) << said;
    EXPECT_EQ(said.find("lost"), std::string::npos) << said;
}

}  // namespace

// A test process registers its own command callback with the core-device library, serves
// the channel on a thread as the application does, and talks TCP to it. Shared by the
// channel's test programs (one of them runs with a short FTX_TIME_SCALE).
#pragma once

#include <arpa/inet.h>
#include <errno.h>
#include <netinet/in.h>
#include <poll.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <sys/socket.h>
#include <unistd.h>

#include <algorithm>
#include <atomic>
#include <chrono>
#include <functional>
#include <map>
#include <mutex>
#include <string>
#include <thread>
#include <utility>
#include <vector>

#include <gtest/gtest.h>

#include "android/log.h"
#include "channel_probe.h"
#include "ftx_host.h"
#include "hw/libdvk_ncoredevice.h"
#include "pc_client.h"
#include "support/temp_root.h"

extern "C" int ftx_sim_control(const char *line, char *reply, size_t size);

namespace chantest {

inline std::mutex g_seenLock;
inline std::vector<std::string> g_seen;

// The test's commands: "echo TEXT" answers TEXT, "fill N" N bytes of 'f', "read PATH" a
// file through the library's file read, "sleep MS" answers "slept" after MS ms, "none"
// result 3, anything else 2 "unknown".
inline int command_cb(const char *line, char *reply, unsigned int size) {
    {
        std::lock_guard<std::mutex> lock(g_seenLock);
        g_seen.push_back(line);
    }
    if (strncmp(line, "echo ", 5) == 0) {
        snprintf(reply, size, "%s", line + 5);
        return 0;
    }
    if (strncmp(line, "fill ", 5) == 0) {
        size_t n = std::min<size_t>(strtoul(line + 5, nullptr, 10), size - 1);
        memset(reply, 'f', n);
        reply[n] = '\0';
        return 0;
    }
    if (strncmp(line, "read ", 5) == 0) {
        mmi_AutoTest_FileOpt_Read(line + 5, static_cast<int>(strlen(line + 5)));
        return 0;
    }
    if (strncmp(line, "sleep ", 6) == 0) {
        // The command's own run time, as a handler waiting for hardware has.
        std::this_thread::sleep_for(std::chrono::milliseconds(atoi(line + 6)));
        snprintf(reply, size, "slept");
        return 0;
    }
    if (strcmp(line, "none") == 0) return 3;
    snprintf(reply, size, "unknown");
    return 2;
}

inline size_t seen_count() {
    std::lock_guard<std::mutex> lock(g_seenLock);
    return g_seen.size();
}

// The channel's figures (see channel_probe.h).
inline std::map<std::string, long> figures() {
    std::vector<char> buf(1 << 16);
    ftx_sim_control("status", buf.data(), buf.size());
    return parse_channel_figures(buf.data());
}

// Polls pred every millisecond until it holds or timeoutMs passes.
inline bool wait_until(const std::function<bool()> &pred, int timeoutMs = 20000) {
    auto end = std::chrono::steady_clock::now() + std::chrono::milliseconds(timeoutMs);
    while (!pred()) {
        if (std::chrono::steady_clock::now() >= end) return false;
        std::this_thread::sleep_for(std::chrono::milliseconds(1));
    }
    return true;
}

// Entries the channel logged (priority, text) while a test ran.
class ChannelLog {
  public:
    ChannelLog() { ftx_log_set_capture(&ChannelLog::capture, this); }
    ~ChannelLog() { ftx_log_set_capture(nullptr, nullptr); }
    // How many entries of at least prio hold text.
    size_t count(const std::string &text, int prio = 0) const {
        std::lock_guard<std::mutex> lock(lock_);
        size_t n = 0;
        for (const auto &e : entries_)
            n += e.first >= prio && e.second.find(text) != std::string::npos;
        return n;
    }

  private:
    static void capture(int prio, const char *tag, const char *msg, void *ctx) {
        if (strcmp(tag, "DVK_CHANNEL") != 0) return;
        auto *self = static_cast<ChannelLog *>(ctx);
        std::lock_guard<std::mutex> lock(self->lock_);
        self->entries_.emplace_back(prio, msg);
    }
    mutable std::mutex lock_;
    std::vector<std::pair<int, std::string>> entries_;
};

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
    ChannelLog log_;
    std::thread loop_;
    std::atomic<int> loopResult_{-1};
    int port_ = 0;
};

}  // namespace chantest

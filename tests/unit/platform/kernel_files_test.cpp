// The kernel files that act on writes: the RTC alarm, and the suspend through the power state.
#include <errno.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <time.h>

#include <chrono>
#include <condition_variable>
#include <future>
#include <mutex>
#include <string>

#include <gtest/gtest.h>

#include "devfs.h"
#include "ftx_host.h"
#include "minigui/ftx_gui.h"
#include "support/temp_root.h"
#include "tp_os.h"

namespace {

const char kAlarm[] = "/sys/class/rtc/rtc0/wakealarm";
const char kState[] = "/sys/power/state";

using Clock = std::chrono::system_clock;

long long now_s() {
    return static_cast<long long>(Clock::to_time_t(Clock::now()));
}

// One write through dev_fopen, as the application makes it: 0, or the errno of the failure.
int write_file(const char *path, const std::string &text) {
    FILE *f = dev_fopen(path, "w");
    if (f == nullptr) return errno;
    fputs(text.c_str(), f);
    errno = 0;
    return fclose(f) == 0 ? 0 : errno;
}

// A root with the files the kernel makes at boot.
struct KernelRoot : TempRoot {
    KernelRoot() {
        write(kAlarm, "");
        write(kState, "mem\n");
    }
};

// The platform's log lines, and waiting for them.
class PlatformLog {
  public:
    PlatformLog() { ftx_log_set_capture(capture, this); }
    ~PlatformLog() { ftx_log_set_capture(nullptr, nullptr); }
    size_t count(const std::string &line) {
        std::lock_guard<std::mutex> lk(lock_);
        return count_locked(line);
    }
    bool wait(const std::string &line, size_t n = 1) {
        std::unique_lock<std::mutex> lk(lock_);
        return cv_.wait_for(lk, std::chrono::seconds(10), [&] { return count_locked(line) >= n; });
    }

  private:
    static void capture(int, const char *tag, const char *msg, void *ctx) {
        if (strcmp(tag, "PLATFORM") != 0) return;
        auto *self = static_cast<PlatformLog *>(ctx);
        std::lock_guard<std::mutex> lk(self->lock_);
        self->text_ += std::string(msg) + "\n";
        self->cv_.notify_all();
    }
    size_t count_locked(const std::string &line) const {
        size_t n = 0;
        for (size_t p = text_.find(line + "\n"); p != std::string::npos;
             p = text_.find(line + "\n", p + 1))
            n++;
        return n;
    }
    std::mutex lock_;
    std::condition_variable cv_;
    std::string text_;
};

// "mem" written on a thread of its own. The handset is woken in the end whatever the test
// saw, so that a failed expectation never leaves the thread asleep.
class Suspend {
  public:
    Suspend() : done_(std::async(std::launch::async, [] { return write_file(kState, "mem"); })) {}
    ~Suspend() {
        char reply[64];
        while (!returned(100))
            ftx_console_execute("wake", reply, sizeof(reply));
    }
    bool returned(int ms) {
        return !done_.valid() ||
               done_.wait_for(std::chrono::milliseconds(ms)) == std::future_status::ready;
    }
    int result() { return done_.get(); }

  private:
    std::future<int> done_;
};

TEST(KernelFiles, TheRtcAlarmIsArmedOnceAndClearedByZeroOrAPastTime) {
    KernelRoot root;
    const long long at = now_s() + 100;
    EXPECT_EQ(0, write_file(kAlarm, std::to_string(at)));
    EXPECT_EQ(std::to_string(at) + "\n", root.read(kAlarm));
    // Armed: another time is refused until a 0 clears it.
    EXPECT_EQ(EBUSY, write_file(kAlarm, std::to_string(at + 50)));
    EXPECT_EQ(std::to_string(at) + "\n", root.read(kAlarm));
    EXPECT_EQ(0, write_file(kAlarm, "0\n"));
    EXPECT_EQ("", root.read(kAlarm));

    const long long before = now_s();
    EXPECT_EQ(0, write_file(kAlarm, "+30"));
    const long long relative = atoll(root.read(kAlarm).c_str());
    EXPECT_GE(relative, before + 30);
    EXPECT_LE(relative, now_s() + 30);
    EXPECT_EQ(0, write_file(kAlarm, std::to_string(now_s() - 10)));
    EXPECT_EQ("", root.read(kAlarm));
    for (const char *bad : {"soon", "-5", "12x", "+", "\n"})
        EXPECT_EQ(EINVAL, write_file(kAlarm, bad)) << bad;
    EXPECT_EQ(EINVAL, write_file(kState, "disk"));
}

TEST(KernelFiles, TheKernelMakesThemAtBootKeepsAnArmedAlarmAndUnblanksThePanel) {
    TempRoot root;
    errno = 0;
    EXPECT_EQ(nullptr, dev_fopen(kState, "w"));
    EXPECT_EQ(ENOENT, errno);
    tp_os_thread_init(0, nullptr);
    EXPECT_EQ("mem\n", root.read(kState));
    EXPECT_EQ("", root.read(kAlarm));
    const std::string armed = std::to_string(now_s() + 100) + "\n";
    ASSERT_EQ(0, write_file(kAlarm, armed));
    // A handset that went down asleep comes up lit, whatever the alarm does.
    root.write("/sys/class/graphics/fb0/blank", "4");
    root.write("/sys/class/leds/lcd-backlight/brightness", "0");
    tp_os_thread_init(0, nullptr);
    EXPECT_EQ(armed, root.read(kAlarm));
    EXPECT_EQ("0", root.read("/sys/class/graphics/fb0/blank"));
    EXPECT_EQ("255", root.read("/sys/class/leds/lcd-backlight/brightness"));
}

TEST(Suspend, SleepsUntilTheAlarmAndClearsIt) {
    KernelRoot root;
    PlatformLog log;
    const long long at = now_s() + 1;
    ASSERT_EQ(0, write_file(kAlarm, std::to_string(at)));
    {
        Suspend s;
        ASSERT_TRUE(s.returned(10000));
        EXPECT_EQ(0, s.result());
    }
    EXPECT_GE(Clock::now(), Clock::from_time_t(static_cast<time_t>(at)));
    EXPECT_EQ("", root.read(kAlarm));
    EXPECT_EQ(1u, log.count("suspend: sleeping until " + std::to_string(at)));
    EXPECT_EQ(1u, log.count("resume: woken by alarm"));

    // An alarm time already past fires at once.
    root.write(kAlarm, std::to_string(now_s() - 5) + "\n");
    {
        Suspend s;
        ASSERT_TRUE(s.returned(10000));
    }
    EXPECT_EQ("", root.read(kAlarm));
    EXPECT_EQ(2u, log.count("resume: woken by alarm"));
    EXPECT_EQ(0u, log.count("resume: woken by key"));
}

TEST(Suspend, AKeyOrTheConsoleWakesItAndAnAlarmArmedMeanwhileToo) {
    KernelRoot root;
    PlatformLog log;
    char reply[64];
    EXPECT_EQ(-1, ftx_console_execute("wake", reply, sizeof(reply)));
    EXPECT_STREQ("KO not suspended\n", reply);
    const std::string byKey = "suspend: sleeping until a key press";
    {
        Suspend s;
        ASSERT_TRUE(log.wait(byKey));
        EXPECT_FALSE(s.returned(0));
        EXPECT_EQ(0, ftx_console_execute("wake", reply, sizeof(reply)));
        ASSERT_TRUE(s.returned(10000));
        EXPECT_EQ(0, s.result());
    }
    EXPECT_EQ(1u, log.count("resume: woken by key"));

    // A key press comes before the alarm, which stays armed.
    const std::string at = std::to_string(now_s() + 3600);
    ASSERT_EQ(0, write_file(kAlarm, at));
    {
        Suspend s;
        ASSERT_TRUE(log.wait("suspend: sleeping until " + at));
        ftx_gui_inject(FTX_INPUT_KEYDOWN, 1, 0);
        ASSERT_TRUE(s.returned(10000));
    }
    EXPECT_EQ(2u, log.count("resume: woken by key"));
    EXPECT_EQ(at + "\n", root.read(kAlarm));

    // Asleep without an alarm, then one is armed: it fires.
    ASSERT_EQ(0, write_file(kAlarm, "0"));
    {
        Suspend s;
        ASSERT_TRUE(log.wait(byKey, 2));
        ASSERT_EQ(0, write_file(kAlarm, "+1"));
        ASSERT_TRUE(s.returned(10000));
    }
    EXPECT_EQ(1u, log.count("resume: woken by alarm"));
    EXPECT_EQ("", root.read(kAlarm));
}

}  // namespace

// Kernel files written at boot, and the kernel files that act on what is written into them.
#include "kernel_files.h"

#include <ctype.h>
#include <errno.h>
#include <fcntl.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <strings.h>
#include <unistd.h>

#include <chrono>
#include <condition_variable>
#include <mutex>
#include <string>

#include <android/log.h>

#include "devfs.h"
#include "ftx_host.h"
#include "shell_line.h"

namespace ftxhost {

namespace {

const char kTag[] = "PLATFORM";
const char kAlarmFile[] = "/sys/class/rtc/rtc0/wakealarm";
const char kStateFile[] = "/sys/power/state";
// The sleep states the state file offers: the one this kernel knows.
const char kStates[] = "mem\n";
// Later than any alarm the RTC can hold; a larger number is refused.
const long long kEpochMax = 1LL << 40;

using Clock = std::chrono::system_clock;

long long epoch_now() {
    return static_cast<long long>(Clock::to_time_t(Clock::now()));
}

// Makes the folders of a device path, and the file holding text when it is missing: an
// existing file keeps what it holds (the RTC keeps its alarm across a power-off).
void ensure_file(const std::string &devicePath, const char *text) {
    for (size_t slash = devicePath.find('/', 1); slash != std::string::npos;
         slash = devicePath.find('/', slash + 1))
        dev_mkdir(devicePath.substr(0, slash).c_str(), 0755);
    int fd = dev_open(devicePath.c_str(), O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC, 0644);
    if (fd < 0) return;
    const size_t n = strlen(text);
    if (write(fd, text, n) != static_cast<ssize_t>(n))
        __android_log_print(ANDROID_LOG_WARN, kTag, "cannot write %s", devicePath.c_str());
    close(fd);
}

// The RTC alarm: its file holds the armed epoch time, or nothing.
std::mutex g_alarmLock;  // every read and write of the alarm file

long long alarm_locked(const std::string &host) {
    FILE *f = fopen(host.c_str(), "r");
    if (f == nullptr) return 0;
    long long at = 0;
    if (fscanf(f, "%lld", &at) != 1) at = 0;
    fclose(f);
    return at > 0 ? at : 0;
}

int set_alarm_locked(const std::string &host, long long at) {
    FILE *f = fopen(host.c_str(), "w");
    if (f == nullptr) return -1;
    if (at > 0) fprintf(f, "%lld\n", at);
    return fclose(f) == 0 ? 0 : -1;
}

long long read_alarm(const std::string &host) {
    std::lock_guard<std::mutex> lock(g_alarmLock);
    return alarm_locked(host);
}

// The suspend: a sleeping writer of the state file wakes when the alarm time comes, when the
// alarm changes (it sleeps on towards the new one), or on a key press.
std::mutex g_sleepLock;
std::condition_variable g_sleepCv;
unsigned long g_keyWakes = 0;      // under g_sleepLock
unsigned long g_alarmChanges = 0;  // under g_sleepLock
int g_sleepers = 0;                // under g_sleepLock

void alarm_changed() {
    std::lock_guard<std::mutex> lock(g_sleepLock);
    g_alarmChanges++;
    g_sleepCv.notify_all();
}

void suspend(const std::string &alarmHost) {
    std::unique_lock<std::mutex> lk(g_sleepLock);
    const unsigned long keys = g_keyWakes;
    g_sleepers++;
    unsigned long seen = g_alarmChanges - 1;  // the alarm is read first
    long long at = 0;
    bool logged = false, byAlarm = false;
    for (;;) {
        if (seen != g_alarmChanges) {
            seen = g_alarmChanges;
            lk.unlock();
            at = read_alarm(alarmHost);
            if (!logged) {
                if (at > 0)
                    __android_log_print(ANDROID_LOG_INFO, kTag, "suspend: sleeping until %lld", at);
                else
                    __android_log_print(ANDROID_LOG_INFO, kTag,
                                        "suspend: sleeping until a key press");
                logged = true;
            }
            lk.lock();
            continue;
        }
        if (g_keyWakes != keys) break;
        if (at > 0 && Clock::now() >= Clock::from_time_t(static_cast<time_t>(at))) {
            byAlarm = true;
            break;
        }
        auto woken = [&] { return g_keyWakes != keys || g_alarmChanges != seen; };
        if (at > 0)
            g_sleepCv.wait_until(lk, Clock::from_time_t(static_cast<time_t>(at)), woken);
        else
            g_sleepCv.wait(lk, woken);
    }
    g_sleepers--;
    lk.unlock();
    if (byAlarm) {
        // As after it fires: the alarm reads empty (unless it was armed anew meanwhile).
        std::lock_guard<std::mutex> lock(g_alarmLock);
        if (alarm_locked(alarmHost) == at) set_alarm_locked(alarmHost, 0);
    }
    __android_log_print(ANDROID_LOG_INFO, kTag, "resume: woken by %s", byAlarm ? "alarm" : "key");
}

// One write into a kernel file, without its line end.
std::string written(const char *buf, size_t size) {
    std::string text(buf, size);
    while (!text.empty() && isspace(static_cast<unsigned char>(text.back())))
        text.pop_back();
    return text;
}

ssize_t store_alarm(const std::string &host, const char *buf, size_t size) {
    const std::string text = written(buf, size);
    const bool relative = !text.empty() && text[0] == '+';
    const char *digits = text.c_str() + (relative ? 1 : 0);
    char *end = nullptr;
    errno = 0;
    const long long value = strtoll(digits, &end, 10);
    if (!isdigit(static_cast<unsigned char>(*digits)) || *end != '\0' || errno != 0 ||
        value > kEpochMax) {
        errno = EINVAL;
        return -1;
    }
    const long long now = epoch_now();
    const long long at = relative ? now + value : value;
    {
        std::lock_guard<std::mutex> lock(g_alarmLock);
        // A past time (0 among them) clears the alarm; a new one waits until it is cleared.
        if (at > now && alarm_locked(host) > now) {
            errno = EBUSY;
            return -1;
        }
        if (set_alarm_locked(host, at > now ? at : 0) != 0) return -1;
    }
    alarm_changed();
    return static_cast<ssize_t>(size);
}

ssize_t store_state(const char *buf, size_t size) {
    if (written(buf, size) != "mem") {
        errno = EINVAL;
        return -1;
    }
    char host[4096];
    if (dev_path(kAlarmFile, host, sizeof(host)) != 0) {
        errno = ENAMETOOLONG;
        return -1;
    }
    suspend(host);
    return static_cast<ssize_t>(size);
}

enum class Kind { Alarm, State };

struct KernelStream {
    Kind kind;
    std::string host;
    off_t readPos;
};

ssize_t kernel_write(void *cookie, const char *buf, size_t size) {
    auto *s = static_cast<KernelStream *>(cookie);
    return s->kind == Kind::Alarm ? store_alarm(s->host, buf, size) : store_state(buf, size);
}

ssize_t kernel_read(void *cookie, char *buf, size_t size) {
    auto *s = static_cast<KernelStream *>(cookie);
    int fd = open(s->host.c_str(), O_RDONLY | O_CLOEXEC);
    if (fd < 0) return -1;
    ssize_t n = pread(fd, buf, size, s->readPos);
    close(fd);
    if (n > 0) s->readPos += n;
    return n;
}

int kernel_close(void *cookie) {
    delete static_cast<KernelStream *>(cookie);
    return 0;
}

}  // namespace

struct BootText {
    const char *path;
    const char *text;
};
const BootText kDisplayAtBoot[] = {
    {"/sys/class/graphics/fb0/blank", "0"},
    {"/sys/class/leds/lcd-backlight/brightness", "255"},
};

const char *panel_description(const char *type) {
    if (type != nullptr && strcasecmp(type, "Truly") == 0)
        return "panel=qcom,mdss_dsi_dvkTruly_hx83112a_1080p_video\n";
    return "panel=qcom,mdss_dsi_dvkJDI_nt36672a_1080p_video\n";
}

void write_boot_kernel_files() {
    ensure_file(kAlarmFile, "");
    ensure_file(kStateFile, kStates);
    // The panel comes up lit whatever it was when the handset went down asleep.
    for (const auto &f : kDisplayAtBoot) {
        FILE *d = dev_fopen(f.path, "w");
        if (d == nullptr) continue;
        fputs(f.text, d);
        fclose(d);
    }
    char type[64];
    ftx_device_ini_get("panel", "type", type, sizeof(type), "JDI");
    FILE *f = dev_fopen("/proc/msm_lcd", "w");
    if (f == nullptr) {
        __android_log_print(ANDROID_LOG_WARN, "PLATFORM", "cannot write /proc/msm_lcd");
        return;
    }
    fputs(panel_description(type), f);
    fclose(f);
}

bool open_kernel_file(const char *devicePath, const char *hostPath, const char *mode, FILE **out) {
    if (devicePath == nullptr || mode == nullptr || strpbrk(mode, "wa+") == nullptr) return false;
    const std::string device = normalise_device_path(devicePath);
    Kind kind;
    if (device == kAlarmFile)
        kind = Kind::Alarm;
    else if (device == kStateFile)
        kind = Kind::State;
    else
        return false;
    *out = nullptr;
    if (access(hostPath, F_OK) != 0) return true;  // errno tells why
    auto *s = new KernelStream{kind, hostPath, 0};
    const cookie_io_functions_t io = {kernel_read, kernel_write, nullptr, kernel_close};
    // A sysfs file is never truncated nor appended to: every write is handed to the driver.
    *out = fopencookie(s, strchr(mode, '+') != nullptr ? "r+" : "w", io);
    if (*out == nullptr) delete s;
    return true;
}

bool resume_by_key() {
    std::lock_guard<std::mutex> lock(g_sleepLock);
    if (g_sleepers == 0) return false;
    g_keyWakes++;
    g_sleepCv.notify_all();
    return true;
}

}  // namespace ftxhost

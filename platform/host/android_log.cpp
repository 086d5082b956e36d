// The Android log on the host: logcat's threadtime lines in $FTX_ROOT/log/logcat.txt, a
// bounded ring like the handset's log buffer saved with logcat -r/-n: when the file would
// pass FTX_LOG_ROTATE_KB (default 4096) it becomes logcat.txt.1, the older ones move up, and
// logcat.txt.N (N = FTX_LOG_ROTATE_COUNT, default 4) is the oldest kept.
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <sys/file.h>
#include <sys/stat.h>
#include <sys/syscall.h>
#include <sys/time.h>
#include <time.h>
#include <unistd.h>

#include <atomic>
#include <mutex>
#include <string>

#include <android/log.h>

#include "devfs.h"
#include "ftx_host.h"
#include "host_internal.h"

namespace {

const long kDefaultRotateKb = 4096;
const int kDefaultRotateCount = 4;
const int kMaxRotateCount = 99;

std::mutex g_logLock;
FILE *g_logFile = nullptr;
std::string g_logPath;  // of the open file
long g_logSize = 0;     // of the open file, as of our last write
long g_rotateBytes = -1;
int g_rotateCount = -1;
std::atomic<int> g_floor{-1};  // lowest priority kept; -1 until read from FTX_LOG_LEVEL
int g_toStderr = -1;
ftx_log_capture_fn g_capture = nullptr;
void *g_captureCtx = nullptr;

int parse_level(const char *s) {
    if (s == nullptr || *s == '\0') return ANDROID_LOG_VERBOSE;
    if (s[0] >= '0' && s[0] <= '9') return atoi(s);
    const char *letters = "??VDIWEFS";
    const char *hit = strchr(letters + 2, toupper(static_cast<unsigned char>(s[0])));
    return hit != nullptr ? static_cast<int>(hit - letters) : ANDROID_LOG_VERBOSE;
}

char prio_letter(int prio) {
    static const char letters[] = "??VDIWEFS";
    return (prio >= 2 && prio <= 8) ? letters[prio] : 'V';
}

int log_floor() {
    int floor = g_floor.load(std::memory_order_relaxed);
    if (floor < 0) {
        floor = parse_level(getenv("FTX_LOG_LEVEL"));
        g_floor.store(floor, std::memory_order_relaxed);
    }
    return floor;
}

// A whole decimal number within [min, max] from the environment, else def.
long env_number(const char *name, long def, long min, long max) {
    const char *e = getenv(name);
    if (e == nullptr || *e == '\0') return def;
    char *end = nullptr;
    long v = strtol(e, &end, 10);
    return (*end == '\0' && v >= min && v <= max) ? v : def;
}

// Caller holds g_logLock for all of the helpers below.
void read_ring_settings() {
    if (g_rotateBytes >= 0) return;
    g_rotateBytes = env_number("FTX_LOG_ROTATE_KB", kDefaultRotateKb, 1, 1L << 30) * 1024;
    g_rotateCount = static_cast<int>(
        env_number("FTX_LOG_ROTATE_COUNT", kDefaultRotateCount, 0, kMaxRotateCount));
}

void close_log() {
    if (g_logFile != nullptr) fclose(g_logFile);
    g_logFile = nullptr;
}

FILE *log_file() {
    if (g_logFile == nullptr) {
        char dir[4096];
        if (dev_path("/log", dir, sizeof(dir)) != 0) return nullptr;
        mkdir(dev_root(), 0755);
        mkdir(dir, 0755);
        g_logPath = std::string(dir) + "/logcat.txt";
        g_logFile = fopen(g_logPath.c_str(), "ae");  // not inherited by shell lines
        struct stat st;
        g_logSize = (g_logFile != nullptr && fstat(fileno(g_logFile), &st) == 0)
                        ? static_cast<long>(st.st_size)
                        : 0;
    }
    return g_logFile;
}

bool still_current(FILE *f) {
    struct stat mine, named;
    return fstat(fileno(f), &mine) == 0 && stat(g_logPath.c_str(), &named) == 0 &&
           mine.st_ino == named.st_ino && mine.st_dev == named.st_dev;
}

// Moves logcat.txt to logcat.txt.1 (and each older file one up, the oldest dropped) and
// starts an empty one. Another process writing the same log may have rotated already: the
// file lock makes one of them do it, the other only reopens.
void rotate() {
    FILE *f = g_logFile;
    flock(fileno(f), LOCK_EX);
    if (still_current(f)) {
        const std::string &base = g_logPath;
        if (g_rotateCount == 0) {
            unlink(base.c_str());
        } else {
            unlink((base + "." + std::to_string(g_rotateCount)).c_str());
            for (int i = g_rotateCount - 1; i >= 1; i--) {
                rename((base + "." + std::to_string(i)).c_str(),
                       (base + "." + std::to_string(i + 1)).c_str());
            }
            rename(base.c_str(), (base + ".1").c_str());
        }
    }
    flock(fileno(f), LOCK_UN);
    close_log();
}

// The file to append n more bytes to, rotated first when they would pass the limit.
FILE *log_file_for(size_t n) {
    read_ring_settings();
    FILE *f = log_file();
    if (f != nullptr && g_logSize > 0 && g_logSize + static_cast<long>(n) > g_rotateBytes) {
        rotate();
        f = log_file();
    }
    return f;
}

}  // namespace

namespace ftxhost {

std::string timestamp() {
    struct timeval tv;
    gettimeofday(&tv, nullptr);
    struct tm tm;
    localtime_r(&tv.tv_sec, &tm);
    char buf[32];
    snprintf(buf, sizeof(buf), "%02d-%02d %02d:%02d:%02d.%03d", tm.tm_mon + 1, tm.tm_mday,
             tm.tm_hour, tm.tm_min, tm.tm_sec, static_cast<int>(tv.tv_usec / 1000));
    return buf;
}

void log_reset() {
    std::lock_guard<std::mutex> lock(g_logLock);
    close_log();
    g_rotateBytes = -1;
    g_rotateCount = -1;
    g_floor = -1;
    g_toStderr = -1;
}

}  // namespace ftxhost

extern "C" int __android_log_is_loggable(int prio, const char *tag, int default_prio) {
    (void)tag;
    int floor = log_floor();
    return prio >= (floor > default_prio ? floor : default_prio) ? 1 : 0;
}

extern "C" void ftx_log_set_capture(ftx_log_capture_fn fn, void *ctx) {
    std::lock_guard<std::mutex> lock(g_logLock);
    g_capture = fn;
    g_captureCtx = ctx;
}

extern "C" int __android_log_write(int prio, const char *tag, const char *text) {
    if (tag == nullptr) tag = "";
    if (text == nullptr) text = "";
    std::lock_guard<std::mutex> lock(g_logLock);
    int floor = log_floor();
    if (g_toStderr < 0) {
        const char *e = getenv("FTX_LOG_STDERR");
        g_toStderr = (e != nullptr && strcmp(e, "1") == 0) ? 1 : 0;
    }
    std::string msg(text);
    if (!msg.empty() && msg.back() == '\n') msg.pop_back();
    // The capture sees every entry whatever the floor; it must not log itself.
    if (g_capture != nullptr) g_capture(prio, tag, msg.c_str(), g_captureCtx);
    if (prio < floor) return 0;
    char prefix[96];
    snprintf(prefix, sizeof(prefix), "%s %5d %5d %c ", ftxhost::timestamp().c_str(),
             static_cast<int>(getpid()), static_cast<int>(syscall(SYS_gettid)), prio_letter(prio));
    // Embedded newlines continue the entry on lines with the same prefix.
    std::string out;
    size_t start = 0;
    do {
        size_t nl = msg.find('\n', start);
        std::string line =
            msg.substr(start, nl == std::string::npos ? std::string::npos : nl - start);
        out += prefix;
        out += tag;
        out += ": ";
        out += line;
        out += '\n';
        start = (nl == std::string::npos) ? msg.size() + 1 : nl + 1;
    } while (start <= msg.size());

    FILE *f = log_file_for(out.size());
    if (f != nullptr) {
        fwrite(out.data(), 1, out.size(), f);
        fflush(f);
        // Appends land at the end whoever else writes the file, so the offset is its size.
        long end = ftell(f);
        g_logSize = end >= 0 ? end : g_logSize + static_cast<long>(out.size());
    }
    if (g_toStderr == 1) fwrite(out.data(), 1, out.size(), stderr);
    return static_cast<int>(out.size());
}

extern "C" int __android_log_vprint(int prio, const char *tag, const char *fmt, va_list ap) {
    char buf[4096];
    if (fmt == nullptr) return __android_log_write(prio, tag, "");
    vsnprintf(buf, sizeof(buf), fmt, ap);
    return __android_log_write(prio, tag, buf);
}

extern "C" int __android_log_print(int prio, const char *tag, const char *fmt, ...) {
    va_list ap;
    va_start(ap, fmt);
    int rc = __android_log_vprint(prio, tag, fmt, ap);
    va_end(ap);
    return rc;
}

// The Android log on the host: logcat's threadtime lines in $FTX_ROOT/log/logcat.txt.
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
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

std::mutex g_logLock;
FILE *g_logFile = nullptr;
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

// Caller holds g_logLock.
FILE *log_file() {
    if (g_logFile == nullptr) {
        char dir[4096];
        if (dev_path("/log", dir, sizeof(dir)) != 0) return nullptr;
        mkdir(dev_root(), 0755);
        mkdir(dir, 0755);
        std::string file = std::string(dir) + "/logcat.txt";
        g_logFile = fopen(file.c_str(), "a");
    }
    return g_logFile;
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
    if (g_logFile != nullptr) fclose(g_logFile);
    g_logFile = nullptr;
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

    FILE *f = log_file();
    if (f != nullptr) {
        fwrite(out.data(), 1, out.size(), f);
        fflush(f);
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

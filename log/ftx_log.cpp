// Plain-text event logs under the log directory.
#include "ftx_log.h"

#include <errno.h>
#include <stdarg.h>
#include <stdlib.h>
#include <string.h>
#include <unistd.h>

#include <atomic>
#include <mutex>

#include <android/log.h>

#include "devfs.h"
#include "tp_os.h"

#define LOG_TAG "FTXLOG"
#define LOG_DEBUG(...) __android_log_print(ANDROID_LOG_DEBUG, LOG_TAG, __VA_ARGS__)
#define LOG_ERROR(...) __android_log_print(ANDROID_LOG_ERROR, LOG_TAG, __VA_ARGS__)

FILE *s_logFp;

namespace {

// Serialises every open, write and close of every log stream, and mkdir_main's splitter.
std::mutex s_logMutex;
std::atomic<ftx_log_clock_fn> s_clock{nullptr};

#define LOG_MSG_SIZE 1024
#define LOG_PATH_SIZE 256
#define LOG_PREFIX_SIZE 4096
#define LOG_NAME_MAX 100

time_t now() {
    ftx_log_clock_fn fn = s_clock.load();
    return fn != nullptr ? fn() : time(nullptr);
}

// The open's common failure end: the caller learns there is no log.
int open_failed(FILE **stream_out) {
    LOG_DEBUG("%s:L%d::s_logFp=%p, end", "init_ftx_log", 208, (void *)nullptr);
    *stream_out = nullptr;
    return -1;
}

// Formats and appends one entry (time-stamped or plain), flushed and synced to storage.
int write_entry(FILE *stream, const char *who, int line, const char *label, bool stamped,
                const char *format, va_list ap) {
    std::lock_guard<std::mutex> lock(s_logMutex);
    if (stream == nullptr) {
        LOG_DEBUG("%s:s_logFp is NULL.", who);
        return -1;
    }
    char msg[LOG_MSG_SIZE] = {0};
    vsnprintf(msg, sizeof(msg), format, ap);
    LOG_DEBUG("%s:buf=%s.", who, msg);
    size_t size = strlen(label) + 1156;
    char *entry = (char *)calloc(1, size);
    if (entry == nullptr) {
        LOG_ERROR("%s:calloc failed", who);
        return -1;
    }
    if (stamped) {
        time_t t = now();
        struct tm tmv;
        localtime_r(&t, &tmv);
        char stamp[32] = {0};
        strftime(stamp, sizeof(stamp), "%m/%d-%H:%M:%S ", &tmv);
        snprintf(entry, size, "%s[%s] %s", stamp, label, msg);
    } else {
        snprintf(entry, size, "[%s]\n%s", label, msg);
    }
    LOG_DEBUG("%s,L%d::%s", who, line, entry);
    fprintf(stream, "%s\n", entry);
    fflush(stream);
    fsync(fileno(stream));
    free(entry);
    return 0;
}

}  // namespace

void ftx_log_set_clock(ftx_log_clock_fn fn) {
    s_clock = fn;
}

int mkdir_main(const char *path) {
    if (path == nullptr) return 1;
    char copy[LOG_PATH_SIZE] = {0};
    tp_os_strlcpy(copy, path, sizeof(copy));
    char prefix[LOG_PREFIX_SIZE] = {0};
    if (copy[0] == '/') prefix[0] = '/';
    char *save = nullptr;
    for (char *part = strtok_r(copy, "/", &save); part != nullptr;
         part = strtok_r(nullptr, "/", &save)) {
        size_t used = strlen(prefix);
        if (used + strlen(part) + 1 >= sizeof(prefix)) {
            fprintf(stderr, "Invalid path specified: too long\n");
            LOG_ERROR("%s,L%d::Invalid path specified: too long", __func__, 106);
            return 1;
        }
        snprintf(prefix + used, sizeof(prefix) - used, "%s/", part);
        struct stat st;
        if (dev_stat(prefix, &st) == 0) continue;
        int rc = dev_mkdir(prefix, 0777);
        if (rc != 0) {
            fprintf(stderr, "mkdir failed for %s, %s\n", prefix, strerror(errno));
            LOG_ERROR("%s,L%d::mkdir failed for %s, %s", __func__, 115, prefix, strerror(errno));
            return rc;
        }
    }
    return 0;
}

int init_ftx_log(FILE **stream_out, const char *directory, const char *file_name) {
    if (stream_out == nullptr) return -1;
    if (directory == nullptr || file_name == nullptr) return open_failed(stream_out);
    LOG_DEBUG("%s: begin,logfilename=%s.", __func__, file_name);
    std::unique_lock<std::mutex> lock(s_logMutex);
    if (dev_access(directory, F_OK) != 0) {
        LOG_DEBUG("%s:%s not exist.", __func__, directory);
        if (mkdir_main(directory) != 0) {
            LOG_ERROR("%s: make dirctory fail errno = %d, strerrno = %s", __func__, errno,
                      strerror(errno));
            lock.unlock();
            return open_failed(stream_out);
        }
    } else {
        LOG_ERROR("%s: directory %s is exist", __func__, directory);
    }
    char path[LOG_PATH_SIZE] = {0};
    size_t len = tp_os_strlcpy(path, directory, sizeof(path));
    if (len == 0 || path[len - 1] != '/') {
        LOG_DEBUG("%s:L%d:path laster byte must /.", __func__, 187);
        if (len < sizeof(path) - 1) path[len++] = '/';
    }
    LOG_DEBUG("%s:L%d:path laster byte is /.", __func__, 191);
    char name[LOG_NAME_MAX + 1] = {0};
    tp_os_strlcpy(name, file_name, sizeof(name));
    tp_os_strlcpy(path + len, name, sizeof(path) - len);
    LOG_DEBUG("%s:open %s.", __func__, path);
    FILE *fp = dev_fopen(path, "a+");
    if (fp == nullptr) {
        LOG_ERROR("%s:L%d,open file %s failed,errno(%d):errstr(%s)", __func__, 197, path, errno,
                  strerror(errno));
        lock.unlock();
        return open_failed(stream_out);
    }
    LOG_DEBUG("%s:L%d,open file %s oK,errno(%d):errstr(%s)", __func__, 201, path, errno,
              strerror(errno));
    lock.unlock();
    LOG_DEBUG("%s:L%d::s_logFp=%p, end", __func__, 208, (void *)fp);
    *stream_out = fp;
    return 0;
}

int ftx_initlog(const char *directory) {
    if (init_ftx_log(&s_logFp, directory, "ftx.log") != 0) {
        LOG_ERROR("%s:L%d:init_ftx_log(ftx.log) fail.", __func__, 357);
        return -1;
    }
    return 0;
}

int writeftxlog(FILE *stream, const char *label, const char *format, ...) {
    va_list ap;
    va_start(ap, format);
    int rc = write_entry(stream, __func__, 266, label != nullptr ? label : "", true, format, ap);
    va_end(ap);
    return rc;
}

int writeftxlog_NoTime(FILE *stream, const char *label, const char *format, ...) {
    va_list ap;
    va_start(ap, format);
    int rc = write_entry(stream, __func__, 328, label != nullptr ? label : "", false, format, ap);
    va_end(ap);
    return rc;
}

int uninit_ftxlog(FILE *stream) {
    std::lock_guard<std::mutex> lock(s_logMutex);
    if (stream != nullptr) fclose(stream);
    return 0;
}

int Conver_time2ASC(long seconds, long nanoseconds, char *out, size_t out_size) {
    char text[LOG_PATH_SIZE] = {0};
    time_t t = (time_t)seconds;
    struct tm tmv;
    if (gmtime_r(&t, &tmv) != nullptr) asctime_r(&tmv, text);
    if (out != nullptr) memcpy(out, text, out_size < sizeof(text) ? out_size : sizeof(text));
    __android_log_print(ANDROID_LOG_DEBUG, "ALARM", "time L%d -> %ld.%09ld\n", 60, seconds,
                        nanoseconds);
    return 0;
}

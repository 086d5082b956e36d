// The platform OS layer on POSIX threads.
#include <pthread.h>
#include <stdarg.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <time.h>
#include <unistd.h>

#include <chrono>
#include <condition_variable>
#include <mutex>
#include <string>

#include "kernel_files.h"
#include "root_check.h"
#include "tp_os.h"

namespace {

struct Sema {
    std::mutex lock;
    std::condition_variable cv;
    int count = 0;
    bool used = false;
    std::string name;
};

// Never destroyed: detached threads may still wait on or post a semaphore while the
// process runs its exit handlers.
Sema *semas() {
    static Sema *const table = new Sema[TP_OS_SEMA_MAX];
    return table;
}
std::mutex g_semaTableLock;  // guards used/name

struct ThreadStart {
    tp_os_thread_func func;
    void *arg;
    char name[16];
};

void *thread_trampoline(void *p) {
    ThreadStart start = *static_cast<ThreadStart *>(p);
    delete static_cast<ThreadStart *>(p);
    pthread_setname_np(pthread_self(), start.name);
    return start.func(start.arg);
}

double read_time_scale() {
    const char *e = getenv("FTX_TIME_SCALE");
    if (e == nullptr || *e == '\0') return 1.0;
    double v = atof(e);
    return v > 0 ? v : 1.0;
}

}  // namespace

extern "C" int tp_os_thread_init(int argc, char **argv) {
    (void)argc;
    (void)argv;
    ftxhost::require_writable_root();
    ftxhost::write_boot_kernel_files();
    // Semaphore 0 always exists: the main thread parks on it.
    tp_os_sema_create(0, 0);
    return 0;
}

extern "C" tp_os_thread_t tp_os_thread_create(const char *name, int priority, size_t stack_size,
                                              tp_os_thread_func func, void *arg) {
    (void)priority;  // advisory on the host: every thread runs at normal priority
    if (func == nullptr) return 0;
    pthread_attr_t attr;
    pthread_attr_init(&attr);
    pthread_attr_setdetachstate(&attr, PTHREAD_CREATE_DETACHED);
    if (stack_size > 0) {
        // Handset stack sizes are tuned for its libraries; the host's text rendering
        // (FreeType, iconv) needs more, so small requests are raised.
        if (stack_size < 512 * 1024) stack_size = 512 * 1024;
        pthread_attr_setstacksize(&attr, stack_size);
    }
    auto *start = new ThreadStart{func, arg, {0}};
    snprintf(start->name, sizeof(start->name), "%s", name != nullptr ? name : "tp_os");
    pthread_t t;
    int rc = pthread_create(&t, &attr, thread_trampoline, start);
    pthread_attr_destroy(&attr);
    if (rc != 0) {
        delete start;
        return 0;
    }
    return static_cast<tp_os_thread_t>(t);
}

extern "C" int tp_os_sema_create(int id, int initial) {
    if (id < 0 || id >= TP_OS_SEMA_MAX) return -1;
    std::lock_guard<std::mutex> table(g_semaTableLock);
    Sema &s = semas()[id];
    std::lock_guard<std::mutex> lock(s.lock);
    s.used = true;
    s.count = initial;
    return 0;
}

extern "C" int tp_os_sema_get(int id, int timeout_ms) {
    if (id < 0 || id >= TP_OS_SEMA_MAX) return -1;
    Sema &s = semas()[id];
    std::unique_lock<std::mutex> lock(s.lock);
    if (timeout_ms < 0) {
        s.cv.wait(lock, [&] { return s.count > 0; });
    } else {
        auto wait = std::chrono::microseconds(
            static_cast<long long>(timeout_ms * 1000.0 * tp_os_time_scale()));
        if (!s.cv.wait_for(lock, wait, [&] { return s.count > 0; })) return -1;
    }
    s.count--;
    return 0;
}

extern "C" int tp_os_sema_put(int id) {
    if (id < 0 || id >= TP_OS_SEMA_MAX) return -1;
    Sema &s = semas()[id];
    {
        std::lock_guard<std::mutex> lock(s.lock);
        s.count++;
    }
    s.cv.notify_one();
    return 0;
}

extern "C" int tp_os_sema_named(const char *name, int initial) {
    if (name == nullptr) return -1;
    std::lock_guard<std::mutex> table(g_semaTableLock);
    int freeSlot = -1;
    // Numbers from the top down, so named ones rarely meet numbered ones.
    for (int i = TP_OS_SEMA_MAX - 1; i > 0; i--) {
        if (semas()[i].used && semas()[i].name == name) return i;
        if (!semas()[i].used && freeSlot < 0) freeSlot = i;
    }
    if (freeSlot < 0) return -1;
    Sema &s = semas()[freeSlot];
    std::lock_guard<std::mutex> lock(s.lock);
    s.used = true;
    s.name = name;
    s.count = initial;
    return freeSlot;
}

extern "C" void tp_os_print(const char *fmt, ...) {
    va_list ap;
    va_start(ap, fmt);
    vfprintf(stdout, fmt, ap);
    va_end(ap);
    fflush(stdout);
}

extern "C" double tp_os_time_scale(void) {
    static const double scale = read_time_scale();
    return scale;
}

extern "C" void tp_os_usleep(unsigned long us) {
    double scaled = static_cast<double>(us) * tp_os_time_scale();
    struct timespec ts;
    ts.tv_sec = static_cast<time_t>(scaled / 1e6);
    ts.tv_nsec = static_cast<long>((scaled - static_cast<double>(ts.tv_sec) * 1e6) * 1000.0);
    while (nanosleep(&ts, &ts) != 0) {
    }
}

extern "C" void *tp_os_mem_alloc(size_t size) {
    return malloc(size);
}
extern "C" void *tp_os_mem_calloc(size_t count, size_t size) {
    return calloc(count, size);
}
extern "C" void tp_os_mem_free(void *p) {
    free(p);
}

extern "C" size_t tp_os_strlcpy(char *dst, const char *src, size_t size) {
    if (dst == nullptr || size == 0) return 0;
    if (src == nullptr) src = "";
    size_t n = strnlen(src, size - 1);
    memcpy(dst, src, n);
    dst[n] = '\0';
    return n;
}

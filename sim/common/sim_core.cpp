#include "sim_core.h"

#include <errno.h>
#include <stdarg.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>

#include <chrono>
#include <condition_variable>
#include <deque>
#include <map>
#include <mutex>
#include <thread>

#include "tp_os.h"

namespace ftxsim {
namespace {

struct CallRecord {
    std::string args;
    unsigned long count = 0;
};

struct Library {
    const Word *words;
    size_t count;
    void (*state)(Reply &);
};

std::mutex g_lock;
std::map<std::string, CallRecord> g_calls;
std::map<std::string, int> g_forced;
std::vector<Library> g_libraries;
std::map<std::string, long> g_values;

int status_word(Reply &r) {
    std::vector<Library> libs;
    std::map<std::string, CallRecord> calls;
    {
        std::lock_guard<std::mutex> lock(g_lock);
        libs = g_libraries;
        calls = g_calls;
    }
    for (const Library &l : libs) {
        if (l.state != nullptr) l.state(r);
    }
    r.add("calls:\n");
    for (const auto &[op, rec] : calls) {
        r.add("  %s(%s) x%lu\n", op.c_str(), rec.args.c_str(), rec.count);
    }
    return 0;
}

int help_word(Reply &r) {
    std::vector<Library> libs;
    {
        std::lock_guard<std::mutex> lock(g_lock);
        libs = g_libraries;
    }
    r.add("status\nhelp\n");
    for (const Library &l : libs) {
        for (size_t i = 0; i < l.count; ++i)
            r.add("%s %s\n", l.words[i].word, l.words[i].usage);
    }
    return 0;
}

}  // namespace

int call(const char *op, int def, const char *fmt, ...) {
    char args[512] = "";
    if (fmt != nullptr) {
        va_list ap;
        va_start(ap, fmt);
        vsnprintf(args, sizeof(args), fmt, ap);
        va_end(ap);
    }
    std::lock_guard<std::mutex> lock(g_lock);
    CallRecord &rec = g_calls[op];
    rec.args = args;
    ++rec.count;
    auto it = g_forced.find(op);
    return it != g_forced.end() ? it->second : def;
}

void force_answer(const char *op, bool forced, int value) {
    std::lock_guard<std::mutex> lock(g_lock);
    if (forced) {
        g_forced[op] = value;
    } else {
        g_forced.erase(op);
    }
}

bool forced_answer(const char *op, int *value) {
    std::lock_guard<std::mutex> lock(g_lock);
    auto it = g_forced.find(op);
    if (it == g_forced.end()) return false;
    if (value != nullptr) *value = it->second;
    return true;
}

void put_value(const char *key, long value) {
    std::lock_guard<std::mutex> lock(g_lock);
    g_values[key] = value;
}

long get_value(const char *key, long def) {
    std::lock_guard<std::mutex> lock(g_lock);
    auto it = g_values.find(key);
    return it != g_values.end() ? it->second : def;
}

void Reply::vadd(const char *fmt, va_list ap) {
    if (buf_ == nullptr || size_ == 0 || len_ + 1 >= size_) return;
    int n = vsnprintf(buf_ + len_, size_ - len_, fmt, ap);
    if (n > 0) len_ = (len_ + n < size_) ? len_ + n : size_ - 1;
}

void Reply::add(const char *fmt, ...) {
    va_list ap;
    va_start(ap, fmt);
    vadd(fmt, ap);
    va_end(ap);
}

int Reply::done(const char *fmt, ...) {
    va_list ap;
    va_start(ap, fmt);
    vadd(fmt, ap);
    va_end(ap);
    return 0;
}

void add_words(const Word *words, size_t count, void (*state)(Reply &)) {
    std::lock_guard<std::mutex> lock(g_lock);
    for (const Library &l : g_libraries) {
        if (l.words == words) return;
    }
    g_libraries.push_back({words, count, state});
}

int control(const char *line, char *reply, size_t size) {
    Reply r(reply, size);
    Args args = split(line);
    if (args.empty()) return -1;
    if (args[0] == "status") return status_word(r);
    if (args[0] == "help") return help_word(r);
    std::vector<Library> libs;
    {
        std::lock_guard<std::mutex> lock(g_lock);
        libs = g_libraries;
    }
    for (const Library &l : libs) {
        for (size_t i = 0; i < l.count; ++i) {
            if (args[0] != l.words[i].word) continue;
            int rc = l.words[i].fn(args, r);
            if (rc != 0 && r.length() == 0)
                r.add("usage: %s %s", l.words[i].word, l.words[i].usage);
            return rc != 0 ? 1 : 0;
        }
    }
    return -1;
}

Args split(const char *line) {
    Args out;
    if (line == nullptr) return out;
    const char *p = line;
    while (*p != '\0') {
        while (*p == ' ' || *p == '\t' || *p == '\r' || *p == '\n')
            ++p;
        if (*p == '\0') break;
        const char *s = p;
        while (*p != '\0' && *p != ' ' && *p != '\t' && *p != '\r' && *p != '\n')
            ++p;
        out.emplace_back(s, p - s);
    }
    return out;
}

bool to_int(const std::string &text, long *value) {
    if (text.empty()) return false;
    char *end = nullptr;
    errno = 0;
    long v = strtol(text.c_str(), &end, 0);
    if (errno != 0 || end == nullptr || *end != '\0') return false;
    *value = v;
    return true;
}

struct Worker::State {
    std::mutex lock;
    std::condition_variable cv;
    std::deque<std::pair<std::chrono::steady_clock::time_point, std::function<void()>>> jobs;
    bool started = false;
    std::string name;
};

Worker::Worker(const char *name) : state_(new State) {
    state_->name = name;
}

void Worker::post(std::function<void()> job, int delay_ms) {
    auto due = std::chrono::steady_clock::now() +
               std::chrono::microseconds(static_cast<long>(delay_ms * 1000.0 * tp_os_time_scale()));
    State *s = state_;
    std::lock_guard<std::mutex> lock(s->lock);
    // Jobs keep their posting order: a job is never due before the one posted ahead of it.
    if (!s->jobs.empty() && due < s->jobs.back().first) due = s->jobs.back().first;
    s->jobs.emplace_back(due, std::move(job));
    if (!s->started) {
        s->started = true;
        std::thread([s] {
            std::unique_lock<std::mutex> lk(s->lock);
            for (;;) {
                if (s->jobs.empty()) {
                    s->cv.wait(lk);
                    continue;
                }
                auto due = s->jobs.front().first;
                if (std::chrono::steady_clock::now() < due) {
                    s->cv.wait_until(lk, due);
                    continue;
                }
                std::function<void()> job = std::move(s->jobs.front().second);
                s->jobs.pop_front();
                lk.unlock();
                job();
                lk.lock();
            }
        }).detach();
    }
    s->cv.notify_one();
}

}  // namespace ftxsim

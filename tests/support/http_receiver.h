// A small HTTP/1.1 receiver for the tests: listens on 127.0.0.1 (a free port or a given
// one), takes one request per connection (request line, headers, a Content-Length body, no
// chunked one; "Expect: 100-continue" is answered), records it, answers the configured
// status with an empty body and closes. It can be stopped (its port then refuses
// connections) and started again on the same port, and a test waits for the n-th request
// on a condition, never on a sleep. One test thread drives it.
#pragma once

#include <arpa/inet.h>
#include <fcntl.h>
#include <netinet/in.h>
#include <poll.h>
#include <stdlib.h>
#include <string.h>
#include <strings.h>
#include <sys/socket.h>
#include <unistd.h>

#include <chrono>
#include <condition_variable>
#include <mutex>
#include <string>
#include <thread>
#include <vector>

#include "support/host_io.h"

class HttpReceiver {
  public:
    struct Request {
        std::string method;
        std::string path;
        std::string contentType;
        std::string body;
    };

    HttpReceiver() = default;
    HttpReceiver(const HttpReceiver &) = delete;
    HttpReceiver &operator=(const HttpReceiver &) = delete;
    ~HttpReceiver() {
        stop();
        release();
    }

    // Listens on port (0: a free one); false when it cannot.
    bool start(int port = 0) {
        stop();
        if (listen_ >= 0 && port != 0 && port != port_) release();
        if (listen_ < 0 && !bind_port(port)) return false;
        set_reuse(1);
        if (listen(listen_, 16) != 0 || pipe2(wake_, O_CLOEXEC) != 0) {
            release();
            return false;
        }
        thread_ = std::thread([this] { serve(); });
        return true;
    }
    // Listens again on the port of the last start.
    bool restart() { return start(port_); }
    // Stops listening and ends the thread. The port stays bound to this receiver without a
    // listener, so connections to it are refused and nothing else takes it before restart().
    void stop() {
        if (!thread_.joinable()) return;
        char c = 0;
        (void)!write(wake_[1], &c, 1);
        thread_.join();
        close(wake_[0]);
        close(wake_[1]);
        set_reuse(0);  // no other socket may bind the port meanwhile
        sockaddr unspec{};
        unspec.sa_family = AF_UNSPEC;
        connect(listen_, &unspec, sizeof(unspec));  // Linux: a listener back to a bound socket
    }

    int port() const { return port_; }
    std::string endpoint() const { return "127.0.0.1:" + std::to_string(port_); }
    // The status every later request is answered with (200 at first).
    void set_status(int status) { set_statuses({status}); }
    // The statuses the next requests are answered with in turn; the last one then stays.
    void set_statuses(std::vector<int> statuses) {
        std::lock_guard<std::mutex> lock(mutex_);
        if (!statuses.empty()) statuses_ = std::move(statuses);
    }

    std::vector<Request> requests() const {
        std::lock_guard<std::mutex> lock(mutex_);
        return requests_;
    }
    size_t count() const {
        std::lock_guard<std::mutex> lock(mutex_);
        return requests_.size();
    }
    // True once n requests were received in all, false when timeout passed first.
    bool wait_for(size_t n, std::chrono::milliseconds timeout = std::chrono::seconds(10)) {
        std::unique_lock<std::mutex> lock(mutex_);
        return cv_.wait_for(lock, timeout, [&] { return requests_.size() >= n; });
    }

  private:
    static constexpr int kIdleMs = 5000;  // a client silent this long is dropped

    // Binds a socket to 127.0.0.1:port; for port 0 a free port, bound by its number so
    // that the kernel keeps it for this socket when it stops listening.
    bool bind_port(int port) {
        for (int attempt = 0; attempt < 8; attempt++) {
            sockaddr_in a{};
            a.sin_family = AF_INET;
            a.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
            a.sin_port = htons(static_cast<uint16_t>(port));
            if (port == 0 && !free_port(&a)) return false;
            listen_ = socket(AF_INET, SOCK_STREAM | SOCK_CLOEXEC, 0);
            if (listen_ < 0) return false;
            set_reuse(1);
            if (bind(listen_, reinterpret_cast<sockaddr *>(&a), sizeof(a)) == 0) {
                port_ = ntohs(a.sin_port);
                return true;
            }
            release();
            if (port != 0) return false;  // taken: only a free port is tried again
        }
        return false;
    }
    static bool free_port(sockaddr_in *a) {
        int probe = socket(AF_INET, SOCK_STREAM | SOCK_CLOEXEC, 0);
        socklen_t len = sizeof(*a);
        bool ok = probe >= 0 && bind(probe, reinterpret_cast<sockaddr *>(a), sizeof(*a)) == 0 &&
                  getsockname(probe, reinterpret_cast<sockaddr *>(a), &len) == 0;
        if (probe >= 0) close(probe);
        return ok;
    }
    void set_reuse(int on) { setsockopt(listen_, SOL_SOCKET, SO_REUSEADDR, &on, sizeof(on)); }
    void release() {
        if (listen_ >= 0) close(listen_);
        listen_ = -1;
    }

    void serve() {
        for (;;) {
            pollfd p[2] = {{listen_, POLLIN, 0}, {wake_[0], POLLIN, 0}};
            if (poll(p, 2, -1) < 0) continue;
            if (p[1].revents != 0) return;
            int c = accept4(listen_, nullptr, nullptr, SOCK_CLOEXEC);
            if (c < 0) continue;
            bool woken = handle(c);
            close(c);
            if (woken) return;
        }
    }

    // Reads until the pattern is in buf or n bytes are; false on close, time-out or stop.
    // woken is set when stop() asked to end.
    bool fill(int c, std::string *buf, const std::string &pattern, size_t n, bool *woken) {
        while (pattern.empty() ? buf->size() < n : buf->find(pattern) == std::string::npos) {
            pollfd p[2] = {{c, POLLIN, 0}, {wake_[0], POLLIN, 0}};
            if (poll(p, 2, kIdleMs) <= 0) return false;
            if (p[1].revents != 0) {
                *woken = true;
                return false;
            }
            char chunk[4096];
            ssize_t got = recv(c, chunk, sizeof(chunk), 0);
            if (got <= 0) return false;
            buf->append(chunk, static_cast<size_t>(got));
        }
        return true;
    }

    static std::string header(const std::string &head, const char *name) {
        size_t at = head.find("\r\n");
        const size_t len = strlen(name);
        while (at != std::string::npos && at + 2 < head.size()) {
            size_t line = at + 2;
            at = head.find("\r\n", line);
            if (head.size() - line > len && strncasecmp(head.c_str() + line, name, len) == 0 &&
                head[line + len] == ':') {
                size_t v = head.find_first_not_of(" \t", line + len + 1);
                if (v == std::string::npos || v > at) return "";
                return head.substr(v, at - v);
            }
        }
        return "";
    }

    // One request on connection c; true when stop() interrupted it.
    bool handle(int c) {
        bool woken = false;
        std::string buf;
        if (!fill(c, &buf, "\r\n\r\n", 0, &woken)) return woken;
        const size_t end = buf.find("\r\n\r\n");
        const std::string head = buf.substr(0, end + 2);
        Request r;
        const size_t sp1 = head.find(' ');
        const size_t sp2 = sp1 == std::string::npos ? sp1 : head.find(' ', sp1 + 1);
        if (sp2 == std::string::npos) return false;
        r.method = head.substr(0, sp1);
        r.path = head.substr(sp1 + 1, sp2 - sp1 - 1);
        r.contentType = header(head, "Content-Type");
        const size_t length = strtoul(header(head, "Content-Length").c_str(), nullptr, 10);
        if (strcasecmp(header(head, "Expect").c_str(), "100-continue") == 0 &&
            !send_all(c, "HTTP/1.1 100 Continue\r\n\r\n"))
            return false;
        buf.erase(0, end + 4);
        if (!fill(c, &buf, "", length, &woken)) return woken;
        r.body = buf.substr(0, length);
        int status;
        {
            std::lock_guard<std::mutex> lock(mutex_);
            status = statuses_.front();
            if (statuses_.size() > 1) statuses_.erase(statuses_.begin());
            requests_.push_back(std::move(r));
        }
        cv_.notify_all();
        send_all(c, "HTTP/1.1 " + std::to_string(status) + " " + reason(status) +
                        "\r\nContent-Length: 0\r\nConnection: close\r\n\r\n");
        return false;
    }

    static const char *reason(int status) {
        if (status >= 200 && status < 300) return "OK";
        if (status >= 500) return "Server Error";
        return "Refused";
    }

    int listen_ = -1;
    int wake_[2] = {-1, -1};
    int port_ = 0;
    std::thread thread_;
    mutable std::mutex mutex_;  // guards what follows
    std::condition_variable cv_;
    std::vector<int> statuses_{200};
    std::vector<Request> requests_;
};

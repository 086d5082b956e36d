// The PC command channel: TCP, one command per line, answered "<result> <n>\n" + n bytes +
// "\n". Commands run one at a time, in arrival order, on the thread in runSelectLoopMode.
// A client cannot take the channel down: the clients are capped, silent ones are closed,
// a client that does not take its replies is not read until it does, and when the process
// runs out of descriptors the listener rests instead of spinning on a socket it cannot
// accept from (limits in channel.h).
#include <arpa/inet.h>
#include <errno.h>
#include <fcntl.h>
#include <netinet/in.h>
#include <netinet/tcp.h>
#include <poll.h>
#include <stdarg.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <sys/socket.h>
#include <time.h>
#include <unistd.h>

#include <algorithm>
#include <atomic>
#include <memory>
#include <mutex>
#include <string>
#include <vector>

#include "android/log.h"
#include "channel.h"
#include "devfs.h"
#include "hw/libdvk_ncoredevice.h"
#include "line_framer.h"
#include "pc_port.h"
#include "sim_core.h"
#include "tp_os.h"

namespace ftxsim {
namespace {

const char kTag[] = "DVK_CHANNEL";
const size_t kRecvChunk = 16384;
// recv calls for one client per poll round, so that a client streaming commands cannot
// keep the others waiting.
const int kReadsPerTurn = 4;
// An emptied output buffer larger than this is given back rather than kept.
const size_t kKeepCapacity = 64u << 10;

// Milliseconds of the coarse monotonic clock: a few nanoseconds a read, against some 60 for
// the precise one, and a tick of a few milliseconds is plenty for idle times of seconds.
long long now_ms() {
    timespec ts;
    clock_gettime(CLOCK_MONOTONIC_COARSE, &ts);
    return static_cast<long long>(ts.tv_sec) * 1000 + ts.tv_nsec / 1000000;
}

struct Client {
    int fd = -1;
    LineFramer framer{FTX_AT_LINE_MAX};
    std::string held;  // received bytes not framed yet: their lines wait for room to answer
    size_t held_off = 0;
    std::string out;  // answers, sent from out_off on
    size_t out_off = 0;
    long long last = 0;    // when the last byte was received or sent (now_ms)
    bool eof = false;      // the client sent its last byte
    bool gone = false;     // the connection broke: close it
    bool waiting = false;  // over the output bound (logged once per stretch)

    size_t unsent() const { return out.size() - out_off; }
    bool has_held() const { return held_off < held.size(); }
};

std::mutex g_lock;  // guards the fields below against the control line and Unregister
int g_listen = -1;
int g_wake[2] = {-1, -1};
int g_port = 0;
std::atomic<FTX_AtCommandProcess_cb> g_cb{nullptr};
std::atomic<bool> g_stop{false};
// Figures for "hw status", published by the loop thread.
std::atomic<unsigned long> g_served{0};
std::atomic<int> g_clients{0};
std::atomic<size_t> g_unsent{0};
std::atomic<int> g_waiting{0};
std::atomic<unsigned long> g_refused{0};
std::atomic<unsigned long> g_idleClosed{0};
std::atomic<unsigned long> g_wakeups{0};
thread_local ChannelReply *t_reply = nullptr;

// A start-up error goes to the log and to standard error: the channel then serves nowhere.
void start_error(const char *fmt, ...) __attribute__((format(printf, 1, 2)));
void start_error(const char *fmt, ...) {
    char text[512];
    va_list ap;
    va_start(ap, fmt);
    vsnprintf(text, sizeof(text), fmt, ap);
    va_end(ap);
    __android_log_print(ANDROID_LOG_ERROR, kTag, "%s", text);
    fprintf(stderr, "ftx: %s\n", text);
}

void close_fd(int *fd) {
    if (*fd >= 0) close(*fd);
    *fd = -1;
}

bool transient(int err) {
    return err == EAGAIN || err == EWOULDBLOCK || err == EINTR;
}

// The select loop's state; lives on the thread in runSelectLoopMode.
class Loop {
  public:
    Loop(int listen_fd, int wake_fd)
        : listen_(listen_fd),
          wake_(wake_fd),
          reply_(FTX_AT_REPLY_SIZE),
          idle_ms_(static_cast<long long>(kChannelIdleSeconds * 1000.0 * tp_os_time_scale())) {}

    void run() {
        while (!g_stop.load()) {
            build_poll_set();
            int r = poll(fds_.data(), fds_.size(), poll_timeout_ms());
            if (r < 0) {
                if (errno == EINTR) continue;
                break;
            }
            g_wakeups.fetch_add(1, std::memory_order_relaxed);
            now_ = now_ms();
            long long woke = now_;
            if (fds_[1].revents != 0) break;
            serve_ready();
            serve_released();
            close_finished(woke);
            if (polled_listener_ && (fds_[0].revents & POLLIN)) accept_clients();
            publish();
        }
        for (auto &c : clients_) {
            flush(*c);
            close(c->fd);
        }
        clients_.clear();
        total_ = 0;
        publish();
    }

  private:
    // May the client's next line run now? Not while its own answers, or all clients'
    // together, are over their bound; a client with nothing unsent always may.
    bool may_serve(const Client &c) const {
        return c.unsent() < kChannelClientOutMax &&
               (c.unsent() == 0 || total_ < kChannelTotalOutMax);
    }

    void build_poll_set() {
        fds_.clear();
        polled_listener_ = !resting_ || now_ >= rest_until_;
        fds_.push_back({polled_listener_ ? listen_ : -1, POLLIN, 0});
        fds_.push_back({wake_, POLLIN, 0});
        for (auto &c : clients_) {
            short ev = 0;
            // A client whose lines wait is not read: its bytes stay in the kernel.
            if (!c->eof && !c->has_held() && may_serve(*c)) ev |= POLLIN;
            if (c->unsent() > 0) ev |= POLLOUT;
            fds_.push_back({c->fd, ev, 0});
        }
    }

    // Until the next idle deadline or the listener's rest ends; -1 for none.
    int poll_timeout_ms() const {
        bool any = false;
        long long next = 0;
        for (auto &c : clients_) {
            // Room freed by a client that left: its held lines run at once.
            if (c->has_held() && may_serve(*c)) return 0;
            long long d = c->last + idle_ms_;
            if (!any || d < next) next = d;
            any = true;
        }
        if (resting_ && !polled_listener_ && (!any || rest_until_ < next)) {
            next = rest_until_;
            any = true;
        }
        if (!any) return -1;
        if (next <= now_) return 0;
        // One more millisecond: the clock's tick may lag the wake-up.
        return static_cast<int>(std::min<long long>(next - now_ + 1, 60000));
    }

    void serve_ready() {
        for (size_t i = 0; i < clients_.size(); ++i) {
            short re = fds_[i + 2].revents;
            if (re == 0) continue;
            Client &c = *clients_[i];
            if (re & (POLLOUT | POLLHUP | POLLERR)) {
                flush(c);
                pump(c);
            }
            if (!c.gone && (re & (POLLIN | POLLHUP | POLLERR))) read_client(c);
        }
    }

    // Lines held back by a bound that has room again run now, whoever freed it.
    void serve_released() {
        for (auto &c : clients_)
            pump(*c);
    }

    // Serves held lines and sends their answers while the bounds leave room. The socket
    // may take all that was unsent at once: then the next held lines run now, as no poll
    // event would come for them.
    void pump(Client &c) {
        while (!c.gone && c.has_held() && may_serve(c)) {
            serve_held(c);
            flush(c);
        }
    }

    void read_client(Client &c) {
        char buf[kRecvChunk];
        for (int turn = 0; turn < kReadsPerTurn; ++turn) {
            if (c.eof || c.has_held() || !may_serve(c)) return;
            ssize_t n = recv(c.fd, buf, sizeof(buf), MSG_DONTWAIT);
            if (n == 0) {
                c.eof = true;
                return;
            }
            if (n < 0) {
                if (!transient(errno)) c.gone = true;
                return;
            }
            c.last = now_;
            size_t used = feed(c, buf, static_cast<size_t>(n));
            flush(c);
            if (used < static_cast<size_t>(n)) {
                c.held.assign(buf + used, static_cast<size_t>(n) - used);
                c.held_off = 0;
                pump(c);
            }
            // A short read emptied the socket: poll again rather than ask for EAGAIN.
            if (c.gone || g_stop.load() || static_cast<size_t>(n) < sizeof(buf)) return;
        }
    }

    void serve_held(Client &c) {
        c.held_off += feed(c, c.held.data() + c.held_off, c.held.size() - c.held_off);
        if (!c.has_held()) {
            c.held.clear();
            c.held_off = 0;
        }
    }

    // Frames bytes and serves their lines while the bounds allow; the bytes consumed.
    size_t feed(Client &c, const char *data, size_t n) {
        size_t used = 0;
        if (may_serve(c)) {
            used = c.framer.feed(data, n, [&](const std::string &line, bool overlong) {
                serve_line(c, line, overlong);
                return may_serve(c);
            });
        }
        if (used < n) note_waiting(c);
        return used;
    }

    void note_waiting(Client &c) {
        if (c.waiting) return;
        c.waiting = true;
        __android_log_print(ANDROID_LOG_INFO, kTag,
                            "PC client %d: %zu reply bytes unsent (all clients %zu): its next "
                            "lines wait until it reads",
                            c.fd, c.unsent(), total_);
    }

    // Runs one command and queues its answer.
    void serve_line(Client &c, const std::string &line, bool overlong) {
        int result = 2;
        long length = 0;
        if (!overlong) {
            FTX_AtCommandProcess_cb cb = g_cb.load();
            // Only the part the previous command wrote needs clearing.
            memset(reply_.data(), 0, std::min(dirty_, reply_.size()));
            dirty_ = 0;
            if (cb != nullptr) {
                ChannelReply ctx{reply_.data(), reply_.size(), -1};
                t_reply = &ctx;
                result = cb(line.c_str(), reply_.data(), static_cast<unsigned int>(reply_.size()));
                t_reply = nullptr;
                now_ = now_ms();  // a command may take long: idle times count from its end
                reply_.back() = '\0';
                size_t text = strlen(reply_.data());
                length = ctx.length >= 0 ? ctx.length : static_cast<long>(text);
                dirty_ = std::max(text, static_cast<size_t>(length)) + 1;
            } else {
                __android_log_print(ANDROID_LOG_ERROR, kTag, "no command process registered");
            }
        } else {
            __android_log_print(ANDROID_LOG_ERROR, kTag, "line longer than %d bytes refused",
                                FTX_AT_LINE_MAX);
        }
        g_served.fetch_add(1, std::memory_order_relaxed);
        char head[32];
        int n = snprintf(head, sizeof(head), "%d %ld\n", result, length);
        size_t before = c.out.size();
        c.out.append(head, static_cast<size_t>(n));
        c.out.append(reply_.data(), static_cast<size_t>(length));
        c.out.push_back('\n');
        total_ += c.out.size() - before;
    }

    // Sends what the socket takes now.
    void flush(Client &c) {
        while (c.unsent() > 0) {
            ssize_t w =
                send(c.fd, c.out.data() + c.out_off, c.unsent(), MSG_NOSIGNAL | MSG_DONTWAIT);
            if (w < 0) {
                if (errno == EINTR) continue;
                if (!transient(errno)) c.gone = true;
                break;
            }
            c.out_off += static_cast<size_t>(w);
            total_ -= static_cast<size_t>(w);
            c.last = now_;
        }
        if (c.unsent() == 0) {
            if (c.out.capacity() > kKeepCapacity) {
                std::string().swap(c.out);
            } else {
                c.out.clear();
            }
            c.out_off = 0;
        } else if (c.out_off >= kKeepCapacity && c.out_off >= c.unsent()) {
            c.out.erase(0, c.out_off);
            c.out_off = 0;
            if (!c.has_held()) c.waiting = false;
        }
    }

    // Closes clients that broke, finished, or stayed silent past the idle time. Only a
    // client the poll found quiet is idle: bytes that came while a long command ran count.
    void close_finished(long long woke) {
        size_t kept = 0;
        for (size_t i = 0; i < clients_.size(); ++i) {
            Client &c = *clients_[i];
            bool idle = fds_[i + 2].revents == 0 && woke - c.last >= idle_ms_;
            bool done = c.eof && !c.has_held() && c.unsent() == 0;
            if (idle && !c.gone && !done) {
                g_idleClosed.fetch_add(1, std::memory_order_relaxed);
                __android_log_print(ANDROID_LOG_INFO, kTag,
                                    "PC client %d closed: no traffic for %.1f s", c.fd,
                                    idle_ms_ / 1000.0);
            }
            if (c.gone || done || idle) {
                total_ -= c.unsent();
                close(c.fd);
                clients_[i].reset();
                // A descriptor is free again: the listener need not rest any longer.
                resting_ = false;
            } else {
                clients_[kept++] = std::move(clients_[i]);
            }
        }
        clients_.resize(kept);
        if (at_cap_ && clients_.size() < kChannelMaxClients) at_cap_ = false;
    }

    void accept_clients() {
        for (;;) {
            int fd = accept4(listen_, nullptr, nullptr, SOCK_NONBLOCK | SOCK_CLOEXEC);
            if (fd < 0) {
                if (errno == EINTR || errno == ECONNABORTED) continue;
                if (errno == EMFILE || errno == ENFILE || errno == ENOBUFS || errno == ENOMEM) {
                    rest_listener(errno);
                }
                return;
            }
            resting_ = false;
            if (out_of_fds_) {
                out_of_fds_ = false;
                __android_log_print(ANDROID_LOG_INFO, kTag, "PC clients are accepted again");
            }
            if (clients_.size() >= kChannelMaxClients) {
                // Counted before the client can see its end.
                g_refused.fetch_add(1, std::memory_order_relaxed);
                close(fd);
                if (!at_cap_) {
                    at_cap_ = true;
                    __android_log_print(ANDROID_LOG_WARN, kTag,
                                        "%zu PC clients connected: further connections are "
                                        "closed until one leaves",
                                        kChannelMaxClients);
                }
                continue;
            }
            int one = 1;
            setsockopt(fd, IPPROTO_TCP, TCP_NODELAY, &one, sizeof(one));
            auto c = std::make_unique<Client>();
            c->fd = fd;
            c->last = now_;
            clients_.push_back(std::move(c));
        }
    }

    // The pending connection stays in the kernel's queue; polling a listener that stays
    // readable would spin, so it rests until a client leaves or the retry time passes.
    void rest_listener(int err) {
        resting_ = true;
        rest_until_ = now_ + kChannelAcceptRetryMs;
        if (out_of_fds_) return;
        out_of_fds_ = true;
        __android_log_print(ANDROID_LOG_ERROR, kTag,
                            "cannot accept a PC client: %s; new clients wait until a "
                            "descriptor is free",
                            strerror(err));
    }

    void publish() {
        int waiting = 0;
        for (auto &c : clients_)
            waiting += c->has_held() || !may_serve(*c);
        g_clients.store(static_cast<int>(clients_.size()), std::memory_order_release);
        g_unsent.store(total_, std::memory_order_release);
        g_waiting.store(waiting, std::memory_order_release);
    }

    int listen_;
    int wake_;
    std::vector<std::unique_ptr<Client>> clients_;
    std::vector<char> reply_;
    std::vector<pollfd> fds_;
    long long idle_ms_;
    long long now_ = now_ms();  // read when poll returns and after each command
    long long rest_until_ = 0;
    size_t dirty_ = SIZE_MAX;  // reply bytes the last command may have written
    size_t total_ = 0;         // unsent answer bytes of all clients
    bool polled_listener_ = true;
    bool resting_ = false;
    bool out_of_fds_ = false;  // logged once per stretch
    bool at_cap_ = false;      // logged once per stretch
};

void write_port_file(int port) {
    dev_mkdir("/run", 0755);
    FILE *f = dev_fopen("/run/pc_port", "w");
    if (f == nullptr) return;
    fprintf(f, "%d\n", port);
    fclose(f);
}

}  // namespace

ChannelReply *channel_current_reply() {
    return t_reply;
}

void channel_state(Reply &r) {
    std::lock_guard<std::mutex> lock(g_lock);
    r.add(
        "channel: %s port=%d clients=%d/%zu served=%lu unsent=%zu waiting=%d refused=%lu "
        "idle_closed=%lu wakeups=%lu\n",
        g_listen >= 0 ? "open" : "closed", g_port, g_clients.load(), kChannelMaxClients,
        g_served.load(), g_unsent.load(), g_waiting.load(), g_refused.load(), g_idleClosed.load(),
        g_wakeups.load());
}

}  // namespace ftxsim

using namespace ftxsim;

extern "C" int registerAtSocket(void) {
    call("registerAtSocket", 0);
    std::lock_guard<std::mutex> lock(g_lock);
    close_fd(&g_listen);
    // A port file left by an earlier run must not point the tools at a closed channel.
    dev_unlink("/run/pc_port");
    PcPortSetting port = pc_port_setting();
    if (!port.ok) {
        start_error("PC channel not opened: %s \"%s\" is not a port number (0..65535)", port.source,
                    port.text);
        return -1;
    }
    const char *bind_to = getenv("FTX_PC_BIND");
    sockaddr_in addr{};
    addr.sin_family = AF_INET;
    addr.sin_port = htons(static_cast<uint16_t>(port.port));
    if (inet_pton(AF_INET, bind_to != nullptr && *bind_to ? bind_to : "127.0.0.1",
                  &addr.sin_addr) != 1) {
        start_error("PC channel not opened: FTX_PC_BIND \"%s\" is not an IPv4 address", bind_to);
        return -1;
    }
    if (g_wake[0] < 0 && pipe2(g_wake, O_NONBLOCK | O_CLOEXEC) != 0) return -1;
    int fd = socket(AF_INET, SOCK_STREAM | SOCK_NONBLOCK | SOCK_CLOEXEC, 0);
    if (fd < 0) return -1;
    int one = 1;
    setsockopt(fd, SOL_SOCKET, SO_REUSEADDR, &one, sizeof(one));
    if (bind(fd, reinterpret_cast<sockaddr *>(&addr), sizeof(addr)) != 0 || listen(fd, 64) != 0) {
        start_error("PC channel not opened: cannot listen on port %d: %s", port.port,
                    strerror(errno));
        close(fd);
        return -1;
    }
    socklen_t len = sizeof(addr);
    getsockname(fd, reinterpret_cast<sockaddr *>(&addr), &len);
    g_port = ntohs(addr.sin_port);
    g_listen = fd;
    g_stop.store(false);
    write_port_file(g_port);
    __android_log_print(ANDROID_LOG_INFO, kTag,
                        "PC channel listening on port %d (at most %zu clients, closed after "
                        "%.1f s without traffic)",
                        g_port, kChannelMaxClients, kChannelIdleSeconds * tp_os_time_scale());
    return 0;
}

extern "C" int UnregisterAtSocket(void) {
    call("UnregisterAtSocket", 0);
    g_stop.store(true);
    std::lock_guard<std::mutex> lock(g_lock);
    if (g_wake[1] >= 0) {
        char b = 1;
        ssize_t n = write(g_wake[1], &b, 1);
        (void)n;
    }
    return 0;
}

extern "C" int registerCommandProcess(FTX_AtCommandProcess_cb cb) {
    call("registerCommandProcess", 0, "cb=%p", reinterpret_cast<void *>(cb));
    g_cb.store(cb);
    return 0;
}

extern "C" int runSelectLoopMode(void) {
    call("runSelectLoopMode", 0);
    int listen_fd, wake_fd;
    {
        std::lock_guard<std::mutex> lock(g_lock);
        listen_fd = g_listen;
        wake_fd = g_wake[0];
    }
    if (listen_fd < 0) return -1;
    Loop(listen_fd, wake_fd).run();
    std::lock_guard<std::mutex> lock(g_lock);
    close_fd(&g_listen);
    char drain[16];
    while (g_wake[0] >= 0 && read(g_wake[0], drain, sizeof(drain)) > 0) {
    }
    return 0;
}

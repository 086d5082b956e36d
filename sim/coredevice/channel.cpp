// The PC command channel: TCP, one command per line, answered "<result> <n>\n" + n bytes +
// "\n". Commands run one at a time, in arrival order, on the thread in runSelectLoopMode.
#include <arpa/inet.h>
#include <errno.h>
#include <fcntl.h>
#include <netinet/in.h>
#include <netinet/tcp.h>
#include <poll.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <sys/socket.h>
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
#include "ftx_host.h"
#include "hw/libdvk_ncoredevice.h"
#include "line_framer.h"
#include "sim_core.h"

namespace ftxsim {
namespace {

const char kTag[] = "DVK_CHANNEL";
const int kDefaultPort = 20051;
// A client that does not read its replies is dropped past this much unsent output.
const size_t kMaxPending = 16u << 20;

struct Client {
    int fd;
    LineFramer framer{FTX_AT_LINE_MAX};
    std::string out;
    bool closing = false;
};

std::mutex g_lock;  // guards the fields below against the control line and Unregister
int g_listen = -1;
int g_wake[2] = {-1, -1};
int g_port = 0;
std::atomic<FTX_AtCommandProcess_cb> g_cb{nullptr};
std::atomic<bool> g_stop{false};
std::atomic<unsigned long> g_served{0};
std::atomic<int> g_clients{0};
thread_local ChannelReply *t_reply = nullptr;
size_t g_dirty = SIZE_MAX;  // reply bytes the last command may have written (loop thread only)

int configured_port() {
    const char *env = getenv("FTX_PC_PORT");
    if (env != nullptr && *env != '\0') return atoi(env);
    return ftx_device_ini_get_int("pc", "port", kDefaultPort);
}

void close_fd(int *fd) {
    if (*fd >= 0) close(*fd);
    *fd = -1;
}

// Runs one command and queues its answer.
void serve_line(Client &c, const std::string &line, bool overlong, std::vector<char> &reply) {
    int result = 2;
    long length = 0;
    if (!overlong) {
        FTX_AtCommandProcess_cb cb = g_cb.load();
        // Only the part the previous command wrote needs clearing.
        memset(reply.data(), 0, std::min(g_dirty, reply.size()));
        g_dirty = 0;
        if (cb != nullptr) {
            ChannelReply ctx{reply.data(), reply.size(), -1};
            t_reply = &ctx;
            result = cb(line.c_str(), reply.data(), static_cast<unsigned int>(reply.size()));
            t_reply = nullptr;
            reply.back() = '\0';
            size_t text = strlen(reply.data());
            length = ctx.length >= 0 ? ctx.length : static_cast<long>(text);
            g_dirty = std::max(text, static_cast<size_t>(length)) + 1;
        } else {
            __android_log_print(ANDROID_LOG_ERROR, kTag, "no command process registered");
        }
    } else {
        __android_log_print(ANDROID_LOG_ERROR, kTag, "line longer than %d bytes refused",
                            FTX_AT_LINE_MAX);
    }
    g_served.fetch_add(1);
    char head[32];
    int n = snprintf(head, sizeof(head), "%d %ld\n", result, length);
    c.out.append(head, static_cast<size_t>(n));
    c.out.append(reply.data(), static_cast<size_t>(length));
    c.out.push_back('\n');
}

// Sends what the socket takes now; false when the client is gone.
bool flush(Client &c) {
    while (!c.out.empty()) {
        ssize_t w = send(c.fd, c.out.data(), c.out.size(), MSG_NOSIGNAL | MSG_DONTWAIT);
        if (w < 0) return errno == EAGAIN || errno == EWOULDBLOCK || errno == EINTR;
        c.out.erase(0, static_cast<size_t>(w));
    }
    return true;
}

void accept_clients(int listen_fd, std::vector<std::unique_ptr<Client>> &clients) {
    for (;;) {
        int fd = accept4(listen_fd, nullptr, nullptr, SOCK_NONBLOCK | SOCK_CLOEXEC);
        if (fd < 0) return;
        int one = 1;
        setsockopt(fd, IPPROTO_TCP, TCP_NODELAY, &one, sizeof(one));
        auto c = std::make_unique<Client>();
        c->fd = fd;
        clients.push_back(std::move(c));
    }
}

// Reads what a client sent and serves every complete line; false when it is gone.
bool read_client(Client &c, std::vector<char> &reply) {
    char buf[16384];
    for (;;) {
        ssize_t n = recv(c.fd, buf, sizeof(buf), MSG_DONTWAIT);
        if (n == 0) return false;
        if (n < 0) return errno == EAGAIN || errno == EWOULDBLOCK || errno == EINTR;
        c.framer.feed(buf, static_cast<size_t>(n), [&](const std::string &line, bool overlong) {
            serve_line(c, line, overlong, reply);
        });
        if (!flush(c) || c.out.size() > kMaxPending) return false;
        // A short read emptied the socket: poll again rather than ask for EAGAIN.
        if (g_stop.load() || static_cast<size_t>(n) < sizeof(buf)) return true;
    }
}

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
    r.add("channel: %s port=%d clients=%d served=%lu\n", g_listen >= 0 ? "open" : "closed", g_port,
          g_clients.load(), g_served.load());
}

}  // namespace ftxsim

using namespace ftxsim;

extern "C" int registerAtSocket(void) {
    call("registerAtSocket", 0);
    std::lock_guard<std::mutex> lock(g_lock);
    close_fd(&g_listen);
    if (g_wake[0] < 0 && pipe2(g_wake, O_NONBLOCK | O_CLOEXEC) != 0) return -1;
    int fd = socket(AF_INET, SOCK_STREAM | SOCK_NONBLOCK | SOCK_CLOEXEC, 0);
    if (fd < 0) return -1;
    int one = 1;
    setsockopt(fd, SOL_SOCKET, SO_REUSEADDR, &one, sizeof(one));
    sockaddr_in addr{};
    addr.sin_family = AF_INET;
    addr.sin_port = htons(static_cast<uint16_t>(configured_port()));
    const char *bind_to = getenv("FTX_PC_BIND");
    if (inet_pton(AF_INET, bind_to != nullptr && *bind_to ? bind_to : "127.0.0.1",
                  &addr.sin_addr) != 1) {
        __android_log_print(ANDROID_LOG_ERROR, kTag, "bad FTX_PC_BIND address %s", bind_to);
        close(fd);
        return -1;
    }
    if (bind(fd, reinterpret_cast<sockaddr *>(&addr), sizeof(addr)) != 0 || listen(fd, 16) != 0) {
        __android_log_print(ANDROID_LOG_ERROR, kTag, "cannot listen on port %d: %s",
                            ntohs(addr.sin_port), strerror(errno));
        close(fd);
        return -1;
    }
    socklen_t len = sizeof(addr);
    getsockname(fd, reinterpret_cast<sockaddr *>(&addr), &len);
    g_port = ntohs(addr.sin_port);
    g_listen = fd;
    g_stop.store(false);
    write_port_file(g_port);
    __android_log_print(ANDROID_LOG_INFO, kTag, "PC channel listening on port %d", g_port);
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
    std::vector<std::unique_ptr<Client>> clients;
    std::vector<char> reply(FTX_AT_REPLY_SIZE);
    std::vector<pollfd> fds;
    while (!g_stop.load()) {
        fds.clear();
        fds.push_back({listen_fd, POLLIN, 0});
        fds.push_back({wake_fd, POLLIN, 0});
        for (auto &c : clients) {
            short ev = POLLIN;
            if (!c->out.empty()) ev |= POLLOUT;
            fds.push_back({c->fd, ev, 0});
        }
        if (poll(fds.data(), fds.size(), -1) < 0) {
            if (errno == EINTR) continue;
            break;
        }
        if (fds[1].revents != 0) break;
        for (size_t i = 0; i < clients.size(); ++i) {
            short re = fds[i + 2].revents;
            Client &c = *clients[i];
            bool alive = true;
            if (re & (POLLIN | POLLHUP | POLLERR)) alive = read_client(c, reply);
            if (alive && (re & POLLOUT)) alive = flush(c);
            if (!alive) c.closing = true;
        }
        for (size_t i = 0; i < clients.size();) {
            if (clients[i]->closing) {
                close(clients[i]->fd);
                clients.erase(clients.begin() + static_cast<long>(i));
            } else {
                ++i;
            }
        }
        if (fds[0].revents & POLLIN) accept_clients(listen_fd, clients);
        g_clients.store(static_cast<int>(clients.size()));
    }
    for (auto &c : clients) {
        flush(*c);
        close(c->fd);
    }
    g_clients.store(0);
    std::lock_guard<std::mutex> lock(g_lock);
    close_fd(&g_listen);
    char drain[16];
    while (g_wake[0] >= 0 && read(g_wake[0], drain, sizeof(drain)) > 0) {
    }
    return 0;
}

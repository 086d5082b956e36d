// Probes of the PC channel for its tests, in this process or against ftx-mmi: its figures
// and bare connections.
#pragma once

#include <arpa/inet.h>
#include <errno.h>
#include <netinet/in.h>
#include <poll.h>
#include <stdlib.h>
#include <sys/socket.h>
#include <unistd.h>

#include <chrono>
#include <map>
#include <string>

namespace chantest {

// The figures of a "hw status" line "channel: open port=P clients=N/CAP served=S unsent=B
// waiting=W refused=R idle_closed=I wakeups=K" ("open" is 1 while it listens; clients is
// the count before the slash).
// Plain string scanning, no streams: one test reads the figures while the process is out of
// descriptors, where the sanitizers' type checks of stream objects cannot run.
inline std::map<std::string, long> parse_channel_figures(const std::string &status) {
    std::map<std::string, long> f;
    size_t at = status.find("channel: ");
    while (at != std::string::npos && at != 0 && status[at - 1] != '\n')
        at = status.find("channel: ", at + 1);
    if (at == std::string::npos) return f;
    size_t end = status.find('\n', at);
    std::string line = status.substr(at, end == std::string::npos ? end : end - at);
    f["open"] = line.rfind("channel: open", 0) == 0;
    for (size_t w = 0; w < line.size();) {
        size_t stop = line.find(' ', w);
        if (stop == std::string::npos) stop = line.size();
        size_t eq = line.find('=', w);
        if (eq < stop) f[line.substr(w, eq - w)] = atol(line.c_str() + eq + 1);
        w = stop + 1;
    }
    return f;
}

// Whether the peer closed the connection: EOF or a reset within timeoutMs (false when the
// connection is still open then). Data that arrives first is read and dropped.
inline bool closed_by_peer(int fd, int timeoutMs = 10000) {
    auto end = std::chrono::steady_clock::now() + std::chrono::milliseconds(timeoutMs);
    for (;;) {
        auto left = std::chrono::duration_cast<std::chrono::milliseconds>(
                        end - std::chrono::steady_clock::now())
                        .count();
        pollfd p{fd, POLLIN, 0};
        if (left < 0 || poll(&p, 1, static_cast<int>(left)) <= 0) return false;
        char buf[4096];
        ssize_t n = recv(fd, buf, sizeof(buf), MSG_DONTWAIT);
        if (n == 0 || (n < 0 && errno == ECONNRESET)) return true;
    }
}

// A bare TCP connection to the channel; -1 when refused.
inline int raw_connect(int port) {
    int fd = socket(AF_INET, SOCK_STREAM | SOCK_CLOEXEC, 0);
    sockaddr_in a{};
    a.sin_family = AF_INET;
    a.sin_port = htons(static_cast<uint16_t>(port));
    a.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
    if (fd >= 0 && connect(fd, reinterpret_cast<sockaddr *>(&a), sizeof(a)) != 0) {
        close(fd);
        fd = -1;
    }
    return fd;
}

}  // namespace chantest

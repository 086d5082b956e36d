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
#include <sstream>
#include <string>

namespace chantest {

// The figures of a "hw status" line "channel: open port=P clients=N/CAP served=S unsent=B
// waiting=W refused=R idle_closed=I wakeups=K" ("open" is 1 while it listens; clients is
// the count before the slash).
inline std::map<std::string, long> parse_channel_figures(const std::string &status) {
    std::map<std::string, long> f;
    std::istringstream in(status);
    std::string line;
    while (std::getline(in, line)) {
        if (line.rfind("channel: ", 0) != 0) continue;
        f["open"] = line.rfind("channel: open", 0) == 0;
        std::istringstream words(line);
        std::string w;
        while (words >> w) {
            size_t eq = w.find('=');
            if (eq != std::string::npos) f[w.substr(0, eq)] = atol(w.c_str() + eq + 1);
        }
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

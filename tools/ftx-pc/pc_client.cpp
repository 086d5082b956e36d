#include "pc_client.h"

#include <errno.h>
#include <netdb.h>
#include <netinet/in.h>
#include <netinet/tcp.h>
#include <poll.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <sys/socket.h>
#include <unistd.h>

namespace ftxpc {

PcClient::~PcClient() {
    close_connection();
}

int PcClient::connect_to(const char *host, int port, int timeout_ms) {
    close_connection();
    addrinfo hints{};
    hints.ai_family = AF_UNSPEC;
    hints.ai_socktype = SOCK_STREAM;
    addrinfo *res = nullptr;
    std::string service = std::to_string(port);
    if (getaddrinfo(host, service.c_str(), &hints, &res) != 0) return -1;
    for (addrinfo *a = res; a != nullptr && fd_ < 0; a = a->ai_next) {
        int fd = socket(a->ai_family, a->ai_socktype | SOCK_CLOEXEC, a->ai_protocol);
        if (fd < 0) continue;
        if (connect(fd, a->ai_addr, a->ai_addrlen) == 0) {
            int one = 1;
            setsockopt(fd, IPPROTO_TCP, TCP_NODELAY, &one, sizeof(one));
            fd_ = fd;
        } else {
            close(fd);
        }
    }
    freeaddrinfo(res);
    (void)timeout_ms;
    in_.clear();
    return fd_ >= 0 ? 0 : -1;
}

void PcClient::close_connection() {
    if (fd_ >= 0) close(fd_);
    fd_ = -1;
    in_.clear();
}

int PcClient::send_raw(const std::string &bytes) {
    size_t done = 0;
    while (done < bytes.size()) {
        ssize_t w = send(fd_, bytes.data() + done, bytes.size() - done, MSG_NOSIGNAL);
        if (w < 0) {
            if (errno == EINTR) continue;
            return -1;
        }
        done += static_cast<size_t>(w);
    }
    return 0;
}

int PcClient::finish_sending() {
    return fd_ >= 0 ? shutdown(fd_, SHUT_WR) : -1;
}

bool PcClient::fill(int timeout_ms) {
    pollfd p{fd_, POLLIN, 0};
    int r = poll(&p, 1, timeout_ms);
    if (r <= 0) return false;
    char buf[65536];
    ssize_t n = recv(fd_, buf, sizeof(buf), 0);
    if (n <= 0) return false;
    in_.append(buf, static_cast<size_t>(n));
    return true;
}

int PcClient::read_answer(std::string *reply, int timeout_ms) {
    if (fd_ < 0) return -1;
    size_t eol;
    while ((eol = in_.find('\n')) == std::string::npos) {
        if (in_.size() > 64 || !fill(timeout_ms)) return -1;
    }
    int result = 0;
    unsigned long n = 0;
    char extra;
    if (sscanf(in_.substr(0, eol).c_str(), "%d %lu%c", &result, &n, &extra) != 2) return -1;
    while (in_.size() < eol + 1 + n + 1) {
        if (!fill(timeout_ms)) return -1;
    }
    if (in_[eol + 1 + n] != '\n') return -1;
    if (reply != nullptr) reply->assign(in_, eol + 1, n);
    in_.erase(0, eol + 1 + n + 1);
    return result;
}

int PcClient::command(const std::string &line, std::string *reply, int timeout_ms) {
    if (send_raw(line + "\n") != 0) return -1;
    return read_answer(reply, timeout_ms);
}

}  // namespace ftxpc

// Small host helpers the tests share: a command's output and exit status, and a whole
// send on a socket.
#pragma once

#include <stdio.h>
#include <sys/socket.h>
#include <sys/wait.h>

#include <string>

// Runs cmd with the host's shell; its standard output, and its exit status (-1 when killed).
inline std::string run(const std::string &cmd, int *status) {
    FILE *p = popen(cmd.c_str(), "r");
    std::string out;
    if (p == nullptr) {
        *status = -1;
        return out;
    }
    char buf[4096];
    size_t n;
    while ((n = fread(buf, 1, sizeof(buf), p)) > 0)
        out.append(buf, n);
    int st = pclose(p);
    *status = WIFEXITED(st) ? WEXITSTATUS(st) : -1;
    return out;
}

// Sends all of s; false when the connection failed first.
inline bool send_all(int fd, const std::string &s) {
    size_t off = 0;
    while (off < s.size()) {
        ssize_t n = send(fd, s.data() + off, s.size() - off, MSG_NOSIGNAL);
        if (n <= 0) return false;
        off += static_cast<size_t>(n);
    }
    return true;
}

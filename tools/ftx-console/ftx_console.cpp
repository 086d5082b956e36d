// ftx-console: the emulator console's client.
//   ftx-console [-s SOCKET] [LINE...]   sends one request (the words joined) and prints the
//                                      reply; without words it reads requests from stdin.
// The socket is $FTX_CONSOLE, else $FTX_ROOT/run/console.sock, else ./root (or the demo's
// ./root-demo). Exit status: 0 OK, 2 KO,
// 1 when the console cannot be reached.
#include <limits.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <sys/socket.h>
#include <sys/un.h>
#include <unistd.h>

#include <iostream>
#include <string>

namespace {

int connect_to(const std::string &path) {
    sockaddr_un a{};
    a.sun_family = AF_UNIX;
    if (path.size() >= sizeof(a.sun_path)) return -1;
    memcpy(a.sun_path, path.c_str(), path.size() + 1);
    int fd = socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0);
    if (fd < 0) return -1;
    if (connect(fd, reinterpret_cast<sockaddr *>(&a), sizeof(a)) != 0) {
        close(fd);
        return -1;
    }
    return fd;
}

// A screenshot is written by the console's process: make the file name absolute here.
std::string absolute_paths(const std::string &line) {
    const std::string cmd = "screenshot ";
    if (line.compare(0, cmd.size(), cmd) != 0) return line;
    std::string file = line.substr(cmd.size());
    while (!file.empty() && file[0] == ' ')
        file.erase(0, 1);
    if (file.empty() || file[0] == '/') return line;
    char cwd[PATH_MAX];
    if (getcwd(cwd, sizeof(cwd)) == nullptr) return line;
    return cmd + cwd + "/" + file;
}

// Sends one line and copies the reply to stdout; returns 0 for OK, 2 for KO, 1 on a lost link.
int ask(int fd, const std::string &line) {
    std::string l = absolute_paths(line) + "\n";
    if (write(fd, l.data(), l.size()) != static_cast<ssize_t>(l.size())) return 1;
    std::string cur;
    char c;
    while (read(fd, &c, 1) == 1) {
        cur += c;
        if (c != '\n') continue;
        fputs(cur.c_str(), stdout);
        fflush(stdout);
        if (cur == "OK\n") return 0;
        if (cur.compare(0, 2, "KO") == 0) return 2;
        cur.clear();
    }
    return 1;
}

}  // namespace

int main(int argc, char **argv) {
    std::string path;
    int first = 1;
    if (argc > 2 && strcmp(argv[1], "-s") == 0) {
        path = argv[2];
        first = 3;
    } else if (argc > 1 && (strcmp(argv[1], "-h") == 0 || strcmp(argv[1], "--help") == 0)) {
        printf(
            "usage: ftx-console [-s SOCKET] [LINE...]   (\"help\" lists the console's commands)\n");
        return 0;
    }
    if (path.empty()) {
        const char *env = getenv("FTX_CONSOLE");
        const char *root = getenv("FTX_ROOT");
        if (env != nullptr && *env != '\0')
            path = env;
        else if (root != nullptr && *root != '\0')
            path = std::string(root) + "/run/console.sock";
        else if (access("root-demo/run/console.sock", F_OK) == 0 &&
                 access("root/run/console.sock", F_OK) != 0)
            path = "root-demo/run/console.sock";  // the demo's root
        else
            path = "root/run/console.sock";
    }
    int fd = connect_to(path);
    if (fd < 0) {
        fprintf(stderr,
                "ftx-console: cannot reach %s (is the handset running? set FTX_ROOT or -s)\n",
                path.c_str());
        return 1;
    }
    int rc = 0;
    if (first < argc) {
        std::string line;
        for (int i = first; i < argc; i++)
            line += (i > first ? " " : "") + std::string(argv[i]);
        rc = ask(fd, line);
    } else {
        std::string line;
        bool tty = isatty(0) != 0;
        if (tty) fputs("console> ", stdout);
        while (std::getline(std::cin, line)) {
            if (!line.empty()) rc = ask(fd, line);
            if (rc == 1) break;
            if (tty) fputs("console> ", stdout);
        }
    }
    close(fd);
    return rc;
}

// ftx-console: the emulator console's client.
//   ftx-console [-s SOCKET] [--root DIR] [LINE...]   sends one request (the words joined) and
//                                      prints the reply; without words it reads requests from
//                                      stdin.
// The socket is -s, else DIR/run/console.sock, else $FTX_CONSOLE, else
// $FTX_ROOT/run/console.sock, else the root ./ftx run makes ($FTX_TOP or the current folder:
// root, or the demo's root-demo). Exit status: 0 OK, 2 KO, 1 when the console cannot be
// reached.
#include <getopt.h>
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
    std::string aux;
    const std::string auxOption = "--aux ";
    if (file.compare(0, auxOption.size(), auxOption) == 0) {
        aux = auxOption;
        file.erase(0, aux.size());
        while (!file.empty() && file[0] == ' ')
            file.erase(0, 1);
    }
    if (file.empty() || file[0] == '/') return line;
    char cwd[PATH_MAX];
    if (getcwd(cwd, sizeof(cwd)) == nullptr) return line;
    return cmd + aux + cwd + "/" + file;
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

void usage(FILE *to) {
    fputs(
        "usage: ftx-console [-s SOCKET] [--root DIR] [LINE...]\n"
        "  sends LINE (its words joined by blanks) to the emulator console and prints the\n"
        "  reply (\"help\" lists the console's commands); without a line it reads lines\n"
        "  from standard input. Exit status: 0 OK, 2 KO, 1 the console cannot be reached.\n"
        "  the socket: -s, else DIR/run/console.sock, else FTX_CONSOLE, else\n"
        "  $FTX_ROOT/run/console.sock, else ./root (or the demo's ./root-demo)\n",
        to);
}

std::string default_socket() {
    const char *env = getenv("FTX_CONSOLE");
    const char *root = getenv("FTX_ROOT");
    if (env != nullptr && *env != '\0') return env;
    if (root != nullptr && *root != '\0') return std::string(root) + "/run/console.sock";
    const char *top = getenv("FTX_TOP");
    std::string base = top != nullptr && *top != '\0' ? std::string(top) + "/" : "";
    std::string run = base + "root/run/console.sock", demo = base + "root-demo/run/console.sock";
    // The demo's root, when only the demo is running.
    if (access(demo.c_str(), F_OK) == 0 && access(run.c_str(), F_OK) != 0) return demo;
    return run;
}

}  // namespace

int main(int argc, char **argv) {
    std::string path;
    const option longopts[] = {{"help", no_argument, nullptr, 'h'},
                               {"root", required_argument, nullptr, 'r'},
                               {nullptr, 0, nullptr, 0}};
    int opt;
    while ((opt = getopt_long(argc, argv, "+s:h", longopts, nullptr)) != -1) {
        switch (opt) {
            case 's':
                path = optarg;
                break;
            case 'r':
                // -s names the socket itself and wins over a root.
                if (path.empty()) path = std::string(optarg) + "/run/console.sock";
                break;
            case 'h':
                usage(stdout);
                return 0;
            default:
                usage(stderr);
                return 1;
        }
    }
    int first = optind;
    if (path.empty()) path = default_socket();
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

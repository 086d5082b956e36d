// ftx-pc: the test station's client for the handset's command channel.
//   ftx-pc [-H HOST] [-p PORT] [--root DIR] [-t SECONDS] COMMAND...   sends one command,
//            prints the reply; the exit status is the result (0, 2, 3; 1 no connection)
//   ftx-pc [-H HOST] [-p PORT] [--root DIR] [-t SECONDS]   interactive prompt ("history", "!!")
#include <getopt.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <unistd.h>

#include <string>
#include <vector>

#include "ftx_host.h"
#include "pc_client.h"
#include "pc_port.h"

namespace {

void usage(FILE *to) {
    fputs(
        "usage: ftx-pc [-H HOST] [-p PORT] [--root DIR] [-t SECONDS] [COMMAND...]\n"
        "  sends COMMAND (its words joined by blanks), prints the reply and exits with the\n"
        "  result: 0 done, 2 not understood, 3 not possible here, 1 no connection\n"
        "  without a command: an interactive prompt (history, !!, !N, quit)\n"
        "  the port: -p, else FTX_PC_PORT, else the port the handset of the device root\n"
        "  listens on (its run/pc_port), else [pc] port of the root's sim/device.ini;\n"
        "  the root: --root DIR, else FTX_ROOT, else ./root\n"
        "  -t: how long to wait for an answer (default 120 s: a board check may take a\n"
        "  minute)\n",
        to);
}

// The port the handset of $FTX_ROOT listens on (it writes run/pc_port at start), unless
// FTX_PC_PORT names one; 0 when neither tells.
int running_port() {
    const char *env = getenv("FTX_PC_PORT");
    const char *root = getenv("FTX_ROOT");
    if ((env != nullptr && *env != '\0') || root == nullptr) return 0;
    FILE *fp = fopen((std::string(root) + "/run/pc_port").c_str(), "r");
    if (fp == nullptr) return 0;
    char text[32] = {};
    int port = 0;
    if (fgets(text, sizeof text, fp) == nullptr || !ftxsim::pc_port_parse(text, &port)) port = 0;
    fclose(fp);
    return port;
}

// The device root whose settings give the port: --root, else FTX_ROOT, else the root
// that ./ftx run makes by default (FTX_TOP/root when the launcher runs us, else ./root).
void choose_root(const char *root) {
    if (root == nullptr) {
        const char *env = getenv("FTX_ROOT");
        if (env != nullptr && *env != '\0') return;
        const char *top = getenv("FTX_TOP");
        std::string dflt = std::string(top != nullptr && *top != '\0' ? top : ".") + "/root";
        setenv("FTX_ROOT", dflt.c_str(), 1);
    } else {
        setenv("FTX_ROOT", root, 1);
    }
    ftx_host_reset();
}

void print_reply(const std::string &reply) {
    fwrite(reply.data(), 1, reply.size(), stdout);
    if (reply.empty() || reply.back() != '\n') fputc('\n', stdout);
    fflush(stdout);
}

std::string history_path() {
    const char *home = getenv("HOME");
    return home != nullptr ? std::string(home) + "/.ftx_pc_history" : "";
}

std::vector<std::string> load_history() {
    std::vector<std::string> h;
    std::string path = history_path();
    FILE *f = path.empty() ? nullptr : fopen(path.c_str(), "r");
    if (f == nullptr) return h;
    char line[4200];
    while (fgets(line, sizeof(line), f) != nullptr) {
        line[strcspn(line, "\n")] = '\0';
        if (line[0] != '\0') h.push_back(line);
    }
    fclose(f);
    return h;
}

void append_history(const std::string &line) {
    std::string path = history_path();
    FILE *f = path.empty() ? nullptr : fopen(path.c_str(), "a");
    if (f == nullptr) return;
    fprintf(f, "%s\n", line.c_str());
    fclose(f);
}

// Expands "!!" and "!N" from the history; false when there is no such entry.
bool expand(const std::vector<std::string> &history, std::string *line) {
    if (line->empty() || (*line)[0] != '!') return true;
    size_t index;
    if (*line == "!!") {
        if (history.empty()) return false;
        index = history.size() - 1;
    } else {
        char *end = nullptr;
        long n = strtol(line->c_str() + 1, &end, 10);
        if (*end != '\0' || n < 1 || static_cast<size_t>(n) > history.size()) return false;
        index = static_cast<size_t>(n - 1);
    }
    *line = history[index];
    printf("%s\n", line->c_str());
    return true;
}

int interactive(ftxpc::PcClient &client, const char *host, int port, int waitMs) {
    std::vector<std::string> history = load_history();
    bool tty = isatty(0);
    char buf[8192];
    for (;;) {
        if (tty) {
            printf("ftx-pc> ");
            fflush(stdout);
        }
        if (fgets(buf, sizeof(buf), stdin) == nullptr) break;
        std::string line(buf, strcspn(buf, "\r\n"));
        if (line.empty()) continue;
        if (line == "quit" || line == "exit") break;
        if (line == "history") {
            for (size_t i = 0; i < history.size(); ++i)
                printf("%4zu  %s\n", i + 1, history[i].c_str());
            continue;
        }
        if (!expand(history, &line)) {
            printf("no such history entry\n");
            continue;
        }
        history.push_back(line);
        append_history(line);
        std::string reply;
        int result = client.command(line, &reply, waitMs);
        if (result < 0) {
            // The handset may have restarted: connect once more and retry.
            if (client.connect_to(host, port) != 0 ||
                (result = client.command(line, &reply, waitMs)) < 0) {
                printf("connection to %s:%d lost\n", host, port);
                continue;
            }
        }
        printf("[%d] ", result);
        print_reply(reply);
    }
    return 0;
}

}  // namespace

int main(int argc, char **argv) {
    const char *host = "127.0.0.1";
    const char *root = nullptr;
    int port = 0;
    int waitMs = 120000;
    const option longopts[] = {{"help", no_argument, nullptr, 'h'},
                               {"root", required_argument, nullptr, 'r'},
                               {nullptr, 0, nullptr, 0}};
    int opt;
    while ((opt = getopt_long(argc, argv, "+H:p:t:h", longopts, nullptr)) != -1) {
        switch (opt) {
            case 'H':
                host = optarg;
                break;
            case 'p':
                if (!ftxsim::pc_port_parse(optarg, &port) || port == 0) {
                    fprintf(stderr, "ftx-pc: -p %s: the port is a number 1..65535\n", optarg);
                    return 1;
                }
                break;
            case 'r':
                root = optarg;
                break;
            case 't': {
                char *end = nullptr;
                const long seconds = strtol(optarg, &end, 10);
                if (end == optarg || *end != '\0' || seconds < 1 || seconds > 86400) {
                    fprintf(stderr, "ftx-pc: -t %s: the wait is a number of seconds 1..86400\n",
                            optarg);
                    return 1;
                }
                waitMs = static_cast<int>(seconds * 1000);
                break;
            }
            case 'h':
                usage(stdout);
                return 0;
            default:
                usage(stderr);
                return 1;
        }
    }
    if (port == 0) {
        choose_root(root);
        port = running_port();
    }
    if (port == 0) {
        ftxsim::PcPortSetting s = ftxsim::pc_port_setting();
        if (!s.ok || s.port == 0) {
            fprintf(stderr, "ftx-pc: %s \"%s\" is not a port number (1..65535)\n", s.source,
                    s.text);
            return 1;
        }
        if (root != nullptr && strcmp(s.source, "default") == 0) {
            fprintf(stderr, "ftx-pc: no [pc] port in %s/sim/device.ini (is it a device root?)\n",
                    root);
            return 1;
        }
        port = s.port;
    }
    ftxpc::PcClient client;
    if (client.connect_to(host, port) != 0) {
        fprintf(stderr, "ftx-pc: cannot connect to %s:%d\n", host, port);
        return 1;
    }
    if (optind >= argc) return interactive(client, host, port, waitMs);
    std::string line;
    for (int i = optind; i < argc; ++i) {
        if (!line.empty()) line += ' ';
        line += argv[i];
    }
    std::string reply;
    int result = client.command(line, &reply, waitMs);
    if (result < 0) {
        fprintf(stderr, "ftx-pc: no answer from %s:%d within %d s\n", host, port, waitMs / 1000);
        return 1;
    }
    print_reply(reply);
    return result;
}

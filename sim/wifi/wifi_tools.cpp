#include "wifi_tools.h"

#include <errno.h>
#include <fcntl.h>
#include <poll.h>
#include <signal.h>
#include <stdio.h>
#include <string.h>
#include <sys/socket.h>
#include <sys/stat.h>
#include <sys/syscall.h>
#include <sys/un.h>
#include <sys/wait.h>
#include <time.h>
#include <unistd.h>

#include <vector>

#include "wifi_link.h"

namespace ftxwifi {
namespace {

const char kHostWpaCli[] = "/usr/sbin/wpa_cli";
const char kNull[] = "/dev/null";
const int kReadyTimeoutMs = 10000;

bool wait_readable(int fd, int timeoutMs) {
    struct pollfd p = {fd, POLLIN, 0};
    int rc;
    while ((rc = poll(&p, 1, timeoutMs)) < 0 && errno == EINTR) {
    }
    return rc > 0;
}

// Starts the supplicant in a session of its own (it outlives this tool) and waits for its
// word that it serves.
int init(const std::string &root) {
    if (ftxhost::wifi_supplicant_running(root)) {
        std::string reply;
        ctrl_request(root + ftxhost::kWifiSocket, "SIM_IFUP", &reply, 2000);
        return 0;
    }
    mkdir((root + "/log").c_str(), 0755);
    int fds[2];
    if (pipe2(fds, O_CLOEXEC) != 0) return 1;
    pid_t child = fork();
    if (child == 0) {
        setsid();
        if (fork() != 0) _exit(0);
        // Descriptor 3 tells the starter; the rest of what this tool had stays here.
        if (fds[1] == 3) {
            fcntl(3, F_SETFD, 0);
        } else {
            dup2(fds[1], 3);
        }
        int null = open(kNull, O_RDWR);
        dup2(null, STDIN_FILENO);
        dup2(null, STDOUT_FILENO);
        int log =
            open((root + "/log/wpa_supplicant.txt").c_str(), O_WRONLY | O_CREAT | O_APPEND, 0644);
        dup2(log >= 0 ? log : null, STDERR_FILENO);
        close_range(4, ~0U, 0);
        execl(FTX_WIFI_SUPPLICANT, "ftx-wpa-supplicant", "--ready-fd", "3", nullptr);
        _exit(127);
    }
    close(fds[1]);
    if (child < 0) {
        close(fds[0]);
        return 1;
    }
    waitpid(child, nullptr, 0);
    char word = 0;
    bool served = wait_readable(fds[0], kReadyTimeoutMs) && read(fds[0], &word, 1) == 1 &&
                  (word == '1' || word == '0');
    close(fds[0]);
    if (!served) fprintf(stderr, "pv_wifi_init.sh: the supplicant did not start\n");
    return served ? 0 : 1;
}

bool wait_exit(pid_t pid, int pidfd, const std::string &root, int timeoutMs) {
    if (pidfd >= 0) return wait_readable(pidfd, timeoutMs);
    // Without process descriptors: its lock goes when it ends.
    for (int waited = 0; waited < timeoutMs; waited += 10) {
        if (ftxhost::wifi_supplicant_pid(root) != pid) return true;
        struct timespec ts = {0, 10 * 1000000L};
        nanosleep(&ts, nullptr);
    }
    return false;
}

int close_supplicant(const std::string &root) {
    pid_t pid = ftxhost::wifi_supplicant_pid(root);
    if (pid <= 0) return 0;
    int pidfd = static_cast<int>(syscall(SYS_pidfd_open, pid, 0));
    kill(pid, SIGTERM);
    if (!wait_exit(pid, pidfd, root, 5000)) {
        kill(pid, SIGKILL);
        wait_exit(pid, pidfd, root, 2000);
    }
    if (pidfd >= 0) close(pidfd);
    return 0;
}

int dhcp(const std::string &tool, const std::string &root, int argc, char **argv) {
    const char *ifname = argc > 0 ? argv[argc - 1] : "wlan0";
    std::string reply;
    if (strcmp(ifname, "wlan0") != 0 ||
        ctrl_request(root + ftxhost::kWifiSocket, "SIM_DHCP", &reply, 2000) != 0 ||
        reply == "FAIL\n") {
        fprintf(stderr, "%s: %s: no lease\n", tool.c_str(), ifname);
        return 1;
    }
    return 0;
}

// The host's wpa_cli, held to the root: a control path outside it, the global interface,
// action scripts, pid files and daemons are refused; without -p it uses the root's sockets.
int wpa_cli(const std::string &root, const std::function<bool(const std::string &)> &insideRoot,
            int argc, char **argv) {
    std::vector<std::string> args = {"wpa_cli"};
    bool hasPath = false, command = false;
    for (int i = 0; i < argc; i++) {
        const std::string a = argv[i];
        if (command || a.size() < 2 || a[0] != '-') {
            command = true;
            args.push_back(a);
            continue;
        }
        const char opt = a[1];
        if (opt == 'h' || opt == 'v') {
            args.push_back(a);
            continue;
        }
        if (opt != 'i' && opt != 'p') {
            fprintf(stderr, "wpa_cli: %s: not available on the handset\n", a.c_str());
            return 1;
        }
        std::string value = a.substr(2);
        if (value.empty()) {
            if (i + 1 >= argc) return 1;
            value = argv[++i];
        }
        if (opt == 'p') {
            if (!insideRoot(value)) {
                fprintf(stderr, "wpa_cli: %s: outside the device\n", value.c_str());
                return 1;
            }
            hasPath = true;
        }
        args.push_back(std::string("-") + opt);
        args.push_back(value);
    }
    if (!hasPath) {
        args.insert(args.begin() + 1, root + ftxhost::kWifiSocketDir);
        args.insert(args.begin() + 1, "-p");
    }
    std::vector<char *> av;
    for (std::string &s : args)
        av.push_back(s.data());
    av.push_back(nullptr);
    execv(kHostWpaCli, av.data());
    fprintf(stderr, "wpa_cli: %s: %s\n", kHostWpaCli, strerror(errno));
    return 127;
}

}  // namespace

int run_wifi_tool(const std::string &name, const std::string &root,
                  const std::function<bool(const std::string &)> &insideRoot, int argc,
                  char **argv) {
    if (name == "pv_wifi_init.sh") return init(root);
    if (name == "pv_wifi_close.sh") return close_supplicant(root);
    if (name == "dhcptool" || name == "dhcpcd") return dhcp(name, root, argc, argv);
    if (name == "wpa_cli") return wpa_cli(root, insideRoot, argc, argv);
    return 127;
}

int wifi_ifconfig(const std::string &root, int argc, char **argv) {
    if (argc < 2 || strcmp(argv[0], "wlan0") != 0) return 0;
    const char *request = nullptr;
    for (int i = 1; i < argc; i++) {
        if (strcmp(argv[i], "down") == 0) request = "SIM_IFDOWN";
        if (strcmp(argv[i], "up") == 0) request = "SIM_IFUP";
    }
    std::string reply;
    if (request != nullptr && ftxhost::wifi_supplicant_running(root))
        ctrl_request(root + ftxhost::kWifiSocket, request, &reply, 2000);
    return 0;
}

int ctrl_request(const std::string &socketPath, const std::string &request, std::string *reply,
                 int timeoutMs) {
    struct sockaddr_un to = {};
    to.sun_family = AF_UNIX;
    if (socketPath.size() >= sizeof(to.sun_path)) return -1;
    memcpy(to.sun_path, socketPath.c_str(), socketPath.size() + 1);
    int fd = socket(AF_UNIX, SOCK_DGRAM | SOCK_CLOEXEC, 0);
    if (fd < 0) return -1;
    // An address of the kernel's choosing (abstract), for the reply to come back to.
    struct sockaddr_un self = {};
    self.sun_family = AF_UNIX;
    int rc = -1;
    char buf[4096];
    if (bind(fd, reinterpret_cast<sockaddr *>(&self), sizeof(sa_family_t)) == 0 &&
        connect(fd, reinterpret_cast<sockaddr *>(&to), sizeof(to)) == 0 &&
        send(fd, request.data(), request.size(), 0) == static_cast<ssize_t>(request.size()) &&
        wait_readable(fd, timeoutMs)) {
        ssize_t n = recv(fd, buf, sizeof(buf), 0);
        if (n >= 0) {
            reply->assign(buf, static_cast<size_t>(n));
            rc = 0;
        }
    }
    close(fd);
    return rc;
}

}  // namespace ftxwifi

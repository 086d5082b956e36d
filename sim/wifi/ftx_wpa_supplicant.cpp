// ftx-wpa-supplicant: the simulated handset's Wi-Fi supplicant. It serves the supplicant's
// control interface on the Unix datagram socket $FTX_ROOT/data/misc/wifi/sockets/wlan0,
// answering each request with sendto() to the client's own address, so the real wpa_ctrl
// client library and wpa_cli work against it. It joins the networks its clients configure to
// the access points of sim/device.ini [wifi], as the console changed them, and publishes its
// state in $FTX_ROOT/run/wifi/link.
//
// One instance per device root: it holds a lock on run/wifi/supplicant.pid while it runs.
// It ends on TERMINATE, SIGTERM, when the application that started it (FTX_APP_PID) ends,
// or when its device root is removed. "--ready-fd N": writes one byte to descriptor N once it
// serves (or once it found another instance serving) and closes it.
#include <errno.h>
#include <fcntl.h>
#include <limits.h>
#include <poll.h>
#include <signal.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <sys/socket.h>
#include <sys/stat.h>
#include <sys/un.h>
#include <time.h>
#include <unistd.h>

#include <string>

#include <android/log.h>

#include "supplicant.h"
#include "tp_os.h"
#include "wifi_link.h"
#include "wifi_model.h"

namespace {

const char kTag[] = "wpa_supplicant";
// How often the console's changes, the application and the root are looked at (ms).
const long long kWatchMs = 25;

volatile sig_atomic_t g_stop = 0;

void on_signal(int) {
    g_stop = 1;
}

long long now_ms() {
    struct timespec ts;
    clock_gettime(CLOCK_MONOTONIC, &ts);
    return ts.tv_sec * 1000LL + ts.tv_nsec / 1000000;
}

void make_dirs(const std::string &root, const std::string &devicePath) {
    for (size_t slash = 1; slash != std::string::npos;) {
        slash = devicePath.find('/', slash + 1);
        mkdir((root + devicePath.substr(0, slash)).c_str(), 0755);
    }
}

void ready(int fd, char what) {
    if (fd < 0) return;
    ssize_t n = write(fd, &what, 1);
    (void)n;
    close(fd);
}

bool alive(pid_t pid) {
    return pid <= 0 || kill(pid, 0) == 0 || errno != ESRCH;
}

// Takes the root's supplicant lock (a write lock on the pid file): 1, 0 when another
// supplicant holds it, -1 when the file cannot be used.
int lock_instance(const std::string &root, int *fd) {
    *fd = open((root + ftxhost::kWifiPidFile).c_str(), O_RDWR | O_CREAT | O_CLOEXEC, 0644);
    if (*fd < 0) return -1;
    struct flock lk = {};
    lk.l_type = F_WRLCK;
    lk.l_whence = SEEK_SET;
    if (fcntl(*fd, F_SETLK, &lk) != 0) return errno == EACCES || errno == EAGAIN ? 0 : -1;
    const std::string pid = std::to_string(getpid()) + "\n";
    if (ftruncate(*fd, 0) != 0 || pwrite(*fd, pid.data(), pid.size(), 0) < 0) return -1;
    return 1;
}

// Appends one request and the first line of its answer to log/wpa_supplicant.txt, the
// request's control characters as \xHH.
void record(FILE *log, std::string_view request, const std::string &reply) {
    if (log == nullptr) return;
    struct timespec ts;
    clock_gettime(CLOCK_REALTIME, &ts);
    struct tm tm;
    localtime_r(&ts.tv_sec, &tm);
    std::string line;
    for (unsigned char c : request) {
        char hex[8];
        snprintf(hex, sizeof(hex), "\\x%02x", c);
        line += c < ' ' || c == 0x7F ? std::string(hex) : std::string(1, static_cast<char>(c));
    }
    fprintf(log, "%02d-%02d %02d:%02d:%02d.%03ld %s -> %s\n", tm.tm_mon + 1, tm.tm_mday, tm.tm_hour,
            tm.tm_min, tm.tm_sec, ts.tv_nsec / 1000000, line.c_str(),
            reply.substr(0, reply.find('\n')).c_str());
    fflush(log);
}

// The console's file as (inode, change time, size); a rename over it changes the inode.
std::string file_identity(const std::string &path) {
    struct stat st;
    if (stat(path.c_str(), &st) != 0) return "";
    return std::to_string(st.st_ino) + ":" + std::to_string(st.st_mtim.tv_sec) + "." +
           std::to_string(st.st_mtim.tv_nsec) + ":" + std::to_string(st.st_size);
}

int serve(const std::string &root, int readyFd) {
    make_dirs(root, ftxhost::kWifiRunDir);
    make_dirs(root, ftxhost::kWifiSocketDir);
    int lockFd = -1;
    const int locked = lock_instance(root, &lockFd);
    if (locked <= 0) {
        if (locked < 0) {
            fprintf(stderr, "%s: %s%s: %s\n", kTag, root.c_str(), ftxhost::kWifiPidFile,
                    strerror(errno));
            return 1;
        }
        ready(readyFd, '0');  // one supplicant per root: the running one serves
        return 0;
    }
    const std::string path = root + ftxhost::kWifiSocket;
    struct sockaddr_un addr = {};
    addr.sun_family = AF_UNIX;
    if (path.size() >= sizeof(addr.sun_path)) {
        fprintf(stderr, "%s: %s: the socket path is too long\n", kTag, path.c_str());
        return 1;
    }
    memcpy(addr.sun_path, path.c_str(), path.size() + 1);
    int sock = socket(AF_UNIX, SOCK_DGRAM | SOCK_CLOEXEC, 0);
    unlink(path.c_str());  // left by a supplicant that was killed
    if (sock < 0 || bind(sock, reinterpret_cast<sockaddr *>(&addr), sizeof(addr)) != 0) {
        fprintf(stderr, "%s: %s: %s\n", kTag, path.c_str(), strerror(errno));
        return 1;
    }

    ftxwifi::NetworkModel model = ftxwifi::load_model();
    ftxwifi::Supplicant core(model, ftxwifi::scaled_timing(model.joinMs, tp_os_time_scale()));
    auto previous = ftxhost::wifi_read_link(root);
    core.restore_linklocal(strtoll(previous["linklocal.serial"].c_str(), nullptr, 10),
                           atoi(previous["linklocal.used"].c_str()));
    const std::string consoleFile = root + ftxhost::kWifiConsoleFile;
    const std::string linkFile = root + ftxhost::kWifiLinkFile;
    std::string consoleSeen = "-";
    std::map<std::string, std::string> published;
    std::string state = core.state();
    make_dirs(root, "/log");
    FILE *log = fopen((root + "/log/wpa_supplicant.txt").c_str(), "ae");
    const char *appEnv = getenv("FTX_APP_PID");
    const pid_t app = appEnv != nullptr ? static_cast<pid_t>(atol(appEnv)) : 0;
    __android_log_print(ANDROID_LOG_INFO, kTag, "wlan0: serving %s, %zu access points",
                        path.c_str(), model.aps.size());
    ready(readyFd, '1');

    // The console's changes count from the next request on, and within a watch period.
    auto take_console = [&] {
        const std::string identity = file_identity(consoleFile);
        if (identity == consoleSeen) return;
        consoleSeen = identity;
        core.set_console(ftxwifi::read_console(root));
    };
    bool terminate = false;
    while (!terminate && !g_stop) {
        const long long now = now_ms();
        take_console();
        core.tick(now);
        if (state != core.state()) {
            __android_log_print(ANDROID_LOG_INFO, kTag, "wlan0: State: %s -> %s", state.c_str(),
                                core.state());
            state = core.state();
        }
        if (core.published() != published) {
            published = core.published();
            ftxhost::wifi_write_file(linkFile, published);
        }
        struct stat st;
        if (stat(root.c_str(), &st) != 0 || !alive(app)) break;

        long long wait = core.next_event(now);
        wait = wait == LLONG_MAX ? kWatchMs : wait - now;
        if (wait > kWatchMs) wait = kWatchMs;
        if (wait < 0) wait = 0;
        struct pollfd pfd = {sock, POLLIN, 0};
        if (poll(&pfd, 1, static_cast<int>(wait)) <= 0) continue;
        char buf[ftxwifi::kMaxMessage];
        struct sockaddr_un from = {};
        socklen_t fromLen = sizeof(from);
        ssize_t n =
            recvfrom(sock, buf, sizeof(buf), 0, reinterpret_cast<sockaddr *>(&from), &fromLen);
        if (n < 0) continue;
        take_console();
        std::string reply =
            core.handle(std::string_view(buf, static_cast<size_t>(n)), now_ms(), &terminate);
        if (reply.size() > ftxwifi::kMaxMessage) reply.resize(ftxwifi::kMaxMessage);
        record(log, std::string_view(buf, static_cast<size_t>(n)), reply);
        sendto(sock, reply.data(), reply.size(), 0, reinterpret_cast<sockaddr *>(&from), fromLen);
    }
    __android_log_print(ANDROID_LOG_INFO, kTag, "wlan0: CTRL-EVENT-TERMINATING");
    unlink(path.c_str());
    close(sock);
    // The link and its address end with the supplicant; the counters stay for the next one.
    std::map<std::string, std::string> last = core.published();
    last["wpa_state"] = "INTERFACE_DISABLED";
    last.erase("ip");
    ftxhost::wifi_write_file(linkFile, last);
    if (log != nullptr) fclose(log);
    close(lockFd);
    return 0;
}

}  // namespace

int main(int argc, char **argv) {
    int readyFd = -1;
    if (argc == 3 && strcmp(argv[1], "--ready-fd") == 0) {
        readyFd = atoi(argv[2]);
    } else if (argc != 1) {
        fprintf(stderr, "usage: %s [--ready-fd N]\n", argv[0]);
        return 2;
    }
    char root[PATH_MAX];
    const char *env = getenv("FTX_ROOT");
    if (env == nullptr || env[0] == '\0' || realpath(env, root) == nullptr) {
        fprintf(stderr, "%s: the device root is not set\n", kTag);
        return 127;
    }
    setenv("FTX_ROOT", root, 1);
    struct sigaction sa = {};
    sa.sa_handler = on_signal;
    sigaction(SIGTERM, &sa, nullptr);
    sigaction(SIGINT, &sa, nullptr);
    sigaction(SIGHUP, &sa, nullptr);
    signal(SIGPIPE, SIG_IGN);
    int rc = serve(root, readyFd);
    if (rc != 0) ready(readyFd, 'x');
    return rc;
}

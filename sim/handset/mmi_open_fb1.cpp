// mmi_open_fb1: the handset's auxiliary display program. "mmi_open_fb1 1 N" shows colour N
// (0 white, 1 red, 2 green, 3 blue, 4 black) on the whole auxiliary display until
// /data/fb1_close_flag appears; then the display goes dark and the program ends. A new start
// replaces a running one. It never outlives the application that started it (FTX_APP_PID)
// or its device root.
#include <errno.h>
#include <limits.h>
#include <signal.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <sys/stat.h>
#include <time.h>
#include <unistd.h>

#include <fstream>
#include <string>

#include "aux_fb.h"
#include "kv_file.h"
#include "tool_record.h"

namespace {

const char kName[] = "mmi_open_fb1";
const char kCloseFlag[] = "/data/fb1_close_flag";
const char kPidFile[] = "/run/fb1.pid";
// The colours of the panel test; the first white is one step below full white.
const uint32_t kColours[] = {0xFFFFFE, 0xFF0000, 0x00FF00, 0x0000FF, 0x000000};
const long kPollMs = 20;

volatile sig_atomic_t g_replaced = 0;

void on_term(int) {
    g_replaced = 1;
}

void sleep_ms(long ms) {
    struct timespec ts = {ms / 1000, (ms % 1000) * 1000000L};
    while (nanosleep(&ts, &ts) != 0 && errno == EINTR && !g_replaced) {
    }
}

bool exists(const std::string &path) {
    struct stat st;
    return stat(path.c_str(), &st) == 0;
}

// True when pid is a running mmi_open_fb1. One that has ended but was not reaped yet (its
// parent, the shell, is gone) counts as ended.
bool is_display_program(pid_t pid) {
    std::ifstream in("/proc/" + std::to_string(pid) + "/stat");
    std::string stat;
    if (!std::getline(in, stat)) return false;
    const size_t open = stat.find('('), close = stat.rfind(')');
    if (open == std::string::npos || close == std::string::npos || close + 2 >= stat.size())
        return false;
    const char state = stat[close + 2];
    return stat.substr(open + 1, close - open - 1) == kName && state != 'Z' && state != 'X';
}

// Ends an earlier instance that still shows its colour.
void replace_earlier(const std::string &pidFile) {
    std::ifstream in(pidFile);
    long pid = 0;
    if (!(in >> pid) || pid <= 1 || pid == getpid()) return;
    const pid_t earlier = static_cast<pid_t>(pid);
    if (!is_display_program(earlier)) return;
    kill(earlier, SIGTERM);
    for (int i = 0; i < 100 && is_display_program(earlier); i++)
        sleep_ms(kPollMs);
    if (is_display_program(earlier)) kill(earlier, SIGKILL);
}

int number(const char *s, long lo, long hi, long *out) {
    char *end = nullptr;
    errno = 0;
    long v = strtol(s, &end, 10);
    if (errno != 0 || end == s || *end != '\0' || v < lo || v > hi) return -1;
    *out = v;
    return 0;
}

int side(const std::map<std::string, std::string> &ini, const char *key, int fallback) {
    auto it = ini.find(std::string("aux_screen.") + key);
    long v = 0;
    if (it == ini.end() || number(it->second.c_str(), 1, ftxhost::kAuxFbMaxSide, &v) != 0)
        return fallback;
    return static_cast<int>(v);
}

// The application that started the program, or 0 when none was named.
pid_t app_pid() {
    const char *e = getenv("FTX_APP_PID");
    long v = 0;
    if (e == nullptr || number(e, 2, INT_MAX, &v) != 0) return 0;
    return static_cast<pid_t>(v);
}

bool alive(pid_t pid) {
    return pid == 0 || kill(pid, 0) == 0 || errno != ESRCH;
}

}  // namespace

int main(int argc, char **argv) {
    long mode = 0, index = 0;
    if (argc != 3 || number(argv[1], 1, 1, &mode) != 0 || number(argv[2], 0, 4, &index) != 0) {
        fprintf(stderr,
                "usage: %s 1 COLOUR\n"
                "Shows COLOUR (0 white, 1 red, 2 green, 3 blue, 4 black) on the auxiliary "
                "display until %s appears.\n",
                kName, kCloseFlag);
        return 2;
    }
    char real[PATH_MAX];
    const char *rootEnv = getenv("FTX_ROOT");
    if (rootEnv == nullptr || realpath(rootEnv, real) == nullptr) {
        fprintf(stderr, "%s: the device root is not set\n", kName);
        return 127;
    }
    const std::string root = real;
    ftxhandset::record(kName, argc - 1, argv + 1);

    signal(SIGTERM, on_term);
    const std::string pidFile = root + kPidFile, flag = root + kCloseFlag,
                      frame = root + ftxhost::kAuxFbDevicePath;
    mkdir((root + "/run").c_str(), 0755);
    replace_earlier(pidFile);
    { std::ofstream(pidFile, std::ios::trunc) << getpid() << "\n"; }
    unlink(flag.c_str());  // a close left over from an earlier run

    const auto ini = ftxhost::read_kv_file((root + "/sim/device.ini").c_str(), true);
    const int w = side(ini, "width", ftxhost::kAuxFbDefaultWidth),
              h = side(ini, "height", ftxhost::kAuxFbDefaultHeight);
    if (ftxhost::aux_fb_write(frame, ftxhost::aux_fb_plain(w, h, true, kColours[index])) != 0) {
        fprintf(stderr, "%s: cannot write %s\n", kName, frame.c_str());
        return 1;
    }

    const pid_t app = app_pid();
    bool closed = false;
    while (!g_replaced) {
        if (exists(flag)) {
            closed = true;
            break;
        }
        if (!exists(root) || !alive(app)) return 0;
        sleep_ms(kPollMs);
    }
    if (g_replaced) return 0;  // the new instance shows its own colour
    unlink(flag.c_str());
    ftxhost::aux_fb_write(frame, ftxhost::aux_fb_plain(w, h, false, 0));
    std::ifstream in(pidFile);
    long owner = 0;
    if (in >> owner && owner == getpid()) unlink(pidFile.c_str());
    return closed ? 0 : 1;
}

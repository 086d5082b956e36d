// The emulator console: a line protocol on the Unix socket $FTX_ROOT/run/console.sock.
// Every request gets its reply lines and a last line "OK" or "KO <reason>".
#include <errno.h>
#include <fcntl.h>
#include <limits.h>
#include <poll.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <sys/socket.h>
#include <sys/un.h>
#include <unistd.h>

#include <string>
#include <thread>

#include <android/log.h>

#include "aux_fb.h"
#include "console_parse.h"
#include "devfs.h"
#include "ftx_host.h"
#include "gui_internal.h"
#include "kernel_files.h"
#include "minigui/ftx_gui.h"

namespace ftxgui {

namespace {

const char *kTag = "FTX_CONSOLE";
// How long one move of a gesture may wait for the application.
const int kMoveTakenMs = 5000;

std::mutex g_conLock;
int g_listenFd = -1;
int g_stopPipe[2] = {-1, -1};
std::string g_path;

typedef int (*ConsoleHandler)(const ConsoleRequest &req, std::string &out, std::string &why);

int inject_all(const int (*events)[3], int n, std::string &why) {
    for (int i = 0; i < n; i++) {
        if (ftx_gui_inject(events[i][0], events[i][1], events[i][2]) != 0) {
            why = "input layer not running";
            return -1;
        }
    }
    return 0;
}

int do_key(const ConsoleRequest &r, std::string &, std::string &why) {
    int code = static_cast<int>(r.a);
    const int down[][3] = {{FTX_INPUT_KEYDOWN, code, 0}};
    const int up[][3] = {{FTX_INPUT_KEYUP, code, 0}};
    const int press[][3] = {{FTX_INPUT_KEYDOWN, code, 0}, {FTX_INPUT_KEYUP, code, 0}};
    if (r.action == ACT_DOWN) return inject_all(down, 1, why);
    if (r.action == ACT_UP) return inject_all(up, 1, why);
    return inject_all(press, 2, why);
}

bool on_screen(const ConsoleRequest &r, std::string &why) {
    if (r.a < g_fbW && r.b < g_fbH) return true;
    why = "outside the screen";
    return false;
}

int do_touch(const ConsoleRequest &r, std::string &, std::string &why) {
    if (!on_screen(r, why)) return -1;
    int kind = r.action == ACT_DOWN ? FTX_INPUT_TOUCHDOWN
               : r.action == ACT_UP ? FTX_INPUT_TOUCHUP
                                    : FTX_INPUT_TOUCHMOVE;
    const int ev[][3] = {{kind, static_cast<int>(r.a), static_cast<int>(r.b)}};
    return inject_all(ev, 1, why);
}

int do_tap(const ConsoleRequest &r, std::string &, std::string &why) {
    if (!on_screen(r, why)) return -1;
    int x = static_cast<int>(r.a), y = static_cast<int>(r.b);
    const int ev[][3] = {{FTX_INPUT_TOUCHDOWN, x, y}, {FTX_INPUT_TOUCHUP, x, y}};
    return inject_all(ev, 2, why);
}

// The moves of one straight segment: the given steps, or one every kGestureStep pixels.
int segment_steps(const int *a, const int *b, long steps) {
    if (steps > 0) return static_cast<int>(steps);
    const int dx = abs(b[0] - a[0]), dy = abs(b[1] - a[1]);
    const int longest = dx > dy ? dx : dy;
    return longest == 0 ? 1 : (longest + kGestureStep - 1) / kGestureStep;
}

int do_gesture(const ConsoleRequest &r, std::string &, std::string &why) {
    for (int i = 0; i < r.pointCount; i++) {
        if (r.points[i][0] >= g_fbW || r.points[i][1] >= g_fbH) {
            why = "outside the screen";
            return -1;
        }
    }
    const int(*pt)[2] = r.points;
    const int first[][3] = {{FTX_INPUT_TOUCHDOWN, pt[0][0], pt[0][1]}};
    if (inject_all(first, 1, why) != 0) return -1;
    for (int i = 1; i < r.pointCount; i++) {
        const int n = segment_steps(pt[i - 1], pt[i], r.steps);
        for (int k = 1; k <= n; k++) {
            const int x = pt[i - 1][0] + (pt[i][0] - pt[i - 1][0]) * k / n;
            const int y = pt[i - 1][1] + (pt[i][1] - pt[i - 1][1]) * k / n;
            const int move[][3] = {{FTX_INPUT_TOUCHMOVE, x, y}};
            if (inject_all(move, 1, why) != 0) return -1;
            // As a panel reports: the application sees every point of the way.
            if (!wait_moves_taken(kMoveTakenMs)) {
                why = "the application does not take the touch moves";
                return -1;
            }
        }
    }
    const int *last = pt[r.pointCount - 1];
    const int up[][3] = {{FTX_INPUT_TOUCHUP, last[0], last[1]}};
    return inject_all(up, 1, why);
}

int do_screenshot(const ConsoleRequest &r, std::string &out, std::string &why) {
    if ((r.a == 1 ? aux_screenshot(r.text) : ftx_gui_screenshot(r.text)) != 0) {
        why = std::string("cannot write ") + r.text;
        return -1;
    }
    out += r.text;
    out += "\n";
    return 0;
}

int do_windows(const ConsoleRequest &, std::string &out, std::string &) {
    std::lock_guard<std::mutex> lk(g_lock);
    Window *active = active_locked();
    for (Window *w : zorder_snapshot_locked()) {
        if (w->destroyed) continue;
        char line[512];
        snprintf(line, sizeof(line),
                 "%p active=%d visible=%d rect=%d,%d,%d,%d caption=\"%.300s\"\n",
                 static_cast<void *>(w), w == active ? 1 : 0, (w->style & WS_VISIBLE) != 0 ? 1 : 0,
                 w->rc.left, w->rc.top, w->rc.right, w->rc.bottom, w->caption.c_str());
        out += line;
    }
    return 0;
}

int do_screen(const ConsoleRequest &, std::string &out, std::string &) {
    int blank, bright;
    display_dim_state(&blank, &bright);
    char line[256];
    snprintf(line, sizeof(line), "size %dx%d\nblank %d\nbrightness %d\ndisplay %s\ninput %s\n",
             g_fbW, g_fbH, blank, bright, ftx_gui_backend(), ial_running() ? "running" : "stopped");
    out += line;
    const ftxhost::AuxFrame aux = aux_frame();
    snprintf(line, sizeof(line), "aux size %dx%d\naux %s\n", aux.width, aux.height,
             aux.on ? "on" : "off");
    out += line;
    return 0;
}

int do_help(const ConsoleRequest &, std::string &out, std::string &) {
    out += console_help();
    return 0;
}

int do_hw(const ConsoleRequest &r, std::string &out, std::string &why) {
    char reply[8192] = "";
    int rc = ftx_host_hw_dispatch(r.text, reply, sizeof(reply));
    if (rc == 0) {
        out += reply;
        if (!out.empty() && out.back() != '\n') out += "\n";
        return 0;
    }
    why = reply[0] != '\0' ? reply : "failed";
    return -1;
}

int do_idle(const ConsoleRequest &r, std::string &, std::string &why) {
    if (ftx_gui_wait_idle(static_cast<int>(r.a)) != 0) {
        why = "still busy";
        return -1;
    }
    return 0;
}

int do_wake(const ConsoleRequest &, std::string &, std::string &why) {
    if (ftxhost::resume_by_key()) return 0;
    why = "not suspended";
    return -1;
}

// Indexed by ConsoleCmd.
const ConsoleHandler kHandlers[] = {do_key,     do_touch,   do_tap,     do_screenshot,
                                    do_windows, do_screen,  do_help,    do_hw,
                                    do_idle,    do_gesture, do_gesture, do_wake};

void serve_client(int fd) {
    std::string pending;
    bool skipping = false;  // inside a line already answered as too long
    char buf[4096];
    for (;;) {
        ssize_t n = read(fd, buf, sizeof(buf));
        if (n <= 0) break;
        pending.append(buf, static_cast<size_t>(n));
        size_t nl;
        while ((nl = pending.find('\n')) != std::string::npos) {
            std::string line = pending.substr(0, nl);
            pending.erase(0, nl + 1);
            if (skipping) {
                skipping = false;
                continue;
            }
            std::vector<char> reply(16384);
            ftx_console_execute(line.c_str(), reply.data(), reply.size());
            size_t len = strlen(reply.data()), off = 0;
            while (off < len) {
                ssize_t w = write(fd, reply.data() + off, len - off);
                if (w <= 0) break;
                off += static_cast<size_t>(w);
            }
        }
        if (pending.size() > kConsoleLineMax) {
            // A line that never ends is answered once; the rest of it is dropped.
            if (!skipping) {
                const char ko[] = "KO line too long\n";
                if (write(fd, ko, sizeof(ko) - 1) < 0) break;
            }
            skipping = true;
            pending.clear();
        }
    }
    close(fd);
}

void accept_loop(int lfd, int stopFd) {
    for (;;) {
        pollfd p[2] = {{lfd, POLLIN, 0}, {stopFd, POLLIN, 0}};
        if (poll(p, 2, -1) < 0) {
            if (errno == EINTR) continue;
            break;
        }
        if (p[1].revents != 0) break;
        int c = accept4(lfd, nullptr, nullptr, SOCK_CLOEXEC);
        if (c < 0) continue;
        std::thread(serve_client, c).detach();
    }
    close(lfd);
    close(stopFd);
}

}  // namespace

void console_autostart() {
    if (ftx_console_start() != 0)
        __android_log_print(ANDROID_LOG_WARN, kTag, "console not started: no %s",
                            ftx_console_path());
}

}  // namespace ftxgui

using namespace ftxgui;

extern "C" {

int ftx_console_execute(const char *line, char *reply, size_t size) {
    if (reply == nullptr || size == 0) return -1;
    ConsoleRequest *req = new ConsoleRequest;
    char why[256] = "";
    std::string out, reason;
    int rc;
    if (console_parse(line, line != nullptr ? strlen(line) : 0, req, why, sizeof(why)) != 0) {
        reason = why;
        rc = -1;
    } else {
        rc = kHandlers[req->cmd](*req, out, reason);
    }
    delete req;
    std::string last = rc == 0 ? "OK\n" : "KO " + reason + "\n";
    // The status line always fits; the reply lines are cut when the buffer is short.
    if (last.size() >= size) last = rc == 0 ? "OK\n" : "KO\n";
    size_t room = size - 1 > last.size() ? size - 1 - last.size() : 0;
    if (out.size() > room) out.resize(room);
    snprintf(reply, size, "%s%s", out.c_str(), last.c_str());
    return rc;
}

const char *ftx_console_path(void) {
    std::lock_guard<std::mutex> lk(g_conLock);
    if (g_path.empty()) {
        char p[PATH_MAX];
        if (dev_path("/run/console.sock", p, sizeof(p)) == 0) g_path = p;
    }
    return g_path.c_str();
}

int ftx_console_start(void) {
    const char *path = ftx_console_path();
    std::lock_guard<std::mutex> lk(g_conLock);
    if (g_listenFd >= 0) return 0;
    sockaddr_un addr{};
    addr.sun_family = AF_UNIX;
    if (g_path.empty() || g_path.size() >= sizeof(addr.sun_path)) return -1;
    memcpy(addr.sun_path, path, g_path.size() + 1);
    dev_mkdir("/run", 0755);
    unlink(path);
    int fd = socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0);
    if (fd < 0) return -1;
    if (bind(fd, reinterpret_cast<sockaddr *>(&addr), sizeof(addr)) != 0 || listen(fd, 8) != 0 ||
        pipe2(g_stopPipe, O_CLOEXEC) != 0) {
        close(fd);
        return -1;
    }
    g_listenFd = fd;
    std::thread(accept_loop, fd, g_stopPipe[0]).detach();
    __android_log_print(ANDROID_LOG_INFO, kTag, "console on %s", path);
    return 0;
}

void ftx_console_stop(void) {
    std::lock_guard<std::mutex> lk(g_conLock);
    if (g_listenFd < 0) return;
    if (write(g_stopPipe[1], "x", 1) < 0) {
        // the accept loop also ends when the pipe closes
    }
    close(g_stopPipe[1]);
    g_listenFd = -1;
    g_stopPipe[0] = g_stopPipe[1] = -1;
    unlink(g_path.c_str());
    g_path.clear();
}

}  // extern "C"

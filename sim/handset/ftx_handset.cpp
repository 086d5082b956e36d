// The handset's command-line tools on the host: one program under many names, linked into
// the build's handset tool folder, where device shell lines find them. toybox's file applets
// run the host's own tools, and only on paths inside the device root; tools that would change
// the kernel, the radio or the machine only record what they were asked; the Wi-Fi tools work
// the simulated network (sim/wifi). Every call is recorded in $FTX_ROOT/log/tools.txt with
// device paths.
#include <errno.h>
#include <fcntl.h>
#include <limits.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <sys/stat.h>
#include <unistd.h>

#include <string>
#include <vector>

#include "shell_line.h"
#include "tool_record.h"
#include "wifi_tools.h"

using ftxhandset::under;

namespace {

enum class Kind {
    Toybox,      // the multi-call tool: its first argument names the applet
    FileApplet,  // a toybox applet that works on files of the device root
    Recorder,    // a kernel or radio tool: recorded, and it succeeds
    Wifi,        // the simulated Wi-Fi network's tools (sim/wifi)
};

struct Tool {
    const char *name;
    Kind kind;
};

const Tool kTools[] = {
    {"toybox", Kind::Toybox},         {"cat", Kind::FileApplet},
    {"chmod", Kind::FileApplet},      {"cp", Kind::FileApplet},
    {"echo", Kind::FileApplet},       {"false", Kind::FileApplet},
    {"grep", Kind::FileApplet},       {"head", Kind::FileApplet},
    {"ls", Kind::FileApplet},         {"mkdir", Kind::FileApplet},
    {"mv", Kind::FileApplet},         {"rm", Kind::FileApplet},
    {"sleep", Kind::FileApplet},      {"sync", Kind::FileApplet},
    {"tail", Kind::FileApplet},       {"touch", Kind::FileApplet},
    {"true", Kind::FileApplet},       {"wc", Kind::FileApplet},
    {"dhcpcd", Kind::Wifi},           {"dhcptool", Kind::Wifi},
    {"insmod", Kind::Recorder},       {"iwpriv", Kind::Recorder},
    {"rmmod", Kind::Recorder},        {"ptt_socket_app", Kind::Recorder},
    {"wpa_cli", Kind::Wifi},          {"pv_wifi_init.sh", Kind::Wifi},
    {"pv_wifi_close.sh", Kind::Wifi},
};

const char kSelf[] = "ftx-handset";

const Tool *find_tool(const std::string &name) {
    for (const Tool &t : kTools) {
        if (name == t.name) return &t;
    }
    return nullptr;
}

std::string base_name(const char *path) {
    const char *slash = strrchr(path, '/');
    return slash != nullptr ? slash + 1 : path;
}

std::string real_root() {
    char buf[PATH_MAX];
    const char *root = getenv("FTX_ROOT");
    if (root == nullptr || root[0] == '\0' || realpath(root, buf) == nullptr) return "";
    return buf;
}

// True when path, followed through every link that exists so far, stays inside root.
bool inside_root(const std::string &arg, const std::string &root) {
    char cwd[PATH_MAX];
    if (getcwd(cwd, sizeof(cwd)) == nullptr) return false;
    std::string path =
        ftxhost::normalise_device_path(arg[0] == '/' ? arg : std::string(cwd) + "/" + arg);
    std::string rest;
    while (true) {
        char real[PATH_MAX];
        if (realpath(path.c_str(), real) != nullptr)
            return under(ftxhost::normalise_device_path(real + rest), root);
        if (path == "/") return false;
        size_t slash = path.rfind('/');
        rest = path.substr(slash) + rest;
        path = slash == 0 ? "/" : path.substr(0, slash);
    }
}

int sync_root(const std::string &root) {
    int fd = open(root.c_str(), O_RDONLY | O_DIRECTORY);
    if (fd < 0) return 1;
    int rc = syncfs(fd);
    close(fd);
    return rc == 0 ? 0 : 1;
}

// Runs the host's own applet on arguments that stay inside the device root.
int file_applet(const std::string &applet, int argc, char **argv) {
    std::string root = real_root();
    if (root.empty()) {
        fprintf(stderr, "%s: the device root is not set\n", applet.c_str());
        return 127;
    }
    if (applet == "sync") return sync_root(root);
    char cwd[PATH_MAX];
    if (getcwd(cwd, sizeof(cwd)) == nullptr || !under(cwd, root)) {
        if (chdir(root.c_str()) != 0) return 1;
    }
    for (int i = 0; i < argc; i++) {
        std::string a = argv[i];
        if (a[0] == '-') {
            if (a.find('/') == std::string::npos) continue;
            fprintf(stderr, "%s: %s: an option may not name a path\n", applet.c_str(), argv[i]);
            return 1;
        }
        bool pathLike = a.find('/') != std::string::npos || a == ".." || a.empty();
        if (pathLike && !inside_root(a.empty() ? "." : a, root)) {
            fprintf(stderr, "%s: %s: outside the device\n", applet.c_str(), argv[i]);
            return 1;
        }
    }
    for (const char *dir : {"/usr/bin/", "/bin/"}) {
        std::string host = dir + applet;
        if (access(host.c_str(), X_OK) != 0) continue;
        std::vector<char *> args;
        args.push_back(const_cast<char *>(applet.c_str()));
        for (int i = 0; i < argc; i++)
            args.push_back(argv[i]);
        args.push_back(nullptr);
        execv(host.c_str(), args.data());
        fprintf(stderr, "%s: %s\n", applet.c_str(), strerror(errno));
        return 126;
    }
    fprintf(stderr, "%s: not found\n", applet.c_str());
    return 127;
}

// Links every tool's name to this program, in the folder this program lives in.
int install_links() {
    char self[PATH_MAX];
    ssize_t n = readlink("/proc/self/exe", self, sizeof(self) - 1);
    if (n <= 0) return 1;
    self[n] = '\0';
    std::string dir(self, strrchr(self, '/') - self);
    for (const Tool &t : kTools) {
        std::string link = dir + "/" + t.name;
        unlink(link.c_str());
        if (symlink(kSelf, link.c_str()) != 0) {
            fprintf(stderr, "%s: %s: %s\n", kSelf, link.c_str(), strerror(errno));
            return 1;
        }
    }
    return 0;
}

}  // namespace

int main(int argc, char **argv) {
    std::string name = base_name(argv[0]);
    if (name == kSelf) {
        if (argc == 2 && strcmp(argv[1], "--links") == 0) return install_links();
        fprintf(stderr,
                "usage: %s --links\n"
                "The handset's tools for device shell lines; run under a tool's name.\n",
                kSelf);
        return 2;
    }
    const Tool *tool = find_tool(name);
    if (tool == nullptr) {
        fprintf(stderr, "%s: not a handset tool\n", name.c_str());
        return 127;
    }
    ftxhandset::record(name, argc - 1, argv + 1);
    switch (tool->kind) {
        case Kind::Toybox: {
            if (argc < 2) return 0;
            if (strcmp(argv[1], "ifconfig") == 0)
                return ftxwifi::wifi_ifconfig(real_root(), argc - 2, argv + 2);
            const Tool *applet = find_tool(argv[1]);
            if (applet == nullptr || applet->kind != Kind::FileApplet) return 0;
            return file_applet(argv[1], argc - 2, argv + 2);
        }
        case Kind::FileApplet:
            return file_applet(name, argc - 1, argv + 1);
        case Kind::Recorder:
            return 0;
        case Kind::Wifi: {
            const std::string root = real_root();
            if (root.empty()) {
                fprintf(stderr, "%s: the device root is not set\n", name.c_str());
                return 127;
            }
            auto inside = [&root](const std::string &path) { return inside_root(path, root); };
            return ftxwifi::run_wifi_tool(name, root, inside, argc - 1, argv + 1);
        }
    }
    return 0;
}

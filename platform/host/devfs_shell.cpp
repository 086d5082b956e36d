// Device shell, power and mounts: nothing here reaches the real machine.
#include <errno.h>
#include <fcntl.h>
#include <spawn.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <sys/wait.h>
#include <unistd.h>

#include <atomic>
#include <mutex>
#include <string>
#include <vector>

#include <android/log.h>

#include "devfs.h"
#include "ftx_host.h"
#include "host_internal.h"

extern char **environ;

namespace {

std::mutex g_shellLogLock;
std::atomic<ftx_reboot_hook_fn> g_rebootHook{nullptr};

// Characters after which a '/' starts a path word in a shell line.
bool starts_word(char prev) {
    return strchr(" \t'\"=<>|;&(`", prev) != nullptr;
}

void record(const std::string &line) {
    std::lock_guard<std::mutex> lock(g_shellLogLock);
    char dir[4096];
    if (dev_path("/log", dir, sizeof(dir)) != 0) return;
    mkdir(dir, 0755);
    std::string file = std::string(dir) + "/shell.txt";
    FILE *f = fopen(file.c_str(), "a");
    if (f == nullptr) return;
    fprintf(f, "%s %s\n", ftxhost::timestamp().c_str(), line.c_str());
    fclose(f);
}

}  // namespace

// Moves every absolute device path of a shell line into the device root.
std::string ftx_map_shell_line(const char *cmd) {
    std::string root = dev_root();
    std::string out;
    size_t n = strlen(cmd);
    for (size_t i = 0; i < n; i++) {
        char c = cmd[i];
        if (c == '/' && (i == 0 || starts_word(cmd[i - 1])) &&
            strncmp(cmd + i, root.c_str(), root.size()) != 0 &&
            strncmp(cmd + i, "/dev/null", 9) != 0) {
            out += root;
        }
        out += c;
    }
    return out;
}

extern "C" int dev_system(const char *cmd) {
    if (cmd == nullptr) return 1;  // a shell is available
    record(cmd);
    std::string line = ftx_map_shell_line(cmd);
    std::string root = dev_root();
    const char *oldPath = getenv("PATH");
    std::string path = "PATH=" + root + "/system/bin:" + root +
                       "/system/xbin:" + (oldPath != nullptr ? oldPath : "/usr/bin:/bin");
    std::string rootVar = "FTX_ROOT=" + root;

    std::vector<std::string> env;
    for (char **e = environ; *e != nullptr; e++) {
        if (strncmp(*e, "PATH=", 5) != 0 && strncmp(*e, "FTX_ROOT=", 9) != 0) env.push_back(*e);
    }
    env.push_back(path);
    env.push_back(rootVar);
    std::vector<char *> envp;
    for (std::string &s : env)
        envp.push_back(s.data());
    envp.push_back(nullptr);

    const char *argv[] = {"sh", "-c", line.c_str(), nullptr};
    pid_t pid;
    int rc = posix_spawn(&pid, "/bin/sh", nullptr, nullptr, const_cast<char **>(argv), envp.data());
    if (rc != 0) {
        errno = rc;
        return -1;
    }
    int status = 0;
    while (waitpid(pid, &status, 0) < 0) {
        if (errno != EINTR) return -1;
    }
    return status;
}

extern "C" void ftx_set_reboot_hook(ftx_reboot_hook_fn fn) {
    g_rebootHook.store(fn);
}

extern "C" int dev_reboot(int cmd) {
    int status = (static_cast<unsigned>(cmd) == LINUX_REBOOT_CMD_POWER_OFF) ? DEV_EXIT_POWER_OFF
                                                                            : DEV_EXIT_REBOOT;
    __android_log_print(ANDROID_LOG_INFO, "PLATFORM", "dev_reboot: %s (exit status %d)",
                        status == DEV_EXIT_POWER_OFF ? "power off" : "reboot", status);
    record(status == DEV_EXIT_POWER_OFF ? "reboot power-off" : "reboot restart");
    ftx_reboot_hook_fn hook = g_rebootHook.load();
    if (hook != nullptr) {
        hook(status);
        return -1;
    }
    fflush(nullptr);
    _exit(status);
}

extern "C" void dev_sync(void) {
    // Only the device root's file system, never the whole machine's.
    int fd = open(dev_root(), O_RDONLY | O_DIRECTORY);
    if (fd >= 0) {
        syncfs(fd);
        close(fd);
    }
}

extern "C" int dev_mount(const char *source, const char *target, const char *fstype,
                         unsigned long flags, const void *data) {
    (void)data;
    std::string line = std::string("mount ") + (source ? source : "-") + " " +
                       (target ? target : "-") + " " + (fstype ? fstype : "-") +
                       " flags=" + std::to_string(flags);
    record(line);
    return 0;
}

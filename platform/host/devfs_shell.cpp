// Device shell, power and mounts: nothing here reaches the real machine.
#include <errno.h>
#include <fcntl.h>
#include <spawn.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <sys/mount.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

#include <atomic>
#include <map>
#include <mutex>
#include <string>
#include <vector>

#include <android/log.h>

#include "devfs.h"
#include "ftx_host.h"
#include "host_internal.h"
#include "shell_line.h"

extern char **environ;

namespace {

std::mutex g_shellLogLock;
std::atomic<ftx_reboot_hook_fn> g_rebootHook{nullptr};
// The system partition is mounted read-only at boot, as on a handset.
std::atomic<bool> g_systemWritable{false};

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

namespace {

const char *tool_dir() {
    return FTX_HANDSET_TOOL_DIR;
}

ftxhost::ShellContext shell_context() {
    ftxhost::ShellContext ctx;
    ctx.root = dev_root();
    ctx.toolDir = tool_dir();
    ctx.hasTool = [](const std::string &name) {
        std::string p = std::string(tool_dir()) + "/" + name;
        return access(p.c_str(), X_OK) == 0;
    };
    ctx.deviceHas = [](const std::string &devicePath) {
        struct stat st;
        char buf[4096];
        return dev_path(devicePath.c_str(), buf, sizeof(buf)) == 0 && lstat(buf, &st) == 0;
    };
    return ctx;
}

}  // namespace

extern "C" int ftx_shell_prepare(const char *line, char *out, size_t size) {
    if (line == nullptr || out == nullptr || size == 0) return -1;
    std::string prepared, why;
    int rc = ftxhost::shell_prepare(line, shell_context(), &prepared, &why);
    snprintf(out, size, "%s", rc == 0 ? prepared.c_str() : why.c_str());
    return rc;
}

namespace {

// Checks, records and starts a device shell line; with childFd >= 0 that descriptor becomes
// the shell's targetFd. The shell's pid, or -1 (*refused tells whether the line was refused).
pid_t start_line(const char *cmd, int childFd, int targetFd, bool *refused) {
    *refused = false;
    record(cmd);
    std::string line, why;
    if (ftxhost::shell_prepare(cmd, shell_context(), &line, &why) != 0) {
        record("refused: " + why);
        __android_log_print(ANDROID_LOG_ERROR, "PLATFORM", "dev_system: refused \"%s\": %s", cmd,
                            why.c_str());
        *refused = true;
        return -1;
    }
    std::string root = dev_root();
    std::vector<std::string> env;
    for (char **e = environ; *e != nullptr; e++) {
        if (strncmp(*e, "PATH=", 5) != 0 && strncmp(*e, "FTX_ROOT=", 9) != 0 &&
            strncmp(*e, "FTX_APP_PID=", 12) != 0)
            env.push_back(*e);
    }
    // A tool left running in the background ends with the application.
    env.push_back("FTX_APP_PID=" + std::to_string(getpid()));
    // Only the build's tools are found by name; the root's files never run.
    env.push_back(std::string("PATH=") + tool_dir());
    env.push_back("FTX_ROOT=" + root);
    std::vector<char *> envp;
    for (std::string &s : env)
        envp.push_back(s.data());
    envp.push_back(nullptr);

    // The handset's shell starts in "/": relative paths of the tools land in the root.
    posix_spawn_file_actions_t actions;
    posix_spawn_file_actions_init(&actions);
    posix_spawn_file_actions_addchdir_np(&actions, root.c_str());
    if (childFd >= 0) posix_spawn_file_actions_adddup2(&actions, childFd, targetFd);
    const char *argv[] = {"sh", "-c", line.c_str(), nullptr};
    pid_t pid;
    int rc =
        posix_spawn(&pid, "/bin/sh", &actions, nullptr, const_cast<char **>(argv), envp.data());
    posix_spawn_file_actions_destroy(&actions);
    if (rc != 0) {
        errno = rc;
        return -1;
    }
    return pid;
}

int wait_line(pid_t pid) {
    int status = 0;
    while (waitpid(pid, &status, 0) < 0) {
        if (errno != EINTR) return -1;
    }
    return status;
}

// The shells behind the streams dev_popen handed out.
std::mutex g_streamsLock;
std::map<FILE *, pid_t> g_streams;

}  // namespace

extern "C" int dev_system(const char *cmd) {
    if (cmd == nullptr) return 1;  // a shell is available
    bool refused = false;
    pid_t pid = start_line(cmd, -1, -1, &refused);
    if (refused) return W_EXITCODE(127, 0);
    return pid < 0 ? -1 : wait_line(pid);
}

extern "C" FILE *dev_popen(const char *cmd, const char *mode) {
    if (cmd == nullptr || mode == nullptr || (mode[0] != 'r' && mode[0] != 'w')) {
        errno = EINVAL;
        return nullptr;
    }
    const bool reading = mode[0] == 'r';
    int fds[2];
    if (pipe2(fds, O_CLOEXEC) != 0) return nullptr;
    // The shell gets the pipe's writing end as its output, or its reading end as its input.
    const int mine = reading ? fds[0] : fds[1], theirs = reading ? fds[1] : fds[0];
    bool refused = false;
    pid_t pid = start_line(cmd, theirs, reading ? STDOUT_FILENO : STDIN_FILENO, &refused);
    close(theirs);
    FILE *fp = pid < 0 ? nullptr : fdopen(mine, reading ? "r" : "w");
    if (fp == nullptr) {
        close(mine);
        if (pid >= 0) wait_line(pid);
        if (refused) errno = EPERM;
        return nullptr;
    }
    std::lock_guard<std::mutex> lock(g_streamsLock);
    g_streams[fp] = pid;
    return fp;
}

extern "C" int dev_pclose(FILE *fp) {
    pid_t pid;
    {
        std::lock_guard<std::mutex> lock(g_streamsLock);
        auto it = g_streams.find(fp);
        if (it == g_streams.end()) {
            errno = ECHILD;
            return -1;
        }
        pid = it->second;
        g_streams.erase(it);
    }
    fclose(fp);
    return wait_line(pid);
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
    std::string where = ftxhost::normalise_device_path(target != nullptr ? target : "");
    if (where == "/system" || where == "/system/") {
        if ((flags & MS_RDONLY) != 0) {
            g_systemWritable = false;
        } else if ((flags & MS_REMOUNT) != 0) {
            g_systemWritable = true;
        }
    }
    return 0;
}

extern "C" int ftx_host_system_writable(void) {
    return g_systemWritable.load() ? 1 : 0;
}

namespace ftxhost {
void mounts_reset() {
    g_systemWritable = false;
}
}  // namespace ftxhost

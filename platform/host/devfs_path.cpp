// The device root and the mapping of device paths into it.
#include <errno.h>
#include <fcntl.h>
#include <stdarg.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <unistd.h>

#include <mutex>
#include <string>

#include "devfs.h"
#include "ftx_host.h"
#include "host_internal.h"
#include "kernel_files.h"
#include "shell_line.h"

namespace {

std::mutex g_rootLock;
std::string g_root;
bool g_rootKnown = false;

}  // namespace

namespace ftxhost {
void root_reset() {
    std::lock_guard<std::mutex> lock(g_rootLock);
    g_rootKnown = false;
}
}  // namespace ftxhost

extern "C" const char *dev_root(void) {
    std::lock_guard<std::mutex> lock(g_rootLock);
    if (!g_rootKnown) {
        const char *env = getenv("FTX_ROOT");
        if (env != nullptr && env[0] != '\0') {
            g_root = env;
        } else {
            // Never fall through to the real file system: an unset root is a private folder.
            g_root = "/tmp/ftx-root-" + std::to_string(getuid());
            fprintf(stderr, "ftx: FTX_ROOT is not set, using %s\n", g_root.c_str());
        }
        while (g_root.size() > 1 && g_root.back() == '/')
            g_root.pop_back();
        g_rootKnown = true;
    }
    return g_root.c_str();
}

extern "C" int dev_path(const char *path, char *out, size_t size) {
    if (path == nullptr || out == nullptr || size == 0) return -1;
    // "." and ".." are resolved lexically, so no device path leaves the root; a relative path
    // is taken from the handset's working directory, "/".
    std::string device = ftxhost::normalise_device_path(path);
    std::string result = dev_root();
    if (device != "/") result += device;
    if (result.size() + 1 > size) {
        out[0] = '\0';
        return -1;
    }
    memcpy(out, result.c_str(), result.size() + 1);
    return 0;
}

namespace {

// Maps path into buf; on failure errno is ENAMETOOLONG and null is returned.
const char *mapped(const char *path, char *buf, size_t size) {
    if (dev_path(path, buf, size) != 0) {
        errno = ENAMETOOLONG;
        return nullptr;
    }
    return buf;
}

}  // namespace

extern "C" FILE *dev_fopen(const char *path, const char *mode) {
    char buf[4096];
    const char *p = mapped(path, buf, sizeof(buf));
    if (p == nullptr) return nullptr;
    // The RTC alarm and the power state act on writes, as their drivers do.
    FILE *kernel;
    if (ftxhost::open_kernel_file(path, p, mode, &kernel)) return kernel;
    return fopen(p, mode);
}

extern "C" int dev_open(const char *path, int flags, ...) {
    mode_t mode = 0;
    if ((flags & O_CREAT) != 0 || (flags & O_TMPFILE) == O_TMPFILE) {
        va_list ap;
        va_start(ap, flags);
        mode = static_cast<mode_t>(va_arg(ap, int));
        va_end(ap);
    }
    char buf[4096];
    const char *p = mapped(path, buf, sizeof(buf));
    return p != nullptr ? open(p, flags, mode) : -1;
}

extern "C" int dev_access(const char *path, int mode) {
    char buf[4096];
    const char *p = mapped(path, buf, sizeof(buf));
    return p != nullptr ? access(p, mode) : -1;
}

extern "C" int dev_stat(const char *path, struct stat *st) {
    char buf[4096];
    const char *p = mapped(path, buf, sizeof(buf));
    return p != nullptr ? stat(p, st) : -1;
}

extern "C" int dev_mkdir(const char *path, mode_t mode) {
    char buf[4096];
    const char *p = mapped(path, buf, sizeof(buf));
    return p != nullptr ? mkdir(p, mode) : -1;
}

extern "C" int dev_unlink(const char *path) {
    char buf[4096];
    const char *p = mapped(path, buf, sizeof(buf));
    return p != nullptr ? unlink(p) : -1;
}

extern "C" int dev_rename(const char *from, const char *to) {
    char a[4096], b[4096];
    if (mapped(from, a, sizeof(a)) == nullptr || mapped(to, b, sizeof(b)) == nullptr) return -1;
    return rename(a, b);
}

extern "C" DIR *dev_opendir(const char *path) {
    char buf[4096];
    const char *p = mapped(path, buf, sizeof(buf));
    return p != nullptr ? opendir(p) : nullptr;
}

extern "C" const char *dev_ifname(const char *name) {
    static thread_local char buf[64];
    if (name == nullptr) return "";
    const char *fallback = strcmp(name, "wlan0") == 0 ? "lo" : name;
    ftx_device_ini_get("network", name, buf, sizeof(buf), fallback);
    return buf;
}

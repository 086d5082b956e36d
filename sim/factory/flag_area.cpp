#include "flag_area.h"

#include <dirent.h>
#include <errno.h>
#include <fcntl.h>
#include <signal.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <unistd.h>

#include <sys/stat.h>

#include <android/log.h>

#include <mutex>
#include <string>

#include "devfs.h"
#include "hw/lib_factory.h"

namespace ftxsim {
namespace {

const char kTag[] = "FTX_FLAGS";
const char kFolder[] = "/sim";
const char kPath[] = "/sim/testinfo_flags.bin";
const char kTmpPrefix[] = "testinfo_flags.bin.";  // then the writer's PID and ".tmp"
std::mutex g_flagsLock;                           // held across every change of the area

// The last area read or written, with the identity of the file it came from. Every store
// renames a new file into place, so an unchanged inode and time mean unchanged bytes and a
// stat replaces the open and read on the command path.
struct FlagCache {
    std::mutex lock;
    bool valid = false;
    std::string path;
    ino_t ino = 0;
    struct timespec mtime = {0, 0};
    unsigned char bytes[FTX_TESTINFO_FLAGS_SIZE];
};
FlagCache g_cache;

bool same_file(const struct stat &st, const std::string &path) {
    return g_cache.valid && g_cache.path == path && g_cache.ino == st.st_ino &&
           g_cache.mtime.tv_sec == st.st_mtim.tv_sec && g_cache.mtime.tv_nsec == st.st_mtim.tv_nsec;
}

void remember(const struct stat &st, const std::string &path, const unsigned char *flags) {
    g_cache.valid = true;
    g_cache.path = path;
    g_cache.ino = st.st_ino;
    g_cache.mtime = st.st_mtim;
    memcpy(g_cache.bytes, flags, FTX_TESTINFO_FLAGS_SIZE);
}

std::string host_path() {
    char buf[4096];
    return dev_path(kPath, buf, sizeof(buf)) == 0 ? std::string(buf) : std::string();
}

bool write_all(int fd, const unsigned char *p, size_t n) {
    while (n > 0) {
        ssize_t w = write(fd, p, n);
        if (w < 0) return false;
        p += w;
        n -= static_cast<size_t>(w);
    }
    return true;
}

int store_failed(const char *step, const char *path, int err) {
    __android_log_print(ANDROID_LOG_ERROR, kTag, "cannot store the flag area: %s %s: %s", step,
                        path, strerror(err));
    return -1;
}

// Caller holds g_flagsLock.
int store_locked(const unsigned char *flags) {
    dev_mkdir(kFolder, 0755);
    char tmp[64];
    snprintf(tmp, sizeof(tmp), "%s.%d.tmp", kPath, static_cast<int>(getpid()));
    int fd = dev_open(tmp, O_WRONLY | O_CREAT | O_TRUNC, 0644);
    if (fd < 0) return store_failed("create", tmp, errno);
    int err = 0;
    if (!write_all(fd, flags, FTX_TESTINFO_FLAGS_SIZE) || fsync(fd) != 0) err = errno;
    if (close(fd) != 0 && err == 0) err = errno;
    if (err == 0 && dev_rename(tmp, kPath) != 0) err = errno;
    if (err != 0) {
        dev_unlink(tmp);
        return store_failed("write", kPath, err);
    }
    int dir = dev_open(kFolder, O_RDONLY | O_DIRECTORY);
    if (dir >= 0) {
        fsync(dir);
        close(dir);
    }
    std::string path = host_path();
    struct stat st;
    std::lock_guard<std::mutex> lock(g_cache.lock);
    if (!path.empty() && stat(path.c_str(), &st) == 0) {
        remember(st, path, flags);
    } else {
        g_cache.valid = false;
    }
    return 0;
}

// The PID of a temporary's name, or 0 when the name is not one of ours.
pid_t tmp_owner(const char *name) {
    size_t prefix = sizeof(kTmpPrefix) - 1;
    if (strncmp(name, kTmpPrefix, prefix) != 0) return 0;
    char *end = nullptr;
    long pid = strtol(name + prefix, &end, 10);
    if (end == name + prefix || strcmp(end, ".tmp") != 0 || pid <= 0) return 0;
    return static_cast<pid_t>(pid);
}

}  // namespace

void flags_load(unsigned char *flags) {
    memset(flags, 0, FTX_TESTINFO_FLAGS_SIZE);
    std::string path = host_path();
    std::lock_guard<std::mutex> lock(g_cache.lock);
    struct stat st;
    if (path.empty() || stat(path.c_str(), &st) != 0) {
        g_cache.valid = false;
        return;
    }
    if (same_file(st, path)) {
        memcpy(flags, g_cache.bytes, FTX_TESTINFO_FLAGS_SIZE);
        return;
    }
    FILE *f = fopen(path.c_str(), "rb");
    if (f == nullptr) return;
    size_t n = fread(flags, 1, FTX_TESTINFO_FLAGS_SIZE, f);
    struct stat after;
    bool stable = fstat(fileno(f), &after) == 0 && after.st_ino == st.st_ino;
    fclose(f);
    if (n == FTX_TESTINFO_FLAGS_SIZE && stable) remember(after, path, flags);
}

int flags_store(const unsigned char *flags) {
    std::lock_guard<std::mutex> lock(g_flagsLock);
    return store_locked(flags);
}

int flags_update(int index, unsigned char mask, unsigned char bits) {
    if (index < 0 || index >= FTX_TESTINFO_FLAGS_SIZE) return -1;
    std::lock_guard<std::mutex> lock(g_flagsLock);
    unsigned char flags[FTX_TESTINFO_FLAGS_SIZE];
    flags_load(flags);
    flags[index] = static_cast<unsigned char>((flags[index] & ~mask) | (bits & mask));
    return store_locked(flags);
}

int flags_write_byte(int index, unsigned char value) {
    return flags_update(index, 0xFF, value);
}

int flags_clear_stale() {
    DIR *dir = dev_opendir(kFolder);
    if (dir == nullptr) return 0;
    int removed = 0;
    std::lock_guard<std::mutex> lock(g_flagsLock);
    while (struct dirent *e = readdir(dir)) {
        pid_t owner = tmp_owner(e->d_name);
        if (owner == 0) continue;
        // Our own is left from an earlier life of this PID; a live other may be writing.
        if (owner != getpid() && (kill(owner, 0) == 0 || errno == EPERM)) continue;
        std::string path = std::string(kFolder) + "/" + e->d_name;
        if (dev_unlink(path.c_str()) == 0) {
            removed++;
            __android_log_print(ANDROID_LOG_WARN, kTag, "removed %s left by an ended writer",
                                path.c_str());
        }
    }
    closedir(dir);
    return removed;
}

}  // namespace ftxsim

#include "flag_area.h"

#include <fcntl.h>
#include <stdio.h>
#include <string.h>
#include <unistd.h>

#include <mutex>

#include "devfs.h"
#include "hw/lib_factory.h"

namespace ftxsim {
namespace {

const char kFolder[] = "/sim";
const char kPath[] = "/sim/testinfo_flags.bin";
std::mutex g_flagsLock;

bool write_all(int fd, const unsigned char *p, size_t n) {
    while (n > 0) {
        ssize_t w = write(fd, p, n);
        if (w < 0) return false;
        p += w;
        n -= static_cast<size_t>(w);
    }
    return true;
}

}  // namespace

void flags_load(unsigned char *flags) {
    memset(flags, 0, FTX_TESTINFO_FLAGS_SIZE);
    FILE *f = dev_fopen(kPath, "rb");
    if (f == nullptr) return;
    size_t n = fread(flags, 1, FTX_TESTINFO_FLAGS_SIZE, f);
    (void)n;
    fclose(f);
}

int flags_store(const unsigned char *flags) {
    dev_mkdir(kFolder, 0755);
    char tmp[64];
    snprintf(tmp, sizeof(tmp), "%s.%d.tmp", kPath, static_cast<int>(getpid()));
    int fd = dev_open(tmp, O_WRONLY | O_CREAT | O_TRUNC, 0644);
    if (fd < 0) return -1;
    bool ok = write_all(fd, flags, FTX_TESTINFO_FLAGS_SIZE) && fsync(fd) == 0;
    close(fd);
    if (!ok || dev_rename(tmp, kPath) != 0) {
        dev_unlink(tmp);
        return -1;
    }
    int dir = dev_open(kFolder, O_RDONLY | O_DIRECTORY);
    if (dir >= 0) {
        fsync(dir);
        close(dir);
    }
    return 0;
}

int flags_write_byte(int index, unsigned char value) {
    if (index < 0 || index >= FTX_TESTINFO_FLAGS_SIZE) return -1;
    std::lock_guard<std::mutex> lock(g_flagsLock);
    unsigned char flags[FTX_TESTINFO_FLAGS_SIZE];
    flags_load(flags);
    flags[index] = value;
    return flags_store(flags);
}

}  // namespace ftxsim

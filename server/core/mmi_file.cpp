#include "core/mmi_file.h"

#include <fcntl.h>
#include <stdio.h>
#include <string.h>
#include <unistd.h>

#include "devfs.h"

namespace {

// The folder of path (up to its last '/'), so that the rename itself reaches storage;
// best effort.
void sync_folder_of(const char *path) {
    const char *slash = strrchr(path, '/');
    if (slash == nullptr) return;
    char dir[512];
    const size_t n = static_cast<size_t>(slash - path);
    if (n == 0 || n >= sizeof dir) return;
    memcpy(dir, path, n);
    dir[n] = '\0';
    const int fd = dev_open(dir, O_RDONLY | O_DIRECTORY);
    if (fd < 0) return;
    fsync(fd);
    close(fd);
}

}  // namespace

int mmi_file_replace(const char *path, const void *data, size_t len) {
    char tmp[512];
    if (snprintf(tmp, sizeof tmp, "%s.tmp", path) >= static_cast<int>(sizeof tmp)) return -1;
    FILE *fp = dev_fopen(tmp, "wb");
    if (fp == nullptr) return -1;
    bool ok = fwrite(data, 1, len, fp) == len && fflush(fp) == 0 && fsync(fileno(fp)) == 0;
    ok = fclose(fp) == 0 && ok;
    if (!ok || dev_rename(tmp, path) != 0) {
        dev_unlink(tmp);
        return -1;
    }
    sync_folder_of(path);
    return 0;
}

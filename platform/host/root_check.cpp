// The start-up check of the device root: results, settings and the log are all files of the
// root, and a root that takes no writes would drop every one of them without a word.
#include "root_check.h"

#include <errno.h>
#include <fcntl.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <sys/stat.h>
#include <unistd.h>

#include <string>

#include "devfs.h"

namespace ftxhost {
namespace {

// The folders the handset and its libraries write, when the image has them.
const char *const kWrittenFolders[] = {"", "/etc", "/sim", "/log", "/data", "/cache"};

// Creates, writes and removes one probe file in dir; 0 or an errno.
int probe(const std::string &dir) {
    std::string file = dir + "/.ftx-write-probe." + std::to_string(getpid());
    int fd = open(file.c_str(), O_WRONLY | O_CREAT | O_TRUNC | O_CLOEXEC, 0600);
    if (fd < 0) return errno;
    int err = write(fd, "x", 1) == 1 ? 0 : (errno != 0 ? errno : EIO);
    if (close(fd) != 0 && err == 0) err = errno;
    unlink(file.c_str());
    return err;
}

}  // namespace

int root_writable(char *why, size_t size) {
    std::string root = dev_root();
    if (mkdir(root.c_str(), 0755) != 0 && errno != EEXIST) {
        snprintf(why, size, "%s: %s", root.c_str(), strerror(errno));
        return -1;
    }
    for (const char *sub : kWrittenFolders) {
        std::string dir = root + sub;
        struct stat st;
        if (*sub != '\0' && (stat(dir.c_str(), &st) != 0 || !S_ISDIR(st.st_mode))) continue;
        int err = probe(dir);
        if (err != 0) {
            snprintf(why, size, "%s: %s", dir.c_str(), strerror(err));
            return -1;
        }
    }
    return 0;
}

void require_writable_root() {
    char why[4200];
    if (root_writable(why, sizeof(why)) == 0) return;
    fprintf(stderr,
            "ftx: the device root %s cannot be written (%s); results and settings would be "
            "lost, so the handset does not start\n",
            dev_root(), why);
    exit(1);
}

}  // namespace ftxhost

// The "FileOptMoudle" file operations. Every path stays inside the device root: relative
// paths, ".." parts and symbolic links that lead out of the root are refused.
#include "fileopt.h"

#include <ctype.h>
#include <errno.h>
#include <fcntl.h>
#include <limits.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <sys/stat.h>
#include <unistd.h>

#include "android/log.h"
#include "channel.h"
#include "devfs.h"
#include "ftx_host.h"
#include "hw/libdvk_ncoredevice.h"
#include "sim_core.h"

namespace ftxsim {
namespace {

const char kTag[] = "DVK_FILEOPT";
const size_t kMaxPath = 1024;

bool under(const std::string &path, const std::string &folder) {
    return path.compare(0, folder.size(), folder) == 0 &&
           (path.size() == folder.size() || path[folder.size()] == '/');
}

bool inside_root(const std::string &real) {
    char root[PATH_MAX];
    return realpath(dev_root(), root) != nullptr && under(real, root);
}

// The real path of path's folder must be inside the root, and so must path itself when it
// exists and is a symbolic link.
bool resolves_inside(const std::string &host, std::string *reason) {
    std::string folder = host.substr(0, host.find_last_of('/'));
    char real[PATH_MAX];
    if (realpath(folder.empty() ? "/" : folder.c_str(), real) == nullptr) {
        *reason = "no such folder";
        return false;
    }
    if (!inside_root(real)) {
        *reason = "path leaves the device root";
        return false;
    }
    struct stat st;
    if (lstat(host.c_str(), &st) == 0 && S_ISLNK(st.st_mode)) {
        if (realpath(host.c_str(), real) == nullptr || !inside_root(real)) {
            *reason = "path leaves the device root";
            return false;
        }
    }
    return true;
}

int fail(char *reply, size_t size, const std::string &path, const std::string &reason) {
    if (reply != nullptr && size > 0) snprintf(reply, size, "ERROR %s", reason.c_str());
    __android_log_print(ANDROID_LOG_ERROR, kTag, "%s: %s", path.c_str(), reason.c_str());
    return 0;
}

// Splits "a,b" at the first comma; false when there is none.
bool cut(const std::string &s, std::string *a, std::string *b) {
    size_t comma = s.find(',');
    if (comma == std::string::npos) return false;
    *a = s.substr(0, comma);
    *b = s.substr(comma + 1);
    return true;
}

bool to_size(const std::string &s, size_t *v) {
    if (s.empty() || s.size() > 12 || s.find_first_not_of("0123456789") != std::string::npos) {
        return false;
    }
    *v = static_cast<size_t>(strtoull(s.c_str(), nullptr, 10));
    return true;
}

// Where host's folder really is: its deepest existing part resolved through every link, the
// rest as written (the caller has refused ".." parts).
std::string landing(const std::string &folder) {
    std::string path = folder, rest;
    while (true) {
        char real[PATH_MAX];
        if (realpath(path.c_str(), real) != nullptr) return real + rest;
        size_t slash = path.rfind('/');
        if (slash == std::string::npos || slash == 0) return "/" + path.substr(slash + 1) + rest;
        rest = path.substr(slash) + rest;
        path = path.substr(0, slash);
    }
}

// The checks that come before anything is made or changed for a write or a remove: the
// path lands inside the root, and not on the system partition while it is read-only.
bool may_change(const std::string &host, std::string *where, std::string *reason) {
    char root[PATH_MAX];
    if (realpath(dev_root(), root) == nullptr) {
        *reason = "no device root";
        return false;
    }
    // The last part itself is not followed: a write never goes through a link, and a remove
    // takes the link away, not what it points to.
    size_t slash = host.rfind('/');
    *where = landing(host.substr(0, slash)) + host.substr(slash);
    if (!under(*where, root)) {
        *reason = "path leaves the device root";
        return false;
    }
    if (under(*where, std::string(root) + "/system") && !ftx_host_system_writable()) {
        *reason = "read-only file system";
        return false;
    }
    return true;
}

// Makes the missing folders above where, a path that may_change accepted.
bool make_parents(const std::string &where) {
    size_t slash = where.rfind('/');
    for (size_t i = 1; i <= slash; ++i) {
        if (where[i] != '/') continue;
        if (mkdir(where.substr(0, i).c_str(), 0755) != 0 && errno != EEXIST) return false;
    }
    return true;
}

}  // namespace

bool fileopt_confine(const std::string &path, std::string *host, std::string *reason) {
    if (path.empty() || path[0] != '/') {
        *reason = "path must be an absolute device path";
        return false;
    }
    if (path.size() > kMaxPath) {
        *reason = "path too long";
        return false;
    }
    for (unsigned char c : path) {
        if (c < 0x20 || c == 0x7f) {
            *reason = "control character in path";
            return false;
        }
    }
    size_t start = 0;
    while (start <= path.size()) {
        size_t end = path.find('/', start);
        if (end == std::string::npos) end = path.size();
        if (path.compare(start, end - start, "..") == 0) {
            *reason = "\"..\" is not allowed";
            return false;
        }
        start = end + 1;
    }
    char out[PATH_MAX];
    if (dev_path(path.c_str(), out, sizeof(out)) != 0) {
        *reason = "path too long";
        return false;
    }
    *host = out;
    if (host->size() <= strlen(dev_root()) + 1) {
        *reason = "not a file path";
        return false;
    }
    return resolves_inside(*host, reason);
}

bool fileopt_unescape(const std::string &in, std::string *out) {
    out->clear();
    for (size_t i = 0; i < in.size(); ++i) {
        if (in[i] != '\\') {
            out->push_back(in[i]);
            continue;
        }
        if (++i >= in.size()) return false;
        switch (in[i]) {
            case 'n':
                out->push_back('\n');
                break;
            case 'r':
                out->push_back('\r');
                break;
            case 't':
                out->push_back('\t');
                break;
            case '\\':
                out->push_back('\\');
                break;
            case 'x': {
                if (i + 2 >= in.size()) return false;
                char hex[3] = {in[i + 1], in[i + 2], '\0'};
                if (!isxdigit(static_cast<unsigned char>(hex[0])) ||
                    !isxdigit(static_cast<unsigned char>(hex[1]))) {
                    return false;
                }
                out->push_back(static_cast<char>(strtol(hex, nullptr, 16)));
                i += 2;
                break;
            }
            default:
                return false;
        }
    }
    return true;
}

int fileopt_read(const std::string &parm, char *reply, size_t size, size_t *length) {
    *length = 0;
    std::string path = parm, rest, host, reason;
    size_t offset = 0, want = SIZE_MAX;
    std::string off, len;
    bool ranged = cut(parm, &path, &rest);
    if (ranged && !cut(rest, &off, &len)) off = rest;
    int ok = 0;
    if (ranged && (!to_size(off, &offset) || (!len.empty() && !to_size(len, &want)))) {
        ok = fail(reply, size, parm, "expected PATH[,OFFSET[,LENGTH]]");
    } else if (!fileopt_confine(path, &host, &reason)) {
        ok = fail(reply, size, path, reason);
    } else {
        // Non-blocking, so a FIFO cannot stall the channel; only regular files are read.
        int fd = open(host.c_str(), O_RDONLY | O_CLOEXEC | O_NOFOLLOW | O_NONBLOCK);
        struct stat st;
        if (fd < 0 && errno == ELOOP) {
            // A link inside the root: follow it, it was checked above.
            fd = open(host.c_str(), O_RDONLY | O_CLOEXEC | O_NONBLOCK);
        }
        if (fd < 0) {
            ok = fail(reply, size, path, strerror(errno));
        } else if (fstat(fd, &st) != 0 || !S_ISREG(st.st_mode)) {
            ok = fail(reply, size, path, "not a regular file");
            close(fd);
        } else {
            size_t room = size > 2 ? size - 2 : 0;  // "*" and a NUL
            if (want > room) want = room;
            reply[0] = '*';
            ssize_t n = pread(fd, reply + 1, want, static_cast<off_t>(offset));
            close(fd);
            if (n < 0) {
                ok = fail(reply, size, path, strerror(errno));
            } else {
                reply[1 + n] = '\0';
                *length = 1 + static_cast<size_t>(n);
                return 1;
            }
        }
    }
    *length = strlen(reply);
    return ok;
}

int fileopt_write(const std::string &parm, char *reply, size_t size) {
    std::string path, data, bytes, host, reason;
    if (!cut(parm, &path, &data)) return fail(reply, size, parm, "expected PATH,DATA");
    bool append = !path.empty() && path[0] == '+';
    if (append) path.erase(0, 1);
    if (!fileopt_unescape(data, &bytes)) return fail(reply, size, path, "bad escape in data");
    std::string where;
    bool confined = fileopt_confine(path, &host, &reason);
    // The folder may be missing: it is made only where the path really lands, and only
    // after that place was checked.
    if (!confined && reason != "no such folder") return fail(reply, size, path, reason);
    if (!may_change(host, &where, &reason)) return fail(reply, size, path, reason);
    if (!confined) {
        if (!make_parents(where)) return fail(reply, size, path, strerror(errno));
        if (!fileopt_confine(path, &host, &reason)) return fail(reply, size, path, reason);
    }
    struct stat st;
    if (stat(host.c_str(), &st) == 0 && !S_ISREG(st.st_mode)) {
        return fail(reply, size, path, "not a regular file");
    }
    int flags =
        O_WRONLY | O_CREAT | O_CLOEXEC | O_NOFOLLOW | O_NONBLOCK | (append ? O_APPEND : O_TRUNC);
    int fd = open(host.c_str(), flags, 0644);
    if (fd < 0 && errno == ELOOP) {
        return fail(reply, size, path, "will not write through a symbolic link");
    }
    if (fd < 0) return fail(reply, size, path, strerror(errno));
    size_t done = 0;
    while (done < bytes.size()) {
        ssize_t w = write(fd, bytes.data() + done, bytes.size() - done);
        if (w < 0) {
            close(fd);
            return fail(reply, size, path, strerror(errno));
        }
        done += static_cast<size_t>(w);
    }
    fsync(fd);
    close(fd);
    if (reply != nullptr && size > 0) snprintf(reply, size, "*%zu", done);
    return 1;
}

int fileopt_remove(const std::string &parm, char *reply, size_t size) {
    std::string host, reason;
    if (!fileopt_confine(parm, &host, &reason)) return fail(reply, size, parm, reason);
    std::string where;
    if (!may_change(host, &where, &reason)) return fail(reply, size, parm, reason);
    struct stat st;
    if (lstat(host.c_str(), &st) != 0) return fail(reply, size, parm, strerror(errno));
    int rc = S_ISDIR(st.st_mode) ? rmdir(host.c_str()) : unlink(host.c_str());
    if (rc != 0) return fail(reply, size, parm, strerror(errno));
    if (reply != nullptr && size > 0) snprintf(reply, size, "*removed");
    return 1;
}

}  // namespace ftxsim

using namespace ftxsim;

namespace {

std::string parm_text(const char *parm, int len) {
    if (parm == nullptr || len <= 0) return "";
    return std::string(parm, strnlen(parm, static_cast<size_t>(len)));
}

// Read and write answer into the reply of the command being served; outside a command
// their answer only reaches the log.
int answer_in_channel(int (*op)(const std::string &, char *, size_t, size_t *),
                      const std::string &parm) {
    ChannelReply *r = channel_current_reply();
    char local[256];
    char *buf = r != nullptr ? r->buf : local;
    size_t size = r != nullptr ? r->size : sizeof(local);
    size_t length = 0;
    int ok = op(parm, buf, size, &length);
    if (r != nullptr) r->length = static_cast<long>(length);
    return ok;
}

int write_op(const std::string &parm, char *reply, size_t size, size_t *length) {
    int ok = fileopt_write(parm, reply, size);
    *length = strlen(reply);
    return ok;
}

}  // namespace

extern "C" int mmi_AutoTest_FileOpt_Read(const char *parm, int parmLen) {
    std::string p = parm_text(parm, parmLen);
    call("mmi_AutoTest_FileOpt_Read", 0, "%s", p.c_str());
    return answer_in_channel(fileopt_read, p);
}

extern "C" int mmi_AutoTest_FileOpt_Write(const char *parm, int parmLen) {
    std::string p = parm_text(parm, parmLen);
    call("mmi_AutoTest_FileOpt_Write", 0, "%s", p.c_str());
    return answer_in_channel(write_op, p);
}

extern "C" int mmi_AutoTest_FileOpt_Remove(const char *parm, int parmLen, char *reply,
                                           unsigned int replySize) {
    std::string p = parm_text(parm, parmLen);
    call("mmi_AutoTest_FileOpt_Remove", 0, "%s", p.c_str());
    char local[256];
    if (reply == nullptr || replySize == 0) return fileopt_remove(p, local, sizeof(local));
    return fileopt_remove(p, reply, replySize);
}

#include "wifi_link.h"

#include <errno.h>
#include <fcntl.h>
#include <stdio.h>
#include <unistd.h>

#include <atomic>

#include "kv_file.h"

namespace ftxhost {

pid_t wifi_supplicant_pid(const std::string &root) {
    int fd = open((root + kWifiPidFile).c_str(), O_RDONLY | O_CLOEXEC);
    if (fd < 0) return 0;
    struct flock lk = {};
    lk.l_type = F_WRLCK;
    lk.l_whence = SEEK_SET;
    // Asks who holds the lock without taking it (this process holds none on the file, so
    // closing it releases nothing).
    int rc = fcntl(fd, F_GETLK, &lk);
    close(fd);
    return rc == 0 && lk.l_type != F_UNLCK ? lk.l_pid : 0;
}

bool wifi_supplicant_running(const std::string &root) {
    return wifi_supplicant_pid(root) > 0;
}

std::map<std::string, std::string> wifi_read_link(const std::string &root) {
    return read_kv_file((root + kWifiLinkFile).c_str(), false);
}

int wifi_write_file(const std::string &hostPath, const std::map<std::string, std::string> &kv) {
    std::string text;
    for (const auto &[key, value] : kv)
        text += key + "=" + value + "\n";
    static std::atomic<unsigned> s_count{0};
    const std::string temp =
        hostPath + ".tmp." + std::to_string(getpid()) + "." + std::to_string(++s_count);
    int fd = open(temp.c_str(), O_WRONLY | O_CREAT | O_TRUNC | O_CLOEXEC, 0644);
    if (fd < 0) return -1;
    bool ok = write(fd, text.data(), text.size()) == static_cast<ssize_t>(text.size());
    ok = fsync(fd) == 0 && ok;
    ok = close(fd) == 0 && ok;
    if (!ok || rename(temp.c_str(), hostPath.c_str()) != 0) {
        unlink(temp.c_str());
        return -1;
    }
    return 0;
}

std::string wifi_escape(const std::string &text) {
    static const char kHex[] = "0123456789ABCDEF";
    std::string out;
    for (unsigned char c : text) {
        if (c > ' ' && c < 0x7F && c != '%') {
            out += static_cast<char>(c);
        } else {
            out += '%';
            out += kHex[c >> 4];
            out += kHex[c & 15];
        }
    }
    return out;
}

std::string wifi_unescape(const std::string &value) {
    auto nibble = [](char c) {
        if (c >= '0' && c <= '9') return c - '0';
        if (c >= 'A' && c <= 'F') return c - 'A' + 10;
        if (c >= 'a' && c <= 'f') return c - 'a' + 10;
        return -1;
    };
    std::string out;
    for (size_t i = 0; i < value.size(); i++) {
        if (value[i] == '%' && i + 2 < value.size() && nibble(value[i + 1]) >= 0 &&
            nibble(value[i + 2]) >= 0) {
            out += static_cast<char>(nibble(value[i + 1]) * 16 + nibble(value[i + 2]));
            i += 2;
        } else {
            out += value[i];
        }
    }
    return out;
}

}  // namespace ftxhost

// Rewriting one key of the main configuration (the end of an "mmi_flag" run and the PC's
// "ConfigMoudle testItem write"), and making the partition that holds it writable.
#include <stdio.h>
#include <string.h>
#include <sys/mount.h>
#include <unistd.h>

#include <mutex>
#include <string>

#include <android/log.h>

#include "core/mmi_file.h"
#include "devfs.h"
#include "core/ftx_config.h"
#include "core/mmi_autotest_config.h"
#include "tp_os.h"

#define CW_DEBUG(...) __android_log_print(ANDROID_LOG_DEBUG, "FTX_CONFIG", __VA_ARGS__)
#define CW_ERROR(...) __android_log_print(ANDROID_LOG_ERROR, "FTX_CONFIG", __VA_ARGS__)

namespace {

// The configuration is a few kilobytes; the limit only bounds the memory of a rewrite. A
// larger file is refused whole rather than written back cut.
const size_t kMaxConfigSize = 16u << 20;
const char kTmpFile[] = FTX_MAIN_CONFIG_FILE ".tmp";

// One rewrite at a time: the end of a run and the PC may both change a key, and each
// rewrite reads what the last one wrote and goes through the same temporary.
std::mutex s_writeLock;

std::string trimmed(const std::string &s) {
    size_t b = s.find_first_not_of(" \t");
    if (b == std::string::npos) return "";
    size_t e = s.find_last_not_of(" \t\r\n");
    return s.substr(b, e - b + 1);
}

// Texts that would change the file's structure if written into a line.
bool safe_name(const char *s) {
    return s[0] != '\0' && strpbrk(s, "[]=\r\n#,") == nullptr;
}

bool safe_value(const char *s) {
    return strpbrk(s, "\r\n") == nullptr;
}

}  // namespace

int mmi_config_split_parm(const char *parm, char *domain, char *key, char *value) {
    if (!parm) return -1;
    const char *c1 = strchr(parm, ',');
    if (!c1) return -1;
    const char *c2 = strchr(c1 + 1, ',');
    if (!c2) return -1;
    size_t dlen = (size_t)(c1 - parm), klen = (size_t)(c2 - c1 - 1);
    if (dlen >= MMI_CFG_NAME_SIZE || klen >= MMI_CFG_NAME_SIZE ||
        strlen(c2 + 1) >= MMI_CFG_NAME_SIZE) {
        return -1;
    }
    memcpy(domain, parm, dlen);
    domain[dlen] = '\0';
    memcpy(key, c1 + 1, klen);
    key[klen] = '\0';
    tp_os_strlcpy(value, c2 + 1, MMI_CFG_NAME_SIZE);
    // A value is one line; the PC may send a trailing line end.
    size_t vlen = strlen(value);
    while (vlen > 0 && (value[vlen - 1] == '\r' || value[vlen - 1] == '\n'))
        value[--vlen] = '\0';
    if (!safe_name(domain) || !safe_name(key) || !safe_value(value)) return -1;
    return 0;
}

int mmi_config_set_value(const std::string &in, const char *domain, const char *key,
                         const char *value, std::string *out) {
    if (!safe_name(domain) || !safe_name(key) || !safe_value(value)) return -1;
    // The files are written with CR LF; a file without any CR keeps bare LF.
    const char *eol = (in.empty() || in.find("\r\n") != std::string::npos) ? "\r\n" : "\n";
    const std::string entry = std::string(key) + "=" + value + eol;
    out->clear();
    out->reserve(in.size() + entry.size() + 8);

    bool inDomain = false, done = false;
    size_t pos = 0;
    while (pos < in.size()) {
        size_t nl = in.find('\n', pos);
        size_t end = nl == std::string::npos ? in.size() : nl + 1;
        std::string line = in.substr(pos, end - pos);
        pos = end;
        if (!done && line[0] == '[') {
            if (inDomain) {
                // The key was missing: it goes at the end of its domain.
                out->append(entry);
                done = true;
            } else {
                size_t rb = line.find(']');
                inDomain = rb != std::string::npos && line.compare(1, rb - 1, domain) == 0 &&
                           strlen(domain) == rb - 1;
            }
        } else if (!done && inDomain && line[0] != '#') {
            size_t eq = line.find('=');
            if (eq != std::string::npos && trimmed(line.substr(0, eq)) == key) {
                bool crlf = line.size() >= 2 && line.compare(line.size() - 2, 2, "\r\n") == 0;
                bool lf = !crlf && line.back() == '\n';
                line = std::string(key) + "=" + value + (crlf ? "\r\n" : lf ? "\n" : "");
                done = true;
            }
        }
        out->append(line);
    }
    if (!done) {
        if (!out->empty() && out->back() != '\n') out->append(eol);
        if (!inDomain) out->append(std::string("[") + domain + "]" + eol);
        out->append(entry);
    }
    return 0;
}

int remount_system_partition(void) {
    int rc =
        dev_mount("/dev/block/bootdevice/by-name/system", "/system", "ext4", MS_REMOUNT, nullptr);
    if (rc != 0) CW_ERROR("%s remount /system fail", __func__);
    return rc;
}

int mmi_AutoTest_Modify_ConfigFile(const char *parm) {
    CW_DEBUG("%s begin,parm=%s", __func__, parm ? parm : "");
    char domain[MMI_CFG_NAME_SIZE], key[MMI_CFG_NAME_SIZE], value[MMI_CFG_NAME_SIZE];
    if (mmi_config_split_parm(parm, domain, key, value) != 0) {
        CW_ERROR("%s bad parameter", __func__);
        return 0;
    }
    remount_system_partition();
    std::lock_guard<std::mutex> lock(s_writeLock);

    FILE *fp = dev_fopen(FTX_MAIN_CONFIG_FILE, "rb");
    if (!fp) {
        CW_ERROR("%s open %s fail.", __func__, FTX_MAIN_CONFIG_FILE);
        return 0;
    }
    std::string in;
    char buf[4096];
    size_t n;
    while (in.size() <= kMaxConfigSize && (n = fread(buf, 1, sizeof(buf), fp)) > 0) {
        in.append(buf, n);
    }
    bool readError = ferror(fp) != 0;
    fclose(fp);
    if (readError || in.size() > kMaxConfigSize) {
        CW_ERROR("%s %s %s: left unchanged", __func__, FTX_MAIN_CONFIG_FILE,
                 readError ? "cannot be read" : "is over 16 MB");
        return 0;
    }

    std::string out;
    if (mmi_config_set_value(in, domain, key, value, &out) != 0) return 0;

    // Written beside and renamed over, so a power cut leaves the old or the new file.
    if (mmi_file_replace(FTX_MAIN_CONFIG_FILE, out.data(), out.size()) != 0) {
        CW_ERROR("%s write %s fail.", __func__, FTX_MAIN_CONFIG_FILE);
        return 0;
    }
    CW_DEBUG("%s %s,%s=%s", __func__, domain, key, value);
    return 1;
}

int mmi_config_clear_stale_temporary(void) {
    std::lock_guard<std::mutex> lock(s_writeLock);
    if (dev_unlink(kTmpFile) != 0) return 0;
    __android_log_print(ANDROID_LOG_WARN, "FTX_CONFIG", "%s removed %s left by a rewrite cut short",
                        __func__, kTmpFile);
    return 1;
}

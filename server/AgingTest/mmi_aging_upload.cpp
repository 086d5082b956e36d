// The aging record's outbox (one file per record, written atomically) and its upload over
// HTTP. Record names are "record_<sequence>_<epoch ms>.json": the sequence follows the
// highest one in the folder, so the names sort in the order the records were kept even
// when the handset's clock moves back across a reboot.
#include "AgingTest/mmi_aging_upload.h"

#include <ctype.h>
#include <dirent.h>
#include <fcntl.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <sys/stat.h>
#include <time.h>
#include <unistd.h>

#include <algorithm>
#include <mutex>
#include <string>
#include <vector>

#include <android/log.h>
#include <curl/curl.h>

#include "core/mmi_file.h"
#include "devfs.h"
#include "ftx_log.h"

#define AGING_TAG "AgingTest"
#define LOGD(...) __android_log_print(ANDROID_LOG_DEBUG, AGING_TAG, __VA_ARGS__)
#define LOGI(...) __android_log_print(ANDROID_LOG_INFO, AGING_TAG, __VA_ARGS__)
#define LOGE(...) __android_log_print(ANDROID_LOG_ERROR, AGING_TAG, __VA_ARGS__)

namespace {

const char kPrefix[] = "record_";
const char kSuffix[] = ".json";
const char kTempSuffix[] = ".json.tmp";
const char kPath[] = "/aging/record";
const size_t kMaxRecord = 1024 * 1024;
const long kConnectTimeoutMs = 3000;
const long kRequestTimeoutMs = 10000;
const int kPathSize = 512;

// One keep at a time chooses the next sequence; one flush at a time sends, so that two
// flushes never send the same record twice.
std::mutex s_keepLock;
std::mutex s_flushLock;

bool ends_with(const char *s, const char *suffix) {
    size_t n = strlen(s), m = strlen(suffix);
    return n >= m && memcmp(s + n - m, suffix, m) == 0;
}

bool is_record(const char *name) {
    return strncmp(name, kPrefix, sizeof(kPrefix) - 1) == 0 && ends_with(name, kSuffix);
}

bool is_temp(const char *name) {
    return strncmp(name, kPrefix, sizeof(kPrefix) - 1) == 0 && ends_with(name, kTempSuffix);
}

// dir "/" name into out; false when it does not fit.
bool join(const char *dir, const char *name, char *out, size_t size) {
    size_t n = strlen(dir);
    const char *sep = n > 0 && dir[n - 1] == '/' ? "" : "/";
    int w = snprintf(out, size, "%s%s%s", dir, sep, name);
    return w > 0 && static_cast<size_t>(w) < size;
}

// The record names of dir, sorted (oldest first); empty when dir cannot be read.
std::vector<std::string> list_records(const char *dir) {
    std::vector<std::string> names;
    DIR *d = dev_opendir(dir);
    if (d == nullptr) return names;
    while (struct dirent *e = readdir(d)) {
        if (is_record(e->d_name)) names.emplace_back(e->d_name);
    }
    closedir(d);
    std::sort(names.begin(), names.end());
    return names;
}

// The sequence for a new record of dir: one past the highest kept. Removes the temporary
// files a keep interrupted by a power cut left (those records were never kept).
unsigned long next_sequence(const char *dir) {
    unsigned long highest = 0;
    DIR *d = dev_opendir(dir);
    if (d == nullptr) return 1;
    while (struct dirent *e = readdir(d)) {
        if (is_record(e->d_name)) {
            unsigned long seq = strtoul(e->d_name + sizeof(kPrefix) - 1, nullptr, 10);
            highest = std::max(highest, seq);
        } else if (is_temp(e->d_name)) {
            char path[kPathSize];
            if (join(dir, e->d_name, path, sizeof(path))) dev_unlink(path);
        }
    }
    closedir(d);
    return highest + 1;
}

long long epoch_ms() {
    struct timespec ts;
    clock_gettime(CLOCK_REALTIME, &ts);
    return static_cast<long long>(ts.tv_sec) * 1000 + ts.tv_nsec / 1000000;
}

bool is_directory(const char *dir) {
    struct stat st;
    return dev_stat(dir, &st) == 0 && S_ISDIR(st.st_mode);
}

// Makes the folder when missing; true when it is there.
bool make_folder(const char *dir) {
    if (is_directory(dir)) return true;
    mkdir_main(dir);
    return is_directory(dir);
}

bool read_record(const char *path, std::string *out) {
    FILE *fp = dev_fopen(path, "rb");
    if (fp == nullptr) return false;
    bool ok = false;
    if (fseek(fp, 0, SEEK_END) == 0) {
        long size = ftell(fp);
        if (size >= 0 && static_cast<size_t>(size) <= kMaxRecord && fseek(fp, 0, SEEK_SET) == 0) {
            out->resize(static_cast<size_t>(size));
            ok = fread(out->data(), 1, out->size(), fp) == out->size();
        }
    }
    fclose(fp);
    return ok;
}

// The endpoint as log text: at most its allowed length, unprintable bytes as '?'.
void printable(const char *text, char *out, size_t size) {
    size_t i = 0;
    for (; text[i] != '\0' && i + 1 < size; i++) {
        unsigned char c = static_cast<unsigned char>(text[i]);
        out[i] = c >= 0x20 && c < 0x7f ? static_cast<char>(c) : '?';
    }
    out[i] = '\0';
}

int refuse(const char *endpoint, const char *why) {
    char shown[MMI_AGING_ENDPOINT_MAX + 1];
    printable(endpoint, shown, sizeof(shown));
    LOGE("upload: endpoint \"%s\" refused: %s", shown, why);
    return -1;
}

bool host_char(char c) {
    return isalnum(static_cast<unsigned char>(c)) || c == '-' || c == '.';
}

bool v6_char(char c) {
    return isxdigit(static_cast<unsigned char>(c)) || c == ':' || c == '.';
}

bool curl_ready() {
    static std::once_flag once;
    static CURLcode status = CURLE_FAILED_INIT;
    std::call_once(once, [] { status = curl_global_init(CURL_GLOBAL_DEFAULT); });
    return status == CURLE_OK;
}

size_t discard(char *, size_t size, size_t count, void *) {
    return size * count;
}

// An easy handle set up for POSTing JSON to url (the body is set per record); null when
// libcurl cannot make one.
CURL *make_request(const char *url, curl_slist *headers, char *error) {
    CURL *curl = curl_easy_init();
    if (curl == nullptr) return nullptr;
    curl_easy_setopt(curl, CURLOPT_URL, url);
#if LIBCURL_VERSION_NUM >= 0x075500
    curl_easy_setopt(curl, CURLOPT_PROTOCOLS_STR, "http");
#else
    curl_easy_setopt(curl, CURLOPT_PROTOCOLS, static_cast<long>(CURLPROTO_HTTP));
#endif
    curl_easy_setopt(curl, CURLOPT_POST, 1L);
    curl_easy_setopt(curl, CURLOPT_HTTPHEADER, headers);
    curl_easy_setopt(curl, CURLOPT_NOSIGNAL, 1L);
    curl_easy_setopt(curl, CURLOPT_NOPROXY, "*");
    curl_easy_setopt(curl, CURLOPT_CONNECTTIMEOUT_MS, kConnectTimeoutMs);
    curl_easy_setopt(curl, CURLOPT_TIMEOUT_MS, kRequestTimeoutMs);
    curl_easy_setopt(curl, CURLOPT_WRITEFUNCTION, discard);
    curl_easy_setopt(curl, CURLOPT_ERRORBUFFER, error);
    return curl;
}

// POSTs body; 0 with the HTTP status in code, or -1 with the reason in why.
int post(CURL *curl, const std::string &body, const char *error, long *code, std::string *why) {
    curl_easy_setopt(curl, CURLOPT_POSTFIELDSIZE_LARGE, static_cast<curl_off_t>(body.size()));
    curl_easy_setopt(curl, CURLOPT_POSTFIELDS, body.data());
    CURLcode rc = curl_easy_perform(curl);
    if (rc != CURLE_OK) {
        *why = error[0] != '\0' ? error : curl_easy_strerror(rc);
        return -1;
    }
    curl_easy_getinfo(curl, CURLINFO_RESPONSE_CODE, code);
    return 0;
}

}  // namespace

int mmi_aging_upload_url(const char *endpoint, char *out, size_t size) {
    if (out != nullptr && size > 0) out[0] = '\0';
    if (endpoint == nullptr) return refuse("", "none configured");
    size_t len = strnlen(endpoint, MMI_AGING_ENDPOINT_MAX + 1);
    if (len == 0) return refuse(endpoint, "empty");
    if (len > MMI_AGING_ENDPOINT_MAX) return refuse(endpoint, "too long");
    const char *colon = static_cast<const char *>(memrchr(endpoint, ':', len));
    if (colon == nullptr) return refuse(endpoint, "no :port");
    size_t hostLen = static_cast<size_t>(colon - endpoint);
    if (hostLen == 0) return refuse(endpoint, "no address");
    if (endpoint[0] == '[') {
        if (hostLen < 3 || endpoint[hostLen - 1] != ']' ||
            !std::all_of(endpoint + 1, endpoint + hostLen - 1, v6_char))
            return refuse(endpoint, "bad address");
    } else if (!std::all_of(endpoint, colon, host_char)) {
        return refuse(endpoint, "bad address");
    }
    const char *digits = colon + 1;
    size_t digitLen = len - hostLen - 1;
    if (digitLen == 0 || digitLen > 5 ||
        !std::all_of(digits, digits + digitLen, [](char c) { return c >= '0' && c <= '9'; }))
        return refuse(endpoint, "bad port");
    unsigned long port = strtoul(digits, nullptr, 10);
    if (port < 1 || port > 65535) return refuse(endpoint, "port outside 1..65535");
    if (out == nullptr) return -1;
    int w =
        snprintf(out, size, "http://%.*s:%lu%s", static_cast<int>(hostLen), endpoint, port, kPath);
    if (w < 0 || static_cast<size_t>(w) >= size) {
        if (size > 0) out[0] = '\0';
        return -1;
    }
    return 0;
}

int mmi_aging_upload_keep(const char *dir, const char *json) {
    if (dir == nullptr || json == nullptr) return -1;
    size_t len = strlen(json);
    if (len > kMaxRecord) {
        LOGE("upload: record of %zu bytes refused (at most %zu)", len, kMaxRecord);
        return -1;
    }
    std::lock_guard<std::mutex> lock(s_keepLock);
    if (!make_folder(dir)) {
        LOGE("upload: cannot make the outbox %s", dir);
        return -1;
    }
    char name[64];
    snprintf(name, sizeof(name), "%s%010lu_%013lld%s", kPrefix, next_sequence(dir), epoch_ms(),
             kSuffix);
    char path[kPathSize];
    if (!join(dir, name, path, sizeof(path))) {
        LOGE("upload: outbox path too long: %s", dir);
        return -1;
    }
    // Written as NAME.tmp and renamed: a record is whole or absent, and a flush never sends
    // a neighbour (it does not end in the suffix).
    if (mmi_file_replace(path, json, len) != 0) {
        LOGE("upload: cannot write %s", path);
        return -1;
    }
    LOGD("upload: kept %s (%zu bytes)", name, len);
    return 0;
}

int mmi_aging_upload_pending(const char *dir) {
    if (dir == nullptr) return -1;
    return static_cast<int>(list_records(dir).size());
}

int mmi_aging_upload_flush(const char *dir, const char *endpoint) {
    char url[MMI_AGING_URL_SIZE];
    if (mmi_aging_upload_url(endpoint, url, sizeof(url)) != 0 || dir == nullptr) return -1;
    std::lock_guard<std::mutex> lock(s_flushLock);
    std::vector<std::string> names = list_records(dir);
    if (names.empty()) return 0;
    if (!curl_ready()) {
        LOGE("upload: %s failed: libcurl unavailable, %zu record(s) kept", url, names.size());
        return -1;
    }
    curl_slist *headers = curl_slist_append(nullptr, "Content-Type: application/json");
    // No "Expect: 100-continue" pause before larger bodies.
    curl_slist *more = headers != nullptr ? curl_slist_append(headers, "Expect:") : nullptr;
    char error[CURL_ERROR_SIZE] = {0};
    CURL *curl = more != nullptr ? make_request(url, more, error) : nullptr;
    if (curl == nullptr) {
        curl_slist_free_all(headers);
        LOGE("upload: %s failed: no request handle, %zu record(s) kept", url, names.size());
        return -1;
    }
    int sent = 0;
    std::string why;
    for (const std::string &name : names) {
        char path[kPathSize];
        std::string body;
        if (!join(dir, name.c_str(), path, sizeof(path)) || !read_record(path, &body)) {
            why = "cannot read " + name;
            break;
        }
        error[0] = '\0';
        long code = 0;
        if (post(curl, body, error, &code, &why) != 0) break;
        if (code < 200 || code > 299) {
            why = "HTTP " + std::to_string(code);
            break;
        }
        LOGI("upload: sent %s to %s (HTTP %ld)", name.c_str(), url, code);
        sent++;
        if (dev_unlink(path) != 0) {
            // It would go again with every later record: stop until the folder is fixed.
            why = "cannot delete " + name + " after sending it";
            break;
        }
    }
    curl_easy_cleanup(curl);
    curl_slist_free_all(headers);
    if (!why.empty()) {
        LOGE("upload: %s failed: %s, %d record(s) kept", url, why.c_str(),
             mmi_aging_upload_pending(dir));
        if (sent == 0) return -1;
    }
    return sent;
}

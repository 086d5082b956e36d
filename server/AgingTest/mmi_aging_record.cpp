#include "AgingTest/mmi_aging_record.h"

#include <stdarg.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <unistd.h>

#include "core/mmi_file.h"
#include "devfs.h"
#include "ftx_profile.h"
#include "tp_os.h"

namespace {

struct ItemNames {
    const char *name;
    const char *label;
};
const ItemNames kItems[AGING_ITEM_COUNT] = {
    {"wifi_detect", "aging_WifiDetect"},
    {"bt_detect", "aging_BtDetect"},
    {"fm_detect", "aging_FmDetect"},
    {"video", "aging_Video"},
    {"light", "aging_Light"},
    {"camera", "aging_Camera"},
    {"vibrator", "aging_Vibrator"},
    {"audio", "aging_Audio"},
    {"cpu", "aging_Cpu"},
    {"standby", "aging_Standby"},
    {"reboot", "aging_Reboot"},
};

const char kAging[] = "aging";
const char kCounts[] = "counts";
// The most cycles or steps a record may claim (a corrupted number is clamped to it).
const long long kMaxCount = 1000000000;

// Appends to out at *used; false when it did not fit.
bool append(char *out, size_t size, size_t *used, const char *fmt, ...)
    __attribute__((format(printf, 4, 5)));
bool append(char *out, size_t size, size_t *used, const char *fmt, ...) {
    if (*used >= size) return false;
    va_list ap;
    va_start(ap, fmt);
    const int n = vsnprintf(out + *used, size - *used, fmt, ap);
    va_end(ap);
    if (n < 0 || static_cast<size_t>(n) >= size - *used) return false;
    *used += static_cast<size_t>(n);
    return true;
}

// A value of key in section of the profile text, or false.
bool value_of(const char *text, const char *section, const char *key, char *out, size_t size) {
    int ss, se, ks, ke, vs, ve;
    if (parse_file(section, key, text, &ss, &se, &ks, &ke, &vs, &ve) != 1) return false;
    size_t len = ve >= vs ? static_cast<size_t>(ve - vs + 1) : 0;
    if (len >= size) len = size - 1;
    memcpy(out, text + vs, len);
    out[len] = '\0';
    return true;
}

long long clamp(long long v, long long lo, long long hi) {
    return v < lo ? lo : v > hi ? hi : v;
}

long long number_of(const char *text, const char *key, long long lo, long long hi) {
    char v[32];
    if (!value_of(text, kAging, key, v, sizeof v)) return lo;
    return clamp(strtoll(v, nullptr, 10), lo, hi);
}

// JSON string contents: quotes, backslashes and control characters escaped.
bool append_json_text(char *out, size_t size, size_t *used, const char *s) {
    for (; s != nullptr && *s != '\0'; s++) {
        const unsigned char c = static_cast<unsigned char>(*s);
        bool ok;
        if (c == '"' || c == '\\')
            ok = append(out, size, used, "\\%c", c);
        else if (c < 0x20)
            ok = append(out, size, used, "\\u%04x", c);
        else
            ok = append(out, size, used, "%c", c);
        if (!ok) return false;
    }
    return true;
}

}  // namespace

const char *mmi_aging_item_name(int item) {
    return item >= 0 && item < AGING_ITEM_COUNT ? kItems[item].name : "none";
}

const char *mmi_aging_item_label(int item) {
    return item >= 0 && item < AGING_ITEM_COUNT ? kItems[item].label : "aging_Title";
}

void mmi_aging_record_init(mmi_aging_record *r, int cycles, long long now) {
    memset(r, 0, sizeof *r);
    r->cycles = cycles < 1 ? 1 : cycles;
    r->startedAt = now;
}

void mmi_aging_record_count(mmi_aging_record *r, int item, int passed, const char *failure) {
    if (item < 0 || item >= AGING_ITEM_COUNT) return;
    if (passed) {
        r->counts[item].pass++;
        return;
    }
    r->counts[item].fail++;
    r->failures++;
    if (failure != nullptr) tp_os_strlcpy(r->lastFailure, failure, sizeof r->lastFailure);
}

int mmi_aging_record_format(const mmi_aging_record *r, char *out, size_t size) {
    size_t used = 0;
    // The failure text is one line: line ends would start a new entry.
    char failure[MMI_AGING_FAILURE_SIZE];
    tp_os_strlcpy(failure, r->lastFailure, sizeof failure);
    for (char *p = failure; *p != '\0'; p++)
        if (*p == '\r' || *p == '\n') *p = ' ';
    bool ok = append(out, size, &used,
                     "[%s]\ncycle=%d\ncycles=%d\nitem=%s\nstep=%d\nreboot_pending=%d\n"
                     "finished=%d\nstopped=%d\nstarted=%lld\nelapsed=%lld\nuploaded=%lld\n"
                     "failures=%d\nlast_failure=%s\n[%s]\n",
                     kAging, r->cycle, r->cycles, mmi_aging_item_name(r->item), r->step,
                     r->rebootPending, r->finished, r->stopped, r->startedAt, r->elapsed,
                     r->uploadedAt, r->failures, failure, kCounts);
    for (int i = 0; ok && i < AGING_ITEM_COUNT; i++)
        ok = append(out, size, &used, "%s=%d,%d\n", kItems[i].name, r->counts[i].pass,
                    r->counts[i].fail);
    return ok ? static_cast<int>(used) : -1;
}

int mmi_aging_record_save(const mmi_aging_record *r, const char *path) {
    char text[4096];
    const int len = mmi_aging_record_format(r, text, sizeof text);
    if (len < 0) return -1;
    return mmi_file_replace(path, text, static_cast<size_t>(len));
}

namespace {

// The text a record is read from: the profile reader wants it terminated.
thread_local char s_text[FTX_PROFILE_BUF_SIZE];

int parse_terminated(mmi_aging_record *r, const char *buf) {
    memset(r, 0, sizeof *r);
    char v[MMI_AGING_FAILURE_SIZE];
    if (!value_of(buf, kAging, "cycles", v, sizeof v)) return -1;
    r->cycles = static_cast<int>(number_of(buf, "cycles", 1, kMaxCount));
    r->cycle = static_cast<int>(number_of(buf, "cycle", 0, r->cycles));
    r->item = 0;
    if (value_of(buf, kAging, "item", v, sizeof v))
        for (int i = 0; i < AGING_ITEM_COUNT; i++)
            if (strcmp(v, kItems[i].name) == 0) r->item = i;
    r->step = static_cast<int>(number_of(buf, "step", 0, kMaxCount));
    r->rebootPending = static_cast<int>(number_of(buf, "reboot_pending", 0, 1));
    r->finished = static_cast<int>(number_of(buf, "finished", 0, 1));
    r->stopped = static_cast<int>(number_of(buf, "stopped", 0, 1));
    r->startedAt = number_of(buf, "started", 0, 1LL << 40);
    r->elapsed = number_of(buf, "elapsed", 0, 1LL << 40);
    r->uploadedAt = number_of(buf, "uploaded", 0, 1LL << 40);
    r->failures = static_cast<int>(number_of(buf, "failures", 0, kMaxCount));
    if (value_of(buf, kAging, "last_failure", v, sizeof v))
        tp_os_strlcpy(r->lastFailure, v, sizeof r->lastFailure);
    for (int i = 0; i < AGING_ITEM_COUNT; i++) {
        if (!value_of(buf, kCounts, kItems[i].name, v, sizeof v)) continue;
        char *end = nullptr;
        r->counts[i].pass = static_cast<int>(clamp(strtoll(v, &end, 10), 0, kMaxCount));
        if (end != nullptr && *end == ',')
            r->counts[i].fail =
                static_cast<int>(clamp(strtoll(end + 1, nullptr, 10), 0, kMaxCount));
    }
    return 0;
}

}  // namespace

int mmi_aging_record_parse(mmi_aging_record *r, const char *text, size_t len) {
    if (len >= sizeof s_text) len = sizeof s_text - 1;
    memcpy(s_text, text, len);
    s_text[len] = '\0';
    return parse_terminated(r, s_text);
}

int mmi_aging_record_load(mmi_aging_record *r, const char *path) {
    memset(r, 0, sizeof *r);
    FILE *fp = dev_fopen(path, "r");
    if (fp == nullptr) return -1;
    const size_t n = fread(s_text, 1, sizeof s_text - 1, fp);
    fclose(fp);
    s_text[n] = '\0';
    return parse_terminated(r, s_text);
}

int mmi_aging_record_json(const mmi_aging_record *r, const char *barcode, const char *version,
                          char *out, size_t size) {
    size_t used = 0;
    bool ok =
        append(out, size, &used, "{\"barcode\":\"") &&
        append_json_text(out, size, &used, barcode) &&
        append(out, size, &used, "\",\"version\":\"") &&
        append_json_text(out, size, &used, version) &&
        append(out, size, &used,
               "\",\"started\":%lld,\"elapsed\":%lld,\"cycles\":%d,\"cycle\":%d,"
               "\"item\":\"%s\",\"step\":%d,\"finished\":%s,\"stopped\":%s,"
               "\"failures\":%d,\"last_failure\":\"",
               r->startedAt, r->elapsed, r->cycles, r->cycle, mmi_aging_item_name(r->item), r->step,
               r->finished ? "true" : "false", r->stopped ? "true" : "false", r->failures) &&
        append_json_text(out, size, &used, r->lastFailure) &&
        append(out, size, &used, "\",\"items\":{");
    for (int i = 0; ok && i < AGING_ITEM_COUNT; i++)
        ok = append(out, size, &used, "%s\"%s\":{\"pass\":%d,\"fail\":%d}", i ? "," : "",
                    kItems[i].name, r->counts[i].pass, r->counts[i].fail);
    ok = ok && append(out, size, &used, "}}");
    return ok ? static_cast<int>(used) : -1;
}

// Writable INI profile files: read whole, matched exactly, rewritten in place.
#include "ftx_profile.h"

#include <stdio.h>
#include <stdlib.h>
#include <string.h>

#include <android/log.h>

#include "devfs.h"
#include "tp_os.h"

namespace {

bool is_newline(char c) {
    return c == '\r' || c == '\n';
}
bool is_space(char c) {
    return c == ' ' || c == '\t';
}

// Reads the file into a zeroed buffer; a 0xFF byte ends the read like the end of file.
// False when the file cannot be opened.
bool load_file(const char *path, char *buf) {
    memset(buf, 0, FTX_PROFILE_BUF_SIZE);
    FILE *fp = dev_fopen(path, "r");
    if (fp == nullptr) return false;
    int c;
    size_t n = 0;
    while (n < FTX_PROFILE_BUF_SIZE - 1 && (c = fgetc(fp)) != EOF && c != 0xFF) {
        buf[n++] = (char)c;
    }
    fclose(fp);
    return true;
}

// Positions [s, e] with the spaces and tabs at both ends left out; e < s when empty.
void trim_span(const char *buf, int *s, int *e) {
    while (*s <= *e && is_space(buf[*s]))
        (*s)++;
    while (*e >= *s && is_space(buf[*e]))
        (*e)--;
}

bool span_equals(const char *buf, int s, int e, const char *name) {
    size_t len = (size_t)(e - s + 1);
    return e >= s && strlen(name) == len && strncmp(buf + s, name, len) == 0;
}

int line_end(const char *buf, int i) {
    while (buf[i] != '\0' && !is_newline(buf[i]))
        i++;
    return i;
}

// Looks for key in the lines from i up to the next line that begins with '['. Fills the
// key and value positions when found.
bool find_key(const char *key, const char *buf, int i, int *key_s, int *key_e, int *value_s,
              int *value_e) {
    while (buf[i] != '\0') {
        if (buf[i] == '[') return false;
        int end = line_end(buf, i);
        const char *eq = (const char *)memchr(buf + i, '=', (size_t)(end - i));
        if (buf[i] != ';' && buf[i] != '=' && end > i && eq != nullptr) {
            int ks = i, ke = (int)(eq - buf) - 1;
            trim_span(buf, &ks, &ke);
            if (span_equals(buf, ks, ke, key)) {
                int vs = (int)(eq - buf) + 1, ve = end - 1;
                trim_span(buf, &vs, &ve);
                *key_s = ks;
                *key_e = ke;
                *value_s = vs;
                *value_e = ve;
                return true;
            }
        }
        i = end;
        while (is_newline(buf[i]))
            i++;
    }
    return false;
}

// Appends text to a bounded buffer; false when it does not fit.
bool append(char *dst, size_t *used, const char *src, size_t len) {
    if (*used + len >= FTX_PROFILE_BUF_SIZE) return false;
    memcpy(dst + *used, src, len);
    *used += len;
    dst[*used] = '\0';
    return true;
}

bool append_str(char *dst, size_t *used, const char *src) {
    return append(dst, used, src, strlen(src));
}

bool append_entry(char *dst, size_t *used, const char *key, const char *value) {
    return append_str(dst, used, key) && append_str(dst, used, "=") &&
           append_str(dst, used, value) && append_str(dst, used, "\n");
}

bool append_section(char *dst, size_t *used, const char *section, const char *key,
                    const char *value) {
    return append_str(dst, used, "[") && append_str(dst, used, section) &&
           append_str(dst, used, "]\n") && append_entry(dst, used, key, value);
}

// The new file content with key set to value in section.
bool build_content(const char *old, bool exists, const char *section, const char *key,
                   const char *value, char *out) {
    int sec_s, sec_e, key_s, key_e, value_s, value_e;
    int found = parse_file(section, key, old, &sec_s, &sec_e, &key_s, &key_e, &value_s, &value_e);
    size_t used = 0;
    out[0] = '\0';
    size_t oldLen = strlen(old);
    if (!exists || (sec_s == -1 && oldLen == 0)) {
        return append_section(out, &used, section, key, value);
    }
    if (sec_s == -1) {
        return append(out, &used, old, oldLen) && append_str(out, &used, "\n") &&
               append_section(out, &used, section, key, value);
    }
    if (!found) {
        // The new entry becomes the section's first line: it goes after the character that
        // follows ']' (between CR and LF with CR LF ends).
        size_t head = (size_t)sec_e + 2;
        if (head > oldLen) {
            return append(out, &used, old, oldLen) && append_str(out, &used, "\n") &&
                   append_entry(out, &used, key, value);
        }
        return append(out, &used, old, head) && append_entry(out, &used, key, value) &&
               append(out, &used, old + head, oldLen - head);
    }
    // Replace the value only: blanks around it stay as they were.
    size_t tail = (size_t)(value_e + 1);
    return append(out, &used, old, (size_t)value_s) && append_str(out, &used, value) &&
           append(out, &used, old + tail, oldLen - tail);
}

}  // namespace

int parse_file(const char *section, const char *key, const char *buf, int *sec_s, int *sec_e,
               int *key_s, int *key_e, int *value_s, int *value_e) {
    *sec_s = *sec_e = *key_s = *key_e = *value_s = *value_e = -1;
    if (section == nullptr || key == nullptr || buf == nullptr) return 0;
    for (int i = 0; buf[i] != '\0'; i++) {
        if (buf[i] != '[' || (i > 0 && !is_newline(buf[i - 1]))) continue;
        const char *rb = strchr(buf + i + 1, ']');
        if (rb == nullptr) return 0;
        int ns = i + 1, ne = (int)(rb - buf) - 1;
        trim_span(buf, &ns, &ne);
        if (!span_equals(buf, ns, ne, section)) continue;
        if (*sec_s == -1) {
            *sec_s = i + 1;
            *sec_e = (int)(rb - buf);
        }
        int next = line_end(buf, (int)(rb - buf));
        while (is_newline(buf[next]))
            next++;
        if (find_key(key, buf, next, key_s, key_e, value_s, value_e)) {
            *sec_s = i + 1;
            *sec_e = (int)(rb - buf);
            return 1;
        }
    }
    return 0;
}

int read_profile_string(const char *section, const char *key, char *out, size_t size,
                        const char *def, const char *path) {
    if (out == nullptr || size == 0) return -1;
    char *buf = (char *)malloc(FTX_PROFILE_BUF_SIZE);
    if (buf == nullptr) return -1;
    int sec_s, sec_e, key_s, key_e, value_s, value_e;
    int found = path != nullptr && load_file(path, buf) &&
                parse_file(section, key, buf, &sec_s, &sec_e, &key_s, &key_e, &value_s, &value_e);
    if (!found) {
        free(buf);
        // Bounded by size and not terminated when def fills it, like strncpy.
        if (def != nullptr) {
            size_t n = strlen(def) + 1;
            memcpy(out, def, n < size ? n : size);
        }
        return -1;
    }
    memset(out, 0, size);
    size_t len = (size_t)(value_e - value_s + 1);
    memcpy(out, buf + value_s, len < size - 1 ? len : size - 1);
    free(buf);
    return 0;
}

int read_profile_int(const char *section, const char *key, int def, const char *path) {
    char value[32] = {0};
    if (read_profile_string(section, key, value, sizeof(value), nullptr, path) != 0) return def;
    return atoi(value);
}

int write_profile_string(const char *section, const char *key, const char *value,
                         const char *path) {
    if (section == nullptr || key == nullptr || value == nullptr || path == nullptr) return -1;
    char *old = (char *)malloc(FTX_PROFILE_BUF_SIZE);
    char *content = (char *)malloc(FTX_PROFILE_BUF_SIZE);
    int rc = -1;
    if (old != nullptr && content != nullptr) {
        bool exists = load_file(path, old);
        if (!build_content(old, exists, section, key, value, content)) {
            __android_log_print(ANDROID_LOG_ERROR, "FTXLOG", "%s: %s would exceed %d bytes",
                                __func__, path, FTX_PROFILE_BUF_SIZE);
        } else {
            FILE *fp = dev_fopen(path, "w");
            if (fp != nullptr) {
                bool ok = fputs(content, fp) >= 0;
                ok = fclose(fp) == 0 && ok;
                rc = ok ? 0 : -1;
            }
        }
    }
    free(old);
    free(content);
    return rc;
}

int write_profile_int(const char *section, const char *key, int value, const char *path) {
    char text[64];
    snprintf(text, sizeof(text), "%d", value);
    return write_profile_string(section, key, text, path);
}

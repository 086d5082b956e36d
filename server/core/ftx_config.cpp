// Reader of the sectioned configuration format and of parameter strings.
#include "core/ftx_config.h"

#include <string.h>

#include <android/log.h>

#include "devfs.h"
#include "tp_os.h"

#define CFG_TAG "FTX_CONFIG"
#define CFG_DEBUG(...) __android_log_print(ANDROID_LOG_DEBUG, CFG_TAG, __VA_ARGS__)
#define CFG_ERROR(...) __android_log_print(ANDROID_LOG_ERROR, CFG_TAG, __VA_ARGS__)

namespace {

// The loaded language section; written only during start-up.
ftx_lang_record s_langList[FTX_LANG_LIST_SIZE];
int s_langCount;

// The parameter parser's work buffer. One per thread: the Wi-Fi and aging settings are
// parsed off the GUI thread too.
thread_local char s_paraPiece[FTX_CFG_TEXT_SIZE];

bool is_blank(char c) {
    return c == '\t' || c == '\n' || c == ' ';
}

// Removes TAB, LF and space around s (a CR stays: the copy to the caller drops it).
void trim_both(char *s) {
    size_t len = strlen(s);
    while (len > 0 && is_blank(s[len - 1]))
        s[--len] = '\0';
    size_t start = 0;
    while (start < len && is_blank(s[start]))
        start++;
    if (start > 0) memmove(s, s + start, len - start + 1);
}

void trim_trailing(char *s) {
    size_t len = strlen(s);
    while (len > 0 && is_blank(s[len - 1]))
        s[--len] = '\0';
}

bool has_prefix(const char *s, const char *prefix) {
    return strncmp(s, prefix, strlen(prefix)) == 0;
}

// Copies a found value to the caller: the old content is cleared over its own length (at
// most a text buffer, should the caller's be unterminated) and the value's last character
// (the CR of the CR LF files) is left out.
void copy_found(char *out, const char *value) {
    memset(out, 0, strnlen(out, FTX_CFG_TEXT_SIZE));
    tp_os_strlcpy(out, value, strlen(value));
}

// Reads fp line by line and hands every entry with a non-empty key and value inside a
// domain that `wanted` begins with to on_entry, split and trimmed, until it returns true.
// -1 on a malformed header (logged for `who`), else 0.
template <typename OnEntry>
int scan_entries(FILE *fp, const char *wanted, const char *who, OnEntry on_entry) {
    char line[FTX_CFG_LINE_SIZE] = {0};
    char domain[FTX_CFG_TEXT_SIZE] = {0};
    char key[FTX_CFG_TEXT_SIZE] = {0};
    char value[FTX_CFG_TEXT_SIZE] = {0};
    while (fgets(line, sizeof(line), fp) != nullptr) {
        if (line[0] == '#') continue;
        if (line[0] == '[') {
            if (mmi_parse_domain(line, domain) == 0) continue;
            CFG_DEBUG("%s mmi_parse_domain fail.", who);
            return -1;
        }
        if (domain[0] == '\0' || !has_prefix(wanted, domain)) continue;
        key[0] = '\0';
        value[0] = '\0';
        mmi_parse_equal(line, key, value);
        trim_both(key);
        trim_both(value);
        if (key[0] != '\0' && value[0] != '\0' && on_entry(key, value)) break;
    }
    return 0;
}

}  // namespace

int mmi_parse_domain(const char *line, char *name_out) {
    const char *lb = strchr(line, '[');
    const char *rb = strchr(line, ']');
    if (lb == nullptr || rb == nullptr || rb - lb < 2) {
        CFG_DEBUG("%s 2222 fail.", __func__);
        return -1;
    }
    if (rb - lb > FTX_CFG_TEXT_SIZE) {
        CFG_DEBUG("%s 11111 fail.", __func__);
        return -1;
    }
    size_t len = (size_t)(rb - lb - 1);
    memcpy(name_out, lb + 1, len);
    name_out[len] = '\0';
    return 0;
}

void mmi_parse_equal(const char *line, char *key_out, char *value_out) {
    const char *eq = strchr(line, '=');
    if (eq == nullptr || eq - line >= FTX_CFG_TEXT_SIZE) return;
    size_t klen = (size_t)(eq - line);
    memcpy(key_out, line, klen);
    key_out[klen] = '\0';
    tp_os_strlcpy(value_out, eq + 1, FTX_CFG_TEXT_SIZE);
}

int ftx_config_lookup_stream(FILE *fp, const char *domain, const char *key, char *out,
                             const char *def) {
    int rc = scan_entries(fp, domain, "Get_CfgValue", [&](const char *fileKey, const char *value) {
        if (!has_prefix(key, fileKey)) return false;
        copy_found(out, value);
        return true;
    });
    if (rc != 0) return rc;
    // The default fills an empty buffer without a terminator of its own: the caller's
    // zeroed buffer ends it.
    if (out[0] == '\0' && def != nullptr) memcpy(out, def, strlen(def));
    return 0;
}

int Get_CfgValue(const char *path, const char *domain, const char *key, char *out,
                 const char *def) {
    if (path == nullptr || domain == nullptr || key == nullptr || out == nullptr) {
        CFG_ERROR("%s,L%d::cfg_file domain name value NULL", __func__, 279);
        return -1;
    }
    FILE *fp = dev_fopen(path, "r");
    if (fp == nullptr) {
        CFG_DEBUG("%s open %s fail.", __func__, path);
        return -1;
    }
    int rc = ftx_config_lookup_stream(fp, domain, key, out, def);
    fclose(fp);
    return rc;
}

int Read_MainCfgFile(const char *domain, const char *key, char *out, const char *def) {
    CFG_DEBUG("%s begin", __func__);
    if (Get_CfgValue(FTX_MAIN_CONFIG_FILE, domain, key, out, def) != 0) {
        CFG_DEBUG("%s Get_CfgValue fail.", __func__);
        return -1;
    }
    CFG_DEBUG("%s end", __func__);
    return 0;
}

int ftx_config_load_lang_stream(FILE *fp, const char *language) {
    memset(s_langList, 0, sizeof(s_langList));
    s_langCount = 0;
    return scan_entries(fp, language, "Get_CfgValueList", [](const char *key, const char *text) {
        // The last record stays empty: it ends every scan of the list.
        if (s_langCount < FTX_LANG_LIST_SIZE - 1) {
            tp_os_strlcpy(s_langList[s_langCount].key, key, FTX_CFG_TEXT_SIZE);
            tp_os_strlcpy(s_langList[s_langCount].text, text, FTX_CFG_TEXT_SIZE);
            s_langCount++;
        }
        return false;
    });
}

int Get_CfgValueList(const char *language) {
    CFG_DEBUG("%s begin.", __func__);
    memset(s_langList, 0, sizeof(s_langList));
    s_langCount = 0;
    if (language == nullptr) return -1;
    FILE *fp = dev_fopen(FTX_LANGUAGE_FILE, "r");
    if (fp == nullptr) {
        CFG_DEBUG("%s open %s fail.", __func__, FTX_LANGUAGE_FILE);
        return -1;
    }
    int rc = ftx_config_load_lang_stream(fp, language);
    fclose(fp);
    if (rc == 0) CFG_DEBUG("%s end.", __func__);
    return rc;
}

int ftx_config_lang_count(void) {
    return s_langCount;
}

int Read_LangCfgFromList(const char *text_key, char *out) {
    if (text_key == nullptr || out == nullptr) {
        CFG_ERROR("%s,L%d::name or value NULL", __func__, 397);
        return -1;
    }
    for (int i = 0; i < FTX_LANG_LIST_SIZE && s_langList[i].key[0] != '\0'; i++) {
        if (strcmp(s_langList[i].key, text_key) != 0) continue;
        if (s_langList[i].text[0] == '\0') return -1;
        // text_key may be out itself: it is not read again from here on.
        copy_found(out, s_langList[i].text);
        return 0;
    }
    return -1;
}

int ftx_config_parse_parameter(const char *str, ftx_config_para *records, int max) {
    if (str == nullptr || records == nullptr) return 0;
    CFG_DEBUG("%s::begin::%s", __func__, str);
    if (strlen(str) < 3) return 0;
    int filled = 0;
    const char *p = str;
    while (*p != '\0') {
        size_t len = strcspn(p, ";");
        memset(s_paraPiece, 0, sizeof(s_paraPiece));
        memcpy(s_paraPiece, p, len < sizeof(s_paraPiece) ? len : sizeof(s_paraPiece) - 1);
        char *colon = strchr(s_paraPiece, ':');
        if (colon == nullptr) break;
        if (colon != s_paraPiece) {
            if (filled >= max) {
                CFG_ERROR("%s paras_index=%d,max_paras_index=%d", "ftx_config", filled, max);
                break;
            }
            *colon = '\0';
            ftx_config_para *rec = &records[filled];
            tp_os_strlcpy(rec->key, s_paraPiece, sizeof(rec->key));
            tp_os_strlcpy(rec->value, colon + 1, sizeof(rec->value));
            trim_trailing(rec->key);
            trim_trailing(rec->value);
            filled++;
            CFG_DEBUG("%s::final paras_key=%s,paras_value=%s", __func__, rec->key, rec->value);
        }
        if (p[len] == '\0') break;
        p += len + 1;
    }
    return filled;
}

int ftx_config_get_para_value(const ftx_config_para *records, int count, const char *name,
                              char *out, size_t out_size, const char *def) {
    if (out == nullptr || out_size == 0) return 0;
    if (records != nullptr && name != nullptr) {
        size_t nlen = strlen(name);
        for (int i = 0; i < count; i++) {
            if (strncmp(records[i].key, name, nlen) != 0) continue;
            // The caller zeroed out; the last byte stays its terminator.
            size_t vlen = strlen(records[i].value);
            memcpy(out, records[i].value, vlen < out_size - 1 ? vlen : out_size - 1);
            break;
        }
    }
    if (out[0] == '\0' && def != nullptr) tp_os_strlcpy(out, def, out_size);
    return (int)strnlen(out, out_size);
}

// Texts of the audio tests.
#include "testwnd/audio/mmi_audio_text.h"

#include <stdio.h>
#include <stdlib.h>
#include <string.h>

namespace {

const int kBandLow = 640;    // 64.0 MHz
const int kBandHigh = 1080;  // 108.0 MHz

// The frequency of the n characters at s ("1017"), or -1.
int frequency(const char *s, size_t n) {
    if (n == 0 || n > 4) return -1;
    int f = 0;
    for (size_t i = 0; i < n; i++) {
        if (s[i] < '0' || s[i] > '9') return -1;
        f = f * 10 + (s[i] - '0');
    }
    return f >= kBandLow && f <= kBandHigh ? f : -1;
}

size_t trimmed(const char **s, size_t n) {
    while (n > 0 && (**s == ' ' || **s == '\t')) {
        (*s)++;
        n--;
    }
    while (n > 0 && ((*s)[n - 1] == ' ' || (*s)[n - 1] == '\t' || (*s)[n - 1] == '\r'))
        n--;
    return n;
}

}  // namespace

int mmi_fm_parse_stations(const char *text, mmi_fm_station *out, int max) {
    if (text == nullptr || out == nullptr) return 0;
    int count = 0;
    const char *p = text;
    while (*p != '\0' && count < max) {
        const char *comma = strchr(p, ',');
        const size_t len = comma != nullptr ? (size_t)(comma - p) : strlen(p);
        const char *slash = static_cast<const char *>(memchr(p, '/', len));
        const char *f = p;
        const size_t fn = trimmed(&f, slash != nullptr ? (size_t)(slash - p) : len);
        const int freq = frequency(f, fn);
        if (freq > 0) {
            mmi_fm_station &st = out[count++];
            st.frequency = freq;
            const char *name = slash != nullptr ? slash + 1 : "";
            size_t nn = slash != nullptr ? len - (size_t)(slash - p) - 1 : 0;
            nn = trimmed(&name, nn);
            if (nn == 0) {
                snprintf(st.name, sizeof(st.name), "%d.%d MHz", freq / 10, freq % 10);
            } else {
                const size_t copy = nn < sizeof(st.name) - 1 ? nn : sizeof(st.name) - 1;
                memcpy(st.name, name, copy);
                st.name[copy] = '\0';
            }
        }
        if (comma == nullptr) break;
        p = comma + 1;
    }
    return count;
}

int mmi_smartpa_parse(const char *text, int *ohms) {
    if (text == nullptr || ohms == nullptr) return -1;
    int result = -1;
    long value = -1;
    const char *p = text;
    while (*p != '\0') {
        const char *semi = strchr(p, ';');
        const size_t len = semi != nullptr ? (size_t)(semi - p) : strlen(p);
        if (len == 11 && strncmp(p, "result=pass", 11) == 0) result = 1;
        if (len == 11 && strncmp(p, "result=fail", 11) == 0) result = 0;
        if (len > 6 && len < 16 && strncmp(p, "value=", 6) == 0) {
            char digits[16];
            memcpy(digits, p + 6, len - 6);
            digits[len - 6] = '\0';
            char *end = nullptr;
            const long v = strtol(digits, &end, 10);
            if (end != digits && *end == '\0' && v >= 0 && v <= 100000) value = v;
        }
        if (semi == nullptr) break;
        p = semi + 1;
    }
    if (result < 0 || (result == 1 && value < 0)) return -1;
    *ohms = result == 1 ? (int)value : 0;
    return result;
}

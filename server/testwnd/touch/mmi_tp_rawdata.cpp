// The self test's failure text.
#include "testwnd/touch/mmi_tp_rawdata.h"

#include <stdlib.h>
#include <string.h>

#include <android/log.h>

#define RAW_DEBUG(tag, ...) __android_log_print(ANDROID_LOG_DEBUG, tag, __VA_ARGS__)
#define RAW_ERROR(tag, ...) __android_log_print(ANDROID_LOG_ERROR, tag, __VA_ARGS__)

namespace {

// The next non-empty comma-separated field at *pos (cut to the buffer), or null at the end.
const char *next_field(const char **pos, char *buf, size_t size) {
    while (*pos != nullptr) {
        const char *s = *pos;
        const char *comma = strchr(s, ',');
        const size_t n = comma != nullptr ? (size_t)(comma - s) : strlen(s);
        *pos = comma != nullptr ? comma + 1 : nullptr;
        if (n == 0) continue;
        const size_t len = n < size - 1 ? n : size - 1;
        memcpy(buf, s, len);
        buf[len] = '\0';
        return buf;
    }
    return nullptr;
}

}  // namespace

void mmi_tp_raw_free(mmi_tp_raw *raw) {
    free(raw->p);
    memset(raw, 0, sizeof(*raw));
}

int mmi_tp_raw_cell(const mmi_tp_raw *raw, int point, int w, int h, int box[4]) {
    if (raw->x <= 0 || raw->y <= 0 || raw->p == nullptr || point < 0) return -1;
    if ((int64_t)point * 2 + 1 >= raw->filled) return -1;
    const uint32_t px = raw->p[2 * point], py = raw->p[2 * point + 1];
    if (px >= (uint32_t)raw->x || py >= (uint32_t)raw->y) return -1;
    box[0] = (int)((int64_t)px * w / raw->x);
    box[1] = (int)((int64_t)py * h / raw->y);
    box[2] = w / raw->x;
    box[3] = h / raw->y;
    return 0;
}

int mmi_tp_raw_parse(const char *text, mmi_tp_raw *out, const char *tag) {
    mmi_tp_raw_free(out);
    if (text == nullptr) return -1;
    const char *pos = text;
    char field[32];
    int32_t *head[] = {&out->x, &out->y, &out->num};
    const char *const names[] = {"x", "y", "num"};
    for (int i = 0; i < 3; i++) {
        if (next_field(&pos, field, sizeof(field)) == nullptr) {
            RAW_ERROR(tag, "Parameter Error! token==NULL,line: %d", __LINE__);
            return -1;
        }
        *head[i] = atoi(field);
        RAW_DEBUG(tag, "g_TPSelfRawFailData.%s=%d", names[i], *head[i]);
    }
    if (out->num < 0) out->num = 0;
    if (out->num > MMI_TP_RAW_MAX_POINTS) out->num = MMI_TP_RAW_MAX_POINTS;
    const size_t len = (size_t)out->num * 2 * sizeof(uint32_t);
    out->p = out->num > 0 ? static_cast<uint32_t *>(calloc((size_t)out->num * 2, sizeof(uint32_t)))
                          : nullptr;
    RAW_DEBUG(tag, "g_TPSelfRawFailData.p=%p,,len=%d", static_cast<void *>(out->p), (int)len);
    int index = 0;
    while (out->p != nullptr && index < 2 * out->num &&
           next_field(&pos, field, sizeof(field)) != nullptr)
        out->p[index++] = (uint32_t)strtoul(field, nullptr, 10);
    out->filled = index;
    RAW_DEBUG(tag, "index=%d", index);
    return 0;
}

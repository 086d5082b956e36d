// The sensor report reader and the line judges.
#include "testwnd/sensors/mmi_sensor_lines.h"

#include <math.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>

namespace {

struct Word {
    const char *text;
    double value;
};
const Word kWords[] = {{"near", 0}, {"far", 1}, {"pass", 1}, {"fail", 0}};

// Copies [b, e) into out (size bytes) when it fits; false when it does not.
bool copy_span(const char *b, const char *e, char *out, size_t size) {
    const size_t n = (size_t)(e - b);
    if (n == 0 || n >= size) return false;
    memcpy(out, b, n);
    out[n] = 0;
    return true;
}

// The numbers of one value ("0.1,0.2,9.8", "5"), or its word.
void read_value(const char *b, const char *e, mmi_sensor_field *f) {
    f->count = 0;
    f->word[0] = 0;
    char text[64];
    if (!copy_span(b, e, text, sizeof(text))) return;
    for (const Word &w : kWords) {
        if (strcmp(text, w.text) == 0) {
            snprintf(f->word, sizeof(f->word), "%s", w.text);
            f->v[0] = w.value;
            f->count = 1;
            return;
        }
    }
    const char *p = text;
    while (f->count < MMI_SENSOR_VALUES_MAX) {
        char *end = nullptr;
        const double v = strtod(p, &end);
        if (end == p || !isfinite(v)) break;
        f->v[f->count++] = v;
        p = end;
        while (*p == ' ')
            p++;
        if (*p != ',') break;
        p++;
    }
}

double magnitude(const mmi_sensor_line *l) {
    if (l->count == 1) return l->v[0];
    double s = 0;
    for (int i = 0; i < l->count; i++)
        s += l->v[i] * l->v[i];
    return sqrt(s);
}

}  // namespace

int mmi_sensor_parse(const char *text, size_t len, mmi_sensor_report *out) {
    memset(out, 0, sizeof(*out));
    if (text == nullptr) return 0;
    const char *end = (const char *)memchr(text, 0, len);
    if (end == nullptr) end = text + len;
    const char *p = text;
    while (p < end && out->count < MMI_SENSOR_FIELDS_MAX) {
        const char *stop = (const char *)memchr(p, ';', (size_t)(end - p));
        if (stop == nullptr) stop = end;
        const char *eq = (const char *)memchr(p, '=', (size_t)(stop - p));
        mmi_sensor_field &f = out->f[out->count];
        if (eq != nullptr && copy_span(p, eq, f.key, sizeof(f.key))) {
            read_value(eq + 1, stop, &f);
            out->count++;
        }
        p = stop + 1;
    }
    return out->count;
}

const mmi_sensor_field *mmi_sensor_find(const mmi_sensor_report *r, const char *key) {
    for (int i = 0; i < r->count; i++)
        if (strcmp(r->f[i].key, key) == 0) return &r->f[i];
    return nullptr;
}

void mmi_sensor_line_reset(mmi_sensor_line *l, const mmi_sensor_line_spec *spec, double lo,
                           double hi) {
    memset(l, 0, sizeof(*l));
    l->spec = spec;
    l->lo = lo;
    l->hi = hi;
}

int mmi_sensor_line_update(mmi_sensor_line *l, const mmi_sensor_report *r) {
    const mmi_sensor_field *f = mmi_sensor_find(r, l->spec->key);
    if (f == nullptr || f->count == 0) return l->done;
    l->seen = 1;
    l->count = f->count;
    memcpy(l->v, f->v, sizeof(l->v));
    memcpy(l->word, f->word, sizeof(l->word));
    if (l->spec->extraKey != nullptr) {
        const mmi_sensor_field *x = mmi_sensor_find(r, l->spec->extraKey);
        l->hasExtra = x != nullptr && x->count > 0;
        if (l->hasExtra) l->extra = x->v[0];
    }
    const double m = magnitude(l);
    bool ok = false;
    switch (l->spec->kind) {
        case MMI_SENSOR_AXIS_G:
            for (int i = 0; i < l->count; i++)
                ok = ok || fabs(fabs(l->v[i]) - MMI_SENSOR_GRAVITY) <= l->lo;
            break;
        case MMI_SENSOR_RANGE:
            ok = m >= l->lo && m <= l->hi;
            break;
        case MMI_SENSOR_ABOVE:
            ok = m >= l->lo;
            break;
        case MMI_SENSOR_BOTH_SIDES:
            if (m <= l->lo) l->low = 1;
            if (m >= l->hi) l->high = 1;
            ok = l->low && l->high;
            break;
        case MMI_SENSOR_RESULT:
            ok = m == 1;
            break;
        case MMI_SENSOR_COME_GO: {
            const bool highIsNear = l->spec->highIsNear != 0;
            int &cameNear = highIsNear ? l->high : l->low;
            int &wentFar = highIsNear ? l->low : l->high;
            if (highIsNear ? m >= l->hi : m <= l->lo) {
                cameNear = 1;
            } else if (cameNear && (highIsNear ? m <= l->lo : m >= l->hi)) {
                wentFar = 1;
            }
            ok = cameNear && wentFar;
            break;
        }
    }
    if (ok) l->done = 1;
    return l->done;
}

void mmi_sensor_line_value(const mmi_sensor_line *l, char *out, size_t size) {
    if (size == 0) return;
    out[0] = 0;
    if (!l->seen) return;
    if (l->word[0] != 0) {
        snprintf(out, size, "%s", l->word);
        return;
    }
    size_t used = 0;
    for (int i = 0; i < l->count && used < size; i++) {
        int n =
            snprintf(out + used, size - used, "%s%.*f", i ? " " : "", l->spec->decimals, l->v[i]);
        if (n < 0) return;
        used += (size_t)n;
    }
    if (used < size && l->spec->unit != nullptr && l->spec->unit[0] != 0)
        snprintf(out + used, size - used, " %s", l->spec->unit);
}

int mmi_sensor_lines_done(const mmi_sensor_line *lines, int n) {
    if (n <= 0) return 0;
    for (int i = 0; i < n; i++)
        if (!lines[i].done) return 0;
    return 1;
}

// The battery test's lines: one table of what each shows, how it is judged and written.
#include "testwnd/battery/mmi_battery_lines.h"

#include <stdarg.h>
#include <stdio.h>
#include <string.h>

#include "hw/libdvk_ncoredevice.h"

namespace {

const int kTextSize = 128;
const int kMaxDigits = 7;

enum Judge {
    JUDGE_NONE,   // shown only
    JUDGE_RANGE,  // inside [min, max]
    JUDGE_GOOD,   // the health must be good
};

// A value and the language key of its word.
struct Word {
    int value;
    const char *key;
};
const Word kHealthWords[] = {
    {FTX_BATTERY_HEALTH_GOOD, "info_BatteryHealthGood"},
    {FTX_BATTERY_HEALTH_OVERHEAT, "info_BatteryHealthOverheat"},
    {FTX_BATTERY_HEALTH_DEAD, "info_BatteryHealthDead"},
    {FTX_BATTERY_HEALTH_OVER_VOLTAGE, "info_BatteryHealthOverVoltage"},
    {FTX_BATTERY_HEALTH_UNSPECIFIED_FAILURE, "info_BatteryHealthFailure"},
    {FTX_BATTERY_HEALTH_COLD, "info_BatteryHealthCold"},
};
const Word kStatusWords[] = {
    {FTX_BATTERY_STATUS_CHARGING, "info_BatteryCharging"},
    {FTX_BATTERY_STATUS_NOT_CHARGING, "info_BatteryNotCharging"},
    {FTX_BATTERY_STATUS_FULL, "info_BatteryFull"},
    {FTX_BATTERY_STATUS_DISCHARGING, "info_BatteryDischarging"},
};
const char kUnknownKey[] = "info_BatteryUnknown";

// Appends to the text in out, cut to size.
__attribute__((format(printf, 3, 4))) void appendf(char *out, size_t size, const char *fmt, ...) {
    const size_t used = strnlen(out, size);
    if (used + 1 >= size) return;
    va_list ap;
    va_start(ap, fmt);
    vsnprintf(out + used, size - used, fmt, ap);
    va_end(ap);
}

const char *word_key(const Word *words, size_t n, int value) {
    for (size_t i = 0; i < n; i++)
        if (words[i].value == value) return words[i].key;
    return kUnknownKey;
}

typedef void (*format_fn)(int value, const mmi_battery_values *v, mmi_battery_translate_fn tr,
                          char *out, size_t size);

void percent(int value, const mmi_battery_values *, mmi_battery_translate_fn, char *out,
             size_t size) {
    snprintf(out, size, "%d %%", value);
}

void millivolts(int value, const mmi_battery_values *, mmi_battery_translate_fn, char *out,
                size_t size) {
    snprintf(out, size, "%d mV", value);
}

// Tenths of a degree as degrees with one decimal ("-0.5 C" for -5).
void tenths(int value, const mmi_battery_values *, mmi_battery_translate_fn, char *out,
            size_t size) {
    long long t = value;
    const char *sign = t < 0 ? "-" : "";
    if (t < 0) t = -t;
    snprintf(out, size, "%s%lld.%lld C", sign, t / 10, t % 10);
}

void health(int value, const mmi_battery_values *, mmi_battery_translate_fn tr, char *out,
            size_t size) {
    tr(word_key(kHealthWords, sizeof kHealthWords / sizeof kHealthWords[0], value), out, size);
}

// The chargers online and the charging state: "USB, charging", "AC+USB, full",
// "none, discharging"; the state alone when the chargers were not reported.
void charger(int value, const mmi_battery_values *v, mmi_battery_translate_fn tr, char *out,
             size_t size) {
    char state[kTextSize];
    tr(word_key(kStatusWords, sizeof kStatusWords / sizeof kStatusWords[0], value), state,
       sizeof state);
    if (!v->chargersKnown) {
        snprintf(out, size, "%s", state);
        return;
    }
    const struct {
        int online;
        const char *key;
    } kChargers[] = {{v->ac, "info_ChargerAC"},
                     {v->usb, "info_ChargerUSB"},
                     {v->wireless, "info_ChargerWireless"}};
    char chargers[kTextSize] = "";
    char word[kTextSize];
    for (const auto &c : kChargers) {
        if (!c.online) continue;
        tr(c.key, word, sizeof word);
        appendf(chargers, sizeof chargers, "%s%s", chargers[0] != '\0' ? "+" : "", word);
    }
    if (chargers[0] == '\0') tr("info_ChargerNone", chargers, sizeof chargers);
    snprintf(out, size, "%s, %s", chargers, state);
}

struct Line {
    const char *labelKey;
    Judge judge;
    const char *minKey, *maxKey;  // item parameter names of a range's limits
    int minDefault, maxDefault;
    int mmi_battery_values::*value;
    format_fn format;
};

const Line kLines[MMI_BATTERY_LINES] = {
    {"info_BatteryLevel", JUDGE_RANGE, "MinLevel", "MaxLevel", 0, 100, &mmi_battery_values::level,
     percent},
    {"info_BatteryVoltage", JUDGE_RANGE, "MinVoltage", "MaxVoltage", 3400, 4500,
     &mmi_battery_values::voltage, millivolts},
    {"info_BatteryTemperature", JUDGE_RANGE, "MinTemperature", "MaxTemperature", 0, 450,
     &mmi_battery_values::temperature, tenths},
    {"info_BatteryHealth", JUDGE_GOOD, nullptr, nullptr, 0, 0, &mmi_battery_values::health, health},
    {"info_BatteryCharger", JUDGE_NONE, nullptr, nullptr, 0, 0, &mmi_battery_values::status,
     charger},
};

bool blank(char c) {
    return c == ' ' || c == '\t' || c == '\r' || c == '\n';
}

// The n characters at *s without the blanks around them: moves *s, returns the length.
size_t trimmed(const char **s, size_t n) {
    while (n > 0 && blank(**s)) {
        (*s)++;
        n--;
    }
    while (n > 0 && blank((*s)[n - 1]))
        n--;
    return n;
}

// A whole number of at most kMaxDigits digits with an optional sign, blanks around it.
bool whole_number(const char *s, size_t n, int *out) {
    n = trimmed(&s, n);
    bool negative = false;
    if (n > 0 && (*s == '-' || *s == '+')) {
        negative = *s == '-';
        s++;
        n--;
    }
    if (n == 0 || n > (size_t)kMaxDigits) return false;
    int v = 0;
    for (size_t i = 0; i < n; i++) {
        if (s[i] < '0' || s[i] > '9') return false;
        v = v * 10 + (s[i] - '0');
    }
    *out = negative ? -v : v;
    return true;
}

}  // namespace

void mmi_battery_read_limits(mmi_battery_param_fn param, void *ctx, mmi_battery_limits *out) {
    for (int i = 0; i < MMI_BATTERY_LINES; i++) {
        const Line &l = kLines[i];
        out->min[i] = l.minDefault;
        out->max[i] = l.maxDefault;
        if (l.judge != JUDGE_RANGE || param == nullptr) continue;
        out->min[i] = param(l.minKey, l.minDefault, ctx);
        out->max[i] = param(l.maxKey, l.maxDefault, ctx);
    }
}

int mmi_battery_line(int line, const mmi_battery_values *v, const mmi_battery_limits *lim,
                     mmi_battery_translate_fn tr, char *out, size_t size) {
    if (size == 0) return 0;
    out[0] = '\0';
    if (line < 0 || line >= MMI_BATTERY_LINES) return 0;
    const Line &l = kLines[line];
    char label[kTextSize], shown[kTextSize], limit[kTextSize], word[kTextSize];
    tr(l.labelKey, label, sizeof label);
    if (v == nullptr) {
        snprintf(out, size, "%s -", label);
        return 0;
    }
    const int value = v->*l.value;
    l.format(value, v, tr, shown, sizeof shown);
    snprintf(out, size, "%s %s", label, shown);
    if (l.judge == JUDGE_RANGE && (value < lim->min[line] || value > lim->max[line])) {
        const bool below = value < lim->min[line];
        tr(below ? "info_BatteryBelow" : "info_BatteryAbove", word, sizeof word);
        l.format(below ? lim->min[line] : lim->max[line], v, tr, limit, sizeof limit);
        appendf(out, size, " %s %s", word, limit);
        return 0;
    }
    if (l.judge == JUDGE_GOOD && value != FTX_BATTERY_HEALTH_GOOD) {
        tr("info_BatteryNotGood", word, sizeof word);
        appendf(out, size, " (%s)", word);
        return 0;
    }
    return 1;
}

int mmi_battery_parse(const char *text, mmi_battery_values *out) {
    if (text == nullptr || out == nullptr) return -1;
    static const struct {
        const char *key;
        int mmi_battery_values::*field;
    } kFields[] = {
        {"level", &mmi_battery_values::level},
        {"voltage", &mmi_battery_values::voltage},
        {"temperature", &mmi_battery_values::temperature},
        {"status", &mmi_battery_values::status},
        {"health", &mmi_battery_values::health},
    };
    const int kAll = (1 << (sizeof kFields / sizeof kFields[0])) - 1;
    mmi_battery_values v{};
    int seen = 0;
    for (const char *p = text;;) {
        const size_t len = strcspn(p, ";");
        const char *eq = (const char *)memchr(p, '=', len);
        if (eq != nullptr) {
            const char *key = p;
            const size_t keyLen = trimmed(&key, (size_t)(eq - p));
            const size_t valueLen = len - (size_t)(eq - p) - 1;
            for (size_t f = 0; f < sizeof kFields / sizeof kFields[0]; f++) {
                if (strlen(kFields[f].key) != keyLen || strncmp(key, kFields[f].key, keyLen) != 0)
                    continue;
                if (!whole_number(eq + 1, valueLen, &(v.*kFields[f].field))) return -1;
                seen |= 1 << f;
            }
        }
        if (p[len] == '\0') break;
        p += len + 1;
    }
    if (seen != kAll) return -1;
    *out = v;
    return 0;
}

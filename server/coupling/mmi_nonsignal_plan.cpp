#include "coupling/mmi_nonsignal_plan.h"

#include <stdio.h>
#include <stdlib.h>
#include <string.h>

#include "core/ftx_config.h"
#include "hw/lib_dvk_nonsignal.h"

const mmi_ns_tech kMmiNsTechs[MMI_NS_TECHS] = {
    {"LTE", "LTE", FTX_RF_TECH_LTE, 38, "S_LTE_CPT", 230},
    {"GSM", "GSM", FTX_RF_TECH_GSM, 6, "S_GSM_CPT", 330},
    {"CDMA2000", "CDMA2000", FTX_RF_TECH_CDMA2000, 18, "S_CDMA_CPT", 240},
    {"WCDMA", "WCDMA", FTX_RF_TECH_WCDMA, 26, "S_WCDMA_CPT", 240},
    {"TDSCDMA", "TD-SCDMA", FTX_RF_TECH_TDSCDMA, 30, "S_TD_CPT", 240},
};

namespace {

constexpr int kMaxBandsOrChannels = 100000;

// A whole number 0..kMaxBandsOrChannels from [s, end) (CDMA's band class 0 and GSM's ARFCN 0
// are real); -1 when it is not one.
int parse_number(const char *s, const char *end) {
    if (s == end || end - s > 6) return -1;
    int v = 0;
    for (; s < end; s++) {
        if (*s < '0' || *s > '9') return -1;
        v = v * 10 + (*s - '0');
    }
    return v <= kMaxBandsOrChannels ? v : -1;
}

int fail(mmi_ns_plan *plan, const char *fmt, const char *what) {
    snprintf(plan->reason, sizeof plan->reason, fmt, what);
    plan->valid = false;
    return -1;
}

// The value of key, or def; false when the value is there but empty.
bool value_of(const ftx_config_para *records, int count, const char *key, char *out, size_t size) {
    memset(out, 0, size);
    ftx_config_get_para_value(records, count, key, out, size, nullptr);
    return out[0] != '\0';
}

// A limit or power in dBm, or def when the key is absent.
int read_dbm(const ftx_config_para *records, int count, const char *key, int def, int *out,
             mmi_ns_plan *plan) {
    char text[FTX_CFG_TEXT_SIZE];
    *out = def;
    if (!value_of(records, count, key, text, sizeof text)) return 0;
    if (mmi_ns_parse_dbm(text, out) != 0) return fail(plan, "bad %s", key);
    return 0;
}

}  // namespace

int mmi_ns_parse_dbm(const char *text, int *tenths) {
    if (text == nullptr || tenths == nullptr) return -1;
    const char *s = text;
    const bool negative = *s == '-';
    if (*s == '-' || *s == '+') s++;
    int whole = 0, digits = 0, tenth = 0;
    for (; *s >= '0' && *s <= '9'; s++) {
        if (++digits > 3) return -1;
        whole = whole * 10 + (*s - '0');
    }
    if (digits == 0) return -1;
    if (*s == '.') {
        s++;
        if (*s < '0' || *s > '9') return -1;
        tenth = *s++ - '0';
    }
    if (*s != '\0') return -1;
    const int v = (whole * 10 + tenth) * (negative ? -1 : 1);
    if (v < -2000 || v > 600) return -1;
    *tenths = v;
    return 0;
}

void mmi_ns_format_dbm(int tenths, char *out, size_t size) {
    if (out == nullptr || size == 0) return;
    const int a = tenths < 0 ? -tenths : tenths;
    snprintf(out, size, "%s%d.%d", tenths < 0 ? "-" : "", a / 10, a % 10);
}

bool mmi_ns_level_passes(const mmi_ns_plan &plan, int level) {
    return level >= plan.min && level <= plan.max;
}

int mmi_ns_parse_plan(const mmi_ns_tech &tech, const char *parameter, mmi_ns_plan *plan) {
    if (plan == nullptr) return -1;
    *plan = mmi_ns_plan{};
    plan->power = tech.defaultPower;
    plan->valid = true;
    ftx_config_para records[16];
    memset(records, 0, sizeof records);
    const int n = ftx_config_parse_parameter(parameter, records, 16);
    char text[FTX_CFG_TEXT_SIZE];
    plan->enabled = value_of(records, n, "enable", text, sizeof text) && atoi(text) == 1;
    if (!plan->enabled) return 0;

    char bands[FTX_CFG_TEXT_SIZE], channels[FTX_CFG_TEXT_SIZE];
    if (!value_of(records, n, "band", bands, sizeof bands)) return fail(plan, "no %s", "band");
    if (!value_of(records, n, "channel", channels, sizeof channels))
        return fail(plan, "no %s", "channel");
    // Band by band, each with its group of channels.
    const char *b = bands, *c = channels;
    while (true) {
        const char *bEnd = b + strcspn(b, ",");
        const char *cEnd = c + strcspn(c, ",");
        const int band = parse_number(b, bEnd);
        if (band < 0) return fail(plan, "bad %s", "band");
        if (*c == '\0') return fail(plan, "%s: fewer channel groups than bands", "channel");
        for (const char *ch = c;;) {
            const char *chEnd = ch + strcspn(ch, "/,");
            const int channel = parse_number(ch, chEnd);
            if (channel < 0) return fail(plan, "bad %s", "channel");
            if (plan->stepCount >= MMI_NS_MAX_STEPS) return fail(plan, "too many %s", "channels");
            plan->steps[plan->stepCount++] = {band, channel};
            if (*chEnd != '/') break;
            ch = chEnd + 1;
        }
        if (*bEnd == '\0') {
            if (*cEnd != '\0') return fail(plan, "%s: more channel groups than bands", "channel");
            break;
        }
        b = bEnd + 1;
        c = *cEnd == '\0' ? cEnd : cEnd + 1;
    }
    if (read_dbm(records, n, "power", tech.defaultPower, &plan->power, plan) != 0 ||
        read_dbm(records, n, "min", -800, &plan->min, plan) != 0 ||
        read_dbm(records, n, "max", -400, &plan->max, plan) != 0)
        return -1;
    if (plan->min > plan->max) return fail(plan, "%s above max", "min");
    if (value_of(records, n, "settle", text, sizeof text)) {
        const int settle = parse_number(text, text + strlen(text));
        if (settle < 0 || settle > 10000) return fail(plan, "bad %s", "settle");
        plan->settleMs = settle;
    }
    return 0;
}

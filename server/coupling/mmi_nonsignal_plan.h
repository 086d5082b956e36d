// The non-signalling test's settings and judging, apart from the window so that they are
// tested and fuzzed alone. The settings are the FTX_NONSIGNAL domain of /etc/ftx_config.ini:
// "enable" (0/1) and one key per technology (LTE, GSM, CDMA2000, WCDMA, TDSCDMA) whose
// value is a parameter string:
//
//   LTE=enable:1;band:1,3,7;channel:300,1575,3100;power:23;min:-80;max:-40;settle:20
//
//   enable   1 tests the technology (default 0)
//   band     the bands, in test order, separated by ','
//   channel  one group per band, in the same order, separated by ','; a group is one
//            channel or several separated by '/' (300/50,1575,3100: band 1 is tested on
//            channels 300 and 50)
//   power    the transmit power, dBm with at most one decimal (default: the technology's
//            usual maximum, table below)
//   min, max the received-level limits, dBm, inclusive (default -80 and -40)
//   settle   ms between the transmitter on and the reading (default 0; scaled)
#pragma once

#include <stddef.h>

#define MMI_NS_TECHS 5
#define MMI_NS_MAX_STEPS 16
#define MMI_NS_REASON_SIZE 96

// A technology: its settings key, its name on screen, its library number, its result item
// and its default power (tenths of a dBm).
struct mmi_ns_tech {
    const char *key;
    const char *name;
    int libTech;
    int resultItem;
    const char *resultLabel;
    int defaultPower;
};
extern const mmi_ns_tech kMmiNsTechs[MMI_NS_TECHS];

struct mmi_ns_step {
    int band;
    int channel;
};

// One technology's settings. Powers and levels in tenths of a dBm.
struct mmi_ns_plan {
    bool enabled = false;
    bool valid = false;                 // when enabled: the settings could be read
    char reason[MMI_NS_REASON_SIZE]{};  // why they could not
    int stepCount = 0;
    mmi_ns_step steps[MMI_NS_MAX_STEPS]{};
    int power = 0;
    int min = -800, max = -400;
    int settleMs = 0;
};

// Reads one technology's parameter string into plan (a technology not enabled stays
// disabled and valid). 0, or -1 when enabled and unreadable (plan->reason tells why).
int mmi_ns_parse_plan(const mmi_ns_tech &tech, const char *parameter, mmi_ns_plan *plan);
// "-60", "-60.5", "23" into tenths of a dBm; -1 when text is not such a number (in
// -200.0..+60.0).
int mmi_ns_parse_dbm(const char *text, int *tenths);
// "-60.5" from -605.
void mmi_ns_format_dbm(int tenths, char *out, size_t size);
// Whether a received level passes the plan's limits (inclusive).
bool mmi_ns_level_passes(const mmi_ns_plan &plan, int level);

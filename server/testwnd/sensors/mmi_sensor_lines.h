// The sensor windows' plain parts: the library's report text ("acc=0.1,0.2,9.8;proxi=5;
// state=near...") read into fields, and the lines that judge each sensor from the fields
// the reports bring. No window and no lock here: the windows hold these on the GUI thread.
#pragma once

#include <stddef.h>

#define MMI_SENSOR_KEY_SIZE 16
#define MMI_SENSOR_WORD_SIZE 16
#define MMI_SENSOR_FIELDS_MAX 12
#define MMI_SENSOR_VALUES_MAX 3
#define MMI_SENSOR_LINES_MAX 8

// One field of a report: a key and up to three numbers. The words near, far, pass and fail
// read as 0, 1, 1 and 0 and are kept as written.
struct mmi_sensor_field {
    char key[MMI_SENSOR_KEY_SIZE];
    char word[MMI_SENSOR_WORD_SIZE];
    int count;  // numbers read, 0 when the value is none of them
    double v[MMI_SENSOR_VALUES_MAX];
};

struct mmi_sensor_report {
    int count;
    mmi_sensor_field f[MMI_SENSOR_FIELDS_MAX];
};

// Reads at most len bytes of text (a NUL ends it sooner) into out; the number of fields.
// Fields without '=' or with an over-long key are skipped; values beyond three are dropped.
int mmi_sensor_parse(const char *text, size_t len, mmi_sensor_report *out);
// The field of key, or null.
const mmi_sensor_field *mmi_sensor_find(const mmi_sensor_report *r, const char *key);

// How a line is judged; a line once passed stays passed until the window starts again.
enum mmi_sensor_kind {
    MMI_SENSOR_AXIS_G,      // one axis within `lo` of 9.8 (acceleration at rest)
    MMI_SENSOR_RANGE,       // the value (a vector's length) seen within lo..hi
    MMI_SENSOR_ABOVE,       // the value (a vector's length) seen at or above lo
    MMI_SENSOR_BOTH_SIDES,  // the value seen at or below lo and at or above hi
    MMI_SENSOR_RESULT,      // the value seen 1 (a "pass")
    MMI_SENSOR_COME_GO,     // something seen near and then far again (a magnet, a hand)
};

// One line of a sensor window, written as a table row of its family.
struct mmi_sensor_line_spec {
    const char *key{};       // field of the report
    const char *labelKey{};  // language key of the label
    mmi_sensor_kind kind{};
    const char *enableParam{};  // item parameter that turns it on ("Acc:1"); null: always on
    const char *loParam{};      // item parameters of its limits, null when fixed
    double loDef{};
    const char *hiParam{};
    double hiDef{};
    const char *unit{};         // after the value ("lux"), or ""
    int decimals{};             // of the value shown
    const char *lowWordKey{};   // language keys of the two sides of a BOTH_SIDES line, or of
    const char *highWordKey{};  // a RESULT's fail and pass; null: the numbers alone
    const char *extraKey{};     // a second field shown after the value ("value" of a result)
    int calibrate = 0;          // FTX_SENSOR_... the PC may calibrate; 0 none
    int offByDefault = 0;       // off unless its enable parameter turns it on
    int highIsNear = 0;         // COME_GO: near is at or above hi (else at or below lo)
};

struct mmi_sensor_line {
    const mmi_sensor_line_spec *spec;
    double lo, hi;
    int seen;  // a value has arrived
    int count;
    double v[MMI_SENSOR_VALUES_MAX];
    char word[MMI_SENSOR_WORD_SIZE];  // the value's word ("near"), when it came as one
    double extra;
    int hasExtra;
    int low, high;  // the sides a BOTH_SIDES or COME_GO line has seen
    int done;
};

// The gravity an acceleration line looks for.
#define MMI_SENSOR_GRAVITY 9.8

// A line ready for its first report, with its limits.
void mmi_sensor_line_reset(mmi_sensor_line *l, const mmi_sensor_line_spec *spec, double lo,
                           double hi);
// Takes the line's field (and its extra field) from a report; the line's done flag after.
int mmi_sensor_line_update(mmi_sensor_line *l, const mmi_sensor_report *r);
// The value text of a line ("0.10 -0.20 9.80 m/s2", its word, or "" before its first
// report).
void mmi_sensor_line_value(const mmi_sensor_line *l, char *out, size_t size);
// 1 when every one of n lines is done (0 lines: 0).
int mmi_sensor_lines_done(const mmi_sensor_line *lines, int n);

// The aging run's record: where the run is (cycle, item, step), what each item counted and
// the last failure. The reboot marker holds it while a run is in progress, written whole
// through a temporary file and a rename, so a power cut at any moment leaves either the
// previous record or the new one. A finished run's record stays as the result file.
#pragma once

#include <stddef.h>

// The items of a cycle, in the order they run. The three detections start every cycle.
enum mmi_aging_item_id {
    AGING_ITEM_WIFI_DETECT,
    AGING_ITEM_BT_DETECT,
    AGING_ITEM_FM_DETECT,
    AGING_ITEM_VIDEO,
    AGING_ITEM_LIGHT,
    AGING_ITEM_CAMERA,
    AGING_ITEM_VIBRATOR,
    AGING_ITEM_AUDIO,
    AGING_ITEM_CPU,
    AGING_ITEM_STANDBY,
    AGING_ITEM_REBOOT,
    AGING_ITEM_COUNT
};

// Name of an item in the record files, the log and the upload ("video", "camera", ...).
const char *mmi_aging_item_name(int item);
// Language key of an item's label in the aging window and the result list.
const char *mmi_aging_item_label(int item);

struct mmi_aging_count {
    int pass;
    int fail;
};

#define MMI_AGING_FAILURE_SIZE 128

struct mmi_aging_record {
    int cycle;             // cycles completed
    int cycles;            // cycles asked for
    int item;              // item in progress (mmi_aging_item_id)
    int step;              // steps of that item completed in this cycle
    int rebootPending;     // a reboot was asked for and the handset has not come back yet
    int finished;          // 1 once every cycle ran, or the operator stopped the run
    int stopped;           // 1 when the operator stopped it
    long long startedAt;   // epoch seconds when the run began
    long long elapsed;     // seconds the run has been running (its restarts included)
    long long uploadedAt;  // epoch seconds of the last record kept for the server, 0 none
    int failures;          // every failed step
    mmi_aging_count counts[AGING_ITEM_COUNT];
    char lastFailure[MMI_AGING_FAILURE_SIZE];
};

// A fresh record for a run of `cycles` cycles started now.
void mmi_aging_record_init(mmi_aging_record *r, int cycles, long long now);
// Counts a step of the item in progress as passed or failed; a failure's text (may be null)
// becomes the last failure.
void mmi_aging_record_count(mmi_aging_record *r, int item, int passed, const char *failure);

// The record as profile text ("[aging]" and "[counts]" sections), bounded by size. Returns
// the length, or -1 when it does not fit.
int mmi_aging_record_format(const mmi_aging_record *r, char *out, size_t size);
// Writes the record to the device path through a temporary file and a rename; 0 or -1.
int mmi_aging_record_save(const mmi_aging_record *r, const char *path);
// Reads a record written by save; 0, or -1 when the file is missing or is not a record
// (then r is a zero record). Values out of range are clamped, never trusted.
int mmi_aging_record_load(mmi_aging_record *r, const char *path);
// Reads a record from profile text held in memory (the fuzz target feeds it); 0 or -1.
int mmi_aging_record_parse(mmi_aging_record *r, const char *text, size_t len);

// The record as one JSON object for the result server, with the handset's identity (bar
// code and software version texts; null for none). Returns the length, or -1 when it does
// not fit.
int mmi_aging_record_json(const mmi_aging_record *r, const char *barcode, const char *version,
                          char *out, size_t size);

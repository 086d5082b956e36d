// The aging run: cycles of the enabled items in a fixed order on a thread of its own, the
// battery watch, the record kept in the reboot marker, the aging log and the upload. The
// aging window only shows what the run publishes here.
#pragma once

#include "AgingTest/mmi_aging_record.h"

// What the run is doing.
enum mmi_aging_phase {
    AGING_PHASE_STARTING,  // the thread is starting or resuming
    AGING_PHASE_ITEM,      // an item runs
    AGING_PHASE_BETWEEN,   // between two items (idle)
    AGING_PHASE_HOT,       // paused: the battery is too warm, charging is off
    AGING_PHASE_STANDBY,   // the handset is suspended until the RTC alarm
    AGING_PHASE_REBOOT,    // a reboot was asked for
    AGING_PHASE_DONE,      // every cycle ran (or the operator stopped it)
};

// A copy of the run's state for the window, taken under the run's lock.
struct mmi_aging_view {
    mmi_aging_record record;
    int phase;         // mmi_aging_phase
    int itemLeft;      // seconds left of a timed item, -1 when the item is not timed
    int itemSteps;     // steps of the item in progress in one cycle (camera tests, ...)
    int batteryLevel;  // percent, -1 unknown
    int batteryTemp;   // tenths of a degree, valid when batteryLevel >= 0
    int video;         // 1 while the video item wants its moving pattern on screen
};

// Thread body of the run (started by mmi_AgingTest_Start_Entry): resumes from the reboot
// marker when it exists, else starts a new record; returns when the run is finished or
// stopped.
void *mmi_AgingTest_Thread(void *arg);
// Claims the run before its thread starts: -1 when one is active already.
int mmi_aging_run_begin(void);
// Gives the claim up when the thread could not be started.
void mmi_aging_run_abandon(void);
// The run's state now.
void mmi_aging_view_get(mmi_aging_view *out);
// 1 while the run thread is alive.
int mmi_aging_run_active(void);
// Asks the run to stop after the step in flight (the operator leaves the aging window) and
// waits for the thread to end; the marker is removed and the record kept as the result.
// 0, or -1 when no run was active.
int mmi_aging_run_stop(void);

// Device paths of the aging files (from the log folder settings).
void mmi_aging_marker_path(char *out, size_t size);  // the reboot marker
void mmi_aging_result_path(char *out, size_t size);  // the last run's record
void mmi_aging_upload_dir(char *out, size_t size);   // records kept for the server

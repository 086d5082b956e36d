// Run state shared by the GUI, command and aging threads, and the run interface through
// which a test window reports its pass or fail to the run that opened it: the automatic
// sequence and the monomer preview each install theirs, so a window never calls them.
#pragma once

#include <atomic>

// 1 while an automatic run is active; results are recorded and chained only then.
extern std::atomic<int> g_bAutoTestRunning;
// 1 while an aging (burn-in) run is in progress, from its start (or its resume after a
// reboot) until its window closes.
extern std::atomic<int> g_deviceIsAgingTest;

// The runs a test window can belong to.
enum mmi_run_kind {
    MMI_RUN_AUTO,     // the automatic sequence: a pass is recorded and the next item opens
    MMI_RUN_MONOMER,  // the monomer preview: nothing is recorded, the next screen opens
    MMI_RUN_KINDS,
};

struct mmi_run_ops {
    void (*pass)(int resultIndex, const char *domain);
    void (*fail)(int resultIndex);
    // A PC command closed the open test windows: the run cannot get its answer.
    void (*windows_closed)(void);
};

// Installs (or, with null, removes) the receiver of one kind of run.
void mmi_run_install(int kind, const mmi_run_ops *ops);
// What a test window reports; nothing happens for a kind without a receiver.
void mmi_run_pass(int kind, int resultIndex, const char *domain);
void mmi_run_fail(int kind, int resultIndex);
void mmi_run_windows_closed(void);  // tells every receiver

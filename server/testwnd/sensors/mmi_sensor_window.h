// The window every sensor family shares (sensor list, hall sensors, SAR, force touch): one
// line per configured sensor with its live value, red until the sensor has shown what its
// line asks for and green after. The library reports on its own thread through the family's
// callback; the report is kept under a lock and the window is told with MSG_CALLBACK.
// A family is a descriptor (its lines, its library start and stop) and its entry functions.
#pragma once

#include <atomic>
#include <mutex>

#include "hw/lib_factory.h"
#include "mmi_msg.h"
#include "testwnd/catalogue.h"
#include "testwnd/mmi_testwnd.h"
#include "testwnd/sensors/mmi_sensor_lines.h"

#define MMI_SENSOR_REPORT_SIZE 512

// Reports the window has not taken yet are kept, so a value that comes and goes between two
// redraws (a hand over the proximity sensor) is still judged.
#define MMI_SENSOR_QUEUE 16

// Run-time state of one family: the window, the reports and the lines.
struct mmi_sensorwnd_state {
    mmi_ownwnd_state wnd;
    std::mutex lock;  // the reports and their count
    char queue[MMI_SENSOR_QUEUE][MMI_SENSOR_REPORT_SIZE] = {};
    unsigned reports = 0;         // reports so far; the last is queue[(reports - 1) % QUEUE]
    std::atomic<int> running{0};  // the library reports (started by the window or the PC)
    // The GUI thread's.
    unsigned taken = 0;  // reports the lines have seen
    mmi_sensor_line lines[MMI_SENSOR_LINES_MAX];
    int lineCount = 0;
    int passOffered = 0;
};

struct mmi_sensorwnd_desc {
    const mmi_catalogue_row *row{};  // domain (also the log tag), result item, title key
    const char *caption{};
    const char *noteKey{};  // the operator's instruction above the lines
    const mmi_sensor_line_spec *lines{};
    int lineCount{};
    int (*bind)(void) = nullptr;  // per-feature binder; non-zero keeps the window shut
    // The library's start, given the family's callback, and its stop.
    int (*start)(ftx_api_module_cb cb) = nullptr;
    int (*stop)(void) = nullptr;
    ftx_api_module_cb callback{};  // the family's callback (calls mmi_sensorwnd_report)
    int autoPass{};                // passes by itself once every line is green
    mmi_sensorwnd_state *state{};
    int (*stopEntry)(void) = nullptr;
};

// The item's parameter records of a family (at most MMI_SENSOR_PARAMS_MAX): its catalogue
// row's, else its configuration domain's. How many.
#define MMI_SENSOR_PARAMS_MAX 24
int mmi_sensorwnd_params(const mmi_sensorwnd_desc *d, ftx_config_para *p);
// Whether those records turn the line on (a line without an enable key always is).
bool mmi_sensorwnd_line_on(const ftx_config_para *p, int n, const mmi_sensor_line_spec *s);

// What the family's callback does with a report (library thread).
void mmi_sensorwnd_report(const mmi_sensorwnd_desc *d, const module_data *data);

// Opens the window on the GUI thread (the menu, the run); HWND_INVALID when the binder
// fails, no line is configured or the window cannot be made.
HWND mmi_sensorwnd_open(const mmi_sensorwnd_desc *d);
// Closes it from outside (any thread); 1.
int mmi_sensorwnd_close(const mmi_sensorwnd_desc *d);
// The PC's open: the window, PC-driven (it never closes by itself); 1, 0 when it failed.
int mmi_sensorwnd_pc_open(const mmi_sensorwnd_desc *d);
// The PC's close: reply gets "*" and each line's key=0|1; 1 when every line passed, 0 when
// not, -1 when no window was open.
int mmi_sensorwnd_pc_close(const mmi_sensorwnd_desc *d, char *reply, unsigned int size);

// The count of reports so far, and a wait (tries x 100 ms) for one after `before`: 0 and
// that report in out, -1 when none came.
unsigned mmi_sensorwnd_reports(const mmi_sensorwnd_desc *d);
int mmi_sensorwnd_wait(const mmi_sensorwnd_desc *d, unsigned before, int tries,
                       mmi_sensor_report *out);

// A fresh report for the PC (command thread): the window's when it runs, else the library
// is started for it and stopped again. Waits up to `tries` x 100 ms; 0 and the report in
// out, -1 when none came or the library cannot start.
int mmi_sensorwnd_fresh_report(const mmi_sensorwnd_desc *d, mmi_sensor_report *out, int tries);

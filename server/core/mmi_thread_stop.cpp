#include "core/mmi_thread_stop.h"

#include <errno.h>
#include <signal.h>
#include <string.h>
#include <time.h>

#include "tp_os.h"

namespace {

thread_local volatile sig_atomic_t t_stopRequested;

void signalHandler(int) {
    t_stopRequested = 1;
}

}  // namespace

void mmi_thread_stop_install(void) {
    struct sigaction sa;
    memset(&sa, 0, sizeof(sa));
    sa.sa_handler = signalHandler;
    sigemptyset(&sa.sa_mask);
    sigaction(SIGUSR1, &sa, nullptr);
}

bool mmi_thread_stop_requested(void) {
    return t_stopRequested != 0;
}

bool mmi_sleep_unless_stopped(unsigned long us) {
    if (t_stopRequested) return false;  // asked before the sleep began
    double scaled = (double)us * tp_os_time_scale();
    struct timespec ts;
    ts.tv_sec = (time_t)(scaled / 1e6);
    ts.tv_nsec = (long)((scaled - (double)ts.tv_sec * 1e6) * 1000.0);
    while (nanosleep(&ts, &ts) != 0) {
        if (errno != EINTR || t_stopRequested) break;
    }
    return !t_stopRequested;
}

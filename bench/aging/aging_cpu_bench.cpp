// The aging window's cost: the application's CPU while the run only waits (a light item:
// the window redraws its counters each second; target under 1 % of one core) and while
// the full-load item runs (target: one busy core per core). Headless at 720x1280 with the
// clock at a tenth, so each one-minute item lasts 6 s.
#include <stdio.h>
#include <stdlib.h>
#include <unistd.h>

#include <string>
#include <thread>

#include "support/device_under_test.h"
#include "support/proc_figures.h"

namespace {

// The process's CPU over seconds, in percent of one core.
double cpu_percent(const DeviceUnderTest &dut, double seconds) {
    const long long before = bench::cpu_ticks(dut.pid());
    std::this_thread::sleep_for(std::chrono::duration<double>(seconds));
    const long long after = bench::cpu_ticks(dut.pid());
    return 100.0 * (after - before) / sysconf(_SC_CLK_TCK) / seconds;
}

}  // namespace

int main() {
    setenv("FTX_SOURCE_DIR", FTX_BENCH_SOURCE_DIR, 0);
    setenv("FTX_BUILD_DIR", FTX_BENCH_BUILD_DIR, 0);
    DeviceUnderTest dut;
    dut.setScreen(720, 1280);
    dut.setEnv("FTX_TIME_SCALE", "0.1");
    for (const char *key :
         {"vediotest", "cameratest", "reboottest", "standbytest", "vibratortest", "audioloop"})
        dut.setConfig("FTX_AGING", key, "enable:0");
    dut.setConfig("FTX_AGING", "lighttest", "enable:1;time:1");
    dut.setConfig("FTX_AGING", "cpufullload", "enable:1;time:1");
    dut.setConfig("FTX_AGING", "Parameters", "Cycles:1;TempUpLimit:550;TempUncharge:450");
    dut.write("/cache/ftx/rebootAging.txt", "[aging]\ncycle=0\ncycles=1\n");
    if (!dut.start() || !dut.waitLog("light begins", 30000)) {
        fprintf(stderr, "aging: the run did not reach its light item\n");
        return 1;
    }
    std::this_thread::sleep_for(std::chrono::seconds(1));  // the window settles
    const double idle = cpu_percent(dut, 4.0);
    if (!dut.waitLog("busy thread(s)", 30000)) {
        fprintf(stderr, "aging: the full-load item did not start\n");
        return 1;
    }
    std::this_thread::sleep_for(std::chrono::milliseconds(500));
    const double load = cpu_percent(dut, 4.0);
    const long cores = sysconf(_SC_NPROCESSORS_ONLN);
    dut.stop();
    printf("aging window while the run waits: %.2f %% of one core (target < 1 %%, ratio %.2f)\n",
           idle, idle / 1.0);
    printf("aging full-load item: %.0f %% on %ld core(s) (target %ld %%, ratio %.2f)\n", load,
           cores, cores * 100, load / (cores * 100.0));
    return 0;
}

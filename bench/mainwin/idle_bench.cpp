// An idle main menu: CPU used over 10 s (target under 1 % of one core) and resident
// memory (target under 32 MB), headless at 720x1280.
#include <stdio.h>
#include <stdlib.h>
#include <unistd.h>

#include <string>
#include <thread>

#include "support/device_under_test.h"
#include "support/proc_figures.h"

int main() {
    setenv("FTX_SOURCE_DIR", FTX_BENCH_SOURCE_DIR, 0);
    setenv("FTX_BUILD_DIR", FTX_BENCH_BUILD_DIR, 0);
    DeviceUnderTest dut;
    dut.setScreen(720, 1280);
    if (!dut.startToMenu()) {
        fprintf(stderr, "mainwin: ftx-mmi did not reach the main menu\n");
        return 1;
    }
    std::this_thread::sleep_for(std::chrono::seconds(2));  // start-up settles
    const double seconds = 10.0;
    long long before = bench::cpu_ticks(dut.pid());
    std::this_thread::sleep_for(std::chrono::duration<double>(seconds));
    long long after = bench::cpu_ticks(dut.pid());
    long rss = bench::rss_kb(dut.pid());
    double cpuPercent = 100.0 * (after - before) / sysconf(_SC_CLK_TCK) / seconds;
    double rssMb = rss / 1024.0;
    printf("mainwin idle CPU over %.0f s: %.2f %% of one core (target < 1 %%, ratio %.2f)\n",
           seconds, cpuPercent, cpuPercent / 1.0);
    printf("mainwin resident memory at the main menu: %.1f MB (target < 32 MB, ratio %.2f)\n",
           rssMb, rssMb / 32.0);
    return 0;
}

// An idle main menu: CPU used over 10 s (target under 1 % of one core) and resident
// memory (target under 32 MB), headless at 720x1280.
#include <stdio.h>
#include <stdlib.h>
#include <unistd.h>

#include <fstream>
#include <sstream>
#include <string>
#include <thread>

#include "support/device_under_test.h"

namespace {

// utime + stime of the process, in clock ticks.
long long cpu_ticks(pid_t pid) {
    std::ifstream in("/proc/" + std::to_string(pid) + "/stat");
    std::string stat((std::istreambuf_iterator<char>(in)), std::istreambuf_iterator<char>());
    size_t close = stat.rfind(')');
    if (close == std::string::npos) return -1;
    std::istringstream rest(stat.substr(close + 2));
    std::string field;
    long long utime = 0, stime = 0;
    for (int i = 3; i <= 15 && rest >> field; i++) {
        if (i == 14) utime = atoll(field.c_str());
        if (i == 15) stime = atoll(field.c_str());
    }
    return utime + stime;
}

long rss_kb(pid_t pid) {
    std::ifstream in("/proc/" + std::to_string(pid) + "/status");
    std::string line;
    while (std::getline(in, line))
        if (line.rfind("VmRSS:", 0) == 0) return atol(line.c_str() + 6);
    return -1;
}

}  // namespace

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
    long long before = cpu_ticks(dut.pid());
    std::this_thread::sleep_for(std::chrono::duration<double>(seconds));
    long long after = cpu_ticks(dut.pid());
    long rss = rss_kb(dut.pid());
    double cpuPercent = 100.0 * (after - before) / sysconf(_SC_CLK_TCK) / seconds;
    double rssMb = rss / 1024.0;
    printf("mainwin idle CPU over %.0f s: %.2f %% of one core (target < 1 %%, ratio %.2f)\n",
           seconds, cpuPercent, cpuPercent / 1.0);
    printf("mainwin resident memory at the main menu: %.1f MB (target < 32 MB, ratio %.2f)\n",
           rssMb, rssMb / 32.0);
    return 0;
}

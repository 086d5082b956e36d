// A camera preview left open: the application's CPU over 5 s while the back camera's window
// redraws its frames (target under 10 % of one core), headless at 720x1280, real time.
#include <stdio.h>
#include <stdlib.h>
#include <unistd.h>

#include <string>
#include <thread>

#include "support/device_under_test.h"
#include "support/proc_figures.h"

namespace {

// The preview frames the library has given since the camera started ("hw camera").
long frames(const DeviceUnderTest &dut) {
    const std::string line = dut.console("hw camera");
    const size_t at = line.find("camera.frames=");
    return at == std::string::npos ? -1 : atol(line.c_str() + at + 14);
}

}  // namespace

int main() {
    setenv("FTX_SOURCE_DIR", FTX_BENCH_SOURCE_DIR, 0);
    setenv("FTX_BUILD_DIR", FTX_BENCH_BUILD_DIR, 0);
    DeviceUnderTest dut;
    dut.setScreen(720, 1280);
    if (!dut.startToMenu() || !dut.waitChannel()) {
        fprintf(stderr, "camera: ftx-mmi did not reach the main menu\n");
        return 1;
    }
    if (dut.pc("backcameraMoudle testItem open").first != 0 ||
        !dut.waitLog("FTX_CAMERA_BACK: offer_pass::preview running, pass offered")) {
        fprintf(stderr, "camera: the back camera's preview did not start\n");
        return 1;
    }
    std::this_thread::sleep_for(std::chrono::seconds(1));  // the window settles
    const double seconds = 5.0;
    const long framesBefore = frames(dut);
    const long long before = bench::cpu_ticks(dut.pid());
    std::this_thread::sleep_for(std::chrono::duration<double>(seconds));
    const long long after = bench::cpu_ticks(dut.pid());
    const long shown = frames(dut) - framesBefore;
    dut.pc("backcameraMoudle testItem close");
    const double cpuPercent = 100.0 * (after - before) / sysconf(_SC_CLK_TCK) / seconds;
    printf(
        "camera preview CPU over %.0f s (%.1f frames/s): %.2f %% of one core (target < 10 %%, "
        "ratio %.2f)\n",
        seconds, shown / seconds, cpuPercent, cpuPercent / 10.0);
    return 0;
}

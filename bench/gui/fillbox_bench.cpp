// Full-screen FillBox against memset of the same framebuffer bytes.
#include <stdio.h>
#include <stdlib.h>
#include <string.h>

#include <algorithm>
#include <chrono>
#include <filesystem>
#include <vector>

#include "minigui/common.h"
#include "minigui/minigui.h"
#include "minigui/gdi.h"
#include "minigui/ftx_gui.h"

namespace {

template <typename Fn>
double median_us(Fn fn, int rounds, int reps) {
    std::vector<double> t;
    for (int r = 0; r < rounds; r++) {
        auto start = std::chrono::steady_clock::now();
        for (int i = 0; i < reps; i++)
            fn(i);
        std::chrono::duration<double, std::micro> d = std::chrono::steady_clock::now() - start;
        t.push_back(d.count() / reps);
    }
    std::sort(t.begin(), t.end());
    return t[t.size() / 2];
}

}  // namespace

int main() {
    char root[] = "/tmp/ftx-bench-XXXXXX";
    if (mkdtemp(root) == nullptr) return 1;
    setenv("FTX_ROOT", root, 1);
    setenv("FTX_DISPLAY", "headless", 1);
    if (getenv("FTX_SCREEN") == nullptr) setenv("FTX_SCREEN", "720x1280", 1);
    InitGUI(0, nullptr);
    int w, h;
    Uint32 *fb = const_cast<Uint32 *>(ftx_gui_framebuffer(&w, &h));
    size_t bytes = static_cast<size_t>(w) * h * 4;
    std::vector<Uint32> other(static_cast<size_t>(w) * h);
    const int rounds = 15, reps = 20;
    // Both write the same bytes: memset into a buffer of the framebuffer's size, FillBox
    // through the GDI into the framebuffer itself.
    double mem = median_us([&](int i) { memset(other.data(), i & 0xFF, bytes); }, rounds, reps);
    double fill = median_us(
        [&](int i) {
            SetBrushColor(HDC_SCREEN, static_cast<gal_pixel>(i * 0x010101));
            FillBox(HDC_SCREEN, 0, 0, w, h);
        },
        rounds, reps);
    double ratio = fill / mem;
    printf("gui fillbox: FillBox %dx%d %.1f us, memset %.1f us, ratio %.2f (target <= 1.5) %s\n", w,
           h, fill, mem, ratio, ratio <= 1.5 ? "ok" : "OVER");
    (void)fb;
    TerminateGUI(0);
    std::error_code ec;
    std::filesystem::remove_all(root, ec);
    return 0;
}

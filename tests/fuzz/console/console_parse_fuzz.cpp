// Any console line is parsed without a crash, and an accepted request is well formed.
#include <stdint.h>
#include <stdlib.h>
#include <string.h>

#include "console_parse.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t *data, size_t size) {
    static ftxgui::ConsoleRequest req;
    char why[128];
    const char *line = reinterpret_cast<const char *>(data);
    if (ftxgui::console_parse(line, size, &req, why, sizeof(why)) != 0) {
        if (strnlen(why, sizeof(why)) == sizeof(why)) abort();
        return 0;
    }
    if (req.cmd > ftxgui::CON_PATH) abort();
    if (strnlen(req.text, sizeof(req.text)) == sizeof(req.text)) abort();
    if ((req.cmd == ftxgui::CON_TAP || req.cmd == ftxgui::CON_TOUCH) && (req.a < 0 || req.b < 0))
        abort();
    if (req.cmd == ftxgui::CON_SWIPE || req.cmd == ftxgui::CON_PATH) {
        if (req.pointCount < 2 || req.pointCount > ftxgui::kGesturePointsMax) abort();
        if (req.steps < 0 || req.steps > ftxgui::kGestureStepsMax) abort();
        for (int i = 0; i < req.pointCount; i++)
            if (req.points[i][0] < 0 || req.points[i][1] < 0) abort();
    }
    return 0;
}

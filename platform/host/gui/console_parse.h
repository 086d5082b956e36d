// The emulator console's request parser (no GUI state: also built into its fuzz target).
#pragma once

#include <stddef.h>

namespace ftxgui {

enum ConsoleCmd {
    CON_KEY,
    CON_TOUCH,
    CON_TAP,
    CON_SCREENSHOT,
    CON_WINDOWS,
    CON_SCREEN,
    CON_HELP,
    CON_HW,
    CON_IDLE,
    CON_SWIPE,
    CON_PATH,
    CON_WAKE,
};

enum ConsoleAction { ACT_NONE, ACT_DOWN, ACT_UP, ACT_PRESS, ACT_MOVE };

constexpr size_t kConsoleLineMax = 4096;
// Points of one gesture (a swipe is two), and the longest step between two touch moves of a
// path when the steps are not given.
constexpr int kGesturePointsMax = 512;
constexpr int kGestureStep = 8;
constexpr long kGestureStepsMax = 10000;

struct ConsoleRequest {
    ConsoleCmd cmd;
    ConsoleAction action;
    long a;
    long b;
    char text[kConsoleLineMax];  // screenshot path, or the hw line
    // A gesture: its points, and the touch moves from one point to the next (0: one every
    // kGestureStep pixels at most).
    int points[kGesturePointsMax][2];
    int pointCount;
    long steps;
};

// Parses one request line (without its line end). Returns 0, or -1 with a reason for the
// "KO" reply in why.
int console_parse(const char *line, size_t len, ConsoleRequest *req, char *why, size_t whySize);

// The "help" text: one line per command.
const char *console_help();

}  // namespace ftxgui

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
};

enum ConsoleAction { ACT_NONE, ACT_DOWN, ACT_UP, ACT_PRESS, ACT_MOVE };

constexpr size_t kConsoleLineMax = 4096;

struct ConsoleRequest {
    ConsoleCmd cmd;
    ConsoleAction action;
    long a;
    long b;
    char text[kConsoleLineMax];  // screenshot path, or the hw line
};

// Parses one request line (without its line end). Returns 0, or -1 with a reason for the
// "KO" reply in why.
int console_parse(const char *line, size_t len, ConsoleRequest *req, char *why, size_t whySize);

// The "help" text: one line per command.
const char *console_help();

}  // namespace ftxgui

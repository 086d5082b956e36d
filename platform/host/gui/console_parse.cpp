// Request lines of the emulator console: a command word and its arguments separated by
// blanks. Key codes are numbers or the names of the handset's keys.
#include "console_parse.h"

#include <errno.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>

#include <string>

namespace ftxgui {

namespace {

constexpr int kMaxWords = 6;
constexpr long kMaxCoord = 65535;

struct Words {
    const char *p[kMaxWords];
    size_t n[kMaxWords];
    int count;
    bool overflow;
    const char *rest;  // everything after the first word, blanks skipped
    const char *end;
};

bool blank(char c) {
    return c == ' ' || c == '\t';
}

// Splits at most kMaxWords words; overflow tells that there were more.
void split(const char *s, size_t len, Words &w) {
    w.count = 0;
    w.overflow = false;
    w.rest = nullptr;
    w.end = s + len;
    size_t i = 0;
    while (i < len) {
        while (i < len && blank(s[i]))
            i++;
        if (i >= len) break;
        if (w.count == 1 && w.rest == nullptr) w.rest = s + i;
        if (w.count == kMaxWords) {
            w.overflow = true;
            return;
        }
        size_t start = i;
        while (i < len && !blank(s[i]))
            i++;
        w.p[w.count] = s + start;
        w.n[w.count] = i - start;
        w.count++;
    }
}

bool word_is(const Words &w, int i, const char *s) {
    return i < w.count && strlen(s) == w.n[i] && memcmp(w.p[i], s, w.n[i]) == 0;
}

bool number(const Words &w, int i, long lo, long hi, long *out) {
    if (i >= w.count || w.n[i] == 0 || w.n[i] > 12) return false;
    char buf[16];
    memcpy(buf, w.p[i], w.n[i]);
    buf[w.n[i]] = '\0';
    char *end = nullptr;
    errno = 0;
    long v = strtol(buf, &end, 0);
    if (errno != 0 || end == buf || *end != '\0' || v < lo || v > hi) return false;
    *out = v;
    return true;
}

struct KeyName {
    const char *name;
    long code;
};
const KeyName kKeyNames[] = {
    {"power", 1},         {"enter", 28}, {"up", 103},     {"down", 108},  {"volume-up", 103},
    {"volume-down", 108}, {"home", 102}, {"back", 88},    {"menu", 127},  {"camera", 68},
    {"search", 128},      {"hook", 130}, {"recent", 187}, {"torch", 131}, {"tv", 377},
    {"left", 60},         {"pass", 60},  {"right", 61},   {"fail", 61},   {"middle", 62},
};

bool key_code(const Words &w, int i, long *out) {
    if (number(w, i, 0, 0xFFFF, out)) return true;
    for (const KeyName &k : kKeyNames) {
        if (word_is(w, i, k.name)) {
            *out = k.code;
            return true;
        }
    }
    return false;
}

void fail(char *why, size_t size, const char *text) {
    snprintf(why, size, "%s", text);
}

typedef int (*ParseFn)(const Words &w, ConsoleRequest *req, char *why, size_t size);

int parse_key(const Words &w, ConsoleRequest *req, char *why, size_t size) {
    if (w.count != 3) return fail(why, size, "usage: key down|up|press CODE"), -1;
    if (word_is(w, 1, "down"))
        req->action = ACT_DOWN;
    else if (word_is(w, 1, "up"))
        req->action = ACT_UP;
    else if (word_is(w, 1, "press"))
        req->action = ACT_PRESS;
    else
        return fail(why, size, "usage: key down|up|press CODE"), -1;
    if (!key_code(w, 2, &req->a)) return fail(why, size, "bad key code"), -1;
    return 0;
}

int parse_point(const Words &w, int first, ConsoleRequest *req, char *why, size_t size) {
    if (!number(w, first, 0, kMaxCoord, &req->a) || !number(w, first + 1, 0, kMaxCoord, &req->b))
        return fail(why, size, "bad coordinates"), -1;
    return 0;
}

int parse_touch(const Words &w, ConsoleRequest *req, char *why, size_t size) {
    if (w.count != 4) return fail(why, size, "usage: touch down|move|up X Y"), -1;
    if (word_is(w, 1, "down"))
        req->action = ACT_DOWN;
    else if (word_is(w, 1, "move"))
        req->action = ACT_MOVE;
    else if (word_is(w, 1, "up"))
        req->action = ACT_UP;
    else
        return fail(why, size, "usage: touch down|move|up X Y"), -1;
    return parse_point(w, 2, req, why, size);
}

int parse_tap(const Words &w, ConsoleRequest *req, char *why, size_t size) {
    if (w.count != 3) return fail(why, size, "usage: tap X Y"), -1;
    return parse_point(w, 1, req, why, size);
}

int parse_swipe(const Words &w, ConsoleRequest *req, char *why, size_t size) {
    if (w.count != 5 && w.count != 6)
        return fail(why, size, "usage: swipe X1 Y1 X2 Y2 [STEPS]"), -1;
    long c[4];
    for (int i = 0; i < 4; i++)
        if (!number(w, 1 + i, 0, kMaxCoord, &c[i])) return fail(why, size, "bad coordinates"), -1;
    if (w.count == 6 && !number(w, 5, 1, kGestureStepsMax, &req->steps))
        return fail(why, size, "bad step count"), -1;
    req->points[0][0] = (int)c[0];
    req->points[0][1] = (int)c[1];
    req->points[1][0] = (int)c[2];
    req->points[1][1] = (int)c[3];
    req->pointCount = 2;
    return 0;
}

// "X,Y": one point of a path.
bool point(const char *s, size_t n, int *x, int *y) {
    const char *comma = static_cast<const char *>(memchr(s, ',', n));
    if (comma == nullptr) return false;
    Words one;
    one.count = 2;
    one.p[0] = s;
    one.n[0] = static_cast<size_t>(comma - s);
    one.p[1] = comma + 1;
    one.n[1] = n - one.n[0] - 1;
    long a, b;
    if (!number(one, 0, 0, kMaxCoord, &a) || !number(one, 1, 0, kMaxCoord, &b)) return false;
    *x = (int)a;
    *y = (int)b;
    return true;
}

int parse_path(const Words &w, ConsoleRequest *req, char *why, size_t size) {
    const char *usage = "usage: path X,Y X,Y [X,Y ...]";
    if (w.count < 3 || w.rest == nullptr) return fail(why, size, usage), -1;
    const char *p = w.rest;
    while (p < w.end) {
        while (p < w.end && blank(*p))
            p++;
        if (p >= w.end) break;
        const char *start = p;
        while (p < w.end && !blank(*p))
            p++;
        if (req->pointCount == kGesturePointsMax) return fail(why, size, "too many points"), -1;
        int *pt = req->points[req->pointCount];
        if (!point(start, static_cast<size_t>(p - start), &pt[0], &pt[1]))
            return fail(why, size, "bad point (X,Y)"), -1;
        req->pointCount++;
    }
    return 0;
}

int parse_screenshot(const Words &w, ConsoleRequest *req, char *why, size_t size) {
    const bool aux = w.count == 3 && word_is(w, 1, "--aux");
    // A file name never starts with '-': "screenshot --aux" is a request without its file.
    const bool plain = w.count == 2 && w.n[1] > 0 && w.p[1][0] != '-';
    if (!plain && !aux) return fail(why, size, "usage: screenshot [--aux] FILE.png"), -1;
    const int file = aux ? 2 : 1;
    if (w.n[file] >= sizeof(req->text)) return fail(why, size, "path too long"), -1;
    req->a = aux ? 1 : 0;
    memcpy(req->text, w.p[file], w.n[file]);
    req->text[w.n[file]] = '\0';
    return 0;
}

int parse_bare(const Words &w, ConsoleRequest *, char *why, size_t size) {
    if (w.count != 1) return fail(why, size, "no arguments expected"), -1;
    return 0;
}

int parse_hw(const Words &w, ConsoleRequest *req, char *why, size_t size) {
    if (w.count < 2 || w.rest == nullptr) return fail(why, size, "usage: hw LINE"), -1;
    size_t n = static_cast<size_t>(w.end - w.rest);
    if (n >= sizeof(req->text)) return fail(why, size, "line too long"), -1;
    memcpy(req->text, w.rest, n);
    req->text[n] = '\0';
    return 0;
}

int parse_idle(const Words &w, ConsoleRequest *req, char *why, size_t size) {
    req->a = 2000;
    if (w.count > 2 || (w.count == 2 && !number(w, 1, 1, 60000, &req->a)))
        return fail(why, size, "usage: idle [MS]"), -1;
    return 0;
}

struct Command {
    const char *name;
    ConsoleCmd cmd;
    ParseFn parse;
    const char *help;
};

const Command kCommands[] = {
    {"key", CON_KEY, parse_key,
     "key down|up|press CODE   a handset key (number or power, volume-up (up), volume-down "
     "(down), home, back, menu, camera, search, hook, recent, torch, tv, enter, pass (left), "
     "fail (right), middle)"},
    {"touch", CON_TOUCH, parse_touch,
     "touch down|move|up X Y   the finger on the panel (screen pixels)"},
    {"tap", CON_TAP, parse_tap, "tap X Y                  touch down and up at one point"},
    {"swipe", CON_SWIPE, parse_swipe,
     "swipe X1 Y1 X2 Y2 [STEPS]  the finger down, moved in STEPS moves, and up"},
    {"path", CON_PATH, parse_path,
     "path X,Y X,Y ...         the finger down at the first point, along the straight lines "
     "through the others, up at the last"},
    {"screenshot", CON_SCREENSHOT, parse_screenshot,
     "screenshot [--aux] FILE.png  the picture as shown (host path); --aux: the auxiliary "
     "display"},
    {"windows", CON_WINDOWS, parse_bare, "windows                  main windows, top first"},
    {"screen", CON_SCREEN, parse_bare,
     "screen                   size, blank, brightness and the auxiliary display"},
    {"idle", CON_IDLE, parse_idle,
     "idle [MS]                wait until input and windows have nothing left to do"},
    {"hw", CON_HW, parse_hw, "hw LINE                  a line for the simulated hardware"},
    {"wake", CON_WAKE, parse_bare,
     "wake                     wakes the suspended handset as a key press does"},
    {"help", CON_HELP, parse_bare, "help                     this list"},
};

}  // namespace

int console_parse(const char *line, size_t len, ConsoleRequest *req, char *why, size_t whySize) {
    if (line == nullptr || req == nullptr || why == nullptr || whySize == 0) return -1;
    memset(req, 0, sizeof(*req));
    while (len > 0 && (line[len - 1] == '\r' || line[len - 1] == '\n'))
        len--;
    if (len >= kConsoleLineMax) return fail(why, whySize, "line too long"), -1;
    if (memchr(line, '\0', len) != nullptr) return fail(why, whySize, "bad character"), -1;
    Words w;
    split(line, len, w);
    if (w.count == 0) return fail(why, whySize, "empty line"), -1;
    for (const Command &c : kCommands) {
        if (!word_is(w, 0, c.name)) continue;
        req->cmd = c.cmd;
        // A hw line and a path may have any number of words.
        if (w.overflow && c.cmd != CON_HW && c.cmd != CON_PATH)
            return fail(why, whySize, "too many words"), -1;
        return c.parse(w, req, why, whySize);
    }
    return fail(why, whySize, "unknown command (try help)"), -1;
}

const char *console_help() {
    static const std::string text = [] {
        std::string t;
        for (const Command &c : kCommands)
            t += std::string(c.help) + "\n";
        return t;
    }();
    return text.c_str();
}

}  // namespace ftxgui

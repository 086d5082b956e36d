// Shared core of the simulated handset libraries (libftxsim.so): what each operation was
// last asked, answers forced from the console, the "hw" control words of every library,
// and the worker thread that delivers callbacks the way a handset's library does.
#pragma once

#include <stdarg.h>
#include <stddef.h>

#include <functional>
#include <string>
#include <vector>

namespace ftxsim {

// Records a call of op with its arguments (printf-style) and returns the answer the
// console forced for op ("hw set OP VALUE"), else def.
int call(const char *op, int def, const char *fmt = nullptr, ...)
    __attribute__((format(printf, 3, 4)));
// Forces op's answer; clears it when forced is false.
void force_answer(const char *op, bool forced, int value);
// The forced answer of op, when there is one.
bool forced_answer(const char *op, int *value);

// Model values one library publishes for another (the battery for the factory's tests).
void put_value(const char *key, long value);
long get_value(const char *key, long def);

using Args = std::vector<std::string>;

// A bounded text builder over a caller's buffer.
class Reply {
  public:
    Reply(char *buf, size_t size) : buf_(buf), size_(size) {
        if (buf_ != nullptr && size_ > 0) buf_[0] = '\0';
    }
    void add(const char *fmt, ...) __attribute__((format(printf, 2, 3)));
    // Adds the word's last line and returns 0, what a word that is done returns.
    int done(const char *fmt, ...) __attribute__((format(printf, 2, 3)));
    size_t length() const { return len_; }

  private:
    void vadd(const char *fmt, va_list ap);
    char *buf_;
    size_t size_;
    size_t len_ = 0;
};

// One control word of a library: "hw WORD ARGS...". fn returns 0 done, 1 failed (reply
// holds the reason).
struct Word {
    const char *word;
    const char *usage;
    int (*fn)(const Args &args, Reply &reply);
};

// Adds a library's words and the function that prints its state for "hw status".
void add_words(const Word *words, size_t count, void (*state)(Reply &reply));
// Runs one control line against every library's words ("status" and "help" are common).
// Returns 0, 1, or -1 when no word claims the line.
int control(const char *line, char *reply, size_t size);

// Splits a line at blanks.
Args split(const char *line);
// Parses a whole decimal (or 0x hex) integer; false when text is not one.
bool to_int(const std::string &text, long *value);

// A library's own callback thread: jobs run one at a time in posting order, each after
// its delay (milliseconds, scaled by FTX_TIME_SCALE).
class Worker {
  public:
    explicit Worker(const char *name);
    void post(std::function<void()> job, int delay_ms = 0);

  private:
    struct State;
    State *state_;  // never freed: the thread may outlive static destruction
};

}  // namespace ftxsim

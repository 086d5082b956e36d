// Splits a client's byte stream into command lines: LF ends a line, a CR before it is
// dropped, and a line longer than the limit is reported as overlong (its bytes are not kept).
#pragma once

#include <stddef.h>
#include <string.h>

#include <string>
#include <type_traits>

namespace ftxsim {

class LineFramer {
  public:
    explicit LineFramer(size_t max_line) : max_(max_line) {}

    // Feeds bytes; on_line(const std::string &line, bool overlong) runs once per line end.
    // When on_line returns bool, false stops right after that line. Returns the bytes
    // consumed: all of them unless stopped; the caller feeds the rest again later.
    template <typename F>
    size_t feed(const char *data, size_t n, F &&on_line) {
        size_t i = 0;
        while (i < n) {
            const char *lf = static_cast<const char *>(memchr(data + i, '\n', n - i));
            size_t end = lf != nullptr ? static_cast<size_t>(lf - data) : n;
            take(data + i, end - i);
            i = end;
            if (lf == nullptr) break;
            ++i;
            if (!overlong_ && !line_.empty() && line_.back() == '\r') line_.pop_back();
            bool go = true;
            if constexpr (std::is_same_v<decltype(on_line(line_, overlong_)), bool>) {
                go = on_line(line_, overlong_);
            } else {
                on_line(line_, overlong_);
            }
            line_.clear();
            overlong_ = false;
            if (!go) break;
        }
        return i;
    }
    // Bytes held of an unfinished line.
    size_t pending() const { return line_.size(); }

  private:
    // Appends bytes of the current line up to the limit; past it the line is overlong.
    void take(const char *p, size_t len) {
        if (overlong_ || len == 0) return;
        // One byte of slack for a CR that a line end may still drop: a line of max_ bytes
        // may be followed by one CR, nothing else.
        size_t room = max_ + 1 - line_.size();
        bool fits = len < room || (len == room && p[len - 1] == '\r');
        if (fits) {
            line_.append(p, len);
        } else {
            overlong_ = true;
            line_.clear();
        }
    }

    size_t max_;
    std::string line_;
    bool overlong_ = false;
};

}  // namespace ftxsim

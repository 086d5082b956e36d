// Splits a client's byte stream into command lines: LF ends a line, a CR before it is
// dropped, and a line longer than the limit is reported as overlong (its bytes are not kept).
#pragma once

#include <stddef.h>

#include <string>

namespace ftxsim {

class LineFramer {
  public:
    explicit LineFramer(size_t max_line) : max_(max_line) {}

    // Feeds bytes; on_line(const std::string &line, bool overlong) runs once per line end.
    template <typename F>
    void feed(const char *data, size_t n, F &&on_line) {
        for (size_t i = 0; i < n; ++i) {
            char c = data[i];
            if (c == '\n') {
                if (!overlong_ && !line_.empty() && line_.back() == '\r') line_.pop_back();
                on_line(line_, overlong_);
                line_.clear();
                overlong_ = false;
            } else if (!overlong_) {
                // One byte of slack for a CR that a line end may still drop.
                if (line_.size() >= max_ + 1 || (line_.size() == max_ && c != '\r')) {
                    overlong_ = true;
                    line_.clear();
                } else {
                    line_.push_back(c);
                }
            }
        }
    }
    // Bytes held of an unfinished line.
    size_t pending() const { return line_.size(); }

  private:
    size_t max_;
    std::string line_;
    bool overlong_ = false;
};

}  // namespace ftxsim

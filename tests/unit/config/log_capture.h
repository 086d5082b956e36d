// Collects the Android log lines written while it lives ("P TAG: message" per entry).
#pragma once

#include <string>
#include <vector>

#include "ftx_host.h"

class LogCapture {
  public:
    LogCapture() { ftx_log_set_capture(&LogCapture::add, this); }
    ~LogCapture() { ftx_log_set_capture(nullptr, nullptr); }

    bool has(const std::string &text) const {
        for (const auto &l : lines) {
            if (l.find(text) != std::string::npos) return true;
        }
        return false;
    }
    std::vector<std::string> lines;

  private:
    static void add(int prio, const char *tag, const char *msg, void *ctx) {
        static const char kPrio[] = "??VDIWEFS";
        char p = prio >= 0 && prio < 9 ? kPrio[prio] : '?';
        static_cast<LogCapture *>(ctx)->lines.push_back(std::string(1, p) + " " + tag + ": " + msg);
    }
};

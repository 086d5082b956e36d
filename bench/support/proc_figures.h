// What the benchmarks read of a running process from /proc: its CPU time and its resident
// memory.
#pragma once

#include <stdlib.h>
#include <sys/types.h>

#include <fstream>
#include <iterator>
#include <sstream>
#include <string>

namespace bench {

// utime + stime of the process, in clock ticks; -1 when it cannot be read.
inline long long cpu_ticks(pid_t pid) {
    std::ifstream in("/proc/" + std::to_string(pid) + "/stat");
    std::string stat((std::istreambuf_iterator<char>(in)), std::istreambuf_iterator<char>());
    size_t close = stat.rfind(')');
    if (close == std::string::npos) return -1;
    std::istringstream rest(stat.substr(close + 2));
    std::string field;
    long long utime = 0, stime = 0;
    for (int i = 3; i <= 15 && rest >> field; i++) {
        if (i == 14) utime = atoll(field.c_str());
        if (i == 15) stime = atoll(field.c_str());
    }
    return utime + stime;
}

// VmRSS in kB; -1 when it cannot be read.
inline long rss_kb(pid_t pid) {
    std::ifstream in("/proc/" + std::to_string(pid) + "/status");
    std::string line;
    while (std::getline(in, line))
        if (line.rfind("VmRSS:", 0) == 0) return atol(line.c_str() + 6);
    return -1;
}

}  // namespace bench

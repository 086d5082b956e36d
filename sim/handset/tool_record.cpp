// The record of the handset tools' calls.
#include "tool_record.h"

#include <stdio.h>
#include <stdlib.h>
#include <sys/stat.h>

namespace ftxhandset {

namespace {

// The words of a call, host paths inside the root written as device paths.
std::string device_words(int argc, char **argv) {
    const char *env = getenv("FTX_ROOT");
    std::string root = env != nullptr ? env : "";
    std::string out;
    for (int i = 0; i < argc; i++) {
        std::string a = argv[i];
        if (!root.empty() && under(a, root)) a = a.substr(root.size());
        out += " " + (a.empty() ? std::string("/") : a);
    }
    return out;
}

}  // namespace

bool under(const std::string &path, const std::string &folder) {
    return path.compare(0, folder.size(), folder) == 0 &&
           (path.size() == folder.size() || path[folder.size()] == '/');
}

void record(const std::string &name, int argc, char **argv) {
    const char *root = getenv("FTX_ROOT");
    if (root == nullptr || root[0] == '\0') return;
    std::string dir = std::string(root) + "/log";
    mkdir(dir.c_str(), 0755);
    FILE *f = fopen((dir + "/tools.txt").c_str(), "a");
    if (f == nullptr) return;
    fprintf(f, "%s%s\n", name.c_str(), device_words(argc, argv).c_str());
    fclose(f);
}

}  // namespace ftxhandset

#include "kv_file.h"

#include <stdio.h>

namespace ftxhost {

namespace {

std::string trim(const std::string &s) {
    size_t b = s.find_first_not_of(" \t\r\n");
    if (b == std::string::npos) return "";
    size_t e = s.find_last_not_of(" \t\r\n");
    return s.substr(b, e - b + 1);
}

}  // namespace

std::map<std::string, std::string> read_kv_file(const char *hostPath, bool sections) {
    std::map<std::string, std::string> out;
    FILE *f = fopen(hostPath, "r");
    if (f == nullptr) return out;
    std::string section;
    char buf[1024];
    while (fgets(buf, sizeof(buf), f) != nullptr) {
        std::string line = trim(buf);
        if (line.empty() || line[0] == '#' || line[0] == ';') continue;
        if (sections && line[0] == '[') {
            size_t close = line.find(']');
            section =
                trim(line.substr(1, close == std::string::npos ? std::string::npos : close - 1));
            continue;
        }
        size_t eq = line.find('=');
        if (eq == std::string::npos) continue;
        std::string key = trim(line.substr(0, eq));
        if (sections && !section.empty()) key = section + "." + key;
        out[key] = trim(line.substr(eq + 1));
    }
    fclose(f);
    return out;
}

}  // namespace ftxhost

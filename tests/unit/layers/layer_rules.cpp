#include "layer_rules.h"

#include <string.h>

#include <fstream>

namespace fs = std::filesystem;

namespace layers {
namespace {

// Lowest first. A folder holds its subfolders too, unless `own` says only its direct files.
struct Layer {
    const char *folder;
    int rank;
    bool own;
};
const Layer kLayers[] = {
    {"log", 1, false},
    {"gui", 1, false},
    {"server/core", 2, false},
    {"server/session", 3, false},
    {"server/testwnd", 4, false},
    {"server/screens", 5, false},
    {"server/pcba", 5, false},
    {"server/wifi", 5, false},
    {"server/AgingTest", 5, false},
    {"server/coupling", 5, false},
    {"server/adbd_connection", 6, false},
    {"server/hub", 7, false},
    {"server", 8, true},  // the program's start
};

// Headers a folder's own files may not include although the order allows it.
struct Forbidden {
    const char *from;  // a folder; only its direct files
    const char *to;    // a header
    const char *why;
};
const Forbidden kForbidden[] = {
    {"server/testwnd", "server/session/mmi_autotest.h",
     "the framework reports a result through the run interface, not to the sequence"},
    {"server/testwnd", "server/session/mmi_monomer.h",
     "the framework reports a result through the run interface, not to the preview"},
};

const char kAreas[] = "server/testwnd/";
const char kHandlers[] = "server/adbd_connection/handlers/";

bool starts_with(const std::string &s, const std::string &prefix) {
    return s.compare(0, prefix.size(), prefix) == 0;
}

const Layer *layer_of(const std::string &rel) {
    const Layer *best = nullptr;
    for (const Layer &l : kLayers) {
        std::string folder = std::string(l.folder) + "/";
        if (!starts_with(rel, folder)) continue;
        if (l.own && rel.find('/', folder.size()) != std::string::npos) continue;
        if (best == nullptr || strlen(l.folder) > strlen(best->folder)) best = &l;
    }
    return best;
}

// The test area a file belongs to: testwnd/<area>/... or handlers/<area>.cpp; "" for none.
std::string area_of(const std::string &rel) {
    if (starts_with(rel, kAreas)) {
        size_t slash = rel.find('/', strlen(kAreas));
        return slash == std::string::npos ? "" : rel.substr(strlen(kAreas), slash - strlen(kAreas));
    }
    if (starts_with(rel, kHandlers)) {
        std::string name = rel.substr(strlen(kHandlers));
        if (name.find('/') != std::string::npos) return "";
        return name.substr(0, name.rfind('.'));
    }
    return "";
}

bool direct_child(const std::string &rel, const std::string &folder) {
    return starts_with(rel, folder + "/") && rel.find('/', folder.size() + 1) == std::string::npos;
}

// The quoted include of a line, or "".
std::string included(const std::string &line) {
    size_t i = line.find_first_not_of(" \t");
    if (i == std::string::npos || line[i] != '#') return "";
    i = line.find_first_not_of(" \t", i + 1);
    if (i == std::string::npos || line.compare(i, 7, "include") != 0) return "";
    size_t open = line.find('"', i + 7);
    if (open == std::string::npos) return "";
    size_t close = line.find('"', open + 1);
    return close == std::string::npos ? "" : line.substr(open + 1, close - open - 1);
}

// Where an include lands, relative to top: next to the includer, then under server/, gui/
// and log/ (the application's include folders); "" for the platform and the system.
std::string resolve(const fs::path &top, const std::string &includer, const std::string &inc) {
    const fs::path candidates[] = {fs::path(includer).parent_path() / inc, fs::path("server") / inc,
                                   fs::path("gui") / inc, fs::path("log") / inc};
    for (const fs::path &c : candidates) {
        if (fs::exists(top / c)) return c.lexically_normal().generic_string();
    }
    return "";
}

void check_file(const fs::path &top, const std::string &rel, std::vector<std::string> &out) {
    auto report = [&](int n, const char *what, const std::string &line) {
        out.push_back(rel + ":" + std::to_string(n) + ": " + what + ": " + line);
    };
    const Layer *mine = layer_of(rel);
    std::ifstream in(top / rel);
    std::string line;
    int n = 0;
    if (mine == nullptr) {
        report(0, "the folder is in no layer (add it to the layer table)", "");
        return;
    }
    while (std::getline(in, line)) {
        n++;
        std::string inc = included(line);
        if (inc.empty()) continue;
        std::string target = resolve(top, rel, inc);
        if (target.empty()) continue;
        const Layer *theirs = layer_of(target);
        if (theirs == nullptr) {
            report(n, "includes a header that is in no layer", line);
            continue;
        }
        if (theirs->rank > mine->rank) report(n, "includes a higher layer", line);
        for (const Forbidden &f : kForbidden) {
            if (direct_child(rel, f.from) && target == f.to) report(n, f.why, line);
        }
        std::string area = area_of(rel);
        std::string theirArea = area_of(target);
        if (!area.empty() && !theirArea.empty() && starts_with(target, kAreas) &&
            theirArea != area) {
            report(n, "includes another test area than its own", line);
        }
    }
}

}  // namespace

std::vector<std::string> violations(const fs::path &top) {
    std::vector<std::string> out;
    for (const char *folder : {"server", "gui", "log"}) {
        if (!fs::exists(top / folder)) continue;
        for (const auto &entry : fs::recursive_directory_iterator(top / folder)) {
            std::string ext = entry.path().extension().string();
            if (ext != ".c" && ext != ".cpp" && ext != ".h") continue;
            check_file(top, fs::relative(entry.path(), top).generic_string(), out);
        }
    }
    return out;
}

}  // namespace layers

// Small readers of the host's own settings files (not the application's formats).
#pragma once

#include <map>
#include <string>

namespace ftxhost {

// "name=value" lines; '#' starts a comment line; spaces around name and value and a
// trailing CR are dropped. With sections, "[name]" lines prefix keys as "section.key".
std::map<std::string, std::string> read_kv_file(const char *hostPath, bool sections);

}  // namespace ftxhost

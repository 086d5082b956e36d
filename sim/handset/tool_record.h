// What every handset tool shares: the record of its calls in $FTX_ROOT/log/tools.txt, one
// line a call, the tool's name and its words, host paths inside the root written as device
// paths.
#pragma once

#include <string>

namespace ftxhandset {

// True when path is folder or lies below it.
bool under(const std::string &path, const std::string &folder);
// Appends "NAME WORD..." to the root's tools.txt (nothing without a root).
void record(const std::string &name, int argc, char **argv);

}  // namespace ftxhandset

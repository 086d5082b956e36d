// The application's include rules: every file of server/, gui/ and log/ sits in a layer, and
// a file includes only headers of its own layer or of the layers below it. On top of the
// order: the test-window framework does not include the sequence or the monomer preview (a
// window reports through the run interface), and a test area or a PC handler file includes
// no other test area than its own.
#pragma once

#include <filesystem>
#include <string>
#include <vector>

namespace layers {

// One line per broken rule: "file:line: what: the include line".
std::vector<std::string> violations(const std::filesystem::path &top);

}  // namespace layers

// Text checks the tests share.
#pragma once

#include <string>

// Whether text holds part.
inline bool has(const std::string &text, const std::string &part) {
    return text.find(part) != std::string::npos;
}

// Run by the build of the tests: a broken include rule fails the build and says where.
#include <stdio.h>

#include "layer_rules.h"

int main(int argc, char **argv) {
    if (argc != 2) {
        fprintf(stderr, "usage: %s SOURCE_TOP\n", argv[0]);
        return 2;
    }
    std::vector<std::string> found = layers::violations(argv[1]);
    for (const std::string &v : found)
        fprintf(stderr, "include rule broken: %s\n", v.c_str());
    return found.empty() ? 0 : 1;
}

// Every test program knows where the sources and the build are, run by ctest or by hand.
#include <stdlib.h>

namespace {

__attribute__((constructor)) void set_test_paths() {
    setenv("FTX_SOURCE_DIR", FTX_TEST_SOURCE_DIR, 0);
    setenv("FTX_BUILD_DIR", FTX_TEST_BUILD_DIR, 0);
}

}  // namespace

// Test item lists are rebuilt without freeing the old nodes (menus may still point at
// them), so those nodes are not leaks.
extern "C" const char *__lsan_default_suppressions() {
    return "leak:append_node\n";
}

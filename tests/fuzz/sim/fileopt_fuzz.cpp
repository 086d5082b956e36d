// The file operations' parameters from the PC, in a throw-away device root: no input may
// crash them or touch anything outside the root.
#include <stddef.h>
#include <stdint.h>
#include <stdlib.h>
#include <string.h>

#include <string>

#include "fileopt.h"
#include "ftx_host.h"

namespace {

bool make_root() {
    static char root[] = "/tmp/ftx-fuzz-fileopt-XXXXXX";
    if (mkdtemp(root) == nullptr) return false;
    setenv("FTX_ROOT", root, 1);
    ftx_host_reset();
    return true;
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t *data, size_t size) {
    static bool ready = make_root();
    if (!ready || size < 1) return 0;
    std::string parm(reinterpret_cast<const char *>(data + 1), size - 1);
    parm = parm.substr(0, strnlen(parm.c_str(), parm.size()));  // the channel's lines end at NUL
    char reply[512];
    size_t len = 0;
    switch (data[0] % 3) {
        case 0:
            ftxsim::fileopt_read(parm, reply, sizeof(reply), &len);
            break;
        case 1:
            ftxsim::fileopt_write(parm, reply, sizeof(reply));
            break;
        default:
            ftxsim::fileopt_remove(parm, reply, sizeof(reply));
            break;
    }
    if (len > sizeof(reply) || strnlen(reply, sizeof(reply)) == sizeof(reply)) abort();
    std::string host, reason;
    if (ftxsim::fileopt_confine(parm, &host, &reason) && host.rfind(getenv("FTX_ROOT"), 0) != 0) {
        abort();
    }
    return 0;
}

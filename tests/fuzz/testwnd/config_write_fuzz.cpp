// The PC's "ConfigMoudle testItem write" parameter applied to a configuration file: the
// input is "<parameter>\n<file>". The result must keep every other line and stay readable.
#include <stddef.h>
#include <stdint.h>
#include <stdio.h>
#include <string.h>

#include <algorithm>
#include <string>

#include "core/ftx_config.h"
#include "core/mmi_autotest_config.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t *data, size_t size) {
    std::string input(reinterpret_cast<const char *>(data), size);
    size_t nl = input.find('\n');
    std::string parm = input.substr(0, nl);
    std::string file = nl == std::string::npos ? "" : input.substr(nl + 1);
    if (parm.find('\0') != std::string::npos) return 0;

    char domain[MMI_CFG_NAME_SIZE], key[MMI_CFG_NAME_SIZE], value[MMI_CFG_NAME_SIZE];
    if (mmi_config_split_parm(parm.c_str(), domain, key, value) != 0) return 0;
    std::string out;
    if (mmi_config_set_value(file, domain, key, value, &out) != 0) __builtin_trap();
    // Exactly one line more at most, and the reader still gets through the result.
    size_t before = (size_t)std::count(file.begin(), file.end(), '\n');
    size_t after = (size_t)std::count(out.begin(), out.end(), '\n');
    if (after > before + 3) __builtin_trap();
    FILE *fp = fmemopen(out.data(), out.size() ? out.size() : 1, "r");
    if (fp) {
        char found[FTX_CFG_TEXT_SIZE] = {0};
        ftx_config_lookup_stream(fp, domain, key, found, nullptr);
        fclose(fp);
    }
    return 0;
}

// Get_CfgValue on arbitrary files: first line the domain, second the key, the rest the file.
#include <stdio.h>
#include <string.h>

#include "core/ftx_config.h"
#include "tests/fuzz/config/fuzz_common.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t *data, size_t size) {
    std::string rest(reinterpret_cast<const char *>(data), size);
    std::string domain = fuzz_take_line(rest, 255);
    std::string key = fuzz_take_line(rest, 255);
    FILE *fp = fmemopen(rest.data(), rest.size(), "r");
    if (fp == nullptr) return 0;
    char out[FTX_CFG_TEXT_SIZE + 1] = {0};
    out[FTX_CFG_TEXT_SIZE] = 0x5a;  // guard
    snprintf(out, FTX_CFG_TEXT_SIZE, "prior");
    int rc = ftx_config_lookup_stream(fp, domain.c_str(), key.c_str(), out, "default");
    fclose(fp);
    if (rc != 0 && rc != -1) abort();
    if (out[FTX_CFG_TEXT_SIZE] != 0x5a || strnlen(out, FTX_CFG_TEXT_SIZE) >= FTX_CFG_TEXT_SIZE) {
        abort();
    }
    return 0;
}

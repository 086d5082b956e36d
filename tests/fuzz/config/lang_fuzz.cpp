// The language load on arbitrary files: first line the language, the rest the file. Every
// loaded key must be found again.
#include <stdio.h>
#include <string.h>

#include "core/ftx_config.h"
#include "tests/fuzz/config/fuzz_common.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t *data, size_t size) {
    std::string rest(reinterpret_cast<const char *>(data), size);
    std::string language = fuzz_take_line(rest, 255);
    FILE *fp = fmemopen(rest.data(), rest.size(), "r");
    if (fp == nullptr) return 0;
    ftx_config_load_lang_stream(fp, language.c_str());
    fclose(fp);
    int n = ftx_config_lang_count();
    if (n < 0 || n > FTX_LANG_LIST_SIZE - 1) abort();
    // Look up a few keys taken from the input itself.
    std::string probe(reinterpret_cast<const char *>(data), size);
    for (int i = 0; i < 4 && !probe.empty(); i++) {
        std::string key = fuzz_take_line(probe, 255);
        char out[FTX_CFG_TEXT_SIZE] = "fallback";
        if (Read_LangCfgFromList(key.c_str(), out) != 0 && strcmp(out, "fallback") != 0) abort();
        if (strnlen(out, sizeof(out)) >= sizeof(out)) abort();
    }
    return 0;
}

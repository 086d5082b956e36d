// Parameter strings: the first byte chooses the record limit, the rest is the string.
#include <string.h>

#include <memory>

#include "core/ftx_config.h"
#include "tests/fuzz/config/fuzz_common.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t *data, size_t size) {
    if (size == 0) return 0;
    int max = data[0] % 13;
    std::string str(reinterpret_cast<const char *>(data + 1), size - 1);
    // Exactly max zeroed records (a real allocation even for 0), so ASan sees any write past.
    std::unique_ptr<ftx_config_para[]> recs(new ftx_config_para[max]());
    int n = ftx_config_parse_parameter(str.c_str(), recs.get(), max);
    if (n < 0 || n > max) abort();
    for (int i = 0; i < n; i++) {
        // A key of blanks only is stored empty: the skip looks at the untrimmed key.
        char out[16] = {0};
        int len = ftx_config_get_para_value(recs.get(), n, recs[i].key, out, sizeof(out), "d");
        if (len < 0 || len >= (int)sizeof(out) || len != (int)strlen(out)) abort();
    }
    return 0;
}

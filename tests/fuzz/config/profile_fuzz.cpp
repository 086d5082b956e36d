// Profile files: first line the section, second the key, third the value, the rest the
// file. Parses the file, then writes the value through it and reads it back.
#include <stdio.h>
#include <string.h>

#include "devfs.h"
#include "ftx_profile.h"
#include "tests/fuzz/config/fuzz_common.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t *data, size_t size) {
    std::string rest(reinterpret_cast<const char *>(data), size);
    std::string section = fuzz_take_line(rest, 64);
    std::string key = fuzz_take_line(rest, 64);
    std::string value = fuzz_take_line(rest, 64);
    if (rest.size() >= FTX_PROFILE_BUF_SIZE) rest.resize(FTX_PROFILE_BUF_SIZE - 1);
    std::string buf(rest.c_str());  // as loaded: up to the first NUL
    int pos[6];
    int found = parse_file(section.c_str(), key.c_str(), buf.c_str(), &pos[0], &pos[1], &pos[2],
                           &pos[3], &pos[4], &pos[5]);
    int len = (int)buf.size();
    for (int p : pos) {
        if (p < -1 || p > len) abort();
    }
    if (found && (pos[2] < 0 || pos[2] > pos[3] || pos[4] < 0 || pos[5] < pos[4] - 1)) abort();

    FILE *fp = dev_fopen("/fuzz.ini", "w");
    if (fp == nullptr) return 0;
    fwrite(rest.data(), 1, rest.size(), fp);
    fclose(fp);
    write_profile_string(section.c_str(), key.c_str(), value.c_str(), "/fuzz.ini");
    char out[32];
    read_profile_string(section.c_str(), key.c_str(), out, sizeof(out), "d", "/fuzz.ini");
    read_profile_int(section.c_str(), key.c_str(), 0, "/fuzz.ini");
    return 0;
}

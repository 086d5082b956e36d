// A microphone's WAV input as the console loads it: any bytes are read without a crash, a
// refusal has its reason, and an accepted file gives at most the samples asked for.
#include <stdint.h>
#include <stdio.h>

#include <string>
#include <vector>

#include "sim_wav.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t *data, size_t size) {
    std::vector<uint8_t> copy(data, data + size);
    FILE *f = fmemopen(copy.data(), copy.size() ? copy.size() : 1, "rb");
    if (f == nullptr) return 0;
    std::vector<int16_t> samples;
    std::string why;
    const int rc = ftxsim::sim_read_wav(f, "input.wav", 16000, 4000, &samples, &why);
    fclose(f);
    if (rc == 0 && (samples.empty() || samples.size() > 4000 || !why.empty())) __builtin_trap();
    if (rc != 0 && why.empty()) __builtin_trap();
    return 0;
}

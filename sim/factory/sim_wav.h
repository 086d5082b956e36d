// Reading a WAV file of 16-bit PCM mono samples, as the console gives it for a microphone.
#pragma once

#include <stddef.h>
#include <stdint.h>
#include <stdio.h>

#include <string>
#include <vector>

namespace ftxsim {

// Reads the samples of the WAV stream f (name is what reasons call it): its format must be
// 16-bit PCM mono at rate; at most maxSamples are kept. Returns 0, or -1 with the reason in
// why (not a WAV file, another format or rate, data before the format, no data).
int sim_read_wav(FILE *f, const char *name, uint32_t rate, size_t maxSamples,
                 std::vector<int16_t> *out, std::string *why);

}  // namespace ftxsim

// The simulated microphones' WAV input.
#include "sim_wav.h"

#include <string.h>

namespace ftxsim {
namespace {

unsigned get16(const unsigned char *p) {
    return p[0] | (p[1] << 8);
}
uint32_t get32(const unsigned char *p) {
    return get16(p) | (static_cast<uint32_t>(get16(p + 2)) << 16);
}

}  // namespace

int sim_read_wav(FILE *f, const char *name, uint32_t rate, size_t maxSamples,
                 std::vector<int16_t> *out, std::string *why) {
    unsigned char h[16];
    bool fmt = false;
    int rc = -1;
    *why = std::string(name) + " is not a WAV file";
    if (fread(h, 1, 12, f) == 12 && memcmp(h, "RIFF", 4) == 0 && memcmp(h + 8, "WAVE", 4) == 0) {
        *why = std::string(name) + " has no data";
        while (fread(h, 1, 8, f) == 8) {
            const uint32_t len = get32(h + 4);
            if (memcmp(h, "fmt ", 4) == 0 && len >= 16 && fread(h, 1, 16, f) == 16) {
                const unsigned format = get16(h), channels = get16(h + 2), bits = get16(h + 14);
                const uint32_t fileRate = get32(h + 4);
                if (format != 1 || channels != 1 || bits != 16) {
                    *why = std::string(name) + " is not 16-bit PCM mono (format " +
                           std::to_string(format) + ", " + std::to_string(channels) +
                           " channels, " + std::to_string(bits) + " bits)";
                    break;
                }
                if (fileRate != rate) {
                    *why = std::string(name) + " is at " + std::to_string(fileRate) + " Hz: only " +
                           std::to_string(rate) + " Hz is taken, nothing is resampled";
                    break;
                }
                fmt = true;
                if (fseek(f, static_cast<long>(len - 16 + (len & 1)), SEEK_CUR) != 0) break;
            } else if (memcmp(h, "data", 4) == 0) {
                if (!fmt) {
                    *why = std::string(name) + " has its data before its format";
                    break;
                }
                const size_t n = len / 2 < maxSamples ? len / 2 : maxSamples;
                std::vector<unsigned char> bytes(n * 2);
                const size_t got = fread(bytes.data(), 2, n, f);
                out->resize(got);
                for (size_t i = 0; i < got; ++i)
                    (*out)[i] = static_cast<int16_t>(get16(&bytes[2 * i]));
                if (got > 0) rc = 0;
                break;
            } else if (fseek(f, static_cast<long>(len + (len & 1)), SEEK_CUR) != 0) {
                break;
            }
        }
    }
    if (rc == 0) why->clear();
    return rc;
}

}  // namespace ftxsim

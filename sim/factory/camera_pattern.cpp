// The cameras' test patterns: one table row per camera.
#include "camera_pattern.h"

namespace ftxsim {
namespace {

struct Pattern {
    unsigned colours[8];
    int count;
    int ax, ay;  // the bands run across x, y or both (diagonal)
};

const Pattern kPatterns[] = {
    // Back: the broadcast colour bars.
    {{0xC0C0C0, 0xC0C000, 0x00C0C0, 0x00C000, 0xC000C0, 0xC00000, 0x0000C0, 0x101010}, 8, 1, 0},
    // Front: warm bands.
    {{0xFF8C00, 0xFFD700, 0xFF69B4, 0x8B4513, 0xF5F5DC, 0xDC143C}, 6, 0, 1},
    // Second back: cool diagonal stripes.
    {{0x003366, 0x0099CC, 0x66CCCC, 0xCCFFFF, 0x336699}, 5, 1, 1},
};
constexpr int kPatternCount = sizeof(kPatterns) / sizeof(kPatterns[0]);
constexpr long long kCrossingMs = 4000;

}  // namespace

int camera_pattern(int id, long long ms, unsigned *argb, int w, int h) {
    if (argb == nullptr || id < 0 || ms < 0 || w < 1 || h < 1 || w > SIM_CAMERA_MAX_SIDE ||
        h > SIM_CAMERA_MAX_SIDE)
        return -1;
    const Pattern &p = kPatterns[id % kPatternCount];
    const long long span = static_cast<long long>(w) * p.ax + static_cast<long long>(h) * p.ay;
    const long long band = span / p.count > 0 ? span / p.count : 1;
    // Where the pattern has moved to: one band every kCrossingMs, in steps of a pixel.
    const long long shift = (ms % (kCrossingMs * p.count)) * band / kCrossingMs;
    const long long period = band * p.count;
    for (int y = 0; y < h; y++) {
        unsigned *row = argb + static_cast<long long>(y) * w;
        // Moving forward: the colour at t is the one that was at t - shift. Along a row the
        // band advances a pixel a step (or not at all for bands across y).
        const long long along =
            ((static_cast<long long>(y) * p.ay - shift) % period + period) % period;
        int index = static_cast<int>(along / band);
        long long inBand = along % band;
        for (int x = 0; x < w; x++) {
            row[x] = p.colours[index];
            if (p.ax == 0) continue;
            if (++inBand == band) {
                inBand = 0;
                if (++index == p.count) index = 0;
            }
        }
    }
    return 0;
}

}  // namespace ftxsim

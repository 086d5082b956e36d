// The audio tests' outside texts: the FM station list of the configuration and the
// amplifier calibration's answer from the factory library. Stations stay in the band with
// bounded names; a calibration is pass, fail or refused, never a negative impedance.
#include <stddef.h>
#include <stdint.h>
#include <string.h>

#include <string>

#include "testwnd/audio/mmi_audio_text.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t *data, size_t size) {
    std::string text(reinterpret_cast<const char *>(data), size);
    text = text.substr(0, text.find('\0'));
    mmi_fm_station st[MMI_FM_STATIONS_MAX];
    const int n = mmi_fm_parse_stations(text.c_str(), st, MMI_FM_STATIONS_MAX);
    if (n < 0 || n > MMI_FM_STATIONS_MAX) __builtin_trap();
    for (int i = 0; i < n; i++) {
        if (st[i].frequency < 640 || st[i].frequency > 1080) __builtin_trap();
        const size_t len = strnlen(st[i].name, MMI_FM_NAME_SIZE);
        if (len == 0 || len == MMI_FM_NAME_SIZE) __builtin_trap();
    }
    int ohms = -1;
    const int r = mmi_smartpa_parse(text.c_str(), &ohms);
    if (r < -1 || r > 1 || (r >= 0 && ohms < 0)) __builtin_trap();
    return 0;
}

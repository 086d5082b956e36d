// Texts the audio tests read: the FM stations of the configuration and the amplifier
// calibration's answer from the factory library.
//
// The FM test's stations as the item's "SetFMFreq" lists them: comma-separated entries of a
// frequency in units of 100 kHz and an optional display name after a slash, e.g.
// "875/FM 87.5,1017/FM 101.7,1080". An entry without a name shows its frequency in MHz.
#pragma once

#define MMI_FM_STATIONS_MAX 16
#define MMI_FM_NAME_SIZE 32

struct mmi_fm_station {
    int frequency;  // 100 kHz units, 640..1080
    char name[MMI_FM_NAME_SIZE];
};

// The stations of text in order (at most max); entries that are not a frequency in the
// band are left out. Returns how many were read.
int mmi_fm_parse_stations(const char *text, mmi_fm_station *out, int max);

// The calibration answer "result=pass|fail;value=N" (fields in any order): 1 pass with the
// impedance in *ohms, 0 fail, -1 when the text is not such an answer.
int mmi_smartpa_parse(const char *text, int *ohms);

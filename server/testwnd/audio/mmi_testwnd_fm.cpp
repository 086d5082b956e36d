// The FM radio test, a window of the common pattern. The stations come from the item's
// "SetFMFreq"; volume up and down tune the previous and the next one.
#include "testwnd/audio/mmi_testwnd_fm.h"

#include <stdio.h>
#include <string.h>

#include <android/log.h>

#include "testwnd/audio/mmi_audio_text.h"
#include "testwnd/mmi_testwnd.h"

#define FM_DEBUG(...) __android_log_print(ANDROID_LOG_DEBUG, kTag, __VA_ARGS__)

namespace {

const char *const kTag = catalogue::Fm.domain;
// Stations when the item lists none.
const char kDefaultStations[] = "875,1017,1080";
const WPARAM kPrevious = 103;  // volume up
const WPARAM kNext = 108;      // volume down

mmi_testwnd_state s_state;
// The GUI thread's station list and choice.
mmi_fm_station s_stations[MMI_FM_STATIONS_MAX];
int s_count = 0;
int s_index = 0;

// The configured stations (the defaults when the item lists none); how many.
int read_stations(mmi_fm_station *out) {
    ftx_config_para p[12];
    const int n = mmi_testwnd_params(kTag, p, 12);
    char list[FTX_CFG_TEXT_SIZE] = {0};
    ftx_config_get_para_value(p, n, "SetFMFreq", list, sizeof(list), kDefaultStations);
    int count = mmi_fm_parse_stations(list, out, MMI_FM_STATIONS_MAX);
    if (count == 0) count = mmi_fm_parse_stations(kDefaultStations, out, MMI_FM_STATIONS_MAX);
    FM_DEBUG("%s::SetFMFreq=%s,stations=%d", __func__, list, count);
    return count;
}

void note(char *out, unsigned int size) {
    mmi_translate("info_FMNote", out, size);
    for (int i = 0; i < s_count; i++) {
        char line[MMI_FM_NAME_SIZE + 8];
        snprintf(line, sizeof(line), "\n%s %s", i == s_index ? ">" : "  ", s_stations[i].name);
        strncat(out, line, size - strlen(out) - 1);
    }
}

void tune(int index) {
    s_index = index;
    s_state.mode = s_stations[index].frequency;
    FM_DEBUG("ftx_api_FM_Test_Start(%d) %s", s_stations[index].frequency, s_stations[index].name);
    if (hw::ftx_api_FM_Test_Start) hw::ftx_api_FM_Test_Start(s_stations[index].frequency);
}

int fm_hook(HWND hWnd, UINT message, WPARAM wParam, LPARAM) {
    if (message != MSG_KEYDOWN || s_count == 0) return 0;
    if (wParam != kPrevious && wParam != kNext) return 0;
    const int step = wParam == kNext ? 1 : s_count - 1;
    tune((s_index + step) % s_count);
    InvalidateRect(hWnd, nullptr, TRUE);
    return 1;
}

const mmi_testwnd_desc kFm = {
    .row = &catalogue::Fm,
    .caption = "FM Test",
    .titleKey = "title_FMTest",
    .start = MMI_HW_OP(ftx_api_FM_Test_Start),
    .stop = MMI_HW_OP(ftx_api_FM_Test_Stop),
    .stopEntrySleepMs = 100,
    .state = &s_state,
    .stopEntry = mmi_testwnd_FmTest_Stop_Entry,
    .note = note,
    .hook = fm_hook,
};

}  // namespace

void *mmi_testwnd_FmTestEntry(void) {
    s_count = read_stations(s_stations);
    s_index = 0;
    return mmi_testwnd_open(&kFm, s_stations[0].frequency);
}

int mmi_testwnd_FmTest_Stop_Entry(void) {
    return mmi_testwnd_close(&kFm);
}

int mmi_AutoTest_FMTest_Entry(int frequency) {
    if (frequency == 0) {
        mmi_fm_station first[MMI_FM_STATIONS_MAX];
        read_stations(first);
        frequency = first[0].frequency;
    }
    return mmi_testwnd_pc_start(&kFm, frequency);
}

int mmi_AutoTest_FMTest_Stop_Entry(void) {
    return mmi_testwnd_pc_stop(&kFm);
}

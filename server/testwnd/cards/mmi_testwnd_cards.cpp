// The card tests: three items of one pattern, differing only in the cards they check.
#include "testwnd/cards/mmi_testwnd_cards.h"

#include <stdio.h>

#include <android/log.h>

#include "testwnd/cards/mmi_card_window.h"

namespace {

int bind_sim(void) {
    return Init_lib_Interface_SimSd(catalogue::SimCard.domain);
}
int bind_sd(void) {
    return Init_lib_Interface_SimSd(catalogue::SdCard.domain);
}

enum { SIM_ONLY, SD_ONLY, BOTH, FAMILIES };
mmi_cardwnd_state s_states[FAMILIES];

const mmi_cardwnd_desc kFamilies[FAMILIES] = {
    {.row = &catalogue::SimCard,
     .caption = "SIM Card Test",
     .noteKey = "info_SimCardNote",
     .sim = 1,
     .bind = bind_sim,
     .state = &s_states[SIM_ONLY],
     .stopEntry = mmi_testwnd_SIMCardTest_Stop_Entry},
    {.row = &catalogue::SdCard,
     .caption = "SD Card Test",
     .noteKey = "info_SdCardNote",
     .sd = 1,
     .bind = bind_sd,
     .state = &s_states[SD_ONLY],
     .stopEntry = mmi_testwnd_SDCardTest_Stop_Entry},
    {.row = &catalogue::Cards,
     .caption = "Cards Test",
     .noteKey = "info_CardsNote",
     .sim = 1,
     .sd = 1,
     .bind = bind_sim,
     .state = &s_states[BOTH],
     .stopEntry = mmi_testwnd_SIMMEMTest_Stop_Entry},
};

// A PC read: "*1[,SIZE MB]" or "*0"; 1 when present.
int read_card(const char *tag, int kind, int index, char *reply, unsigned int size) {
    int sizeMb = 0;
    const int present =
        Init_lib_Interface_SimSd(tag) == 0 ? mmi_card_check(kind, index, &sizeMb) : -1;
    __android_log_print(ANDROID_LOG_DEBUG, tag, "card %d present=%d size=%d MB", index, present,
                        sizeMb);
    if (reply != nullptr && size > 0) {
        if (present == 1 && sizeMb > 0)
            snprintf(reply, size, "*1,%d MB", sizeMb);
        else
            snprintf(reply, size, "*%d", present == 1 ? 1 : 0);
    }
    return present == 1 ? 1 : 0;
}

}  // namespace

void *mmi_testwnd_SIMCardTestEntry(void) {
    return mmi_cardwnd_open(&kFamilies[SIM_ONLY]);
}
int mmi_testwnd_SIMCardTest_Stop_Entry(void) {
    return mmi_cardwnd_close(&kFamilies[SIM_ONLY]);
}
void *mmi_testwnd_SDCardTestEntry(void) {
    return mmi_cardwnd_open(&kFamilies[SD_ONLY]);
}
int mmi_testwnd_SDCardTest_Stop_Entry(void) {
    return mmi_cardwnd_close(&kFamilies[SD_ONLY]);
}
void *mmi_testwnd_SIMMEMTestEntry(void) {
    return mmi_cardwnd_open(&kFamilies[BOTH]);
}
int mmi_testwnd_SIMMEMTest_Stop_Entry(void) {
    return mmi_cardwnd_close(&kFamilies[BOTH]);
}

int mmi_AutoTest_SIM_Status_Read(int index, char *reply, unsigned int size) {
    return read_card(catalogue::SimCard.domain, MMI_CARD_SIM, index, reply, size);
}

int mmi_AutoTest_SDCARD_Status_Read(int index, char *reply, unsigned int size) {
    return read_card(catalogue::SdCard.domain, MMI_CARD_SD, index, reply, size);
}

// The auxiliary-LCD hint, a window of the common pattern.
#include "testwnd/display/mmi_testwnd_auxlcdhint.h"

#include "testwnd/mmi_testwnd.h"

namespace {

mmi_testwnd_state s_state;

const mmi_testwnd_desc kAuxLcdHint = {
    .row = &catalogue::AuxLcdHint,
    .caption = "Auxiliary LCD Test",
    .noteKey = "info_AuxLcdHint",
    .foolProofSeconds = 1,
    .state = &s_state,
    .stopEntry = mmi_testwnd_AuxLCDHintStop_Entry,
};

}  // namespace

void *mmi_testwnd_AuxLCDHintTestEntry(void) {
    return mmi_testwnd_open(&kAuxLcdHint, 0);
}

int mmi_testwnd_AuxLCDHintStop_Entry(void) {
    return mmi_testwnd_close(&kAuxLcdHint);
}

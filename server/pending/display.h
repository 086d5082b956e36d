// Stand-ins for the display tests (LCD colours, the auxiliary display hint, the preview's LCD
// colours) until each window exists. An entry logs at error priority that its test is not
// available and opens nothing; a family that lands takes its lines out of this list.
#pragma once

#include "pending/pending.h"

#define MMI_PENDING_DISPLAY(ENTRY, STOP)                      \
    ENTRY(mmi_LCDColorTestEntry, "FTX_LCD")                   \
    STOP(mmi_LCDColorTest_Stop_Entry, "FTX_LCD")              \
    ENTRY(mmi_testwnd_AuxLCDHintTestEntry, "FTX_AUXLCD_HINT") \
    STOP(mmi_testwnd_AuxLCDHintStop_Entry, "FTX_AUXLCD_HINT") \
    ENTRY(mmi_Monomer_LCDColorTestEntry, "FTX_MONOMER_LCD")   \
    STOP(mmi_Monomer_LCDColorTest_Stop_Entry, "FTX_MONOMER_LCD")

MMI_PENDING_DISPLAY(MMI_DECLARE_ENTRY, MMI_DECLARE_STOP)

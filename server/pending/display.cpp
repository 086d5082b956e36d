// Stand-ins of the display tests.
#include "pending/display.h"

#include "pending/pending.h"

MMI_PENDING_ENTRY(mmi_LCDColorTestEntry, "FTX_LCD")
MMI_PENDING_STOP(mmi_LCDColorTest_Stop_Entry, "FTX_LCD")
MMI_PENDING_ENTRY(mmi_testwnd_AuxLCDHintTestEntry, "FTX_AUXLCD_HINT")
MMI_PENDING_STOP(mmi_testwnd_AuxLCDHintStop_Entry, "FTX_AUXLCD_HINT")
MMI_PENDING_ENTRY(mmi_Monomer_LCDColorTestEntry, "FTX_MONOMER_LCD")
MMI_PENDING_STOP(mmi_Monomer_LCDColorTest_Stop_Entry, "FTX_MONOMER_LCD")

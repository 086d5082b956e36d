// Stand-ins of the touch tests.
#include "pending/touch.h"

#include "pending/pending.h"

MMI_PENDING_ENTRY(mmi_testwnd_TPSelfTest_Entry, "FTX_TPSELF")
MMI_PENDING_STOP(mmi_testwnd_TPSelfTest_Stop, "FTX_TPSELF")
MMI_PENDING_ENTRY(mmi_testwnd_touchTestEntry, "FTX_TOUCH")
MMI_PENDING_STOP(mmi_AutoTest_touchscreenTest_Stop_Entry, "FTX_TOUCH")
MMI_PENDING_ENTRY(mmi_testwnd_Monomer_TPSelfTest_Entry, "FTX_TPSELF")
MMI_PENDING_STOP(mmi_testwnd_Monomer_TPSelfTest_Stop, "FTX_TPSELF")
MMI_PENDING_ENTRY(mmi_testwnd_Monomer_touchTestEntry, "FTX_TOUCH")
MMI_PENDING_STOP(mmi_testwnd_Monomer_touchscreenTest_Stop, "FTX_TOUCH")

// Stand-ins for the touch tests (the panel self-test and the touch screen, in a run and in the
// preview) until each window exists. An entry logs at error priority that its test is not
// available and opens nothing; a family that lands takes its lines out of this list.
#pragma once

#include "pending/pending.h"

#define MMI_PENDING_TOUCH(ENTRY, STOP)                         \
    ENTRY(mmi_testwnd_TPSelfTest_Entry, "FTX_TPSELF")          \
    STOP(mmi_testwnd_TPSelfTest_Stop, "FTX_TPSELF")            \
    ENTRY(mmi_testwnd_touchTestEntry, "FTX_TOUCH")             \
    STOP(mmi_AutoTest_touchscreenTest_Stop_Entry, "FTX_TOUCH") \
    ENTRY(mmi_testwnd_Monomer_TPSelfTest_Entry, "FTX_TPSELF")  \
    STOP(mmi_testwnd_Monomer_TPSelfTest_Stop, "FTX_TPSELF")    \
    ENTRY(mmi_testwnd_Monomer_touchTestEntry, "FTX_TOUCH")     \
    STOP(mmi_testwnd_Monomer_touchscreenTest_Stop, "FTX_TOUCH")

MMI_PENDING_TOUCH(MMI_DECLARE_ENTRY, MMI_DECLARE_STOP)

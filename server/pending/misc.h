// Stand-ins for the battery test until each window exists. An entry logs at error priority that
// its test is not available and opens nothing; a family that lands takes its lines out of this
// list.
#pragma once

#include "pending/pending.h"

#define MMI_PENDING_MISC(ENTRY, STOP)                  \
    ENTRY(mmi_testwnd_BatteryTestEntry, "FTX_BATTERY") \
    STOP(mmi_testwnd_BatteryTest_Stop_Entry, "FTX_BATTERY")

MMI_PENDING_MISC(MMI_DECLARE_ENTRY, MMI_DECLARE_STOP)

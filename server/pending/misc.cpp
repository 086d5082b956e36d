// Stand-ins of the misc tests.
#include "pending/misc.h"

#include "pending/pending.h"

MMI_PENDING_ENTRY(mmi_testwnd_BatteryTestEntry, "FTX_BATTERY")
MMI_PENDING_STOP(mmi_testwnd_BatteryTest_Stop_Entry, "FTX_BATTERY")

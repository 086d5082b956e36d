// Stand-ins of the keys tests.
#include "pending/keys.h"

#include "pending/pending.h"

MMI_PENDING_ENTRY(mmi_teswnd_KeyTestEntry, "FTX_KEYS")
MMI_PENDING_STOP(mmi_teswnd_KeyTest_Stop_Entry, "FTX_KEYS")
MMI_PENDING_ENTRY(mmi_teswnd_HookKeyTestEntry, "FTX_HOOKKEY")
MMI_PENDING_STOP(mmi_teswnd_HookKeyTest_Stop_Entry, "FTX_HOOKKEY")

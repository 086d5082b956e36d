// Stand-ins for the key tests (the keypad, the headset hook key) until each window exists. An
// entry logs at error priority that its test is not available and opens nothing; a family that
// lands takes its lines out of this list.
#pragma once

#include "pending/pending.h"

#define MMI_PENDING_KEYS(ENTRY, STOP)                 \
    ENTRY(mmi_teswnd_KeyTestEntry, "FTX_KEYS")        \
    STOP(mmi_teswnd_KeyTest_Stop_Entry, "FTX_KEYS")   \
    ENTRY(mmi_teswnd_HookKeyTestEntry, "FTX_HOOKKEY") \
    STOP(mmi_teswnd_HookKeyTest_Stop_Entry, "FTX_HOOKKEY")

MMI_PENDING_KEYS(MMI_DECLARE_ENTRY, MMI_DECLARE_STOP)

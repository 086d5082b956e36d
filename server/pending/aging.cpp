#include "pending/aging.h"

#include "pending/pending.h"

MMI_PENDING(int, mmi_AgingTestEntry, (void), 0, "AgingTest")
MMI_PENDING(int, mmi_AgingTest_Start_Entry, (void), 0, "AgingTest")
MMI_PENDING(void *, mmi_AgingTest_Wnd_Thread, (void *), nullptr, "AgingTest")

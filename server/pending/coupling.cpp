#include "pending/coupling.h"

#include "pending/pending.h"

MMI_PENDING(int, mmi_testwnd_Coupling_Entry, (void), 0, "FTX_MAIN")

// Stand-ins of the display tests.
#include "pending/display.h"

MMI_PENDING_DISPLAY(MMI_PENDING_ENTRY, MMI_PENDING_STOP)

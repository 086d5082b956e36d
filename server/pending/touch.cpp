// Stand-ins of the touch tests.
#include "pending/touch.h"

MMI_PENDING_TOUCH(MMI_PENDING_ENTRY, MMI_PENDING_STOP)

// Stand-ins of the misc tests.
#include "pending/misc.h"

MMI_PENDING_MISC(MMI_PENDING_ENTRY, MMI_PENDING_STOP)

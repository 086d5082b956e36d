// Stand-ins of the keys tests.
#include "pending/keys.h"

MMI_PENDING_KEYS(MMI_PENDING_ENTRY, MMI_PENDING_STOP)

// Stand-ins of the cards tests.
#include "pending/cards.h"

MMI_PENDING_CARDS(MMI_PENDING_ENTRY, MMI_PENDING_STOP)

// Stand-ins of the sensors tests.
#include "pending/sensors.h"

MMI_PENDING_SENSORS(MMI_PENDING_ENTRY, MMI_PENDING_STOP)

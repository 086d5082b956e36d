// Stand-ins of the camera tests.
#include "pending/camera.h"

MMI_PENDING_CAMERA(MMI_PENDING_ENTRY, MMI_PENDING_STOP)

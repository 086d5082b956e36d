// Stand-ins of the audio tests.
#include "pending/audio.h"

MMI_PENDING_AUDIO(MMI_PENDING_ENTRY, MMI_PENDING_STOP)

// The PCBA run's commands: each board check's start (with its value reply) and stop, and the
// camera-ID check. The key, ring and vibrator checks live with their own tests.
#include "adbd_connection/handlers/common.h"
#include "adbd_connection/handlers/handlers.h"
#include "pcba/mmi_pcba.h"

// A start that passes the reply buffer on.
#define PCBA_READER(handler, start)                                       \
    int handler(const char *, int, char *reply, unsigned int replySize) { \
        at_log_begin(__func__);                                           \
        return start(reply, replySize);                                   \
    }
// A start that is given all four arguments.
#define PCBA_WITH_PARM(handler, start)                                            \
    int handler(const char *parm, int len, char *reply, unsigned int replySize) { \
        at_log_parm(__func__, parm);                                              \
        return start(parm, len, reply, replySize);                                \
    }
#define PCBA_STOP(handler)                                 \
    int handler(const char *, int, char *, unsigned int) { \
        at_log_begin(__func__);                            \
        return PCBATestStop();                             \
    }

PCBA_READER(PCBAAutotestCpuStart, PCBACpuTestStart)
PCBA_READER(PCBAAutotestMemoryStart, PCBAMemoryTestStart)
PCBA_READER(PCBAAutotestBluetoothStart, PCBABluetoothTestStart)
PCBA_READER(PCBAAutotestCameraBackStart, PCBACameraBackTestStart)
PCBA_READER(PCBAAutotestCameraFrontStart, PCBACameraFrontTestStart)
PCBA_READER(PCBAAutotestBatteryStart, PCBABatteryTestStart)
PCBA_READER(PCBAAutotestWifiStart, PCBAWifiTestStart)
PCBA_READER(PCBAAutotestGpsStart, PCBAGpsTestStart)
PCBA_READER(PCBAAutotestTouchStart, PCBATouchTestStart)
PCBA_READER(PCBAAutotestStorageStart, PCBAStorageTestStart)
PCBA_READER(PCBAAutotestSdcardStart, PCBASdcardTestStart)
PCBA_WITH_PARM(PCBAAutotestFmStart, PCBAFmTestStart)
PCBA_WITH_PARM(PCBAAutotestSimStart, PCBASimTestStart)
PCBA_WITH_PARM(PCBAAutotestWgbStart, PCBAWgbTestStart)
PCBA_WITH_PARM(AutotestReadCameraIDStart, ReadCameraIDTestStart)

PCBA_STOP(PCBAAutotestCpuStop)
PCBA_STOP(PCBAAutotestMemoryStop)
PCBA_STOP(PCBAAutotestBluetoothStop)
PCBA_STOP(PCBAAutotestBatteryStop)
PCBA_STOP(PCBAAutotestWifiStop)
PCBA_STOP(PCBAAutotestFmStop)
PCBA_STOP(PCBAAutotestGpsStop)
PCBA_STOP(PCBAAutotestTouchStop)
PCBA_STOP(PCBAAutotestStorageStop)
PCBA_STOP(PCBAAutotestSdcardStop)
PCBA_STOP(PCBAAutotestSimStop)
PCBA_STOP(PCBAAutotestWgbStop)

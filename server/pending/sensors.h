// Stand-ins for the sensor tests (the sensor list, the hall sensors, the fingerprint reader, SAR)
// until each window exists. An entry logs at error priority that its test is not available and
// opens nothing; a family that lands takes its lines out of this list.
#pragma once

#include "pending/pending.h"

#define MMI_PENDING_SENSORS(ENTRY, STOP)                            \
    ENTRY(mmi_testwnd_SensorsTestEntry, "FTX_SENSOR")               \
    STOP(mmi_testwnd_SensorsTest_Stop_Entry, "FTX_SENSOR")          \
    ENTRY(mmi_testwnd_HallSensorTestEntry, "FTX_HALLSENSOR")        \
    STOP(mmi_testwnd_HallSensorTest_Stop_Entry, "FTX_HALLSENSOR")   \
    ENTRY(mmi_testwnd_HallTest_2nd_TestEntry, "FTX_HALL_2ND")       \
    STOP(mmi_testwnd_HallTest_2nd_Stop_Entry, "FTX_HALL_2ND")       \
    ENTRY(mmi_testwnd_FingerPrintTestEntry, "FTX_FINGERPRINT")      \
    STOP(mmi_testwnd_FingerPrintTest_Stop_Entry, "FTX_FINGERPRINT") \
    ENTRY(mmi_testwnd_sar_start, "FTX_SAR")                         \
    STOP(mmi_testwnd_sar_stop, "FTX_SAR")                           \
    ENTRY(mmi_testwnd_Auxiliarysar_start, "FTX_AuxiliarySAR")

MMI_PENDING_SENSORS(MMI_DECLARE_ENTRY, MMI_DECLARE_STOP)

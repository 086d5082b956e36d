// Stand-ins of the sensors tests.
#include "pending/sensors.h"

#include "pending/pending.h"

MMI_PENDING_ENTRY(mmi_testwnd_SensorsTestEntry, "FTX_SENSOR")
MMI_PENDING_STOP(mmi_testwnd_SensorsTest_Stop_Entry, "FTX_SENSOR")
MMI_PENDING_ENTRY(mmi_testwnd_HallSensorTestEntry, "FTX_HALLSENSOR")
MMI_PENDING_STOP(mmi_testwnd_HallSensorTest_Stop_Entry, "FTX_HALLSENSOR")
MMI_PENDING_ENTRY(mmi_testwnd_HallTest_2nd_TestEntry, "FTX_HALL_2ND")
MMI_PENDING_STOP(mmi_testwnd_HallTest_2nd_Stop_Entry, "FTX_HALL_2ND")
MMI_PENDING_ENTRY(mmi_testwnd_FingerPrintTestEntry, "FTX_FINGERPRINT")
MMI_PENDING_STOP(mmi_testwnd_FingerPrintTest_Stop_Entry, "FTX_FINGERPRINT")
MMI_PENDING_ENTRY(mmi_testwnd_sar_start, "FTX_SAR")
MMI_PENDING_STOP(mmi_testwnd_sar_stop, "FTX_SAR")
MMI_PENDING_ENTRY(mmi_testwnd_Auxiliarysar_start, "FTX_AuxiliarySAR")

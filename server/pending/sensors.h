// The sensor tests: the sensor list, the hall sensors, the fingerprint reader and the SAR sensors:
// stand-ins until each window exists. An entry logs at error priority that its test is not
// available and opens nothing.
#pragma once

void *mmi_testwnd_SensorsTestEntry(void);  // FTX_SENSOR
int mmi_testwnd_SensorsTest_Stop_Entry(void);
void *mmi_testwnd_HallSensorTestEntry(void);  // FTX_HALLSENSOR
int mmi_testwnd_HallSensorTest_Stop_Entry(void);
void *mmi_testwnd_HallTest_2nd_TestEntry(void);  // FTX_HALL_2ND
int mmi_testwnd_HallTest_2nd_Stop_Entry(void);
void *mmi_testwnd_FingerPrintTestEntry(void);  // FTX_FINGERPRINT
int mmi_testwnd_FingerPrintTest_Stop_Entry(void);
void *mmi_testwnd_sar_start(void);  // FTX_SAR
int mmi_testwnd_sar_stop(void);
void *mmi_testwnd_Auxiliarysar_start(void);  // FTX_AuxiliarySAR

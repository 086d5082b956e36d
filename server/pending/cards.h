// The card and peripheral tests: SIM, SD, both cards, USB host and NFC: stand-ins until each window
// exists. An entry logs at error priority that its test is not available and opens nothing.
#pragma once

void *mmi_testwnd_SIMCardTestEntry(void);  // FTX_SIMCARD
int mmi_testwnd_SIMCardTest_Stop_Entry(void);
void *mmi_testwnd_SDCardTestEntry(void);  // FTX_SDCARD
int mmi_testwnd_SDCardTest_Stop_Entry(void);
void *mmi_testwnd_USBOTGTestEntry(void);  // FTX_USBHOST
int mmi_testwnd_USBOTGTest_Stop_Entry(void);
void *mmi_testwnd_NfcTestEntry(void);  // FTX_NFC
int mmi_testwnd_NfcTest_Stop_Entry(void);
void *mmi_testwnd_SIMMEMTestEntry(void);  // FTX_CARDS
int mmi_testwnd_SIMMEMTest_Stop_Entry(void);

// The card tests: the SIM slots, the SD card, and both in one window (the all-cards item),
// and the PC's reads of one card.
#pragma once

void *mmi_testwnd_SIMCardTestEntry(void);
int mmi_testwnd_SIMCardTest_Stop_Entry(void);
void *mmi_testwnd_SDCardTestEntry(void);
int mmi_testwnd_SDCardTest_Stop_Entry(void);
void *mmi_testwnd_SIMMEMTestEntry(void);
int mmi_testwnd_SIMMEMTest_Stop_Entry(void);

// The PC's read of SIM slot index: reply "*1" (present) or "*0"; 1 when present, 0 when
// absent or the library cannot tell.
int mmi_AutoTest_SIM_Status_Read(int index, char *reply, unsigned int size);
// The PC's read of SD card index (only 0): reply "*1,SIZE MB" (present) or "*0"; 1 when
// present.
int mmi_AutoTest_SDCARD_Status_Read(int index, char *reply, unsigned int size);

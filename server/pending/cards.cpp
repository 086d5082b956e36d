// Stand-ins of the cards tests.
#include "pending/cards.h"

#include "pending/pending.h"

MMI_PENDING_ENTRY(mmi_testwnd_SIMCardTestEntry, "FTX_SIMCARD")
MMI_PENDING_STOP(mmi_testwnd_SIMCardTest_Stop_Entry, "FTX_SIMCARD")
MMI_PENDING_ENTRY(mmi_testwnd_SDCardTestEntry, "FTX_SDCARD")
MMI_PENDING_STOP(mmi_testwnd_SDCardTest_Stop_Entry, "FTX_SDCARD")
MMI_PENDING_ENTRY(mmi_testwnd_USBOTGTestEntry, "FTX_USBHOST")
MMI_PENDING_STOP(mmi_testwnd_USBOTGTest_Stop_Entry, "FTX_USBHOST")
MMI_PENDING_ENTRY(mmi_testwnd_NfcTestEntry, "FTX_NFC")
MMI_PENDING_STOP(mmi_testwnd_NfcTest_Stop_Entry, "FTX_NFC")
MMI_PENDING_ENTRY(mmi_testwnd_SIMMEMTestEntry, "FTX_CARDS")
MMI_PENDING_STOP(mmi_testwnd_SIMMEMTest_Stop_Entry, "FTX_CARDS")

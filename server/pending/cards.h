// Stand-ins for the card and peripheral tests (SIM, SD, both cards, USB host, NFC, fingerprint)
// until each
// window exists. An entry logs at error priority that its test is not available and opens nothing;
// a family that lands takes its lines out of this list.
#pragma once

#include "pending/pending.h"

#define MMI_PENDING_CARDS(ENTRY, STOP)                         \
    ENTRY(mmi_testwnd_SIMCardTestEntry, "FTX_SIMCARD")         \
    STOP(mmi_testwnd_SIMCardTest_Stop_Entry, "FTX_SIMCARD")    \
    ENTRY(mmi_testwnd_SDCardTestEntry, "FTX_SDCARD")           \
    STOP(mmi_testwnd_SDCardTest_Stop_Entry, "FTX_SDCARD")      \
    ENTRY(mmi_testwnd_USBOTGTestEntry, "FTX_USBHOST")          \
    STOP(mmi_testwnd_USBOTGTest_Stop_Entry, "FTX_USBHOST")     \
    ENTRY(mmi_testwnd_NfcTestEntry, "FTX_NFC")                 \
    STOP(mmi_testwnd_NfcTest_Stop_Entry, "FTX_NFC")            \
    ENTRY(mmi_testwnd_SIMMEMTestEntry, "FTX_CARDS")            \
    STOP(mmi_testwnd_SIMMEMTest_Stop_Entry, "FTX_CARDS")       \
    ENTRY(mmi_testwnd_FingerPrintTestEntry, "FTX_FINGERPRINT") \
    STOP(mmi_testwnd_FingerPrintTest_Stop_Entry, "FTX_FINGERPRINT")

MMI_PENDING_CARDS(MMI_DECLARE_ENTRY, MMI_DECLARE_STOP)

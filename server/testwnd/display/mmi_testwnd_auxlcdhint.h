// The auxiliary-LCD hint: the last item of the main LCD pass tells the operator that the
// handset turns off and the test goes on with the auxiliary display at the next start.
#pragma once

void *mmi_testwnd_AuxLCDHintTestEntry(void);
int mmi_testwnd_AuxLCDHintStop_Entry(void);

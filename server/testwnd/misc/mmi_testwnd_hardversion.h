// The monomer preview's hardware version screen: the panel firmware, judged by the operator.
#pragma once

void *mmi_testwnd_Monomer_HardwareVersionEntry(void);
int mmi_testwnd_Monomer_HardwareVersion_Stop(void);

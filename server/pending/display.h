// The display tests: LCD colours, the auxiliary display hint and the preview's LCD colours:
// stand-ins until each window exists. An entry logs at error priority that its test is not
// available and opens nothing.
#pragma once

void *mmi_LCDColorTestEntry(void);  // FTX_LCD
int mmi_LCDColorTest_Stop_Entry(void);
void *mmi_testwnd_AuxLCDHintTestEntry(void);  // FTX_AUXLCD_HINT
int mmi_testwnd_AuxLCDHintStop_Entry(void);
void *mmi_Monomer_LCDColorTestEntry(void);  // FTX_MONOMER_LCD
int mmi_Monomer_LCDColorTest_Stop_Entry(void);

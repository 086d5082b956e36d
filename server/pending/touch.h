// The touch tests: the panel self-test and the touch screen, in a run and in the preview: stand-ins
// until each window exists. An entry logs at error priority that its test is not available and
// opens nothing.
#pragma once

void *mmi_testwnd_TPSelfTest_Entry(void);  // FTX_TPSELF
int mmi_testwnd_TPSelfTest_Stop(void);
void *mmi_testwnd_touchTestEntry(void);  // FTX_TOUCH
int mmi_AutoTest_touchscreenTest_Stop_Entry(void);
void *mmi_testwnd_Monomer_TPSelfTest_Entry(void);  // FTX_TPSELF
int mmi_testwnd_Monomer_TPSelfTest_Stop(void);
void *mmi_testwnd_Monomer_touchTestEntry(void);  // FTX_TOUCH
int mmi_testwnd_Monomer_touchscreenTest_Stop(void);

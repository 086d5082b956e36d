// The touch panel's self test: the panel firmware, the controller's own verdict through the
// factory library, and on failure the map of the failing channels.
#pragma once

#include <hw/lib_factory.h>

#include "mmi_msg.h"

void *mmi_testwnd_TPSelfTest_Entry(void);
int mmi_testwnd_TPSelfTest_Stop(void);
void *mmi_testwnd_Monomer_TPSelfTest_Entry(void);
int mmi_testwnd_Monomer_TPSelfTest_Stop(void);
// The library's verdict (its own thread).
void tpd_auto_test_callback(module_data *data);
// The failure map of the last verdict.
void *mmi_TP_RawDataDetail_Entry(void);

// The detail lines of a verdict: its language keys joined by '\n' (translated when
// translate is set); the verdicts 0, -1, -2 and -4 are passes (returns 1), others fail (0).
int mmi_tp_verdict_detail(int verdict, char *out, unsigned int size, bool translate);

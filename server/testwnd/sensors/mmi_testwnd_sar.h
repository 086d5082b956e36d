// The SAR sensor tests (the main sensor and the auxiliary one): each passes by itself once
// a body was seen to come near and go.
#pragma once

#include "hw/lib_factory.h"
#include "mmi_msg.h"

void *mmi_testwnd_sar_start(void);
void *mmi_testwnd_Auxiliarysar_start(void);
// Closes whichever SAR window is open.
int mmi_testwnd_sar_stop(void);
// The library's reports (its own thread).
void sar_test_callback(module_data *data);
void aux_sar_test_callback(module_data *data);

// The fingerprint test: passes on a good finger; a bad one asks the operator to try again.
#include "testwnd/cards/mmi_testwnd_fingerprint.h"

#include "testwnd/cards/mmi_card_window.h"

namespace {

int bind_lib(void) {
    return Init_lib_FingerPrint_Interface();
}

int lib_start(ftx_api_module_cb cb) {
    return hw::ftx_api_FingerPrintTest_Start ? hw::ftx_api_FingerPrintTest_Start(cb) : -1;
}
int lib_stop(void) {
    return hw::ftx_api_FingerPrintTest_Stop ? hw::ftx_api_FingerPrintTest_Stop() : -1;
}

void report(module_data *data);

mmi_cardwnd_state s_state;

const mmi_cardwnd_desc kDesc = {
    .row = &catalogue::FingerPrint,
    .caption = "Fingerprint Test",
    .noteKey = "info_FingerNote",
    .bind = bind_lib,
    .start = lib_start,
    .stop = lib_stop,
    .callback = report,
    .labelKey = "card_Finger",
    .failKey = "card_BadFinger",
    .state = &s_state,
    .stopEntry = mmi_testwnd_FingerPrintTest_Stop_Entry,
};

void report(module_data *data) {
    mmi_cardwnd_report(&kDesc, data);
}

}  // namespace

void *mmi_testwnd_FingerPrintTestEntry(void) {
    return mmi_cardwnd_open(&kDesc);
}

int mmi_testwnd_FingerPrintTest_Stop_Entry(void) {
    return mmi_cardwnd_close(&kDesc);
}

int mmi_AutoTest_FingerPrintTestEntry(void) {
    return mmi_cardwnd_pc_open(&kDesc);
}

int mmi_AutoTest_FingerPrintTest_Stop_Entry(char *reply, unsigned int size) {
    return mmi_cardwnd_pc_close(&kDesc, reply, size) > 0 ? 1 : 0;
}

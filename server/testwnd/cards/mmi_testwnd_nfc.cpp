// The NFC test: passes once the reader reports a tag, whose identifier it shows.
#include "testwnd/cards/mmi_testwnd_nfc.h"

#include "testwnd/cards/mmi_card_window.h"

namespace {

int bind_lib(void) {
    return Init_lib_Interface_Nfc();
}

int lib_start(ftx_api_module_cb cb) {
    return hw::ftx_api_NFC_Start ? hw::ftx_api_NFC_Start(cb) : -1;
}
int lib_stop(void) {
    return hw::ftx_api_NFC_Stop ? hw::ftx_api_NFC_Stop() : -1;
}

void report(module_data *data);

mmi_cardwnd_state s_state;

const mmi_cardwnd_desc kDesc = {
    .row = &catalogue::Nfc,
    .caption = "NFC Test",
    .noteKey = "info_NfcNote",
    .bind = bind_lib,
    .start = lib_start,
    .stop = lib_stop,
    .callback = report,
    .labelKey = "card_NfcTag",
    .failKey = "card_NfcFail",
    .state = &s_state,
    .stopEntry = mmi_testwnd_NfcTest_Stop_Entry,
};

void report(module_data *data) {
    mmi_cardwnd_report(&kDesc, data);
}

}  // namespace

void *mmi_testwnd_NfcTestEntry(void) {
    return mmi_cardwnd_open(&kDesc);
}

int mmi_testwnd_NfcTest_Stop_Entry(void) {
    return mmi_cardwnd_close(&kDesc);
}

int mmi_AutoTest_NfcTestEntry(void) {
    return mmi_cardwnd_pc_open(&kDesc);
}

int mmi_AutoTest_NfcTest_Stop_Entry(char *reply, unsigned int size) {
    return mmi_cardwnd_pc_close(&kDesc, reply, size) > 0 ? 1 : 0;
}

// The USB OTG test: passes once the library reports a device plugged into the port.
#include "testwnd/cards/mmi_testwnd_otg.h"

#include "testwnd/cards/mmi_card_window.h"

namespace {

// The operations are optional, bound at start-up.
int bind_lib(void) {
    return hw::ftx_api_USB_OTG_Test_START && hw::ftx_api_USB_OTG_Test_Stop ? 0 : -1;
}

int lib_start(ftx_api_module_cb cb) {
    return hw::ftx_api_USB_OTG_Test_START ? hw::ftx_api_USB_OTG_Test_START(cb) : -1;
}
int lib_stop(void) {
    return hw::ftx_api_USB_OTG_Test_Stop ? hw::ftx_api_USB_OTG_Test_Stop() : -1;
}

void report(module_data *data);

mmi_cardwnd_state s_state;

const mmi_cardwnd_desc kDesc = {
    .row = &catalogue::UsbHost,
    .caption = "USB OTG Test",
    .noteKey = "info_OtgNote",
    .bind = bind_lib,
    .start = lib_start,
    .stop = lib_stop,
    .callback = report,
    .labelKey = "card_OtgDevice",
    .failKey = "card_OtgFail",
    .state = &s_state,
    .stopEntry = mmi_testwnd_USBOTGTest_Stop_Entry,
};

void report(module_data *data) {
    mmi_cardwnd_report(&kDesc, data);
}

}  // namespace

void *mmi_testwnd_USBOTGTestEntry(void) {
    return mmi_cardwnd_open(&kDesc);
}

int mmi_testwnd_USBOTGTest_Stop_Entry(void) {
    return mmi_cardwnd_close(&kDesc);
}

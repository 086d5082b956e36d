// The SAR test family. The library reports both readings (value=N;aux=M); a reading at or
// below the item's Far is nothing near, at or above its Near a body.
#include "testwnd/sensors/mmi_testwnd_sar.h"

#include "testwnd/sensors/mmi_sensor_window.h"

namespace {

#define SAR_LINE(field, label)                                                         \
    {                                                                                  \
        .key = field, .labelKey = label, .kind = MMI_SENSOR_COME_GO, .loParam = "Far", \
        .loDef = 100, .hiParam = "Near", .hiDef = 500, .unit = "", .decimals = 0,      \
        .lowWordKey = "sensor_far", .highWordKey = "sensor_near", .highIsNear = 1      \
    }
const mmi_sensor_line_spec kMain[] = {SAR_LINE("value", "sensor_Sar")};
const mmi_sensor_line_spec kAux[] = {SAR_LINE("aux", "sensor_AuxSar")};

mmi_sensorwnd_state s_main, s_aux;

int start(ftx_api_module_cb cb) {
    return hw::ftx_api_sar_start ? hw::ftx_api_sar_start(cb) : -1;
}
int stop(void) {
    return hw::ftx_api_sar_stop ? hw::ftx_api_sar_stop() : -1;
}

const mmi_sensorwnd_desc kMainSar = {
    .row = &catalogue::Sar,
    .caption = "SAR Test",
    .noteKey = "info_SarNote",
    .lines = kMain,
    .lineCount = 1,
    .bind = Init_lib_sar_Interface,
    .start = start,
    .stop = stop,
    .callback = sar_test_callback,
    .autoPass = 1,
    .state = &s_main,
    .stopEntry = mmi_testwnd_sar_stop,
};

const mmi_sensorwnd_desc kAuxSar = {
    .row = &catalogue::AuxiliarySar,
    .caption = "Auxiliary SAR Test",
    .noteKey = "info_SarNote",
    .lines = kAux,
    .lineCount = 1,
    .bind = Init_lib_sar_Interface,
    .start = start,
    .stop = stop,
    .callback = aux_sar_test_callback,
    .autoPass = 1,
    .state = &s_aux,
    .stopEntry = mmi_testwnd_sar_stop,
};

}  // namespace

void sar_test_callback(module_data *data) {
    mmi_sensorwnd_report(&kMainSar, data);
}

void aux_sar_test_callback(module_data *data) {
    mmi_sensorwnd_report(&kAuxSar, data);
}

void *mmi_testwnd_sar_start(void) {
    s_main.wnd.pcDriven = 0;
    return mmi_sensorwnd_open(&kMainSar);
}

void *mmi_testwnd_Auxiliarysar_start(void) {
    s_aux.wnd.pcDriven = 0;
    return mmi_sensorwnd_open(&kAuxSar);
}

int mmi_testwnd_sar_stop(void) {
    if (s_aux.wnd.hwnd.load() != HWND_INVALID) mmi_sensorwnd_close(&kAuxSar);
    if (s_main.wnd.hwnd.load() != HWND_INVALID) mmi_sensorwnd_close(&kMainSar);
    return 1;
}

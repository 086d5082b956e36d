// The hardware version screen of the monomer preview, a window of the common pattern whose
// body is the panel firmware.
#include "testwnd/misc/mmi_testwnd_hardversion.h"

#include <android/log.h>

#include "testwnd/mmi_testwnd.h"
#include "tp_os.h"

namespace {

mmi_testwnd_state s_state;

// The panel firmware as the library describes it.
void firmware_note(char *out, unsigned int size) {
    char buf[FTX_FIRMWARE_TEXT_SIZE] = {0};
    if (!hw::ftx_api_GetFireWare || hw::ftx_api_GetFireWare(buf) != 0) {
        __android_log_print(ANDROID_LOG_ERROR, catalogue::MonomerHardVersion.domain,
                            "%s ftx_api_GetFireWare fail", __func__);
    }
    buf[sizeof(buf) - 1] = '\0';
    tp_os_strlcpy(out, buf, size);
}

const mmi_testwnd_desc kHardVersion = {
    .row = &catalogue::MonomerHardVersion,
    .caption = "Hardware Version",
    .foolProofSeconds = 1,
    .state = &s_state,
    .stopEntry = mmi_testwnd_Monomer_HardwareVersion_Stop,
    .run = MMI_RUN_MONOMER,
    .bind = Init_lib_HardVersion_Interface,
    .note = firmware_note,
};

}  // namespace

void *mmi_testwnd_Monomer_HardwareVersionEntry(void) {
    return mmi_testwnd_open(&kHardVersion, 0);
}

int mmi_testwnd_Monomer_HardwareVersion_Stop(void) {
    return mmi_testwnd_close(&kHardVersion);
}

// Kernel files written at boot.
#include "kernel_files.h"

#include <stdio.h>
#include <strings.h>

#include <android/log.h>

#include "devfs.h"
#include "ftx_host.h"

namespace ftxhost {

const char *panel_description(const char *type) {
    if (type != nullptr && strcasecmp(type, "Truly") == 0)
        return "panel=qcom,mdss_dsi_dvkTruly_hx83112a_1080p_video\n";
    return "panel=qcom,mdss_dsi_dvkJDI_nt36672a_1080p_video\n";
}

void write_boot_kernel_files() {
    char type[64];
    ftx_device_ini_get("panel", "type", type, sizeof(type), "JDI");
    FILE *f = dev_fopen("/proc/msm_lcd", "w");
    if (f == nullptr) {
        __android_log_print(ANDROID_LOG_WARN, "PLATFORM", "cannot write /proc/msm_lcd");
        return;
    }
    fputs(panel_description(type), f);
    fclose(f);
}

}  // namespace ftxhost

// Kernel files the simulated handset's kernel writes when it boots (the application's start):
// the panel description /proc/msm_lcd, whose driver name carries the panel maker chosen by
// [panel] type= of sim/device.ini (JDI, the default, or Truly).
#pragma once

namespace ftxhost {

// The text of /proc/msm_lcd for a [panel] type value (an unknown one gives JDI's).
const char *panel_description(const char *type);
void write_boot_kernel_files();

}  // namespace ftxhost

// Kernel files of the simulated handset. At boot (the application's start) the kernel writes
// the panel description /proc/msm_lcd, whose driver name carries the panel maker chosen by
// [panel] type= of sim/device.ini (JDI, the default, or Truly), unblanks the panel at full
// backlight (a handset that went down asleep comes up lit), and makes the RTC alarm and
// power state files when the root lacks them.
//
// Two files act on what is written into them through dev_fopen, as their drivers do (each
// flush of the stream is one write): /sys/class/rtc/rtc0/wakealarm arms the RTC alarm at an
// epoch time ("+N": N seconds from now) and clears it with "0" or a past time, and refuses a
// new time while one is armed (EBUSY); "mem" written into /sys/power/state suspends. The
// suspend is a simulation: only the writing thread sleeps, until the armed alarm time (then
// the alarm is cleared, as after it fires) or, with none armed, until a key press or the
// console's "wake".
#pragma once

#include <stdio.h>

namespace ftxhost {

// The text of /proc/msm_lcd for a [panel] type value (an unknown one gives JDI's).
const char *panel_description(const char *type);
void write_boot_kernel_files();

// dev_fopen's stream for a kernel file that acts on writes, when mode writes: true with *out
// (null with errno set when the file is missing), false when devicePath is not such a file
// or mode only reads (a plain stream then reads it).
bool open_kernel_file(const char *devicePath, const char *hostPath, const char *mode, FILE **out);

// Wakes a suspended handset as a key press does; false when no suspend was under way.
bool resume_by_key();

}  // namespace ftxhost

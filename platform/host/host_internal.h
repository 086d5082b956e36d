// Shared between the host platform's own files only.
#pragma once

#include <string>

namespace ftxhost {

// Parses "section.key" settings of $FTX_ROOT/sim/device.ini on first use.
void device_ini_reset();
void properties_reset();
void log_reset();
void root_reset();
void mounts_reset();

// Current wall time as "MM-DD HH:MM:SS.mmm".
std::string timestamp();

}  // namespace ftxhost

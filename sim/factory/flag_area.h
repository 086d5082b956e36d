// The persistent 256-byte result flag area: $FTX_ROOT/sim/testinfo_flags.bin.
#pragma once

namespace ftxsim {

// Fills flags (256 bytes) from the file; a missing or short file reads as zeros.
void flags_load(unsigned char *flags);
// Replaces the file atomically (temporary file, fsync, rename, fsync of the folder), so a
// kill at any moment leaves either the old or the new area. Returns 0 or -1.
int flags_store(const unsigned char *flags);
// Read-modify-write of one byte under the process's lock. Returns 0 or -1.
int flags_write_byte(int index, unsigned char value);

}  // namespace ftxsim

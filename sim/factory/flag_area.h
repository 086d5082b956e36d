// The persistent 256-byte result flag area: $FTX_ROOT/sim/testinfo_flags.bin.
#pragma once

namespace ftxsim {

// Fills flags (256 bytes) from the file; a missing or short file reads as zeros.
void flags_load(unsigned char *flags);
// Replaces the file atomically (temporary file, fsync, rename, fsync of the folder), so a
// kill at any moment leaves either the old or the new area. Returns 0, or -1 with an error
// in the log.
int flags_store(const unsigned char *flags);
// Sets the bits of mask in byte index to those of bits, the others as stored. Every change
// of the area (this, flags_write_byte, flags_store) is made under one lock, so a change
// never undoes another made at the same time. Returns 0 or -1.
int flags_update(int index, unsigned char mask, unsigned char bits);
// Replaces one byte. Returns 0 or -1.
int flags_write_byte(int index, unsigned char value);
// Removes the temporaries of writers that are no longer running (a kill between the write
// and the rename leaves one behind). Returns how many were removed.
int flags_clear_stale();

}  // namespace ftxsim

// Parameter handling of the "FileOptMoudle" file operations, kept apart from the channel so
// it can be tested and fuzzed alone.
#pragma once

#include <stddef.h>

#include <string>

namespace ftxsim {

// Checks a device path from the PC: absolute, no ".." part, no control bytes, not too long.
// On success host holds the path in the device root; else reason says why.
bool fileopt_confine(const std::string &path, std::string *host, std::string *reason);
// Decodes the escapes of a write's data: \n \r \t \\ \xHH. False on a bad escape.
bool fileopt_unescape(const std::string &in, std::string *out);

// The three operations on their parameter text; the answer goes to reply: "*..." on success,
// "ERROR <reason>" on failure. Return 1 on success, 0 on failure. length gets the reply's
// byte count (a read may carry NUL bytes).
int fileopt_read(const std::string &parm, char *reply, size_t size, size_t *length);
int fileopt_write(const std::string &parm, char *reply, size_t size);
int fileopt_remove(const std::string &parm, char *reply, size_t size);

}  // namespace ftxsim

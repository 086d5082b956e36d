// The start-up check of the device root.
#pragma once

#include <stddef.h>

namespace ftxhost {

// 0 when the device root and the folders the handset writes in it take new files; else -1
// with the folder and the reason in why.
int root_writable(char *why, size_t size);

// Ends the process with a message on standard error when the root cannot be written: a
// handset that cannot store its results must not look as if it ran.
void require_writable_root();

}  // namespace ftxhost

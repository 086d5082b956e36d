// Writing a device file so that a power cut leaves its old content or the new one, never
// a part of it.
#pragma once

#include <stddef.h>

// Writes len bytes of data beside path (path + ".tmp"), syncs them to storage, renames the
// neighbour over path and syncs the folder's entry. 0, or -1 with path as it was and no
// neighbour left behind.
int mmi_file_replace(const char *path, const void *data, size_t len);

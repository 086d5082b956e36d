// Writable INI profile files ("[section]" headers, "key=value" lines, ';' comments),
// read whole into memory, matched exactly, rewritten in place. Paths are device paths.
#pragma once

#include <stddef.h>

#define FTX_PROFILE_BUF_SIZE 16384

// 0 when found; otherwise def (if not null) is copied with a size-bounded copy and -1.
int read_profile_string(const char *section, const char *key, char *out, size_t size,
                        const char *def, const char *path);
// def when the key is missing, else atoi of the value.
int read_profile_int(const char *section, const char *key, int def, const char *path);
// 0, or -1 when the file cannot be written.
int write_profile_string(const char *section, const char *key, const char *value, const char *path);
int write_profile_int(const char *section, const char *key, int value, const char *path);

// Finds key in section of a NUL-terminated buffer. Fills the six positions (-1 when not
// found): section start and end (the ']'), key start and end, value start and end (the
// value's last character, or value start - 1 when the value is empty). 1 when the key was
// found, 0 otherwise.
int parse_file(const char *section, const char *key, const char *buf, int *sec_s, int *sec_e,
               int *key_s, int *key_e, int *value_s, int *value_e);

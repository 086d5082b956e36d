// Plain-text event logs on the device (the main one is ftx.log in the log folder). One mutex
// serialises every open, write and close; each entry is flushed and synced before return.
#pragma once

#include <stddef.h>
#include <stdio.h>
#include <time.h>

// The main event log; null when it could not be opened (writes are then refused).
extern FILE *s_logFp;

// Opens directory/file_name for appending, creating the directory path. Stores the stream
// or null through stream_out; 0 or -1.
int init_ftx_log(FILE **stream_out, const char *directory, const char *file_name);
// Opens the main log ftx.log in directory (the configured log folder); 0 or -1.
int ftx_initlog(const char *directory);
// "MM/DD-HH:MM:SS [label] message"; 0, or -1 on a null stream.
int writeftxlog(FILE *stream, const char *label, const char *format, ...)
    __attribute__((format(printf, 3, 4)));
// "[label]" newline "message"; 0, or -1 on a null stream.
int writeftxlog_NoTime(FILE *stream, const char *label, const char *format, ...)
    __attribute__((format(printf, 3, 4)));
// Closes stream when not null; 0.
int uninit_ftxlog(FILE *stream);

// Creates every missing directory of the device path; 0, or non-zero on failure. Not
// re-entrant: call it under the log mutex (init_ftx_log does).
int mkdir_main(const char *path);

// Replaces the clock of the time stamps (tests); null restores time().
typedef time_t (*ftx_log_clock_fn)(void);
void ftx_log_set_clock(ftx_log_clock_fn fn);

// The UTC time as asctime text into out (min(out_size, 256) bytes copied); 0.
int Conver_time2ASC(long seconds, long nanoseconds, char *out, size_t out_size);

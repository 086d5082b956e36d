// The text of a PCBA event from the hardware library: "VALUE,RESULT", the value a decimal
// number (a frequency, a size, a count) and the result 1 for a pass (a failure may be
// negative).
#pragma once

#include <stddef.h>

struct mmi_pcba_event {
    unsigned long long value = 0;
    int result = 0;  // 1 pass, anything else a fail
};

// Reads the first len bytes of text (it may hold no NUL); 0, or -1 when the text is not of
// that form (blanks around either number are allowed, nothing else).
int mmi_pcba_parse_event(const char *text, size_t len, mmi_pcba_event *out);

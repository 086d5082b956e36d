// The panel self test's failure data: the grid size and the failing points, as the factory
// library's text gives them ("x,y,num,px,py,px,py,...").
#pragma once

#include <stdint.h>

// At most this many failing points are kept (a panel has far fewer channels).
#define MMI_TP_RAW_MAX_POINTS 65536

struct mmi_tp_raw {
    int32_t x, y;    // grid size
    int32_t num;     // failing points
    uint32_t *p;     // num pairs of x and y grid positions (heap)
    int32_t filled;  // values read into p
};

// Parses text into out (whose earlier array is released); logs under tag. 0, or -1 when
// x, y or num is missing (out then holds what was read before the gap, no array).
int mmi_tp_raw_parse(const char *text, mmi_tp_raw *out, const char *tag);
void mmi_tp_raw_free(mmi_tp_raw *raw);
// The screen box (x, y, width, height) of failing point `point` on a w x h screen; -1 when
// the grid is empty or the point is outside it or was not read.
int mmi_tp_raw_cell(const mmi_tp_raw *raw, int point, int w, int h, int box[4]);

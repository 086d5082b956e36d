// The shapes the touch tests fill: the frame of cells around the screen edge and the rings
// of a round screen, with where a touch lands in them. No window here: the tests' windows
// draw them.
#pragma once

#include <stdint.h>

// ---- the cell frame ----

// Strips, in numbering order.
enum { MMI_STRIP_LEFT, MMI_STRIP_BOTTOM, MMI_STRIP_TOP, MMI_STRIP_RIGHT, MMI_STRIPS };

struct mmi_strip {
    int64_t left, top, right, bottom;
};

struct mmi_cells {
    mmi_strip strip[MMI_STRIPS];
    int32_t cellWidth;   // thickness of every strip
    int32_t cellHeight;  // length of one cell along its strip
    uint32_t cellCount[MMI_STRIPS];
    uint32_t lineColour, fillColour;
    uint8_t *touched;  // one byte per cell, strip by strip
    int32_t totalCount;
    int32_t drawCount;
};

// The cell length for a screen w wide and a configured length (0: from the width).
int mmi_cells_length(int w, int rectWidth);
// Builds the frame for a w x h screen (logged under tag); 0, or -1 when the touched map
// cannot be allocated (the frame is then unusable).
int initCells(mmi_cells *cells, int w, int h, int rectWidth, const char *tag);
void mmi_cells_free(mmi_cells *cells);
// The cell under (x, y) and its strip, or -1 when the point is in no strip.
int mmi_cells_index(const mmi_cells *cells, int x, int y, int *strip);
// The box of cell `index` inset by one pixel on each side (left, top, right, bottom).
void mmi_cells_box(const mmi_cells *cells, int index, int box[4]);
// Marks the cell under (x, y); true when it was not marked before.
bool mmi_cells_mark(mmi_cells *cells, int x, int y, int *index);

// ---- the rings ----

#define MMI_RING_MAX_SECTORS 40

struct mmi_circle {
    int32_t radius, cx, cy;
    int32_t divided_num;
    struct {
        int32_t x, y;
        float angle;
    } point[MMI_RING_MAX_SECTORS + 1];
};

// A ring: its outer and inner edge, and which of its sectors were touched.
struct mmi_ring {
    mmi_circle outer, inner;
    uint8_t clicked[MMI_RING_MAX_SECTORS + 1];
    int32_t iClickedNum;
    bool enabled;
};

// The boundary points of a circle (angle 2*pi*j/n, y growing downwards on the screen).
void initCircls(mmi_circle *c, int radius, int cx, int cy, int sectors);
// The two rings of a screen w wide: the outer one always, the inner one when enabled.
void mmi_rings_init(mmi_ring *outer, mmi_ring *inner, int w, bool innerEnabled);
// The angle of (x, y) around the centre, 0..2*pi counter-clockwise from the positive x
// axis (y up), and the distance from it.
double mmi_ring_angle(int cx, int cy, int x, int y, double *distance);
// The sector of the ring under (x, y) (1..divided_num), or -1 when the point lies outside
// the ring (logged under tag).
int mmi_ring_sector(const mmi_ring *ring, int x, int y, const char *tag);
// Marks that sector; true when it was not marked before.
bool mmi_ring_mark(mmi_ring *ring, int sector);
// Every sector of the ring touched (always true for a ring that is not used).
bool mmi_ring_full(const mmi_ring *ring);

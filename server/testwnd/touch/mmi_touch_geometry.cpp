// The cell frame and the rings.
#include "testwnd/touch/mmi_touch_geometry.h"

#include <errno.h>
#include <math.h>
#include <stdlib.h>
#include <string.h>

#include <android/log.h>

#define GEO_DEBUG(tag, ...) __android_log_print(ANDROID_LOG_DEBUG, tag, __VA_ARGS__)
#define GEO_ERROR(tag, ...) __android_log_print(ANDROID_LOG_ERROR, tag, __VA_ARGS__)

namespace {

const double kPi = 3.1415926;

// The largest length of [lo, hi] that divides w, else fallback.
int dividing_length(int w, int hi, int lo, int fallback) {
    for (int len = hi; len >= lo; len--)
        if (w % len == 0) return len;
    return fallback;
}

bool inside(const mmi_strip &s, int x, int y) {
    return s.left < x && x < s.right && s.top < y && y < s.bottom;
}

bool vertical(int strip) {
    return strip == MMI_STRIP_LEFT || strip == MMI_STRIP_RIGHT;
}

// The first cell of each strip.
uint32_t first_cell(const mmi_cells *c, int strip) {
    uint32_t n = 0;
    for (int s = 0; s < strip; s++)
        n += c->cellCount[s];
    return n;
}

}  // namespace

int mmi_cells_length(int w, int rectWidth) {
    int h = rectWidth;
    if (h == 0) h = w < 720 ? dividing_length(w, 20, 11, 10) : dividing_length(w, 40, 21, 20);
    return h < 10 ? 10 : h;
}

int initCells(mmi_cells *cells, int w, int h, int rectWidth, const char *tag) {
    free(cells->touched);
    memset(cells, 0, sizeof(*cells));
    const int len = mmi_cells_length(w, rectWidth);
    cells->cellHeight = len;
    GEO_DEBUG(tag, "%s::1111 cells->cellHeight=%d", __func__, len);
    const int n = (w / 3) / len;
    const int t = n * len;
    cells->cellWidth = t;

    // Along the top and bottom rows; a rest over half a cell makes one more cell.
    const int m = (w - 2 * t) / len;
    int rest = w - (2 * n + m) * len;
    int k = n + m;
    GEO_DEBUG(tag, "%s::temp1 1111=%d,CELLCOUNT2 1111=%d", __func__, rest, k);
    if (10 * rest > 5 * len) k++;
    GEO_DEBUG(tag, "%s::temp1 2222=%d,CELLCOUNT2 2222=%d", __func__, rest, k);

    // Along the left and right columns.
    int c = (h - t) / len;
    rest = (h - t) % len;
    GEO_DEBUG(tag, "%s::temp1 1111=%d,cells->cellCount[0] 1111=%d", __func__, rest, c);
    if (10 * rest > 5 * len) c++;
    GEO_DEBUG(tag, "%s::temp1 2222=%d,cells->cellCount[0] 2222=%d", __func__, rest, c);
    GEO_DEBUG(tag, "TESTWND_HEIGHT = %d,cells->cellWidth=%d,cells->cellHeight=%d", h, t, len);

    // The one-pixel gaps between the strips are part of the layout.
    const int64_t ch = (int64_t)c * len, kh = (int64_t)k * len;
    cells->strip[MMI_STRIP_LEFT] = {0, 0, t, ch};
    cells->strip[MMI_STRIP_BOTTOM] = {0, ch + 1, kh, ch + 1 + t};
    cells->strip[MMI_STRIP_TOP] = {t + 1, 0, t + 1 + kh, t};
    cells->strip[MMI_STRIP_RIGHT] = {kh + 1, t + 1, kh + 1 + t, t + 1 + ch};
    cells->cellCount[MMI_STRIP_LEFT] = (uint32_t)c;
    cells->cellCount[MMI_STRIP_BOTTOM] = (uint32_t)k;
    cells->cellCount[MMI_STRIP_TOP] = (uint32_t)k;
    cells->cellCount[MMI_STRIP_RIGHT] = (uint32_t)c;
    cells->totalCount = 2 * (k + c);
    cells->drawCount = 0;
    cells->touched = static_cast<uint8_t *>(calloc((size_t)cells->totalCount, 1));
    if (cells->touched == nullptr) {
        GEO_ERROR(tag, "initCells: Fail to calloc memory ,errno(%d)", errno);
        return -1;
    }
    return 0;
}

void mmi_cells_free(mmi_cells *cells) {
    free(cells->touched);
    cells->touched = nullptr;
}

int mmi_cells_index(const mmi_cells *cells, int x, int y, int *strip) {
    for (int s = 0; s < MMI_STRIPS; s++) {
        const mmi_strip &r = cells->strip[s];
        if (!inside(r, x, y)) continue;
        const int64_t offset = vertical(s) ? y - r.top : x - r.left;
        const int64_t along = offset / cells->cellHeight;
        if (along >= (int64_t)cells->cellCount[s]) return -1;
        if (strip != nullptr) *strip = s;
        return (int)(first_cell(cells, s) + along);
    }
    return -1;
}

void mmi_cells_box(const mmi_cells *cells, int index, int box[4]) {
    int s = 0;
    while (s < MMI_STRIPS - 1 && index >= (int)(first_cell(cells, s) + cells->cellCount[s]))
        s++;
    const mmi_strip &r = cells->strip[s];
    const int along = index - (int)first_cell(cells, s);
    const int64_t from = (int64_t)along * cells->cellHeight, to = from + cells->cellHeight;
    if (vertical(s)) {
        box[0] = (int)r.left + 1;
        box[1] = (int)(r.top + from) + 1;
        box[2] = (int)r.right - 1;
        box[3] = (int)(r.top + to) - 1;
    } else {
        box[0] = (int)(r.left + from) + 1;
        box[1] = (int)r.top + 1;
        box[2] = (int)(r.left + to) - 1;
        box[3] = (int)r.bottom - 1;
    }
}

bool mmi_cells_mark(mmi_cells *cells, int x, int y, int *index) {
    if (cells->touched == nullptr) return false;
    const int i = mmi_cells_index(cells, x, y, nullptr);
    if (i < 0 || i >= cells->totalCount || cells->touched[i]) return false;
    cells->touched[i] = 1;
    cells->drawCount++;
    if (index != nullptr) *index = i;
    return true;
}

// ---- rings ----

void initCircls(mmi_circle *c, int radius, int cx, int cy, int sectors) {
    if (sectors > MMI_RING_MAX_SECTORS) sectors = MMI_RING_MAX_SECTORS;
    c->radius = radius;
    c->cx = cx;
    c->cy = cy;
    c->divided_num = sectors;
    for (int j = 0; j <= sectors; j++) {
        const double a = 2 * kPi * j / sectors;
        c->point[j].angle = (float)a;
        c->point[j].x = (int32_t)(cx + radius * cos(a));
        c->point[j].y = (int32_t)(cy - radius * sin(a));
    }
}

void mmi_rings_init(mmi_ring *outer, mmi_ring *inner, int w, bool innerEnabled) {
    memset(outer, 0, sizeof(*outer));
    memset(inner, 0, sizeof(*inner));
    const int c = w / 2;
    initCircls(&outer->outer, w / 2 - w / 40, c, c, 40);
    initCircls(&outer->inner, w / 4 + 5, c, c, 40);
    outer->enabled = true;
    initCircls(&inner->outer, w / 4, c, c, 20);
    initCircls(&inner->inner, 1, c, c, 20);
    inner->enabled = innerEnabled;
}

double mmi_ring_angle(int cx, int cy, int x, int y, double *distance) {
    const double dx = x - cx, dy = cy - y;
    *distance = sqrt(dx * dx + dy * dy);
    double a = atan2(dy, dx);
    if (a < 0) a += 2 * kPi;
    return a;
}

int mmi_ring_sector(const mmi_ring *ring, int x, int y, const char *tag) {
    const mmi_circle &out = ring->outer;
    double distance;
    const double a = mmi_ring_angle(out.cx, out.cy, x, y, &distance);
    if (distance < ring->inner.radius || distance > out.radius) {
        GEO_ERROR(tag, "20150607 %s unused point,x=%d,y=%d", "Circle_Test_Start", x, y);
        return -1;
    }
    for (int j = 1; j <= out.divided_num; j++)
        if (a <= out.point[j].angle) return j;
    // Rounding can leave an angle just under 2*pi above the last boundary's float.
    return out.divided_num;
}

bool mmi_ring_mark(mmi_ring *ring, int sector) {
    if (sector < 1 || sector > ring->outer.divided_num || ring->clicked[sector]) return false;
    ring->clicked[sector] = 1;
    ring->iClickedNum++;
    return true;
}

bool mmi_ring_full(const mmi_ring *ring) {
    return !ring->enabled || ring->iClickedNum >= ring->outer.divided_num;
}

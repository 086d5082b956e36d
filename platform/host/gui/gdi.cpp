// Device contexts and shapes. Every drawing call clips to the DC's region (what of the
// window is on screen, narrowed by the program's clip calls) and writes the framebuffer
// under its lock.
#include <math.h>
#include <string.h>
#include <wchar.h>

#include <algorithm>

#include "gui_internal.h"

namespace ftxgui {

// ---- regions ----------------------------------------------------------------------------

void Region::set(const RECT &rc) {
    rects.clear();
    if (!IsRectEmpty(&rc)) rects.push_back(rc);
}

void Region::intersect(const RECT &rc) {
    std::vector<RECT> out;
    for (const RECT &r : rects) {
        RECT i;
        if (IntersectRect(&i, &r, &rc)) out.push_back(i);
    }
    rects.swap(out);
}

void Region::intersect(const Region &r) {
    std::vector<RECT> out;
    for (const RECT &a : rects)
        for (const RECT &b : r.rects) {
            RECT i;
            if (IntersectRect(&i, &a, &b)) out.push_back(i);
        }
    rects.swap(out);
}

void Region::subtract(const RECT &cut) {
    std::vector<RECT> out;
    for (const RECT &r : rects) {
        RECT i;
        if (!IntersectRect(&i, &r, &cut)) {
            out.push_back(r);
            continue;
        }
        if (r.top < i.top) out.push_back(RECT{r.left, r.top, r.right, i.top});
        if (i.bottom < r.bottom) out.push_back(RECT{r.left, i.bottom, r.right, r.bottom});
        if (r.left < i.left) out.push_back(RECT{r.left, i.top, i.left, i.bottom});
        if (i.right < r.right) out.push_back(RECT{i.right, i.top, r.right, i.bottom});
    }
    rects.swap(out);
}

void Region::unite(const RECT &rc) {
    if (IsRectEmpty(&rc)) return;
    subtract(rc);
    rects.push_back(rc);
}

bool Region::contains(int x, int y) const {
    for (const RECT &r : rects)
        if (PtInRect(&r, x, y)) return true;
    return false;
}

RECT Region::bounds() const {
    RECT b{0, 0, 0, 0};
    for (const RECT &r : rects)
        UnionRect(&b, &b, &r);
    return b;
}

// ---- pixels -----------------------------------------------------------------------------

gal_pixel rgb_pixel(int r, int g, int b) {
    return (static_cast<Uint32>(r & 0xFF) << 16) | (static_cast<Uint32>(g & 0xFF) << 8) |
           static_cast<Uint32>(b & 0xFF);
}

static void fill_raw(RECT rc, gal_pixel px) {
    RECT scr{0, 0, g_fbW, g_fbH};
    if (!IntersectRect(&rc, &rc, &scr)) return;
    int w = rc.right - rc.left;
    static_assert(sizeof(wchar_t) == sizeof(Uint32), "pixels are filled as wide characters");
    if (w == g_fbW) {
        // Whole rows are one run of memory.
        wmemset(reinterpret_cast<wchar_t *>(g_fb + static_cast<size_t>(rc.top) * g_fbW),
                static_cast<wchar_t>(px), static_cast<size_t>(w) * (rc.bottom - rc.top));
        return;
    }
    for (int y = rc.top; y < rc.bottom; y++)
        wmemset(reinterpret_cast<wchar_t *>(g_fb + static_cast<size_t>(y) * g_fbW + rc.left),
                static_cast<wchar_t>(px), static_cast<size_t>(w));
}

void fill_screen_rect_locked_fb(const Region &clip, const RECT &rc, gal_pixel px) {
    for (const RECT &c : clip.rects) {
        RECT i;
        if (IntersectRect(&i, &c, &rc)) fill_raw(i, px);
    }
}

void px_fill(const DC *dc, RECT rc, gal_pixel px) {
    fill_screen_rect_locked_fb(dc->clip, rc, px);
}

void px_blend(const DC *dc, int x, int y, gal_pixel px, int alpha) {
    if (alpha <= 0 || !dc->clip.contains(x, y)) return;
    Uint32 &d = g_fb[static_cast<size_t>(y) * g_fbW + x];
    if (alpha >= 255) {
        d = px;
        return;
    }
    int inv = 255 - alpha;
    int r = (((px >> 16) & 0xFF) * alpha + ((d >> 16) & 0xFF) * inv) / 255;
    int g = (((px >> 8) & 0xFF) * alpha + ((d >> 8) & 0xFF) * inv) / 255;
    int b = ((px & 0xFF) * alpha + (d & 0xFF) * inv) / 255;
    d = rgb_pixel(r, g, b);
}

// ---- device contexts --------------------------------------------------------------------

namespace {

thread_local DC t_screenDc;
thread_local bool t_screenReady = false;

DC *screen_dc() {
    RECT scr{0, 0, g_fbW, g_fbH};
    if (!t_screenReady || t_screenDc.base.rects.empty() ||
        !EqualRect(&t_screenDc.base.rects[0], &scr)) {
        t_screenDc = DC{};
        t_screenDc.base.set(RECT{0, 0, g_fbW, g_fbH});
        t_screenDc.clip = t_screenDc.base;
        t_screenDc.font = g_SysLogFont[SYSLOGFONT_DEFAULT];
        t_screenReady = true;
    }
    return &t_screenDc;
}

int half_low(int w) {
    return (w - 1) / 2;
}

// A pen dot: w x w pixels centred on the point.
void pen_dot(DC *dc, int x, int y) {
    int w = std::max(dc->penWidth, 1);
    if (w == 1) {
        if (dc->clip.contains(x, y)) g_fb[static_cast<size_t>(y) * g_fbW + x] = dc->pen;
        return;
    }
    int l = x - half_low(w), t = y - half_low(w);
    px_fill(dc, RECT{l, t, l + w, t + w}, dc->pen);
}

// A line in screen coordinates, both ends included.
void line_screen(DC *dc, int x0, int y0, int x1, int y1) {
    int w = std::max(dc->penWidth, 1);
    if (y0 == y1 || x0 == x1) {
        int l = std::min(x0, x1), r = std::max(x0, x1), t = std::min(y0, y1), b = std::max(y0, y1);
        px_fill(dc,
                RECT{l - half_low(w), t - half_low(w), r - half_low(w) + w, b - half_low(w) + w},
                dc->pen);
        return;
    }
    int dx = abs(x1 - x0), sx = x0 < x1 ? 1 : -1;
    int dy = -abs(y1 - y0), sy = y0 < y1 ? 1 : -1;
    int err = dx + dy;
    for (;;) {
        pen_dot(dc, x0, y0);
        if (x0 == x1 && y0 == y1) break;
        int e2 = 2 * err;
        if (e2 >= dy) {
            err += dy;
            x0 += sx;
        }
        if (e2 <= dx) {
            err += dx;
            y0 += sy;
        }
    }
}

}  // namespace

DcDraw::DcDraw(DC *dc) {
    g_fbLock.lock();
    // Until the window system stayed still between the narrowing and the lock.
    while (dc->win != nullptr && dc->zGen != g_zGen.load()) {
        // The window system's lock comes before the framebuffer's.
        g_fbLock.unlock();
        {
            std::lock_guard<std::mutex> lk(g_lock);
            Region now;  // empty once the window is gone
            if (alive_locked(dc->win)) visible_region_locked(dc->win, dc->client, now);
            dc->base.intersect(now);
            dc->clip.intersect(now);
            dc->zGen = g_zGen.load();
        }
        g_fbLock.lock();
    }
}

DcDraw::~DcDraw() {
    g_fbSerial++;
    g_fbLock.unlock();
}

DC *as_dc(HDC hdc) {
    if (hdc == HDC_SCREEN) return g_fb != nullptr ? screen_dc() : nullptr;
    if (hdc == HDC_INVALID) return nullptr;
    DC *dc = static_cast<DC *>(hdc);
    return dc->magic == kDcMagic ? dc : nullptr;
}

HDC make_dc(Window *w, bool client, bool) {
    DC *dc = new DC;
    std::lock_guard<std::mutex> lk(g_lock);
    if (w == nullptr) {
        dc->base.set(RECT{0, 0, g_fbW, g_fbH});
        dc->font = g_SysLogFont[SYSLOGFONT_DEFAULT];
    } else {
        RECT r = client ? client_screen_rect_locked(w) : window_screen_rect_locked(w);
        dc->ox = r.left;
        dc->oy = r.top;
        dc->win = w;
        dc->client = client;
        dc->zGen = g_zGen.load();
        visible_region_locked(w, client, dc->base);
        dc->font = w->font != nullptr ? w->font : g_SysLogFont[SYSLOGFONT_DEFAULT];
    }
    dc->clip = dc->base;
    return dc;
}

void free_dc(HDC hdc) {
    DC *dc = as_dc(hdc);
    if (dc == nullptr || hdc == HDC_SCREEN) return;
    dc->magic = 0;
    delete dc;
}

int dc_font_height(HDC hdc) {
    DC *dc = as_dc(hdc);
    return dc != nullptr && dc->font != nullptr ? dc->font->size : 0;
}

void draw_border(Window *w) {
    HDC hdc = make_dc(w, false, false);
    DC *dc = as_dc(hdc);
    RECT r;
    {
        std::lock_guard<std::mutex> lk(g_lock);
        r = window_screen_rect_locked(w);
    }
    {
        DcDraw fb(dc);
        draw_frame_screen(dc->clip, r, SysPixelIndex[20]);
    }
    free_dc(hdc);
}

void draw_frame_screen(const Region &clip, const RECT &r, gal_pixel px) {
    fill_screen_rect_locked_fb(clip, RECT{r.left, r.top, r.right, r.top + 1}, px);
    fill_screen_rect_locked_fb(clip, RECT{r.left, r.bottom - 1, r.right, r.bottom}, px);
    fill_screen_rect_locked_fb(clip, RECT{r.left, r.top, r.left + 1, r.bottom}, px);
    fill_screen_rect_locked_fb(clip, RECT{r.right - 1, r.top, r.right, r.bottom}, px);
}

}  // namespace ftxgui

using namespace ftxgui;

extern "C" {

HDC BeginPaint(HWND h) {
    Window *w;
    RECT inv{};
    bool erase = false, border = false, transparent = false;
    {
        std::lock_guard<std::mutex> lk(g_lock);
        w = as_window_locked(h);
        if (w == nullptr) return HDC_INVALID;
        inv = w->inv;
        erase = w->erase;
        border = (w->style & WS_BORDER) != 0;
        transparent = (w->exStyle & WS_EX_TRANSPARENT) != 0;
        w->inv = RECT{};
        w->erase = false;
        w->paintPending = false;
    }
    if (border) draw_border(w);
    HDC hdc = make_dc(w, true, true);
    // A paint asked for by a sent MSG_PAINT has no invalid part: it repaints everything.
    if (!IsRectEmpty(&inv)) ClipRectIntersect(hdc, &inv);
    if (erase && !transparent) SendMessage(h, MSG_ERASEBKGND, reinterpret_cast<WPARAM>(hdc), 0);
    return hdc;
}

void EndPaint(HWND, HDC hdc) {
    free_dc(hdc);
}

HDC GetClientDC(HWND h) {
    if (h == HWND_DESKTOP || h == nullptr) return make_dc(nullptr, true, false);
    std::unique_lock<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    lk.unlock();
    if (w == nullptr) return HDC_INVALID;
    return make_dc(w, true, false);
}

HDC GetDC(HWND h) {
    if (h == HWND_DESKTOP || h == nullptr) return make_dc(nullptr, false, false);
    std::unique_lock<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    lk.unlock();
    if (w == nullptr) return HDC_INVALID;
    return make_dc(w, false, false);
}

void ReleaseDC(HDC hdc) {
    free_dc(hdc);
}

Uint32 GetDCAttr(HDC hdc, int attr) {
    DC *dc = as_dc(hdc);
    if (dc == nullptr) return 0;
    switch (attr) {
        case DC_ATTR_BK_COLOR:
            return dc->bk;
        case DC_ATTR_PEN_COLOR:
            return dc->pen;
        case DC_ATTR_BRUSH_COLOR:
            return dc->brush;
        case DC_ATTR_TEXT_COLOR:
            return dc->text;
        case DC_ATTR_BK_MODE:
            return static_cast<Uint32>(dc->bkMode);
        case DC_ATTR_TAB_STOP:
            return static_cast<Uint32>(dc->tabStop);
        case DC_ATTR_CHAR_EXTRA:
            return static_cast<Uint32>(dc->charExtra);
        case DC_ATTR_ALINE_EXTRA:
            return static_cast<Uint32>(dc->alineExtra);
        case DC_ATTR_BLINE_EXTRA:
            return static_cast<Uint32>(dc->blineExtra);
        case DC_ATTR_TEXT_ALIGN:
            return dc->textAlign;
        case DC_ATTR_PEN_TYPE:
            return dc->penType;
        case DC_ATTR_PEN_CAP_STYLE:
            return dc->capStyle;
        case DC_ATTR_PEN_JOIN_STYLE:
            return dc->joinStyle;
        case DC_ATTR_PEN_WIDTH:
            return static_cast<Uint32>(dc->penWidth);
        case DC_ATTR_BRUSH_TYPE:
            return dc->brushType;
        default:
            return 0;
    }
}

Uint32 SetDCAttr(HDC hdc, int attr, Uint32 v) {
    DC *dc = as_dc(hdc);
    if (dc == nullptr) return 0;
    Uint32 old = GetDCAttr(hdc, attr);
    int iv = static_cast<int>(v);
    switch (attr) {
        case DC_ATTR_BK_COLOR:
            dc->bk = v;
            break;
        case DC_ATTR_PEN_COLOR:
            dc->pen = v;
            break;
        case DC_ATTR_BRUSH_COLOR:
            dc->brush = v;
            break;
        case DC_ATTR_TEXT_COLOR:
            dc->text = v;
            break;
        case DC_ATTR_BK_MODE:
            dc->bkMode = iv;
            break;
        case DC_ATTR_TAB_STOP:
            dc->tabStop = iv;
            break;
        case DC_ATTR_CHAR_EXTRA:
            dc->charExtra = iv;
            break;
        case DC_ATTR_ALINE_EXTRA:
            dc->alineExtra = iv;
            break;
        case DC_ATTR_BLINE_EXTRA:
            dc->blineExtra = iv;
            break;
        case DC_ATTR_TEXT_ALIGN:
            dc->textAlign = v;
            break;
        case DC_ATTR_PEN_TYPE:
            dc->penType = v;
            break;
        case DC_ATTR_PEN_CAP_STYLE:
            dc->capStyle = v;
            break;
        case DC_ATTR_PEN_JOIN_STYLE:
            dc->joinStyle = v;
            break;
        case DC_ATTR_PEN_WIDTH:
            dc->penWidth = std::clamp(iv, 1, 256);
            break;
        case DC_ATTR_BRUSH_TYPE:
            dc->brushType = v;
            break;
        default:
            break;
    }
    return old;
}

gal_pixel RGBA2Pixel(HDC, Uint8 r, Uint8 g, Uint8 b, Uint8) {
    return rgb_pixel(r, g, b);
}

void Pixel2RGB(HDC, gal_pixel px, Uint8 *r, Uint8 *g, Uint8 *b) {
    if (r != nullptr) *r = static_cast<Uint8>(px >> 16);
    if (g != nullptr) *g = static_cast<Uint8>(px >> 8);
    if (b != nullptr) *b = static_cast<Uint8>(px);
}

void Pixel2RGBA(HDC hdc, gal_pixel px, Uint8 *r, Uint8 *g, Uint8 *b, Uint8 *a) {
    Pixel2RGB(hdc, px, r, g, b);
    if (a != nullptr) *a = 0xFF;
}

gal_pixel GetPixel(HDC hdc, int x, int y) {
    DC *dc = as_dc(hdc);
    if (dc == nullptr) return 0;
    x += dc->ox;
    y += dc->oy;
    std::lock_guard<std::mutex> fb(g_fbLock);
    if (!dc->base.contains(x, y)) return 0;
    return g_fb[static_cast<size_t>(y) * g_fbW + x];
}

gal_pixel SetPixel(HDC hdc, int x, int y, gal_pixel px) {
    DC *dc = as_dc(hdc);
    if (dc == nullptr) return 0;
    DcDraw fb(dc);
    px_blend(dc, x + dc->ox, y + dc->oy, px, 255);
    return px;
}

void SelectClipRect(HDC hdc, const RECT *prc) {
    DC *dc = as_dc(hdc);
    if (dc == nullptr) return;
    dc->clip = dc->base;
    if (prc != nullptr) {
        RECT r = *prc;
        OffsetRect(&r, dc->ox, dc->oy);
        dc->clip.intersect(r);
    }
}

void ClipRectIntersect(HDC hdc, const RECT *prc) {
    DC *dc = as_dc(hdc);
    if (dc == nullptr || prc == nullptr) return;
    RECT r = *prc;
    OffsetRect(&r, dc->ox, dc->oy);
    dc->clip.intersect(r);
}

void ExcludeClipRect(HDC hdc, const RECT *prc) {
    DC *dc = as_dc(hdc);
    if (dc == nullptr || prc == nullptr) return;
    RECT r = *prc;
    OffsetRect(&r, dc->ox, dc->oy);
    dc->clip.subtract(r);
}

void IncludeClipRect(HDC hdc, const RECT *prc) {
    DC *dc = as_dc(hdc);
    if (dc == nullptr || prc == nullptr) return;
    RECT r = *prc;
    OffsetRect(&r, dc->ox, dc->oy);
    Region add = dc->base;
    add.intersect(r);
    for (const RECT &a : add.rects)
        dc->clip.unite(a);
}

void GetBoundsRect(HDC hdc, RECT *prc) {
    DC *dc = as_dc(hdc);
    if (dc == nullptr || prc == nullptr) return;
    *prc = dc->clip.bounds();
    OffsetRect(prc, -dc->ox, -dc->oy);
}

void MoveTo(HDC hdc, int x, int y) {
    DC *dc = as_dc(hdc);
    if (dc == nullptr) return;
    dc->pos = POINT{x, y};
}

void LineTo(HDC hdc, int x, int y) {
    DC *dc = as_dc(hdc);
    if (dc == nullptr) return;
    {
        DcDraw fb(dc);
        line_screen(dc, dc->pos.x + dc->ox, dc->pos.y + dc->oy, x + dc->ox, y + dc->oy);
    }
    dc->pos = POINT{x, y};
}

void LineEx(HDC hdc, int x1, int y1, int x2, int y2) {
    MoveTo(hdc, x1, y1);
    LineTo(hdc, x2, y2);
}

void PolyLineEx(HDC hdc, const POINT *pts, int n) {
    if (pts == nullptr || n < 2) return;
    MoveTo(hdc, pts[0].x, pts[0].y);
    for (int i = 1; i < n; i++)
        LineTo(hdc, pts[i].x, pts[i].y);
}

void Rectangle(HDC hdc, int x0, int y0, int x1, int y1) {
    DC *dc = as_dc(hdc);
    if (dc == nullptr) return;
    int l = std::min(x0, x1) + dc->ox, r = std::max(x0, x1) + dc->ox;
    int t = std::min(y0, y1) + dc->oy, b = std::max(y0, y1) + dc->oy;
    DcDraw fb(dc);
    line_screen(dc, l, t, r, t);
    line_screen(dc, l, b, r, b);
    line_screen(dc, l, t, l, b);
    line_screen(dc, r, t, r, b);
}

void FillBox(HDC hdc, int x, int y, int w, int h) {
    DC *dc = as_dc(hdc);
    if (dc == nullptr || w <= 0 || h <= 0) return;
    DcDraw fb(dc);
    px_fill(dc, RECT{x + dc->ox, y + dc->oy, x + dc->ox + w, y + dc->oy + h}, dc->brush);
}

void Circle(HDC hdc, int sx, int sy, int r) {
    DC *dc = as_dc(hdc);
    if (dc == nullptr || r < 0) return;
    sx += dc->ox;
    sy += dc->oy;
    DcDraw fb(dc);
    int x = r, y = 0, err = 1 - r;
    while (x >= y) {
        const int pts[8][2] = {{x, y},   {y, x},   {-y, x}, {-x, y},
                               {-x, -y}, {-y, -x}, {y, -x}, {x, -y}};
        for (const auto &p : pts)
            pen_dot(dc, sx + p[0], sy + p[1]);
        y++;
        if (err < 0) {
            err += 2 * y + 1;
        } else {
            x--;
            err += 2 * (y - x) + 1;
        }
    }
}

void FillCircle(HDC hdc, int sx, int sy, int r) {
    DC *dc = as_dc(hdc);
    if (dc == nullptr || r < 0) return;
    sx += dc->ox;
    sy += dc->oy;
    DcDraw fb(dc);
    for (int dy = -r; dy <= r; dy++) {
        int dx = static_cast<int>(sqrt(static_cast<double>(r) * r - static_cast<double>(dy) * dy));
        px_fill(dc, RECT{sx - dx, sy + dy, sx + dx + 1, sy + dy + 1}, dc->brush);
    }
}

BOOL FillPolygon(HDC hdc, const POINT *pts, int n) {
    DC *dc = as_dc(hdc);
    if (dc == nullptr || pts == nullptr || n < 3) return FALSE;
    int top = pts[0].y, bottom = pts[0].y;
    for (int i = 1; i < n; i++) {
        top = std::min(top, pts[i].y);
        bottom = std::max(bottom, pts[i].y);
    }
    RECT b = dc->clip.bounds();
    top = std::max(top, b.top - dc->oy);
    bottom = std::min(bottom, b.bottom - dc->oy);
    std::vector<double> xs;
    DcDraw fb(dc);
    // Scan lines through pixel centres, even-odd rule; the outline itself is filled too.
    for (int y = top; y <= bottom; y++) {
        xs.clear();
        double cy = y + 0.5;
        for (int i = 0; i < n; i++) {
            const POINT &a = pts[i], &c = pts[(i + 1) % n];
            if ((a.y <= cy && c.y > cy) || (c.y <= cy && a.y > cy))
                xs.push_back(a.x + (cy - a.y) * (c.x - a.x) / static_cast<double>(c.y - a.y));
        }
        std::sort(xs.begin(), xs.end());
        for (size_t i = 0; i + 1 < xs.size(); i += 2) {
            int l = static_cast<int>(floor(xs[i] + 0.5)),
                r = static_cast<int>(floor(xs[i + 1] + 0.5));
            px_fill(dc, RECT{l + dc->ox, y + dc->oy, r + 1 + dc->ox, y + 1 + dc->oy}, dc->brush);
        }
    }
    Uint32 pen = dc->pen;
    int width = dc->penWidth;
    dc->pen = dc->brush;
    dc->penWidth = 1;
    for (int i = 0; i < n; i++) {
        const POINT &a = pts[i], &c = pts[(i + 1) % n];
        line_screen(dc, a.x + dc->ox, a.y + dc->oy, c.x + dc->ox, c.y + dc->oy);
    }
    dc->pen = pen;
    dc->penWidth = width;
    return TRUE;
}

}  // extern "C"

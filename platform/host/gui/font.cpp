// Logical fonts and text. Glyphs come from a CJK TrueType font through FreeType (the
// "song" family is AR PL UMing), bold is emboldened, and text bytes are decoded in the
// font's charset (GB18030 through iconv). Rendered glyphs are cached per size and weight.
#include <ft2build.h>
#include FT_FREETYPE_H
#include FT_OUTLINE_H
#include <iconv.h>
#include <stdlib.h>
#include <string.h>
#include <unistd.h>

#include <algorithm>
#include <unordered_map>

#include <android/log.h>

#include "gui_internal.h"
#include "tp_os.h"

struct _DEVFONT {
    char name[64];
};

namespace ftxgui {

namespace {

const char *kTag = "FTX_GUI";
DEVFONT g_devfont = {"ttf-song-rrncnn-0-0-GB18030,UTF-8"};

struct Glyph {
    int left = 0, top = 0, w = 0, h = 0, adv = 0;
    std::vector<uint8_t> bits;
};

struct Fonts {
    std::mutex m;
    FT_Library lib = nullptr;
    FT_Face face = nullptr;
    double ascRatio = 0.86;
    std::unordered_map<uint64_t, Glyph> cache;
};
Fonts &g_fonts = *new Fonts;  // glyphs are drawn until the process is gone

constexpr size_t kCacheLimit = 40000;

void load_face() {
    if (FT_Init_FreeType(&g_fonts.lib) != 0) {
        __android_log_print(ANDROID_LOG_ERROR, kTag, "FreeType did not start: text is not drawn");
        return;
    }
    const char *env = getenv("FTX_FONT");
    const char *candidates[] = {env, "/usr/share/fonts/truetype/arphic/uming.ttc",
                                "/usr/share/fonts/truetype/dejavu/DejaVuSans.ttf"};
    for (const char *path : candidates) {
        if (path == nullptr || *path == '\0') continue;
        if (FT_New_Face(g_fonts.lib, path, 0, &g_fonts.face) == 0) break;
        g_fonts.face = nullptr;
    }
    if (g_fonts.face == nullptr) {
        __android_log_print(ANDROID_LOG_ERROR, kTag, "no TrueType font found: text is not drawn");
        return;
    }
    FT_Face f = g_fonts.face;
    double span = static_cast<double>(f->ascender - f->descender);
    if (span > 0) g_fonts.ascRatio = f->ascender / span;
}

bool is_wide(uint32_t cp) {
    return cp >= 0x2E80;
}

// The glyph of cp at a pixel size; the reference stays valid (the cache only grows).
const Glyph &glyph(uint32_t cp, int size, bool bold) {
    thread_local Glyph scratch;
    uint64_t key =
        (static_cast<uint64_t>(cp) << 16) | (static_cast<uint64_t>(size) << 1) | (bold ? 1 : 0);
    std::lock_guard<std::mutex> lk(g_fonts.m);
    auto it = g_fonts.cache.find(key);
    if (it != g_fonts.cache.end()) return it->second;
    Glyph g;
    g.adv = is_wide(cp) ? size : size / 2;
    FT_Face f = g_fonts.face;
    if (f != nullptr && FT_Set_Pixel_Sizes(f, 0, static_cast<FT_UInt>(size)) == 0) {
        FT_UInt idx = FT_Get_Char_Index(f, cp);
        if (idx != 0 && FT_Load_Glyph(f, idx, FT_LOAD_DEFAULT | FT_LOAD_NO_BITMAP) == 0) {
            FT_GlyphSlot slot = f->glyph;
            int extra = 0;
            if (bold && slot->format == FT_GLYPH_FORMAT_OUTLINE) {
                FT_Pos strength = std::max<FT_Pos>(64, size * 64 / 20);
                FT_Outline_Embolden(&slot->outline, strength);
                extra = static_cast<int>(strength >> 6);
            }
            if (FT_Render_Glyph(slot, FT_RENDER_MODE_NORMAL) == 0) {
                const FT_Bitmap &bm = slot->bitmap;
                g.left = slot->bitmap_left;
                g.top = slot->bitmap_top;
                g.w = static_cast<int>(bm.width);
                g.h = static_cast<int>(bm.rows);
                g.adv = static_cast<int>(slot->advance.x >> 6) + extra;
                g.bits.resize(static_cast<size_t>(g.w) * g.h);
                for (int y = 0; y < g.h; y++)
                    memcpy(&g.bits[static_cast<size_t>(y) * g.w],
                           bm.buffer + static_cast<ptrdiff_t>(y) * bm.pitch,
                           static_cast<size_t>(g.w));
            }
        }
    }
    if (g_fonts.cache.size() >= kCacheLimit) {
        scratch = std::move(g);
        return scratch;
    }
    return g_fonts.cache.emplace(key, std::move(g)).first->second;
}

enum class Charset { Utf8, Gb, Latin1 };

Charset charset_of(PLOGFONT f) {
    if (f == nullptr) return Charset::Gb;
    if (strcasecmp(f->charset, "UTF-8") == 0 || strcasecmp(f->charset, "UTF8") == 0)
        return Charset::Utf8;
    if (strncasecmp(f->charset, "GB", 2) == 0) return Charset::Gb;
    return Charset::Latin1;
}

struct Ch {
    uint32_t cp;
    int off;
    int len;
};

// One converter per drawing thread, closed when the thread ends.
struct GbConverter {
    iconv_t cd = iconv_open("UTF-32LE", "GB18030");
    ~GbConverter() {
        if (cd != reinterpret_cast<iconv_t>(-1)) iconv_close(cd);
    }
};

uint32_t gb_unit(const unsigned char *p, size_t n) {
    thread_local GbConverter conv;
    iconv_t cd = conv.cd;
    if (cd == reinterpret_cast<iconv_t>(-1)) return 0xFFFD;
    char in[4];
    memcpy(in, p, n);
    unsigned char out[8];
    char *ip = in, *op = reinterpret_cast<char *>(out);
    size_t il = n, ol = sizeof(out);
    iconv(cd, nullptr, nullptr, nullptr, nullptr);
    if (iconv(cd, &ip, &il, &op, &ol) == static_cast<size_t>(-1) || ol != 4) return 0xFFFD;
    return out[0] | (out[1] << 8) | (out[2] << 16) | (static_cast<uint32_t>(out[3]) << 24);
}

void decode(const char *text, int len, Charset cs, std::vector<Ch> &out) {
    out.clear();
    const unsigned char *s = reinterpret_cast<const unsigned char *>(text);
    int i = 0;
    while (i < len) {
        unsigned c = s[i];
        int n = 1;
        uint32_t cp = c;
        if (c >= 0x80 && cs == Charset::Gb) {
            cp = 0xFFFD;
            if (c >= 0x81 && c <= 0xFE && i + 1 < len) {
                unsigned c2 = s[i + 1];
                if ((c2 >= 0x40 && c2 <= 0x7E) || (c2 >= 0x80 && c2 <= 0xFE)) {
                    n = 2;
                } else if (c2 >= 0x30 && c2 <= 0x39 && i + 3 < len && s[i + 2] >= 0x81 &&
                           s[i + 2] <= 0xFE && s[i + 3] >= 0x30 && s[i + 3] <= 0x39) {
                    n = 4;
                }
                if (n > 1) cp = gb_unit(s + i, static_cast<size_t>(n));
            }
        } else if (c >= 0x80 && cs == Charset::Utf8) {
            int need = c >= 0xF0 && c < 0xF8 ? 3 : c >= 0xE0 ? 2 : c >= 0xC0 ? 1 : -1;
            cp = 0xFFFD;
            if (need > 0) {
                uint32_t v = c & (0x3Fu >> need);
                bool ok = true;
                for (int k = 1; k <= need; k++) {
                    if (i + k >= len || (s[i + k] & 0xC0) != 0x80) {
                        ok = false;
                        break;
                    }
                    v = (v << 6) | (s[i + k] & 0x3F);
                }
                if (ok) {
                    cp = v;
                    n = need + 1;
                }
            }
        }
        out.push_back(Ch{cp, i, n});
        i += n;
    }
}

int text_len(const char *text, int len) {
    if (text == nullptr) return 0;
    return len < 0 ? static_cast<int>(strlen(text)) : len;
}

bool font_bold(PLOGFONT f) {
    if (f == nullptr) return false;
    DWORD w = f->style & FS_WEIGHT_MASK;
    return w == FS_WEIGHT_BOLD || w == FS_WEIGHT_BLACK || w == FS_WEIGHT_DEMIBOLD;
}

int font_size(PLOGFONT f) {
    return f != nullptr ? f->size : 16;
}

int advance(const DC *dc, uint32_t cp) {
    if (cp == '\n' || cp == '\r') return 0;
    if (cp == '\t') cp = ' ';
    return glyph(cp, font_size(dc->font), font_bold(dc->font)).adv + dc->charExtra;
}

int run_width(const DC *dc, const Ch *chars, size_t n) {
    int w = 0;
    for (size_t i = 0; i < n; i++)
        w += advance(dc, chars[i].cp);
    return w;
}

// Draws one line with its top-left at (x, y) in screen coordinates; returns its width.
int draw_run(DC *dc, int x, int y, const Ch *chars, size_t n) {
    int size = font_size(dc->font);
    bool bold = font_bold(dc->font);
    int ascent = dc->font != nullptr ? dc->font->ascent : size * 7 / 8;
    int width = run_width(dc, chars, n);
    DcDraw fb(dc);
    if (dc->bkMode == BM_OPAQUE) px_fill(dc, RECT{x, y, x + width, y + size}, dc->bk);
    RECT clipBox = dc->clip.bounds();
    int pen = x;
    for (size_t i = 0; i < n; i++) {
        uint32_t cp = chars[i].cp;
        if (cp == '\n' || cp == '\r') continue;
        if (cp == '\t') cp = ' ';
        const Glyph &g = glyph(cp, size, bold);
        int gx = pen + g.left, gy = y + ascent - g.top;
        if (gx < clipBox.right && gy < clipBox.bottom && gx + g.w > clipBox.left &&
            gy + g.h > clipBox.top) {
            for (int r = 0; r < g.h; r++) {
                const uint8_t *row = &g.bits[static_cast<size_t>(r) * g.w];
                for (int c = 0; c < g.w; c++)
                    if (row[c] != 0) px_blend(dc, gx + c, gy + r, dc->text, row[c]);
            }
        }
        pen += g.adv + dc->charExtra;
    }
    return width;
}

struct Line {
    size_t begin, end;  // chars [begin, end)
    int width;
};

bool breakable_after(uint32_t cp) {
    return cp == ' ' || cp == '\t' || is_wide(cp);
}

// Splits chars into lines at line feeds and, when wrapping, at spaces or between wide
// characters so that no line is wider than maxWidth (a single long word is cut).
void layout(const DC *dc, const std::vector<Ch> &chars, int maxWidth, bool wrap, bool single,
            std::vector<Line> &lines) {
    lines.clear();
    size_t start = 0, i = 0;
    int width = 0;
    size_t lastBreak = SIZE_MAX;
    while (i < chars.size()) {
        uint32_t cp = chars[i].cp;
        if (cp == '\n' && !single) {
            lines.push_back(Line{start, i, run_width(dc, &chars[start], i - start)});
            start = ++i;
            width = 0;
            lastBreak = SIZE_MAX;
            continue;
        }
        int a = advance(dc, cp);
        if (wrap && !single && width + a > maxWidth && i > start) {
            size_t cut = i;
            if (cp != ' ' && lastBreak != SIZE_MAX && lastBreak + 1 > start) cut = lastBreak + 1;
            if (is_wide(cp)) cut = i;
            size_t end = cut;
            while (end > start && chars[end - 1].cp == ' ')
                end--;
            lines.push_back(Line{start, end, run_width(dc, &chars[start], end - start)});
            start = cut;
            while (start < chars.size() && chars[start].cp == ' ')
                start++;
            i = start;
            width = 0;
            lastBreak = SIZE_MAX;
            continue;
        }
        if (breakable_after(cp)) lastBreak = i;
        width += a;
        i++;
    }
    if (start < chars.size() || lines.empty())
        lines.push_back(
            Line{start, chars.size(), run_width(dc, chars.data() + start, chars.size() - start)});
}

const char *style_letters_ok(char weight, char slant, char underline, char struckout) {
    if (strchr("rbcdmlks*", weight) == nullptr || weight == '\0') return "weight";
    if (strchr("rio*", slant) == nullptr || slant == '\0') return "slant";
    if (strchr("un*", underline) == nullptr || underline == '\0') return "underline";
    if (strchr("sn*", struckout) == nullptr || struckout == '\0') return "struckout";
    return nullptr;
}

DWORD weight_bits(char w) {
    switch (w) {
        case 'b':
            return FS_WEIGHT_BOLD;
        case 'c':
            return FS_WEIGHT_BLACK;
        case 'd':
            return FS_WEIGHT_DEMIBOLD;
        case 'm':
            return FS_WEIGHT_MEDIUM;
        case 'l':
            return FS_WEIGHT_LIGHT;
        case 'k':
            return FS_WEIGHT_BOOK;
        case 's':
            return FS_WEIGHT_SUBPIXEL;
        default:
            return FS_WEIGHT_REGULAR;
    }
}

}  // namespace

void fonts_init(int screenWidth) {
    load_face();
    int size = std::max(12, screenWidth / 30);
    PLOGFONT def = CreateLogFont("ttf", "song", "GB18030", 'r', 'r', 'n', 'n', 'n', 'n', size, 0);
    PLOGFONT bold = CreateLogFont("ttf", "song", "GB18030", 'b', 'r', 'n', 'n', 'n', 'n', size, 0);
    for (int i = 0; i < NR_SYSLOGFONTS; i++)
        g_SysLogFont[i] = i == SYSLOGFONT_CAPTION ? bold : def;
}

}  // namespace ftxgui

using namespace ftxgui;

extern "C" {

PLOGFONT g_SysLogFont[NR_SYSLOGFONTS];

PLOGFONT CreateLogFont(const char *type, const char *family, const char *charset, char weight,
                       char slant, char flip, char other, char underline, char struckout, int size,
                       int rotation) {
    (void)flip;
    (void)other;
    if (style_letters_ok(weight, slant, underline, struckout) != nullptr) return nullptr;
    auto *f = static_cast<PLOGFONT>(calloc(1, sizeof(LOGFONT)));
    if (f == nullptr) return nullptr;
    tp_os_strlcpy(f->type, type != nullptr ? type : "ttf", sizeof(f->type));
    tp_os_strlcpy(f->family, family != nullptr ? family : "song", sizeof(f->family));
    tp_os_strlcpy(f->charset, charset != nullptr ? charset : "GB18030", sizeof(f->charset));
    f->style = weight_bits(weight) |
               (slant == 'i'   ? FS_SLANT_ITALIC
                : slant == 'o' ? FS_SLANT_OBLIQUE
                               : FS_SLANT_ROMAN) |
               (underline == 'u' ? FS_UNDERLINE_LINE : 0) |
               (struckout == 's' ? FS_STRUCKOUT_LINE : 0);
    size = std::clamp(size, 4, 256);
    f->ascent = static_cast<int>(size * g_fonts.ascRatio + 0.5);
    f->descent = size - f->ascent;
    f->size = f->ascent + f->descent;
    f->rotation = rotation;
    f->sbc_scale = 1;
    f->mbc_scale = 1;
    f->sbc_devfont = &g_devfont;
    f->mbc_devfont = &g_devfont;
    return f;
}

PLOGFONT CreateLogFontByName(const char *name) {
    if (name == nullptr) return nullptr;
    char type[32] = "", family[32] = "", style[8] = "", charset[32] = "";
    int width = 0, height = 0;
    if (sscanf(name, "%31[^-]-%31[^-]-%7[^-]-%d-%d-%31s", type, family, style, &width, &height,
               charset) != 6 ||
        strlen(style) != 6)
        return nullptr;
    char *comma = strchr(charset, ',');
    if (comma != nullptr) *comma = '\0';
    return CreateLogFont(type, family, charset, style[0], style[1], style[2], style[3], style[4],
                         style[5], height, 0);
}

PLOGFONT CreateLogFontIndirect(LOGFONT *lf) {
    if (lf == nullptr) return nullptr;
    auto *f = static_cast<PLOGFONT>(malloc(sizeof(LOGFONT)));
    if (f != nullptr) *f = *lf;
    return f;
}

void DestroyLogFont(PLOGFONT f) {
    if (f == nullptr) return;
    for (PLOGFONT sys : g_SysLogFont)
        if (sys == f) return;  // the system fonts live as long as the process
    free(f);
}

PLOGFONT SelectFont(HDC hdc, PLOGFONT f) {
    DC *dc = as_dc(hdc);
    if (dc == nullptr) return nullptr;
    PLOGFONT old = dc->font;
    dc->font = f != nullptr ? f : g_SysLogFont[SYSLOGFONT_DEFAULT];
    return old;
}

PLOGFONT GetCurFont(HDC hdc) {
    DC *dc = as_dc(hdc);
    return dc != nullptr ? dc->font : nullptr;
}

DEVFONT *LoadDevFontFromFile(const char *, const char *file) {
    if (file == nullptr || access(file, R_OK) != 0) return nullptr;
    return &g_devfont;
}

void DestroyDynamicDevFont(DEVFONT **f) {
    if (f != nullptr) *f = nullptr;
}

int GetFontHeight(HDC hdc) {
    DC *dc = as_dc(hdc);
    return dc != nullptr ? font_size(dc->font) : 0;
}

int GetMaxFontWidth(HDC hdc) {
    DC *dc = as_dc(hdc);
    return dc != nullptr ? font_size(dc->font) : 0;
}

int GetTextExtent(HDC hdc, const char *text, int len, SIZE *sz) {
    DC *dc = as_dc(hdc);
    if (dc == nullptr) return 0;
    std::vector<Ch> chars;
    decode(text, text_len(text, len), charset_of(dc->font), chars);
    int w = run_width(dc, chars.data(), chars.size());
    if (sz != nullptr) {
        sz->cx = w;
        sz->cy = font_size(dc->font);
    }
    return w;
}

int GetTabbedTextExtent(HDC hdc, const char *text, int len, SIZE *sz) {
    return GetTextExtent(hdc, text, len, sz);
}

int TextOutLen(HDC hdc, int x, int y, const char *text, int len) {
    DC *dc = as_dc(hdc);
    if (dc == nullptr || text == nullptr) return 0;
    std::vector<Ch> chars;
    decode(text, text_len(text, len), charset_of(dc->font), chars);
    if ((dc->textAlign & TA_UPDATECP) != 0) {
        x = dc->pos.x;
        y = dc->pos.y;
    }
    int w = run_width(dc, chars.data(), chars.size());
    int h = font_size(dc->font);
    int sx = x;
    if ((dc->textAlign & TA_X_MASK) == TA_CENTER) sx -= w / 2;
    if ((dc->textAlign & TA_X_MASK) == TA_RIGHT) sx -= w;
    int sy = y;
    if ((dc->textAlign & TA_Y_MASK) == TA_BASELINE)
        sy -= dc->font != nullptr ? dc->font->ascent : h;
    if ((dc->textAlign & TA_Y_MASK) == TA_BOTTOM) sy -= h;
    draw_run(dc, sx + dc->ox, sy + dc->oy, chars.data(), chars.size());
    if ((dc->textAlign & TA_UPDATECP) != 0) dc->pos.x = x + w;
    return w;
}

int TabbedTextOutLen(HDC hdc, int x, int y, const char *text, int len) {
    DC *dc = as_dc(hdc);
    if (dc == nullptr || text == nullptr) return 0;
    std::vector<Ch> chars;
    decode(text, text_len(text, len), charset_of(dc->font), chars);
    int h = font_size(dc->font);
    int tab = std::max(1, dc->tabStop) * std::max(1, advance(dc, ' '));
    int px = x, py = y, widest = 0;
    size_t runStart = 0;
    for (size_t i = 0; i <= chars.size(); i++) {
        bool end = i == chars.size();
        uint32_t cp = end ? 0 : chars[i].cp;
        if (!end && cp != '\t' && cp != '\n') continue;
        px += draw_run(dc, px + dc->ox, py + dc->oy, &chars[runStart], i - runStart);
        widest = std::max(widest, px - x);
        if (!end && cp == '\t') px = x + ((px - x) / tab + 1) * tab;
        if (!end && cp == '\n') {
            px = x;
            py += h + dc->alineExtra + dc->blineExtra;
        }
        runStart = i + 1;
    }
    return widest;
}

int DrawTextEx2(HDC hdc, const char *text, int count, RECT *rc, int indent, UINT fmt,
                DTFIRSTLINE *first) {
    DC *dc = as_dc(hdc);
    if (dc == nullptr || text == nullptr || rc == nullptr) return 0;
    std::vector<Ch> chars;
    decode(text, text_len(text, count), charset_of(dc->font), chars);
    bool single = (fmt & DT_SINGLELINE) != 0;
    int boxW = std::max(1, rc->right - rc->left - indent);
    std::vector<Line> lines;
    layout(dc, chars, boxW, (fmt & DT_WORDBREAK) != 0 || (fmt & DT_CHARBREAK) != 0, single, lines);
    int lineH = font_size(dc->font) + dc->alineExtra + dc->blineExtra;
    int total = lineH * static_cast<int>(lines.size());
    int widest = 0;
    for (const Line &l : lines)
        widest = std::max(widest, l.width);
    if (first != nullptr && !lines.empty()) {
        const Line &l = lines[0];
        first->nr_chars =
            l.end > l.begin ? chars[l.end - 1].off + chars[l.end - 1].len - chars[l.begin].off : 0;
        first->startx = rc->left + indent;
        first->starty = rc->top;
        first->width = l.width;
        first->height = lineH;
    }
    if ((fmt & DT_CALCRECT) != 0) {
        rc->right = rc->left + widest + indent;
        rc->bottom = rc->top + total;
        return total;
    }
    int y = rc->top;
    if (single && (fmt & DT_VCENTER) != 0) y = rc->top + (rc->bottom - rc->top - lineH) / 2;
    if (single && (fmt & DT_BOTTOM) != 0) y = rc->bottom - lineH;
    Region saved = dc->clip;
    if ((fmt & DT_NOCLIP) == 0) {
        RECT r = *rc;
        OffsetRect(&r, dc->ox, dc->oy);
        dc->clip.intersect(r);
    }
    for (size_t i = 0; i < lines.size(); i++) {
        const Line &l = lines[i];
        int left = rc->left + (i == 0 ? indent : 0);
        int x = left;
        if ((fmt & DT_CENTER) != 0) x = left + (rc->right - left - l.width) / 2;
        if ((fmt & DT_RIGHT) != 0) x = rc->right - l.width;
        if (l.end > l.begin)
            draw_run(dc, x + dc->ox, y + dc->oy + dc->alineExtra, &chars[l.begin], l.end - l.begin);
        y += lineH;
    }
    dc->clip = saved;
    dc->clip.intersect(dc->base);  // drawing may have found less of the window visible
    return total;
}

}  // extern "C"

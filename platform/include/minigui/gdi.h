/* MiniGUI 3 drawing: device contexts, pens and brushes, shapes, text, fonts, bitmaps. */
#ifndef FTX_MINIGUI_GDI_H
#define FTX_MINIGUI_GDI_H

#include "common.h"
#include "minigui.h"

#ifdef __cplusplus
extern "C" {
#endif

#define DC_ATTR_BK_COLOR 0
#define DC_ATTR_PEN_COLOR 1
#define DC_ATTR_BRUSH_COLOR 2
#define DC_ATTR_TEXT_COLOR 3
#define DC_ATTR_BK_MODE 4
#define DC_ATTR_TAB_STOP 5
#define DC_ATTR_CHAR_EXTRA 6
#define DC_ATTR_ALINE_EXTRA 7
#define DC_ATTR_BLINE_EXTRA 8
#define DC_ATTR_MAP_MODE 9
#define DC_ATTR_TEXT_ALIGN 10
#define DC_ATTR_BIDI_FLAGS 11
#define DC_ATTR_PEN_TYPE 12
#define DC_ATTR_PEN_CAP_STYLE 13
#define DC_ATTR_PEN_JOIN_STYLE 14
#define DC_ATTR_PEN_WIDTH 15
#define DC_ATTR_BRUSH_TYPE 16

MGUI_API Uint32 GetDCAttr(HDC hdc, int attr);
MGUI_API Uint32 SetDCAttr(HDC hdc, int attr, Uint32 value);

#define GetBkColor(hdc) GetDCAttr(hdc, DC_ATTR_BK_COLOR)
#define GetPenColor(hdc) GetDCAttr(hdc, DC_ATTR_PEN_COLOR)
#define GetBrushColor(hdc) GetDCAttr(hdc, DC_ATTR_BRUSH_COLOR)
#define GetTextColor(hdc) GetDCAttr(hdc, DC_ATTR_TEXT_COLOR)
#define GetBkMode(hdc) GetDCAttr(hdc, DC_ATTR_BK_MODE)
#define GetTextAlign(hdc) GetDCAttr(hdc, DC_ATTR_TEXT_ALIGN)
#define GetPenWidth(hdc) GetDCAttr(hdc, DC_ATTR_PEN_WIDTH)
#define SetBkColor(hdc, color) SetDCAttr(hdc, DC_ATTR_BK_COLOR, (Uint32)(color))
#define SetPenColor(hdc, color) SetDCAttr(hdc, DC_ATTR_PEN_COLOR, (Uint32)(color))
#define SetBrushColor(hdc, color) SetDCAttr(hdc, DC_ATTR_BRUSH_COLOR, (Uint32)(color))
#define SetTextColor(hdc, color) SetDCAttr(hdc, DC_ATTR_TEXT_COLOR, (Uint32)(color))
#define SetBkMode(hdc, mode) SetDCAttr(hdc, DC_ATTR_BK_MODE, (Uint32)(mode))
#define SetTabStop(hdc, value) SetDCAttr(hdc, DC_ATTR_TAB_STOP, (Uint32)(value))
#define SetTextCharacterExtra(hdc, extra) SetDCAttr(hdc, DC_ATTR_CHAR_EXTRA, (Uint32)(extra))
#define SetTextAboveLineExtra(hdc, extra) SetDCAttr(hdc, DC_ATTR_ALINE_EXTRA, (Uint32)(extra))
#define SetTextBellowLineExtra(hdc, extra) SetDCAttr(hdc, DC_ATTR_BLINE_EXTRA, (Uint32)(extra))
#define SetTextAlign(hdc, ta_flags) SetDCAttr(hdc, DC_ATTR_TEXT_ALIGN, (Uint32)(ta_flags))
/* The handset's library is built with its 2D option: the width applies to every line,
 * frame and circle. */
#define SetPenWidth(hdc, width) SetDCAttr(hdc, DC_ATTR_PEN_WIDTH, (Uint32)(width))
#define SetPenType(hdc, type) SetDCAttr(hdc, DC_ATTR_PEN_TYPE, (Uint32)(type))
#define SetPenCapStyle(hdc, style) SetDCAttr(hdc, DC_ATTR_PEN_CAP_STYLE, (Uint32)(style))
#define SetPenJoinStyle(hdc, style) SetDCAttr(hdc, DC_ATTR_PEN_JOIN_STYLE, (Uint32)(style))
#define SetBrushType(hdc, type) SetDCAttr(hdc, DC_ATTR_BRUSH_TYPE, (Uint32)(type))

#define BM_OPAQUE 0
#define BM_TRANSPARENT 1

#define TA_LEFT 0x0000
#define TA_RIGHT 0x0001
#define TA_CENTER 0x0002
#define TA_X_MASK 0x000F
#define TA_TOP 0x0000
#define TA_BASELINE 0x0010
#define TA_BOTTOM 0x0020
#define TA_Y_MASK 0x00F0
#define TA_NOUPDATECP 0x0000
#define TA_UPDATECP 0x0100

/* Device contexts. */
MGUI_API HDC BeginPaint(HWND hWnd);
MGUI_API void EndPaint(HWND hWnd, HDC hdc);
MGUI_API HDC GetClientDC(HWND hWnd);
MGUI_API HDC GetDC(HWND hWnd);
MGUI_API void ReleaseDC(HDC hdc);

MGUI_API gal_pixel RGBA2Pixel(HDC hdc, Uint8 r, Uint8 g, Uint8 b, Uint8 a);
static inline gal_pixel RGB2Pixel(HDC hdc, Uint8 r, Uint8 g, Uint8 b) {
    return RGBA2Pixel(hdc, r, g, b, 0xFF);
}
MGUI_API void Pixel2RGB(HDC hdc, gal_pixel pixel, Uint8 *r, Uint8 *g, Uint8 *b);
MGUI_API void Pixel2RGBA(HDC hdc, gal_pixel pixel, Uint8 *r, Uint8 *g, Uint8 *b, Uint8 *a);
MGUI_API gal_pixel GetPixel(HDC hdc, int x, int y);
MGUI_API gal_pixel SetPixel(HDC hdc, int x, int y, gal_pixel pixel);

/* Clipping. */
MGUI_API void SelectClipRect(HDC hdc, const RECT *prc);
MGUI_API void ClipRectIntersect(HDC hdc, const RECT *prc);
MGUI_API void ExcludeClipRect(HDC hdc, const RECT *prc);
MGUI_API void IncludeClipRect(HDC hdc, const RECT *prc);
MGUI_API void GetBoundsRect(HDC hdc, RECT *pRect);

/* Shapes. */
MGUI_API void MoveTo(HDC hdc, int x, int y);
MGUI_API void LineTo(HDC hdc, int x, int y);
MGUI_API void LineEx(HDC hdc, int x1, int y1, int x2, int y2);
MGUI_API void PolyLineEx(HDC hdc, const POINT *pts, int nr_pts);
MGUI_API void Rectangle(HDC hdc, int x0, int y0, int x1, int y1);
MGUI_API void FillBox(HDC hdc, int x, int y, int w, int h);
MGUI_API void Circle(HDC hdc, int sx, int sy, int r);
MGUI_API void FillCircle(HDC hdc, int sx, int sy, int r);
MGUI_API BOOL FillPolygon(HDC hdc, const POINT *pts, int vertices);

/* Fonts. */
struct _DEVFONT;
typedef struct _DEVFONT DEVFONT;

typedef struct _LOGFONT {
    char type[32];
    char family[32];
    char charset[32];
    DWORD style;
    int size;
    int rotation;
    int ascent;
    int descent;
    unsigned short sbc_scale;
    unsigned short mbc_scale;
    DEVFONT *sbc_devfont;
    DEVFONT *mbc_devfont;
} LOGFONT;
typedef LOGFONT *PLOGFONT;
typedef const LOGFONT *CPLOGFONT;

#define FONT_WEIGHT_ANY '*'
#define FONT_WEIGHT_REGULAR 'r'
#define FONT_WEIGHT_BOLD 'b'
#define FONT_WEIGHT_BLACK 'c'
#define FONT_WEIGHT_DEMIBOLD 'd'
#define FONT_WEIGHT_MEDIUM 'm'
#define FONT_WEIGHT_LIGHT 'l'
#define FONT_WEIGHT_BOOK 'k'
#define FONT_WEIGHT_SUBPIXEL 's'
#define FONT_SLANT_ANY '*'
#define FONT_SLANT_ROMAN 'r'
#define FONT_SLANT_ITALIC 'i'
#define FONT_SLANT_OBLIQUE 'o'
#define FONT_FLIP_NIL 'n'
#define FONT_FLIP_HORZ 'H'
#define FONT_FLIP_VERT 'V'
#define FONT_FLIP_HORZVERT 'T'
#define FONT_OTHER_NIL 'n'
#define FONT_OTHER_AUTOSCALE 'S'
#define FONT_OTHER_TTFNOCACHE 'N'
#define FONT_OTHER_TTFKERN 'K'
#define FONT_OTHER_TTFNOCACHEKERN 'R'
#define FONT_UNDERLINE_ANY '*'
#define FONT_UNDERLINE_LINE 'u'
#define FONT_UNDERLINE_NONE 'n'
#define FONT_STRUCKOUT_ANY '*'
#define FONT_STRUCKOUT_LINE 's'
#define FONT_STRUCKOUT_NONE 'n'

#define FONT_TYPE_NAME_ALL "*"
#define FONT_TYPE_NAME_SCALE_TTF "ttf"

#define FS_WEIGHT_MASK 0x000000FF
#define FS_WEIGHT_REGULAR 0x00000001
#define FS_WEIGHT_BOLD 0x00000002
#define FS_WEIGHT_BLACK 0x00000003
#define FS_WEIGHT_DEMIBOLD 0x00000004
#define FS_WEIGHT_MEDIUM 0x00000005
#define FS_WEIGHT_LIGHT 0x00000006
#define FS_WEIGHT_BOOK 0x00000007
#define FS_WEIGHT_SUBPIXEL 0x00000008
#define FS_SLANT_MASK 0x00000F00
#define FS_SLANT_ROMAN 0x00000100
#define FS_SLANT_ITALIC 0x00000200
#define FS_SLANT_OBLIQUE 0x00000300
#define FS_UNDERLINE_MASK 0x00F00000
#define FS_UNDERLINE_LINE 0x00100000
#define FS_STRUCKOUT_MASK 0x0F000000
#define FS_STRUCKOUT_LINE 0x01000000

MGUI_API PLOGFONT CreateLogFont(const char *type, const char *family, const char *charset,
                                char weight, char slant, char flip, char other, char underline,
                                char struckout, int size, int rotation);
MGUI_API PLOGFONT CreateLogFontByName(const char *font_name);
MGUI_API PLOGFONT CreateLogFontIndirect(LOGFONT *logfont);
MGUI_API void DestroyLogFont(PLOGFONT log_font);
MGUI_API PLOGFONT SelectFont(HDC hdc, PLOGFONT log_font);
MGUI_API PLOGFONT GetCurFont(HDC hdc);
MGUI_API DEVFONT *LoadDevFontFromFile(const char *devfont_name, const char *file_name);
MGUI_API void DestroyDynamicDevFont(DEVFONT **devfont);

#define SYSLOGFONT_DEFAULT 0
#define SYSLOGFONT_WCHAR_DEF 1
#define SYSLOGFONT_FIXED 2
#define SYSLOGFONT_CAPTION 3
#define SYSLOGFONT_MENU 4
#define SYSLOGFONT_CONTROL 5
#define NR_SYSLOGFONTS 6
extern MGUI_API PLOGFONT g_SysLogFont[NR_SYSLOGFONTS];
static inline PLOGFONT GetSystemFont(int font_id) {
    return (font_id >= 0 && font_id < NR_SYSLOGFONTS) ? g_SysLogFont[font_id] : (PLOGFONT)NULL;
}

/* Text. */
MGUI_API int GetFontHeight(HDC hdc);
MGUI_API int GetMaxFontWidth(HDC hdc);
MGUI_API int GetTextExtent(HDC hdc, const char *spText, int len, SIZE *pSize);
MGUI_API int GetTabbedTextExtent(HDC hdc, const char *spText, int len, SIZE *pSize);
MGUI_API int TextOutLen(HDC hdc, int x, int y, const char *spText, int len);
MGUI_API int TabbedTextOutLen(HDC hdc, int x, int y, const char *spText, int len);
#define TextOut(hdc, x, y, text) TextOutLen(hdc, x, y, text, -1)
#define TabbedTextOut(hdc, x, y, text) TabbedTextOutLen(hdc, x, y, text, -1)

#define DT_TOP 0x00000000
#define DT_LEFT 0x00000000
#define DT_CENTER 0x00000001
#define DT_RIGHT 0x00000002
#define DT_VCENTER 0x00000004
#define DT_BOTTOM 0x00000008
#define DT_WORDBREAK 0x00000010
#define DT_SINGLELINE 0x00000020
#define DT_EXPANDTABS 0x00000040
#define DT_TABSTOP 0x00000080
#define DT_NOCLIP 0x00000100
#define DT_EXTERNALLPADING 0x00000200
#define DT_CALCRECT 0x00000400
#define DT_NOPREFIX 0x00000800
#define DT_INTERNAL 0x00001000
#define DT_CHARBREAK 0x00002000

typedef struct _DTFIRSTLINE {
    int nr_chars;
    int startx;
    int starty;
    int width;
    int height;
} DTFIRSTLINE;

MGUI_API int DrawTextEx2(HDC hdc, const char *pText, int nCount, RECT *pRect, int nIndent,
                         UINT nFormat, DTFIRSTLINE *firstline);
#define DrawText(hdc, text, n, rc, format) DrawTextEx2(hdc, text, n, rc, 0, format, NULL)
#define DrawTextEx(hdc, text, n, rc, indent, format) \
    DrawTextEx2(hdc, text, n, rc, indent, format, NULL)

/* Bitmaps. */
#define BMP_TYPE_NORMAL 0x00
#define BMP_TYPE_RLE 0x01
#define BMP_TYPE_ALPHA 0x02
#define BMP_TYPE_ALPHACHANNEL 0x04
#define BMP_TYPE_COLORKEY 0x10
#define BMP_TYPE_ALPHA_MASK 0x20

typedef struct _BITMAP {
    Uint8 bmType;
    Uint8 bmBitsPerPixel;
    Uint8 bmBytesPerPixel;
    Uint8 bmAlpha;
    Uint32 bmColorKey;
    Uint32 bmWidth;
    Uint32 bmHeight;
    Uint32 bmPitch;
    Uint8 *bmBits;
    Uint8 *bmAlphaMask;
    Uint32 bmAlphaPitch;
} BITMAP;
typedef BITMAP *PBITMAP;

#define ERR_BMP_OK 0
#define ERR_BMP_IMAGE_TYPE -1
#define ERR_BMP_UNKNOWN_TYPE -2
#define ERR_BMP_CANT_READ -3
#define ERR_BMP_CANT_SAVE -4
#define ERR_BMP_NOT_SUPPORTED -5
#define ERR_BMP_MEM -6
#define ERR_BMP_LOAD -7
#define ERR_BMP_FILEIO -8
#define ERR_BMP_OTHER -9
#define ERR_BMP_ERROR_SOURCE -10

MGUI_API int LoadBitmapFromFile(HDC hdc, PBITMAP pBitmap, const char *spFileName);
#define LoadBitmap LoadBitmapFromFile
MGUI_API int LoadBitmapFromMem(HDC hdc, PBITMAP pBitmap, const void *mem, int size,
                               const char *ext);
MGUI_API void UnloadBitmap(PBITMAP pBitmap);
MGUI_API BOOL FillBoxWithBitmap(HDC hdc, int x, int y, int w, int h, const BITMAP *pBitmap);
MGUI_API int SetBitmapKeyColor(HDC hdc, PBITMAP bmp, Uint8 r, Uint8 g, Uint8 b);

#ifdef __cplusplus
}
#endif
#endif

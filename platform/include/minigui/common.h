/* MiniGUI 3 common types and helper macros (LP64 host build). */
#ifndef FTX_MINIGUI_COMMON_H
#define FTX_MINIGUI_COMMON_H

#include <stddef.h>
#include <stdint.h>

#ifndef MGUI_API
#define MGUI_API __attribute__((visibility("default")))
#endif
#ifndef GUIAPI
#define GUIAPI
#endif

#ifdef __cplusplus
extern "C" {
#endif

typedef int BOOL;
#ifndef TRUE
#define TRUE 1
#endif
#ifndef FALSE
#define FALSE 0
#endif

typedef unsigned char BYTE;
typedef signed char SBYTE;
typedef unsigned int UINT;
typedef unsigned int WORD;
typedef int SWORD;
typedef unsigned short WORD16;
typedef short SWORD16;
typedef unsigned long DWORD;
typedef unsigned int DWORD32;
typedef long LONG;
typedef unsigned long ULONG;
typedef long LINT;
typedef long LRESULT;
typedef unsigned long WPARAM;
typedef unsigned long LPARAM;

typedef void *GHANDLE;
typedef void *HWND;
typedef void *HDC;
typedef void *HMENU;
typedef void *HICON;
typedef void *HCURSOR;
typedef void *HACCEL;
typedef void *HPALETTE;

typedef uint8_t Uint8;
typedef uint16_t Uint16;
typedef uint32_t Uint32;
typedef int8_t Sint8;
typedef int16_t Sint16;
typedef int32_t Sint32;
typedef Uint32 gal_pixel;

typedef struct _RECT {
    int left;
    int top;
    int right;
    int bottom;
} RECT;
typedef RECT *PRECT;

typedef struct _POINT {
    int x;
    int y;
} POINT;
typedef POINT *PPOINT;

typedef struct _SIZE {
    int cx;
    int cy;
} SIZE;
typedef SIZE *PSIZE;

typedef struct _RGB {
    BYTE r;
    BYTE g;
    BYTE b;
    BYTE a;
} RGB;
typedef RGB *PRGB;

typedef LRESULT (*WNDPROC)(HWND, UINT, WPARAM, LPARAM);

#define MGUI_WORD_BITS 32

#define LOWORD(l) ((WORD)((DWORD)(l)&0xFFFFFFFFUL))
#define HIWORD(l) ((WORD)(((DWORD)(l) >> 32) & 0xFFFFFFFFUL))
#define LOSWORD(l) ((SWORD)LOWORD(l))
#define HISWORD(l) ((SWORD)HIWORD(l))
#define MAKELONG(low, high) ((DWORD)(((DWORD)(WORD)(low)) | (((DWORD)(WORD)(high)) << 32)))
#define MAKELONG32(low, high) MAKELONG(low, high)

#define LOBYTE(w) ((BYTE)(w))
#define HIBYTE(w) ((BYTE)(((WORD)(w) >> 8) & 0xFF))
#define MAKEWORD(low, high) ((WORD)(((BYTE)(low)) | (((WORD)((BYTE)(high))) << 8)))
#define FIRSTBYTE(w) ((BYTE)(w))
#define SECONDBYTE(w) ((BYTE)((w) >> 8))
#define THIRDBYTE(w) ((BYTE)((w) >> 16))
#define FOURTHBYTE(w) ((BYTE)((w) >> 24))

#define MakeRGB(r, g, b) \
    (((DWORD32)((BYTE)(r))) | ((DWORD32)((BYTE)(g)) << 8) | ((DWORD32)((BYTE)(b)) << 16))
#define MakeRGBA(r, g, b, a) (MakeRGB(r, g, b) | ((DWORD32)((BYTE)(a)) << 24))
#define GetRValue(rgba) ((BYTE)(rgba))
#define GetGValue(rgba) ((BYTE)(((DWORD32)(rgba)) >> 8))
#define GetBValue(rgba) ((BYTE)((DWORD32)(rgba) >> 16))
#define GetAValue(rgba) ((BYTE)((DWORD32)(rgba) >> 24))

#define RECTW(rc) ((rc).right - (rc).left)
#define RECTH(rc) ((rc).bottom - (rc).top)
#define RECTWP(prc) ((prc)->right - (prc)->left)
#define RECTHP(prc) ((prc)->bottom - (prc)->top)

#define HWND_NULL ((HWND)0)
#define HWND_INVALID ((HWND)-1)
#define HDC_SCREEN ((HDC)0)
#define HDC_INVALID ((HDC)-1)
#define INV_PTR ((void *)-1)

#define ERR_OK 0
#define ERR_INV_HWND -1
#define ERR_QUEUE_FULL -2

#ifndef MIN
#define MIN(x, y) (((x) < (y)) ? (x) : (y))
#endif
#ifndef MAX
#define MAX(x, y) (((x) > (y)) ? (x) : (y))
#endif
#ifndef TABLESIZE
#define TABLESIZE(table) (sizeof(table) / sizeof(table[0]))
#endif

#ifdef __cplusplus
}
#endif
#endif

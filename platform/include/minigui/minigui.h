/* MiniGUI 3 start-up, screen, system colours, key codes and rectangle helpers. */
#ifndef FTX_MINIGUI_MINIGUI_H
#define FTX_MINIGUI_MINIGUI_H

#include <pthread.h>

#include "common.h"

#ifdef __cplusplus
extern "C" {
#endif

/* Key scan codes. */
#define SCANCODE_ESCAPE 1
#define SCANCODE_1 2
#define SCANCODE_2 3
#define SCANCODE_3 4
#define SCANCODE_4 5
#define SCANCODE_5 6
#define SCANCODE_6 7
#define SCANCODE_7 8
#define SCANCODE_8 9
#define SCANCODE_9 10
#define SCANCODE_0 11
#define SCANCODE_MINUS 12
#define SCANCODE_EQUAL 13
#define SCANCODE_BACKSPACE 14
#define SCANCODE_TAB 15
#define SCANCODE_Q 16
#define SCANCODE_W 17
#define SCANCODE_E 18
#define SCANCODE_R 19
#define SCANCODE_T 20
#define SCANCODE_Y 21
#define SCANCODE_U 22
#define SCANCODE_I 23
#define SCANCODE_O 24
#define SCANCODE_P 25
#define SCANCODE_BRACKET_LEFT 26
#define SCANCODE_BRACKET_RIGHT 27
#define SCANCODE_ENTER 28
#define SCANCODE_LEFTCONTROL 29
#define SCANCODE_A 30
#define SCANCODE_S 31
#define SCANCODE_D 32
#define SCANCODE_F 33
#define SCANCODE_G 34
#define SCANCODE_H 35
#define SCANCODE_J 36
#define SCANCODE_K 37
#define SCANCODE_L 38
#define SCANCODE_SEMICOLON 39
#define SCANCODE_APOSTROPHE 40
#define SCANCODE_GRAVE 41
#define SCANCODE_LEFTSHIFT 42
#define SCANCODE_BACKSLASH 43
#define SCANCODE_Z 44
#define SCANCODE_X 45
#define SCANCODE_C 46
#define SCANCODE_V 47
#define SCANCODE_B 48
#define SCANCODE_N 49
#define SCANCODE_M 50
#define SCANCODE_COMMA 51
#define SCANCODE_PERIOD 52
#define SCANCODE_SLASH 53
#define SCANCODE_RIGHTSHIFT 54
#define SCANCODE_KEYPADMULTIPLY 55
#define SCANCODE_LEFTALT 56
#define SCANCODE_SPACE 57
#define SCANCODE_CAPSLOCK 58
#define SCANCODE_F1 59
#define SCANCODE_F2 60
#define SCANCODE_F3 61
#define SCANCODE_F4 62
#define SCANCODE_F5 63
#define SCANCODE_F6 64
#define SCANCODE_F7 65
#define SCANCODE_F8 66
#define SCANCODE_F9 67
#define SCANCODE_F10 68
#define SCANCODE_NUMLOCK 69
#define SCANCODE_SCROLLLOCK 70
#define SCANCODE_KEYPAD7 71
#define SCANCODE_CURSORUPLEFT 71
#define SCANCODE_KEYPAD8 72
#define SCANCODE_CURSORUP 72
#define SCANCODE_KEYPAD9 73
#define SCANCODE_CURSORUPRIGHT 73
#define SCANCODE_KEYPADMINUS 74
#define SCANCODE_KEYPAD4 75
#define SCANCODE_CURSORLEFT 75
#define SCANCODE_KEYPAD5 76
#define SCANCODE_KEYPAD6 77
#define SCANCODE_CURSORRIGHT 77
#define SCANCODE_KEYPADPLUS 78
#define SCANCODE_KEYPAD1 79
#define SCANCODE_CURSORDOWNLEFT 79
#define SCANCODE_KEYPAD2 80
#define SCANCODE_CURSORDOWN 80
#define SCANCODE_KEYPAD3 81
#define SCANCODE_CURSORDOWNRIGHT 81
#define SCANCODE_KEYPAD0 82
#define SCANCODE_KEYPADPERIOD 83
#define SCANCODE_LESS 86
#define SCANCODE_F11 87
#define SCANCODE_F12 88
#define SCANCODE_KEYPADENTER 96
#define SCANCODE_RIGHTCONTROL 97
#define SCANCODE_CONTROL 97
#define SCANCODE_KEYPADDIVIDE 98
#define SCANCODE_PRINTSCREEN 99
#define SCANCODE_RIGHTALT 100
#define SCANCODE_BREAK 101
#define SCANCODE_HOME 102
#define SCANCODE_CURSORBLOCKUP 103
#define SCANCODE_PAGEUP 104
#define SCANCODE_CURSORBLOCKLEFT 105
#define SCANCODE_CURSORBLOCKRIGHT 106
#define SCANCODE_END 107
#define SCANCODE_CURSORBLOCKDOWN 108
#define SCANCODE_PAGEDOWN 109
#define SCANCODE_INSERT 110
#define SCANCODE_REMOVE 111
#define SCANCODE_PAUSE 119
#define SCANCODE_BREAK_ALTERNATIVE 119
#define SCANCODE_POWER 120
#define SCANCODE_SLEEP 121
#define SCANCODE_WAKEUP 122
#define SCANCODE_LEFTWIN 125
#define SCANCODE_RIGHTWIN 126
#define SCANCODE_MENU 127
#define NR_KEYS 128
#define SCANCODE_USER (NR_KEYS + 1)
#define MGUI_NR_KEYS 255
#define SCANCODE_LEFTBUTTON 0x1000
#define SCANCODE_RIGHTBUTTON 0x2000
#define SCANCODE_MIDDLBUTTON 0x4000

/* Key and button state flags. */
#define KS_RIGHTSHIFT 0x00000001
#define KS_LEFTSHIFT 0x00000002
#define KS_SHIFT 0x00000003
#define KS_RIGHTALT 0x00000004
#define KS_LEFTALT 0x00000008
#define KS_ALT 0x0000000C
#define KS_RIGHTCTRL 0x00000010
#define KS_LEFTCTRL 0x00000020
#define KS_CTRL 0x00000030
#define KS_SCROLLLOCK 0x00000040
#define KS_NUMLOCK 0x00000080
#define KS_CAPSLOCK 0x00000100
#define KS_IMEPOST 0x00000200
#define KS_CAPTURED 0x00000400
#define KS_REPEATED 0x00000800
#define MASK_KS_SHIFTKEYS 0x00000FFF
#define KS_LEFTBUTTON 0x00001000
#define KS_RIGHTBUTTON 0x00002000
#define KS_MIDDLBUTTON 0x00004000
#define MASK_KS_BUTTONS 0x0000F000

/* Start-up. InitGUI starts the desktop, the timer thread, the display backend and the
 * emulator console; returns 0. Calling it again does nothing. */
MGUI_API int InitGUI(int argc, const char *argv[]);
MGUI_API void TerminateGUI(int not_used);
/* Starts the input layer (keys and touches from the display window and the console).
 * The handset's library calls it once its main window exists; returns 0. */
MGUI_API int InitGUIIAL(void);

int MiniGUIAppMain(int argc, const char *argv[]);
#define MiniGUIMain                                   \
    MiniGUIAppMain(int args, const char *argv[]);     \
    int main_entry(int args, const char *argv[]) {    \
        int iRet = 0;                                 \
        if (InitGUI(args, argv) != 0) return 1;       \
        iRet = MiniGUIAppMain(args, argv);            \
        TerminateGUI(iRet);                           \
        return iRet;                                  \
    }                                                 \
    int main(int args, char *argv[]) {                \
        return main_entry(args, (const char **)argv); \
    }                                                 \
    int MiniGUIAppMain

/* The key code reported to a PC for a scan code (the handset's key numbering); 0 when the
 * scan code stands for no key. */
MGUI_API int scancode_convert_keycode(int scancode);

/* The screen. */
extern MGUI_API RECT g_rcScr;

/* System colours: indexes 0..16 are the standard ones, 17..22 the handset's theme
 * (17 bar background, 18 window background, 19 text, 20 frame, 21 dialog control
 * background, 22 highlight). */
#define FTX_NR_SYSPIXEL 23
extern MGUI_API gal_pixel SysPixelIndex[FTX_NR_SYSPIXEL];
extern MGUI_API const RGB SysPixelColor[FTX_NR_SYSPIXEL];

#define PIXEL_invalid 0
#define PIXEL_transparent SysPixelIndex[0]
#define PIXEL_darkblue SysPixelIndex[1]
#define PIXEL_darkgreen SysPixelIndex[2]
#define PIXEL_darkcyan SysPixelIndex[3]
#define PIXEL_darkred SysPixelIndex[4]
#define PIXEL_darkmagenta SysPixelIndex[5]
#define PIXEL_darkyellow SysPixelIndex[6]
#define PIXEL_darkgray SysPixelIndex[7]
#define PIXEL_lightgray SysPixelIndex[8]
#define PIXEL_blue SysPixelIndex[9]
#define PIXEL_green SysPixelIndex[10]
#define PIXEL_cyan SysPixelIndex[11]
#define PIXEL_red SysPixelIndex[12]
#define PIXEL_magenta SysPixelIndex[13]
#define PIXEL_yellow SysPixelIndex[14]
#define PIXEL_lightwhite SysPixelIndex[15]
#define PIXEL_black SysPixelIndex[16]

#define COLOR_invalid PIXEL_invalid
#define COLOR_transparent PIXEL_transparent
#define COLOR_darkblue PIXEL_darkblue
#define COLOR_darkgreen PIXEL_darkgreen
#define COLOR_darkcyan PIXEL_darkcyan
#define COLOR_darkred PIXEL_darkred
#define COLOR_darkmagenta PIXEL_darkmagenta
#define COLOR_darkyellow PIXEL_darkyellow
#define COLOR_darkgray PIXEL_darkgray
#define COLOR_lightgray PIXEL_lightgray
#define COLOR_blue PIXEL_blue
#define COLOR_green PIXEL_green
#define COLOR_cyan PIXEL_cyan
#define COLOR_red PIXEL_red
#define COLOR_magenta PIXEL_magenta
#define COLOR_yellow PIXEL_yellow
#define COLOR_lightwhite PIXEL_lightwhite
#define COLOR_black PIXEL_black

/* Rectangle helpers (right column and bottom row lie outside). */
static inline void SetRect(RECT *prc, int left, int top, int right, int bottom) {
    prc->left = left;
    prc->top = top;
    prc->right = right;
    prc->bottom = bottom;
}
static inline void SetRectEmpty(RECT *prc) {
    SetRect(prc, 0, 0, 0, 0);
}
static inline void CopyRect(RECT *pdrc, const RECT *psrc) {
    *pdrc = *psrc;
}
static inline void OffsetRect(RECT *prc, int x, int y) {
    prc->left += x;
    prc->top += y;
    prc->right += x;
    prc->bottom += y;
}
static inline void InflateRect(RECT *prc, int cx, int cy) {
    prc->left -= cx;
    prc->top -= cy;
    prc->right += cx;
    prc->bottom += cy;
}
static inline BOOL IsRectEmpty(const RECT *prc) {
    return prc->left >= prc->right || prc->top >= prc->bottom;
}
static inline BOOL PtInRect(const RECT *prc, int x, int y) {
    return x >= prc->left && x < prc->right && y >= prc->top && y < prc->bottom;
}
static inline BOOL EqualRect(const RECT *a, const RECT *b) {
    return a->left == b->left && a->top == b->top && a->right == b->right && a->bottom == b->bottom;
}
static inline void NormalizeRect(RECT *prc) {
    int t;
    if (prc->left > prc->right) {
        t = prc->left;
        prc->left = prc->right;
        prc->right = t;
    }
    if (prc->top > prc->bottom) {
        t = prc->top;
        prc->top = prc->bottom;
        prc->bottom = t;
    }
}
static inline BOOL IntersectRect(RECT *pdrc, const RECT *psrc1, const RECT *psrc2) {
    RECT r;
    r.left = MAX(psrc1->left, psrc2->left);
    r.top = MAX(psrc1->top, psrc2->top);
    r.right = MIN(psrc1->right, psrc2->right);
    r.bottom = MIN(psrc1->bottom, psrc2->bottom);
    if (r.left >= r.right || r.top >= r.bottom) {
        SetRectEmpty(pdrc);
        return FALSE;
    }
    *pdrc = r;
    return TRUE;
}
static inline BOOL DoesIntersect(const RECT *psrc1, const RECT *psrc2) {
    RECT r;
    return IntersectRect(&r, psrc1, psrc2);
}
static inline BOOL UnionRect(RECT *pdrc, const RECT *psrc1, const RECT *psrc2) {
    if (IsRectEmpty(psrc1)) {
        *pdrc = *psrc2;
        return !IsRectEmpty(psrc2);
    }
    if (IsRectEmpty(psrc2)) {
        *pdrc = *psrc1;
        return TRUE;
    }
    RECT r;
    r.left = MIN(psrc1->left, psrc2->left);
    r.top = MIN(psrc1->top, psrc2->top);
    r.right = MAX(psrc1->right, psrc2->right);
    r.bottom = MAX(psrc1->bottom, psrc2->bottom);
    *pdrc = r;
    return TRUE;
}

/* 10 ms ticks since InitGUI (FTX_TIME_SCALE shortens the tick). */
MGUI_API DWORD GetTickCount(void);

#ifdef __cplusplus
}
#endif
#endif

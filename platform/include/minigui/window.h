/* MiniGUI 3 windows, messages, hooks and timers (MiniGUI-Threads semantics). */
#ifndef FTX_MINIGUI_WINDOW_H
#define FTX_MINIGUI_WINDOW_H

#include <pthread.h>

#include "common.h"
#include "gdi.h"
#include "minigui.h"

#ifdef __cplusplus
extern "C" {
#endif

/* Mouse */
#define MSG_LBUTTONDOWN 0x0001
#define MSG_LBUTTONUP 0x0002
#define MSG_LBUTTONDBLCLK 0x0003
#define MSG_MOUSEMOVE 0x0004
#define MSG_RBUTTONDOWN 0x0005
#define MSG_RBUTTONUP 0x0006
#define MSG_RBUTTONDBLCLK 0x0007
#define MSG_NCLBUTTONDOWN 0x0008
#define MSG_NCLBUTTONUP 0x0009
#define MSG_NCLBUTTONDBLCLK 0x000A
#define MSG_NCMOUSEMOVE 0x000B
#define MSG_NCRBUTTONDOWN 0x000C
#define MSG_NCRBUTTONUP 0x000D
#define MSG_NCRBUTTONDBLCLK 0x000E
#define MSG_FIRSTMOUSEMSG 0x0001
#define MSG_LASTMOUSEMSG 0x000F
/* Keys */
#define MSG_KEYDOWN 0x0010
#define MSG_CHAR 0x0011
#define MSG_KEYUP 0x0012
#define MSG_SYSKEYDOWN 0x0013
#define MSG_SYSCHAR 0x0014
#define MSG_SYSKEYUP 0x0015
#define MSG_KEYLONGPRESS 0x0016
#define MSG_KEYALWAYSPRESS 0x0017
#define MSG_KEYSYM 0x0018
#define MSG_UTF8CHAR 0x0019
#define MSG_FIRSTKEYMSG 0x0010
#define MSG_LASTKEYMSG 0x001F
/* Post-mouse and window state */
#define MSG_NCHITTEST 0x0021
#define MSG_HITTEST MSG_NCHITTEST
#define MSG_SIZECHANGING 0x0025
#define MSG_SIZECHANGED 0x0026
#define MSG_CSIZECHANGED 0x0027
#define MSG_SETFOCUS 0x0030
#define MSG_KILLFOCUS 0x0031
#define MSG_MOUSEACTIVE 0x0032
#define MSG_ACTIVE 0x0033
#define MSG_HSCROLL 0x0042
#define MSG_VSCROLL 0x0043
/* Creation */
#define MSG_CREATE 0x0060
#define MSG_NCCREATE 0x0061
#define MSG_DESTROY 0x0064
#define MSG_CLOSE 0x0066
/* Painting */
#define MSG_SHOWWINDOW 0x00A0
#define MSG_ERASEBKGND 0x00B0
#define MSG_PAINT 0x00B1
#define MSG_NCPAINT 0x00B2
/* Commands and text */
#define MSG_COMMAND 0x0120
#define MSG_SYSCOMMAND 0x0121
#define MSG_FONTCHANGING 0x0130
#define MSG_FONTCHANGED 0x0131
#define MSG_GETTEXTLENGTH 0x0132
#define MSG_GETTEXT 0x0133
#define MSG_SETTEXT 0x0134
#define MSG_ENABLE 0x0135
/* System */
#define MSG_QUIT 0x0140
#define MSG_IDLE 0x0142
#define MSG_TIMER 0x0144
#define MSG_FIRSTUSERMSG 0x0800
#define MSG_USER 0x0800
#define MSG_LASTUSERMSG 0xEFFF
#define MSG_FIRSTCTRLMSG 0xF000
#define MSG_LASTCTRLMSG 0xFFFF

/* Window styles */
#define WS_NONE 0x00000000L
#define WS_CHILD 0x40000000L
#define WS_CAPTION 0x20000000L
#define WS_SYSMENU 0x10000000L
#define WS_VISIBLE 0x08000000L
#define WS_DISABLED 0x04000000L
#define WS_MINIMIZE 0x02000000L
#define WS_MAXIMIZE 0x01000000L
#define WS_DLGFRAME 0x00800000L
#define WS_BORDER 0x00400000L
#define WS_THICKFRAME 0x00200000L
#define WS_THINFRAME 0x00100000L
#define WS_VSCROLL 0x00080000L
#define WS_HSCROLL 0x00040000L
#define WS_GROUP 0x00020000L
#define WS_MINIMIZEBOX 0x00020000L
#define WS_TABSTOP 0x00010000L
#define WS_MAXIMIZEBOX 0x00010000L
#define WS_OVERLAPPED 0x00000000L
#define WS_ABSSCRPOS 0x00000000L
#define WS_CTRLMASK 0x0000FFFFL

#define WS_EX_NONE 0x00000000L
#define WS_EX_CONTROL_MASK 0x0000000FL
#define WS_EX_TROUNDCNS 0x00000010L
#define WS_EX_BROUNDCNS 0x00000020L
#define WS_EX_USEPRIVATECDC 0x00000040L
#define WS_EX_NOTDRAGGABLE 0x00000080L
#define WS_EX_DRAGGABLE 0x00000000L
#define WS_EX_USEPARENTFONT 0x00000100L
#define WS_EX_USEPARENTCURSOR 0x00000200L
#define WS_EX_USEPARENTRDR 0x00000400L
#define WS_EX_NOPARENTNOTIFY 0x00000800L
#define WS_EX_AUTOSECONDARYDC 0x00001000L
#define WS_EX_TRANSPARENT 0x00002000L
#define WS_EX_TOPMOST 0x00004000L
/* A tool window (the soft-key bar, the title strip) is never made the active window. */
#define WS_EX_TOOLWINDOW 0x00008000L
#define WS_EX_RIGHT 0x00010000L
#define WS_EX_LEFT 0x00000000L
#define WS_EX_RTLREADING 0x00020000L
#define WS_EX_LTRREADING 0x00000000L
#define WS_EX_LEFTSCROLLBAR 0x00040000L
#define WS_EX_RIGHTSCROLLBAR 0x00000000L
#define WS_EX_DLGHIDE 0x00100000L
#define WS_EX_NOCLOSEBOX 0x00400000L
#define WS_EX_CLIPCHILDREN 0x00800000L
#define WS_EX_LFRDR_MASK 0x0F000000L
#define WS_EX_LFRDR_CUSTOM1 0x01000000L
#define WS_EX_LFRDR_CUSTOM2 0x02000000L
#define WS_EX_LFRDR_CUSTOM3 0x04000000L
#define WS_EX_LFRDR_CUSTOM4 0x08000000L
#define WS_EX_INTERNAL_MASK 0xF0000000L
#define WS_EX_IMECOMPOSE 0x00000000L

#define SW_HIDE 0x0000
#define SW_SHOW 0x0010
#define SW_SHOWNORMAL 0x0100

#define PM_NOREMOVE 0x0000
#define PM_REMOVE 0x0001

#define HOOK_GOON 0
#define HOOK_STOP 1

/* The desktop window (not a real window: IsWindow(HWND_DESKTOP) is FALSE). */
extern MGUI_API HWND __mg_hwnd_desktop;
#define HWND_DESKTOP __mg_hwnd_desktop

typedef struct _MAINWINCREATE {
    DWORD dwStyle;
    DWORD dwExStyle;
    const char *spCaption;
    HMENU hMenu;
    HCURSOR hCursor;
    HICON hIcon;
    HWND hHosting;
    LRESULT (*MainWindowProc)(HWND, UINT, WPARAM, LPARAM);
    int lx, ty, rx, by;
    gal_pixel iBkColor;
    DWORD dwAddData;
    DWORD dwReserved;
} MAINWINCREATE;
typedef MAINWINCREATE *PMAINWINCREATE;

#define COP_STYLE 0x0001
#define COP_HCURSOR 0x0002
#define COP_BKCOLOR 0x0004
#define COP_WINPROC 0x0008
#define COP_ADDDATA 0x0010

typedef struct _WNDCLASS {
    const char *spClassName;
    DWORD opMask;
    DWORD dwStyle;
    DWORD dwExStyle;
    HCURSOR hCursor;
    gal_pixel iBkColor;
    LRESULT (*WinProc)(HWND, UINT, WPARAM, LPARAM);
    DWORD dwAddData;
} WNDCLASS;
typedef WNDCLASS *PWNDCLASS;

typedef struct _MSG {
    HWND hwnd;
    UINT message;
    WPARAM wParam;
    LPARAM lParam;
    DWORD time;
    void *pAdd;
} MSG;
typedef MSG *PMSG;

typedef int (*MSGHOOK)(void *context, HWND dst_wnd, UINT msg, WPARAM wparam, LPARAM lparam);
typedef BOOL (*TIMERPROC)(HWND, LINT id, DWORD tick_count);
typedef void (*NOTIFPROC)(HWND hwnd, LINT id, int nc, DWORD add_data);

/* Main windows and their threads. */
MGUI_API HWND CreateMainWindowEx(PMAINWINCREATE pCreateInfo, const char *werdr_name,
                                 const void *we_rdr, const void *we_attrs, const char *window_name,
                                 const char *layer_name);
static inline HWND CreateMainWindow(PMAINWINCREATE pCreateInfo) {
    return CreateMainWindowEx(pCreateInfo, NULL, NULL, NULL, NULL, NULL);
}
MGUI_API BOOL DestroyMainWindow(HWND hWnd);
MGUI_API void MainWindowThreadCleanup(HWND hMainWnd);
#define MainWindowCleanup(hwnd) MainWindowThreadCleanup(hwnd)
MGUI_API int CreateThreadForMainWindow(pthread_t *thread, pthread_attr_t *attr,
                                       void *(*start_routine)(void *), void *arg);
MGUI_API pthread_t GetMainWinThread(HWND hMainWnd);
MGUI_API int WaitMainWindowClose(HWND hWnd, void **returnval);

/* Controls. */
MGUI_API HWND CreateWindowEx(const char *spClassName, const char *spCaption, DWORD dwStyle,
                             DWORD dwExStyle, LINT id, int x, int y, int w, int h, HWND hParentWnd,
                             DWORD dwAddData);
#define CreateWindow(class_name, caption, style, id, x, y, w, h, parent, add_data) \
    CreateWindowEx(class_name, caption, style, 0, id, x, y, w, h, parent, add_data)
MGUI_API BOOL DestroyWindow(HWND hWnd);
MGUI_API void DestroyAllControls(HWND hWnd);

MGUI_API BOOL RegisterWindowClass(PWNDCLASS pWndClass);
MGUI_API BOOL UnregisterWindowClass(const char *szClassName);
MGUI_API BOOL GetWindowClassInfo(PWNDCLASS pWndClass);
MGUI_API BOOL SetWindowClassInfo(const WNDCLASS *pWndClass);

/* Messages. */
MGUI_API BOOL GetMessage(PMSG pMsg, HWND hMainWnd);
MGUI_API BOOL PeekMessage(PMSG pMsg, HWND hWnd, UINT nMsgFilterMin, UINT nMsgFilterMax,
                          UINT uRemoveMsg);
MGUI_API BOOL TranslateMessage(PMSG pMsg);
MGUI_API LRESULT DispatchMessage(PMSG pMsg);
MGUI_API LRESULT SendMessage(HWND hWnd, UINT nMsg, WPARAM wParam, LPARAM lParam);
MGUI_API int PostMessage(HWND hWnd, UINT nMsg, WPARAM wParam, LPARAM lParam);
MGUI_API int SendNotifyMessage(HWND hWnd, UINT nMsg, WPARAM wParam, LPARAM lParam);
MGUI_API LRESULT SendAsyncMessage(HWND hWnd, UINT nMsg, WPARAM wParam, LPARAM lParam);
MGUI_API LRESULT PostSyncMessage(HWND hWnd, UINT nMsg, WPARAM wParam, LPARAM lParam);
MGUI_API int PostQuitMessage(HWND hWnd);

extern MGUI_API WNDPROC __mg_def_proc[3];
#define DefaultMainWinProc (__mg_def_proc[0])
#define DefaultDialogProc (__mg_def_proc[1])
#define DefaultControlProc (__mg_def_proc[2])

/* Window state. */
MGUI_API BOOL ShowWindow(HWND hWnd, int iCmdShow);
MGUI_API BOOL MoveWindow(HWND hWnd, int x, int y, int w, int h, BOOL fPaint);
MGUI_API BOOL EnableWindow(HWND hWnd, BOOL fEnable);
MGUI_API BOOL IsWindowEnabled(HWND hWnd);
MGUI_API BOOL IsWindow(HWND hWnd);
MGUI_API BOOL IsMainWindow(HWND hWnd);
MGUI_API BOOL IsControl(HWND hWnd);
MGUI_API BOOL IsWindowVisible(HWND hWnd);
MGUI_API HWND GetActiveWindow(void);
MGUI_API HWND SetActiveWindow(HWND hMainWnd);
MGUI_API HWND GetParent(HWND hWnd);
MGUI_API HWND GetMainWindowHandle(HWND hWnd);
MGUI_API HWND GetHosting(HWND hMainWnd);
MGUI_API BOOL GetClientRect(HWND hWnd, PRECT prc);
MGUI_API BOOL GetWindowRect(HWND hWnd, PRECT prc);
MGUI_API void ClientToScreen(HWND hWnd, int *x, int *y);
MGUI_API void ScreenToClient(HWND hWnd, int *x, int *y);
MGUI_API BOOL InvalidateRect(HWND hWnd, const RECT *prc, BOOL bEraseBkgnd);
MGUI_API void UpdateWindow(HWND hWnd, BOOL bErase);
MGUI_API HWND SetFocusChild(HWND hWnd);
MGUI_API HWND GetFocusChild(HWND hParent);
#define SetFocus SetFocusChild
#define GetFocus GetFocusChild
MGUI_API HWND GetDlgItem(HWND hDlg, LINT nIDDlgItem);
MGUI_API LINT GetDlgCtrlID(HWND hwndCtl);
MGUI_API BOOL SetWindowText(HWND hWnd, const char *spString);
MGUI_API int GetWindowText(HWND hWnd, char *spString, int nMaxLen);
MGUI_API int GetWindowTextLength(HWND hWnd);
MGUI_API const char *GetWindowCaption(HWND hWnd);
MGUI_API BOOL SetWindowCaption(HWND hWnd, const char *spCaption);
MGUI_API PLOGFONT SetWindowFont(HWND hWnd, PLOGFONT pLogFont);
MGUI_API PLOGFONT GetWindowFont(HWND hWnd);
MGUI_API gal_pixel SetWindowBkColor(HWND hWnd, gal_pixel new_bkcolor);
MGUI_API gal_pixel GetWindowBkColor(HWND hWnd);
MGUI_API DWORD GetWindowStyle(HWND hWnd);
MGUI_API DWORD GetWindowExStyle(HWND hWnd);
MGUI_API BOOL IncludeWindowStyle(HWND hWnd, DWORD dwStyle);
MGUI_API BOOL ExcludeWindowStyle(HWND hWnd, DWORD dwStyle);
MGUI_API DWORD GetWindowAdditionalData(HWND hWnd);
MGUI_API DWORD SetWindowAdditionalData(HWND hWnd, DWORD newData);
MGUI_API DWORD GetWindowAdditionalData2(HWND hWnd);
MGUI_API DWORD SetWindowAdditionalData2(HWND hWnd, DWORD newData);
MGUI_API WNDPROC GetWindowCallbackProc(HWND hWnd);
MGUI_API WNDPROC SetWindowCallbackProc(HWND hWnd, WNDPROC newProc);
MGUI_API NOTIFPROC SetNotificationCallback(HWND hwnd, NOTIFPROC notif_proc);
MGUI_API NOTIFPROC GetNotificationCallback(HWND hwnd);
MGUI_API void NotifyParentEx(HWND hwnd, LINT id, int code, DWORD add_data);
#define NotifyParent(hwnd, id, code) NotifyParentEx(hwnd, id, code, 0)
MGUI_API HWND GetCapture(void);
MGUI_API HWND SetCapture(HWND hWnd);
MGUI_API void ReleaseCapture(void);

/* Hooks: called on the input thread before an event is queued; HOOK_STOP swallows it. */
MGUI_API MSGHOOK RegisterKeyMsgHook(void *context, MSGHOOK hook);
MGUI_API MSGHOOK RegisterMouseMsgHook(void *context, MSGHOOK hook);

/* Timers: speed in 10 ms units. */
MGUI_API BOOL SetTimerEx(HWND hWnd, LINT id, DWORD speed, TIMERPROC timer_proc);
#define SetTimer(hwnd, id, speed) SetTimerEx(hwnd, id, speed, NULL)
MGUI_API int KillTimer(HWND hWnd, LINT id);
MGUI_API BOOL ResetTimerEx(HWND hWnd, LINT id, DWORD speed, TIMERPROC timer_proc);
#define ResetTimer(hwnd, id, speed) ResetTimerEx(hwnd, id, speed, (TIMERPROC)INV_PTR)
MGUI_API BOOL IsTimerInstalled(HWND hWnd, LINT id);
MGUI_API BOOL HaveFreeTimer(void);

#ifdef __cplusplus
}
#endif
#endif

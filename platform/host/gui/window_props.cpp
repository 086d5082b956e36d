// Window properties and queries: enabled state, kind and visibility, parent and host,
// rectangles and coordinates, focus and dialog items, text and caption, font, colours,
// styles, additional data, procedures and notifications.
#include "window_internal.h"

using namespace ftxgui;

extern "C" {

BOOL EnableWindow(HWND h, BOOL enable) {
    BOOL old;
    {
        std::lock_guard<std::mutex> lk(g_lock);
        Window *w = as_window_locked(h);
        if (w == nullptr) return FALSE;
        old = (w->style & WS_DISABLED) == 0;
        if (enable)
            w->style &= ~static_cast<DWORD>(WS_DISABLED);
        else
            w->style |= WS_DISABLED;
    }
    if (old != (enable != 0)) SendMessage(h, MSG_ENABLE, enable, 0);
    return old;
}

BOOL IsWindowEnabled(HWND h) {
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    return w != nullptr && (w->style & WS_DISABLED) == 0;
}

BOOL IsWindow(HWND h) {
    std::lock_guard<std::mutex> lk(g_lock);
    return as_window_locked(h) != nullptr;
}

BOOL IsMainWindow(HWND h) {
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    return w != nullptr && w->isMain;
}

BOOL IsControl(HWND h) {
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    return w != nullptr && !w->isMain;
}

BOOL IsWindowVisible(HWND h) {
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    for (; w != nullptr; w = w->parent)
        if ((w->style & WS_VISIBLE) == 0) return FALSE;
    return as_window_locked(h) != nullptr;
}

HWND GetParent(HWND h) {
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    if (w == nullptr) return HWND_INVALID;
    if (w->parent != nullptr) return w->parent;
    return w->host != nullptr ? static_cast<HWND>(w->host) : HWND_DESKTOP;
}

HWND GetMainWindowHandle(HWND h) {
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    if (w == nullptr) return HWND_INVALID;
    while (w->parent != nullptr)
        w = w->parent;
    return w;
}

HWND GetHosting(HWND h) {
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    if (w == nullptr || !w->isMain) return HWND_INVALID;
    return w->host != nullptr ? static_cast<HWND>(w->host) : HWND_DESKTOP;
}

extern "C++" {
namespace {

// A window's rectangle as pick gives it, or the whole screen for the desktop.
template <typename Pick>
BOOL query_rect(HWND h, PRECT prc, Pick pick) {
    if (prc == nullptr) return FALSE;
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    if (w == nullptr) {
        if (h != HWND_DESKTOP) return FALSE;
        *prc = screen_rect();
        return TRUE;
    }
    *prc = pick(w);
    return TRUE;
}

}  // namespace
}  // extern "C++"

BOOL GetClientRect(HWND h, PRECT prc) {
    return query_rect(h, prc, [](Window *w) {
        RECT r = client_screen_rect_locked(w);
        RECT out;
        SetRect(&out, 0, 0, r.right - r.left, r.bottom - r.top);
        return out;
    });
}

BOOL GetWindowRect(HWND h, PRECT prc) {
    return query_rect(h, prc, [](Window *w) { return w->rc; });
}

void ClientToScreen(HWND h, int *x, int *y) {
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    if (w == nullptr) return;
    RECT r = client_screen_rect_locked(w);
    if (x != nullptr) *x += r.left;
    if (y != nullptr) *y += r.top;
}

void ScreenToClient(HWND h, int *x, int *y) {
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    if (w == nullptr) return;
    RECT r = client_screen_rect_locked(w);
    if (x != nullptr) *x -= r.left;
    if (y != nullptr) *y -= r.top;
}

HWND SetFocusChild(HWND h) {
    Window *old = nullptr;
    {
        std::lock_guard<std::mutex> lk(g_lock);
        Window *w = as_window_locked(h);
        if (w == nullptr || w->parent == nullptr) return HWND_INVALID;
        old = w->parent->focus;
        if (old == w) return old;
        w->parent->focus = w;
    }
    if (old != nullptr) SendMessage(old, MSG_KILLFOCUS, reinterpret_cast<WPARAM>(h), 0);
    SendMessage(h, MSG_SETFOCUS, reinterpret_cast<WPARAM>(old), 0);
    return old;
}

HWND GetFocusChild(HWND h) {
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    if (w == nullptr || w->focus == nullptr || g_windows.count(w->focus) == 0) return HWND_NULL;
    return w->focus;
}

HWND GetDlgItem(HWND h, LINT id) {
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    if (w == nullptr) return HWND_NULL;
    for (Window *c : w->children)
        if (c->id == id) return c;
    return HWND_NULL;
}

LINT GetDlgCtrlID(HWND h) {
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    return w != nullptr ? w->id : -1;
}

BOOL SetWindowText(HWND h, const char *text) {
    return SendMessage(h, MSG_SETTEXT, 0, reinterpret_cast<LPARAM>(text)) == 0;
}

int GetWindowText(HWND h, char *buf, int max) {
    if (buf == nullptr || max < 0) return 0;
    return static_cast<int>(
        SendMessage(h, MSG_GETTEXT, static_cast<WPARAM>(max), reinterpret_cast<LPARAM>(buf)));
}

int GetWindowTextLength(HWND h) {
    return static_cast<int>(SendMessage(h, MSG_GETTEXTLENGTH, 0, 0));
}

const char *GetWindowCaption(HWND h) {
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    return w != nullptr ? w->caption.c_str() : nullptr;
}

BOOL SetWindowCaption(HWND h, const char *caption) {
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    if (w == nullptr) return FALSE;
    w->caption = caption != nullptr ? caption : "";
    invalidate_locked(w, nullptr, true);
    return TRUE;
}

PLOGFONT SetWindowFont(HWND h, PLOGFONT font) {
    if (font == nullptr) font = g_SysLogFont[SYSLOGFONT_DEFAULT];
    PLOGFONT old;
    {
        std::lock_guard<std::mutex> lk(g_lock);
        Window *w = as_window_locked(h);
        if (w == nullptr) return nullptr;
        old = w->font;
    }
    if (SendMessage(h, MSG_FONTCHANGING, 0, reinterpret_cast<LPARAM>(font)) != 0) return old;
    {
        std::lock_guard<std::mutex> lk(g_lock);
        Window *w = as_window_locked(h);
        if (w == nullptr) return old;
        w->font = font;
        invalidate_locked(w, nullptr, true);
    }
    SendMessage(h, MSG_FONTCHANGED, 0, 0);
    return old;
}

PLOGFONT GetWindowFont(HWND h) {
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    return w != nullptr ? w->font : nullptr;
}

gal_pixel SetWindowBkColor(HWND h, gal_pixel c) {
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    if (w == nullptr) return 0;
    gal_pixel old = w->bk;
    w->bk = c;
    return old;
}

gal_pixel GetWindowBkColor(HWND h) {
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    return w != nullptr ? w->bk : 0;
}

DWORD GetWindowStyle(HWND h) {
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    return w != nullptr ? w->style : 0;
}

DWORD GetWindowExStyle(HWND h) {
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    return w != nullptr ? w->exStyle : 0;
}

BOOL IncludeWindowStyle(HWND h, DWORD s) {
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    if (w == nullptr) return FALSE;
    w->style |= s;
    return TRUE;
}

BOOL ExcludeWindowStyle(HWND h, DWORD s) {
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    if (w == nullptr) return FALSE;
    w->style &= ~s;
    return TRUE;
}

#define FTX_WINDOW_FIELD(getter, setter, field) \
    DWORD getter(HWND h) {                      \
        std::lock_guard<std::mutex> lk(g_lock); \
        Window *w = as_window_locked(h);        \
        return w != nullptr ? w->field : 0;     \
    }                                           \
    DWORD setter(HWND h, DWORD v) {             \
        std::lock_guard<std::mutex> lk(g_lock); \
        Window *w = as_window_locked(h);        \
        if (w == nullptr) return 0;             \
        DWORD old = w->field;                   \
        w->field = v;                           \
        return old;                             \
    }
FTX_WINDOW_FIELD(GetWindowAdditionalData, SetWindowAdditionalData, add1)
FTX_WINDOW_FIELD(GetWindowAdditionalData2, SetWindowAdditionalData2, add2)
#undef FTX_WINDOW_FIELD

WNDPROC GetWindowCallbackProc(HWND h) {
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    return w != nullptr ? w->proc : nullptr;
}

WNDPROC SetWindowCallbackProc(HWND h, WNDPROC proc) {
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    if (w == nullptr) return nullptr;
    WNDPROC old = w->proc;
    if (proc != nullptr) w->proc = proc;
    return old;
}

NOTIFPROC SetNotificationCallback(HWND h, NOTIFPROC proc) {
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    if (w == nullptr) return nullptr;
    NOTIFPROC old = w->notif;
    w->notif = proc;
    return old;
}

NOTIFPROC GetNotificationCallback(HWND h) {
    std::lock_guard<std::mutex> lk(g_lock);
    Window *w = as_window_locked(h);
    return w != nullptr ? w->notif : nullptr;
}

void NotifyParentEx(HWND h, LINT id, int code, DWORD add) {
    NOTIFPROC proc;
    Window *parent;
    {
        std::lock_guard<std::mutex> lk(g_lock);
        Window *w = as_window_locked(h);
        if (w == nullptr) return;
        proc = w->notif;
        parent = (w->exStyle & WS_EX_NOPARENTNOTIFY) != 0 ? nullptr : w->parent;
    }
    if (proc != nullptr) {
        proc(h, id, code, add);
    } else if (parent != nullptr) {
        SendNotifyMessage(parent, MSG_COMMAND,
                          MAKELONG(static_cast<WORD>(id), static_cast<WORD>(code)),
                          reinterpret_cast<LPARAM>(h));
    }
}

}  // extern "C"

// The GUI-thread helper: a synchronous SendMessage for callers that need the result, a
// notify message for fire-and-forget work.
#include "mmi_guithread.h"

#include <pthread.h>

#include <atomic>

namespace {
std::atomic<HWND> s_window{HWND_INVALID};
}  // namespace

void mmi_guithread_set_window(HWND hWnd) {
    s_window = hWnd;
}

HWND mmi_guithread_window(void) {
    return s_window;
}

int mmi_on_gui_thread(void) {
    HWND w = s_window;
    if (w == HWND_INVALID || w == HWND_NULL || !IsWindow(w)) return 1;
    return pthread_equal(GetMainWinThread(w), pthread_self()) ? 1 : 0;
}

int mmi_RunOnGuiThread(mmi_gui_fn fn, void *arg) {
    if (!fn) return -1;
    if (mmi_on_gui_thread()) return fn(arg);
    return (int)SendMessage(s_window, MSG_RUNONGUITHREAD, (WPARAM)fn, (LPARAM)arg);
}

int mmi_PostToGuiThread(mmi_gui_fn fn, void *arg) {
    if (!fn) return -1;
    HWND w = s_window;
    if (w == HWND_INVALID || w == HWND_NULL || !IsWindow(w)) {
        fn(arg);
        return 0;
    }
    return SendNotifyMessage(w, MSG_RUNONGUITHREAD, (WPARAM)fn, (LPARAM)arg) == ERR_OK ? 0 : -1;
}

int mmi_guithread_dispatch(UINT msg, WPARAM wParam, LPARAM lParam, LRESULT *result) {
    if (msg != MSG_RUNONGUITHREAD) return 0;
    mmi_gui_fn fn = reinterpret_cast<mmi_gui_fn>(wParam);
    LRESULT r = fn ? fn(reinterpret_cast<void *>(lParam)) : -1;
    if (result) *result = r;
    return 1;
}

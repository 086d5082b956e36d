// Shared between the window core's own files (window.cpp, window_*.cpp) only.
#pragma once

#include <unordered_set>
#include <vector>

#include "gui_internal.h"

namespace ftxgui {

// The window system's state (window.cpp), under g_lock. It outlives static destruction:
// GUI threads may still run at exit.
extern std::unordered_set<Window *> &g_windows;  // live windows
// Destroyed windows, memory kept until the queue's clean-up.
extern std::unordered_set<Window *> &g_zombies;
extern std::vector<Window *> &g_zorder;  // main windows, top first
extern std::vector<MsgQueue *> &g_queues;
extern Window *g_active;
extern Window *g_capture;
extern thread_local MsgQueue *t_queue;  // the calling thread's queue, once it has one

// Lookups and geometry (window.cpp).
bool same_thread(const MsgQueue *q);
bool is_tool(const Window *w);
bool shown(const Window *w);
RECT screen_rect();
// A live window, or a destroyed one whose memory is still kept.
Window *any_window_locked(HWND h);
int border_of(const Window *w);

// Z-order and activation (window_zorder.cpp).
Window *pick_active_locked(const Window *exclude);
// Repaints what a vanished or moved window leaves behind.
void expose_locked(const RECT &rc, const Window *gone);
// Makes nw the active window and tells both windows; call without the lock.
void activate(Window *nw);

// Painting (window_paint.cpp): the first shown window at or below w with a paint due.
Window *find_paint_locked(Window *w);

}  // namespace ftxgui

// Shared between the GUI library's own files only.
#pragma once

#include <pthread.h>

#include <atomic>
#include <condition_variable>
#include <deque>
#include <mutex>
#include <string>
#include <vector>

#include "aux_fb.h"
#include "minigui/common.h"
#include "minigui/minigui.h"
#include "minigui/gdi.h"
#include "minigui/window.h"
#include "minigui/control.h"

namespace ftxgui {

// A set of disjoint rectangles (screen coordinates).
struct Region {
    std::vector<RECT> rects;
    void set(const RECT &rc);
    void clear() { rects.clear(); }
    bool empty() const { return rects.empty(); }
    void intersect(const RECT &rc);
    void intersect(const Region &r);
    void subtract(const RECT &rc);
    void unite(const RECT &rc);  // rc is added without overlapping what is there
    bool contains(int x, int y) const;
    RECT bounds() const;
};

struct MsgQueue;

struct WndClass {
    std::string name;
    WNDPROC proc = nullptr;
    DWORD style = 0;
    DWORD exStyle = 0;
    gal_pixel bk = 0;
    DWORD addData = 0;
    bool parentBk = true;  // built-in controls take the parent's background
};

constexpr uint32_t kWindowMagic = 0x57494E44;  // "WIND"

struct Window {
    uint32_t magic = kWindowMagic;
    bool isMain = false;
    bool destroyed = false;
    MsgQueue *queue = nullptr;
    Window *parent = nullptr;  // controls
    Window *host = nullptr;    // main windows: the hosting main window
    const WndClass *cls = nullptr;
    WNDPROC proc = nullptr;
    std::string caption;
    DWORD style = 0;
    DWORD exStyle = 0;
    gal_pixel bk = 0;
    RECT rc{};  // main: screen; control: parent's client coordinates
    LINT id = 0;
    DWORD add1 = 0;
    DWORD add2 = 0;
    PLOGFONT font = nullptr;
    std::vector<Window *> children;
    Window *focus = nullptr;
    Window *capture = nullptr;  // child holding the pointer between press and release
    NOTIFPROC notif = nullptr;
    // Painting (under the window lock): invalid part in client coordinates.
    bool paintPending = false;
    bool erase = false;
    RECT inv{};
};

struct SyncMsg {
    Window *wnd;
    UINT msg;
    WPARAM wp;
    LPARAM lp;
    LRESULT result = 0;
    bool done = false;
};

struct Timer {
    bool used = false;
    Window *wnd = nullptr;
    LINT id = 0;
    DWORD speed = 1;
    TIMERPROC proc = nullptr;
    MsgQueue *queue = nullptr;
    uint64_t last = 0;
    bool pending = false;
    DWORD firedAt = 0;
};

constexpr size_t kPostedSlots = 16;

struct MsgQueue {
    pthread_t thread{};
    std::condition_variable cv;
    bool quit = false;
    Window *quitWnd = nullptr;
    std::deque<SyncMsg *> sync;
    std::deque<MSG> notify;
    std::deque<MSG> posted;
    std::vector<Window *> mains;  // the root first
    Window *root = nullptr;
    bool waiting = false;  // blocked in GetMessage with nothing to do
};

// The window system's one lock: windows, queues, z-order, timers, hooks.
extern std::mutex g_lock;
extern std::condition_variable &g_syncCv;

bool alive_locked(HWND h);
std::vector<Timer> &timers_locked();
Window *capture_main_locked();
Window *as_window_locked(HWND h);
// Screen rectangle of the client area / whole window.
RECT client_screen_rect_locked(const Window *w);
RECT window_screen_rect_locked(const Window *w);
// What of the client (or whole window) is visible on screen.
void visible_region_locked(const Window *w, bool client, Region &out);
// Bumped under g_lock whenever a window is shown, hidden, raised, moved or destroyed: a
// device context made before then checks what of its window is still visible before it
// draws again (DcDraw).
extern std::atomic<unsigned> g_zGen;
void invalidate_locked(Window *w, const RECT *clientRc, bool erase);
void wake_locked(MsgQueue *q);
std::vector<Window *> zorder_snapshot_locked();
Window *active_locked();
bool queues_idle_locked();
// A touch move is waiting in some queue (a newer one would replace it).
bool moves_pending_locked();
// Waits until the input layer has handed on every event and no window has a touch move
// waiting: a gesture's next move then cannot replace one not yet seen. False on time-out.
bool wait_moves_taken(int timeoutMs);
// The desktop's answer to a request sent to HWND_DESKTOP.
LRESULT desktop_request_locked(UINT msg, WPARAM wp, LPARAM lp);

// Runs fn on the thread that owns w (directly when that is this thread).
LRESULT call_on_owner(Window *w, LRESULT (*fn)(Window *, void *), void *arg);

void timers_start();

// Framebuffer (display.cpp).
extern std::mutex g_fbLock;
extern Uint32 *g_fb;
extern int g_fbW, g_fbH;
extern std::atomic<unsigned> g_fbSerial;  // bumped by every drawing call
void display_init();
void display_dim_state(int *blank, int *brightness);
void present_copy(std::vector<Uint32> &out);  // the shown picture, dimmed
// Writes pixels (0x00RRGGBB) as an RGB PNG; 0 or -1 (logged).
int write_png(const char *path, int width, int height, const Uint32 *pixels);
// The auxiliary display as its program left it (dark, of the configured size, when it
// never ran), and its picture as a PNG.
ftxhost::AuxFrame aux_frame();
int aux_screenshot(const char *path);

// A device context: an origin and a clip region in screen coordinates plus attributes.
constexpr uint32_t kDcMagic = 0x4844430A;
struct DC {
    uint32_t magic = kDcMagic;
    Window *win = nullptr;
    bool client = true;  // of the client area, not the whole window
    int ox = 0, oy = 0;
    Region base;        // what of the window is on screen
    Region clip;        // base narrowed by the program's clip calls
    unsigned zGen = 0;  // g_zGen when base was last checked
    gal_pixel bk = 0xFFFFFF, pen = 0, brush = 0xFFFFFF, text = 0;
    int bkMode = BM_OPAQUE;
    Uint32 textAlign = 0;
    int tabStop = 8;
    int charExtra = 0, alineExtra = 0, blineExtra = 0;
    int penWidth = 1;
    Uint32 penType = 0, capStyle = 0, joinStyle = 0, brushType = 0;
    POINT pos{0, 0};
    PLOGFONT font = nullptr;
};
DC *as_dc(HDC hdc);
// Holds the framebuffer while drawing through a DC. A DC lives across other threads'
// work: a bar's paint may begin before a window comes up over the bar and draw after that
// window painted. So whenever the windows changed since the DC last looked, what of its
// window is no longer visible is first taken out of its region. The look is made with the
// framebuffer held: a window that comes up after it paints after this drawing, over it.
class DcDraw {
  public:
    explicit DcDraw(DC *dc);
    ~DcDraw();  // the picture changed
    DcDraw(const DcDraw &) = delete;
    DcDraw &operator=(const DcDraw &) = delete;
};
// Pixel writers; the caller holds g_fbLock. Coordinates are on screen.
void px_fill(const DC *dc, RECT rc, gal_pixel px);
void px_blend(const DC *dc, int x, int y, gal_pixel px, int alpha);

// GDI internals (gdi.cpp).
void fill_screen_rect_locked_fb(const Region &clip, const RECT &rc, gal_pixel px);
void draw_frame_screen(const Region &clip, const RECT &rc, gal_pixel px);
HDC make_dc(Window *w, bool client, bool paint);
void free_dc(HDC hdc);
int dc_font_height(HDC hdc);

// Fonts (font.cpp).
void fonts_init(int screenWidth);

// Controls (controls.cpp).
void controls_register();
const WndClass *find_class_locked(const char *name);
// Whether a control lets the pointer through to its parent.
bool control_mouse_transparent(const Window *w);

// Input (input.cpp).
bool ial_running();
bool input_idle();

// Console (console.cpp) and its parser (console_parse.cpp).
void console_autostart();

// Painting helpers used by the default procedures.
void draw_border(Window *w);

LRESULT default_main_proc(HWND, UINT, WPARAM, LPARAM);
LRESULT default_control_proc(HWND, UINT, WPARAM, LPARAM);

gal_pixel rgb_pixel(int r, int g, int b);

}  // namespace ftxgui

// The two bars share one implementation; each instance has its own window thread, lock
// and registry. Registry access is under the bar's lock; drawing works on a copy so a slow
// redraw never holds the registry.
#include "mmi_bars.h"

#include <android/log.h>
#include <stdlib.h>
#include <string.h>
#include <tp_os.h>

#include <atomic>

#include "mmi_iconlet.h"
#include "mmi_theme.h"

namespace {

#define TAG "FTX_MAIN"

struct BarRecord {
    BarRecord *prev;
    BarRecord *next;
    char *items[3];
    HWND owner;
    const ICONLET_SKIN *skin;  // null: the bar's default skin
    int visible;
};

struct Bar {
    const char *lockName;
    const char *threadName;
    const char *caption;
    int priority;
    WNDPROC proc;
    std::atomic<HWND> window{HWND_NULL};
    std::atomic<HWND> control{HWND_NULL};
    int lock = -1;
    BarRecord head{};  // sentinel of the circular list
    RECT rect{};
    PLOGFONT font = nullptr;
};

LRESULT soft_key_bar_proc(HWND, UINT, WPARAM, LPARAM);
LRESULT batteryshow_proc(HWND, UINT, WPARAM, LPARAM);

Bar s_skb{"SOFT_KEY_BAR_LOCK", "PROCESS_DVK_SOFT_KEY_BAR", "softkeybar", 200, soft_key_bar_proc};
Bar s_title{"BATTERYSHOW_LOCK", "PROCESS_BATTERYSHOW", "batteryshow", 208, batteryshow_proc};

// The handset asks for 2048 bytes of stack; the host's FreeType text rendering needs far
// more than the platform's 64 KiB floor, so the bars take the default stack.
const size_t kBarStack = 0;

// Scan codes a tap on each soft-key slot stands for.
const int kSlotKeys[3] = {SCANCODE_F2, SCANCODE_F4, SCANCODE_F3};

bool exists(const Bar &b) {
    return b.control.load() != HWND_NULL;
}

void lock(Bar &b) {
    tp_os_sema_get(b.lock, TP_OS_WAIT_FOREVER);
}
void unlock(Bar &b) {
    tp_os_sema_put(b.lock);
}

void init_list(Bar &b) {
    if (b.head.next == nullptr) b.head.next = b.head.prev = &b.head;
}

BarRecord *find_locked(Bar &b, HWND owner) {
    init_list(b);
    for (BarRecord *r = b.head.next; r != &b.head; r = r->next)
        if (r->owner == owner) return r;
    return nullptr;
}

void free_record(BarRecord *r) {
    for (char *t : r->items)
        free(t);
    free(r);
}

void unlink_record(BarRecord *r) {
    r->prev->next = r->next;
    r->next->prev = r->prev;
}

BarRecord *new_record(HWND owner, const char *const texts[3]) {
    BarRecord *r = static_cast<BarRecord *>(calloc(1, sizeof(BarRecord)));
    if (!r) return nullptr;
    r->owner = owner;
    r->visible = 1;
    for (int i = 0; i < 3; i++)
        r->items[i] = strndup(texts[i] ? texts[i] : "", ICONLET_TEXT_SIZE - 1);
    return r;
}

int set_texts(Bar &b, HWND owner, const char *const texts[3]) {
    if (!exists(b)) return 0;
    BarRecord *r = new_record(owner, texts);
    if (!r) return 0;
    lock(b);
    BarRecord *old = find_locked(b, owner);
    if (old) {
        unlink_record(old);
        free_record(old);
    }
    r->next = &b.head;
    r->prev = b.head.prev;
    b.head.prev->next = r;
    b.head.prev = r;
    unlock(b);
    return 1;
}

int set_text_by_index(Bar &b, HWND owner, const char *text, int index, const char *fn) {
    if (!exists(b)) return 0;
    if (index < 0 || index > 2) {
        __android_log_print(ANDROID_LOG_ERROR, TAG, "%s index error = %d", fn, index);
        return 0;
    }
    char *copy = strndup(text ? text : "", ICONLET_TEXT_SIZE - 1);
    lock(b);
    BarRecord *r = find_locked(b, owner);
    if (r) {
        free(r->items[index]);
        r->items[index] = copy;
        copy = nullptr;
    }
    unlock(b);
    if (!r) {
        __android_log_print(ANDROID_LOG_ERROR, TAG, "%s pNode is NULL", fn);
        free(copy);
        return 0;
    }
    return 1;
}

int update(Bar &b, HWND owner) {
    if (!exists(b)) return 0;
    char texts[3][ICONLET_TEXT_SIZE] = {};
    bool present[3] = {};
    const ICONLET_SKIN *skin = nullptr;
    int visible = 1;
    lock(b);
    if (BarRecord *r = find_locked(b, owner)) {
        for (int i = 0; i < 3; i++) {
            present[i] = r->items[i] != nullptr;
            if (present[i]) tp_os_strlcpy(texts[i], r->items[i], ICONLET_TEXT_SIZE);
        }
        skin = r->skin;
        visible = r->visible;
    }
    unlock(b);
    HWND ctrl = b.control;
    HWND win = b.window;
    if (ctrl == HWND_NULL) return 0;
    SendMessage(ctrl, ILM_LOCKPAINT, 1, 0);
    SendMessage(ctrl, ILM_RESETCONTENT, 0, 0);
    SendMessage(ctrl, ILM_SETSKIN, 0, (LPARAM)skin);
    RECT rc;
    GetClientRect(win, &rc);
    int slotWidth = RECTW(rc) / 3;
    for (int i = 0; i < 3; i++) {
        if (!present[i]) continue;
        ICONLET_ITEM it{};
        it.x = i * slotWidth;
        it.width = slotWidth;
        it.slot = i;
        tp_os_strlcpy(it.text, texts[i], sizeof it.text);
        SendMessage(ctrl, ILM_ADDITEM, 0, (LPARAM)&it);
    }
    bool ownerShown = owner && owner != HWND_INVALID && (GetWindowStyle(owner) & WS_VISIBLE);
    ShowWindow(win, visible && ownerShown ? SW_SHOW : SW_HIDE);
    SendMessage(ctrl, ILM_LOCKPAINT, 0, 0);
    return 1;
}

void *bar_thread(void *arg) {
    Bar &b = *static_cast<Bar *>(arg);
    MAINWINCREATE create{};
    create.dwStyle = WS_NONE;
    create.dwExStyle = WS_EX_TOOLWINDOW | WS_EX_TOPMOST;
    create.spCaption = b.caption;
    create.hHosting = HWND_DESKTOP;
    create.MainWindowProc = b.proc;
    create.lx = b.rect.left;
    create.ty = b.rect.top;
    create.rx = b.rect.right;
    create.by = b.rect.bottom;
    create.iBkColor = mmi_pixel(MMI_COLOUR_BAR);
    HWND win = CreateMainWindow(&create);
    if (win == HWND_INVALID) {
        unlock(b);
        return nullptr;
    }
    HWND ctrl = CreateWindowEx(CTRL_ICONLET, "", WS_CHILD | WS_VISIBLE, WS_EX_NONE, 1, 0, 0,
                               RECTW(b.rect), RECTH(b.rect), win, 0);
    if (ctrl != HWND_INVALID) {
        int w = g_ptScreenInfo.width;
        if (!b.font)
            b.font = CreateLogFont("ttf", "song", "GB18030", 'r', 'r', 'n', 'c', 'n', 'n',
                                   w < 1725 ? (int)((w * 458129845LL) >> 33) & ~3 : 90, 0);
        if (b.font) SetWindowFont(ctrl, b.font);
        SetWindowBkColor(ctrl, mmi_pixel(MMI_COLOUR_BAR));
        SendMessage(ctrl, ILM_SETALIGN, ICONLET_ALIGN_CENTER, 0);
        b.window = win;
        b.control = ctrl;
    }
    unlock(b);
    if (ctrl != HWND_INVALID) {
        MSG msg;
        while (GetMessage(&msg, win)) {
            TranslateMessage(&msg);
            DispatchMessage(&msg);
        }
    } else {
        DestroyMainWindow(win);
    }
    MainWindowThreadCleanup(win);
    b.control = HWND_NULL;
    b.window = HWND_NULL;
    return nullptr;
}

int create(Bar &b, const RECT *rect) {
    if (!rect) return 0;
    if (!exists(b)) {
        if (b.lock < 0) {
            b.lock = tp_os_sema_named(b.lockName, 0);
        } else {
            lock(b);
        }
        if (b.lock < 0) return 0;
        b.rect = *rect;
        if (tp_os_thread_create(b.threadName, b.priority, kBarStack, bar_thread, &b) == 0) {
            unlock(b);
            return 0;
        }
        lock(b);  // the thread releases the lock once the bar is built
        unlock(b);
    }
    return exists(b) ? 1 : 0;
}

int show(Bar &b, int on) {
    if (!exists(b)) return 0;
    ShowWindow(b.window, on ? SW_SHOW : SW_HIDE);
    return 1;
}

int destroy(Bar &b) {
    if (!exists(b)) return 0;
    HWND win = b.window;
    SendNotifyMessage(win, MSG_CLOSE, 0, 0);
    // The bar's own thread closes it; wait (bounded) until it has.
    for (int i = 0; i < 200 && exists(b); i++)
        tp_os_usleep(10000);
    return 1;
}

int del_items(Bar &b) {
    if (!exists(b)) return 0;
    lock(b);
    init_list(b);
    while (b.head.next != &b.head) {
        BarRecord *r = b.head.next;
        unlink_record(r);
        free_record(r);
    }
    unlock(b);
    return 1;
}

int record_count(Bar &b) {
    if (b.lock < 0) return 0;
    lock(b);
    init_list(b);
    int n = 0;
    for (BarRecord *r = b.head.next; r != &b.head; r = r->next)
        n++;
    unlock(b);
    return n;
}

LRESULT close_bar(HWND h) {
    DestroyAllControls(h);
    DestroyMainWindow(h);
    PostQuitMessage(h);
    return 0;
}

LRESULT soft_key_bar_proc(HWND h, UINT msg, WPARAM wParam, LPARAM lParam) {
    switch (msg) {
        case MSG_LBUTTONDOWN: {
            RECT rc;
            GetClientRect(h, &rc);
            int slot = tp_bar_slot_at(LOSWORD(lParam), RECTW(rc));
            if (slot >= 0 && s_skb.control != HWND_NULL)
                SendMessage(s_skb.control, ILM_SETPRESSED, (WPARAM)slot, 0);
            return 0;
        }
        case MSG_LBUTTONUP: {
            HWND ctrl = s_skb.control;
            if (ctrl == HWND_NULL) return 0;
            RECT rc;
            GetClientRect(h, &rc);
            int slot = tp_bar_slot_at(LOSWORD(lParam), RECTW(rc));
            int pressed = (int)SendMessage(ctrl, ILM_GETPRESSED, 0, 0);
            SendMessage(ctrl, ILM_SETPRESSED, (WPARAM)-1, 0);
            if (slot < 0 || slot != pressed) return 0;
            HWND active = GetActiveWindow();
            if (!active || active == HWND_INVALID) return 0;
            bool press = false;
            lock(s_skb);
            if (BarRecord *r = find_locked(s_skb, active)) {
                const char *t = r->items[slot];
                press = t && t[0] != '\0' && t[0] != ' ';
            }
            unlock(s_skb);
            if (!press) return 0;
            PostMessage(active, MSG_KEYDOWN, (WPARAM)kSlotKeys[slot], 0);
            PostMessage(active, MSG_SOFTKEYTAP, (WPARAM)slot, 0);
            return 0;
        }
        case MSG_MOUSEMOVE:
            return 0;
        case MSG_CLOSE:
            return close_bar(h);
        default:
            return DefaultMainWinProc(h, msg, wParam, lParam);
    }
}

LRESULT batteryshow_proc(HWND h, UINT msg, WPARAM wParam, LPARAM lParam) {
    if (msg == MSG_CLOSE) return close_bar(h);
    if (msg >= MSG_FIRSTMOUSEMSG && msg <= MSG_LASTMOUSEMSG) return 0;  // nothing to touch
    return DefaultMainWinProc(h, msg, wParam, lParam);
}

const char *const *texts_of(const TP_BAR_ITEM items[3], const char *out[3]) {
    for (int i = 0; i < 3; i++)
        out[i] = items ? items[i].text : nullptr;
    return out;
}

}  // namespace

int tp_bar_slot_at(int x, int w) {
    int slotWidth = w / 3;
    if (x < 0 || slotWidth <= 0) return -1;
    int slot = x / slotWidth;
    return slot > 2 ? -1 : slot;
}

int tp_skb_create(HWND, const RECT *rect) {
    return create(s_skb, rect);
}
int svr_create_softkeybar(HWND owner, const RECT *rect, int on) {
    int ok = tp_skb_create(owner, rect);
    if (ok && on) show(s_skb, 1);
    return ok;
}
int tp_skb_set_items(HWND owner, const TP_BAR_ITEM items[3]) {
    const char *t[3];
    return set_texts(s_skb, owner, texts_of(items, t));
}
int tp_skb_set_text_items(HWND owner, const char *left, const char *middle, const char *right) {
    const char *t[3] = {left, middle, right};
    return set_texts(s_skb, owner, t);
}
int tp_skb_set_text_col(int colour) {
    if (!exists(s_skb)) return 0;
    SendMessage(s_skb.control, ILM_SETTEXTCOLOR, (WPARAM)colour, 0);
    return 1;
}
int tp_skb_update(HWND owner) {
    return update(s_skb, owner);
}
int tp_skb_show(int on) {
    return show(s_skb, on);
}
int tp_skb_del_items(void) {
    return del_items(s_skb);
}
int tp_skb_destroy(void) {
    return destroy(s_skb);
}
int svr_destroy_softkeybar(void) {
    return tp_skb_destroy();
}

int tp_batteryshow_create(HWND, const RECT *rect) {
    return create(s_title, rect);
}
int svr_create_batteryshow(HWND owner, const RECT *rect, int on) {
    int ok = tp_batteryshow_create(owner, rect);
    if (ok && on) show(s_title, 1);
    return ok;
}
int tp_batteryshow_set_items(HWND owner, const TP_BAR_ITEM items[3]) {
    const char *t[3];
    return set_texts(s_title, owner, texts_of(items, t));
}
int tp_batteryshow_set_items_byIndex(HWND owner, const TP_BAR_ITEM *item, int index) {
    return set_text_by_index(s_title, owner, item ? item->text : nullptr, index,
                             "tp_batteryshow_set_items_byIndex");
}
int tp_batteryshow_set_text_items(HWND owner, const char *left, const char *middle,
                                  const char *right) {
    const char *t[3] = {left, middle, right};
    return set_texts(s_title, owner, t);
}
int tp_batteryshow_set_text_items_byIndex(HWND owner, const char *text, int index) {
    return set_text_by_index(s_title, owner, text, index, "tp_batteryshow_set_text_items_byIndex");
}
int tp_batteryshow_set_text_col(int colour) {
    if (!exists(s_title)) return 0;
    SendMessage(s_title.control, ILM_SETTEXTCOLOR, (WPARAM)colour, 0);
    return 1;
}
int tp_batteryshow_update(HWND owner) {
    return update(s_title, owner);
}
int tp_batteryshow_show(int on) {
    return show(s_title, on);
}
int tp_batteryshow_destroy(void) {
    return destroy(s_title);
}

HWND tp_skb_window(void) {
    return s_skb.window;
}
HWND tp_skb_control(void) {
    return s_skb.control;
}
HWND tp_batteryshow_window(void) {
    return s_title.window;
}
HWND tp_batteryshow_control(void) {
    return s_title.control;
}
int tp_batteryshow_has_items(HWND owner) {
    if (s_title.lock < 0) return 0;
    lock(s_title);
    int found = find_locked(s_title, owner) != nullptr ? 1 : 0;
    unlock(s_title);
    return found;
}
int tp_skb_record_count(void) {
    return record_count(s_skb);
}
int tp_batteryshow_record_count(void) {
    return record_count(s_title);
}

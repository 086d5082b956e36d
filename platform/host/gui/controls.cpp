// Window classes and the built-in controls: "static" (text, rectangles, frames, bitmaps)
// and "scrollview" (a list of program-drawn items with a highlighted one).
#include <string.h>
#include <strings.h>

#include <algorithm>
#include <memory>

#include "gui_internal.h"

namespace ftxgui {

namespace {

std::vector<std::unique_ptr<WndClass>> &g_classes = *new std::vector<std::unique_ptr<WndClass>>;

bool valid_class_name(const char *name) {
    if (name == nullptr || !isalpha(static_cast<unsigned char>(name[0]))) return false;
    return strlen(name) <= 31;
}

// ---- static -----------------------------------------------------------------------------

void static_paint(HWND h) {
    HDC hdc = BeginPaint(h);
    DWORD style = GetWindowStyle(h);
    RECT rc;
    GetClientRect(h, &rc);
    DWORD type = style & SS_TYPEMASK;
    switch (type) {
        case SS_BLACKRECT:
        case SS_GRAYRECT:
        case SS_WHITERECT: {
            const gal_pixel fills[] = {PIXEL_black, PIXEL_darkgray, PIXEL_lightwhite};
            SetBrushColor(hdc, fills[type - SS_BLACKRECT]);
            FillBox(hdc, 0, 0, RECTW(rc), RECTH(rc));
            break;
        }
        case SS_BLACKFRAME:
        case SS_GRAYFRAME:
        case SS_WHITEFRAME: {
            const gal_pixel frames[] = {PIXEL_black, PIXEL_darkgray, PIXEL_lightwhite};
            SetPenColor(hdc, frames[type - SS_BLACKFRAME]);
            Rectangle(hdc, 0, 0, RECTW(rc) - 1, RECTH(rc) - 1);
            break;
        }
        case SS_BITMAP: {
            const BITMAP *bmp = reinterpret_cast<const BITMAP *>(GetWindowAdditionalData(h));
            if (bmp != nullptr && bmp->bmBits != nullptr) {
                if ((style & SS_REALSIZEIMAGE) != 0) {
                    int x = (style & SS_CENTERIMAGE) != 0
                                ? (RECTW(rc) - static_cast<int>(bmp->bmWidth)) / 2
                                : 0;
                    int y = (style & SS_CENTERIMAGE) != 0
                                ? (RECTH(rc) - static_cast<int>(bmp->bmHeight)) / 2
                                : 0;
                    FillBoxWithBitmap(hdc, x, y, 0, 0, bmp);
                } else {
                    FillBoxWithBitmap(hdc, 0, 0, RECTW(rc), RECTH(rc), bmp);
                }
            }
            break;
        }
        case SS_ICON:
        case SS_OWNERDRAW:
        case SS_ENHMETAFILE:
            break;
        default: {
            const char *text = GetWindowCaption(h);
            std::string copy = text != nullptr ? text : "";
            SetBkMode(hdc, BM_TRANSPARENT);
            SetTextColor(hdc, SysPixelIndex[19]);
            UINT fmt = DT_TOP;
            DWORD align = style & SS_ALIGNMASK;
            if (align == SS_CENTER) fmt |= DT_CENTER;
            if (align == SS_RIGHT) fmt |= DT_RIGHT;
            if (type == SS_GROUPBOX) {
                SetPenColor(hdc, SysPixelIndex[20]);
                int half = GetFontHeight(hdc) / 2;
                Rectangle(hdc, 0, half, RECTW(rc) - 1, RECTH(rc) - 1);
                SetBkMode(hdc, BM_OPAQUE);
                SetBkColor(hdc, GetWindowBkColor(h));
                TextOut(hdc, half, 0, copy.c_str());
                break;
            }
            if ((style & SS_NOWORDWRAP) != 0) {
                fmt |= DT_SINGLELINE;
                if ((style & SS_CENTERIMAGE) != 0) fmt |= DT_VCENTER;
            } else {
                fmt |= DT_WORDBREAK;
                if ((style & SS_CENTERIMAGE) != 0) {
                    RECT calc = rc;
                    int th = DrawText(hdc, copy.c_str(), -1, &calc, fmt | DT_CALCRECT);
                    rc.top += std::max(0, (RECTH(rc) - th) / 2);
                }
            }
            DrawText(hdc, copy.c_str(), -1, &rc, fmt);
            break;
        }
    }
    EndPaint(h, hdc);
}

LRESULT static_proc(HWND h, UINT msg, WPARAM wp, LPARAM lp) {
    switch (msg) {
        case MSG_PAINT:
            static_paint(h);
            return 0;
        case MSG_SETTEXT:
            SetWindowCaption(h, reinterpret_cast<const char *>(lp));
            return 0;
        case STM_SETIMAGE: {
            DWORD old = SetWindowAdditionalData(h, wp);
            InvalidateRect(h, nullptr, TRUE);
            return static_cast<LRESULT>(old);
        }
        case STM_GETIMAGE:
            return static_cast<LRESULT>(GetWindowAdditionalData(h));
        case STM_SETICON:
        case STM_GETICON:
            return 0;
        case MSG_LBUTTONUP:
            if ((GetWindowStyle(h) & SS_NOTIFY) != 0) NotifyParent(h, GetDlgCtrlID(h), STN_CLICKED);
            return 0;
        case MSG_LBUTTONDBLCLK:
            if ((GetWindowStyle(h) & SS_NOTIFY) != 0) NotifyParent(h, GetDlgCtrlID(h), STN_DBLCLK);
            return 0;
        default:
            return DefaultControlProc(h, msg, wp, lp);
    }
}

// ---- scroll view ------------------------------------------------------------------------

struct SvItem {
    int height = 16;
    DWORD addData = 0;
    bool selected = false;
};

// Lives in the control's second additional word; used on the control's thread only.
struct ScrollView {
    std::vector<SvItem *> items;
    int cur = -1;
    int pressed = -1;
    int top = 0;  // content offset
    SVITEMOPS ops{};
    SVITEM_CMP cmp = nullptr;
    ~ScrollView() {
        for (SvItem *i : items)
            delete i;
    }
};

ScrollView *sv_of(HWND h) {
    return reinterpret_cast<ScrollView *>(GetWindowAdditionalData2(h));
}

int sv_index(ScrollView *sv, WPARAM idOrHandle) {
    if (idOrHandle == 0) return -1;
    for (size_t i = 0; i < sv->items.size(); i++)
        if (reinterpret_cast<WPARAM>(sv->items[i]) == idOrHandle) return static_cast<int>(i);
    return -1;
}

// Index from an "index or handle" argument: a small value is an index.
int sv_resolve(ScrollView *sv, WPARAM v) {
    int byHandle = sv_index(sv, v);
    if (byHandle >= 0) return byHandle;
    if (v < sv->items.size()) return static_cast<int>(v);
    return -1;
}

int sv_item_top(ScrollView *sv, int idx) {
    int y = 0;
    for (int i = 0; i < idx; i++)
        y += sv->items[static_cast<size_t>(i)]->height;
    return y;
}

int sv_content_height(ScrollView *sv) {
    return sv_item_top(sv, static_cast<int>(sv->items.size()));
}

void sv_show(HWND h, ScrollView *sv, int idx) {
    if (idx < 0 || idx >= static_cast<int>(sv->items.size())) return;
    RECT rc;
    GetClientRect(h, &rc);
    int t = sv_item_top(sv, idx), b = t + sv->items[static_cast<size_t>(idx)]->height;
    int old = sv->top;
    if (t < sv->top) sv->top = t;
    if (b > sv->top + RECTH(rc)) sv->top = b - RECTH(rc);
    sv->top = std::max(0, std::min(sv->top, std::max(0, sv_content_height(sv) - RECTH(rc))));
    if (old != sv->top) InvalidateRect(h, nullptr, TRUE);
}

void sv_set_cur(HWND h, ScrollView *sv, int idx, bool notify) {
    if (idx == sv->cur || idx < -1 || idx >= static_cast<int>(sv->items.size())) return;
    if (notify && sv->cur >= 0)
        NotifyParentEx(h, GetDlgCtrlID(h), SVN_SELCHANGING,
                       reinterpret_cast<DWORD>(sv->items[static_cast<size_t>(sv->cur)]));
    sv->cur = idx;
    InvalidateRect(h, nullptr, TRUE);
    if (notify && idx >= 0)
        NotifyParentEx(h, GetDlgCtrlID(h), SVN_SELCHANGED,
                       reinterpret_cast<DWORD>(sv->items[static_cast<size_t>(idx)]));
}

int sv_hit(ScrollView *sv, int y) {
    int t = -sv->top;
    for (size_t i = 0; i < sv->items.size(); i++) {
        if (y >= t && y < t + sv->items[i]->height) return static_cast<int>(i);
        t += sv->items[i]->height;
    }
    return -1;
}

void sv_choose(HWND h, ScrollView *sv, int idx) {
    if (idx < 0) return;
    NotifyParentEx(h, GetDlgCtrlID(h), SVN_ITEMCHOSEN,
                   reinterpret_cast<DWORD>(sv->items[static_cast<size_t>(idx)]));
}

void sv_paint(HWND h, ScrollView *sv) {
    HDC hdc = BeginPaint(h);
    RECT rc;
    GetClientRect(h, &rc);
    int y = -sv->top;
    for (size_t i = 0; i < sv->items.size(); i++) {
        SvItem *it = sv->items[i];
        RECT ir{0, y, RECTW(rc), y + it->height};
        y += it->height;
        if (ir.bottom <= 0 || ir.top >= rc.bottom) continue;
        if (sv->ops.drawItem != nullptr) {
            sv->ops.drawItem(h, it, hdc, &ir);
        } else if (static_cast<int>(i) == sv->cur) {
            SetBrushColor(hdc, SysPixelIndex[22]);
            FillBox(hdc, ir.left, ir.top, RECTW(ir), RECTH(ir));
        }
    }
    EndPaint(h, hdc);
}

void sv_delete(HWND h, ScrollView *sv, int idx) {
    SvItem *it = sv->items[static_cast<size_t>(idx)];
    if (sv->ops.destroyItem != nullptr) sv->ops.destroyItem(h, it);
    sv->items.erase(sv->items.begin() + idx);
    delete it;
    if (sv->cur == idx) sv->cur = -1;
    if (sv->cur > idx) sv->cur--;
    sv->pressed = -1;
}

// Inserts an item where info asks (or in sort order); its position, or -1 when the item's
// init callback refused it.
LRESULT sv_add_item(HWND h, ScrollView *sv, WPARAM wp, LPARAM lp) {
    int count = static_cast<int>(sv->items.size());
    const SVITEMINFO *info = reinterpret_cast<const SVITEMINFO *>(lp);
    auto *it = new SvItem;
    if (info != nullptr) {
        it->height = info->nItemHeight > 0 ? info->nItemHeight : 16;
        it->addData = info->addData;
    }
    int pos = info != nullptr && info->nItem >= 0 && info->nItem < count ? info->nItem : count;
    if (sv->cmp != nullptr && (GetWindowStyle(h) & SVS_AUTOSORT) != 0) {
        pos = 0;
        while (pos < count && sv->cmp(sv->items[static_cast<size_t>(pos)], it) <= 0)
            pos++;
    }
    sv->items.insert(sv->items.begin() + pos, it);
    if (sv->ops.initItem != nullptr && sv->ops.initItem(h, it) == -1) {
        sv->items.erase(sv->items.begin() + pos);
        delete it;
        return -1;
    }
    if (sv->cur >= pos) sv->cur++;
    if (wp != 0) *reinterpret_cast<HSVITEM *>(wp) = it;
    InvalidateRect(h, nullptr, TRUE);
    return pos;
}

// Sorts the items by cmp (or the control's own), keeping the current item current.
LRESULT sv_sort(HWND h, ScrollView *sv, LPARAM lp) {
    auto cmp = reinterpret_cast<SVITEM_CMP>(lp);
    if (cmp == nullptr) cmp = sv->cmp;
    if (cmp == nullptr) return 0;
    SvItem *cur = sv->cur >= 0 ? sv->items[static_cast<size_t>(sv->cur)] : nullptr;
    std::stable_sort(sv->items.begin(), sv->items.end(),
                     [cmp](SvItem *a, SvItem *b) { return cmp(a, b) < 0; });
    sv->cur = cur != nullptr ? sv_index(sv, reinterpret_cast<WPARAM>(cur)) : -1;
    InvalidateRect(h, nullptr, TRUE);
    return 0;
}

// The content and view geometry messages.
LRESULT sv_geometry(HWND h, ScrollView *sv, UINT msg, LPARAM lp) {
    RECT rc;
    GetClientRect(h, &rc);
    switch (msg) {
        case SVM_GETFIRSTVISIBLEITEM:
            return sv_hit(sv, 0);
        case SVM_GETCONTENTY:
        case SVM_GETVSCROLLVAL:
            return sv->top;
        case SVM_GETCONTENTX:
        case SVM_GETHSCROLLVAL:
        case SVM_GETLEFTMARGIN:
        case SVM_GETTOPMARGIN:
        case SVM_GETRIGHTMARGIN:
        case SVM_GETBOTTOMMARGIN:
            return 0;
        case SVM_SETCONTPOS:
        case SVM_MAKEPOSVISIBLE:
            if (static_cast<long>(lp) >= 0) {
                sv->top = std::max(0, std::min(static_cast<int>(lp),
                                               std::max(0, sv_content_height(sv) - RECTH(rc))));
                InvalidateRect(h, nullptr, TRUE);
            }
            return 0;
        case SVM_GETVISIBLEWIDTH:
        case SVM_GETCONTWIDTH:
            return RECTW(rc);
        case SVM_GETVISIBLEHEIGHT:
        case SVM_GETVSCROLLPAGEVAL:
            return RECTH(rc);
        case SVM_GETCONTHEIGHT:
            return sv_content_height(sv);
        case SVM_GETMARGINS:
            if (lp != 0) SetRectEmpty(reinterpret_cast<RECT *>(lp));
            return 0;
        default:
            return 0;
    }
}

LRESULT sv_message(HWND h, ScrollView *sv, UINT msg, WPARAM wp, LPARAM lp) {
    int count = static_cast<int>(sv->items.size());
    switch (msg) {
        case SVM_ADDITEM:
            return sv_add_item(h, sv, wp, lp);
        case SVM_DELITEM: {
            int idx = sv_resolve(sv, wp);
            if (idx < 0) return -1;
            sv_delete(h, sv, idx);
            InvalidateRect(h, nullptr, TRUE);
            return 0;
        }
        case SVM_RESETCONTENT:
            while (!sv->items.empty())
                sv_delete(h, sv, static_cast<int>(sv->items.size()) - 1);
            sv->top = 0;
            InvalidateRect(h, nullptr, TRUE);
            return 0;
        case SVM_SETITEMDRAW: {
            SVITEM_DRAWFUNC old = sv->ops.drawItem;
            sv->ops.drawItem = reinterpret_cast<SVITEM_DRAWFUNC>(lp);
            return reinterpret_cast<LRESULT>(old);
        }
        case SVM_SETITEMINIT: {
            SVITEM_INITFUNC old = sv->ops.initItem;
            sv->ops.initItem = reinterpret_cast<SVITEM_INITFUNC>(lp);
            return reinterpret_cast<LRESULT>(old);
        }
        case SVM_SETITEMDESTROY: {
            SVITEM_DESTROYFUNC old = sv->ops.destroyItem;
            sv->ops.destroyItem = reinterpret_cast<SVITEM_DESTROYFUNC>(lp);
            return reinterpret_cast<LRESULT>(old);
        }
        case SVM_SETITEMOPS:
            if (lp != 0) sv->ops = *reinterpret_cast<const SVITEMOPS *>(lp);
            return 0;
        case SVM_SETITEMCMP: {
            SVITEM_CMP old = sv->cmp;
            sv->cmp = reinterpret_cast<SVITEM_CMP>(lp);
            return reinterpret_cast<LRESULT>(old);
        }
        case SVM_SORTITEMS:
            return sv_sort(h, sv, lp);
        case SVM_GETCURSEL:
            return sv->cur;
        case SVM_SETCURSEL:
            if (static_cast<long>(wp) < -1 || static_cast<long>(wp) >= count) return -1;
            sv_set_cur(h, sv, static_cast<int>(wp), false);
            if (lp != 0) sv_show(h, sv, sv->cur);
            return sv->cur;
        case SVM_SELECTITEM: {
            int idx = sv_resolve(sv, wp);
            if (idx < 0) return -1;
            sv->items[static_cast<size_t>(idx)]->selected = lp != 0;
            InvalidateRect(h, nullptr, TRUE);
            return 0;
        }
        case SVM_SHOWITEM:
            sv_show(h, sv, sv_resolve(sv, wp));
            return 0;
        case SVM_CHOOSEITEM: {
            int idx = sv_resolve(sv, wp);
            sv_set_cur(h, sv, idx, false);
            sv_show(h, sv, idx);
            return idx;
        }
        case SVM_GETITEMCOUNT:
            return count;
        case SVM_GETITEMADDDATA: {
            int idx = sv_resolve(sv, wp);
            return idx < 0 ? 0 : static_cast<LRESULT>(sv->items[static_cast<size_t>(idx)]->addData);
        }
        case SVM_SETITEMADDDATA:
            if (static_cast<long>(wp) < 0 || static_cast<long>(wp) >= count) return -1;
            sv->items[wp]->addData = lp;
            return 0;
        case SVM_REFRESHITEM:
            InvalidateRect(h, nullptr, TRUE);
            return 0;
        case SVM_SETITEMHEIGHT:
            if (static_cast<long>(wp) < 0 || static_cast<long>(wp) >= count) return -1;
            sv->items[wp]->height = lp > 0 ? static_cast<int>(lp) : 16;
            InvalidateRect(h, nullptr, TRUE);
            return 0;
        default:
            return sv_geometry(h, sv, msg, lp);
    }
}

LRESULT scrollview_proc(HWND h, UINT msg, WPARAM wp, LPARAM lp) {
    ScrollView *sv = sv_of(h);
    switch (msg) {
        case MSG_CREATE:
            SetWindowAdditionalData2(h, reinterpret_cast<DWORD>(new ScrollView));
            return 0;
        case MSG_DESTROY:
            if (sv != nullptr) {
                while (!sv->items.empty())
                    sv_delete(h, sv, static_cast<int>(sv->items.size()) - 1);
                delete sv;
                SetWindowAdditionalData2(h, 0);
            }
            return 0;
        case MSG_PAINT:
            if (sv != nullptr) sv_paint(h, sv);
            return 0;
        case MSG_KEYDOWN: {
            if (sv == nullptr || sv->items.empty()) return 0;
            int n = static_cast<int>(sv->items.size());
            bool loop = (GetWindowStyle(h) & SVS_LOOP) != 0;
            int idx = sv->cur;
            if (wp == SCANCODE_CURSORBLOCKUP || wp == SCANCODE_CURSORUP) {
                idx = idx <= 0 ? (loop ? n - 1 : 0) : idx - 1;
            } else if (wp == SCANCODE_CURSORBLOCKDOWN || wp == SCANCODE_CURSORDOWN) {
                idx = idx >= n - 1 ? (loop ? 0 : n - 1) : idx + 1;
            } else if (wp == SCANCODE_ENTER || wp == SCANCODE_KEYPADENTER) {
                sv_choose(h, sv, sv->cur);
                return 0;
            } else {
                return 0;
            }
            sv_set_cur(h, sv, idx, true);
            sv_show(h, sv, idx);
            return 0;
        }
        case MSG_LBUTTONDOWN:
            if (sv == nullptr) return 0;
            sv->pressed = sv_hit(sv, HISWORD(lp));
            if (sv->pressed >= 0) sv_set_cur(h, sv, sv->pressed, true);
            return 0;
        case MSG_LBUTTONUP: {
            if (sv == nullptr) return 0;
            int idx = sv_hit(sv, HISWORD(lp));
            RECT rc;
            GetClientRect(h, &rc);
            bool inside = PtInRect(&rc, LOSWORD(lp), HISWORD(lp));
            if (inside && idx >= 0 && idx == sv->pressed) {
                if ((GetWindowStyle(h) & SVS_UPNOTIFY) == 0)
                    NotifyParentEx(h, GetDlgCtrlID(h), SVN_CLICKED,
                                   reinterpret_cast<DWORD>(sv->items[static_cast<size_t>(idx)]));
                sv_choose(h, sv, idx);
            }
            sv->pressed = -1;
            return 0;
        }
        default:
            if (msg >= 0xF300 && msg <= 0xF3FF && sv != nullptr)
                return sv_message(h, sv, msg, wp, lp);
            return DefaultControlProc(h, msg, wp, lp);
    }
}

void add_builtin(const char *name, WNDPROC proc) {
    auto c = std::make_unique<WndClass>();
    c->name = name;
    c->proc = proc;
    g_classes.push_back(std::move(c));
}

}  // namespace

void controls_register() {
    std::lock_guard<std::mutex> lk(g_lock);
    add_builtin(CTRL_STATIC, static_proc);
    add_builtin(CTRL_SCROLLVIEW, scrollview_proc);
}

const WndClass *find_class_locked(const char *name) {
    if (name == nullptr) return nullptr;
    for (auto &c : g_classes)
        if (strcasecmp(c->name.c_str(), name) == 0) return c.get();
    return nullptr;
}

bool control_mouse_transparent(const Window *w) {
    return w->cls != nullptr && w->cls->proc == static_proc && (w->style & SS_NOTIFY) == 0;
}

}  // namespace ftxgui

using namespace ftxgui;

extern "C" {

BOOL RegisterWindowClass(PWNDCLASS wc) {
    if (wc == nullptr || !valid_class_name(wc->spClassName) || wc->WinProc == nullptr) return FALSE;
    std::lock_guard<std::mutex> lk(g_lock);
    if (find_class_locked(wc->spClassName) != nullptr) return FALSE;
    auto c = std::make_unique<WndClass>();
    c->name = wc->spClassName;
    c->proc = wc->WinProc;
    c->style = wc->dwStyle;
    c->exStyle = wc->dwExStyle;
    c->bk = wc->iBkColor;
    c->addData = wc->dwAddData;
    c->parentBk = false;
    g_classes.push_back(std::move(c));
    return TRUE;
}

BOOL UnregisterWindowClass(const char *name) {
    std::lock_guard<std::mutex> lk(g_lock);
    for (auto it = g_classes.begin(); it != g_classes.end(); ++it) {
        if (strcasecmp((*it)->name.c_str(), name != nullptr ? name : "") != 0) continue;
        if (!(*it)->parentBk) {
            // Windows of the class keep a pointer to it: keep the record, just unlist it.
            (*it)->name = "";
            return TRUE;
        }
        return FALSE;
    }
    return FALSE;
}

BOOL GetWindowClassInfo(PWNDCLASS wc) {
    if (wc == nullptr) return FALSE;
    std::lock_guard<std::mutex> lk(g_lock);
    const WndClass *c = find_class_locked(wc->spClassName);
    if (c == nullptr) return FALSE;
    wc->dwStyle = c->style;
    wc->dwExStyle = c->exStyle;
    wc->iBkColor = c->bk;
    wc->WinProc = c->proc;
    wc->dwAddData = c->addData;
    return TRUE;
}

BOOL SetWindowClassInfo(const WNDCLASS *wc) {
    if (wc == nullptr) return FALSE;
    std::lock_guard<std::mutex> lk(g_lock);
    auto *c = const_cast<WndClass *>(find_class_locked(wc->spClassName));
    if (c == nullptr) return FALSE;
    if ((wc->opMask & COP_STYLE) != 0) {
        c->style = wc->dwStyle;
        c->exStyle = wc->dwExStyle;
    }
    if ((wc->opMask & COP_BKCOLOR) != 0) c->bk = wc->iBkColor;
    if ((wc->opMask & COP_WINPROC) != 0 && wc->WinProc != nullptr) c->proc = wc->WinProc;
    if ((wc->opMask & COP_ADDDATA) != 0) c->addData = wc->dwAddData;
    return TRUE;
}

DWORD scrollview_get_item_adddata(HSVITEM hsvi) {
    return hsvi != nullptr ? static_cast<SvItem *>(hsvi)->addData : 0;
}

int scrollview_get_item_index(HWND h, HSVITEM hsvi) {
    ScrollView *sv = sv_of(h);
    return sv != nullptr ? sv_index(sv, reinterpret_cast<WPARAM>(hsvi)) : -1;
}

BOOL scrollview_is_item_hilight(HWND h, HSVITEM hsvi) {
    ScrollView *sv = sv_of(h);
    return sv != nullptr && sv->cur >= 0 && sv->items[static_cast<size_t>(sv->cur)] == hsvi;
}

BOOL scrollview_is_item_selected(HSVITEM hsvi) {
    return hsvi != nullptr && static_cast<SvItem *>(hsvi)->selected;
}

int scrollview_set_item_height(HWND h, HSVITEM hsvi, int height) {
    ScrollView *sv = sv_of(h);
    if (sv == nullptr || hsvi == nullptr) return -1;
    static_cast<SvItem *>(hsvi)->height = height > 0 ? height : 16;
    InvalidateRect(h, nullptr, TRUE);
    return 0;
}

}  // extern "C"

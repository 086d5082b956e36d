// One row of a menu list: highlighted background for the current row, the label centred
// vertically, and a separator line under each row.
#include "mmi_menulist.h"

void mmi_SVDrawItem(HWND hWnd, HSVITEM hsvi, HDC hdc, RECT *rcDraw) {
    const char *label = reinterpret_cast<const char *>(scrollview_get_item_adddata(hsvi));
    bool hilight = scrollview_is_item_hilight(hWnd, hsvi);
    SetBrushColor(hdc, SysPixelIndex[hilight ? 22 : 18]);
    FillBox(hdc, rcDraw->left, rcDraw->top, RECTWP(rcDraw), RECTHP(rcDraw));
    SetPenColor(hdc, SysPixelIndex[20]);
    MoveTo(hdc, rcDraw->left, rcDraw->bottom - 1);
    LineTo(hdc, rcDraw->right, rcDraw->bottom - 1);
    if (!label) return;
    SetBkMode(hdc, BM_TRANSPARENT);
    SetTextColor(hdc, SysPixelIndex[hilight ? 14 : 19]);
    RECT text = *rcDraw;
    text.left += RECTWP(rcDraw) / 20;
    DrawText(hdc, label, -1, &text, DT_SINGLELINE | DT_VCENTER | DT_LEFT | DT_NOPREFIX);
}

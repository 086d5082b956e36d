// One row of a menu list: highlighted background for the current row, the label centred
// vertically, and a separator line under each row.
#include "mmi_menulist.h"

#include "mmi_theme.h"

void mmi_SVDrawItem(HWND hWnd, HSVITEM hsvi, HDC hdc, RECT *rcDraw) {
    const char *label = reinterpret_cast<const char *>(scrollview_get_item_adddata(hsvi));
    bool hilight = scrollview_is_item_hilight(hWnd, hsvi);
    SetBrushColor(hdc, mmi_pixel(hilight ? MMI_COLOUR_HILIGHT : MMI_COLOUR_WINDOW));
    FillBox(hdc, rcDraw->left, rcDraw->top, RECTWP(rcDraw), RECTHP(rcDraw));
    SetPenColor(hdc, mmi_pixel(MMI_COLOUR_FRAME));
    MoveTo(hdc, rcDraw->left, rcDraw->bottom - 1);
    LineTo(hdc, rcDraw->right, rcDraw->bottom - 1);
    if (!label) return;
    SetBkMode(hdc, BM_TRANSPARENT);
    SetTextColor(hdc, mmi_pixel(hilight ? MMI_COLOUR_HILIGHT_TEXT : MMI_COLOUR_TEXT));
    RECT text = *rcDraw;
    text.left += RECTWP(rcDraw) / 20;
    DrawText(hdc, label, -1, &text, DT_SINGLELINE | DT_VCENTER | DT_LEFT | DT_NOPREFIX);
}

// The look every screen shares: the named entries of the system palette and the six fonts.
// Code names a colour here, never by its palette number.
#pragma once

#include "mmi_msg.h"

// Palette entries (indexes of SysPixelIndex) the screens use.
enum mmi_colour {
    MMI_COLOUR_GRAY = 7,           // cursor row, dialog background, a disabled label
    MMI_COLOUR_BLUE = 9,           // the Wi-Fi key while it connects or is down
    MMI_COLOUR_PASS = 10,          // green: a pass, the test windows' top line
    MMI_COLOUR_FAIL = 12,          // red: a fail, a warning on the title strip
    MMI_COLOUR_HILIGHT_TEXT = 14,  // yellow: the chosen menu row's text
    MMI_COLOUR_WHITE = 15,         // a pressed key
    MMI_COLOUR_BAR = 17,           // title strip and soft-key bar background
    MMI_COLOUR_WINDOW = 18,        // window background
    MMI_COLOUR_TEXT = 19,          // ordinary text
    MMI_COLOUR_FRAME = 20,         // separators and frames
    MMI_COLOUR_CONTROL = 21,       // a dialog's button background
    MMI_COLOUR_HILIGHT = 22,       // the chosen row or button
    // The plain colours of the LCD test.
    MMI_COLOUR_DARK_GRAY = 7,
    MMI_COLOUR_PURE_BLUE = 9,
    MMI_COLOUR_PURE_GREEN = 10,
    MMI_COLOUR_PURE_RED = 12,
    MMI_COLOUR_LIGHT_WHITE = 15,
    MMI_COLOUR_BLACK = 16,
};

// The screen pixel of a palette entry.
static inline gal_pixel mmi_pixel(int colour) {
    return SysPixelIndex[colour];
}

// The six fonts (index 1..6); made once by mmi_testwnd_InitLogFont.
extern PLOGFONT g_mmiLogFont[7];
void mmi_testwnd_InitLogFont(void);
// Font sizes for screen width w (index 1..6).
int mmi_logfont_size(int index, int w);

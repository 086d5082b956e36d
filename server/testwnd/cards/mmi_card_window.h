// The window the card and peripheral tests share. A card family checks the SIM slots and the
// SD card its item configures through the library, once a second, a line each (present in
// green, absent in red); a peripheral family waits for the library's report (a device on
// the OTG port, an NFC tag, a finger) on one line. Either passes by itself once every line
// is green, unless the PC opened it, and fails when the item's time-out ("Timeout:N"
// seconds, default 30) runs out; the window shows the seconds left.
#pragma once

#include <atomic>
#include <mutex>

#include "hw/lib_factory.h"
#include "testwnd/cards/mmi_card_report.h"
#include "testwnd/catalogue.h"
#include "testwnd/mmi_testwnd.h"

#define MMI_CARD_SIM_SLOTS 4
#define MMI_CARD_LINES (MMI_CARD_SIM_SLOTS + 1)
#define MMI_CARD_TIMEOUT_DEFAULT 30

enum mmi_card_kind { MMI_CARD_SIM, MMI_CARD_SD, MMI_CARD_EVENT };

// One line of the window (GUI thread).
struct mmi_cardwnd_line {
    int kind = MMI_CARD_SIM;
    int slot = 0;
    // 1 present (or the report passed), 0 not (yet), -1 the library failed, -2 not asked yet
    int present = -2;
    int sizeMb = 0;  // the SD card's size, when the library tells it
};

// Run-time state of one family.
struct mmi_cardwnd_state {
    mmi_ownwnd_state wnd;
    std::mutex lock;  // the library's reports
    mmi_card_report last;
    int passSeen = 0;
    int failsSeen = 0;
    char lastText[64] = {};
    std::atomic<int> running{0};
    std::atomic<int> byPc{0};  // opened by the PC: set before the window exists
    // The GUI thread's.
    mmi_cardwnd_line lines[MMI_CARD_LINES];
    int lineCount = 0;
    int timeout = MMI_CARD_TIMEOUT_DEFAULT;
    int left = MMI_CARD_TIMEOUT_DEFAULT;
    int failsShown = 0;
    char uid[MMI_CARD_UID_SIZE] = {};
    int passOffered = 0;
};

struct mmi_cardwnd_desc {
    const mmi_catalogue_row *row{};  // domain (also the log tag), result item, title key
    const char *caption{};
    const char *noteKey{};        // the operator's instruction above the lines
    int sim{};                    // checks the SIM slots ("SimSlots:N", the first N; default 2)
    int sd{};                     // checks the SD card
    int (*bind)(void) = nullptr;  // per-feature binder; non-zero keeps the window shut
    // A peripheral family: the library's start, given the callback, and its stop; the line's
    // label and the text a failing report shows (the line stays red and the test waits on).
    int (*start)(ftx_api_module_cb cb) = nullptr;
    int (*stop)(void) = nullptr;
    ftx_api_module_cb callback{};
    const char *labelKey{};
    const char *failKey{};
    mmi_cardwnd_state *state{};
    int (*stopEntry)(void) = nullptr;
};

// What the family's callback does with a report (library thread).
void mmi_cardwnd_report(const mmi_cardwnd_desc *d, const module_data *data);

// Opens the window on the GUI thread; HWND_INVALID when the binder fails, no line is
// configured or the window cannot be made.
HWND mmi_cardwnd_open(const mmi_cardwnd_desc *d);
// Closes it from outside (any thread); 1.
int mmi_cardwnd_close(const mmi_cardwnd_desc *d);
// The PC's open: the window, PC-driven (no pass by itself, no time-out); 1, 0 when it failed.
int mmi_cardwnd_pc_open(const mmi_cardwnd_desc *d);
// The PC's close: reply gets "*" and the last report's text ("*none" without one); 1 when
// every line passed, 0 when not, -1 when no window was open.
int mmi_cardwnd_pc_close(const mmi_cardwnd_desc *d, char *reply, unsigned int size);

// One card's presence through the library (command thread or GUI thread): 1 present, 0
// absent, -1 a bad slot or no library; *sizeMb gets the SD card's size when known, else 0.
int mmi_card_check(int kind, int slot, int *sizeMb);

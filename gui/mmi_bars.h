// The soft-key bar (bottom) and the title strip (top, "batteryshow"). Each is a main
// window with its own thread; every window registers its three texts (left, middle,
// right) with a bar and the bar shows the texts of the window last updated. Setters
// return 0 while the bar does not exist, 1 otherwise.
#pragma once

#include "mmi_msg.h"

struct TP_BAR_ITEM {
    const char *text;  // null is the empty text
};

// Soft-key bar.
int tp_skb_create(HWND owner, const RECT *rect);
int svr_create_softkeybar(HWND owner, const RECT *rect, int show);
int tp_skb_set_items(HWND owner, const TP_BAR_ITEM items[3]);
int tp_skb_set_text_items(HWND owner, const char *left, const char *middle, const char *right);
int tp_skb_set_text_col(int colour);
int tp_skb_update(HWND owner);
int tp_skb_show(int show);
int tp_skb_del_items(void);
int tp_skb_destroy(void);
int svr_destroy_softkeybar(void);

// Title strip.
int tp_batteryshow_create(HWND owner, const RECT *rect);
int svr_create_batteryshow(HWND owner, const RECT *rect, int show);
int tp_batteryshow_set_items(HWND owner, const TP_BAR_ITEM items[3]);
int tp_batteryshow_set_items_byIndex(HWND owner, const TP_BAR_ITEM *item, int index);
int tp_batteryshow_set_text_items(HWND owner, const char *left, const char *middle,
                                  const char *right);
int tp_batteryshow_set_text_items_byIndex(HWND owner, const char *text, int index);
int tp_batteryshow_set_text_col(int colour);
int tp_batteryshow_update(HWND owner);
int tp_batteryshow_show(int show);
int tp_batteryshow_destroy(void);

// The bars' windows and controls (0 while a bar does not exist), for tests and tools.
HWND tp_skb_window(void);
HWND tp_skb_control(void);
HWND tp_batteryshow_window(void);
HWND tp_batteryshow_control(void);
// 1 when owner has texts registered with the title strip.
int tp_batteryshow_has_items(HWND owner);
// Number of registry records of a bar (tests).
int tp_skb_record_count(void);
int tp_batteryshow_record_count(void);

// Slot under x for a bar of width w (each slot w/3 wide); -1 beyond the third.
int tp_bar_slot_at(int x, int w);

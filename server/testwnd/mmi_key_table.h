// The key item table the key test and the hook-key test each keep (other tests look up
// their keys by name here), its layout and the
// press and release rules: a key passes on its first clean press and release while no other
// tested key is held.
#pragma once

#include <stddef.h>
#include <stdint.h>

#define MMI_KEY_ITEMS 12
#define MMI_KEY_TEXT_SIZE 256
// Scan code of the headset hook key.
#define MMI_KEY_HOOK 130

struct mmi_key_item {
    uint32_t key;  // scan code of MSG_KEYDOWN / MSG_KEYUP
    char config_name[MMI_KEY_TEXT_SIZE];
    int32_t test_enable;
    char text[MMI_KEY_TEXT_SIZE];  // language key; its translation after a paint
    uint32_t done;
    int64_t left, top, right, bottom;
    uint8_t down, up;
};

// The table's initial contents: every key, disabled, not done, no rectangle.
void mmi_key_table_init(mmi_key_item *t);
// The row whose config_name is a prefix of name, or -1.
int mmi_key_table_find_name(const mmi_key_item *t, const char *name);
// The scan code of the key whose configuration name is a prefix of name; 102 (home) when
// none matches.
uint32_t Get_Keytest_item_key_value(const char *name);
// The first enabled row with this scan code, or -1.
int mmi_key_table_find_enabled(const mmi_key_item *t, uint32_t key);
// True when some row is to be tested.
bool mmi_key_any_enabled(const mmi_key_item *t);
// Full-width stacked rows for the enabled keys, the first at the top of the key list of a
// screen w pixels wide, each rowHeight high; disabled rows keep their rectangles.
void mmi_key_table_layout(mmi_key_item *t, int w, int rowHeight);
// Top of the key list in the window.
int mmi_key_list_top(int w);
// The press and release rules; true when the row changed and wants a repaint. A refusal
// because another tested key is still held logs at error priority under tag.
bool mmi_key_press(mmi_key_item *t, uint32_t key, const char *tag);
bool mmi_key_release(mmi_key_item *t, uint32_t key, const char *tag);
// True when no enabled row is waiting for its key.
bool mmi_key_all_done(const mmi_key_item *t);
// The converted codes of the enabled rows not done, each followed by ','.
void mmi_key_pending_codes(const mmi_key_item *t, char *out, size_t size);

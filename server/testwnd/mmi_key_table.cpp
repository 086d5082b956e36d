// The key item table and the press and release rules.
#include "testwnd/mmi_key_table.h"

#include <stdio.h>
#include <string.h>

#include <android/log.h>
#include <minigui/minigui.h>

#include "tp_os.h"

namespace {

struct InitialRow {
    uint32_t key;
    const char *name;
    const char *text;
};

const InitialRow kRows[MMI_KEY_ITEMS] = {
    {103, "VOLUME_UP", "info_KeyItem0"},
    {108, "VOLUME_DOWN", "info_KeyItem1"},
    {102, "HOME", "info_KeyItem2"},
    {88, "BACK", "info_KeyItem3"},
    {127, "MENU", "info_KeyItem4"},
    {1, "POWER", "info_KeyItem5"},
    {68, "CAMERA", "info_KeyItemCamera"},
    {128, "SEARCH", "info_KeyItemSearch"},
    {MMI_KEY_HOOK, "HOOK", "info_KeyItemHook"},
    {187, "APP_SWITCH", "info_KeyItemRcentAPP"},
    {131, "TORCH", "info_KeyItem6"},
    {377, "TV", "info_keyItemTVText"},
};

// A tested row other than `except` that is held (pressed, not yet released), or -1.
int held_row(const mmi_key_item *t, int except) {
    for (int i = 0; i < MMI_KEY_ITEMS; i++)
        if (i != except && t[i].test_enable && t[i].down != t[i].up) return i;
    return -1;
}

}  // namespace

void mmi_key_table_init(mmi_key_item *t) {
    memset(t, 0, sizeof(mmi_key_item) * MMI_KEY_ITEMS);
    for (int i = 0; i < MMI_KEY_ITEMS; i++) {
        t[i].key = kRows[i].key;
        tp_os_strlcpy(t[i].config_name, kRows[i].name, sizeof(t[i].config_name));
        tp_os_strlcpy(t[i].text, kRows[i].text, sizeof(t[i].text));
    }
}

int mmi_key_table_find_name(const mmi_key_item *t, const char *name) {
    if (name == nullptr) return -1;
    for (int i = 0; i < MMI_KEY_ITEMS; i++)
        if (strncmp(t[i].config_name, name, strlen(t[i].config_name)) == 0) return i;
    return -1;
}

uint32_t Get_Keytest_item_key_value(const char *name) {
    if (name == nullptr) return 102;
    for (const InitialRow &r : kRows)
        if (strncmp(r.name, name, strlen(r.name)) == 0) return r.key;
    return 102;
}

int mmi_key_table_find_enabled(const mmi_key_item *t, uint32_t key) {
    for (int i = 0; i < MMI_KEY_ITEMS; i++)
        if (t[i].test_enable && t[i].key == key) return i;
    return -1;
}

bool mmi_key_any_enabled(const mmi_key_item *t) {
    for (int i = 0; i < MMI_KEY_ITEMS; i++)
        if (t[i].test_enable) return true;
    return false;
}

int mmi_key_list_top(int w) {
    return (w / 15) * 3 + 30;
}

void mmi_key_table_layout(mmi_key_item *t, int w, int rowHeight) {
    int64_t top = mmi_key_list_top(w);
    for (int i = 0; i < MMI_KEY_ITEMS; i++) {
        if (!t[i].test_enable) continue;
        t[i].left = 0;
        t[i].top = top;
        t[i].right = w;
        t[i].bottom = top + rowHeight;
        top = t[i].bottom;
    }
}

bool mmi_key_press(mmi_key_item *t, uint32_t key, const char *tag) {
    const int held = held_row(t, -1);
    if (held >= 0) {
        __android_log_print(ANDROID_LOG_ERROR, tag, "%s,L%d::key %s DownUp status fail.",
                            "CheckKeyisDown", 610, t[held].config_name);
        return false;
    }
    const int i = mmi_key_table_find_enabled(t, key);
    if (i < 0 || t[i].down || t[i].up) return false;
    t[i].down = 1;
    return !t[i].done;
}

bool mmi_key_release(mmi_key_item *t, uint32_t key, const char *tag) {
    const int i = mmi_key_table_find_enabled(t, key);
    const int held = held_row(t, i);
    if (held >= 0) {
        __android_log_print(ANDROID_LOG_ERROR, tag, "%s,L%d::key %s DownUp status fail.",
                            "CheckKeyisUp", 649, t[held].config_name);
        return false;
    }
    if (i < 0 || !t[i].down) return false;
    // A release after the one that counted changes nothing.
    if (t[i].up) return false;
    t[i].up = 1;
    if (t[i].done) return false;
    t[i].done = 1;
    return true;
}

bool mmi_key_all_done(const mmi_key_item *t) {
    for (int i = 0; i < MMI_KEY_ITEMS; i++)
        if (t[i].test_enable && !t[i].done) return false;
    return true;
}

void mmi_key_pending_codes(const mmi_key_item *t, char *out, size_t size) {
    if (size == 0) return;
    out[0] = '\0';
    for (int i = 0; i < MMI_KEY_ITEMS; i++) {
        if (!t[i].test_enable || t[i].done) continue;
        const size_t used = strlen(out);
        snprintf(out + used, size - used, "%d,", scancode_convert_keycode((int)t[i].key));
    }
}

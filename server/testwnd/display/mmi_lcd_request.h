// The fields of the display's PC requests ("NAME,VALUE", "NAME,ACTION,PANEL", "R,G,B") and
// the check of a field that becomes part of a file name or a shell line.
#pragma once

// The comma-separated fields of a PC request (its first 255 bytes; at most three fields,
// each cut to 63 bytes);
// empty fields are skipped, as strtok does.
#define MMI_LCD_FIELD_SIZE 64
struct mmi_lcd_fields {
    char f[3][MMI_LCD_FIELD_SIZE];
    int count;
};
void mmi_lcd_split_fields(const char *parm, int max, mmi_lcd_fields *out);
// True for a field that may become part of a file name or a shell line: letters, digits,
// '_' and '-' (a value may also hold '.'); never empty.
bool mmi_lcd_plain_field(const char *s, bool value);

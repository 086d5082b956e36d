// Fields of the display's PC requests.
#include "testwnd/display/mmi_lcd_request.h"

#include <ctype.h>
#include <string.h>

#include "tp_os.h"

namespace {

const size_t kLineSize = 256;

}  // namespace

void mmi_lcd_split_fields(const char *parm, int max, mmi_lcd_fields *out) {
    memset(out, 0, sizeof(*out));
    if (parm == nullptr) return;
    if (max > 3) max = 3;
    char text[kLineSize] = {0};
    tp_os_strlcpy(text, parm, sizeof(text));
    char *save = nullptr;
    for (char *t = strtok_r(text, ",", &save); t != nullptr && out->count < max;
         t = strtok_r(nullptr, ",", &save)) {
        tp_os_strlcpy(out->f[out->count++], t, MMI_LCD_FIELD_SIZE);
    }
}

bool mmi_lcd_plain_field(const char *s, bool value) {
    if (s == nullptr || *s == '\0') return false;
    for (; *s != '\0'; s++) {
        unsigned char c = (unsigned char)*s;
        if (!isalnum(c) && c != '_' && c != '-' && !(value && c == '.')) return false;
    }
    return true;
}

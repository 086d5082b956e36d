// A PC request of the display commands ("HueMoudle testItem set", "HueRegMoudle ...",
// "GrayLevelMoudle ..."): its fields never overflow, never hold the separator, and a field
// that passes the plain-word check holds nothing a shell or a path could act on.
#include <stddef.h>
#include <stdint.h>
#include <string.h>

#include <string>

#include "testwnd/display/mmi_lcd_request.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t *data, size_t size) {
    if (size == 0) return 0;
    const int max = 1 + data[0] % 3;
    std::string parm(reinterpret_cast<const char *>(data) + 1, size - 1);
    parm = parm.substr(0, parm.find('\0'));
    mmi_lcd_fields x;
    mmi_lcd_split_fields(parm.c_str(), max, &x);
    if (x.count < 0 || x.count > max) __builtin_trap();
    for (int i = 0; i < x.count; i++) {
        const size_t len = strnlen(x.f[i], MMI_LCD_FIELD_SIZE);
        if (len == 0 || len >= MMI_LCD_FIELD_SIZE) __builtin_trap();
        if (strchr(x.f[i], ',') != nullptr) __builtin_trap();
        if (parm.find(x.f[i]) == std::string::npos) __builtin_trap();
        for (bool value : {false, true}) {
            if (!mmi_lcd_plain_field(x.f[i], value)) continue;
            if (strpbrk(x.f[i], "/ ;&|$`<>()\\\"'*?~\n\t") != nullptr) __builtin_trap();
            if (!value && strchr(x.f[i], '.') != nullptr) __builtin_trap();
        }
    }
    for (int i = x.count; i < 3; i++)
        if (x.f[i][0] != '\0') __builtin_trap();
    return 0;
}

// The LCD record and the built-in text domains.
#include <stdio.h>
#include <stdlib.h>
#include <string.h>

#include <cutils/properties.h>

#include "ftx_host.h"
#include "tp_os.h"

extern "C" {
TP_SCREEN_INFO g_ptScreenInfo = {720, 1280, 32};
// Exported by the application; absent in programs that only use the platform.
extern const TP_I18N_DOMAIN language_domains[] __attribute__((weak));
}

extern "C" long tp_man_lcd_get_info_only(void) {
    int w = ftx_device_ini_get_int("screen", "width", 720);
    int h = ftx_device_ini_get_int("screen", "height", 1280);
    long rc = 0;
    const char *env = getenv("FTX_SCREEN");
    if (env != nullptr && *env != '\0') {
        int ew = 0, eh = 0;
        if (sscanf(env, "%dx%d", &ew, &eh) == 2 && ew >= 64 && eh >= 64 && ew <= 8192 &&
            eh <= 8192) {
            w = ew;
            h = eh;
        } else {
            fprintf(stderr, "ftx: FTX_SCREEN=%s is not WxH, using %dx%d\n", env, w, h);
            rc = -1;
        }
    }
    if (w < 64 || h < 64 || w > 8192 || h > 8192) {
        w = 720;
        h = 1280;
        rc = -1;
    }
    g_ptScreenInfo.width = w;
    g_ptScreenInfo.height = h;
    g_ptScreenInfo.bpp = 32;
    return rc;
}

extern "C" const char *tp_i18n_get_text(const char *domain, const char *key) {
    if (key == nullptr) return "";
    const TP_I18N_DOMAIN *domains = language_domains;
    if (domains == nullptr) return key;
    char locale[PROPERTY_VALUE_MAX];
    if (domain == nullptr) {
        property_get("ro.product.locale", locale, "en-US");
        domain = strncmp(locale, "zh", 2) == 0 ? "zh" : "en";
    }
    for (const TP_I18N_DOMAIN *d = domains; d->name != nullptr; d++) {
        if (strcmp(d->name, domain) != 0 || d->texts == nullptr) continue;
        for (const TP_I18N_TEXT *t = d->texts; t->key != nullptr; t++) {
            if (strcmp(t->key, key) == 0) return t->text;
        }
    }
    return key;
}

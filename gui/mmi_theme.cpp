// The six fonts of the screens, sized from the screen width.
#include "mmi_theme.h"

#include "tp_os.h"

PLOGFONT g_mmiLogFont[7];

int mmi_logfont_size(int index, int w) {
    switch (index) {
        case 1:
        case 2:
            return w < 1365 ? w / 15 : 90;
        case 3:
            return w < 1725 ? (int)(((long long)w * 458129845LL) >> 33) & ~3 : 90;
        case 4:
            return w < 2415 ? (int)(((w + (((long long)w * 940802361LL) >> 32)) >> 1) >> 4) & ~3
                            : 90;
        case 5:
            return 250;
        case 6:
            return 25;
        default:
            return 0;
    }
}

void mmi_testwnd_InitLogFont(void) {
    static const char kWeight[7] = {0, 'b', 'r', 'r', 'r', 'm', 'm'};
    int w = g_ptScreenInfo.width;
    for (int i = 1; i <= 6; i++) {
        if (g_mmiLogFont[i]) continue;
        g_mmiLogFont[i] = CreateLogFont("ttf", "song", "GB18030", kWeight[i], 'r', 'n', 'c', 'n',
                                        'n', mmi_logfont_size(i, w), 0);
    }
}

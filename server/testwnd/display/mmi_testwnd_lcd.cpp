// The LCD colour test and the monomer preview's colour screen share one full-screen window
// procedure; each keeps its own state. Work that comes from the PC thread runs on the GUI
// thread.
#include "testwnd/display/mmi_testwnd_lcd.h"

#include <pthread.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>

#include <atomic>
#include <new>

#include <android/log.h>

#include "core/ftx_config.h"
#include "mmi_bars.h"
#include "mmi_guithread.h"
#include "mmi_theme.h"
#include "session/mmi_testitem.h"
#include "testwnd/display/mmi_lcd_request.h"
#include "testwnd/mmi_testwnd.h"
#include "tp_os.h"

#define LCD_DEBUG(tag, ...) __android_log_print(ANDROID_LOG_DEBUG, tag, __VA_ARGS__)
#define LCD_ERROR(tag, ...) __android_log_print(ANDROID_LOG_ERROR, tag, __VA_ARGS__)

namespace {

const char kMonomerTag[] = "FTX_MONOMER_LCD";
// How long each colour stays before a touch may move on.
const unsigned long kFoolProofUs = 1000000;
const unsigned long kCloseSleepUs = 100000;
// A test item's parameter string holds at most this many pairs.
const int kMaxParams = 12;

// One colour screen's state: the LCD test's or the monomer preview's.
struct ColourScreen {
    const mmi_catalogue_row *row;  // domain (the current-test name) and result item
    const char *tag;
    bool preview;  // no fool-proof delay, no confirmation, pictures
    int (*stopEntry)(void);

    uint32_t table[MMI_LCD_MAX_COLOURS] = {};
    std::atomic<int> tableSize{5};
    std::atomic<int> count{0};
    // A new colour was asked for (the window opened, a touch, the PC); any other paint (the
    // screen uncovered) shows the colour that is up again without moving on.
    std::atomic<bool> nextColour{false};
    std::atomic<uint64_t> index{0};
    std::atomic<HWND> hwnd{HWND_INVALID};
    std::atomic<unsigned char> foolProof{0};
    std::atomic<unsigned char> grayLevel{0};
    std::atomic<unsigned char> autoMode{0};
    std::atomic<unsigned char> windowOpen{0};
    std::atomic<unsigned char> pictureMode{0};
    std::atomic<long> grayValue{0};
    std::atomic<int> pictureIndex{0};
    // Each paint's fool-proof thread clears the flag only if no later paint came.
    std::atomic<unsigned> paintGeneration{0};
};

ColourScreen s_lcd{&catalogue::Lcd, catalogue::Lcd.domain, false, mmi_LCDColorTest_Stop_Entry};
ColourScreen s_preview{&catalogue::MonomerLcd, kMonomerTag, true,
                       mmi_Monomer_LCDColorTest_Stop_Entry};

ColourScreen *screen_of(HWND hWnd) {
    return reinterpret_cast<ColourScreen *>(GetWindowAdditionalData(hWnd));
}

struct FoolProofArg {
    ColourScreen *screen;
    unsigned generation;
};

void *WaitForFoolProofLcd(void *arg) {
    FoolProofArg a = *static_cast<FoolProofArg *>(arg);
    delete static_cast<FoolProofArg *>(arg);
    LCD_DEBUG(a.screen->tag, "WaitForFoolProofLcd begin");
    tp_os_usleep(kFoolProofUs);
    if (a.screen->paintGeneration.load() == a.generation) a.screen->foolProof = 0;
    LCD_DEBUG(a.screen->tag, "WaitForFoolProofLcd end");
    return nullptr;
}

void start_fool_proof(ColourScreen *s) {
    s->foolProof = 1;
    FoolProofArg *arg = new (std::nothrow) FoolProofArg{s, ++s->paintGeneration};
    pthread_t t;
    if (arg == nullptr || pthread_create(&t, nullptr, WaitForFoolProofLcd, arg) != 0) {
        // Without the thread the flag would never clear: the colour may be left at once.
        LCD_ERROR(s->tag, "%s: no fool-proof thread", __func__);
        delete arg;
        s->foolProof = 0;
        return;
    }
    pthread_detach(t);
}

// Draws calibration picture `index` stretched over the screen (black when it is missing).
void showPictureByIndex(HDC hdc, int index) {
    char path[MMI_LCD_PICTURE_PATH_SIZE];
    mmi_lcd_picture_path(index, path, sizeof(path));
    BITMAP bmp;
    memset(&bmp, 0, sizeof(bmp));
    if (LoadBitmap(hdc, &bmp, path) != 0) {
        LCD_ERROR(kMonomerTag, "%s: cannot load %s", __func__, path);
        SetBrushColor(hdc, mmi_pixel(MMI_COLOUR_BLACK));
        FillBox(hdc, 0, 0, g_ptScreenInfo.width, g_ptScreenInfo.height);
        return;
    }
    LCD_DEBUG(kMonomerTag, "%s %s", __func__, path);
    FillBoxWithBitmap(hdc, 0, 0, g_ptScreenInfo.width, g_ptScreenInfo.height, &bmp);
    UnloadBitmap(&bmp);
}

void paint(HWND hWnd, ColourScreen *s) {
    LCD_DEBUG(s->tag, "%s MSG_PAINT begin", __func__);
    HDC hdc = BeginPaint(hWnd);
    LCD_DEBUG(s->tag, "%s MSG_PAINT hdc=%x", __func__, (unsigned)(uintptr_t)hdc);
    // The colour at the index moves on only when a new colour was asked for; a picture
    // never moves it.
    const bool picture = s->preview && s->pictureMode;
    const bool next = !picture && s->nextColour.exchange(false);
    if (picture) {
        showPictureByIndex(hdc, s->pictureIndex.load());
    } else {
        uint64_t i = s->index.load();
        if (!next && i > 0) i--;
        const int last = s->tableSize.load() - 1;
        SetBrushColor(hdc, s->table[i > (uint64_t)last ? last : i]);
        FillBox(hdc, 0, 0, g_ptScreenInfo.width, g_ptScreenInfo.height);
    }
    EndPaint(hWnd, hdc);
    if (next && !s->preview) start_fool_proof(s);
    LCD_DEBUG(s->tag, "%s MSG_PAINT end", __func__);
    if (next) s->index++;
}

// Asks for the colour at the index.
void paint_next(HWND hWnd, ColourScreen *s) {
    s->nextColour = true;
    UpdateWindow(hWnd, TRUE);
}

// The touch was released: the next colour, or the end of the colours.
void touched(HWND hWnd, ColourScreen *s) {
    if (s->foolProof || s->grayLevel || (s->preview && s->pictureMode)) {
        LCD_DEBUG(s->tag, "%s touch ignored", __func__);
        return;
    }
    if ((int)s->index.load() < s->count.load()) {
        paint_next(hWnd, s);
        return;
    }
    SendMessage(hWnd, MSG_CLOSE, 0, 0);
    if (s->preview) {
        mmi_run_pass(MMI_RUN_MONOMER, s->row->resultIndex, s->row->domain);
    } else {
        mmi_LCDColorTestCheckResultEntry();
    }
}

LRESULT colour_proc(HWND hWnd, UINT message, WPARAM wParam, LPARAM lParam) {
    ColourScreen *s = screen_of(hWnd);
    switch (message) {
        case MSG_CREATE:
            s = reinterpret_cast<ColourScreen *>(
                reinterpret_cast<PMAINWINCREATE>(lParam)->dwAddData);
            mmi_set_current_test(s->row->domain);
            if (!s->autoMode) s->index = 0;
            s->nextColour = true;
            tp_skb_show(0);
            break;
        case MSG_PAINT:
            paint(hWnd, s);
            return 0;
        case MSG_LBUTTONUP:
            touched(hWnd, s);
            return 0;
        case MSG_CLOSE:
            mmi_set_current_test("");
            s->windowOpen = 0;
            s->autoMode = 0;
            s->index = 0;
            // However the window closed, the next one takes touches and shows colours.
            s->grayLevel = 0;
            s->pictureMode = 0;
            s->paintGeneration++;
            s->foolProof = 0;
            mmi_testwnd_unregister(hWnd);
            s->hwnd = HWND_INVALID;
            // The window that hid the soft-key bar gives it back to whatever comes next.
            tp_skb_show(1);
            DestroyAllControls(hWnd);
            DestroyMainWindow(hWnd);
            return 0;
        default:
            break;
    }
    return DefaultMainWinProc(hWnd, message, wParam, lParam);
}

// The full-screen window of a colour screen, shown; HWND_INVALID on failure.
HWND create_colour_window(ColourScreen *s) {
    LCD_DEBUG(s->tag, "%s begin", __func__);
    // Over the title strip too: the colour fills the whole panel.
    HWND hWnd = mmi_testwnd_create_full("", colour_proc, reinterpret_cast<DWORD>(s));
    if (hWnd == HWND_INVALID) return hWnd;
    s->hwnd = hWnd;
    mmi_testwnd_register_open(hWnd, s->stopEntry);
    LCD_DEBUG(s->tag, "%s end", __func__);
    return hWnd;
}

void fill_preview_table(void) {
    const int n = mmi_lcd_monomer_table(s_preview.table);
    s_preview.count = n;
    s_preview.tableSize = n;
}

// On the GUI thread: opens the screen, or repaints it when the PC opened it already.
int open_or_repaint(void *arg) {
    ColourScreen *s = static_cast<ColourScreen *>(arg);
    HWND open = s->hwnd.load();
    if (s->windowOpen && open != HWND_INVALID) {
        paint_next(open, s);
        return 1;
    }
    s->windowOpen = 1;
    if (s->preview) {
        fill_preview_table();
    } else {
        mmi_LCDColorTest_Init();
    }
    if (create_colour_window(s) == HWND_INVALID) s->windowOpen = 0;
    return 1;
}

int close_screen(void *arg) {
    HWND hWnd = static_cast<ColourScreen *>(arg)->hwnd.load();
    if (hWnd != HWND_INVALID) SendMessage(hWnd, MSG_CLOSE, 0, 0);
    return 1;
}

int stop_screen(ColourScreen *s) {
    mmi_RunOnGuiThread(close_screen, s);
    tp_os_usleep(kCloseSleepUs);
    return 1;
}

// The PC's open: every other test window closes first (never this one: it is repainted).
int pc_open(ColourScreen *s) {
    mmi_testwnd_close_others(s->hwnd.load());
    return mmi_RunOnGuiThread(open_or_repaint, s);
}

// ---- the confirmation window ----

mmi_testwnd_state s_checkState;

int close_check(void);

const mmi_testwnd_desc kCheck = {
    .row = &catalogue::Lcd,
    .caption = "LCD Color Test",
    .titleKey = "title_LCDTest",
    .noteKey = "info_LCDNote",
    .state = &s_checkState,
    .stopEntry = close_check,
};

int close_check(void) {
    return mmi_testwnd_close(&kCheck);
}

}  // namespace

// ---- tables ----

int mmi_lcd_colour_table(const char *colornum, int itemMmi, uint32_t *out, int *size) {
    const int n = colornum != nullptr ? atoi(colornum) : 5;
    int filled = MMI_LCD_MAX_COLOURS;
    if (n == MMI_LCD_MAX_COLOURS) {
        const int six[] = {MMI_COLOUR_LIGHT_WHITE, MMI_COLOUR_DARK_GRAY, MMI_COLOUR_PURE_RED,
                           MMI_COLOUR_PURE_GREEN,  MMI_COLOUR_PURE_BLUE, MMI_COLOUR_BLACK};
        for (int i = 0; i < MMI_LCD_MAX_COLOURS; i++)
            out[i] = mmi_pixel(six[i]);
    } else {
        filled = mmi_lcd_monomer_table(out);
    }
    if (size != nullptr) *size = filled;
    // Never more colours than the table holds, and at least one.
    const int count = n < 1 ? 1 : (n > filled ? filled : n);
    return itemMmi == 2 ? 1 : count;
}

int mmi_lcd_monomer_table(uint32_t *out) {
    // The first white is one step below full white: kept as the handset has it.
    out[0] = mmi_pixel(MMI_COLOUR_LIGHT_WHITE) - 1;
    out[1] = mmi_pixel(MMI_COLOUR_PURE_RED);
    out[2] = mmi_pixel(MMI_COLOUR_PURE_GREEN);
    out[3] = mmi_pixel(MMI_COLOUR_PURE_BLUE);
    out[4] = mmi_pixel(MMI_COLOUR_BLACK);
    return 5;
}

void mmi_lcd_picture_path(int index, char *out, size_t size) {
    if (index <= 9) {
        snprintf(out, size, "/vendor/etc/data/ratio_25_000%d.png", index);
    } else {
        snprintf(out, size, "/vendor/etc/data/ratio_25_00%d.png", index);
    }
}

long mmi_lcd_pack_gray(int r, int g, int b) {
    return (long)((r & 0xffff) | ((g << 8) & 0xffff) | ((long)b << 16));
}

// ---- operator-driven ----

int mmi_LCDColorTest_Init(void) {
    char colornum[FTX_CFG_TEXT_SIZE] = {0};
    ftx_config_para paras[kMaxParams];
    const int n = mmi_testwnd_params(catalogue::Lcd.domain, paras, kMaxParams);
    ftx_config_get_para_value(paras, n, "colornum", colornum, sizeof(colornum), "5");
    const testitem *row = mmi_testitem_main_row(catalogue::Lcd.domain);
    const int itemMmi = row != nullptr ? row->item_mmi : 0;
    LCD_DEBUG(s_lcd.tag, "%s::LcdColorTestNum=%d", __func__, atoi(colornum));
    int size = 0;
    s_lcd.count = mmi_lcd_colour_table(colornum, itemMmi, s_lcd.table, &size);
    s_lcd.tableSize = size;
    return 0;
}

void *mmi_CreateLcdColorTestWnd(void) {
    return create_colour_window(&s_lcd);
}

void *mmi_LCDColorTestEntry(void) {
    s_lcd.index = 0;
    mmi_LCDColorTest_Init();
    return mmi_CreateLcdColorTestWnd();
}

int mmi_LCDColorTest_Stop_Entry(void) {
    return stop_screen(&s_lcd);
}

void *mmi_LCDColorTestCheckResultEntry(void) {
    LCD_DEBUG(s_lcd.tag, "%s", __func__);
    return mmi_testwnd_open(&kCheck, 0);
}

// ---- PC-driven ----

int mmi_AutoTest_LCDColorTestEntry(int index) {
    s_lcd.autoMode = 1;
    s_lcd.index = (uint64_t)(index < 0 ? 0 : index);
    LCD_DEBUG(s_lcd.tag, "%s::g_LcdColorTestIndex=%d", __func__, index);
    return pc_open(&s_lcd);
}

int mmi_AutoTest_LCDColorTest_Stop_Entry(void) {
    return stop_screen(&s_lcd);
}

int mmi_AutoTest_GrayLevel_Set(const char *parm, int, char *, unsigned int) {
    LCD_DEBUG(s_lcd.tag, "%s begin", __func__);
    if (!s_lcd.windowOpen) mmi_testwnd_close_others(s_lcd.hwnd.load());
    s_lcd.autoMode = 1;
    if (parm != nullptr && strcmp(parm, "close") == 0) {
        s_lcd.grayLevel = 0;
        mmi_RunOnGuiThread(close_screen, &s_lcd);
        return 1;
    }
    mmi_lcd_fields x;
    mmi_lcd_split_fields(parm, 3, &x);
    if (x.count < 1) return 0;
    const int r = atoi(x.f[0]), g = atoi(x.f[1]), b = atoi(x.f[2]);
    LCD_DEBUG(s_lcd.tag, "%s RGB value: %d %d %d", __func__, r, g, b);
    s_lcd.grayLevel = 1;
    s_lcd.grayValue = mmi_lcd_pack_gray(r, g, b);
    LCD_DEBUG(s_lcd.tag, "RGB int value: %ld", s_lcd.grayValue.load());
    mmi_RunOnGuiThread(open_or_repaint, &s_lcd);
    LCD_DEBUG(s_lcd.tag, "%s end", __func__);
    return 1;
}

// ---- monomer preview ----

void *mmi_Monomer_LCDColorTestEntry(void) {
    s_preview.index = 0;
    fill_preview_table();
    return create_colour_window(&s_preview);
}

int mmi_Monomer_LCDColorTest_Stop_Entry(void) {
    return stop_screen(&s_preview);
}

int mmi_AutoTest_PW_ShowPicture(int index) {
    mmi_testwnd_close_others(s_preview.hwnd.load());
    s_preview.pictureMode = 1;
    s_preview.autoMode = 1;
    s_preview.pictureIndex = index;
    LCD_DEBUG(kMonomerTag, "%s::g_LcdColorTestIndex=%d", __func__, index);
    return mmi_RunOnGuiThread(open_or_repaint, &s_preview);
}

int mmi_AutoTest_PW_ShowPicture_Close(void) {
    s_preview.pictureMode = 0;
    return stop_screen(&s_preview);
}

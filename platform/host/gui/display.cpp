// The framebuffer, the system colours, start-up, and the display backends: "headless"
// keeps the picture in memory only; "sdl" shows it in a desktop window scaled to fit, with
// the PC keyboard as the handset's keys and the mouse as the finger. The backlight and
// blank files of the device root dim what is shown and what a screenshot records; the
// notification LED's dot is drawn over both.
#include <SDL2/SDL.h>
#include <png.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <unistd.h>

#include <algorithm>
#include <chrono>
#include <thread>

#include <android/log.h>

#include "devfs.h"
#include "ftx_host.h"
#include "gui_internal.h"
#include "minigui/ftx_gui.h"
#include "tp_os.h"

namespace ftxgui {

std::mutex g_fbLock;
Uint32 *g_fb = nullptr;
int g_fbW = 0, g_fbH = 0;
std::atomic<unsigned> g_fbSerial{0};

namespace {

const char *kTag = "FTX_GUI";
std::once_flag g_initOnce;
std::atomic<bool> g_sdl{false};
// The notification LED's dot: kIndicatorOn with its colour in the low 24 bits, or 0.
const unsigned kIndicatorOn = 1u << 24;
std::atomic<unsigned> g_indicator{0};

// A filled dot at the right end of the title strip (the strip is width/15 + 10 high).
void draw_indicator(std::vector<Uint32> &out) {
    const unsigned ind = g_indicator.load();
    if ((ind & kIndicatorOn) == 0) return;
    const int r = std::max(3, g_fbW / 60);
    const int cx = g_fbW - g_fbW / 20, cy = (g_fbW / 15 + 10) / 2;
    for (int y = std::max(0, cy - r); y <= cy + r && y < g_fbH; y++)
        for (int x = std::max(0, cx - r); x <= cx + r && x < g_fbW; x++)
            if ((x - cx) * (x - cx) + (y - cy) * (y - cy) <= r * r)
                out[static_cast<size_t>(y) * g_fbW + x] = ind & 0xFFFFFFu;
}

int read_int_file(const char *devicePath, int fallback) {
    FILE *f = dev_fopen(devicePath, "r");
    if (f == nullptr) return fallback;
    int v = fallback;
    if (fscanf(f, "%d", &v) != 1) v = fallback;
    fclose(f);
    return v;
}

// PC keys for the handset's keys.
struct KeyBinding {
    SDL_Scancode pc;
    int handset;
};
const KeyBinding kKeyMap[] = {
    {SDL_SCANCODE_F2, SCANCODE_F2},
    {SDL_SCANCODE_LCTRL, SCANCODE_F2},
    {SDL_SCANCODE_F3, SCANCODE_F3},
    {SDL_SCANCODE_RCTRL, SCANCODE_F3},
    {SDL_SCANCODE_F4, SCANCODE_F4},
    {SDL_SCANCODE_SPACE, SCANCODE_F4},
    {SDL_SCANCODE_UP, SCANCODE_CURSORBLOCKUP},
    {SDL_SCANCODE_DOWN, SCANCODE_CURSORBLOCKDOWN},
    {SDL_SCANCODE_RETURN, SCANCODE_ENTER},
    {SDL_SCANCODE_KP_ENTER, SCANCODE_ENTER},
    {SDL_SCANCODE_HOME, SCANCODE_HOME},
    {SDL_SCANCODE_BACKSPACE, SCANCODE_F12},
    {SDL_SCANCODE_MENU, SCANCODE_MENU},
    {SDL_SCANCODE_APPLICATION, SCANCODE_MENU},
    {SDL_SCANCODE_F5, SCANCODE_MENU},
    {SDL_SCANCODE_ESCAPE, SCANCODE_ESCAPE},
    {SDL_SCANCODE_P, SCANCODE_ESCAPE},
};

int handset_key(SDL_Scancode sc) {
    for (const KeyBinding &k : kKeyMap)
        if (k.pc == sc) return k.handset;
    return -1;
}

void sdl_event(const SDL_Event &e) {
    switch (e.type) {
        case SDL_QUIT:
            __android_log_print(ANDROID_LOG_INFO, kTag, "display window closed");
            fflush(nullptr);
            _exit(0);
        case SDL_KEYDOWN:
        case SDL_KEYUP: {
            if (e.key.repeat != 0) break;
            int code = handset_key(e.key.keysym.scancode);
            if (code >= 0)
                ftx_gui_inject(e.type == SDL_KEYDOWN ? FTX_INPUT_KEYDOWN : FTX_INPUT_KEYUP, code,
                               0);
            break;
        }
        case SDL_MOUSEBUTTONDOWN:
        case SDL_MOUSEBUTTONUP:
            if (e.button.button == SDL_BUTTON_LEFT)
                ftx_gui_inject(
                    e.type == SDL_MOUSEBUTTONDOWN ? FTX_INPUT_TOUCHDOWN : FTX_INPUT_TOUCHUP,
                    std::clamp(e.button.x, 0, g_fbW - 1), std::clamp(e.button.y, 0, g_fbH - 1));
            break;
        case SDL_MOUSEMOTION:
            if ((e.motion.state & SDL_BUTTON_LMASK) != 0)
                ftx_gui_inject(FTX_INPUT_TOUCHMOVE, std::clamp(e.motion.x, 0, g_fbW - 1),
                               std::clamp(e.motion.y, 0, g_fbH - 1));
            break;
        default:
            break;
    }
}

void sdl_loop(SDL_Window *win, SDL_Renderer *ren, SDL_Texture *tex) {
    std::vector<Uint32> frame;
    unsigned shownSerial = ~0u;
    auto lastDim = std::chrono::steady_clock::now() - std::chrono::seconds(1);
    int shownDim = -1;
    for (;;) {
        SDL_Event e;
        if (SDL_WaitEventTimeout(&e, 30) != 0) {
            sdl_event(e);
            while (SDL_PollEvent(&e) != 0)
                sdl_event(e);
        }
        auto now = std::chrono::steady_clock::now();
        bool dimCheck = now - lastDim > std::chrono::milliseconds(250);
        int dimKey = shownDim;
        if (dimCheck) {
            int blank, bright;
            display_dim_state(&blank, &bright);
            dimKey = blank * 1000 + bright;
            lastDim = now;
        }
        unsigned serial = g_fbSerial.load();
        if (serial == shownSerial && dimKey == shownDim) continue;
        shownSerial = serial;
        shownDim = dimKey;
        present_copy(frame);
        SDL_UpdateTexture(tex, nullptr, frame.data(), g_fbW * 4);
        SDL_RenderClear(ren);
        SDL_RenderCopy(ren, tex, nullptr, nullptr);
        SDL_RenderPresent(ren);
    }
    (void)win;
}

void sdl_thread(std::atomic<int> *ready) {
    if (SDL_Init(SDL_INIT_VIDEO) != 0) {
        __android_log_print(ANDROID_LOG_WARN, kTag, "SDL unavailable (%s): headless display",
                            SDL_GetError());
        ready->store(-1);
        return;
    }
    double scale = 1.0;
    SDL_Rect usable;
    if (SDL_GetDisplayUsableBounds(0, &usable) == 0 && usable.w > 0 && usable.h > 0) {
        scale = std::min({1.0, 0.92 * usable.w / g_fbW, 0.92 * usable.h / g_fbH});
    }
    SDL_Window *win = SDL_CreateWindow("ftx handset", SDL_WINDOWPOS_CENTERED,
                                       SDL_WINDOWPOS_CENTERED, static_cast<int>(g_fbW * scale),
                                       static_cast<int>(g_fbH * scale), SDL_WINDOW_RESIZABLE);
    SDL_Renderer *ren = win != nullptr ? SDL_CreateRenderer(win, -1, 0) : nullptr;
    SDL_Texture *tex = ren != nullptr ? SDL_CreateTexture(ren, SDL_PIXELFORMAT_RGB888,
                                                          SDL_TEXTUREACCESS_STREAMING, g_fbW, g_fbH)
                                      : nullptr;
    if (tex == nullptr) {
        __android_log_print(ANDROID_LOG_WARN, kTag, "SDL window failed (%s): headless display",
                            SDL_GetError());
        ready->store(-1);
        return;
    }
    SDL_SetHint(SDL_HINT_RENDER_SCALE_QUALITY, "linear");
    SDL_RenderSetLogicalSize(ren, g_fbW, g_fbH);
    g_sdl = true;
    ready->store(1);
    sdl_loop(win, ren, tex);
}

void start_backend() {
    const char *want = getenv("FTX_DISPLAY");
    bool sdl;
    if (want != nullptr && *want != '\0') {
        sdl = strcmp(want, "sdl") == 0;
    } else {
        const char *x = getenv("DISPLAY"), *wl = getenv("WAYLAND_DISPLAY");
        sdl = (x != nullptr && *x != '\0') || (wl != nullptr && *wl != '\0');
    }
    if (!sdl) return;
    std::atomic<int> ready{0};
    std::thread(sdl_thread, &ready).detach();
    while (ready.load() == 0)
        std::this_thread::sleep_for(std::chrono::milliseconds(5));
}

void init_once() {
    tp_man_lcd_get_info_only();
    g_fbW = g_ptScreenInfo.width;
    g_fbH = g_ptScreenInfo.height;
    g_fb = static_cast<Uint32 *>(calloc(static_cast<size_t>(g_fbW) * g_fbH, sizeof(Uint32)));
    if (g_fb == nullptr) {
        __android_log_print(ANDROID_LOG_FATAL, kTag, "no memory for a %dx%d framebuffer", g_fbW,
                            g_fbH);
        abort();
    }
    g_rcScr = RECT{0, 0, g_fbW, g_fbH};
    for (int i = 0; i < FTX_NR_SYSPIXEL; i++)
        SysPixelIndex[i] = rgb_pixel(SysPixelColor[i].r, SysPixelColor[i].g, SysPixelColor[i].b);
    fonts_init(g_fbW);
    controls_register();
    timers_start();
    start_backend();
    __android_log_print(ANDROID_LOG_INFO, kTag, "screen %dx%d, display %s", g_fbW, g_fbH,
                        ftx_gui_backend());
    console_autostart();
}

}  // namespace

void display_dim_state(int *blank, int *brightness) {
    *blank = read_int_file("/sys/class/graphics/fb0/blank", 0);
    *brightness = read_int_file("/sys/class/leds/lcd-backlight/brightness", 255);
}

void present_copy(std::vector<Uint32> &out) {
    int blank, bright;
    display_dim_state(&blank, &bright);
    std::lock_guard<std::mutex> fb(g_fbLock);
    size_t n = static_cast<size_t>(g_fbW) * g_fbH;
    out.resize(n);
    // A powered-down panel (blank 4) or a backlight at 0 shows black.
    if (blank == 4 || bright <= 0)
        std::fill(out.begin(), out.end(), 0);
    else
        memcpy(out.data(), g_fb, n * sizeof(Uint32));
    draw_indicator(out);
}

int write_png(const char *path, int width, int height, const Uint32 *pixels) {
    const size_t n = static_cast<size_t>(width) * static_cast<size_t>(height);
    std::vector<png_byte> rgb(n * 3);
    for (size_t i = 0; i < n; i++) {
        rgb[i * 3] = static_cast<png_byte>(pixels[i] >> 16);
        rgb[i * 3 + 1] = static_cast<png_byte>(pixels[i] >> 8);
        rgb[i * 3 + 2] = static_cast<png_byte>(pixels[i]);
    }
    png_image img;
    memset(&img, 0, sizeof(img));
    img.version = PNG_IMAGE_VERSION;
    img.width = static_cast<png_uint_32>(width);
    img.height = static_cast<png_uint_32>(height);
    img.format = PNG_FORMAT_RGB;
    if (png_image_write_to_file(&img, path, 0, rgb.data(), 0, nullptr) == 0) {
        __android_log_print(ANDROID_LOG_ERROR, kTag, "screenshot %s: %s", path, img.message);
        return -1;
    }
    return 0;
}

ftxhost::AuxFrame aux_frame() {
    ftxhost::AuxFrame f;
    char path[4096];
    if (dev_path(ftxhost::kAuxFbDevicePath, path, sizeof(path)) == 0 &&
        ftxhost::aux_fb_read(path, &f) == 0)
        return f;
    int w = ftx_device_ini_get_int("aux_screen", "width", ftxhost::kAuxFbDefaultWidth);
    int h = ftx_device_ini_get_int("aux_screen", "height", ftxhost::kAuxFbDefaultHeight);
    if (w <= 0 || w > ftxhost::kAuxFbMaxSide) w = ftxhost::kAuxFbDefaultWidth;
    if (h <= 0 || h > ftxhost::kAuxFbMaxSide) h = ftxhost::kAuxFbDefaultHeight;
    return ftxhost::aux_fb_plain(w, h, false, 0);
}

int aux_screenshot(const char *path) {
    if (path == nullptr) return -1;
    const ftxhost::AuxFrame f = aux_frame();
    return write_png(path, f.width, f.height, f.pixels.data());
}

}  // namespace ftxgui

using namespace ftxgui;

extern "C" {

RECT g_rcScr = {0, 0, 0, 0};

const RGB SysPixelColor[FTX_NR_SYSPIXEL] = {
    {0x00, 0x00, 0x00, 0x00},
    {0x00, 0x00, 0x80, 0xFF},
    {0x00, 0x80, 0x00, 0xFF},
    {0x00, 0x80, 0x80, 0xFF},
    {0x80, 0x00, 0x00, 0xFF},
    {0x80, 0x00, 0x80, 0xFF},
    {0x80, 0x80, 0x00, 0xFF},
    {0x80, 0x80, 0x80, 0xFF},
    {0xC0, 0xC0, 0xC0, 0xFF},
    {0x00, 0x00, 0xFF, 0xFF},
    {0x00, 0xFF, 0x00, 0xFF},
    {0x00, 0xFF, 0xFF, 0xFF},
    {0xFF, 0x00, 0x00, 0xFF},
    {0xFF, 0x00, 0xFF, 0xFF},
    {0xFF, 0xFF, 0x00, 0xFF},
    {0xFF, 0xFF, 0xFF, 0xFF},
    {0x00, 0x00, 0x00, 0xFF},
    // The handset's dark theme: bar background, window background, text, frame, dialog
    // control background, highlight.
    {0x1C, 0x22, 0x2B, 0xFF},
    {0x10, 0x14, 0x1A, 0xFF},
    {0xE6, 0xEA, 0xEE, 0xFF},
    {0x4A, 0x55, 0x63, 0xFF},
    {0x28, 0x30, 0x3B, 0xFF},
    {0x1F, 0x5F, 0xA8, 0xFF},
};
gal_pixel SysPixelIndex[FTX_NR_SYSPIXEL];

int InitGUI(int, const char **) {
    std::call_once(g_initOnce, init_once);
    return 0;
}

void TerminateGUI(int) {
    ftx_console_stop();
    fflush(nullptr);
}

const Uint32 *ftx_gui_framebuffer(int *width, int *height) {
    if (width != nullptr) *width = g_fbW;
    if (height != nullptr) *height = g_fbH;
    return g_fb;
}

void ftx_gui_lock_framebuffer(void) {
    g_fbLock.lock();
}
void ftx_gui_unlock_framebuffer(void) {
    g_fbLock.unlock();
}

void ftx_host_set_indicator(int on, unsigned int rgb) {
    g_indicator.store(on != 0 ? kIndicatorOn | (rgb & 0xFFFFFFu) : 0);
    g_fbSerial++;  // the window shows it at its next look
}

const char *ftx_gui_backend(void) {
    return g_sdl ? "sdl" : "headless";
}

int ftx_gui_screenshot(const char *path) {
    if (path == nullptr || g_fb == nullptr) return -1;
    std::vector<Uint32> frame;
    present_copy(frame);
    return write_png(path, g_fbW, g_fbH, frame.data());
}

}  // extern "C"

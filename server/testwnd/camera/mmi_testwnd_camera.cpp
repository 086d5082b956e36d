// The camera window. The camera starts as the window is made; a GUI timer fetches the
// library's preview frame and blits it into the preview box. The pass label and key come
// once a frame was shown; a camera that does not start shows why in red, offers only fail
// and fails by itself after kFailDelay (unless the PC opened it). The middle key (or OK)
// saves a snapshot through the library. The window's drawing state is the GUI thread's.
#include "testwnd/camera/mmi_testwnd_camera.h"

#include <errno.h>
#include <stdio.h>
#include <string.h>
#include <sys/stat.h>

#include <atomic>
#include <vector>

#include <android/log.h>

#include "devfs.h"
#include "mmi_guithread.h"
#include "mmi_theme.h"
#include "testwnd/mmi_testwnd.h"
#include "tp_os.h"

#define CAM_DEBUG(c, ...) __android_log_print(ANDROID_LOG_DEBUG, (c).row->domain, __VA_ARGS__)
#define CAM_ERROR(c, ...) __android_log_print(ANDROID_LOG_ERROR, (c).row->domain, __VA_ARGS__)

namespace {

const char kPictureDir[] = "/data/ftx_camera";
const int kPreviewTimer = 131;
const int kPreviewPeriod = 15;  // 10 ms units: about 7 frames a second
const int kFailTimer = 132;
const int kFailDelay = 300;  // 10 ms units
const int kPathSize = 128;

// What each camera's window and the PC share.
struct CameraState {
    mmi_ownwnd_state wnd;
    std::atomic<int> started{0};  // the library started the camera for the open window
    std::atomic<int> byPc{0};     // the PC opened the window: no fail by itself
    std::atomic<unsigned> shots{0};
};

struct Camera {
    const mmi_catalogue_row *row;  // domain (also the log tag), result item, title key
    int id;                        // FTX_CAMERA_...
    const char *caption;
    const char *fileName;  // the pictures' name: /data/ftx_camera/<fileName>_<n>.png
    int (*stopEntry)(void);
    void *(*open)(void);  // opens the window on the GUI thread, by-PC flag untouched
    CameraState *state;
};

CameraState s_states[3];
template <int K>
void *open_camera(void);

const Camera kCameras[] = {
    {&catalogue::CameraBack, FTX_CAMERA_BACK, "Rear Camera Test", "back",
     mmi_AutoTest_CameraBackTest_Stop_Entry, open_camera<0>, &s_states[0]},
    {&catalogue::AuxCameraBack, FTX_CAMERA_AUX_BACK, "Rear Camera 2 Test", "auxback",
     mmi_AutoTest_CameraAuxBackTest_Stop_Entry, open_camera<1>, &s_states[1]},
    {&catalogue::CameraFront, FTX_CAMERA_FRONT, "Front Camera Test", "front",
     mmi_AutoTest_CameraFrontTest_Stop_Entry, open_camera<2>, &s_states[2]},
};
enum { BACK, AUX_BACK, FRONT };

// The open window's drawing state (one camera window at a time); GUI thread only.
struct Screen {
    mmi_camera_layout layout;
    std::vector<unsigned> frame;
    BITMAP bitmap;
    bool previewBound;  // the library gives preview frames
    bool frameOk;       // the last fetch gave a frame
    bool running;       // the preview runs: the operator may judge it
    bool passOffered;
    const char *errorKey;  // red text in the preview box, or null
    char status[MMI_TESTWND_TEXT_SIZE];
    bool statusOk;
};
Screen s;

void soft_keys(HWND hWnd, const Camera &c) {
    char pass[MMI_TESTWND_TEXT_SIZE], shot[MMI_TESTWND_TEXT_SIZE], fail[MMI_TESTWND_TEXT_SIZE];
    mmi_translate("Result_pass", pass, sizeof pass);
    mmi_translate("info_CameraSnapshot", shot, sizeof shot);
    mmi_translate("Result_fail", fail, sizeof fail);
    mmi_testwnd_set_bars(hWnd, c.row->titleKey, s.passOffered ? pass : "",
                         c.state->started.load() ? shot : "", fail);
}

void offer_pass(HWND hWnd, const Camera &c, bool offer) {
    if (offer == s.passOffered) return;
    s.passOffered = offer;
    CAM_DEBUG(c, "%s::%s", __func__, offer ? "preview running, pass offered" : "pass withdrawn");
    if (c.state->wnd.activated.load()) soft_keys(hWnd, c);  // else its activation shows them
}

// Asks the library for the current frame; the pass follows whether one came.
void fetch_frame(HWND hWnd, const Camera &c) {
    const auto get =
        static_cast<decltype(&ftx_api_camera_get_preview)>(hw::ftx_api_camera_get_preview);
    const int w = RECTW(s.layout.preview), h = RECTH(s.layout.preview);
    const bool ok = get != nullptr && !s.frame.empty() && get(c.id, s.frame.data(), w, h) == 0;
    if (ok != s.frameOk) CAM_DEBUG(c, "%s::%s", __func__, ok ? "frames arrive" : "no frame");
    s.frameOk = ok;
    s.running = ok;
    offer_pass(hWnd, c, ok);
}

void stop_camera(const Camera &c) {
    if (!c.state->started.exchange(0)) return;
    const int rc = hw::ftx_api_camera_test_stop(c.id);
    CAM_DEBUG(c, "ftx_api_camera_test_stop(%d) ret=%d", c.id, rc);
}

void start_camera(HWND hWnd, const Camera &c) {
    const int rc = hw::ftx_api_camera_test_start ? hw::ftx_api_camera_test_start(c.id) : -1;
    CAM_DEBUG(c, "ftx_api_camera_test_start(%d) ret=%d", c.id, rc);
    if (rc != 0) {
        s.errorKey = "info_CameraStartFail";
        CAM_ERROR(c, "camera %d did not start", c.id);
        if (!c.state->byPc.load()) SetTimer(hWnd, kFailTimer, kFailDelay);
        return;
    }
    c.state->started = 1;
    s.previewBound = hw::ftx_api_camera_get_preview != nullptr;
    if (!s.previewBound) {
        // Nothing to look at here: the operator judges the snapshots.
        CAM_DEBUG(c, "no ftx_api_camera_get_preview: no preview");
        s.running = true;
        s.passOffered = true;
        return;
    }
    s.frame.assign(static_cast<size_t>(RECTW(s.layout.preview)) * RECTH(s.layout.preview), 0);
    s.bitmap = BITMAP{};
    s.bitmap.bmType = BMP_TYPE_NORMAL;
    s.bitmap.bmBitsPerPixel = 32;
    s.bitmap.bmBytesPerPixel = 4;
    s.bitmap.bmAlpha = 255;
    s.bitmap.bmWidth = static_cast<Uint32>(RECTW(s.layout.preview));
    s.bitmap.bmHeight = static_cast<Uint32>(RECTH(s.layout.preview));
    s.bitmap.bmPitch = s.bitmap.bmWidth * 4;
    s.bitmap.bmBits = reinterpret_cast<Uint8 *>(s.frame.data());
    fetch_frame(hWnd, c);
    SetTimer(hWnd, kPreviewTimer, kPreviewPeriod);
}

void make_picture_dir(const Camera &c) {
    if (dev_mkdir(kPictureDir, 0755) != 0 && errno != EEXIST)
        CAM_ERROR(c, "cannot make %s: %s", kPictureDir, strerror(errno));
}

// Saves a picture of the started camera; 0 and its device path, else -1.
int snapshot(HWND hWnd, const Camera &c, char *path, size_t size) {
    if (!c.state->started.load()) {
        CAM_ERROR(c, "%s::camera not started", __func__);
        return -1;
    }
    make_picture_dir(c);
    snprintf(path, size, "%s/%s_%u.png", kPictureDir, c.fileName, ++c.state->shots);
    if (hw::ftx_api_camera_do_autofocus) {
        const int af = hw::ftx_api_camera_do_autofocus(c.id);
        CAM_DEBUG(c, "ftx_api_camera_do_autofocus(%d) ret=%d", c.id, af);
    }
    const int rc = hw::ftx_api_camera_start_capture(c.id, path);
    CAM_DEBUG(c, "snapshot %s ret=%d", path, rc);
    char word[MMI_TESTWND_TEXT_SIZE];
    mmi_translate(rc == 0 ? "info_CameraSaved" : "info_CameraSnapshotFail", word, sizeof word);
    // A path cut short still says the picture was saved.
    if (snprintf(s.status, sizeof s.status, "%s %s", word, rc == 0 ? path : "") < 0)
        s.status[0] = '\0';
    s.statusOk = rc == 0;
    InvalidateRect(hWnd, &s.layout.status, TRUE);
    return rc == 0 ? 0 : -1;
}

void pass_and_close(HWND hWnd, const Camera &c) {
    CAM_DEBUG(c, "%s", __func__);
    stop_camera(c);
    mmi_testwnd_pass_and_close(hWnd, c.row->resultIndex, c.row->domain);
}

void fail_and_close(HWND hWnd, const Camera &c) {
    CAM_DEBUG(c, "%s", __func__);
    stop_camera(c);
    mmi_testwnd_fail_and_close(hWnd, c.row->resultIndex);
}

void centred_text(HDC hdc, const char *key, mmi_colour colour, const RECT &box) {
    char text[MMI_TESTWND_TEXT_SIZE];
    mmi_translate(key, text, sizeof text);
    SetTextColor(hdc, mmi_pixel(colour));
    RECT rc = box;
    DrawText(hdc, text, -1, &rc, DT_CENTER | DT_VCENTER | DT_SINGLELINE);
}

void paint(HWND hWnd) {
    HDC hdc = BeginPaint(hWnd);
    mmi_testwnd_draw_top_line(hdc);
    SetBkMode(hdc, BM_TRANSPARENT);
    // The note in the smaller font, so that it stays one line.
    PLOGFONT font = GetCurFont(hdc);
    if (g_mmiLogFont[4]) SelectFont(hdc, g_mmiLogFont[4]);
    centred_text(hdc, "info_CameraNote", MMI_COLOUR_TEXT, s.layout.note);
    if (font) SelectFont(hdc, font);
    const RECT &box = s.layout.preview;
    if (s.previewBound && s.frameOk && s.errorKey == nullptr) {
        FillBoxWithBitmap(hdc, box.left, box.top, RECTW(box), RECTH(box), &s.bitmap);
    } else {
        SetBrushColor(hdc, mmi_pixel(MMI_COLOUR_BLACK));
        FillBox(hdc, box.left, box.top, RECTW(box), RECTH(box));
        if (s.errorKey != nullptr) {
            centred_text(hdc, s.errorKey, MMI_COLOUR_FAIL, box);
        } else if (!s.previewBound) {
            centred_text(hdc, "info_CameraNoPreview", MMI_COLOUR_TEXT, box);
        } else {
            centred_text(hdc, "info_CameraNoPicture", MMI_COLOUR_FAIL, box);
        }
    }
    if (s.status[0] != '\0') {
        SetTextColor(hdc, mmi_pixel(s.statusOk ? MMI_COLOUR_PASS : MMI_COLOUR_FAIL));
        RECT rc = s.layout.status;
        DrawText(hdc, s.status, -1, &rc, DT_CENTER | DT_VCENTER | DT_SINGLELINE);
    }
    EndPaint(hWnd, hdc);
}

LRESULT camera_proc(HWND hWnd, UINT message, WPARAM wParam, LPARAM lParam) {
    const DWORD index = mmi_window_data(hWnd, message, lParam);
    if (index >= sizeof kCameras / sizeof kCameras[0])
        return DefaultMainWinProc(hWnd, message, wParam, lParam);
    const Camera &c = kCameras[index];
    if (mmi_ownwnd_verdict(
            message, wParam, s.passOffered, [&] { pass_and_close(hWnd, c); },
            [&] { fail_and_close(hWnd, c); }))
        return 0;
    switch (message) {
        case MSG_CREATE: {
            mmi_testwnd_create_title(hWnd, c.row->titleKey);
            s = Screen{};
            RECT client;
            GetClientRect(hWnd, &client);
            mmi_camera_layout_for(RECTW(client), RECTH(client),
                                  mmi_logfont_size(3, g_ptScreenInfo.width) * 3 / 2, &s.layout);
            mmi_ownwnd_created(&c.state->wnd, hWnd, c.row->domain);
            start_camera(hWnd, c);
            break;
        }
        case MSG_ACTIVE:
            if (mmi_ownwnd_refuses(&c.state->wnd, message, c.row->domain)) return 0;
            if (wParam == 1) soft_keys(hWnd, c);
            break;
        case MSG_PAINT:
            if (mmi_ownwnd_refuses(&c.state->wnd, message, c.row->domain)) return 0;
            paint(hWnd);
            return 0;
        case MSG_TIMER:
            if (wParam == kPreviewTimer) {
                fetch_frame(hWnd, c);
                InvalidateRect(hWnd, &s.layout.preview, FALSE);
            } else if (wParam == kFailTimer && !c.state->byPc.load()) {
                CAM_DEBUG(c, "camera %d did not start: fail", c.id);
                KillTimer(hWnd, kFailTimer);
                fail_and_close(hWnd, c);
            }
            return 0;
        case MSG_KEYDOWN:
            if (wParam == 62 || wParam == 28) {
                char path[kPathSize];
                snapshot(hWnd, c, path, sizeof path);
            }
            return 0;
        case MSG_CLOSE:
            KillTimer(hWnd, kPreviewTimer);
            KillTimer(hWnd, kFailTimer);
            stop_camera(c);
            s.frame.clear();
            s.frame.shrink_to_fit();
            s.bitmap.bmBits = nullptr;
            mmi_ownwnd_destroy(&c.state->wnd, hWnd);
            return 0;
        default:
            break;
    }
    return DefaultMainWinProc(hWnd, message, wParam, lParam);
}

HWND open_window(int k) {
    const Camera &c = kCameras[k];
    if (Init_lib_Camera_Interface() != 0) {
        CAM_ERROR(c, "%s::Init_lib_Camera_Interface fail, test not opened", __func__);
        return HWND_INVALID;
    }
    HWND hWnd = mmi_testwnd_create(c.caption, camera_proc, static_cast<DWORD>(k));
    return mmi_ownwnd_opened(&c.state->wnd, hWnd, c.stopEntry);
}

template <int K>
void *open_camera(void) {
    return open_window(K);
}

void *menu_open(int k) {
    kCameras[k].state->byPc = 0;
    return open_window(k);
}

// The PC's close: the verdict of the open window (GUI thread), then the window closes.
int preview_ran(char *, unsigned int) {
    return s.running ? 1 : 0;
}

int stop(int k) {
    const int verdict = mmi_ownwnd_pc_stop(&kCameras[k].state->wnd, preview_ran, nullptr, 0);
    if (verdict < 0) CAM_DEBUG(kCameras[k], "%s::no camera window open", __func__);
    return verdict > 0 ? 1 : 0;
}

int pc_open(int k) {
    const Camera &c = kCameras[k];
    if (Init_lib_Camera_Interface() != 0) return 0;
    c.state->byPc = 1;
    mmi_ownwnd_pc_open(&c.state->wnd, c.open);
    const int started = c.state->started.load();
    CAM_DEBUG(c, "%s::camera %d %s", __func__, c.id, started ? "started" : "not started");
    return started ? 1 : 0;
}

struct ShotRequest {
    int k;
    char path[kPathSize];
};

int snapshot_on_gui(void *arg) {
    ShotRequest *r = static_cast<ShotRequest *>(arg);
    HWND hWnd = kCameras[r->k].state->wnd.hwnd.load();
    if (hWnd == HWND_INVALID) return -1;
    return snapshot(hWnd, kCameras[r->k], r->path, sizeof r->path);
}

int pc_snapshot(int k, char *reply, unsigned int size) {
    ShotRequest r{k, ""};
    const int rc = mmi_RunOnGuiThread(snapshot_on_gui, &r);
    if (rc != 0) {
        CAM_ERROR(kCameras[k], "%s::no picture taken", __func__);
        return 0;
    }
    if (reply != nullptr && size > 0) snprintf(reply, size, "*%s", r.path);
    return 1;
}

}  // namespace

void mmi_camera_layout_for(int w, int h, int lineHeight, mmi_camera_layout *out) {
    const int margin = lineHeight / 4;
    out->note = {0, margin, w, margin + lineHeight};
    const int top = out->note.bottom + margin;
    const int room = h - top - lineHeight - 2 * margin;  // the status line below the box
    int bw = w, bh = w * 4 / 3;
    if (bh > room) {
        bh = room > 0 ? room : 0;
        bw = bh * 3 / 4;
    }
    const int left = (w - bw) / 2;
    out->preview = {left, top, left + bw, top + bh};
    out->status = {0, top + bh + margin, w, top + bh + margin + lineHeight};
}

int mmi_camera_check(int camera, char *out, unsigned int size) {
    const Camera *found = nullptr;
    for (const Camera &c : kCameras)
        if (c.id == camera) found = &c;
    if (found == nullptr || out == nullptr || size == 0) return -1;
    const Camera &c = *found;
    if (c.state->started.load()) {
        // Its window holds it: a second start would fail for a reason of ours, not the board's.
        snprintf(out, size, "camera %d is in use: fail", camera);
        return -1;
    }
    int rc = hw::ftx_api_camera_test_start ? hw::ftx_api_camera_test_start(camera) : -1;
    CAM_DEBUG(c, "%s::ftx_api_camera_test_start(%d) ret=%d", __func__, camera, rc);
    if (rc != 0) {
        snprintf(out, size, "camera %d did not start: fail", camera);
        return -1;
    }
    make_picture_dir(c);
    char path[kPathSize];
    snprintf(path, sizeof path, "%s/pcba_%s.png", kPictureDir, c.fileName);
    rc = hw::ftx_api_camera_start_capture ? hw::ftx_api_camera_start_capture(camera, path) : -1;
    CAM_DEBUG(c, "%s::capture %s ret=%d", __func__, path, rc);
    if (hw::ftx_api_camera_test_stop) hw::ftx_api_camera_test_stop(camera);
    if (rc != 0) {
        snprintf(out, size, "camera %d started, no picture: fail", camera);
        return -1;
    }
    snprintf(out, size, "camera %d took %s: success", camera, path);
    return 0;
}

#define MMI_CAMERA_ENTRIES(Name, K)                                                  \
    void *mmi_testwnd_Camera##Name##TestEntry(void) {                                \
        return menu_open(K);                                                         \
    }                                                                                \
    int mmi_AutoTest_Camera##Name##Test_Stop_Entry(void) {                           \
        return stop(K);                                                              \
    }                                                                                \
    int mmi_AutoTest_Camera##Name##TestEntry(void) {                                 \
        return pc_open(K);                                                           \
    }                                                                                \
    int mmi_AutoTest_Camera##Name##Test_Snapshot_Entry(char *reply, unsigned size) { \
        return pc_snapshot(K, reply, size);                                          \
    }
MMI_CAMERA_ENTRIES(Back, BACK)
MMI_CAMERA_ENTRIES(AuxBack, AUX_BACK)
MMI_CAMERA_ENTRIES(Front, FRONT)

// Camera area of the factory model: which cameras the console made fail, which are started,
// and their pictures (a moving test pattern per camera, saved as PNG by a capture).
#include <png.h>
#include <stdio.h>

#include <chrono>
#include <mutex>
#include <string>
#include <vector>

#include "camera_pattern.h"
#include "devfs.h"
#include "factory_area.h"

namespace ftxsim {
namespace {

constexpr int kIds = 32;
// The size of a captured picture: upright 3:4, like the preview.
constexpr int kPictureW = 480;
constexpr int kPictureH = 640;

struct Camera {
    unsigned cameraFail = 0;  // bit per camera id
    unsigned started = 0;     // bit per camera id
    std::chrono::steady_clock::time_point since[kIds];
    unsigned long frames = 0;  // preview frames given since the last start
    unsigned long captures = 0;
};

Camera &camera() {
    return model_part<Camera>();
}

bool known(int id) {
    return id >= 0 && id < kIds;
}

bool broken(int id) {
    return (camera().cameraFail & (1u << id)) != 0;
}

// Milliseconds since the camera's start; under model_lock().
long long running_ms(int id) {
    const auto d = std::chrono::steady_clock::now() - camera().since[id];
    return std::chrono::duration_cast<std::chrono::milliseconds>(d).count();
}

// This area's part of "hw status".
void state(Reply &r) {
    r.add(" camera.fail=0x%x camera.started=", camera().cameraFail);
    if (camera().started == 0) r.add("none");
    for (int id = 0, n = 0; id < kIds; id++)
        if (camera().started & (1u << id)) r.add("%s%d", n++ ? "," : "", id);
    r.add(" camera.frames=%lu camera.captures=%lu", camera().frames, camera().captures);
}

// Writes w x h pixels of 0x00RRGGBB to the device path as an 8-bit RGB PNG; 0 or -1.
int write_png(const char *path, const std::vector<unsigned> &argb, int w, int h) {
    std::vector<unsigned char> rgb(argb.size() * 3);
    for (size_t i = 0; i < argb.size(); i++) {
        rgb[i * 3] = static_cast<unsigned char>(argb[i] >> 16);
        rgb[i * 3 + 1] = static_cast<unsigned char>(argb[i] >> 8);
        rgb[i * 3 + 2] = static_cast<unsigned char>(argb[i]);
    }
    FILE *f = dev_fopen(path, "wb");
    if (f == nullptr) return -1;
    png_image img = {};
    img.version = PNG_IMAGE_VERSION;
    img.width = static_cast<png_uint_32>(w);
    img.height = static_cast<png_uint_32>(h);
    img.format = PNG_FORMAT_RGB;
    const int ok = png_image_write_to_stdio(&img, f, 0, rgb.data(), 0, nullptr);
    png_image_free(&img);
    const bool closed = fclose(f) == 0;
    return ok != 0 && closed ? 0 : -1;
}

}  // namespace

bool FactoryModel::camera_ok(int id) {
    std::lock_guard<std::mutex> lock(model_lock());
    return !known(id) || !broken(id);
}

int FactoryModel::camera_start(int id, bool on) {
    std::lock_guard<std::mutex> lock(model_lock());
    if (!known(id)) return on ? -1 : 0;
    if (!on) {
        camera().started &= ~(1u << id);
        return 0;
    }
    if (broken(id)) return -1;
    camera().started |= 1u << id;
    camera().since[id] = std::chrono::steady_clock::now();
    camera().frames = 0;
    return 0;
}

int FactoryModel::camera_frame(int id, unsigned *argb, int w, int h) {
    long long ms;
    {
        std::lock_guard<std::mutex> lock(model_lock());
        if (!known(id) || broken(id) || (camera().started & (1u << id)) == 0) return -1;
        ms = running_ms(id);
    }
    if (camera_pattern(id, ms, argb, w, h) != 0) return -1;
    std::lock_guard<std::mutex> lock(model_lock());
    camera().frames++;
    return 0;
}

int FactoryModel::camera_capture(int id, const char *path) {
    long long ms;
    {
        std::lock_guard<std::mutex> lock(model_lock());
        if (path == nullptr || !known(id) || broken(id) || (camera().started & (1u << id)) == 0)
            return -1;
        ms = running_ms(id);
    }
    std::vector<unsigned> frame(static_cast<size_t>(kPictureW) * kPictureH);
    if (camera_pattern(id, ms, frame.data(), kPictureW, kPictureH) != 0 ||
        write_png(path, frame, kPictureW, kPictureH) != 0)
        return -1;
    std::lock_guard<std::mutex> lock(model_lock());
    camera().captures++;
    return 0;
}

// ---- control words ----
namespace {

int w_camera(const Args &a, Reply &r) {
    if (a.size() == 1) {
        std::lock_guard<std::mutex> lock(model_lock());
        r.add("camera:");
        state(r);
        return r.done("\n");
    }
    long id;
    bool ok;
    if (a.size() != 3 || !to_int(a[1], &id) || id < 0 || id >= kIds || !on_off(a[2], &ok)) return 1;
    std::lock_guard<std::mutex> lock(model_lock());
    if (ok) {
        camera().cameraFail &= ~(1u << id);
    } else {
        camera().cameraFail |= 1u << id;
    }
    return r.done("camera %ld %s\n", id, ok ? "ok" : "fail");
}

}  // namespace

constinit const Area kCameraArea = {
    .words = {{"camera",
               "[ID ok|fail]  (a broken camera fails its start, capture, preview and ID check; "
               "alone: the cameras' state)",
               w_camera}},
    .state = state,
};

}  // namespace ftxsim

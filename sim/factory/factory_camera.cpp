// Camera area of the factory model: which cameras the console made fail.
#include <mutex>

#include "factory_area.h"

namespace ftxsim {
namespace {

struct Camera {
    unsigned cameraFail = 0;  // bit per camera id
};

Camera &camera() {
    return model_part<Camera>();
}

// This area's part of "hw status".
void state(Reply &r) {
    r.add(" camera.fail=0x%x", camera().cameraFail);
}

}  // namespace

bool FactoryModel::camera_ok(int id) {
    std::lock_guard<std::mutex> lock(model_lock());
    return id < 0 || id > 31 || (camera().cameraFail & (1u << id)) == 0;
}

// ---- control words ----
namespace {

int w_camera(const Args &a, Reply &r) {
    long id;
    bool ok;
    if (a.size() != 3 || !to_int(a[1], &id) || id < 0 || id > 31 || !on_off(a[2], &ok)) return 1;
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
    .words = {{"camera", "ID ok|fail", w_camera}},
    .state = state,
};

}  // namespace ftxsim

// The factory library's cameras: the moving test pattern, the preview and capture operations,
// a camera the console breaks, and the pictures a capture saves.
#include <png.h>
#include <stdlib.h>

#include <set>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "camera_pattern.h"
#include "ftx_host.h"
#include "hw/lib_factory.h"
#include "support/temp_root.h"
#include "support/text.h"
#include "support/hw_line.h"

namespace {

using ftxsim::camera_pattern;

std::vector<unsigned> frame(int id, long long ms, int w, int h) {
    std::vector<unsigned> f(static_cast<size_t>(w) * h, 0xDEADBEEF);
    EXPECT_EQ(0, camera_pattern(id, ms, f.data(), w, h));
    return f;
}

std::set<unsigned> colours(const std::vector<unsigned> &f) {
    return std::set<unsigned>(f.begin(), f.end());
}

// A picture read back as 0x00RRGGBB pixels; false when it is no PNG.
bool load_png(const std::string &path, std::vector<unsigned> *px, int *w, int *h) {
    png_image img = {};
    img.version = PNG_IMAGE_VERSION;
    if (png_image_begin_read_from_file(&img, path.c_str()) == 0) return false;
    img.format = PNG_FORMAT_RGB;
    std::vector<unsigned char> rgb(PNG_IMAGE_SIZE(img));
    if (png_image_finish_read(&img, nullptr, rgb.data(), 0, nullptr) == 0) return false;
    *w = static_cast<int>(img.width);
    *h = static_cast<int>(img.height);
    px->resize(rgb.size() / 3);
    for (size_t i = 0; i < px->size(); i++)
        (*px)[i] = rgb[i * 3] << 16 | rgb[i * 3 + 1] << 8 | rgb[i * 3 + 2];
    return true;
}

}  // namespace

TEST(CameraPattern, EachCameraShowsItsOwnBandsAndEveryBandFitsTheFrame) {
    const auto back = frame(FTX_CAMERA_BACK, 0, 720, 960);
    const auto front = frame(FTX_CAMERA_FRONT, 0, 720, 960);
    const auto aux = frame(FTX_CAMERA_AUX_BACK, 0, 720, 960);
    // Every pixel drawn, every colour of the camera's set shown, no colour shared.
    EXPECT_EQ(0u, colours(back).count(0xDEADBEEF));
    EXPECT_EQ(8u, colours(back).size());
    EXPECT_EQ(6u, colours(front).size());
    EXPECT_EQ(5u, colours(aux).size());
    for (unsigned c : colours(back)) {
        EXPECT_EQ(0u, colours(front).count(c));
        EXPECT_EQ(0u, colours(aux).count(c));
    }
    // The back camera's bars stand upright, the front camera's bands lie across.
    EXPECT_EQ(back[0], back[959 * 720]);
    EXPECT_NE(back[0], back[719]);
    EXPECT_EQ(front[0], front[719]);
    EXPECT_NE(front[0], front[959 * 720]);
    // Higher camera numbers repeat the three.
    EXPECT_EQ(back, frame(3, 0, 720, 960));
}

TEST(CameraPattern, TheBandsMoveWithTimeAndComeBackAfterAFullTurn) {
    const auto at0 = frame(FTX_CAMERA_BACK, 0, 720, 960);
    // A band (720 / 8 = 90 pixels) crosses in 4 s: after 1 s it moved 22 pixels right.
    const auto at1 = frame(FTX_CAMERA_BACK, 1000, 720, 960);
    EXPECT_NE(at0, at1);
    for (int x = 0; x + 22 < 720; x++)
        ASSERT_EQ(at0[x], at1[x + 22]) << x;
    EXPECT_EQ(at1, frame(FTX_CAMERA_BACK, 1000, 720, 960));  // the same time, the same frame
    EXPECT_EQ(at0, frame(FTX_CAMERA_BACK, 8 * 4000, 720, 960));
    EXPECT_NE(frame(FTX_CAMERA_FRONT, 0, 64, 48), frame(FTX_CAMERA_FRONT, 500, 64, 48));
    EXPECT_NE(frame(FTX_CAMERA_AUX_BACK, 0, 64, 48), frame(FTX_CAMERA_AUX_BACK, 500, 64, 48));
}

class CameraLib : public ::testing::Test {
  protected:
    void SetUp() override {
        hw("camera 0 ok");
        hw("camera 1 ok");
        hw("set ftx_api_camera_test_start default");
        root_.write("/data/ftx_camera/.keep", "");
    }
    void TearDown() override {
        for (int id : {0, 1, 2})
            ftx_api_camera_test_stop(id);
    }
    TempRoot root_;
};

TEST_F(CameraLib, APreviewOnlyWhileStartedAndStatusSaysWhichCamera) {
    std::vector<unsigned> f(32 * 24);
    EXPECT_EQ(-1, ftx_api_camera_get_preview(0, f.data(), 32, 24));
    EXPECT_TRUE(has(hw("camera"), "camera.started=none"));
    ASSERT_EQ(0, ftx_api_camera_test_start(FTX_CAMERA_FRONT));
    EXPECT_EQ(-1, ftx_api_camera_get_preview(FTX_CAMERA_BACK, f.data(), 32, 24));
    EXPECT_EQ(0, ftx_api_camera_get_preview(FTX_CAMERA_FRONT, f.data(), 32, 24));
    EXPECT_EQ(-1, ftx_api_camera_get_preview(FTX_CAMERA_FRONT, f.data(), 0, 24));
    EXPECT_EQ(-1, ftx_api_camera_get_preview(FTX_CAMERA_FRONT, nullptr, 32, 24));
    const std::string st = hw("status");
    EXPECT_TRUE(has(st, "camera.started=1 camera.frames=1 ")) << st;
    ASSERT_EQ(0, ftx_api_camera_test_start(FTX_CAMERA_BACK));
    EXPECT_TRUE(has(hw("camera"), "camera.started=0,1 camera.frames=0 "));
    ASSERT_EQ(0, ftx_api_camera_test_stop(FTX_CAMERA_FRONT));
    EXPECT_EQ(-1, ftx_api_camera_get_preview(FTX_CAMERA_FRONT, f.data(), 32, 24));
    EXPECT_TRUE(has(hw("camera"), "camera.started=0 "));
    // A refused line changes nothing.
    EXPECT_TRUE(has(hw("camera 0"), "usage"));
    EXPECT_TRUE(has(hw("camera 32 fail"), "usage"));
}

TEST_F(CameraLib, ABrokenCameraFailsEveryOperationAndLosesItsRunningPreview) {
    std::vector<unsigned> f(32 * 24);
    ASSERT_EQ(0, ftx_api_camera_test_start(FTX_CAMERA_BACK));
    hw("camera 0 fail");
    EXPECT_EQ(-1, ftx_api_camera_get_preview(FTX_CAMERA_BACK, f.data(), 32, 24));
    EXPECT_NE(0, ftx_api_camera_start_capture(FTX_CAMERA_BACK, "/data/ftx_camera/b.png"));
    EXPECT_FALSE(root_.exists("/data/ftx_camera/b.png"));
    EXPECT_NE(0, ftx_api_cameraID_test(0));
    ftx_api_camera_test_stop(FTX_CAMERA_BACK);
    EXPECT_NE(0, ftx_api_camera_test_start(FTX_CAMERA_BACK));
    EXPECT_TRUE(has(hw("camera"), "camera.fail=0x1 camera.started=none"));
    // The others go on; a forced failure of a start starts nothing.
    EXPECT_EQ(0, ftx_api_camera_test_start(FTX_CAMERA_FRONT));
    hw("set ftx_api_camera_test_start -1");
    EXPECT_NE(0, ftx_api_camera_test_start(FTX_CAMERA_AUX_BACK));
    EXPECT_TRUE(has(hw("camera"), "camera.started=1 "));
}

TEST_F(CameraLib, ACaptureSavesTheCurrentPictureAsAnUprightPng) {
    EXPECT_NE(0, ftx_api_camera_start_capture(FTX_CAMERA_AUX_BACK, "/data/ftx_camera/x.png"));
    ASSERT_EQ(0, ftx_api_camera_test_start(FTX_CAMERA_AUX_BACK));
    ASSERT_EQ(0, ftx_api_camera_start_capture(FTX_CAMERA_AUX_BACK, "/data/ftx_camera/x.png"));
    std::vector<unsigned> px;
    int w = 0, h = 0;
    ASSERT_TRUE(load_png(root_.host("/data/ftx_camera/x.png"), &px, &w, &h));
    EXPECT_EQ(480, w);
    EXPECT_EQ(640, h);
    std::vector<unsigned> ref(480 * 640);
    ASSERT_EQ(0, camera_pattern(FTX_CAMERA_AUX_BACK, 0, ref.data(), 480, 640));
    EXPECT_EQ(colours(ref), colours(px));
    EXPECT_TRUE(has(hw("camera"), "camera.captures=1"));
    // No folder, no picture; no path either.
    EXPECT_NE(0, ftx_api_camera_start_capture(FTX_CAMERA_AUX_BACK, "/data/none/x.png"));
    EXPECT_NE(0, ftx_api_camera_start_capture(FTX_CAMERA_AUX_BACK, nullptr));
}

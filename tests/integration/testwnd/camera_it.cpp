// The real ftx-mmi, headless: the camera window's live preview, its snapshot and verdict in a
// run, the PC's open, snapshot and close of each camera, and a camera the model breaks.
#include <string>

#include <gtest/gtest.h>

#include "support/handset.h"
#include "support/text.h"

using namespace handset;

namespace {

const Item kBack = {"FTX_CAMERA_BACK", 1, 0, 1};
const Item kFront = {"FTX_CAMERA_FRONT", 1, 0, 1};

// The preview box of a 720x1280 screen: the window starts at 58, the box 80 below that,
// 720 x 960 (upright 3:4).
const int kBoxTop = 58 + 80;
const int kBoxBottom = kBoxTop + 960;

struct Cam {
    const char *module;  // the PC's word
    int id;
    const char *caption;
    const char *domain;
    int r, g, b;  // a colour of its pattern that no other camera shows
};
const Cam kCams[] = {
    {"backcameraMoudle", 0, "Rear Camera Test", "FTX_CAMERA_BACK", 0xC0, 0xC0, 0x00},
    {"frontcameraMoudle", 1, "Front Camera Test", "FTX_CAMERA_FRONT", 0xFF, 0x8C, 0x00},
    {"auxbackcameraMoudle", 2, "Rear Camera 2 Test", "FTX_AUX_CAMERA_BACK", 0x00, 0x99, 0xCC},
};

// Pixels of the camera's own colour in the box [top, bottom) of p.
int camColour(const Png &p, const Cam &c, int top = kBoxTop, int bottom = kBoxBottom) {
    return p.count(0, top, p.w, bottom,
                   [&](int r, int g, int b) { return r == c.r && g == c.g && b == c.b; });
}

bool sameBox(const Png &a, const Png &b) {
    const size_t from = (size_t)kBoxTop * 720 * 3, to = (size_t)kBoxBottom * 720 * 3;
    return std::equal(a.rgb.begin() + from, a.rgb.begin() + to, b.rgb.begin() + from);
}

std::string cameraLine(Handset &h) {
    return h.dut.console("hw camera");
}

// A screenshot once the preview box shows the camera's picture.
Png previewShot(Handset &h, const Cam &c, const std::string &name) {
    Png p;
    EXPECT_TRUE(dut_wait_until(
        [&] {
            p = h.shot(name);
            return camColour(p, c) > 10000;
        },
        10000))
        << name;
    return p;
}

}  // namespace

TEST(CameraPreview, ThePictureMovesBetweenTwoScreenshots) {
    Handset h({});
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.dut.waitChannel());
    const Cam &back = kCams[0];
    EXPECT_EQ(0, h.dut.pc("backcameraMoudle testItem open").first);
    ASSERT_TRUE(h.waitActive(back.caption));
    ASSERT_TRUE(h.dut.waitLog("FTX_CAMERA_BACK: offer_pass::preview running, pass offered"));
    const Png first = previewShot(h, back, "camera_first.png");
    Png later;
    EXPECT_TRUE(dut_wait_until(
        [&] {
            later = h.shot("camera_later.png");
            return !sameBox(first, later);
        },
        5000));
    // Still the same camera's picture, and pass is offered to the operator.
    EXPECT_GT(camColour(later, back), 10000);
    EXPECT_TRUE(pass_label(later));
    EXPECT_EQ(0, h.dut.pc("backcameraMoudle testItem close").first);
    EXPECT_TRUE(has(cameraLine(h), "camera.started=none"));
}

TEST(CameraRun, TheBackCameraSavesASnapshotAndPassesItsItem) {
    Handset h({kBack, kCards});
    ASSERT_TRUE(h.start());
    h.openDeviceList();
    h.chooseRow(0);
    ASSERT_TRUE(h.waitActive("Rear Camera Test"));
    ASSERT_TRUE(h.dut.waitLog("FTX_CAMERA_BACK: offer_pass::preview running, pass offered"));
    EXPECT_TRUE(has(cameraLine(h), "camera.started=0 "));
    h.key(62);  // the middle key: a snapshot
    ASSERT_TRUE(h.dut.waitLog("FTX_CAMERA_BACK: snapshot /data/ftx_camera/back_1.png ret=0"));
    Png picture;
    ASSERT_TRUE(picture.load(h.dut.host("/data/ftx_camera/back_1.png")));
    EXPECT_EQ(480, picture.w);
    EXPECT_EQ(640, picture.h);
    EXPECT_GT(camColour(picture, kCams[0], 0, 640), 1000);
    // The status line under the box tells where it went.
    Png shot;
    EXPECT_TRUE(dut_wait_until(
        [&] {
            shot = h.shot("camera_run.png");
            return shot.count(0, kBoxBottom, 720, kBoxBottom + 70, green) > 100 &&
                   camColour(shot, kCams[0]) > 10000 && pass_label(shot);
        },
        5000));
    h.keepForDocs("camera_run.png", "camera_preview.png");
    EXPECT_EQ(0, h.result(288));
    h.key(60);
    ASSERT_TRUE(h.dut.waitLog(kCardsOpened));
    EXPECT_EQ(1, h.result(288));
    EXPECT_TRUE(has(cameraLine(h), "camera.started=none"));
}

TEST(CameraPc, EachCameraOpensSnapshotsAValidPictureAndCloses) {
    Handset h({});
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.dut.waitChannel());
    for (const Cam &c : kCams) {
        SCOPED_TRACE(c.module);
        const std::string cmd = std::string(c.module) + " testItem ";
        // Nothing open: no snapshot, and the close has no verdict to give.
        EXPECT_EQ(2, h.dut.pc(cmd + "snapshot").first);
        EXPECT_EQ(0, h.dut.pc(cmd + "open").first);
        ASSERT_TRUE(h.waitActive(c.caption));
        EXPECT_TRUE(has(cameraLine(h), "camera.started=" + std::to_string(c.id) + " "));
        EXPECT_GT(camColour(previewShot(h, c, "camera_pc.png"), c), 10000);
        for (int n = 1; n <= 2; n++) {
            auto shot = h.dut.pc(cmd + "snapshot");
            ASSERT_EQ(0, shot.first);
            ASSERT_EQ('*', shot.second[0]) << shot.second;
            const std::string path = shot.second.substr(1);
            EXPECT_TRUE(has(path, "/data/ftx_camera/")) << path;
            Png picture;
            ASSERT_TRUE(picture.load(h.dut.host(path))) << path;
            EXPECT_EQ(480, picture.w);
            EXPECT_EQ(640, picture.h);
            EXPECT_GT(camColour(picture, c, 0, 640), 1000);
        }
        EXPECT_TRUE(has(cameraLine(h), "camera.captures="));
        EXPECT_EQ(0, h.dut.pc(cmd + "close").first);
        EXPECT_TRUE(has(cameraLine(h), "camera.started=none"));
        EXPECT_EQ(2, h.dut.pc(cmd + "close").first);
    }
    // The PC-driven windows never closed by themselves: nothing was recorded.
    EXPECT_EQ(0, h.result(288));
    EXPECT_EQ(0, h.result(292));
}

TEST(CameraBroken, InARunTheWindowShowsWhyAndFailsByItself) {
    Handset h({kBack, kCards});
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.dut.consoleOk("hw camera 0 fail"));
    h.openDeviceList();
    h.chooseRow(0);
    ASSERT_TRUE(h.dut.waitLog("FTX_CAMERA_BACK: camera 0 did not start"));
    ASSERT_TRUE(h.dut.waitLog("FTX_CAMERA_BACK: camera 0 did not start: fail"));
    ASSERT_TRUE(h.waitActive("Device Test"));
    EXPECT_EQ(2, h.result(288));
    EXPECT_FALSE(has(h.dut.logcat(), kCardsOpened));
    EXPECT_FALSE(has(h.dut.logcat(), "pass offered"));
}

TEST(CameraBroken, ThePcOpenFailsTheWindowStaysRedWithoutPassAndTheCloseFails) {
    Handset h({});
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.dut.waitChannel());
    ASSERT_TRUE(h.dut.consoleOk("hw camera 1 fail"));
    EXPECT_EQ(2, h.dut.pc("frontcameraMoudle testItem open").first);
    ASSERT_TRUE(h.waitActive("Front Camera Test"));
    const Png p = h.shotWhen("camera_broken.png", [](const Png &s) {
        return s.count(0, kBoxTop, 720, kBoxBottom, red) > 200 && fail_label(s);
    });
    EXPECT_FALSE(pass_label(p));
    EXPECT_EQ(0, camColour(p, kCams[1]));
    EXPECT_EQ(2, h.dut.pc("frontcameraMoudle testItem snapshot").first);
    EXPECT_EQ(2, h.dut.pc("frontcameraMoudle testItem close").first);
    EXPECT_TRUE(dut_wait_until([&] { return h.activeCaption() != "Front Camera Test"; }, 5000));
    EXPECT_FALSE(has(h.dut.console("hw status"), "ftx_api_camera_start_capture"));
    // Another camera is not concerned.
    EXPECT_EQ(0, h.dut.pc("backcameraMoudle testItem open").first);
    EXPECT_EQ(0, h.dut.pc("backcameraMoudle testItem close").first);
}

TEST(CameraBroken, ACameraThatStopsGivingFramesLosesItsPassUntilTheyComeBack) {
    Handset h({});
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.dut.waitChannel());
    EXPECT_EQ(0, h.dut.pc("backcameraMoudle testItem open").first);
    ASSERT_TRUE(h.dut.waitLog("FTX_CAMERA_BACK: offer_pass::preview running, pass offered"));
    ASSERT_TRUE(h.dut.consoleOk("hw camera 0 fail"));
    ASSERT_TRUE(h.dut.waitLog("FTX_CAMERA_BACK: offer_pass::pass withdrawn"));
    const Png lost = h.shotWhen("camera_lost.png", [](const Png &s) {
        return s.count(0, kBoxTop, 720, kBoxBottom, red) > 200 && !pass_label(s);
    });
    EXPECT_EQ(0, camColour(lost, kCams[0]));
    EXPECT_EQ(2, h.dut.pc("backcameraMoudle testItem snapshot").first);
    ASSERT_TRUE(h.dut.consoleOk("hw camera 0 ok"));
    ASSERT_TRUE(
        h.dut.waitLogCount("FTX_CAMERA_BACK: offer_pass::preview running, pass offered", 2));
    EXPECT_GT(camColour(previewShot(h, kCams[0], "camera_back.png"), kCams[0]), 10000);
    EXPECT_EQ(0, h.dut.pc("backcameraMoudle testItem close").first);
}

TEST(CameraNoPreview, ALibraryWithoutFramesSaysSoAndStillTakesPictures) {
    Handset h({});
    const std::string lib = DeviceUnderTest::buildDir() + "/lib";
    h.dut.setEnv("LD_LIBRARY_PATH", lib + "/variants/no_preview:" + lib);
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.dut.waitChannel());
    EXPECT_EQ(0, h.dut.pc("backcameraMoudle testItem open").first);
    ASSERT_TRUE(h.dut.waitLog("FTX_CAMERA_BACK: no ftx_api_camera_get_preview: no preview"));
    const Png p = h.shotWhen("camera_nopreview.png", [](const Png &s) {
        return s.count(0, kBoxTop, 720, kBoxBottom, light) > 200 && pass_label(s);
    });
    EXPECT_EQ(0, camColour(p, kCams[0]));
    auto shot = h.dut.pc("backcameraMoudle testItem snapshot");
    EXPECT_EQ(0, shot.first);
    Png picture;
    EXPECT_TRUE(picture.load(h.dut.host(shot.second.substr(1))));
    EXPECT_EQ(0, h.dut.pc("backcameraMoudle testItem close").first);
}

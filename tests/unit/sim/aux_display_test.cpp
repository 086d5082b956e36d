// The simulated handset's display side: the auxiliary display's frame file and its program
// (run for real, as the device shell runs it), the panel description written at boot, and
// the calibration pictures the build adds to the image.
#include <png.h>
#include <signal.h>
#include <stdlib.h>
#include <sys/wait.h>
#include <unistd.h>

#include <set>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "aux_fb.h"
#include "kernel_files.h"
#include "support/device_under_test.h"
#include "support/temp_root.h"

namespace {

TEST(AuxFrameFile, RoundTripsAndRefusesAnythingButAWholeFrame) {
    ftxhost::AuxFrame f = ftxhost::aux_fb_plain(3, 2, true, 0xFFFFFE);
    f.pixels[4] = 0x0000FF;
    const std::string bytes = ftxhost::aux_fb_format(f);
    ftxhost::AuxFrame back;
    ASSERT_EQ(0, ftxhost::aux_fb_parse(bytes, &back));
    EXPECT_EQ(3, back.width);
    EXPECT_EQ(2, back.height);
    EXPECT_TRUE(back.on);
    EXPECT_EQ(f.pixels, back.pixels);

    for (const std::string &bad :
         {bytes.substr(0, bytes.size() - 1), bytes + "x", std::string("FTXFB1 3 2 1"),
          std::string("FTXFB1 0 2 1\n"), std::string("FTXFB1 5000 1 1\n"),
          std::string("FTXFB2 3 2 1\n") + bytes.substr(bytes.find('\n') + 1),
          std::string("FTXFB1 3 2 7\n") + bytes.substr(bytes.find('\n') + 1),
          std::string("FTXFB1 3 2 1 9\n") + bytes.substr(bytes.find('\n') + 1)}) {
        EXPECT_EQ(-1, ftxhost::aux_fb_parse(bad, &back)) << bad.substr(0, 20);
    }
    // Off is dark whatever colour was asked for.
    EXPECT_EQ(0u, ftxhost::aux_fb_plain(2, 2, false, 0xFF0000).pixels[3]);
}

// The program in the build's handset tool folder, started as the shell would start it.
class AuxProgram : public ::testing::Test {
  protected:
    void SetUp() override {
        root_.write("/sim/device.ini", "[aux_screen]\nwidth=8\nheight=4\n");
        root_.write("/data/.keep", "");
    }
    pid_t start(const std::vector<std::string> &args, pid_t app) {
        const std::string exe = std::string(FTX_TEST_BUILD_DIR) + "/handset/bin/mmi_open_fb1";
        pid_t pid = fork();
        if (pid == 0) {
            setenv("FTX_APP_PID", std::to_string(app).c_str(), 1);
            std::vector<char *> argv{const_cast<char *>("mmi_open_fb1")};
            for (const std::string &a : args)
                argv.push_back(const_cast<char *>(a.c_str()));
            argv.push_back(nullptr);
            execv(exe.c_str(), argv.data());
            _exit(127);
        }
        return pid;
    }
    // Waits for the program's exit status (-1 when it still runs after the deadline).
    int finish(pid_t pid, int timeoutMs = 5000) {
        int status = 0;
        bool done =
            dut_wait_until([&] { return waitpid(pid, &status, WNOHANG) == pid; }, timeoutMs);
        if (!done) {
            kill(pid, SIGKILL);
            waitpid(pid, &status, 0);
            return -1;
        }
        return WIFEXITED(status) ? WEXITSTATUS(status) : 128 + WTERMSIG(status);
    }
    bool shows(uint32_t colour, bool on = true) {
        return dut_wait_until(
            [&] {
                ftxhost::AuxFrame f;
                return ftxhost::aux_fb_read(root_.host("/sim/fb1"), &f) == 0 && f.on == on &&
                       f.width == 8 && f.height == 4 && f.pixels[31] == colour;
            },
            5000);
    }
    TempRoot root_;
};

TEST_F(AuxProgram, PaintsItsColourAndANewStartReplacesIt) {
    pid_t first = start({"1", "2"}, getpid());
    ASSERT_TRUE(shows(0x00FF00));
    pid_t second = start({"1", "0"}, getpid());
    EXPECT_EQ(0, finish(first)) << "the earlier instance ends";
    ASSERT_TRUE(shows(0xFFFFFE));
    // The close flag ends it, dark, and takes the flag and the pid file with it.
    root_.write("/data/fb1_close_flag", "");
    EXPECT_EQ(0, finish(second));
    EXPECT_TRUE(shows(0x000000, false));
    EXPECT_FALSE(root_.exists("/data/fb1_close_flag"));
    EXPECT_FALSE(root_.exists("/run/fb1.pid"));
    EXPECT_NE(std::string::npos, root_.read("/log/tools.txt").find("mmi_open_fb1 1 2\n"));
}

TEST_F(AuxProgram, AStaleCloseFlagIsIgnoredAndBadArgumentsAreRefused) {
    root_.write("/data/fb1_close_flag", "");
    pid_t p = start({"1", "3"}, getpid());
    ASSERT_TRUE(shows(0x0000FF));
    EXPECT_FALSE(root_.exists("/data/fb1_close_flag"));
    root_.write("/data/fb1_close_flag", "");
    EXPECT_EQ(0, finish(p));
    for (const std::vector<std::string> &bad : std::vector<std::vector<std::string>>{
             {"2", "0"}, {"1", "5"}, {"1", "-1"}, {"1"}, {"1", "2", "3"}, {"1", "x"}})
        EXPECT_EQ(2, finish(start(bad, getpid()))) << bad.size();
}

TEST_F(AuxProgram, ItEndsWithTheApplicationThatStartedIt) {
    pid_t app = fork();
    if (app == 0) {
        pause();
        _exit(0);
    }
    pid_t p = start({"1", "1"}, app);
    ASSERT_TRUE(shows(0xFF0000));
    kill(app, SIGKILL);
    waitpid(app, nullptr, 0);
    EXPECT_EQ(0, finish(p));
}

TEST(PanelDescription, NamesTheMakerChosenInTheDeviceSettings) {
    EXPECT_NE(nullptr, strstr(ftxhost::panel_description("JDI"), "dvkJDI"));
    EXPECT_NE(nullptr, strstr(ftxhost::panel_description("truly"), "dvkTruly"));
    EXPECT_EQ(nullptr, strstr(ftxhost::panel_description("Truly"), "dvkJDI"));
    EXPECT_NE(nullptr, strstr(ftxhost::panel_description("LG"), "dvkJDI"));
    EXPECT_NE(nullptr, strstr(ftxhost::panel_description(nullptr), "dvkJDI"));
}

TEST(CalibrationPictures, TwelvePicturesAllDifferent) {
    std::set<std::vector<png_byte>> seen;
    for (int n = 0; n < 12; n++) {
        char path[256];
        snprintf(path, sizeof(path), "%s/image/vendor/etc/data/ratio_25_%04d.png",
                 FTX_TEST_BUILD_DIR, n);
        png_image img{};
        img.version = PNG_IMAGE_VERSION;
        ASSERT_NE(0, png_image_begin_read_from_file(&img, path)) << path;
        img.format = PNG_FORMAT_RGB;
        std::vector<png_byte> rgb(PNG_IMAGE_SIZE(img));
        ASSERT_NE(0, png_image_finish_read(&img, nullptr, rgb.data(), 0, nullptr)) << path;
        EXPECT_TRUE(seen.insert(rgb).second) << path << " is the same as an earlier picture";
    }
}

}  // namespace

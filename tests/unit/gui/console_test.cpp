// The emulator console over its socket: screenshots, keys and taps, the window list.
#include <png.h>
#include <sys/socket.h>
#include <sys/un.h>
#include <unistd.h>

#include <string>

#include "aux_fb.h"
#include "gui_harness.h"

using namespace guitest;

namespace {

class Console {
  public:
    Console() {
        fd_ = socket(AF_UNIX, SOCK_STREAM, 0);
        sockaddr_un a{};
        a.sun_family = AF_UNIX;
        snprintf(a.sun_path, sizeof(a.sun_path), "%s", ftx_console_path());
        ok_ = connect(fd_, reinterpret_cast<sockaddr *>(&a), sizeof(a)) == 0;
    }
    ~Console() { close(fd_); }
    bool ok() const { return ok_; }
    // Sends a line; returns every reply line up to and including OK or KO.
    std::string ask(const std::string &line) {
        std::string l = line + "\n";
        if (write(fd_, l.data(), l.size()) != static_cast<ssize_t>(l.size())) return "";
        std::string got;
        char c;
        size_t lineStart = 0;
        while (read(fd_, &c, 1) == 1) {
            got += c;
            if (c != '\n') continue;
            std::string last = got.substr(lineStart);
            if (last == "OK\n" || last.rfind("KO", 0) == 0) break;
            lineStart = got.size();
        }
        return got;
    }

  private:
    int fd_ = -1;
    bool ok_ = false;
};

std::mutex g_seenLock;
std::vector<std::pair<UINT, WPARAM>> g_seen;

int see_key(void *, HWND, UINT msg, WPARAM wp, LPARAM) {
    std::lock_guard<std::mutex> lk(g_seenLock);
    g_seen.emplace_back(msg, wp);
    return HOOK_GOON;
}

int see_mouse(void *, HWND, UINT msg, WPARAM, LPARAM lp) {
    std::lock_guard<std::mutex> lk(g_seenLock);
    g_seen.emplace_back(msg, lp);
    return HOOK_GOON;
}

}  // namespace

namespace {

// A PNG read back as RGB bytes; empty when it cannot be read.
struct Rgb {
    png_uint_32 width = 0, height = 0;
    std::vector<png_byte> bytes;
};
Rgb read_rgb(const std::string &file) {
    Rgb out;
    png_image img{};
    img.version = PNG_IMAGE_VERSION;
    if (png_image_begin_read_from_file(&img, file.c_str()) == 0) return out;
    img.format = PNG_FORMAT_RGB;
    out.bytes.resize(PNG_IMAGE_SIZE(img));
    if (png_image_finish_read(&img, nullptr, out.bytes.data(), 0, nullptr) == 0) {
        out.bytes.clear();
        return out;
    }
    out.width = img.width;
    out.height = img.height;
    return out;
}

}  // namespace

TEST(Console, ScreenshotIsTheFramebuffer) {
    GuiThread gui;
    ASSERT_TRUE(idle());
    gui.run([&] {
        HDC hdc = GetClientDC(gui.hwnd());
        for (int i = 0; i < 16; i++) {
            SetBrushColor(hdc, static_cast<gal_pixel>(0x102030 * (i + 1)) & 0xFFFFFF);
            FillBox(hdc, i * 30, i * 50, 30, 50);
        }
        SetTextColor(hdc, 0xFFFFFF);
        TextOut(hdc, 20, 400, "screenshot");
        ReleaseDC(hdc);
    });
    Console con;
    ASSERT_TRUE(con.ok()) << ftx_console_path();
    std::string file = GuiEnvironment::root_->host("/shot.png");
    EXPECT_EQ(con.ask("screenshot " + file), file + "\nOK\n");

    const Rgb shot = read_rgb(file);
    ASSERT_FALSE(shot.bytes.empty());
    ASSERT_EQ(shot.width, static_cast<png_uint_32>(kW));
    ASSERT_EQ(shot.height, static_cast<png_uint_32>(kH));
    const std::vector<png_byte> &rgb = shot.bytes;
    int w, h, differ = 0;
    ftx_gui_lock_framebuffer();
    const Uint32 *fb = ftx_gui_framebuffer(&w, &h);
    for (size_t i = 0; i < static_cast<size_t>(w) * h; i++) {
        Uint32 px =
            (static_cast<Uint32>(rgb[i * 3]) << 16) | (rgb[i * 3 + 1] << 8) | rgb[i * 3 + 2];
        if (px != fb[i]) differ++;
    }
    ftx_gui_unlock_framebuffer();
    EXPECT_EQ(differ, 0);

    // A panel switched off records black.
    GuiEnvironment::root_->write("/sys/class/graphics/fb0/blank", "4\n");
    EXPECT_EQ(con.ask("screenshot " + file), file + "\nOK\n");
    GuiEnvironment::root_->write("/sys/class/graphics/fb0/blank", "0\n");
    const std::vector<png_byte> black = read_rgb(file).bytes;
    ASSERT_FALSE(black.empty());
    EXPECT_EQ(std::count(black.begin(), black.end(), 0), static_cast<long>(black.size()));
    EXPECT_NE(con.ask("screen").find("blank 0\n"), std::string::npos);
}

TEST(Console, KeysAndTapsGoThroughTheHooksToTheActiveWindow) {
    log().clear();
    GuiThread gui;
    ASSERT_TRUE(idle());
    MSGHOOK oldKey = RegisterKeyMsgHook(nullptr, see_key);
    MSGHOOK oldMouse = RegisterMouseMsgHook(nullptr, see_mouse);
    Console con;
    EXPECT_EQ(con.ask("key press 60"), "OK\n");
    EXPECT_EQ(con.ask("key down fail"), "OK\n");
    EXPECT_EQ(con.ask("tap 30 40"), "OK\n");
    EXPECT_EQ(con.ask("idle"), "OK\n");
    RegisterKeyMsgHook(nullptr, oldKey);
    RegisterMouseMsgHook(nullptr, oldMouse);
    {
        std::lock_guard<std::mutex> lk(g_seenLock);
        std::vector<std::pair<UINT, WPARAM>> want = {{MSG_KEYDOWN, 60},
                                                     {MSG_KEYUP, 60},
                                                     {MSG_KEYDOWN, 61},
                                                     {MSG_LBUTTONDOWN, MAKELONG(30, 40)},
                                                     {MSG_LBUTTONUP, MAKELONG(30, 40)}};
        EXPECT_EQ(g_seen, want);
        g_seen.clear();
    }
    EXPECT_EQ(log().of(gui.hwnd(), MSG_KEYDOWN).size(), 2u);
    EXPECT_EQ(log().of(gui.hwnd(), MSG_KEYUP).size(), 1u);
    ASSERT_EQ(log().of(gui.hwnd(), MSG_LBUTTONUP).size(), 1u);
    EXPECT_EQ(log().of(gui.hwnd(), MSG_LBUTTONUP)[0].lp, MAKELONG(30, 40));
}

TEST(Console, GesturesDeliverEveryPointOfTheWayInOrder) {
    log().clear();
    GuiThread gui;
    ASSERT_TRUE(idle());
    Console con;
    EXPECT_EQ(con.ask("swipe 10 10 50 10 4"), "OK\n");
    // Without steps a path moves at most 8 pixels at a time.
    EXPECT_EQ(con.ask("path 0,0 0,16   8,16"), "OK\n");
    EXPECT_EQ(con.ask("idle"), "OK\n");
    std::vector<LPARAM> got;
    for (const Rec &m : log().all())
        if (m.hwnd != gui.hwnd())
            continue;
        else if (m.msg == MSG_LBUTTONDOWN || m.msg == MSG_MOUSEMOVE || m.msg == MSG_LBUTTONUP)
            got.push_back(m.msg == MSG_MOUSEMOVE ? m.lp : -m.lp - 1);
    auto at = [](int x, int y) { return static_cast<LPARAM>(MAKELONG(x, y)); };
    auto edge = [](int x, int y) { return -static_cast<LPARAM>(MAKELONG(x, y)) - 1; };
    const std::vector<LPARAM> want = {edge(10, 10), at(20, 10),   at(30, 10), at(40, 10),
                                      at(50, 10),   edge(50, 10), edge(0, 0), at(0, 8),
                                      at(0, 16),    at(8, 16),    edge(8, 16)};
    EXPECT_EQ(got, want);
    EXPECT_EQ(con.ask("path 1,1"), "KO usage: path X,Y X,Y [X,Y ...]\n");
    EXPECT_EQ(con.ask("path 1,1 2"), "KO bad point (X,Y)\n");
    EXPECT_EQ(con.ask("path 1,1 2,-2"), "KO bad point (X,Y)\n");
    EXPECT_EQ(con.ask("swipe 1 2 3"), "KO usage: swipe X1 Y1 X2 Y2 [STEPS]\n");
    EXPECT_EQ(con.ask("swipe 1 2 3 4 0"), "KO bad step count\n");
    EXPECT_EQ(con.ask("swipe 1 1 9999 1"), "KO outside the screen\n");
    std::string many = "path";
    for (int i = 0; i <= 512; i++)
        many += " 1,1";
    EXPECT_EQ(con.ask(many), "KO too many points\n");
}

TEST(Console, ATrackingWindowGetsTheTouchesUntilItIsGivenBack) {
    GuiThread below(RECT{0, 0, kW, kH}, "below");
    GuiThread above(RECT{0, 100, kW, 700}, "above");
    ASSERT_TRUE(idle());
    log().clear();
    const UINT track = 248;
    EXPECT_EQ(0, SendMessage(HWND_DESKTOP, track, reinterpret_cast<WPARAM>(above.hwnd()), 0));
    Console con;
    EXPECT_EQ(con.ask("tap 10 50"), "OK\n");  // over the lower window only
    EXPECT_EQ(con.ask("idle"), "OK\n");
    EXPECT_EQ(1u, log().of(above.hwnd(), MSG_LBUTTONDOWN).size());
    EXPECT_EQ(0u, log().of(below.hwnd(), MSG_LBUTTONDOWN).size());
    // The answer is the window that tracked before: handing it back ends the tracking.
    EXPECT_EQ(reinterpret_cast<LRESULT>(above.hwnd()), SendMessage(HWND_DESKTOP, track, 0, 0));
    EXPECT_EQ(con.ask("tap 10 50"), "OK\n");
    EXPECT_EQ(con.ask("idle"), "OK\n");
    EXPECT_EQ(1u, log().of(below.hwnd(), MSG_LBUTTONDOWN).size());
}

TEST(Console, WindowsListsTheStackTopFirst) {
    GuiThread below(RECT{0, 0, kW, kH}, "below");
    GuiThread above(RECT{0, 100, kW, 700}, "above");
    ASSERT_TRUE(idle());
    Console con;
    std::string out = con.ask("windows");
    char a[64], b[64];
    snprintf(a, sizeof(a), "%p active=1 visible=1", above.hwnd());
    snprintf(b, sizeof(b), "%p active=0 visible=1", below.hwnd());
    size_t pa = out.find(a), pb = out.find(b);
    ASSERT_NE(pa, std::string::npos) << out;
    ASSERT_NE(pb, std::string::npos) << out;
    EXPECT_LT(pa, pb);
    EXPECT_NE(out.find("caption=\"above\""), std::string::npos);
    EXPECT_EQ(out.substr(out.size() - 3), "OK\n");
}

TEST(Console, RequestsAreCheckedBeforeAnythingHappens) {
    Console con;
    EXPECT_EQ(con.ask("hw battery level 50"), "KO no hardware\n");
    EXPECT_EQ(con.ask("frobnicate"), "KO unknown command (try help)\n");
    EXPECT_EQ(con.ask("key press"), "KO usage: key down|up|press CODE\n");
    EXPECT_EQ(con.ask("key press banana"), "KO bad key code\n");
    EXPECT_EQ(con.ask("key press volume-up"), "OK\n");
    EXPECT_EQ(con.ask("tap 10"), "KO usage: tap X Y\n");
    EXPECT_EQ(con.ask("tap -1 10"), "KO bad coordinates\n");
    EXPECT_EQ(con.ask("tap 10 5000"), "KO outside the screen\n");
    EXPECT_EQ(con.ask("touch slide 1 1"), "KO usage: touch down|move|up X Y\n");
    EXPECT_EQ(con.ask("windows please"), "KO no arguments expected\n");
    EXPECT_EQ(con.ask(""), "KO empty line\n");
    EXPECT_EQ(con.ask("screen\r").substr(0, 12), "size 480x800");
    std::string help = con.ask("help");
    for (const char *cmd : {"key ", "touch ", "tap ", "swipe ", "path ", "screenshot ", "windows",
                            "screen", "hw ", "help", "camera", "volume-down"})
        EXPECT_NE(help.find(cmd), std::string::npos) << cmd;
    EXPECT_EQ(con.ask(std::string(5000, 'x')), "KO line too long\n");
    EXPECT_EQ(con.ask("screen").substr(0, 4), "size") << "the connection survives a bad line";
}

TEST(Console, TheAuxiliaryDisplayIsDarkUntilItsProgramPaintsIt) {
    Console con;
    ASSERT_TRUE(con.ok());
    const TempRoot &root = *GuiEnvironment::root_;
    root.write("/sim/fb1", "");  // not a frame: the display counts as never painted
    std::string screen = con.ask("screen");
    EXPECT_NE(screen.find("\naux size 240x320\naux off\n"), std::string::npos) << screen;
    const std::string file = root.host("/aux.png");
    EXPECT_EQ(con.ask("screenshot --aux " + file), file + "\nOK\n");
    const Rgb dark = read_rgb(file);
    EXPECT_EQ(dark.width, 240u);
    EXPECT_EQ(dark.height, 320u);
    EXPECT_EQ(std::count(dark.bytes.begin(), dark.bytes.end(), 0), (long)dark.bytes.size());

    // A painted frame, read back pixel for pixel.
    ftxhost::AuxFrame f = ftxhost::aux_fb_plain(4, 3, true, 0x00FF00);
    f.pixels[5] = 0x123456;
    ASSERT_EQ(0, ftxhost::aux_fb_write(root.host("/sim/fb1"), f));
    EXPECT_NE(con.ask("screen").find("aux size 4x3\naux on\n"), std::string::npos);
    EXPECT_EQ(con.ask("screenshot --aux " + file), file + "\nOK\n");
    const std::vector<png_byte> rgb = read_rgb(file).bytes;
    ASSERT_EQ(rgb.size(), 4u * 3 * 3);
    EXPECT_EQ(rgb[0 * 3 + 1], 0xFF);
    EXPECT_EQ(rgb[5 * 3], 0x12);
    EXPECT_EQ(rgb[5 * 3 + 1], 0x34);
    EXPECT_EQ(rgb[5 * 3 + 2], 0x56);

    EXPECT_EQ(con.ask("screenshot --aux"), "KO usage: screenshot [--aux] FILE.png\n");
    EXPECT_EQ(con.ask("screenshot --main x.png"), "KO usage: screenshot [--aux] FILE.png\n");
}

TEST(Console, ReplyIsCutToTheBufferButKeepsItsStatus) {
    char small[8];
    EXPECT_EQ(ftx_console_execute("help", small, sizeof(small)), 0);
    EXPECT_EQ(std::string(small).substr(std::string(small).size() - 3), "OK\n");
    char tiny[4];
    EXPECT_EQ(ftx_console_execute("nope", tiny, sizeof(tiny)), -1);
    EXPECT_STREQ(tiny, "KO\n");
}

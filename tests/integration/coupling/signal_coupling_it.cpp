// The real ftx-mmi, headless: the signalling coupling test from the main menu's coupling row.
// The library and its operations must be there and the modem must initialise, or no window
// opens; the worker's switches end online or on the failure text; the back key waits for a
// switch in progress and the library is uninitialised and closed with the window; nothing
// is left behind after many rounds.
#include <stdio.h>

#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "support/handset.h"
#include "support/text.h"

using namespace handset;

namespace {

namespace fs = std::filesystem;

const double kScale = 0.1;
// The window's timer period (100 ticks of 10 ms) and the worker's pause, scaled.
const int kTimerMs = static_cast<int>(1000 * kScale);
const int kSettleMs = static_cast<int>(2000 * kScale);

const char kOpened[] = "mmi_SignalCouplingTestEntry the window is open";
const char kClosed[] = "MSG_CLOSE uninit done, lib_dvk_signalcoupling.so closed";
const char kLoadFail[] =
    "E SIGNAL_COUPLING: mmi_SignalCouplingTestEntry::SIGNAL_COUPLING_LOAD_LIB Fail.";
const char kLibrary[] = "lib_dvk_signalcoupling.so";

std::string state_line(int state) {
    return "Set_Modem_online_mode modem state " + std::to_string(state);
}
std::string painted(int state) {
    return "MSG_PAINT modem state " + std::to_string(state);
}
std::string timer_saw(int state) {
    return "MSG_TIMER modem state " + std::to_string(state);
}
std::string switched(int mode, int rc) {
    return "FTX_API_SignalCoupling_setModemMode(" + std::to_string(mode) +
           ") ret=" + std::to_string(rc);
}

// Milliseconds of the day of the first log line holding text after from (threadtime:
// "MM-DD HH:MM:SS.mmm ..."), -1 when there is none.
long line_ms(const std::string &log, const std::string &text, size_t from = 0) {
    size_t at = log.find(text, from);
    if (at == std::string::npos) return -1;
    size_t start = log.rfind('\n', at);
    start = start == std::string::npos ? 0 : start + 1;
    int h = 0, m = 0, s = 0, ms = 0;
    if (sscanf(log.c_str() + start, "%*d-%*d %d:%d:%d.%d", &h, &m, &s, &ms) != 4) return -1;
    return ((h * 60L + m) * 60L + s) * 1000L + ms;
}

// The lines in this order in log from `from` on.
bool in_order(const std::string &log, const std::vector<std::string> &lines, size_t from) {
    for (const std::string &l : lines) {
        size_t p = log.find(l, from);
        if (p == std::string::npos) {
            ADD_FAILURE() << "missing or out of order: " << l;
            return false;
        }
        from = p + l.size();
    }
    return true;
}

// Whether the process has the library mapped (open).
bool library_mapped(const DeviceUnderTest &dut) {
    std::ifstream maps("/proc/" + std::to_string(dut.pid()) + "/maps");
    const std::string all((std::istreambuf_iterator<char>(maps)), std::istreambuf_iterator<char>());
    return has(all, kLibrary);
}

// The handle of the window in front: the coupling window has no caption, as the main
// window, and covers the same rectangle, so the handle tells them apart.
std::string active_window(const DeviceUnderTest &dut) {
    const std::string w = dut.console("windows");
    const size_t a = w.find(" active=1 ");
    if (a == std::string::npos) return "";
    const size_t start = w.rfind('\n', a);
    return w.substr(start == std::string::npos ? 0 : start + 1,
                    a - (start == std::string::npos ? 0 : start + 1));
}

// Columns of the window's text box (x from w/8 to w/8 + 3w/4 of 720) that hold text, between
// the window's top strip and the soft-key bar, on the background beside the box.
int ink_in_box(const Png &p) {
    const std::vector<int> ink = p.inkColumns(120, 1150, 20, 600);
    int n = 0;
    for (int x = 90; x < 630; x++)
        n += ink[(size_t)x];
    return n;
}
std::vector<int> box_ink(const Png &p) {
    std::vector<int> ink = p.inkColumns(120, 1150, 20, 600);
    return std::vector<int>(ink.begin() + 90, ink.begin() + 630);
}

class SignalCoupling : public ::testing::Test {
  protected:
    Handset h{{}, kScale};

    void start() {
        ASSERT_TRUE(h.start());
        menu_ = active_window(h.dut);
        ASSERT_NE("", menu_);
    }
    bool inFront(bool menu) {
        return dut_wait_until([&] { return (active_window(h.dut) == menu_) == menu; }, 5000);
    }
    std::string status() { return h.dut.console("hw status"); }
    bool hwOk(const std::string &line) { return h.dut.consoleOk("hw " + line); }
    bool mapped() { return library_mapped(h.dut); }
    // The main menu's coupling row (row 3): the menu keeps its cursor on it afterwards.
    void choose() {
        ASSERT_TRUE(inFront(true));
        if (!onRow_)
            for (int i = 0; i < 3; i++)
                h.key(108);
        onRow_ = true;
        h.key(28);
    }
    // Opens the window: true once it is open (the entry said so, and it is in front).
    bool open() {
        const size_t n = h.dut.logCount(kOpened);
        choose();
        return h.dut.waitLogCount(kOpened, n + 1) && inFront(false);
    }
    // The back key; true once the window is closed and the library with it.
    bool back() {
        const size_t n = h.dut.logCount(kClosed);
        h.key(kBack);
        return h.dut.waitLogCount(kClosed, n + 1) && inFront(true);
    }
    // The worker ends in state for the (n+1)th time and the window's timer sees it.
    bool ends(int state, size_t n) {
        return h.dut.waitLogCount(state_line(state), n + 1) &&
               h.dut.waitLogCount(timer_saw(state), n + 1);
    }

    static constexpr int kBack = 61;  // the right soft key
    std::string menu_;                // the main window's handle
    bool onRow_ = false;
};

// Each way the entry refuses: the log says why, and no window opens with the library left
// mapped.
TEST(SignalCouplingEntry, MissingLibraryOperationOrInitOpenNoWindow) {
    struct Case {
        const char *name;
        const char *variant;  // "" the full library, "broken" an unloadable one
        const char *hwLine;   // "" none
        std::vector<std::string> lines;
        const char *notLogged;
    };
    const Case cases[] = {
        {"missing library",
         "broken",
         "",
         {"E SIGNAL_COUPLING: FATAL ERROR: could not dlopen lib_dvk_signalcoupling.so: ",
          kLoadFail},
         "could not dlsym"},
        {"no init",
         "no_coupling_init",
         "",
         {"E SIGNAL_COUPLING: FATAL ERROR: could not dlsym FTX_API_SignalCoupling_init", kLoadFail},
         "FTX_API_SignalCoupling_init Fail"},
        {"no uninit",
         "no_coupling_uninit",
         "",
         {"E SIGNAL_COUPLING: FATAL ERROR: could not dlsym FTX_API_SignalCoupling_uninit",
          kLoadFail},
         "could not dlsym FTX_API_SignalCoupling_init"},
        {"no setModemMode",
         "no_coupling_setmode",
         "",
         {"E SIGNAL_COUPLING: FATAL ERROR: could not dlsym FTX_API_SignalCoupling_setModemMode",
          kLoadFail},
         "could not dlsym FTX_API_SignalCoupling_uninit"},
        {"init fails",
         "",
         "modem init fail",
         {"E SIGNAL_COUPLING: mmi_SignalCouplingTestEntry::FTX_API_SignalCoupling_init Fail, "
          "ret=-1."},
         "SIGNAL_COUPLING_LOAD_LIB Fail"},
    };
    for (const Case &c : cases) {
        SCOPED_TRACE(c.name);
        Handset h{{}, kScale};
        const std::string lib = DeviceUnderTest::buildDir() + "/lib";
        if (std::string(c.variant) == "broken") {
            // An empty file of the library's name comes first on the library path.
            fs::create_directories(h.dut.root() + "/brokenlibs");
            h.dut.write(std::string("/brokenlibs/") + kLibrary, "");
            h.dut.setEnv("LD_LIBRARY_PATH", h.dut.root() + "/brokenlibs:" + lib);
        } else if (c.variant[0] != '\0') {
            h.dut.setEnv("LD_LIBRARY_PATH", lib + "/variants/" + c.variant + ":" + lib);
        }
        ASSERT_TRUE(h.start());
        const std::string menu = active_window(h.dut);
        if (c.hwLine[0] != '\0') {
            ASSERT_TRUE(h.dut.consoleOk(std::string("hw ") + c.hwLine));
        }
        for (int i = 0; i < 3; i++)
            h.key(108);
        h.key(28);
        ASSERT_TRUE(h.dut.waitLog(c.lines.back()));
        const std::string log = h.dut.logcat();
        EXPECT_TRUE(in_order(log, c.lines, 0));
        EXPECT_FALSE(has(log, c.notLogged));
        EXPECT_FALSE(has(log, kOpened));
        EXPECT_EQ(menu, active_window(h.dut));
        // (The initialisation's failure is logged before the library is closed.)
        EXPECT_TRUE(dut_wait_until([&] { return !library_mapped(h.dut); }, 5000))
            << "the library is closed again";
        const std::string st = h.dut.console("hw status");
        EXPECT_FALSE(has(st, "FTX_API_SignalCoupling_setModemMode")) << st;
        EXPECT_FALSE(has(st, "modem: initialised")) << st;
    }
}

// A switch that succeeds: the note of the switching state, then, one timer period at most
// after the worker is done, the note of the online state, with the back key's label.
TEST_F(SignalCoupling, SuccessfulSwitchShowsTheOnlineNote) {
    start();
    // A switch that lasts until the console shortens it.
    ASSERT_TRUE(hwOk("modem delay 3600000"));
    ASSERT_TRUE(open());
    ASSERT_TRUE(dut_wait_until([&] { return has(status(), "switching=lowpower"); }, 5000));
    ASSERT_TRUE(h.dut.waitLog(painted(0)));
    const Png switching = h.shotWhen(
        "coupling_switching.png", [](const Png &p) { return ink_in_box(p) > 50 && fail_label(p); });
    const size_t from = h.dut.logcat().size();
    ASSERT_TRUE(hwOk("modem delay 20"));
    ASSERT_TRUE(ends(1, 0));
    const Png online = h.shotWhen("coupling_online.png", [&](const Png &p) {
        return ink_in_box(p) > 50 && box_ink(p) != box_ink(switching);
    });
    h.keepForDocs("coupling_online.png", "signal_coupling.png");
    EXPECT_TRUE(fail_label(online)) << "the back key's label";
    EXPECT_FALSE(pass_label(online));

    const std::string log = h.dut.logcat();
    EXPECT_TRUE(in_order(
        log, {switched(5, 0), switched(4, 0), state_line(1), timer_saw(1), painted(1)}, from));
    const long done = line_ms(log, state_line(1), from);
    const long shown = line_ms(log, timer_saw(1), from);
    ASSERT_GE(done, 0);
    ASSERT_GE(shown, done);
    EXPECT_LE(shown - done, 2 * kTimerMs) << "repainted within a timer period";
    EXPECT_TRUE(has(status(), "modem: initialised mode=online"));
    ASSERT_TRUE(back());
}

// The worker's roads: the switches it makes and the state it ends in, for each way the modem
// answers; a failure shows the fixed failure text.
TEST_F(SignalCoupling, EachModemAnswerEndsInItsState) {
    struct Case {
        const char *name;
        std::vector<std::string> hwLines;
        std::vector<std::string> switches;
        int state;
        long minWaitMs;  // from the first switch to the end
    };
    const Case cases[] = {
        {"online refused", {"modem online fail"}, {switched(5, 0), switched(4, -1)}, 2, 0},
        {"low-power refused for good",
         {"modem lowpower fail"},
         {switched(5, -1), switched(4, 0), switched(5, -1)},
         2,
         0},
        {"low-power refused once",
         {"modem lowpower fail 1"},
         {switched(5, -1), switched(4, 0), switched(5, 0), switched(4, 0)},
         1,
         2 * kSettleMs},
        {"low-power refused, then online",
         {"modem lowpower fail 1", "modem online fail"},
         {switched(5, -1), switched(4, -1)},
         2,
         0},
    };
    start();
    size_t failures = 0, onlines = 0;
    for (const Case &c : cases) {
        SCOPED_TRACE(c.name);
        ASSERT_TRUE(hwOk("modem lowpower ok") && hwOk("modem online ok"));
        for (const std::string &l : c.hwLines)
            ASSERT_TRUE(hwOk(l));
        const size_t from = h.dut.logcat().size();
        ASSERT_TRUE(open());
        ASSERT_TRUE(ends(c.state, c.state == 2 ? failures++ : onlines++));
        const std::string log = h.dut.logcat();
        std::vector<std::string> lines = c.switches;
        lines.push_back(state_line(c.state));
        EXPECT_TRUE(in_order(log, lines, from));
        // No switch beyond the listed ones.
        size_t switches = 0;
        for (size_t p = log.find("setModemMode(", from); p != std::string::npos;
             p = log.find("setModemMode(", p + 1))
            switches++;
        EXPECT_EQ(c.switches.size(), switches);
        const long first = line_ms(log, c.switches.front(), from);
        const long end = line_ms(log, state_line(c.state), from);
        EXPECT_GE(end - first, c.minWaitMs);
        if (c.state == 2) {
            // The failure text, GBK in the program, is drawn in the box.
            Png p = h.shotWhen("coupling_failed.png",
                               [](const Png &s) { return ink_in_box(s) > 50 && fail_label(s); });
            EXPECT_GT(ink_in_box(p), 50);
        } else {
            EXPECT_TRUE(has(status(), "mode=online"));
        }
        ASSERT_TRUE(back());
    }
}

// The back key during a switch: the window stays until the switch is done, then the library
// is uninitialised and closed with it.
TEST_F(SignalCoupling, BackDuringASwitchWaitsForIt) {
    start();
    ASSERT_TRUE(hwOk("modem delay 3600000"));
    ASSERT_TRUE(open());
    ASSERT_TRUE(dut_wait_until([&] { return has(status(), "switching=lowpower"); }, 5000));
    EXPECT_TRUE(mapped());
    h.key(kBack);
    ASSERT_TRUE(h.dut.waitLog("MSG_CLOSE waiting for the modem switch"));
    std::string st = status();
    EXPECT_TRUE(has(st, "switching=lowpower")) << st;
    EXPECT_FALSE(has(st, "FTX_API_SignalCoupling_uninit")) << "not before the switch ends";
    EXPECT_FALSE(has(h.dut.logcat(), kClosed));

    ASSERT_TRUE(hwOk("modem delay 0"));
    ASSERT_TRUE(h.dut.waitLog(kClosed));
    ASSERT_TRUE(inFront(true));
    const std::string log = h.dut.logcat();
    EXPECT_TRUE(in_order(log,
                         {"MSG_CLOSE waiting for the modem switch", switched(5, 0), switched(4, 0),
                          state_line(1), kClosed},
                         0));
    st = status();
    EXPECT_TRUE(has(st, "FTX_API_SignalCoupling_uninit() x1")) << st;
    EXPECT_TRUE(has(st, "modem: closed mode=online")) << st;
    EXPECT_FALSE(mapped());
}

// Twenty rounds leave as many descriptors and threads as one, and the library unmapped.
TEST_F(SignalCoupling, NothingLeaksOverManyRounds) {
    start();
    const std::string proc = "/proc/" + std::to_string(h.dut.pid());
    auto count = [&](const char *dir) {
        std::error_code ec;
        int n = 0;
        for (fs::directory_iterator it(proc + dir, ec), end; !ec && it != end; it.increment(ec))
            n++;
        return n;
    };
    auto round = [&](int i) {
        ASSERT_TRUE(open());
        ASSERT_TRUE(ends(1, (size_t)i));
        ASSERT_TRUE(back());
    };
    round(0);  // the first opening may allocate for good (fonts, the bars' records)
    const int fds = count("/fd"), threads = count("/task");
    for (int i = 1; i <= 20; i++) {
        SCOPED_TRACE(i);
        round(i);
    }
    EXPECT_TRUE(
        dut_wait_until([&] { return count("/fd") <= fds && count("/task") <= threads; }, 5000))
        << "fds " << fds << " -> " << count("/fd") << ", threads " << threads << " -> "
        << count("/task");
    EXPECT_FALSE(mapped());
    EXPECT_TRUE(has(status(), "FTX_API_SignalCoupling_uninit() x21"));
}

}  // namespace

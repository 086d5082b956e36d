// The real ftx-mmi, headless: what happens to results, settings and the log when the
// device root cannot take them, when writers meet, after a kill, and under a flood of lines.
#include <fcntl.h>
#include <poll.h>
#include <sched.h>
#include <signal.h>
#include <sys/mount.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

#include <gtest/gtest.h>

#include <atomic>
#include <barrier>
#include <chrono>
#include <filesystem>
#include <string>
#include <thread>

#include "support/device_under_test.h"

namespace fs = std::filesystem;

namespace {

const char kSkipExit = 77;

// Makes the root read-only for the child about to exec: as root (which ignores modes) a
// read-only bind mount in a mount namespace of its own, else the folders' modes.
bool make_read_only_in_child(const std::string &root) {
    if (geteuid() != 0) return true;  // the parent took the write bits away
    return unshare(CLONE_NEWNS) == 0 &&
           mount(nullptr, "/", nullptr, MS_REC | MS_PRIVATE, nullptr) == 0 &&
           mount(root.c_str(), root.c_str(), nullptr, MS_BIND | MS_REC, nullptr) == 0 &&
           mount(nullptr, root.c_str(), nullptr, MS_REMOUNT | MS_BIND | MS_RDONLY, nullptr) == 0;
}

struct Ended {
    int status = -1;  // exit status, -1 while still running when time ran out
    std::string err;  // standard error
};

// Runs ftx-mmi on root (read-only when asked) and collects standard error until it ends.
Ended run_mmi(const std::string &root, bool readOnly) {
    if (readOnly && geteuid() != 0) {
        for (const auto &e : fs::recursive_directory_iterator(root))
            if (e.is_directory()) chmod(e.path().c_str(), 0555);
        chmod(root.c_str(), 0555);
    }
    int pipeFd[2];
    Ended out;
    if (pipe(pipeFd) != 0) return out;
    pid_t pid = fork();
    if (pid == 0) {
        close(pipeFd[0]);
        dup2(pipeFd[1], 2);
        if (readOnly && !make_read_only_in_child(root)) _exit(kSkipExit);
        setenv("FTX_ROOT", root.c_str(), 1);
        setenv("FTX_DISPLAY", "headless", 1);
        setenv("FTX_PC_PORT", "1", 1);
        setenv("LD_LIBRARY_PATH", (DeviceUnderTest::buildDir() + "/lib").c_str(), 1);
        std::string exe = DeviceUnderTest::buildDir() + "/bin/ftx-mmi";
        execl(exe.c_str(), "ftx-mmi", static_cast<char *>(nullptr));
        _exit(127);
    }
    close(pipeFd[1]);
    auto end = std::chrono::steady_clock::now() + std::chrono::seconds(10);
    char buf[4096];
    for (;;) {
        int left = static_cast<int>(std::chrono::duration_cast<std::chrono::milliseconds>(
                                        end - std::chrono::steady_clock::now())
                                        .count());
        pollfd p{pipeFd[0], POLLIN, 0};
        if (left <= 0 || poll(&p, 1, left) <= 0) break;
        ssize_t n = read(pipeFd[0], buf, sizeof(buf));
        if (n <= 0) break;  // the program ended (or closed its error output)
        out.err.append(buf, static_cast<size_t>(n));
    }
    close(pipeFd[0]);
    int st = 0;
    bool ended = dut_wait_until([&] { return waitpid(pid, &st, WNOHANG) == pid; }, 2000);
    if (!ended) {
        kill(pid, SIGKILL);
        waitpid(pid, &st, 0);
        return out;
    }
    out.status = WIFEXITED(st) ? WEXITSTATUS(st) : 128 + WTERMSIG(st);
    return out;
}

TEST(DeviceRoot, ARootThatTakesNoWritesDoesNotStart) {
    {
        DeviceUnderTest dut;
        Ended e = run_mmi(dut.root(), true);
        chmod(dut.root().c_str(), 0755);  // so that the root can be removed
        for (const auto &f : fs::recursive_directory_iterator(dut.root()))
            if (f.is_directory()) chmod(f.path().c_str(), 0755);
        if (e.status == kSkipExit) GTEST_SKIP() << "no read-only mount possible here";
        EXPECT_EQ(1, e.status) << e.err;
        EXPECT_NE(std::string::npos,
                  e.err.find("ftx: the device root " + dut.root() + " cannot be written"))
            << e.err;
        bool reason = e.err.find("Read-only file system") != std::string::npos ||
                      e.err.find("Permission denied") != std::string::npos;
        EXPECT_TRUE(reason) << e.err;
        EXPECT_FALSE(dut.exists("/run/console.sock")) << "the program went on";
    }
    {
        // A file where the root folder should be.
        DeviceUnderTest dut;
        std::string file = dut.root() + "/plain";
        dut.write("/plain", "x");
        Ended e = run_mmi(file, false);
        EXPECT_EQ(1, e.status) << e.err;
        EXPECT_NE(std::string::npos, e.err.find(file + ": Not a directory")) << e.err;
    }
}

// Item 5 is byte 1, bits 5-4: 0x10 pass, 0x20 fail.
TEST(Results, AStoreThatFailsIsAnsweredDoneAndLoggedAsAnError) {
    DeviceUnderTest dut;
    ASSERT_TRUE(dut.startToMenu());
    // A folder in the area file's place: every store of the library fails.
    dut.remove("/sim/testinfo_flags.bin");
    dut.write("/sim/testinfo_flags.bin/keep", "");
    auto r = dut.pc("testinfoMoudle testItem 5,1,write");
    EXPECT_EQ(0, r.first) << "the answer stays done";
    EXPECT_TRUE(
        dut.waitLog(" E FTX_FLAGS: cannot store the flag area: write "
                    "/sim/testinfo_flags.bin:"));
    EXPECT_TRUE(
        dut.waitLog(" E CHECKTESTINFO: mmi_write_testinfo_single_byte::check testinfo "
                    "indexbyte=1,writeval=16,readval=0"));
    EXPECT_EQ((std::pair<int, std::string>{0, "0"}), dut.pc("testinfoMoudle testItem 5,read"));

    // Once the area can be stored again, a write lands and logs no error.
    fs::remove_all(dut.host("/sim/testinfo_flags.bin"));
    size_t errors = dut.logCount(" E CHECKTESTINFO:");
    EXPECT_EQ(0, dut.pc("testinfoMoudle testItem 5,1,write").first);
    EXPECT_EQ((std::pair<int, std::string>{0, "1"}), dut.pc("testinfoMoudle testItem 5,read"));
    EXPECT_EQ(errors, dut.logCount(" E CHECKTESTINFO:"));
}

TEST(Results, ConsoleItemWritesNeverUndoPcResults) {
    DeviceUnderTest dut;
    ASSERT_TRUE(dut.startToMenu());
    // Each round the PC records item 5 while the console sets item 4 of the same byte; when
    // both are done, item 5 must hold the PC's result.
    std::barrier round(2);
    std::atomic<bool> stop{false};
    std::thread console([&] {
        for (int i = 0;; i++) {
            round.arrive_and_wait();
            if (stop) break;
            dut.console("hw flags item 4 " + std::to_string(1 + i % 2));
            round.arrive_and_wait();
        }
    });
    int lost = 0;
    for (int i = 0; i < 100; i++) {
        std::string value = std::to_string(1 + i % 2);
        round.arrive_and_wait();
        EXPECT_EQ(0, dut.pc("testinfoMoudle testItem 5," + value + ",write").first);
        round.arrive_and_wait();
        if (dut.pc("testinfoMoudle testItem 5,read").second != value) lost++;
    }
    stop = true;
    round.arrive_and_wait();
    console.join();
    EXPECT_EQ(0, lost) << "PC results undone by console writes";
}

TEST(Restart, TemporariesOfAKilledRunAreClearedAtStart) {
    DeviceUnderTest dut;
    pid_t ended = fork();
    if (ended == 0) _exit(0);
    waitpid(ended, nullptr, 0);
    std::string area(256, '\0');
    area[1] = 0x10;  // item 5 passed
    dut.write("/sim/testinfo_flags.bin", area);
    const std::string flagsTmp = "/sim/testinfo_flags.bin." + std::to_string(ended) + ".tmp";
    dut.write(flagsTmp, std::string(100, '\xff'));
    const std::string config = dut.read("/etc/ftx_config.ini");
    dut.write("/etc/ftx_config.ini.tmp", config.substr(0, config.size() / 2));

    ASSERT_TRUE(dut.startToMenu());
    EXPECT_TRUE(dut.waitLog(" W FTX_FLAGS: removed " + flagsTmp));
    EXPECT_TRUE(
        dut.waitLog(" W FTX_CONFIG: mmi_config_clear_stale_temporary removed "
                    "/etc/ftx_config.ini.tmp"));
    EXPECT_FALSE(dut.exists(flagsTmp));
    EXPECT_FALSE(dut.exists("/etc/ftx_config.ini.tmp"));
    EXPECT_EQ(config, dut.read("/etc/ftx_config.ini"));
    EXPECT_EQ((std::pair<int, std::string>{0, "1"}), dut.pc("testinfoMoudle testItem 5,read"));
}

TEST(Configuration, AMissingFileIsReportedAtStart) {
    const char kLine[] = "/etc/ftx_config.ini is missing (";
    {
        DeviceUnderTest dut;
        dut.remove("/etc/ftx_config.ini");
        ASSERT_TRUE(dut.startToMenu());
        EXPECT_TRUE(dut.waitLog(std::string(" E FTX_CONFIG: mmi_initconfig ") + kLine + dut.root() +
                                "/etc/ftx_config.ini): built-in defaults apply"));
        std::string err = dut.read("/log/stdout.txt");
        EXPECT_NE(std::string::npos, err.find(std::string("ftx-mmi: ") + kLine)) << err;
    }
    {
        DeviceUnderTest dut;
        ASSERT_TRUE(dut.startToMenu());
        EXPECT_EQ(std::string::npos, dut.logPos("is missing"));
        EXPECT_EQ(std::string::npos, dut.read("/log/stdout.txt").find("is missing"));
    }
}

// The marker line of one read command, and the sizes of the log's files.
std::string read_marker(int item) {
    return "mmi_AutoTest_testinfo_Read::buf_In=" + std::to_string(item) + ",read";
}

TEST(LogRing, APcFloodRotatesTheLogAndTestsStillReadIt) {
    DeviceUnderTest dut;
    dut.setEnv("FTX_LOG_ROTATE_KB", "64");
    dut.setEnv("FTX_LOG_ROTATE_COUNT", "2");
    ASSERT_TRUE(dut.startToMenu());
    ASSERT_EQ(0, dut.pc("testinfoMoudle testItem 7,read").first);
    const std::string base = dut.host("/log/logcat.txt");
    auto flood_until = [&](const std::function<bool()> &done) {
        for (int i = 0; i < 100 && !done(); i++)
            dut.pc("testinfoMoudle testItem 5,read");
        return done();
    };
    auto current_has_marker = [&] {
        return dut.read("/log/logcat.txt").find(read_marker(7)) != std::string::npos;
    };
    // Rotated away from logcat.txt, the line is still found.
    ASSERT_TRUE(flood_until([&] { return !current_has_marker(); }));
    EXPECT_TRUE(fs::exists(base + ".1"));
    EXPECT_TRUE(dut.waitLog(read_marker(7)));
    size_t before = dut.logPos(read_marker(7));
    EXPECT_LT(before, dut.logPos(read_marker(5))) << "older files come first";

    // The ring is bounded: the line drops out, and no more files than asked stay.
    ASSERT_TRUE(flood_until([&] { return dut.logPos(read_marker(7)) == std::string::npos; }));
    EXPECT_TRUE(fs::exists(base + ".2"));
    EXPECT_FALSE(fs::exists(base + ".3"));
    for (const char *suffix : {"", ".1", ".2"}) {
        std::string f = base + suffix;
        EXPECT_LE(fs::file_size(f), 64u * 1024) << f;
        std::string text = dut.read(std::string("/log/logcat.txt") + suffix);
        EXPECT_EQ('\n', text.back()) << "an entry cut at a rotation in " << f;
    }
    EXPECT_TRUE(dut.running());
}

TEST(LogRing, TheFloorDecidesWhatAReadCommandLogs) {
    for (const char *floor : {"", "D", "W"}) {
        SCOPED_TRACE(floor);
        DeviceUnderTest dut;
        if (*floor != '\0') dut.setEnv("FTX_LOG_LEVEL", floor);
        ASSERT_TRUE(dut.startToMenu());
        size_t from = dut.logcat().size();
        ASSERT_EQ(0, dut.pc("testinfoMoudle testItem 5,read").first);
        // The reply is sent after the handler's lines are written.
        std::string added = dut.logcat().substr(from);
        bool debug = added.find(read_marker(5)) != std::string::npos;
        EXPECT_EQ(std::string(floor) != "W", debug) << added.size() << " bytes added";
        if (std::string(floor) == "W") {
            EXPECT_EQ(std::string::npos, added.find(" D "));
        }
    }
}

}  // namespace

// The factory library's model: the persistent flag area, console lines and callbacks.
#include <signal.h>
#include <sys/wait.h>
#include <unistd.h>

#include <atomic>
#include <barrier>
#include <chrono>
#include <filesystem>
#include <condition_variable>
#include <mutex>
#include <string>
#include <thread>
#include <vector>

#include <gtest/gtest.h>

#include "ftx_host.h"
#include "hw/lib_dvk_signalcoupling.h"
#include "hw/lib_factory.h"
#include "support/temp_root.h"
#include "unit/config/log_capture.h"
#include "support/hw_line.h"

namespace {

const bool kFastTime = setenv("FTX_TIME_SCALE", "0.01", 1) == 0;

unsigned char flag_byte(int index) {
    unsigned char flags[FTX_TESTINFO_FLAGS_SIZE];
    EXPECT_EQ(ftx_api_GetTestInfoFlag(flags), 0);
    return flags[index];
}

// Collects callback events delivered on the library's thread.
struct Events {
    std::mutex lock;
    std::condition_variable cv;
    std::vector<std::pair<int, std::string>> got;
    std::thread::id thread;

    bool wait_for(size_t n) {
        std::unique_lock<std::mutex> lk(lock);
        return cv.wait_for(lk, std::chrono::seconds(5), [&] { return got.size() >= n; });
    }
};
Events *g_events = nullptr;

void collect(module_data *d) {
    std::lock_guard<std::mutex> lk(g_events->lock);
    g_events->got.emplace_back(d->datatype,
                               d->data != nullptr ? std::string(d->data, d->totallen) : "");
    g_events->thread = std::this_thread::get_id();
    g_events->cv.notify_all();
}

class FactoryModel : public ::testing::Test {
  protected:
    void SetUp() override {
        ASSERT_TRUE(kFastTime);
        root_.write("/sim/device.ini",
                    "[identity]\nimei=861234567890123\nimei2=861234567890131\npsn=PSN42\n"
                    "barcode=BOARD-7\nsw_internal=INT_9\nram=3GB\n");
        g_events = &events_;
    }
    void TearDown() override { g_events = nullptr; }
    TempRoot root_;
    Events events_;
};

TEST_F(FactoryModel, FlagBytesPersistAcrossProcesses) {
    EXPECT_EQ(flag_byte(0), 0) << "a fresh root reads as an all-zero area";
    pid_t child = fork();
    if (child == 0) {
        // Another run of the handset writes and ends.
        _exit(ftx_api_WriteFuncTestInfoFlags(1, 0x10) == 0 &&
                      ftx_api_WriteFuncTestInfoFlags(255, 0xAB) == 0
                  ? 0
                  : 1);
    }
    int status = 0;
    ASSERT_EQ(waitpid(child, &status, 0), child);
    ASSERT_EQ(WEXITSTATUS(status), 0);
    EXPECT_EQ(flag_byte(1), 0x10);
    EXPECT_EQ(flag_byte(255), 0xAB);
    unsigned char one = 0;
    EXPECT_EQ(ftx_api_ReadFuncTestInfoFlags(1, &one), 0);
    EXPECT_EQ(one, 0x10);
    EXPECT_NE(ftx_api_WriteFuncTestInfoFlags(256, 1), 0);
    EXPECT_NE(ftx_api_ReadFuncTestInfoFlags(-1, &one), 0);
    EXPECT_EQ(root_.read("/sim/testinfo_flags.bin").size(), 256u);
}

TEST_F(FactoryModel, KilledWriterLeavesAWholeArea) {
    ASSERT_EQ(ftx_api_WriteFuncTestInfoFlags(0, 0x40), 0);
    for (int round = 0; round < 5; ++round) {
        pid_t child = fork();
        if (child == 0) {
            for (int i = 0;; ++i)
                ftx_api_WriteFuncTestInfoFlags(1 + i % 99, static_cast<unsigned char>(i));
        }
        std::this_thread::sleep_for(std::chrono::milliseconds(20 + round * 7));
        kill(child, SIGKILL);
        waitpid(child, nullptr, 0);
        EXPECT_EQ(root_.read("/sim/testinfo_flags.bin").size(), 256u);
        EXPECT_EQ(flag_byte(0), 0x40) << "bytes no writer touched survive every kill";
    }
}

TEST_F(FactoryModel, ConsoleLinesDriveTheFlagArea) {
    int rc;
    hw("flags item 5 2", &rc);
    EXPECT_EQ(rc, 0);
    EXPECT_EQ(flag_byte(1), 0x20) << "item 5 is byte 1, bits 5-4";
    EXPECT_NE(hw("flags").find("000: 00 20 00"), std::string::npos);
    hw("flags set 16 255", &rc);
    EXPECT_EQ(rc, 0);
    EXPECT_EQ(hw("flags item 64"), "item 64 = 3\n");
    hw("flags clear");
    EXPECT_EQ(flag_byte(16), 0);
    hw("flags item 400 1", &rc);
    EXPECT_EQ(rc, 1);
    hw("flags set 3 256", &rc);
    EXPECT_EQ(rc, 1);
}

TEST_F(FactoryModel, ConsoleItemWritesNeverUndoOtherWriters) {
    // One thread per item of byte 1, all writing at once, round after round; between
    // rounds each checks that its item holds what it wrote. A console item is set under the
    // area's lock. A library writer, as the application writing a PC result, reads the area
    // and writes the whole byte, which may undo anyone (the handset's interface allows
    // that), so with one in the game only its own item is checked.
    auto item_of = [](int item) { return (flag_byte(1) >> ((3 - item % 4) * 2)) & 3; };
    auto run = [&](int libraryItem) {
        std::atomic<int> lost{0};
        std::barrier round(4);
        std::vector<std::thread> threads;
        for (int item = 4; item < 8; item++) {
            threads.emplace_back([&, item] {
                int shift = (3 - item % 4) * 2;
                for (int i = 0; i < 15; i++) {
                    int value = 1 + (i + item) % 2;
                    if (item != libraryItem) {
                        hw("flags item " + std::to_string(item) + " " + std::to_string(value));
                    } else {
                        unsigned char flags[FTX_TESTINFO_FLAGS_SIZE];
                        ftx_api_GetTestInfoFlag(flags);
                        unsigned char b = flags[1];
                        b = static_cast<unsigned char>((b & ~(3 << shift)) | (value << shift));
                        ftx_api_WriteFuncTestInfoFlags(1, b);
                    }
                    round.arrive_and_wait();
                    bool checked = libraryItem < 0 || item == libraryItem;
                    if (checked && item_of(item) != value) lost++;
                    round.arrive_and_wait();
                }
            });
        }
        for (auto &t : threads)
            t.join();
        return lost.load();
    };
    EXPECT_EQ(0, run(-1)) << "console writes undid each other";
    EXPECT_EQ(0, run(6)) << "a console write undid a result written through the library";
}

TEST_F(FactoryModel, StartClearsTheTemporariesOfEndedWriters) {
    pid_t ended = fork();
    if (ended == 0) _exit(0);
    waitpid(ended, nullptr, 0);
    auto tmp = [](long pid) { return "/sim/testinfo_flags.bin." + std::to_string(pid) + ".tmp"; };
    const std::string dead = tmp(ended), mine = tmp(getpid()), live = tmp(1);
    for (const std::string &f : {dead, mine, live, std::string("/sim/testinfo_flags.bin.x.tmp")})
        root_.write(f, "half");
    ASSERT_EQ(0, ftx_api_WriteFuncTestInfoFlags(3, 0x40));
    EXPECT_FALSE(root_.exists(mine)) << "a store replaces its own temporary";
    root_.write(mine, "half");

    ftx_api_ftx_mode_init(0);
    EXPECT_FALSE(root_.exists(dead));
    EXPECT_FALSE(root_.exists(mine)) << "nothing of this process writes at its start";
    EXPECT_TRUE(root_.exists(live)) << "a running writer keeps its temporary";
    EXPECT_TRUE(root_.exists("/sim/testinfo_flags.bin.x.tmp")) << "not a writer's name";
    EXPECT_EQ(flag_byte(3), 0x40);
}

TEST_F(FactoryModel, AFailedStoreIsAnErrorAndKeepsNoTemporary) {
    ASSERT_EQ(0, ftx_api_WriteFuncTestInfoFlags(0, 0x40));
    // A folder in the file's place: every rename over it fails.
    std::filesystem::remove(root_.host("/sim/testinfo_flags.bin"));
    root_.write("/sim/testinfo_flags.bin/keep", "");
    LogCapture log;
    EXPECT_NE(0, ftx_api_WriteFuncTestInfoFlags(1, 0x10));
    EXPECT_TRUE(log.has("E FTX_FLAGS: cannot store the flag area: write /sim/testinfo_flags.bin:"));
    int rc = 0;
    EXPECT_EQ("cannot write the flag area", hw("flags item 5 1", &rc));
    EXPECT_EQ(1, rc);
    hw("flags clear", &rc);
    EXPECT_EQ(1, rc);
    EXPECT_EQ(flag_byte(1), 0);
    for (const auto &e : std::filesystem::directory_iterator(root_.host("/sim")))
        EXPECT_NE(".tmp", e.path().extension()) << e.path();
}

TEST_F(FactoryModel, ForcedAnswersAndStatus) {
    char buf[64];
    EXPECT_EQ(ftx_api_GetPSN(buf, sizeof(buf)), 0);
    EXPECT_STREQ(buf, "PSN42");
    EXPECT_EQ(ftx_api_GetBoardNum(buf, 4), 0);
    EXPECT_STREQ(buf, "BOA") << "identity texts are cut to the caller's size";
    EXPECT_EQ(ftx_api_GetSoftVersion(FTX_SOFTVERSION_INTERNAL, buf, sizeof(buf)), 0);
    EXPECT_STREQ(buf, "INT_9");

    int rc;
    hw("set ftx_api_Vibrator_Test_Start -5", &rc);
    EXPECT_EQ(rc, 0);
    EXPECT_EQ(ftx_api_Vibrator_Test_Start(1000), -5);
    hw("set ftx_api_Vibrator_Test_Start default");
    EXPECT_EQ(ftx_api_Vibrator_Test_Start(15000), 0);
    EXPECT_NE(hw("status").find("ftx_api_Vibrator_Test_Start(ms=15000)"), std::string::npos);

    hw("set ftx_api_WriteFuncTestInfoFlags 1");
    EXPECT_NE(ftx_api_WriteFuncTestInfoFlags(2, 0x55), 0);
    hw("set ftx_api_WriteFuncTestInfoFlags default");
    EXPECT_EQ(flag_byte(2), 0) << "a forced write failure stores nothing";

    std::string reply = hw("no-such-word 1", &rc);
    EXPECT_EQ(rc, -1);
    EXPECT_EQ(reply, "no hardware");
    reply = hw("headset 7", &rc);
    EXPECT_EQ(rc, 1);
    EXPECT_NE(reply.find("usage: headset"), std::string::npos);
    EXPECT_NE(hw("help").find("battery level"), std::string::npos) << "every library's words";
}

TEST_F(FactoryModel, TestInfoArrivesOnTheLibraryThread) {
    ASSERT_EQ(ftx_api_Get_TestInfo(collect), 0);
    ASSERT_TRUE(events_.wait_for(4));
    EXPECT_EQ(events_.got[0],
              std::make_pair(FTX_DATATYPE_TESTINFO_IMEI, std::string("861234567890123")));
    EXPECT_EQ(events_.got[2].second, "PSN42");
    EXPECT_EQ(events_.got[3].first, FTX_DATATYPE_TESTINFO_END);
    EXPECT_NE(events_.thread, std::this_thread::get_id());

    events_.got.clear();
    hw("testinfo off");
    ftx_api_Get_TestInfo(collect);
    std::this_thread::sleep_for(std::chrono::milliseconds(50));
    EXPECT_TRUE(events_.got.empty());
    hw("testinfo on");
}

TEST_F(FactoryModel, HeadsetTouchAndPcbaEvents) {
    hw("headset 2");
    ASSERT_EQ(ftx_api_Audio_Loopback_Test_Start(2, 2, "", collect), 0);
    ASSERT_TRUE(events_.wait_for(1));
    EXPECT_EQ(events_.got[0], std::make_pair(FTX_DATATYPE_HEADSET, std::string("2")));
    hw("headset 0");
    ASSERT_TRUE(events_.wait_for(2)) << "a change reaches a running loopback";
    EXPECT_EQ(events_.got[1].second, "0");
    ftx_api_Audio_Loopback_Test_Stop(2, 2);
    hw("headset 1");
    EXPECT_EQ(ftx_api_GetHeadsetState(), 1);

    hw("tp verdict 513 4,4,1,2,3");
    ftx_api_tpd_SelfTest_Start(collect);
    ASSERT_TRUE(events_.wait_for(3));
    EXPECT_EQ(events_.got[2], std::make_pair(0x201, std::string("4,4,1,2,3")));
    hw("tp verdict 0");

    ftx_api_RegisterModuleCallback("TPHARDWARE", collect);
    hw("tp status 3");
    ftx_api_GetModuleStatus("TPHARDWARE");
    ASSERT_TRUE(events_.wait_for(4));
    EXPECT_EQ(events_.got[3].first, FTX_DATATYPE_TPSTATUS);
    EXPECT_NE(events_.got[3].second.find("0x03"), std::string::npos);

    ftx_api_memory_start(collect);
    ASSERT_TRUE(events_.wait_for(5));
    EXPECT_EQ(events_.got[4], std::make_pair(FTX_DATATYPE_PCBA_MEMORY, std::string("3072,1")));
    hw("reply ftx_api_cpu_start 110 1800000,0");
    ftx_api_cpu_start(collect);
    ASSERT_TRUE(events_.wait_for(6));
    EXPECT_EQ(events_.got[5].second, "1800000,0");
    int rc;
    hw("send ftx_api_cpu_start 110 5,1", &rc);
    EXPECT_EQ(rc, 0);
    ASSERT_TRUE(events_.wait_for(7));
    hw("reply ftx_api_cpu_start default");
}

std::atomic<unsigned> g_hookStatus{99};
void hook_cb(unsigned int *status) {
    g_hookStatus = *status;
}

TEST_F(FactoryModel, HookKeyPressesAreCounted) {
    int rc;
    hw("hook press", &rc);
    EXPECT_EQ(rc, 1) << "no hook test is running";
    ftx_api_HookKeyTest_Start(hook_cb);
    hw("hook press", &rc);
    EXPECT_EQ(rc, 0);
    for (int i = 0; i < 200 && g_hookStatus != 1; ++i)
        std::this_thread::sleep_for(std::chrono::milliseconds(5));
    EXPECT_EQ(g_hookStatus, 1u);
    char reply[16];
    ftx_api_HookKeyTest_Stop(reply, sizeof(reply));
    EXPECT_STREQ(reply, "*1");
}

TEST(SignalCoupling, ModemSwitchesCanBeMadeToFail) {
    ASSERT_TRUE(kFastTime);
    EXPECT_NE(FTX_API_SignalCoupling_setModemMode(FTX_MODEM_MODE_ONLINE), 0) << "not initialised";
    ASSERT_EQ(FTX_API_SignalCoupling_init(), 0);
    EXPECT_EQ(FTX_API_SignalCoupling_setModemMode(FTX_MODEM_MODE_LOW_POWER), 0);
    hw("modem online fail");
    EXPECT_NE(FTX_API_SignalCoupling_setModemMode(FTX_MODEM_MODE_ONLINE), 0);
    EXPECT_NE(hw("status").find("modem: initialised mode=lowpower online-fails"),
              std::string::npos);
    hw("modem online ok");
    EXPECT_EQ(FTX_API_SignalCoupling_setModemMode(FTX_MODEM_MODE_ONLINE), 0);
    EXPECT_NE(FTX_API_SignalCoupling_setModemMode(3), 0);
    FTX_API_SignalCoupling_uninit();
}

}  // namespace

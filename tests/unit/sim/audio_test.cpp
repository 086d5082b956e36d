// The factory library's audio routes: what each output plays, heard through its WAV file of
// the device root, driven by the library's operations and "hw" lines.
#include <math.h>
#include <stdint.h>
#include <string.h>

#include <condition_variable>
#include <filesystem>
#include <mutex>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "ftx_host.h"
#include "hw/lib_factory.h"
#include "support/temp_root.h"
#include "support/text.h"
#include "support/hw_line.h"

namespace {

const bool kFastTime = setenv("FTX_TIME_SCALE", "0.01", 1) == 0;
constexpr int kRate = 16000;
constexpr size_t kClip = 2 * kRate;

using Samples = std::vector<int16_t>;

// A WAV file's bytes: the canonical header, then the samples.
std::string wav(const Samples &s, int rate = kRate, int channels = 1, int bits = 16) {
    auto le = [](uint32_t v, int n) {
        std::string b;
        for (int i = 0; i < n; ++i)
            b += static_cast<char>((v >> (8 * i)) & 0xff);
        return b;
    };
    const uint32_t bytes = static_cast<uint32_t>(s.size() * 2);
    std::string out = "RIFF" + le(36 + bytes, 4) + "WAVEfmt " + le(16, 4) + le(1, 2) +
                      le(channels, 2) + le(rate, 4) + le(rate * channels * bits / 8, 4) +
                      le(channels * bits / 8, 2) + le(bits, 2) + "data" + le(bytes, 4);
    return out + std::string(reinterpret_cast<const char *>(s.data()), bytes);
}

// The samples of a file the model wrote, after checking its header is 16-bit mono at 16 kHz.
Samples samples_of(const std::string &bytes) {
    if (bytes.size() < 44 || bytes.compare(0, 4, "RIFF") != 0 || bytes.compare(36, 4, "data"))
        return {};
    EXPECT_EQ(bytes.substr(0, 44), wav(Samples((bytes.size() - 44) / 2)).substr(0, 44));
    Samples s((bytes.size() - 44) / 2);
    memcpy(s.data(), bytes.data() + 44, s.size() * 2);
    return s;
}

// The strongest whole frequency (100..5000 Hz) of the first quarter second, by Goertzel's
// recurrence.
int dominant_hz(const Samples &s) {
    const size_t n = std::min<size_t>(s.size(), kRate / 4);
    int best = 0;
    double bestPower = 0;
    for (int f = 100; f <= 5000; ++f) {
        const double c = 2 * cos(2 * M_PI * f / kRate);
        double s1 = 0, s2 = 0;
        for (size_t i = 0; i < n; ++i) {
            const double s0 = s[i] + c * s1 - s2;
            s2 = s1;
            s1 = s0;
        }
        const double power = s1 * s1 + s2 * s2 - c * s1 * s2;
        if (power > bestPower) {
            bestPower = power;
            best = f;
        }
    }
    return best;
}

Samples noise(size_t n, uint32_t seed) {
    Samples s(n);
    for (int16_t &v : s) {
        seed = seed * 1103515245u + 12345u;
        v = static_cast<int16_t>((seed >> 16) & 0xffff);
    }
    return s;
}

// The events of the smart PA calibration.
struct Events {
    std::mutex lock;
    std::condition_variable cv;
    std::vector<std::string> got;
};
Events g_events;

void collect(module_data *d) {
    std::lock_guard<std::mutex> lk(g_events.lock);
    g_events.got.emplace_back(d->data != nullptr ? std::string(d->data, d->totallen) : "");
    g_events.cv.notify_all();
}

std::string next_event() {
    std::unique_lock<std::mutex> lk(g_events.lock);
    g_events.cv.wait_for(lk, std::chrono::seconds(5), [] { return !g_events.got.empty(); });
    std::string e = g_events.got.empty() ? "" : g_events.got.front();
    if (!g_events.got.empty()) g_events.got.erase(g_events.got.begin());
    return e;
}

class SimAudio : public ::testing::Test {
  protected:
    void SetUp() override {
        ASSERT_TRUE(kFastTime);
        hw("headset 1");
        hw("audio reset");
    }
    Samples played(const char *output) const {
        return samples_of(root_.read(std::string("/sim/audio/") + output + ".wav"));
    }
    // Loads a microphone's input from a file of the root.
    std::string load(const Samples &s, const std::string &mic) {
        root_.write("/in.wav", wav(s));
        int rc;
        std::string reply = hw("mic " + root_.host("/in.wav") + " " + mic, &rc);
        EXPECT_EQ(rc, 0) << reply;
        return reply;
    }
    TempRoot root_;
};

TEST_F(SimAudio, EachRingTypePlaysItsToneOnItsOutput) {
    const struct {
        int type, hz;
    } kTones[] = {{0, 1000}, {1, 1500}, {2, 2000}, {3, 800}, {9, 1000}};
    for (const auto &t : kTones) {
        SCOPED_TRACE(t.type);
        ASSERT_EQ(ftx_api_Audio_RingTest_Start(t.type), 0);
        EXPECT_EQ(played("speaker").size(), kClip);
        EXPECT_EQ(dominant_hz(played("speaker")), t.hz);
    }
    EXPECT_TRUE(has(hw("audio"), " ring=9@speaker "));
    ASSERT_EQ(ftx_api_Audio_Receiver_Start(3), 0);
    EXPECT_EQ(dominant_hz(played("receiver")), 800);
    EXPECT_TRUE(has(hw("audio"), " ring=3@receiver ")) << "one ring at a time";
    ASSERT_EQ(ftx_api_Audio_RingTest_Stop(0), 0);
    EXPECT_TRUE(has(hw("audio"), " ring=3@receiver ")) << "the speaker's stop is not its own";
    ASSERT_EQ(ftx_api_Audio_Receiver_Stop(), 0);
    EXPECT_TRUE(has(hw("audio"), " ring=idle "));
    EXPECT_EQ(played("receiver").size(), kClip) << "a stop leaves the file";
    for (const auto &e : std::filesystem::directory_iterator(root_.host("/sim/audio")))
        EXPECT_EQ(".wav", e.path().extension()) << e.path();
}

TEST_F(SimAudio, LoopbacksPlayWhatTheirMicrophoneHears) {
    const Samples in = noise(3 * kRate, 7);
    load(in, "aux1");
    ASSERT_EQ(ftx_api_Audio_Loopback_Test_Start(4, 4, "", nullptr), 0);
    EXPECT_EQ(played("headset"), Samples(in.begin(), in.begin() + kClip)) << "longer is cut";
    EXPECT_TRUE(has(hw("status"), " route=aux1>headset volume=5 "));

    const Samples tail = noise(kRate / 2, 9);  // a shorter input is repeated
    load(tail, "aux1");
    const Samples now = played("headset");
    ASSERT_EQ(now.size(), kClip) << "a new input reaches a running loopback";
    for (size_t i = 0; i < kClip; i += 997)
        ASSERT_EQ(now[i], tail[i % tail.size()]) << i;

    EXPECT_EQ(ftx_api_Audio_Loopback_Test_Stop(4, 1), 0);
    EXPECT_TRUE(has(hw("audio"), " route=aux1>headset ")) << "a stop of another route";
    EXPECT_EQ(ftx_api_Audio_Loopback_Test_Stop(4, 4), 0);
    EXPECT_TRUE(has(hw("audio"), " route=idle volume=- "));
    EXPECT_EQ(ftx_api_Audio_Loopback_Test_Start(3, 4, "", nullptr), -1) << "no microphone 3";
    EXPECT_EQ(ftx_api_Audio_Loopback_Test_Start(1, 8, "", nullptr), -1) << "no output 8";

    // The two-speaker loopback plays the main microphone's default tone on both.
    ASSERT_EQ(ftx_api_Audio_Acoustic_Loopback_Two_Speaker_Test_Start(nullptr), 0);
    EXPECT_EQ(dominant_hz(played("upspeaker")), 440);
    EXPECT_EQ(played("speaker"), played("upspeaker"));
    EXPECT_TRUE(has(hw("audio"), " route=main>speaker,main>upspeaker "));
    ASSERT_EQ(ftx_api_mic2earpiece_start(), 0);
    EXPECT_TRUE(has(hw("audio"), " route=main>receiver ")) << "one loopback at a time";
    ASSERT_EQ(ftx_api_mic2earpiece_stop(), 0);
    EXPECT_TRUE(has(hw("audio"), " route=idle "));
}

TEST_F(SimAudio, VolumeLevelsAreClampedPerRoute) {
    EXPECT_EQ(ftx_api_Audio_GetVolume(1, 2), 5);
    ftx_api_Audio_SetVolume(1, 2, 20);
    ftx_api_Audio_SetVolume(2, 1, -3);
    EXPECT_EQ(ftx_api_Audio_GetVolume(1, 2), 15);
    EXPECT_EQ(ftx_api_Audio_GetVolume(2, 1), 0);
    ASSERT_EQ(ftx_api_Audio_Loopback_Test_Start(1, 2, "", nullptr), 0);
    EXPECT_TRUE(has(hw("status"), " route=main>speaker volume=15 ring="));
    hw("mic tone 300");
    hw("pa fail");
    EXPECT_TRUE(has(hw("audio reset"),
                    "audio: route=idle volume=- ring=idle hifi=off fm=off "
                    "record=none mic=main:440,headset:440,aux1:440,aux2:440 "
                    "pa=8\n"));
    EXPECT_EQ(ftx_api_Audio_GetVolume(1, 2), 5);
}

TEST_F(SimAudio, HiFiNeedsAHeadsetAndFmFallsBackToTheSpeaker) {
    hw("headset 0");
    EXPECT_EQ(ftx_api_Audio_HiFiTest_Start(), -1);
    EXPECT_EQ(ftx_api_Audio_HiFiTest_auto_Start("x"), -1);
    EXPECT_FALSE(root_.exists("/sim/audio/headset.wav"));
    ASSERT_EQ(ftx_api_FM_Test_Start(1017), 0);
    EXPECT_EQ(dominant_hz(played("speaker")), 217);
    EXPECT_TRUE(has(hw("audio"), " hifi=off fm=1017@speaker "));

    hw("headset 1");
    ASSERT_EQ(ftx_api_FM_Test_Start(875), 0);
    EXPECT_EQ(dominant_hz(played("headset")), 1075);
    EXPECT_TRUE(has(hw("audio"), " fm=875@headset ")) << "a new station replaces the old";
    ASSERT_EQ(ftx_api_FM_Test_Stop(), 0);
    ASSERT_EQ(ftx_api_Audio_HiFiTest_Start(), 0);
    EXPECT_EQ(dominant_hz(played("headset")), 3000);
    EXPECT_TRUE(has(hw("audio"), " hifi=on fm=off "));
    ASSERT_EQ(ftx_api_Audio_HiFiTest_Stop(), 0);
    EXPECT_TRUE(has(hw("audio"), " hifi=off "));
}

TEST_F(SimAudio, RecordThenPlayCopiesTheMainMicrophoneToTheSpeaker) {
    EXPECT_EQ(ftx_api_Audio_MainMicRecord_Play(), -1) << "nothing recorded";
    EXPECT_TRUE(has(hw("audio"), " record=none "));
    EXPECT_EQ(ftx_api_Audio_MainMicRecord_Start(0), -1);
    EXPECT_EQ(ftx_api_Audio_MainMicRecord_Start(11), -1);

    const Samples in = noise(3 * kRate, 3);
    load(in, "main");
    ASSERT_EQ(ftx_api_Audio_MainMicRecord_Start(3), 0);
    load(noise(kRate, 5), "main");  // heard after the record: not in it
    ASSERT_EQ(ftx_api_Audio_MainMicRecord_Play(), 0);
    EXPECT_EQ(played("speaker"), Samples(in.begin(), in.begin() + kClip));
    EXPECT_TRUE(has(hw("audio"), " record=3s@speaker "));
    ASSERT_EQ(ftx_api_Audio_MainMicRecord_Stop(), 0);
    EXPECT_TRUE(has(hw("audio"), " record=3s "));

    hw("mic tone 440 main");
    // A recording shorter than the file is padded with silence.
    ASSERT_EQ(ftx_api_Audio_MainMicRecord_Start(1), 0);
    ASSERT_EQ(ftx_api_Audio_MainMicRecord_Play(), 0);
    const Samples out = played("speaker");
    ASSERT_EQ(out.size(), kClip);
    EXPECT_EQ(dominant_hz(out), 440);
    EXPECT_EQ(out[kRate], 0);
    EXPECT_EQ(out.back(), 0);
    ftx_api_Audio_MainMicRecord_Stop();
}

TEST_F(SimAudio, BadMicrophoneInputsAreRefusedWithTheirReason) {
    const Samples s = noise(kRate, 1);
    const struct {
        std::string bytes, reason;
    } kBad[] = {
        {"not audio", "is not a WAV file"},
        {wav(s, 44100), "44100 Hz"},
        {wav(s, kRate, 2), "not 16-bit PCM mono"},
        {wav(s, kRate, 1, 8), "not 16-bit PCM mono"},
        {wav({}), "has no data"},
    };
    for (const auto &b : kBad) {
        SCOPED_TRACE(b.reason);
        root_.write("/bad.wav", b.bytes);
        int rc;
        EXPECT_TRUE(has(hw("mic " + root_.host("/bad.wav"), &rc), b.reason));
        EXPECT_EQ(rc, 1);
    }
    int rc;
    EXPECT_TRUE(has(hw("mic " + root_.host("/none.wav"), &rc), "cannot open"));
    EXPECT_TRUE(has(hw("mic tone 440 ear", &rc), "no microphone ear"));
    EXPECT_TRUE(has(hw("mic tone 8000", &rc), "tone of 1 to 7999 Hz"));
    EXPECT_TRUE(has(hw("audio"), " mic=main:440,headset:440,aux1:440,aux2:440 "))
        << "a refused input changes nothing";
    hw("mic tone 1234 aux2");
    EXPECT_TRUE(has(hw("audio"), ",aux2:1234 "));
}

TEST_F(SimAudio, SmartPaCalibrationAnswersTheConsolesImpedance) {
    const struct {
        const char *line, *event;
    } kCases[] = {{"pa 6", "result=pass;value=6"},
                  {"pa fail", "result=fail;value=0"},
                  {"pa 8", "result=pass;value=8"}};
    for (const auto &c : kCases) {
        int rc;
        hw(c.line, &rc);
        ASSERT_EQ(rc, 0) << c.line;
        ASSERT_EQ(ftx_api_SmartPACalibrate_Start(collect), 0);
        EXPECT_EQ(next_event(), c.event);
    }
    int rc;
    hw("pa 0", &rc);
    EXPECT_EQ(rc, 1);
}

}  // namespace

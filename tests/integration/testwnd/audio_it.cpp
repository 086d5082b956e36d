// The real ftx-mmi, headless: the loopback windows with the simulated headset, the PC's
// audio routes with the loop each close stops, the ring tone and the record played into the
// simulated outputs' WAV files, the FM stations and the speaker calibration.
#include <math.h>
#include <stdint.h>

#include <fstream>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "support/handset.h"
#include "support/text.h"

using namespace handset;

namespace {

// 16-bit mono samples of a WAV file (empty when it cannot be read).
std::vector<int16_t> wav_samples(const std::string &path) {
    std::ifstream in(path, std::ios::binary);
    std::vector<char> bytes((std::istreambuf_iterator<char>(in)), std::istreambuf_iterator<char>());
    std::vector<int16_t> out;
    // Walk the chunks to "data".
    size_t pos = 12;
    while (pos + 8 <= bytes.size()) {
        const std::string id(&bytes[pos], 4);
        uint32_t len;
        memcpy(&len, &bytes[pos + 4], 4);
        if (id == "data") {
            const size_t n = std::min<size_t>(len, bytes.size() - pos - 8) / 2;
            out.resize(n);
            memcpy(out.data(), &bytes[pos + 8], n * 2);
            return out;
        }
        pos += 8 + len + (len & 1);
    }
    return out;
}

void write_wav(const std::string &path, const std::vector<int16_t> &s) {
    std::ofstream out(path, std::ios::binary);
    auto u32 = [&](uint32_t v) { out.write(reinterpret_cast<const char *>(&v), 4); };
    auto u16 = [&](uint16_t v) { out.write(reinterpret_cast<const char *>(&v), 2); };
    const uint32_t data = (uint32_t)(s.size() * 2);
    out.write("RIFF", 4);
    u32(36 + data);
    out.write("WAVEfmt ", 8);
    u32(16);
    u16(1);
    u16(1);
    u32(16000);
    u32(32000);
    u16(2);
    u16(16);
    out.write("data", 4);
    u32(data);
    out.write(reinterpret_cast<const char *>(s.data()), (std::streamsize)data);
}

// The strongest frequency (10 Hz steps, 100..5000 Hz) of the first quarter second.
int dominant_hz(const std::vector<int16_t> &s) {
    const size_t n = std::min<size_t>(s.size(), 4000);
    int best = 0;
    double bestPower = 0;
    for (int f = 100; f <= 5000; f += 10) {
        double re = 0, im = 0;
        for (size_t i = 0; i < n; i++) {
            const double a = 2 * M_PI * f * (double)i / 16000.0;
            re += s[i] * cos(a);
            im += s[i] * sin(a);
        }
        if (re * re + im * im > bestPower) {
            bestPower = re * re + im * im;
            best = f;
        }
    }
    return best;
}

// The status lines of the loopback calls.
std::string loopback_calls(const std::string &status) {
    std::string out, line;
    for (char c : status) {
        if (c != '\n') {
            line += c;
            continue;
        }
        if (has(line, "Loopback_Test_")) out += line + "\n";
        line.clear();
    }
    return out;
}

struct Member {
    const char *domain;
    int mic, out, resultItem;
};

const Member kMembers[] = {
    {"FTX_AUDIO_MIC_HEADSET_LOOPBACK", 1, 4, 136},
    {"FTX_AUDIO_AUXILIARYMIC1_HEADSET_LOOPBACK", 4, 4, 140},
    {"FTX_AUDIO_AUXILIARYMIC2_HEADSET_LOOPBACK", 8, 4, 142},
    {"FTX_AUDIO_HEADSET_RECEIVER_LOOPBACK", 2, 1, 144},
    {"FTX_AUDIO_HEADSET_SPEAKER_LOOPBACK", 2, 2, 148},
    {"FTX_HEADSET_LOOPBACK", 2, 4, 304},
};

std::string started(int mic, int out) {
    return "ftx_api_Audio_Loopback_Test_Start(" + std::to_string(mic) + "," + std::to_string(out) +
           ",";
}

// The note area of a loopback window on 720x1280.
int note_pixels(const Png &p, bool (*colour)(int, int, int)) {
    return p.count(90, 60, 630, 200, colour);
}

}  // namespace

TEST(Loopback, EachMemberRoutesItsCodesFollowsTheHeadsetAndRecordsItsItem) {
    for (const Member &m : kMembers) {
        SCOPED_TRACE(m.domain);
        Handset h({{m.domain, 1, 0, 1}, kCards});
        ASSERT_TRUE(h.start());
        ASSERT_TRUE(h.dut.waitChannel());
        ASSERT_TRUE(h.dut.consoleOk("hw headset 2"));
        h.openDeviceList();
        h.chooseRow(0);  // the full run: the item alone
        const std::string tag = std::string(m.domain) + ": ";
        ASSERT_TRUE(h.dut.waitLog(tag + m.domain + "::headset status=2"));
        EXPECT_TRUE(has(h.dut.console("hw status"), started(m.mic, m.out)));
        // Without a microphone: the red note and no pass key, which does nothing.
        Png noMic = h.shotWhen("nomic.png", [](const Png &p) { return note_pixels(p, red) > 50; });
        EXPECT_FALSE(pass_label(noMic));
        h.key(60);
        ASSERT_TRUE(h.dut.consoleOk("idle"));  // the refused key is handled before the headset
        ASSERT_TRUE(h.dut.consoleOk("hw headset 1"));
        Png in = h.shotWhen("inserted.png", [](const Png &p) {
            return note_pixels(p, green) > 50 && pass_label(p);
        });
        if (m.resultItem == 148) h.keepForDocs("inserted.png", "loopback_headset.png");
        ASSERT_TRUE(h.dut.consoleOk("hw headset 0"));
        h.shotWhen("removed.png",
                   [](const Png &p) { return note_pixels(p, red) > 50 && !pass_label(p); });
        ASSERT_TRUE(h.dut.consoleOk("hw headset 1"));
        h.shotWhen("again.png", pass_label);
        h.key(60);
        ASSERT_TRUE(h.dut.waitLog(kCardsOpened));
        EXPECT_EQ(1, h.result(m.resultItem));
        EXPECT_TRUE(has(h.dut.console("hw status"), "ftx_api_Audio_Loopback_Test_Stop(" +
                                                        std::to_string(m.mic) + "," +
                                                        std::to_string(m.out) + ")"));
    }
}

TEST(Loopback, MainLoopVolumeKeysStepTheLevelAndStopAtZero) {
    Handset h({{"FTX_AUDIO_LOOPBACK", 1, 0, 1}});
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.dut.waitChannel());
    ASSERT_TRUE(h.fromList(4, "CAMERA WIN"));
    EXPECT_TRUE(has(h.dut.console("hw status"), started(1, 1)));
    h.shotWhen("main.png", pass_label);  // no headset needed
    h.key(103);
    ASSERT_TRUE(h.dut.waitLog("mainmic-receiver KEY_UP get vol=5"));
    for (int i = 0; i < 8; i++)
        h.key(108);
    ASSERT_TRUE(h.dut.waitLog("mainmic-receiver KEY_DOWN get vol=1"));
    ASSERT_TRUE(h.dut.waitLogCount("mainmic-receiver KEY_DOWN get vol=0", 2));
    // Six steps down from 6, then none: the level stays at 0.
    EXPECT_TRUE(has(h.dut.console("hw status"), "ftx_api_Audio_SetVolume(1,1,0) x7"));
    EXPECT_TRUE(has(h.dut.console("hw audio"), "volume=0"));
    h.key(61);
    EXPECT_TRUE(h.waitActive("Device Test"));
}

TEST(Loopback, TwoSpeakersOpenTheWindowTwiceAndOnlyTheSecondPassRecords) {
    Handset h({{"FTX_AUDIO_HEADSET_SPEAKER_LOOPBACK", 1, 0, 1}, kCards});
    h.dut.setConfig("FTX_AUDIO_HEADSET_SPEAKER_LOOPBACK", "parameter", "TwoSpeaker:1;Volume:7");
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.dut.waitChannel());
    h.openDeviceList();
    h.chooseRow(0);
    ASSERT_TRUE(h.dut.waitLog("iTwoSpeaker = 1 , Volume = 7"));
    h.shotWhen("upper.png", pass_label);
    EXPECT_TRUE(has(h.dut.console("hw status"), started(2, 160) + "7,"));
    h.key(60);
    ASSERT_TRUE(
        dut_wait_until([&] { return has(h.dut.console("hw status"), started(2, 2)); }, 5000));
    EXPECT_EQ(0, h.result(148));
    h.shotWhen("lower.png", pass_label);
    h.key(60);
    ASSERT_TRUE(h.dut.waitLog(kCardsOpened));
    EXPECT_EQ(1, h.result(148));
}

TEST(AudioPc, EachStartRoutesItsLoopAndCloseStopsTheStoredOne) {
    Handset h({});
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.dut.waitChannel());
    const struct {
        const char *word;
        int mic, out;
    } kLoops[] = {{"HeadsetHeadset", 2, 4},         {"HeadsetSpeaker", 2, 2},
                  {"HeadsetReceiver", 2, 1},        {"MicroHeadset", 1, 4},
                  {"AuxiliaryMicroHeadset1", 4, 4}, {"AuxiliaryMicroHeadset2", 8, 4}};
    for (const auto &l : kLoops) {
        SCOPED_TRACE(l.word);
        ASSERT_EQ(0, h.dut.pc(std::string("audioMoudle testItem ") + l.word).first);
        // An empty argument reaches the library as an empty text.
        EXPECT_TRUE(has(h.dut.console("hw status"), started(l.mic, l.out) + ",cb="));
        EXPECT_FALSE(has(h.dut.console("hw audio"), "route=idle"));
        EXPECT_EQ(0, h.dut.pc("audioMoudle testItem close").first);
        EXPECT_TRUE(has(h.dut.console("hw status"), "ftx_api_Audio_Loopback_Test_Stop(" +
                                                        std::to_string(l.mic) + "," +
                                                        std::to_string(l.out) + ")"));
        EXPECT_TRUE(has(h.dut.console("hw audio"), "route=idle"));
    }

    // MicroSpeaker starts nothing and its close stops nothing.
    const std::string before = loopback_calls(h.dut.console("hw status"));
    EXPECT_EQ(2, h.dut.pc("audioMoudle testItem MicroSpeaker").first);
    EXPECT_EQ(0, h.dut.pc("audioMoudle testItem close").first);
    ASSERT_TRUE(h.dut.waitLog("AutoTest_audioloop_Stop::audio loop=7"));
    EXPECT_EQ(before, loopback_calls(h.dut.console("hw status")));

    // HeadsetRecSpeaker plays on the upper speaker, but its close is the receiver loop's.
    ASSERT_EQ(0, h.dut.pc("audioMoudle testItem HeadsetRecSpeaker").first);
    EXPECT_TRUE(has(h.dut.console("hw audio"), "route=headset>upspeaker"));
    EXPECT_EQ(0, h.dut.pc("audioMoudle testItem close").first);
    EXPECT_TRUE(has(h.dut.console("hw status"), "ftx_api_Audio_Loopback_Test_Stop(2,1) x7"));
    EXPECT_TRUE(has(h.dut.console("hw audio"), "route=headset>upspeaker"));  // still playing
}

TEST(AudioPc, TheSpeakerRingPlaysItsTypesToneAndTheRecordPlaysWhatTheMicHeard) {
    Handset h({{"FTX_RINGTONE", 1, 0, 1}});
    h.dut.setConfig("FTX_RINGTONE", "parameter", "RingType:1");
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.dut.waitChannel());
    const std::string speaker = h.dut.host("/sim/audio/speaker.wav");
    ASSERT_EQ(0, h.dut.pc("audioMoudle testItem openSpeaker").first);
    EXPECT_EQ(1500, dominant_hz(wav_samples(speaker)));
    EXPECT_EQ(0, h.dut.pc("audioMoudle testItem close").first);
    EXPECT_TRUE(has(h.dut.console("hw status"), "ftx_api_Audio_RingTest_Stop(arg=1) x1"));
    // The PCBA run's single tone.
    EXPECT_EQ(0, h.dut.pc("RingPCBA testItem start").first);
    EXPECT_EQ(2000, dominant_hz(wav_samples(speaker)));
    EXPECT_EQ(0, h.dut.pc("RingPCBA testItem stop").first);

    // A noise the microphone hears comes back on the speaker.
    std::vector<int16_t> noise(48000);
    uint32_t x = 12345;
    for (int16_t &v : noise) {
        x = x * 1103515245u + 12345u;
        v = (int16_t)((x >> 16) & 0x7fff) - 16384;
    }
    const std::string input = h.dut.root() + "/noise.wav";
    write_wav(input, noise);
    ASSERT_TRUE(h.dut.consoleOk("hw mic " + input + " main"));
    ASSERT_EQ(0, h.dut.pc("audioMoudle testItem openMicro").first);
    const std::vector<int16_t> played = wav_samples(speaker);
    ASSERT_EQ(32000u, played.size());
    EXPECT_TRUE(std::equal(played.begin(), played.end(), noise.begin()));
    EXPECT_EQ(0, h.dut.pc("audioMoudle testItem close").first);
    EXPECT_TRUE(has(h.dut.console("hw status"), "ftx_api_Audio_MainMicRecord_Stop() x1"));
}

TEST(AudioPc, HiFiNeedsAHeadsetAndTheCalibrationAnswersTheImpedance) {
    Handset h({});
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.dut.waitChannel());
    ASSERT_TRUE(h.dut.consoleOk("hw headset 0"));
    EXPECT_EQ(2, h.dut.pc("audioMoudle testItem HiFi").first);
    ASSERT_TRUE(h.dut.consoleOk("hw headset 1"));
    EXPECT_EQ(0, h.dut.pc("audioMoudle testItem HiFi").first);
    EXPECT_EQ(3000, dominant_hz(wav_samples(h.dut.host("/sim/audio/headset.wav"))));
    EXPECT_EQ(0, h.dut.pc("hifiaudioMoudle testItem close").first);

    ASSERT_TRUE(h.dut.consoleOk("hw pa 6"));
    ASSERT_EQ(0, h.dut.pc("SpeakerCalibrateMoudle testItem open").first);
    auto cal = h.dut.pc("SpeakerCalibrateMoudle testItem calibrate");
    EXPECT_EQ(0, cal.first);
    EXPECT_EQ("*6", cal.second);
    EXPECT_EQ(0, h.dut.pc("SpeakerCalibrateMoudle testItem close").first);
    ASSERT_TRUE(h.dut.consoleOk("hw pa fail"));
    ASSERT_EQ(0, h.dut.pc("SpeakerCalibrateMoudle testItem open").first);
    EXPECT_EQ(2, h.dut.pc("SpeakerCalibrateMoudle testItem calibrate").first);
}

TEST(FmTest, TheVolumeKeysTuneTheConfiguredStationsInOrder) {
    Handset h({{"FTX_FM", 1, 0, 1}, kCards});
    h.dut.setConfig("FTX_FM", "parameter", "SetFMFreq:875/Jazz,1017,1080/News");
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.dut.waitChannel());
    h.openDeviceList();
    h.chooseRow(0);
    ASSERT_TRUE(h.waitActive("FM Test"));
    h.shotWhen("fm.png", pass_label);
    EXPECT_TRUE(has(h.dut.console("hw audio"), "fm=875@"));
    h.key(108);
    h.key(108);
    h.key(108);  // round to the first
    ASSERT_TRUE(h.dut.waitLog("ftx_api_FM_Test_Start(875) Jazz"));
    const size_t mid = h.dut.logPos("ftx_api_FM_Test_Start(1017) 101.7 MHz");
    const size_t news = h.dut.logPos("ftx_api_FM_Test_Start(1080) News");
    EXPECT_LT(mid, news);
    EXPECT_LT(news, h.dut.logPos("ftx_api_FM_Test_Start(875) Jazz"));
    h.key(108);
    ASSERT_TRUE(h.dut.waitLogCount("ftx_api_FM_Test_Start(1017) 101.7 MHz", 2));
    h.shotWhen("fm.png", pass_label);
    h.keepForDocs("fm.png", "fm_test.png");
    h.key(60);
    ASSERT_TRUE(h.dut.waitLog(kCardsOpened));
    EXPECT_EQ(1, h.result(308));
    // The PC tunes what it is given, or the first station.
    EXPECT_EQ(0, h.dut.pc("FMMoudle testItem 1080").first);
    EXPECT_TRUE(has(h.dut.console("hw audio"), "fm=1080@"));
    EXPECT_EQ(0, h.dut.pc("FMMoudle testItem").first);
    EXPECT_TRUE(has(h.dut.console("hw audio"), "fm=875@"));
    EXPECT_EQ(0, h.dut.pc("FMMoudle testItem close").first);
}

TEST(AudioWindows, EachToneWindowPlaysOpensInARunAndRecordsItsItem) {
    const struct {
        const char *domain, *caption, *wav;
        int hz, resultItem;
        const char *parameter;
    } kWindows[] = {
        {"FTX_RINGTONE", "Ringtone Test", "speaker", 1000, 296, nullptr},
        {"FTX_RTUP", "Ringtone Up Test", "speaker", 800, 296, "RingType:3"},
        {"FTX_RTDOWN", "Ringtone Down Test", "speaker", 1500, 296, "RingType:1"},
        {"FTX_RECEIVER", "Receiver Test", "receiver", 2000, 298, "RingType:2"},
        {"FTX_HIFI", "CAMERA WIN", "headset", 3000, 368, nullptr},
        {"FTX_AUDIO_MAINMICRECORD", "MainMic Record Test", "speaker", 440, -1, nullptr},
        {"FTX_SMARTPACAL", "SmartPA Calibration", nullptr, 0, 300, nullptr},
        {"FTX_AUDIO_LOOPBACK", "Speaker", "upspeaker", 440, 300,
         "AuxiliaryMIC:0;WakeupMIC:0;TwoSpeaker:1"},
    };
    for (const auto &w : kWindows) {
        SCOPED_TRACE(w.domain);
        // An item without a result is opened alone (the card item comes before it in a run).
        const bool run = w.resultItem > 0;
        Handset h = run ? Handset({{w.domain, 1, 0, 1}, kCards}) : Handset({{w.domain, 1, 0, 1}});
        if (w.parameter != nullptr) h.dut.setConfig(w.domain, "parameter", w.parameter);
        ASSERT_TRUE(h.start());
        ASSERT_TRUE(h.dut.waitChannel());
        ASSERT_TRUE(h.fromList(run ? 0 : 4, w.caption));
        h.shotWhen("tone.png", pass_label);
        if (w.wav != nullptr) {
            const std::string wav = h.dut.host(std::string("/sim/audio/") + w.wav + ".wav");
            EXPECT_EQ(w.hz, dominant_hz(wav_samples(wav)));
        }
        h.key(60);
        if (!run) {
            EXPECT_TRUE(h.waitActive("Device Test"));
            continue;
        }
        ASSERT_TRUE(h.dut.waitLog(kCardsOpened));
        EXPECT_EQ(1, h.result(w.resultItem));
    }
}

TEST(AudioWindows, AFailedCalibrationAndHiFiWithoutAHeadsetOfferOnlyFail) {
    Handset h({{"FTX_HIFI", 1, 0, 1}, {"FTX_SMARTPACAL", 1, 0, 1}});
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.dut.waitChannel());
    ASSERT_TRUE(h.dut.consoleOk("hw headset 0"));
    ASSERT_TRUE(h.dut.consoleOk("hw pa fail"));
    ASSERT_TRUE(h.fromList(4, "SmartPA Calibration"));
    ASSERT_TRUE(h.dut.waitLog("result=fail;value=0 result=0"));
    Png pa = h.shotWhen("pa.png", fail_label);
    EXPECT_FALSE(pass_label(pa));
    h.key(61);
    ASSERT_TRUE(h.waitActive("Device Test"));
    h.chooseRow(1);  // HiFi, one row below
    ASSERT_TRUE(h.waitActive("CAMERA WIN"));
    ASSERT_TRUE(h.dut.waitLog("hifi_hook::headset=0"));
    Png hifi = h.shotWhen("hifi.png", fail_label);
    EXPECT_FALSE(pass_label(hifi));
    EXPECT_FALSE(has(h.dut.console("hw audio"), "hifi=on"));
    h.key(60);  // refused
    ASSERT_TRUE(h.dut.consoleOk("idle"));
    EXPECT_EQ("CAMERA WIN", h.activeCaption());
    h.key(61);
    EXPECT_TRUE(h.waitActive("Device Test"));
}

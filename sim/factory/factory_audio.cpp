// Audio area of the factory model: the headset plugged in, the hook key, the events of the
// loopback and amplifier tests, and the audio routes. Each output that starts playing writes
// what it plays (its last two seconds) to a WAV file of the device root,
// /sim/audio/<output>.wav, from a tone or from what a microphone hears (a tone, or a WAV file
// the console loaded), so that a test can listen to the route the application chose.
#include <math.h>
#include <stdint.h>
#include <stdio.h>
#include <string.h>

#include <android/log.h>

#include <iterator>
#include <map>
#include <mutex>
#include <string>
#include <utility>
#include <vector>

#include "devfs.h"
#include "factory_area.h"
#include "sim_wav.h"

namespace ftxsim {
namespace {

const char kTag[] = "FTX_AUDIO";
const char kSimFolder[] = "/sim";
const char kFolder[] = "/sim/audio";

constexpr int kRate = 16000;           // samples a second of every microphone and file
constexpr size_t kClip = 2 * kRate;    // an output's file: two seconds
constexpr int kMaxRecordSeconds = 10;  // of the main-microphone record
constexpr size_t kMaxInput = kMaxRecordSeconds * kRate;  // the most of a file a mic keeps
constexpr double kAmplitude = 12000;                     // of every tone
constexpr int kMicToneHz = 440;                          // what a microphone hears until "hw mic"
constexpr int kHiFiHz = 3000;
constexpr int kFmBaseHz = 200;  // FM: (frequency mod 1000) + 200 Hz
constexpr int kDefaultLevel = 5;
constexpr int kMaxLevel = 15;
constexpr long kDefaultOhms = 8;
constexpr long kMaxOhms = 1000;

using Samples = std::vector<int16_t>;

// Microphones and outputs by the codes the library is given; their index is the model's.
struct Device {
    int code;
    const char *name;
};
constexpr Device kMics[] = {{1, "main"}, {2, "headset"}, {4, "aux1"}, {8, "aux2"}};
constexpr Device kOutputs[] = {{1, "receiver"}, {2, "speaker"}, {4, "headset"}, {160, "upspeaker"}};
constexpr size_t kMicCount = std::size(kMics);
constexpr size_t kOutputCount = std::size(kOutputs);
enum Mic { MAIN, HEADSET_MIC, AUX1, AUX2, CALL_MIC = -1 };
enum Out { RECEIVER, SPEAKER, HEADSET, UPSPEAKER, NO_OUT = -1 };

// The tone of each ring type; any other type rings at kOtherRingHz.
struct RingTone {
    int type;
    int hz;
};
constexpr RingTone kRingTones[] = {{0, 1000}, {1, 1500}, {2, 2000}, {3, 800}};
constexpr int kOtherRingHz = 1000;

enum Kind { LOOP, RING, HIFI, FM, RECORD, PLAYBACK };

// What an audio operation starts and the operation that ends it. A loopback plays what its
// microphone hears; CALL_MIC and a first output NO_OUT take the call's own codes. FM plays
// on the headset, or on the speaker when none is plugged; the record plays nothing.
struct Route {
    const char *start;
    const char *stop;
    Kind kind;
    Mic mic;
    Out outs[2];
};
const Route kRoutes[] = {
    {"ftx_api_Audio_Loopback_Test_Start",
     "ftx_api_Audio_Loopback_Test_Stop",
     LOOP,
     CALL_MIC,
     {NO_OUT, NO_OUT}},
    {"ftx_api_Audio_Acoustic_Loopback_Test_Start",
     "ftx_api_Audio_Acoustic_Loopback_Test_Stop",
     LOOP,
     MAIN,
     {RECEIVER, NO_OUT}},
    {"ftx_api_Audio_Acoustic_Loopback_Speaker_Test_Start",
     "ftx_api_Audio_Acoustic_Loopback_Test_Stop",
     LOOP,
     MAIN,
     {SPEAKER, NO_OUT}},
    {"ftx_api_Audio_Acoustic_Loopback_Two_Speaker_Test_Start",
     "ftx_api_Audio_Acoustic_Loopback_Test_Stop",
     LOOP,
     MAIN,
     {UPSPEAKER, SPEAKER}},
    {"ftx_api_Audio_Acoustic_Loopback_Headset_Test_Start",
     "ftx_api_Audio_Acoustic_Loopback_Headset_Test_Stop",
     LOOP,
     HEADSET_MIC,
     {HEADSET, NO_OUT}},
    {"ftx_api_Audio_Acoustic_Loopback_Auxiliary_MIC_Test_Start",
     "ftx_api_Audio_Acoustic_Loopback_Auxiliary_MIC_Test_Stop",
     LOOP,
     AUX1,
     {RECEIVER, NO_OUT}},
    {"ftx_api_Audio_wakeupMic_on_Start",
     "ftx_api_Audio_wakeupMic_Stop",
     LOOP,
     AUX2,
     {RECEIVER, NO_OUT}},
    {"ftx_api_mic2earpiece_start", "ftx_api_mic2earpiece_stop", LOOP, MAIN, {RECEIVER, NO_OUT}},
    {"ftx_api_auxmic2earpiece_start",
     "ftx_api_auxmic2earpiece_stop",
     LOOP,
     AUX1,
     {RECEIVER, NO_OUT}},
    {"ftx_api_Audio_RingTest_Start", "ftx_api_Audio_RingTest_Stop", RING, MAIN, {SPEAKER, NO_OUT}},
    {"ftx_api_Audio_Receiver_Start", "ftx_api_Audio_Receiver_Stop", RING, MAIN, {RECEIVER, NO_OUT}},
    {"ftx_api_Audio_HiFiTest_Start", "ftx_api_Audio_HiFiTest_Stop", HIFI, MAIN, {HEADSET, NO_OUT}},
    {"ftx_api_Audio_HiFiTest_auto_Start",
     "ftx_api_Audio_HiFiTest_auto_Stop",
     HIFI,
     MAIN,
     {HEADSET, NO_OUT}},
    {"ftx_api_FM_Test_Start", "ftx_api_FM_Test_Stop", FM, MAIN, {HEADSET, SPEAKER}},
    {"ftx_api_Audio_MainMicRecord_Start",
     "ftx_api_Audio_MainMicRecord_Stop",
     RECORD,
     MAIN,
     {NO_OUT, NO_OUT}},
    {"ftx_api_Audio_MainMicRecord_Play",
     "ftx_api_Audio_MainMicRecord_Stop",
     PLAYBACK,
     MAIN,
     {SPEAKER, NO_OUT}},
};

// What a microphone hears: a tone, or the samples of a file (repeated when shorter than
// what is read of it).
struct Input {
    int hz = kMicToneHz;
    Samples clip;  // empty: the tone
};

// What an output plays: the route that started it (null: idle) and its number (a loopback's
// microphone index, a ring type, an FM frequency).
struct Playing {
    const Route *route = nullptr;
    int arg = 0;
};

// What "hw audio reset" restores: every route idle, the default tones, levels and impedance,
// nothing recorded.
struct RouteState {
    Input mics[kMicCount];
    Playing outs[kOutputCount];
    std::map<std::pair<int, int>, int> levels;  // by microphone and output code
    int loopMic = 1, loopOut = 1;               // codes of the loopback started last
    Samples recording;
    long paOhms = kDefaultOhms;
    bool paFails = false;
};

struct Audio : RouteState {
    ftx_api_hookkey_cb hook = nullptr;
    int hookPresses = 0;
    int headset = 1;
};

Audio &audio() {
    return model_part<Audio>();
}

template <size_t N>
int index_of(const Device (&table)[N], int code) {
    for (size_t i = 0; i < N; ++i)
        if (table[i].code == code) return static_cast<int>(i);
    return -1;
}

const Route *route_of(const char *op, bool stop) {
    for (const Route &r : kRoutes)
        if (strcmp(stop ? r.stop : r.start, op) == 0) return &r;
    return nullptr;
}

int ring_hz(int type) {
    for (const RingTone &t : kRingTones)
        if (t.type == type) return t.hz;
    return kOtherRingHz;
}

int fm_hz(int frequency) {
    return (frequency % 1000 + 1000) % 1000 + kFmBaseHz;
}

Samples tone(int hz, size_t n) {
    Samples s(n);
    for (size_t i = 0; i < n; ++i)
        s[i] = static_cast<int16_t>(
            lround(kAmplitude * sin(2 * M_PI * hz * static_cast<double>(i) / kRate)));
    return s;
}

// The first n samples a microphone hears.
Samples hear(const Input &in, size_t n) {
    if (in.clip.empty()) return tone(in.hz, n);
    Samples s(n);
    for (size_t i = 0; i < n; ++i)
        s[i] = in.clip[i % in.clip.size()];
    return s;
}

// ---- WAV files: 16-bit PCM mono at kRate, the canonical 44-byte header ----

void put16(unsigned char *p, unsigned v) {
    p[0] = static_cast<unsigned char>(v & 0xff);
    p[1] = static_cast<unsigned char>((v >> 8) & 0xff);
}
void put32(unsigned char *p, uint32_t v) {
    put16(p, v & 0xffff);
    put16(p + 2, v >> 16);
}

int write_failed(const char *step, const char *path) {
    __android_log_print(ANDROID_LOG_ERROR, kTag, "cannot write %s: %s: %s", path, step,
                        strerror(errno));
    return -1;
}

// Writes s as output's file: beside it first, then renamed over it, so that a reader sees
// the previous file or the whole new one.
int write_wav(const char *output, const Samples &s) {
    char path[64], tmp[80];
    snprintf(path, sizeof(path), "%s/%s.wav", kFolder, output);
    snprintf(tmp, sizeof(tmp), "%s.tmp", path);
    dev_mkdir(kSimFolder, 0755);
    dev_mkdir(kFolder, 0755);
    const uint32_t bytes = static_cast<uint32_t>(s.size() * 2);
    std::vector<unsigned char> buf(44 + bytes);
    unsigned char *h = buf.data();
    memcpy(h, "RIFF", 4);
    put32(h + 4, 36 + bytes);
    memcpy(h + 8, "WAVEfmt ", 8);
    put32(h + 16, 16);
    put16(h + 20, 1);  // PCM
    put16(h + 22, 1);  // mono
    put32(h + 24, kRate);
    put32(h + 28, kRate * 2);
    put16(h + 32, 2);
    put16(h + 34, 16);
    memcpy(h + 36, "data", 4);
    put32(h + 40, bytes);
    for (size_t i = 0; i < s.size(); ++i)
        put16(h + 44 + 2 * i, static_cast<uint16_t>(s[i]));
    FILE *f = dev_fopen(tmp, "wb");
    if (f == nullptr) return write_failed("open", tmp);
    bool ok = fwrite(buf.data(), 1, buf.size(), f) == buf.size();
    ok = fclose(f) == 0 && ok;
    if (!ok || dev_rename(tmp, path) != 0) {
        write_failed(ok ? "rename" : "write", tmp);
        dev_unlink(tmp);
        return -1;
    }
    return 0;
}

// Reads a host WAV file: at most kMaxInput samples, the rest is cut. Returns 0, or -1 with
// the reason in why.
int read_wav(const char *path, Samples *out, std::string *why) {
    FILE *f = fopen(path, "rb");
    if (f == nullptr) {
        *why = std::string("cannot open ") + path + ": " + strerror(errno);
        return -1;
    }
    const int rc = sim_read_wav(f, path, kRate, kMaxInput, out, why);
    fclose(f);
    return rc;
}

// ---- routes (the callers hold model_lock()) ----

// Writes the file of output o from what it plays.
void render(size_t o) {
    const Audio &s = audio();
    const Playing &p = s.outs[o];
    if (p.route == nullptr) return;
    Samples out;
    switch (p.route->kind) {
        case LOOP:
            out = hear(s.mics[p.arg], kClip);
            break;
        case RING:
            out = tone(ring_hz(p.arg), kClip);
            break;
        case HIFI:
            out = tone(kHiFiHz, kClip);
            break;
        case FM:
            out = tone(fm_hz(p.arg), kClip);
            break;
        case PLAYBACK:  // the recording's first seconds, then silence
            out.assign(kClip, 0);
            for (size_t i = 0; i < kClip && i < s.recording.size(); ++i)
                out[i] = s.recording[i];
            break;
        case RECORD:
            return;
    }
    write_wav(kOutputs[o].name, out);
}

// Ends every output playing that kind of sound: one of each kind plays at a time.
void end_kind(Kind kind) {
    for (Playing &p : audio().outs)
        if (p.route != nullptr && p.route->kind == kind) p = Playing{};
}

void start(const Route &r, int arg, int out) {
    Audio &s = audio();
    Out outs[2] = {r.outs[0], r.outs[1]};
    if (r.kind == RECORD) {
        if (arg < 1 || arg > kMaxRecordSeconds) return;
        s.recording = hear(s.mics[MAIN], static_cast<size_t>(arg) * kRate);
        return;
    }
    if (r.kind == LOOP && r.mic == CALL_MIC) {
        const int mic = index_of(kMics, arg), o = index_of(kOutputs, out);
        if (mic < 0 || o < 0) return;  // a forced answer: no such route to play
        arg = mic;
        outs[0] = static_cast<Out>(o);
    } else if (r.kind == LOOP) {
        arg = r.mic;
    }
    if (r.kind == FM && s.headset == 0) outs[0] = r.outs[1];
    if (r.kind == FM) outs[1] = NO_OUT;
    end_kind(r.kind);
    for (Out o : outs) {
        if (o == NO_OUT) continue;
        s.outs[o] = Playing{&r, arg};
        render(o);
    }
    if (r.kind == LOOP) {
        s.loopMic = kMics[arg].code;
        s.loopOut = kOutputs[outs[0]].code;
    }
}

// Ends what the stop operation op ends; a loopback stop given codes ends only that route.
void stop(const char *op, int mic, int out) {
    Audio &s = audio();
    for (size_t o = 0; o < kOutputCount; ++o) {
        Playing &p = s.outs[o];
        if (p.route == nullptr || strcmp(p.route->stop, op) != 0) continue;
        if (p.route->mic == CALL_MIC && (kMics[p.arg].code != mic || kOutputs[o].code != out))
            continue;
        p = Playing{};
    }
}

int level(int mic, int out) {
    auto it = audio().levels.find({mic, out});
    return it != audio().levels.end() ? it->second : kDefaultLevel;
}

// The output playing kind, or -1.
int playing(Kind kind) {
    for (size_t o = 0; o < kOutputCount; ++o)
        if (audio().outs[o].route != nullptr && audio().outs[o].route->kind == kind)
            return static_cast<int>(o);
    return -1;
}

// The routes' fields of "hw status" and "hw audio".
void routes(Reply &r) {
    const Audio &s = audio();
    r.add(" route=");
    const char *sep = "";
    for (size_t o = 0; o < kOutputCount; ++o) {
        const Playing &p = s.outs[o];
        if (p.route == nullptr || p.route->kind != LOOP) continue;
        r.add("%s%s>%s", sep, kMics[p.arg].name, kOutputs[o].name);
        sep = ",";
    }
    if (*sep == '\0') {
        r.add("idle volume=-");
    } else {
        r.add(" volume=%d", level(s.loopMic, s.loopOut));
    }
    const int ring = playing(RING), fm = playing(FM), back = playing(PLAYBACK);
    if (ring < 0) {
        r.add(" ring=idle");
    } else {
        r.add(" ring=%d@%s", s.outs[ring].arg, kOutputs[ring].name);
    }
    r.add(" hifi=%s", playing(HIFI) >= 0 ? "on" : "off");
    if (fm < 0) {
        r.add(" fm=off");
    } else {
        r.add(" fm=%d@%s", s.outs[fm].arg, kOutputs[fm].name);
    }
    if (s.recording.empty()) {
        r.add(" record=none");
    } else {
        r.add(" record=%zus%s", s.recording.size() / kRate, back >= 0 ? "@speaker" : "");
    }
    sep = " mic=";
    for (size_t m = 0; m < kMicCount; ++m) {
        if (s.mics[m].clip.empty()) {
            r.add("%s%s:%d", sep, kMics[m].name, s.mics[m].hz);
        } else {
            r.add("%s%s:wav", sep, kMics[m].name);
        }
        sep = ",";
    }
    if (s.paFails) {
        r.add(" pa=fail");
    } else {
        r.add(" pa=%ld", s.paOhms);
    }
}

// This area's part of "hw status".
void state(Reply &r) {
    const Audio &s = audio();
    r.add(" headset=%d hook=%s presses=%d", s.headset, s.hook ? "running" : "idle", s.hookPresses);
    routes(r);
}

Event reply(const std::string &op) {
    if (op == "ftx_api_SmartPACalibrate_Start") {
        std::lock_guard<std::mutex> lock(model_lock());
        if (audio().paFails) return {FTX_DATATYPE_SMARTPA, "result=fail;value=0"};
        return {FTX_DATATYPE_SMARTPA, "result=pass;value=" + std::to_string(audio().paOhms)};
    }
    if (op.find("Loopback") != std::string::npos || op == "ftx_api_Audio_wakeupMic_on_Start") {
        return {FTX_DATATYPE_LOOPBACK, "result=pass"};
    }
    return no_event();
}

}  // namespace

void FactoryModel::send_headset() {
    int h = headset();
    deliver(callback_of("ftx_api_Audio_Loopback_Test_Start"), FTX_DATATYPE_HEADSET,
            std::to_string(h), true);
}

int FactoryModel::headset() {
    std::lock_guard<std::mutex> lock(model_lock());
    return audio().headset;
}

int FactoryModel::set_hook_cb(ftx_api_hookkey_cb cb) {
    std::lock_guard<std::mutex> lock(model_lock());
    int presses = audio().hookPresses;
    audio().hook = cb;
    audio().hookPresses = 0;
    return presses;
}

int FactoryModel::audio_answer(const char *op, int arg, int out) {
    std::lock_guard<std::mutex> lock(model_lock());
    const Route *r = route_of(op, false);
    if (r == nullptr) return 0;
    switch (r->kind) {
        case LOOP:
            return r->mic != CALL_MIC || (index_of(kMics, arg) >= 0 && index_of(kOutputs, out) >= 0)
                       ? 0
                       : -1;
        case HIFI:
            return audio().headset != 0 ? 0 : -1;
        case RECORD:
            return arg >= 1 && arg <= kMaxRecordSeconds ? 0 : -1;
        case PLAYBACK:
            return audio().recording.empty() ? -1 : 0;
        default:
            return 0;
    }
}

void FactoryModel::audio_route(const char *op, int arg, int out) {
    std::lock_guard<std::mutex> lock(model_lock());
    if (const Route *r = route_of(op, false)) {
        start(*r, arg, out);
    } else {
        stop(op, arg, out);
    }
}

void FactoryModel::set_volume(int microphone, int output, int level) {
    std::lock_guard<std::mutex> lock(model_lock());
    audio().levels[{microphone, output}] = level < 0 ? 0 : level > kMaxLevel ? kMaxLevel : level;
}

int FactoryModel::volume(int microphone, int output) {
    std::lock_guard<std::mutex> lock(model_lock());
    return level(microphone, output);
}

// ---- control words ----
namespace {

int w_headset(const Args &a, Reply &r) {
    long v;
    if (a.size() != 2 || !to_int(a[1], &v) || v < 0 || v > 2) return 1;
    {
        std::lock_guard<std::mutex> lock(model_lock());
        audio().headset = static_cast<int>(v);
    }
    model().send_headset();
    return r.done("headset %ld\n", v);
}

int w_hook(const Args &a, Reply &r) {
    if (a.size() != 2 || (a[1] != "press" && a[1] != "release")) return 1;
    unsigned int status = a[1] == "press" ? 1 : 0;
    ftx_api_hookkey_cb cb;
    {
        std::lock_guard<std::mutex> lock(model_lock());
        cb = audio().hook;
        if (status == 1) ++audio().hookPresses;
    }
    if (cb == nullptr) {
        r.add("hook test not running");
        return 1;
    }
    worker().post([cb, status] {
        unsigned int s = status;
        cb(&s);
    });
    return r.done("hook %s\n", a[1].c_str());
}

// "hw mic FILE.wav [MIC]", "hw mic tone HZ [MIC]": what one microphone (or all) hears. The
// loopbacks playing a changed microphone write their files again.
int w_mic(const Args &a, Reply &r) {
    const bool isTone = a.size() >= 2 && a[1] == "tone";
    const size_t named = isTone ? 3 : 2;  // index of the microphone's name
    if (a.size() < named || a.size() > named + 1) return 1;
    int mic = -1;  // all
    if (a.size() == named + 1) {
        for (size_t m = 0; m < kMicCount; ++m)
            if (a[named] == kMics[m].name) mic = static_cast<int>(m);
        if (mic < 0) {
            r.add("no microphone %s (main, headset, aux1, aux2)", a[named].c_str());
            return 1;
        }
    }
    Input in;
    long hz = 0;
    if (isTone) {
        if (!to_int(a[2], &hz) || hz < 1 || hz >= kRate / 2) {
            r.add("tone of 1 to %d Hz", kRate / 2 - 1);
            return 1;
        }
        in.hz = static_cast<int>(hz);
    } else {
        std::string why;
        if (read_wav(a[1].c_str(), &in.clip, &why) != 0) {
            r.add("%s", why.c_str());
            return 1;
        }
    }
    {
        std::lock_guard<std::mutex> lock(model_lock());
        Audio &s = audio();
        for (size_t m = 0; m < kMicCount; ++m)
            if (mic < 0 || static_cast<size_t>(mic) == m) s.mics[m] = in;
        for (size_t o = 0; o < kOutputCount; ++o) {
            const Playing &p = s.outs[o];
            if (p.route != nullptr && p.route->kind == LOOP && (mic < 0 || p.arg == mic)) render(o);
        }
    }
    const char *who = mic < 0 ? "all" : kMics[mic].name;
    if (isTone) return r.done("mic %s: %ld Hz\n", who, hz);
    return r.done("mic %s: %zu samples\n", who, in.clip.size());
}

int w_pa(const Args &a, Reply &r) {
    long ohms = 0;
    const bool fails = a.size() == 2 && a[1] == "fail";
    if (a.size() != 2 || (!fails && (!to_int(a[1], &ohms) || ohms < 1 || ohms > kMaxOhms)))
        return 1;
    {
        std::lock_guard<std::mutex> lock(model_lock());
        audio().paFails = fails;
        if (!fails) audio().paOhms = ohms;
    }
    if (fails) return r.done("pa calibration fails\n");
    return r.done("pa %ld ohms\n", ohms);
}

int w_audio(const Args &a, Reply &r) {
    if (a.size() > 2 || (a.size() == 2 && a[1] != "reset")) return 1;
    std::lock_guard<std::mutex> lock(model_lock());
    if (a.size() == 2) static_cast<RouteState &>(audio()) = RouteState{};
    r.add("audio:");
    routes(r);
    return r.done("\n");
}

}  // namespace

constinit const Area kAudioArea = {
    .words =
        {
            {"headset", "0|1|2  (none, with microphone, without microphone)", w_headset},
            {"hook", "press|release", w_hook},
            {"mic",
             "FILE.wav|tone HZ [main|headset|aux1|aux2]  (what a microphone hears, all when "
             "none is named; 16-bit PCM mono at 16000 Hz, repeated; default tone 440)",
             w_mic},
            {"pa", "OHMS|fail  (the smart PA calibration's impedance, default 8, or a failure)",
             w_pa},
            {"audio",
             "[reset]  (reset: all idle, defaults, nothing recorded; the routes: "
             "route=MIC>OUT,...|idle volume=N|- ring=TYPE@OUT|idle hifi=on|off "
             "fm=FREQ@OUT|off record=none|Ns[@speaker] mic=NAME:HZ|wav,... pa=OHMS|fail)",
             w_audio},
        },
    .reply = reply,
    .state = state,
};

}  // namespace ftxsim

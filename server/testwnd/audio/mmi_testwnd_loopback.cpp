// The loopback tests. A member's loop starts when its window is created (or when the PC asks)
// and stops on pass, fail or the stop entry. The library reports the headset through the
// callback; the window judges it on the GUI thread.
#include "testwnd/audio/mmi_testwnd_loopback.h"

#include <stdlib.h>
#include <string.h>

#include <atomic>

#include <android/log.h>

#include "mmi_guithread.h"
#include "mmi_theme.h"
#include "testwnd/mmi_testwnd.h"
#include "tp_os.h"

#define LB_DEBUG(tag, ...) __android_log_print(ANDROID_LOG_DEBUG, tag, __VA_ARGS__)
#define LB_ERROR(tag, ...) __android_log_print(ANDROID_LOG_ERROR, tag, __VA_ARGS__)

namespace {

enum Id {
#define MMI_LOOPBACK_ID(id, ...) id,
    MMI_LOOPBACK_MEMBERS(MMI_LOOPBACK_ID)
#undef MMI_LOOPBACK_ID
        LB_MAIN,
    LB_TWO_SPEAKER,
    LB_COUNT
};

// Microphones and outputs as the library numbers them.
enum : unsigned { MIC_MAIN = 1, MIC_HEADSET = 2, MIC_AUX1 = 4, MIC_AUX2 = 8 };
enum : unsigned { OUT_RECEIVER = 1, OUT_SPEAKER = 2, OUT_HEADSET = 4, OUT_UPSPEAKER = 160 };

const WPARAM kVolumeUp = 103;
const WPARAM kVolumeDown = 108;
const int kParmSize = 256;

struct Member {
    const mmi_catalogue_row *row;
    const char *caption;
    const char *titleKey;
    unsigned mic, out;
    bool headset;            // the pass key waits for a headset with microphone
    const char *volName;     // names the loop in the volume-key log lines
    int (*stopEntry)(void);  // the operator's stop
};

const Member kMembers[LB_COUNT] = {
    {&catalogue::AudioMicHeadsetLoopback, "", "menu_Mic_Headset", MIC_MAIN, OUT_HEADSET, true,
     "mainmic-headset", mmi_testwnd_Audio_MIC_Headset_Stop_Entry},
    {&catalogue::AudioAuxMic1HeadsetLoopback, "", "menu_AuxMic1_Headset", MIC_AUX1, OUT_HEADSET,
     true, "auxmic1-headset", mmi_testwnd_Audio_AuxiliaryMIC1_Headset_Stop_Entry},
    {&catalogue::AudioAuxMic2HeadsetLoopback, "", "menu_AuxMic2_Headset", MIC_AUX2, OUT_HEADSET,
     true, "auxmic2-headset", mmi_testwnd_Audio_AuxiliaryMIC2_Headset_Stop_Entry},
    {&catalogue::AudioHeadsetReceiverLoopback, "", "menu_Headset_Receiver", MIC_HEADSET,
     OUT_RECEIVER, true, "headsetmic-receiver", mmi_testwnd_Audio_Headset_Receiver_Stop_Entry},
    {&catalogue::AudioHeadsetSpeakerLoopback, "", "title_Headset_Speaker", MIC_HEADSET, OUT_SPEAKER,
     true, "headsetmic-speaker", mmi_testwnd_Audio_Headset_Speaker_Stop_Entry},
    {&catalogue::HeadsetLoopback, "", "menu_HeadSetTest", MIC_HEADSET, OUT_HEADSET, true,
     "headsetmic-headset", mmi_testwnd_HANDSET_MIC_Stop_Entry},
    {&catalogue::AudioLoopback, "CAMERA WIN", "title_LoopBackTest", MIC_MAIN, OUT_RECEIVER, false,
     "mainmic-receiver", mmi_testwnd_AudioLoopBackTest_Stop_Entry},
    {&catalogue::AudioLoopback, "Speaker", "title_LoopBackTest", MIC_MAIN, OUT_UPSPEAKER, false,
     "mainmic-speakers", mmi_testwnd_AudioLoopBackTest_Stop_Entry},
};

// A member's run: its window, the headset the library reported, its route.
struct Run {
    mmi_ownwnd_state wnd;
    std::atomic<int> status{0};
    std::atomic<int> arrived{0};
    std::atomic<unsigned> mic{0}, out{0};
    int passes = 0;      // two-speaker passes (GUI thread)
    int twoSpeaker = 0;  // the headset-to-speaker member's "TwoSpeaker"
    char parm[kParmSize] = "";
};

Run s_run[LB_COUNT];
// The member whose loop the library serves: its callback has no other way to tell.
std::atomic<int> s_current{-1};
// The main loopback's "AuxiliaryMIC": the auxiliary microphone feeds the receiver instead.
int s_mainAuxiliary = 0;

const char *tag_of(int id) {
    return kMembers[id].row->domain;
}

bool judged_ok(int id) {
    return !kMembers[id].headset || s_run[id].status.load() == 1;
}

// Waits up to tries x 100 ms for the library's headset report.
void WaitForResult(const std::atomic<int> &arrived, int tries) {
    for (int i = 0; i < tries && !arrived.load(); i++)
        tp_os_usleep(100000);
}

void read_speaker_config(int id) {
    if (id != LB_HEADSET_SPEAKER) return;
    ftx_config_para p[12];
    const int n = mmi_testwnd_params(tag_of(id), p, 12);
    s_run[id].twoSpeaker = mmi_testwnd_param_int(p, n, "TwoSpeaker", "0");
    char volume[FTX_CFG_TEXT_SIZE] = {0};
    ftx_config_get_para_value(p, n, "Volume", volume, sizeof(volume), "0");
    tp_os_strlcpy(s_run[id].parm, volume, sizeof(s_run[id].parm));
    LB_DEBUG(tag_of(id), "%s::iTwoSpeaker = %d , Volume = %s\n", __func__, s_run[id].twoSpeaker,
             volume);
}

// The route of the member's next loop.
void choose_route(int id) {
    Run &r = s_run[id];
    r.mic = kMembers[id].mic;
    r.out = kMembers[id].out;
    if (id == LB_HEADSET_SPEAKER && r.twoSpeaker == 1)
        r.out = r.passes < 1 ? OUT_UPSPEAKER : OUT_SPEAKER;
    if (id == LB_MAIN && s_mainAuxiliary == 1) r.mic = MIC_AUX1;
}

int start_loop(int id, const char *parm) {
    Run &r = s_run[id];
    r.status = 0;
    r.arrived = 0;
    s_current = id;
    if (id == LB_TWO_SPEAKER) {
        if (!hw::ftx_api_Audio_Acoustic_Loopback_Two_Speaker_Test_Start) return -1;
        return hw::ftx_api_Audio_Acoustic_Loopback_Two_Speaker_Test_Start(headsetmic_test_callback);
    }
    if (!hw::ftx_api_Audio_Loopback_Test_Start) return -1;
    return hw::ftx_api_Audio_Loopback_Test_Start((int)r.mic.load(), (int)r.out.load(), parm,
                                                 headsetmic_test_callback);
}

void stop_loop(int id) {
    Run &r = s_run[id];
    if (id == LB_TWO_SPEAKER) {
        if (hw::ftx_api_Audio_Acoustic_Loopback_Test_Stop)
            hw::ftx_api_Audio_Acoustic_Loopback_Test_Stop();
    } else if (hw::ftx_api_Audio_Loopback_Test_Stop) {
        hw::ftx_api_Audio_Loopback_Test_Stop((int)r.mic.load(), (int)r.out.load());
    }
    int expected = id;
    s_current.compare_exchange_strong(expected, -1);
}

int id_of(HWND hWnd) {
    return (int)GetWindowAdditionalData(hWnd);
}

void soft_keys(HWND hWnd, int id, const char *titleKey) {
    char pass[MMI_TESTWND_TEXT_SIZE], fail[MMI_TESTWND_TEXT_SIZE];
    mmi_translate("Result_pass", pass, sizeof(pass));
    mmi_translate("Result_fail", fail, sizeof(fail));
    mmi_testwnd_set_bars(hWnd, titleKey, judged_ok(id) ? pass : "", "", fail);
}

// The note and the speaker line, in the colour of the headset's state.
void paint(HWND hWnd, int id) {
    const Member &m = kMembers[id];
    const Run &r = s_run[id];
    const int w = g_ptScreenInfo.width, h = g_ptScreenInfo.height;
    HDC hdc = BeginPaint(hWnd);
    mmi_testwnd_draw_top_line(hdc);
    // The note before a headset is seen, and of the loops without one.
    const char *noteKey = m.headset ? "info_HeadSetNote" : "info_LoopBackNote";
    int colour = MMI_COLOUR_TEXT;
    if (m.headset && r.arrived.load()) {
        const int s = r.status.load();
        noteKey = s == 1 ? "info_HeadSetinsert" : s == 2 ? "info_HeadSetNoMicNote" : noteKey;
        colour = s == 1 ? MMI_COLOUR_PASS : MMI_COLOUR_FAIL;
    }
    char text[MMI_TESTWND_TEXT_SIZE];
    mmi_translate(noteKey, text, sizeof(text));
    SetBkMode(hdc, BM_TRANSPARENT);
    SetTextColor(hdc, mmi_pixel(colour));
    const int top = w / 15 + 10;
    RECT note = {w / 8, top, w / 8 + (w / 4) * 3, h - (h / 15 + 10)};
    DrawText(hdc, text, -1, &note, DT_WORDBREAK);
    if (m.headset && judged_ok(id) && r.arrived.load()) {
        const char *speakerKey = "info_speaker";
        if (id == LB_HEADSET_SPEAKER && r.twoSpeaker == 1)
            speakerKey = r.passes < 1 ? "info_upspeaker" : "info_downspeaker";
        mmi_translate(speakerKey, text, sizeof(text));
        RECT line = {w / 8, 2 * top, w / 8 + (w / 4) * 3, h - (h / 15 + 10)};
        DrawText(hdc, text, -1, &line, DT_WORDBREAK);
    }
    EndPaint(hWnd, hdc);
}

void change_volume(int id, WPARAM key) {
    const Run &r = s_run[id];
    if (!hw::ftx_api_Audio_GetVolume || !hw::ftx_api_Audio_SetVolume) return;
    const int mic = (int)r.mic.load(), out = (int)r.out.load();
    const int level = hw::ftx_api_Audio_GetVolume(mic, out);
    const bool up = key == kVolumeUp;
    LB_DEBUG(tag_of(id), "%s %s get vol=%d", kMembers[id].volName, up ? "KEY_UP" : "KEY_DOWN",
             level);
    if (up) {
        hw::ftx_api_Audio_SetVolume(mic, out, level + 1);
    } else if (level != 0) {
        hw::ftx_api_Audio_SetVolume(mic, out, level - 1);
    }
}

void *open_member(int id);

void pass_key(HWND hWnd, int id) {
    Run &r = s_run[id];
    if (id == LB_HEADSET_SPEAKER && r.twoSpeaker == 1 && r.passes < 1) {
        // The upper speaker passed: the lower one gets a window of its own.
        stop_loop(id);
        r.passes++;
        SendMessage(hWnd, MSG_CLOSE, 0, 0);
        read_speaker_config(id);
        open_member(id);
        return;
    }
    stop_loop(id);
    r.passes = 0;
    mmi_testwnd_pass_and_close(hWnd, kMembers[id].row->resultIndex, tag_of(id));
}

void fail_key(HWND hWnd, int id) {
    stop_loop(id);
    s_run[id].passes = 0;
    mmi_testwnd_fail_and_close(hWnd, kMembers[id].row->resultIndex);
}

LRESULT loopback_proc(HWND hWnd, UINT message, WPARAM wParam, LPARAM lParam) {
    int id = message == MSG_CREATE ? (int)reinterpret_cast<PMAINWINCREATE>(lParam)->dwAddData
                                   : id_of(hWnd);
    if (id < 0 || id >= LB_COUNT) return DefaultMainWinProc(hWnd, message, wParam, lParam);
    Run &r = s_run[id];
    const char *tag = tag_of(id);
    switch (message) {
        case MSG_CREATE:
            mmi_testwnd_create_title(hWnd, kMembers[id].titleKey);
            // The library may report the headset as soon as the loop starts.
            r.wnd.hwnd = hWnd;
            choose_route(id);
            LB_DEBUG(tag, "%s::ftx_api_Audio_Loopback_Test_Start begin", tag);
            if (start_loop(id, r.parm) != 0)
                LB_ERROR(tag, "%s::ftx_api_Audio_Loopback_Test_Start fail", tag);
            LB_DEBUG(tag, "%s::ftx_api_Audio_Loopback_Test_Start end", tag);
            mmi_set_current_test(tag);
            r.wnd.created = 1;
            break;
        case MSG_ACTIVE:
            if (mmi_ownwnd_refuses(&r.wnd, message, tag)) return 0;
            SendMessage(hWnd, MSG_CALLBACK, 1, 0);
            if (wParam == 1) soft_keys(hWnd, id, kMembers[id].titleKey);
            break;
        case MSG_PAINT:
            if (mmi_ownwnd_refuses(&r.wnd, message, tag)) return 0;
            paint(hWnd, id);
            return 0;
        case MSG_CALLBACK:
            if (kMembers[id].headset) WaitForResult(r.arrived, 4);
            LB_DEBUG(tag, "%s::headset status=%d", tag, r.status.load());
            soft_keys(hWnd, id, nullptr);
            InvalidateRect(hWnd, nullptr, TRUE);
            return 0;
        case MSG_KEYDOWN:
            if (wParam == kVolumeUp || wParam == kVolumeDown) {
                change_volume(id, wParam);
            } else if (wParam == MMI_KEY_PASS && judged_ok(id)) {
                pass_key(hWnd, id);
            } else if (wParam == MMI_KEY_FAIL) {
                fail_key(hWnd, id);
            }
            return 0;
        case MSG_FAILANDQUIT:
            fail_key(hWnd, id);
            return 0;
        case MSG_CLOSE:
            r.status = 0;
            r.arrived = 0;
            mmi_ownwnd_destroy(&r.wnd, hWnd);
            return 0;
        default:
            break;
    }
    return DefaultMainWinProc(hWnd, message, wParam, lParam);
}

void *open_member(int id) {
    const char *tag = tag_of(id);
    if (id != LB_TWO_SPEAKER && load_lib_interface_loopback(tag) != 0) {
        LB_ERROR(tag, "FATAL ERROR:%s::load_lib_interface fail.\n", tag);
        return HWND_INVALID;
    }
    HWND hWnd = mmi_testwnd_create(kMembers[id].caption, loopback_proc, (DWORD)id);
    return mmi_ownwnd_opened(&s_run[id].wnd, hWnd, kMembers[id].stopEntry);
}

void *open_operator(int id) {
    s_run[id].passes = 0;
    s_run[id].parm[0] = '\0';
    read_speaker_config(id);
    return open_member(id);
}

int stop_operator(int id) {
    s_run[id].parm[0] = '\0';
    if (s_run[id].wnd.hwnd.load() != HWND_INVALID || s_current.load() == id) stop_loop(id);
    s_run[id].passes = 0;
    return mmi_ownwnd_stop(&s_run[id].wnd);
}

int pc_start(int id, unsigned out, const char *parm, int parmLen) {
    const char *tag = tag_of(id);
    Check_AllTestWnd_Closed();
    Run &r = s_run[id];
    r.parm[0] = '\0';
    if (parm != nullptr && parmLen >= 1) tp_os_strlcpy(r.parm, parm, sizeof(r.parm));
    if (load_lib_interface_loopback(tag) != 0) {
        LB_ERROR(tag, "FATAL ERROR:%s::load_lib_interface fail.\n", tag);
        return 0;
    }
    r.mic = kMembers[id].mic;
    r.out = out;
    if (start_loop(id, r.parm) != 0) {
        LB_ERROR(tag, "%s::ftx_api_Audio_Loopback_Test_Start fail", tag);
        return 0;
    }
    return 1;
}

int pc_stop(int id) {
    const char *tag = tag_of(id);
    LB_DEBUG(tag, "%s::ftx_api_Audio_Loopback_Test_Stop begin", tag);
    stop_loop(id);
    LB_DEBUG(tag, "%s::ftx_api_Audio_Loopback_Test_Stop end", tag);
    return 1;
}

}  // namespace

#define MMI_LOOPBACK_DEFINE(id, entry, stop, pcEntry, pcStop) \
    void *entry(void) {                                       \
        return open_operator(id);                             \
    }                                                         \
    int stop(void) {                                          \
        return stop_operator(id);                             \
    }                                                         \
    int pcEntry(const char *parm, int parmLen) {              \
        return pc_start(id, kMembers[id].out, parm, parmLen); \
    }                                                         \
    int pcStop(void) {                                        \
        return pc_stop(id);                                   \
    }
MMI_LOOPBACK_MEMBERS(MMI_LOOPBACK_DEFINE)
#undef MMI_LOOPBACK_DEFINE

int mmi_AutoTest_Audio_Headset_UpSpeaker_LoopBackTestEntry(const char *parm, int parmLen) {
    return pc_start(LB_HEADSET_SPEAKER, OUT_UPSPEAKER, parm, parmLen);
}

void *mmi_testwnd_AudioLoopBackTestEntry(void) {
    const char *tag = tag_of(LB_MAIN);
    ftx_config_para p[12];
    const int n = mmi_testwnd_params(tag, p, 12);
    char aux[FTX_CFG_TEXT_SIZE] = {0};
    ftx_config_get_para_value(p, n, "AuxiliaryMIC", aux, sizeof(aux), "0");
    const int auxiliary = atoi(aux);
    const int wakeup = mmi_testwnd_param_int(p, n, "WakeupMIC", "0");
    const int two = mmi_testwnd_param_int(p, n, "TwoSpeaker", "0");
    LB_DEBUG(tag, "%s::CONFIG_AUXILIARYMIC=%s,g_auxiliarymic=%d", __func__, aux, auxiliary);
    LB_DEBUG(tag, "%s::wakeupmic=%d,twospeaker=%d", __func__, wakeup, two);
    if (two == 1) return open_operator(LB_TWO_SPEAKER);
    s_mainAuxiliary = auxiliary;
    return open_operator(LB_MAIN);
}

int mmi_testwnd_AudioLoopBackTest_Stop_Entry(void) {
    stop_operator(LB_TWO_SPEAKER);
    return stop_operator(LB_MAIN);
}

void headsetmic_test_callback(module_data *data) {
    const int id = s_current.load();
    if (data == nullptr || id < 0 || id >= LB_COUNT) return;
    if (data->datatype != FTX_DATATYPE_HEADSET) return;
    Run &r = s_run[id];
    r.status = data->data != nullptr ? atoi(data->data) : 0;
    r.arrived = 1;
    HWND hWnd = r.wnd.hwnd.load();
    if (hWnd != HWND_INVALID) SendMessage(hWnd, MSG_CALLBACK, 1, 0);
}

namespace {

// Runs a route operation of the PCBA set, bound on first use.
int pcba_route(ftx_hw_op<int (*)(void)> &op, const char *name) {
    if (!op) Init_lib_Interface_all();
    if (!op) {
        LB_ERROR("FTX_CPU", "%s is not bound", name);
        return 1;
    }
    LB_DEBUG("FTX_CPU", "%s rc=%d", name, op());
    return 1;
}

}  // namespace

int mmi_mic2earpiece_start(void) {
    return pcba_route(hw::ftx_api_mic2earpiece_start, "ftx_api_mic2earpiece_start");
}

int mmi_mic2earpiece_stop(void) {
    return pcba_route(hw::ftx_api_mic2earpiece_stop, "ftx_api_mic2earpiece_stop");
}

int mmi_auxmic2earpiece_start(void) {
    return pcba_route(hw::ftx_api_auxmic2earpiece_start, "ftx_api_auxmic2earpiece_start");
}

int mmi_auxmic2earpiece_stop(void) {
    return pcba_route(hw::ftx_api_auxmic2earpiece_stop, "ftx_api_auxmic2earpiece_stop");
}

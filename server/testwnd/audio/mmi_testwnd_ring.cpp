// The tone tests. The library plays; the operator listens and judges.
#include "testwnd/audio/mmi_testwnd_ring.h"

#include <ctype.h>
#include <stdlib.h>

#include <android/log.h>

#include "mmi_theme.h"
#include "testwnd/mmi_testwnd.h"

#define RING_DEBUG(tag, ...) __android_log_print(ANDROID_LOG_DEBUG, tag, __VA_ARGS__)
#define RING_ERROR(tag, ...) __android_log_print(ANDROID_LOG_ERROR, tag, __VA_ARGS__)

namespace {

// The ring type the PCBA run plays: one frequency.
const int kSingleFreqType = 2;

mmi_testwnd_state s_ring, s_up, s_down, s_receiver, s_hifi;

#define RING_DESC(name, rowName, captionText, stateVar)         \
    const mmi_testwnd_desc name = {                             \
        .row = &catalogue::rowName,                             \
        .caption = captionText,                                 \
        .noteKey = "info_RingNote",                             \
        .start = MMI_HW_OP(ftx_api_Audio_RingTest_Start),       \
        .stopWithMode = MMI_HW_OP(ftx_api_Audio_RingTest_Stop), \
        .stopEntrySleepMs = 100,                                \
        .state = &stateVar,                                     \
        .stopEntry = mmi_test_RingtoneTest_Stop_Entry,          \
    }
RING_DESC(kRing, Ringtone, "Ringtone Test", s_ring);
RING_DESC(kRingUp, RingtoneUp, "Ringtone Up Test", s_up);
RING_DESC(kRingDown, RingtoneDown, "Ringtone Down Test", s_down);
#undef RING_DESC

const mmi_testwnd_desc kReceiver = {
    .row = &catalogue::Receiver,
    .caption = "Receiver Test",
    .titleKey = "title_ReceiverRingTest",
    .noteKey = "info_ReceiverRingNote",
    .start = MMI_HW_OP(ftx_api_Audio_Receiver_Start),
    .stop = MMI_HW_OP(ftx_api_Audio_Receiver_Stop),
    .stopEntrySleepMs = 100,
    .state = &s_receiver,
    .stopEntry = mmi_testwnd_ReceiverTest_Stop_Entry,
};

// ---- high fidelity: plays only into a headset ----

int headset_status(void) {
    return hw::ftx_api_Get_HeadSetStatus ? hw::ftx_api_Get_HeadSetStatus() : 0;
}

std::atomic<int> s_hifiHeadset{0};

void hifi_note(char *out, unsigned int size) {
    mmi_translate(s_hifiHeadset.load() == 1 ? "info_HIFINote" : "info_HeadSetNote", out, size);
}

int hifi_hook(HWND, UINT message, WPARAM, LPARAM) {
    switch (message) {
        case MSG_CREATE:
            s_hifiHeadset = headset_status();
            if (s_hifiHeadset.load() == 1 && hw::ftx_api_Audio_HiFiTest_Start)
                hw::ftx_api_Audio_HiFiTest_Start();
            RING_DEBUG("FTX_HIFI", "%s::headset=%d", __func__, s_hifiHeadset.load());
            return 0;
        default:
            return 0;
    }
}

// Without a headset nothing plays: only the fail key is offered.
bool hifi_ready(void) {
    return s_hifiHeadset.load() == 1;
}

const mmi_testwnd_desc kHifi = {
    .row = &catalogue::Hifi,
    .caption = "CAMERA WIN",
    .titleKey = "title_RingTest",
    .stop = MMI_HW_OP(ftx_api_Audio_HiFiTest_Stop),
    .stopEntrySleepMs = 100,
    .state = &s_hifi,
    .stopEntry = mmi_test_HiFiTest_Stop_Entry,
    .bind = Init_Hifi_Interface,
    .note = hifi_note,
    .hook = hifi_hook,
    .passReady = hifi_ready,
};

// The ring type of an item ("RingType", default 0).
int ring_type(const char *domain) {
    ftx_config_para p[12];
    const int n = mmi_testwnd_params(domain, p, 12);
    return mmi_testwnd_param_int(p, n, "RingType", "0");
}

void *open_ring(const mmi_testwnd_desc *d) {
    return mmi_testwnd_open(d, ring_type(d->row->domain));
}

int start_ring(const char *fn, int type) {
    const char *tag = catalogue::Ringtone.domain;
    if (!hw::ftx_api_Audio_RingTest_Start) return 0;
    RING_DEBUG(tag, "%s::ftx_api_Audio_RingTest_Start begin", fn);
    const int rc = hw::ftx_api_Audio_RingTest_Start(type);
    RING_DEBUG(tag, "%s::ftx_api_Audio_RingTest_Start end", fn);
    if (rc != 0) {
        RING_ERROR(tag, "%s::ftx_api_Audio_RingTest_Start fail", fn);
        return 0;
    }
    s_ring.mode = type;
    return 1;
}

}  // namespace

void *mmi_testwnd_RingtoneTestEntry(void) {
    return open_ring(&kRing);
}

void *mmi_testwnd_RingtoneUpTestEntry(void) {
    return open_ring(&kRingUp);
}

void *mmi_testwnd_RingtoneDownTestEntry(void) {
    return open_ring(&kRingDown);
}

int mmi_test_RingtoneTest_Stop_Entry(void) {
    for (const mmi_testwnd_desc *d : {&kRingUp, &kRingDown})
        if (d->state->hwnd.load() != HWND_INVALID) mmi_testwnd_close(d);
    return mmi_testwnd_close(&kRing);
}

void *mmi_testwnd_ReceiverTestEntry(void) {
    return open_ring(&kReceiver);
}

int mmi_testwnd_ReceiverTest_Stop_Entry(void) {
    return mmi_testwnd_close(&kReceiver);
}

void *mmi_testwnd_HiFiTestEntry(void) {
    return mmi_testwnd_open(&kHifi, 0);
}

int mmi_test_HiFiTest_Stop_Entry(void) {
    return mmi_testwnd_close(&kHifi);
}

int mmi_AutoTest_Audio_SpeakerRingtone_TestEntry(void) {
    Check_AllTestWnd_Closed();
    return start_ring(__func__, ring_type(catalogue::Ringtone.domain));
}

int mmi_AutoTest_Audio_SpeakerRingtone_Test_Stop_Entry(void) {
    return RingSingleFreqStop(s_ring.mode.load());
}

int mmi_auto_RingtoneTest(const char *parm) {
    Check_AllTestWnd_Closed();
    const bool given = parm != nullptr && isdigit((unsigned char)parm[0]);
    return start_ring(__func__, given ? atoi(parm) : ring_type(catalogue::Ringtone.domain));
}

int RingSingleFreqStart(void) {
    if (hw::ftx_api_Audio_RingTest_Start) hw::ftx_api_Audio_RingTest_Start(kSingleFreqType);
    return 1;
}

int RingSingleFreqStop(int argument) {
    if (hw::ftx_api_Audio_RingTest_Stop) hw::ftx_api_Audio_RingTest_Stop(argument);
    return 1;
}

int mmi_AutoTest_HiFiTestEntry(const char *parm) {
    const char *tag = catalogue::Hifi.domain;
    Check_AllTestWnd_Closed();
    if (Init_Hifi_Interface() != 0) return 0;
    if (headset_status() != 1) {
        RING_ERROR(tag, "%s::no headset", __func__);
        return 0;
    }
    if (!hw::ftx_api_Audio_HiFiTest_auto_Start) return 0;
    return hw::ftx_api_Audio_HiFiTest_auto_Start(parm != nullptr ? parm : "") == 0 ? 1 : 0;
}

int mmi_AutoTest_HiFiTest_Stop_Entry(void) {
    if (hw::ftx_api_Audio_HiFiTest_auto_Stop) hw::ftx_api_Audio_HiFiTest_auto_Stop();
    return 1;
}

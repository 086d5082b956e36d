// The loopback tests: a microphone routed to an output by the factory library while the
// operator speaks and listens. One table of members, one window procedure; each member has
// its operator entry and stop, and (except the main and two-speaker loops) a PC entry and
// stop that route the sound without a window.
#pragma once

#include "hw/lib_factory.h"

// Member, operator entry, operator stop, PC entry, PC stop.
#define MMI_LOOPBACK_MEMBERS(X)                                                                   \
    X(LB_MIC_HEADSET, mmi_testwnd_Audio_MIC_Headset_LoopBackTestEntry,                            \
      mmi_testwnd_Audio_MIC_Headset_Stop_Entry, mmi_AutoTest_Audio_MIC_Headset_LoopBackTestEntry, \
      mmi_AutoTest_Audio_MIC_Headset_LoopBackTest_Stop_Entry)                                     \
    X(LB_AUX1_HEADSET, mmi_testwnd_Audio_AuxiliaryMIC1_Headset_LoopBackTestEntry,                 \
      mmi_testwnd_Audio_AuxiliaryMIC1_Headset_Stop_Entry,                                         \
      mmi_AutoTest_Audio_AuxiliaryMIC1_Headset_LoopBackTestEntry,                                 \
      mmi_AutoTest_Audio_AuxiliaryMIC1_Headset_LoopBackTest_Stop_Entry)                           \
    X(LB_AUX2_HEADSET, mmi_testwnd_Audio_AuxiliaryMIC2_Headset_LoopBackTestEntry,                 \
      mmi_testwnd_Audio_AuxiliaryMIC2_Headset_Stop_Entry,                                         \
      mmi_AutoTest_Audio_AuxiliaryMIC2_Headset_LoopBackTestEntry,                                 \
      mmi_AutoTest_Audio_AuxiliaryMIC2_Headset_LoopBackTest_Stop_Entry)                           \
    X(LB_HEADSET_RECEIVER, mmi_testwnd_Audio_Headset_Receiver_LoopBackTestEntry,                  \
      mmi_testwnd_Audio_Headset_Receiver_Stop_Entry,                                              \
      mmi_AutoTest_Audio_Headset_Receiver_LoopBackTestEntry,                                      \
      mmi_AutoTest_Audio_Headset_Receiver_LoopBackTest_Stop_Entry)                                \
    X(LB_HEADSET_SPEAKER, mmi_testwnd_Audio_Headset_Speaker_LoopBackTestEntry,                    \
      mmi_testwnd_Audio_Headset_Speaker_Stop_Entry,                                               \
      mmi_AutoTest_Audio_Headset_Speaker_LoopBackTestEntry,                                       \
      mmi_AutoTest_Audio_Headset_Speaker_LoopBackTest_Stop_Entry)                                 \
    X(LB_HEADSET_HEADSET, mmi_testwnd_HANDSET_MIC_TestEntry, mmi_testwnd_HANDSET_MIC_Stop_Entry,  \
      mmi_AutoTest_Audio_Headset_Headset_LoopBackTestEntry,                                       \
      mmi_AutoTest_Audio_Headset_Headset_LoopBackTest_Stop_Entry)

#define MMI_LOOPBACK_DECLARE(id, entry, stop, pcEntry, pcStop) \
    void *entry(void);                                         \
    int stop(void);                                            \
    int pcEntry(const char *parm, int parmLen);                \
    int pcStop(void);
MMI_LOOPBACK_MEMBERS(MMI_LOOPBACK_DECLARE)
#undef MMI_LOOPBACK_DECLARE

// The headset-to-upper-speaker loop of the PC (the same member, output 160).
int mmi_AutoTest_Audio_Headset_UpSpeaker_LoopBackTestEntry(const char *parm, int parmLen);

// The main loopback (main microphone to receiver), or the two-speaker acoustic loop when the
// item's "TwoSpeaker" is 1.
void *mmi_testwnd_AudioLoopBackTestEntry(void);
int mmi_testwnd_AudioLoopBackTest_Stop_Entry(void);

// The library's headset events of the member that runs (datatype 105).
void headsetmic_test_callback(module_data *data);

// The PCBA run's microphone-to-earpiece routes (main and auxiliary microphone); 1 always.
int mmi_mic2earpiece_start(void);
int mmi_mic2earpiece_stop(void);
int mmi_auxmic2earpiece_start(void);
int mmi_auxmic2earpiece_stop(void);

// The tone tests: the speaker ringtone (and its upper and lower variants), the receiver ring
// and the high-fidelity output. Windows of the common pattern; the ring type comes from each
// item's "RingType".
#pragma once

void *mmi_testwnd_RingtoneTestEntry(void);
void *mmi_testwnd_RingtoneUpTestEntry(void);
void *mmi_testwnd_RingtoneDownTestEntry(void);
// Closes whichever speaker-ring window is open.
int mmi_test_RingtoneTest_Stop_Entry(void);
void *mmi_testwnd_ReceiverTestEntry(void);
int mmi_testwnd_ReceiverTest_Stop_Entry(void);
void *mmi_testwnd_HiFiTestEntry(void);
int mmi_test_HiFiTest_Stop_Entry(void);

// PC: the configured ringtone on the speaker (1 started, 0 failed) and its stop.
int mmi_AutoTest_Audio_SpeakerRingtone_TestEntry(void);
int mmi_AutoTest_Audio_SpeakerRingtone_Test_Stop_Entry(void);
// PC: the ringtone of the type in parm (a number), or the configured one.
int mmi_auto_RingtoneTest(const char *parm);
// The single-frequency tone (ring type 2) of the PCBA run, and the ring stop; both answer 1.
int RingSingleFreqStart(void);
int RingSingleFreqStop(int argument);
// PC: the high-fidelity output, refused without a headset (0).
int mmi_AutoTest_HiFiTestEntry(const char *parm);
int mmi_AutoTest_HiFiTest_Stop_Entry(void);

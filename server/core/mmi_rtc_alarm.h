// The real-time clock's alarm and the system suspend. The alarm wakes a suspended handset
// and starts a powered-off one; its time is kept by the RTC in epoch seconds.
#pragma once

// Arms the RTC alarm seconds from now (times FTX_TIME_SCALE, rounded up to whole seconds, at
// least 1), replacing an armed one. 0, or -1 when seconds < 1 or the RTC refuses it.
int mmi_rtc_set_wakealarm(int seconds);
// Clears the alarm. 0, or -1.
int mmi_rtc_clear_wakealarm(void);
// The armed alarm time (epoch seconds), 0 when none is armed or the RTC cannot be read.
long long mmi_rtc_get_wakealarm(void);

// Suspends the handset ("mem") and returns once it has resumed (the alarm or a key): 0, or
// -1 when the kernel refuses the suspend. Only the calling thread waits for the resume.
int mmi_system_suspend(void);

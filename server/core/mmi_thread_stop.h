// Stopping a worker thread from outside: SIGUSR1, only ever sent with pthread_kill, asks the
// thread it reaches to end. The handler only marks the thread; a sleep or a blocking call is
// cut short (the handler is installed without SA_RESTART) and the thread returns by itself,
// so nothing is unwound inside the handler and no lock is left held.
#pragma once

// Installs the handler (process-wide; every thread that may be stopped calls it first).
void mmi_thread_stop_install(void);
// Whether the calling thread was asked to end.
bool mmi_thread_stop_requested(void);
// The platform's scaled sleep (FTX_TIME_SCALE), cut short by the stop; false when it was.
bool mmi_sleep_unless_stopped(unsigned long us);

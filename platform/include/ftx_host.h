/* Host-only services of the platform: used by the simulated handset, the tools and
 * the tests, never by application code. */
#ifndef FTX_HOST_H
#define FTX_HOST_H

#include <stddef.h>

#ifdef __cplusplus
extern "C" {
#endif

/* Reads key from [section] of $FTX_ROOT/sim/device.ini into out (default when absent).
 * Returns 0 when found, -1 when the default was used. */
int ftx_device_ini_get(const char *section, const char *key, char *out, size_t size,
                       const char *default_value);
int ftx_device_ini_get_int(const char *section, const char *key, int default_value);

/* An in-process view of every log entry, for unit tests. Pass null to remove it. */
typedef void (*ftx_log_capture_fn)(int prio, const char *tag, const char *msg, void *ctx);
void ftx_log_set_capture(ftx_log_capture_fn fn, void *ctx);

/* Replaces the process exit of dev_reboot (tests): fn gets the exit status (100 or 101). */
typedef void (*ftx_reboot_hook_fn)(int status);
void ftx_set_reboot_hook(ftx_reboot_hook_fn fn);

/* Forgets cached properties, device settings and the root, so the next call rereads them
 * (tests that switch roots). */
void ftx_host_reset(void);

/* 1 once the system partition was remounted writable (dev_mount with MS_REMOUNT on
 * "/system"), else 0: the root's "/system" is read-only to the PC's file operations. */
int ftx_host_system_writable(void);

/* What dev_system would hand the host shell for line (0), or why it would refuse it (-1);
 * either text goes to out. For tests and the fuzzer. */
int ftx_shell_prepare(const char *line, char *out, size_t size);

/* Simulated hardware control lines ("hw ..." on the emulator console). Each simulated
 * library exports ftx_sim_control(line, reply, size) and registers it when loaded.
 * The function gets the line without the "hw " prefix and returns 0 when it handled
 * the line (reply holds any reply lines), 1 when it handled it and failed (reply holds
 * the reason), -1 when the line is not its own. */
typedef int (*ftx_sim_control_fn)(const char *line, char *reply, size_t size);
void ftx_host_register_hw(const char *name, ftx_sim_control_fn fn);
/* Offers line to every registered library in turn. Returns -1 with reply
 * "no hardware" when none claims it. */
int ftx_host_hw_dispatch(const char *line, char *reply, size_t size);

/* The handset's notification LED as the simulated screen shows it: with on non-zero a dot
 * of colour rgb (0xRRGGBB) at the right end of the title strip, drawn over what the display
 * shows and what a screenshot records (whatever the backlight); on 0 removes it. */
void ftx_host_set_indicator(int on, unsigned int rgb);

#ifdef __cplusplus
}
#endif
#endif

/* Host-only services of the GUI library: the framebuffer, injected input, screenshots and
 * the emulator console. Used by tests, tools and the simulated handset, never by
 * application code. */
#ifndef FTX_MINIGUI_FTX_GUI_H
#define FTX_MINIGUI_FTX_GUI_H

#include <stddef.h>

#include "common.h"

#ifdef __cplusplus
extern "C" {
#endif

/* The framebuffer: width x height pixels of 0x00RRGGBB, rows without padding. Hold the
 * lock while reading so no drawing is half done. */
MGUI_API const Uint32 *ftx_gui_framebuffer(int *width, int *height);
MGUI_API void ftx_gui_lock_framebuffer(void);
MGUI_API void ftx_gui_unlock_framebuffer(void);

/* The picture as the panel shows it (dimmed by the backlight and blank files). */
MGUI_API int ftx_gui_screenshot(const char *host_png_path);

/* Input as if from the panel; queued for the input layer. Returns 0, or -1 when the input
 * layer does not run yet (events are only queued once InitGUIIAL ran). */
#define FTX_INPUT_KEYDOWN 1
#define FTX_INPUT_KEYUP 2
#define FTX_INPUT_TOUCHDOWN 3
#define FTX_INPUT_TOUCHMOVE 4
#define FTX_INPUT_TOUCHUP 5
MGUI_API int ftx_gui_inject(int kind, int a, int b);

/* Waits until the input queue is empty and every GUI thread has nothing left to fetch
 * (or timeout_ms passed). Returns 0 when idle, -1 on time-out. */
MGUI_API int ftx_gui_wait_idle(int timeout_ms);

/* Console: the server on $FTX_ROOT/run/console.sock runs from InitGUI. */
MGUI_API int ftx_console_start(void);
MGUI_API void ftx_console_stop(void);
MGUI_API const char *ftx_console_path(void);
/* Handles one request line; writes the reply lines, the last one "OK" or "KO <reason>",
 * each ending in '\n'. Returns 0 for OK, -1 for KO. */
MGUI_API int ftx_console_execute(const char *line, char *reply, size_t size);

/* Display backend in use: "headless" or "sdl". */
MGUI_API const char *ftx_gui_backend(void);

#ifdef __cplusplus
}
#endif
#endif

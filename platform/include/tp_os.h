/* Platform OS layer of the handset's platform library. */
#ifndef FTX_TP_OS_H
#define FTX_TP_OS_H

#include <stddef.h>

#ifdef __cplusplus
extern "C" {
#endif

#define TP_OS_WAIT_FOREVER (-1)
#define TP_OS_SEMA_MAX 64

typedef unsigned long tp_os_thread_t;
typedef void *(*tp_os_thread_func)(void *arg);

int tp_os_thread_init(int argc, char **argv);

/* Starts a named thread (detached). priority: 0 normal, higher is more urgent
 * (advisory on the host); stack_size 0 takes the default. Returns the thread
 * handle (a pthread_t), or 0 on failure. */
tp_os_thread_t tp_os_thread_create(const char *name, int priority, size_t stack_size,
                                   tp_os_thread_func func, void *arg);

/* Semaphores by number (0..TP_OS_SEMA_MAX-1; each starts at 0 on first use)
 * and by name. Waits take milliseconds, TP_OS_WAIT_FOREVER for no limit.
 * tp_os_sema_get returns 0 when taken, -1 on time-out or a bad number. */
int tp_os_sema_create(int id, int initial);
int tp_os_sema_get(int id, int timeout_ms);
int tp_os_sema_put(int id);
/* Returns the number of the named semaphore, creating it with initial on first use; -1 when full. */
int tp_os_sema_named(const char *name, int initial);

void tp_os_print(const char *fmt, ...) __attribute__((format(printf, 1, 2)));

/* Sleeps us microseconds times FTX_TIME_SCALE. */
void tp_os_usleep(unsigned long us);
/* FTX_TIME_SCALE (default 1.0; 0.01 makes every platform wait 100 times shorter). */
double tp_os_time_scale(void);

void *tp_os_mem_alloc(size_t size);
void *tp_os_mem_calloc(size_t count, size_t size);
void tp_os_mem_free(void *p);
/* Bounded copy: always terminates dst when size > 0; returns the length copied. */
size_t tp_os_strlcpy(char *dst, const char *src, size_t size);

/* The screen record, filled by tp_man_lcd_get_info_only(). */
typedef struct {
    int width;
    int height;
    int bpp;
} TP_SCREEN_INFO;
extern TP_SCREEN_INFO g_ptScreenInfo;

/* Queries the LCD; 0 on success (pointer-wide like the handset's). */
long tp_man_lcd_get_info_only(void);

/* Built-in text domains, exported by the application as `language_domains`:
 * an array ended by a record with a null name; each domain's texts end with a null key. */
typedef struct {
    const char *key;
    const char *text;
} TP_I18N_TEXT;
typedef struct {
    const char *name;
    const TP_I18N_TEXT *texts;
} TP_I18N_DOMAIN;

/* Looks key up in the domain named domain ("en", "zh"); a null domain takes the one
 * matching "ro.product.locale" ("zh..." -> "zh", else "en"). Returns the key itself
 * when it is not found. */
const char *tp_i18n_get_text(const char *domain, const char *key);

#ifdef __cplusplus
}
#endif
#endif

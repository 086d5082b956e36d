// The panel's kernel files, the backlight and the auxiliary display, from the PC.
#include "testwnd/display/mmi_lcd_panel.h"

#include <dlfcn.h>
#include <errno.h>
#include <fcntl.h>
#include <stdarg.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <unistd.h>

#include <android/log.h>

#include "core/ftx_lib_binding.h"
#include "devfs.h"
#include "tp_os.h"

#define LCD_TAG "FTX_LCD"
#define LCD_DEBUG(...) __android_log_print(ANDROID_LOG_DEBUG, LCD_TAG, __VA_ARGS__)
#define LCD_ERROR(...) __android_log_print(ANDROID_LOG_ERROR, LCD_TAG, __VA_ARGS__)

namespace {

const char kPanelInfo[] = "/proc/msm_lcd";
const char kTouchMainCtrl[] = "/proc/touchscreen/ts_main_ctrl";
const char kFb0BlackFlag[] = "/data/fb0_black_flag";
const size_t kLineSize = 256;

int copy_register(const char *name, const char *suffix, int length) {
    char from[kLineSize], to[kLineSize];
    snprintf(from, sizeof(from), "/data/panel_hue_dll_%s%s_switch_temp", name, suffix);
    snprintf(to, sizeof(to), "/proc/panel_hue_dll_%s%s_switch", name, suffix);
    char value[1024 + 1] = {0};
    if (read_regvalue_from_file(from, value, length) < 0) return 0;
    if (write_regvalue_to_file(to, value) < 0) return 0;
    return 1;
}

// Builds a shell line from its words and runs it through the device shell.
__attribute__((format(printf, 1, 2))) void run_line(const char *fmt, ...) {
    char line[kLineSize];
    va_list ap;
    va_start(ap, fmt);
    vsnprintf(line, sizeof(line), fmt, ap);
    va_end(ap);
    dev_system(line);
}

}  // namespace

int read_regvalue_from_file(const char *path, char *buffer, int length) {
    if (path == nullptr || buffer == nullptr || length < 0) return -1;
    int fd = dev_open(path, O_RDONLY);
    if (fd < 0) {
        LCD_ERROR("Could not open '%s',errno=%d,%s", path, errno, strerror(errno));
        return -1;
    }
    ssize_t n = read(fd, buffer, (size_t)length);
    close(fd);
    if (n < 0) return -1;
    while (n > 0 && buffer[n - 1] == '\n')
        n--;
    buffer[n] = '\0';
    return (int)n;
}

int write_regvalue_to_file(const char *path, const char *text) {
    if (path == nullptr || text == nullptr) return -1;
    // A kernel file takes the whole text as one value; the host's plain file must not keep
    // the tail of a longer earlier one.
    int fd = dev_open(path, O_WRONLY | O_TRUNC);
    if (fd < 0) {
        LCD_ERROR("open %s fails.", path);
        return -1;
    }
    const size_t len = strlen(text);
    ssize_t n = write(fd, text, len);
    close(fd);
    LCD_DEBUG("%s write_count %d", path, (int)n);
    return n == (ssize_t)len ? (int)n : -1;
}

int mmi_AutoTest_Hue_Set(const char *parm, int, char *, unsigned int) {
    mmi_lcd_fields x;
    mmi_lcd_split_fields(parm, 2, &x);
    if (x.count < 2) return 0;
    if (!mmi_lcd_plain_field(x.f[0], false) || !mmi_lcd_plain_field(x.f[1], true)) {
        LCD_ERROR("%s: refused \"%s\"", __func__, parm);
        return 0;
    }
    run_line("echo %s > /proc/panel_hue_%s_switch", x.f[1], x.f[0]);
    return 1;
}

int mmi_AutoTest_Hue_Register_Set(const char *parm, int, char *, unsigned int) {
    LCD_DEBUG("%s begin.", __func__);
    mmi_lcd_fields x;
    mmi_lcd_split_fields(parm, 3, &x);
    const char *name = x.f[0], *action = x.f[1], *panel = x.f[2];
    LCD_DEBUG("%s, %s %s %s", __func__, name, action, panel);
    if (x.count < 3) return 0;
    if (!mmi_lcd_plain_field(name, false)) {
        LCD_ERROR("%s: refused name \"%s\"", __func__, name);
        return 0;
    }
    const bool truly = strcmp(panel, "truly") == 0, jdi = strcmp(panel, "jdi") == 0;
    if (!truly && !jdi) return 0;
    if (strcmp(action, "default") == 0) {
        run_line("echo > /proc/panel_hue_dll_%s_switch", name);
        return 1;
    }
    if (strcmp(action, "reg") != 0) return 0;
    if (truly) return copy_register(name, "", 256);
    return copy_register(name, "", 1024) && copy_register(name, "1", 1024) ? 1 : 0;
}

int mmi_AutoTest_LCDType_Read(const char *, int, char *reply, unsigned int replySize) {
    FILE *fp = dev_fopen(kPanelInfo, "r");
    if (fp == nullptr) {
        LCD_ERROR("Cannot open file %s\n", kPanelInfo);
        return 0;
    }
    char info[256] = {0};
    size_t n = fread(info, 1, sizeof(info) - 1, fp);
    fclose(fp);
    info[n] = '\0';
    LCD_DEBUG("lcd info: %s", info);
    if (reply == nullptr || replySize == 0) return 1;
    if (strstr(info, "dvkJDI") != nullptr) {
        tp_os_strlcpy(reply, "JDI", replySize);
    } else if (strstr(info, "dvkTruly") != nullptr) {
        tp_os_strlcpy(reply, "Truly", replySize);
    }
    return 1;
}

int mmi_AutoTest_LCDBacklightTestEntry(unsigned int level) {
    typedef int (*set_fn)(unsigned int);
    void *lib = lib_dvk_factory.load();
    // Looked up at each call: the aging run and the PC share it.
    set_fn set = lib != nullptr ? (set_fn)dlsym(lib, "ftx_api_Set_LCDBacklight") : nullptr;
    if (set == nullptr) {
        LCD_ERROR("FATAL ERROR: could not dlsym lib_factory.so::ftx_api_Set_LCDBacklight\n");
        const char *why = dlerror();
        if (why != nullptr) LCD_ERROR("error = %s,%s\n", why, "ftx_api_Set_LCDBacklight");
        return 1;
    }
    LCD_DEBUG("%s::ftx_api_Set_LCDBacklight=%d", __func__, (int)level);
    set(level);
    return 1;
}

int mmi_AutoTest_LCDRefresh(int arg) {
    if (!hw::ftx_api_LCD_Refresh) {
        LCD_ERROR("%s: ftx_api_LCD_Refresh is not bound", __func__);
        return 0;
    }
    int rc = hw::ftx_api_LCD_Refresh(arg);
    if (rc != 0) LCD_ERROR("%s: ftx_api_LCD_Refresh(%d) = %d", __func__, arg, rc);
    return rc == 0 ? 1 : 0;
}

int mmi_AutoTest_AUX_LCDColorTestEntry(int index) {
    run_line("mmi_open_fb1 1 %d &", index);
    return 1;
}

int mmi_AutoTest_AUX_LCDColorTest_Stop_Entry(void) {
    dev_system("touch /data/fb1_close_flag");
    return 1;
}

int mmi_AutoTest_Switch_Display(const char *parm, int, char *, unsigned int) {
    const bool main = parm != nullptr && (strcmp(parm, "main") == 0 || strcmp(parm, "1") == 0);
    const bool aux = parm != nullptr && (strcmp(parm, "aux") == 0 || strcmp(parm, "0") == 0);
    LCD_DEBUG("%s %s", __func__, parm != nullptr ? parm : "");
    if (!main && !aux) return 0;
    // The main display is kept black while the auxiliary one is in use.
    run_line("echo %d > %s", main ? 1 : 0, kTouchMainCtrl);
    run_line("%s %s", main ? "rm -f" : "touch", kFb0BlackFlag);
    return 1;
}

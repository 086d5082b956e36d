// The display commands that are shell lines: they answer success whatever the line did.
#include "adbd_connection/handlers/common.h"
#include "adbd_connection/handlers/handlers.h"

int AutoTest_LCD_Turnoff(const char *, int, char *, unsigned int) {
    return at_run_shell(__func__, "echo 4 > /sys/class/graphics/fb0/blank");
}

int AutoTest_CABC_Open(const char *, int, char *, unsigned int) {
    return at_run_shell(__func__, "echo 2 > /proc/panel_cabc_level_switch");
}

int AutoTest_CABC_Close(const char *, int, char *, unsigned int) {
    return at_run_shell(__func__, "echo 0 > /proc/panel_cabc_level_switch");
}

// The test and product information screen ("menu_ProduceInfo"): versions, serial and board
// numbers, IMEI, flash type, then every item of the result record that passed or failed.
#pragma once

#include "mmi_msg.h"

#define MMI_INFO_LINE_SIZE 128
#define MMI_INFO_MAX_LINES 420

struct mmi_info_line {
    char label[MMI_INFO_LINE_SIZE];
    char value[MMI_INFO_LINE_SIZE];
    int colour;  // system pixel index of the line
};

// The record part of the screen from a 256-byte flag area: one line per item whose value is
// 1 or 2, with its label and the pass or fail word. Returns the number of lines written.
int mmi_info_record_lines(const unsigned char *flags, mmi_info_line *lines, int max);

int mmi_TestInfoEntry(void);  // 0, or -1 when the window cannot be made
HWND mmi_TestInfo_Window(void);

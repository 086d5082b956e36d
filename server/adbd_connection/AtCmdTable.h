// The PC command table: 179 rows registered in order at channel start.
#pragma once

#include "adbd_connection/CmdParse.h"

typedef struct {
    const char *cmd;     // module word, "testItem" and mostly the operation word
    const char *action;  // when not empty, the parameter must equal it
    AtCmdFun fun;        // null until the row's handler exists: answered with result 3
} AtCmdRow;

#define AT_CMD_TABLE_ROWS 179

extern const AtCmdRow g_atcmd_table[AT_CMD_TABLE_ROWS];

// Registers every row in order with registerModule(cmd, action, fun, 1); 0, or -1 at the
// first refused row (rows before it stay registered).
int register_at_procs(void);

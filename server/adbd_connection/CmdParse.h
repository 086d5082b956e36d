// The PC command registry and parser: rows of the command table registered into a list,
// a command line matched against them by prefix, its parameter cut out and its handler
// called. The matching rules, quirks included, are what the station PCs rely on.
#pragma once

#define CMD_PARM_SIZE 256

// Parser results.
#define PARSE_OK 0
#define PARSE_NOFUND 2
// Registration results.
#define REGISTER_OK 0
#define REGISTER_NOMEM 2
#define REGISTER_EXISTS 3
// AtCommandProcess results sent to the PC.
#define AT_RESULT_OK 0
#define AT_RESULT_FAIL 2
#define AT_RESULT_NOHANDLER 3

// A command handler: bit 0 of its answer is the success flag. parm is the text after the
// command (parmLen bytes); reply/replySize the channel's reply buffer.
typedef int (*AtCmdFun)(const char *parm, int parmLen, char *reply, unsigned int replySize);

typedef struct CommandEntry {
    struct CommandEntry *next;
    struct CommandEntry *prev;
    char *cmd;
    char *action;
    AtCmdFun fun;
} CommandEntry;

// 0 registered (or replaced when bit 0 of overwrite is set), 2 out of memory, 3 the same
// cmd and action exist and overwrite was clear.
unsigned int registerModule(const char *cmd, const char *action, AtCmdFun fun, int overwrite);
// 0 with *fun set (possibly null) and parm (CMD_PARM_SIZE bytes) holding the parameter;
// 2 when nothing matched.
unsigned int parseCommand(const char *cmdString, AtCmdFun *fun, char *parm);
// The channel's command callback: 0 handler succeeded, 2 not found or handler failed,
// 3 the row has no handler.
int AtCommandProcess(const char *cmdString, char *reply, unsigned int replySize);

// Walks the registry in registration order: the entry after e (the first for null), or
// null after the last.
const CommandEntry *mmi_cmd_registry_next(const CommandEntry *e);
int mmi_cmd_registry_count(void);
// Frees every entry (tests; the program never empties the registry).
void mmi_cmd_registry_clear(void);

// What the handler files share: the begin line, a shell line that always answers success,
// and the check of a parameter that goes into a shell line.
#pragma once

#define AT_TAG "AtThread"

// "<name> begin" in the command thread's log (subject to the log level).
void at_log_begin(const char *name);
// "<name> begin,bufIn=<parm>", for the handlers that use their parameter.
void at_log_parm(const char *name, const char *parm);
// Runs line through the device shell; 1 whatever it did.
int at_run_shell(const char *name, const char *line);
// True when s holds only words of a driver's (letters, digits, " ._,:=-"), never shell syntax.
bool at_is_plain_argument(const char *s);

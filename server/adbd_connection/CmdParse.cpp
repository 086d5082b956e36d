// Registry and parser of the PC commands.
#include "adbd_connection/CmdParse.h"

#include <stdint.h>
#include <stdlib.h>
#include <string.h>

#include <android/log.h>

#include "core/mmi_loglevel.h"

namespace {

const char kTag[] = "CMDPARSE";
const char kAtTag[] = "AtThread";

// Circular list head; new entries go in at the tail, so a walk sees table order.
CommandEntry g_cmd_list = {&g_cmd_list, &g_cmd_list, nullptr, nullptr, nullptr};

// The parameter of the command being served; only the channel thread uses it.
char g_parm[CMD_PARM_SIZE];

bool same_text(const char *stored, const char *text) {
    if (stored == nullptr || text == nullptr) return stored == text;
    size_t n = strlen(stored);
    return strncmp(stored, text, n) == 0 && strlen(text) == n;
}

// strncmp(line, cmd, strlen(cmd)) == 0, stopping at the first difference.
bool starts_with(const char *line, const char *cmd) {
    while (*cmd != '\0') {
        if (*line++ != *cmd++) return false;
    }
    return true;
}

char *copy_text(const char *s) {
    size_t n = strlen(s);
    char *p = static_cast<char *>(calloc(1, n + 1));
    if (p != nullptr) memcpy(p, s, n);
    return p;
}

void free_entry(CommandEntry *e) {
    free(e->cmd);
    free(e->action);
    free(e);
}

}  // namespace

unsigned int registerModule(const char *cmd, const char *action, AtCmdFun fun, int overwrite) {
    static const char kName[] = "registerModule";
    if (action == nullptr) action = "";
    for (CommandEntry *e = g_cmd_list.next; e != &g_cmd_list; e = e->next) {
        if (!same_text(e->cmd, cmd) || !same_text(e->action, action)) continue;
        if (overwrite & 1) {
            e->fun = fun;
            return REGISTER_OK;
        }
        MMI_LOGD(kTag, "have a fun fo  the same modele, type ,action.");
        return REGISTER_EXISTS;
    }
    CommandEntry *e = static_cast<CommandEntry *>(calloc(1, sizeof(CommandEntry)));
    if (e == nullptr) {
        MMI_LOGD(kTag, "calloc fail");
        return REGISTER_NOMEM;
    }
    if (cmd != nullptr) {
        MMI_LOGD(kTag, "%s::cmd is %s,len=%d", kName, cmd, static_cast<int>(strlen(cmd)));
        e->cmd = copy_text(cmd);
    }
    MMI_LOGD(kTag, "%s::action is %s,len=%d", kName, action, static_cast<int>(strlen(action)));
    e->action = copy_text(action);
    if ((cmd != nullptr && e->cmd == nullptr) || e->action == nullptr) {
        MMI_LOGD(kTag, "calloc fail");
        free_entry(e);
        return REGISTER_NOMEM;
    }
    e->fun = fun;
    e->prev = g_cmd_list.prev;
    e->next = &g_cmd_list;
    g_cmd_list.prev->next = e;
    g_cmd_list.prev = e;
    return REGISTER_OK;
}

unsigned int parseCommand(const char *cmdString, AtCmdFun *fun, char *parm) {
    static const char kName[] = "parseCommand";
    if (g_cmd_list.next == &g_cmd_list || cmdString == nullptr) {
        __android_log_print(ANDROID_LOG_ERROR, kTag, "command not found,ret=PARSE_NOFUND");
        return PARSE_NOFUND;
    }
    unsigned int ret = PARSE_NOFUND;
    const size_t lineLen = strlen(cmdString);
    // Every row is looked at for every command: the walk's own line is only formatted
    // when debug entries are kept.
    const bool walkLog = mmi_log_enabled(ANDROID_LOG_DEBUG);
    for (CommandEntry *e = g_cmd_list.next; e != &g_cmd_list; e = e->next) {
        if (walkLog)
            __android_log_print(ANDROID_LOG_DEBUG, kTag,
                                "tmpcmd->cmd = %s,tmpcmd->action = %s,cmdString = %s",
                                e->cmd != nullptr ? e->cmd : "", e->action, cmdString);
        if (e->cmd == nullptr || !starts_with(cmdString, e->cmd)) continue;
        const size_t cmdLen = strlen(e->cmd);
        MMI_LOGD(kTag, "%s::before cpy parm=%s", kName, parm);
        MMI_LOGD(kTag, "%s::strlen(cmdString)=%d,strlen(tmpcmd->cmd)=%d", kName,
                 static_cast<int>(lineLen), static_cast<int>(cmdLen));
        // The character after the command is a separator whatever it is. With nothing
        // after it the parameter keeps what an earlier candidate copied.
        if (lineLen >= cmdLen + 2) {
            size_t n = lineLen - cmdLen - 1;
            if (n > CMD_PARM_SIZE - 1) n = CMD_PARM_SIZE - 1;
            memcpy(parm, cmdString + cmdLen + 1, n);
            parm[n] = '\0';
        }
        MMI_LOGD(kTag, "%s::after cpy parm=%s", kName, parm);
        if (parm[0] == '\0') {
            *fun = e->fun;
            MMI_LOGD(kTag, "parse valid command");
            return PARSE_OK;
        }
        if (e->action[0] != '\0') {
            const size_t actionLen = strlen(e->action);
            const size_t parmLen = strlen(parm);
            MMI_LOGD(kTag, "%s::tmpcmd->action=%d", kName, static_cast<int>(actionLen));
            __android_log_print(ANDROID_LOG_ERROR, kTag,
                                "%s::parm=%s,parm len=%d,cmd->action=%s,action len=%d", kName, parm,
                                static_cast<int>(parmLen), e->action, static_cast<int>(actionLen));
            if (strncmp(parm, e->action, actionLen) == 0 && parmLen == actionLen) {
                *fun = e->fun;
                MMI_LOGD(kTag, "parse valid command");
                return PARSE_OK;
            }
            continue;
        }
        // A later candidate may still override this one.
        *fun = e->fun;
        MMI_LOGD(kTag, "parse valid command");
        ret = PARSE_OK;
    }
    if (ret == PARSE_OK) return PARSE_OK;
    __android_log_print(ANDROID_LOG_ERROR, kTag, "command not found,ret=PARSE_NOFUND");
    return PARSE_NOFUND;
}

int AtCommandProcess(const char *cmdString, char *reply, unsigned int replySize) {
    memset(g_parm, 0, sizeof(g_parm));
    AtCmdFun fun = nullptr;
    int ret;
    if (parseCommand(cmdString, &fun, g_parm) != PARSE_OK) {
        ret = AT_RESULT_FAIL;
    } else if (fun == nullptr) {
        ret = AT_RESULT_NOHANDLER;
    } else {
        MMI_LOGD(kAtTag, "callfun = %d", static_cast<int>(reinterpret_cast<uintptr_t>(fun)));
        int answer = fun(g_parm, static_cast<int>(strlen(g_parm)), reply, replySize);
        if (answer & 1) {
            MMI_LOGD(kAtTag, "invoke fun success");
            ret = AT_RESULT_OK;
        } else {
            ret = AT_RESULT_FAIL;
        }
        MMI_LOGD(kAtTag, "AtCommandProcess middle ret = %d", ret);
    }
    MMI_LOGD(kAtTag, "AtCommandProcess ret = %d", ret);
    return ret;
}

const CommandEntry *mmi_cmd_registry_next(const CommandEntry *e) {
    const CommandEntry *n = e == nullptr ? g_cmd_list.next : e->next;
    return n == &g_cmd_list ? nullptr : n;
}

int mmi_cmd_registry_count(void) {
    int n = 0;
    for (const CommandEntry *e = mmi_cmd_registry_next(nullptr); e != nullptr;
         e = mmi_cmd_registry_next(e))
        n++;
    return n;
}

void mmi_cmd_registry_clear(void) {
    CommandEntry *e = g_cmd_list.next;
    while (e != &g_cmd_list) {
        CommandEntry *next = e->next;
        free_entry(e);
        e = next;
    }
    g_cmd_list.next = g_cmd_list.prev = &g_cmd_list;
}

// Any line through AtCommandProcess over the real command table, each row registered with
// a handler that records its row: the row reached and its parameter must be what a plain
// reading of the matching rules gives, and the result code must follow the row's handler.
// The parameter then goes through the result record's command back end.
#include <stddef.h>
#include <stdint.h>
#include <stdlib.h>
#include <string.h>

#include <array>
#include <string>
#include <utility>

#include "adbd_connection/AtCmdTable.h"
#include "adbd_connection/handlers/handlers.h"
#include "adbd_connection/CmdParse.h"
#include "core/ftx_lib_binding.h"
#include "session/mmi_testinfo.h"

namespace {

int g_row = 0;
std::string g_parm;

template <int Row>
int record(const char *parm, int parmLen, char *reply, unsigned int replySize) {
    if (parmLen < 0 || parmLen >= CMD_PARM_SIZE || strlen(parm) != static_cast<size_t>(parmLen))
        abort();
    g_row = Row;
    g_parm = parm;
    snprintf(reply, replySize, "%d", Row);
    return Row & 1;  // odd rows succeed, even rows fail
}

template <size_t... I>
constexpr std::array<AtCmdFun, sizeof...(I)> make_recorders(std::index_sequence<I...>) {
    return {&record<static_cast<int>(I) + 1>...};
}
const auto kRecorders = make_recorders(std::make_index_sequence<AT_CMD_TABLE_ROWS>());

// The matching rules read plainly: row number (from 1) and parameter, or 0.
int reference(const std::string &line, std::string *parm) {
    parm->clear();
    int found = 0;
    for (int i = 0; i < AT_CMD_TABLE_ROWS; i++) {
        const std::string cmd = g_atcmd_table[i].cmd, action = g_atcmd_table[i].action;
        if (line.compare(0, cmd.size(), cmd) != 0) continue;
        if (line.size() >= cmd.size() + 2) *parm = line.substr(cmd.size() + 1, CMD_PARM_SIZE - 1);
        if (parm->empty()) return i + 1;
        if (!action.empty()) {
            if (*parm == action) return i + 1;
            continue;
        }
        found = i + 1;
    }
    return found;
}

unsigned char g_area[MMI_TESTINFO_FLAGS_SIZE];
int fake_get(unsigned char *flags) {
    memcpy(flags, g_area, sizeof(g_area));
    return 0;
}
int fake_write(int index, unsigned char value) {
    if (index < 0 || index >= MMI_TESTINFO_FLAGS_SIZE) abort();
    g_area[index] = value;
    return 0;
}

}  // namespace

extern "C" int LLVMFuzzerInitialize(int *, char ***) {
    static char root[] = "/tmp/ftx-fuzz-parser-XXXXXX";
    if (getenv("FTX_ROOT") == nullptr && mkdtemp(root) != nullptr) setenv("FTX_ROOT", root, 1);
    setenv("FTX_LOG_LEVEL", "F", 1);
    for (int i = 0; i < AT_CMD_TABLE_ROWS; i++) {
        const AtCmdRow &r = g_atcmd_table[i];
        if (registerModule(r.cmd, r.action, r.fun != nullptr ? kRecorders[i] : nullptr, 0) != 0)
            abort();
    }
    hw::ftx_api_GetTestInfoFlag = fake_get;
    hw::ftx_api_WriteFuncTestInfoFlags = fake_write;
    return 0;
}

extern "C" int LLVMFuzzerTestOneInput(const uint8_t *data, size_t size) {
    // The channel hands over one line as a C string.
    std::string line(reinterpret_cast<const char *>(data),
                     strnlen(reinterpret_cast<const char *>(data), size));
    if (line.size() > 4095) line.resize(4095);

    std::string expectParm;
    int expectRow = reference(line, &expectParm);
    g_row = 0;
    g_parm = "-";
    char reply[64] = "";
    int rc = AtCommandProcess(line.c_str(), reply, sizeof(reply));
    if (expectRow == 0) {
        if (rc != AT_RESULT_FAIL || g_row != 0) abort();
    } else if (g_atcmd_table[expectRow - 1].fun == nullptr) {
        if (rc != AT_RESULT_NOHANDLER || g_row != 0) abort();
    } else {
        if (g_row != expectRow || g_parm != expectParm) abort();
        if (rc != ((expectRow & 1) ? AT_RESULT_OK : AT_RESULT_FAIL)) abort();
    }

    // The same text as a "testinfoMoudle testItem" parameter.
    std::string parm = line.substr(0, CMD_PARM_SIZE - 1);
    char out[8];
    AutoTest_testinfo(parm.c_str(), static_cast<int>(parm.size()), out, sizeof(out));
    CheckParaResult(parm.c_str(), static_cast<int>(size), static_cast<int>(size & 1));
    return 0;
}

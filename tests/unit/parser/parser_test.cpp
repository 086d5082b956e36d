// The command registry and parser over the real command table, each row registered with
// a handler that records its row, so every resolution names the row that won.
#include <string.h>

#include <array>
#include <string>
#include <utility>

#include <gtest/gtest.h>

#include "adbd_connection/AtCmdTable.h"
#include "adbd_connection/CmdParse.h"
#include "support/temp_root.h"
#include "unit/config/log_capture.h"

namespace {

int g_calledRow = 0;
std::string g_calledParm;
int g_calledLen = -1;
int g_answer = 1;

template <int Row>
int record(const char *parm, int parmLen, char *reply, unsigned int replySize) {
    g_calledRow = Row;
    g_calledParm = parm;
    g_calledLen = parmLen;
    snprintf(reply, replySize, "row %d", Row);
    return g_answer;
}

template <size_t... I>
constexpr std::array<AtCmdFun, sizeof...(I)> make_recorders(std::index_sequence<I...>) {
    return {&record<static_cast<int>(I) + 1>...};
}
const auto kRecorders = make_recorders(std::make_index_sequence<AT_CMD_TABLE_ROWS>());

class Parser : public ::testing::Test {
  protected:
    void SetUp() override {
        mmi_cmd_registry_clear();
        g_answer = 1;
    }
    void TearDown() override { mmi_cmd_registry_clear(); }

    // The table's rows with recording handlers (row numbers from 1).
    void register_recorders() {
        for (int i = 0; i < AT_CMD_TABLE_ROWS; i++) {
            ASSERT_EQ(0u, registerModule(g_atcmd_table[i].cmd, g_atcmd_table[i].action,
                                         kRecorders[i], 0));
        }
    }
    // The row whose handler the line reaches (0: not found) and the parameter it got.
    std::pair<int, std::string> resolve(const std::string &line) {
        char reply[64] = "";
        g_calledRow = 0;
        g_calledParm = "-";
        int rc = AtCommandProcess(line.c_str(), reply, sizeof(reply));
        if (rc == 2 && g_calledRow == 0) return {0, ""};
        EXPECT_EQ(0, rc) << line;
        EXPECT_EQ(static_cast<int>(g_calledParm.size()), g_calledLen);
        return {g_calledRow, g_calledParm};
    }
    TempRoot root;
};

using Hit = std::pair<int, std::string>;

TEST_F(Parser, RegisteringTheTableAgainReplacesHandlersAndAddsNothing) {
    ASSERT_EQ(0, register_at_procs());
    ASSERT_EQ(0, register_at_procs());
    EXPECT_EQ(AT_CMD_TABLE_ROWS, mmi_cmd_registry_count());
}

TEST_F(Parser, AuxRowsWinOverTheirPrefix) {
    register_recorders();
    EXPECT_EQ(Hit(14, "aux"), resolve("LCDMoudle testItem 000000 aux"));
    EXPECT_EQ(Hit(10, "aux"), resolve("LCDMoudle testItem FFFFFF aux"));
    EXPECT_EQ(Hit(15, "aux"), resolve("LCDMoudle testItem close aux"));
    EXPECT_EQ(Hit(8, ""), resolve("LCDMoudle testItem 000000"));
    // A different last word stays with the colour row as its parameter.
    EXPECT_EQ(Hit(8, "main"), resolve("LCDMoudle testItem 000000 main"));
}

TEST_F(Parser, FmRowsAndTheCloseAction) {
    register_recorders();
    EXPECT_EQ(Hit(39, "close"), resolve("FMMoudle testItem close"));
    EXPECT_EQ(Hit(38, "1017"), resolve("FMMoudle testItem 1017"));
    EXPECT_EQ(Hit(38, ""), resolve("FMMoudle testItem"));
    EXPECT_EQ(Hit(38, "closed"), resolve("FMMoudle testItem closed"));
}

TEST_F(Parser, ParameterRowsTakeTheRestOfTheLine) {
    register_recorders();
    EXPECT_EQ(Hit(75, "1"), resolve("simMoudle testItem 1"));
    EXPECT_EQ(Hit(87, "5,2,write"), resolve("testinfoMoudle testItem 5,2,write"));
    EXPECT_EQ(Hit(20, "80"), resolve("LCDbacklightMoudle testItem 80"));
    EXPECT_EQ(Hit(177, "11n"), resolve("WiFiDataRate testItem set 11n"));
    EXPECT_EQ(Hit(147, "lab ap"), resolve("SwitchSSID testItem lab ap"));
    EXPECT_EQ(Hit(77, ""), resolve("batteryMoudle testItem charging"));
    EXPECT_EQ(Hit(78, ""), resolve("batteryMoudle testItem chargeing"));
    EXPECT_EQ(Hit(30, ""), resolve("flashlightMoudle testItem front open"));
    EXPECT_EQ(Hit(156, ""), resolve("audioMoudle testItem HeadsetRecSpeaker"));
    // The separator is any one character.
    EXPECT_EQ(Hit(75, "3"), resolve("simMoudle testItem_3"));
    // An over-long parameter is cut to the buffer.
    Hit longHit = resolve("simMoudle testItem " + std::string(600, 'x'));
    EXPECT_EQ(75, longHit.first);
    EXPECT_EQ(std::string(CMD_PARM_SIZE - 1, 'x'), longHit.second);
}

TEST_F(Parser, StrayCharactersAndSpaceActions) {
    register_recorders();
    EXPECT_EQ(Hit(2, ""), resolve("vibratorMoudle testItem openX"));
    EXPECT_EQ(Hit(2, "now"), resolve("vibratorMoudle testItem open now"));
    EXPECT_EQ(Hit(23, ""), resolve("LCDTurnoffMoudle testItem"));
    EXPECT_EQ(Hit(23, ""), resolve("LCDTurnoffMoudle testItem!"));
    EXPECT_EQ(Hit(23, " "), resolve("LCDTurnoffMoudle testItem  "));
    EXPECT_EQ(Hit(0, ""), resolve("LCDTurnoffMoudle testItem x"));
    EXPECT_EQ(Hit(21, ""), resolve("LCDbacklightTestMoudle testItem close"));
    EXPECT_EQ(Hit(0, ""), resolve("LCDbacklightTestMoudle testItem close now"));
}

TEST_F(Parser, NotFound) {
    register_recorders();
    LogCapture log;
    for (const char *line : {"vibratorMoudle testItem", "vibratorMoudle", "", "nothing at all",
                             "vibratormoudle testItem open"}) {
        EXPECT_EQ(Hit(0, ""), resolve(line)) << line;
    }
    EXPECT_TRUE(log.has("E CMDPARSE: command not found,ret=PARSE_NOFUND"));
    mmi_cmd_registry_clear();
    AtCmdFun fun = nullptr;
    char parm[CMD_PARM_SIZE] = {};
    EXPECT_EQ(2u, parseCommand("vibratorMoudle testItem open", &fun, parm));
}

TEST_F(Parser, ParameterOfAnEarlierCandidateCarriesOver) {
    // A later candidate that adds at most one character keeps the earlier parameter.
    ASSERT_EQ(0u, registerModule("a b", "", kRecorders[0], 0));
    ASSERT_EQ(0u, registerModule("a b cd", "", kRecorders[1], 0));
    ASSERT_EQ(0u, registerModule("a b c", "", kRecorders[2], 0));
    EXPECT_EQ(Hit(3, "cd"), resolve("a b cd"));
}

TEST_F(Parser, RegisterOverwriteAndDuplicates) {
    ASSERT_EQ(0u, registerModule("xMoudle testItem open", "", kRecorders[0], 1));
    ASSERT_EQ(0u, registerModule("yMoudle testItem open", "", kRecorders[1], 1));
    ASSERT_EQ(0u, registerModule("xMoudle testItem open", "", kRecorders[2], 1));
    EXPECT_EQ(2, mmi_cmd_registry_count());
    const CommandEntry *first = mmi_cmd_registry_next(nullptr);
    EXPECT_STREQ("xMoudle testItem open", first->cmd);
    EXPECT_EQ(kRecorders[2], first->fun);

    LogCapture log;
    EXPECT_EQ(3u, registerModule("xMoudle testItem open", "", kRecorders[3], 0));
    EXPECT_EQ(3u, registerModule("xMoudle testItem open", "", kRecorders[3], 2));  // bit 0 only
    EXPECT_TRUE(log.has("have a fun fo  the same modele, type ,action."));
    EXPECT_EQ(kRecorders[2], first->fun);
    // Same command with another action, or a longer command, is a new entry.
    EXPECT_EQ(0u, registerModule("xMoudle testItem open", "close", kRecorders[4], 0));
    EXPECT_EQ(0u, registerModule("xMoudle testItem openX", "", kRecorders[5], 0));
    EXPECT_EQ(0u, registerModule("xMoudle testItem ope", "", kRecorders[6], 0));
    EXPECT_EQ(5, mmi_cmd_registry_count());
}

TEST_F(Parser, DispatchResults) {
    ASSERT_EQ(0, register_at_procs());
    ASSERT_EQ(0u, registerModule("okMoudle testItem", "", kRecorders[0], 0));
    char reply[64] = "";
    EXPECT_EQ(0, AtCommandProcess("okMoudle testItem", reply, sizeof(reply)));
    EXPECT_STREQ("row 1", reply);
    g_answer = 2;  // bit 0 clear
    EXPECT_EQ(2, AtCommandProcess("okMoudle testItem", reply, sizeof(reply)));
    g_answer = 3;
    EXPECT_EQ(0, AtCommandProcess("okMoudle testItem", reply, sizeof(reply)));
    EXPECT_EQ(2, AtCommandProcess("unknownMoudle testItem", reply, sizeof(reply)));
    // A row whose handler is not there yet.
    for (const AtCmdRow &r : g_atcmd_table) {
        if (r.fun != nullptr || r.action[0] != '\0') continue;
        EXPECT_EQ(3, AtCommandProcess(r.cmd, reply, sizeof(reply))) << r.cmd;
        break;
    }
    // The parameter buffer is cleared between commands.
    AtCommandProcess("okMoudle testItem abc", reply, sizeof(reply));
    AtCommandProcess("okMoudle testItem", reply, sizeof(reply));
    EXPECT_EQ("", g_calledParm);
}

}  // namespace

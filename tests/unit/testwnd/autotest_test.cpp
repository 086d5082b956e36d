// The automatic sequence: which item a run opens first and next, what the end of a run
// records, and the restore files.
#include <string.h>

#include <deque>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "session/mmi_autotest.h"
#include "session/mmi_monomer.h"
#include "session/mmi_runstate.h"
#include "core/mmi_settings.h"
#include "testwnd/mmi_testwnd.h"
#include "support/temp_root.h"

namespace {

// The sequence and the preview receive what their windows report, as after start-up.
[[maybe_unused]] const bool kRunsInstalled =
    (mmi_autotest_install_run(), mmi_monomer_install_run(), true);

struct Flags {
    const char *domain;
    int autoF, mmi, pre;
};

// Owns a hand-built item list; the entries record which domain was opened.
std::vector<std::string> g_opened;

void *open_item(const char *domain) {
    g_opened.push_back(domain);
    return nullptr;
}
// One entry per position: the list below has at most six items.
void *e0() {
    return open_item("A");
}
void *e1() {
    return open_item("B");
}
void *e2() {
    return open_item("C");
}
void *e3() {
    return open_item("D");
}
void *e4() {
    return open_item("E");
}
void *e5() {
    return open_item("F");
}
void *e_broken() {
    g_opened.push_back("broken");
    return AUTOTEST_ENTRY_FAILED;
}
testitem_entry_fn kEntries[] = {e0, e1, e2, e3, e4, e5};

class ItemList {
  public:
    explicit ItemList(std::initializer_list<Flags> rows) {
        for (const Flags &f : rows) {
            nodes_.emplace_back();
            testitem_node &n = nodes_.back();
            memset(static_cast<void *>(&n), 0, sizeof(n));
            snprintf(n.config_domain, sizeof(n.config_domain), "%s", f.domain);
            n.item_enable = 1;
            n.item_auto = f.autoF;
            n.item_mmi = f.mmi;
            n.item_pre = f.pre;
            n.entry = kEntries[nodes_.size() - 1];
        }
        for (size_t i = 0; i + 1 < nodes_.size(); i++)
            nodes_[i].pNodeNext = &nodes_[i + 1];
    }
    const testitem_node *head() const { return nodes_.empty() ? nullptr : &nodes_[0]; }
    const testitem_node *at(size_t i) const { return &nodes_[i]; }

  private:
    std::deque<testitem_node> nodes_;
};

const char *domain_of(const testitem_node *n) {
    return n ? n->config_domain : "(end)";
}

// The list: A plain, B not in automatic runs, C operator-judged, D not in pretest 1,
// E pretest-only (auto 0), F plain.
ItemList sample() {
    return ItemList({{"A", 1, 0, 1},
                     {"B", 0, 0, 1},
                     {"C", 1, 1, 1},
                     {"D", 1, 0, 0},
                     {"E", 0, 0, 1},
                     {"F", 1, 0, 1}});
}

TEST(AutotestRule, FirstItemOfEachRun) {
    ItemList l = sample();
    EXPECT_STREQ("A", domain_of(mmi_autotest_first_item(l.head(), AUTOTEST_MODE_FULL, 0)));
    ItemList late({{"B", 0, 0, 1}, {"C", 1, 1, 1}, {"F", 1, 0, 1}});
    EXPECT_STREQ("C", domain_of(mmi_autotest_first_item(late.head(), AUTOTEST_MODE_FULL, 0)));
    EXPECT_STREQ("F", domain_of(mmi_autotest_first_item(late.head(), AUTOTEST_MODE_FULL, 1)));
    // Pretest 1 takes the first item with `pre`, whatever `auto` says.
    EXPECT_STREQ("B", domain_of(mmi_autotest_first_item(late.head(), AUTOTEST_MODE_PRETEST1, 0)));
    // Pretest 2 takes the first item whose `pre` is not 1, also without looking at `auto`.
    ItemList p2({{"A", 1, 0, 1}, {"E", 0, 0, 2}, {"D", 1, 0, 0}});
    EXPECT_STREQ("E", domain_of(mmi_autotest_first_item(p2.head(), AUTOTEST_MODE_PRETEST2, 0)));
    EXPECT_EQ(nullptr, mmi_autotest_first_item(nullptr, AUTOTEST_MODE_FULL, 0));
}

TEST(AutotestRule, NextItemByModeAndPreFlag) {
    ItemList l = sample();
    auto next = [&](size_t from, int mode, int pre) {
        return std::string(domain_of(mmi_autotest_next_item(l.at(from), mode, pre)));
    };
    EXPECT_EQ("C", next(0, AUTOTEST_MODE_FULL, 0));  // B has auto 0
    EXPECT_EQ("D", next(0, AUTOTEST_MODE_FULL, 1));  // C is operator-judged
    EXPECT_EQ("F", next(3, AUTOTEST_MODE_FULL, 0));
    EXPECT_EQ("(end)", next(5, AUTOTEST_MODE_FULL, 0));
    // Pretest 1: pre and auto; D (pre 0) and E (auto 0) are passed over.
    EXPECT_EQ("F", next(2, AUTOTEST_MODE_PRETEST1, 0));
    // Pretest 2: pre not 1 and auto.
    EXPECT_EQ("D", next(0, AUTOTEST_MODE_PRETEST2, 0));
    EXPECT_EQ("(end)", next(3, AUTOTEST_MODE_PRETEST2, 0));
    // The pre-flag pass runs after the mode's own pass and may move further.
    ItemList m({{"A", 1, 0, 1}, {"B", 1, 1, 1}, {"C", 1, 0, 0}});
    EXPECT_EQ("C",
              std::string(domain_of(mmi_autotest_next_item(m.at(0), AUTOTEST_MODE_PRETEST1, 1))));
}

// Every value a configuration row can give `auto`, `mmi` and `pre` (0, 1 and anything
// else), one candidate at a time: whether each run takes it as its first item and as the
// item after another.
TEST(AutotestRule, EachFlagValueInEveryRun) {
    struct Case {
        int autoF, mmi, pre;
        // next item: full run, full run with mmi_flag, pretest 1, pretest 2, pretest 2
        // with mmi_flag
        bool full, fullMmi, pre1, pre2, pre2Mmi;
        // first item: full run with mmi_flag, pretest 1, pretest 2
        bool firstFullMmi, firstPre1, firstPre2;
    };
    const Case kCases[] = {
        {1, 0, 0, true, true, false, true, true, true, false, true},
        {1, 0, 1, true, true, true, false, false, true, true, false},
        {1, 0, 2, true, true, true, true, true, true, true, true},
        {0, 0, 2, false, false, false, false, false, false, true, true},
        {0, 0, 0, false, false, false, false, false, false, false, true},
        {1, 1, 0, true, false, false, true, false, false, false, true},
        {1, 2, 0, true, true, false, true, true, false, false, true},
        {2, 0, 2, true, true, true, true, true, true, true, true},
        {1, 2, 2, true, true, true, true, true, false, true, true},
    };
    for (const Case &c : kCases) {
        SCOPED_TRACE(testing::Message()
                     << "auto " << c.autoF << " mmi " << c.mmi << " pre " << c.pre);
        // The current item's own flags play no part in the next pick.
        ItemList l({{"A", 0, 1, 1}, {"B", c.autoF, c.mmi, c.pre}});
        auto takesNext = [&](int mode, int mmiFlag) {
            return mmi_autotest_next_item(l.at(0), mode, mmiFlag) == l.at(1);
        };
        EXPECT_EQ(c.full, takesNext(AUTOTEST_MODE_FULL, 0));
        EXPECT_EQ(c.fullMmi, takesNext(AUTOTEST_MODE_FULL, 1));
        EXPECT_EQ(c.pre1, takesNext(AUTOTEST_MODE_PRETEST1, 0));
        EXPECT_EQ(c.pre2, takesNext(AUTOTEST_MODE_PRETEST2, 0));
        EXPECT_EQ(c.pre2Mmi, takesNext(AUTOTEST_MODE_PRETEST2, 1));

        ItemList one({{"B", c.autoF, c.mmi, c.pre}});
        auto takesFirst = [&](int mode, int mmiFlag) {
            return mmi_autotest_first_item(one.head(), mode, mmiFlag) == one.at(0);
        };
        EXPECT_EQ(c.full, takesFirst(AUTOTEST_MODE_FULL, 0));
        EXPECT_EQ(c.firstFullMmi, takesFirst(AUTOTEST_MODE_FULL, 1));
        EXPECT_EQ(c.firstPre1, takesFirst(AUTOTEST_MODE_PRETEST1, 0));
        EXPECT_EQ(c.firstPre2, takesFirst(AUTOTEST_MODE_PRETEST2, 0));
    }
}

TEST(AutotestRule, CurrentItemIsFoundByItsDomainPrefix) {
    ItemList l({{"FTX_VIBRATOR", 1, 0, 1}, {"FTX_LCD", 1, 0, 1}});
    EXPECT_EQ(l.at(1), mmi_autotest_find_item(l.head(), "FTX_LCD"));
    EXPECT_EQ(l.at(0), mmi_autotest_find_item(l.head(), "FTX_VIBRATOR_2ND"));
    EXPECT_EQ(nullptr, mmi_autotest_find_item(l.head(), "FTX_SAR"));
}

// ---- the sequence with its outside replaced ----

struct Recorder {
    std::vector<std::pair<int, int>> results;
    std::vector<std::string> configWrites;
    std::string auxLcd = "0";
    std::string mmiFlag = "0";
    std::string pretestMenu = "0";
    unsigned char flags[256] = {0};
    bool listOpen = false;
    int listOpened = 0, refreshed = 0, lcdOff = 0, exitStatus = -1;
};
Recorder *g_rec;
ItemList *g_list;

mmi_autotest_ops fake_ops() {
    mmi_autotest_ops ops;
    ops.write_result = [](int item, int result) {
        g_rec->results.push_back({item, result});
        return 0;
    };
    ops.read_flags = [](unsigned char *flags) {
        memcpy(flags, g_rec->flags, 256);
        return 0;
    };
    ops.read_config = [](const char *, const char *key, char *out, const char *) {
        const std::string &v = strcmp(key, "aux_lcd") == 0    ? g_rec->auxLcd
                               : strcmp(key, "mmi_flag") == 0 ? g_rec->mmiFlag
                                                              : g_rec->pretestMenu;
        snprintf(out, 256, "%s", v.c_str());
        return 0;
    };
    ops.modify_config = [](const char *parm) {
        g_rec->configWrites.push_back(parm);
        return 1;
    };
    ops.build_list = [](int) {
        g_pTestItemListHead = const_cast<testitem_node *>(g_list->head());
        return 0;
    };
    ops.build_aux_list = ops.build_list;
    ops.open_device_list = [] {
        g_rec->listOpened++;
        g_rec->listOpen = true;
        return 0;
    };
    ops.device_list_is_open = [] { return g_rec->listOpen ? 1 : 0; };
    ops.refresh_device_list = [] { g_rec->refreshed++; };
    ops.lcd_off = [] {
        g_rec->lcdOff++;
        return 0;
    };
    ops.exit_process = [](int status) { g_rec->exitStatus = status; };
    ops.sleep_us = [](unsigned long) {};
    return ops;
}

class Sequence : public ::testing::Test {
  protected:
    void SetUp() override {
        g_rec = &rec;
        g_list = &list;
        // The folders of the handset's image.
        root.write("/data/.keep", "");
        root.write(AUTOTEST_TS_MAIN_CTRL_FILE, "");
        g_opened.clear();
        saved = g_autotestOps;
        g_autotestOps = fake_ops();
        g_pTestItemListHead = const_cast<testitem_node *>(list.head());
        g_bRestoreAutotest = 0;
        g_bAutoTestRunning = 0;
        g_autoTestMode = AUTOTEST_MODE_FULL;
        g_mmiPreFlag = 0;
        g_pretestMenuEnabled = 0;
    }
    void TearDown() override {
        g_autotestOps = saved;
        g_pTestItemListHead = nullptr;
        g_bAutoTestRunning = 0;
        g_bRestoreAutotest = 0;
    }
    TempRoot root;
    Recorder rec;
    ItemList list = sample();
    mmi_autotest_ops saved;
};

TEST_F(Sequence, FullRunOpensItemsInTurnAndEndsWithThePreviewPass) {
    mmi_AutoTestEntry();
    EXPECT_EQ(1, g_bAutoTestRunning.load());
    for (const char *d : {"A", "C", "D"})
        mmi_startNextItemTest(d);
    EXPECT_EQ((std::vector<std::string>{"A", "C", "D", "F"}), g_opened);
    EXPECT_TRUE(rec.results.empty());
    mmi_startNextItemTest("F");
    EXPECT_EQ((std::vector<std::pair<int, int>>{{64, 1}}), rec.results);
    EXPECT_EQ(0, g_bAutoTestRunning.load());
    EXPECT_EQ(1, rec.refreshed);
    EXPECT_EQ(0, rec.listOpened);  // restore off: only refreshed
    EXPECT_EQ(-1, rec.exitStatus);
}

TEST_F(Sequence, MmiFlagSkipsOperatorItemsAndIsSwitchedOffAtTheEnd) {
    rec.mmiFlag = "1";
    mmi_AutoTestEntry();
    EXPECT_EQ(1, g_mmiPreFlag.load());
    mmi_startNextItemTest("A");
    mmi_startNextItemTest("F");
    EXPECT_EQ((std::vector<std::string>{"A", "D"}), g_opened);
    EXPECT_EQ((std::vector<std::string>{"MMI,mmi_flag,0"}), rec.configWrites);
}

TEST_F(Sequence, PretestOneFailsItemSixtySixFirstAndPassesItAtTheEnd) {
    mmi_AutoTestEntry_Ex();
    ASSERT_FALSE(rec.results.empty());
    EXPECT_EQ(std::make_pair(66, 2), rec.results.front());
    EXPECT_EQ("A", g_opened.front());
    mmi_startNextItemTest("F");
    EXPECT_EQ(std::make_pair(66, 1), rec.results.back());
    EXPECT_EQ(AUTOTEST_MODE_FULL, g_autoTestMode.load());
}

TEST_F(Sequence, PretestTwoNeedsItemSixtySixPassed) {
    EXPECT_EQ(-1, mmi_AutoTestEntry_Ex2());
    EXPECT_TRUE(g_opened.empty());
    EXPECT_EQ(0, g_bAutoTestRunning.load());
    rec.flags[16] = 0x08;  // item 66 fail
    EXPECT_EQ(-1, mmi_AutoTestEntry_Ex2());
    rec.flags[16] = 0x04;  // item 66 pass
    EXPECT_EQ(0, mmi_AutoTestEntry_Ex2());
    EXPECT_EQ("D", g_opened.front());
    mmi_startNextItemTest("D");
    EXPECT_EQ((std::vector<std::pair<int, int>>{{64, 1}}), rec.results);
}

TEST_F(Sequence, RestoreKeepsTheLastPassedDomainWithoutALineEnd) {
    g_bRestoreAutotest = 1;
    g_bAutoTestRunning = 1;
    mmi_startNextItemTest("A");
    EXPECT_EQ("A", root.read(AUTOTEST_LATEST_PASS_FILE));
    // The first pass after a resume removes the flag instead and runs again.
    g_bAutoTestRunning = 0;
    root.write(AUTOTEST_RESTORE_FLAG_FILE, "");
    mmi_startNextItemTest("C");
    EXPECT_FALSE(root.exists(AUTOTEST_RESTORE_FLAG_FILE));
    EXPECT_EQ("A", root.read(AUTOTEST_LATEST_PASS_FILE));
    EXPECT_EQ(1, g_bAutoTestRunning.load());
    EXPECT_EQ("D", g_opened.back());
}

TEST_F(Sequence, EndWithRestoreRemovesTheFilesAndOpensTheList) {
    g_bRestoreAutotest = 1;
    g_bAutoTestRunning = 1;
    root.write(AUTOTEST_LATEST_PASS_FILE, "D");
    mmi_startNextItemTest("F");
    EXPECT_FALSE(root.exists(AUTOTEST_LATEST_PASS_FILE));
    EXPECT_FALSE(root.exists(AUTOTEST_RESTORE_FLAG_FILE));
    EXPECT_EQ(1, rec.listOpened);
    EXPECT_EQ(1, rec.refreshed);
    EXPECT_EQ(0, g_bAutoTestRunning.load());
}

TEST_F(Sequence, FullRunEndRecordsSixtySixTooWhenThePretestMenuIsOn) {
    rec.pretestMenu = "1";
    mmi_AutoTestEntry();
    EXPECT_EQ(1, g_pretestMenuEnabled.load());
    mmi_startNextItemTest("F");
    EXPECT_EQ((std::vector<std::pair<int, int>>{{66, 1}, {64, 1}}), rec.results);

    // Pretest 1 records its own 66 once, pretest 2 both.
    rec.results.clear();
    mmi_AutoTestEntry_Ex();
    mmi_startNextItemTest("F");
    EXPECT_EQ((std::vector<std::pair<int, int>>{{66, 2}, {66, 1}}), rec.results);
    rec.results.clear();
    rec.flags[16] = 0x04;
    mmi_AutoTestEntry_Ex2();
    mmi_startNextItemTest("D");
    EXPECT_EQ((std::vector<std::pair<int, int>>{{66, 1}, {64, 1}}), rec.results);
}

// A domain that is in no node (nothing here is a prefix of these) ends the run where it
// is: nothing says the run got to its end, so no summary is recorded.
TEST_F(Sequence, DomainNotInTheListEndsTheRunWithoutASummary) {
    for (const char *domain : {"", "ZZ_GONE", "G"}) {
        SCOPED_TRACE(domain);
        rec.results.clear();
        g_bAutoTestRunning = 1;
        g_autoTestMode = AUTOTEST_MODE_PRETEST1;
        EXPECT_EQ(-1, mmi_startNextItemTest(domain));
        EXPECT_TRUE(g_opened.empty());
        EXPECT_TRUE(rec.results.empty());
        EXPECT_EQ(0, g_bAutoTestRunning.load());
        EXPECT_EQ(AUTOTEST_MODE_FULL, g_autoTestMode.load());
    }
    g_bAutoTestRunning = 1;
    g_pTestItemListHead = nullptr;
    EXPECT_EQ(-1, mmi_startNextItemTest("A"));
    EXPECT_EQ(0, g_bAutoTestRunning.load());
}

// What start-up leaves when it resumes: the restore flag, and the domain read from the
// latest-pass file, which a power cut or a changed configuration may have left empty or
// stale.
TEST_F(Sequence, ResumeOfAnEmptyOrStaleDomainRecordsNothing) {
    g_bRestoreAutotest = 1;
    for (const char *domain : {"", "ZZ_NO_LONGER_ENABLED"}) {
        SCOPED_TRACE(domain);
        rec = Recorder();
        root.write(AUTOTEST_RESTORE_FLAG_FILE, "");
        mmi_startNextItemTest(domain);
        EXPECT_TRUE(rec.results.empty());
        EXPECT_TRUE(g_opened.empty());
        EXPECT_EQ(0, g_bAutoTestRunning.load());
        EXPECT_FALSE(root.exists(AUTOTEST_RESTORE_FLAG_FILE));
        EXPECT_EQ(0, rec.listOpened);
    }
}

TEST_F(Sequence, LatestPassIsReplacedWholeOrNotAtAll) {
    g_bRestoreAutotest = 1;
    g_bAutoTestRunning = 1;
    root.write(AUTOTEST_LATEST_PASS_FILE, "FIRST");
    mmi_startNextItemTest("C");
    EXPECT_EQ("C", root.read(AUTOTEST_LATEST_PASS_FILE));
    EXPECT_EQ(0, mmi_autotest_write_latest_pass("FIRST"));
    EXPECT_EQ("FIRST", root.read(AUTOTEST_LATEST_PASS_FILE));
    // Nothing but the file itself is left in /data.
    EXPECT_FALSE(root.exists(std::string(AUTOTEST_LATEST_PASS_FILE) + ".tmp"));
    // A write that cannot be completed leaves the previous content as it was (here the
    // new text has nowhere to go: its neighbour's name is taken by a folder).
    root.write(std::string(AUTOTEST_LATEST_PASS_FILE) + ".tmp/x", "");
    EXPECT_EQ(-1, mmi_autotest_write_latest_pass("D"));
    EXPECT_EQ("FIRST", root.read(AUTOTEST_LATEST_PASS_FILE));
}

// Every way a run ends leaves the device-test list usable: running cleared.
TEST_F(Sequence, ARunWithNothingToOpenIsOverAtOnce) {
    ItemList none({{"A", 0, 0, 0}, {"B", 0, 1, 0}});
    g_list = &none;
    mmi_AutoTestEntry();
    EXPECT_EQ(0, g_bAutoTestRunning.load());
    mmi_AutoTestEntry_Ex();
    EXPECT_EQ(0, g_bAutoTestRunning.load());
    EXPECT_EQ(AUTOTEST_MODE_FULL, g_autoTestMode.load());
    ItemList allPre1({{"A", 1, 0, 1}});
    g_list = &allPre1;
    rec.flags[16] = 0x04;
    mmi_AutoTestEntry_Ex2();
    EXPECT_EQ(0, g_bAutoTestRunning.load());
    EXPECT_TRUE(g_opened.empty());
    rec.mmiFlag = "1";
    ItemList onlyMmi({{"A", 1, 1, 1}});
    g_list = &onlyMmi;
    mmi_AutoTestEntry();
    EXPECT_EQ(0, g_bAutoTestRunning.load());
    EXPECT_TRUE(g_opened.empty());
    g_list = &list;
}

int s_stops = 0;
int fake_stop() {
    s_stops++;
    return 1;
}

TEST_F(Sequence, ClosingTheRunsWindowFromOutsideEndsTheRun) {
    Check_AllTestWnd_Closed();  // whatever an earlier test left registered
    mmi_AutoTestEntry();
    ASSERT_EQ(1, g_bAutoTestRunning.load());
    // Nothing open: a PC start closes nothing and the run goes on.
    EXPECT_EQ(0, Check_AllTestWnd_Closed());
    EXPECT_EQ(1, g_bAutoTestRunning.load());
    HWND fake = (HWND)0x5150;
    mmi_testwnd_register_open(fake, fake_stop);
    EXPECT_EQ(1, Check_AllTestWnd_Closed());
    EXPECT_EQ(1, s_stops);
    EXPECT_EQ(0, g_bAutoTestRunning.load());
    // A window closed outside a run changes nothing.
    g_autoTestMode = AUTOTEST_MODE_PRETEST1;
    mmi_testwnd_register_open(fake, fake_stop);
    EXPECT_EQ(1, Check_AllTestWnd_Closed());
    EXPECT_EQ(AUTOTEST_MODE_PRETEST1, g_autoTestMode.load());
    EXPECT_TRUE(rec.results.empty());
    // The monomer preview ends the same way.
    g_bMonomerPreviewRunning = 1;
    mmi_testwnd_register_open(fake, fake_stop);
    EXPECT_EQ(1, Check_AllTestWnd_Closed());
    EXPECT_EQ(0, g_bMonomerPreviewRunning.load());
}

TEST_F(Sequence, ItemThatCannotOpenEndsTheRunWithoutARecord) {
    const_cast<testitem_node *>(list.at(2))->entry = e_broken;
    mmi_AutoTestEntry();
    mmi_startNextItemTest("A");
    EXPECT_EQ((std::vector<std::string>{"A", "broken"}), g_opened);
    EXPECT_EQ(0, g_bAutoTestRunning.load());
    EXPECT_TRUE(rec.results.empty());
}

TEST_F(Sequence, AuxiliaryLcdEndsTheProcessBetweenTheTwoPasses) {
    rec.auxLcd = "1";
    g_bAutoTestRunning = 1;
    mmi_startNextItemTest("F");
    // Main LCD pass over: item 64 stays failed until the auxiliary pass.
    EXPECT_EQ(std::make_pair(64, 2), rec.results.back());
    EXPECT_TRUE(root.exists(AUTOTEST_AUX_LCD_FLAG_FILE));
    EXPECT_EQ(1, rec.lcdOff);
    EXPECT_EQ(0, rec.exitStatus);

    rec = Recorder();
    rec.auxLcd = "1";
    root.write(AUTOTEST_FB0_BLACK_FLAG_FILE, "");
    mmi_AutoTestEntry();
    EXPECT_EQ("0\n", root.read(AUTOTEST_TS_MAIN_CTRL_FILE));
    mmi_startNextItemTest("F");
    EXPECT_FALSE(root.exists(AUTOTEST_AUX_LCD_FLAG_FILE));
    EXPECT_FALSE(root.exists(AUTOTEST_FB0_BLACK_FLAG_FILE));
    EXPECT_EQ("1\n", root.read(AUTOTEST_TS_MAIN_CTRL_FILE));
    EXPECT_EQ(0, rec.exitStatus);
}

}  // namespace

// The real ftx-mmi, headless: the PC's card reads, the card windows that pass by themselves
// once every configured card is in and fail when their time-out runs out, and the OTG, NFC
// and fingerprint windows driven by the console's device, tag and finger.
#include <string>

#include <gtest/gtest.h>

#include "support/handset.h"
#include "support/text.h"

using namespace handset;

namespace {

std::pair<int, std::string> answer(int result, const std::string &reply) {
    return {result, reply};
}

// A run of the given items from the device-test list, each with its parameter.
struct CardRun {
    Handset h;
    CardRun(std::initializer_list<Item> items,
            std::initializer_list<std::pair<const char *, const char *>> params,
            double scale = 0.25)
        : h(items, scale) {
        for (const auto &p : params)
            h.dut.setConfig(p.first, "parameter", p.second);
    }
    void start(const std::initializer_list<const char *> &hwLines = {}) {
        ASSERT_TRUE(h.start());
        ASSERT_TRUE(h.dut.waitChannel());
        for (const char *line : hwLines)
            ASSERT_TRUE(h.dut.consoleOk(line)) << line;
        h.openDeviceList();
        h.chooseRow(0);
    }
    bool waitResult(int item, int value) {
        return dut_wait_until([&] { return h.result(item) == value; }, 10000);
    }
};

TEST(CardsPc, SimReadsTakeOnlyIndexesZeroToThree) {
    Handset h({});
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.dut.waitChannel());
    EXPECT_EQ(2, h.dut.pc("simMoudle testItem 4").first);
    EXPECT_EQ(2, h.dut.pc("simMoudle testItem A").first);
    EXPECT_EQ(2, h.dut.pc("simMoudle testItem 10").first);  // a first digit in range
    EXPECT_TRUE(h.dut.waitLog("AutoTest_sim_Read::sim index=10 error"));
    EXPECT_FALSE(has(h.dut.console("hw status"), "ftx_api_SimCard_Test_Start("));
    // Slot 3 is empty in the image: read, but not there.
    EXPECT_EQ(answer(2, "*0"), h.dut.pc("simMoudle testItem 3"));
    EXPECT_TRUE(has(h.dut.console("hw status"), "ftx_api_SimCard_Test_Start(3)"));
    ASSERT_TRUE(h.dut.consoleOk("hw card sim 3 1"));
    EXPECT_EQ(answer(0, "*1"), h.dut.pc("simMoudle testItem 3"));
    // No index is SIM 0.
    EXPECT_EQ(answer(0, "*1"), h.dut.pc("simMoudle testItem"));
    EXPECT_TRUE(has(h.dut.console("hw status"), "ftx_api_SimCard_Test_Start(0)"));
}

TEST(CardsPc, SdReadTellsPresenceAndSize) {
    Handset h({});
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.dut.waitChannel());
    EXPECT_EQ(2, h.dut.pc("sdCardMoudle testItem 1").first);
    EXPECT_TRUE(h.dut.waitLog("AutoTest_SDCard_Read::sdcard index=1 error"));
    EXPECT_EQ(answer(0, "*1,15193 MB"), h.dut.pc("sdCardMoudle testItem"));
    ASSERT_TRUE(h.dut.consoleOk("hw card sd 0 1 30436"));
    EXPECT_EQ(answer(0, "*1,30436 MB"), h.dut.pc("sdCardMoudle testItem 0"));
    ASSERT_TRUE(h.dut.consoleOk("hw card sd 0 0"));
    EXPECT_EQ(answer(2, "*0"), h.dut.pc("sdCardMoudle testItem"));
    // A size only for the SD card, and a positive one.
    EXPECT_FALSE(h.dut.consoleOk("hw card sim 0 1 100"));
    EXPECT_FALSE(h.dut.consoleOk("hw card sd 0 1 0"));
}

TEST(CardWindow, ARemovedSimKeepsTheTestWaitingUntilItsTimeOutFails) {
    CardRun run({{"FTX_SIMCARD", 1, 0, 1}, {"FTX_SDCARD", 1, 0, 1}},
                {{"FTX_SIMCARD", "SimSlots:2;Timeout:4"}});
    run.start({"hw card sim 1 0"});
    ASSERT_TRUE(run.h.waitActive("SIM Card Test"));
    ASSERT_TRUE(run.h.dut.waitLog("sim slot 1 present=0"));
    ASSERT_TRUE(run.h.dut.waitLog("no pass within 4 s, fail"));
    EXPECT_TRUE(run.waitResult(324, 2));
    // A fail ends the run: the SD test never opens.
    EXPECT_FALSE(run.h.dut.waitLog("FTX_SDCARD: test window open", 300));
    EXPECT_EQ(0, run.h.result(360));
}

TEST(CardWindow, ACardInsertedWhileWaitingPassesAndTheRunGoesOn) {
    CardRun run({{"FTX_SIMCARD", 1, 0, 1}, {"FTX_SDCARD", 1, 0, 1}},
                {{"FTX_SIMCARD", "SimSlots:3;Timeout:60"}});
    run.start();
    ASSERT_TRUE(run.h.waitActive("SIM Card Test"));
    ASSERT_TRUE(run.h.dut.waitLog("sim slot 2 present=0"));  // the image's third slot is empty
    ASSERT_TRUE(run.h.dut.consoleOk("hw card sim 2 1"));
    ASSERT_TRUE(run.h.dut.waitLog("sim slot 2 present=1"));
    // The SD test follows and passes at once with the card and its size.
    ASSERT_TRUE(run.h.dut.waitLog("sd card present=1 size=15193 MB"));
    EXPECT_TRUE(run.waitResult(360, 1));
    EXPECT_EQ(1, run.h.result(324));
}

TEST(CardWindow, AllCardsWithASimMissingShowsItRedAndTheCountdown) {
    CardRun run({kCards}, {{"FTX_CARDS", "SimSlots:2;Timeout:30"}}, 1.0);
    run.start({"hw card sim 1 0"});
    ASSERT_TRUE(run.h.waitActive("Cards Test"));
    ASSERT_TRUE(run.h.dut.waitLog(kCardsOpened));
    // SIM 1 and the SD card green, SIM 2 red; only the fail label.
    Png p = run.h.shotWhen("card_test.png", [](const Png &s) {
        return s.count(0, 200, 720, 700, red) > 200 && s.count(0, 200, 720, 700, green) > 400;
    });
    EXPECT_TRUE(fail_label(p));
    EXPECT_FALSE(pass_label(p));
    run.h.keepForDocs("card_test.png", "card_test.png");
    run.h.key(61);  // the fail key
    EXPECT_TRUE(run.waitResult(324, 2));
}

// The peripheral tests: what the console does to pass each, and its result item.
struct Peripheral {
    const char *domain;
    const char *caption;
    const char *pass;
    int item;
};
const Peripheral kPeripherals[] = {
    {"FTX_USBHOST", "USB OTG Test", "hw otg plug", -1},
    {"FTX_NFC", "NFC Test", "hw nfc tag 04A2B3C4", 340},
    {"FTX_FINGERPRINT", "Fingerprint Test", "hw finger press", 336},
};

TEST(PeripheralWindow, EachPassesOnItsDeviceAndFailsOnItsTimeOut) {
    for (const Peripheral &p : kPeripherals) {
        SCOPED_TRACE(p.domain);
        {
            CardRun run({{p.domain, 1, 0, 1}, kCards}, {{p.domain, "Timeout:60"}});
            run.start();
            ASSERT_TRUE(run.h.waitActive(p.caption));
            ASSERT_TRUE(run.h.dut.waitLog(std::string(p.domain) + ": test window open"));
            ASSERT_TRUE(run.h.dut.consoleOk(p.pass));
            ASSERT_TRUE(run.h.dut.waitLog("report passed"));
            ASSERT_TRUE(run.h.dut.waitLog(kCardsOpened));  // the run's next item
            if (p.item >= 0) {
                EXPECT_EQ(1, run.h.result(p.item));
            }
        }
        {
            CardRun run({{p.domain, 1, 0, 1}, kCards}, {{p.domain, "Timeout:2"}});
            run.start();
            ASSERT_TRUE(run.h.waitActive(p.caption));
            ASSERT_TRUE(run.h.dut.waitLog("no pass within 2 s, fail"));
            if (p.item >= 0) {
                EXPECT_TRUE(run.waitResult(p.item, 2));
            }
            EXPECT_EQ(0u, run.h.dut.logCount(kCardsOpened));
        }
    }
}

TEST(PeripheralWindow, ABadFingerAsksAgainAndADeviceAlreadyPluggedPassesAtOnce) {
    {
        CardRun run({{"FTX_FINGERPRINT", 1, 0, 1}}, {{"FTX_FINGERPRINT", "Timeout:60"}});
        run.start();
        ASSERT_TRUE(run.h.waitActive("Fingerprint Test"));
        ASSERT_TRUE(run.h.dut.waitLog("FTX_FINGERPRINT: test window open"));
        ASSERT_TRUE(run.h.dut.consoleOk("hw finger bad"));
        ASSERT_TRUE(run.h.dut.waitLog("mmi_cardwnd_report::result=2"));
        ASSERT_TRUE(run.h.dut.consoleOk("idle"));
        EXPECT_EQ("Fingerprint Test", run.h.activeCaption());
        ASSERT_TRUE(run.h.dut.consoleOk("hw finger press"));
        EXPECT_TRUE(run.waitResult(336, 1));
    }
    {
        CardRun run({{"FTX_USBHOST", 1, 0, 1}, kCards}, {{"FTX_USBHOST", "Timeout:60"}});
        run.start({"hw otg plug"});
        ASSERT_TRUE(run.h.dut.waitLog("report passed"));
        ASSERT_TRUE(run.h.dut.waitLog(kCardsOpened));
    }
}

TEST(PeripheralPc, NfcAndFingerprintWindowsWaitForThePcsClose) {
    Handset h({}, 0.1);
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.dut.waitChannel());
    // Nothing shown: the close fails.
    ASSERT_EQ(0, h.dut.pc("nfcMoudle testItem open").first);
    ASSERT_TRUE(h.waitActive("NFC Test"));
    EXPECT_EQ(answer(2, "*none"), h.dut.pc("nfcMoudle testItem close"));
    EXPECT_TRUE(has(h.dut.console("hw status"), "ftx_api_NFC_Stop"));
    // A tag: the window stays for the PC, whose close answers the tag.
    ASSERT_EQ(0, h.dut.pc("nfcMoudle testItem open").first);
    ASSERT_TRUE(h.waitActive("NFC Test"));
    ASSERT_TRUE(h.dut.consoleOk("hw nfc tag 04:A2:B3"));
    ASSERT_TRUE(h.dut.waitLog("report passed, uid=04:A2:B3"));
    ASSERT_TRUE(h.dut.consoleOk("idle"));
    EXPECT_EQ("NFC Test", h.activeCaption());
    EXPECT_EQ(answer(0, "*result=pass;uid=04:A2:B3"), h.dut.pc("nfcMoudle testItem close"));
    EXPECT_FALSE(h.dut.consoleOk("hw nfc tag 04;A2"));  // no field separator in a tag

    ASSERT_EQ(0, h.dut.pc("fingerprintMoudle testItem open").first);
    ASSERT_TRUE(h.waitActive("Fingerprint Test"));
    ASSERT_TRUE(h.dut.consoleOk("hw finger bad"));
    ASSERT_TRUE(h.dut.waitLog("mmi_cardwnd_report::result=2"));
    EXPECT_EQ(answer(2, "*result=fail"), h.dut.pc("fingerprintMoudle testItem close"));
    ASSERT_EQ(0, h.dut.pc("fingerprintMoudle testItem open").first);
    ASSERT_TRUE(h.waitActive("Fingerprint Test"));
    ASSERT_TRUE(h.dut.consoleOk("hw finger press"));
    ASSERT_TRUE(h.dut.waitLog("report passed"));
    EXPECT_EQ(answer(0, "*result=pass"), h.dut.pc("fingerprintMoudle testItem close"));
}

}  // namespace

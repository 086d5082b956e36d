// The real ftx-mmi, headless: the sensor window judged from the simulated sensors, the PC's
// reads and calibration, the hall and SAR windows that pass by themselves, and the
// force-touch windows with the kept calibration.
#include <string>

#include <gtest/gtest.h>

#include "support/handset.h"
#include "support/text.h"

using namespace handset;

namespace {

constexpr Item kSensor = {"FTX_SENSOR", 1, 0, 1};
const char kCaption[] = "Sensor Test";

// A run of the sensor item (then the cards) with the image's sensor list.
struct SensorRun {
    Handset h{{kSensor, kCards}};
    void open() {
        ASSERT_TRUE(h.start());
        ASSERT_TRUE(h.dut.waitChannel());
        h.openDeviceList();
        h.chooseRow(0);
        ASSERT_TRUE(h.waitActive(kCaption));
    }
    void hw(const std::string &line) { ASSERT_TRUE(h.dut.consoleOk("hw sensor " + line)); }
    bool passed(const std::string &sensor) { return h.dut.waitLog("sensor " + sensor + " passed"); }
};

TEST(SensorWindow, EverySensorMovedThroughItsRangeEnablesPass) {
    SensorRun run;
    run.open();
    // At rest: the acceleration, the field and the pressure lie in range at once.
    ASSERT_TRUE(run.passed("acc"));
    ASSERT_TRUE(run.passed("mag"));
    ASSERT_TRUE(run.passed("pressure"));
    run.hw("gyro 0.2,1.5,0");
    ASSERT_TRUE(run.passed("gyro"));
    // A hand over the sensor and away, quicker than the window redraws: no report is lost.
    run.hw("proxi 0");
    run.hw("proxi 5");
    ASSERT_TRUE(run.passed("proxi"));
    // The light is stuck: pass stays off and its key does nothing.
    Png mid = run.h.shotWhen("sensor_test.png", [](const Png &p) { return fail_label(p); });
    EXPECT_FALSE(pass_label(mid));
    run.h.keepForDocs("sensor_test.png", "sensor_test.png");
    run.h.key(60);
    ASSERT_TRUE(run.h.dut.consoleOk("idle"));
    EXPECT_EQ(kCaption, run.h.activeCaption());
    // A light that sweeps from dark to bright passes.
    run.hw("light wave 0 300 400");
    ASSERT_TRUE(run.passed("light"));
    ASSERT_TRUE(run.h.dut.waitLog("every sensor passed"));
    run.h.shotWhen("sensor_pass.png", pass_label);
    run.h.key(60);
    ASSERT_TRUE(run.h.dut.waitLog(kCardsOpened));
    EXPECT_EQ(1, run.h.result(328));
    EXPECT_TRUE(has(run.h.dut.console("hw status"), "ftx_api_Sensors_Test_Stop"));
}

TEST(SensorWindow, AFailRecordsTheItemAndEndsTheRun) {
    SensorRun run;
    run.open();
    run.h.key(61);
    ASSERT_TRUE(run.h.waitActive("Device Test"));
    EXPECT_EQ(2, run.h.result(328));
    EXPECT_FALSE(run.h.dut.waitLog(kCardsOpened, 300));
}

TEST(SensorWindow, AnItemWithoutSensorsOpensNoWindow) {
    Handset h({kSensor});
    h.dut.setConfig("FTX_SENSOR", "parameter",
                    "Acc:0;Mag:0;Gyro:0;Pressure:0;Proxi:0;Light:0;HeartRate:0");
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.dut.waitChannel());
    h.openDeviceList();
    h.chooseRow(4);
    ASSERT_TRUE(h.dut.waitLog("no sensor is configured, test not opened"));
    EXPECT_TRUE(h.waitActive("Device Test"));
}

TEST(SensorPc, ReadsFollowTheSensorsAndCalibrationMovesTheNextRead) {
    Handset h({});
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.dut.waitChannel());
    EXPECT_EQ(std::make_pair(0, std::string("*0,0,9.8")),
              h.dut.pc("sensorMoudle testItem readAcc"));
    EXPECT_EQ(std::make_pair(0, std::string("*20,-5,40")),
              h.dut.pc("sensorMoudle testItem readMag"));
    EXPECT_EQ(std::make_pair(0, std::string("*1013")),
              h.dut.pc("sensorMoudle testItem readPressure"));
    EXPECT_EQ(std::make_pair(0, std::string("*72")),
              h.dut.pc("sensorMoudle testItem readHeartrate"));
    for (const char *proxi : {"0", "5", "2.5"}) {
        ASSERT_TRUE(h.dut.consoleOk(std::string("hw sensor proxi ") + proxi));
        EXPECT_EQ(std::string("*") + proxi, h.dut.pc("sensorMoudle testItem readProxi").second);
    }
    for (const char *lux : {"3", "850"}) {
        ASSERT_TRUE(h.dut.consoleOk(std::string("hw sensor light ") + lux));
        EXPECT_EQ(std::string("*") + lux, h.dut.pc("sensorMoudle testItem readLight").second);
    }
    // Each read starts the library and stops it again.
    EXPECT_TRUE(has(h.dut.console("hw status"), "running=0"));

    ASSERT_TRUE(h.dut.consoleOk("hw sensor acc 0.5,-0.25,9.5"));
    ASSERT_TRUE(h.dut.consoleOk("hw sensor gyro 0.1,0.2,-0.1"));
    EXPECT_EQ("*0.5,-0.25,9.5", h.dut.pc("sensorMoudle testItem readAcc").second);
    auto cal = h.dut.pc("sensorMoudle testItem calibrate");
    EXPECT_EQ(0, cal.first);
    EXPECT_EQ("*acc=-0.50,0.25,0.30;gyro=-0.10,-0.20,0.10", cal.second);
    EXPECT_EQ("*0,0,9.8", h.dut.pc("sensorMoudle testItem readAcc").second);
    EXPECT_EQ("*0,0,0", h.dut.pc("sensorMoudle testItem readGyro").second);
    ASSERT_TRUE(h.dut.consoleOk("hw set ftx_api_Sensors_Calibration -1"));
    EXPECT_EQ(2, h.dut.pc("sensorMoudle testItem calibrate").first);

    // The heart-rate sensor's self test.
    EXPECT_EQ(std::make_pair(0, std::string("*1")),
              h.dut.pc("sensorMoudle testItem heartrateSelfTest"));
    ASSERT_TRUE(h.dut.consoleOk("hw sensor hrself 0"));
    EXPECT_EQ(std::make_pair(2, std::string("*0")),
              h.dut.pc("sensorMoudle testItem heartrateSelfTest"));
}

TEST(SensorPc, OpenShowsTheWindowAndCloseAnswersEachSensor) {
    Handset h({kSensor});
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.dut.waitChannel());
    ASSERT_EQ(0, h.dut.pc("sensorMoudle testItem open").first);
    ASSERT_TRUE(h.waitActive(kCaption));
    ASSERT_TRUE(h.dut.waitLog("sensor acc passed"));
    // A read while the window runs leaves the library running for it.
    EXPECT_EQ("*0,0,9.8", h.dut.pc("sensorMoudle testItem readAcc").second);
    EXPECT_TRUE(has(h.dut.console("hw status"), "running=1"));
    auto partial = h.dut.pc("sensorMoudle testItem close");
    EXPECT_EQ(2, partial.first);
    EXPECT_EQ("*acc=1;mag=1;gyro=0;pressure=1;proxi=0;light=0", partial.second);
    EXPECT_EQ(0, h.result(328));  // the PC's verdict is not recorded
    EXPECT_TRUE(has(h.dut.console("hw status"), "running=0"));

    ASSERT_EQ(0, h.dut.pc("sensorMoudle testItem open").first);
    for (const char *line : {"gyro 0,0,2", "proxi 0", "proxi 9", "light 1", "light 500"})
        ASSERT_TRUE(h.dut.consoleOk(std::string("hw sensor ") + line));
    ASSERT_TRUE(h.dut.waitLog("every sensor passed"));
    // Driven by the PC the window waits for its close.
    EXPECT_EQ(kCaption, h.activeCaption());
    EXPECT_EQ(std::make_pair(0, std::string("*acc=1;mag=1;gyro=1;pressure=1;proxi=1;light=1")),
              h.dut.pc("sensorMoudle testItem close"));
    EXPECT_EQ(2, h.dut.pc("sensorMoudle testItem close").first);  // nothing open
}

TEST(HallPc, TheMagnetMustComeAndGo) {
    Handset h({});
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.dut.waitChannel());
    ASSERT_EQ(0, h.dut.pc("hallsensorMoudle testItem open").first);
    ASSERT_TRUE(h.waitActive("Hall Sensor Test"));
    ASSERT_TRUE(h.dut.consoleOk("hw hall near"));
    ASSERT_TRUE(h.dut.consoleOk("idle"));
    EXPECT_EQ(std::make_pair(2, std::string("*state=0")),
              h.dut.pc("hallsensorMoudle testItem close"));  // it came, it did not go

    ASSERT_EQ(0, h.dut.pc("hallsensorMoudle testItem open").first);
    ASSERT_TRUE(h.dut.consoleOk("hw hall far"));
    ASSERT_TRUE(h.dut.consoleOk("hw hall near"));
    ASSERT_TRUE(h.dut.consoleOk("hw hall far"));
    ASSERT_TRUE(h.dut.waitLog("every sensor passed"));
    EXPECT_EQ(std::make_pair(0, std::string("*state=1")),
              h.dut.pc("hallsensorMoudle testItem close"));
    EXPECT_TRUE(has(h.dut.console("hw status"), "ftx_api_HallSensorTest_Stop"));
}

TEST(HallWindow, BothHallTestsPassByThemselvesInARun) {
    Handset h({{"FTX_HALLSENSOR", 1, 0, 1}, {"FTX_HALL_2ND", 1, 0, 1}, kCards});
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.dut.waitChannel());
    h.openDeviceList();
    h.chooseRow(0);
    ASSERT_TRUE(h.waitActive("Hall Sensor Test"));
    ASSERT_TRUE(h.dut.consoleOk("hw hall near"));
    ASSERT_TRUE(h.dut.consoleOk("hw hall far"));
    ASSERT_TRUE(h.waitActive("Hall Sensor 2 Test"));
    // The first sensor's magnet does nothing to the second.
    ASSERT_TRUE(h.dut.consoleOk("hw hall near"));
    ASSERT_TRUE(h.dut.consoleOk("hw hall far"));
    ASSERT_TRUE(h.dut.consoleOk("idle"));
    EXPECT_EQ("Hall Sensor 2 Test", h.activeCaption());
    ASSERT_TRUE(h.dut.consoleOk("hw hall 2nd near"));
    ASSERT_TRUE(h.dut.consoleOk("hw hall 2nd far"));
    ASSERT_TRUE(h.dut.waitLog(kCardsOpened));
    EXPECT_EQ(1, h.result(352));
    EXPECT_TRUE(has(h.dut.console("hw status"), "ftx_api_Hall_2nd_calibrate"));
}

TEST(SarWindow, TheAuxiliarySensorPassesOnItsOwnReading) {
    Handset h({{"FTX_SAR", 1, 0, 1}, {"FTX_AuxiliarySAR", 1, 0, 1}, kCards});
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.dut.waitChannel());
    h.openDeviceList();
    h.chooseRow(0);
    ASSERT_TRUE(h.waitActive("SAR Test"));
    ASSERT_TRUE(h.dut.consoleOk("hw sar 800"));
    ASSERT_TRUE(h.dut.consoleOk("hw sar 20"));
    ASSERT_TRUE(h.waitActive("Auxiliary SAR Test"));
    // Far from the start does not count, nor a reading between the limits, nor a body that
    // comes and stays.
    for (const char *aux : {"300", "500", "450"})
        ASSERT_TRUE(h.dut.consoleOk(std::string("hw sar aux ") + aux));
    ASSERT_TRUE(h.dut.consoleOk("idle"));
    EXPECT_EQ("Auxiliary SAR Test", h.activeCaption());
    ASSERT_TRUE(h.dut.consoleOk("hw sar aux 100"));
    ASSERT_TRUE(h.dut.waitLog(kCardsOpened));
    EXPECT_EQ(1, h.result(376));
}

TEST(ForceTouchPc, CalibrationIsKeptAndReadBack) {
    Handset h({});
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.dut.waitChannel());
    EXPECT_EQ(2, h.dut.pc("forcetouchcalibrationMoudle testItem read").first);  // none yet

    ASSERT_TRUE(h.dut.consoleOk("hw force 480"));
    EXPECT_EQ(0, h.dut.pc("forcetouchcalibrationMoudle testItem open 500").first);
    EXPECT_TRUE(has(h.dut.console("hw status"), "ftx_api_force_touch_calibration_start"));
    EXPECT_EQ(0, h.dut.pc("forcetouchcalibrationMoudle testItem close").first);
    const auto kept = std::make_pair(0, std::string("*result=pass;value=480"));
    EXPECT_EQ(kept, h.dut.pc("forcetouchcalibrationMoudle testItem read"));
    EXPECT_EQ(kept, h.dut.pc("forcetouchcomprehensiveMoudle testItem read"));

    // A failed calibration keeps the last good one.
    ASSERT_TRUE(h.dut.consoleOk("hw force result fail"));
    EXPECT_EQ(2, h.dut.pc("forcetouchcalibrationMoudle testItem open").first);
    EXPECT_EQ(0, h.dut.pc("forcetouchcalibrationMoudle testItem close").first);
    EXPECT_EQ(kept, h.dut.pc("forcetouchcalibrationMoudle testItem read"));
    EXPECT_EQ(2, h.dut.pc("forcetouchcomprehensiveMoudle testItem open").first);
    ASSERT_TRUE(h.dut.consoleOk("hw force result pass"));
    EXPECT_EQ(0, h.dut.pc("forcetouchcomprehensiveMoudle testItem open").first);
    EXPECT_EQ(0, h.dut.pc("forcetouchcomprehensiveMoudle testItem close").first);
}

TEST(ForceTouchPc, TheTestPassesOnceTheThresholdIsPressed) {
    Handset h({});
    ASSERT_TRUE(h.start());
    ASSERT_TRUE(h.dut.waitChannel());
    ASSERT_EQ(0, h.dut.pc("forcetouchMoudle testItem open").first);
    ASSERT_TRUE(h.waitActive("Force Touch Test"));
    ASSERT_TRUE(h.dut.consoleOk("hw force 150"));
    ASSERT_TRUE(h.dut.consoleOk("idle"));
    EXPECT_EQ(2, h.dut.pc("forcetouchMoudle testItem close").first);

    ASSERT_EQ(0, h.dut.pc("forcetouchMoudle testItem open").first);
    ASSERT_TRUE(h.dut.consoleOk("hw force 260"));
    ASSERT_TRUE(h.dut.waitLog("sensor value passed"));
    ASSERT_TRUE(h.dut.consoleOk("hw force 0"));
    EXPECT_EQ(0, h.dut.pc("forcetouchMoudle testItem close").first);
}

}  // namespace

// The battery service: periodic observer calls from its own thread, the low-level warning,
// and observers that remove themselves.
#include <stdlib.h>

#include <atomic>
#include <chrono>
#include <functional>
#include <string>
#include <thread>

#include <gtest/gtest.h>

#include "ftx_host.h"
#include "hw/libdvk_ncoredevice.h"

namespace {

const bool kFastTime = setenv("FTX_TIME_SCALE", "0.01", 1) == 0;

std::atomic<int> g_temperatureCalls{0};
std::atomic<int> g_voltageCalls{0};
std::atomic<int> g_lastStatus{0};
std::atomic<int> g_lastTemperature{0};

void temperature_cb(const FTX_BATTERY_INFO *info) {
    g_lastStatus = info->batteryStatus;
    g_lastTemperature = info->batteryTemperature;
    ++g_temperatureCalls;
}

// Warns once, as the application's voltage observer does.
void voltage_cb(const FTX_BATTERY_INFO *) {
    ++g_voltageCalls;
    FTX_API_BatteryService_unregister_Observer(FTX_BATTERY_OBSERVER_VOLTAGE, voltage_cb);
}

void hw(const char *line) {
    char reply[1024];
    ASSERT_EQ(ftx_host_hw_dispatch(line, reply, sizeof(reply)), 0) << line << ": " << reply;
}

bool wait_until(const std::function<bool()> &done) {
    for (int i = 0; i < 500; ++i) {
        if (done()) return true;
        std::this_thread::sleep_for(std::chrono::milliseconds(5));
    }
    return false;
}

TEST(BatteryService, ObserversFollowTheModel) {
    ASSERT_TRUE(kFastTime);
    ASSERT_EQ(
        FTX_API_BatteryService_register_Observer(FTX_BATTERY_OBSERVER_TEMPERATURE, temperature_cb),
        0);
    ASSERT_EQ(
        FTX_API_BatteryService_register_Observer(FTX_BATTERY_OBSERVER_TEMPERATURE, temperature_cb),
        0);
    ASSERT_EQ(FTX_API_BatteryService_register_Observer(FTX_BATTERY_OBSERVER_VOLTAGE, voltage_cb),
              0);
    EXPECT_NE(FTX_API_BatteryService_register_Observer(7, temperature_cb), 0);
    ASSERT_EQ(FTX_API_BatteryService_StartService(), 0);

    hw("battery temperature 455");
    hw("charger usb 1");
    EXPECT_TRUE(wait_until([] { return g_lastTemperature == 455; }));
    EXPECT_EQ(g_lastStatus, FTX_BATTERY_STATUS_CHARGING);
    ASSERT_EQ(FTX_API_BatteryService_ChargingStatusSet(0), 0);
    EXPECT_TRUE(wait_until([] { return g_lastStatus == FTX_BATTERY_STATUS_NOT_CHARGING; }));
    FTX_API_BatteryService_ChargingStatusSet(1);

    hw("battery level 10");
    std::this_thread::sleep_for(std::chrono::milliseconds(50));
    EXPECT_EQ(g_voltageCalls, 0) << "no low-level warning while a charger is online";
    hw("charger none");
    EXPECT_TRUE(wait_until([] { return g_voltageCalls > 0; }));
    int before = g_temperatureCalls;
    EXPECT_TRUE(wait_until([&] { return g_temperatureCalls > before + 3; }))
        << "the service goes on after an observer removed itself";
    EXPECT_EQ(g_voltageCalls, 1);
    EXPECT_EQ(g_lastStatus, FTX_BATTERY_STATUS_DISCHARGING);

    ASSERT_EQ(FTX_API_BatteryService_StopService(), 0);
    std::this_thread::sleep_for(std::chrono::milliseconds(40));
    int stopped = g_temperatureCalls;
    std::this_thread::sleep_for(std::chrono::milliseconds(60));
    EXPECT_EQ(g_temperatureCalls, stopped);
    EXPECT_NE(FTX_API_BatteryService_unregister_Observer(FTX_BATTERY_OBSERVER_VOLTAGE, voltage_cb),
              0);
    hw("battery level 80");
    hw("charger usb 1");
}

}  // namespace

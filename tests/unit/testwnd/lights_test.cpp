// The lights' table: which steps an item's parameter makes (the library operations each light
// is switched with are seen through the simulated handset in lights_it.cpp).
#include <stdio.h>
#include <string.h>

#include <string>

#include <gtest/gtest.h>

#include "testwnd/lights/mmi_lights.h"

namespace {

// The steps' names for a parameter text, joined by commas.
std::string steps(const char *parameter) {
    char text[256] = {0};
    snprintf(text, sizeof text, "%s", parameter);
    ftx_config_para p[16];
    memset(p, 0, sizeof p);
    const int n = ftx_config_parse_parameter(text, p, 16);
    int ids[MMI_LIGHTS];
    const int count = mmi_light_steps(p, n, ids, MMI_LIGHTS);
    std::string out;
    for (int i = 0; i < count; i++)
        out += std::string(i ? "," : "") + mmi_light_of(ids[i]).name;
    return out;
}

}  // namespace

TEST(LightSteps, TheParameterChoosesStepsThatKeepTheTablesOrder) {
    // Unnamed lights take their default: every one but the second back flashlight.
    EXPECT_EQ("back flashlight,front flashlight,red LED,green LED,orange LED,key backlight",
              steps(""));
    EXPECT_EQ("second back flashlight,green LED",
              steps("KeyBacklight:0;LedGreen:1;SecondBackFlashlight:1;BackFlashlight:0;"
                    "FrontFlashlight:0;LedRed:0;LedOrange:0"));
    EXPECT_EQ("", steps("BackFlashlight:0;FrontFlashlight:0;LedRed:0;LedGreen:0;LedOrange:0;"
                        "KeyBacklight:0"));
}

TEST(LightSteps, NoParameterKeyBeginsWithAnothersSoEachAnswersOnlyForItself) {
    for (int a = 0; a < MMI_LIGHTS; a++)
        for (int b = 0; b < MMI_LIGHTS; b++) {
            const char *ka = mmi_light_of(a).paramKey, *kb = mmi_light_of(b).paramKey;
            if (a == b || ka == nullptr || kb == nullptr) continue;
            EXPECT_NE(0, strncmp(ka, kb, strlen(kb))) << ka << " begins with " << kb;
        }
    // The all-light switch is never a step, and the steps stop at the caller's room.
    int ids[2];
    ftx_config_para none[1] = {};
    EXPECT_EQ(2, mmi_light_steps(none, 0, ids, 2));
    EXPECT_EQ(MMI_LIGHT_BACK, ids[0]);
    EXPECT_EQ(MMI_LIGHT_FRONT, ids[1]);
}

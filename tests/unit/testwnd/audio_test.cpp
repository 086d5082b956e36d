// The audio tests' texts: the FM stations of the configuration and the calibration answer.
#include <string.h>

#include <gtest/gtest.h>

#include "testwnd/audio/mmi_audio_text.h"

TEST(FmStations, FrequenciesWithOrWithoutNamesAndOnlyThoseInTheBand) {
    mmi_fm_station st[MMI_FM_STATIONS_MAX];
    ASSERT_EQ(3, mmi_fm_parse_stations(" 875 / Jazz ,1017,,1080/News", st, MMI_FM_STATIONS_MAX));
    EXPECT_EQ(875, st[0].frequency);
    EXPECT_STREQ("Jazz", st[0].name);
    EXPECT_STREQ("101.7 MHz", st[1].name);  // no name: the frequency in MHz
    EXPECT_STREQ("News", st[2].name);
    // Out of the band, not a number, too many digits: left out; the list stops at max.
    EXPECT_EQ(1, mmi_fm_parse_stations("500,1090,abc,10170,900", st, MMI_FM_STATIONS_MAX));
    EXPECT_EQ(900, st[0].frequency);
    EXPECT_EQ(2, mmi_fm_parse_stations("875,900,1000", st, 2));
    // A long name is cut to the buffer.
    const std::string longName = "1017/" + std::string(100, 'x');
    ASSERT_EQ(1, mmi_fm_parse_stations(longName.c_str(), st, 1));
    EXPECT_EQ(MMI_FM_NAME_SIZE - 1, (int)strlen(st[0].name));
}

TEST(SmartPaAnswer, PassCarriesTheImpedanceFailNoneAndOtherTextsAreRefused) {
    int ohms = -1;
    EXPECT_EQ(1, mmi_smartpa_parse("result=pass;value=8", &ohms));
    EXPECT_EQ(8, ohms);
    EXPECT_EQ(1, mmi_smartpa_parse("value=6;result=pass", &ohms));
    EXPECT_EQ(6, ohms);
    EXPECT_EQ(0, mmi_smartpa_parse("result=fail;value=0", &ohms));
    EXPECT_EQ(-1, mmi_smartpa_parse("result=pass", &ohms));  // a pass needs its value
    EXPECT_EQ(-1, mmi_smartpa_parse("result=pass;value=-3", &ohms));
    EXPECT_EQ(-1, mmi_smartpa_parse("result=passed;value=8", &ohms));
    EXPECT_EQ(-1, mmi_smartpa_parse("", &ohms));
}

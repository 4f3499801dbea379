#include <gtest/gtest.h>

#include <cstdio>
#include <string>

#include "tests/embedded/value/DateTimeOf.h"

namespace NORVZEL20 {
namespace {

constexpr std::int64_t kMicrosecondsOfDay = 86400000000;

TEST(DateTimeTest, TextComesBackAsItWasRead)
{
    for (const char* const text :
         {"19700101000000.000000+000", "20240229235959.999999+060", "20000101003000.000001-720", "00000101000000.000000+000",
          "99991231235959.999999+999", "00000000000000.000000:000", "99999999235959.999999:000", "00000012123456.9*****:000",
          "2024**********.******+000", "****0131******.******-420", "********120000.000000+000", "202402291234**.******+060",
          "19000301000000.000000+000", "19691231235959.999999+000"}) {
        EXPECT_EQ(text, DateTimeOf(text).ToText());
    }
}

TEST(DateTimeTest, MicrosecondsCountFrom1970InUtc)
{
    EXPECT_EQ(0, DateTimeOf("19700101000000.000000+000").GetMicroseconds());
    EXPECT_EQ(-1, DateTimeOf("19691231235959.999999+000").GetMicroseconds());
    EXPECT_EQ(1709164800000000, DateTimeOf("20240229000000.000000+000").GetMicroseconds());
    EXPECT_EQ(1709164800000000 - 3600000000, DateTimeOf("20240229000000.000000+060").GetMicroseconds());
    EXPECT_EQ(60, DateTimeOf("20240229000000.000000+060").GetOffset());
    EXPECT_EQ(90061000001, DateTimeOf("00000001010101.000001:000").GetMicroseconds());
}

TEST(DateTimeTest, EqualMeansTheSameInstant)
{
    EXPECT_EQ(DateTimeOf("20240101120000.000000+000"), DateTimeOf("20240101130000.000000+060"));
    EXPECT_NE(DateTimeOf("20240101120000.000000+000"), DateTimeOf("20240101120000.000000+060"));
    EXPECT_NE(DateTimeOf("20240101120000.000000+000"), DateTimeOf("20240101120000.000001+000"));
    EXPECT_NE(DateTimeOf("20240101120000.000000+000"), DateTimeOf("20240101120000.00000*+000")) << "asterisks in other places";
    EXPECT_EQ(DateTimeOf("202401011200**.******+000"), DateTimeOf("202401011300**.******+060"));
}

TEST(DateTimeTest, AnIntervalNeverEqualsAPointInTime)
{
    const TCIMDateTime interval = DateTimeOf("00000000000000.000000:000");
    const TCIMDateTime timestamp = DateTimeOf("19700101000000.000000+000");
    EXPECT_TRUE(interval.IsInterval());
    EXPECT_EQ(interval.GetMicroseconds(), timestamp.GetMicroseconds());
    EXPECT_NE(interval, timestamp);
    EXPECT_LT(DateTimeOf("99991231235959.999999+000"), interval);
    EXPECT_FALSE(interval < timestamp);
}

TEST(DateTimeTest, OrderIsThatOfInstants)
{
    EXPECT_LT(DateTimeOf("20240101125959.000000+060"), DateTimeOf("20240101120000.000000+000"));
    EXPECT_LT(DateTimeOf("00000000000000.000000:000"), DateTimeOf("00000000000000.000001:000"));
    EXPECT_FALSE(DateTimeOf("20240101130000.000000+060") < DateTimeOf("20240101120000.000000+000"));
}

TEST(DateTimeTest, UnknownFieldsHaveTheirBits)
{
    EXPECT_EQ(0x001, DateTimeOf("****0131000000.000000+000").GetUnknown());
    EXPECT_EQ(0x800, DateTimeOf("20240131000000.00000*+000").GetUnknown());
    EXPECT_EQ(0xFE0, DateTimeOf("202401310000**.******+000").GetUnknown());
    EXPECT_EQ(0x001, DateTimeOf("********000000.000000:000").GetUnknown());
}

TEST(DateTimeTest, WhatIsNoDateTimeIsRefusedAndLeavesTheResult)
{
    for (const char* const text : {"",
                                   "20240101120000.000000+00",
                                   "20240101120000.000000+0000",
                                   "20240101120000,000000+000",
                                   "20240101120000.000000 000",
                                   "20241301120000.000000+000",
                                   "20240001120000.000000+000",
                                   "20230229120000.000000+000",
                                   "20240431120000.000000+000",
                                   "20240100120000.000000+000",
                                   "20240101240000.000000+000",
                                   "20240101126000.000000+000",
                                   "20240101120060.000000+000",
                                   "2024010112000x.000000+000",
                                   "20240101120000.00000x+000",
                                   "20240101120000.000000+0x0",
                                   "20240101120000.000000*000",
                                   "00000001240000.000000:000",
                                   "00000001000000.000000:001",
                                   "19000229000000.000000+000",
                                   "2*240101120000.000000+000",
                                   "20240101120000.000000+***",
                                   "-0240101120000.000000+000"}) {
        TCIMDateTime time = DateTimeOf("20240101120000.000000+000");
        EXPECT_FALSE(TCIMDateTime::Parse(text, time)) << text;
        EXPECT_EQ("20240101120000.000000+000", time.ToText()) << text;
    }
}

TEST(DateTimeTest, EightDigitsAreTheDaysOfAnInterval)
{
    EXPECT_EQ(20240101 * kMicrosecondsOfDay + kMicrosecondsOfDay / 2, DateTimeOf("20240101120000.000000:000").GetMicroseconds());
}

TEST(DateTimeTest, EveryDayOfFourHundredYearsComesBack)
{
    std::int64_t expected = DateTimeOf("18000101000000.000000+000").GetMicroseconds();
    char text[64];
    for (int year = 1800; year < 2200; ++year) {
        for (int month = 1; month <= 12; ++month) {
            for (int day = 1; day <= 31; ++day) {
                std::snprintf(text, sizeof text, "%04d%02d%02d000000.000000+000", year, month, day);
                TCIMDateTime time;
                if (TCIMDateTime::Parse(text, time)) {
                    ASSERT_EQ(expected, time.GetMicroseconds()) << text;
                    ASSERT_EQ(text, time.ToText());
                    expected += kMicrosecondsOfDay;
                }
            }
        }
    }
    EXPECT_EQ(146097 * kMicrosecondsOfDay, expected - DateTimeOf("18000101000000.000000+000").GetMicroseconds());
}

}  // namespace
}  // namespace NORVZEL20

#include <gtest/gtest.h>

#include <cstdio>
#include <cstdlib>
#include <ctime>
#include <string>
#include <tuple>
#include <utility>

#include "tests/embedded/value/DateTimeOf.h"

namespace NORVZEL20 {
namespace {

constexpr std::int64_t kMicrosecondsOfDay = 86400000000;

/// The text of a point in time at `offset`, by the C library's calendar, with asterisks where `time` has them.
std::string WrittenAt(const TCIMDateTime& time, int offset)
{
    const std::time_t local =
        (time.GetMicroseconds() - (time.GetMicroseconds() % 60000000 + 60000000) % 60000000) / 1000000 + offset * 60;
    std::tm parts{};
    gmtime_r(&local, &parts);
    char text[64];
    std::snprintf(text, sizeof text, "%04d%02d%02d%02d%02d", parts.tm_year + 1900, parts.tm_mon + 1, parts.tm_mday, parts.tm_hour,
                  parts.tm_min);
    std::string written(text);
    for (const auto& [start, length, bit] : {std::tuple(0, 4, 0), {4, 2, 1}, {6, 2, 2}, {8, 2, 3}, {10, 2, 4}}) {
        if ((time.GetUnknown() >> bit & 1) != 0) {
            written.replace(static_cast<std::size_t>(start), static_cast<std::size_t>(length), static_cast<std::size_t>(length),
                            '*');
        }
    }
    std::snprintf(text, sizeof text, "%c%03d", offset < 0 ? '-' : '+', std::abs(offset));
    return written + time.ToText().substr(12, 9) + text;
}

/// The canonical text by its definition: tries 0, 1, -1, 2, -2, ... until the text is that of an equal datetime.
std::string FirstEqualText(const TCIMDateTime& time)
{
    for (int distance = 0; distance <= 999; ++distance) {
        for (const int offset : {distance, -distance}) {
            const std::string text = WrittenAt(time, offset);
            TCIMDateTime read;
            if (TCIMDateTime::Parse(text, read) && read == time) {
                return text;
            }
        }
    }
    return "none";
}

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

TEST(DateTimeTest, TheCanonicalOffsetIsTheOneNextToUtcThatCanExpressIt)
{
    const std::pair<const char*, const char*> cases[] = {
        {"20240229120000.000000+060", "20240229110000.000000+000"}, {"20240229******.******-999", "20240301******.******+441"},
        {"20240229******.******+720", "20240229******.******+720"}, {"20240229******.******-720", "20240301******.******+720"},
        {"2024022912****.******+030", "2024022912****.******+030"}, {"2024022912****.******-030", "2024022913****.******+030"},
        {"00000101000000.000000+999", "00000101000000.000000+999"}, {"99991231235959.999999-999", "99991231235959.999999-999"},
        {"********120000.000000+060", "********110000.000000+000"}, {"00000012123456.9*****:000", "00000012123456.9*****:000"},
    };
    for (const auto& [text, canonical] : cases) {
        EXPECT_EQ(canonical, DateTimeOf(text).GetCanonical().ToText()) << text;
    }
}

TEST(DateTimeTest, TheCanonicalTextIsTheFirstThatReadsAsAnEqualDatetime)
{
    const char* const places[] = {"00000101", "0000****", "****0101", "********", "19691231", "20240229",
                                  "2024**01", "202403**", "20241231", "99990101", "9999****", "99991231"};
    const char* const times[] = {"000000", "235959", "****12", "**0000", "**5900",
                                 "00****", "12****", "23****", "******", "113001"};
    for (const std::string place : places) {
        for (const char* const time : times) {
            for (const char* const offset :
                 {"+001", "-001", "+030", "-030", "+060", "-090", "+480", "-720", "+721", "+999", "-999"}) {
                const std::string text = place + time + ".12345*" + offset;
                const TCIMDateTime read = DateTimeOf(text);
                ASSERT_EQ(FirstEqualText(read), read.GetCanonical().ToText()) << text;
            }
        }
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

#include <gtest/gtest.h>

#include <random>
#include <set>

#include "client/text/ReadableTime.h"
#include "client/text/TUnit.h"
#include "client/text/TValueNames.h"

namespace NORVZEL20 {
namespace {

TEST(ReadableTimeTest, WritesDatesAndIntervalsAsPeopleDo)
{
    const struct {
        const char* text;
        const char* readable;
    } cases[] = {{"20240131100000.000000+060", "2024-01-31 10:00:00 +01:00"},
                 {"20240131100000.500000-330", "2024-01-31 10:00:00.5 -05:30"},
                 {"20240131100000.000001+000", "2024-01-31 10:00:00.000001 +00:00"},
                 {"00000003040506.000000:000", "3 d 04:05:06"},
                 {"00000000000000.250000:000", "0 d 00:00:00.25"},
                 {"20240131******.******+060", "20240131******.******+060"},
                 {"00000003040506.******:000", "00000003040506.******:000"},
                 {"2024-01-31", "2024-01-31"}};
    for (const auto& expected : cases) {
        EXPECT_EQ(expected.readable, ReadableTime(expected.text));
    }
}

TEST(TUnitTest, NamesUnitsAsTheyAreWritten)
{
    const TCIMValue number = 1500U;
    const struct {
        const char* programmatic;
        const char* units;
        const char* text;
    } cases[] = {{"", "", ""},
                 {"hertz * 10^6", "MegaHertz", "1500 MHz"},
                 {"hertz", "", "1500 Hz"},
                 {"second * 10^-3", "", "1500 ms"},
                 {"bit / second", "Bits per Second", "1500 bit/s"},
                 {"percent", "", "1500 %"},
                 {"revolution / minute", "", "1500 rpm"},
                 {"furlong", "Furlongs", "1500 Furlongs"},
                 {"furlong", "", "1500 furlong"},
                 {"meter * 10^-4", "", "1500 meter * 10^-4"},
                 {" count / second ", "", "1500 \"count / second\""},
                 {"", "MilliSeconds", "1500 ms"},
                 {"", "Tenths of a: Degree", "1500 \"Tenths of a: Degree\""},
                 {"byte", "", "1500 bytes"},
                 {"", "Bytes", "1500 bytes"},
                 {"byte * 2^10", "KiloBytes", "1.46 MiB (1536000 bytes)"},
                 {"byte * 2^20 * 1024", "", "1.46 TiB (1610612736000 bytes)"},
                 {"byte * 10^3", "KiloBytes", "1.43 MiB (1500000 bytes)"},
                 {"byte * 2^63", "", "1500 byte * 2^63"},
                 {"byte * 2^70", "", "1500 byte * 2^70"}};
    for (const auto& expected : cases) {
        EXPECT_EQ(expected.text, TUnit(expected.programmatic, expected.units).Describe(number)) << expected.programmatic;
    }
}

TEST(TUnitTest, OneIsSingular)
{
    const struct {
        const char* programmatic;
        const char* units;
        TCIMValue number;
        const char* text;
    } cases[] = {{"", "KiloBytes", TCIMValue(1U), "1 KiloByte"},
                 {"", "KiloBytes", TCIMValue(-1), "-1 KiloByte"},
                 {"", "KiloBytes", TCIMValue(2U), "2 KiloBytes"},
                 {"", "Hundredths of Seconds", TCIMValue(1U), "1 Hundredth of Seconds"},
                 {"", "Degrees Celsius", TCIMValue(1U), "1 Degree Celsius"},
                 {"", "Celsius", TCIMValue(1U), "1 Celsius"},
                 {"", "Gauss", TCIMValue(1U), "1 Gauss"},
                 {"", "Seconds", TCIMValue(1U), "1 s"},
                 {"byte", "", TCIMValue(1U), "1 byte"},
                 {"byte", "", TCIMValue(-1), "-1 byte"},
                 {"byte", "", TCIMValue(-2), "-2 bytes"},
                 {"", "Bytes", TCIMValue(-1), "-1 byte"},
                 {"byte * 2^10", "KiloBytes", TCIMValue(-5), "-5 byte * 2^10"},
                 {"bit / second", "", TCIMValue(1U), "1 bit/s"}};
    for (const auto& expected : cases) {
        EXPECT_EQ(expected.text, TUnit(expected.programmatic, expected.units).Describe(expected.number)) << expected.text;
    }
}

TEST(TUnitTest, BytesAreInTheLargestUnitAndNeverAlike)
{
    EXPECT_EQ("0 bytes", ReadableBytes(0));
    EXPECT_EQ("1 byte", ReadableBytes(1));
    EXPECT_EQ("1023 bytes", ReadableBytes(1023));
    EXPECT_EQ("1 KiB", ReadableBytes(1024));
    EXPECT_EQ("1500 bytes", ReadableBytes(1500));
    EXPECT_EQ("1536 bytes", ReadableBytes(1536));
    EXPECT_EQ("64 KiB", ReadableBytes(65536));
    EXPECT_EQ("1048575 bytes", ReadableBytes(1048575));
    EXPECT_EQ("1.5 MiB", ReadableBytes(1572864));
    EXPECT_EQ("512 MiB", ReadableBytes(536870912));
    EXPECT_EQ("7.46 MiB (7823345 bytes)", ReadableBytes(7823345));
    EXPECT_EQ("16 EiB (18446744073709551615 bytes)", ReadableBytes(UINT64_MAX));
    std::mt19937_64 random(7);
    std::set<std::uint64_t> numbers;
    std::set<std::string> texts;
    for (int i = 0; i < 20000; ++i) {
        const std::uint64_t number = random() >> (random() % 64);
        numbers.insert(number);
        texts.insert(ReadableBytes(number));
        numbers.insert(number + 1);
        texts.insert(ReadableBytes(number + 1));
    }
    EXPECT_EQ(numbers.size(), texts.size());
}

TEST(TValueNamesTest, NamesNumbersAndRanges)
{
    const TValueNames names({"-1", "1", "5..10", "..-5", "0x20..", "..", "junk"},
                            {"Minus", "One", "Few", "Low", "High", "Other", "Never"});
    const struct {
        int number;
        const char* name;
    } cases[] = {{-1, "Minus"}, {1, "One"},  {5, "Few"},   {10, "Few"},  {11, "Other"},
                 {-5, "Low"},   {-9, "Low"}, {32, "High"}, {99, "High"}, {0, "Other"}};
    for (const auto& expected : cases) {
        const std::string* const name = names.Find(TCIMValue(expected.number));
        ASSERT_NE(nullptr, name) << expected.number;
        EXPECT_EQ(expected.name, *name) << expected.number;
    }
}

TEST(TValueNamesTest, ASingleNumberGoesBeforeARange)
{
    const TValueNames names({"0..9", "5"}, {"Any", "Five"});
    EXPECT_EQ("Five", *names.Find(TCIMValue(5)));
    EXPECT_EQ("Any", *names.Find(TCIMValue(6)));
    EXPECT_EQ(nullptr, names.Find(TCIMValue(10)));
}

TEST(TValueNamesTest, WithoutAMapNamesAreThoseOfPositions)
{
    const TValueNames names({}, {"Unknown", "Other"});
    EXPECT_EQ("Unknown", *names.Find(TCIMValue(0U)));
    EXPECT_EQ("Other", *names.Find(TCIMValue(1U)));
    EXPECT_EQ(nullptr, names.Find(TCIMValue(2U)));
    EXPECT_EQ(nullptr, names.Find(TCIMValue("1")));
    EXPECT_EQ(nullptr, names.Find(TCIMValue::Null(TCIMValue::TCIMType::kUint16)));
}

}  // namespace
}  // namespace NORVZEL20

#include "embedded/value/TValueText.h"

#include <gtest/gtest.h>

#include <limits>
#include <string>
#include <utility>
#include <vector>

#include "tests/embedded/value/ValuePrinter.h"

namespace NORVZEL20 {
namespace {

using TType = TCIMValue::TCIMType;

std::string Read(TType::ECIMType type, const std::string& text)
{
    TCIMValue value("untouched");
    if (!TValueText::Parse(type, text, value)) {
        EXPECT_EQ("untouched", value.ToText()) << "a refused text leaves the result";
        return "refused";
    }
    EXPECT_EQ(type, value.GetType());
    return value.ToText();
}

std::string Converted(const TCIMValue& value, TType::ECIMType type)
{
    TCIMValue result("untouched");
    if (!TValueText::Convert(value, type, result)) {
        EXPECT_EQ("untouched", result.ToText());
        return "refused";
    }
    EXPECT_EQ(type, result.GetType());
    return result.ToText();
}

struct TCase {
    TType::ECIMType type;
    const char* text;
    const char* expected;
};

TEST(ValueTextTest, TextBecomesAValueOfItsType)
{
    const TCase cases[] = {
        {TType::kBoolean, "TRUE", "TRUE"},
        {TType::kBoolean, " false\n", "FALSE"},
        {TType::kUint8, "255", "255"},
        {TType::kUint8, "+007", "7"},
        {TType::kUint8, "0xfF", "255"},
        {TType::kSint8, "-128", "-128"},
        {TType::kSint8, "-0X80", "-128"},
        {TType::kSint8, "-0", "0"},
        {TType::kUint16, "65535", "65535"},
        {TType::kSint16, "-32768", "-32768"},
        {TType::kUint32, "4294967295", "4294967295"},
        {TType::kSint32, "-2147483648", "-2147483648"},
        {TType::kUint64, "18446744073709551615", "18446744073709551615"},
        {TType::kSint64, "-9223372036854775808", "-9223372036854775808"},
        {TType::kSint64, "\t9223372036854775807 ", "9223372036854775807"},
        {TType::kReal32, "0.1", "0.1"},
        {TType::kReal32, "3.4028235e38", "3.4028235e+38"},
        {TType::kReal64, "+1.5E+3", "1500"},
        {TType::kReal64, ".5", "0.5"},
        {TType::kReal64, "-inf", "-INF"},
        {TType::kReal64, "+INF", "INF"},
        {TType::kReal64, "nan", "NaN"},
        {TType::kReal64, "4.9406564584124654e-324", "5e-324"},
        {TType::kChar16, "x", "x"},
        {TType::kChar16, " ", " "},
        {TType::kChar16, "\xC3\xA4", "\xC3\xA4"},
        {TType::kChar16, "\xE2\x82\xAC", "\xE2\x82\xAC"},
        {TType::kString, " as it is ", " as it is "},
        {TType::kString, "", ""},
        {TType::kDateTime, " 20240101120000.000000+000 ", "20240101120000.000000+000"},
    };
    for (const TCase& c : cases) {
        EXPECT_EQ(c.expected, Read(c.type, c.text)) << static_cast<int>(c.type) << " " << c.text;
    }
}

void ExpectRefused(const std::vector<std::pair<TType::ECIMType, const char*>>& rows)
{
    for (const auto& [type, text] : rows) {
        EXPECT_EQ("refused", Read(type, text)) << static_cast<int>(type) << " " << text;
    }
}

TEST(ValueTextTest, ANumberThatDoesNotFitItsTypeIsRefused)
{
    ExpectRefused({
        {TType::kUint8, "256"},
        {TType::kUint8, "-1"},
        {TType::kUint8, ""},
        {TType::kUint8, "-0"},
        {TType::kUint8, "0x"},
        {TType::kUint8, "0x100"},
        {TType::kUint8, "1.0"},
        {TType::kUint8, "1 2"},
        {TType::kUint8, "+"},
        {TType::kUint8, "+-1"},
        {TType::kSint8, "128"},
        {TType::kSint8, "-129"},
        {TType::kSint8, "--1"},
        {TType::kUint16, "65536"},
        {TType::kSint16, "32768"},
        {TType::kSint16, "-32769"},
        {TType::kUint32, "4294967296"},
        {TType::kSint32, "2147483648"},
        {TType::kSint32, "-2147483649"},
        {TType::kUint64, "18446744073709551616"},
        {TType::kSint64, "9223372036854775808"},
        {TType::kSint64, "-9223372036854775809"},
        {TType::kReal32, "1e39"},
        {TType::kReal64, "1e309"},
        {TType::kReal64, "1,5"},
        {TType::kReal64, "infinity"},
        {TType::kReal64, "nan(1)"},
        {TType::kReal64, "+-1"},
        {TType::kReal64, "0x1p3"},
        {TType::kReal64, ""},
        {TType::kReal64, "-"},
        {TType::kReal64, "."},
        {TType::kReal64, "1.5x"},
    });
}

TEST(ValueTextTest, OtherTextThatDoesNotFitItsTypeIsRefused)
{
    ExpectRefused({
        {TType::kBoolean, ""},
        {TType::kBoolean, "1"},
        {TType::kBoolean, "TRUEE"},
        {TType::kChar16, ""},
        {TType::kChar16, "xy"},
        {TType::kChar16, "\xF0\x9F\x98\x80"},
        {TType::kChar16, "\xC3"},
        {TType::kChar16, "\xC0\x80"},
        {TType::kChar16, "\xE0\x80\x80"},
        {TType::kChar16, "\xFF"},
        {TType::kDateTime, "yesterday"},
        {TType::kReference, "Disk"},
        {TType::kArrayUint8, "1"},
        {TType::kNone, "x"},
    });
}

TEST(ValueTextTest, TextOfAValueReadsBackEqual)
{
    for (const TCIMValue& value :
         {TCIMValue(0.1f), TCIMValue(0.1), TCIMValue(1.0 / 3), TCIMValue(1e22), TCIMValue(-0.0), TCIMValue(~0ul), TCIMValue(true),
          TCIMValue(u'\u20AC'), TCIMValue(16777217.0), TCIMValue(1e-320)}) {
        EXPECT_EQ(value.ToText(), Read(value.GetType(), value.ToText()));
    }
}

TEST(ValueTextTest, ConversionLosesNothing)
{
    EXPECT_EQ("5", Converted(TCIMValue(5ul), TType::kUint8));
    EXPECT_EQ("-5", Converted(TCIMValue(-5l), TType::kSint8));
    EXPECT_EQ("5", Converted(TCIMValue(5l), TType::kUint64));
    EXPECT_EQ("9007199254740993", Converted(TCIMValue(9007199254740993ul), TType::kSint64));
    EXPECT_EQ("-5", Converted(TCIMValue(-5l), TType::kReal64));
    EXPECT_EQ("0.5", Converted(TCIMValue(0.5), TType::kReal32));
    EXPECT_EQ("0.10000000149011612", Converted(TCIMValue(0.1f), TType::kReal64));
    EXPECT_EQ("NaN", Converted(TCIMValue(std::numeric_limits<double>::quiet_NaN()), TType::kReal32));
    EXPECT_EQ("5", Converted(TCIMValue("5"), TType::kUint16));
    EXPECT_EQ("TRUE", Converted(TCIMValue("true"), TType::kBoolean));
    EXPECT_EQ("20240101120000.000000+000", Converted(TCIMValue("20240101120000.000000+000"), TType::kDateTime));
    EXPECT_EQ("Disk.Id=1", Converted(TCIMValue("Disk.Id=1"), TType::kReference));
    EXPECT_EQ("Disk.Id=1", Converted(TCIMValue(TCIMReference::Parse("Disk.Id=1")), TType::kString));
    EXPECT_EQ("x", Converted(TCIMValue(u'x'), TType::kString));
    EXPECT_EQ("NULL", Converted(TCIMValue(), TType::kUint8));
    EXPECT_EQ("NULL", Converted(TCIMValue::Null(TType::kString), TType::kArrayUint8));
    EXPECT_EQ("as it is", Converted(TCIMValue("as it is"), TType::kString));
    EXPECT_EQ("{1, NULL}", Converted(TCIMValue(TType::kUint64, 2, {TCIMValue(1ul), TCIMValue()}), TType::kArrayUint8));
}

TEST(ValueTextTest, ConversionThatWouldLoseSomethingIsRefused)
{
    EXPECT_EQ("refused", Converted(TCIMValue(256ul), TType::kUint8));
    EXPECT_EQ("refused", Converted(TCIMValue(-1l), TType::kUint64));
    EXPECT_EQ("refused", Converted(TCIMValue(~0ul), TType::kSint64));
    EXPECT_EQ("refused", Converted(TCIMValue(9007199254740993ul), TType::kReal64));
    EXPECT_EQ("refused", Converted(TCIMValue(~0ul), TType::kReal64));
    EXPECT_EQ("refused", Converted(TCIMValue(16777217), TType::kReal32));
    EXPECT_EQ("refused", Converted(TCIMValue(0.1), TType::kReal32));
    EXPECT_EQ("refused", Converted(TCIMValue(1e300), TType::kReal32));
    EXPECT_EQ("refused", Converted(TCIMValue(1.0), TType::kUint8));
    EXPECT_EQ("refused", Converted(TCIMValue(true), TType::kUint8));
    EXPECT_EQ("refused", Converted(TCIMValue(1), TType::kBoolean));
    EXPECT_EQ("refused", Converted(TCIMValue(1), TType::kString));
    EXPECT_EQ("refused", Converted(TCIMValue(u'1'), TType::kUint16));
    EXPECT_EQ("refused", Converted(TCIMValue("five"), TType::kUint16));
    EXPECT_EQ("refused", Converted(TCIMValue("no path"), TType::kReference));
    EXPECT_EQ("refused", Converted(TCIMValue(".Id=1"), TType::kReference));
    EXPECT_EQ("refused", Converted(TCIMValue("root/cimv2:.Id=1"), TType::kReference));
    EXPECT_EQ("refused", Converted(TCIMValue(1ul), TType::kArrayUint8));
    EXPECT_EQ("refused", Converted(TCIMValue(TType::kUint64, 1, {TCIMValue(1ul)}), TType::kUint8));
    EXPECT_EQ("refused", Converted(TCIMValue(TType::kUint64, 2, {TCIMValue(1ul), TCIMValue(256ul)}), TType::kArrayUint8));
}

TEST(ValueTextTest, ABagStaysABagWhenConverted)
{
    TCIMValue result;
    ASSERT_TRUE(TValueText::Convert(TCIMValue(TType::kUint64, 1, {TCIMValue(1ul)}).AsBag(), TType(TType::kArrayUint8), result));
    EXPECT_TRUE(result.IsBag());
}

TEST(ValueTextTest, TypesHaveTheirNames)
{
    std::string names;
    for (int code = 0; code <= 15; ++code) {
        const char* const name = TValueText::GetTypeName(static_cast<TType::ECIMType>(code));
        names += std::string(name) + " ";
        EXPECT_EQ(code, static_cast<int>(TValueText::FindType(name)));
    }
    EXPECT_EQ(" boolean uint8 sint8 uint16 sint16 uint32 sint32 uint64 sint64 real32 real64 char16 string datetime reference ",
              names);
    EXPECT_STREQ("uint16", TValueText::GetTypeName(TType::kArrayUint16));
    EXPECT_EQ(TType::kNone, TValueText::FindType("UINT8"));
    EXPECT_EQ(TType::kNone, TValueText::FindType("uint"));
}

TEST(ValueTextTest, TypesAreDescribedWithBracketsForArrays)
{
    EXPECT_EQ("none", TValueText::DescribeType(TType::kNone));
    EXPECT_EQ("reference", TValueText::DescribeType(TType::kReference));
    EXPECT_EQ("uint16[]", TValueText::DescribeType(TType::kArrayUint16));
}

TEST(ValueTextTest, AKeyOfAPathBecomesTheReal32OfTheSameText)
{
    const std::pair<TCIMValue, const char*> cases[] = {
        {TCIMValue(0.1), "0.1"},        {TCIMValue(1e30), "1e+30"}, {TCIMValue(0.5), "0.5"},
        {TCIMValue(5ul), "5"},          {TCIMValue("0.1"), "0.1"},  {TCIMValue(), "NULL"},
        {TCIMValue(0.123456789), "no"}, {TCIMValue(1e300), "no"},   {TCIMValue(16777217ul), "no"},
    };
    for (const auto& [key, text] : cases) {
        TCIMValue converted("no");
        TValueText::ConvertKey(key, TType::kReal32, converted);
        EXPECT_EQ(text, converted.ToText());
        EXPECT_EQ(converted.ToText() == "no" ? TType::kString : TType::kReal32, converted.GetType()) << key.ToText();
    }
    TCIMValue untouched("no");
    EXPECT_FALSE(TValueText::ConvertKey(TCIMValue(0.5), TType::kUint8, untouched));
    EXPECT_EQ("no", untouched.ToText());
}

}  // namespace
}  // namespace NORVZEL20
